// SPDX-License-Identifier: MIT
// The ways out of pages: PDF, a real print queue, rows for a spreadsheet.
#include "platform/printing/Output.h"

#include <sys/stat.h>

#include <QDir>
#include <QPrinter>
#include <QPrinterInfo>
#include <QProcess>
#include <QProgressBar>

#include "platform/printing/DataReport.h"
#include "reports/ExtractReports.h"
#include "tests/printing/Ledger.h"
#include "tests/support/Operator.h"
#include "tests/support/PrintServer.h"

using namespace Qt::StringLiterals;
using support::failureOf;

namespace {

/// What a program writes; the test fails when the program does.
QString outputOf(const QString& program, const QStringList& arguments) {
    QProcess process;
    process.start(program, arguments);
    EXPECT_TRUE(process.waitForFinished() && process.exitCode() == 0)
        << program.toStdString() << process.readAllStandardError().toStdString();
    EXPECT_EQ(process.readAllStandardError().toStdString(), "");
    return QString::fromUtf8(process.readAllStandardOutput());
}

/// The text of a PDF that is sound and brings its fonts along.
QString textOfPdf(const QString& file) {
    EXPECT_TRUE(outputOf(u"qpdf"_s, {u"--check"_s, file}).contains(u"No syntax"_s));
    EXPECT_TRUE(outputOf(u"pdffonts"_s, {file}).contains(u"LiberationSans"_s));
    return outputOf(u"pdftotext"_s, {u"-layout"_s, file, u"-"_s}).simplified();
}

class ReportOutput : public Ledger {
protected:
    ReportOutput() {
        fill(40);
        report.setCaption(u"Section4"_s, u"nome"_s, u"Conceição Muñoz"_s);
    }
    /// The pages say what was asked for, to the last total: 40 debits of n + 0.1, credits a euro
    /// less.
    static void expectExtract(const QString& file) {
        const QString text = textOfPdf(file);
        for (const QString& part :
             {u"Extracto de Lançamentos"_s, u"Associado: Conceição Muñoz"_s, u"FT 2026/39"_s,
              u"9 de março de 2026"_s, u"Página: 2 / 2"_s, u"Total Creditado: € 784,00"_s,
              u"Total Recebido: € 824,00"_s, u"Total em Dívida: € 40,00"_s, u"165.197,17 Esc"_s})
            EXPECT_TRUE(text.contains(part)) << part.toStdString() << "\n" << text.toStdString();
    }
    static QStringList documents() {
        return QDir(QDir::homePath() + u"/Documents"_s).entryList(QDir::Files);
    }
    static QString document(const QString& name) {
        return QDir::homePath() + u"/Documents/"_s + name;
    }

    printing::DataReport report{reports::rptExtrato2()};
    QTemporaryDir folder;
    support::Operator person;
};

TEST_F(ReportOutput, WritesPdfsOrSaysWhyNot) {
    const QString file = folder.filePath(u"extracto.pdf"_s);
    writePdf(*laidOut(reports::prtExtrato1(), movements()), file);
    EXPECT_TRUE(textOfPdf(file).contains(u"Total a Receber: € 824,00 Escudos: 165.197,17 Esc"_s));
    const auto pages = laidOut(report.design(), movements());
    writePdf(*pages, file);
    expectExtract(file);
    const QString nowhere = folder.filePath(u"não há/extracto.pdf"_s);
    EXPECT_TRUE(failureOf([&] { writePdf(*pages, nowhere); })
                    .text()
                    .startsWith(u"Não foi possível escrever «%1»"_s.arg(nowhere)));
}

TEST_F(ReportOutput, IsReadByItsOwnerOnlyAlsoInPlaceOfAFileThatAllCouldRead) {
    const auto pages = laidOut(report.design(), movements());
    const mode_t before = ::umask(0);
    for (const QString& name : {u"x.pdf"_s, u"x.csv"_s})
        for (int round = 0; round < 2; ++round) {
            const QString file = folder.filePath(name);
            name.endsWith("pdf"_L1) ? void(writePdf(*pages, file))
                                    : writeCsv(report.design(), movements(), file);
            struct stat facts {};
            ::stat(QFile::encodeName(file).constData(), &facts);
            EXPECT_EQ(facts.st_mode & 07777, 0600u) << name.toStdString();
            ::chmod(QFile::encodeName(file).constData(), 0644);
        }
    ::umask(before);
}

TEST_F(ReportOutput, PrintsOnTheDefaultPrinterWithoutAsking) {
    support::PrintServer server;
    report.PrintReport(movements());
    EXPECT_EQ(server.titles(1), QStringList{u"Extracto de Lançamentos"_s});
    expectExtract(server.file(1));
}

TEST_F(ReportOutput, PrintsWholeJobsOrNone) {
    support::PrintServer server;
    const auto pages = laidOut(report.design(), movements());
    const QPrinter printer(QPrinterInfo::defaultPrinter());
    EXPECT_FALSE(print(*pages, printer, 0, 1, [](int done) { return done < 2; }));
    qputenv("TMPDIR", "/proc");
    EXPECT_TRUE(failureOf([&] { print(*pages, printer, 0, 1); })
                    .text()
                    .startsWith(u"Não foi possível imprimir em «Secretaria»."_s));
    qunsetenv("TMPDIR");
    report.PrintReport(movements());
    EXPECT_EQ(server.titles(1).size(), 1);
    expectExtract(server.file(1));  // the first job that the server got
}

TEST_F(ReportOutput, IsGivenUpByAClickWhileItIsPrepared) {
    const ado::RecordsetPtr rows = open(
        u"SELECT m.*, m.debito - m.credito AS saldo, m.debito AS euros, m.tipo AS rubrica FROM "
        "tbZelmar_Movimentos m, tbZelmar_Movimentos AS times, tbZelmar_Movimentos AS again"_s);
    const auto giveUp = [&] {
        person.expectBox(
            {.text = u"A impressão foi cancelada. Nada foi enviado para a impressora."_s,
             .icon = core::Icon::Information,
             .title = u"Extracto de Lançamentos"_s});
        report.PrintReport(rows);
    };
    const auto whileTheJobIsMade = [&] {
        auto* bar = person.here()->findChild<QProgressBar*>();
        QObject::connect(bar, &QProgressBar::valueChanged, bar, [this, bar](int value) {
            if (value > bar->maximum() / 2) bar->disconnect(), person.click(u"Cancelar"_s);
        });
    };
    person.onScreen(u"Progresso"_s, whileTheJobIsMade);
    giveUp();  // no printer: a file is written
    EXPECT_EQ(documents(), QStringList());
    support::PrintServer server;
    person.onScreen(u"Progresso"_s, [&] { person.click(u"Cancelar"_s); });
    giveUp();
    person.onScreen(u"Progresso"_s, whileTheJobIsMade);
    giveUp();
    EXPECT_EQ(rows->State(), ado::adStateOpen);
    report.PrintReport(movements());
    EXPECT_EQ(server.titles(1).size(), 1);
    expectExtract(server.file(1));  // the first job that the server got
}

TEST_F(ReportOutput, LosesNothingWithoutAPrinter) {
    const QString name = u"Extracto de Lançamentos 09-03-2026"_s;
    const auto expectBox = [&](const QString& text) {
        person.expectBox({.text = text, .icon = core::Icon::Information, .partly = true});
    };
    {
        const support::PrintServer server(support::PrintServer::Printer::Refusing);
        expectBox(u"not accepting jobs.\n\nAs páginas ficaram guardadas no ficheiro\n"_s +
                  document(name));
        report.PrintReport(movements());
    }
    expectBox(u"impressora predefinida.\n\nAs páginas ficaram guardadas no ficheiro\n"_s +
              document(name + u" (2).pdf"_s));
    report.PrintReport(movements());
    EXPECT_EQ(documents(), QStringList({name + u" (2).pdf"_s, name + u".pdf"_s}));
    expectExtract(document(name + u".pdf"_s));

    // Something else stands where the documents folder should be.
    QDir(document({})).removeRecursively();
    QFile inTheWay(QDir::homePath() + u"/Documents"_s);
    ASSERT_TRUE(inTheWay.open(QIODevice::WriteOnly));
    expectBox(QDir::homePath() + u'/' + name + u".pdf"_s);
    report.PrintReport(movements());
    expectExtract(QDir::homePath() + u'/' + name + u".pdf"_s);
    QFile::remove(inTheWay.fileName());
}

TEST_F(ReportOutput, GivesRowsThatSpreadsheetsReadAndDoNotRun) {
    const QStringList texts =
        u"=1+1|a;\"b\"|-12,5|100015|00123|1E5|2026/3|1.20|12345678901234567"_s.split(u'|');
    const QStringList cells =
        u"'=1+1|a;\"\"b\"\"|-12,5|100015|'00123|'1E5|'2026/3|'1.20|'12345678901234567"_s.split(
            u'|');
    for (int row = 1; row <= texts.size(); ++row)
        book.exec(
            u"update tbZelmar_Movimentos set debito = -1234.5, doc_no = '%1' where movimento_no = %2"_s
                .arg(texts[row - 1])
                .arg(row));
    const QString file = folder.filePath(u"linhas.csv"_s);
    const auto written = [&](const printing::Report& design, const ado::RecordsetPtr& rows) {
        writeCsv(design, rows, file);
        QFile csv(file);
        EXPECT_TRUE(csv.open(QIODevice::ReadOnly));
        return csv.readAll();
    };
    const QByteArray lines = written(report.design(), movements());
    EXPECT_TRUE(lines.startsWith(
        "\ufeff\"movimento_no\";\"data\";\"codABC\";\"tipo\";\"rubrica\";\"doc_no\";\"doc_valor\";"
        "\"modo_pagamento\";\"credito\";\"debito\"\r\n1;02-01-2026;\"A\";\"DOC\";"
        "\"Consultas de especialidade\";\"'=1+1\";1,25;\"TRF\";0,1;-1234,5\r\n"));
    for (int row = 1; row <= texts.size(); ++row)
        EXPECT_TRUE(lines.contains(u";\"%1\";%2,25;"_s.arg(cells[row - 1]).arg(row).toUtf8()));
    book.exec(u"delete from tbZelmar_Movimentos where movimento_no > 2"_s);
    book.hospital(u"1"_s, u"Hospital A"_s);
    EXPECT_EQ(written(twoLevels(), open(TwoLevelQuery)).toStdString(),
              "\ufeff\"hospital\";\"movimento_no\";\"divida\"\r\n\"Hospital A\";2;-1235,6\r\n");
}

}  // namespace
