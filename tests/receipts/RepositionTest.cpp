// SPDX-License-Identifier: MIT
// Corrections of an account typed by hand: at the screen, to the stored rows.
#include "entry/frmMovimentos.h"
#include "receipts/frmReposicao.h"
#include "tests/receipts/AccountTest.h"

using namespace Qt::StringLiterals;
using core::Icon;

namespace {

const QString Screen = u"frmReposicao"_s;

class Reposition : public AccountTest {
protected:
    void openNew() { open(&General::Correcao, Screen); }
    void choosePerson() {
        FakeSearch::person = relative;
        person.accelerator(u'I');
    }
    void typeReposition(const QString& debit, const QString& credit) {
        openNew();
        person.fill(u"No_Kor"_s, u"100015"_s);
        person.fill(u"Debito"_s, debit);
        person.fill(u"Credito"_s, credit);
    }
};

TEST_F(Reposition, WithRubricAndPersonFindsOrAddsTheirRow) {
    for (const char* expected : {"1|B|%1|NULL|10|2.5|NULL", "1|B|%1|NULL|20|5|NULL"}) {
        typeReposition(u"10"_s, u"2,5"_s);
        choosePerson();
        EXPECT_EQ(shown(u"Text4"_s), u"Maria da Luz Matos"_s);
        person.fill(u"DataCombo1"_s, u"0101"_s);
        person.fill(u"Text1"_s, u"acerto"_s);
        postAnd();
        EXPECT_FALSE(person.isShown(Screen));
        EXPECT_EQ(totals().substr(2), QString::fromLatin1(expected).arg(rubric).toStdString());
    }
    EXPECT_EQ(stored("select movimento_no, tipo, modo_pagamento, data, codABC, doc_valor, debito, "
                     "credito, descrit, created_by from tbZelmar_Movimentos order by 1"),
              "1|REP|NULL|2026-05-15 00:00:00|B|0|10|2.5|acerto|NULL\n"
              "2|REP|NULL|2026-05-15 00:00:00|B|0|10|2.5|acerto|NULL");
}

TEST_F(Reposition, WithoutRubricAddsARowEachTime) {
    for (int time = 0; time < 2; ++time) {
        typeReposition(u"-1"_s, u"0"_s);
        if (time > 0) person.fill(u"DataCombo1"_s, {});  // left as empty as it was
        postAnd();
    }
    EXPECT_EQ(stored("select rubrica_id from tbZelmar_Movimentos order by movimento_no"),
              "NULL\n0");
    EXPECT_EQ(totals(), "3|1|NULL|0|NULL|-1|0|NULL\n3|1|NULL|0|NULL|-1|0|NULL");
}

TEST_F(Reposition, RefusesWhatIsMissingOrWrongAndKeepsWhatWasTyped) {
    const auto refused = [&](const QString& text) {
        postAnd({{.text = text, .icon = Icon::Information, .title = title}});
    };
    const QString noAmount = u"Tem de indicar um valor para o crédito ou para o débito!"_s;
    const QString noPerson = u"Uma rubrica tem de estar associada a um familiar."_s;
    typeReposition({}, u"5"_s);
    refused(noAmount);
    EXPECT_TRUE(person.find(u"Debito"_s)->hasFocus());
    person.fill(u"Debito"_s, u"0"_s);
    person.fill(u"Credito"_s, {});
    refused(noAmount);
    EXPECT_TRUE(person.find(u"Credito"_s)->hasFocus());
    person.fill(u"Credito"_s, u"0"_s);
    refused(noAmount);
    person.fill(u"Credito"_s, u"10"_s);
    person.fill(u"DataCombo1"_s, u"0101"_s);
    refused(noPerson);
    person.fill(u"DataCombo1"_s, {});
    choosePerson();
    refused(noPerson);
    person.fill(u"No_Kor"_s, {});  // clears the person as well
    EXPECT_EQ(shown(u"Text3"_s), QString());
    EXPECT_FALSE(person.peek(u"Command2"_s)->isEnabled());
    refused(u"Tem de indicar um Sócio!"_s);
    person.fill(u"No_Kor"_s, u"100015"_s);
    person.fill(u"Text7"_s, {});
    refused(u"Tem de introduzir a data do registo."_s);
    person.fill(u"Text7"_s, u"15-05-2026"_s);
    postAnd();
    EXPECT_EQ(stored("select rubrica_id, codABC, credito from tbZelmar_Movimentos"), "0||10");
}

TEST_F(Reposition, SearchGivenUpLeavesNoMemberWithTheOldNameShown) {
    book.exec(u"update tbSocios set zelmar = 0"_s);  // enrolment is not tested here
    openNew();
    FakeSearch::member = socio;
    person.accelerator(u'P');
    EXPECT_EQ(shown(u"No_Kor"_s), u"100015"_s);
    const auto& screen = forms::DefaultInstance<receipts::frmReposicao>::get();
    const qint64 other = book.member({.no_kor = u"100023"_s});
    FakeSearch::member = other;
    book.exec(u"alter table tbSocios rename nome to apelido"_s);
    person.expectBox({.text = u"nome"_s, .icon = Icon::None, .partly = true});
    person.accelerator(u'P');
    EXPECT_EQ(screen.Socio_ID, socio) << "a search that fails changes nothing";
    FakeSearch::member = 0;
    person.accelerator(u'P');
    EXPECT_EQ(shown(u"No_Kor"_s) + shown(u"Text2"_s), u"100015António Manuel Silva Matos"_s);
    EXPECT_EQ(screen.Socio_ID, 0);
}

// Counter, movement and accumulator are three writes.
TEST_F(Reposition, FailingWriteIsToldAndTheNextPressDoesOnlyWhatIsMissing) {
    typeReposition(u"1"_s, u"0"_s);
    for (const QString& write : {u"update on tbContadores"_s, u"insert on tbZelmar_Movimentos"_s}) {
        book.refuse(write, u"disco cheio"_s);
        postAnd({{.text = u"disco cheio"_s, .icon = Icon::None, .partly = true},
                 {.text = u"Não foi possível registar o registo, contacte o Administrador do "
                          "Sistema."_s,
                  .icon = Icon::Critical,
                  .title = title}});
        book.refuseNoMore();
        EXPECT_EQ(shown(u"Debito"_s), u"€ 1,00"_s);
        EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s), 0);
    }
    book.refuse(u"insert on tbSocios_Acumulados"_s, u"disco cheio"_s);
    postAnd({{.text = u"O movimento nº 2 está registado, mas falta somar aos acumulados."_s,
              .icon = Icon::Critical,
              .title = title,
              .partly = true}});
    EXPECT_EQ(stored("select movimento_no from tbZelmar_Movimentos"), "2") << "number 1 is lost";
    EXPECT_EQ(book.count(u"tbSocios_Acumulados"_s), 0);
    book.refuseNoMore();
    person.put(u"Debito"_s, u"9"_s);
    EXPECT_EQ(shown(u"Debito"_s), u"1"_s) << "is locked";
    person.accelerator(u'O');
    EXPECT_FALSE(person.isShown(Screen));
    EXPECT_EQ(stored("select debito_ac, credito_ac, (select count(*) from tbZelmar_Movimentos) "
                     "from tbSocios_Acumulados"),
              "1|0|1");
}

TEST_F(Reposition, ViewShowsItAndMakesRoomForTheNextButNotForWhatIsTyped) {
    const qint64 key = insert(u"REP"_s);
    openView(key, Screen);
    EXPECT_EQ(shown(u"No_Kor"_s) + u'|' + shown(u"Text4"_s) + u'|' + shown(u"Debito"_s),
              u"100015|Maria da Luz Matos|€ 3,00"_s);
    for (const QString& hidden : {u"Command1"_s, u"Command2"_s, u"Command4"_s})
        EXPECT_FALSE(person.peek(hidden)->isVisible());
    person.fill(u"Debito"_s, u"9"_s);
    typeReposition(u"1"_s, u"2"_s);  // in place of the view
    const auto& entry = forms::DefaultInstance<entry::frmMovimentos>::get();
    const ado::RecordsetPtr attached = entry.Adodc1->Recordset();
    person.expectBox({.text = u"Há um lançamento por terminar."_s, .partly = true});
    general.Registo({}, key);
    EXPECT_EQ(entry.Adodc1->Recordset(), attached) << "nothing makes room for a view refused";
    EXPECT_EQ(shown(u"Credito"_s), u"€ 2,00"_s);
    person.expectBox(
        {.text = u"Há dados por lançar"_s, .answer = core::Answer::Yes, .partly = true});
    person.accelerator(u'C');
    openView(key, Screen);
    EXPECT_EQ(shown(u"Debito"_s), u"€ 3,00"_s);
    person.accelerator(u'S');
    EXPECT_FALSE(person.isShown(Screen));
}

}  // namespace
