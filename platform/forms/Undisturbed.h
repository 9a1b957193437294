// SPDX-License-Identifier: MIT
#pragma once

#include <QElapsedTimer>
#include <QObject>

namespace forms {

/// While long work runs on the screens' own thread: the windows go on being painted, but no key
/// and no click reaches them, now or later; what is typed meanwhile is dropped, so that nothing is
/// pressed by it when the work is done. A window that asks whether to go on waiting is served.
class Undisturbed : public QObject {
public:
    Undisturbed();
    ~Undisturbed() override;

    /// To be called often, as at each row; gives the windows their turn now and then.
    void serve();
    /// Ends it early: what came since the windows' last turn is not dropped but served as usual.
    void end();

protected:
    bool eventFilter(QObject* receiver, QEvent* event) override;

private:
    QElapsedTimer served_;
    bool hasEnded_ = false;
};

}  // namespace forms
