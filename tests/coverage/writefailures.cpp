// SPDX-License-Identifier: MIT
// Counter, movement and accumulator are three writes. What the book holds when one of them fails,
// and after the operator has tried once more.
#include "tests/coverage/Desk.h"

using namespace Qt::StringLiterals;

namespace {

class WriteFailure : public Desk {
protected:
    WriteFailure() { tryOut(entry); }

    void failToPost(const QString& description) {
        expectBox(description);
        expectBox(u"Não foi possível registar o registo, contacte o Administrador do Sistema."_s,
                  core::Icon::Critical, caption);
        EXPECT_FALSE(post(entry));
    }
    void refuse(const QString& write) {
        book.exec(
            u"create trigger refuses before %1 begin select raise(abort, 'disco cheio'); end"_s.arg(
                write));
    }
    /// The next number, the movements' numbers, and credit and documents in the accumulators.
    void expectState(const char* expected) {
        EXPECT_EQ(stored("select (select zelmars from tbContadores), "
                         "(select group_concat(movimento_no) from tbZelmar_Movimentos), "
                         "(select printf('%.0f in %d', sum(credito_ac), sum(no_docs)) "
                         "from tbSocios_Acumulados)"),
                  expected);
    }

    const coverage::Entry entry = enter({.rubrica_id = book.childRubric({})});
};

TEST_F(WriteFailure, OfTheCounterSavesNothing) {
    refuse(u"update on tbContadores"_s);
    failToPost(u"disco cheio"_s);
    expectState("1|NULL|0 in 0");
    book.exec(u"drop trigger refuses"_s);
    EXPECT_TRUE(post(entry));
    expectState("2|1|80 in 1");
}

TEST_F(WriteFailure, OfTheMovementLosesItsNumber) {
    refuse(u"insert on tbZelmar_Movimentos"_s);
    failToPost(u"disco cheio"_s);
    expectState("2|NULL|0 in 0");
    book.exec(u"drop trigger refuses"_s);
    EXPECT_TRUE(post(entry));
    expectState("3|2|80 in 1");
}

TEST_F(WriteFailure, OfTheAccumulatorIsPassedOver) {
    refuse(u"update on tbSocios_Acumulados"_s);
    EXPECT_TRUE(post(entry));
    expectState("2|1|0 in 0");
}

TEST_F(WriteFailure, OfABookHeldByAnotherProgramLeavesItAsItWas) {
    book.exec(u"begin immediate"_s);
    failToPost(u"database is locked"_s);
    expectState("1|NULL|0 in 0");
    book.exec(u"commit"_s);
    EXPECT_TRUE(post(entry));
    expectState("2|1|80 in 1");
}

}  // namespace
