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
#include <map>
#include <stdexcept>

#include "platform/forms/Form.h"
#include "platform/forms/MsgBoxes.h"

using namespace Qt::StringLiterals;

namespace support {

namespace {

constexpr int Patience = 10'000;  // milliseconds; reached only when something is wrong

std::string plain(const QString& text) {
    return text.toStdString();
}

QMessageBox::StandardButton buttonOf(core::Answer answer) {
    if (answer == core::Answer::Ok) return QMessageBox::Ok;
    return answer == core::Answer::Yes ? QMessageBox::Yes : QMessageBox::No;
}

QMessageBox::Icon iconOf(core::Icon icon) {
    static const std::map<core::Icon, QMessageBox::Icon> icons{
        {core::Icon::None, QMessageBox::NoIcon},
        {core::Icon::Information, QMessageBox::Information},
        {core::Icon::Exclamation, QMessageBox::Warning},
        {core::Icon::Question, QMessageBox::Question},
        {core::Icon::Critical, QMessageBox::Critical}};
    return icons.at(icon);
}

QWidget* shownWindow(const QString& name) {
    for (QWidget* window : QApplication::topLevelWidgets())
        if (window->isVisible() && window->objectName() == name) return window;
    return nullptr;
}

void compare(const QMessageBox& box, const Operator::Box& expected) {
    const QString text = box.text();
    if (!expected.partly || !text.contains(expected.text)) {
        EXPECT_EQ(plain(text), plain(expected.text));
    }
    if (expected.icon) {
        EXPECT_EQ(box.icon(), iconOf(*expected.icon)) << "icon of: " << plain(text);
    }
    if (!expected.title.isEmpty()) {
        EXPECT_EQ(plain(box.windowTitle()), plain(expected.title)) << "title of: " << plain(text);
    }
}

bool anyButtonDown() {
    for (QWidget* widget : QApplication::allWidgets()) {
        const auto* button = qobject_cast<QAbstractButton*>(widget);
        if (button && button->isVisible() && button->isDown()) return true;
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
        ADD_FAILURE() << "the screen " << plain(visit.name) << " did not come";
}

void Operator::expectBox(const Box& box) {
    expected_.append(box);
}

void Operator::expectNoBoxesLeft() {
    for (const Box& box : expected_) ADD_FAILURE() << "no box said: " << plain(box.text);
    expected_.clear();
}

void Operator::missing(const QString& name, const char* how) const {
    throw std::runtime_error(plain(name) + " " + how);
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
    if (qobject_cast<forms::Form*>(shown) && shown->windowModality() == Qt::ApplicationModal) {
        ADD_FAILURE() << "nobody waits on the modal screen " << plain(shown->objectName());
        QTimer::singleShot(0, shown,
                           [shown] { static_cast<forms::Form*>(shown.data())->Unload(); });
    }
    return false;
}

void Operator::visit(const QPointer<QWidget>& shown, const std::function<void()>& steps) {
    if (!shown) return;
    const QPointer<QWidget> before = current_;
    try {
        turnTo(shown);
        steps();
    } catch (const std::exception& failure) {
        ADD_FAILURE() << "on " << plain(shown ? shown->objectName() : QString()) << ": "
                      << failure.what();
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
        ADD_FAILURE() << "unexpected box \"" << plain(box->windowTitle()) << "\": " << plain(text);
        expected.answer = box->button(QMessageBox::Ok) ? core::Answer::Ok : core::Answer::No;
    } else {
        expected = expected_.takeFirst();
        compare(*box, expected);
    }
    QAbstractButton* button = box->button(buttonOf(expected.answer));
    if (button) clickOn(button);
    if (!shown || !shown->isVisible()) return;
    ADD_FAILURE() << "the box cannot be answered as expected: " << plain(text);
    box->done(QMessageBox::No);
}

QWidget* Operator::screen(const QString& name) {
    if (!QTest::qWaitFor([&name] { return shownWindow(name) != nullptr; }, Patience))
        missing(name, "is not shown");
    turnTo(shownWindow(name));
    return current_;
}

/// On a real display a window takes keys only once the window manager has made it the active one.
void Operator::turnTo(QWidget* window) {
    current_ = window;
    const QWidget* modal = QApplication::activeModalWidget();
    if (modal && modal != window) return;
    window->activateWindow();
    const auto isActive = [this] { return !current_ || current_->isActiveWindow(); };
    EXPECT_TRUE(QTest::qWaitFor(isActive, Patience))
        << "not active: " << plain(window->objectName());
}

void Operator::onScreen(const QString& name, const std::function<void()>& steps) {
    awaited_.append({name, steps});
}

bool Operator::isShown(const QString& name) const {
    return shownWindow(name) != nullptr;
}

QWidget* Operator::here() const {
    QWidget* modal = QApplication::activeModalWidget();
    if (modal && !qobject_cast<QMessageBox*>(modal)) return modal;
    if (current_ && current_->isVisible()) return current_;
    if (QApplication::activeWindow()) return QApplication::activeWindow();
    throw std::runtime_error("no window is shown");
}

QWindow* Operator::keyWindow() const {
    if (QWidget* popup = QApplication::activePopupWidget()) return popup->windowHandle();
    return here()->windowHandle();
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

void Operator::doubleClick(const QString& name) {
    auto* control = find(name);
    QTest::mouseDClick(control->window()->windowHandle(), Qt::LeftButton, Qt::NoModifier,
                       control->mapTo(control->window(), control->rect().center()));
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

void Operator::fill(const QString& name, const QString& text) {
    put(name, text);
    tab();
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
    QTest::keyClick(keyWindow(), key, modifiers);
    settle();
}

void Operator::accelerator(QChar letter) {
    press(static_cast<Qt::Key>(letter.toUpper().unicode()), Qt::AltModifier);
}

bool Operator::waitUntil(const std::function<bool()>& condition, const QString& what) {
    const bool came = QTest::qWaitFor(condition, Patience);
    EXPECT_TRUE(came) << "in vain: " << plain(what);
    return came;
}

void Operator::settle() {
    QCoreApplication::processEvents();
    EXPECT_TRUE(QTest::qWaitFor([] { return !anyButtonDown(); }, Patience));
    QCoreApplication::processEvents();
}

}  // namespace support
