// SPDX-License-Identifier: MIT
#pragma once

#include <utility>

#include "platform/forms/Bound.h"
#include "platform/forms/Validation.h"

namespace forms {

/// A control that a person types into, bound or not.
///
/// What is typed is *edited* from its first key until it is taken or another row is shown; so long
/// no change of the row's value takes its place. The control is *entered* from the moment it gets
/// the focus until the focus goes to another control; another window, a list or a menu in between
/// is no leaving.
class TypedField : public Bound, public Validating {
public:
    bool leave() final {
        if (!mayLeave()) return false;
        if (edited_) edited_ = !take();
        return !edited_;
    }

protected:
    /// Asked at each leaving, edited or not; false keeps the focus.
    virtual bool mayLeave() { return true; }
    /// Takes what was typed: shows it and writes it to the row when bound. False, after a box that
    /// says why, keeps it as it stands.
    virtual bool take() = 0;
    virtual void showRow() = 0;

    void refreshFromRow() final {
        if (!edited_) showRow();
    }
    void rowReplaced() final {
        edited_ = false;
        showRow();
    }

    bool isEdited() const { return edited_; }
    void setEdited(bool edited) { edited_ = edited; }
    bool isEntered() const { return entered_; }
    /// To be told of each focus that comes; true when the control is entered by it.
    bool enters() { return !std::exchange(entered_, true); }
    /// To be told of each focus that goes; true when the control is left by it.
    bool leaves(const QFocusEvent* event) {
        return !isAnotherWindows(event) && std::exchange(entered_, false);
    }

private:
    bool edited_ = false;
    bool entered_ = false;
};

}  // namespace forms
