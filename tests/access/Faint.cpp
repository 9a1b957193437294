// SPDX-License-Identifier: MIT
#include <QHash>
#include <QImage>
#include <QStyle>

#include "tests/access/Inspection.h"
#include "tests/access/Texts.h"
#include "tests/support/Contrast.h"

using namespace Qt::StringLiterals;

namespace inspection {

namespace {

constexpr double Least = 4.5;
constexpr double LeastDisabled = 3;  // nobody has to read what cannot be used now

/// Between the commonest colour, the ground, and the letters, which stand out from it most.
double contrastIn(const QImage& picture) {
    QHash<QRgb, int> colors;
    for (int y = 0; y < picture.height(); ++y)
        for (int x = 0; x < picture.width(); ++x) ++colors[picture.pixel(x, y)];
    QRgb ground = 0;
    for (auto color = colors.cbegin(); color != colors.cend(); ++color)
        if (color.value() > colors.value(ground)) ground = color.key();
    double most = 1;
    // The edges of letters are blends of both.
    for (auto color = colors.cbegin(); color != colors.cend(); ++color)
        most = std::max(most, support::contrast(QColor(color.key()), QColor(ground)));
    return most;
}

/// Where the letters are, in the window; empty when they are scrolled out of sight.
QRect placeOfLetters(const Text& text) {
    const QSize letters = text.on->fontMetrics().size(0, text.text).boundedTo(text.room.size());
    QRect place = QStyle::alignedRect(Qt::LeftToRight, text.alignment,
                                      text.wraps ? text.room.size() : letters, text.room);
    if (!text.on->visibleRegion().contains(place)) return {};
    place.moveTopLeft(text.on->mapTo(text.on->window(), place.topLeft()));
    return place;
}

}  // namespace

QStringList tooFaint(QWidget* window) {
    QStringList faults;
    const QImage picture = window->grab().toImage();
    for (const Text& text : textsOf(window)) {
        const QRect place = placeOfLetters(text);
        if (place.isEmpty()) continue;
        const double seen = contrastIn(picture.copy(place));
        if (seen < (text.on->isEnabled() ? Least : LeastDisabled))
            faults << placeOf(text.on) +
                          u"«%1» has a contrast of %2"_s.arg(text.text).arg(seen, 0, 'f', 1);
    }
    return faults;
}

}  // namespace inspection
