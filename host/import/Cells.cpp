// SPDX-License-Identifier: MIT
#include "host/import/Cells.h"

#include <QDate>
#include <QRegularExpression>
#include <algorithm>

#include "data/Rubrics.h"
#include "host/bankfile/Iban.h"
#include "platform/core/Folding.h"

using namespace Qt::StringLiterals;

namespace importing {

namespace {

ReadCell fault(const QString& why) {
    return {{}, why};
}

ReadCell readText(const QString& text, int definedSize) {
    if (std::any_of(text.begin(), text.end(),
                    [](QChar letter) { return letter.category() == QChar::Other_Control; }))
        return fault(
            u"tem um sinal que não se pode escrever (uma mudança de linha, por exemplo)"_s);
    if (definedSize > 0 && text.toUcs4().size() > definedSize)
        return fault(u"tem mais de %1 letras"_s.arg(definedSize));
    return {text.toUtf8(), {}};
}

ReadCell readYesNo(const QString& text) {
    const std::string word = core::folded(text);
    if (word == "sim" || word == "s" || word == "1") return {qint64{1}, {}};
    if (word == "nao" || word == "n" || word == "0") return {qint64{0}, {}};
    return fault(u"não é «sim» nem «não»"_s);
}

ReadCell readDay(const QString& text) {
    for (const QString& form : {u"yyyy-MM-dd"_s, u"dd-MM-yyyy"_s, u"dd/MM/yyyy"_s}) {
        const QDate day = QDate::fromString(text, form);
        if (day.isValid() && day.year() >= 1800 && day.year() < 2200)
            return {day.toString(Qt::ISODate).toLatin1() + " 00:00:00", {}};
    }
    return fault(u"não é um dia como 31-12-2026 ou 2026-12-31"_s);
}

ReadCell readWhole(const QString& text, qint64 least, qint64 most) {
    bool isNumber = false;
    const qint64 number = text.toLongLong(&isNumber);
    if (isNumber && number >= least && number <= most) return {number, {}};
    return fault(u"não é um número inteiro de %1 a %2"_s.arg(least).arg(most));
}

/// A number with a point for its decimals; empty for none, and `why` then tells. The last sign of a
/// number parts the decimals. One sign alone before three digits could part thousands as well, and
/// nobody should have to guess at somebody's money.
QString plainNumber(const QString& text, QString& why) {
    static const QRegularExpression form(
        uR"(^-?(\d+|\d{1,3}(?<thousands>[., ])\d{3}(\k<thousands>\d{3})*)((?<point>[.,])(?<decimals>\d+))?$)"_s);
    const auto match = form.match(text);
    const QString thousands = match.captured(u"thousands"_s);
    const QString point = match.captured(u"point"_s);
    if (!match.hasMatch() || (!point.isEmpty() && point == thousands)) {
        why = u"não é um número"_s;
        return {};
    }
    const qsizetype groups = text.count(thousands);
    const bool isOneSign = thousands.isEmpty()
                               ? match.captured(u"decimals"_s).size() == 3
                               : point.isEmpty() && groups == 1 && thousands != u" "_s;
    if (isOneSign && text != u"0"_s + point + match.captured(u"decimals"_s)) {
        QString whole = text;
        whole.remove(QRegularExpression(u"[.,]"_s));
        why = u"pode ser %1 ou %2: escreva-o sem separador dos milhares e com duas casas decimais"_s
                  .arg(whole, text);
        return {};
    }
    QString number = text;
    if (!thousands.isEmpty()) number.remove(thousands);
    return number.replace(u',', u'.');
}

ReadCell readAmount(const QString& text) {
    QString why;
    const QString number = plainNumber(text, why);
    if (number.isEmpty()) return fault(why);
    if (number.section(u'.', 1).size() > 4) return fault(u"tem mais de quatro casas decimais"_s);
    const auto amount = core::Money::fromPlainText(number);
    if (!amount) return fault(u"é grande de mais"_s);
    if (amount->units() < 0) return fault(u"é negativo"_s);
    return {*amount, {}};
}

ReadCell readFraction(const QString& text) {
    QString number = text;
    number.replace(u',', u'.');
    bool isNumber = false;
    const double fraction = number.toDouble(&isNumber);
    if (!isNumber) return fault(u"não é um número"_s);
    if (!data::isPercent(fraction)) return fault(u"não está entre 0 e 1 (80 % escreve-se 0,8)"_s);
    return {fraction, {}};
}

QString shownDay(const QByteArray& text) {
    return QDate::fromString(QString::fromLatin1(text.left(10)), Qt::ISODate)
        .toString(u"dd-MM-yyyy"_s);
}

QString shownNumber(double number) {
    return QString::number(number, 'g', QLocale::FloatingPointShortest).replace(u'.', u',');
}

}  // namespace

ReadCell readCell(const QString& text, Holds holds, int definedSize) {
    if (text.isEmpty()) return {};
    switch (holds) {
        case Holds::YesNo:
            return readYesNo(text);
        case Holds::Day:
            return readDay(text);
        case Holds::Year:
            return readWhole(text, 1900, 2199);
        case Holds::Month:
            return readWhole(text, 1, 12);
        case Holds::Count:
            return readWhole(text, 0, std::numeric_limits<qint32>::max());
        case Holds::Amount:
            return readAmount(text);
        case Holds::Fraction:
            return readFraction(text);
        case Holds::Nib:
            if (!bankfile::isNib(text))
                return fault(u"não é um NIB certo: 21 algarismos, os dois últimos de controlo"_s);
            [[fallthrough]];
        case Holds::Text:
        case Holds::Member:
        case Holds::Group:
            break;
    }
    return readText(text, definedSize);
}

QString shownValue(const ado::BulkValue& value, Holds holds) {
    if (const auto* number = std::get_if<qint64>(&value)) {
        if (holds == Holds::YesNo) return *number != 0 ? u"sim"_s : u"não"_s;
        return QString::number(*number);
    }
    if (const auto* number = std::get_if<double>(&value)) return shownNumber(*number);
    if (const auto* amount = std::get_if<core::Money>(&value)) {
        QString text = amount->toPlainText();
        if (text.endsWith(u"00"_s)) text.chop(2);
        return text.replace(u'.', u',');
    }
    const auto* text = std::get_if<QByteArray>(&value);
    if (!text) return {};
    return holds == Holds::Day ? shownDay(*text) : QString::fromUtf8(*text);
}

}  // namespace importing
