// SPDX-License-Identifier: MIT
#include "host/TextTable.h"

#include <QAbstractTableModel>
#include <QHeaderView>

#include "platform/forms/Look.h"

namespace host {

class TextTable::Rows : public QAbstractTableModel {
public:
    Rows(const std::vector<Column>& columns, QObject* parent)
        : QAbstractTableModel(parent), columns_(columns) {}

    void set(std::vector<QStringList> rows) {
        beginResetModel();
        rows_ = std::move(rows);
        endResetModel();
    }
    int rowCount(const QModelIndex& parent = {}) const override {
        return parent.isValid() ? 0 : static_cast<int>(rows_.size());
    }
    int columnCount(const QModelIndex& parent = {}) const override {
        return parent.isValid() ? 0 : static_cast<int>(columns_.size());
    }
    QVariant data(const QModelIndex& index, int role) const override {
        if (role == Qt::DisplayRole || role == Qt::ToolTipRole)
            return rows_[static_cast<std::size_t>(index.row())].value(index.column());
        if (role == Qt::TextAlignmentRole) return alignment(index.column());
        return {};
    }
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override {
        if (orientation != Qt::Horizontal) return {};
        if (role == Qt::DisplayRole) return columns_[static_cast<std::size_t>(section)].title;
        if (role == Qt::TextAlignmentRole) return alignment(section);
        return {};
    }

private:
    QVariant alignment(int column) const {
        const bool isNumber = columns_[static_cast<std::size_t>(column)].isNumber;
        return QVariant::fromValue((isNumber ? Qt::AlignRight : Qt::AlignLeft) | Qt::AlignVCenter);
    }
    std::vector<Column> columns_;
    std::vector<QStringList> rows_;
};

TextTable::TextTable(const QString& name, const std::vector<Column>& columns)
    : rows_(new Rows(columns, this)) {
    setObjectName(name);
    setModel(rows_);
    forms::settleTable(*this, ExtendedSelection);
    setHorizontalScrollMode(ScrollPerPixel);
    horizontalHeader()->setStretchLastSection(true);
    for (std::size_t column = 0; column < columns.size(); ++column)
        setColumnWidth(static_cast<int>(column),
                       fontMetrics().horizontalAdvance(u'0') * columns[column].width);
}

void TextTable::setRows(std::vector<QStringList> rows) {
    rows_->set(std::move(rows));
}

QSize TextTable::sizeHint() const {
    constexpr int FewRows = 5;
    return {QTableView::sizeHint().width(), FewRows * verticalHeader()->defaultSectionSize()};
}

}  // namespace host
