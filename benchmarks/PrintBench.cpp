// SPDX-License-Identifier: MIT
// Reports: pages as PDF against a bare PDF writer that draws the same texts at the same places;
// memory of a long one, and how soon its first page is seen.
#include <malloc.h>

#include <QElapsedTimer>
#include <QPainter>
#include <QPdfWriter>
#include <QTemporaryDir>

#include "benchmarks/Bare.h"
#include "benchmarks/Benches.h"
#include "benchmarks/FirstPage.h"
#include "boundary/environment/dtZelmars.h"
#include "platform/printing/Layout.h"
#include "platform/printing/Output.h"
#include "platform/printing/Typesetting.h"
#include "reports/DebtReports.h"
#include "reports/ExtractReports.h"

using namespace Qt::StringLiterals;

namespace benchmarks {

namespace {

constexpr int Movements = 100'000;
constexpr int ManyPages = 5'000;
constexpr int Letters = 20'000;

/// The first so many movements, as the extracts of a member select them.
ado::RecordsetPtr movements(int count) {
    const double last = bare(largeBook())
                            ->run(
                                "SELECT movimento_id FROM tbZelmar_Movimentos WHERE tipo = 'DOC' "
                                "ORDER BY movimento_id "
                                "LIMIT 1 OFFSET " +
                                QByteArray::number(count - 1));
    const ado::RecordsetPtr rows = ado::Recordset::create();
    rows->setClientSide(true);
    rows->Open(
        u"SELECT tbZelmar_Movimentos.*, debito - credito AS saldo, debito*(200.482) AS euros, "
        "tbZelmar_Plafonds.descrit AS rubrica, tbSocios_Familias.nome AS Familiar FROM "
        "((tbZelmar_Movimentos LEFT OUTER JOIN tbZelmar_Plafonds ON "
        "tbZelmar_Movimentos.rubrica_id = tbZelmar_Plafonds.rubrica_id) LEFT OUTER JOIN "
        "tbSocios_Familias ON ((tbZelmar_Movimentos.socio_id = tbSocios_Familias.socio_id) AND "
        "(tbZelmar_Movimentos.codABC = tbSocios_Familias.codABC))) WHERE "
        "(tbZelmar_Movimentos.tipo = 'DOC') AND (tbZelmar_Movimentos.movimento_id <= %1) ORDER BY "
        "movimento_id"_s.arg(last, 0, 'f', 0),
        environment::dtZelmars::instance().SqlServer());
    return rows;
}

double milliseconds(const QElapsedTimer& clock) {
    return static_cast<double>(clock.nsecsElapsed()) / 1e6;
}

/// The texts of laid-out pages; only the drawing counts.
double drawBare(const printing::Pages& pages, const QString& file) {
    QElapsedTimer clock;
    clock.start();
    QPdfWriter writer(file);
    writer.setResolution(printing::UnitsPerInch);
    writer.setPageSize(QPageSize(QPageSize::A4));
    writer.setPageMargins({});
    QPainter painter(&writer);
    printing::Faces faces;
    double spent = milliseconds(clock);
    for (int at = 0; at < pages.count(); ++at) {
        const printing::Page page = pages.at(at);
        clock.restart();
        if (at > 0) writer.newPage();
        printing::Style style{.points = 0};
        for (const printing::TextRun& run : page.texts) {
            if (style != run.style) painter.setFont(faces.of(style = run.style).font);
            painter.drawText(run.baseline * printing::UnitsPerMillimetre, run.text);
        }
        spent += milliseconds(clock);
    }
    clock.restart();
    painter.end();
    return spent + milliseconds(clock);
}

const QString Memory = u"report of 5,000 pages, memory"_s;
const QString FirstPage = u"report of 5,000 pages, first page shown"_s;

QString pdfOf(const printing::Report& design) {
    return design.name + u" to PDF"_s;
}

void measurePdf(Report& report, const printing::Report& design, const ado::RecordsetPtr& rows,
                int rounds) {
    const QTemporaryDir folder;
    const QString file = folder.filePath(u"pages.pdf"_s);
    std::vector<double> ours, theirs;
    double pages = 0, bytes = 0;
    for (int round = 0; round < rounds; ++round) {
        QElapsedTimer clock;
        clock.start();
        printing::Layout layout(design, rows);
        layout.go(-1);
        printing::writePdf(*layout.pages(), file);
        pages = layout.pages()->count();
        ours.push_back(milliseconds(clock) / pages);
        bytes = static_cast<double>(QFileInfo(file).size());
        theirs.push_back(drawBare(*layout.pages(), file) / pages);
    }
    report.ratio(pdfOf(design), 1.3, ours, theirs);
    report.value(pdfOf(design) + u", size of a page"_s, u"KB"_s, 4, bytes / pages / 1024);
}

/// One debtor a letter, whose texts are of usual lengths.
ado::RecordsetPtr debtors(int count) {
    const ado::RecordsetPtr rows = ado::Recordset::create();
    rows->setClientSide(true);
    rows->Open(
        u"SELECT no_kor, nome, morada1, code_postal1 + ' ' + localidade1 AS code_completo, "
        "socio_id AS divida FROM tbSocios WHERE socio_id <= %1 ORDER BY socio_id"_s.arg(count),
        environment::dtZelmars::instance().SqlServer());
    return rows;
}

/// Rows and pages together, from nothing to the last page.
void measureMemory(Report& report) {
    // Memory that earlier measures used and gave back is returned first, so that it is neither
    // counted nor used again.
    malloc_trim(0);
    mallopt(M_MMAP_THRESHOLD, 128 * 1024);
    const double before = residentMegabytes(QCoreApplication::applicationPid());
    const ado::RecordsetPtr rows = movements(ManyPages * 56);
    printing::Layout layout(reports::rptExtrato2(), rows);
    layout.go(-1);
    const bool enough = layout.pages()->count() >= ManyPages;
    // A shorter report would pass without having been measured.
    report.value(Memory, u"MB"_s, 150,
                 enough ? residentMegabytes(QCoreApplication::applicationPid()) - before : 1e9);
}

void measureFirstPage(Report& report) {
    const ado::RecordsetPtr rows = movements(ManyPages * 56);
    const double shown = report.medianOf(
        3, [&] { return timedFirstPage(reports::rptExtrato2(), [&] { return rows; }); });
    report.value(FirstPage, u"ms"_s, 300, shown);
}

}  // namespace

void measurePrinting(Report& report) {
    const auto measure = [&](const QString& name, const std::function<void()>& work) {
        if (!report.wanted(name)) return;
        use(largeBook());
        work();
    };
    const printing::Report summary = reports::rptExtrato2();
    const printing::Report detailed = reports::prtExtrato1();
    measure(pdfOf(summary), [&] { measurePdf(report, summary, movements(Movements), 3); });
    // Six times as many pages.
    measure(pdfOf(detailed), [&] { measurePdf(report, detailed, movements(Movements), 1); });
    const printing::Report letters = reports::Print_frmCartasDividas();
    measure(pdfOf(letters), [&] { measurePdf(report, letters, debtors(Letters), 3); });
    measure(Memory, [&] { measureMemory(report); });
    measure(FirstPage, [&] { measureFirstPage(report); });
}

}  // namespace benchmarks
