// SPDX-License-Identifier: MIT
// Who the document is for: the member by number or search, and the person of his family.
#include "platform/com/Component.h"
#include "tests/entry/EntryTest.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

using core::Answer;
using core::Icon;
using forms::BackColor;
using support::Operator;

const Operator::Box NotEnrolled{.text = u"Este Associado não está inscrito no plano de Saúde."_s,
                                .icon = Icon::Critical,
                                .title = u"Zelmars"_s};

class Beneficiary : public EntryTest {
protected:
    Beneficiary() {
        openNew();
        typeMember();
        choosePerson(child);
        EXPECT_EQ(companions.calls, QStringList({u"Tiqueta.Login()"_s,
                                                 u"Tiqueta.EscolherFamiliar(%1)"_s.arg(socio)}));
        companions.calls.clear();
    }

    void expectMember(qint64 id, const char* name, const char* code) {
        EXPECT_EQ(form().Socio_ID, id);
        EXPECT_EQ(form().Command2->isEnabled(), id != 0);
        EXPECT_EQ(form().Text2->Text(), QString::fromUtf8(name));
        EXPECT_EQ(form().Text2->backColor(), id ? BackColor::Window : BackColor::Menu);
        EXPECT_EQ(form().Text3->Text(), QString::fromLatin1(code));
        EXPECT_EQ(pending(u"codABC"_s).toString(), QString::fromLatin1(code));
        EXPECT_EQ(form().Text4->Text().isEmpty(), *code == 0);
        EXPECT_EQ(form().Text4->backColor(), *code ? BackColor::Window : BackColor::Menu);
    }

    void expectFormer() { expectMember(socio, "António Manuel Silva Matos", "C1"); }

    void search(qint64 found) {
        companions.memberFound = found;
        person.accelerator(u'P');
        person.expectNoBoxesLeft();
    }
};

TEST_F(Beneficiary, NumberIsHeldWhenUnknownAndWhoIsNotEnrolledClearsTheMember) {
    const qint64 other = book.member({.no_kor = u"100020"_s, .zelmar = 0});
    person.expectBox({.text = u"Número de Empresa não encontrado!"_s,
                      .icon = Icon::Critical,
                      .title = u"Associados"_s});
    person.fill(u"No_Kor"_s, u"999999"_s);
    EXPECT_TRUE(form().No_Kor->hasFocus());
    expectFormer();
    person.expectBox(NotEnrolled);
    person.fill(u"No_Kor"_s, u"100020"_s);
    EXPECT_EQ(form().No_Kor->Text(), u"100020"_s);
    expectMember(0, "", "");

    typeMember();
    person.expectBox(NotEnrolled);
    search(other);
    EXPECT_EQ(form().No_Kor->Text(), QString()) << "a search wipes the number too";
    expectMember(0, "", "");
}

TEST_F(Beneficiary, TypingResetsTheVatAndKeepsThePersonSearchingTheOtherWayRound) {
    book.premiumInOrder(book.member({.no_kor = u"100077"_s, .nome = u"Rui Sá"_s}));
    const qint64 other = book.value(u"select max(socio_id) from tbSocios"_s).toLongLong();
    person.fill(u"Text6"_s, u"123"_s);
    person.fill(u"Text11"_s, u"5"_s);
    ASSERT_EQ(form().Text10->Text(), u"5,86"_s);
    typeMember(u"100077"_s);
    expectMember(other, "Rui Sá", "C1");
    EXPECT_EQ(form().Text10->Text(), u"0,00"_s);

    person.fill(u"Text11"_s, u"5"_s);
    person.expectBox(
        {.text = u"Quer ver o extrato de quotizações deste Associado?"_s, .answer = Answer::Yes});
    search(socio);
    expectMember(socio, "António Manuel Silva Matos", "");
    EXPECT_EQ(form().No_Kor->Text(), u"100015"_s);
    EXPECT_EQ(form().Text10->Text(), u"5,86"_s);
    EXPECT_EQ(companions.calls.last(),
              u"Lumbra.appShow(\"QUO01\", 1, nothing, \"Activos\", "
              "\"tbQuotas_Movimentos.socio_id=%1\", true, true)"_s.arg(socio));
    EXPECT_EQ(companions.statementsOpen, 1);
    search(0);
    EXPECT_EQ(companions.statementsOpen, 1) << "a search that is given up closes nothing";
}

TEST_F(Beneficiary, ArrearsWarnAndTheQuestionAlwaysFollows) {
    const QString arrears =
        u"Este Associado tem em atrazo o prémio de zelmar (quotizações do Plano de Saúde) desde "_s;
    const QString due =
        u"Este Associado o prémio de zelmar (quotizações do Plano de Saúde) por liquidar."_s;
    // The month and year paid up to, what is paid of 120, and the warning.
    const std::tuple<int, int, int, QString> rows[] = {
        {2, 2026, 120, {}},  // one month's delay is tolerated
        {1, 2026, 120, arrears + u"1/2026."_s},
        {3, 2027, 120, arrears + u"3/2027."_s},
        {2, 2026, 119, due},
    };
    const QString paidUpTo =
        u"update tbQuotas_Socios set total_quotas=120, ult_mes=%1, ult_ano=%2, total_pago=%3"_s;
    for (const auto& [month, year, paid, warning] : rows) {
        book.exec(paidUpTo.arg(month).arg(year).arg(paid));
        if (!warning.isEmpty())
            person.expectBox({.text = warning, .icon = Icon::Critical, .title = u"Zelmars"_s});
        typeMember();
        person.expectNoBoxesLeft();
        EXPECT_EQ(form().Socio_ID, socio);
    }
}

// The days on which waiting and childhood end are a matter of the rule.
TEST_F(Beneficiary, PersonWhoIsRefusedOrNotChosenLeavesTheFormerOne) {
    person.expectBox({.text = u"Este familiar tem mais de 25 anos! Tente indicar outro."_s,
                      .icon = Icon::Information});
    choosePerson(book.person({.socio_id = socio, .codABC = u"C2"_s}));
    person.expectNoBoxesLeft();
    expectFormer();
    choosePerson(0);
    expectFormer();
    EXPECT_TRUE(form().Command2->hasFocus());
    choosePerson(child);
    EXPECT_TRUE(form().Text1->hasFocus());
}

TEST_F(Beneficiary, CompanionsThatAnswerNonsenseOrAreMissingAreSaid) {
    const std::tuple<QString, QChar, Icon> rows[] = {
        {u"Lumbra.General"_s, u'P', Icon::None},
        {u"Tiqueta.General"_s, u'I', Icon::Critical},
    };
    companions.memberFound = companions.personChosen = u"abc"_s;
    for (const auto& [name, key, icon] : rows) {
        for (const QString& text : {QString(), name}) {
            person.expectBox({.text = text, .icon = icon, .partly = true});
            person.accelerator(key);
            person.expectNoBoxesLeft();
            expectFormer();
            com::registerRunning(name, {});
        }
    }
}

}  // namespace

}  // namespace entry
