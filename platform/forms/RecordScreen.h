// SPDX-License-Identifier: MIT
#pragma once

#include "platform/forms/Bound.h"
#include "platform/forms/Controls.h"
#include "platform/forms/Form.h"

namespace forms {

/// A screen over one row, the current one of `Adodc1`: a new row that "&OK" completes and
/// "&Cancelar" abandons, or an existing one that is only looked at.
class RecordScreen : public Form {
    Q_OBJECT
public:
    /// What the screen is there for: nothing yet, a new row, or the read-only view of a stored one.
    enum class Mode { Unused, New, View };

    RecordScreen(const QString& name, const QString& caption);

    DataControl* Adodc1;
    Button* Command3;  ///< "&OK"; "&Sair" on an existing row
    Button* Command4;  ///< "&Cancelar"

    Mode mode() const { return mode_; }
    bool bShowing() const { return mode_ == Mode::View; }
    /// Takes a stored row for the view, which is shown later.
    void attach(const ado::RecordsetPtr& rows);
    /// Adds a new row to the row set and shows the screen on it, modeless.
    void showNew(const ado::RecordsetPtr& rows);
    /// A person has chosen something in another window that is now part of the new row; what is
    /// typed into the controls counts by itself.
    void noteChoice() { typed_ = true; }
    /// True while a person is at work on a new row.
    bool isUnderWay() const { return isVisible() && mode_ == Mode::New; }

protected:
    /// Sets the new row's defaults, once, a moment after the screen is up and bound.
    virtual void setDefaults() = 0;
    /// "&OK" on a new row.
    virtual void post() = 0;
    /// Turns the screen into the view of an existing row: no defaults, "&Sair" in place of both
    /// buttons.
    /// @param note  what is to be known of the row, for the heading band
    void showForReading(const QString& note);
    /// Locks all fields: what is typed cannot change the row any more.
    void lockFields();
    /// Whether a new row may be given up: asks when something was typed into it.
    bool mayGiveUp();
    void closeEvent(QCloseEvent* event) override;

private:
    void watchTyping();
    void Timer1_Timer();
    void Command3_Click();

    Timer* Timer1;
    Mode mode_ = Mode::Unused;
    bool typed_ = false;  ///< a person has typed or chosen something since the row was added
    bool watching_ = false;
};

/// Unloads the default instance of a record screen if it only shows a row: it holds nothing that a
/// person typed and makes room.
template <class Screen>
void closeView() {
    if (DefaultInstance<Screen>::isLoaded() && DefaultInstance<Screen>::get().bShowing())
        DefaultInstance<Screen>::unload();
}

}  // namespace forms
