// SPDX-License-Identifier: MIT
#include "host/MovementTable.h"

#include <QHeaderView>

#include "host/MovementList.h"
#include "host/Notice.h"
#include "platform/forms/Look.h"
#include "platform/forms/TableCopy.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

// Usual widths, in digits of the list's font; the names take what is left.
constexpr int Widths[MovementRow::ColumnCount] = {8, 12, 9, 34, 34, 6, 14, 13, 13, 13};
constexpr int LeastName = 16;

}  // namespace

MovementTable::MovementTable(MovementList* movements)
    : empty_(new Notice(viewport(), u"Vazio"_s, u"VazioSugestao"_s)) {
    setObjectName(u"Lista"_s);
    setAccessibleName(u"Movimentos"_s);
    setModel(movements);
    copying_ = forms::settleTable(*this, ExtendedSelection);
    copying_->textOf = [movements](const QModelIndex& cell) {
        return movements->text(cell.row(), cell.column());
    };
    setFrameShape(QFrame::NoFrame);
    setHorizontalScrollMode(ScrollPerPixel);
    QHeaderView* header = horizontalHeader();
    header->setSectionsMovable(false);
    header->setSectionsClickable(true);
    header->setSortIndicatorClearable(true);
    header->setSortIndicatorShown(true);
    header->setSortIndicator(-1, Qt::AscendingOrder);
    for (int column = 0; column < MovementRow::ColumnCount; ++column)
        setColumnWidth(column, fontMetrics().horizontalAdvance('0'_L1) * Widths[column]);
    connect(header, &QHeaderView::sectionResized, this, [this](int column, int before, int after) {
        giveFreeSpace(column, std::max(0, after - before));
    });
    connect(movements, &QAbstractItemModel::modelReset, this, &MovementTable::showEmptyText);
}

void MovementTable::standOn(int row) {
    const QModelIndex index = model()->index(row, 0);
    if (selectionModel()->isSelected(index) && currentIndex().row() == row) return;
    selectionModel()->setCurrentIndex(
        index, QItemSelectionModel::ClearAndSelect | QItemSelectionModel::Rows);
}

void MovementTable::setEmptyText(const QString& text, const QString& hint) {
    empty_->text->setText(text);
    empty_->hint->setText(hint);
    showEmptyText();
}

void MovementTable::showEmptyText() {
    const bool isEmpty = model()->rowCount() == 0;
    empty_->text->setVisible(isEmpty);
    empty_->hint->setVisible(isEmpty);
}

QByteArray MovementTable::columns() const {
    return horizontalHeader()->saveState();
}

void MovementTable::setColumns(const QByteArray& columns) {
    QHeaderView* header = horizontalHeader();
    header->restoreState(columns);
    // What a person can do with the columns is not a matter of what was kept.
    header->setSectionResizeMode(QHeaderView::Interactive);
    header->setSortIndicatorClearable(true);
    header->setSortIndicatorShown(true);
}

// Before it is shown, the table has a width that means nothing.
void MovementTable::showEvent(QShowEvent* event) {
    QTableView::showEvent(event);
    giveFreeSpace(-1, viewport()->width());
}

void MovementTable::resizeEvent(QResizeEvent* event) {
    QTableView::resizeEvent(event);
    if (isVisible())
        giveFreeSpace(-1, std::max(0, event->oldSize().width() - event->size().width()));
}

/// The names grow and shrink so that the columns fill the window: by what the person gave to
/// another column or took from the window, so that a list that he made wider than the window stays
/// so. A name's column whose width he is changing keeps what he gives it.
/// @param kept  that column; -1 for none
/// @param mostTaken  how much the names shrink at most, in pixels
void MovementTable::giveFreeSpace(int kept, int mostTaken) {
    if (isFitting_) return;
    isFitting_ = true;
    const int least = fontMetrics().horizontalAdvance('0'_L1) * LeastName;
    int free = std::max(viewport()->width() - horizontalHeader()->length(), -mostTaken);
    int sharing = kept == MovementRow::Name || kept == MovementRow::Person ? 1 : 2;
    for (const int column : {MovementRow::Name, MovementRow::Person}) {
        if (column == kept) continue;
        const int before = columnWidth(column);
        const int after = std::max(before + free / sharing--, std::min(before, least));
        setColumnWidth(column, after);
        free -= after - before;
    }
    isFitting_ = false;
}

}  // namespace host
