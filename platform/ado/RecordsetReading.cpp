// SPDX-License-Identifier: MIT
// Opening, moving and reading of row sets.
#include <limits>

#include "platform/ado/RecordsetImplementation.h"
#include "platform/ado/dialect/Query.h"
#include "platform/ado/engine/ColumnValue.h"
#include "platform/ado/engine/EngineTexts.h"
#include "platform/core/Failure.h"
#include "platform/core/Values.h"

namespace ado {

using namespace Qt::StringLiterals;

namespace {

/// The value that relates parent and child as text; null relates to nothing.
QString keyOf(const Cell& cell) {
    return cell.kind == Cell::Null ? QString() : core::toText(toVariant(cell, ColumnType::Other));
}

int requireColumn(const Pass& pass, const QString& name) {
    const int column = pass.indexOf(name);
    if (column < 0) throw core::Failure(core::NoSuchItem, u"A coluna «%1» não existe."_s.arg(name));
    return column;
}

}  // namespace

// --- Opening

void Recordset::Implementation::openRows() {
    const std::shared_ptr<Session> engine = connection->session();
    engine->setTimeout(connection->CommandTimeout);
    const Query statement(source);
    statement.requireQuery(connection->shapes());
    book = engine->book();
    try {
        if (ShapeQuery::isShape(statement)) {
            openShape(statement);
        } else {
            openStatement(statement);
        }
    } catch (const core::Failure& failure) {
        throw explained(failure, source);
    }
    at = rows->toFirst() ? At::Row : At::Nothing;
}

void Recordset::Implementation::openStatement(const Query& statement) {
    Session& engine = *connection->session();
    if (!readOnly()) table = statement.singleTable();
    if (!table.isEmpty() && !engine.isTable(table)) table.clear();
    rows = std::make_unique<Rows>(engine.open(statement, table), clientSide);
    // A counter without its row: of all that find none, one alone adds it; the others wait here
    // and find it then.
    const bool isCounter = cursor == adOpenDynamic && lockType == adLockPessimistic;
    if (!isCounter || table.isEmpty() || rows->toFirst()) return;
    RowStore nothing;
    heldPlace = engine.lock(table, NoRow, connection->CommandTimeout, nothing);
    rows = std::make_unique<Rows>(engine.open(statement, table), clientSide);
    if (rows->toFirst()) heldPlace.reset();
}

void Recordset::Implementation::openShape(const Query& statement) {
    const ShapeQuery shape = ShapeQuery::parse(statement);
    const Query parent(shape.parent);
    const Query child(shape.child);
    parent.requireQuery(false);
    child.requireQuery(false);
    Session& engine = *connection->session();

    auto parents = std::make_unique<Rows>(engine.open(parent, {}), true);
    chapter = std::make_shared<ChapterRows>();
    chapter->name = shape.chapter;
    chapter->parentColumn = requireColumn(parents->columns(), shape.parentColumn);
    for (qint64 row = 0; row < parents->count(); ++row) {
        const QString key = keyOf(parents->cellAt(row, chapter->parentColumn));
        if (!key.isNull()) chapter->byKey.insert(key, std::make_shared<RowStore>());
    }
    // One pass over the children; those of no parent are not kept.
    chapter->description = engine.open(child, {});
    const int childColumn = requireColumn(*chapter->description, shape.childColumn);
    while (!chapter->byKey.isEmpty() && chapter->description->step()) {
        const auto of = chapter->byKey.constFind(keyOf(chapter->description->cell(childColumn)));
        if (of != chapter->byKey.constEnd()) (*of)->append(*chapter->description);
    }
    chapter->description->release();
    rows = std::move(parents);
}

void Recordset::Implementation::close() {
    leaveRow();
    heldPlace.reset();
    rows.reset();
    chapter.reset();
    table.clear();
    book.clear();
    added.clear();
    stored.clear();
    storedFar.clear();
    gone.clear();
    types.clear();
    for (Name& name : names) name = {};
    at = At::Nothing;
}

// --- Moving

void Recordset::Implementation::leaveRow() {
    if (at == At::New) at = before;
    changes.clear();
    fresh.clear();
    wantsFresh = settled = deleted = wasHeld = false;
    held.reset();
}

void Recordset::Implementation::toFirst() {
    leaveRow();
    arrive(rows->toFirst());
}

void Recordset::Implementation::toNext() {
    leaveRow();
    if (at == At::Row) {
        arrive(rows->toNext());
    } else if (at == At::Added && ++addedAt >= static_cast<qint64>(added.size())) {
        at = At::Nothing;
    }
    wantsFresh = at == At::Added || wantsFresh;
}

void Recordset::Implementation::arrive(bool found) {
    for (; found; found = rows->toNext()) {
        if (isGone(rows->row())) continue;
        at = At::Row;
        wantsFresh = isOutdated(rows->row());
        if (cursor != adOpenDynamic || table.isEmpty() || readFresh()) return;
    }
    addedAt = 0;
    at = added.empty() ? At::Nothing : At::Added;
    wantsFresh = at == At::Added;
}

void Recordset::Implementation::toLast() {
    leaveRow();
    bool found = rows->toLast();
    if (!added.empty()) {
        at = At::Added;
        addedAt = static_cast<qint64>(added.size()) - 1;
        wantsFresh = true;
        return;
    }
    qint64 row = rows->row();
    while (found && isGone(row)) found = --row >= 0;
    if (found) rows->toRow(row);
    at = found ? At::Row : At::Nothing;
    wantsFresh = found && isOutdated(row);
}

void Recordset::Implementation::toRow(qint64 place) {
    if (place < 0 || place >= rowsInMemory())
        throw core::Failure(core::NoCurrentRow, u"A linha pedida não existe."_s);
    leaveRow();
    const qint64 row = shown(place);
    at = row < rows->count() ? At::Row : At::Added;
    if (at == At::Row)
        rows->toRow(row);
    else
        addedAt = row - rows->count();
    wantsFresh = at == At::Added || isOutdated(row);
}

qint64 Recordset::Implementation::recordCount() const {
    if (rows->count() < 0) return -1;
    return rows->count() - static_cast<qint64>(gone.size()) + static_cast<qint64>(added.size());
}

qint64 Recordset::Implementation::rowsInMemory() const {
    return rows && rows->inMemory() ? recordCount() : 0;
}

qint64 Recordset::Implementation::shown(qint64 place) const {
    for (const qint64 row : gone) place += row <= place ? 1 : 0;
    return place;
}

// --- Reading

int Recordset::Implementation::find(const QString& name) const {
    // The multiplication spreads the places of texts that the compiler laid side by side.
    const auto place = reinterpret_cast<quintptr>(name.constData()) * 0x9E3779B97F4A7C15U;
    Name& known = names[place >> 58];
    if (known.column >= 0 && known.text == name) return known.column;
    const int column = rows->columns().indexOf(name);
    if (column >= 0) known = {name, column};
    return column;
}

int Recordset::Implementation::columnOf(const QString& name) const {
    requireOpen();
    const int column = find(name);
    return column >= 0 ? column : requireColumn(rows->columns(), name);
}

QVariant Recordset::Implementation::value(int column) {
    requireRow();
    if (const QVariant* changed = changes.find(column)) return *changed;
    if (at == At::New) return {};
    look();
    const ColumnType type = typeOf(column);
    if (fresh.count() > 0) return toVariant(fresh.cell(0, column), type);
    if (at == At::Added) return {};  // deleted by somebody else since
    if (!stored.empty())
        if (const auto row = stored.find(rows->row()); row != stored.end())
            if (const QVariant* known = row->second.find(column)) return *known;
    return toVariant(rows->cell(column), type);
}

ColumnType Recordset::Implementation::typeOf(int column) {
    const Pass& pass = rows->columns();
    if (types.empty()) types.resize(static_cast<std::size_t>(pass.columnCount()));
    std::optional<ColumnType>& known = types[static_cast<std::size_t>(column)];
    if (!known) known = pass.column(column).type;
    return *known;
}

QVariant Recordset::Implementation::valueAt(qint64 place, int column) {
    const qint64 row = shown(place);
    const ColumnType type = rows->columns().column(column).type;
    if (row >= rows->count() || isStoredFar(row)) {
        RowStore store;
        const RowIdentity which = row < rows->count()
                                      ? rows->identityAt(row)
                                      : added[static_cast<std::size_t>(row - rows->count())];
        if (!session()->read(table, which, store)) return {};
        return toVariant(store.cell(0, column), type);
    }
    if (const auto known = stored.find(row); known != stored.end())
        if (const QVariant* changed = known->second.find(column)) return *changed;
    return toVariant(rows->cellAt(row, column), type);
}

RowIdentity Recordset::Implementation::identity() {
    return at == At::Added ? added[static_cast<std::size_t>(addedAt)] : rows->identity();
}

void Recordset::Implementation::lookAtRow() {
    if (lockType == adLockPessimistic && !wasHeld && !settled) {
        fresh.clear();
        held = session()->lock(table, identity(), connection->CommandTimeout, fresh);
        wasHeld = true;
        wantsFresh = false;
    }
    if (wantsFresh) readFresh();
}

void Recordset::Implementation::holdStill() {
    if (!wasHeld || isHeld()) return;
    held.reset();
    RowStore now;
    std::unique_ptr<RowLock> again =
        session()->lock(table, identity(), connection->CommandTimeout, now);
    if (now != fresh)
        throw core::Failure(core::RowInUse,
                            u"A ligação a «%1» perdeu-se e a linha foi entretanto alterada por "
                            u"outro posto; nada foi gravado. Leia-a de novo."_s.arg(book));
    held = std::move(again);
}

bool Recordset::Implementation::readFresh() {
    wantsFresh = false;
    fresh.clear();
    return session()->read(table, identity(), fresh);
}

// --- Requirements

void Recordset::Implementation::refuseClosed() {
    throw core::Failure(core::ObjectClosed, u"O conjunto de linhas está fechado."_s);
}

void Recordset::Implementation::refuseNoRow() {
    throw core::Failure(core::NoCurrentRow, u"Não há nenhuma linha corrente."_s);
}

std::shared_ptr<Session> Recordset::Implementation::session() const {
    const std::shared_ptr<Session>& engine = connection->session();
    if (engine->book() != book)
        throw core::Failure(
            core::NotUpdatable,
            u"A ligação passou para outro livro («%1»); a linha pertence a «%2»."_s.arg(
                engine->book(), book));
    return engine;
}

}  // namespace ado
