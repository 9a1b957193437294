// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <functional>
#include <map>

#include "platform/ado/engine/BulkAccess.h"

/// Proves a book: whether its rows agree with each other.
namespace database {

/// Movements of one year, or those in force, and what they come to.
struct YearTotals {
    qint64 movements = 0;
    core::Money debito;
    core::Money credito;
};

/// What was looked at.
struct CheckSummary {
    YearTotals live;
    std::map<qint64, YearTotals> history;  ///< by year
    qint64 findings = 0;
};

/// Told of each thing that is wrong, in a line that names the row.
using FindingListener = std::function<void(const QString& finding)>;

/// Reads the book once, as it stands at the beginning, and writes nothing; others may go on working
/// with it. Wrong are:
/// - accumulators whose sums are not those that the maintenance would give. Their number of
/// documents
///   may be that of the documents in force, as the daily work counts, or up to that of all
///   movements, as the maintenance does;
/// - annulled movements without a correcting row that takes their amounts back;
/// - movement numbers that are missing or given twice, and a counter that is not above them;
/// - a share above its incidence, a negative remainder of a ceiling;
/// - movements in force of a member, rubric or hospital that the book does not know.
/// Fails as the engine does when the book cannot be read.
CheckSummary checkBook(ado::BulkAccess& book, const FindingListener& listener);

/// What was looked at, for people: the movements in force and those of each closed year, and in the
/// last line how many things are wrong.
QString summaryText(const CheckSummary& summary);

}  // namespace database
