// SPDX-License-Identifier: MIT
#include "platform/forms/DataGrid.h"

#include <QAbstractTableModel>
#include <QHeaderView>
#include <QKeyEvent>
#include <algorithm>

#include "platform/core/Format.h"
#include "platform/forms/Form.h"
#include "platform/forms/Look.h"

namespace forms {

/// The rows of the set as Qt's views read them.
class DataGrid::Rows : public QAbstractTableModel {
public:
    using QAbstractTableModel::QAbstractTableModel;

    void setColumns(const std::vector<GridColumn>& columns) {
        beginResetModel();
        columns_ = columns;
        find();
        endResetModel();
    }

    void setRecordset(const ado::RecordsetPtr& recordset) {
        if (set_) set_->disconnect(this);
        set_ = recordset;
        if (set_) {
            const auto again = [this] { handle([this] { readAnew(); }); };
            connect(set_.get(), &ado::Recordset::opened, this, again);
            connect(set_.get(), &ado::Recordset::closed, this, again);
            connect(set_.get(), &ado::Recordset::currentRowChanged, this, [this] { rowWritten(); });
        }
        readAnew();
    }

    /// Makes a line the set's current row.
    void moveTo(int row) {
        if (isOpen() && row >= 0 && row < count_) set_->MoveTo(row);
    }

    int rowCount(const QModelIndex& parent = {}) const override {
        return parent.isValid() ? 0 : count_;
    }
    int columnCount(const QModelIndex& parent = {}) const override {
        return parent.isValid() ? 0 : static_cast<int>(columns_.size());
    }

    QVariant data(const QModelIndex& index, int role) const override {
        const auto at = static_cast<std::size_t>(index.column());
        if (role == Qt::TextAlignmentRole) return alignment(columns_[at]);
        if (role != Qt::DisplayRole || positions_[at] < 0 || index.row() >= count_) return {};
        return core::formatted(set_->valueAt(index.row(), positions_[at]), columns_[at].format);
    }

    QVariant headerData(int section, Qt::Orientation orientation, int role) const override {
        if (orientation != Qt::Horizontal) return {};
        const GridColumn& column = columns_[static_cast<std::size_t>(section)];
        if (role == Qt::TextAlignmentRole) return alignment(column);
        return role == Qt::DisplayRole ? QVariant(column.heading) : QVariant();
    }

private:
    static QVariant alignment(const GridColumn& column) {
        return int((column.rightAligned ? Qt::AlignRight : Qt::AlignLeft) | Qt::AlignVCenter);
    }

    bool isOpen() const { return set_ && set_->State() == ado::adStateOpen; }

    int columnOf(const QString& field) const {
        for (int column = 0; isOpen() && column < set_->columnCount(); ++column)
            if (set_->Fields(column).Name().compare(field, Qt::CaseInsensitive) == 0) return column;
        return -1;
    }

    void find() {
        positions_.clear();
        for (const GridColumn& column : columns_) positions_.push_back(columnOf(column.field));
    }

    void readAnew() {
        beginResetModel();
        count_ = 0;
        if (isOpen()) {
            set_->readAll();
            count_ = static_cast<int>(set_->rowsInMemory());
        }
        find();
        endResetModel();
    }

    void rowWritten() {
        if (!isOpen()) return;
        if (set_->rowsInMemory() != count_)
            readAnew();
        else if (count_ > 0 && !columns_.empty())
            emit dataChanged(index(0, 0), index(count_ - 1, columnCount() - 1));
    }

    ado::RecordsetPtr set_;
    std::vector<GridColumn> columns_;
    std::vector<int> positions_;  ///< of each grid column in the set, -1 for missing
    int count_ = 0;
};

DataGrid::DataGrid(const QString& name, QWidget* parent)
    : QTableView(parent), rows_(new Rows(this)) {
    setObjectName(name);
    setModel(rows_);
    settleTable(*this);
    horizontalHeader()->setStretchLastSection(true);
    connect(rows_, &QAbstractItemModel::modelReset, this, [this] { mark(marked_); });
}

void DataGrid::setColumns(const std::vector<GridColumn>& columns) {
    rows_->setColumns(columns);
    const int character = fontMetrics().averageCharWidth();
    for (std::size_t at = 0; at < columns.size(); ++at)
        setColumnWidth(static_cast<int>(at), columns[at].width * character + character);
}

void DataGrid::setRecordset(const ado::RecordsetPtr& recordset) {
    marked_ = 0;
    rows_->setRecordset(recordset);
}

void DataGrid::mark(int row) {
    if (rows_->rowCount() == 0) return;
    marked_ = std::clamp(row, 0, rows_->rowCount() - 1);
    selectRow(marked_);
    handle([this] { rows_->moveTo(marked_); });
}

void DataGrid::currentChanged(const QModelIndex& current, const QModelIndex& previous) {
    QTableView::currentChanged(current, previous);
    if (!current.isValid() || current.row() == marked_) return;
    marked_ = current.row();
    handle([this] { rows_->moveTo(marked_); });
}

void DataGrid::keyPressEvent(QKeyEvent* event) {
    if (event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter)
        emit chosen();
    else if (event->key() == Qt::Key_Home)  // rows are chosen here, not cells
        mark(0);
    else if (event->key() == Qt::Key_End)
        mark(rows_->rowCount() - 1);
    else
        QTableView::keyPressEvent(event);
}

void DataGrid::mouseDoubleClickEvent(QMouseEvent* event) {
    QTableView::mouseDoubleClickEvent(event);
    if (event->button() == Qt::LeftButton) emit chosen();
}

}  // namespace forms
