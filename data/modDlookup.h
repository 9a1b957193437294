// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <QVariant>

namespace data {

/// One column of the first row of a query, without the caller holding a row set.
///
/// Three outcomes stay apart: null for an empty query or column name, or a null column; empty
/// text for no row; otherwise the value. A query that fails, or a column that is not there,
/// fails the caller.
///
/// The query always runs on the first connection of the data environment. Intentional:
/// `strConnection` and the two last texts are accepted and have no effect.
QVariant DLookup(const QString& strSQL, const QString& strConnection, const QString& strField,
                 const QString& unused1 = {}, const QString& unused2 = {});

}  // namespace data
