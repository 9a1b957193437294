// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

namespace payments {

/// One row: the running number.
inline constexpr QStringView ChequesStatement = u"Select * from tbCheques";

/// The next cheque number to offer. A book without one gets the row, holding 0.
QString nextChequeNumber();

/// The number that a person typed. Fails with TypeMismatch when it is no whole number of at most
/// fifteen digits.
qint64 chequeNumber(const QString& typed);

/// Stores what follows the number used, also when that lies below the former one.
void storeChequeNumber(qint64 used);

}  // namespace payments
