// SPDX-License-Identifier: MIT
// Who the document is for: the member by number or search, and the person of his family.
#include "platform/com/Component.h"
#include "platform/core/Clock.h"
#include "tests/entry/EntryTest.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

using core::Answer;
using core::Icon;
using forms::BackColor;
using support::Operator;

const QString Question = u"Quer ver o extrato de quotizações deste Associado?"_s;
const Operator::Box NoStatement{.text = Question, .answer = Answer::No};
const Operator::Box NotEnrolled{.text = u"Este Associado não está inscrito no plano de Saúde."_s,
                                .icon = Icon::Critical,
                                .title = u"Zelmars"_s};

class Beneficiary : public EntryTest {
protected:
    Beneficiary() { openNew(); }

    void expectNobody() {
        EXPECT_EQ(form().Socio_ID, 0);
        EXPECT_FALSE(form().Familia_ID.isValid());
        EXPECT_FALSE(form().Command2->isEnabled());
        for (const forms::TextBox* box : {form().Text2, form().Text3, form().Text4}) {
            EXPECT_EQ(box->Text(), QString());
            EXPECT_EQ(box->backColor(), BackColor::Menu);
        }
    }

    void search(qint64 found) {
        companions.memberFound = static_cast<qint32>(found);
        person.accelerator(u'P');
    }
};

TEST_F(Beneficiary, TypedNumberChoosesTheMember) {
    typeMember();
    EXPECT_EQ(form().Socio_ID, socio);
    EXPECT_EQ(form().Text2->Text(), u"António Manuel Silva Matos"_s);
    for (const forms::TextBox* box : {form().Text2, form().Text3, form().Text4})
        EXPECT_EQ(box->backColor(), BackColor::Window);
    EXPECT_TRUE(form().Command2->isEnabled());
    EXPECT_EQ(form().Text11->Text(), u"00,00"_s);
    EXPECT_EQ(form().Text10->Text(), u"0,00"_s);
    EXPECT_EQ(companions.calls, QStringList());
}

TEST_F(Beneficiary, EmptiedNumberClearsTheMemberAndCanBeLeft) {
    typeMember();
    choosePerson(spouse);
    ASSERT_EQ(form().Text3->Text(), u"B"_s);
    person.fill(u"No_Kor"_s, QString());
    EXPECT_FALSE(form().No_Kor->hasFocus());
    expectNobody();
}

TEST_F(Beneficiary, UnknownNumberHoldsTheFocusAndClearsNothing) {
    typeMember();
    person.expectBox({.text = u"Número de Empresa não encontrado!"_s,
                      .icon = Icon::Critical,
                      .title = u"Associados"_s});
    person.fill(u"No_Kor"_s, u"999999"_s);
    EXPECT_TRUE(form().No_Kor->hasFocus());
    EXPECT_EQ(form().Socio_ID, socio);
    EXPECT_EQ(form().Text2->Text(), u"António Manuel Silva Matos"_s);
}

TEST_F(Beneficiary, MemberOutsideThePlanIsClearedInBothWays) {
    const qint64 outside = book.member({.no_kor = u"100020"_s, .zelmar = 0});
    typeMember();
    person.expectBox(NotEnrolled);
    person.fill(u"No_Kor"_s, u"100020"_s);
    EXPECT_FALSE(form().No_Kor->hasFocus());
    EXPECT_EQ(form().No_Kor->Text(), u"100020"_s);
    expectNobody();

    typeMember();
    person.expectBox(NotEnrolled);
    search(outside);
    EXPECT_EQ(form().No_Kor->Text(), QString());
    expectNobody();
}

TEST_F(Beneficiary, TypingResetsTheVatAndKeepsThePersonSearchingTheOtherWayRound) {
    const qint64 other = book.member({.no_kor = u"100077"_s, .nome = u"Rui Sá"_s});
    book.premiumInOrder(other);
    typeMember();
    choosePerson(child);
    person.fill(u"Text6"_s, u"123"_s);
    person.fill(u"Text11"_s, u"5"_s);
    ASSERT_EQ(form().Text10->Text(), u"5,86"_s);

    typeMember(u"100077"_s);
    EXPECT_EQ(form().Text2->Text(), u"Rui Sá"_s);
    EXPECT_EQ(form().Text3->Text(), u"C1"_s);
    EXPECT_EQ(form().Text4->Text(), u"Inês Matos"_s);
    EXPECT_EQ(form().Text10->Text(), u"0,00"_s);

    person.fill(u"Text11"_s, u"5"_s);
    person.expectBox(NoStatement);
    search(socio);
    EXPECT_EQ(form().Socio_ID, socio);
    EXPECT_EQ(form().No_Kor->Text(), u"100015"_s);
    EXPECT_EQ(form().Text2->Text(), u"António Manuel Silva Matos"_s);
    EXPECT_EQ(form().Text2->backColor(), BackColor::Window);
    EXPECT_EQ(form().Text10->Text(), u"5,86"_s);
    EXPECT_FALSE(form().Familia_ID.isValid());
    for (const forms::TextBox* box : {form().Text3, form().Text4}) {
        EXPECT_EQ(box->Text(), QString());
        EXPECT_EQ(box->backColor(), BackColor::Menu);
    }
    EXPECT_TRUE(form().Command2->isEnabled());
}

TEST_F(Beneficiary, SearchGivenUpLeavesTheScreenAndOneWithoutMemberClearsIt) {
    typeMember();
    search(0);
    EXPECT_EQ(companions.calls, QStringList({u"Lumbra.Login(\"zelmars\", \"\")"_s,
                                             u"Lumbra.appShow(\"SOC01\", false)"_s}));
    EXPECT_EQ(form().Socio_ID, socio);

    person.expectBox({.text = u"Este Associado não se encontra na tabela de activos."_s,
                      .icon = Icon::Critical,
                      .title = u"Zelmars"_s});
    search(31000);
    EXPECT_EQ(form().No_Kor->Text(), QString());
    expectNobody();
}

TEST_F(Beneficiary, FailingSearchIsAPlainBoxAndClearsNothing) {
    typeMember();
    companions.failing = u"Lumbra.appShow"_s;
    person.expectBox({.text = CompanionFailure.toString(), .icon = Icon::None});
    search(socio);
    companions.failing.clear();

    for (const QVariant& nonsense : {QVariant(), QVariant(u"abc"_s)}) {
        person.expectBox({.icon = Icon::None, .partly = true});
        companions.memberFound = nonsense;
        person.accelerator(u'P');
    }

    com::registerRunning(u"Lumbra.General"_s, {});
    person.expectBox({.text = u"Lumbra.General"_s, .icon = Icon::None, .partly = true});
    person.accelerator(u'P');
    EXPECT_EQ(form().Socio_ID, socio);
    EXPECT_EQ(form().No_Kor->Text(), u"100015"_s);
}

TEST_F(Beneficiary, ArrearsWarnAndTheQuestionAlwaysFollows) {
    const QString arrears =
        u"Este Associado tem em atrazo o prémio de zelmar (quotizações do Plano de Saúde) desde "_s;
    const QString due =
        u"Este Associado o prémio de zelmar (quotizações do Plano de Saúde) por liquidar."_s;
    struct {
        int month, year, due, paid;
        QString warning;
    } const rows[] = {
        {3, 2026, 120, 120, {}},
        {2, 2026, 120, 120, {}},  // one month's delay is tolerated
        {1, 2026, 120, 120, arrears + u"1/2026."_s},
        {3, 2025, 120, 120, arrears + u"3/2025."_s},
        {3, 2027, 120, 120, arrears + u"3/2027."_s},
        {2, 2026, 120, 119, due},
        {1, 2026, 120, 119, arrears + u"1/2026."_s},
    };
    for (const auto& row : rows) {
        book.exec(
            u"update tbQuotas_Socios set ult_mes=%1, ult_ano=%2, total_quotas=%3, "
            "total_pago=%4"_s.arg(row.month)
                .arg(row.year)
                .arg(row.due)
                .arg(row.paid));
        if (!row.warning.isEmpty())
            person.expectBox({.text = row.warning, .icon = Icon::Critical, .title = u"Zelmars"_s});
        typeMember();
        person.expectNoBoxesLeft();
        EXPECT_EQ(form().Socio_ID, socio);
    }
    core::setToday(QDate(2027, 1, 10));
    book.exec(u"update tbQuotas_Socios set ult_mes=12, ult_ano=2026"_s);
    person.expectBox({.text = arrears + u"12/2026."_s});
    typeMember();
    book.exec(u"delete from tbQuotas_Socios"_s);
    person.expectBox({.text = u"Este Associado ainda não liquidou nenhum prémio de zelmar "
                              "(quotizações do Plano de Saúde)."_s,
                      .icon = Icon::Critical});
    typeMember();
    EXPECT_EQ(form().Socio_ID, socio);
}

TEST_F(Beneficiary, PremiumStatementStaysOpenUntilTheNextSearchOrTheEnd) {
    person.expectBox({.text = Question, .answer = Answer::Yes});
    person.fill(u"No_Kor"_s, u"100015"_s);
    EXPECT_EQ(companions.calls,
              QStringList({u"Lumbra.Login(\"zelmars\", \"\")"_s,
                           u"Lumbra.appShow(\"QUO01\", 1, nothing, \"Activos\", "
                           "\"tbQuotas_Movimentos.socio_id=%1\", true, true)"_s.arg(socio)}));
    EXPECT_EQ(companions.statementsOpen, 1);

    person.expectBox({.text = Question, .answer = Answer::Yes});
    search(socio);
    EXPECT_EQ(companions.statementsOpen, 1);

    form().Unload();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    EXPECT_EQ(companions.statementsOpen, 0);
}

TEST_F(Beneficiary, FaultyBankNumberWarnsAndOffersTheFile) {
    const QString question = u"Quer abrir a ficha deste Associado para proceder a alterações?"_s;
    struct {
        const char* nib;
        QString warning;
    } const rows[] = {
        {"null", u"Este Associado não tem NIB!"_s},
        {"''", u"Este Associado não tem NIB!"_s},
        {"'00130000000000000018'", u"Este Associado tem especificado um NIB INVÁLIDO!"_s},
        {"'0013000000000000001866'", u"Este Associado tem especificado um NIB INVÁLIDO!"_s},
    };
    for (const auto& row : rows) {
        book.exec(u"update tbSocios set nib="_s + QString::fromLatin1(row.nib));
        person.expectBox(NoStatement);
        person.expectBox({.text = row.warning, .icon = Icon::Critical, .title = u"Zelmars"_s});
        person.expectBox({.text = question,
                          .answer = Answer::No,
                          .icon = Icon::Question,
                          .title = u"Associados"_s});
        person.fill(u"No_Kor"_s, u"100015"_s);
        person.expectNoBoxesLeft();
        EXPECT_EQ(form().Socio_ID, socio);
    }
    EXPECT_EQ(companions.calls, QStringList());

    const auto wantTheFile = [&] {
        person.expectBox(NoStatement);
        person.expectBox({.text = u"Este Associado tem especificado um NIB INVÁLIDO!"_s});
        person.expectBox({.text = question, .answer = Answer::Yes});
    };
    wantTheFile();
    person.fill(u"No_Kor"_s, u"100015"_s);
    wantTheFile();
    search(socio);
    const QString open = u"Tiqueta.AbrirRegisto(%1"_s.arg(socio);
    EXPECT_EQ(companions.calls.filter(u"Tiqueta"_s),
              QStringList({u"Tiqueta.Login()"_s, open + u" of 16 bits)"_s, u"Tiqueta.Login()"_s,
                           open + u")"_s}));
}

TEST_F(Beneficiary, NumberBeyond16BitsSaysSoAndIsChosenWithoutTheFile) {
    book.insert(u"tbSocios"_s,
                {{"socio_id", 40000}, {"no_kor", u"100099"_s}, {"nome", u"Ana"_s}, {"zelmar", 1}});
    const auto upToTheFile = [&](Answer answer) {
        person.expectBox({.text = u"ainda não liquidou"_s, .partly = true});
        person.expectBox(NoStatement);
        person.expectBox({.text = u"Este Associado não tem NIB!"_s});
        person.expectBox({.text = u"Quer abrir a ficha"_s, .answer = answer, .partly = true});
    };
    upToTheFile(Answer::Yes);
    person.expectBox({.text = u"40000"_s, .icon = Icon::Critical, .partly = true});
    person.fill(u"No_Kor"_s, u"100099"_s);
    EXPECT_TRUE(form().No_Kor->hasFocus());
    EXPECT_EQ(form().Socio_ID, 0);

    upToTheFile(Answer::No);
    person.tab();
    EXPECT_EQ(form().Socio_ID, 40000);
}

// --- The person

struct PersonCase {
    const char* what;
    const char* codABC;
    QDate birth;
    QDate waiting;        ///< of the family row
    QDate memberWaiting;  ///< of the member
    QString refusal;      ///< empty when accepted
};

TEST_F(Beneficiary, PersonIsAdmittedByWaitingPeriodAndAge) {
    const QString old = u"Este familiar tem mais de 25 anos! Tente indicar outro."_s;
    const QString waits =
        u"Este familiar está dentro do periodo de carência! Não pode ser processado o documento."_s;
    const QString memberWaits =
        u"O Associado está dentro do periodo de carência! Não pode ser processado o documento."_s;
    const QDate today(2026, 3, 15);
    const QDate yesterday(2026, 3, 14);
    const QDate young(2001, 3, 15);  // 9131 days old today
    const PersonCase cases[] = {
        {"a child one day under the limit", "C1", young, {}, {}, {}},
        {"a child of 9132 days", "C1", QDate(2001, 3, 14), {}, {}, old},
        {"a child without a birth date", "C2", {}, {}, {}, old},
        {"a child's letter in lower case", "c1", {}, {}, {}, old},
        {"both letters", "AC", {}, {}, {}, old},
        {"an old child in waiting", "C1", QDate(1990, 1, 1), today, {}, old},
        {"a child on the last day of waiting", "C1", young, today, {}, waits},
        {"a child after waiting", "C1", young, yesterday, {}, {}},
        {"the member on his last day", "A", {}, {}, today, memberWaits},
        {"the member after waiting", "A", {}, today, yesterday, {}},
        {"a relative on the last day", "B", {}, today, {}, waits},
        {"a relative of any age after waiting", "D1", QDate(1930, 1, 1), yesterday, today, {}},
    };
    typeMember();
    for (const PersonCase& row : cases) {
        SCOPED_TRACE(row.what);
        const QString code = QString::fromLatin1(row.codABC);
        const QString before = form().Text3->Text();
        const auto orNull = [](QDate day) { return day.isValid() ? QVariant(day) : QVariant(); };
        const qint64 id = book.person({.socio_id = socio,
                                       .codABC = code,
                                       .nome = u"Fulano "_s + code,
                                       .data_nascimento = orNull(row.birth),
                                       .data_carencia = orNull(row.waiting)});
        book.exec(row.memberWaiting.isValid()
                      ? u"update tbSocios set zelmar_data_carencia = '%1 00:00:00'"_s.arg(
                            row.memberWaiting.toString(Qt::ISODate))
                      : u"update tbSocios set zelmar_data_carencia = null"_s);
        if (!row.refusal.isEmpty())
            person.expectBox(
                {.text = row.refusal,
                 .icon = Icon::Information,
                 .title = row.refusal == old ? u"Familiares"_s : u"Periodo de Carência"_s});
        choosePerson(id);
        person.expectNoBoxesLeft();
        EXPECT_EQ(form().Familia_ID.toLongLong(), id);
        EXPECT_EQ(form().Text3->Text(), row.refusal.isEmpty() ? code : before);
        EXPECT_EQ(pending(u"codABC"_s).toString(), form().Text3->Text());
        if (row.refusal.isEmpty()) {
            EXPECT_EQ(form().Text4->Text(), u"Fulano "_s + code);
        }
    }
    EXPECT_EQ(companions.calls.first(2),
              QStringList({u"Tiqueta.Login()"_s, u"Tiqueta.EscolherFamiliar(%1)"_s.arg(socio)}));
}

TEST_F(Beneficiary, NobodyChosenAndFaultyRowsKeepTheFields) {
    typeMember();
    choosePerson(spouse);
    choosePerson(0);
    EXPECT_EQ(form().Familia_ID.toInt(), 0);
    EXPECT_EQ(form().Text3->Text(), u"B"_s);
    choosePerson(book.person({.socio_id = socio, .codABC = QVariant()}));
    EXPECT_EQ(form().Text3->Text(), u"B"_s);
    choosePerson(book.person({.socio_id = socio, .codABC = u"H"_s, .nome = QVariant()}));
    EXPECT_EQ(form().Text3->Text(), u"H"_s);
    EXPECT_EQ(form().Text4->Text(), u"Maria da Luz Matos"_s);
}

TEST_F(Beneficiary, NonsenseFromTheMemberFileIsABoxAndTheScreenStays) {
    typeMember();
    choosePerson(spouse);
    for (const QVariant& nonsense : {QVariant(), QVariant(u"abc"_s)}) {
        person.expectBox({.icon = Icon::Critical, .partly = true});
        companions.personChosen = nonsense;
        person.accelerator(u'I');
    }
    companions.failing = u"Tiqueta.EscolherFamiliar"_s;
    person.expectBox({.text = CompanionFailure.toString(), .icon = Icon::Critical});
    choosePerson(child);
    com::registerRunning(u"Tiqueta.General"_s, {});
    person.expectBox({.text = u"Tiqueta.General"_s, .icon = Icon::Critical, .partly = true});
    choosePerson(child);
    EXPECT_EQ(form().Familia_ID, QVariant(0));
    EXPECT_EQ(form().Text3->Text(), u"B"_s);
    EXPECT_EQ(form().Socio_ID, socio);
    EXPECT_TRUE(form().isVisible());
}

}  // namespace

}  // namespace entry
