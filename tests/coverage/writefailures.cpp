// SPDX-License-Identifier: MIT
// Counter, movement and accumulator are three writes. What the book holds when one of them fails,
// and after the operator has tried once more.
#include "boundary/environment/dtZelmars.h"
#include "tests/coverage/Desk.h"

using namespace Qt::StringLiterals;

namespace {

class WriteFailure : public Desk {
protected:
    WriteFailure() { tryOut(entry); }

    void expectFailureBoxes(const QString& description) {
        boxes.expect(description);
        boxes.expect(u"Não foi possível registar o registo, contacte o Administrador do Sistema."_s,
                     core::Icon::Critical, caption);
    }
    /// Next number; movements by number; credit and documents in the accumulators.
    std::string state() {
        return stored(
            "select (select zelmars from tbContadores), "
            "(select group_concat(movimento_no) from tbZelmar_Movimentos), "
            "(select printf('%.0f in %d', sum(credito_ac), sum(no_docs)) "
            "from tbSocios_Acumulados)");
    }

    const coverage::Entry entry = enter({.rubrica_id = book.childRubric({})});
};

/// A write that fails, and what the book holds after it and after a second try.
struct FailingWrite {
    const char* name;
    const char* write;
    bool told;
    const char* after;
    const char* afterASecondTry;
};

class FailingWrites : public WriteFailure, public ::testing::WithParamInterface<FailingWrite> {};

TEST_P(FailingWrites, LeaveWhatWasWrittenBeforeAndAfter) {
    book.exec(
        u"create trigger refuses before %1 begin select raise(abort, 'disco cheio'); end"_s.arg(
            QLatin1StringView(GetParam().write)));
    if (GetParam().told) expectFailureBoxes(u"disco cheio"_s);
    EXPECT_EQ(post(entry), !GetParam().told);
    EXPECT_EQ(state(), GetParam().after);
    if (!GetParam().told) return;
    book.exec(u"drop trigger refuses"_s);
    EXPECT_TRUE(post(entry));
    EXPECT_EQ(state(), GetParam().afterASecondTry);
}

// Without the counter the movement is written all the same, with the number that was read.
INSTANTIATE_TEST_SUITE_P(Posting, FailingWrites,
                         ::testing::Values(FailingWrite{"Counter", "update on tbContadores", true,
                                                        "1|1|0 in 0", "2|1|80 in 1"},
                                           FailingWrite{"Movement", "insert on tbZelmar_Movimentos",
                                                        true, "2|NULL|0 in 0", "3|2|80 in 1"},
                                           FailingWrite{"Accumulator",
                                                        "update on tbSocios_Acumulados", false,
                                                        "2|1|0 in 0", ""}),
                         [](const auto& at) { return std::string(at.param.name); });

TEST_F(WriteFailure, OfABookHeldByAnotherProgramLeavesItAsItWas) {
    book.exec(u"begin immediate"_s);
    expectFailureBoxes(u"database is locked"_s);
    EXPECT_FALSE(post(entry));
    EXPECT_EQ(state(), "1|NULL|0 in 0");
    book.exec(u"commit"_s);
    EXPECT_TRUE(post(entry));
    EXPECT_EQ(state(), "2|1|80 in 1");
}

// Another workstation stands on the counter's row. Which number the row gets meanwhile does not
// matter: the second try gives it one of its own.
TEST_F(WriteFailure, OfACounterHeldByAnotherWorkstationIsMendedByTryingAgain) {
    const auto counterOf = [](const ado::ConnectionPtr& connection) {
        const ado::RecordsetPtr counter = ado::Recordset::create();
        counter->Open(u"select * from tbContadores"_s, connection, ado::adOpenDynamic,
                      ado::adLockPessimistic, ado::adCmdUnknown);
        counter->Collect(u"zelmars"_s);  // a row is held from its first reading on
        return counter;
    };
    const auto other = std::make_shared<ado::Connection>();
    other->ConnectionString = book.connectionString();
    other->Open();
    const ado::RecordsetPtr held = counterOf(other);
    try {
        counterOf(environment::dtZelmars::instance().MSAccess());
        FAIL() << "two workstations hold the counter";
    } catch (const core::Failure& failure) {
        EXPECT_EQ(failure.number(), core::RowInUse);
        expectFailureBoxes(failure.text());
    }
    EXPECT_FALSE(post(entry));
    EXPECT_EQ(stored("select zelmars from tbContadores"), "1");
    EXPECT_EQ(stored("select sum(no_docs) from tbSocios_Acumulados"), "0");
    held->Close();
    EXPECT_TRUE(post(entry));
    EXPECT_EQ(state(), "2|1|80 in 1");
}

}  // namespace
