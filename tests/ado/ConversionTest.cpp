// SPDX-License-Identifier: MIT
// What each kind of column keeps of what is written to it.
#include <QDateTime>
#include <limits>

#include "SmallBook.h"
#include "platform/core/Money.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace {

class Columns : public SmallBook {
protected:
    ado::RecordsetPtr rows = open(u"select * from tbMov"_s, connection);
};

QString shown(const QVariant& value) {
    if (!value.isValid()) return u"NULL"_s;
    if (value.typeId() == QMetaType::QDateTime)
        return value.toDateTime().toString(u"yyyy-MM-dd HH:mm:ss"_s);
    return core::toText(value);
}

TEST_F(Columns, KeepWhatTheirTypeHoldsAndReadBackTheSame) {
    const QDateTime noon(QDate(2001, 2, 28), QTime(12, 30, 5, 900), Qt::LocalTime);
    const struct {
        QString column;
        QVariant written;
        QString read;
        QString stored;  // storage class and value in the book
    } table[] = {
        {u"valor"_s, QVariant::fromValue(core::Money::fromUnits(873500)), u"87.35"_s,
         u"real 87.35"_s},
        {u"valor"_s, 0.00005, u"0.0001"_s, u"real 0.0001"_s},
        {u"valor"_s, u"-0"_s, u"0"_s, u"integer 0"_s},
        {u"valor"_s, QVariant(), u"NULL"_s, u"null NULL"_s},
        {u"socio"_s, 7.5, u"8"_s, u"integer 8"_s},
        {u"simples"_s, 16777217.0, u"16777216"_s, u"real 16777216.0"_s},
        {u"data"_s, noon, u"2001-02-28 12:30:05"_s, u"text '2001-02-28 12:30:05'"_s},
        {u"data"_s, u"12/31/1999"_s, u"1999-12-31 00:00:00"_s, u"text '1999-12-31 00:00:00'"_s},
        {u"nome"_s, u""_s, u""_s, u"text ''"_s},
        {u"nome"_s, u"çãéõ€😀🎉abc"_s, u"çãéõ€😀🎉abc"_s, u"text 'çãéõ€😀🎉abc'"_s},
    };
    for (const auto& row : table) {
        SCOPED_TRACE(qPrintable(row.column + u' ' + row.stored));
        rows->AddNew();
        rows->setCollect(u"tipo"_s, u"x"_s);
        rows->setCollect(row.column, row.written);
        EXPECT_EQ(shown(rows->Collect(row.column)), row.read);
        rows->Update();
        EXPECT_EQ(shown(rows->Collect(row.column)), row.read);
        EXPECT_EQ(book.text(u"SELECT typeof(%1) || ' ' || quote(%1) FROM tbMov "
                            "ORDER BY id DESC LIMIT 1"_s.arg(row.column)),
                  row.stored);
    }
}

TEST_F(Columns, RefuseTheRestAndKeepWhatWasThere) {
    const struct {
        QString column;
        QVariant written;
        int number;
    } table[] = {
        {u"socio"_s, 2147483648.0, core::Overflow},
        {u"valor"_s, u"12,5"_s, core::TypeMismatch},
        {u"simples"_s, 1e39, core::Overflow},
        {u"taxa"_s, std::numeric_limits<double>::quiet_NaN(), core::TypeMismatch},
        {u"data"_s, u"31/12/1999"_s, core::TypeMismatch},
        {u"nome"_s, u"onze letras"_s, core::Overflow},
        {u"nome"_s, QString(u"a"_s + QChar(u'\0') + u"b"_s), core::TypeMismatch},
    };
    rows->AddNew();
    for (const auto& row : table) {
        EXPECT_EQ(failureOf([&] { rows->setCollect(row.column, row.written); }).number(),
                  row.number)
            << qPrintable(row.column);
        EXPECT_FALSE(rows->Collect(row.column).isValid());
        EXPECT_TRUE(rows->isNewRow());
    }
}

TEST_F(Columns, RefuseAmountsThatTheBookCannotHoldRatherThanBendThem) {
    rows->AddNew();
    rows->setCollect(u"valor"_s, u"922337203685477.5807"_s);
    EXPECT_EQ(failureOf([&] { rows->Update(); }).number(), core::Overflow);
    rows->setCollect(u"valor"_s, u"900719925474.0991"_s);
    rows->Update();
    EXPECT_EQ(core::toText(rows->Collect(u"valor"_s)), u"900719925474.0991"_s);
}

}  // namespace
