// SPDX-License-Identifier: MIT
#pragma once

#include <QWidget>

#include "host/MovementList.h"
#include "host/MovementLoader.h"

class QLabel;
class QLineEdit;
class QStackedWidget;
class QTableView;

namespace host {

/// The list of movements in force with its filter; in place of the list a text when the book cannot
/// be read.
class MovementsView : public QWidget {
    Q_OBJECT
public:
    MovementsView();

    /// Shows the newest movements of a book at once and reads the others beside it.
    void open(const BookSettings& settings);
    /// Shows what was posted or annulled since, here or at another workstation.
    void takeNewer();

    void focusFilter();
    void focusList();
    /// As Enter on the movement under the cursor.
    void chooseCurrent();
    QByteArray columns() const;
    /// Widths as columns() gave them; anything else leaves the usual ones.
    void setColumns(const QByteArray& columns);

signals:
    /// Enter or a double click on a movement.
    void chosen(qint32 movimento_id);
    /// How many movements are shown, for the status line.
    void countChanged(const QString& text);
    /// The whole book was read afresh.
    void bookRead();

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void layOut();
    void connectParts();
    bool keyInFilter(int key);
    bool keyInList(const QKeyEvent& key);
    void filterChanged(const QString& text);
    void takeLoaded(const std::shared_ptr<MovementSearch>& search);
    template <class Change>
    void changeList(Change&& change);
    template <class Change>
    void keepingPlace(Change&& change);
    void showUnreadable(const QString& text);
    void showNotice(const QString& text, const QString& hint);
    void showCount();

    BookSettings settings_;
    std::shared_ptr<MovementBook> book_;
    MovementList* movements_;
    MovementLoader* loader_;
    QLineEdit* filter_;
    QTableView* list_;
    QLabel* notice_;
    QLabel* hint_;
    QStackedWidget* stack_;
};

}  // namespace host
