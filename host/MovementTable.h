// SPDX-License-Identifier: MIT
#pragma once

#include <QTableView>

namespace host {

class MovementList;
class Notice;

/// The table of movements: columns as wide as the person made them, what is left of the window to
/// the names; Ctrl+C copies whole rows; a text in the middle while there are none.
class MovementTable : public QTableView {
    Q_OBJECT
public:
    explicit MovementTable(MovementList* movements);

    /// Selects a row alone, whatever keys are held; rows chosen with it stay so.
    void standOn(int row);
    /// What stands in place of the rows while there are none, and what can be done about it.
    void setEmptyText(const QString& text, const QString& hint);
    /// The widths, for setColumns; anything else leaves the usual ones.
    QByteArray columns() const;
    void setColumns(const QByteArray& columns);

signals:
    /// So many rows went to the clipboard, at most those that a spreadsheet takes at once.
    void copied(int rows, bool all);

protected:
    void showEvent(QShowEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;

private:
    void showEmptyText();
    void copyRows();
    void giveFreeSpace(int kept, int mostTaken);

    MovementList* movements_;
    Notice* empty_;
    bool isFitting_ = false;
};

}  // namespace host
