// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

namespace host {

/// Passwords are never given on the command line, where every user of the machine could read them.
inline constexpr auto AdminPasswordVariable = "ZELMARS_ADMIN_PASSWORD";
inline constexpr auto UserPasswordVariable = "ZELMARS_USER_PASSWORD";

/// The value of the environment variable; where it is not set, what is typed at the terminal, which
/// shows nothing of it; empty where there is no terminal either.
QString password(const char* variable, const QString& question);

}  // namespace host
