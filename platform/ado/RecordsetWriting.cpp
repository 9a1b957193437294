// SPDX-License-Identifier: MIT
// Writing of row sets.
#include "platform/ado/RecordsetImplementation.h"
#include "platform/ado/engine/ColumnValue.h"
#include "platform/ado/engine/EngineTexts.h"
#include "platform/core/Failure.h"

namespace ado {

using namespace Qt::StringLiterals;

void Recordset::Implementation::requireTable() const {
    if (readOnly())
        throw core::Failure(core::NotUpdatable, u"O conjunto de linhas é só de leitura."_s);
    if (table.isEmpty())
        throw core::Failure(core::NotUpdatable,
                            u"As linhas desta consulta não podem ser gravadas."_s);
}

bool Recordset::Implementation::setValue(int column, const QVariant& value) {
    requireRow();
    if (readOnly()) requireTable();
    const QVariant kept = toColumn(value, rows->columns().column(column));
    if (!current.isNew()) {
        current.expectChange();
        look();
        holdStill();
        // Only a row that is held still is what it was read as.
        if (current.isHeld() && !ado::find(current.changes(), column) &&
            this->value(column) == kept)
            return false;
    }
    current.change(column, kept);
    return true;
}

void Recordset::Implementation::addNew() {
    requireOpen();
    requireTable();
    current.startNew();
}

void Recordset::Implementation::update(const Accompaniment& with) {
    requireRow();
    try {
        if (current.isNew()) {
            insertNew(with);
        } else if (!current.changes().empty() || with) {
            updateCurrent(with);
        }
    } catch (const core::Failure& failure) {
        throw explained(failure, (current.isNew() ? u"INSERT INTO "_s : u"UPDATE "_s) + table);
    }
    // Gathered writes follow each other without anybody between them.
    if (!isGathering()) current.letGo();
}

std::pair<QStringList, std::vector<QVariant>> Recordset::Implementation::written() const {
    std::pair<QStringList, std::vector<QVariant>> written;
    for (const auto& [column, value] : current.changes()) {
        written.first += rows->columns().column(column).name;
        written.second.push_back(value);
    }
    return written;
}

void Recordset::Implementation::insertNew(const Accompaniment& with) {
    requireTable();
    if (heldPlace && !heldPlace->isUnbroken())
        throw core::Failure(
            core::RowInUse,
            u"A ligação a «%1» perdeu-se e outro posto pode ter entretanto criado a "
            u"linha; nada foi gravado. Tente de novo."_s.arg(book));
    const auto [columns, values] = written();
    own.noteInserted(session()->insert(table, columns, values, with));
    heldPlace.reset();
    standOnInserted(own.insertedCount() - 1);
}

void Recordset::Implementation::updateCurrent(const Accompaniment& with) {
    requireTable();
    holdStill();
    const auto [columns, values] = written();
    const TableRow row = tableRow();
    if (!row.session->update(table, row.identity, columns, values, with))
        throw core::Failure(core::DatabaseFailure,
                            u"A linha foi entretanto apagada por outro posto; não foi gravada."_s);
    if (current.at() == At::Queried)
        own.noteStored(rows->row(), current.changes(), rows->inMemory());
    if (isGathering() && current.isFresh()) return current.noteGathered();
    current.noteStored(isOutdated());
}

void Recordset::Implementation::remove() {
    requireRow();
    requireTable();
    if (current.isNew()) return current.cancel(isOutdated());
    look();
    holdStill();
    const TableRow row = tableRow();
    if (!row.session->remove(table, row.identity))
        throw core::Failure(core::DatabaseFailure,
                            u"A linha já tinha sido apagada por outro posto."_s);
    if (current.at() == At::Queried)
        own.noteDeleted(rows->row());
    else
        own.noteInsertedDeleted(current.inserted());
    current.noteDeleted();
}

}  // namespace ado
