// SPDX-License-Identifier: MIT
// Reports over a large book: how soon the first page is seen, against the bare engine that reads
// the rows of the same query.
#include "benchmarks/Benches.h"
#include "benchmarks/FirstPage.h"
#include "payments/PaymentQueries.h"
#include "reports/PaymentReports.h"
#include "reports/ReportRows.h"
#include "reports/TaxQuery.h"
#include "reports/TaxReport.h"

using namespace Qt::StringLiterals;

namespace benchmarks {

namespace {

constexpr int Runs = 3;
const QDate NewYear(2026, 1, 1);
const QDate LastDay(2026, 12, 31);

struct Listing {
    QString name;
    printing::Report design;
    QString query;
    QByteArray bareQuery;  ///< in words that both engines understand
};

Listing transfers() {
    const auto of = [](const QByteArray& suffix) {
        QByteArray query =
            "SELECT m.socio_id, s.no_kor, s.nome_guerra, s.nib, SUM(m.debito) FROM "
            "tbZelmar_Movimentos$ m LEFT JOIN tbSocios$ s ON m.socio_id = s.socio_id WHERE m.data "
            ">= '2026-01-01 00:00:00' AND m.data <= '2026-12-31 00:00:00' AND m.modo_pagamento = "
            "'TRF' GROUP BY m.socio_id, s.no_kor, s.nome_guerra, s.nib HAVING SUM(m.debito) > 1 ";
        return query.replace("$", suffix);
    };
    return {u"transfer list of 1,000,000 movements"_s, reports::Print_frmTRF_TRF(),
            payments::transferListQuery(NewYear, LastDay),
            of("") + "UNION " + of("_Inactivos") + "ORDER BY 2"};
}

Listing declarations() {
    const QStringList codes{u"A"_s, u"B"_s, u"C1"_s, u"C2"_s};
    return {
        u"declarations of 1,000,000 movements"_s, reports::prtIRS(),
        reports::taxQuery({.year = u"1999"_s, .codes = codes}),
        "SELECT ano, no_kor, nome, morada, localidade_completo, no_contribuinte, "
        "SUM(doc_valor - debito - recebido), SUM(doc_valor), SUM(debito), SUM(recebido) FROM "
        "tbZelmar_Movimentos_Historico WHERE (tipo = 'DOC' OR tipo = 'HOS') AND ano = 1999 AND "
        "(codABC = 'A' OR codABC = 'B' OR codABC = 'C1' OR codABC = 'C2') GROUP BY ano, no_kor, "
        "nome, morada, localidade_completo, no_contribuinte ORDER BY no_kor"};
}

/// All movements of the year, as documents of a year that was closed before.
void closeYear(const Book& book) {
    const std::unique_ptr<ado::BulkAccess> opened = database::opened(book.place());
    opened->execute(
        "INSERT INTO tbZelmar_Movimentos_Historico (ano, socio_id, no_kor, nome, morada, "
        "localidade_completo, no_contribuinte, tipo, codABC, doc_valor, debito, recebido) SELECT "
        "1999, m.socio_id, s.no_kor, s.nome, s.morada1, s.localidade1, s.no_contribuinte, 'DOC', "
        "'A', m.doc_valor, m.debito, m.recebido FROM tbZelmar_Movimentos m JOIN tbSocios s ON "
        "s.socio_id = m.socio_id");
    if (book.engine == Engine::Postgres)
        opened->execute("VACUUM ANALYZE tbZelmar_Movimentos_Historico");
}

void measure(Report& report, const Listing& listing, const QString& name, const Book& book) {
    use(book);
    std::vector<double> ours, theirs;
    for (int run = 0; run < Runs; ++run) {
        ours.push_back(timedFirstPage(listing.design, [&] {
            return reports::openReportRows(listing.design.dataMember, listing.query);
        }));
        theirs.push_back(timedBareRows(book, {listing.bareQuery}));
    }
    report.ratio(name + u", first page"_s, 1.3, ours, theirs);
}

}  // namespace

void measureListings(Report& report) {
    for (const Engine engine : {Engine::Sqlite, Engine::Postgres}) {
        const auto nameOn = [&](const Listing& listing) {
            return listing.name + u'/' + nameOf(engine);
        };
        if (const Listing paid = transfers(); report.wanted(nameOn(paid)))
            measure(report, paid, nameOn(paid), largeBook(engine));
        const Listing declared = declarations();
        if (!report.wanted(nameOn(declared))) continue;
        const BookCopy copy(largeBook(engine));
        closeYear(copy.book());
        measure(report, declared, nameOn(declared), copy.book());
    }
}

}  // namespace benchmarks
