// SPDX-License-Identifier: MIT
#pragma once

#include <QWidget>

#include "host/MovementList.h"
#include "host/MovementLoader.h"
#include "host/MovementSorter.h"

class QLineEdit;
class QStackedWidget;

namespace host {

class MovementTable;
class Notice;

/// Why a movement of that type has no screen to be looked at on; empty for those that have one.
QString reasonNotToOpen(const QString& tipo);

/// The list of movements in force with its filter; in place of the list a text when the book cannot
/// be read.
class MovementsView : public QWidget {
    Q_OBJECT
public:
    MovementsView();

    /// Reads a book beside the window: the newest movements are shown as soon as they are there,
    /// and what was shown of the same book until then.
    void open(const BookSettings& settings);
    /// Shows, in place of the list, why the book is not opened, and what can be done about it.
    void refuse(const QString& why, const QString& hint);
    /// Shows what was posted or annulled since, here or at another workstation.
    void takeNewer();

    /// True when the book that is open holds sample data.
    bool isSample() const { return isSample_; }

    void focusFilter();
    void focusList();
    /// As Enter on the movement under the cursor.
    void chooseCurrent();
    /// The movement under the cursor; 0 for none.
    qint32 current() const;
    /// Widths and order, for setColumns; anything else leaves the usual ones.
    QByteArray columns() const;
    void setColumns(const QByteArray& columns);
    QString filter() const;
    void setFilter(const QString& filter);
    /// Sorts by a column, and turns the order round when it is sorted by that one; -1 puts the
    /// newest at the top.
    void orderBy(int column);

    /// Shows what the filter leaves as pages to print.
    void print();
    /// Asks for a file and writes what the filter leaves to it, for spreadsheets.
    void keepAsCsv();

signals:
    /// The newest movements of the book are shown.
    void opened();
    /// Enter or a double click on a movement.
    void chosen(qint32 movimento_id);
    /// How many movements are shown, for the status line.
    void countChanged(const QString& text);
    /// The whole book was read afresh.
    void bookRead();
    /// Something to be read in passing, for the status line.
    void told(const QString& text);

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void layOut();
    void connectParts();
    bool keyInFilter(int key);
    bool keyInList(const QKeyEvent& key);
    void filterChanged(const QString& text);
    void forgetBook();
    void takeBegun(const std::shared_ptr<MovementSearch>& newest, bool isSample);
    void takeLoaded(const std::shared_ptr<MovementSearch>& search);
    void sortBy(int column, Qt::SortOrder order);
    void sortAgain();
    void takeSorted(const std::vector<quint32>& positions);
    template <class Change>
    void changeList(Change&& change);
    template <class Change>
    void keepingPlace(Change&& change);
    void showUnreadable(const QString& text);
    void showNotice(const QString& text, const QString& hint);
    void showCount();
    void showEmptyText();
    bool isListed();

    BookSettings settings_;
    int read_ = 0;  ///< movements that have been read of a book that is being read
    bool isSample_ = false;
    std::shared_ptr<MovementBook> book_;
    MovementList* movements_;
    MovementLoader* loader_;
    MovementSorter* sorter_;
    int sortColumn_ = -1;  // -1 for none, with the newest first
    Qt::SortOrder sortOrder_ = Qt::AscendingOrder;
    bool isNewerWanted_ =
        false;  // takeNewer() waits until the sorter no longer reads the movements
    QLineEdit* filter_;
    MovementTable* list_;
    Notice* notice_;
    QStackedWidget* stack_;
};

}  // namespace host
