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
        QString kept;
    } table[] = {
        {u"valor"_s, QVariant::fromValue(core::Money::fromUnits(873500)), u"87.35"_s},
        {u"valor"_s, 0.00005, u"0.0001"_s},
        {u"valor"_s, u"-0"_s, u"0"_s},
        {u"valor"_s, QVariant(), u"NULL"_s},
        {u"socio"_s, 7.5, u"8"_s},
        {u"socio"_s, 6.5, u"6"_s},
        {u"pequeno"_s, -32768, u"-32768"_s},
        {u"grande"_s, QVariant(9007199254740993LL), u"9007199254740993"_s},
        {u"taxa"_s, u"23.5"_s, u"23.5"_s},
        {u"simples"_s, 16777217.0, u"16777216"_s},
        {u"data"_s, noon, u"2001-02-28 12:30:05"_s},
        {u"data"_s, u"12/31/1999"_s, u"1999-12-31 00:00:00"_s},
        {u"nome"_s, u""_s, u""_s},
        {u"nome"_s, u"O'Brien \\%"_s, u"O'Brien \\%"_s},
        {u"nome"_s, u"çãéõ€😀🎉abc"_s, u"çãéõ€😀🎉abc"_s},
    };
    for (const auto& row : table) {
        SCOPED_TRACE(qPrintable(row.column + u' ' + row.kept));
        rows->AddNew();
        rows->setCollect(u"tipo"_s, u"x"_s);
        rows->setCollect(row.column, row.written);
        EXPECT_EQ(shown(rows->Collect(row.column)), row.kept);
        rows->Update();
        EXPECT_EQ(shown(rows->Collect(row.column)), row.kept);
        EXPECT_EQ(book.text(u"SELECT %1 FROM tbMov ORDER BY id DESC LIMIT 1"_s.arg(row.column)),
                  row.kept);
    }
}

TEST_F(Columns, KeepTheLargestAndTheSmallestNumbersToTheLastBit) {
    using Single = std::numeric_limits<float>;
    using Double = std::numeric_limits<double>;
    const std::pair<float, double> table[] = {{Single::max(), Double::max()},
                                              {Single::lowest(), Double::lowest()},
                                              {Single::denorm_min(), Double::denorm_min()},
                                              {-Single::min(), -Double::min()},
                                              {16777215.0F, 9007199254740991.0},
                                              {7.0385307e-26F, 0.1}};
    for (const auto& [single, number] : table) {
        rows->AddNew();
        rows->setCollect(u"simples"_s, single);
        rows->setCollect(u"taxa"_s, number);
        rows->Update();
        const auto stored =
            open(u"select * from tbMov order by id desc"_s, connection, ado::adLockReadOnly);
        for (const ado::RecordsetPtr& each : {rows, stored}) {
            EXPECT_EQ(each->Collect(u"simples"_s), QVariant(single)) << single;
            EXPECT_EQ(each->Collect(u"taxa"_s), QVariant(number)) << number;
        }
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
        {u"data"_s, u"12-11-10"_s, core::TypeMismatch},
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

// A file keeps amounts in binary, which has no room for the last decimals of the largest.
TEST_F(Columns, BendNoAmountThatTheBookCannotHold) {
    const int refusal = support::onServer() ? 0 : core::Overflow;
    for (const auto& [amount, number] :
         {std::pair(u"900719925474.0991"_s, 0), {u"922337203685477.5807"_s, refusal}}) {
        rows->AddNew();
        rows->setCollect(u"valor"_s, amount);
        EXPECT_EQ(failureOf([&] { rows->Update(); }).number(), number);
        EXPECT_EQ(core::toText(rows->Collect(u"valor"_s)), amount);
    }
}

TEST_F(Columns, TellTheirTypesAndSizesAndHideTheRowsIdentity) {
    using enum ado::ColumnType;
    const struct {
        QString column;
        ado::ColumnType type;
        int size;
    } table[] = {
        {u"ID"_s, Integer32, 4},      {u"valor"_s, Money, 8},      {u"data"_s, DateTime, 8},
        {u"nome"_s, Text, 10},        {u"obs"_s, Text, 0},         {u"taxa"_s, Double, 8},
        {u"pequeno"_s, Integer16, 2}, {u"grande"_s, Integer64, 8}, {u"simples"_s, Single, 4}};
    for (const auto& row : table) {
        EXPECT_EQ(rows->Fields(row.column).Type(), row.type) << qPrintable(row.column);
        EXPECT_EQ(rows->Fields(row.column).DefinedSize(), row.size) << qPrintable(row.column);
    }
    for (const auto lock : {ado::adLockPessimistic, ado::adLockReadOnly})
        EXPECT_EQ(open(u"select * from tbSoma"_s, connection, lock)->columnCount(), 3);
}

}  // namespace
