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
    search.nameMember(1, "100015", "António Manuel Silva Matos");
    search.nameMember(2, "12040", "Conceição d'Araújo");
    search.nameMember(3, "100073", "ANA SÁ");
    qint32 key = 100;
    const auto add = [&](qint32 number, qint32 socio, const char* code, QDate day, const char* tipo,
                         const char* document) {
        search.append({.movimento_id = key--,
                       .movimento_no = number,
                       .socio_id = socio,
                       .codABC = code,
                       .data = day,
                       .tipo = tipo,
                       .doc_no = document});
    };
    add(1205, 1, "A", {2026, 11, 22}, "DOC", "FT 2026/118");
    add(1204, 1, "C1", {2026, 11, 21}, "HOS", "77001");
    add(1203, 2, "B", {2026, 11, 21}, "DOC", "a-9%");
    add(120, 3, "", {2026, 2, 1}, "PAG", "");
    add(12, 2, "A", {2025, 11, 21}, "ANL", "1204");
    add(0, 9, "A", {}, "SA", "");
    search.nameRelative(1, "A", "António Manuel Silva Matos");
    search.nameRelative(1, "C1", "Inês Matos");
    search.nameRelative(2, "B", "João Gonçalves");
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
