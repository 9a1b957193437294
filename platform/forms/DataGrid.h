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

private:
    class Rows;
    Rows* rows_;
};

}  // namespace forms
