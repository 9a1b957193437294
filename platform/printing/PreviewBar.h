// SPDX-License-Identifier: MIT
#pragma once

#include <QWidget>
#include <functional>

#include "platform/printing/PreviewCommand.h"
#include "platform/printing/PreviewView.h"

class QBoxLayout;
class QComboBox;
class QLabel;
class QLineEdit;

namespace forms {
class Button;
class CheckBox;
}  // namespace forms

namespace printing {

/// Does what a person asks of the preview.
using PreviewHandler = std::function<void(PreviewCommand)>;

/// A button for a command, one that clicking does not give the focus: it stays on the pages.
forms::Button* previewButton(PreviewCommand command, const PreviewHandler& handler);

/// The bar over the pages.
class PreviewBar : public QWidget {
public:
    explicit PreviewBar(const PreviewHandler& handler);

    /// @param page   from 0; -1 for none yet
    /// @param count  of the pages laid out so far
    void showPage(int page, int count);
    /// @param percent  of the size on paper
    void showZoom(double percent);
    /// Whether the pages stand one below the other.
    void showContinuous(bool continuous);
    /// Whether the buttons for printing, PDF and CSV can be pressed.
    void setOutputEnabled(bool enabled);
    /// For the window, which Esc closes by this button.
    forms::Button* closeButton() const { return close_; }

    /// The page that a person wants, from 0; it may be one that is not there.
    std::function<void(int page)> onPage;
    /// The size that a person wants, and whether it is to follow the window.
    std::function<void(double percent)> onPercent;
    std::function<void(PreviewView::Fit fit)> onFit;

    /// Puts the cursor into the field of the page's number.
    void askPage();
    /// Puts the cursor into the field of the size.
    void askZoom();

private:
    void addOutput(QBoxLayout* row, const PreviewHandler& handler);
    void addPages(QBoxLayout* row, const PreviewHandler& handler);
    void addZoom(QBoxLayout* row, const PreviewHandler& handler);
    void pageTyped();
    void zoomTyped(const QString& text);

    forms::Button* output_[3];  ///< print, PDF, CSV
    forms::Button* back_[2];    ///< first, previous
    forms::Button* ahead_[2];   ///< next, last
    QLineEdit* page_;
    QLabel* count_;
    QComboBox* zoom_;
    forms::CheckBox* continuous_;
    forms::Button* close_;
    int shownPage_ = -1;
    int shownCount_ = 0;
    double shownPercent_ = 0;
};

}  // namespace printing
