// SPDX-License-Identifier: MIT
// Texts that try to do more than to name a member, typed as his number and given as the statement
// of a new entry: each is refused, and nothing is changed.
#include <QSet>

#include "boundary/General.h"
#include "data/modDlookup.h"
#include "tests/entry/EntryTest.h"
#include "tests/support/Lines.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

/// What no statement of the office may do.
const QStringList Deeds = support::linesOf(QStringLiteral(DEEDS_FILE));

/// How a text closes the quote that it stands in and brings a deed with it.
const QStringList Wrappings = {
    u"'; %1; --"_s,          u"';%1;select '"_s,  u"x' ; /* ; */ %1 --"_s,
    u"\\'; %1; --"_s,        u"') UNION %1 --"_s, u"';\n%1;\n--\n"_s,
    u"'\u00a0;\u00a0%1 '"_s, u"$$'; %1; --$$"_s,  u"' /* '; %1 -- */ '"_s};

/// Functions that do more than give a value, or that no engine can finish.
const QStringList Functions = support::linesOf(QStringLiteral(FUNCTIONS_FILE));

const QStringList Unbalanced = {u"'"_s,
                                u"''' "_s,
                                u"d'Almeida"_s,
                                u"x' AND [y = '"_s,
                                u"x' AND `y = '"_s,
                                u"x' AND \"y = '"_s,
                                u"x' /* "_s,
                                u"x' AND y = $$ '"_s,
                                u"\u0027 or )"_s,
                                u"' OR 1=1 -- "_s,
                                u"' OR 1=1 /*"_s,
                                QString(100000, u'x') + u"'; DELETE FROM tbSocios; --"_s,
                                QString(5001, u'\'') + u"; DELETE FROM tbSocios"_s};

/// What stands behind the opening quote of a member's number.
QStringList hostileTexts() {
    QStringList texts = Unbalanced;
    for (const QString& deed : Deeds)
        for (const QString& wrapping : Wrappings) texts << QString(wrapping).replace(u"%1"_s, deed);
    for (const QString& function : Functions)
        texts << u"' OR %1 IS NULL OR no_kor = '"_s.arg(function);
    return texts;
}

class HostileTexts : public EntryTest {
protected:
    HostileTexts() { EXPECT_EQ(QSet<QString>(texts.begin(), texts.end()).size(), texts.size()); }
    ~HostileTexts() override {
        EXPECT_EQ(state(), before);
        // The program goes on.
        person.expectNoBoxesLeft();
        forms::DefaultInstance<frmMovimentos>::unload();
        openNew();
        typeMember();
        EXPECT_EQ(form().Socio_ID, socio);
    }
    /// Every row of every table, and what an engine keeps besides.
    QString state() {
        const QString besides =
            support::onServer()
                ? u"select (select count(*) from pg_class), (select count(*) from pg_roles), "
                  "(select count(*) from pg_largeobject_metadata), last_value from "
                  "tbsocios_socio_id_seq"_s
                : u"select name, sql from sqlite_schema"_s;
        return book.everything() + book.text(besides);
    }

    const QStringList texts = hostileTexts();
    const QString before = state();
};

TEST_F(HostileTexts, AsAMembersNumberAreRefused) {
    ASSERT_GE(texts.size(), 200);
    openNew();
    for (const QString& text : texts) {
        SCOPED_TRACE(text.left(100).toStdString());
        const QString statement = u"select * from tbSocios where no_kor ='"_s + text + u"'"_s;
        EXPECT_NE(support::failureOf([&] { data::DLookup(statement, {}, u"socio_id"_s); }).text(),
                  QString());
        person.expectBox({.partly = true});
        person.press(Qt::Key_A, Qt::ControlModifier);
        person.paste(text);
        person.tab();
        person.expectNoBoxesLeft();
        ASSERT_EQ(form().Socio_ID, 0);
        ASSERT_TRUE(form().No_Kor->hasFocus());
    }
}

TEST_F(HostileTexts, AsTheStatementOfANewEntryAreRefused) {
    QStringList statements = Deeds;
    statements << u";"_s << u"EXPLAIN DELETE FROM tbSocios"_s << u"VALUES(1)"_s
               << u"select * into tbX from tbSocios"_s << u"select * from tbSocios for update"_s
               << u"select 1"_s + QChar(u'\0');
    for (const QString& text : texts)
        statements << u"select * from tbzelmar_movimentos where doc_no ='"_s + text + u"'"_s;
    for (QString statement : statements) {
        SCOPED_TRACE(statement.left(140).toStdString());
        QString connection = u"SqlServer"_s;
        EXPECT_NE(support::failureOf([&] {
                      General().NewMovimento(false, &connection, &statement);
                  }).text(),
                  QString());
        ASSERT_FALSE(person.isShown(u"frmMovimentos"_s));
    }
}

}  // namespace

}  // namespace entry
