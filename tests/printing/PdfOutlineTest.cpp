// SPDX-License-Identifier: MIT
// Bookmarks, from the rows to what other programs read in a PDF.
#include "platform/printing/PdfOutline.h"

#include <QFile>
#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QProcess>
#include <QTemporaryDir>

#include "platform/printing/Output.h"
#include "reports/ExtractReports.h"
#include "tests/printing/Ledger.h"

using namespace Qt::StringLiterals;
using support::failureOf;

namespace {

QByteArray outputOf(const QString& program, const QStringList& arguments) {
    QProcess process;
    process.start(program, arguments);
    EXPECT_TRUE(process.waitForFinished() && process.exitCode() == 0)
        << program.toStdString() << process.readAllStandardError().toStdString();
    return process.readAllStandardOutput();
}

/// Lines "page name" of the bookmarks, pages counted from 1.
QStringList inPages(const printing::Pages& pages) {
    QStringList lines;
    for (int at = 0; at < pages.bookmarkCount(); ++at) {
        const printing::Bookmark bookmark = pages.bookmark(at);
        lines << QString::number(bookmark.page + 1) + u' ' + bookmark.text;
    }
    return lines;
}

/// The same of a file's outline, as another program reads it.
QStringList inFile(const QString& file) {
    EXPECT_TRUE(outputOf(u"qpdf"_s, {u"--check"_s, file}).contains("No syntax"));
    const QJsonDocument document =
        QJsonDocument::fromJson(outputOf(u"qpdf"_s, {u"--json"_s, u"--json-key=outlines"_s, file}));
    QStringList lines;
    for (const QJsonValue& entry : document[u"outlines"_s].toArray())
        lines << QString::number(entry[u"destpageposfrom1"_s].toInt()) + u' ' +
                     entry[u"title"_s].toString();
    return lines;
}

class Bookmarks : public Ledger {
protected:
    static printing::Page pageSaying(const QString& text) {
        printing::Page page;
        page.texts.push_back({.baseline = {20, 20}, .width = 30, .text = text, .style = {}});
        return page;
    }
    QTemporaryDir folder;
    const QString file = folder.filePath(u"x.pdf"_s);
};

TEST_F(Bookmarks, NameThePageOfEachRowByWhatItsColumnsSay) {
    fill(80);
    const auto rows = [&] {
        return open(
            u"SELECT m.*, debito - credito AS saldo, debito AS euros, tipo AS rubrica, CASE "
            "movimento_no WHEN 2 THEN 'ab%1' WHEN 3 THEN ' a\n\tb ' ELSE doc_no END AS documento "
            "FROM tbZelmar_Movimentos m ORDER BY movimento_no"_s.arg(u"😀"_s.repeated(200)));
    };
    printing::Report report = reports::rptExtrato2();
    EXPECT_EQ(inPages(*laidOut(report, rows())), QStringList());
    report.bookmark = {u"movimento_no"_s, u"documento"_s, u"modo_pagamento"_s};
    const auto pages = laidOut(report, rows());
    const QStringList lines = inPages(*pages);
    ASSERT_EQ(lines.size(), 80);
    EXPECT_EQ(lines[0], u"1 1 - FT 2026/1 - TRF"_s);
    EXPECT_EQ(lines[1], u"1 2 - ab"_s + u"😀"_s.repeated(96) + u'…');  // no half letter
    EXPECT_EQ(lines[2], u"1 3 - a b - TRF"_s);
    EXPECT_EQ(lines[6], u"1 7 - TRF"_s);  // a null
    for (const int row : {40, 50, 52, 54, 60, 79}) {
        const printing::Bookmark bookmark = pages->bookmark(row);
        EXPECT_TRUE(textsOf(*pages, bookmark.page).contains(bookmark.text.section(u" - "_s, 1, 1)))
            << row;
    }
    EXPECT_EQ(pages->bookmark(79).page, pages->count() - 1);
    report.bookmark = {u"nada"_s};
    EXPECT_EQ(failureOf([&] { laidOut(report, rows()); }).number(), core::NoSuchItem);
}

TEST_F(Bookmarks, NameThePageWhereAGroupBegins) {
    // The second group's head finds no room on the page that the first one fills.
    printing::Report report = twoLevels();
    report.bookmark = {u"hospital"_s};
    book.hospital(u"1"_s, u"B"_s);
    book.hospital(u"2"_s, u"A"_s);
    int moved = 0;
    for (int rows = 0, before = 0; rows < 120; rows += 2) {
        book.exec(u"delete from tbZelmar_Movimentos"_s);
        fill(rows);
        const auto pages = laidOut(report, open(TwoLevelQuery));
        ASSERT_EQ(pages->bookmarkCount(), 2);
        const int page = pages->bookmark(1).page;
        EXPECT_TRUE(textsOf(*pages, page).contains(u"Hospital:|B|"_s)) << rows;
        EXPECT_EQ(inPages(*pages)[0], u"1 A"_s);
        moved += page > std::exchange(before, page) ? 1 : 0;
    }
    EXPECT_EQ(moved, 1);
}

TEST_F(Bookmarks, AreReadByOtherProgramsAsTheyAre) {
    printing::Pages pages;
    pages.caption = u"Recibos (2026) \\ João"_s;
    pages.add(pageSaying(u"um"_s));
    pages.add(pageSaying(u"dois"_s));
    for (const QString& text : {u"Ação (1"_s, u"2) \\"_s, u"\\"_s, u"😀 šč ⠨⠩ ഊ"_s,
                                u"/Outlines 9 0 R endobj"_s, u"x"_s.repeated(9000)})
        pages.addBookmark({pages.bookmarkCount() / 3, text});
    pages.complete();
    printing::writePdf(pages, file);
    EXPECT_EQ(inFile(file), inPages(pages));
    const QByteArray facts = outputOf(u"pdfinfo"_s, {file});
    EXPECT_TRUE(facts.contains("Recibos (2026) \\ João\n")) << facts.toStdString();
    const QByteArray all =
        outputOf(u"qpdf"_s, {u"--qdf"_s, u"--object-streams=disable"_s, file, u"-"_s});
    EXPECT_TRUE(all.contains("/Lang (pt-PT)"));
    EXPECT_TRUE(all.contains("/PageMode /UseOutlines"));
    EXPECT_EQ(outputOf(u"pdftotext"_s, {file, u"-"_s}).simplified(), "um dois");
}

TEST_F(Bookmarks, AreAsManyAsThereAreOnThePagesWritten) {
    printing::Pages pages;
    constexpr int Pages = 2000;  // their list does not fit into what is read at once
    constexpr int Each = 5;
    for (int page = 0; page < Pages; ++page) {
        pages.add(pageSaying(QString::number(page)));
        for (int at = 0; at < Each; ++at) pages.addBookmark({page, u"n.º %1"_s.arg(page)});
    }
    pages.complete();
    const QStringList every = inPages(pages);
    printing::writePdf(pages, file);
    EXPECT_EQ(inFile(file), every);
    printing::writePdf(pages, {7, 8, QPageSize(QPageSize::A4)}, file);
    EXPECT_EQ(inFile(file),
              QStringList({u"1 n.º 7"_s, u"1 n.º 7"_s, u"1 n.º 7"_s, u"1 n.º 7"_s, u"1 n.º 7"_s,
                           u"2 n.º 8"_s, u"2 n.º 8"_s, u"2 n.º 8"_s, u"2 n.º 8"_s, u"2 n.º 8"_s}));
    printing::Pages bare;
    bare.add(pageSaying(u"um"_s));
    bare.complete();
    printing::writePdf(bare, file);
    EXPECT_EQ(inFile(file), QStringList());
    EXPECT_TRUE(outputOf(u"qpdf"_s, {u"--qdf"_s, file, u"-"_s}).contains("/Lang (pt-PT)"));
}

TEST_F(Bookmarks, AreRefusedByAFileThatTheWriterDidNotMake) {
    printing::Pages pages;
    pages.add(pageSaying(u"um"_s));
    pages.addBookmark({0, u"um"_s});
    pages.complete();
    printing::writePdf(pages, file);
    QFile written(file);
    ASSERT_TRUE(written.open(QIODevice::ReadWrite));
    const QByteArray updated = written.readAll();
    // What the writer alone made, and then damaged.
    const QByteArray sound = updated.left(updated.indexOf("%%EOF\n") + 6);
    const auto with = [&](const char* before, const char* after) {
        return QByteArray(sound).replace(before, after);
    };
    const auto tryOn = [&](const QByteArray& bytes) {
        written.resize(0);
        written.seek(0);
        written.write(bytes);
        addOutline(written, pages, 0, 0);
    };
    tryOn(sound);
    EXPECT_GT(written.size(), sound.size());
    for (const QByteArray& bytes :
         {QByteArray(), QByteArray("%PDF-1.4\n"), with("startxref", "startxyz"),
          with("/Root", "/Rood"), with("/Kids", "/Kidz"), with("xref\n0 ", "xref\n1 "),
          with(" 0 obj", " 1 obj"), with("00000 n", "00000 f"), with("/Size ", "/Size 9"),
          sound.left(sound.size() / 2)}) {
        EXPECT_TRUE(failureOf([&] { tryOn(bytes); })
                        .text()
                        .startsWith(u"Não foi possível pôr os marcadores em «%1»"_s.arg(file)));
        EXPECT_EQ(written.size(), bytes.size());
    }
}

}  // namespace
