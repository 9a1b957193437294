// SPDX-License-Identifier: MIT
// What postings use up of the ceilings that the rubrics of a group share.
#include "tests/coverage/Desk.h"

namespace {

class GroupCeilings : public Desk {};

// The accumulator rows are those that the program makes itself; the plan's share of each document
// is 80.
TEST_F(GroupCeilings, AreUsedUpByWhatWasPostedOnTheOtherRubricsOfTheGroup) {
    const struct {
        const char* ceiling;  ///< of the main rubric, always 100
        QString first, second;
    } rows[] = {
        {"socio", QStringLiteral("A"), QStringLiteral("A")},
        {"familiar", QStringLiteral("B"), QStringLiteral("B")},
        {"agregado", QStringLiteral("A"), QStringLiteral("B")},
        {"total_familia", QStringLiteral("B"), QStringLiteral("C1")},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.ceiling);
        const qint64 group = book.rubric({});
        const qint64 rubric = book.childRubric({.rubrica_id_main = group});
        const qint64 sister = book.childRubric({.rubrica_id_main = group});
        setRubric(group, row.ceiling, 100);
        const coverage::Document first = enter({.rubrica_id = rubric, .codABC = row.first});
        EXPECT_TRUE(post(first));
        EXPECT_EQ(kept(first, "credito"), "80");
        const coverage::Document second = enter({.rubrica_id = sister, .codABC = row.second});
        EXPECT_TRUE(post(second));
        EXPECT_EQ(kept(second, "saldo_plafond"), "20");
        EXPECT_EQ(kept(second, "credito"), "20");
    }
}

}  // namespace
