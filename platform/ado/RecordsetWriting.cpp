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

namespace {

/// True for what a column of that type keeps, and no other type would.
bool isKeptIn(ColumnType type, Cell::Kind kind) {
    switch (type) {
        case ColumnType::Integer16:
        case ColumnType::Integer32:
        case ColumnType::Integer64:
            return kind == Cell::Integer;
        case ColumnType::Single:
        case ColumnType::Double:
            return kind == Cell::Real;
        case ColumnType::Money:
            return kind == Cell::Real || kind == Cell::Text;  // as the engine keeps amounts
        case ColumnType::DateTime:
        case ColumnType::Text:
            return kind == Cell::Text;
        case ColumnType::Other:
            break;
    }
    return false;
}

QVariant asItIs(const Cell& cell) {
    switch (cell.kind) {
        case Cell::Integer:
            return cell.integer;
        case Cell::Real:
            return cell.real;
        case Cell::Text:
            return QByteArray(cell.text.data(), static_cast<qsizetype>(cell.text.size()));
        case Cell::Null:
            break;
    }
    return {};
}

}  // namespace

bool Recordset::Implementation::copyCell(int column, const Implementation& from, int fromColumn) {
    const bool isRead = from.rows && from.table.isEmpty() && from.current.at() == At::Queried;
    if (!current.isNew() || !isRead || from.book != book) return false;
    const Column& target = rows->columns().column(column);
    const Column& given = from.rows->columns().column(fromColumn);
    if (target.type != given.type || target.definedSize != given.definedSize) return false;
    const Cell cell = from.rows->cell(fromColumn);
    if (cell.kind != Cell::Null && !isKeptIn(target.type, cell.kind)) return false;
    current.change(column, asItIs(cell));
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

std::pair<QStringList, std::vector<QVariant>> Recordset::Implementation::written() {
    std::vector<int> columns;
    std::vector<QVariant> values;
    for (const auto& [column, value] : current.changes()) {
        columns.push_back(column);
        values.push_back(value);
    }
    if (columns != writtenColumns) {
        writtenNames.clear();
        for (const int column : columns) writtenNames += rows->columns().column(column).name;
        writtenColumns = std::move(columns);
    }
    return {writtenNames, std::move(values)};
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
