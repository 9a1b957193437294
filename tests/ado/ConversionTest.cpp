// SPDX-License-Identifier: MIT
// What each kind of column keeps of what is written to it.
#include <gtest/gtest.h>

#include <QDateTime>
#include <limits>

#include "SmallBook.h"
#include "platform/core/Money.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace {

struct Kept {
    const char* column;
    QVariant written;
    QString read;    ///< as text; "NULL" for null
    QString stored;  ///< storage class and value in the book
};

struct RefusedValue {
    const char* column;
    QVariant written;
    int number;
};

class Keeps : public testing::TestWithParam<Kept> {};
class RefusesValue : public testing::TestWithParam<RefusedValue> {};

QString shown(const QVariant& value) {
    if (!value.isValid()) return u"NULL"_s;
    if (value.typeId() == QMetaType::QDateTime)
        return value.toDateTime().toString(u"yyyy-MM-dd HH:mm:ss"_s);
    return core::toText(value);
}

const QVariant Amount = QVariant::fromValue(core::Money::fromUnits(873500));
const QDateTime Noon(QDate(2001, 2, 28), QTime(12, 30, 5, 900), Qt::LocalTime);
constexpr double Infinity = std::numeric_limits<double>::infinity();

}  // namespace

TEST_P(Keeps, AndReadsBackTheSame) {
    SmallBook book;
    const QString column = QString::fromLatin1(GetParam().column);
    const auto rows = openRows(u"select * from tbMov"_s, book.connect());
    rows->AddNew();
    rows->setCollect(u"tipo"_s, u"x"_s);
    rows->setCollect(column, GetParam().written);
    EXPECT_EQ(shown(rows->Collect(column)), GetParam().read);
    rows->Update();
    EXPECT_EQ(shown(rows->Collect(column)), GetParam().read);
    EXPECT_EQ(book.stored(column, u"tbMov"_s), GetParam().stored);
}

INSTANTIATE_TEST_SUITE_P(
    Columns, Keeps,
    testing::Values(
        Kept{"valor", Amount, u"87.35"_s, u"real 87.35"_s},
        Kept{"valor", 0.00005, u"0.0001"_s, u"real 0.0001"_s},
        Kept{"valor", -2.00004, u"-2"_s, u"integer -2"_s},
        Kept{"valor", u"87.35"_s, u"87.35"_s, u"real 87.35"_s},
        Kept{"valor", u"1e3"_s, u"1000"_s, u"integer 1000"_s},
        Kept{"valor", u"-0"_s, u"0"_s, u"integer 0"_s},
        Kept{"valor", 87.35F, u"87.35"_s, u"real 87.35"_s},
        Kept{"valor", QVariant(), u"NULL"_s, u"null NULL"_s},
        Kept{"socio", 7.5, u"8"_s, u"integer 8"_s}, Kept{"socio", 6.5, u"6"_s, u"integer 6"_s},
        Kept{"socio", u" 12 "_s, u"12"_s, u"integer 12"_s},
        Kept{"pequeno", -32768, u"-32768"_s, u"integer -32768"_s},
        Kept{"grande", QVariant(9007199254740993LL), u"9007199254740993"_s,
             u"integer 9007199254740993"_s},
        Kept{"taxa", u"23.5"_s, u"23.5"_s, u"real 23.5"_s},
        Kept{"taxa", -0.0, u"0"_s, u"real 0.0"_s},
        Kept{"data", QDate(2024, 2, 29), u"2024-02-29 00:00:00"_s, u"text '2024-02-29 00:00:00'"_s},
        Kept{"data", Noon, u"2001-02-28 12:30:05"_s, u"text '2001-02-28 12:30:05'"_s},
        Kept{"data", u"12/31/1999"_s, u"1999-12-31 00:00:00"_s, u"text '1999-12-31 00:00:00'"_s},
        Kept{"data", u"1999-12-31T23:59"_s, u"1999-12-31 23:59:00"_s,
             u"text '1999-12-31 23:59:00'"_s},
        Kept{"nome", u""_s, u""_s, u"text ''"_s},
        Kept{"nome", u"O'Brien %"_s, u"O'Brien %"_s, u"text 'O''Brien %'"_s},
        Kept{"nome", u"çãéõ€😀🎉abc"_s, u"çãéõ€😀🎉abc"_s, u"text 'çãéõ€😀🎉abc'"_s},
        Kept{"nome", 12.5, u"12.5"_s, u"text '12.5'"_s},
        Kept{"nome", QVariant(), u"NULL"_s, u"null NULL"_s}));

TEST_P(RefusesValue, AndKeepsWhatWasThere) {
    SmallBook book;
    const QString column = QString::fromLatin1(GetParam().column);
    const auto rows = openRows(u"select * from tbMov"_s, book.connect());
    rows->AddNew();
    EXPECT_EQ(failureNumberOf([&] { rows->setCollect(column, GetParam().written); }),
              GetParam().number);
    EXPECT_FALSE(rows->Collect(column).isValid());
    EXPECT_TRUE(rows->isNewRow());
}

INSTANTIATE_TEST_SUITE_P(
    Columns, RefusesValue,
    testing::Values(
        RefusedValue{"socio", 2147483648.0, core::Overflow},
        RefusedValue{"socio", u"12a"_s, core::TypeMismatch},
        RefusedValue{"socio", u""_s, core::TypeMismatch},
        RefusedValue{"pequeno", 40000, core::Overflow},
        RefusedValue{"grande", 1e19, core::Overflow},
        RefusedValue{"valor", u"12,5"_s, core::TypeMismatch},
        RefusedValue{"valor", u"1e400"_s, core::Overflow},
        RefusedValue{"valor", Infinity, core::Overflow},
        RefusedValue{"valor", 1e16, core::Overflow},
        RefusedValue{"taxa", -Infinity, core::Overflow},
        RefusedValue{"taxa", std::numeric_limits<double>::quiet_NaN(), core::TypeMismatch},
        RefusedValue{"data", u"31/12/1999"_s, core::TypeMismatch},
        RefusedValue{"data", u"2023-02-29"_s, core::TypeMismatch},
        RefusedValue{"data", 5, core::TypeMismatch},
        RefusedValue{"nome", u"onze letras"_s, core::Overflow},
        RefusedValue{"nome", QString(u"a"_s + QChar(u'\0') + u"b"_s), core::TypeMismatch}));

TEST(Singles, AreThirtyTwoBits) {
    SmallBook book;
    const auto rows = openRows(u"select * from tbSoma"_s, book.connect());
    rows->AddNew();
    rows->setCollect(u"credito"_s, 33.33 * 0.7);
    EXPECT_EQ(rows->Collect(u"credito"_s), QVariant(static_cast<float>(33.33 * 0.7)));
    EXPECT_EQ(failureNumberOf([&] { rows->setCollect(u"credito"_s, 1e39); }), core::Overflow);
    rows->Update();
    EXPECT_EQ(rows->Collect(u"credito"_s), QVariant(static_cast<float>(33.33 * 0.7)));
}

TEST(Amounts, ThatABinaryNumberDoesNotHoldAreRefusedNotBent) {
    SmallBook book;
    const auto rows = openRows(u"select * from tbMov"_s, book.connect());
    rows->AddNew();
    rows->setCollect(u"valor"_s, u"922337203685477.5807"_s);
    EXPECT_EQ(failureNumberOf([&] { rows->Update(); }), core::Overflow);
    rows->setCollect(u"valor"_s, u"900719925474.0991"_s);
    rows->Update();
    EXPECT_EQ(core::toText(rows->Collect(u"valor"_s)), u"900719925474.0991"_s);
}

TEST(Columns, TellTheirTypeAndSize) {
    SmallBook book;
    const auto rows = openRows(u"select * from tbMov"_s, book.connect());
    EXPECT_EQ(rows->Fields(u"NOME"_s).Name(), u"nome"_s);
    EXPECT_EQ(rows->Fields(u"nome"_s).DefinedSize(), 10);
    EXPECT_EQ(rows->Fields(u"obs"_s).DefinedSize(), 0);
    EXPECT_EQ(rows->Fields(u"valor"_s).Type(), ado::ColumnType::Money);
    EXPECT_EQ(rows->Fields(0).Type(), ado::ColumnType::Integer32);
    EXPECT_EQ(rows->columnCount(), 11);
    EXPECT_TRUE(rows->hasColumn(u"Grande"_s));
    EXPECT_FALSE(rows->hasColumn(u"outra"_s));
    EXPECT_TRUE(failureOf([&] { rows->Fields(u"outra"_s); }).contains(u"«outra»"_s));
    EXPECT_EQ(failureNumberOf([&] { rows->Fields(11); }), core::NoSuchItem);
}
