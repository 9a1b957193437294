// SPDX-License-Identifier: MIT
#pragma once

#include <QDate>
#include <QVariant>

namespace core {

// A value of a field or of a control is a QVariant. Null, empty text and 0 are three things:
// null is an invalid QVariant; amounts are core::Money, 32-bit floats are float, dates are
// QDateTime without a zone (Qt::UTC stands for "no zone").

/// True for null only.
inline bool isNull(const QVariant& value) {
    return !value.isValid() || value.isNull();
}

/// The one place where a rule treats null and empty text alike.
bool isNullOrEmpty(const QVariant& value);

/// The number as a double. Fails with InvalidUseOfNull on null, with TypeMismatch on what is no
/// number (texts are read with a decimal point).
double toDouble(const QVariant& value);

/// The number as a 32-bit float, the working type of the calculation. Fails like toDouble, and
/// with Overflow when the value is past single precision.
float toSingle(const QVariant& value);
/// As above, from a double.
float toSingle(double value);

/// Whole numbers, rounded to nearest with halves to the even neighbour. Fail like toDouble, and
/// with Overflow when the value does not fit.
qint32 toLong(const QVariant& value);
qint16 toInteger(const QVariant& value);

/// The day of a date value. An invalid QDate for null.
QDate toDate(const QVariant& value);
/// The first instant of a day as a field holds it.
QVariant fromDate(QDate day);

/// The text of a value as it is joined into a query or shown plain: "" for null, numbers with
/// a point, whole numbers without decimals.
QString toText(const QVariant& value);

/// How two numbers of any kind stand to each other: below, equal, above. Nothing when one of them
/// is null, so a comparison with null does not hold.
std::partial_ordering compareNumbers(const QVariant& a, const QVariant& b);

}  // namespace core
