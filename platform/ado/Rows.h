// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/engine/RowStore.h"

namespace ado {

/// The rows of one query and a place among them. Few rows are taken in at once and the engine
/// is let go; of many the first are kept and the others come from the pass, so that memory does not
/// grow with the table.
class Rows {
public:
    /// @param all     takes in every row, however many
    /// @param isDear  the query is dear to run a second time, and gives few and narrow rows for
    /// what
    ///                it reads
    Rows(std::shared_ptr<Pass> pass, bool all, bool isDear = false);
    /// Rows that are in memory already; `description` tells their columns.
    Rows(std::shared_ptr<Pass> description, std::shared_ptr<RowStore> store);

    const Pass& columns() const { return *pass_; }

    bool toFirst();
    bool toNext();
    bool toLast();
    /// Number of rows; -1 as long as nobody has seen the last one.
    qint64 count() const { return count_; }
    /// Sees the last one; the place stays.
    void countAll();
    /// Place of the current row, from 0.
    qint64 row() const { return row_; }

    /// A value of the current row, good until the place changes.
    Cell cell(int column) {
        if (kept(row_)) return store_->cell(row_, column);
        if (passRow_ != row_) seek(row_);
        return pass_->cell(column);
    }
    /// What tells the current row from all others.
    RowIdentity identity();

    bool inMemory() const { return complete_; }
    /// Takes in all rows; the place stays.
    void takeAll();
    void toRow(qint64 row) { row_ = row; }
    RowIdentity identityAt(qint64 row) const { return store_->identity(row); }
    Cell cellAt(qint64 row, int column) const { return store_->cell(row, column); }

private:
    void take(qint64 most);
    bool kept(qint64 row) const { return row < store_->count(); }
    /// Makes the pass stand on a row behind the kept ones; false when there is no such row.
    bool seek(qint64 row);

    std::shared_ptr<Pass> pass_;
    std::shared_ptr<RowStore> store_;
    bool isDear_ = false;
    bool complete_ = false;  ///< all rows are in the store
    qint64 count_ = -1;
    qint64 row_ = 0;
    qint64 passRow_ = -1;  ///< the row that the pass stands on
};

}  // namespace ado
