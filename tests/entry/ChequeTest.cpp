// SPDX-License-Identifier: MIT
// The cheque's number, asked for during a posting.
#include <QPushButton>

#include "tests/entry/EntryTest.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

using core::Icon;

class Cheque : public EntryTest {
protected:
    Cheque() {
        openNew();
        typeDocument(u"100"_s, u"0"_s, u"0"_s);
        person.fill(u"DataCombo3"_s, u"CHQ"_s);
    }

    /// Posts, and does the steps on the cheque screen.
    void post(const std::function<void()>& steps) {
        person.onScreen(u"frmPagamentoCheque"_s, steps);
        postAndLeave();
        EXPECT_FALSE(person.isShown(u"frmPagamentoCheque"_s));
    }

    QString number() { return person.find<forms::TextBox>(u"Text1"_s)->Text(); }
    QString next() { return book.text(u"select cheque_no from tbCheques"_s); }
    QString stored() { return book.text(u"select cheque from tbZelmar_Movimentos"_s); }
};

TEST_F(Cheque, EmptyTableOffers0AndStepsHaveNoEnd) {
    book.exec(u"delete from tbCheques"_s);
    post([this] {
        EXPECT_EQ(person.here()->windowTitle(), u"Pagamento por Cheque"_s);
        EXPECT_EQ(person.find<QGroupBox>(u"Frame1"_s)->title(), u"Número Cheque:"_s);
        EXPECT_EQ(person.find<QPushButton>(u"Command1"_s)->text(), u"&OK"_s);
        EXPECT_EQ(number(), u"0"_s);
        EXPECT_EQ(next(), u"0"_s);
        person.click(u"Command3"_s);
        EXPECT_EQ(number(), u"1"_s);
        person.click(u"Command2"_s);
        person.click(u"Command2"_s);
        EXPECT_EQ(number(), u"-1"_s);
        person.accelerator(u'O');
    });
    EXPECT_EQ(stored(), u"-1"_s);
    EXPECT_EQ(next(), u"0"_s);
}

TEST_F(Cheque, OvertypedNumberBelowTheFormerIsContinuedFrom) {
    book.exec(u"delete from tbCheques; insert into tbCheques (cheque_no) values (1000)"_s);
    post([this] {
        EXPECT_EQ(number(), u"1000"_s);
        person.fill(u"Text1"_s, u"500"_s);
        person.accelerator(u'O');
    });
    EXPECT_EQ(stored(), u"500"_s);
    EXPECT_EQ(next(), u"501"_s);
}

TEST_F(Cheque, WhatIsNoNumberIsSaidAndTheScreenStays) {
    book.exec(u"delete from tbCheques; insert into tbCheques (cheque_no) values (7)"_s);
    post([this] {
        for (const QString& typed : {u"abc"_s, QString(), u"1,5"_s, u"99999999999999999999"_s}) {
            SCOPED_TRACE(typed.toStdString());
            person.expectBox({.text = typed, .icon = Icon::Critical, .partly = true});
            person.put(u"Text1"_s, typed);
            person.accelerator(u'O');
            person.expectNoBoxesLeft();
            EXPECT_EQ(number(), typed);
            EXPECT_EQ(next(), u"7"_s);
        }
        person.expectBox({.icon = Icon::Critical, .partly = true});
        person.click(u"Command3"_s);
        person.put(u"Text1"_s, u"8"_s);
        person.enter();
    });
    EXPECT_EQ(stored(), u"8"_s);
    EXPECT_EQ(next(), u"9"_s);
}

TEST_F(Cheque, ClosedScreenLeavesThePostingWithoutANumber) {
    const QString before = next();
    post([this] { person.escape(); });
    EXPECT_EQ(stored(), u"NULL"_s);
    EXPECT_EQ(next(), before);
}

}  // namespace

}  // namespace entry
