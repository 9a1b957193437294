// SPDX-License-Identifier: MIT
#include "data/modDlookup.h"

#include "boundary/environment/dtZelmars.h"

using namespace Qt::StringLiterals;

namespace data {

QVariant DLookup(const QString& strSQL, const QString& /*strConnection*/, const QString& strField,
                 const QString& /*unused1*/, const QString& /*unused2*/) {
    if (strSQL.isEmpty() || strField.isEmpty()) return {};
    const ado::RecordsetPtr rows = ado::Recordset::create();
    rows->Open(strSQL, environment::dtZelmars::instance().Connections(1), ado::adOpenStatic,
               ado::adLockPessimistic, ado::adCmdUnknown);
    if (rows->atEnd()) return u""_s;
    rows->MoveFirst();
    // A row that somebody holds may be read all the same.
    const QVariant value = rows->readValue(strField);
    rows->Close();
    return value;
}

}  // namespace data
