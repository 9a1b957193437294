// SPDX-License-Identifier: MIT
#include "host/documents/MemberDocuments.h"

#include "boundary/environment/dtZelmars.h"
#include "platform/core/Values.h"
#include "platform/printing/Layout.h"
#include "reports/DebtReports.h"
#include "reports/ExtractQuery.h"
#include "reports/ExtractReports.h"
#include "reports/TaxQuery.h"
#include "reports/TaxReport.h"

using namespace Qt::StringLiterals;

namespace documents {

namespace {

ado::RecordsetPtr opened(const QString& query, const ado::ConnectionPtr& connection) {
    const ado::RecordsetPtr rows = ado::Recordset::create();
    rows->Open(query, connection);
    return rows;
}

QStringList familyCodes(const ado::ConnectionPtr& connection) {
    QStringList codes;
    const ado::RecordsetPtr rows =
        opened(u"select descrit from tbSocios_Familias_CodeABC order by descrit"_s, connection);
    for (; !rows->atEnd(); rows->MoveNext()) codes << core::toText(rows->Collect(u"descrit"_s));
    return codes;
}

/// Of a report that has a page for each row.
bool eachPage(const printing::Report& report, const ado::RecordsetPtr& rows, const Taker& take) {
    printing::Layout layout(report, rows);
    layout.go(-1);
    const qint64 count = rows->rowsInMemory();
    for (qint64 row = 0; row < count; ++row) {
        rows->MoveTo(row);
        const int page = static_cast<int>(row);
        const Document document{core::toText(rows->Collect(u"no_kor"_s)),
                                core::toText(rows->Collect(u"nome"_s)), *layout.pages(), page,
                                page};
        if (!take(document, row + 1, count)) return false;
    }
    return true;
}

bool eachExtract(const Wish& wish, const ado::ConnectionPtr& connection, const Taker& take) {
    const ado::RecordsetPtr members =
        opened(u"select * from tbSocios order by no_kor, socio_id"_s, connection);
    members->readAll();
    const qint64 count = members->rowsInMemory();
    for (qint64 row = 0; row < count; ++row) {
        members->MoveTo(row);
        const ado::RecordsetPtr rows =
            opened(reports::extractQuery({.socio_id = core::toLong(members->Collect(u"socio_id"_s)),
                                          .detailed = wish.detailed,
                                          .first = wish.first,
                                          .last = wish.last,
                                          .doc_no = {}}),
                   connection);
        if (rows->atEnd()) continue;
        printing::Layout layout(reports::extractOf(*members, wish.detailed).design(), rows);
        layout.go(-1);
        const Document document{core::toText(members->Collect(u"no_kor"_s)),
                                core::toText(members->Collect(u"nome"_s)), *layout.pages(), 0,
                                layout.pages()->count() - 1};
        if (!take(document, row + 1, count)) return false;
    }
    return true;
}

}  // namespace

bool eachDocument(const Wish& wish, const ado::ConnectionPtr& connection, const Taker& take) {
    const auto all = [&](const printing::Report& report, const QString& query) {
        return eachPage(report, opened(query, connection), take);
    };
    switch (wish.kind) {
        case Kind::Letters: {
            const printing::Report letters = reports::Print_frmCartasDividas();
            return all(letters,
                       environment::dtZelmars::instance().Commands(letters.dataMember).CommandText);
        }
        case Kind::Declarations:
            return all(reports::prtIRS(), reports::taxQuery({.year = QString::number(wish.year),
                                                             .codes = familyCodes(connection)}));
        case Kind::Extracts:
            break;
    }
    return eachExtract(wish, connection, take);
}

ado::ConnectionPtr openBook(const QString& connectionString) {
    auto connection = std::make_shared<ado::Connection>();
    connection->ConnectionString = connectionString;
    connection->Open();
    return connection;
}

std::vector<int> closedYears(const ado::ConnectionPtr& connection) {
    std::vector<int> years;
    const ado::RecordsetPtr rows =
        opened(u"select ano from tbZelmar_Movimentos_Historico group by ano order by ano desc"_s,
               connection);
    for (; !rows->atEnd(); rows->MoveNext()) years.push_back(core::toLong(rows->Collect(u"ano"_s)));
    return years;
}

}  // namespace documents
