// SPDX-License-Identifier: MIT
#pragma once

#include <QRectF>
#include <QString>
#include <memory>
#include <string>
#include <vector>

#include "platform/printing/Pages.h"

namespace printing {

/// Looks for a text on pages of which more may be to come, a stretch at a time. Accents and case
/// make no difference. A text is found within one line of one field.
class PreviewSearch {
public:
    enum class State {
        Idle,      ///< nothing to look for
        Looking,   ///< go() has more to do, perhaps only once more pages are there
        Found,     ///< at hitPage(), hitBox()
        NotFound,  ///< on no page
    };

    explicit PreviewSearch(std::shared_ptr<const Pages> pages) : pages_(std::move(pages)) {}

    /// Starts at the top of a page to look for a text; an empty one ends the search.
    void look(const QString& text, int fromPage);
    /// From a place found on to the next one, or back to the one before; the last place and the
    /// first are neighbours.
    void lookOn(bool forward);
    /// Works for about so many milliseconds. While more pages are to come it waits for them at the
    /// end of those that are there.
    State go(int milliseconds, bool moreToCome);

    /// How far the search has come.
    State state() const { return state_; }
    // The place found, while the state says so.
    int hitPage() const { return page_; }
    QRectF hitBox() const { return box_; }  ///< millimetres on the page
    /// True when the end, or looking back the beginning, was passed on the way.
    bool wasWrapped() const { return wrapped_; }
    /// All places on a page, in reading order.
    std::vector<QRectF> hitsOn(int page) const;

private:
    void lookAtPage();
    bool mayHold(const Page& page) const;
    bool turnPage(bool moreToCome);

    std::shared_ptr<const Pages> pages_;
    std::string text_;  ///< folded
    State state_ = State::Idle;
    bool forward_ = true;
    bool wrapped_ = false;
    int start_ = 0;    ///< the page at which this search began
    int page_ = 0;     ///< to be looked at next, or where the text was found
    int beyond_ = -1;  ///< number of the place on page_ behind (before) which the next one counts
    QRectF box_;
};

}  // namespace printing
