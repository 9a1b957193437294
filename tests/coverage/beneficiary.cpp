// SPDX-License-Identifier: MIT
// Who may have a document processed, and the VAT in its value. Today is 15 May 2026.
#include "entry/Beneficiary.h"
#include "boundary/environment/LoginState.h"
#include "entry/DocumentVat.h"
#include "platform/core/Clock.h"
#include "platform/core/Values.h"
#include "tests/coverage/Desk.h"

using namespace Qt::StringLiterals;
using core::Answer;
using core::Icon;

namespace {

class Beneficiary : public Desk {
protected:
    void askStatement(Answer answer) {
        boxes.ask(u"Quer ver o extrato de quotizações deste Associado?"_s, Icon::Exclamation,
                  u"Quotizações"_s, answer);
    }
};

struct Premium {
    const char* name;
    QDate today;
    int ult_ano;  ///< 0: no row
    int ult_mes;
    int total;
    int paid;
    QString box;  ///< empty when nothing is owed
};

class Premiums : public Beneficiary, public ::testing::WithParamInterface<Premium> {};

TEST_P(Premiums, WarnAndInEveryCaseOfferTheStatement) {
    const Premium& premium = GetParam();
    core::setToday(premium.today);
    if (premium.ult_ano)
        book.insert(u"tbQuotas_Socios"_s, {{"socio_id", socio},
                                           {"ult_ano", premium.ult_ano},
                                           {"ult_mes", premium.ult_mes},
                                           {"total_quotas", premium.total},
                                           {"total_pago", premium.paid}});
    if (!premium.box.isEmpty()) boxes.expect(premium.box, Icon::Critical);
    askStatement(Answer::No);
    EXPECT_FALSE(entry::testPremium(socio));
    EXPECT_EQ(Companions::calls(), QStringList());
}

QString arrears(const char* since) {
    return u"Este Associado tem em atrazo o prémio de zelmar (quotizações do Plano de Saúde) desde "
           "%1."_s.arg(QLatin1StringView(since));
}
const QString NeverPaid =
    u"Este Associado ainda não liquidou nenhum prémio de zelmar (quotizações do Plano de Saúde)."_s;
const QString Due =
    u"Este Associado o prémio de zelmar (quotizações do Plano de Saúde) por liquidar."_s;
const QDate May(2026, 5, 15);
const QDate January(2026, 1, 2);
const QDate December(2026, 12, 31);

INSTANTIATE_TEST_SUITE_P(
    Premium, Premiums,
    ::testing::Values(Premium{"NeverPaid", May, 0, 0, 0, 0, NeverPaid},
                      Premium{"PaidThisMonth", May, 2026, 5, 120, 120, {}},
                      Premium{"PaidLastMonth", May, 2026, 4, 120, 120, {}},
                      Premium{"PaidTheMonthBefore", May, 2026, 3, 120, 120, arrears("3/2026")},
                      Premium{"PaidAhead", May, 2026, 12, 120, 120, {}},
                      Premium{"PaidAYearAhead", May, 2027, 5, 120, 120, arrears("5/2027")},
                      Premium{"PaidLastYear", May, 2025, 5, 120, 120, arrears("5/2025")},
                      Premium{"DecemberSeenInJanuary", January, 2025, 12, 9, 9, arrears("12/2025")},
                      Premium{"JanuarySeenInJanuary", January, 2026, 1, 9, 9, {}},
                      Premium{"NovemberSeenInDecember", December, 2026, 11, 9, 9, {}},
                      Premium{"LessPaidThanDue", May, 2026, 4, 120, 119, Due},
                      Premium{"MorePaidThanDue", May, 2026, 5, 120, 121, Due},
                      Premium{"LateAndDue", May, 2026, 2, 120, 0, arrears("2/2026")}),
    [](const auto& at) { return std::string(at.param.name); });

TEST_F(Beneficiary, ThePremiumStatementStaysOpenWithItsOwner) {
    environment::loginState().dtUser = u"ana"_s;
    environment::loginState().dtPassword = u"segredo"_s;
    book.premiumInOrder(socio);
    askStatement(Answer::Yes);
    com::Object statement = entry::testPremium(socio);
    const QStringList opened{
        u"Lumbra"_s, u"Lumbra.Login(ana, segredo)"_s,
        u"Lumbra.appShow(QUO01, 1, , Activos, tbQuotas_Movimentos.socio_id=%1, true, true)"_s.arg(
            socio)};
    EXPECT_TRUE(statement);
    EXPECT_EQ(Companions::calls(), opened);
    statement = {};
    EXPECT_EQ(Companions::calls(), opened + QStringList{u"Lumbra.~"_s});
    environment::loginState() = {};
}

TEST_F(Beneficiary, ABankNumberIsTestedByItsLengthAndTheMemberFileOffered) {
    const auto id = [&] { return QVariant::fromValue(static_cast<qint16>(socio)); };
    const struct {
        QVariant nib;
        QString box;
    } numbers[] = {{{}, u"Este Associado não tem NIB!"_s},
                   {u""_s, u"Este Associado não tem NIB!"_s},
                   {QString(20, u'1'), u"Este Associado tem especificado um NIB INVÁLIDO!"_s},
                   {QString(22, u'1'), u"Este Associado tem especificado um NIB INVÁLIDO!"_s}};
    for (const auto& number : numbers) {
        for (const Answer answer : {Answer::No, Answer::Yes}) {
            Companions::calls().clear();
            boxes.expect(number.box, Icon::Critical);
            boxes.ask(u"Quer abrir a ficha deste Associado para proceder a alterações?"_s,
                      Icon::Question, u"Associados"_s, answer);
            entry::testBankNumber(number.nib, id);
            EXPECT_EQ(Companions::calls(),
                      answer == Answer::No
                          ? QStringList()
                          : QStringList({u"Tiqueta"_s, u"Tiqueta.Login()"_s,
                                         u"Tiqueta.AbrirRegisto(short, %1)"_s.arg(socio),
                                         u"Tiqueta.~"_s}));
        }
    }
    entry::testBankNumber(QString(21, u'x'), id);
}

TEST_F(Beneficiary, OnlyAZeroMeansThatAMemberIsNotEnrolled) {
    for (const QVariant& zelmar : {QVariant(1), QVariant(-1), QVariant(2)}) {
        book.exec(u"update tbSocios set zelmar = %1"_s.arg(zelmar.toInt()));
        EXPECT_TRUE(entry::checkEnrolled(*entry::openMemberByNumber(u"100015"_s)));
    }
    book.exec(u"update tbSocios set zelmar = 0"_s);
    boxes.expect(u"Este Associado não está inscrito no plano de Saúde."_s, Icon::Critical);
    EXPECT_FALSE(entry::checkEnrolled(*entry::openMemberById(socio)));
    EXPECT_TRUE(entry::openMemberByNumber(u"999999"_s)->atEnd());
}

TEST_F(Beneficiary, ThePersonIsChosenInTheMemberFile) {
    EXPECT_EQ(entry::choosePerson(socio).toInt(), 42);
    EXPECT_EQ(Companions::calls(),
              QStringList({u"Tiqueta"_s, u"Tiqueta.Login()"_s,
                           u"Tiqueta.EscolherFamiliar(%1)"_s.arg(socio), u"Tiqueta.~"_s}));
}

struct Refusal {
    const char* text;
    const char* title;
};
constexpr Refusal TooOld{"Este familiar tem mais de 25 anos! Tente indicar outro.", "Familiares"};
constexpr Refusal Waits{
    "Este familiar está dentro do periodo de carência! Não pode ser processado o documento.",
    "Periodo de Carência"};
constexpr Refusal MemberWaits{
    "O Associado está dentro do periodo de carência! Não pode ser processado o documento.",
    "Periodo de Carência"};

struct Candidate {
    const char* name;
    const char* codABC;
    std::optional<int> age;      ///< in days
    std::optional<int> waiting;  ///< last day of the waiting period, in days from today
    const Refusal* refusal = nullptr;
};

class Persons : public Beneficiary, public ::testing::WithParamInterface<Candidate> {
protected:
    static QVariant daysFromToday(std::optional<int> days) {
        return days ? QVariant(core::today().addDays(*days)) : QVariant();
    }
};

// The waiting period of the member himself stands in another table than that of the others.
TEST_P(Persons, AreAdmittedByAgeAndWaitingPeriod) {
    const Candidate& person = GetParam();
    const bool himself = std::string(person.codABC) == "A";
    const QVariant waiting = daysFromToday(person.waiting);
    const QVariant farAway = daysFromToday(100);
    const qint64 member = book.member({.zelmar_data_carencia = himself ? waiting : farAway});
    const qint64 id = book.person(
        {.socio_id = member,
         .codABC = QString::fromLatin1(person.codABC),
         .nome = u"Rita"_s,
         .data_nascimento = daysFromToday(person.age ? std::optional(-*person.age) : std::nullopt),
         .data_carencia = himself ? farAway : waiting});
    if (person.refusal)
        boxes.expect(QString::fromUtf8(person.refusal->text), Icon::Information,
                     QString::fromUtf8(person.refusal->title));
    const auto admitted = entry::admitPerson(id, static_cast<qint32>(member));
    ASSERT_EQ(admitted.has_value(), person.refusal == nullptr);
    if (!admitted) return;
    EXPECT_EQ(admitted->codABC.toString(), QString::fromLatin1(person.codABC));
    EXPECT_EQ(admitted->nome.toString(), u"Rita"_s);
}

INSTANTIATE_TEST_SUITE_P(
    Person, Persons,
    ::testing::Values(Candidate{"AChildOneDayBelowTheLimit", "C1", 9131, {}},
                      Candidate{"AChildAtTheLimit", "C1", 9132, {}, &TooOld},
                      Candidate{"AChildAtTheLimitInSmallLetters", "c2", 9132, {}, &TooOld},
                      Candidate{"AChildWithoutABirthDate", "C", {}, {}, &TooOld},
                      Candidate{"AChildTooOldAndWaiting", "C1", 9132, 5, &TooOld},
                      Candidate{"AChildOnTheLastDayOfWaiting", "C1", 400, 0, &Waits},
                      Candidate{"AChildTheDayAfterWaiting", "C1", 400, -1},
                      Candidate{"ACodeWithBothLettersTooOld", "AC", 9132, {}, &TooOld},
                      Candidate{"ACodeWithBothLettersWaiting", "CA", 400, 0, &Waits},
                      Candidate{"TheMemberHimself", "A", 20000, {}},
                      Candidate{"TheMemberOnTheLastDayOfWaiting", "A", 20000, 0, &MemberWaits},
                      Candidate{"TheMemberTheDayAfterWaiting", "A", 20000, -1},
                      Candidate{"ASpouseOfAnyAge", "B", 30000, {}},
                      Candidate{"ASpouseWithoutABirthDate", "B", {}, {}},
                      Candidate{"ASpouseOnTheLastDayOfWaiting", "B", 30000, 0, &Waits},
                      Candidate{"ASpouseTheDayAfterWaiting", "B", 30000, -1}),
    [](const auto& at) { return std::string(at.param.name); });

TEST_F(Beneficiary, APersonNeedsACodeButNoName) {
    EXPECT_FALSE(entry::admitPerson(book.person({.socio_id = socio, .codABC = {}}), socio));
    const auto nameless = entry::admitPerson(book.person({.socio_id = socio, .nome = {}}), socio);
    EXPECT_TRUE(nameless && !nameless->nome.isValid());
}

// A missing row looks up as empty text, which is neither null nor a day that has passed.
TEST_F(Beneficiary, APersonWhoseRowIsGoneIsRefused) {
    boxes.expect(
        u"Este familiar está dentro do periodo de carência! Não pode ser processado o "
        "documento."_s,
        Icon::Information, u"Periodo de Carência"_s);
    EXPECT_FALSE(entry::admitPerson(99999, socio));
}

TEST_F(Beneficiary, AMemberWhoHasLeftIsRefused) {
    const qint64 id = book.person({.socio_id = socio, .codABC = u"A"_s});
    book.exec(u"delete from tbSocios"_s);
    boxes.expect(
        u"O Associado está dentro do periodo de carência! Não pode ser processado o "
        "documento."_s,
        Icon::Information, u"Periodo de Carência"_s);
    EXPECT_FALSE(entry::admitPerson(id, socio));
}

TEST(DocumentVat, IsTheTaxContainedInTheValueToTheCent) {
    const struct {
        float value;
        double rate;
        double vat;
    } rows[] = {
        {123.0F, 5, 5.86},    // 123 - 117.142857
        {87.35F, 23, 16.33},  // 87.35 - 71.016260
        {100.0F, 100, 50},    // half of the value
        {100.0F, 0.5, 0.5},   // 100 - 99.502488
        {0.25F, 100, 0.12},   // 12.5 cents, to the even neighbour
        {0.75F, 100, 0.38},   // 37.5 cents, likewise
        {-123.0F, 5, -5.86}, {0.0F, 23, 0},
    };
    for (const auto& row : rows)
        EXPECT_DOUBLE_EQ(entry::vatOf(row.value, row.rate), row.vat)
            << row.value << " at " << row.rate;
}

TEST(DocumentVat, OfMoreThanA32BitNumberOfCentsFails) {
    EXPECT_DOUBLE_EQ(entry::vatOf(41943040.0F, 100), 20971520.0);
    EXPECT_EQ(failureOf([] { entry::vatOf(1e9F, 100); }), core::Overflow);
}

}  // namespace
