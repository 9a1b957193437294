// SPDX-License-Identifier: MIT
#pragma once

#include <QObject>
#include <functional>

class QModelIndex;
class QTableView;

namespace forms {

/// Ctrl+C and the menu of a table: the chosen rows go to the clipboard, from top to bottom, a line
/// each, their columns parted by tabs, as spreadsheets take them. Where several rows can be chosen,
/// Ctrl+A chooses all.
class TableCopy : public QObject {
    Q_OBJECT
public:
    explicit TableCopy(QTableView& table);

    /// What is copied of a cell, where that is not what its model says it shows.
    std::function<QString(const QModelIndex& cell)> textOf;

signals:
    /// So many rows went to the clipboard, at most those that a spreadsheet takes at once.
    void copied(int rows, bool all);

private:
    void copyRows();

    QTableView& table_;
};

}  // namespace forms
