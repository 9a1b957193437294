// SPDX-License-Identifier: MIT
// Whole pages against lists that somebody has looked at.
#include "reports/DebtReports.h"
#include "reports/ExtractReports.h"
#include "reports/TaxReport.h"
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

/// So many debtors; the third has neither name nor address, the fourth very long ones.
QString debtors(int count) {
    QStringList rows;
    for (int at = 1; at <= count; ++at) {
        QString values =
            u"'%1' as no_kor, 'Maria d''Além' as nome, 'Rua da Misericórdia, 20 A' as morada1, "
            "'1200-273 Lisboa' as code_completo, %2.5 as divida"_s.arg(100000 + at)
                .arg(at);
        if (at == 3)
            values = u"null, null, null, null, null"_s;
        else if (at == 4)
            values = u"'100004', '%1', '%2', '%3', 1234567.8901"_s.arg(
                u"Maria do Carmo de Sousa e Albuquerque "_s.repeated(2),
                u"Urbanização Quinta das Laranjeiras, lote 35, "_s.repeated(2),
                u"8125-999 Vila Nova de Santo António "_s.repeated(2));
        rows << u"select "_s + values;
    }
    return count > 0 ? rows.join(u" union all "_s)
                     : u"select * from (%1) d where no_kor = ''"_s.arg(debtors(1));
}

TEST_F(Ledger, PrintsDebtsAsTheyWereSeen) {
    const struct {
        printing::Report report;
        const char16_t* name;
        int rows;
        int pages;
    } lists[] = {
        {reports::Print_frmListagemDividas(), u"debts-empty", 0, 1},
        {reports::Print_frmListagemDividas(), u"debts-one", 1, 1},
        {reports::Print_frmListagemDividas(), u"debts-full-page", 42, 1},
        {reports::Print_frmListagemDividas(), u"debts-one-too-many", 43, 2},
        {reports::Print_frmCartasDividas(), u"letters-empty", 0, 1},
        {reports::Print_frmCartasDividas(), u"letters-four", 4, 4},
    };
    for (const auto& list : lists) {
        const QString name = QString::fromUtf16(list.name);
        SCOPED_TRACE(name.toStdString());
        const auto pages = laidOut(list.report, open(debtors(list.rows)));
        EXPECT_EQ(pages->count(), list.pages);
        const QString shown = describe(*pages);
        EXPECT_EQ(shown, golden(name, shown));
    }
}

/// What shows in an envelope's window, and nothing else does.
TEST_F(Ledger, PutsTheAddressOfALetterIntoTheWindow) {
    const auto pages = laidOut(reports::Print_frmCartasDividas(), open(debtors(4)));
    for (int page = 0; page < pages->count(); ++page) {
        QStringList inWindow;
        for (const printing::TextRun& text : pages->at(page).texts) {
            const QPointF from = text.baseline;
            if (from.y() < 45 || from.y() > 81) continue;
            inWindow << text.text;
            EXPECT_GE(from.x(), 20) << text.text.toStdString();
            EXPECT_LE(from.x() + text.width, 90) << text.text.toStdString();
        }
        EXPECT_EQ(inWindow.size(), page == 2 ? 4 : 8);
    }
}

TEST_F(Ledger, PrintsDeclarationsAsTheyWereSeen) {
    const QString row =
        u"select 2025 as ano, '100015' as no_kor, 'Maria d''Além' as nome, 'Rua do Ouro, 5' as "
        "morada, '1100-060 Lisboa' as localidade_completo, '123456789' as no_contribuinte, 30 as "
        "tresponsabilidade, 100 as tdoc_valor, 60 as tcredito, 10 as trecebido"_s;
    const QString others =
        row +
        u" union all select 2025, '100023', null, null, null, null, null, null, null, null "
        "union all select 2025, '100031', '%1', '%1', '%1', '123456789', -1234567.8901, "
        "99999999.99, 0.005, 0"_s.arg(u"Maria do Carmo de Sousa e Albuquerque "_s.repeated(2));
    const struct {
        const char16_t* name;
        QString query;
        int pages;
    } lists[] = {{u"declarations-empty", u"select * from (%1) d where no_kor = ''"_s.arg(row), 1},
                 {u"declarations-three", others, 3}};
    for (const auto& list : lists) {
        const QString name = QString::fromUtf16(list.name);
        SCOPED_TRACE(name.toStdString());
        const auto pages = laidOut(reports::prtIRS(), open(list.query));
        EXPECT_EQ(pages->count(), list.pages);
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
