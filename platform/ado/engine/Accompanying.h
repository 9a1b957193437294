// SPDX-License-Identifier: MIT
#pragma once

#include <QStringList>
#include <QStringView>
#include <QVariant>
#include <optional>
#include <vector>

namespace ado {

/// A write to another table that goes into the commit of a row's own write: both stand or neither,
/// and the disk is waited for once.
struct Accompanying {
    enum class Kind { Insert, Update, Delete };

    Kind kind = Kind::Insert;
    QString table;
    // What is written, column by column; nothing of a deletion.
    QStringList columns;
    std::vector<QVariant> values;
    /// Beside a new row: the column that takes the key which that row was given. Empty for none.
    QString keyColumn = {};
    // The row to be updated or deleted: the columns that have to hold these values, none null. When
    // that is not exactly one row, nothing at all is written.
    QStringList whereColumns = {};
    std::vector<QVariant> whereValues = {};
};

/// Why nothing was written: the row that was to be touched beside it is not as expected.
inline constexpr QStringView NotAccompaniedText =
    u"Outro posto terminou entretanto esta operação, ou apagou a linha; nada foi gravado.";

/// Nothing where a row is written by itself.
using Accompaniment = std::optional<Accompanying>;

}  // namespace ado
