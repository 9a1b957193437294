// SPDX-License-Identifier: MIT
// Rows in memory and in a file.
#include "platform/ado/engine/RowStore.h"

#include <gtest/gtest.h>

#include "platform/ado/engine/RowFile.h"

namespace {

/// A text of its own for each row; some are longer than what is read from a file at once.
std::string textOf(qint64 row) {
    return std::string(row % 100 == 7 ? 150'000 : row % 13, 'x') + std::to_string(row);
}

TEST(RowStore, GivesTheSameRowsFromAFile) {
    const auto file = std::make_shared<ado::RowFile>();
    ado::RowStore stores[2];  // share the file
    constexpr qint64 Rows = 5'000;
    for (qint64 row = 0; row < Rows; ++row) {
        const std::string text = textOf(row);
        for (ado::RowStore& store : stores) {
            store.beginRow(row);
            store.add({ado::Cell::Integer, row, 0, {}});
            store.add({});
            store.add({ado::Cell::Text, 0, 0, text});
            if (row % 1'700 == 1'699) {
                store.setAside(file);
                EXPECT_EQ(store.packedBytes(), 0u);
            }
        }
    }
    for (ado::RowStore& store : stores) {
        ASSERT_EQ(store.count(), Rows);
        EXPECT_GT(store.packedBytes(), 0u);  // the last rows are in memory
        // Forwards, backwards, and to and fro.
        for (const qint64 step : {qint64{1}, Rows - 1, qint64{2'503}})
            for (qint64 at = 0, row = 0; at < Rows; ++at, row = (row + step) % Rows) {
                ASSERT_EQ(store.cell(row, 0).integer, row);
                ASSERT_EQ(store.cell(row, 1).kind, ado::Cell::Null);
                ASSERT_EQ(store.cell(row, 2).text, textOf(row));
                ASSERT_EQ(store.identity(row), row);
            }
    }
}

}  // namespace
