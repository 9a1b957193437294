// SPDX-License-Identifier: MIT
// The limits of a rubric, each for the member and for a relative, on a document and on a hospital
// bill.
#include "platform/core/Values.h"
#include "tests/coverage/Desk.h"

using namespace Qt::StringLiterals;

namespace {

enum class Person { Member, Relative };
enum class Kind { Document, HospitalBill };

std::string nameOf(Person person, Kind kind) {
    return std::string(person == Person::Member ? "ForTheMember" : "ForARelative") +
           (kind == Kind::Document ? "OnADocument" : "OnAHospitalBill");
}

Document documentOf(Person person, Kind kind, qint64 rubric, int value) {
    return {.rubrica_id = rubric,
            .codABC = person == Person::Member ? u"A"_s : u"B"_s,
            .doc_valor = value,
            .hospital = kind == Kind::HospitalBill,
            .incidencia = value};
}

/// A ceiling and what of it is used up when the member's credits are 1 on the rubric and 2 on its
/// sister rubric, those of the relative 4 and 8, those of another relative 16 and 32.
struct Ceiling {
    const char* name;
    const char* ofMember;  ///< its column; the one of a relative where it does not bind a member
    const char* ofRelative;
    bool ofGroup;  ///< on the main rubric
    int usedByMember;
    int usedByRelative;
    bool bindsMember = true;
    bool hasFloor = true;
};

constexpr Ceiling OwnLimit{"OwnLimit", "socio", "familiar", false, 1, 4};
constexpr Ceiling GroupHousehold{"GroupHousehold", "agregado", "agregado", true, 63, 63};
const Ceiling Ceilings[] = {
    OwnLimit,
    GroupHousehold,
    {"Household", "agregado", "agregado", false, 21, 21},
    {"Relatives", "total_familia", "total_familia", false, 20, 20, false},
    {"GroupPerson", "socio", "familiar", true, 3, 12},
    {"GroupRelatives", "total_familia", "total_familia", true, 60, 60, false},
    {"MaximumPerDocument", "socio_max_lan", "familiar_max_lan", false, 0, 0, true, false},
};

/// What the ceiling under test leaves, while another one leaves 70.
struct Outcome {
    const char* name;
    int left;
    int expected;
};
constexpr Outcome Outcomes[] = {{"Wins", 50, 50}, {"Loses", 90, 70}, {"IsOverdrawn", -1, 0}};

using CeilingCase = std::tuple<Ceiling, Outcome, Person, Kind>;
class LowestRemainder : public Desk, public ::testing::WithParamInterface<CeilingCase> {
protected:
    LowestRemainder() {
        accumulated(u"A"_s, rubric, 1);
        accumulated(u"A"_s, sister, 2);
        accumulated(u"B"_s, rubric, 4);
        accumulated(u"B"_s, sister, 8);
        accumulated(u"C1"_s, rubric, 16);
        accumulated(u"C1"_s, sister, 32);
        // Neither another group nor another member counts.
        accumulated(u"A"_s, book.childRubric({}), 100000);
        accumulated(u"B"_s, book.childRubric({}), 100000);
        book.exec(
            u"insert into tbSocios_Acumulados select socio_id + 1, codABC, rubrica_id, "
            "rubrica_id_main, 90000, 90000, 9 from tbSocios_Acumulados"_s);
    }
    /// Lets a ceiling leave so much, in euros.
    void leave(const Ceiling& ceiling, Person person, int left) {
        const bool ofMember = person == Person::Member;
        setRubric(ceiling.ofGroup ? group : rubric,
                  ofMember ? ceiling.ofMember : ceiling.ofRelative,
                  left + (ofMember ? ceiling.usedByMember : ceiling.usedByRelative));
    }

    const qint64 group = book.rubric({});
    const qint64 rubric = book.childRubric({.rubrica_id_main = group});
    const qint64 sister = book.childRubric({.rubrica_id_main = group});
};

TEST_P(LowestRemainder, BindsTheDocument) {
    const auto& [ceiling, outcome, person, kind] = GetParam();
    leave(std::string(ceiling.name) == OwnLimit.name ? GroupHousehold : OwnLimit, person, 70);
    leave(ceiling, person, outcome.left);
    int expected = outcome.expected;
    if (!ceiling.hasFloor && outcome.left < 0) expected = outcome.left;
    if (!ceiling.bindsMember && person == Person::Member) expected = 70;

    const coverage::Entry entry = enter(documentOf(person, kind, rubric, 1000));
    tryOut(entry);
    const std::string amount = std::to_string(expected);
    EXPECT_EQ(kept(entry, "comparticipacao"), "800");
    EXPECT_EQ(kept(entry, "saldo_plafond"), amount);
    EXPECT_EQ(kept(entry, "liquido"), amount);
    EXPECT_EQ(kept(entry, "credito"), amount);
    EXPECT_EQ(kept(entry, "debito"), kind == Kind::HospitalBill ? "1000"
                                     : expected < 0             ? "0"
                                                                : amount);
    EXPECT_EQ(FakeVorlane::steps(), 22);
}

std::string ceilingName(const ::testing::TestParamInfo<CeilingCase>& at) {
    const auto& [ceiling, outcome, person, kind] = at.param;
    return std::string(ceiling.name) + outcome.name + nameOf(person, kind);
}
INSTANTIATE_TEST_SUITE_P(Ceilings, LowestRemainder,
                         ::testing::Combine(::testing::ValuesIn(Ceilings),
                                            ::testing::ValuesIn(Outcomes),
                                            ::testing::Values(Person::Member, Person::Relative),
                                            ::testing::Values(Kind::Document, Kind::HospitalBill)),
                         ceilingName);

/// The limits that the two kinds of person and of entry have alike.
class Limits : public Desk, public ::testing::WithParamInterface<std::tuple<Person, Kind>> {
protected:
    const Person person = std::get<0>(GetParam());
    const Kind kind = std::get<1>(GetParam());
    const QString code = person == Person::Member ? u"A"_s : u"B"_s;
    const qint64 rubric = book.childRubric({});
    /// Sets the limit of this person, and one that nothing passes for the others.
    void limit(const char* ofMember, const char* ofRelative, const QVariant& value,
               const QVariant& ofOthers) {
        const bool member = person == Person::Member;
        setRubric(rubric, member ? ofMember : ofRelative, value);
        setRubric(rubric, member ? ofRelative : ofMember, ofOthers);
    }
    coverage::Entry document(int value = 100) {
        return enter(documentOf(person, kind, rubric, value));
    }
};

INSTANTIATE_TEST_SUITE_P(EachWay, Limits,
                         ::testing::Combine(::testing::Values(Person::Member, Person::Relative),
                                            ::testing::Values(Kind::Document, Kind::HospitalBill)),
                         [](const auto& at) {
                             return nameOf(std::get<0>(at.param), std::get<1>(at.param));
                         });

TEST_P(Limits, AMinimumAboveTheValueEndsTheRunButLeavesItValid) {
    limit("socio_min_lan", "familiar_min_lan", 100.01, 0);
    const coverage::Entry entry = document();
    boxes.expect(u"Este lançamento tem um limite minimo de € 100,01"_s);
    tryOut(entry);
    EXPECT_TRUE(run.bEnsaioValido);
    EXPECT_EQ(kept(entry, "comparticipacao"), "null");
    EXPECT_EQ(FakeVorlane::steps(), 1);
    EXPECT_EQ(FakeVorlane::calls().mid(3), QStringList({u"terminar()"_s, u"gone"_s}));
    EXPECT_EQ(book.count(u"tbSocios_Acumulados"_s), 0);
}

TEST_P(Limits, AMinimumOfTheValueItselfPasses) {
    limit("socio_min_lan", "familiar_min_lan", 100, 101);
    const coverage::Entry entry = document();
    tryOut(entry);
    EXPECT_EQ(kept(entry, "credito"), "80");
}

TEST_P(Limits, TheLastOfFiveDocumentsPasses) {
    limit("nomax_recibos_socio", "nomax_recibos_familiar", 5, 0);
    accumulated(code, rubric, 0, 4);
    accumulated(u"C9"_s, rubric, 0, 9);
    const coverage::Entry entry = document();
    tryOut(entry);
    EXPECT_EQ(kept(entry, "credito"), "80");
}

TEST_P(Limits, ADocumentPastTheMaximumEndsTheRunButLeavesItValid) {
    accumulated(code, rubric, 0, 5);
    for (const int maximum : {5, 0}) {
        FakeVorlane::calls().clear();
        limit("nomax_recibos_socio", "nomax_recibos_familiar", maximum, 100);
        const coverage::Entry entry = document();
        boxes.expect(u"O limite máximo do nº de documentos foi atingido."_s,
                     core::Icon::Information, caption);
        tryOut(entry);
        EXPECT_TRUE(run.bEnsaioValido);
        EXPECT_EQ(kept(entry, "comparticipacao"), "80");
        EXPECT_EQ(kept(entry, "saldo_plafond"), "null");
        EXPECT_EQ(FakeVorlane::steps(), 13);
        EXPECT_EQ(FakeVorlane::calls().last(), u"gone"_s);
    }
}

TEST_P(Limits, WhatIsLeftOfTheFranchiseComesOffTheNetAmount) {
    setRubric(rubric, "franquia", 10);
    moved(rubric, 30, 26);
    const coverage::Entry entry = document();
    tryOut(entry);
    EXPECT_EQ(kept(entry, "liquido"), "80");
    EXPECT_EQ(kept(entry, "credito"), "74");
    EXPECT_EQ(kept(entry, "debito"), kind == Kind::HospitalBill ? "100" : "74");
}

TEST_P(Limits, AFranchiseThatIsJustSpentTakesNothing) {
    setRubric(rubric, "franquia", 10);
    moved(rubric, 30, 20);
    const coverage::Entry entry = document();
    tryOut(entry);
    EXPECT_EQ(kept(entry, "credito"), "80");
}

TEST_P(Limits, AFranchiseAsLargeAsTheNetAmountLeavesNothing) {
    setRubric(rubric, "franquia", 84);
    moved(rubric, 4, 0);
    const coverage::Entry entry = document();
    tryOut(entry);
    EXPECT_EQ(kept(entry, "liquido"), "80");
    EXPECT_EQ(kept(entry, "credito"), "0");
    EXPECT_EQ(kept(entry, "debito"), kind == Kind::HospitalBill ? "100" : "0");
}

TEST_P(Limits, WithoutALimitOfItsOwnARubricPaysNothing) {
    limit("socio", "familiar", {}, 1000);
    const coverage::Entry entry = document();
    tryOut(entry);
    EXPECT_EQ(core::toText(run.shown.LimiteAplicavel.value_or(u"?"_s)), u"0"_s);
    EXPECT_EQ(kept(entry, "saldo_plafond"), "0");
    EXPECT_EQ(kept(entry, "credito"), "0");
    EXPECT_EQ(kept(entry, "debito"), kind == Kind::HospitalBill ? "100" : "0");
}

TEST_P(Limits, AFirstDocumentGetsAnEmptyAccumulatorAndKeepsIt) {
    const coverage::Entry entry = document();
    tryOut(entry);
    tryOut(entry);
    const std::string expected = code.toStdString() + "|1|0.0|0.0|0";
    EXPECT_EQ(stored("select codABC, rubrica_id_main = (select rubrica_id_main from "
                     "tbZelmar_Plafonds p where p.rubrica_id = a.rubrica_id), "
                     "printf('%.1f', debito_ac), printf('%.1f', credito_ac), no_docs "
                     "from tbSocios_Acumulados a"),
              expected);
}

class Accumulators : public Desk {};

// The second row of one person counts towards all sums, but what the person himself has used is
// read from the first row alone.
TEST_F(Accumulators, AnAccumulatorWithANullCreditGetsASecondRow) {
    const qint64 rubric = book.childRubric({.socio = 100});
    book.insert(u"tbSocios_Acumulados"_s,
                {{"socio_id", socio}, {"codABC", u"A"_s}, {"rubrica_id", rubric}, {"no_docs", 3}});
    const coverage::Entry entry = enter({.rubrica_id = rubric});
    tryOut(entry);
    EXPECT_EQ(kept(entry, "saldo_plafond"), "100");
    EXPECT_EQ(
        stored(
            "select ifnull(credito_ac, 'null'), no_docs from tbSocios_Acumulados order by rowid"),
        "null|3\n0|0");
}

TEST_F(Accumulators, ARowWithoutItsMainRubricCountsForTheRubricButNotForTheGroup) {
    const qint64 group = book.rubric({.agregado = 100});
    const qint64 rubric = book.childRubric({.rubrica_id_main = group, .agregado = 50});
    book.insert(
        u"tbSocios_Acumulados"_s,
        {{"socio_id", socio}, {"codABC", u"B"_s}, {"rubrica_id", rubric}, {"credito_ac", 30.0}});
    coverage::Entry entry = enter({.rubrica_id = rubric, .doc_valor = 1000});
    tryOut(entry);
    EXPECT_EQ(kept(entry, "saldo_plafond"), "20");
    setRubric(rubric, "agregado", {});
    tryOut(entry);
    EXPECT_EQ(kept(entry, "saldo_plafond"), "100");
}

TEST_F(Accumulators, AMainRubricThatIsGoneBindsNothingAndItsThreeStepsAreNotShown) {
    const coverage::Entry entry =
        enter({.rubrica_id = book.childRubric({.rubrica_id_main = 9999, .socio = 60})});
    tryOut(entry);
    EXPECT_EQ(kept(entry, "credito"), "60");
    EXPECT_EQ(FakeVorlane::steps(), 19);
}

}  // namespace
