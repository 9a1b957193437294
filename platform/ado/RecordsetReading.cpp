// SPDX-License-Identifier: MIT
// Opening, moving and reading of row sets.
#include "platform/ado/RecordsetImplementation.h"
#include "platform/ado/dialect/Query.h"
#include "platform/ado/engine/ColumnValue.h"
#include "platform/ado/engine/EngineTexts.h"
#include "platform/ado/engine/RowFile.h"
#include "platform/core/Failure.h"
#include "platform/core/Values.h"

namespace ado {

using namespace Qt::StringLiterals;

namespace {

/// The value that relates parent and child as text; null relates to nothing.
QString keyOf(const Cell& cell) {
    return cell.kind == Cell::Null ? QString() : core::toText(toVariant(cell, ColumnType::Other));
}

/// A change, which may be a value that was copied as the engine keeps it.
QVariant converted(const QVariant& change, ColumnType type) {
    Cell cell;
    const QByteArray text =
        change.typeId() == QMetaType::QByteArray ? change.toByteArray() : QByteArray();
    if (!text.isNull()) {
        cell.kind = Cell::Text;
        cell.text = {text.constData(), static_cast<std::size_t>(text.size())};
    } else if (change.typeId() == QMetaType::Double) {
        cell.kind = Cell::Real;
        cell.real = change.toDouble();
    } else if (change.typeId() == QMetaType::LongLong) {
        cell.kind = Cell::Integer;
        cell.integer = change.toLongLong();
    } else {
        return change;
    }
    return toVariant(cell, type);
}

/// Bytes of child rows that are held in memory; very many more are set aside together.
constexpr std::size_t MostInMemory = 16 << 20;

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
    const Query query(source);
    query.requireQuery(connection->shapes());
    book = engine->book();
    try {
        if (ShapeQuery::isShape(query)) {
            openShape(query);
        } else {
            openQuery(query);
        }
    } catch (const core::Failure& failure) {
        throw explained(failure, source);
    }
    current.standOn(rows->toFirst() ? At::Queried : At::Nothing, false);
}

void Recordset::Implementation::openQuery(const Query& query) {
    Session& engine = *connection->session();
    if (!readOnly()) table = query.singleTable();
    if (!table.isEmpty() && !engine.isTable(table)) table.clear();
    rows = std::make_unique<Rows>(engine.open(query, table), clientSide, query.groups());
    // A counter without its row: of all that find none, one alone adds it; the others wait here
    // and find it then.
    const bool isCounter = cursor == adOpenDynamic && lockType == adLockPessimistic;
    if (!isCounter || table.isEmpty() || rows->toFirst()) return;
    RowStore nothing;
    heldPlace = engine.lock(table, NoRow, connection->CommandTimeout, nothing);
    rows = std::make_unique<Rows>(engine.open(query, table), clientSide);
    if (rows->toFirst()) heldPlace.reset();
}

void Recordset::Implementation::openShape(const Query& query) {
    const ShapeQuery shape = ShapeQuery::parse(query);
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
    while (!chapter->byKey.isEmpty() && chapter->description->step())
        chapter->keep(keyOf(chapter->description->cell(childColumn)));
    chapter->description->release();
    rows = std::move(parents);
}

void ChapterRows::keep(const QString& key) {
    const auto of = byKey.constFind(key);
    if (of == byKey.constEnd()) return;
    RowStore& rows = **of;
    const std::size_t before = rows.packedBytes();
    rows.append(*description);
    bytes += rows.packedBytes() - before;
    if (bytes < MostInMemory) return;
    if (!file) file = std::make_shared<RowFile>();
    for (const auto& each : byKey) each->setAside(file);
    bytes = 0;
}

void Recordset::Implementation::close() {
    current.standOn(At::Nothing, false);
    own = {};
    heldPlace.reset();
    rows.reset();
    chapter.reset();
    table.clear();
    book.clear();
    for (Name& name : names) name = {};
    writtenColumns.clear();
}

// --- Moving

void Recordset::Implementation::toFirst() {
    current.leave();
    arrive(rows->toFirst());
}

void Recordset::Implementation::toNext() {
    current.leave();
    if (current.at() == At::Queried)
        arrive(rows->toNext());
    else if (current.at() == At::Inserted)
        standOnInserted(current.inserted() + 1);
}

void Recordset::Implementation::arrive(bool found) {
    for (; found; found = rows->toNext()) {
        if (own.isDeleted(rows->row())) continue;
        current.standOn(At::Queried, isOutdated(rows->row()));
        if (!isDynamic() || current.read(tableRow())) return;
    }
    standOnInserted(0);
}

void Recordset::Implementation::toLast() {
    current.leave();
    rows->toLast();
    if (own.insertedCount() > 0) return standOnInserted(own.insertedCount() - 1);
    qint64 row = rows->row();
    while (row >= 0 && own.isDeleted(row)) --row;
    if (row < 0) return current.standOn(At::Nothing, false);
    rows->toRow(row);
    current.standOn(At::Queried, isOutdated(row));
}

void Recordset::Implementation::toRow(qint64 place) {
    if (place < 0 || place >= rowsInMemory())
        throw core::Failure(core::NoCurrentRow, u"A linha pedida não existe."_s);
    const qint64 row = own.shownAt(place);
    if (row >= rows->count()) return standOnInserted(row - rows->count());
    rows->toRow(row);
    current.standOn(At::Queried, isOutdated(row));
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
    if (const QVariant* change = ado::find(current.changes(), column))
        return converted(*change, rows->columns().column(column).type);
    if (current.isNew()) return {};
    look();
    const ColumnType type = rows->columns().column(column).type;
    if (const QVariant* written = current.written(column)) return *written;
    if (current.isFresh()) return toVariant(current.cell(column), type);
    if (current.at() == At::Inserted) return {};  // deleted by somebody else since
    if (const QVariant* known = own.stored(rows->row(), column)) return *known;
    return toVariant(rows->cell(column), type);
}

QVariant Recordset::Implementation::valueAt(qint64 place, int column) {
    const qint64 row = own.shownAt(place);
    const ColumnType type = rows->columns().column(column).type;
    const qint64 inserted = row - rows->count();
    if (inserted >= 0 || own.isMarked(row)) {
        RowStore store;
        const RowIdentity identity = inserted >= 0 ? own.inserted(inserted) : rows->identityAt(row);
        if (!session()->read(table, identity, store)) return {};
        return toVariant(store.cell(0, column), type);
    }
    if (const QVariant* known = own.stored(row, column)) return *known;
    return toVariant(rows->cellAt(row, column), type);
}

TableRow Recordset::Implementation::tableRow() {
    const bool isInserted = current.at() == At::Inserted;
    const RowIdentity identity = isInserted ? own.inserted(current.inserted()) : rows->identity();
    if (identity == NoRow)
        throw core::Failure(core::InvalidCall,
                            u"A linha acrescentada só se pode ler depois de gravadas todas."_s);
    return {session(), table, identity, connection->CommandTimeout};
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
