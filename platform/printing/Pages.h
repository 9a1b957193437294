// SPDX-License-Identifier: MIT
#pragma once

#include <QByteArray>
#include <QLineF>
#include <QRectF>
#include <QString>
#include <vector>

#include "platform/printing/Report.h"

namespace printing {

/// One line of text at its place, already formatted and cut to its box. Millimetres from the
/// page's upper left corner.
struct TextRun {
    QPointF baseline;  ///< where the first letter stands
    double width = 0;  ///< of the text as measured
    QString text;
    Style style;
    bool open = false;  ///< the number of pages is still missing: see Pages::resolved
};

/// A straight line, in millimetres as above.
struct Line {
    QLineF line;
    double width = 0;
};

/// A rectangle behind texts, in millimetres as above.
struct Box {
    QRectF rect;
    bool shaded = false;
    bool framed = false;
};

/// What stands on a page, in painting order: boxes, lines, texts.
struct Page {
    std::vector<Box> boxes;
    std::vector<Line> lines;
    std::vector<TextRun> texts;
};

/// A place that a reader can jump to by its name.
struct Bookmark {
    int page = 0;  ///< counted from 0
    QString text;
};

/// The pages laid out so far, packed, so that thousands of them take little memory.
class Pages {
public:
    QString caption;  ///< of the report

    int count() const { return static_cast<int>(pages_.size()); }
    /// Unpacks a page (a fraction of a millisecond); keep it while working with its texts.
    Page at(int page) const;
    /// True when no page is to come; the number of pages is known from then on.
    bool isComplete() const { return complete_; }

    /// A run with the number of pages filled in ("…" while it is not known), moved as its alignment
    /// wants. Other runs as they are.
    TextRun resolved(const TextRun& run) const;

    /// Adds the next page.
    void add(const Page& page);
    /// Names a page, which may be the one that is added next, behind those named before.
    void addBookmark(const Bookmark& bookmark);
    int bookmarkCount() const { return static_cast<int>(bookmarks_.size()); }
    Bookmark bookmark(int at) const;
    /// Tells that no page is to come.
    void complete() { complete_ = true; }

private:
    struct PackedBookmark {
        int page;
        qsizetype end;  ///< of the name among the names
    };
    std::vector<QByteArray> pages_;
    std::vector<PackedBookmark> bookmarks_;
    QByteArray bookmarkNames_;  ///< UTF-8, one after the other
    bool complete_ = false;
};

}  // namespace printing
