// SPDX-License-Identifier: MIT
// The listing of hospitals in a book where every movement names one: how soon its first page is
// seen, against the bare engine that reads the rows of the same two queries, and its memory.
#include <malloc.h>

#include <QCoreApplication>

#include "benchmarks/Benches.h"
#include "benchmarks/FirstPage.h"
#include "platform/core/Failure.h"
#include "platform/printing/Layout.h"
#include "reports/HospitalQuery.h"
#include "reports/HospitalReport.h"
#include "reports/ReportRows.h"

using namespace Qt::StringLiterals;

namespace benchmarks {

namespace {

constexpr int Movements = 1'000'000;
constexpr int MostLinesOnAPage = 53;
constexpr int Runs = 3;
/// Megabytes of twenty thousand pages, which are kept packed, and of the rows that they came from.
constexpr double MostMemory = 200;
const QDate NewYear(2026, 1, 1);
const QDate LastDay(2026, 12, 31);

/// Gives every movement without a hospital one of the twelve.
void nameHospitals(const Book& book) {
    const std::unique_ptr<ado::BulkAccess> opened = database::opened(book.place());
    opened->execute(
        "UPDATE tbZelmar_Movimentos SET hospital_id = 1 + movimento_id % 12 "
        "WHERE hospital_id IS NULL");
    if (book.engine == Engine::Postgres) opened->execute("VACUUM ANALYZE tbZelmar_Movimentos");
}

/// The two queries in words that both engines understand.
QByteArrayList bareQueries() {
    const auto united = [](QByteArray query, const char* order) {
        QByteArray left = query;
        left.replace("$", "_Inactivos");
        return query.replace("$", "") + " UNION " + left + order;
    };
    const QByteArray inPeriod =
        "m.data >= '2026-01-01 00:00:00' AND m.data <= '2026-12-31 00:00:00' ";
    return {united("SELECT m.hospital_id, h.nome, h.code FROM tbZelmar_Movimentos$ m LEFT JOIN "
                   "tbHospitais h ON m.hospital_id = h.hospital_id WHERE m.tipo = 'HOS' AND " +
                       inPeriod + "GROUP BY m.hospital_id, h.nome, h.code",
                   " ORDER BY 2"),
            united("SELECT m.*, debito - credito AS divida, s.no_kor, p.code AS rubrica FROM "
                   "tbZelmar_Movimentos$ m LEFT JOIN tbSocios$ s ON m.socio_id = s.socio_id LEFT "
                   "JOIN tbZelmar_Plafonds p ON m.rubrica_id = p.rubrica_id WHERE " +
                       inPeriod,
                   " ORDER BY movimento_id")};
}

ado::RecordsetPtr openListing() {
    return reports::openReportRows(u"Print_frmListagemHospitais"_s,
                                   reports::hospitalListQuery(NewYear, LastDay));
}

/// Megabytes that rows and pages take together, from nothing to the last page.
double memoryOfPages() {
    // Memory that earlier measures used and gave back is returned first, so that it is neither
    // counted nor used again.
    malloc_trim(0);
    mallopt(M_MMAP_THRESHOLD, 128 * 1024);
    const double before = residentMegabytes(QCoreApplication::applicationPid());
    const ado::RecordsetPtr rows = openListing();
    printing::Layout layout(reports::Print_frmListagemHospitais(), rows);
    layout.go(-1);
    if (layout.pages()->count() < Movements / MostLinesOnAPage)
        throw core::Failure(core::InvalidCall, u"the listing does not hold all movements"_s);
    const double after = residentMegabytes(QCoreApplication::applicationPid());
    rows->Close();
    return after - before;
}

}  // namespace

void measureHospitals(Report& report) {
    for (const Engine engine : {Engine::Sqlite, Engine::Postgres}) {
        const QString name = u"hospital listing of 1,000,000 movements/"_s + nameOf(engine);
        if (!report.wanted(name)) continue;
        const BookCopy copy(largeBook(engine));
        nameHospitals(copy.book());
        use(copy.book());
        const double memory = memoryOfPages();
        std::vector<double> ours, theirs;
        for (int run = 0; run < Runs; ++run) {
            ours.push_back(timedFirstPage(reports::Print_frmListagemHospitais(), openListing));
            theirs.push_back(timedBareRows(copy.book(), bareQueries()));
        }
        report.ratio(name + u", first page"_s, 1.5, ours, theirs);
        report.value(name + u", memory"_s, u"MB"_s, MostMemory, memory);
    }
}

}  // namespace benchmarks
