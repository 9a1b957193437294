// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <functional>

#include "platform/ado/Recordset.h"

/// What is typed into the bank's program. Each step fails when a window is not there.
namespace payments::bank {

inline constexpr QStringView Program = u"C:\\Programas\\Bnubanca\\gcsvcman.exe";
inline constexpr QStringView MainWindow = u"BANCA ELECTRONICA BNU - Menu Principal do Sistema";
inline constexpr QStringView InterbankModule = u"BNUTIB10";
inline constexpr QStringView InternalModule = u"BNUTIN10";
inline constexpr QStringView InterbankWindow = u"Transferências Interbancárias";
inline constexpr QStringView InternalWindow = u"Transferências Internas";

/// Puts the code of a module into the field of the main window for it; Enter opens it then.
void typeModule(const QString& code);

/// Types one transfer, the current row of the set: its member into the list of those who may be
/// paid, the transfer itself, and the member out of the list again.
/// @param isReached  called once the window of the module is in front
void typeTransfer(const ado::Recordset& row, const std::function<void()>& isReached);

}  // namespace payments::bank
