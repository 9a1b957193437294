// SPDX-License-Identifier: MIT
// Try-out and posting at the screen, to the stored rows.
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
            u"select socio_id, codABC, rubrica_id, rubrica_id_main, printf('%.4f',credito_ac), "
            "printf('%.4f',debito_ac), no_docs from tbSocios_Acumulados where rubrica_id = %1"_s
                .arg(rubric));
    }

    void expectResults(const QStringList& shown) {
        const forms::TextBox* boxes[] = {
            form().Incidencia, form().Comparticipacao, form().LimiteAplicavel,
            form().SaldoCC,    form().Iliquido,        form().SaldoPlafond,
            form().Credito,    form().Debito,          form().Liquido};
        QStringList found;
        for (const forms::TextBox* box : boxes) found << box->Text();
        EXPECT_EQ(found, shown);
    }

    /// "&OK" and yes; `refusal` is the last box, in the screen's name.
    void expectRefused(const QString& refusal) {
        person.expectBox({.text = u"Deseja finalizar o registo?"_s, .answer = Answer::Yes});
        person.expectBox({.text = refusal, .icon = Icon::Information, .title = form().Caption()});
        person.accelerator(u'O');
        person.expectNoBoxesLeft();
        EXPECT_TRUE(form().isVisible());
        EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s), 0);
        EXPECT_EQ(book.value(u"select zelmars from tbContadores"_s).toInt(), 1);
    }
};

TEST_F(Posting, DocumentIsStoredToTheFourthDecimal) {
    book.exec(u"insert into tbSocios_Acumulados values (%1,'B',99,98,40,25.5,1)"_s.arg(socio));
    openNew();
    typeDocument(u"87,35"_s, u"23"_s, u"10"_s);
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
    EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s), 0);
    const QString main = book.text(
        u"select rubrica_id_main from tbZelmar_Plafonds where rubrica_id = %1"_s.arg(rubric));
    const QString grain = u"%1|A|%2|%3|"_s.arg(socio).arg(rubric).arg(main);
    EXPECT_EQ(accumulator(), grain + u"0.0000|0.0000|0"_s);

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
    EXPECT_EQ(accumulator(), grain + u"65.5125|65.5125|1"_s);
    EXPECT_EQ(book.value(u"select zelmars from tbContadores"_s).toInt(), 2);
    EXPECT_FALSE(person.isShown(u"frmMovimentos"_s));
    EXPECT_FALSE(person.isShown(u"frmMovimentosF"_s));
}

TEST_F(Posting, HospitalBillByChequeTakesTheOvertypedNumber) {
    openNew(true);
    typeHospitalBill(u"1200"_s, u"1000"_s);
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
    EXPECT_TRUE(accumulator().endsWith(u"|500.0000|1200.0000|1"_s)) << accumulator().toStdString();
}

TEST_F(Posting, NoAtTheQuestionDoesNothing) {
    openNew();
    typeDocument(u"87,35"_s, u"23"_s, u"0"_s);
    const QString before = everything();
    person.expectBox({.text = u"Deseja finalizar o registo?"_s,
                      .answer = Answer::No,
                      .icon = Icon::Question,
                      .title = u"Lançamento (Plano de Saúde)"_s});
    person.accelerator(u'O');
    EXPECT_EQ(everything(), before);
    expectResults(QStringList(9));
}

TEST_F(Posting, TryOutChecksComeOneAfterTheOther) {
    openNew(true);
    const auto expectCheck = [this](const QString& text, bool plain = false) {
        person.expectBox({.text = text,
                          .icon = plain ? Icon::None : Icon::Information,
                          .title = plain ? u"Zelmars"_s : form().Caption()});
        person.accelerator(u'E');
        person.expectNoBoxesLeft();
    };
    expectCheck(u"Tem de Indicar uma rubrica!"_s);
    person.fill(u"DataCombo1"_s, u"0101"_s);
    expectCheck(u"Não foi atribuido nenhum código de familiar!"_s);
    typeMember();
    choosePerson(self);
    expectCheck(u"Tem de indicar o valor de incidência!"_s);
    person.fill(u"Text9"_s, u"50"_s);
    expectCheck(u"Tem de indicar um valor para o documento!"_s);
    person.fill(u"Text6"_s, u"-1"_s);
    expectCheck(u"O valor do documento é inferior a 0."_s, true);
    EXPECT_EQ(companions.calls.filter(u"Vorlane"_s), QStringList());
    EXPECT_EQ(book.count(u"tbSocios_Acumulados"_s), 0);
}

TEST_F(Posting, ReceivedIsComparedWithTheIncidenceFromTheSecondRunOn) {
    openNew();
    typeDocument(u"80"_s, u"0"_s, QString());
    person.expectBox(
        {.text = u"Tem de indicar um valor para o campo Recebido!"_s, .icon = Icon::Information});
    person.accelerator(u'E');
    person.fill(u"Text9"_s, u"-1"_s);
    person.expectBox({.text = u"O valor recebido é inferior a 0."_s, .icon = Icon::None});
    person.accelerator(u'E');
    person.fill(u"Text9"_s, u"100"_s);
    person.accelerator(u'E');
    // 80 - 100: gross, net and credit go below nothing, the debit does not.
    expectResults({u"€ 80,00"_s, u"€ 60,00"_s, u"€ 500,00"_s, u"€ 0,00"_s, u"(€ 20,00)"_s,
                   u"€ 500,00"_s, u"(€ 20,00)"_s, u"€ 0,00"_s, u"(€ 20,00)"_s});
    person.expectBox({.text = u"Deseja finalizar o registo?"_s, .answer = Answer::Yes});
    person.expectBox({.text = u"O valor recebido é maior que o valor do documento."_s,
                      .icon = Icon::None,
                      .title = u"Zelmars"_s});
    person.accelerator(u'O');
    EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s), 0);
}

TEST_F(Posting, EntryChecksComeInTheirOrder) {
    openNew(true);
    typeDocument(u"100"_s, u"0"_s, u"100"_s);
    person.fill(u"DataCombo3"_s, QString());
    person.fill(u"Text1"_s, QString());
    person.fill(u"Text5"_s, QString());
    form().Text7->Clear();
    expectRefused(u"Tem de indicar um modo de pagamento."_s);
    person.fill(u"DataCombo3"_s, u"TRF"_s);
    expectRefused(u"Tem de introduzir a data do registo."_s);
    form().Text7->setText(u"15-03-2026"_s);
    expectRefused(u"Tem de introduzir a data do documento."_s);
    EXPECT_EQ(book.count(u"tbSocios_Acumulados"_s), 1) << "the try-out ran first";
    person.fill(u"Text1"_s, u"10-03-2026"_s);
    expectRefused(u"Tem de introduzir o número do documento."_s);
    person.fill(u"Text5"_s, u"1"_s);
    expectRefused(u"Tem de indicar um hospital."_s);
    person.fill(u"DataCombo2"_s, u"H01"_s);
    postAndLeave();
    EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s), 1);
}

TEST_F(Posting, BankNumberStopsAndAMemberWhoLeftOnlyWarns) {
    openNew();
    typeDocument(u"100"_s, u"0"_s, u"0"_s);
    const std::pair<const char*, QString> faulty[] = {
        {"null", u"Este Associado não tem NIB!"_s},
        {"'00130000000000000018'", u"Este Associado tem especificado um NIB INVÁLIDO!"_s},
        {"'0013000000000000001866'", u"Este Associado tem especificado um NIB INVÁLIDO!"_s},
    };
    for (const auto& [nib, text] : faulty) {
        book.exec(u"update tbSocios set nib="_s + QString::fromLatin1(nib));
        person.expectBox({.text = u"Deseja finalizar o registo?"_s, .answer = Answer::Yes});
        person.expectBox({.text = text, .icon = Icon::Critical, .title = u"Zelmars"_s});
        person.accelerator(u'O');
        person.expectNoBoxesLeft();
        EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s), 0);
    }
    book.exec(u"delete from tbSocios"_s);
    person.expectBox({.text = u"Deseja finalizar o registo?"_s, .answer = Answer::Yes});
    person.expectBox({.text = u"Este Associado não se encontra na tabela de Activos."_s,
                      .icon = Icon::Critical,
                      .title = u"Zelmars"_s});
    person.onScreen(u"frmMovimentosF"_s, [this] { person.escape(); });
    person.accelerator(u'O');
    EXPECT_EQ(stored(u"movimento_no socio_id"_s), u"1|%1"_s.arg(socio));
}

TEST_F(Posting, MinimumAndNumberOfDocumentsAreSaidAndThePostingGoesOn) {
    book.exec(
        u"update tbZelmar_Plafonds set socio_min_lan = 100.5, nomax_recibos_socio = 0 "
        "where rubrica_id = %1"_s.arg(rubric));
    openNew();
    typeDocument(u"100"_s, u"0"_s, u"0"_s);
    person.expectBox({.text = u"Este lançamento tem um limite minimo de € 100,50"_s,
                      .icon = Icon::None,
                      .title = u"Zelmars"_s});
    person.accelerator(u'E');
    person.fill(u"Text6"_s, u"100,5"_s);
    person.expectBox({.text = u"Deseja finalizar o registo?"_s, .answer = Answer::Yes});
    person.expectBox({.text = u"O limite máximo do nº de documentos foi atingido."_s,
                      .icon = Icon::Information,
                      .title = form().Caption()});
    person.onScreen(u"frmMovimentosF"_s, [this] { person.escape(); });
    person.accelerator(u'O');
    EXPECT_EQ(stored(u"#comparticipacao #credito #debito"_s), u"75.3750|NULL|NULL"_s);
    EXPECT_EQ(book.text(u"select credito_ac, debito_ac, no_docs from tbSocios_Acumulados"_s),
              u"NULL|NULL|1"_s);
}

TEST_F(Posting, SecondDocumentFindsTheFirstInItsCeiling) {
    openNew();
    typeDocument(u"600"_s, u"0"_s, u"0"_s);  // 450 of 500
    postAndLeave();
    openNew();
    typeDocument(u"87,35"_s, u"0"_s, u"0"_s);
    postAndLeave();
    EXPECT_EQ(stored(u"movimento_no #comparticipacao #saldo_plafond #saldo_acumulado #credito"_s),
              u"1|450.0000|500.0000|0.0000|450.0000\n2|65.5125|50.0000|0.0000|50.0000"_s);
    EXPECT_TRUE(accumulator().endsWith(u"|500.0000|500.0000|2"_s));
}

}  // namespace

}  // namespace entry
