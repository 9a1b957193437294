// SPDX-License-Identifier: MIT
#pragma once

#include <functional>

#include <memory>

#include "platform/ado/engine/BulkAccess.h"
#include "platform/ado/postgres/Address.h"

/// Carries a whole book from one engine to the other.
namespace database {

/// Where a book lies: in a file, or on a server where its host is set.
struct BookPlace {
    QString folder;
    ado::postgres::Address server;
    QString name;

    /// Reads "sqlite:FOLDER/NAME" or "postgresql:HOST[:PORT]/NAME". Fails with a text that names
    /// both forms.
    static BookPlace parsed(const QString& text);
    bool isOnServer() const { return !server.host.isEmpty(); }
    QString shown() const;
};

/// Opens an existing book for bulk work. Fails when its schema is newer than this program.
std::unique_ptr<ado::BulkAccess> opened(const BookPlace& place);
/// The same whatever its version, for those who ask for that first.
std::unique_ptr<ado::BulkAccess> openedAnyway(const BookPlace& place);

/// How far a copy is.
struct CopyProgress {
    QString table;
    qint64 rows = 0;     ///< of this table so far
    qint64 allRows = 0;  ///< of all tables so far
    qint64 total = 0;    ///< of all tables together
    bool isTableDone = false;
};
/// Told every few thousand rows and at the end of each table; what it throws ends the copy.
using CopyListener = std::function<void(const CopyProgress&)>;

/// What was carried over and found equal on both sides.
struct CopySummary {
    int tables = 0;
    qint64 rows = 0;
    int sums = 0;  ///< columns of amounts
};

/// Copies all tables with their rows in the order of insertion, keys, counters, and the keys that
/// come next. A file is made and must not be there; on a server the book must be there and empty,
/// apart from its code lists and counters, which those of the source replace. The source is read as
/// it stood at the beginning, so that others may go on working with it. In the end the number of
/// rows and the sum of every column of amounts are compared. Fails with a core::Failure, leaving
/// the target as it was, when the version of either is another one, a table or column lacks on
/// either side, or anything differs.
CopySummary copyBook(const BookPlace& from, const BookPlace& into, const CopyListener& listener);

}  // namespace database
