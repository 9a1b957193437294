// SPDX-License-Identifier: MIT
#pragma once

#include <QTableView>

namespace forms {

class TableCopy;

}  // namespace forms

namespace host {

class MovementList;
class Notice;

/// The table of movements: columns as wide as the person made them, what is left of the window to
/// the names; a text in the middle while there are none.
class MovementTable : public QTableView {
    Q_OBJECT
public:
    explicit MovementTable(MovementList* movements);

    /// Selects a row alone, whatever keys are held; rows chosen with it stay so.
    void standOn(int row);
    /// What stands in place of the rows while there are none, and what can be done about it.
    void setEmptyText(const QString& text, const QString& hint);
    /// Widths and order, for setColumns; anything else leaves the usual ones.
    QByteArray columns() const;
    void setColumns(const QByteArray& columns);

    /// Ctrl+C, whole rows, also those that have not been shown yet.
    forms::TableCopy* copying() const { return copying_; }

protected:
    void showEvent(QShowEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;

private:
    void showEmptyText();
    void giveFreeSpace(int kept, int mostTaken);

    forms::TableCopy* copying_;
    Notice* empty_;
    bool isFitting_ = false;
};

}  // namespace host
