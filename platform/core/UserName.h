// SPDX-License-Identifier: MIT
#pragma once

#include <QByteArray>

namespace core {

/// Writes the name under which the operating system's user logged in, with a closing zero, into
/// a buffer of `length` bytes. A name that does not fit is cut and has no closing zero. Returns
/// false when the system knows no name.
bool userName(char* buffer, std::size_t length);

/// For tests: the name that userName() gives; an empty one returns to the system's.
void setUserName(const QByteArray& name);

}  // namespace core
