// SPDX-License-Identifier: MIT
#pragma once

#include <QTemporaryDir>

#include "platform/ado/Recordset.h"

/// A book of two small tables: `recibo` (one row of each type of column) and `rubrica` (a list).
/// Its statements run outside the row-set layer.
class SampleBook {
public:
    SampleBook();
    ado::RecordsetPtr open(const QString& statement, ado::LockType lock = ado::adLockOptimistic);
    /// A new, pending row of `recibo`.
    ado::RecordsetPtr newRow();
    void exec(const QString& statements);

private:
    QTemporaryDir folder_;
    ado::ConnectionPtr connection_;
};
