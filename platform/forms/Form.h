// SPDX-License-Identifier: MIT
#pragma once

#include <QDialog>
#include <QPointer>
#include <functional>

class QEventLoop;
class QLabel;

namespace forms {

class Button;

/// Runs an event handler; an empty one does nothing. A failure that nobody traps is shown in a box
/// with the critical icon, and the screen goes on as it was; the pending error is cleared when the
/// outermost handler ends. Handlers of controls run through it already; a slot connected to a plain
/// Qt signal calls it itself, because nothing thrown may reach Qt's event loop. Returns whether
/// the handler passed.
bool handle(const std::function<void()>& handler);
/// The same with a plain box, for handlers that report their failures themselves.
bool handlePlainly(const std::function<void()>& handler);

/// A screen. Its objectName is its name in the code; so is each control's.
///
/// Life: made hidden; Show or ShowModal; Hide keeps it loaded; Unload takes it away for good.
/// Closing the window unloads. The object of an unloaded screen goes when the outermost handler
/// and modal screen that may still use it have returned.
class Form : public QDialog {
    Q_OBJECT
public:
    Form(const QString& name, const QString& caption);
    ~Form() override;

    void Show();
    /// Returns when the screen has been hidden or unloaded. No other window takes input meanwhile.
    void ShowModal();
    void Hide();
    void Unload();
    bool isUnloaded() const { return unloaded_; }

    QString Caption() const { return windowTitle(); }
    void setCaption(const QString& caption) { setWindowTitle(caption); }

    /// Called once, when the screen is first shown, before it is painted.
    std::function<void()> onLoad;
    /// Called once, when the screen is unloaded, before it disappears.
    std::function<void()> onUnload;

    /// Esc presses this button; while it is hidden, or without one, Esc closes the window. No
    /// validation holds it.
    void setCancelButton(Button* button);
    /// The control that has the focus; null for none.
    QWidget* ActiveControl() const;

    void setVisible(bool visible) override;
    void reject() override;

protected:
    void closeEvent(QCloseEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;

private:
    bool unloaded_ = false;
    bool loaded_ = false;
    QPointer<Button> cancel_;
    QEventLoop* modalLoop_ = nullptr;
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

/// The band at the head of a screen: picture, title, one line of explanation. The labels get the
/// names given. It belongs at the top of a layout without margins.
QWidget* headingBand(const QString& title, const QString& explanation, const QString& titleName,
                     const QString& explanationName, const QString& pictureName);

/// A right-aligned label that is the buddy of its field; an "&" in the text is its accelerator.
QLabel* fieldLabel(const QString& text, QWidget* field, const QString& name = {});

}  // namespace forms
