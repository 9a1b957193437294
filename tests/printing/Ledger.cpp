// SPDX-License-Identifier: MIT
#include "tests/printing/Ledger.h"

#include "platform/core/Clock.h"
#include "platform/core/Format.h"
#include "reports/Furniture.h"

using namespace Qt::StringLiterals;
using core::format::Money;
using printing::Align;

Ledger::Ledger() {
    core::setToday(QDate(2026, 3, 9));
    connection->ConnectionString = book.shapingConnectionString();
    connection->Open();
}

void Ledger::fill(int count) {
    QStringList rows;
    for (int number = 1; number <= count; ++number) {
        const bool bare = number % 7 == 0;
        rows << u"(%1, 1, %2, 'A', '2026-01-%3', 'DOC', '2026-01-02', %4, %1.25, 0, %1.15, 100, "
                "50.5, %1.2, %1.2, %1.1 - 1, %1.1, 'TRF')"_s.arg(number)
                    .arg(1 + number % 2)
                    .arg(1 + number % 28, 2, 10, QChar(u'0'))
                    .arg(bare ? u"null"_s : u"'FT 2026/%1'"_s.arg(number));
    }
    if (!rows.isEmpty())
        book.exec(
            u"insert into tbZelmar_Movimentos (movimento_no, socio_id, hospital_id, codABC, data, "
            "tipo, doc_data, doc_no, doc_valor, recebido, comparticipacao, saldo_plafond, "
            "saldo_acumulado, iliquido, liquido, credito, debito, modo_pagamento) values "_s +
            rows.join(u','));
}

ado::RecordsetPtr Ledger::open(const QString& query) const {
    ado::RecordsetPtr rows = ado::Recordset::create();
    rows->setClientSide(true);
    rows->Open(query, connection);
    return rows;
}

ado::RecordsetPtr Ledger::movements() const {
    return open(
        u"SELECT tbZelmar_Movimentos.*, debito - credito as saldo, debito*(200.482) as euros, "
        "CASE WHEN doc_no IS NULL THEN NULL ELSE 'Consultas de especialidade' END AS rubrica, "
        "'Maria da Luz Matos' AS Familiar FROM tbZelmar_Movimentos ORDER BY movimento_no"_s);
}

std::shared_ptr<printing::Pages> Ledger::laidOut(const printing::Report& report,
                                                 const ado::RecordsetPtr& rows) {
    printing::Layout layout(report, rows);
    layout.go(-1);
    return layout.pages();
}

QString Ledger::textsOf(const printing::Pages& pages, int page) {
    QStringList texts;
    const printing::Page printed = pages.at(page);
    for (const printing::TextRun& run : printed.texts) texts << pages.resolved(run).text;
    return texts.join(u'|');
}

printing::Report twoLevels() {
    const std::vector<reports::Column> columns{{u"Nº"_s, u"movimento_no"_s, 40},
                                               {u"Dívida"_s, u"divida"_s, 40, Align::Right, Money}};
    printing::Report report{.name = u"doisNiveis"_s,
                            .caption = u"Dois níveis"_s,
                            .chapter = u"detalhe"_s,
                            .pageFooter = reports::pageFooter()};
    report.groupHeader.onEachPage = true;
    report.groupHeader.items = {reports::label(0, 0, 20, u"Hospital:"_s),
                                reports::field(20, 0, 80, u"hospital"_s)};
    report.groupHeader.height = reports::LineHeight;
    reports::addTitles(report.groupHeader, columns);
    reports::addValues(report.detail, columns);
    reports::addTotal(report.groupFooter, printing::Total::Of::Sum, u"Total:"_s, u"divida"_s,
                      Money);
    reports::addTotal(report.reportFooter, printing::Total::Of::Count, u"Registos:"_s,
                      u"movimento_no"_s, {});
    reports::addTotal(report.reportFooter, printing::Total::Of::Sum, u"Soma:"_s, u"divida"_s,
                      Money);
    return report;
}

const QString TwoLevelQuery =
    u"SHAPE {SELECT hospital_id, nome AS hospital FROM tbHospitais ORDER BY nome }  AS lista "
    "APPEND ({SELECT tbZelmar_Movimentos.*, debito - credito AS divida FROM tbZelmar_Movimentos "
    "ORDER BY movimento_no } AS detalhe RELATE 'hospital_id' TO 'hospital_id') AS detalhe"_s;
