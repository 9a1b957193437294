// SPDX-License-Identifier: MIT
// From the plan's share, 80 %, to credit and debit. The limits of a rubric come first, each for the
// member and for a relative, on a document and on a hospital bill.
#include <algorithm>

#include "platform/core/Values.h"
#include "tests/coverage/Desk.h"

using namespace Qt::StringLiterals;

namespace {

/// Who a document is for, and of what kind it is.
struct Way {
    QString code;
    bool hospital;
    bool ofMember() const { return code == u"A"_s; }
    std::string name() const { return code.toStdString() + (hospital ? " bill" : " document"); }
};
const Way Ways[] = {{u"A"_s, false}, {u"A"_s, true}, {u"B"_s, false}, {u"B"_s, true}};

/// A ceiling and what of it is used up when the member's credits are 1 on the rubric and 2 on its
/// sister rubric, those of the relative 4 and 8, those of another relative 16 and 32.
struct Ceiling {
    const char* ofMember;    ///< its column
    const char* ofRelative;  ///< its column where it is the relative's
    bool ofGroup;            ///< on the main rubric
    int usedByMember;
    int usedByRelative;
    bool bindsMember = true;
    int lowest = 0;  ///< what it leaves when it is overdrawn by 1
};
constexpr Ceiling OwnLimit{"socio", "familiar", false, 1, 4};
constexpr Ceiling GroupHousehold{"agregado", "agregado", true, 63, 63};

class Limits : public Desk {
protected:
    coverage::Document triedOut(const Way& way, qint64 rubric, int value) {
        const coverage::Document entry = enter({.rubrica_id = rubric,
                                                .codABC = way.code,
                                                .doc_valor = value,
                                                .hospital = way.hospital,
                                                .incidencia = value});
        tryOut(entry);
        return entry;
    }
};

class Ceilings : public Limits {
protected:
    Ceilings() {
        const QString codes[] = {u"A"_s, u"B"_s, u"C1"_s};
        const qint64 otherGroup = book.childRubric({});
        for (int at = 0; at < 3; ++at) {
            accumulated(codes[at], rubric, 1 << 2 * at);
            accumulated(codes[at], sister, 2 << 2 * at);
            accumulated(codes[at], otherGroup, 100000);
        }
        book.exec(
            u"insert into tbSocios_Acumulados select socio_id + 1, codABC, rubrica_id, "
            "rubrica_id_main, 90000, 90000, 9 from tbSocios_Acumulados"_s);
    }
    /// Lets a ceiling leave so much, in euros.
    void leave(const Ceiling& ceiling, const Way& way, int left) {
        setRubric(ceiling.ofGroup ? group : rubric,
                  way.ofMember() ? ceiling.ofMember : ceiling.ofRelative,
                  left + (way.ofMember() ? ceiling.usedByMember : ceiling.usedByRelative));
    }

    const qint64 group = book.rubric({});
    const qint64 rubric = book.childRubric({.rubrica_id_main = group});
    const qint64 sister = book.childRubric({.rubrica_id_main = group});
};

TEST_F(Ceilings, TheLowestRemainderBinds) {
    const Ceiling ceilings[] = {
        OwnLimit,
        GroupHousehold,
        {"agregado", "agregado", false, 21, 21},
        {"total_familia", "total_familia", false, 20, 20, false},
        {"socio", "familiar", true, 3, 12},
        {"total_familia", "total_familia", true, 60, 60, false},
        {"socio_max_lan", "familiar_max_lan", false, 0, 0, true, -1},
    };
    for (const Ceiling& ceiling : ceilings) {
        const Ceiling& other = &ceiling == &ceilings[0] ? GroupHousehold : OwnLimit;
        for (const int left : {50, 90, -1}) {  // wins, loses against 70, is overdrawn
            for (const Way& way : Ways) {
                SCOPED_TRACE(way.name() + ", " + ceiling.ofRelative +
                             (ceiling.ofGroup ? " of the group" : "") + " leaves " +
                             std::to_string(left));
                leave(other, way, 70);
                leave(ceiling, way, left);
                const bool binds = ceiling.bindsMember || !way.ofMember();
                const int expected = binds ? std::clamp(left, ceiling.lowest, 70) : 70;
                const coverage::Document entry = triedOut(way, rubric, 1000);
                for (const char* column : {"saldo_plafond", "liquido", "credito"})
                    EXPECT_EQ(kept(entry, column), std::to_string(expected)) << column;
                EXPECT_EQ(kept(entry, "debito"),
                          std::to_string(way.hospital ? 1000 : std::max(0, expected)));
                for (const Ceiling& former : {ceiling, other}) leave(former, way, 1000000);
            }
        }
    }
}

TEST_F(Limits, OfThePersonsOwnEndTheRunOrLetItPass) {
    const QString minimum = u"Este lançamento tem um limite minimo de € 100,01"_s;
    const QString documents = u"O limite máximo do nº de documentos foi atingido."_s;
    const struct {
        const char* ofMember;
        const char* ofRelative;
        QVariant limit;
        int ofOthers;  ///< the same limit of the other kind of person
        int earlier;   ///< documents so far
        QString box;
        const char* share;
        const char* credit;
    } rows[] = {
        {"socio_min_lan", "familiar_min_lan", 100.01, 0, 0, minimum, "null", "null"},
        {"socio_min_lan", "familiar_min_lan", 100, 101, 0, {}, "80", "80"},
        {"nomax_recibos_socio", "nomax_recibos_familiar", 5, 0, 4, {}, "80", "80"},
        {"nomax_recibos_socio", "nomax_recibos_familiar", 5, 9, 5, documents, "80", "null"},
        {"socio", "familiar", {}, 1000, 0, {}, "80", "0"},
    };
    for (const auto& row : rows) {
        for (const Way& way : Ways) {
            SCOPED_TRACE(way.name() + ", " + row.ofMember);
            const qint64 rubric = book.childRubric({});
            setRubric(rubric, way.ofMember() ? row.ofMember : row.ofRelative, row.limit);
            setRubric(rubric, way.ofMember() ? row.ofRelative : row.ofMember, row.ofOthers);
            accumulated(way.code, rubric, 0, row.earlier);
            accumulated(u"C9"_s, rubric, 0, 9);
            if (row.box == minimum) expectBox(minimum);
            if (row.box == documents) expectBox(documents, core::Icon::Information, caption);
            const coverage::Document entry = triedOut(way, rubric, 100);
            EXPECT_TRUE(run.bEnsaioValido);
            EXPECT_EQ(kept(entry, "comparticipacao"), row.share);
            EXPECT_EQ(kept(entry, "credito"), row.credit);
        }
    }
}

TEST_F(Limits, WhatIsLeftOfTheFamilysFranchiseComesOffTheCredit) {
    struct Movement {
        QVariant net, credit;
        const char* type = "DOC";
    };
    const QVariant none;
    const struct {
        int franchise;
        std::vector<Movement> earlier;  ///< each spends net - credit
        int credit;
    } rows[] = {
        {10, {{30, 26}}, 74},  // 80 - (10 - 4)
        {84, {{4, 0}}, 0},
        {50, {{20, 5, "HOS"}, {30, 25}, {none, none, "PAG"}}, 50},
        // An annulled document spends it all the same.
        {50, {{40, 30, "ANL"}, {none, -30, "COR"}}, 70},
        {10, {{0, 20, "REP"}}, 50},  // 80 - (10 + 20)
    };
    for (const auto& row : rows) {
        for (const Way& way : Ways) {
            SCOPED_TRACE(way.name() + ", credit " + std::to_string(row.credit));
            const qint64 rubric = book.childRubric({.franquia = row.franchise});
            for (const Movement& movement : row.earlier)
                moved(rubric, movement.net, movement.credit, QString::fromLatin1(movement.type));
            const coverage::Document entry = triedOut(way, rubric, 100);
            EXPECT_EQ(kept(entry, "liquido"), "80");
            EXPECT_EQ(kept(entry, "credito"), std::to_string(row.credit));
            EXPECT_EQ(kept(entry, "debito"), std::to_string(way.hospital ? 100 : row.credit));
        }
    }
}

class Amounts : public Desk {
protected:
    coverage::Document triedOut(const Document& document) {
        const coverage::Document entry = enter(document);
        tryOut(entry);
        return entry;
    }
    static void expectAmounts(const coverage::Document& entry,
                              std::initializer_list<std::pair<const char*, const char*>> amounts) {
        for (const auto& [column, amount] : amounts)
            EXPECT_EQ(kept(entry, column), amount) << column;
    }
};

// A relative, 100 at 80 %, franchise 10 of which 4 are spent. The ceilings leave 800 of the
// household, 500 of the relatives, 50 of the person and 20 of the person in the group.
TEST_F(Amounts, OfARelativeWithFourCeilingsAndAFranchise) {
    const qint64 group = book.rubric({.familiar = 300});
    const qint64 rubric = book.childRubric({.rubrica_id_main = group,
                                            .agregado = 1000,
                                            .familiar = 500,
                                            .total_familia = 600,
                                            .franquia = 10});
    const qint64 sister = book.childRubric({.rubrica_id_main = group});
    // The relatives' ceiling counts 100 on rows of which this person's own are more: a correction
    // of another relative makes up the difference.
    accumulated(u"B"_s, rubric, 450);
    accumulated(u"C1"_s, rubric, -350);
    accumulated(u"A"_s, rubric, 100);
    accumulated(u"B"_s, sister, -170);
    moved(rubric, 30, 26);
    expectAmounts(triedOut({.rubrica_id = rubric, .codABC = u"B"_s}), {{"incidencia", "100"},
                                                                       {"comparticipacao", "80"},
                                                                       {"saldo_plafond", "20"},
                                                                       {"iliquido", "80"},
                                                                       {"liquido", "20"},
                                                                       {"credito", "14"},
                                                                       {"debito", "14"}});
}

TEST_F(Amounts, ANegativeNetAmountIsNotCreditedWhileSomeOfTheFranchiseIsLeft) {
    const qint64 rubric = book.childRubric({.franquia = 5});
    expectAmounts(triedOut({.rubrica_id = rubric, .recebido = 120}),
                  {{"liquido", "-20"}, {"credito", "0"}});
}

// A 32-bit float has steps of 1/128 between 65536 and 131072: 123456.78 becomes 123456.78125, of
// which a column keeps four decimals.
TEST_F(Amounts, PassThroughSinglePrecisionAndAreNotRoundedToCents) {
    expectAmounts(
        triedOut({.rubrica_id = book.childRubric({.percent = 1}), .doc_valor = 123456.78}),
        {{"comparticipacao", "123456.78"}, {"iliquido", "123456.7813"}});
}

}  // namespace
