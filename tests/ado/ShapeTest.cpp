// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "SmallBook.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace {

const QString Listing =
    u"SHAPE {SELECT socio, max(nome) AS quem FROM tbMov GROUP BY socio ORDER BY quem DESC }  AS "
    u"lista "
    u"APPEND ({SELECT tbMov.*, valor - 1 AS resto FROM tbMov WHERE data >= CONVERT(DATETIME, "
    u"'01/01/2000 00:00:00',102) ORDER BY id }  AS detalhe RELATE 'socio' TO 'socio') AS detalhe"_s;

class Shapes : public testing::Test {
protected:
    Shapes() {
        book.exec(
            u"INSERT INTO tbMov(socio, nome, valor, data) VALUES (1, 'a', 10, '2001-01-01 "
            u"00:00:00'),"
            u"(2, 'b', 20, '2001-01-01 00:00:00'), (1, 'a', 30, '2001-01-01 00:00:00'),"
            u"(1, 'a', 40, '1999-01-01 00:00:00'), (NULL, 'z', 50, '2001-01-01 00:00:00')"_s);
    }
    SmallBook book;
};

}  // namespace

TEST_F(Shapes, GiveEachRowItsChildren) {
    const auto rows = openRows(Listing, book.connect(u"MSDataShape.1"_s));
    QStringList lines;
    for (; !rows->atEnd(); rows->MoveNext()) {
        QString line = rows->Collect(u"quem"_s).toString() + u':';
        const auto children = rows->Chapter(u"DETALHE"_s);
        for (; !children->atEnd(); children->MoveNext())
            line += u' ' + core::toText(children->Collect(u"valor"_s));
        lines += line;
    }
    // A null relates to nothing, and what the period leaves out is no child.
    EXPECT_EQ(lines, QStringList({u"z:"_s, u"b: 20"_s, u"a: 10 30"_s}));
}

TEST_F(Shapes, GiveChildrenThatListsCanShow) {
    const auto rows = openRows(Listing, book.connect(u"MSDataShape.1"_s));
    rows->MoveLast();
    const auto children = rows->Chapter(u"detalhe"_s);
    EXPECT_EQ(children->RecordCount(), 2);
    EXPECT_EQ(children->rowsInMemory(), 2);
    EXPECT_EQ(core::toText(children->valueAt(1, 4)), u"30"_s);
    children->MoveLast();
    children->Requery();
    EXPECT_EQ(core::toText(children->Collect(u"valor"_s)), u"10"_s);
    EXPECT_EQ(failureNumberOf([&] { rows->Chapter(u"outro"_s); }), core::NoSuchItem);
}

TEST_F(Shapes, AreKnownToShapingConnectionsOnly) {
    EXPECT_TRUE(failureOf([&] { openRows(Listing, book.connect()); }).contains(u"SELECT"_s));
}

TEST_F(Shapes, FailWithTheColumnThatIsMissing) {
    const QString text = QString(Listing).replace(u"TO 'socio'"_s, u"TO 'nada'"_s);
    EXPECT_TRUE(
        failureOf([&] { openRows(text, book.connect(u"MSDataShape.1"_s)); }).contains(u"«nada»"_s));
}
