// SPDX-License-Identifier: MIT
#include "platform/printing/Layout.h"

#include <QElapsedTimer>

#include "platform/core/Failure.h"
#include "platform/core/Format.h"
#include "platform/printing/Sections.h"

using namespace Qt::StringLiterals;

namespace printing {

namespace {

/// Heights are compared with this much grace, in millimetres.
constexpr double Grace = 0.01;

/// A bookmark's most letters: what is longer cannot be read beside the pages.
constexpr qsizetype LongestBookmark = 200;

}  // namespace

struct Layout::Implementation {
    Implementation(const Report& design, ado::RecordsetPtr from, std::shared_ptr<Pages> into);

    /// Prints the next section of the body; behind the last one the pages are complete.
    void step();
    /// How much of the rows is printed, 0..1.
    double share() const {
        const qint64 all = grouped ? rowCount : childCount;
        return all == 0 ? 1 : static_cast<double>(grouped ? row : child) / static_cast<double>(all);
    }
    bool areRowsClosed() const { return rows->State() == ado::adStateClosed; }

private:
    PreparedSection prepared(const Section& section, Over over, RowValues& values) {
        return {section, over, faces, values, detailRow, tallies};
    }
    void start();
    void openGroup();
    void printDetail();
    void closeGroup();
    void finish();

    void startPage();
    void endPage();
    /// Prints a section, on a new page if it does not fit together with `more` that belongs to it.
    void print(const PreparedSection& section, double more = 0);
    void put(const PreparedSection& section);
    /// The bookmark of the row that the sections around the detail read; empty for none.
    QString bookmarkOfRow() const;
    /// What belongs to the row being printed because nothing but totals follows it.
    double footersBehindRow() const;

    const bool grouped;
    const QString chapter;
    const bool repeatsGroupHeader;
    const ado::RecordsetPtr rows;
    qint64 rowCount = 0;
    const std::shared_ptr<Pages> pages;

    Faces faces;
    Tallies tallies;
    RowValues detailRow;
    RowValues groupRow;
    RowValues& outerRow;  ///< what the sections around the detail read
    const PreparedSection reportHeader;
    const PreparedSection pageHeader;
    const PreparedSection groupHeader;
    const PreparedSection detail;
    const PreparedSection groupFooter;
    const PreparedSection pageFooter;
    const PreparedSection reportFooter;
    const double bodyBottom;
    std::vector<size_t> bookmarkPlaces;  ///< among the outer row's values

    bool started = false;
    bool inGroup = false;
    qint64 row = 0;              ///< of the row set
    ado::RecordsetPtr children;  ///< the rows that the detail prints
    qint64 childCount = 0;
    qint64 child = 0;
    QString bookmark;  ///< of the next section of the body that is printed; empty for none

    Page page;
    double y = 0;        ///< where the next section goes
    double bodyTop = 0;  ///< where the body of this page began
};

Layout::Implementation::Implementation(const Report& design, ado::RecordsetPtr from,
                                       std::shared_ptr<Pages> into)
    : grouped(!design.chapter.isEmpty()),
      chapter(design.chapter),
      repeatsGroupHeader(grouped && design.groupHeader.onEachPage),
      rows(std::move(from)),
      pages(std::move(into)),
      outerRow(grouped ? groupRow : detailRow),
      reportHeader(prepared(design.reportHeader, Over::Report, outerRow)),
      pageHeader(prepared(design.pageHeader, Over::Report, outerRow)),
      groupHeader(prepared(design.groupHeader, Over::Group, outerRow)),
      detail(prepared(design.detail, Over::Report, detailRow)),
      groupFooter(prepared(design.groupFooter, Over::Group, outerRow)),
      pageFooter(prepared(design.pageFooter, Over::Report, outerRow)),
      reportFooter(prepared(design.reportFooter, Over::Report, outerRow)),
      bodyBottom(page::Height - page::Margin - design.pageFooter.height) {
    rows->readAll();
    rowCount = rows->rowsInMemory();
    for (const QString& column : design.bookmark) bookmarkPlaces.push_back(outerRow.place(column));
    outerRow.lookUp(*rows);
    if (!grouped) {
        children = rows;
        childCount = rowCount;
    } else {
        if (rowCount > 0) rows->MoveTo(0);
        detailRow.lookUp(*rows->Chapter(chapter));
    }
}

void Layout::Implementation::step() {
    if (!started)
        start();
    else if (grouped && !inGroup && row < rowCount)
        openGroup();
    else if (child < childCount)
        printDetail();
    else if (inGroup)
        closeGroup();
    else
        finish();
}

void Layout::Implementation::start() {
    started = true;
    if (rowCount > 0) outerRow.read(*rows, 0);
    startPage();
}

void Layout::Implementation::openGroup() {
    outerRow.read(*rows, row);
    rows->MoveTo(row);
    children = rows->Chapter(chapter);
    childCount = children->rowsInMemory();
    child = 0;
    tallies.startGroup();
    bookmark = bookmarkOfRow();
    // With an only row go the footers behind it: without them it would leave its header alone.
    print(groupHeader,
          childCount > 0 ? detail.height() + footersBehindRow() : groupFooter.height());
    inGroup = true;
}

void Layout::Implementation::printDetail() {
    detailRow.read(*children, child);
    tallies.take(detailRow.values());
    if (!grouped) bookmark = bookmarkOfRow();
    print(detail, footersBehindRow());
    ++child;
}

void Layout::Implementation::closeGroup() {
    print(groupFooter);
    inGroup = false;
    ++row;
}

void Layout::Implementation::finish() {
    print(reportFooter);
    endPage();
    pages->complete();
}

double Layout::Implementation::footersBehindRow() const {
    if (child + 1 < childCount) return 0;
    if (!grouped) return reportFooter.height();
    return groupFooter.height() + (row + 1 < rowCount ? 0 : reportFooter.height());
}

QString Layout::Implementation::bookmarkOfRow() const {
    QStringList parts;
    for (const size_t place : bookmarkPlaces)
        parts
            << core::formatted(outerRow.values()[place], {}, core::portugueseLocale()).simplified();
    parts.removeAll(QString());
    QString text = parts.join(u" - "_s);
    if (text.size() > LongestBookmark) {
        const bool parted = text[LongestBookmark - 2].isHighSurrogate();
        text = text.first(LongestBookmark - (parted ? 2 : 1)) + u'…';
    }
    return text;
}

// --- Pages

void Layout::Implementation::startPage() {
    y = page::Margin;
    if (pages->count() == 0) put(reportHeader);
    put(pageHeader);
    if (inGroup && repeatsGroupHeader) put(groupHeader);
    bodyTop = y;
}

void Layout::Implementation::endPage() {
    y = bodyBottom;
    put(pageFooter);
    pages->add(page);
    page.boxes.clear();
    page.lines.clear();
    page.texts.clear();
}

void Layout::Implementation::print(const PreparedSection& section, double more) {
    if (section.height() <= 0) return;  // a section that is not there opens no page either
    const double top = page::Margin + pageHeader.height() +
                       (inGroup && repeatsGroupHeader ? groupHeader.height() : 0);
    const double room = bodyBottom - top;
    // Sections that no page can hold together are parted; one that no page can hold runs over the
    // footer.
    const double need = section.height() + (section.height() + more <= room + Grace ? more : 0);
    const bool asEmptyAsItGets = y <= bodyTop + Grace && bodyTop <= top + Grace;
    if (y + need > bodyBottom + Grace && !asEmptyAsItGets) {
        endPage();
        startPage();
    }
    put(section);
    if (bookmark.isEmpty()) return;
    pages->addBookmark({pages->count(), bookmark});
    bookmark.clear();
}

void Layout::Implementation::put(const PreparedSection& section) {
    if (section.height() <= 0) return;
    section.print(page, y, pages->count() + 1);
    y += section.height();
}

// --- Layout

Layout::Layout(const Report& report, const ado::RecordsetPtr& rows)
    : pages_(std::make_shared<Pages>()), d(std::make_unique<Implementation>(report, rows, pages_)) {
    pages_->caption = report.caption;
}

Layout::~Layout() = default;

double Layout::share() const {
    return d->share();
}

bool Layout::go(int milliseconds) {
    if (!isComplete() && d->areRowsClosed())
        throw core::Failure(core::ObjectClosed,
                            u"As linhas foram fechadas antes de o mapa estar completo."_s);
    QElapsedTimer clock;
    clock.start();
    while (!isComplete()) {
        d->step();
        if (milliseconds >= 0 && clock.elapsed() >= milliseconds) break;
    }
    return isComplete();
}

}  // namespace printing
