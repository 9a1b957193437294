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
    if (at != At::New) {
        settled = false;
        look();
        holdStill();
        // Only a row that is held still is what it was read as.
        if (wasHeld && !changes.find(column) && this->value(column) == kept) return false;
    }
    changes.set(column, kept);
    return true;
}

void Recordset::Implementation::addNew() {
    requireOpen();
    requireTable();
    leaveRow();
    before = at;
    at = At::New;
}

void Recordset::Implementation::update(const Accompaniment& with) {
    requireRow();
    try {
        if (at == At::New) return insertNew(with);
        if (!changes.isEmpty() || with) updateCurrent(with);
    } catch (const core::Failure& failure) {
        throw explained(failure, (at == At::New ? u"INSERT INTO "_s : u"UPDATE "_s) + table);
    }
    held.reset();
    wasHeld = false;
    settled = true;
}

void Recordset::Implementation::insertNew(const Accompaniment& with) {
    requireTable();
    if (heldPlace && !heldPlace->isUnbroken())
        throw core::Failure(
            core::RowInUse,
            u"A ligação a «%1» perdeu-se e outro posto pode ter entretanto criado a "
            u"linha; nada foi gravado. Tente de novo."_s.arg(book));
    QStringList columns;
    std::vector<QVariant> values;
    for (const auto& [column, value] : changes.values()) {
        columns += rows->columns().column(column).name;
        values.push_back(value);
    }
    added.push_back(session()->insert(table, columns, values, with));
    heldPlace.reset();
    addedAt = static_cast<qint64>(added.size()) - 1;
    at = At::Added;
    changes.clear();
    settled = true;
    wantsFresh = true;
}

void Recordset::Implementation::updateCurrent(const Accompaniment& with) {
    requireTable();
    holdStill();
    QStringList columns;
    std::vector<QVariant> values;
    for (const auto& [column, value] : changes.values()) {
        columns += rows->columns().column(column).name;
        values.push_back(value);
    }
    if (!session()->update(table, identity(), columns, values, with))
        throw core::Failure(core::DatabaseFailure,
                            u"A linha foi entretanto apagada por outro posto; não foi gravada."_s);
    wantsFresh = at == At::Added || fresh.count() > 0;
    if (at == At::Row) noteStored();
    fresh.clear();
    changes.clear();
}

// Few rows keep what was stored there. A mark for each of many is all that a long pass may cost;
// such a row is read afresh.
void Recordset::Implementation::noteStored() {
    const qint64 row = rows->row();
    if (rows->inMemory()) {
        for (const auto& [column, value] : changes.values()) stored[row].set(column, value);
        return;
    }
    const auto place = static_cast<std::size_t>(row);
    if (place >= storedFar.size()) storedFar.resize(place + 1);
    storedFar[place] = true;
    wantsFresh = true;
}

void Recordset::Implementation::cancel() {
    requireOpen();
    changes.clear();
    if (wasHeld && !isHeld()) {  // the row is read anew when it is looked at
        held.reset();
        wasHeld = false;
    }
    if (at != At::New) return;
    at = before;
    wantsFresh = at == At::Added;
}

void Recordset::Implementation::remove() {
    requireRow();
    requireTable();
    if (at == At::New) return cancel();
    look();
    holdStill();
    if (!session()->remove(table, identity()))
        throw core::Failure(core::DatabaseFailure,
                            u"A linha já tinha sido apagada por outro posto."_s);
    if (at == At::Row) {
        gone.insert(std::upper_bound(gone.begin(), gone.end(), rows->row()), rows->row());
    } else {
        added.erase(added.begin() + addedAt);
        --addedAt;  // the next move comes to the row behind
    }
    changes.clear();
    held.reset();
    wasHeld = false;
    deleted = true;
}

}  // namespace ado
