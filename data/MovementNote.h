// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

#include "platform/ado/Recordset.h"

namespace data {

/// What somebody who looks at a movement has to know besides its amounts: number, author, cheque,
/// and whether it is in force; two lines. What the row does not tell is left out.
/// @param shown  its current row is a movement of the view of those in force
QString noteOf(const ado::Recordset& shown);

}  // namespace data
