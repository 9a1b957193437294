// SPDX-License-Identifier: MIT
#include "host/MovementSearch.h"

#include <gtest/gtest.h>

#include <QStringList>

#include "platform/core/Clock.h"

using namespace Qt::StringLiterals;

namespace {

/// The newest first; named by their numbers in what is expected below.
host::MovementSearch sampleSearch() {
    host::MovementSearch search;
    search.nameMember(1, u"100015"_s, u"António Manuel Silva Matos"_s);
    search.nameMember(2, u"12040"_s, u"Conceição d'Araújo"_s);
    search.nameMember(3, u"100073"_s, u"ANA SÁ"_s);
    qint32 key = 100;
    const auto add = [&](qint32 number, qint32 socio, const QString& code, QDate day,
                         const QString& tipo, const QString& document) {
        search.append({.movimento_id = key--,
                       .movimento_no = number,
                       .socio_id = socio,
                       .codABC = code,
                       .data = day,
                       .tipo = tipo,
                       .doc_no = document});
    };
    add(1205, 1, u"A"_s, {2026, 11, 22}, u"DOC"_s, u"FT 2026/118"_s);
    add(1204, 1, u"C1"_s, {2026, 11, 21}, u"HOS"_s, u"77001"_s);
    add(1203, 2, u"B"_s, {2026, 11, 21}, u"DOC"_s, u"a-9%"_s);
    add(120, 3, {}, {2026, 2, 1}, u"PAG"_s, {});
    add(12, 2, u"A"_s, {2025, 11, 21}, u"ANL"_s, u"1204"_s);
    add(0, 9, u"A"_s, {}, u"SA"_s, {});
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
    core::setToday(QDate(2026, 11, 22));
    const host::MovementSearch search = sampleSearch();
    const std::pair<const char16_t*, const char*> cases[] = {
        {u"", "100 99 98 97 96 95"},
        // Number, staff number and number of the document, from their beginning.
        {u"1205", "100"},
        {u"1204", "99 98 96"},
        {u"205", ""},
        {u"100015", "100 99"},
        {u"ft", "100"},
        {u"FT 2026/118", "100"},
        {u"A-9%", "98"},
        // Words of the member's or relative's name, from their beginning.
        {u"matos", "100 99"},
        {u"ines", "99"},
        {u"  MAT\tine\u0302s", "99"},
        {u"atos", ""},
        {u"d'ara", "98 96"},
        // Types only in full.
        {u"ho", ""},
        {u"Anl", "96"},
        {u"sa", "97 95"},  // the type, and the name Sá
        // Days.
        {u"21-11-2026", "99 98"},
        {u"21/11/26", "99 98"},
        {u"21-11", "99 98"},  // of this year; later in the year it would be of the last one
        {u"2211", "100"},
        {u"22", "100"},
        {u"2026-11-21", "99 98"},
        {u"hoje", "100"},
        {u"11-2026", "100 99 98"},
        {u"2/2026", "97"},
        {u"31-2-2026", ""},
        // Words hold together.
        {u"21-11 doc", "98"},
        {u"matos silva doc", "100"},
        {u"matos araujo", ""},
        // What nobody means to type does no harm.
        {u"'; drop table x", ""},
    };
    for (const auto& [text, keys] : cases) {
        const QString filter = QString::fromUtf16(text);
        EXPECT_EQ(found(search, filter).toStdString(), keys) << filter.toStdString();
    }
    core::setToday({});
}
