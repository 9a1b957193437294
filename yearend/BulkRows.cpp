// SPDX-License-Identifier: MIT
#include "yearend/BulkRows.h"

#include "boundary/environment/dtZelmars.h"

using namespace Qt::StringLiterals;

namespace yearend {

ado::RecordsetPtr openBulk(const QString& query, ado::CursorType cursor, ado::LockType lock) {
    const ado::RecordsetPtr rows = ado::Recordset::create();
    rows->Open(query, environment::dtZelmars::instance().MSAccess(), cursor, lock);
    return rows;
}

void empty(const QString& query, ado::CursorType cursor, const Serve& serve) {
    const ado::RecordsetPtr rows = openBulk(query, cursor, ado::adLockOptimistic);
    for (; !rows->atEnd(); rows->MoveNext()) {
        rows->Delete();
        serve();
    }
    rows->Close();
}

int countFromLast(ado::Recordset& rows) {
    rows.MoveLast();
    rows.MoveFirst();
    return static_cast<int>(rows.RecordCount());
}

}  // namespace yearend
