// SPDX-License-Identifier: MIT
// Many workstations on one book lose nothing, also when some of them are killed.
#include <gtest/gtest.h>

#include "platform/ado/Recordset.h"
#include "tests/workstations/Office.h"

using namespace Qt::StringLiterals;

namespace {

class Workstations : public testing::TestWithParam<office::Engine> {
protected:
    /// How many of something; more of it where a long run is asked for.
    static int many(const char* variable, int usual) {
        const int asked = qEnvironmentVariableIntValue(variable);
        return asked > 0 ? asked : usual;
    }
    static void expectSound(const office::Outcome& outcome) {
        std::printf("%s\n", qUtf8Printable(outcome.text()));
        EXPECT_EQ(outcome.faults.mid(0, 20).join(u'\n').toStdString(), "");
    }
};

TEST_P(Workstations, PostAtOnceAndLoseNothing) {
    const int postings = many("ZELMARS_POSTINGS", 60);
    office::Office office(GetParam(), 8);
    // An editing screen that stays open over lunch: nobody who posts waits for its row.
    const ado::RecordsetPtr rubric = ado::Recordset::create();
    rubric->Open(u"Select * from tbZelmar_Plafonds where rubrica_id = 2"_s, office.connect(30),
                 ado::adOpenStatic, ado::adLockPessimistic);
    rubric->setCollect(u"percent"_s, 0.4);
    const office::Outcome outcome = office.work(8, postings);
    EXPECT_EQ(outcome.posted, 8 * postings);
    expectSound(outcome);
}

TEST_P(Workstations, GiveTheFirstNumberOfAnEmptyCounterTwiceAndNoOther) {
    office::Office office(GetParam(), 8);
    office.emptyCounter();
    expectSound(office.work(8, 5));
}

TEST_P(Workstations, LetGoOfEverythingWhenTheyAreKilled) {
    const int kills = many("ZELMARS_KILLS", 20);
    office::Office office(GetParam(), kills + 8);
    expectSound(office.workThroughKills(4, kills));
    expectSound(office.work(4, 10));
}

INSTANTIATE_TEST_SUITE_P(Engines, Workstations,
                         testing::Values(office::Engine::Sqlite, office::Engine::Postgres),
                         [](const auto& engine) {
                             return engine.param == office::Engine::Sqlite ? "sqlite"
                                                                           : "postgresql";
                         });

}  // namespace
