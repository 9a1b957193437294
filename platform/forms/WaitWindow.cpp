// SPDX-License-Identifier: MIT
#include "platform/forms/WaitWindow.h"

#include <QApplication>
#include <QBoxLayout>
#include <QDialog>
#include <QLabel>
#include <QPointer>
#include <QProgressBar>
#include <QPushButton>
#include <QWindow>
#include <memory>

#include "platform/core/MsgBox.h"
#include "platform/core/Wait.h"

using namespace Qt::StringLiterals;

namespace forms {

namespace {

/// Milliseconds that the windows get each time.
constexpr int Slice = 10;

class WaitWindow : public QDialog {
public:
    WaitWindow(const QString& what, QWidget* before) {
        auto* text = new QLabel(what, this);
        setObjectName(u"frmEspera"_s);
        setWindowTitle(core::DefaultTitle.toString());
        setWindowModality(Qt::ApplicationModal);
        // Intentional: the window has the focus, not its button. A blank or Enter that was typed
        // ahead of a slow answer gives nothing up.
        setFocusPolicy(Qt::StrongFocus);
        text->setObjectName(u"Label1"_s);
        text->setWordWrap(true);
        text->setMinimumWidth(fontMetrics().averageCharWidth() * 52);
        auto* moving = new QProgressBar(this);
        moving->setRange(0, 0);  // goes to and fro: nobody knows how long it takes
        moving->setTextVisible(false);
        moving->setAccessibleName(u"À espera"_s);
        moving->setFixedHeight(fontMetrics().height() / 2);
        auto* giveUp = new QPushButton(u"&Desistir"_s, this);
        giveUp->setObjectName(u"Command1"_s);
        giveUp->setAutoDefault(false);
        connect(giveUp, &QPushButton::clicked, this, &QDialog::reject);

        auto* buttons = new QHBoxLayout;
        buttons->addStretch(1);
        buttons->addWidget(giveUp);
        auto* all = new QVBoxLayout(this);
        all->setContentsMargins(16, 16, 16, 12);
        all->setSpacing(14);
        all->addWidget(text);
        all->addWidget(moving);
        all->addLayout(buttons);
        if (before) {
            winId();  // makes the window, so that it can be told what it stands in front of
            windowHandle()->setTransientParent(before->windowHandle());
        }
    }
};

class Presenter : public core::WaitPresenter {
public:
    bool serve(const QString& what) override {
        if (!window_) {
            before_ = QApplication::activeWindow();
            window_ = std::make_unique<WaitWindow>(what, before_);
            window_->show();
            window_->activateWindow();
            window_->setFocus();
        }
        QCoreApplication::processEvents(QEventLoop::AllEvents, Slice);
        return window_->isVisible();
    }

    void end() override {
        window_.reset();
        // Without a window manager nobody else gives the focus back.
        if (before_ && before_->isVisible()) before_->activateWindow();
        // What could not be read while the book was busy is painted now.
        for (QWidget* shown : QApplication::topLevelWidgets())
            if (shown->isVisible()) shown->update();
    }

private:
    std::unique_ptr<WaitWindow> window_;
    QPointer<QWidget> before_;
};

}  // namespace

void installWaitWindow() {
    static Presenter presenter;
    core::setWaitPresenter(&presenter);
}

}  // namespace forms
