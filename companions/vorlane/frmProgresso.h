// SPDX-License-Identifier: MIT
#pragma once

#include <QElapsedTimer>
#include <QFrame>

namespace forms {
class ProgressBar;
}

namespace vorlane {

/// Title, message and bar, above the screen whose work it shows. It never takes the focus, and
/// while it paints itself no key and no click reaches any screen.
class frmProgresso : public QFrame {
    Q_OBJECT
public:
    /// Shows itself at once.
    frmProgresso(int total, const QString& message, const QString& title);
    void advance(int steps);

private:
    void layOut(const QString& message, const QString& title);
    void paintNow();

    QElapsedTimer painted_;
    forms::ProgressBar* ProgressBar1;
};

}  // namespace vorlane
