// SPDX-License-Identifier: MIT
#include "platform/forms/ScrolledBody.h"

#include <QApplication>
#include <QBoxLayout>
#include <QDialog>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QScreen>
#include <QScrollArea>
#include <QScrollBar>

#include "platform/forms/Form.h"

namespace forms {

namespace {

constexpr QSize FrameSize(16, 40);  // about what a window manager adds to a window

constexpr int Margin = 6;  // above and below what has been scrolled to

constexpr int WholeHeight = 1000;  // against the stretch below the frames

bool isFrame(const QLayoutItem* item) {
    return qobject_cast<QGroupBox*>(item->widget()) != nullptr;
}

/// The column that holds the frames of a screen; null where there is none.
QVBoxLayout* columnOfFrames(QLayout* layout) {
    auto* column = qobject_cast<QVBoxLayout*>(layout);
    for (int at = 0; column && at < column->count(); ++at) {
        if (isFrame(column->itemAt(at))) return column;
        if (auto* inner = columnOfFrames(column->itemAt(at)->layout())) return inner;
    }
    return nullptr;
}

/// Moves the frames of a column, and what grows beside them, into an area that takes their place.
QScrollArea* scrolled(QVBoxLayout* column, QDialog& screen) {
    auto* inside = new QWidget(&screen);
    auto* frames = new QVBoxLayout(inside);
    frames->setContentsMargins(0, 0, 4, 0);
    frames->setSpacing(column->spacing());
    int first = -1;
    for (int at = 0; at < column->count();) {
        // What grows with the screen, such as a table, would be left with nothing.
        const bool grows = column->itemAt(at)->widget() && column->stretch(at) > 0;
        if (!isFrame(column->itemAt(at)) && !grows) {
            ++at;
            continue;
        }
        if (first < 0) first = at;
        const int stretch = column->stretch(at);
        QLayoutItem* frame = column->takeAt(at);
        frames->addWidget(frame->widget(), stretch);
        delete frame;
    }
    auto* area = new QScrollArea(&screen);
    area->setFrameShape(QFrame::NoFrame);
    area->setFocusPolicy(Qt::NoFocus);
    area->setWidgetResizable(true);
    area->setWidget(inside);
    column->insertWidget(first, area, WholeHeight);
    return area;
}

/// A control and its label, in the area's contents.
QRect withLabel(const QWidget* control, const QWidget* contents) {
    QRect place(control->mapTo(contents, QPoint(0, 0)), control->size());
    for (const auto* label : contents->findChildren<QLabel*>())
        if (label->buddy() == control && label->isVisible())
            place |= QRect(label->mapTo(contents, QPoint(0, 0)), label->size());
    return place;
}

/// Scrolls to a part of the screen whenever one of its fields shows something else.
void keepInSight(QScrollArea* area, const QWidget* part) {
    for (const auto* line : part->findChildren<QLineEdit*>())
        QObject::connect(
            line, &QLineEdit::textChanged, area,
            [area, part](const QString& text) {
                if (text.isEmpty()) return;
                const QRect place(part->mapTo(area->widget(), QPoint(0, 0)), part->size());
                area->ensureVisible(place.center().x(), place.bottom(), 0, Margin);
            },
            Qt::QueuedConnection);
}

/// Scrolls to a control: of one that is wider than the area, to where it and its label begin.
void bringIntoSight(QScrollArea& area, const QWidget* control) {
    QRect place = withLabel(control, area.widget());
    place.setWidth(std::min(place.width(), area.viewport()->width()));
    area.ensureVisible(place.right(), place.bottom(), 0, Margin);
    area.ensureVisible(place.left(), place.top(), 0, Margin);
}

}  // namespace

void fitToDisplay(QDialog& screen) {
    if (!screen.layout()) return;
    const QSize most = screen.screen()->availableSize() - FrameSize;
    screen.setMinimumSize(screen.minimumSize().boundedTo(most));
    const QSize wanted = screen.layout()->totalSizeHint().expandedTo(screen.minimumSize());
    const bool hasSize = screen.testAttribute(Qt::WA_Resized);
    if (wanted.width() <= most.width() && wanted.height() <= most.height()) {
        if (hasSize) screen.resize(screen.size().boundedTo(most));
        return;
    }
    QVBoxLayout* column = columnOfFrames(screen.layout());
    if (!column) return;
    QWidget* const focused = screen.focusWidget();
    QScrollArea* area = scrolled(column, screen);
    // A frame that is moved loses the focus of its fields.
    if (focused) focused->setFocus(Qt::TabFocusReason);
    const int bar = area->verticalScrollBar()->sizeHint().width();
    const int others = wanted.width() - area->widget()->sizeHint().width();
    area->setMinimumWidth(
        std::min(area->widget()->sizeHint().width() + bar, most.width() - std::max(others, 0)));
    const QSize chosen = hasSize ? screen.size() : QSize();
    screen.resize(QSize(wanted.width() + bar, wanted.height()).expandedTo(chosen).boundedTo(most));
    const auto* form = qobject_cast<Form*>(&screen);
    const QWidget* part = form ? form->partInSight() : nullptr;
    if (part && area->widget()->isAncestorOf(part)) keepInSight(area, part);
    QObject::connect(qApp, &QApplication::focusChanged, area, [area](QWidget*, QWidget* now) {
        if (now && area->widget()->isAncestorOf(now)) bringIntoSight(*area, now);
    });
}

}  // namespace forms
