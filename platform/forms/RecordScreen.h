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
    RecordScreen(const QString& name, const QString& caption);

    DataControl* Adodc1;
    bool bShowing = false;  ///< an existing row, read-only
    Button* Command3;       ///< "&OK"; "&Sair" on an existing row
    Button* Command4;       ///< "&Cancelar"

    /// Adds a new row to the row set and shows the screen on it, modeless.
    void showNew(const ado::RecordsetPtr& rows);
    /// True while a person is at work on a new row.
    bool isUnderWay() const { return isVisible() && !bShowing; }

protected:
    /// Sets the new row's defaults, once, a moment after the screen is up and bound.
    virtual void setDefaults() = 0;
    /// "&OK" on a new row.
    virtual void post() = 0;
    /// Turns the screen into the view of an existing row: no defaults, "&Sair" in place of both
    /// buttons.
    void showForReading();
    /// Locks all fields: what is typed cannot change the row any more.
    void lockFields();

private:
    void Timer1_Timer();
    void Command3_Click();

    Timer* Timer1;
};

/// Unloads the default instance of a record screen if it only shows a row: it holds nothing that a
/// person typed and makes room.
template <class Screen>
void closeView() {
    if (DefaultInstance<Screen>::isLoaded() && DefaultInstance<Screen>::get().bShowing)
        DefaultInstance<Screen>::unload();
}

}  // namespace forms
