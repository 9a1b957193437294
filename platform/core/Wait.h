// SPDX-License-Identifier: MIT
#pragma once

#include <QElapsedTimer>
#include <QString>

namespace core {

/// A wait for somebody else: another program, a server. Whoever waits says so step by step, so that
/// the windows go on being painted and the operator can give up. Elsewhere than on the
/// application's thread, and in a program without screens, it does nothing.
class Wait {
public:
    /// @param what  what is waited for, as the operator reads it: "À espera de …"
    explicit Wait(const QString& what) : what_(what) { started_.start(); }
    ~Wait();
    Wait(const Wait&) = delete;
    Wait& operator=(const Wait&) = delete;

    /// To be called every 50 milliseconds or so. False once the operator has given up.
    bool goesOn();
    bool isGivenUp() const { return isGivenUp_; }

private:
    QString what_;
    QElapsedTimer started_;
    QElapsedTimer served_;  ///< since the presenter was asked last; not started before the first
    bool isGivenUp_ = false;
};

/// True while windows are served inside of a wait. Whatever would use the book then leaves it for
/// later: the engine is in the midst of something.
bool isWaiting();

/// Who shows a wait that takes long. The screens' runtime installs itself here.
class WaitPresenter {
public:
    virtual ~WaitPresenter() = default;
    /// Shows what is waited for and lets the windows paint; false when the operator gave up.
    virtual bool serve(const QString& what) = 0;
    virtual void end() = 0;
};
/// Null for none.
void setWaitPresenter(WaitPresenter* presenter);

}  // namespace core
