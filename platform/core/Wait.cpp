// SPDX-License-Identifier: MIT
#include "platform/core/Wait.h"

#include <QCoreApplication>
#include <QThread>
#include <utility>

namespace core {

namespace {

// Milliseconds.
constexpr qint64 Unnoticed = 1000;  // a shorter wait shows nothing
constexpr qint64 Pause = 20;        // between two looks at the windows

WaitPresenter* current = nullptr;
bool serving = false;

bool isOnApplicationThread() {
    const QCoreApplication* application = QCoreApplication::instance();
    return application && application->thread() == QThread::currentThread();
}

}  // namespace

Wait::~Wait() {
    if (!served_.isValid() || !current) return;
    serving = true;
    current->end();
    serving = false;
}

bool Wait::goesOn() {
    if (isGivenUp_) return false;
    if (started_.elapsed() < Unnoticed || (served_.isValid() && served_.elapsed() < Pause))
        return true;
    if (!current || !isOnApplicationThread() || std::exchange(serving, true)) return true;
    served_.start();
    isGivenUp_ = !current->serve(what_);
    serving = false;
    served_.start();
    return !isGivenUp_;
}

bool isWaiting() {
    return serving && isOnApplicationThread();
}

void setWaitPresenter(WaitPresenter* presenter) {
    current = presenter;
}

}  // namespace core
