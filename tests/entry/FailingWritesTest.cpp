// SPDX-License-Identifier: MIT
// Writes that fail at each point of an entry: what the operator hears, what is left in the book,
// and that a second attempt goes through.
#include "boundary/environment/dtZelmars.h"
#include "platform/com/Component.h"
#include "tests/entry/EntryTest.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

using core::Answer;
using core::Icon;

class FailingWrites : public EntryTest {
protected:
    FailingWrites() {
        openNew();
        typeDocument(u"100"_s, u"0"_s, u"0"_s);
    }

    /// From here on that kind of write to the table fails.
    void failOn(const QString& write, const QString& table) {
        book.exec(
            u"create trigger avaria before %1 on %2 begin select raise(abort, 'disco cheio'); "
            "end"_s.arg(write, table));
    }
    void mend() { book.exec(u"drop trigger avaria"_s); }

    void expectState(int counter, int movements, int documents) {
        EXPECT_EQ(book.value(u"select zelmars from tbContadores"_s).toInt(), counter);
        EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s), movements);
        EXPECT_EQ(book.value(u"select sum(no_docs) from tbSocios_Acumulados"_s).toInt(), documents);
        EXPECT_EQ(book.value(u"select sum(credito_ac) from tbSocios_Acumulados"_s).toDouble(),
                  75.0 * documents);
    }

    void failToPost(const QString& why) {
        expectFailedPosting(why);
        person.accelerator(u'O');
        person.expectNoBoxesLeft();
        EXPECT_TRUE(form().isVisible());
        EXPECT_EQ(form().Text6->Text(), u"€ 100,00"_s);
        EXPECT_EQ(form().Text5->Text(), u"FT 2026/17"_s);
    }
};

TEST_F(FailingWrites, MovementThatIsNotSavedLosesItsNumberAndPostsWithTheNext) {
    failOn(u"insert"_s, u"tbZelmar_Movimentos"_s);
    failToPost(u"disco cheio"_s);
    expectState(2, 0, 0);
    mend();
    postAndLeave();
    expectState(3, 1, 1);
    EXPECT_EQ(book.text(u"select movimento_no from tbZelmar_Movimentos"_s), u"2"_s);
}

TEST_F(FailingWrites, CounterThatIsNotStoredLeavesTheRowSavedAndPostsAgainWithoutASecondRow) {
    failOn(u"update"_s, u"tbContadores"_s);
    failToPost(u"disco cheio"_s);
    expectState(1, 1, 0);
    mend();
    postAndLeave();
    expectState(2, 1, 1);
    EXPECT_EQ(book.text(u"select movimento_no, created_by from tbZelmar_Movimentos"_s),
              u"1|operador"_s);
}

TEST_F(FailingWrites, AccumulatorsThatAreNotStoredLagInSilence) {
    person.accelerator(u'E');
    failOn(u"update"_s, u"tbSocios_Acumulados"_s);
    postAndLeave();
    expectState(2, 1, 0);
    EXPECT_FALSE(forms::DefaultInstance<frmMovimentos>::isLoaded());
}

TEST_F(FailingWrites, BookLockedByAnotherProgramWritesNothing) {
    environment::dtZelmars::instance().MSAccess()->CommandTimeout = 1;
    book.exec(u"begin immediate"_s);
    person.expectBox({.icon = Icon::Critical, .partly = true});
    person.accelerator(u'E');
    person.expectNoBoxesLeft();
    book.exec(u"rollback"_s);
    person.accelerator(u'E');
    EXPECT_EQ(form().Credito->Text(), u"€ 75,00"_s);

    book.exec(u"begin immediate"_s);
    failToPost(QString());
    book.exec(u"rollback"_s);
    expectState(1, 0, 0);
    postAndLeave();
    expectState(2, 1, 1);
}

TEST_F(FailingWrites, CounterHeldByAnotherWorkstationIsSaid) {
    person.accelerator(u'E');
    const ado::ConnectionPtr connection = environment::dtZelmars::instance().MSAccess();
    connection->CommandTimeout = 1;
    const ado::RecordsetPtr held = ado::Recordset::create();
    held->Open(u"select * from tbContadores"_s, connection, ado::adOpenDynamic,
               ado::adLockPessimistic, ado::adCmdUnknown);
    ASSERT_EQ(held->Collect(u"zelmars"_s).toInt(), 1);
    expectFailedPosting(QString());
    person.accelerator(u'O');
    held->Close();
    EXPECT_TRUE(form().isVisible());
    postAndLeave();
    expectState(2, 1, 1);
}

TEST_F(FailingWrites, ChequeNumberThatIsNotStoredStaysOnItsScreen) {
    person.fill(u"DataCombo3"_s, u"CHQ"_s);
    book.exec(u"delete from tbCheques; insert into tbCheques (cheque_no) values (7)"_s);
    failOn(u"update"_s, u"tbCheques"_s);
    person.onScreen(u"frmPagamentoCheque"_s, [this] {
        person.expectBox({.text = u"disco cheio"_s, .icon = Icon::Critical, .partly = true});
        person.accelerator(u'O');
        EXPECT_TRUE(person.isShown(u"frmPagamentoCheque"_s));
        EXPECT_EQ(book.text(u"select cheque_no from tbCheques"_s), u"7"_s);
        mend();
        person.accelerator(u'O');
    });
    // The failure was said and mended; it is not a failure of the posting.
    postAndLeave();
    expectState(2, 1, 1);
    EXPECT_EQ(book.text(u"select cheque from tbZelmar_Movimentos"_s), u"7"_s);
    EXPECT_EQ(book.text(u"select cheque_no from tbCheques"_s), u"8"_s);
}

TEST_F(FailingWrites, ProgressWindowThatFailsEndsTheTryOutWithItsText) {
    companions.failing = u"Vorlane.setvalor"_s;
    person.expectBox({.text = CompanionFailure.toString(), .icon = Icon::Critical});
    person.accelerator(u'E');
    EXPECT_EQ(form().LimiteAplicavel->Text(), u"€ 500,00"_s) << "what was reached is shown";
    EXPECT_EQ(form().Credito->Text(), QString());
    companions.failing.clear();

    com::registerRunning(u"Vorlane.General"_s, {});
    person.expectBox({.text = u"Deseja finalizar o registo?"_s, .answer = Answer::Yes});
    person.expectBox({.text = u"Vorlane.General"_s, .icon = Icon::Critical, .partly = true});
    person.accelerator(u'O');
    expectState(1, 0, 0);
    EXPECT_TRUE(form().isVisible());
}

}  // namespace

}  // namespace entry
