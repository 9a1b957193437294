// SPDX-License-Identifier: MIT
#pragma once

#include "platform/printing/PreviewBar.h"
#include "platform/printing/PreviewSearch.h"

namespace printing {

/// The bar under the pages in which a person types the text to look for, the search, and its
/// highlights on the pages. Hidden until it is asked for.
class PreviewFindBar : public QWidget {
public:
    PreviewFindBar(const PreviewHandler& handler, std::shared_ptr<const Pages> pages,
                   PreviewView* view);

    /// Comes up with the whole text selected.
    void open();
    /// On to the next place, or back to the one before; comes up if it is hidden.
    void findNext(bool forward);
    /// Ends the search, with its highlights, and hides.
    void end();
    /// True while pages are still to be searched.

    bool isLooking() const { return search_.state() == PreviewSearch::State::Looking; }
    /// Goes on for about so many milliseconds, see PreviewSearch, and shows the place found.
    void look(int milliseconds, bool moreToCome);
    /// A search has begun: look() has to be called until isLooking() is false.
    std::function<void()> onSearch;

protected:
    void keyPressEvent(QKeyEvent* event) override;

private:
    void start();
    std::vector<Highlight> highlightsOn(int page) const;

    PreviewHandler handler_;
    PreviewSearch search_;
    PreviewView* view_;
    QLineEdit* text_;
    QLabel* message_;
};

}  // namespace printing
