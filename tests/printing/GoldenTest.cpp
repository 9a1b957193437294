// SPDX-License-Identifier: MIT
// Whole pages against lists that somebody has looked at.
#include "reports/ExtractReports.h"
#include "tests/printing/Golden.h"
#include "tests/printing/Ledger.h"

using namespace Qt::StringLiterals;

namespace {

TEST_F(Ledger, PrintsExtractsAsTheyWereSeen) {
    const struct {
        printing::Report report;
        const char16_t* name;
        int rows;
        int pages;
    } extracts[] = {
        {reports::rptExtrato2(), u"summary-empty", 0, 1},
        {reports::rptExtrato2(), u"summary-one", 1, 1},
        {reports::rptExtrato2(), u"summary-full-page", 39, 1},
        {reports::rptExtrato2(), u"summary-one-too-many", 40, 2},
        {reports::rptExtrato2(), u"summary-many", 120, 3},
        {reports::prtExtrato1(), u"detailed-empty", 0, 1},
        {reports::prtExtrato1(), u"detailed-one", 1, 1},
        {reports::prtExtrato1(), u"detailed-full-page", 7, 1},
        {reports::prtExtrato1(), u"detailed-many", 20, 3},
    };
    for (const auto& extract : extracts) {
        const QString name = QString::fromUtf16(extract.name);
        SCOPED_TRACE(name.toStdString());
        book.exec(u"delete from tbZelmar_Movimentos"_s);
        fill(extract.rows);
        const auto pages = laidOut(extract.report, movements());
        EXPECT_EQ(pages->count(), extract.pages);
        const QString shown = describe(*pages);
        EXPECT_EQ(shown, golden(name, shown));
    }
}

TEST_F(Ledger, PrintsGroupsOverSeveralPages) {
    for (const QString& name : {u"Hospital A"_s, u"Hospital B"_s, u"Hospital sem contas"_s})
        book.hospital(name.right(1), name);
    fill(130);
    const auto pages = laidOut(twoLevels(), open(TwoLevelQuery));
    const QString shown = describe(*pages);
    EXPECT_EQ(shown, golden(u"two-levels"_s, shown));
    // 65 movements of each hospital, each one euro more debit than credit.
    const QString last = textsOf(*pages, pages->count() - 1);
    EXPECT_TRUE(
        last.contains(u"Total:|€ 65,00|Hospital:|Hospital sem contas|Nº|Dívida|Total:|"
                      "€ 0,00|Registos:|130|Soma:|€ 130,00"_s))
        << last.toStdString();
    for (int page = 0; page < pages->count(); ++page)
        EXPECT_TRUE(textsOf(*pages, page).startsWith(u"Hospital:|Hospital "_s));
}

}  // namespace
