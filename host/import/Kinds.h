// SPDX-License-Identifier: MIT
#pragma once

#include <QByteArray>
#include <QString>
#include <vector>

#include "platform/ado/engine/Column.h"

namespace importing {

/// What a file brings into a book.
enum class Kind { Members, Relatives, Premiums, Rubrics, Hospitals };

/// What a column of a file holds.
enum class Holds {
    Text,
    Member,    ///< the staff number of a member who is in the book
    Group,     ///< the code of a group of rubrics; empty for a group itself
    Nib,       ///< a national bank number
    YesNo,     ///< "sim" or "não", 1 or 0
    Day,       ///< 2026-12-31, 31-12-2026 or 31/12/2026
    Year,      ///< 1900 to 2199
    Month,     ///< 1 to 12
    Amount,    ///< not below 0, four decimals at most
    Fraction,  ///< 0 to 1
    Count      ///< a whole number, not below 0
};

/// A column of a file and where it goes.
struct Column {
    QString heading;  ///< case, accents and signs do not count
    QByteArray name;  ///< of the table's column
    Holds holds = Holds::Text;
    bool isRequired = false;  ///< has to be in the file, with a text in each row
};

/// A kind of file. Rows that agree in the key are the same.
struct Description {
    Kind kind;
    QString word;   ///< as the command line calls it
    QString title;  ///< as people call it
    QByteArray table;
    QByteArray generatedKey;  ///< the table's own key; empty where the member's is it
    std::vector<QByteArray> key;
    std::vector<Column> columns;
};

/// All kinds, in the order in which a new book needs them.
const std::vector<Description>& descriptions();
const Description& descriptionOf(Kind kind);
/// Null when there is no such word.
const Description* descriptionOf(const QString& word);

/// The most characters that a column takes, as the schema says; 0 for one that holds no text.
int definedSize(const QByteArray& table, const QByteArray& column);

}  // namespace importing
