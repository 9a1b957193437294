// SPDX-License-Identifier: MIT
// What nobody should type. A lookup may fail with its text; the row, the screen and the book stay.
#include "tests/entry/EntryTest.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

using core::Icon;
using support::Operator;

const QString Nonsense[] = {
    u"O'Neil'; delete from tbSocios; --"_s, u"%"_s, QString(10000, u'x'),
    u"a"_s + QChar(u'\0') + u"b"_s,         u"😀"_s,
};

class BadInput : public EntryTest {
protected:
    BadInput() {
        openNew(true);
        typeMember();
        choosePerson(self);
        person.fill(u"Text6"_s, u"87,35"_s);
        before_ = everything();
    }

    /// Puts each of the texts into a field and leaves it; `box` comes each time when it is given.
    /// A field that keeps texts refuses only the one that no book stores.
    void tryAll(const QString& name, const std::optional<Operator::Box>& box = {},
                bool keepsText = false) {
        for (const QString& text : Nonsense) {
            SCOPED_TRACE((name + u": "_s + text.left(20)).toStdString());
            person.put(name, QString());
            person.paste(text);
            if (box) person.expectBox(*box);
            if (keepsText && text.contains(QChar(u'\0')))
                person.expectBox({.text = u"carácter nulo"_s, .partly = true});
            person.tab();
            person.expectNoBoxesLeft();
            EXPECT_TRUE(form().isVisible());
            EXPECT_EQ(form().Text6->Text().contains(u"87,35"_s), name != u"Text6"_s);
        }
        EXPECT_EQ(everything(), before_);
    }

    QString before_;
};

TEST_F(BadInput, NumberOfTheMemberFailsItsLookupAndNothingElse) {
    const Operator::Box unknown{.text = u"Número de Empresa não encontrado!"_s};
    const Operator::Box failed{.icon = Icon::Critical, .partly = true};
    for (const QString& text : Nonsense) {
        const bool breaks = text.contains(u'\'') || text.contains(QChar(u'\0'));
        person.put(u"No_Kor"_s, QString());
        person.paste(text);
        person.expectBox(breaks ? failed : unknown);
        person.tab();
        person.expectNoBoxesLeft();
        EXPECT_TRUE(form().No_Kor->hasFocus());
        EXPECT_EQ(form().Socio_ID, socio);
    }
    EXPECT_EQ(everything(), before_);
}

TEST_F(BadInput, QuotesThatMakeAnotherStatementAreRefused) {
    const QString wicked[] = {u"x' or '1'='1"_s, u"x' union select * from tbSocios --"_s,
                              u"x'; update tbSocios set zelmar = 0; --"_s};
    // The first chooses the first member of the table, and that is all that it can do.
    person.expectBox({.text = u"Quer ver o extrato"_s, .answer = core::Answer::No, .partly = true});
    person.fill(u"No_Kor"_s, wicked[0]);
    for (const QString& text : {wicked[1], wicked[2]}) {
        person.put(u"No_Kor"_s, text);
        if (text == wicked[2])
            person.expectBox({.icon = Icon::Critical, .partly = true});
        else
            person.expectBox(
                {.text = u"Quer ver o extrato"_s, .answer = core::Answer::No, .partly = true});
        person.tab();
    }
    EXPECT_EQ(everything(), before_);
}

TEST_F(BadInput, FieldsTakeOrRefuseIt) {
    const Operator::Box notAValue{
        .text = u"não é um valor válido."_s, .icon = Icon::Exclamation, .partly = true};
    tryAll(u"Text5"_s, {}, true);
    EXPECT_EQ(pending(u"doc_no"_s).toString(), u"😀"_s);
    tryAll(u"Text12"_s, {}, true);
    EXPECT_EQ(pending(u"obs"_s).toString(), u"😀"_s);
    tryAll(u"Text9"_s, notAValue);
    person.fill(u"Text9"_s, u"10"_s);
    tryAll(u"Text11"_s, Operator::Box{.text = u"O valor que digitou não é um número válido."_s});
    person.fill(u"Text11"_s, u"0"_s);
    tryAll(u"Text6"_s, notAValue);
    person.fill(u"Text6"_s, u"87,35"_s);
    tryAll(u"Text1"_s);
    EXPECT_TRUE(form().Text1->hasFocus());
    EXPECT_FALSE(pending(u"doc_data"_s).isValid());
}

TEST_F(BadInput, ListsTakeNoChoiceFromIt) {
    for (const QString& name : {u"DataCombo2"_s, u"DataCombo3"_s, u"DataCombo4"_s, u"DataCombo1"_s})
        tryAll(name);
    EXPECT_FALSE(pending(u"rubrica_id"_s).isValid());
    person.fill(u"Text9"_s, u"10"_s);
    person.expectBox({.text = u"Tem de Indicar uma rubrica!"_s});
    person.accelerator(u'E');
    EXPECT_TRUE(form().isVisible());
    EXPECT_EQ(everything(), before_);
}

TEST_F(BadInput, WhatATextFieldTookIsStoredAsItIs) {
    const QString wild = u"O'Neil \"%\" 😀 "_s + QString(3000, u'ã');
    typeHospitalBill(u"100"_s, u"100"_s);
    person.fill(u"Text5"_s, u"n.º '1' 😀"_s);
    person.put(u"Text12"_s, QString());
    person.paste(wild);
    person.fill(u"DataCombo3"_s, u"TRF"_s);
    postAndLeave();
    EXPECT_EQ(book.value(u"select obs from tbZelmar_Movimentos"_s).toString(), wild);
    EXPECT_EQ(book.value(u"select doc_no from tbZelmar_Movimentos"_s).toString(), u"n.º '1' 😀"_s);
}

TEST_F(BadInput, AmountsTooLargeForTheCalculationAreSaid) {
    person.fill(u"DataCombo1"_s, u"0101"_s);
    person.fill(u"Text9"_s, u"900000000000000"_s);
    const QString before = everything();
    person.expectBox({.icon = Icon::Critical, .partly = true});
    book.exec(u"update tbZelmar_Plafonds set percent = 1e30 where rubrica_id = %1"_s.arg(rubric));
    person.accelerator(u'E');
    person.expectNoBoxesLeft();
    book.exec(u"update tbZelmar_Plafonds set percent = 0.75 where rubrica_id = %1"_s.arg(rubric));
    EXPECT_EQ(everything(), before);
    person.fill(u"Text9"_s, u"100"_s);
    person.accelerator(u'E');
    EXPECT_EQ(form().Credito->Text(), u"€ 75,00"_s);
}

}  // namespace

}  // namespace entry
