// SPDX-License-Identifier: MIT
#pragma once

#include <QTableView>

#include "platform/ado/Recordset.h"

namespace forms {

/// One column of a grid.
struct GridColumn {
    QString field;
    QString heading;
    QString format;  ///< a display format of core/Format.h; empty for plain text
    int width = 12;  ///< in characters of the grid's font; the last column stretches
    bool rightAligned = false;
};

/// Rows of a row set as a read-only table, a row selected at a time, by mouse and keyboard, which
/// is the set's current row. Sets are taken into memory (Recordset::readAll). A set that is queried
/// again leaves the mark on the same line, or on the last one.
class DataGrid : public QTableView {
    Q_OBJECT
public:
    explicit DataGrid(const QString& name, QWidget* parent = nullptr);
    void setColumns(const std::vector<GridColumn>& columns);
    void setRecordset(const ado::RecordsetPtr& recordset);

signals:
    /// Enter, or a double click, also where no row is.
    void chosen();

protected:
    void currentChanged(const QModelIndex& current, const QModelIndex& previous) override;
    void keyPressEvent(QKeyEvent* event) override;
    void mouseDoubleClickEvent(QMouseEvent* event) override;

private:
    void mark(int row);

    class Rows;
    Rows* rows_;
    int marked_ = 0;  ///< the line with the mark
};

}  // namespace forms
