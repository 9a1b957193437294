// SPDX-License-Identifier: MIT
// Money that a member pays in: at the screen, to the stored rows.
#include "entry/frmMovimentos.h"
#include "receipts/frmRecebimento.h"
#include "tests/receipts/AccountTest.h"

using namespace Qt::StringLiterals;
using core::Icon;

namespace {

const QString Screen = u"frmRecebimento"_s;

class Receipt : public AccountTest {
protected:
    void openNew() { open(&General::Recebimento, Screen); }
    void typeReceipt(const QString& amount) {
        person.fill(u"No_Kor"_s, u"100015"_s);
        person.fill(u"Credito"_s, amount);
    }
    void annul(const QList<support::Operator::Box>& boxes = {}) {
        press(u'A', u"Deseja anular este registo?"_s, u"Anular Recebimento"_s, boxes);
    }
    std::string movements(const QString& suffix = {}) {
        return book
            .text(
                u"select movimento_no, tipo, modo_pagamento, cheque, data, codABC, doc_valor, "
                "credito, debito, descrit, created_by from tbZelmar_Movimentos%1 "
                "order by movimento_id"_s.arg(suffix))
            .toStdString();
    }
};

TEST_F(Receipt, IsPostedByKeysAndAddsItsCreditToTheAccountLevelRowAlone) {
    book.exec(u"update tbSocios set zelmar = 0"_s);  // a number that is typed is not tested for it
    accumulated(u"A"_s, rubric, 12);
    openNew();
    EXPECT_EQ(shown(u"Text3"_s), u"15-05-2026"_s);
    EXPECT_EQ(person.find<forms::DataCombo>(u"DataCombo3"_s)->Text(), u"CHQ - Cheque"_s);
    person.type(u"100015"_s);
    person.tab();
    EXPECT_EQ(shown(u"Text2"_s), u"António Manuel Silva Matos"_s);
    for (const QString& typed : {u""_s, u""_s, u"1234,5"_s, u""_s, u"500"_s}) {
        person.type(typed);
        person.tab();
    }
    person.type(u"entregue"_s);
    person.enter();  // a new line, not the default button
    person.type(u"em mão"_s);
    postAnd();
    EXPECT_FALSE(person.isShown(Screen));
    EXPECT_EQ(movements(),
              "1|PAG|CHQ|500|2026-05-15 00:00:00|NULL|0|1234.5|0|entregue\nem mão|NULL");
    const std::string others = totals().substr(0, totals().find('\n'));
    EXPECT_EQ(totals(), others + "\n2|1|NULL|NULL|0|0|1234.5|NULL");
    // A row found with null sums counts from 0, and a negative amount lowers it.
    book.exec(u"update tbSocios_Acumulados set credito_ac = null where rubrica_id_main = 0"_s);
    openNew();
    typeReceipt(u"(0,5)"_s);
    postAnd();
    EXPECT_EQ(totals(), "3" + others.substr(1) + "\n3|1|NULL|NULL|0|0|-0.5|NULL");
}

TEST_F(Receipt, AsksOnceAboutEachDateAndAmountThatMayBeASlip) {
    const auto slip = [&](const QString& text, core::Answer answer) {
        return support::Operator::Box{
            .text = text, .answer = answer, .icon = Icon::Question, .title = title};
    };
    const QString day = u"A data do registo é 14-05-2021. Está certa?"_s;
    const QString value = u"O valor a creditar é € 1.000.000,01. Está certo?"_s;
    openNew();
    typeReceipt(u"1000000,01"_s);
    person.fill(u"Text3"_s, u"14-05-2021"_s);
    postAnd({slip(day, core::Answer::No)});
    postAnd({slip(day, core::Answer::Yes), slip(value, core::Answer::No)});
    EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s), 0);
    // Usual ones, up to the limits, are not asked about.
    person.fill(u"Text3"_s, u"15-05-2027"_s);
    postAnd({slip(value, core::Answer::No)});
    person.fill(u"Text3"_s, u"14-05-2021"_s);
    postAnd({slip(value, core::Answer::Yes)});
    EXPECT_EQ(stored("select data, credito from tbZelmar_Movimentos"),
              "2021-05-14 00:00:00|1000000.01");
    openNew();
    typeReceipt(u"1000000"_s);
    person.fill(u"Text3"_s, u"15-05-2021"_s);
    postAnd();
}

TEST_F(Receipt, TakesOnlyTheMemberWhoseNumberIsTypedWithoutTheBlanksAround) {
    openNew();
    expectHeld(u"No_Kor"_s, u"' or '1'='1"_s, u"Número KOR não encontrado!"_s);
    person.fill(u"No_Kor"_s, u"  100015 "_s);
    EXPECT_EQ(shown(u"Text2"_s), u"António Manuel Silva Matos"_s);
}

TEST_F(Receipt, RefusesWhatIsMissingOrWrongAndKeepsWhatWasTyped) {
    openNew();
    typeReceipt(u"10"_s);
    EXPECT_FALSE(isGrey(u"Text3"_s));
    const std::tuple<QString, QString, QString> missing[] = {
        {u"DataCombo3"_s, u"CHQ"_s, u"Tem de indicar um modo de pagamento!"_s},
        {u"No_Kor"_s, u"100015"_s, u"Tem de indicar um Sócio!"_s},
        {u"Credito"_s, u"10"_s, u"Tem de indicar um valor para o crédito!"_s},
        {u"Text3"_s, u"15-05-2026"_s, u"Tem de introduzir a data do registo."_s},
    };
    for (const auto& [field, text, box] : missing) {
        person.fill(field, {});
        postAnd({{.text = box, .icon = Icon::Information, .title = title}});
        EXPECT_TRUE(person.find(field)->hasFocus());
        person.fill(field, text);
    }
    EXPECT_TRUE(isGrey(u"Text3"_s)) << "a wiped number turns the date grey, for good";
    person.fill(u"Credito"_s, u"0"_s);
    postAnd({{.text = u"Tem de indicar um valor diferente de 0(zero) para o crédito !"_s,
              .icon = Icon::Information}});
    for (const QString& text : {u"abc"_s, u"1,2,3"_s, u"99999999999999999999"_s}) {
        expectHeld(u"Credito"_s, text, text);
        person.fill(u"Credito"_s, u"10"_s);
    }
    expectHeld(u"Text4"_s, u"cheque 7"_s, u"cheque 7"_s);
    person.fill(u"Text4"_s, u"7"_s);
    expectHeld(u"No_Kor"_s, u"1000'15"_s, {});
    expectHeld(u"No_Kor"_s, u"100099"_s, u"Número KOR não encontrado!"_s);
    EXPECT_TRUE(isGrey(u"Text2"_s));
    EXPECT_EQ(shown(u"Text2"_s), QString());
    person.fill(u"No_Kor"_s, u"100015"_s);
    postAnd();
    EXPECT_EQ(movements(), "1|PAG|CHQ|7|2026-05-15 00:00:00|NULL|0|10|0|NULL|NULL");
}

TEST_F(Receipt, SearchTakesEnrolledActiveMembersAndIsSilentWhenItFails) {
    const qint64 other = book.member({.no_kor = u"100023"_s, .nome = u"Rui Sá"_s, .zelmar = 0});
    const auto search = [&](qint64 member) {
        FakeSearch::member = member;
        person.accelerator(u'P');
        return shown(u"No_Kor"_s) + u' ' + shown(u"Text2"_s);
    };
    openNew();
    EXPECT_EQ(search(socio), u"100015 António Manuel Silva Matos"_s);
    EXPECT_EQ(search(0), u"100015 António Manuel Silva Matos"_s);
    FakeSearch::failure = u"sem ficha"_s;
    EXPECT_EQ(search(socio), u"100015 António Manuel Silva Matos"_s);
    FakeSearch::failure.clear();
    expectBox(u"Este Associado não está inscrito no plano de Saúde."_s, Icon::Critical);
    EXPECT_EQ(search(other), u" "_s);
    expectBox(u"Este Associado não se encontra na tabela de activos."_s, Icon::Critical);
    EXPECT_EQ(search(9999), u" "_s);
    EXPECT_TRUE(isGrey(u"Text2"_s));
    book.exec(u"alter table tbSocios rename nome to apelido"_s);
    EXPECT_EQ(search(socio), u" "_s);
    EXPECT_EQ(forms::DefaultInstance<receipts::frmRecebimento>::get().Socio_ID, 0) << "all or none";
}

TEST_F(Receipt, AnnulmentTakesFromTheFirstAccumulatorRowOfTheMember) {
    accumulated(u"A"_s, rubric, 12);
    book.insert(u"tbSocios_Acumulados"_s,
                {{"socio_id", socio}, {"rubrica_id_main", 0}, {"credito_ac", 40.25}});
    const qint64 key = insert(u"PAG"_s);
    openView(key, Screen);
    const auto& entry = forms::DefaultInstance<entry::frmMovimentos>::get();
    EXPECT_EQ(entry.Adodc1->Recordset(),
              forms::DefaultInstance<receipts::frmRecebimento>::get().Adodc1->Recordset());
    EXPECT_FALSE(entry.isVisible());
    for (const QString& field :
         {u"No_Kor"_s, u"Text2"_s, u"Text3"_s, u"Text4"_s, u"Text8"_s, u"Credito"_s})
        EXPECT_TRUE(person.find<forms::TextBox>(field)->isReadOnly()) << field.toStdString();
    EXPECT_EQ(shown(u"Text2"_s) + u'|' + shown(u"Credito"_s) + u'|' + shown(u"Text4"_s),
              u"António Manuel Silva Matos|€ 40,25|77"_s);
    ASSERT_TRUE(general.Login());  // reopens the connections beneath the screen
    annul();
    EXPECT_FALSE(person.isShown(Screen));
    EXPECT_EQ(movements(),
              "31|ANL|ANL|77|2026-02-01 00:00:00|B|NULL|40.25|3|acerto|NULL\n"
              "1|COR|NULL|NULL|2026-05-15 00:00:00|NULL|NULL|-40.25|0|NULL|NULL");
    EXPECT_EQ(stored("select debito_ac, credito_ac from tbSocios_Acumulados order by 2"),
              "9|-28.25\nNULL|40.25");
    general.Registo({}, key);
    EXPECT_FALSE(person.isShown(Screen)) << "an annulled receipt opens no more";
}

TEST_F(Receipt, AnnulmentForAMemberWhoHasLeftAddsARowWithNullSums) {
    openView(insert(u"PAG"_s, u"_Inactivos"_s), Screen);
    book.exec(u"delete from tbZelmar_Movimentos_Inactivos"_s);
    annul({{.text = u"Não foi possível anular este registo"_s,
            .icon = Icon::Critical,
            .title = title}});
    EXPECT_EQ(movements(u"_Inactivos"_s),
              "1|COR|NULL|NULL|2026-05-15 00:00:00|NULL|NULL|-40.25|0|NULL|NULL");
    EXPECT_EQ(totals(u"_Inactivos"_s), "2|NULL|NULL|NULL|NULL|NULL|NULL|NULL");
    EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s) + book.count(u"tbSocios_Acumulados"_s), 0);
}

// Each write can fail. The screen stays, and the next press does what is missing: nobody types the
// receipt again, or corrects it twice.
TEST_F(Receipt, FailingWriteIsToldAndTheNextPressDoesOnlyWhatIsMissing) {
    const struct {
        char key;
        const char* write;
        const char* says;
        const char* rows;  // next number, types, greatest number, accumulators
    } presses[] = {
        {'O', "update on tbContadores", "disco cheio", "1|NULL|NULL|NULL|0"},
        {'O', "insert on tbZelmar_Movimentos", "disco cheio", "2|NULL|NULL|NULL|0"},
        {'O', "insert on tbSocios_Acumulados", "nº 2 está registado, mas falta", "3|PAG|PAG|2|0"},
        {'O', "insert on tbSocios_Acumulados", "disco cheio", "3|PAG|PAG|2|0"},
        {'O', nullptr, nullptr, "3|PAG|PAG|2|1"},
        {'A', "update on tbZelmar_Movimentos", "disco cheio", "3|PAG|PAG|2|1"},
        {'A', "update on tbContadores", "nº 2 está marcado como anulado", "3|ANL|ANL|2|1"},
        {'A', "insert on tbZelmar_Movimentos", "disco cheio", "4|ANL|ANL|2|1"},
        {'A', "update on tbSocios_Acumulados", "corrigido com o nº 4, mas falta", "5|ANL|COR|4|1"},
        {'A', nullptr, nullptr, "5|ANL|COR|4|1"},
    };
    openNew();
    typeReceipt(u"10"_s);
    bool isRegistered = false;
    for (const auto& [key, write, says, rows] : presses) {
        SCOPED_TRACE(std::string(1, key) + ' ' + rows);
        if (!person.isShown(Screen)) {
            openView(book.value(u"select movimento_id from tbZelmar_Movimentos"_s).toInt(), Screen);
            isRegistered = false;
        }
        if (write) book.refuse(QString::fromLatin1(write), u"disco cheio"_s);
        QList<support::Operator::Box> boxes;
        if (says)
            boxes.append({.text = QString::fromUtf8(says), .icon = Icon::Critical, .partly = true});
        if (isRegistered) {  // nothing is asked again
            for (const auto& box : boxes) person.expectBox(box);
            person.accelerator(QLatin1Char(key));
            person.expectNoBoxesLeft();
        } else {
            key == 'O' ? postAnd(boxes) : annul(boxes);
        }
        if (write) book.refuseNoMore();
        isRegistered = isRegistered || (says && QByteArrayView(says).contains("nº 2 "));
        EXPECT_EQ(person.isShown(Screen), says != nullptr);
        EXPECT_EQ(
            stored("select zelmars, min(tipo), max(tipo), max(movimento_no), (select count(*) "
                   "from tbSocios_Acumulados) from tbContadores left join "
                   "tbZelmar_Movimentos on true group by 1"),
            rows);
    }
    EXPECT_EQ(stored("select credito_ac from tbSocios_Acumulados"), "0");
}

}  // namespace
