// SPDX-License-Identifier: MIT
#pragma once

#include <QStringList>

namespace masterdata {

/// A row that somebody wants to delete from a list, as queries on the connection `MSAccess`.
struct Deletion {
    QStringList related;    ///< rows that keep it from being deleted
    QString children = {};  ///< rows that go with it, whatever is related to them; empty for none
    QString row;
    QString missing;  ///< what to say when the row is gone
};

/// Asks, refuses a row that others are related to, and deletes it. True when the list is to be
/// queried again. Fails as the engine does.
bool deleteAsked(const Deletion& deletion);

}  // namespace masterdata
