// SPDX-License-Identifier: MIT
#include "data/RowSets.h"

#include "boundary/environment/dtZelmars.h"
#include "platform/core/Values.h"

namespace data {

ado::RecordsetPtr openToRead(const QString& query) {
    const ado::RecordsetPtr rows = ado::Recordset::create();
    rows->Open(query, environment::dtZelmars::instance().MSAccess());
    return rows;
}

ado::RecordsetPtr openToWrite(const QString& query) {
    const ado::RecordsetPtr rows = ado::Recordset::create();
    rows->Open(query, environment::dtZelmars::instance().MSAccess(), ado::adOpenStatic,
               ado::adLockPessimistic, ado::adCmdUnknown);
    return rows;
}

namespace {

void addTimes(int factor, ado::Recordset& row, const QString& column, const QVariant& amount) {
    const QVariant sum = row.Collect(column);
    const bool isKnown = !core::isNull(sum) && !core::isNull(amount);
    row.setCollect(column,
                   isKnown ? core::toDouble(sum) + factor * core::toDouble(amount) : QVariant());
}

}  // namespace

void add(ado::Recordset& row, const QString& column, const QVariant& amount) {
    addTimes(1, row, column, amount);
}

void subtract(ado::Recordset& row, const QString& column, const QVariant& amount) {
    addTimes(-1, row, column, amount);
}

void nullBecomesZero(ado::Recordset& row, const QString& column) {
    if (core::isNull(row.Collect(column))) row.setCollect(column, 0);
}

}  // namespace data
