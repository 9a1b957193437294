// SPDX-License-Identifier: MIT
#include "host/MovementList.h"

#include <QApplication>
#include <numeric>

#include "host/LeftForLater.h"
#include "platform/core/Failure.h"
#include "platform/core/Format.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

struct ColumnLook {
    QString heading;
    QStringView format;
    Qt::Alignment alignment;
};

const ColumnLook& look(int column) {
    static const ColumnLook looks[MovementRow::ColumnCount] = {
        {u"Nº"_s, {}, Qt::AlignRight},
        {u"Data"_s, core::format::Date, Qt::AlignHCenter},
        {u"Nº KOR"_s, {}, Qt::AlignRight},
        {u"Associado"_s, {}, Qt::AlignLeft},
        {u"Familiar"_s, {}, Qt::AlignLeft},
        {u"Tipo"_s, {}, Qt::AlignHCenter},
        {u"Documento"_s, {}, Qt::AlignLeft},
        {u"Valor"_s, core::format::Money, Qt::AlignRight},
        {u"Crédito"_s, core::format::Money, Qt::AlignRight},
        {u"Débito"_s, core::format::Money, Qt::AlignRight},
    };
    return looks[column];
}

constexpr QColor Amber(0x9a, 0x55, 0x00);
constexpr QColor AmberOnDark(0xe8, 0xb0, 0x62);

/// What was annulled is struck out and pale; the row that corrects it is slanted and amber. So the
/// two are told apart also where the colours of a selected row cover theirs.
QVariant lookOfType(const QString& tipo, int role) {
    const bool annulled = tipo == "ANL"_L1;
    if (!annulled && tipo != "COR"_L1) return {};
    if (role == Qt::FontRole) {
        QFont font = QApplication::font("QTableView");
        font.setStrikeOut(annulled);
        font.setItalic(!annulled);
        return font;
    }
    const QPalette palette = QApplication::palette();
    if (annulled) return palette.color(QPalette::PlaceholderText);
    const bool dark = palette.color(QPalette::Base).lightness() < 128;
    return dark ? AmberOnDark : Amber;
}

constexpr int BlockSize = 64;
constexpr int MostRowsKept = 4096;

}  // namespace

MovementList::MovementList(QObject* parent) : QAbstractTableModel(parent) {
    reader_.setSingleShot(true);
    connect(&reader_, &QTimer::timeout, this, &MovementList::readWanted);
}

void MovementList::setBook(std::shared_ptr<MovementBook> book,
                           std::shared_ptr<MovementSearch> search) {
    if (book_ != book) read_.clear();
    book_ = std::move(book);
    search_ = std::move(search);
    order_.clear();
    refilter();
}

void MovementList::setFilter(const QString& filter) {
    filter_ = filter;
    refilter();
}

void MovementList::setOrder(const std::vector<quint32>& positions) {
    order_ = positions;
    refilter();
}

int MovementList::takeNewer() {
    const int count = book_ && search_ ? book_->takeNewer(*search_) : 0;
    forgetRows();
    if (count == 0) return 0;
    if (!order_.empty()) {
        for (quint32& position : order_) position += quint32(count);
        std::vector<quint32> newer(static_cast<std::size_t>(count));
        std::iota(newer.begin(), newer.end(), 0U);
        order_.insert(order_.begin(), newer.begin(), newer.end());
    }
    refilter();
    return count;
}

/// Reads the shown rows afresh the next time they are looked at.
void MovementList::forgetRows() {
    ++reading_;
    if (rowCount() > 0) emit dataChanged(index(0, 0), index(rowCount() - 1, columnCount() - 1));
}

void MovementList::refilter() {
    beginResetModel();
    wanted_.clear();
    found_ = search_ ? inOrder(search_->find(filter_)) : std::vector<quint32>();
    endResetModel();
}

std::vector<quint32> MovementList::inOrder(const std::vector<quint32>& found) const {
    if (order_.empty()) return found;
    std::vector<bool> isFound(search_->size());
    for (const quint32 position : found) isFound[position] = true;
    std::vector<quint32> ordered;
    ordered.reserve(found.size());
    std::copy_if(order_.begin(), order_.end(), std::back_inserter(ordered),
                 [&](quint32 position) { return isFound[position]; });
    return ordered;
}

const QString& MovementList::heading(int column) {
    return look(column).heading;
}

QStringView MovementList::format(int column) {
    return look(column).format;
}

Qt::Alignment MovementList::alignment(int column) {
    return look(column).alignment;
}

std::vector<qint32> MovementList::keys() const {
    std::vector<qint32> keys;
    keys.reserve(found_.size());
    for (const quint32 position : found_) keys.push_back(search_->movimento_id(position));
    return keys;
}

qint32 MovementList::movimento_id(int row) const {
    return search_->movimento_id(found_[std::size_t(row)]);
}

QString MovementList::text(int row, int column) {
    read(row);
    return core::formatted(read_.value(movimento_id(row)).row.values[column], look(column).format);
}

int MovementList::rowOf(qint32 movimento_id) const {
    for (std::size_t row = 0; row < found_.size(); ++row)
        if (search_->movimento_id(found_[row]) == movimento_id) return int(row);
    return -1;
}

int MovementList::rowCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : int(found_.size());
}

int MovementList::columnCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : MovementRow::ColumnCount;
}

QVariant MovementList::data(const QModelIndex& index, int role) const {
    if (role == Qt::TextAlignmentRole)
        return int(look(index.column()).alignment | Qt::AlignVCenter);
    if (role != Qt::DisplayRole && role != Qt::ForegroundRole && role != Qt::FontRole) return {};
    if (!isKnown(index.row())) want(index.row());
    const MovementRow row = read_.value(movimento_id(index.row())).row;
    if (role == Qt::DisplayRole)
        return core::formatted(row.values[index.column()], look(index.column()).format);
    return lookOfType(row.values[MovementRow::Type].toString(), role);
}

QVariant MovementList::headerData(int section, Qt::Orientation orientation, int role) const {
    if (orientation != Qt::Horizontal) return {};
    if (role == Qt::DisplayRole) return look(section).heading;
    if (role == Qt::TextAlignmentRole) return int(look(section).alignment | Qt::AlignVCenter);
    return {};
}

bool MovementList::isKnown(int row) const {
    const auto found = read_.constFind(movimento_id(row));
    return found != read_.constEnd() && found->reading == reading_;
}

void MovementList::want(int row) const {
    wanted_.insert(row / BlockSize);
    if (!reader_.isActive()) reader_.start(0);
}

void MovementList::readWanted() {
    if (leftForLater(this, [this] { readWanted(); })) return;
    while (!wanted_.empty()) readBlock(wanted_.extract(wanted_.begin()).value());
}

void MovementList::read(int row) {
    if (row < rowCount() && !isKnown(row) && !core::isWaiting()) readBlock(row / BlockSize);
}

/// A row that is gone, or a failure, leaves the rows empty. The list may change while the book is
/// waited for.
void MovementList::readBlock(int block) {
    if (read_.size() > MostRowsKept) read_.clear();
    std::vector<qint32> keys;
    const int first = block * BlockSize;
    for (int row = first; row < std::min(first + BlockSize, rowCount()); ++row)
        keys.push_back(movimento_id(row));
    // What is painted while the book is waited for does not ask for them again.
    for (const qint32 key : keys) read_[key].reading = reading_;
    QHash<qint32, MovementRow> found;
    try {
        const std::shared_ptr<MovementBook> book = book_;
        for (const MovementRow& row : book->rows(keys)) found.insert(row.movimento_id, row);
    } catch (const core::Failure& failure) {
        emit failed(failure.text());
    }
    for (const qint32 key : keys) read_[key].row = found.value(key);
    const int last = std::min(first + BlockSize, rowCount()) - 1;
    if (first <= last) emit dataChanged(index(first, 0), index(last, columnCount() - 1));
}

}  // namespace host
