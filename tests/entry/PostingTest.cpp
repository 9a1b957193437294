// SPDX-License-Identifier: MIT
// Try-out and posting at the screen, to the stored rows.
#include "platform/com/Component.h"
#include "tests/entry/EntryTest.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

using core::Answer;
using core::Icon;

class Posting : public EntryTest {
protected:
    /// The movement's columns as they are stored, amounts to the fourth decimal.
    QString stored(const QString& columns) {
        QStringList parts;
        for (const QString& column : columns.split(u' '))
            parts << (column.startsWith(u'#')
                          ? u"iif(%1 is null, 'NULL', printf('%.4f',%1))"_s.arg(column.mid(1))
                          : column);
        return book.text(u"select %1 from tbZelmar_Movimentos"_s.arg(parts.join(u',')));
    }

    QString accumulator() {
        return book.text(
            u"select codABC, printf('%.4f',credito_ac), printf('%.4f',debito_ac), no_docs "
            "from tbSocios_Acumulados where rubrica_id = %1"_s.arg(rubric));
    }

    void expectResults(const QStringList& shown) {
        QStringList found;
        for (const forms::TextBox* box :
             {form().Incidencia, form().Comparticipacao, form().LimiteAplicavel, form().SaldoCC,
              form().Iliquido, form().SaldoPlafond, form().Credito, form().Debito, form().Liquido})
            found << box->Text();
        EXPECT_EQ(found, shown);
    }
};

TEST_F(Posting, DocumentIsStoredToTheFourthDecimal) {
    book.exec(u"insert into tbSocios_Acumulados values (%1,'B',99,98,40,25.5,1)"_s.arg(socio));
    openNew();
    typeDocument(u"87,35"_s, u"10"_s, u"23"_s);
    person.fill(u"DataCombo4"_s, u"ADSE"_s);
    person.fill(u"Text12"_s, u"2.ª via"_s);
    person.accelerator(u'E');
    EXPECT_EQ(companions.calls.mid(2),
              QStringList({u"Vorlane.Iniciar(22 of 16 bits, \"Evolução dos calculos, aguarde "
                           "alguns momentos . . .\", \"Processamento\")"_s,
                           u"Vorlane.terminar()"_s}));
    EXPECT_EQ(companions.progress, 22);
    // 87,35 at 75 % is 65,5125; the account stood at 40 - 25,5.
    expectResults({u"€ 87,35"_s, u"€ 65,51"_s, u"€ 500,00"_s, u"€ 14,50"_s, u"€ 65,51"_s,
                   u"€ 500,00"_s, u"€ 65,51"_s, u"€ 65,51"_s, u"€ 65,51"_s});
    EXPECT_EQ(accumulator(), u"A|0.0000|0.0000|0"_s);
    const QString before = everything();
    person.expectBox({.text = u"Deseja finalizar o registo?"_s, .answer = Answer::No});
    person.accelerator(u'O');
    EXPECT_EQ(everything(), before);

    postAndLeave();
    EXPECT_EQ(
        stored(u"movimento_no socio_id codABC rubrica_id hospital_id oe_id data tipo doc_data "
               "doc_no modo_pagamento cheque obs created_by"_s),
        u"1|%1|A|%2|NULL|1|2026-03-15 00:00:00|DOC|2026-03-10 00:00:00|FT 2026/17|TRF|NULL|"
        "2.ª via|operador"_s.arg(socio)
            .arg(rubric));
    EXPECT_EQ(stored(u"#doc_valor #doc_iva #doc_tx_iva #recebido #incidencia #comparticipacao "
                     "#saldo_plafond #saldo_acumulado #iliquido #liquido #credito #debito"_s),
              u"87.3500|16.3300|23.0000|10.0000|87.3500|65.5125|500.0000|14.5000|65.5125|65.5125|"
              "65.5125|65.5125"_s);
    EXPECT_EQ(accumulator(), u"A|65.5125|65.5125|1"_s);
    EXPECT_EQ(book.value(u"select zelmars from tbContadores"_s).toInt(), 2);
    EXPECT_FALSE(person.isShown(u"frmMovimentos"_s));
}

TEST_F(Posting, HospitalBillByChequeTakesTheOvertypedNumber) {
    openNew(true);
    typeDocument(u"1200"_s, u"1000"_s);
    person.accelerator(u'E');
    // 75 % of the incidence is 750, the ceiling leaves 500; the debit is the whole bill.
    expectResults({u"€ 1.000,00"_s, u"€ 750,00"_s, u"€ 500,00"_s, QString(), u"€ 750,00"_s,
                   u"€ 500,00"_s, u"€ 500,00"_s, u"€ 1.200,00"_s, u"€ 500,00"_s});
    person.onScreen(u"frmPagamentoCheque"_s, [this] {
        auto* number = person.find<forms::TextBox>(u"Text1"_s);
        EXPECT_EQ(number->Text(), u"1"_s);
        person.waitUntil([&] { return number->hasFocus(); }, u"the focus"_s);
        person.type(u"500"_s);  // over the selected number
        person.enter();
    });
    postAndLeave();
    EXPECT_EQ(stored(u"movimento_no codABC hospital_id tipo modo_pagamento cheque #recebido "
                     "#incidencia #comparticipacao #saldo_plafond #saldo_acumulado #iliquido "
                     "#liquido #credito #debito"_s),
              u"1|A|%1|HOS|CHQ|500|NULL|1000.0000|750.0000|500.0000|NULL|750.0000|500.0000|"
              "500.0000|1200.0000"_s.arg(hospital));
    EXPECT_EQ(book.text(u"select cheque_no from tbCheques"_s), u"501"_s);
    EXPECT_EQ(accumulator(), u"A|500.0000|1200.0000|1"_s);
}

// A failing write is said on this screen and is none of the posting once it is mended.
TEST_F(Posting, ChequeScreenStaysUntilItsNumberIsStored) {
    book.exec(u"delete from tbCheques"_s);
    openNew();
    typeDocument(u"100"_s);
    person.fill(u"DataCombo3"_s, u"CHQ"_s);
    person.onScreen(u"frmPagamentoCheque"_s, [this] {
        EXPECT_EQ(person.here()->windowTitle(), u"Pagamento por Cheque"_s);
        const auto* number = person.find<forms::TextBox>(u"Text1"_s);
        EXPECT_EQ(number->Text(), u"0"_s) << "of an empty table";
        for (const QString& step : {u"Command3"_s, u"Command2"_s, u"Command2"_s})
            person.click(step);
        EXPECT_EQ(number->Text(), u"-1"_s);
        person.expectBox({.text = u"abc"_s, .icon = Icon::Critical, .partly = true});
        person.put(u"Text1"_s, u"abc"_s);
        person.accelerator(u'O');
        person.expectNoBoxesLeft();
        failOn(u"update on tbCheques"_s);
        person.expectBox({.text = u"disco cheio"_s, .icon = Icon::Critical, .partly = true});
        person.put(u"Text1"_s, u"7"_s);
        person.accelerator(u'O');
        EXPECT_EQ(book.text(u"select cheque_no from tbCheques"_s), u"0"_s);
        mend();
        person.enter();
    });
    postAndLeave();
    EXPECT_EQ(stored(u"cheque"_s), u"7"_s);
    EXPECT_EQ(book.text(u"select cheque_no from tbCheques"_s), u"8"_s);
}

TEST_F(Posting, ClosedChequeScreenLeavesThePostingWithoutANumber) {
    openNew();
    typeDocument(u"100"_s);
    person.fill(u"DataCombo3"_s, u"CHQ"_s);
    person.onScreen(u"frmPagamentoCheque"_s, [this] { person.escape(); });
    postAndLeave();
    EXPECT_EQ(stored(u"movimento_no cheque"_s), u"1|NULL"_s);
}

TEST_F(Posting, EntryChecksComeInTheirOrder) {
    openNew(true);
    person.expectBox({.text = u"Tem de Indicar uma rubrica!"_s, .icon = Icon::Information});
    person.accelerator(u'E');
    typeDocument(u"100"_s, u"100"_s);
    for (const QString& name : {u"DataCombo3"_s, u"Text1"_s, u"Text5"_s, u"DataCombo2"_s})
        person.fill(name, QString());
    const std::tuple<QString, QString, QString> checks[] = {
        {u"Tem de indicar um modo de pagamento."_s, u"DataCombo3"_s, u"TRF"_s},
        {u"Tem de introduzir a data do documento."_s, u"Text1"_s, u"10-03-2026"_s},
        {u"Tem de introduzir o número do documento."_s, u"Text5"_s, u"1"_s},
        {u"Tem de indicar um hospital."_s, u"DataCombo2"_s, u"H01"_s},
    };
    for (const auto& [refusal, field, mended] : checks) {
        person.expectBox({.text = u"Deseja finalizar o registo?"_s, .answer = Answer::Yes});
        person.expectBox({.text = refusal, .icon = Icon::Information, .title = form().Caption()});
        person.accelerator(u'O');
        person.expectNoBoxesLeft();
        EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s), 0);
        EXPECT_EQ(book.value(u"select zelmars from tbContadores"_s).toInt(), 1);
        person.fill(field, mended);
    }
    postAndLeave();
    EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s), 1);
}

TEST_F(Posting, FailuresAreSaidKeepWhatWasTypedAndCanBeTriedAgain) {
    openNew();
    typeDocument(u"100"_s);
    com::registerRunning(u"Vorlane.General"_s, {});
    person.expectBox({.text = u"Vorlane.General"_s, .icon = Icon::Critical, .partly = true});
    person.accelerator(u'E');
    person.expectNoBoxesLeft();
    companions.offer(u"Vorlane"_s);

    failOn(u"insert on tbZelmar_Movimentos"_s);
    person.expectBox({.text = u"Deseja finalizar o registo?"_s, .answer = Answer::Yes});
    person.expectBox({.text = u"disco cheio"_s, .icon = Icon::None, .partly = true});
    person.expectBox(
        {.text = u"Não foi possível registar o registo, contacte o Administrador do Sistema."_s,
         .icon = Icon::Critical,
         .title = form().Caption()});
    person.accelerator(u'O');
    EXPECT_EQ(form().Text6->Text(), u"€ 100,00"_s);
    EXPECT_EQ(form().Text5->Text(), u"FT 2026/17"_s);
    EXPECT_EQ(accumulator(), u"A|0.0000|0.0000|0"_s);
    mend();
    postAndLeave();
    EXPECT_EQ(stored(u"movimento_no #credito"_s), u"2|75.0000"_s) << "number 1 is lost";
    EXPECT_EQ(accumulator(), u"A|75.0000|75.0000|1"_s);
}

}  // namespace

}  // namespace entry
