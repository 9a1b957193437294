// SPDX-License-Identifier: MIT
#include "platform/printing/PreviewView.h"

#include <QKeyEvent>
#include <QPainter>
#include <QScrollBar>
#include <algorithm>
#include <cmath>

#include "platform/forms/Look.h"
#include "platform/printing/Output.h"

namespace printing {

namespace {

constexpr int Gap = 12;           // pixels around and between pages
constexpr int ArrowStep = 48;     // pixels
constexpr int PagesOverlap = 40;  // pixels of the last screen that stay on the next one
constexpr double Steps[] = {10,  25,  33,  50,  67,  75,  90,  100,
                            110, 125, 150, 175, 200, 250, 300, 400};

const QColor Found(255, 235, 120);
const QColor FoundCurrent(255, 170, 60);

}  // namespace

PreviewView::PreviewView(const QString& name, QWidget* parent) : QAbstractScrollArea(parent) {
    setObjectName(name);
    setFrameShape(QFrame::NoFrame);
    setFocusPolicy(Qt::StrongFocus);
    setVerticalScrollBarPolicy(Qt::ScrollBarAlwaysOn);  // or fitting the width would never settle
    verticalScrollBar()->setSingleStep(ArrowStep);
    horizontalScrollBar()->setSingleStep(ArrowStep);
}

void PreviewView::setPages(std::shared_ptr<const Pages> pages) {
    pages_ = std::move(pages);
    known_ = 0;
    pagesAdded();
}

void PreviewView::pagesAdded() {
    settleRanges();
    setCurrent(std::clamp(current_, std::min(0, count() - 1), count() - 1));
    // Pages out of sight change nothing, unless their number has become known.
    const bool inSight = onScreen(known_).top() <= viewport()->height();
    if (inSight || count() == 0 || pages_->isComplete()) viewport()->update();
    known_ = count();
}

void PreviewView::setHighlights(std::function<std::vector<Highlight>(int)> highlights) {
    highlights_ = std::move(highlights);
    viewport()->update();
}

// Geometry.

double PreviewView::pixelsPerMillimetre() const {
    return logicalDpiX() / 25.4 * percent_ / 100;
}

QSize PreviewView::pageSize() const {
    const double scale = pixelsPerMillimetre();
    return {qRound(page::Width * scale), qRound(page::Height * scale)};
}

int PreviewView::topOf(int page) const {
    return Gap + (continuous_ ? page * (pageSize().height() + Gap) : 0);
}

QRect PreviewView::onScreen(int page) const {
    const QSize size = pageSize();
    const int spareWidth = viewport()->width() - size.width() - 2 * Gap;
    const int left = Gap + std::max(0, spareWidth / 2) - horizontalScrollBar()->value();
    const int shown = continuous_ ? count() : 1;
    const int spareHeight = viewport()->height() - shown * (size.height() + Gap) - Gap;
    const int top = topOf(page) + std::max(0, spareHeight / 2) - verticalScrollBar()->value();
    return {QPoint(left, top), size};
}

void PreviewView::settleRanges() {
    const QSize size = pageSize();
    const int shown = continuous_ ? count() : std::min(1, count());
    const int height = Gap + shown * (size.height() + Gap);
    const int width = size.width() + 2 * Gap;
    const QSize sight = viewport()->size();
    settling_ = true;
    verticalScrollBar()->setPageStep(sight.height());
    verticalScrollBar()->setRange(0, std::max(0, height - sight.height()));
    horizontalScrollBar()->setPageStep(sight.width());
    horizontalScrollBar()->setRange(0, std::max(0, width - sight.width()));
    settling_ = false;
}

void PreviewView::fitPercent() {
    const double whole = logicalDpiX() / 25.4 / 100;  // pixels a millimetre at 1 %
    const double width = (viewport()->width() - 2 * Gap) / (page::Width * whole);
    const double height = (viewport()->height() - 2 * Gap) / (page::Height * whole);
    if (fit_ == Fit::Width) percent_ = width;
    if (fit_ == Fit::Page) percent_ = std::min(width, height);
    percent_ = std::clamp(percent_, LeastPercent, MostPercent);
}

/// Makes a change of size or arrangement, after which the same part of the same page is on top.
void PreviewView::keepingPlace(const std::function<void()>& change) {
    const int page = current_;
    const int above = verticalScrollBar()->value() - topOf(std::max(0, page));
    const double part = above / static_cast<double>(pageSize().height());
    change();
    fitPercent();
    settleRanges();
    const int now = above < 0 ? above : qRound(part * pageSize().height());
    settling_ = true;
    if (page >= 0) verticalScrollBar()->setValue(topOf(page) + now);
    settling_ = false;
    viewport()->update();
    emit moved();
}

// Where the person is.

void PreviewView::setCurrent(int page) {
    if (page == current_) return;
    current_ = page;
    if (!continuous_) viewport()->update();
    emit moved();
}

void PreviewView::goToPage(int page) {
    turnTo(page, false);
}

void PreviewView::turnTo(int page, bool atBottom) {
    page = std::clamp(page, std::min(0, count() - 1), count() - 1);
    settling_ = true;
    const int top = topOf(std::max(0, page)) - Gap;
    const int bottom = top + pageSize().height() + 2 * Gap - viewport()->height();
    verticalScrollBar()->setValue(atBottom ? std::max(top, bottom) : top);
    settling_ = false;
    setCurrent(page);
}

void PreviewView::reveal(int page, const QRectF& box) {
    if (!continuous_ || page != current_) {
        if (!onScreen(page).intersects(viewport()->rect()) || !continuous_) goToPage(page);
    }
    const double scale = pixelsPerMillimetre();
    const auto onTheScreen = [&] {
        const QRectF scaled(box.topLeft() * scale, box.size() * scale);
        return scaled.translated(onScreen(page).topLeft()).toAlignedRect();
    };
    const QRect sight = viewport()->rect().adjusted(Gap, Gap, -Gap, -Gap);
    settling_ = true;
    if (const QRect at = onTheScreen(); at.top() < sight.top() || at.bottom() > sight.bottom())
        verticalScrollBar()->setValue(verticalScrollBar()->value() + at.top() - sight.height() / 3);
    if (const QRect at = onTheScreen(); at.left() < sight.left() || at.right() > sight.right())
        horizontalScrollBar()->setValue(horizontalScrollBar()->value() + at.left() -
                                        sight.width() / 3);
    settling_ = false;
    setCurrent(page);
    viewport()->update();
}

void PreviewView::scrollContentsBy(int dx, int dy) {
    viewport()->scroll(dx, dy);
    if (settling_ || !continuous_ || count() == 0) return;
    const QScrollBar* bar = verticalScrollBar();
    const int height = pageSize().height();
    const int middle = bar->value() + std::min(height, viewport()->height()) / 2;
    const int page = bar->value() == bar->maximum() ? count() - 1 : middle / (height + Gap);
    setCurrent(std::clamp(page, 0, count() - 1));
}

void PreviewView::setContinuous(bool continuous) {
    keepingPlace([&] { continuous_ = continuous; });
}

// Size.

void PreviewView::setFit(Fit fit) {
    keepingPlace([&] { fit_ = fit; });
}

void PreviewView::setPercent(double percent) {
    keepingPlace([&] {
        fit_ = Fit::None;
        percent_ = percent;
    });
}

void PreviewView::zoomBy(int steps) {
    const auto* next = steps > 0
                           ? std::upper_bound(std::begin(Steps), std::end(Steps), percent_ + 1)
                           : std::lower_bound(std::begin(Steps), std::end(Steps), percent_ - 1);
    if (steps < 0 && next != std::begin(Steps)) --next;
    if (next != std::end(Steps)) setPercent(*next);
}

void PreviewView::resizeEvent(QResizeEvent*) {
    keepingPlace([] {});
}

// Painting.

void PreviewView::paintEvent(QPaintEvent* event) {
    QPainter painter(viewport());
    const QColor ground = palette().color(QPalette::Window);
    const QColor ink = palette().color(QPalette::WindowText);
    painter.fillRect(event->rect(), forms::blended(ground, ink, 0.22));
    if (count() == 0) return;
    const int step = pageSize().height() + Gap;
    const int origin = onScreen(0).top();
    const int first = continuous_ ? (event->rect().top() - origin) / step : current_;
    const int last = continuous_ ? (event->rect().bottom() - origin) / step : current_;
    for (int page = std::max(0, first); page <= std::min(last, count() - 1); ++page) {
        painter.save();
        paintPage(painter, page);
        painter.restore();
    }
}

/// Paper is white under any theme.
void PreviewView::paintPage(QPainter& painter, int page) const {
    const QRect paper = onScreen(page);
    painter.setPen(QColor(0, 0, 0, 90));
    painter.drawRect(paper.adjusted(-1, -1, 0, 0));
    painter.fillRect(paper, Qt::white);
    painter.setClipRect(paper, Qt::IntersectClip);
    painter.translate(paper.topLeft());
    painter.setRenderHints(QPainter::Antialiasing | QPainter::TextAntialiasing);
    const double scale = pixelsPerMillimetre();
    paint(painter, *pages_, page, scale);
    if (!highlights_) return;
    painter.setCompositionMode(QPainter::CompositionMode_Multiply);
    for (const Highlight& found : highlights_(page))
        painter.fillRect(QRectF(found.box.topLeft() * scale, found.box.size() * scale),
                         found.current ? FoundCurrent : Found);
}

// Keys and wheel.

void PreviewView::scrollBy(int pixels) {
    QScrollBar* bar = verticalScrollBar();
    const int before = bar->value();
    if (!continuous_ && pixels > 0 && before == bar->maximum() && current_ + 1 < count())
        return turnTo(current_ + 1, false);
    if (!continuous_ && pixels < 0 && before == 0 && current_ > 0)
        return turnTo(current_ - 1, true);
    bar->setValue(before + pixels);
}

void PreviewView::scrollSideways(int direction) {
    QScrollBar* bar = horizontalScrollBar();
    if (bar->maximum() > 0) return bar->setValue(bar->value() + direction * ArrowStep);
    goToPage(current_ + direction);
}

void PreviewView::keyPressEvent(QKeyEvent* event) {
    const int screenful = std::max(ArrowStep, viewport()->height() - PagesOverlap);
    switch (event->key()) {
        case Qt::Key_PageDown:
            return scrollBy(screenful);
        case Qt::Key_PageUp:
            return scrollBy(-screenful);
        case Qt::Key_Space:
            return scrollBy(event->modifiers() & Qt::ShiftModifier ? -screenful : screenful);
        case Qt::Key_Down:
            return scrollBy(ArrowStep);
        case Qt::Key_Up:
            return scrollBy(-ArrowStep);
        case Qt::Key_Left:
            return scrollSideways(-1);
        case Qt::Key_Right:
            return scrollSideways(1);
        case Qt::Key_Home:
            return goToPage(0);
        case Qt::Key_End:
            return turnTo(count() - 1, true);
        default:
            event->ignore();  // Esc and the window's own keys
    }
}

void PreviewView::wheelEvent(QWheelEvent* event) {
    const QPoint angle = event->angleDelta();
    if (event->modifiers() & Qt::ControlModifier) {
        if (angle.y() != 0) zoomBy(angle.y() > 0 ? 1 : -1);
    } else if (angle.y() != 0) {
        scrollBy(-angle.y() * 3 * ArrowStep / (2 * 120));
    } else {
        horizontalScrollBar()->setValue(horizontalScrollBar()->value() - angle.x() / 2);
    }
    event->accept();
}

}  // namespace printing
