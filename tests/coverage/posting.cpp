// SPDX-License-Identifier: MIT
// What a posting refuses, asks, and writes.
#include "boundary/environment/dtZelmars.h"
#include "tests/coverage/Desk.h"

using namespace Qt::StringLiterals;
using core::Icon;

namespace {

class Posting : public Desk {
protected:
    const qint64 rubric = book.childRubric({});
    /// Nothing but the try-out's empty accumulator row was written.
    void expectNothingPosted() {
        EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s), 0);
        EXPECT_EQ(stored("select zelmars from tbContadores"), "1");
        EXPECT_EQ(book.count(u"tbSocios_Acumulados"_s, u"credito_ac <> 0 or no_docs <> 0"_s), 0);
    }
    std::string accumulator() {
        return stored(
            "select printf('%.2f', credito_ac), printf('%.2f', debito_ac), no_docs "
            "from tbSocios_Acumulados");
    }
};

TEST_F(Posting, WritesTheMovementItsNumberAndTheTotals) {
    core::err().set(core::InvalidCall, u"de antes"_s);
    EXPECT_TRUE(post(enter({.rubrica_id = rubric, .codABC = u"B"_s, .doc_valor = 87.35})));
    EXPECT_TRUE(post(enter({.rubrica_id = rubric,
                            .codABC = u"B"_s,
                            .doc_valor = 250,
                            .hospital = true,
                            .incidencia = 200})));
    EXPECT_EQ(
        stored("select movimento_no, codABC, tipo, printf('%.4f', doc_valor), "
               "printf('%.4f', incidencia), printf('%.4f', comparticipacao), "
               "printf('%.4f', iliquido), printf('%.4f', liquido), printf('%.4f', credito), "
               "printf('%.4f', debito), created_by, date(data) "
               "from tbZelmar_Movimentos order by movimento_id"),
        "1|B|DOC|87.3500|87.3500|69.8800|69.8800|69.8800|69.8800|69.8800|operador|2026-05-15\n"
        "2|B|HOS|250.0000|200.0000|160.0000|160.0000|160.0000|160.0000|250.0000|operador|"
        "2026-05-15");
    EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s, u"socio_id = %1"_s.arg(socio)), 2);
    EXPECT_EQ(accumulator(), "229.88|319.88|2");
    EXPECT_EQ(stored("select zelmars from tbContadores"), "3");
}

TEST_F(Posting, ThatIsNotConfirmedDoesNothingAtAll) {
    boxes.ask(u"Deseja finalizar o registo?"_s, Icon::Question, caption, core::Answer::No);
    EXPECT_FALSE(coverage::post(posting(enter({.rubrica_id = rubric})), run));
    EXPECT_EQ(FakeVorlane::calls(), QStringList());
    EXPECT_EQ(book.count(u"tbSocios_Acumulados"_s), 0);
}

TEST_F(Posting, RefusesWhatTheTryOutRefuses) {
    const coverage::Entry entry = enter({.rubrica_id = rubric, .recebido = 120});
    tryOut(entry);
    boxes.expect(u"O valor recebido é maior que o valor do documento."_s);
    EXPECT_FALSE(post(entry));
    expectNothingPosted();
}

TEST_F(Posting, TellsTheFirstThingThatIsMissingAfterTheTryOut) {
    const struct {
        QString coverage::PostingEntry::*text;
        const char* box;
    } missing[] = {{&coverage::PostingEntry::DataCombo3, "Tem de indicar um modo de pagamento."},
                   {&coverage::PostingEntry::Text7, "Tem de introduzir a data do registo."},
                   {&coverage::PostingEntry::Text1, "Tem de introduzir a data do documento."},
                   {&coverage::PostingEntry::Text5, "Tem de introduzir o número do documento."},
                   {&coverage::PostingEntry::DataCombo2, "Tem de indicar um hospital."}};
    coverage::PostingEntry bare = posting(enter({.rubrica_id = rubric, .hospital = true}));
    const coverage::PostingEntry full = bare;
    for (const auto& field : missing) bare.*field.text = QString();
    book.exec(u"update tbSocios set nib = null"_s);  // looked at last
    for (const auto& field : missing) {
        SCOPED_TRACE(field.box);
        boxes.expect(QString::fromUtf8(field.box), Icon::Information, caption);
        EXPECT_FALSE(post(bare));
        expectNothingPosted();
        EXPECT_EQ(book.count(u"tbSocios_Acumulados"_s), 1);
        bare.*field.text = full.*field.text;
    }
    boxes.expect(u"Este Associado não tem NIB!"_s, Icon::Critical);
    EXPECT_FALSE(post(bare));
}

// Also for a cheque, which is then not asked for. The characters are not looked at.
TEST_F(Posting, TakesABankNumberOfTwentyOneCharactersAndNoOther) {
    const QString none = u"Este Associado não tem NIB!"_s;
    const QString bad = u"Este Associado tem especificado um NIB INVÁLIDO!"_s;
    coverage::PostingEntry entry = posting(enter({.rubrica_id = rubric}));
    entry.modo_pagamento = u"CHQ"_s;
    for (const auto& [nib, box] : {std::pair{u"null"_s, none}, std::pair{u"''"_s, none},
                                   std::pair{u"'não é um número 1234'"_s, bad},
                                   std::pair{u"'não é um número 123456'"_s, bad}}) {
        book.exec(u"update tbSocios set nib = "_s + nib);
        boxes.expect(box, Icon::Critical);
        EXPECT_FALSE(post(entry));
        expectNothingPosted();
    }
    book.exec(u"update tbSocios set nib = 'não é um número 12345'"_s);
    entry.modo_pagamento = u"TRF"_s;
    EXPECT_TRUE(post(entry));
}

TEST_F(Posting, WarnsOfAMemberWhoHasLeftAndGoesOn) {
    book.exec(u"delete from tbSocios"_s);
    boxes.expect(u"Este Associado não se encontra na tabela de Activos."_s, Icon::Critical);
    EXPECT_TRUE(post(enter({.rubrica_id = rubric})));
    EXPECT_EQ(accumulator(), "80.00|80.00|1");
}

TEST_F(Posting, ByChequeAsksForItsNumberBeforeAnythingIsWritten) {
    coverage::PostingEntry entry = posting(enter({.rubrica_id = rubric}));
    entry.modo_pagamento = u"CHQ"_s;
    int asked = 0;
    entry.askCheque = [&](const ado::RecordsetPtr& record) {
        ++asked;
        expectNothingPosted();
        EXPECT_EQ(record->Collect(u"socio_id"_s).toInt(), socio);
        record->setCollect(u"cheque"_s, 500);
    };
    EXPECT_TRUE(post(entry));
    EXPECT_EQ(asked, 1);
    EXPECT_EQ(stored("select cheque, movimento_no from tbZelmar_Movimentos"), "500|1");
}

TEST_F(Posting, GoesUpWithAFailureOfTheChequeNumber) {
    coverage::PostingEntry entry = posting(enter({.rubrica_id = rubric}));
    entry.modo_pagamento = u"CHQ"_s;
    entry.askCheque = [](const ado::RecordsetPtr&) {
        throw core::Failure(core::TypeMismatch, u"«abc» não é um número"_s);
    };
    EXPECT_EQ(failureOf([&] { post(entry); }), core::TypeMismatch);
    expectNothingPosted();
}

TEST_F(Posting, OnAnEmptyCounterGivesTheNumberOneTwice) {
    book.exec(u"delete from tbContadores"_s);
    for (int i = 0; i < 3; ++i) EXPECT_TRUE(post(enter({.rubrica_id = rubric})));
    EXPECT_EQ(stored("select movimento_no from tbZelmar_Movimentos order by movimento_id"),
              "1\n1\n2");
    EXPECT_EQ(stored("select zelmars from tbContadores"), "3");
}

// The run stays valid after these two boxes, so the posting goes on with what the row holds.
TEST_F(Posting, PastTheLastDocumentGoesOnWithoutAmountsAndLosesTheTotals) {
    setRubric(rubric, "nomax_recibos_socio", 5);
    accumulated(u"A"_s, rubric, 300, 5);
    boxes.expect(u"O limite máximo do nº de documentos foi atingido."_s, Icon::Information,
                 caption);
    EXPECT_TRUE(post(enter({.rubrica_id = rubric})));
    EXPECT_EQ(stored("select movimento_no, printf('%.2f', comparticipacao), credito, debito "
                     "from tbZelmar_Movimentos"),
              "1|80.00|NULL|NULL");
    EXPECT_EQ(stored("select credito_ac, debito_ac, no_docs from tbSocios_Acumulados"),
              "NULL|NULL|6");
}

TEST_F(Posting, BelowTheMinimumGoesOnWithTheAmountsOfAnEarlierRun) {
    setRubric(rubric, "socio_min_lan", 20);
    const coverage::Entry entry = enter({.rubrica_id = rubric});
    tryOut(entry);
    entry.record->setCollect(u"doc_valor"_s, 10);
    boxes.expect(u"Este lançamento tem um limite minimo de € 20,00"_s);
    EXPECT_TRUE(post(entry));
    EXPECT_EQ(stored("select printf('%.2f', doc_valor), printf('%.2f', incidencia), "
                     "printf('%.2f', credito) from tbZelmar_Movimentos"),
              "10.00|100.00|80.00");
    EXPECT_EQ(accumulator(), "80.00|80.00|1");
}

TEST_F(Posting, AddsANewAccumulatorRowWithoutSumsWhenTheTryOutsOwnIsGone) {
    coverage::PostingEntry entry = posting(enter({.rubrica_id = rubric}));
    entry.modo_pagamento = u"CHQ"_s;
    entry.askCheque = [&](const ado::RecordsetPtr&) {
        book.exec(u"delete from tbSocios_Acumulados"_s);
    };
    EXPECT_TRUE(post(entry));
    EXPECT_EQ(stored("select socio_id = (select socio_id from tbSocios), rubrica_id, codABC, "
                     "rubrica_id_main, credito_ac, debito_ac, no_docs from tbSocios_Acumulados"),
              "1|" + std::to_string(rubric) + "|NULL|NULL|NULL|NULL|NULL");
}

}  // namespace
