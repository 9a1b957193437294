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

/// Runs work once all handlers and modal screens that are under way have returned and the windows
/// that come to the front by that have been asked to; for what is to come to the front in their
/// place. What fails in it is shown as a handler's failure is.
void afterwards(const std::function<void()>& work);

/// The turn of a handler: a screen runs one at a time. It is taken where a handler begins. As long
/// as it is held, also while the handler's box or a modal screen is open, other handlers of the
/// same owner do not get theirs and have to do nothing: five clicks that a program makes on "&OK"
/// must post once. Buttons take it for their screen by themselves.
///
///     const forms::Turn turn(this);
///     if (!turn) return;
class Turn {
public:
    /// @param owner  the screen or window; another one has turns of its own
    explicit Turn(const QObject* owner);
    ~Turn();
    Turn(const Turn&) = delete;
    Turn& operator=(const Turn&) = delete;
    explicit operator bool() const { return owner_ != nullptr; }

private:
    const QObject* owner_;  ///< null when another handler has the turn
};

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

    /// Enter in a field goes on to the next field, as Tab does, but passes buttons by, and from
    /// the last field it presses `last` (null: it stays there). It presses no default button.
    void letEnterGoOn(Button* last);
    bool enterGoesOn() const { return enterGoesOn_; }
    /// What Enter does in a field that lets go.
    void goOnFrom(QWidget* field);

    /// The control that a box of this screen speaks of, null for none: the focus is there once the
    /// box is closed.
    std::function<QWidget*(const QString& text)> onBoxClosed;
    /// Boxes of this screen do not cover that part of it.
    void keepInSight(QWidget* part) { inSight_ = part; }
    const QWidget* partInSight() const { return inSight_; }
    /// The screen that has been shown last, while it is still on its way to the front; null when
    /// it has arrived.
    static Form* comingForward();

    void setVisible(bool visible) override;
    void reject() override;

protected:
    void closeEvent(QCloseEvent* event) override;
    void changeEvent(QEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    /// Whether Enter stops at a control on its way: at fields that a person can type into.
    virtual bool stopsEnter(const QWidget* control) const;

private:
    bool unloaded_ = false;
    bool loaded_ = false;
    bool enterGoesOn_ = false;
    QPointer<Button> enterPresses_;
    QPointer<QWidget> inSight_;
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

/// The band at the head of a screen: picture, title, one line of explanation, and at the right a
/// note that is empty for now. The labels get the names given. It belongs at the top of a layout
/// without margins.
QWidget* headingBand(const QString& title, const QString& explanation, const QString& titleName,
                     const QString& explanationName, const QString& pictureName);

/// Writes the note on the band of a screen.
void setBandNote(const QWidget* screen, const QString& note);

/// A right-aligned label that is the buddy of its field. The letter behind an "&" is its
/// accelerator; the label's text is without the "&".
QLabel* fieldLabel(const QString& text, QWidget* field, const QString& name = {});
/// Gives such a label another text.
void setFieldLabel(QLabel* label, const QString& text);

}  // namespace forms
