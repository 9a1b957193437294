// SPDX-License-Identifier: MIT
// Pages on paper of another size than they were laid out for.
#include <QPrinter>
#include <QProcess>
#include <QRegularExpression>
#include <QTemporaryDir>

#include "platform/printing/Output.h"
#include "reports/ExtractReports.h"
#include "tests/printing/Ledger.h"

using namespace Qt::StringLiterals;

namespace {

/// How far to the right and down the words of a PDF reach, in points.
QPointF cornerOfWords(const QString& file) {
    QProcess process;
    process.start(u"pdftotext"_s, {u"-bbox"_s, file, u"-"_s});
    EXPECT_TRUE(process.waitForFinished() && process.exitCode() == 0);
    static const QRegularExpression word(uR"~(<word .*xMax="([\d.]+)" yMax="([\d.]+)")~"_s);
    QPointF corner;
    const QString words = QString::fromUtf8(process.readAllStandardOutput());
    for (const QRegularExpressionMatch& match : word.globalMatch(words))
        corner = {std::max(corner.x(), match.captured(1).toDouble()),
                  std::max(corner.y(), match.captured(2).toDouble())};
    return corner;
}

class Paper : public Ledger {
protected:
    QPointF cornerOn(QPageSize::PageSizeId paper) {
        QPrinter printer;
        printer.setOutputFileName(folder.filePath(u"folha.pdf"_s));
        printer.setPageSize(QPageSize(paper));
        EXPECT_TRUE(print(*pages, printer, 0, pages->count() - 1));
        return cornerOfWords(printer.outputFileName());
    }
    QTemporaryDir folder;
    std::shared_ptr<printing::Pages> pages;
};

TEST_F(Paper, ThatIsSmallerTakesThePageSmaller) {
    fill(40);
    pages = laidOut(reports::rptExtrato2(), movements());
    const QPointF laidOutFor = cornerOn(QPageSize::A4);
    EXPECT_GT(laidOutFor.x(), 500);
    EXPECT_GT(laidOutFor.y(), 750);
    const struct {
        QPageSize::PageSizeId paper;
        double size;  ///< of the narrower direction: 148 of 210 mm, 279.4 of 297 mm
    } rows[] = {{QPageSize::A5, 148.0 / 210}, {QPageSize::Letter, 279.4 / 297}, {QPageSize::A3, 1}};
    for (const auto& row : rows) {
        const QPointF corner = cornerOn(row.paper);
        SCOPED_TRACE(QPageSize::name(row.paper).toStdString());
        EXPECT_NEAR(corner.x(), laidOutFor.x() * row.size, 1);
        EXPECT_NEAR(corner.y(), laidOutFor.y() * row.size, 1);
    }
}

}  // namespace
