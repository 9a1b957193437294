// SPDX-License-Identifier: MIT
// The document's fields: what each refuses, and what it writes to the row.
#include "platform/core/Money.h"
#include "tests/entry/EntryTest.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

using core::Icon;

class DocumentFields : public EntryTest {
protected:
    DocumentFields() {
        openNew();
        typeMember();
    }

    double amount(const QString& column) const {
        return pending(column).value<core::Money>().toDouble();
    }

    void expectHeldIn(const forms::TextBox* box) {
        EXPECT_TRUE(box->hasFocus()) << box->objectName().toStdString();
    }
};

TEST_F(DocumentFields, VatIsWhatTheValueContainsToTheCentHalvesToEven) {
    struct {
        QString value, rate, vat;
    } const rows[] = {
        {u"123,00"_s, u"5"_s, u"5,86"_s},
        {u"87,35"_s, u"23"_s, u"16,33"_s},
        {u"100"_s, u"100"_s, u"50,00"_s},
        {u"0,25"_s, u"100"_s, u"0,12"_s},  // 12,5 cents
        {u"0,75"_s, u"100"_s, u"0,38"_s},  // 37,5 cents
        {u"1.234,56"_s, u"6"_s, u"69,88"_s},
        // The value is taken in single precision, as 16 777 216.
        {u"16777217"_s, u"100"_s, u"8.388.608,00"_s},
        {u"-50"_s, u"100"_s, u"-25,00"_s},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.value.toStdString());
        person.fill(u"Text11"_s, u"0"_s);
        EXPECT_EQ(form().Text10->Text(), u"0,00"_s);
        person.fill(u"Text6"_s, row.value);
        EXPECT_EQ(form().Text10->Text(), u"0,00"_s) << "a rate of 0 leaves the tax";
        person.fill(u"Text11"_s, row.rate);
        EXPECT_EQ(form().Text10->Text(), row.vat);
    }
    EXPECT_DOUBLE_EQ(amount(u"doc_iva"_s), -25);
    person.fill(u"Text6"_s, u"200"_s);
    EXPECT_EQ(form().Text10->Text(), u"100,00"_s) << "a new value works it out again";
}

TEST_F(DocumentFields, EmptiedAmountsAreNullAndKeepTheOldVat) {
    person.fill(u"Text11"_s, u"5"_s);
    person.fill(u"Text6"_s, u"123"_s);
    person.fill(u"Text9"_s, u"10,5"_s);
    EXPECT_EQ(form().Text6->Text(), u"€ 123,00"_s);
    EXPECT_DOUBLE_EQ(amount(u"recebido"_s), 10.5);
    person.fill(u"Text6"_s, QString());
    person.fill(u"Text9"_s, QString());
    EXPECT_FALSE(pending(u"doc_valor"_s).isValid());
    EXPECT_FALSE(pending(u"recebido"_s).isValid());
    EXPECT_EQ(form().Text10->Text(), u"5,86"_s);
}

TEST_F(DocumentFields, RateIsANumberFrom0To100) {
    const QString notANumber = u"O valor que digitou não é um número válido."_s;
    const QString outside = u"O valor de IVA tem de ser entre 0 e 100."_s;
    const std::pair<QString, QString> refused[] = {
        {u"abc"_s, notANumber},   {QString(), notANumber}, {u"1e1"_s, notANumber},
        {u"5,5,5"_s, notANumber}, {u"-0,01"_s, outside},   {u"100,01"_s, outside},
    };
    person.fill(u"Text6"_s, u"100"_s);
    for (const auto& [rate, text] : refused) {
        SCOPED_TRACE(rate.toStdString());
        person.expectBox({.text = text, .icon = Icon::Information, .title = u"Zelmars"_s});
        person.fill(u"Text11"_s, rate);
        person.expectNoBoxesLeft();
        expectHeldIn(form().Text11);
        EXPECT_DOUBLE_EQ(pending(u"doc_tx_iva"_s).toDouble(), 0);
    }
    // The refusal also holds what a click or an accelerator would do.
    person.expectBox({.text = outside});
    person.accelerator(u'E');
    expectHeldIn(form().Text11);
    EXPECT_EQ(companions.calls, QStringList());
    for (const QString& rate : {u"100"_s, u"-0"_s, u"6,5"_s}) {
        person.fill(u"Text11"_s, rate);
        EXPECT_FALSE(form().Text11->hasFocus());
    }
    EXPECT_DOUBLE_EQ(pending(u"doc_tx_iva"_s).toDouble(), 6.5);
    EXPECT_EQ(form().Text11->Text(), u"06,50"_s);
}

TEST_F(DocumentFields, DateIsRefusedWithoutAWordAndMayStayEmpty) {
    for (const QString& date : {u"31-02-2026"_s, u"ontem"_s, u"10-03"_s, u"0-3-2026"_s}) {
        person.fill(u"Text1"_s, date);
        expectHeldIn(form().Text1);
        EXPECT_EQ(form().Text1->Text(), date);
        EXPECT_FALSE(pending(u"doc_data"_s).isValid());
    }
    person.fill(u"Text1"_s, QString());
    EXPECT_FALSE(form().Text1->hasFocus());
    for (const QString& date : {u"10-03-2026"_s, u"10/3/26"_s, u"10032026"_s}) {
        person.fill(u"Text1"_s, date);
        EXPECT_EQ(form().Text1->Text(), u"10-03-2026"_s);
        EXPECT_EQ(pending(u"doc_data"_s).toDate(), QDate(2026, 3, 10));
    }
}

TEST_F(DocumentFields, NumberOfTheDocumentIsAsLongAsItsColumn) {
    person.put(u"Text5"_s, u"12345678901234567890ABC"_s);
    EXPECT_EQ(form().Text5->Text(), u"12345678901234567890"_s);
    person.tab();
    EXPECT_EQ(pending(u"doc_no"_s).toString(), u"12345678901234567890"_s);
}

TEST_F(DocumentFields, EnteringSelectsAllInNumberValueAndReceived) {
    for (const QString& name : {u"Text5"_s, u"Text6"_s, u"Text9"_s}) {
        person.fill(name, u"71"_s);
        person.click(u"Text1"_s);
        person.click(name);
        EXPECT_EQ(person.find<forms::TextBox>(name)->selectedText(), u"71"_s);
    }
}

TEST_F(DocumentFields, RefusedAmountsHoldTheFocusAndLeaveTheRow) {
    const std::pair<QString, QString> refused[] = {
        {u"abc"_s, u"«abc» não é um valor válido."_s},
        {u"1e400"_s, u"«1e400» não é um valor válido."_s},
        {u"1,234.56"_s, u"«1,234.56» não é um valor válido."_s},
        {u"12.34"_s, u"«12.34» não é um valor válido."_s},
        {u"1,23456"_s, u"«1,23456» tem mais de quatro casas decimais."_s},
        {u"99999999999999999999"_s, u"«99999999999999999999» é um valor demasiado grande."_s},
    };
    for (const QString& name : {u"Text6"_s, u"Text9"_s}) {
        const QString column = name == u"Text6"_s ? u"doc_valor"_s : u"recebido"_s;
        person.fill(name, u"5,4321"_s);
        for (const auto& [typed, text] : refused) {
            SCOPED_TRACE(typed.toStdString());
            person.expectBox({.text = text, .icon = Icon::Exclamation});
            person.fill(name, typed);
            person.expectNoBoxesLeft();
            expectHeldIn(person.find<forms::TextBox>(name));
            EXPECT_DOUBLE_EQ(amount(column), 5.4321);
        }
        person.fill(name, u"-0"_s);
        EXPECT_DOUBLE_EQ(amount(column), 0);
    }
    // Tax of more than 2^31 cents.
    person.fill(u"Text6"_s, u"999999999"_s);
    person.fill(u"Text11"_s, u"23"_s);
    EXPECT_EQ(form().Text10->Text(), u"0,00"_s) << "passed over: the tax stays";
    person.expectBox({.icon = Icon::Critical, .partly = true});
    person.fill(u"Text6"_s, u"999999998"_s);
    expectHeldIn(form().Text6);
    EXPECT_DOUBLE_EQ(amount(u"doc_valor"_s), 999999999);
}

TEST_F(DocumentFields, ListsWriteTheirChoiceAndAWipedOneIsHeldAs0) {
    form().Unload();
    person.settle();
    openNew(true);
    typeMember();
    const std::tuple<QString, QString, qint64> lists[] = {
        {u"DataCombo1"_s, u"rubrica_id"_s, rubric},
        {u"DataCombo2"_s, u"hospital_id"_s, hospital},
    };
    for (const auto& [name, column, key] : lists) {
        SCOPED_TRACE(name.toStdString());
        person.fill(name, u"0"_s);  // every entry holds one; the first is taken
        EXPECT_EQ(pending(column).toLongLong(), key);
        person.click(name);
        person.tab();
        EXPECT_EQ(pending(column).toLongLong(), key) << "looked at, not changed";
        person.fill(name, QString());
        EXPECT_EQ(pending(column), QVariant(0));
        person.fill(name, u"nada disto"_s);
        EXPECT_FALSE(pending(column).isValid());
    }
    person.fill(u"DataCombo4"_s, u"ADSE"_s);
    EXPECT_EQ(pending(u"oe_id"_s).toInt(), 1);
    person.fill(u"DataCombo3"_s, u"NUM"_s);
    EXPECT_EQ(pending(u"modo_pagamento"_s).toString(), u"NUM"_s);
}

TEST_F(DocumentFields, HospitalBillTypesTheIncidenceAndNothingReceived) {
    form().Unload();
    person.settle();
    openNew(true);
    typeMember();
    person.fill(u"Text9"_s, u"1.000,25"_s);
    EXPECT_DOUBLE_EQ(amount(u"incidencia"_s), 1000.25);
    EXPECT_FALSE(pending(u"recebido"_s).isValid());
    person.fill(u"Text9"_s, QString());
    EXPECT_FALSE(pending(u"incidencia"_s).isValid());
}

}  // namespace

}  // namespace entry
