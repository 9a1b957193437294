// SPDX-License-Identifier: MIT
#pragma once

#include <QStringList>
#include <QTableView>
#include <vector>

namespace host {

/// A table of texts that only shows, however many rows there are.
class TextTable : public QTableView {
public:
    struct Column {
        QString title;
        int width;              ///< in digits of the table's font
        bool isNumber = false;  ///< aligned right
    };
    /// The last column takes what is left of the width.
    TextTable(const QString& name, const std::vector<Column>& columns);

    /// Each row has a text for each column.
    void setRows(std::vector<QStringList> rows);

    /// A few rows: the table takes the room that its screen has left.
    QSize sizeHint() const override;

private:
    class Rows;
    Rows* rows_;
};

}  // namespace host
