// SPDX-License-Identifier: MIT
#include "tests/support/Operator.h"

#include <gtest/gtest.h>

#include <QAbstractButton>
#include <QApplication>
#include <QClipboard>
#include <QMessageBox>
#include <QTest>
#include <QTimer>
#include <QWindow>
#include <stdexcept>

#include "platform/forms/Form.h"
#include "platform/forms/MsgBoxes.h"

using namespace Qt::StringLiterals;

namespace support {

namespace {

constexpr int Patience = 10'000;  // milliseconds; reached only when something is wrong

QMessageBox::StandardButton buttonOf(core::Answer answer) {
    if (answer == core::Answer::Ok) return QMessageBox::Ok;
    return answer == core::Answer::Yes ? QMessageBox::Yes : QMessageBox::No;
}

/// In the order of core::Icon.
constexpr QMessageBox::Icon Icons[] = {QMessageBox::NoIcon, QMessageBox::Information,
                                       QMessageBox::Warning, QMessageBox::Question,
                                       QMessageBox::Critical};

void compare(const QMessageBox& box, const Operator::Box& expected) {
    const QString text = box.text();
    if (!expected.partly || !text.contains(expected.text)) {
        EXPECT_EQ(text.toStdString(), expected.text.toStdString());
    }
    if (expected.icon) {
        EXPECT_EQ(box.icon(), Icons[static_cast<int>(*expected.icon)])
            << "icon of: " << text.toStdString();
    }
    if (!expected.title.isEmpty()) {
        EXPECT_EQ(box.windowTitle().toStdString(), expected.title.toStdString())
            << "title of: " << text.toStdString();
    }
}

/// Tool buttons do not count: those of the file dialog stay down to show a choice.
bool anyButtonDown() {
    for (QWidget* widget : QApplication::allWidgets()) {
        const auto* button = qobject_cast<QAbstractButton*>(widget);
        const bool isTool = widget->inherits("QToolButton");
        if (button && !isTool && button->isVisible() && button->isDown()) return true;
    }
    return false;
}

}  // namespace

Operator::Operator() {
    forms::install();
    qApp->installEventFilter(this);
}

Operator::~Operator() {
    expectNoBoxesLeft();
    for (const Visit& visit : awaited_)
        ADD_FAILURE() << "the screen " << visit.name.toStdString() << " did not come";
}

void Operator::expectNoBoxesLeft() {
    for (const Box& box : expected_) ADD_FAILURE() << "no box said: " << box.text.toStdString();
    expected_.clear();
}

void Operator::missing(const QString& name, const char* how) const {
    throw std::runtime_error(name.toStdString() + " " + how);
}

bool Operator::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() != QEvent::Show || !watched->isWidgetType()) return false;
    const QPointer<QWidget> shown = static_cast<QWidget*>(watched);
    if (!shown->isWindow()) return false;
    if (qobject_cast<QMessageBox*>(shown)) {
        QTimer::singleShot(0, this, [this, shown] { answer(shown); });
        return false;
    }
    for (qsizetype at = 0; at < awaited_.size(); ++at) {
        if (awaited_[at].name != shown->objectName()) continue;
        const Visit next = awaited_.takeAt(at);
        QTimer::singleShot(0, this, [this, shown, next] { visit(shown, next.steps); });
        return false;
    }
    return false;
}

void Operator::visit(const QPointer<QWidget>& shown, const std::function<void()>& steps) {
    if (!shown) return;
    const QString name = shown->objectName();
    const QPointer<QWidget> before = current_;
    try {
        turnTo(shown);
        steps();
    } catch (const std::exception& failure) {
        ADD_FAILURE() << "on " << name.toStdString() << ": " << failure.what();
        if (auto* form = qobject_cast<forms::Form*>(shown)) form->Unload();
    }
    if (before && before->isVisible()) current_ = before;
}

void Operator::answer(const QPointer<QWidget>& shown) {
    auto* box = qobject_cast<QMessageBox*>(shown);
    if (!box || !box->isVisible()) return;
    const QString text = box->text();
    Box expected;
    if (expected_.isEmpty()) {
        ADD_FAILURE() << "unexpected box \"" << box->windowTitle().toStdString()
                      << "\": " << text.toStdString();
        expected.answer = box->button(QMessageBox::Ok) ? core::Answer::Ok : core::Answer::No;
    } else {
        expected = expected_.takeFirst();
        compare(*box, expected);
    }
    QAbstractButton* button = box->button(buttonOf(expected.answer));
    if (button) clickOn(button);
    if (!shown || !shown->isVisible()) return;
    ADD_FAILURE() << "the box cannot be answered as expected: " << text.toStdString();
    box->done(QMessageBox::No);
}

QWidget* Operator::shownWindow(const QString& name) {
    for (QWidget* window : QApplication::topLevelWidgets())
        if (window->isVisible() && window->objectName() == name) return window;
    return nullptr;
}

QWidget* Operator::screen(const QString& name) {
    if (!QTest::qWaitFor([&] { return isShown(name); }, Patience)) missing(name, "is not shown");
    turnTo(shownWindow(name));
    return current_;
}

/// On a real display a window takes keys only once the window manager has made it the active one.
void Operator::turnTo(QWidget* window) {
    current_ = window;
    window->activateWindow();
    const auto isActive = [this] { return !current_ || current_->isActiveWindow(); };
    EXPECT_TRUE(QTest::qWaitFor(isActive, Patience))
        << "not active: " << window->objectName().toStdString();
}

QWidget* Operator::here() const {
    QWidget* modal = QApplication::activeModalWidget();
    if (modal && !qobject_cast<QMessageBox*>(modal)) return modal;
    if (current_ && current_->isVisible()) return current_;
    throw std::runtime_error("no window is shown");
}

void Operator::clickOn(QWidget* control) {
    QWidget* window = control->window();
    QTest::mouseClick(window->windowHandle(), Qt::LeftButton, Qt::NoModifier,
                      control->mapTo(window, control->rect().center()));
}

void Operator::click(const QString& name) {
    clickOn(find(name));
    settle();
}

void Operator::put(const QString& name, const QString& text) {
    auto* field = find(name);
    if (!field->hasFocus()) clickOn(field);
    if (!QTest::qWaitFor([field] { return field->hasFocus(); }, Patience / 10))
        missing(name, "does not get the focus");
    press(Qt::Key_A, Qt::ControlModifier);
    press(Qt::Key_Delete);
    type(text);
}

void Operator::type(const QString& text) {
    for (qsizetype at = 0; at < text.size(); ++at) {
        const QChar c = text[at];
        const bool pair = c.isHighSurrogate() && at + 1 < text.size();
        const Qt::Key key = c.unicode() > 0x20 && c.unicode() < 0x7f
                                ? QTest::asciiToKey(c.toLatin1())
                            : c == u' ' ? Qt::Key_Space
                                        : Qt::Key_unknown;
        QTest::sendKeyEvent(QTest::Click, here()->windowHandle(), key, text.mid(at, pair ? 2 : 1),
                            Qt::NoModifier);
        if (pair) ++at;
    }
}

void Operator::paste(const QString& text) {
    QApplication::clipboard()->setText(text);
    press(Qt::Key_V, Qt::ControlModifier);
}

void Operator::press(Qt::Key key, Qt::KeyboardModifiers modifiers) {
    QTest::keyClick(here()->windowHandle(), key, modifiers);
    settle();
}

void Operator::accelerator(QChar letter) {
    press(static_cast<Qt::Key>(letter.toUpper().unicode()), Qt::AltModifier);
}

bool Operator::waitUntil(const std::function<bool()>& condition, const QString& what) {
    const bool came = QTest::qWaitFor(condition, Patience);
    EXPECT_TRUE(came) << "in vain: " << what.toStdString();
    return came;
}

void Operator::settle() {
    QCoreApplication::processEvents();
    EXPECT_TRUE(QTest::qWaitFor([] { return !anyButtonDown(); }, Patience));
    QCoreApplication::processEvents();
}

}  // namespace support
