// SPDX-License-Identifier: MIT
#pragma once

#include <QStringList>
#include <functional>

#include "platform/ado/engine/BulkAccess.h"

namespace database {

/// Looks for the worst at once, however large the book: whether all tables, views and indexes are
/// there, the counter of movement numbers is one and above the newest movements, no number among
/// these was given twice, and no operation was cut short more than an hour ago. Of the movements
/// only the newest thousand of each table are read, and everything through an index. Gives a line
/// for each thing that is wrong. What passes this may still fail checkBook(). Fails as the engine
/// does when the book cannot be read.
/// @param isWanted  asked between two looks; with false the rest is left out
QStringList quickFindings(
    ado::BulkAccess& book, const std::function<bool()>& isWanted = [] { return true; });

}  // namespace database
