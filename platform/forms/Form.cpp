// SPDX-License-Identifier: MIT
#include "platform/forms/Form.h"

#include <QApplication>
#include <QCloseEvent>
#include <QEventLoop>
#include <QKeyEvent>
#include <QLineEdit>
#include <QSet>
#include <QWindow>
#include <vector>

#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Wait.h"
#include "platform/forms/Caught.h"
#include "platform/forms/Controls.h"
#include "platform/forms/MsgBoxes.h"
#include "platform/forms/ScrolledBody.h"
#include "platform/forms/Validation.h"

using namespace Qt::StringLiterals;

namespace forms {

namespace {

/// Handlers and modal screens on the stack: while one runs, it may use a screen that was unloaded.
int running = 0;
std::vector<QPointer<Form>> unloadedScreens;
std::vector<std::function<void()>> workAfterwards;
CaughtListener toldOfCaught = nullptr;

void tellOf(int number, const QString& code = {}) {
    if (toldOfCaught) toldOfCaught({number, code, activeScreen()});
}

class Running {
public:
    Running() { ++running; }
    ~Running() {
        if (--running > 0) return;
        for (const QPointer<Form>& screen : unloadedScreens)
            if (screen) screen->deleteLater();
        unloadedScreens.clear();
        const auto works = std::exchange(workAfterwards, {});
        if (works.empty()) return;
        QGuiApplication::sync();
        for (const std::function<void()>& work : works) handle(work);
    }
    Running(const Running&) = delete;
    Running& operator=(const Running&) = delete;
};

bool run(const std::function<void()>& handler, core::Icon icon) {
    if (!handler) return true;
    // The engine is in the midst of something; a timer comes again, and nobody can click.
    if (core::isWaiting()) return false;
    const Running scope;
    const core::HandlerScope pending;
    QString text;
    try {
        handler();
        return true;
    } catch (const core::Failure& failure) {
        text = failure.text();
        tellOf(failure.number(), failure.code());
    } catch (const std::exception& failure) {
        text = QString::fromUtf8(failure.what());
        tellOf(0);
    } catch (...) {
        text = u"Erro inesperado."_s;
        tellOf(0);
    }
    core::MsgBox(text, icon);
    return false;
}

}  // namespace

bool handle(const std::function<void()>& handler) {
    return run(handler, core::Icon::Critical);
}

bool handlePlainly(const std::function<void()>& handler) {
    return run(handler, core::Icon::None);
}

void setCaughtListener(CaughtListener listener) {
    toldOfCaught = listener;
}

QString activeScreen() {
    const QWidget* window = QApplication::activeWindow();
    return window ? window->objectName() : QString();
}

void afterwards(const std::function<void()>& work) {
    const Running scope;
    workAfterwards.push_back(work);
}

namespace {

/// The owners whose turn is taken. The object of an unloaded screen outlives its handlers, so that
/// no other object comes to the same address meanwhile.
QSet<const QObject*>& takenTurns() {
    static QSet<const QObject*> owners;
    return owners;
}

/// Asked to the front, and not there yet: a window manager answers later.
QPointer<Form> shownLast;

}  // namespace

Turn::Turn(const QObject* owner) : owner_(takenTurns().contains(owner) ? nullptr : owner) {
    if (owner_) takenTurns().insert(owner_);
}

Turn::~Turn() {
    takenTurns().remove(owner_);
}

Form::Form(const QString& name, const QString& caption) {
    install();
    setObjectName(name);
    setWindowTitle(caption);
}

Form::~Form() {
    if (modalLoop_) modalLoop_->quit();
}

void Form::Show() {
    show();
    raise();
    activateWindow();
    shownLast = isVisible() && !isActiveWindow() ? this : nullptr;
}

void Form::ShowModal() {
    if (unloaded_ || modalLoop_) return;
    const Running scope;
    const QPointer<Form> self = this;
    const QPointer<QWidget> before = QApplication::activeWindow();
    if (isVisible()) hide();
    setWindowModality(Qt::ApplicationModal);
    if (before && before != this) {
        winId();  // makes the window, so that it can be told what it stands in front of
        windowHandle()->setTransientParent(before->windowHandle());
    }
    QEventLoop loop;
    modalLoop_ = &loop;
    Show();
    if (self && isVisible()) loop.exec();
    if (self) {
        modalLoop_ = nullptr;
        if (windowHandle()) windowHandle()->setTransientParent(nullptr);
        setWindowModality(Qt::NonModal);
    }
    // Without a window manager nobody else gives the focus back.
    if (before && before->isVisible()) before->activateWindow();
}

void Form::Hide() {
    hide();
}

void Form::Unload() {
    if (unloaded_) return;
    const Running scope;
    unloaded_ = true;
    handle(onUnload);
    hide();
    unloadedScreens.emplace_back(this);
}

void Form::setVisible(bool visible) {
    if (visible && unloaded_) return;
    if (visible && !loaded_) {
        loaded_ = true;
        handle(onLoad);
        if (unloaded_) return;
        fitToDisplay(*this);
    }
    QDialog::setVisible(visible);
    if (!visible && modalLoop_) modalLoop_->quit();
}

void Form::setCancelButton(Button* button) {
    cancel_ = button;
    passesValidation(button);
}

QWidget* Form::ActiveControl() const {
    return focusWidget();
}

Form* Form::comingForward() {
    return shownLast && shownLast->isVisible() ? shownLast : nullptr;
}

void Form::changeEvent(QEvent* event) {
    if (event->type() == QEvent::ActivationChange && isActiveWindow()) {
        // Any screen that gets the keyboard ends the way of another one to the front.
        shownLast = nullptr;
        // The control that has the focus is marked from the start: people work by keys here.
        setAttribute(Qt::WA_KeyboardFocusChange);
    }
    QDialog::changeEvent(event);
}

void Form::letEnterGoOn(Button* last) {
    enterGoesOn_ = true;
    enterPresses_ = last;
}

bool Form::stopsEnter(const QWidget* control) const {
    if (!dynamic_cast<const Validating*>(control)) return false;
    const auto* line = qobject_cast<const QLineEdit*>(control);
    return !line || !line->isReadOnly();
}

void Form::goOnFrom(QWidget* field) {
    // The window itself stands at the end of the chain.
    for (QWidget* next = field->nextInFocusChain(); next != this && next != field;
         next = next->nextInFocusChain()) {
        const bool reachable =
            next->isVisible() && next->isEnabled() && (next->focusPolicy() & Qt::TabFocus);
        if (reachable && stopsEnter(next)) return next->setFocus(Qt::TabFocusReason);
    }
    if (!enterPresses_ || !enterPresses_->isVisible() || !enterPresses_->isEnabled()) return;
    enterPresses_->setFocus(Qt::TabFocusReason);
    enterPresses_->click();
}

void Form::reject() {
    Unload();
}

void Form::closeEvent(QCloseEvent* event) {
    Unload();
    event->accept();
}

void Form::keyPressEvent(QKeyEvent* event) {
    if (event->key() != Qt::Key_Escape) return QDialog::keyPressEvent(event);
    if (!cancel_ || !cancel_->isVisible())
        close();
    else
        cancel_->click();
}

}  // namespace forms
