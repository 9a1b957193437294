// SPDX-License-Identifier: MIT
// What a posting refuses, asks, and writes.
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
    EXPECT_TRUE(post(enter({.rubrica_id = rubric, .codABC = u"B"_s, .doc_valor = 87.35})));
    EXPECT_TRUE(post(enter({.rubrica_id = rubric,
                            .codABC = u"B"_s,
                            .doc_valor = 250,
                            .hospital = true,
                            .incidencia = 200})));
    EXPECT_EQ(stored("select movimento_no, socio_id = (select socio_id from tbSocios), codABC, "
                     "tipo, printf('%.4f %.4f %.4f %.4f %.4f %.4f %.4f', doc_valor, incidencia, "
                     "comparticipacao, iliquido, liquido, credito, debito), created_by, date(data) "
                     "from tbZelmar_Movimentos order by movimento_id"),
              "1|1|B|DOC|87.3500 87.3500 69.8800 69.8800 69.8800 69.8800 69.8800|operador|"
              "2026-05-15\n"
              "2|1|B|HOS|250.0000 200.0000 160.0000 160.0000 160.0000 160.0000 250.0000|operador|"
              "2026-05-15");
    EXPECT_EQ(accumulator(), "229.88|319.88|2");
    EXPECT_EQ(stored("select zelmars from tbContadores"), "3");
}

TEST_F(Posting, TellsTheFirstThingThatIsMissingAfterTheTryOut) {
    const std::pair<QString coverage::PostingEntry::*, QString> missing[] = {
        {&coverage::PostingEntry::DataCombo3, u"Tem de indicar um modo de pagamento."_s},
        {&coverage::PostingEntry::Text7, u"Tem de introduzir a data do registo."_s},
        {&coverage::PostingEntry::Text1, u"Tem de introduzir a data do documento."_s},
        {&coverage::PostingEntry::Text5, u"Tem de introduzir o número do documento."_s},
        {&coverage::PostingEntry::DataCombo2, u"Tem de indicar um hospital."_s}};
    coverage::PostingEntry bare = posting(enter({.rubrica_id = rubric, .hospital = true}));
    const coverage::PostingEntry full = bare;
    for (const auto& [field, box] : missing) bare.*field = QString();
    book.exec(u"update tbSocios set nib = null"_s);  // looked at last
    for (const auto& [field, box] : missing) {
        SCOPED_TRACE(box.toStdString());
        expectBox(box, Icon::Information, caption);
        EXPECT_FALSE(post(bare));
        bare.*field = full.*field;
    }
    expectBox(u"Este Associado não tem NIB!"_s, Icon::Critical);
    EXPECT_FALSE(post(bare));
    expectNothingPosted();
    EXPECT_EQ(book.count(u"tbSocios_Acumulados"_s), 1);
}

// Also for a cheque, which is then not asked for. The characters are not looked at.
TEST_F(Posting, TakesABankNumberOfTwentyOneCharactersAndAMemberWhoHasLeft) {
    const QString none = u"Este Associado não tem NIB!"_s;
    const QString bad = u"Este Associado tem especificado um NIB INVÁLIDO!"_s;
    coverage::PostingEntry entry = posting(enter({.rubrica_id = rubric}));
    entry.modo_pagamento = u"CHQ"_s;
    const std::pair<QString, QString> refused[] = {{u"null"_s, none},
                                                   {u"''"_s, none},
                                                   {u"'não é um número 1234'"_s, bad},
                                                   {u"'não é um número 123456'"_s, bad}};
    for (const auto& [nib, box] : refused) {
        book.exec(u"update tbSocios set nib = "_s + nib);
        expectBox(box, Icon::Critical);
        EXPECT_FALSE(post(entry));
    }
    expectNothingPosted();
    book.exec(u"update tbSocios set nib = 'não é um número 12345'"_s);
    EXPECT_TRUE(post(enter({.rubrica_id = rubric})));
    book.exec(u"delete from tbSocios"_s);
    expectBox(u"Este Associado não se encontra na tabela de Activos."_s, Icon::Critical);
    EXPECT_TRUE(post(enter({.rubrica_id = rubric})));
    EXPECT_EQ(accumulator(), "160.00|160.00|2");
}

TEST_F(Posting, ByChequeAsksForItsNumberBeforeAnythingIsWritten) {
    coverage::PostingEntry entry = posting(enter({.rubrica_id = rubric}));
    entry.modo_pagamento = u"CHQ"_s;
    entry.askCheque = [&](const ado::RecordsetPtr& record) {
        expectNothingPosted();
        EXPECT_EQ(record->Collect(u"socio_id"_s).toInt(), socio);
        record->setCollect(u"cheque"_s, 500);
    };
    EXPECT_TRUE(post(entry));
    EXPECT_EQ(stored("select cheque, movimento_no from tbZelmar_Movimentos"), "500|1");
}

TEST_F(Posting, OnAnEmptyCounterGivesTheNumberOneTwice) {
    book.exec(u"delete from tbContadores"_s);
    for (int i = 0; i < 3; ++i) EXPECT_TRUE(post(enter({.rubrica_id = rubric})));
    EXPECT_EQ(stored("select movimento_no from tbZelmar_Movimentos union all "
                     "select zelmars from tbContadores"),
              "1\n1\n2\n3");
}

// The run stays valid after these two boxes, so the posting goes on with what the row holds.
TEST_F(Posting, PastTheLastDocumentGoesOnWithoutAmountsAndLosesTheTotals) {
    setRubric(rubric, "nomax_recibos_socio", 5);
    accumulated(u"A"_s, rubric, 300, 5);
    expectBox(u"O limite máximo do nº de documentos foi atingido."_s, Icon::Information, caption);
    EXPECT_TRUE(post(enter({.rubrica_id = rubric})));
    EXPECT_EQ(stored("select movimento_no, printf('%.2f', comparticipacao), credito, debito "
                     "from tbZelmar_Movimentos"),
              "1|80.00|NULL|NULL");
    EXPECT_EQ(stored("select credito_ac, debito_ac, no_docs from tbSocios_Acumulados"),
              "NULL|NULL|6");
}

}  // namespace
