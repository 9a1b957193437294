// SPDX-License-Identifier: MIT
#pragma once

#include <QRectF>
#include <QString>
#include <vector>

#include "platform/reports/Report.h"

namespace reports {

/// One line of text at its place, already formatted and cut to its box. Millimetres from the
/// page's upper left corner.
struct TextRun {
    QPointF baseline;  ///< where the first letter stands
    double width;      ///< of the text as measured
    QString text;      ///< with the number of pages still as %P: see Pages::text
    Style style;
};

struct Line {
    QLineF line;
    double width;
};

struct Box {
    QRectF rect;
    bool shaded;
    bool framed;
};

/// What stands on a page, in painting order: boxes, lines, texts.
struct Page {
    std::vector<Box> boxes;
    std::vector<Line> lines;
    std::vector<TextRun> texts;
};

/// The pages laid out so far.
class Pages {
public:
    QString caption;  ///< of the report

    int count() const { return static_cast<int>(pages_.size()); }
    const Page& at(int page) const { return pages_[static_cast<size_t>(page)]; }
    /// True when no page is to come; the number of pages is known from then on.
    bool isComplete() const { return complete_; }

    /// A run with the number of pages filled in ("…" while it is not known) and, where that makes
    /// the text wider, moved as its alignment wants.
    TextRun resolved(const TextRun& run) const;

    void add(Page page) { pages_.push_back(std::move(page)); }
    void complete() { complete_ = true; }

private:
    std::vector<Page> pages_;
    bool complete_ = false;
};

}  // namespace reports
