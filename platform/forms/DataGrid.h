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

/// Rows of a row set as a read-only table, a row selected at a time, by mouse and keyboard. Sets
/// are taken into memory (Recordset::readAll).
class DataGrid : public QTableView {
    Q_OBJECT
public:
    explicit DataGrid(const QString& name, QWidget* parent = nullptr);
    void setColumns(const std::vector<GridColumn>& columns);
    void setRecordset(const ado::RecordsetPtr& recordset);
    /// Row under the cursor, -1 for none.
    int currentRow() const;
    /// A value of the row under the cursor; null when there is none.
    QVariant currentValue(const QString& field) const;

signals:
    /// Enter or a double click on a row. What is connected runs through forms::handle.
    void chosen();

protected:
    void keyPressEvent(QKeyEvent* event) override;

private:
    class Rows;
    Rows* rows_;
};

}  // namespace forms
