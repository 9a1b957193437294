// SPDX-License-Identifier: MIT
#include "SmallBook.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace {

const QString Listing =
    u"SHAPE {SELECT socio, max(nome) AS quem FROM tbMov GROUP BY socio ORDER BY quem DESC }  AS "
    "lista APPEND ({SELECT tbMov.*, valor - 1 AS resto FROM tbMov WHERE data >= CONVERT(DATETIME, "
    "'01/01/2000 00:00:00',102) ORDER BY id }  AS detalhe RELATE 'socio' TO 'socio') AS detalhe"_s;

class Shapes : public SmallBook {
protected:
    Shapes() {
        book.exec(
            u"INSERT INTO tbMov(socio, nome, valor, data) VALUES (1, 'a', 10, '2001-01-01'),"
            "(2, 'b', 20, '2001-01-01'), (1, 'a', 30, '2001-01-01'), (1, 'a', 40, '1999-01-01'),"
            "(NULL, 'z', 50, '2001-01-01')"_s);
    }
    ado::ConnectionPtr shaping = connectShaping();
};

TEST_F(Shapes, GiveEachRowItsChildren) {
    const auto rows = open(Listing, shaping);
    QStringList lines;
    for (; !rows->atEnd(); rows->MoveNext())
        lines += rows->Collect(u"quem"_s).toString() + u": "_s +
                 valuesOf(rows->Chapter(u"DETALHE"_s), u"valor"_s);
    // A null relates to nothing, and what the period leaves out is no child.
    EXPECT_EQ(lines, QStringList({u"z: "_s, u"b: 20"_s, u"a: 10,30"_s}));

    rows->MoveLast();
    const auto children = rows->Chapter(u"detalhe"_s);
    EXPECT_EQ(core::toText(children->valueAt(1, 4)), u"30"_s);
}

TEST_F(Shapes, GiveMoreChildrenThanAreHeldInMemory) {
    book.exec(u"DELETE FROM tbMov"_s);
    QStringList values;
    for (int id = 1; id <= 900; ++id) values << u"(%1, %2)"_s.arg(id).arg(id % 2);
    book.exec(u"INSERT INTO tbMov(id, socio) VALUES "_s + values.join(u','));
    const QString text(50'000, u'x');  // forty-five megabytes with all of them
    const auto rows = open(
        u"SHAPE {SELECT socio FROM tbMov GROUP BY socio ORDER BY socio} APPEND ({SELECT id, socio, "
        "'%1' AS longo FROM tbMov ORDER BY id} RELATE 'socio' TO 'socio') AS detalhe"_s.arg(text),
        shaping);
    for (int socio : {0, 1}) {
        rows->MoveTo(socio);
        const auto children = rows->Chapter(u"detalhe"_s);
        ASSERT_EQ(children->rowsInMemory(), 450);
        for (int row = 449; row >= 0; --row) {
            ASSERT_EQ(core::toLong(children->valueAt(row, 0)), 2 * row + (socio == 0 ? 2 : 1));
            ASSERT_EQ(core::toText(children->valueAt(row, 2)), text);
        }
    }
}

}  // namespace
