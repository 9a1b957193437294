// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <QDateTime>

#include "platform/core/Clock.h"
#include "platform/core/Failure.h"
#include "platform/core/Format.h"
#include "platform/core/Money.h"
#include "platform/core/Values.h"
#include "tests/forms/SampleBook.h"
#include "tests/forms/SampleScreen.h"
#include "tests/support/Operator.h"

using namespace Qt::StringLiterals;

namespace {

class Binding : public testing::Test {
protected:
    ~Binding() override { core::setToday({}); }
    void SetUp() override {
        core::setToday(QDate(2026, 3, 10));
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

TEST_F(Binding, WhatIsTypedIsShownInItsFormatAndKept) {
    const struct {
        QString field;
        QString typed;
        QString shown;
        QString column;
        QString stored;  ///< null for null
    } trials[] = {
        {u"Valor"_s, u"1234,5"_s, u"€ 1.234,50"_s, u"valor"_s, u"1234.5"_s},
        {u"Valor"_s, u"-5"_s, u"(€ 5,00)"_s, u"valor"_s, u"-5"_s},
        {u"Valor"_s, u"(€ 1.000,25)"_s, u"(€ 1.000,25)"_s, u"valor"_s, u"-1000.25"_s},
        {u"Valor"_s, u"1,23450"_s, u"€ 1,23"_s, u"valor"_s, u"1.2345"_s},
        {u"Valor"_s, u""_s, u""_s, u"valor"_s, {}},
        {u"Ordem"_s, u"-32.768"_s, u"-32768"_s, u"ordem"_s, u"-32768"_s},
        {u"Dia"_s, u"5/3/2026"_s, u"05-03-2026"_s, u"dia"_s, u"2026-03-05"_s},
        {u"Dia"_s, u"0503"_s, u"05-03-2026"_s, u"dia"_s, u"2026-03-05"_s},
        {u"Dia"_s, u""_s, u""_s, u"dia"_s, {}},
        {u"Numero"_s, u"A1"_s, u"A1"_s, u"numero"_s, u"A1"_s},
        {u"Numero"_s, u""_s, u""_s, u"numero"_s, u""_s},
        {u"Notas"_s, u"d'Água \"x\" 50%"_s, u"d'Água \"x\" 50%"_s, u"notas"_s,
         u"d'Água \"x\" 50%"_s},
        {u"Notas"_s, u"😀 €<b>"_s, u"😀 €<b>"_s, u"notas"_s, u"😀 €<b>"_s},
    };
    for (const auto& trial : trials) {
        SCOPED_TRACE(trial.field.toStdString() + " " + trial.typed.toStdString());
        person.fill(trial.field, trial.typed);
        EXPECT_EQ(person.find<forms::TextBox>(trial.field)->Text(), trial.shown);
        EXPECT_EQ(core::isNull(row(trial.column)), trial.stored.isNull());
        const QVariant kept = row(trial.column);
        const bool isDay = trial.field == u"Dia"_s && !trial.stored.isNull();
        EXPECT_EQ(isDay ? core::toDate(kept).toString(Qt::ISODate) : core::toText(kept),
                  trial.stored.isNull() ? QString() : trial.stored);
    }
}

TEST_F(Binding, AnAmountIsEditedAsAPlainNumberAndLookingAtItWritesNothing) {
    rows->setCollect(u"valor"_s, QVariant::fromValue(core::Money::fromUnits(873499)));
    EXPECT_EQ(screen.Valor.Text(), u"€ 87,35"_s);
    int writes = 0;
    QObject::connect(rows.get(), &ado::Recordset::fieldChanged, &screen, [&writes] { ++writes; });
    person.click(u"Valor"_s);
    EXPECT_EQ(screen.Valor.Text(), u"87,3499"_s);
    person.tab();
    EXPECT_EQ(writes, 0);
    person.put(u"Valor"_s, u"12"_s);
    person.press(Qt::Key_Period, Qt::KeypadModifier);
    person.type(u"5"_s);
    person.tab();
    EXPECT_EQ(rowText(u"valor"_s), "12.5");
}

TEST_F(Binding, DaysGoOnAndBackByTheArrowsFromToday) {
    for (const QString& field : {u"Dia"_s, u"Desde"_s}) {
        const auto* box = person.find<forms::TextBox>(field);
        person.put(field, {});
        QStringList days;
        for (const Qt::Key key : {Qt::Key_Down, Qt::Key_Down, Qt::Key_Up, Qt::Key_Up}) {
            person.press(key);
            days << box->Text();
        }
        EXPECT_EQ(days, u"10-03-2026 09-03-2026 10-03-2026 11-03-2026"_s.split(u' '));
        person.tab();
        EXPECT_EQ(box->Text(), u"11-03-2026"_s);
    }
    EXPECT_EQ(core::toDate(row(u"dia"_s)), QDate(2026, 3, 11));
}

TEST_F(Binding, BlanksAroundWhatWasPastedAreCut) {
    screen.Livre.setFormat(core::format::Number);
    QString validated;
    screen.Livre.onValidate = [&](bool&) { validated = screen.Livre.Text(); };
    const std::tuple<QString, QString, QString> pastes[] = {
        {u"Livre"_s, u"\t100015 "_s, u"100015"_s},
        {u"Valor"_s, u" \u00a087,35 "_s, u"€ 87,35"_s},
        {u"Dia"_s, u" 05-03-2026\n"_s, u"05-03-2026"_s},
    };
    for (const auto& [field, pasted, shown] : pastes) {
        person.put(field, {});
        person.paste(pasted);
        person.tab();
        EXPECT_EQ(person.find<forms::TextBox>(field)->Text(), shown);
    }
    EXPECT_EQ(validated, u"100015"_s);
}

TEST_F(Binding, WhatTheColumnDoesNotTakeIsRefusedAndNothingTypedIsLost) {
    const struct {
        QString field;
        QString typed;
        QString said;
    } trials[] = {
        {u"Valor"_s, u"abc"_s, u"«abc» não é um valor válido."_s},
        {u"Valor"_s, u"1,234.56"_s, u"«1,234.56» não é um valor válido."_s},
        {u"Valor"_s, u"%1'"_s, u"«%1'» não é um valor válido."_s},
        {u"Valor"_s, u"1,23456"_s, u"«1,23456» tem mais de quatro casas decimais."_s},
        {u"Valor"_s, u"9999999999999999"_s, u"«9999999999999999» é um valor demasiado grande."_s},
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
}

TEST_F(Binding, ValuesSetInTheRowAppearButOnlyAnotherRowTakesThePlaceOfTyping) {
    rows->setCollect(u"valor"_s, 7);
    EXPECT_EQ(screen.Valor.Text(), u"€ 7,00"_s);
    person.put(u"Valor"_s, u"88"_s);
    rows->setCollect(u"valor"_s, 9);
    EXPECT_EQ(screen.Valor.Text(), u"88"_s);
    person.tab();
    EXPECT_EQ(rowText(u"valor"_s), "88");
    person.put(u"Valor"_s, u"99"_s);
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

}  // namespace
