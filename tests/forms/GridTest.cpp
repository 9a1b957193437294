// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <QVBoxLayout>

#include "platform/core/Format.h"
#include "platform/core/Values.h"
#include "platform/forms/DataGrid.h"
#include "tests/forms/SampleBook.h"
#include "tests/forms/SampleScreen.h"
#include "tests/support/Operator.h"

using namespace Qt::StringLiterals;

namespace {

class Grid : public testing::Test {
protected:
    Grid() {
        book.exec(
            u"insert into recibo (recibo_id, numero, valor, dia) values"
            "(1, 'A', 1234.5, '2026-03-05 00:00:00'), (2, 'B', -5, null), (3, null, null, null)"_s);
        rows->Requery();
        (new QVBoxLayout(&form))->addWidget(&grid);
        grid.setColumns(
            {{.field = u"numero"_s, .heading = {}, .format = {}},
             {.field = u"valor"_s, .heading = {}, .format = core::format::Money.toString()},
             {.field = u"DIA"_s, .heading = {}, .format = {}},
             {.field = u"nada"_s, .heading = {}, .format = {}}});
        grid.setRecordset(rows);
        form.Show();
        person.screen(u"frmGrelha"_s);
    }
    QString cell(int row, int column) const {
        return grid.model()->index(row, column).data().toString();
    }

    SampleBook book;
    ado::RecordsetPtr rows = book.open(u"select * from recibo"_s);
    Held<forms::Form> held{u"frmGrelha"_s, u"Recibos"_s};
    forms::Form& form = *held;
    forms::DataGrid& grid = *new forms::DataGrid(u"DataGrid1"_s);
    support::Operator person;
};

TEST_F(Grid, ShowsTheRowsInTheirFormats) {
    ASSERT_EQ(grid.model()->rowCount(), 3);
    EXPECT_EQ(cell(0, 1), u"€ 1.234,50"_s);
    EXPECT_EQ(cell(1, 1), u"(€ 5,00)"_s);
    EXPECT_EQ(cell(2, 1), QString());
    EXPECT_EQ(cell(0, 2), u"05-03-2026"_s);
}

TEST_F(Grid, KeysMoveEnterChoosesAndTheGridFollowsTheSet) {
    int chosen = 0;
    QObject::connect(&grid, &forms::DataGrid::chosen, &form, [&chosen] { ++chosen; });
    person.find(u"DataGrid1"_s)->setFocus();
    EXPECT_EQ(grid.currentRow(), 0);
    person.press(Qt::Key_Down);
    person.enter();
    EXPECT_EQ(chosen, 1);
    EXPECT_EQ(grid.currentValue(u"Numero"_s).toString(), u"B"_s);
    book.exec(u"delete from recibo where recibo_id < 3"_s);
    rows->Requery();
    EXPECT_EQ(grid.model()->rowCount(), 1);
    rows->Close();
    EXPECT_EQ(grid.model()->rowCount(), 0);
    EXPECT_TRUE(core::isNull(grid.currentValue(u"numero"_s)));
}

}  // namespace
