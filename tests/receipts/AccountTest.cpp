// SPDX-License-Identifier: MIT
#include "tests/receipts/AccountTest.h"

#include "entry/frmMovimentos.h"
#include "platform/com/Component.h"
#include "receipts/frmRecebimento.h"
#include "receipts/frmReposicao.h"

using namespace Qt::StringLiterals;

AccountTest::AccountTest() {
    FakeSearch::member = FakeSearch::person = 0;
    FakeSearch::failure.clear();
    for (const QString& name : {u"Lumbra.General"_s, u"Tiqueta.General"_s})
        com::registerRunning(name, [] { return new FakeSearch; });
}

AccountTest::~AccountTest() {
    forms::DefaultInstance<receipts::frmRecebimento>::unload();
    forms::DefaultInstance<receipts::frmReposicao>::unload();
    forms::DefaultInstance<entry::frmMovimentos>::unload();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    for (const QString& name : {u"Lumbra.General"_s, u"Tiqueta.General"_s})
        com::registerRunning(name, {});
}

void AccountTest::open(void (General::*operation)(QString*, QString*), const QString& screen) {
    (general.*operation)(nullptr, nullptr);
    person.screen(screen);
    person.waitUntil([&] { return !shown(u"Text8"_s).isEmpty(); }, u"the defaults"_s);
}

void AccountTest::openView(qint64 key, const QString& screen) {
    general.Registo({}, key);
    person.screen(screen);
}

qint64 AccountTest::insert(const QString& tipo, const QString& suffix) {
    book.exec(
        u"insert into tbZelmar_Movimentos%1 (movimento_no, socio_id, codABC, data, tipo, "
        "modo_pagamento, cheque, descrit, credito, debito) values (31, %2, 'B', "
        "'2026-02-01 00:00:00', '%3', 'CHQ', 77, 'acerto', 40.25, 3)"_s.arg(
            suffix, QString::number(socio), tipo));
    return book.value(u"select movimento_id from tbZelmar_Movimentos"_s + suffix).toLongLong();
}

void AccountTest::press(QChar letter, const QString& question, const QString& boxTitle,
                        const QList<support::Operator::Box>& boxes) {
    person.expectBox({.text = question,
                      .answer = core::Answer::Yes,
                      .icon = core::Icon::Question,
                      .title = boxTitle});
    for (const support::Operator::Box& box : boxes) person.expectBox(box);
    person.accelerator(letter);
    person.expectNoBoxesLeft();
}

void AccountTest::expectHeld(const QString& field, const QString& text, const QString& box) {
    person.expectBox({.text = box, .partly = true});
    person.fill(field, text);
    person.expectNoBoxesLeft();
    EXPECT_TRUE(person.find(field)->hasFocus()) << field.toStdString() << text.toStdString();
    EXPECT_EQ(shown(field), text);
}

std::string AccountTest::totals(const QString& suffix) {
    return book
        .text(
            u"select (select zelmars from tbContadores), socio_id = %1, codABC, rubrica_id, "
            "rubrica_id_main, debito_ac, credito_ac, no_docs from tbSocios_Acumulados%2"_s
                .arg(socio)
                .arg(suffix))
        .replace(u"|t|"_s, u"|1|"_s)  // a server prints truth so
        .toStdString();
}
