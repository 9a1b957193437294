// SPDX-License-Identifier: MIT
#include "platform/forms/ScrolledBody.h"

#include <QApplication>
#include <QBoxLayout>
#include <QDialog>
#include <QGroupBox>
#include <QScreen>
#include <QScrollArea>
#include <QScrollBar>

namespace forms {

namespace {

constexpr QSize FrameSize(16, 40);  // about what a window manager adds to a window

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

/// Moves the frames of a column into an area that takes their place.
QScrollArea* scrolled(QVBoxLayout* column, QDialog& screen) {
    auto* inside = new QWidget(&screen);
    auto* frames = new QVBoxLayout(inside);
    frames->setContentsMargins(0, 0, 4, 0);
    frames->setSpacing(column->spacing());
    int first = -1;
    for (int at = 0; at < column->count();) {
        if (!isFrame(column->itemAt(at))) {
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

}  // namespace

void fitToDisplay(QDialog& screen) {
    if (!screen.layout()) return;
    const QSize most = screen.screen()->availableSize() - FrameSize;
    const QSize wanted = screen.layout()->totalSizeHint().expandedTo(screen.minimumSize());
    if (wanted.width() <= most.width() && wanted.height() <= most.height()) return;
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
    screen.resize(QSize(wanted.width() + bar, wanted.height()).boundedTo(most));
    QObject::connect(qApp, &QApplication::focusChanged, area, [area](QWidget*, QWidget* now) {
        if (now && area->widget()->isAncestorOf(now)) area->ensureWidgetVisible(now);
    });
}

}  // namespace forms
