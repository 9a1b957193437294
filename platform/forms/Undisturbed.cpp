// SPDX-License-Identifier: MIT
#include "platform/forms/Undisturbed.h"

#include <QApplication>
#include <QEvent>

#include "platform/core/Wait.h"

namespace forms {

namespace {

/// The eye sees no more steps than these allow.
constexpr qint64 MillisecondsBetweenTurns = 30;

bool isFromPerson(const QEvent& event) {
    switch (event.type()) {
        case QEvent::KeyPress:
        case QEvent::KeyRelease:
        case QEvent::Shortcut:
        case QEvent::ShortcutOverride:
        case QEvent::InputMethod:
        case QEvent::MouseButtonPress:
        case QEvent::MouseButtonRelease:
        case QEvent::MouseButtonDblClick:
        case QEvent::Wheel:
        case QEvent::ContextMenu:
        case QEvent::TouchBegin:
        case QEvent::TouchUpdate:
        case QEvent::TouchEnd:
        case QEvent::TabletPress:
        case QEvent::TabletRelease:
        case QEvent::DragEnter:
        case QEvent::Drop:
            return true;
        case QEvent::Close:
            return event.spontaneous();
        default:
            return false;
    }
}

}  // namespace

Undisturbed::Undisturbed() {
    served_.start();
    qApp->installEventFilter(this);
}

Undisturbed::~Undisturbed() {
    if (!hasEnded_) QCoreApplication::processEvents();  // what came since then is dropped, too
}

void Undisturbed::serve() {
    if (!served_.hasExpired(MillisecondsBetweenTurns)) return;
    QCoreApplication::processEvents();
    served_.start();
}

void Undisturbed::end() {
    qApp->removeEventFilter(this);
    hasEnded_ = true;
}

bool Undisturbed::eventFilter(QObject*, QEvent* event) {
    if (core::isWaiting() || !isFromPerson(*event)) return false;
    event->ignore();
    return true;
}

}  // namespace forms
