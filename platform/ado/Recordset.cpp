// SPDX-License-Identifier: MIT
#include "platform/ado/Recordset.h"

#include "platform/ado/RecordsetImplementation.h"
#include "platform/ado/ValueRows.h"
#include "platform/ado/engine/ColumnValue.h"
#include "platform/core/Failure.h"
#include "platform/core/Values.h"

namespace ado {

using namespace Qt::StringLiterals;

QString Field::Name() const {
    return owner_->d->rows->columns().column(column_).name;
}
int Field::DefinedSize() const {
    return owner_->d->rows->columns().column(column_).definedSize;
}
ColumnType Field::Type() const {
    return owner_->d->rows->columns().column(column_).type;
}
QVariant Field::Value() const {
    return owner_->value(column_);
}
void Field::setValue(const QVariant& value) {
    owner_->setValue(column_, value);
}

Recordset::Recordset() : d(std::make_unique<Implementation>()) {}
Recordset::~Recordset() = default;

RecordsetPtr Recordset::create() {
    return RecordsetPtr(new Recordset);
}

RecordsetPtr Recordset::ofValues(std::vector<Column> columns, std::vector<QVariantList> rows) {
    RecordsetPtr set = create();
    set->d->rows = std::make_unique<Rows>(
        std::make_shared<ValueRows>(std::move(columns), std::move(rows)), true);
    set->MoveFirst();
    return set;
}

void Recordset::Open(const QString& source, const ConnectionPtr& connection, CursorType cursor,
                     LockType lock, CommandType) {
    if (d->rows) throw core::Failure(core::ObjectOpen, u"O conjunto de linhas já está aberto."_s);
    if (!connection) throw core::Failure(core::ObjectClosed, u"Falta a ligação."_s);
    d->source = source;
    d->connection = connection;
    d->cursor = cursor;
    d->lockType = lock;
    try {
        d->openRows();
    } catch (...) {
        d->close();
        throw;
    }
    emit opened();
    emit currentRowChanged();
}

ObjectState Recordset::State() const {
    return d->rows ? adStateOpen : adStateClosed;
}

void Recordset::Close() {
    d->requireOpen();
    d->close();
    emit closed();
}

void Recordset::Requery() {
    d->requireOpen();
    if (d->book.isEmpty()) return MoveFirst();  // a chapter's rows came with its parent
    d->close();
    try {
        d->openRows();
    } catch (...) {
        d->close();
        emit closed();
        throw;
    }
    emit opened();
    emit currentRowChanged();
}

const QString& Recordset::Source() const {
    return d->source;
}

bool Recordset::atEnd() const {
    d->requireOpen();
    return d->current.isNothing();
}

void Recordset::MoveFirst() {
    d->requireOpen();
    d->toFirst();
    emit currentRowChanged();
}

void Recordset::MoveLast() {
    d->requireOpen();
    d->toLast();
    emit currentRowChanged();
}

void Recordset::MoveNext() {
    d->requireOpen();
    d->toNext();
    emit currentRowChanged();
}

qint64 Recordset::RecordCount() const {
    d->requireOpen();
    return d->recordCount();
}

void Recordset::AddNew() {
    d->addNew();
    emit currentRowChanged();
}

void Recordset::Update(const Accompaniment& with) {
    d->update(with);
    emit currentRowChanged();
}

void Recordset::CancelUpdate() {
    d->requireOpen();
    d->current.cancel(d->isOutdated());
    emit currentRowChanged();
}

void Recordset::Delete() {
    d->remove();
    emit currentRowChanged();
}

bool Recordset::isNewRow() const {
    return d->current.isNew();
}

Field Recordset::Fields(const QString& name) {
    return {this, d->columnOf(name)};
}

Field Recordset::Fields(int column) {
    if (column < 0 || column >= columnCount())
        throw core::Failure(core::NoSuchItem, u"A coluna %1 não existe."_s.arg(column));
    return {this, column};
}

int Recordset::columnCount() const {
    d->requireOpen();
    return d->rows->columns().columnCount();
}

int Recordset::columnOf(const QString& name) const {
    return d->columnOf(name);
}

bool Recordset::hasColumn(const QString& name) const {
    return d->rows && d->find(name) >= 0;
}

QVariant Recordset::Collect(const QString& name) const {
    return d->value(d->columnOf(name));
}

QVariant Recordset::readValue(const QString& name) const {
    const int column = d->columnOf(name);
    return toVariant(readCell(column), d->rows->columns().column(column).type);
}

Cell Recordset::readCell(int column) const {
    d->requireRow();
    const bool isQueried = !d->current.isNew() && d->current.at() == At::Queried;
    return isQueried ? d->rows->cell(column) : Cell();
}

void Recordset::setCollect(const QString& name, const QVariant& value) {
    setValue(d->columnOf(name), value);
}

QVariant Recordset::value(int column) const {
    return d->value(column);
}

void Recordset::setValue(int column, const QVariant& value) {
    if (d->setValue(column, value)) emit fieldChanged(column);
}

void Recordset::copyValue(int column, const Recordset& from, int fromColumn) {
    if (!d->copyCell(column, *from.d, fromColumn)) setValue(column, from.value(fromColumn));
}

RecordsetPtr Recordset::Chapter(const QString& name) const {
    d->requireOpen();
    if (!d->chapter || d->chapter->name.compare(name, Qt::CaseInsensitive) != 0)
        throw core::Failure(core::NoSuchItem, u"O capítulo «%1» não existe."_s.arg(name));
    const ChapterRows& chapter = *d->chapter;
    std::shared_ptr<RowStore> store;
    if (d->rowsInMemory() > 0)
        store = chapter.byKey.value(core::toText(d->value(chapter.parentColumn)));
    if (!store) store = std::make_shared<RowStore>();
    RecordsetPtr children = create();
    children->d->source = d->source;
    children->d->rows = std::make_unique<Rows>(chapter.description, store);
    children->MoveFirst();
    return children;
}

void Recordset::readAll() {
    d->requireOpen();
    d->rows->takeAll();
}

qint64 Recordset::rowsInMemory() const {
    return d->rowsInMemory();
}

QVariant Recordset::valueAt(qint64 row, int column) const {
    if (row < 0 || row >= rowsInMemory())
        throw core::Failure(core::NoCurrentRow, u"A linha pedida não está em memória."_s);
    return d->valueAt(row, column);
}

void Recordset::MoveTo(qint64 row) {
    d->requireOpen();
    d->toRow(row);
    emit currentRowChanged();
}

void Recordset::setClientSide(bool clientSide) {
    d->clientSide = clientSide;
}

}  // namespace ado
