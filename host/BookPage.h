// SPDX-License-Identifier: MIT
#pragma once

#include <QWidget>
#include <functional>

class QGridLayout;
class QLabel;
class QPushButton;

namespace host {

/// What the main window shows while there is no book: the ways to one, each a button that the arrow
/// keys reach and Enter presses.
class BookPage : public QWidget {
    Q_OBJECT
public:
    BookPage();

    /// Says why there is no book, and whether it makes sense to try the same one again.
    void tell(const QString& why, bool canTryAgain);
    /// Puts the focus on the first way.
    void takeFocus();

signals:
    void tryAgain();
    void sampleWanted();
    void newBookWanted();
    void existingWanted();
    void serverWanted();

private:
    QPushButton* addWay(const QString& name, const QString& caption, const QString& explanation,
                        void (BookPage::*wanted)());

    QGridLayout* ways_;
    QLabel* why_;
    QPushButton* again_;
    QPushButton* first_;
    QLabel* againExplained_;
};

}  // namespace host
