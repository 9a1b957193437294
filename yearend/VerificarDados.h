// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

namespace yearend {

/// The repair and rebuild of a book, shown on a screen that is open.
///
/// Intentional: a failure is passed over without a word, and the wait window may stay; what was
/// done until then stays done. Only that there is no progress component fails.
/// @param modo  "M": on frmManutencaoDados, which says so at the end; "F": on the first bar of
/// frmFechoAno
void VerificarDados(const QString& modo);

}  // namespace yearend
