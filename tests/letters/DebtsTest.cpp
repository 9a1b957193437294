// SPDX-License-Identifier: MIT
// Who owes: list and letters, by the operations that hosts call.
#include <QApplication>
#include <QLabel>
#include <QProcess>
#include <algorithm>

#include "boundary/General.h"
#include "boundary/environment/dtZelmars.h"
#include "platform/core/Failure.h"
#include "platform/printing/Layout.h"
#include "platform/printing/Output.h"
#include "platform/printing/Preview.h"
#include "reports/DebtReports.h"
#include "reports/ReportRows.h"
#include "reports/TaxQuery.h"
#include "reports/TaxReport.h"
#include "tests/entry/EntryTest.h"
#include "tests/support/PrintServer.h"

using namespace Qt::StringLiterals;

namespace reports {

namespace {

class Debts : public entry::EntryTest {
protected:
    ~Debts() override { closePreviews(); }

    void owe(qint64 member, const QString& debits, const QString& credits,
             const QString& table = u"tbZelmar_Movimentos"_s) {
        book.exec(u"insert into %1 (socio_id, tipo, debito, credito) values (%2, 'HOS', %3, %4)"_s
                      .arg(table)
                      .arg(member)
                      .arg(debits, credits));
    }
    static QList<printing::Preview*> previews() {
        QList<printing::Preview*> shown;
        for (QWidget* window : QApplication::topLevelWidgets())
            if (auto* preview = qobject_cast<printing::Preview*>(window);
                preview && preview->isVisible())
                shown << preview;
        return shown;
    }
    static void closePreviews() {
        for (printing::Preview* preview : previews()) preview->Unload();
    }
    void waitFor(const QString& pages) {
        person.waitUntil([&] { return person.peek<QLabel>(u"Estado"_s)->text() == pages; }, pages);
    }
    static QString textOf(const QString& pdf) {
        QProcess reader;
        reader.start(u"pdftotext"_s, {u"-layout"_s, pdf, u"-"_s});
        EXPECT_TRUE(reader.waitForFinished() && reader.exitCode() == 0) << pdf.toStdString();
        return QString::fromUtf8(reader.readAllStandardOutput());
    }
    /// Number and debt of each row that both reports show.
    static QStringList debtors() {
        const ado::RecordsetPtr rows = openReportRows(u"Print_frmListagemDividas"_s);
        QStringList lines;
        for (; !rows->atEnd(); rows->MoveNext())
            lines << rows->Collect(u"no_kor"_s).toString() + u' ' +
                         rows->Collect(u"divida"_s).toString();
        rows->Close();
        lines.sort();
        return lines;
    }
};

TEST_F(Debts, AreListedAboveTenCents) {
    const qint64 exact = book.member({.no_kor = u"100023"_s});
    const qint64 computed = book.member({.no_kor = u"100031"_s});
    const qint64 above = book.member({.no_kor = u"100049"_s});
    owe(socio, u"100"_s, u"40"_s);
    owe(socio, u"0"_s, u"20.5"_s);
    owe(exact, u"0.1"_s, u"0"_s);
    owe(computed, u"0.4"_s, u"0.3"_s);
    owe(above, u"0.11"_s, u"0"_s);
    owe(4711, u"7"_s, u"0"_s);  // of nobody who is known
    const QString inactive = u"tbZelmar_Movimentos_Inactivos"_s;
    book.exec(
        u"insert into tbSocios_Inactivos (socio_id, no_kor) values (%1, '100015')"_s.arg(socio));
    owe(socio, u"1"_s, u"0.5"_s, inactive);
    General general;
    ASSERT_TRUE(general.Login());
    EXPECT_EQ(debtors(),
              (QStringList{u" 7"_s, u"100015 0.5"_s, u"100015 39.5"_s, u"100049 0.11"_s}));

    EXPECT_TRUE(general.Ldividas());
    person.screen(u"Print_frmListagemDividas"_s);
    waitFor(u"Página 1 de 1"_s);
    // The preview was not waited for: a second operation takes its rows, its pages stay.
    EXPECT_TRUE(general.Lcartasdividas());
    EXPECT_EQ(previews().size(), 2);
    person.screen(u"Print_frmCartasDividas"_s);
    waitFor(u"Página 1 de 4"_s);
    person.screen(u"Print_frmListagemDividas"_s);
    waitFor(u"Página 1 de 1"_s);
    EXPECT_TRUE(general.Ldividas());
    EXPECT_EQ(previews().size(), 3);
}

TEST_F(Debts, ASecondListBeforeTheFirstIsLaidOutLeavesBothUsable) {
    for (int at = 0; at < 400; ++at) owe(100'000 + at, u"5"_s, u"0"_s);
    General general;
    ASSERT_TRUE(general.Lcartasdividas());
    person.expectBox({.text = u"Abra-a de novo"_s, .partly = true});
    ASSERT_TRUE(general.Lcartasdividas());
    person.waitUntil([&] { return person.boxesLeft() == 0; }, u"the first says so"_s);
    const auto isWhole = [](const printing::Preview* preview) {
        return preview->findChild<QLabel*>(u"Estado"_s)->text() == u"Página 1 de 400"_s;
    };
    person.waitUntil([&] { return std::ranges::count_if(previews(), isWhole) == 1; },
                     u"the pages of the second"_s);
    EXPECT_EQ(previews().size(), 2);
}

TEST_F(Debts, SayTheSameOnPaperInPdfAndAsRows) {
    owe(socio, u"1234.5"_s, u"0"_s);
    owe(4711, u"0.1100"_s, u"0"_s);
    book.exec(
        u"insert into tbZelmar_Movimentos_Historico (ano, no_kor, nome, tipo, codABC, doc_valor, "
        "debito, recebido) values (2025, '100015', 'Ana', 'DOC', 'A', 100, 60, 10)"_s);
    General general;
    ASSERT_TRUE(general.Login());
    const QString debts =
        environment::dtZelmars::instance().Commands(u"Print_frmListagemDividas"_s).CommandText;
    const struct {
        printing::Report report;
        QString query;
        QByteArray rows;
    } cases[] = {
        {Print_frmListagemDividas(), debts, "\"100015\";\"António Manuel Silva Matos\";1234,5\r\n"},
        {Print_frmCartasDividas(), debts, "\"António Manuel Silva Matos\";\"100015\";"},
        {prtIRS(), taxQuery({.year = u"2025"_s, .codes = {u"A"_s}}),
         "\"Ana\";\"100015\";;2025;30;100;60;10;"}};
    support::PrintServer printer;
    int job = 0;
    for (const auto& each : cases) {
        SCOPED_TRACE(each.report.name.toStdString());
        const ado::RecordsetPtr rows = openReportRows(each.report.dataMember, each.query);
        printing::DataReport(each.report).PrintReport(rows);
        printing::Layout layout(each.report, rows);
        layout.go(-1);
        const QString pdf = book.folder() + u"/%1.pdf"_s.arg(++job);
        printing::writePdf(*layout.pages(), pdf);
        const QString text = textOf(pdf);
        EXPECT_TRUE(text.contains(u"100015"_s)) << text.toStdString();
        EXPECT_EQ(printer.titles(job).last(), each.report.caption);
        EXPECT_EQ(textOf(printer.file(job)).toStdString(), text.toStdString());
        const QString csv = book.folder() + u"/linhas.csv"_s;
        printing::writeCsv(each.report, rows, csv);
        QFile file(csv);
        ASSERT_TRUE(file.open(QIODevice::ReadOnly));
        const QByteArray lines = file.readAll();
        EXPECT_TRUE(lines.contains(each.rows)) << lines.toStdString();
        rows->Close();
    }
}

TEST_F(Debts, WithoutAnyTheListIsEmpty) {
    General general;
    EXPECT_TRUE(general.Ldividas());
    person.screen(u"Print_frmListagemDividas"_s);
    waitFor(u"Página 1 de 1"_s);
    EXPECT_EQ(debtors(), QStringList());
}

TEST_F(Debts, FailInSilenceAndLeaveTheReasonBehind) {
    book.exec(u"alter table tbZelmar_Movimentos_Inactivos rename to tbSairam"_s);
    const core::HandlerScope handler;
    General general;
    EXPECT_FALSE(general.Ldividas());
    EXPECT_NE(core::err().description(), QString());
    core::err().clear();
    EXPECT_FALSE(general.Lcartasdividas());
    EXPECT_NE(core::err().description(), QString());
    EXPECT_TRUE(previews().isEmpty());
}

}  // namespace

}  // namespace reports
