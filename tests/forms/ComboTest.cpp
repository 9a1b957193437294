// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <QApplication>
#include <QWheelEvent>

#include "platform/core/Values.h"
#include "tests/forms/SampleBook.h"
#include "tests/forms/SampleScreen.h"
#include "tests/support/Operator.h"

using namespace Qt::StringLiterals;

namespace {

class Combo : public testing::Test {
protected:
    void SetUp() override {
        screen.Rubrica.setList(rubrics, u"descrit"_s, u"rubrica_id"_s);
        screen.take(rows);
        screen.Show();
        person.screen(u"frmRecibo"_s);
    }
    QVariant rubric() const { return rows->Collect(u"rubrica_id"_s); }
    void wheel() {
        QWheelEvent turn(QPointF(5, 5), screen.Rubrica.mapToGlobal(QPointF(5, 5)), {}, {0, -120},
                         Qt::NoButton, Qt::NoModifier, Qt::NoScrollPhase, false);
        QApplication::sendEvent(&screen.Rubrica, &turn);
    }

    SampleBook book;
    ado::RecordsetPtr rows = book.newRow();
    ado::RecordsetPtr rubrics = book.open(u"select * from rubrica"_s, ado::adLockReadOnly);
    Held<SampleScreen> held;
    SampleScreen& screen = *held;
    support::Operator person;
};

TEST_F(Combo, ATypedBeginningOrPartIsTakenByTabAndWhatFitsNothingIsNull) {
    const struct {
        QString typed;
        QString shown;
        int stored;  ///< 0 for null
    } trials[] = {
        {u"02"_s, u"02 Análises clínicas"_s, 2},
        {u"lentes"_s, u"03 Óculos e lentes"_s, 3},
        {u"07 próteses DENTÁRIAS"_s, u"07 Próteses dentárias"_s, 7},
        // An entry that begins so comes before an earlier one that only holds it.
        {u"0"_s, u"01 Consultas"_s, 1},
        {u""_s, u""_s, 0},
        {u"xyz'"_s, u""_s, 0},
        {u"s"_s, u""_s, 0},  // several hold it
    };
    for (const auto& trial : trials) {
        person.fill(u"Rubrica"_s, trial.typed);
        EXPECT_EQ(screen.Rubrica.Text().toStdString(), trial.shown.toStdString());
        EXPECT_EQ(core::isNull(rubric()), trial.stored == 0);
        EXPECT_EQ(rubric().toInt(), trial.stored);
        EXPECT_EQ(screen.Rubrica.BoundText().toInt(), trial.stored);
    }
}

TEST_F(Combo, AnAcceleratorTakesTheTypedEntryBeforeTheButtonIsPressed) {
    int seen = -1;
    screen.Command1.onClick = [&] { seen = rubric().toInt(); };
    person.put(u"Rubrica"_s, u"08"_s);
    person.accelerator(u'P');
    EXPECT_EQ(seen, 8);
}

TEST_F(Combo, TheWheelTurnsOnlyWhatHasTheFocus) {
    person.fill(u"Rubrica"_s, u"02"_s);
    wheel();
    EXPECT_EQ(rubric().toInt(), 2);
    person.click(u"Rubrica"_s);
    wheel();
    EXPECT_EQ(rubric().toInt(), 3);
}

}  // namespace
