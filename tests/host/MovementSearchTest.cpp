// SPDX-License-Identifier: MIT
#include "host/MovementSearch.h"

#include <gtest/gtest.h>

#include <QStringList>

using namespace Qt::StringLiterals;

namespace {

/// The newest first; named by their numbers in what is expected below.
host::MovementSearch sampleSearch() {
    const struct {
        qint32 number;
        qint32 socio;
        const char* code;
        QDate day;
        const char* tipo;
        const char* document;
    } movements[] = {
        {1205, 1, "A", {2026, 11, 22}, "DOC", "FT 2026/118"},
        {1204, 1, "C1", {2026, 11, 21}, "HOS", "77001"},
        {1203, 2, "B", {2026, 11, 21}, "DOC", "a-9%"},
        {120, 3, "", {2026, 2, 1}, "PAG", ""},
        {12, 2, "A", {2025, 11, 21}, "ANL", "1204"},
        {0, 9, "A", {}, "SA", ""},
    };
    host::MovementSearch search;
    search.nameMember(1, u"100015"_s, u"António Manuel Silva Matos"_s);
    search.nameMember(2, u"12040"_s, u"Conceição d'Araújo"_s);
    search.nameMember(3, u"100073"_s, u"ANA SÁ"_s);
    qint32 key = 100;
    for (const auto& movement : movements)
        search.append({.movimento_id = key--,
                       .movimento_no = movement.number,
                       .socio_id = movement.socio,
                       .codABC = QString::fromLatin1(movement.code),
                       .data = movement.day,
                       .tipo = QString::fromLatin1(movement.tipo),
                       .doc_no = QString::fromLatin1(movement.document)});
    search.nameRelative(1, u"A"_s, u"António Manuel Silva Matos"_s);
    search.nameRelative(1, u"C1"_s, u"Inês Matos"_s);
    search.nameRelative(2, u"B"_s, u"João Gonçalves"_s);
    return search;
}

/// Keys of what a filter finds, one blank between.
QString found(const host::MovementSearch& search, const QString& filter) {
    QStringList keys;
    for (const quint32 position : search.find(filter))
        keys.append(QString::number(search.movimento_id(position)));
    return keys.join(u' ');
}

}  // namespace

TEST(MovementSearch, FindsByEveryColumnNewestFirst) {
    const host::MovementSearch search = sampleSearch();
    const struct {
        const char16_t* filter;
        const char* keys;
    } cases[] = {
        {u"", "100 99 98 97 96 95"},
        {u"   ", "100 99 98 97 96 95"},
        // Number, staff number and number of the document, from their beginning.
        {u"1205", "100"},
        {u"120", "100 99 98 97 96"},
        {u"1204", "99 98 96"},
        {u"205", ""},
        {u"01205", ""},
        {u"100015", "100 99"},
        {u"7700", "99"},
        {u"ft", "100"},
        {u"2026/118", "100"},
        {u"FT 2026/118", "100"},
        {u"A-9%", "98"},
        {u"%", ""},
        // Words of the member's or relative's name, from their beginning.
        {u"matos", "100 99"},
        {u"ines", "99"},
        {u"gonçal", "98"},
        {u"atos", ""},
        {u"araujo", "98 96"},
        {u"d'ara", "98 96"},
        // Types only in full.
        {u"hos", "99"},
        {u"ho", ""},
        {u"Anl", "96"},
        {u"sa", "97 95"},  // the type, and the name Sá
        // Days.
        {u"21-11-2026", "99 98"},
        {u"21/11/26", "99 98"},
        {u"21.11.2026", "99 98"},
        {u"21112026", "99 98"},
        {u"21-11", "99 98 96"},
        {u"11-2026", "100 99 98"},
        {u"2/2026", "97"},
        {u"31-2-2026", ""},
        {u"40-11", ""},
        {u"11-", ""},
        // Words hold together.
        {u"21-11 doc", "98"},
        {u"matos silva doc", "100"},
        {u"matos araujo", ""},
        // What nobody means to type does no harm.
        {u"\U0001F600", ""},
        {u"'; drop table x", ""},
    };
    for (const auto& each : cases)
        EXPECT_EQ(found(search, QString::fromUtf16(each.filter)).toStdString(), each.keys)
            << QString::fromUtf16(each.filter).toStdString();
}

TEST(MovementSearch, FindsTheSameHoweverTheFilterIsWritten) {
    const host::MovementSearch search = sampleSearch();
    const QStringList ways[] = {
        {u"inês matos"_s, u"MATOS INES"_s, u"  mat\tinês "_s, u"ine\u0302s matos"_s},
        {u"joão"_s, u"JOAO"_s, u"joa\u0303o"_s},
        {u"22-11-2026 doc"_s, u"DOC 22/11/26"_s, u"doc 22.11.2026"_s, u"22112026 Doc"_s},
    };
    for (const QStringList& writings : ways) {
        EXPECT_NE(found(search, writings.first()).toStdString(), "");
        for (const QString& writing : writings)
            EXPECT_EQ(found(search, writing), found(search, writings.first()))
                << writing.toStdString();
    }
}

TEST(MovementSearch, TakesNewMovementsInFront) {
    host::MovementSearch search = sampleSearch();
    EXPECT_EQ(search.newest(true), 100);
    const qint32 ofThoseWhoLeft = 1'000'000'001;
    search.prepend({{.movimento_id = ofThoseWhoLeft, .socio_id = 5, .activo = false},
                    {.movimento_id = 101, .movimento_no = 1206, .socio_id = 1, .codABC = u"A"_s}});
    EXPECT_EQ(search.newest(true), 101);
    EXPECT_EQ(search.newest(false), ofThoseWhoLeft);
    EXPECT_EQ(found(search, u"matos"_s).toStdString(), "101 100 99");
    EXPECT_EQ(search.movimento_id(0), ofThoseWhoLeft);
}

TEST(MovementSearch, TextsPastWhatIsKeptDoNoHarm) {
    host::MovementSearch search;
    const QString endless(100'000, u'x');
    search.append({.movimento_id = 1, .socio_id = 1, .doc_no = endless});
    search.nameMember(1, endless, endless);
    EXPECT_EQ(found(search, u"xxx"_s).toStdString(), "1");
    EXPECT_EQ(found(search, endless).toStdString(), "");
}
