// SPDX-License-Identifier: MIT
#pragma once

#include <QAbstractTableModel>
#include <QFont>
#include <QPalette>
#include <memory>

#include "host/MovementBook.h"

namespace host {

/// The movements that fit the filter, as a table. Only the rows that are looked at are read from
/// the book, a block at a time.
class MovementList : public QAbstractTableModel {
    Q_OBJECT
public:
    using QAbstractTableModel::QAbstractTableModel;

    /// Takes a book and its movements; null for both empties the list.
    void setBook(std::shared_ptr<MovementBook> book, std::shared_ptr<MovementSearch> search);
    const std::shared_ptr<MovementSearch>& search() const { return search_; }
    void setFilter(const QString& filter);
    /// Shows the movements in this order of all their positions; empty for the newest first.
    void setOrder(const std::vector<quint32>& positions);
    const QString& filter() const { return filter_; }
    /// Takes in what was posted or annulled since, at the top whatever the order, and reads the
    /// shown rows afresh. Gives how many movements came. Fails as reading does.
    int takeNewer();
    /// Reads the shown rows afresh the next time they are looked at.
    void forgetRows();

    /// Movements in all, whatever the filter.
    int total() const { return search_ ? int(search_->size()) : 0; }
    qint32 movimento_id(int row) const;
    /// The number that people know it by, and its type; empty for a row that cannot be read.
    QString number(int row) const;
    QString tipo(int row) const;
    /// Where a movement stands, -1 when it is not shown.
    int rowOf(qint32 movimento_id) const;

    int rowCount(const QModelIndex& parent = {}) const override;
    int columnCount(const QModelIndex& parent = {}) const override;
    QVariant data(const QModelIndex& index, int role) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override;

    /// Tells that a column is to sort by; -1 for none.
    void sort(int column, Qt::SortOrder order) override { emit sortWanted(column, order); }

signals:
    void sortWanted(int column, Qt::SortOrder order);
    /// Rows could not be read; the list shows them empty.
    void failed(const QString& text) const;

private:
    void refilter();
    std::vector<quint32> inOrder(const std::vector<quint32>& found) const;
    const MovementRow& rowAt(int row) const;
    void readBlock(int row) const;

    std::shared_ptr<MovementBook> book_;
    std::shared_ptr<MovementSearch> search_;
    QString filter_;
    std::vector<quint32> order_;  // of all positions; empty for their own
    std::vector<quint32> found_;
    mutable QHash<qint32, MovementRow> read_;
};

}  // namespace host
