// SPDX-License-Identifier: MIT
#pragma once

#include <QAbstractScrollArea>
#include <functional>
#include <memory>
#include <vector>

#include "platform/printing/Pages.h"

namespace printing {

/// A found text on the screen: where it stands on its page, in millimetres, and whether it is the
/// one that the person has come to.
struct Highlight {
    QRectF box;
    bool current;
};

/// Laid-out pages on the screen, one at a time or one below the other. Paints only what is in
/// sight, straight from the page list. Pages are counted from 0.
class PreviewView : public QAbstractScrollArea {
    Q_OBJECT
public:
    /// What the size follows when the window changes: its width, the whole page in it, nothing.
    enum class Fit { Width, Page, None };
    // The smallest and the largest size, in percent of the size on paper.
    static constexpr double LeastPercent = 10;
    static constexpr double MostPercent = 400;

    PreviewView(const QString& name, QWidget* parent);

    /// Shows other pages; null for none.
    void setPages(std::shared_ptr<const Pages> pages);
    /// To be called when pages were added or the last one is known.
    void pagesAdded();
    /// Gives the found texts of a page; asked for the pages in sight at each painting.
    void setHighlights(std::function<std::vector<Highlight>(int page)> highlights);

    /// The page that the person is at; -1 while there is none.
    int currentPage() const { return current_; }
    /// Shows a page from its top; a page that is not there is replaced by the nearest one.
    void goToPage(int page);
    /// Shows a page so that the box (millimetres) is in sight, moving no more than needed.
    void reveal(int page, const QRectF& box);

    /// Whether pages stand one below the other, or one is shown at a time.
    bool isContinuous() const { return continuous_; }
    void setContinuous(bool continuous);

    /// As shown; 100 is the size on paper.
    double percent() const { return percent_; }
    /// What the size follows from now on.
    Fit fit() const { return fit_; }
    void setFit(Fit fit);
    /// Held between LeastPercent and MostPercent.
    void setPercent(double percent);
    /// To the next usual step up or down.
    void zoomBy(int steps);

signals:
    /// Another page is the current one, or another size is shown.
    void moved();

protected:
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void wheelEvent(QWheelEvent* event) override;
    void scrollContentsBy(int dx, int dy) override;

private:
    int count() const { return pages_ ? pages_->count() : 0; }
    double pixelsPerMillimetre() const;
    QSize pageSize() const;
    int topOf(int page) const;       ///< in the scrolled contents
    QRect onScreen(int page) const;  ///< in the viewport
    void paintPage(QPainter& painter, int page) const;
    void settleRanges();
    void fitPercent();
    void keepingPlace(const std::function<void()>& change);
    void setCurrent(int page);
    /// By so many pixels; where one page is shown, over its edge to its neighbour.
    void scrollBy(int pixels);
    void turnTo(int page, bool atBottom);
    void scrollSideways(int direction);

    std::shared_ptr<const Pages> pages_;
    std::function<std::vector<Highlight>(int)> highlights_;
    int known_ = 0;  ///< pages that were there when pagesAdded() was last called
    int current_ = -1;
    bool continuous_ = true;
    Fit fit_ = Fit::Width;
    double percent_ = 100;
    bool settling_ = false;  ///< scroll bars move by program: the current page stays
};

}  // namespace printing
