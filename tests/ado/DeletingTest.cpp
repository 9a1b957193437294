// SPDX-License-Identifier: MIT
// Where a row set stands when rows were deleted through it.
#include "SmallBook.h"

using namespace Qt::StringLiterals;

namespace {

class Deleting : public SmallBook {
protected:
    static void add(const ado::RecordsetPtr& rows, const QString& name) {
        rows->AddNew();
        rows->setCollect(u"nome"_s, name);
        rows->Update();
    }
    /// The names of all rows, from the first on.
    static QString names(const ado::RecordsetPtr& rows) {
        rows->MoveFirst();
        return valuesOf(rows, u"nome"_s);
    }
};

TEST_F(Deleting, ARowThatTheSetAddedGoesOnWithTheRowBehindIt) {
    const struct {
        int deleted;     ///< place of the row that is deleted, from 0
        QString behind;  ///< the rows that a pass comes to then
        QString left;
    } rows[] = {{0, u"a,b,c"_s, u"a,b,c"_s},
                {1, u"b,c"_s, u"n1,b,c"_s},
                {2, u"c"_s, u"n1,a,c"_s},
                {3, u""_s, u"n1,a,b"_s}};
    for (const auto& row : rows) {
        SCOPED_TRACE(row.deleted);
        book.exec(u"DELETE FROM tbMov"_s);
        fill(1);
        const auto set = open(u"select * from tbMov"_s, connection, ado::adLockOptimistic);
        for (const QString& name : {u"a"_s, u"b"_s, u"c"_s}) add(set, name);
        set->MoveFirst();
        for (int at = 0; at < row.deleted; ++at) set->MoveNext();
        set->Delete();
        set->MoveNext();
        EXPECT_EQ(valuesOf(set, u"nome"_s), row.behind);
        EXPECT_EQ(names(set), row.left);
    }
}

// Short sets are held in memory, long ones are not.
TEST_F(Deleting, TheLastRowsLeavesTheRowBeforeThemTheLast) {
    for (const int count : {3, 500}) {
        SCOPED_TRACE(count);
        book.exec(u"DELETE FROM tbMov"_s);
        fill(count);
        const auto rows = open(u"select * from tbMov"_s, connection, ado::adLockOptimistic);
        for (int last = count; last > count - 3; --last) {
            rows->MoveLast();
            ASSERT_FALSE(rows->atEnd());
            EXPECT_EQ(rows->Collect(u"nome"_s).toString(), u"n%1"_s.arg(last));
            rows->Delete();
        }
        rows->MoveLast();
        EXPECT_EQ(rows->atEnd(), count == 3);
        EXPECT_EQ(rows->RecordCount(), count - 3);
        EXPECT_EQ(book.count(u"tbMov"_s), count - 3);
    }
}

TEST_F(Deleting, ARowStaysDeletedWhenANewOneBehindItIsDropped) {
    fill(1);
    const auto rows = open(u"select * from tbMov"_s, connection, ado::adLockOptimistic);
    for (const bool inserted : {false, true}) {
        SCOPED_TRACE(inserted);
        if (inserted) add(rows, u"a"_s);
        rows->Delete();
        rows->AddNew();
        rows->CancelUpdate();
        EXPECT_EQ(failureOf([&] { rows->Collect(u"nome"_s); }).number(), core::NoCurrentRow);
        rows->MoveNext();
        EXPECT_TRUE(rows->atEnd());
    }
}

}  // namespace
