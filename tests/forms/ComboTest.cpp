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
        screen.Modo.setList(book.open(u"select * from codigo"_s, ado::adLockReadOnly),
                            u"completo"_s, u"code"_s);
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

TEST_F(Combo, AHandlerOnLosingTheFocusSeesTheChoiceWrittenAndHasTheLastWord) {
    QStringList texts;
    screen.Rubrica.onGotFocus = [&] { texts << screen.Rubrica.Text(); };
    screen.Rubrica.onLostFocus = [&] {
        texts << core::toText(rubric());
        if (screen.Rubrica.Text().isEmpty()) rows->setCollect(u"rubrica_id"_s, 0);
    };
    person.fill(u"Rubrica"_s, u"03"_s);
    EXPECT_EQ(texts, (QStringList{u""_s, u"3"_s}));
    person.fill(u"Rubrica"_s, u""_s);
    EXPECT_FALSE(core::isNull(rubric()));
    EXPECT_EQ(screen.Rubrica.Text(), QString());
}

TEST_F(Combo, AnAcceleratorTakesTheTypedEntryBeforeTheButtonIsPressed) {
    int seen = -1;
    screen.Command1.onClick = [&] { seen = rubric().toInt(); };
    person.put(u"Rubrica"_s, u"08"_s);
    person.accelerator(u'P');
    EXPECT_EQ(seen, 8);
}

TEST_F(Combo, TheListOpensByKeyAndArrowsChoose) {
    person.click(u"Rubrica"_s);
    person.press(Qt::Key_Down, Qt::AltModifier);
    ASSERT_TRUE(QApplication::activePopupWidget());
    person.press(Qt::Key_Down);
    person.press(Qt::Key_Down);
    person.press(Qt::Key_Return);
    EXPECT_FALSE(QApplication::activePopupWidget());
    EXPECT_GT(rubric().toInt(), 0);
    EXPECT_EQ(rubric(), screen.Rubrica.BoundText());
    EXPECT_EQ(screen.finished, 0);
}

TEST_F(Combo, CodeChoosesByTheStoredValueAlsoOneThatIsNotInTheList) {
    screen.Modo.setBoundText(u"CHQ"_s);
    EXPECT_EQ(screen.Modo.Text(), u"CHQ Cheque"_s);
    EXPECT_EQ(rows->Collect(u"modo"_s).toString(), u"CHQ"_s);
    screen.Modo.setBoundText(u"XXX"_s);
    EXPECT_EQ(screen.Modo.Text(), QString());
    EXPECT_TRUE(core::isNull(screen.Modo.BoundText()));
    EXPECT_EQ(rows->Collect(u"modo"_s).toString(), u"XXX"_s);
    rows->setCollect(u"modo"_s, u"TRF"_s);
    EXPECT_EQ(screen.Modo.Text(), u"TRF Transferência bancária"_s);
}

TEST_F(Combo, AListOpenedAgainKeepsTheChoiceAndWhatIsBeingTyped) {
    person.fill(u"Rubrica"_s, u"07"_s);
    book.exec(
        u"update rubrica set descrit = '07 Estomatologia' where rubrica_id = 7;"
        "insert into rubrica values (9, '09 Fisioterapia')"_s);
    rubrics->Requery();
    EXPECT_EQ(screen.Rubrica.Text(), u"07 Estomatologia"_s);
    EXPECT_EQ(rubric().toInt(), 7);
    person.put(u"Rubrica"_s, u"09"_s);
    rubrics->Requery();
    person.tab();
    EXPECT_EQ(rubric().toInt(), 9);
    book.exec(u"delete from rubrica where rubrica_id = 9"_s);
    rubrics->Requery();
    EXPECT_EQ(screen.Rubrica.Text(), QString());
    EXPECT_EQ(rubric().toInt(), 9);
}

TEST_F(Combo, TheWheelTurnsOnlyWhatHasTheFocusAndNothingThatIsLocked) {
    person.fill(u"Rubrica"_s, u"02"_s);
    wheel();
    EXPECT_EQ(rubric().toInt(), 2);
    person.click(u"Rubrica"_s);
    wheel();
    EXPECT_EQ(rubric().toInt(), 3);
    screen.Rubrica.setLocked(true);
    wheel();
    person.press(Qt::Key_Down);
    person.press(Qt::Key_Down, Qt::AltModifier);
    EXPECT_FALSE(QApplication::activePopupWidget());
    person.type(u"x"_s);
    person.tab();
    EXPECT_EQ(rubric().toInt(), 3);
}

}  // namespace
