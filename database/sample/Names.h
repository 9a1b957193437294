// SPDX-License-Identifier: MIT
#pragma once

#include <QByteArray>

#include "database/sample/Random.h"

/// Portuguese names, addresses and numbers, all UTF-8.
namespace database::sample {

QByteArray givenName(Random& random, bool woman);
QByteArray surname(Random& random);

struct Address {
    QByteArray street;
    QByteArray postalCode;
    QByteArray town;
};
Address address(Random& random);

/// Staff number of the n-th member (from 1): the serial number 10000 + n and a check digit.
QByteArray staffNumber(int n);
/// Tax number of a person: nine digits, the last one checking the others (weights 9 to 2, mod 11).
QByteArray taxNumber(Random& random);
/// Bank account identifier: bank, branch, account, and two digits that make the whole number
/// leave 1 when divided by 97.
QByteArray bankNumber(Random& random);
/// The two check digits behind the 19 digits of bank, branch and account.
QByteArray bankCheckDigits(const QByteArray& digits);

}  // namespace database::sample
