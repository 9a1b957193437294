// SPDX-License-Identifier: MIT
#pragma once

#include <QDialog>
#include <QPointer>
#include <functional>

class QLabel;
class QVBoxLayout;

namespace forms {

class Button;

/// Runs an event handler. A failure that nobody traps is shown in a box with the critical icon, and
/// the screen goes on as it was; the pending error is cleared when the outermost handler ends.
void handle(const std::function<void()>& handler);

/// A screen. Its objectName is its name in the code; so is each control's.
///
/// Life: made hidden; Show or ShowModal; Hide keeps it loaded; Unload takes it away for good (the
/// object goes once the event that unloads it is over). Closing the window unloads.
class Form : public QDialog {
    Q_OBJECT
public:
    Form(const QString& name, const QString& caption);
    ~Form() override;

    void Show();
    /// Returns when the screen has been hidden or unloaded.
    void ShowModal();
    void Hide();
    void Unload();
    bool isUnloaded() const { return unloaded_; }

    QString Caption() const { return windowTitle(); }
    void setCaption(const QString& caption) { setWindowTitle(caption); }

    /// Called once, when the screen is first shown, before it is painted.
    std::function<void()> onLoad;
    /// Called when the screen is unloaded.
    std::function<void()> onUnload;

    /// Esc presses this button; without one Esc closes the window.
    void setCancelButton(Button* button);
    /// The control that has the focus; null for none.
    QWidget* ActiveControl() const;

protected:
    void closeEvent(QCloseEvent* event) override;
    void showEvent(QShowEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;

private:
    void finishUnload();
    bool unloaded_ = false;
    bool loaded_ = false;
    QPointer<Button> cancel_;
};

/// The one default instance of a screen class: made at first use, afresh after it was unloaded.
template <class Screen>
class DefaultInstance {
public:
    static Screen& get() {
        if (!isLoaded()) instance() = new Screen;
        return *instance();
    }
    /// True while there is an instance that was not unloaded.
    static bool isLoaded() { return instance() && !instance()->isUnloaded(); }
    /// Unloads the instance if there is one.
    static void unload() {
        if (isLoaded()) instance()->Unload();
    }

private:
    static QPointer<Screen>& instance() {
        static QPointer<Screen> only;
        return only;
    }
};

/// The band at the head of a screen: picture, title, one line of explanation. The frames and labels
/// get the names given.
QWidget* headingBand(const QString& title, const QString& explanation, const QString& titleName,
                     const QString& explanationName, const QString& pictureName);

/// A right-aligned label that is the buddy of its field; an "&" in the text is its accelerator.
QLabel* fieldLabel(const QString& text, QWidget* field, const QString& name = {});

}  // namespace forms
