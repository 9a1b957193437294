// SPDX-License-Identifier: MIT
#pragma once

#include <QLabel>
#include <QPainter>
#include <QStyle>

namespace host {

/// A label that gives up the middle of its text where there is no room, as for the path of a book;
/// the tool tip has the whole.
class ElidedLabel : public QLabel {
public:
    using QLabel::QLabel;

    QSize minimumSizeHint() const override {
        constexpr int FewLetters = 12;
        return {fontMetrics().averageCharWidth() * FewLetters, QLabel::minimumSizeHint().height()};
    }

protected:
    void paintEvent(QPaintEvent*) override {
        QPainter painter(this);
        const QString shown =
            fontMetrics().elidedText(text(), Qt::ElideMiddle, contentsRect().width());
        setToolTip(shown == text() ? QString() : text());
        style()->drawItemText(&painter, contentsRect(), static_cast<int>(alignment()), palette(),
                              isEnabled(), shown, foregroundRole());
    }
};

}  // namespace host
