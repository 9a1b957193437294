// SPDX-License-Identifier: MIT
#pragma once

class QFocusEvent;

namespace forms {

/// A control that is asked before the focus leaves it.
///
/// One filter for the whole application asks it before a click elsewhere in the window, an
/// accelerator of another control, Tab, or Enter on a default button takes effect; a refusal
/// swallows the event that caused it. Focus that goes to another window (a message box, another
/// program) is no leaving. Esc, a button given to passesValidation() and the closing of the
/// window pass: a person can always give up.
class Validating {
public:
    Validating() = default;
    Validating(const Validating&) = delete;
    Validating& operator=(const Validating&) = delete;
    virtual ~Validating();
    /// Runs the validation and writes what was typed; false keeps the focus.
    virtual bool leave() = 0;
    /// True when Enter belongs to the control itself and presses no default button.
    virtual bool takesEnter() const { return false; }
};

class Button;
/// The button's click never waits for a validation ("&Cancelar"). The field that it passed by is
/// asked when the focus goes on from the button to another control.
void passesValidation(Button* button);

/// Starts the filter of the application; install() does it.
void keepFocus();

/// True for the focus that goes to, or comes back from, another window, a list or a menu: that is
/// no leaving.
bool isAnotherWindows(const QFocusEvent* event);

}  // namespace forms
