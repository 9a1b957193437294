// SPDX-License-Identifier: MIT
// Try-out and posting at the screen, to the stored rows.
#include <QAccessible>
#include <QTest>
#include <QTimer>

#include "tests/entry/EntryTest.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

using core::Answer;
using core::Icon;

class Posting : public EntryTest {
protected:
    QString stored(const QString& columns) {
        return book.text(u"select %1 from tbZelmar_Movimentos"_s.arg(columns));
    }

    /// The sums are 32-bit floats.
    QString accumulator() {
        return book.text(
            u"select codABC, round(cast(credito_ac as numeric), 4), "
            "round(cast(debito_ac as numeric), 4), no_docs "
            "from tbSocios_Acumulados where rubrica_id = %1"_s.arg(rubric));
    }
};

TEST_F(Posting, DocumentIsStoredToTheFourthDecimal) {
    book.exec(u"insert into tbSocios_Acumulados values (%1,'B',99,98,40,25.5,1)"_s.arg(socio));
    openNew();
    typeDocument(u"87,35"_s, u"10"_s, u"23"_s);
    person.fill(u"DataCombo4"_s, u"ADSE"_s);
    person.fill(u"Text12"_s, u"2.ª via"_s);
    person.accelerator(u'E');
    // 87,35 at 75 % is 65,5125; the account stood at 40 - 25,5.
    QStringList shown;
    for (const forms::TextBox* box :
         {form().Incidencia, form().Comparticipacao, form().LimiteAplicavel, form().SaldoCC,
          form().Iliquido, form().SaldoPlafond, form().Credito, form().Debito, form().Liquido})
        shown << box->Text();
    EXPECT_EQ(
        shown,
        u"€ 87,35|€ 65,51|€ 500,00|€ 14,50|€ 65,51|€ 500,00|€ 65,51|€ 65,51|€ 65,51"_s.split(u'|'));
    EXPECT_EQ(accumulator(), u"A|0|0|0"_s);
    postAndLeave();
    EXPECT_EQ(stored(u"movimento_no, socio_id, codABC, rubrica_id, hospital_id, oe_id, data, tipo, "
                     u"doc_data, "
                     "doc_no, modo_pagamento, cheque, obs, created_by"_s),
              u"1|%1|A|%2|NULL|1|2026-03-15 00:00:00|DOC|2026-03-10 00:00:00|FT 2026/17|TRF|NULL|"
              "2.ª via|operador"_s.arg(socio)
                  .arg(rubric));
    EXPECT_EQ(stored(u"doc_valor, doc_iva, doc_tx_iva, recebido, incidencia, comparticipacao, "
                     "saldo_plafond, saldo_acumulado, iliquido, liquido, credito, debito"_s),
              u"87.35|16.33|23|10|87.35|65.5125|500|14.5|65.5125|65.5125|"
              "65.5125|65.5125"_s);
    EXPECT_EQ(accumulator(), u"A|65.5125|65.5125|1"_s);
    EXPECT_EQ(book.value(u"select zelmars from tbContadores"_s).toInt(), 2);
    EXPECT_FALSE(person.isShown(u"frmMovimentos"_s));
}

TEST_F(Posting, HospitalBillByChequeTakesTheOvertypedNumber) {
    book.exec(u"delete from tbCheques"_s);
    openNew(true);
    typeDocument(u"1200"_s, u"1000"_s);
    person.onScreen(u"frmPagamentoCheque"_s, [this] {
        auto* number = person.find<forms::TextBox>(u"Text1"_s);
        EXPECT_EQ(number->Text(), u"0"_s) << "of an empty table";
        person.waitUntil([&] { return number->hasFocus(); }, u"the focus"_s);
        person.type(u"501"_s);  // over the selected number
        for (const QString& step : {u"Command3"_s, u"Command2"_s, u"Command2"_s})
            person.click(step);
        EXPECT_EQ(number->Text(), u"500"_s);
        person.expectBox({.text = u"abc"_s, .icon = Icon::Critical, .partly = true});
        person.put(u"Text1"_s, u"abc"_s);
        person.accelerator(u'O');
        person.expectNoBoxesLeft();
        person.put(u"Text1"_s, u"500"_s);
        person.enter();
    });
    postAndLeave();
    // 75 % of the incidence is 750, the ceiling leaves 500; the debit is the whole bill.
    EXPECT_EQ(stored(u"movimento_no, codABC, hospital_id, tipo, modo_pagamento, cheque, recebido, "
                     "incidencia, comparticipacao, saldo_plafond, saldo_acumulado, iliquido, "
                     "liquido, credito, debito"_s),
              u"1|A|%1|HOS|CHQ|500|NULL|1000|750|500|NULL|750|500|"
              "500|1200"_s.arg(hospital));
    EXPECT_EQ(book.text(u"select cheque_no from tbCheques"_s), u"501"_s);
    EXPECT_EQ(accumulator(), u"A|500|1200|1"_s);
}

/// Presses a button as an assistive program does, and by the call that every program has.
void pressFiveTimes(QAbstractButton* button) {
    for (int time = 0; time < 5; ++time) {
        button->click();
        QAccessible::queryAccessibleInterface(button)->actionInterface()->doAction(
            QAccessibleActionInterface::pressAction());
        EXPECT_TRUE(QTest::qWaitFor([button] { return !button->isDown(); }));
    }
}

TEST_F(Posting, ProgramsThatPressFiveTimesPostAndAnnulOnce) {
    openNew();
    typeDocument(u"100"_s);
    forms::Button* ok = form().Command3;
    person.expectBox({.text = u"Deseja finalizar o registo?"_s, .answer = Answer::Yes});
    person.onScreen(u"frmMovimentosF"_s, [&] {
        pressFiveTimes(ok);
        person.accelerator(u'S');
        person.enter();
    });
    QTimer::singleShot(0, [ok] { pressFiveTimes(ok); });
    ok->click();
    EXPECT_EQ(stored(u"movimento_no, credito"_s), u"1|75"_s);
    EXPECT_EQ(accumulator(), u"A|75|75|1"_s);

    openView(book.value(u"select movimento_id from tbZelmar_Movimentos"_s));
    person.expectBox({.text = u"Deseja anular este registo?"_s, .answer = Answer::Yes});
    QTimer::singleShot(0, [this] { pressFiveTimes(form().Command6); });
    form().Command6->click();
    EXPECT_EQ(book.text(u"select tipo, credito from tbZelmar_Movimentos order by movimento_no"_s),
              u"ANL|75\nCOR|-75"_s);
    EXPECT_EQ(accumulator(), u"A|0|0|0"_s);
}

TEST_F(Posting, ARefusalLeadsToTheFieldThatItNames) {
    const std::tuple<QString, QString, QString> rows[] = {
        {u"DataCombo1"_s, u"Tem de Indicar uma rubrica!"_s, u"0101"_s},
        {u"Text6"_s, u"Tem de indicar um valor para o documento!"_s, u"100"_s},
        {u"Text9"_s, u"Tem de indicar um valor para o campo Recebido!"_s, u"101"_s},
        {u"Text9"_s, u"O valor recebido é maior que o valor do documento."_s, u"0"_s},
        {u"DataCombo3"_s, u"Tem de indicar um modo de pagamento."_s, u"TRF"_s},
        {u"Text1"_s, u"Tem de introduzir a data do documento."_s, u"10-03-2026"_s},
        {u"Text5"_s, u"Tem de introduzir o número do documento."_s, u"4711"_s},
    };
    openNew();
    typeMember();
    person.expectBox({.text = u"Não foi atribuido nenhum código de familiar!"_s});
    person.fill(u"DataCombo1"_s, u"0101"_s);
    person.accelerator(u'E');
    EXPECT_TRUE(form().Command2->hasFocus());
    forms::DefaultInstance<frmMovimentos>::unload();
    openNew();
    typeDocument(u"100"_s);
    for (const auto& [field, text, mended] : rows) {
        SCOPED_TRACE(text.toStdString());
        if (!text.startsWith(u"O valor"_s)) person.fill(field, {});
        person.expectBox({.text = u"Deseja finalizar o registo?"_s, .answer = Answer::Yes});
        person.expectBox({.text = text});
        person.accelerator(u'O');
        person.expectNoBoxesLeft();
        ASSERT_TRUE(person.find(field)->hasFocus());
        person.fill(field, mended);
        if (mended == u"101"_s) person.accelerator(u'E');  // fills the incidence
    }
}

TEST_F(Posting, FailingWriteIsSaidKeepsWhatWasTypedAndCanBeTriedAgain) {
    openNew();
    typeDocument(u"100"_s);
    book.refuse(u"insert on tbZelmar_Movimentos"_s, u"disco cheio"_s);
    person.expectBox({.text = u"Deseja finalizar o registo?"_s, .answer = Answer::Yes});
    person.expectBox({.text = u"disco cheio"_s, .icon = Icon::None, .partly = true});
    person.expectBox(
        {.text = u"Não foi possível registar o registo, contacte o Administrador do Sistema."_s,
         .icon = Icon::Critical,
         .title = form().Caption()});
    person.accelerator(u'O');
    EXPECT_EQ(form().Text6->Text(), u"€ 100,00"_s);
    EXPECT_EQ(form().Text5->Text(), u"FT 2026/17"_s);
    EXPECT_EQ(accumulator(), u"A|0|0|0"_s);
    book.refuseNoMore();
    postAndLeave();
    EXPECT_EQ(stored(u"movimento_no, credito"_s), u"2|75"_s) << "number 1 is lost";
    EXPECT_EQ(accumulator(), u"A|75|75|1"_s);
}

}  // namespace

}  // namespace entry
