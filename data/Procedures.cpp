// SPDX-License-Identifier: MIT
#include "data/Procedures.h"

#include <cstring>

#include "platform/core/UserName.h"

namespace data {

QString ObterUtilizador() {
    char buffer[25];
    std::memset(buffer, ' ', sizeof buffer);
    if (!core::userName(buffer, sizeof buffer)) return {};
    const void* end = std::memchr(buffer, 0, sizeof buffer);
    // A name that fills the whole buffer has no end, and gives no name at all.
    if (!end) return {};
    return QString::fromUtf8(buffer, static_cast<const char*>(end) - buffer);
}

}  // namespace data
