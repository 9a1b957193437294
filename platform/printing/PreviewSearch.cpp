// SPDX-License-Identifier: MIT
#include "platform/printing/PreviewSearch.h"

#include <QElapsedTimer>
#include <algorithm>
#include <limits>

#include "platform/core/Folding.h"
#include "platform/printing/Typesetting.h"

namespace printing {

namespace {

constexpr int FromTheEnd = std::numeric_limits<int>::max();
constexpr double MillimetresPerPoint = 25.4 / 72;

/// A text as it is compared, and for each byte of it the letter that it comes from.
struct FoldedRun {
    std::string plain;
    std::vector<qsizetype> letter;
};

FoldedRun foldedRun(const QString& text) {
    FoldedRun run;
    for (qsizetype at = 0; at < text.size();) {
        const qsizetype length = text[at].isHighSurrogate() ? 2 : 1;
        run.plain += core::folded(text.mid(at, length));
        run.letter.resize(run.plain.size(), at);
        at += length;
    }
    run.letter.push_back(text.size());
    return run;
}

/// The box around letters `from`..`to` of a run.
QRectF boxAround(const TextRun& run, qsizetype from, qsizetype to) {
    const Face face(run.style);
    const double left = face.width(run.text.left(from));
    const double right = face.width(run.text.left(to));
    const double size = run.style.points * MillimetresPerPoint;
    return {run.baseline.x() + left, run.baseline.y() - 0.9 * size, right - left, 1.15 * size};
}

bool readsBefore(const QRectF& a, const QRectF& b) {
    const auto line = [](const QRectF& box) { return qRound(box.bottom() * 2); };
    return std::pair(line(a), a.left()) < std::pair(line(b), b.left());
}

}  // namespace

void PreviewSearch::look(const QString& text, int fromPage) {
    text_ = core::folded(text.trimmed());
    state_ = text_.empty() ? State::Idle : State::Looking;
    forward_ = true;
    wrapped_ = false;
    start_ = page_ = std::max(0, fromPage);
    beyond_ = -1;
}

void PreviewSearch::lookOn(bool forward) {
    if (state_ != State::Found) return;
    state_ = State::Looking;
    forward_ = forward;
    wrapped_ = false;
    start_ = page_;
}

PreviewSearch::State PreviewSearch::go(int milliseconds, bool moreToCome) {
    QElapsedTimer clock;
    clock.start();
    while (state_ == State::Looking && turnPage(moreToCome) && clock.elapsed() <= milliseconds)
        lookAtPage();
    return state_;
}

/// Comes round the end or the beginning. False while the pages to look at are still to come.
bool PreviewSearch::turnPage(bool moreToCome) {
    if (page_ >= 0 && page_ < pages_->count()) return true;
    if (moreToCome) return false;
    wrapped_ = true;
    page_ = forward_ ? 0 : pages_->count() - 1;
    return true;
}

void PreviewSearch::lookAtPage() {
    const std::vector<QRectF> hits = hitsOn(page_);
    const int count = static_cast<int>(hits.size());
    const int next = forward_ ? beyond_ + 1 : std::min(beyond_, count) - 1;
    if (next >= 0 && next < count) {
        state_ = State::Found;
        beyond_ = next;
        box_ = hits[static_cast<size_t>(next)];
        return;
    }
    if (wrapped_ && page_ == start_) {
        state_ = State::NotFound;
        return;
    }
    page_ += forward_ ? 1 : -1;
    beyond_ = forward_ ? -1 : FromTheEnd;
}

std::vector<QRectF> PreviewSearch::hitsOn(int page) const {
    std::vector<QRectF> hits;
    if (text_.empty() || page < 0 || page >= pages_->count()) return hits;
    const Page laidOut = pages_->at(page);
    if (!mayHold(laidOut)) return hits;
    for (const TextRun& unresolved : laidOut.texts) {
        const TextRun run = pages_->resolved(unresolved);
        const FoldedRun folded = foldedRun(run.text);
        for (size_t at = folded.plain.find(text_); at != std::string::npos;
             at = folded.plain.find(text_, at + text_.size()))
            hits.push_back(boxAround(run, folded.letter[at], folded.letter[at + text_.size()]));
    }
    std::stable_sort(hits.begin(), hits.end(), readsBefore);
    return hits;
}

/// Folds all texts of a page in one go: that is quick, and most pages hold none.
bool PreviewSearch::mayHold(const Page& page) const {
    QString all;
    for (const TextRun& run : page.texts) all += pages_->resolved(run).text + u'\n';
    return core::folded(all).find(text_) != std::string::npos;
}

}  // namespace printing
