// SPDX-License-Identifier: MIT
#pragma once

#include <QFont>
#include <QList>
#include <QRect>
#include <QString>
#include <QWidget>

namespace inspection {

/// A text that a control shows.
struct Text {
    QWidget* on;  ///< what paints it
    QRect room;   ///< where it may stand, in that widget's pixels
    QString text;
    Qt::Alignment alignment;
    bool wraps = false;   ///< flows over lines
    bool isWhole = true;  ///< nobody could move to what is cut off or have it shown otherwise, or
                          ///< it is an amount or a date, half of which says something else
};

/// What the visible controls of a window show: of lists, the rows in sight.
QList<Text> textsOf(const QWidget* window);

}  // namespace inspection
