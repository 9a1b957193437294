// SPDX-License-Identifier: MIT
#include "platform/core/Values.h"

#include <cfloat>
#include <cmath>

#include "platform/core/Failure.h"
#include "platform/core/Money.h"

namespace core {

namespace {

[[noreturn]] void mismatch(const QVariant& value) {
    throw Failure(TypeMismatch, QStringLiteral("«%1» não é um número.").arg(value.toString()));
}

qint64 toWhole(const QVariant& value, double lowest, double highest) {
    const double rounded = std::nearbyint(toDouble(value));
    if (!(rounded >= lowest && rounded <= highest))
        throw Failure(Overflow, QStringLiteral("O número %1 não cabe num inteiro de %2 bits.")
                                    .arg(toText(value))
                                    .arg(highest > 32767 ? 32 : 16));
    return static_cast<qint64>(rounded);
}

}  // namespace

bool isNullOrEmpty(const QVariant& value) {
    return isNull(value) || (value.typeId() == QMetaType::QString && value.toString().isEmpty());
}

double toDouble(const QVariant& value) {
    if (isNull(value)) throw Failure(InvalidUseOfNull, QStringLiteral("Uso inválido de nulo."));
    if (value.typeId() == qMetaTypeId<Money>()) return value.value<Money>().toDouble();
    bool ok = false;
    const double number = value.toDouble(&ok);
    if (!ok || !std::isfinite(number)) mismatch(value);
    return number;
}

float toSingle(double value) {
    const float single = static_cast<float>(value);
    if (!std::isfinite(single))
        throw Failure(Overflow, QStringLiteral("O valor não cabe em precisão simples."));
    return single;
}

float toSingle(const QVariant& value) {
    return toSingle(toDouble(value));
}

qint32 toLong(const QVariant& value) {
    return static_cast<qint32>(toWhole(value, -2147483648.0, 2147483647.0));
}

qint16 toInteger(const QVariant& value) {
    return static_cast<qint16>(toWhole(value, -32768.0, 32767.0));
}

QDate toDate(const QVariant& value) {
    return value.toDate();
}

QVariant fromDate(QDate day) {
    return QDateTime(day, QTime(0, 0), Qt::UTC);
}

QString toText(const QVariant& value) {
    if (isNull(value)) return {};
    if (value.typeId() == qMetaTypeId<Money>()) {
        QString text = value.value<Money>().toPlainText();
        while (text.endsWith(u'0')) text.chop(1);
        if (text.endsWith(u'.')) text.chop(1);
        return text;
    }
    if (value.typeId() == QMetaType::Float)
        return QString::number(static_cast<double>(value.toFloat()), 'g', 9);
    if (value.typeId() == QMetaType::Double)
        return QString::number(value.toDouble(), 'g', QLocale::FloatingPointShortest);
    return value.toString();
}

std::partial_ordering compareNumbers(const QVariant& a, const QVariant& b) {
    if (isNull(a) || isNull(b)) return std::partial_ordering::unordered;
    return toDouble(a) <=> toDouble(b);
}

}  // namespace core
