// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <QApplication>
#include <QDateTime>

#include "platform/core/Failure.h"
#include "platform/core/Money.h"
#include "platform/core/Values.h"
#include "tests/forms/SampleBook.h"
#include "tests/forms/SampleScreen.h"
#include "tests/support/Operator.h"

using namespace Qt::StringLiterals;

namespace {

class Binding : public testing::Test {
protected:
    void SetUp() override {
        screen.take(rows);
        screen.Show();
        person.screen(u"frmRecibo"_s);
    }
    QVariant row(const QString& column) const { return rows->Collect(column); }
    std::string rowText(const QString& column) const {
        return core::toText(row(column)).toStdString();
    }

    SampleBook book;
    ado::RecordsetPtr rows = book.newRow();
    Held<SampleScreen> held;
    SampleScreen& screen = *held;
    support::Operator person;
};

TEST_F(Binding, AmountsShowTheFormatAndThePlainNumberWhileTheyAreEdited) {
    person.fill(u"Valor"_s, u"1234,5"_s);
    EXPECT_EQ(screen.Valor.Text(), u"€ 1.234,50"_s);
    EXPECT_EQ(row(u"valor"_s).value<core::Money>(), core::Money::fromDouble(1234.5));
    person.backtab();
    EXPECT_EQ(screen.Valor.Text(), u"1234,5"_s);
    person.fill(u"Valor"_s, u"-5"_s);
    EXPECT_EQ(screen.Valor.Text(), u"(€ 5,00)"_s);
    person.fill(u"Taxa"_s, u"5"_s);
    EXPECT_EQ(screen.Taxa.Text(), u"05,00"_s);
    // What is shown can be typed as well.
    person.fill(u"Valor"_s, u"(€ 1.000,25)"_s);
    EXPECT_EQ(rowText(u"valor"_s), "-1000.25");
}

TEST_F(Binding, LookingAtAFieldWritesNothing) {
    rows->setCollect(u"valor"_s, QVariant::fromValue(core::Money::fromUnits(873499)));
    EXPECT_EQ(screen.Valor.Text(), u"€ 87,35"_s);
    int writes = 0;
    QObject::connect(rows.get(), &ado::Recordset::fieldChanged, &screen, [&writes] { ++writes; });
    person.click(u"Valor"_s);
    EXPECT_EQ(screen.Valor.Text(), u"87,3499"_s);
    person.tab();
    person.tab();
    EXPECT_EQ(writes, 0);
}

TEST_F(Binding, AnEmptiedFieldIsNullWhereItsColumnIsNoText) {
    person.fill(u"Valor"_s, u"5"_s);
    person.fill(u"Valor"_s, u""_s);
    EXPECT_TRUE(core::isNull(row(u"valor"_s)));
    EXPECT_EQ(screen.Valor.Text(), QString());
    person.fill(u"Dia"_s, u"1-2-26"_s);
    person.fill(u"Dia"_s, u""_s);
    EXPECT_TRUE(core::isNull(row(u"dia"_s)));
    person.fill(u"Numero"_s, u"A1"_s);
    person.fill(u"Numero"_s, u""_s);
    EXPECT_FALSE(core::isNull(row(u"numero"_s)));
    EXPECT_EQ(rowText(u"numero"_s), "");
}

TEST_F(Binding, DatesAreShownWithFourDigitsOfTheYear) {
    person.fill(u"Dia"_s, u"5/3/2026"_s);
    EXPECT_EQ(screen.Dia.Text(), u"05-03-2026"_s);
    EXPECT_EQ(core::toDate(row(u"dia"_s)), QDate(2026, 3, 5));
}

TEST_F(Binding, WhatTheColumnDoesNotTakeIsRefusedAndNothingTypedIsLost) {
    const struct {
        QString field;
        QString typed;
        QString said;
    } trials[] = {
        {u"Valor"_s, u"abc"_s, u"«abc» não é um valor válido."_s},
        {u"Valor"_s, u"1,234.56"_s, u"«1,234.56» não é um valor válido."_s},
        {u"Valor"_s, u"1e400"_s, u"«1e400» não é um valor válido."_s},
        {u"Valor"_s, u"%1'"_s, u"«%1'» não é um valor válido."_s},
        {u"Valor"_s, u"1,23456"_s, u"«1,23456» tem mais de quatro casas decimais."_s},
        {u"Valor"_s, u"9999999999999999"_s, u"«9999999999999999» é um valor demasiado grande."_s},
        {u"Taxa"_s, QString(40, u'9'),
         u"«%1» é um valor demasiado grande."_s.arg(QString(40, u'9'))},
        {u"Ordem"_s, u"32768"_s, u"«32768» é um valor demasiado grande."_s},
        {u"Ordem"_s, u"1,5"_s, u"«1,5» não é um número inteiro."_s},
        {u"Dia"_s, u"29-02-2025"_s, u"«29-02-2025» não é uma data válida."_s},
        {u"Desde"_s, u"amanhã"_s, u"«amanhã» não é uma data válida."_s},
    };
    for (const auto& trial : trials) {
        person.expectBox({.text = trial.said, .icon = core::Icon::Exclamation});
        person.fill(trial.field, trial.typed);
        EXPECT_TRUE(person.find(trial.field)->hasFocus()) << trial.said.toStdString();
        EXPECT_EQ(person.find<forms::TextBox>(trial.field)->Text(), trial.typed);
        person.put(trial.field, u""_s);
    }
    EXPECT_TRUE(core::isNull(row(u"valor"_s)));
    EXPECT_TRUE(core::isNull(row(u"ordem"_s)));
}

TEST_F(Binding, FourDecimalsAndMinusNothingAreTaken) {
    person.fill(u"Valor"_s, u"1,23450"_s);
    EXPECT_EQ(rowText(u"valor"_s), "1.2345");
    person.fill(u"Valor"_s, u"-0"_s);
    EXPECT_EQ(rowText(u"valor"_s), "0");
    EXPECT_EQ(screen.Valor.Text(), u"€ 0,00"_s);
    person.fill(u"Ordem"_s, u"-32.768"_s);
    EXPECT_EQ(rowText(u"ordem"_s), "-32768");
}

TEST_F(Binding, AHandlerCanCutTypingToTheColumnElseTheColumnRefuses) {
    person.expectBox({.text = u""_s, .partly = true});
    person.fill(u"Numero"_s, u"12345678901"_s);
    EXPECT_TRUE(screen.Numero.hasFocus());
    screen.Numero.onGotFocus = [this] {
        screen.Numero.limitToColumn();
        screen.Numero.SelectAll();
    };
    person.put(u"Numero"_s, u"1"_s);
    person.tab();
    person.fill(u"Numero"_s, u"ABCDEFGHIJKLM"_s);
    EXPECT_EQ(rowText(u"numero"_s), "ABCDEFGHIJ");
}

TEST_F(Binding, QuotesSignsAndLongTextsAreOnlyText) {
    for (const QString& text :
         {u"d'Água \"x\" 50% ; drop table recibo"_s, u"😀 çãõ €"_s, u"<b>não</b> &amp;"_s}) {
        person.fill(u"Notas"_s, text);
        EXPECT_EQ(row(u"notas"_s).toString(), text);
        EXPECT_EQ(screen.Notas.Text(), text);
    }
    screen.Livre.setText(QString(10'000, u'x'));
    person.click(u"Livre"_s);
    person.tab();
    EXPECT_EQ(screen.Livre.Text().size(), 10'000);
    person.put(u"Notas"_s, u""_s);
    person.paste(QString(10'000, u'y'));
    person.expectBox({.text = u""_s, .partly = true});
    person.tab();
    EXPECT_EQ(screen.Notas.Text().size(), 10'000);
    screen.Livre.setText(u"a"_s + QChar(0) + u"b"_s);
    EXPECT_EQ(screen.Livre.Text().size(), 3);
}

TEST_F(Binding, CodeWritesAtOnceAndFailsOnWhatTheColumnDoesNotTake) {
    screen.Valor.setText(u"12,5"_s);
    EXPECT_EQ(rowText(u"valor"_s), "12.5");
    EXPECT_EQ(screen.Valor.Text(), u"€ 12,50"_s);
    screen.Mostra.setValue(5.86);
    EXPECT_EQ(row(u"fator"_s).toDouble(), 5.86);
    EXPECT_EQ(screen.Mostra.Text(), u"5,86"_s);
    try {
        screen.Valor.setText(u"doze"_s);
        ADD_FAILURE() << "taken";
    } catch (const core::Failure& failure) {
        EXPECT_EQ(failure.number(), core::TypeMismatch);
    }
    EXPECT_EQ(rowText(u"valor"_s), "12.5");
    screen.Valor.Clear();
    EXPECT_TRUE(core::isNull(row(u"valor"_s)));
}

TEST_F(Binding, ValuesSetInTheRowAppearButNotOverWhatIsBeingTyped) {
    rows->setCollect(u"valor"_s, 7);
    EXPECT_EQ(screen.Valor.Text(), u"€ 7,00"_s);
    person.put(u"Valor"_s, u"88"_s);
    rows->setCollect(u"valor"_s, 9);
    EXPECT_EQ(screen.Valor.Text(), u"88"_s);
    person.tab();
    EXPECT_EQ(rowText(u"valor"_s), "88");
}

TEST_F(Binding, AnotherRowTakesThePlaceOfWhatWasTypedForTheFormerOne) {
    person.put(u"Valor"_s, u"88"_s);
    rows->AddNew();
    EXPECT_EQ(screen.Valor.Text(), QString());
    person.tab();
    EXPECT_TRUE(core::isNull(row(u"valor"_s)));
}

TEST_F(Binding, AValidationSeesTheTextAndTheRowGetsItAfterwards) {
    QString inTheRow = u"?"_s;
    screen.Valor.onValidate = [this, &inTheRow](bool&) {
        inTheRow = core::toText(row(u"valor"_s));
        EXPECT_EQ(screen.Valor.Text(), u"123"_s);
        screen.Mostra.setValue(5.86);
    };
    person.fill(u"Valor"_s, u"123"_s);
    EXPECT_EQ(inTheRow, QString());
    EXPECT_EQ(rowText(u"valor"_s), "123");
    EXPECT_EQ(screen.Mostra.Text(), u"5,86"_s);
}

TEST_F(Binding, AChangeInARowThatCannotBeWrittenGoesNowhere) {
    book.exec(u"insert into recibo (recibo_id, valor, rubrica_id) values (5, 10, 2)"_s);
    screen.take(book.open(u"select * from recibo"_s, ado::adLockReadOnly));
    EXPECT_EQ(screen.Valor.Text(), u"€ 10,00"_s);
    person.fill(u"Valor"_s, u"99"_s);
    EXPECT_FALSE(screen.Valor.hasFocus());
    EXPECT_EQ(screen.Valor.Text(), u"€ 10,00"_s);
}

TEST_F(Binding, LockedFieldsTakeNoKeysAndDisplayOnlyOnesNoTab) {
    screen.Valor.setLocked(true);
    screen.Valor.setText(u"5"_s);
    person.click(u"Valor"_s);
    person.type(u"9"_s);
    person.tab();
    EXPECT_EQ(rowText(u"valor"_s), "5");
    person.click(u"Notas"_s);
    person.tab();
    EXPECT_FALSE(screen.Mostra.hasFocus());
    EXPECT_EQ(screen.Mostra.backColor(), forms::BackColor::Menu);
}

TEST_F(Binding, TheDecimalKeyOfTheNumericPadTypesTheMark) {
    person.put(u"Valor"_s, u"12"_s);
    person.press(Qt::Key_Period, Qt::KeypadModifier);
    person.type(u"5"_s);
    person.tab();
    EXPECT_EQ(rowText(u"valor"_s), "12.5");
}

TEST_F(Binding, ADateFieldCanBeEmptied) {
    screen.Desde.setValue(core::fromDate({2026, 3, 5}));
    EXPECT_EQ(screen.Desde.Text(), u"05-03-2026"_s);
    person.fill(u"Desde"_s, u"1.4.26"_s);
    EXPECT_EQ(core::toDate(screen.Desde.Value()), QDate(2026, 4, 1));
    EXPECT_EQ(screen.Desde.Text(), u"01-04-2026"_s);
    person.fill(u"Desde"_s, u""_s);
    EXPECT_TRUE(core::isNull(screen.Desde.Value()));
}

TEST_F(Binding, ADayIsPickedFromTheCalendarByKey) {
    screen.Desde.setValue(core::fromDate({2026, 3, 5}));
    person.click(u"Desde"_s);
    person.press(Qt::Key_Down, Qt::AltModifier);
    ASSERT_TRUE(QApplication::activePopupWidget());
    person.press(Qt::Key_Right);
    person.press(Qt::Key_Return);
    EXPECT_FALSE(QApplication::activePopupWidget());
    EXPECT_EQ(screen.Desde.Text(), u"06-03-2026"_s);
    EXPECT_EQ(screen.finished, 0);
    screen.Desde.setLocked(true);
    person.press(Qt::Key_Down, Qt::AltModifier);
    EXPECT_FALSE(QApplication::activePopupWidget());
}

}  // namespace
