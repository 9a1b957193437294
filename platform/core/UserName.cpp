// SPDX-License-Identifier: MIT
// The user's name as this operating system gives it.
#include "platform/core/UserName.h"

#include <pwd.h>
#include <unistd.h>

#include <algorithm>
#include <cstring>

namespace core {

namespace {
QByteArray fixedName;
}

bool userName(char* buffer, std::size_t length) {
    const passwd* entry = fixedName.isEmpty() ? getpwuid(geteuid()) : nullptr;
    const char* name = fixedName.isEmpty() ? (entry ? entry->pw_name : nullptr) : fixedName.data();
    if (!name) return false;
    std::memcpy(buffer, name, std::min(std::strlen(name) + 1, length));
    return true;
}

void setUserName(const QByteArray& name) {
    fixedName = name;
}

}  // namespace core
