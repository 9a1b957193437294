// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

namespace reports {

// The organisation as it stands at the head of what it sends out, each on one line. An
// administrator sets them in the file organizacao.ini, which is looked for as
// core::configurationFiles says and is read afresh for each report:
//
//     nome = Associação dos Trabalhadores
//     morada = Rua Augusta, 1, 1100-048 Lisboa
//
// A value that is left out or empty in the user's file is looked for in the machine's. They never
// fail: a file that cannot be read is as one that is not there.

/// The name; "Tesmar Nacional" where none is set.
QString organisationName();
/// The postal address; "Lisboa", a placeholder, where none is set.
QString organisationAddress();

}  // namespace reports
