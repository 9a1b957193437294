// SPDX-License-Identifier: MIT
#pragma once

#include <QtGlobal>
#include <string_view>

namespace ado {

/// A value as the engine keeps it, before anybody asked for it as a value of its column's type.
struct Cell {
    enum Kind : quint8 { Null, Integer, Real, Text };

    Kind kind = Null;
    qint64 integer = 0;
    double real = 0;
    std::string_view text;  ///< UTF-8, owned by whoever gave the cell
};

}  // namespace ado
