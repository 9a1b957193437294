// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <QAbstractItemView>
#include <QApplication>
#include <QCompleter>
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

TEST_F(Combo, ATypedPartIsTakenByTabTheLikeliestEntryFirst) {
    const struct {
        QString typed;
        QString shown;
        int stored;  ///< 0 for null
    } trials[] = {
        {u"02"_s, u"02 Análises clínicas"_s, 2},
        {u"lentes"_s, u"03 Óculos e lentes"_s, 3},
        {u"OCULOS"_s, u"03 Óculos e lentes"_s, 3},
        {u"07 proteses DENTÁRIAS"_s, u"07 Próteses dentárias"_s, 7},
        {u"0,8"_s, u"08 Internamento"_s, 8},  // the keypad's comma for a point
        {u"ternam"_s, u"08 Internamento"_s, 8},
        {u"0"_s, u"01 Consultas"_s, 1},
        // The word that begins so comes before an earlier entry that holds it inside a word.
        {u"l"_s, u"03 Óculos e lentes"_s, 3},
        {u""_s, u""_s, 0},
    };
    for (const auto& trial : trials) {
        person.fill(u"Rubrica"_s, trial.typed);
        EXPECT_EQ(screen.Rubrica.Text().toStdString(), trial.shown.toStdString());
        EXPECT_EQ(core::isNull(rubric()), trial.stored == 0);
        EXPECT_EQ(rubric().toInt(), trial.stored);
        EXPECT_EQ(screen.Rubrica.BoundText().toInt(), trial.stored);
    }
}

TEST_F(Combo, ATextThatFitsNothingStaysAndIsRefusedWithAWord) {
    person.fill(u"Rubrica"_s, u"02"_s);
    for (const QString& typed : {u"xyz'"_s, u"-"_s}) {
        person.put(u"Rubrica"_s, typed);
        for (const auto& leave : std::initializer_list<std::function<void()>>{
                 [&] { person.tab(); }, [&] { person.click(u"Livre"_s); },
                 [&] { screen.Livre.setFocus(), person.settle(); }}) {
            person.expectBox({.text = u"«%1» não consta da lista."_s.arg(typed),
                              .icon = core::Icon::Exclamation});
            leave();
            person.expectNoBoxesLeft();
            EXPECT_TRUE(screen.Rubrica.hasFocus());
            EXPECT_EQ(screen.Rubrica.Text(), typed);
            EXPECT_EQ(rubric().toInt(), 2);
        }
    }
    person.escape();  // giving up is never held
    EXPECT_EQ(screen.cancelled, 1);
}

TEST_F(Combo, TheListsAreWideEnoughForTheirTexts) {
    screen.Rubrica.setFixedWidth(60);
    const int widest = screen.fontMetrics().horizontalAdvance(u"02 Análises clínicas"_s);
    person.put(u"Rubrica"_s, u"ana"_s);
    EXPECT_GE(screen.Rubrica.completer()->popup()->viewport()->width(), widest);
    person.tab();
    static_cast<QComboBox&>(screen.Rubrica).showPopup();
    EXPECT_GE(screen.Rubrica.view()->viewport()->width(), widest);
    screen.Rubrica.hidePopup();
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
