// SPDX-License-Identifier: MIT
#include <QAbstractScrollArea>
#include <QFontMetrics>
#include <QLabel>
#include <QScreen>
#include <QScrollBar>

#include "tests/access/Inspection.h"
#include "tests/access/Texts.h"

using namespace Qt::StringLiterals;

namespace inspection {

namespace {

QFont fontOf(const Text& text) {
    // A header and a list paint on a viewport, with letters of their own.
    const auto* whole = qobject_cast<QAbstractScrollArea*>(text.on->parentWidget());
    return whole && whole->viewport() == text.on ? whole->font() : text.on->font();
}

bool fits(const Text& text) {
    const QFontMetrics letters(fontOf(text));
    if (text.wraps) {
        const QRect needed =
            letters.boundingRect(QRect(0, 0, text.room.width(), 0), Qt::TextWordWrap, text.text);
        return needed.width() <= text.room.width() && needed.height() <= text.room.height();
    }
    const QSize needed = letters.size(0, text.text);
    return needed.width() <= text.room.width() && needed.height() <= text.room.height() + 1;
}

/// What moves its contents into sight as the focus or the person wants; null for none.
const QAbstractScrollArea* scrolledBy(const QWidget* widget) {
    for (const QWidget* up = widget->parentWidget(); up && !widget->isWindow();
         up = up->parentWidget()) {
        if (const auto* area = qobject_cast<const QAbstractScrollArea*>(up)) return area;
        if (up->isWindow()) break;
    }
    return nullptr;
}

bool isInSight(const QWidget* widget) {
    for (const QWidget* up = widget->parentWidget(); up; up = up->parentWidget()) {
        const QRect there(widget->mapTo(up, QPoint(0, 0)), widget->size());
        if (!up->rect().contains(there)) return false;
        if (up->isWindow()) break;
    }
    return true;
}

}  // namespace

QStringList cutOff(QWidget* window) {
    QStringList faults;
    const QSize display = window->screen()->availableSize();
    if (window->width() > display.width() || window->height() > display.height())
        faults << placeOf(window) + u"%1×%2 does not fit the display"_s.arg(window->width())
                                        .arg(window->height());
    for (const QWidget* control : controlsOf(window)) {
        const QSize least = control->minimumSizeHint();
        if (control->width() <= 1 || control->height() <= 1) continue;
        if (!scrolledBy(control) && !isInSight(control))
            faults << placeOf(control) + u"reaches out of its window"_s;
        if (control->inherits("QGroupBox") &&
            (control->height() < least.height() || control->width() < least.width()))
            faults << placeOf(control) + u"is squeezed"_s;
    }
    for (const Text& text : textsOf(window))
        if (text.isWhole && !fits(text))
            faults << placeOf(text.on) + u"«%1» is cut off"_s.arg(text.text);
    return faults;
}

}  // namespace inspection
