// SPDX-License-Identifier: MIT
// How rows become texts on pages.
#include "platform/core/Format.h"
#include "platform/core/Money.h"
#include "platform/printing/DataReport.h"
#include "platform/printing/Output.h"
#include "platform/printing/Tallies.h"
#include "platform/printing/Typesetting.h"
#include "reports/ExtractReports.h"
#include "reports/Furniture.h"
#include "tests/printing/Ledger.h"

using namespace Qt::StringLiterals;
using support::failureOf;

namespace {

constexpr printing::Style Right{.points = 9, .align = printing::Align::Right};

TEST(Typesetting, NeverLeavesItsBox) {
    const QString longName = QString(u"Maria da Conceição "_s).repeated(11);
    const struct {
        QString text;
        int lines;
        printing::Overlong overlong;
        QString shown;  ///< lines parted by '|'; '…' at the end stands for any cut
    } rows[] = {
        {QString(), 1, printing::Overlong::Cut, QString()},
        {u"Olá €"_s, 1, printing::Overlong::Cut, u"Olá €"_s},
        {u"um\tdois\ntrês"_s, 1, printing::Overlong::Cut, u"um dois três"_s},
        {longName, 1, printing::Overlong::Cut, u"Maria da Conceição…"_s},
        {u"Consulta de cardiologia pediátrica"_s, 2, printing::Overlong::Cut,
         u"Consulta de cardiologia|pediátrica"_s},
        {longName, 2, printing::Overlong::Cut, u"Maria da Conceição Maria|da Conceição…"_s},
        {QString(u"X"_s).repeated(500), 1, printing::Overlong::Cut, u"XXXX…"_s},
        {u"(€ 922.337.203.685.477,00) menos"_s, 1, printing::Overlong::Shrink,
         u"(€ 922.337.203.685.477,00) menos"_s},
        {u"שלום עולם"_s, 1, printing::Overlong::Cut, u"שלום עולם"_s},
    };
    printing::Faces faces;
    const QRectF box(10, 20, 40, 10);
    for (const auto& row : rows) {
        SCOPED_TRACE(row.shown.toStdString());
        for (const printing::Align align :
             {printing::Align::Left, printing::Align::Centre, printing::Align::Right}) {
            std::vector<printing::TextRun> runs;
            set(runs, faces, row.text, box, {.align = align}, row.lines, row.overlong);
            QStringList lines;
            for (const printing::TextRun& run : runs) {
                lines << run.text;
                EXPECT_TRUE(box.adjusted(-0.01, 0, 0.01, 0)
                                .contains(QRectF(run.baseline, QSizeF(run.width, 0.1))));
                // Letters are rounded to whole units each.
                EXPECT_NEAR(run.width,
                            QFontMetricsF(faces.of(run.style).font).horizontalAdvance(run.text) /
                                printing::UnitsPerMillimetre,
                            0.022 * static_cast<double>(run.text.size()));
            }
            const QString shown = lines.join(u'|');
            if (row.shown.endsWith(u'…'))
                EXPECT_TRUE(shown.startsWith(row.shown.chopped(1)) && shown.endsWith(u'…'));
            else
                EXPECT_EQ(shown, row.shown);
        }
    }
}

TEST_F(Ledger, FillsInDatePageNumbersAndCaptionsLetterForLetter) {
    printing::Report design{.name = u"carta"_s};
    design.reportHeader = {.name = u"Section4"_s,
                           .height = 5,
                           .items = {printing::Label{u"nome"_s, QRectF(0, 0, 90, 5), u"?"_s, {}},
                                     reports::label(90, 0, 60, u"%D, 100%% %p/%P %"_s)}};
    // Exactly one document a page, and one a little higher than that: no empty page follows.
    design.detail = {.height = printing::page::InnerHeight - 9,
                     .items = {reports::field(0, 0, 50, u"doc_no"_s)}};
    design.pageFooter = {.height = 10, .items = {reports::label(0, 0, 186, u"%p de %P"_s, Right)}};
    printing::DataReport report(design);
    report.setCaption(u"section4"_s, u"Nome"_s, u"Ana %P & Filhos"_s);
    EXPECT_EQ(failureOf([&] { report.setCaption(u"Section4"_s, u"nib"_s, u""_s); }).number(),
              core::NoSuchItem);
    fill(7);
    const auto pages = laidOut(report.design(), movements());
    ASSERT_EQ(pages->count(), 8);
    EXPECT_EQ(textsOf(*pages, 0), u"Ana %P & Filhos|9 de março de 2026, 100% 1/8 %|1 de 8"_s);
    EXPECT_EQ(textsOf(*pages, 1), u"FT 2026/1|2 de 8"_s);
    EXPECT_EQ(textsOf(*pages, 7), u"8 de 8"_s);  // a null is empty
    const printing::Page last = pages->at(7);
    const printing::TextRun number = pages->resolved(last.texts.back());
    EXPECT_NEAR(number.baseline.x() + number.width, 198, 0.01);
}

TEST_F(Ledger, KeepsTotalsExactAndBesideTheirLastRow) {
    printing::Report design;
    reports::addValues(design.detail, {{u""_s, u"movimento_no"_s, 20}});
    reports::addTotal(design.reportFooter, printing::Total::Of::Sum, u"Soma:"_s, u"valor"_s,
                      core::format::Money);
    reports::addTotal(design.reportFooter, printing::Total::Of::Count, u"Linhas:"_s, u"doc_no"_s,
                      {});
    const int perPage = static_cast<int>(printing::page::InnerHeight / reports::LineHeight);
    fill(perPage);  // the totals no longer fit below them
    const auto pages = laidOut(design, open(u"SELECT movimento_no, doc_no, 0.1 * 1 AS valor FROM "
                                            "tbZelmar_Movimentos ORDER BY movimento_no"_s));
    ASSERT_EQ(pages->count(), 2);
    const QString sum = core::formatted(QVariant::fromValue(core::Money::fromUnits(perPage * 1000)),
                                        core::format::Money, core::portugueseLocale());
    EXPECT_EQ(textsOf(*pages, 1), u"%1|Soma:|%2|Linhas:|%1"_s.arg(perPage).arg(sum));
}

TEST_F(Ledger, ShowsAComputedAmountAsTheTotalOverItDoes) {
    printing::Report design;
    reports::addValues(design.detail,
                       {{u""_s, u"valor"_s, 40, printing::Align::Right, core::format::Money}});
    reports::addTotal(design.reportFooter, printing::Total::Of::Sum, u"Soma:"_s, u"valor"_s,
                      core::format::Money);
    fill(1);
    for (const char* const amount : {"1.005", "-2.675"}) {
        const ado::RecordsetPtr rows =
            open(u"SELECT 3 * %1 - 2 * %1 AS valor FROM tbZelmar_Movimentos"_s.arg(
                QLatin1StringView(amount)));
        const QStringList texts = textsOf(*laidOut(design, rows), 0).split(u'|');
        EXPECT_EQ(texts.value(0), texts.value(2)) << amount;
        EXPECT_TRUE(texts.value(0).contains(u",01"_s) || texts.value(0).contains(u",68"_s))
            << texts.value(0).toStdString();
    }
}

TEST_F(Ledger, CutsNothingOnAnExtractThatAMemberMustRead) {
    fill(2);
    const QString number = u"FATURA-2026/00012345"_s;
    book.exec(u"update tbZelmar_Movimentos set codABC = 'CWM1', doc_no = '%1'"_s.arg(number));
    for (const printing::Report& report : {reports::rptExtrato2(), reports::prtExtrato1()}) {
        const auto pages = laidOut(report, movements());
        const QString texts = textsOf(*pages, 0);
        EXPECT_TRUE(texts.contains(u"|CWM1|"_s) && texts.contains(number)) << texts.toStdString();
        EXPECT_FALSE(texts.contains(u'…')) << texts.toStdString();
    }
}

TEST(Totals, AreRoundedOnceWhenTheyAreShown) {
    const struct {
        QVariant value;
        int times;
        int decimals;
        QString total;
    } rows[] = {
        {0.02 * 200.482, 40, 2, u"160.3900"_s},
        {-0.02 * 200.482, 40, 4, u"-160.3856"_s},
        {0.0049996, 1, 2, u"0.0000"_s},
        {QVariant::fromValue(core::Money::fromUnits(-50)), 1, 2, u"-0.0100"_s},
        {87.35f, 1000, 4, u"87350.0000"_s},
    };
    for (const auto& row : rows) {
        printing::Sum sum;
        for (int time = 0; time < row.times; ++time) sum.add(row.value);
        EXPECT_EQ(sum.rounded(row.decimals).toPlainText(), row.total);
    }
}

TEST_F(Ledger, NamesWhatTheRowsDoNotHave) {
    printing::Report design;
    reports::addValues(design.detail, {{u""_s, u"inventada"_s, 20}});
    fill(1);
    EXPECT_TRUE(failureOf([&] { laidOut(design, movements()); }).text().contains(u"«inventada»"_s));
    // With groups, and with no group to look at.
    for (const bool hasGroups : {false, true}) {
        if (hasGroups) book.hospital();
        printing::Report groups = twoLevels();
        const auto said = [&](const QString& name) {
            return failureOf([&] { laidOut(groups, open(TwoLevelQuery)); }).text().contains(name);
        };
        reports::addValues(groups.detail, {{u""_s, u"inventada"_s, 20}});
        EXPECT_TRUE(said(u"«inventada»"_s));
        groups.chapter = u"outro"_s;
        EXPECT_TRUE(said(u"«outro»"_s));
    }

    // The layout also ends when somebody closes the rows under way.
    fill(500);
    const ado::RecordsetPtr rows = movements();
    design.detail = {};
    reports::addValues(design.detail, {{u""_s, u"doc_no"_s, 20}});
    printing::Layout layout(design, rows);
    while (layout.pages()->count() == 0) layout.go(0);
    rows->Close();
    EXPECT_EQ(failureOf([&] { layout.go(-1); }).number(), core::ObjectClosed);
}

}  // namespace
