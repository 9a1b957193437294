// SPDX-License-Identifier: MIT
#pragma once

#include <QObject>
#include <QPointer>
#include <QString>
#include <QWidget>
#include <functional>
#include <optional>

#include "platform/core/MsgBox.h"

namespace support {

/// The person at the screen: finds controls by their names, types, clicks, leaves fields, answers
/// boxes. Everything goes through the screen's window, the way keys and clicks really come.
///
///     support::Operator person;
///     frmMovimentos::get().Show();
///     person.screen(u"frmMovimentos"_s);
///     person.expectBox({.text = u"Número de Empresa não encontrado!"_s});
///     person.fill(u"No_Kor"_s, u"999999"_s);              // click, type over, Tab
///     EXPECT_TRUE(person.find<forms::TextBox>(u"No_Kor"_s)->hasFocus());
///     person.accelerator(u'C');                           // "&Cancelar"
///
/// A modal screen runs inside the call that shows it, so what is to be done on it is said before:
///
///     person.onScreen(u"frmMovimentosF"_s, [&] { person.click(u"Option1"_s); person.enter(); });
///     person.accelerator(u'C');
///
/// A control or screen that is missing throws (the test fails there); a box that nobody expected,
/// a wrong text, and boxes or screens that never came fail the test without ending it.
class Operator : public QObject {
public:
    Operator();
    /// Fails the test when an expected box or an awaited screen did not come.
    ~Operator() override;

    // Boxes.

    struct Box {
        QString text = {};
        core::Answer answer = core::Answer::Ok;
        std::optional<core::Icon> icon = {};  ///< not looked at when missing
        QString title = {};                   ///< not looked at when empty
        bool partly = false;                  ///< `text` is a part of the box's text
    };
    /// The next box that appears has to be this one; it gets the answer by a click on its button.
    void expectBox(const Box& box) { expected_.append(box); }
    /// Fails the test when an expected box has not come yet.
    void expectNoBoxesLeft();
    /// How many expected boxes have not come yet.
    qsizetype boxesLeft() const { return expected_.size(); }

    // Screens. What follows below acts on the modal window if there is one, else on the screen
    // named last.

    /// Waits until a window of that name is shown and turns to it.
    QWidget* screen(const QString& name);
    /// Runs the steps, once, when a window of that name is next shown.
    void onScreen(const QString& name, const std::function<void()>& steps) {
        awaited_.append({name, steps});
    }
    bool isShown(const QString& name) const { return shownWindow(name) != nullptr; }
    /// The window that takes the keys.
    QWidget* here() const;

    // Controls of that window.

    /// A control that a person can use: visible and enabled.
    template <class Control = QWidget>
    Control* find(const QString& name) {
        auto* control = peek<Control>(name);
        if (!control->isVisible() || !control->isEnabled()) missing(name, "is hidden or disabled");
        return control;
    }
    /// A control in whatever state.
    template <class Control = QWidget>
    Control* peek(const QString& name) {
        auto* control = here()->findChild<Control*>(name);
        if (!control) missing(name, "is not on the screen");
        return control;
    }

    void click(const QString& name);
    /// Puts the text in the place of what the field holds and stays there.
    void put(const QString& name, const QString& text);
    /// The same, and leaves the field by Tab.
    void fill(const QString& name, const QString& text) { put(name, text), tab(); }

    // Keys, to the control that has the focus.

    void type(const QString& text);
    /// By the clipboard and Ctrl+V.
    void paste(const QString& text);
    void press(Qt::Key key, Qt::KeyboardModifiers modifiers = Qt::NoModifier);
    /// Alt and a letter; returns when the button is up again.
    void accelerator(QChar letter);
    void tab() { press(Qt::Key_Tab); }
    void enter() { press(Qt::Key_Return); }
    void escape() { press(Qt::Key_Escape); }

    /// Waits for a condition; fails the test with `what` when it does not come true.
    bool waitUntil(const std::function<bool()>& condition, const QString& what);
    /// Runs what is pending, animated buttons included.
    void settle();

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    struct Visit {
        QString name;
        std::function<void()> steps;
    };
    [[noreturn]] void missing(const QString& name, const char* how) const;
    static QWidget* shownWindow(const QString& name);
    void turnTo(QWidget* window);
    void clickOn(QWidget* control);
    void answer(const QPointer<QWidget>& shown);
    void visit(const QPointer<QWidget>& shown, const std::function<void()>& steps);

    QPointer<QWidget> current_;
    QList<Box> expected_;
    QList<Visit> awaited_;
};

}  // namespace support
