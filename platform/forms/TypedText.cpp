// SPDX-License-Identifier: MIT
#include "platform/forms/TypedText.h"

#include <cmath>

#include "platform/core/Failure.h"
#include "platform/core/Format.h"
#include "platform/core/Money.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace forms {

namespace {

constexpr QStringView NoValue = u"«%1» não é um valor válido.";
constexpr QStringView NoDate = u"«%1» não é uma data válida.";
constexpr QStringView NotWhole = u"«%1» não é um número inteiro.";
constexpr QStringView TooLarge = u"«%1» é um valor demasiado grande.";
constexpr QStringView TooFine = u"«%1» tem mais de quatro casas decimais.";

[[noreturn]] void refuse(QStringView reason, const QString& typed) {
    constexpr qsizetype Quoted = 40;
    const QString quoted = typed.size() > Quoted ? typed.left(Quoted) + u'…' : typed;
    // The quoted text is joined and not put in by arg(): it may hold a place mark itself.
    const qsizetype mark = reason.indexOf(u"%1");
    throw core::Failure(core::TypeMismatch,
                        reason.left(mark).toString() + quoted + reason.mid(mark + 2).toString());
}

qsizetype decimalsOf(QString plain) {
    const qsizetype point = plain.indexOf(u'.');
    if (point < 0) return 0;
    while (plain.endsWith(u'0')) plain.chop(1);
    return plain.size() - point - 1;
}

QVariant toMoney(const QString& plain, const QString& typed) {
    if (decimalsOf(plain) > 4) refuse(TooFine, typed);
    const std::optional<core::Money> amount = core::Money::fromPlainText(plain);
    if (!amount) refuse(TooLarge, typed);
    return QVariant::fromValue(*amount);
}

QVariant toWhole(const QString& plain, const QString& typed, ado::ColumnType type) {
    if (decimalsOf(plain) > 0) refuse(NotWhole, typed);
    bool fits = false;
    const qint64 number = plain.section(u'.', 0, 0).toLongLong(&fits);
    if (type == ado::ColumnType::Integer16) fits = fits && number == static_cast<qint16>(number);
    if (type == ado::ColumnType::Integer32) fits = fits && number == static_cast<qint32>(number);
    if (!fits) refuse(TooLarge, typed);
    return number;
}

QVariant toFloating(const QString& plain, const QString& typed, ado::ColumnType type) {
    bool ok = false;
    const double number = plain.toDouble(&ok);
    if (!ok || !std::isfinite(number)) refuse(TooLarge, typed);
    if (type == ado::ColumnType::Double) return number;
    const float single = static_cast<float>(number);
    if (!std::isfinite(single)) refuse(TooLarge, typed);
    return single;
}

}  // namespace

QVariant fromTypedDate(const QString& text) {
    if (text.trimmed().isEmpty()) return {};
    const std::optional<QDate> day = core::parseDate(text);
    if (!day) refuse(NoDate, text);
    return core::fromDate(*day);
}

QVariant fromTypedText(const QString& text, ado::ColumnType type) {
    using ado::ColumnType;
    if (type == ColumnType::Text || type == ColumnType::Other) return text;
    if (type == ColumnType::DateTime) return fromTypedDate(text);
    if (text.trimmed().isEmpty()) return {};
    const std::optional<QString> plain = core::parseDecimal(text);
    if (!plain) refuse(NoValue, text);
    if (type == ColumnType::Money) return toMoney(*plain, text);
    if (type == ColumnType::Single || type == ColumnType::Double)
        return toFloating(*plain, text, type);
    return toWhole(*plain, text, type);
}

}  // namespace forms
