// SPDX-License-Identifier: MIT
#pragma once

#include <QAbstractTableModel>
#include <QFont>
#include <QPalette>
#include <QTimer>
#include <memory>
#include <set>

#include "host/MovementBook.h"

namespace host {

/// The movements that fit the filter, as a table. Only the rows that are looked at are read from
/// the book, a block at a time. Painting itself reads nothing, as a book that keeps it waiting
/// would have the windows painted once more meanwhile: a row that is not known yet is painted
/// empty, one that was forgotten as it was, and both are read when the painting is over.
class MovementList : public QAbstractTableModel {
    Q_OBJECT
public:
    explicit MovementList(QObject* parent);

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
    /// Reads the rows around one at once, unless they are known, so that they are painted complete.
    /// Nothing for a row that there is not, nor while the book is being waited for.
    void read(int row);

    /// How a column is headed, written (as core::formatted takes it) and aligned.
    static const QString& heading(int column);
    static QStringView format(int column);
    static Qt::Alignment alignment(int column);

    /// The movements that are shown, in their order.
    std::vector<qint32> keys() const;
    /// Movements in all, whatever the filter.
    int total() const { return search_ ? int(search_->size()) : 0; }
    qint32 movimento_id(int row) const;
    /// What a cell says, read from the book if need be; empty for a row that cannot be read.
    QString text(int row, int column);
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
    void failed(const QString& text);

private:
    void refilter();
    std::vector<quint32> inOrder(const std::vector<quint32>& found) const;
    void forgetRows();
    bool isKnown(int row) const;
    void want(int row) const;
    void readWanted();
    void readBlock(int block);

    std::shared_ptr<MovementBook> book_;
    std::shared_ptr<MovementSearch> search_;
    QString filter_;
    std::vector<quint32> order_;  // of all positions; empty for their own
    std::vector<quint32> found_;
    struct ReadRow {
        MovementRow row;
        int reading = -1;  // which of the readings gave it
    };
    QHash<qint32, ReadRow> read_;
    int reading_ = 0;               // rows of former ones are shown until they are read again
    mutable std::set<int> wanted_;  // blocks of rows that were painted without being known
    mutable QTimer reader_;
};

}  // namespace host
