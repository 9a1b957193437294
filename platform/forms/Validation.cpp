// SPDX-License-Identifier: MIT
// The filter that holds the focus in a field. The press is caught on its way to the QWindow: by the
// time it reaches a widget the focus has moved. Accelerators and Enter press buttons without any
// change of focus, so they are caught as what they are.
#include "platform/forms/Validation.h"

#include <QAbstractButton>
#include <QApplication>
#include <QKeyEvent>
#include <QLabel>
#include <QPointer>
#include <QPushButton>
#include <QWindow>

#include "platform/forms/Controls.h"
#include "platform/forms/Form.h"

namespace forms {

namespace {

constexpr char PassesProperty[] = "passesValidation";

bool passes(const QWidget* widget) {
    return widget->property(PassesProperty).toBool();
}

bool isValidating(QWidget* widget) {
    return dynamic_cast<Validating*>(widget) != nullptr;
}

/// The control that a click on `target` would give the focus to or press; null for neither.
QWidget* receiverOf(QWidget* target) {
    for (QWidget* widget = target; widget; widget = widget->parentWidget()) {
        const bool takesClick = (widget->focusPolicy() & Qt::ClickFocus) == Qt::ClickFocus ||
                                qobject_cast<QAbstractButton*>(widget);
        if (widget->isEnabled() && takesClick) {
            while (widget->focusProxy()) widget = widget->focusProxy();
            return widget;
        }
        if (widget->isWindow()) break;
    }
    return nullptr;
}

QPushButton* defaultButtonOf(const QWidget* window) {
    for (QPushButton* button : window->findChildren<QPushButton*>())
        if (button->isDefault() && button->isVisible() && button->isEnabled()) return button;
    return nullptr;
}

QAbstractButton* disabledButtonOf(const QWidget* window, const QKeyEvent* key) {
    if (!(key->modifiers() & Qt::AltModifier)) return nullptr;
    const QKeySequence pressed(key->keyCombination());
    for (QAbstractButton* button : window->findChildren<QAbstractButton*>())
        if (button->isVisible() && !button->isEnabled() && button->shortcut() == pressed)
            return button;
    return nullptr;
}

class FocusKeeper : public QObject {
public:
    explicit FocusKeeper(QApplication* application) : QObject(application) {
        application->installEventFilter(this);
        connect(application, &QApplication::focusChanged, this, &FocusKeeper::focusMoved);
    }

protected:
    bool eventFilter(QObject* watched, QEvent* event) override {
        switch (event->type()) {
            case QEvent::MouseButtonPress:
                return watched->isWindowType() &&
                       holdsPress(static_cast<QWindow*>(watched), static_cast<QMouseEvent*>(event));
            case QEvent::MouseButtonDblClick:
                // The second half of a press that was swallowed.
                return watched->isWindowType() && swallowed_;
            case QEvent::Shortcut:
                return watched->isWidgetType() &&
                       holdsShortcut(static_cast<QWidget*>(watched),
                                     static_cast<QShortcutEvent*>(event));
            case QEvent::KeyPress:
                return watched->isWidgetType() &&
                       holdsKey(static_cast<QWidget*>(watched), static_cast<QKeyEvent*>(event));
            case QEvent::InputMethod:
                agreed_.clear();
                return false;
            default:
                return false;
        }
    }

private:
    /// The field of a window that has to be asked before the focus goes to `target`; null for none.
    QWidget* fieldBefore(const QWidget* target) const {
        QWidget* current = target->window()->focusWidget();
        if (current && !isValidating(current)) current = passes(current) ? owing_ : nullptr;
        if (!current || current->window() != target->window()) return nullptr;
        if (current == target || current->isAncestorOf(target) || passes(target)) return nullptr;
        return current;
    }

    /// Asks a field; a field whose question is still open lets everything wait.
    bool agrees(QWidget* field) {
        if (asking_.contains(field)) return false;
        asking_.append(field);
        const QPointer<QWidget> alive = field;
        bool agreed = false;
        {
            // While a box of the field is open, a program presses nothing on its screen.
            const Turn turn(field->window());
            agreed = dynamic_cast<Validating*>(field)->leave();
        }
        agreed_ = agreed ? alive : nullptr;
        if (!agreed && alive && !alive->hasFocus()) alive->setFocus(Qt::OtherFocusReason);
        asking_.removeOne(field);
        return agreed;
    }

    bool holdsPress(QWindow* window, const QMouseEvent* press) {
        swallowed_ = false;
        agreed_.clear();
        QWidget* top = QWidget::find(window->winId());
        if (!top || QApplication::activePopupWidget()) return false;
        QWidget* child = top->childAt(press->position().toPoint());
        const QPointer<QWidget> receiver = receiverOf(child ? child : top);
        QWidget* field = receiver ? fieldBefore(receiver) : nullptr;
        if (!field) return false;
        swallowed_ = !agrees(field);
        if (swallowed_ || (QGuiApplication::mouseButtons() & press->button())) return swallowed_;
        // The field showed a box: the mouse button went up long ago, elsewhere.
        swallowed_ = true;
        finishClick(receiver);
        return true;
    }

    static void finishClick(const QPointer<QWidget>& receiver) {
        if (!receiver || !receiver->isVisible() || !receiver->isEnabled()) return;
        if (receiver->focusPolicy() & Qt::ClickFocus) receiver->setFocus(Qt::MouseFocusReason);
        if (qobject_cast<QAbstractButton*>(receiver))
            QMetaObject::invokeMethod(receiver, "click", Qt::QueuedConnection);
    }

    bool holdsShortcut(QWidget* widget, const QShortcutEvent* shortcut) {
        agreed_.clear();
        const auto* label = qobject_cast<QLabel*>(widget);
        const QPointer<QWidget> target = label && label->buddy() ? label->buddy() : widget;
        QWidget* field = fieldBefore(target);
        if (field && !agrees(field)) return true;
        // A pressed accelerator takes the focus along, as a click does.
        if (target && target->isEnabled() && (target->focusPolicy() & Qt::TabFocus))
            target->setFocus(Qt::ShortcutFocusReason);
        auto* button = qobject_cast<QAbstractButton*>(target);
        if (!button || shortcut->isAmbiguous()) return false;
        // At once: by itself the button would stay pressed for a moment first, and what a quick
        // typist does next would come before the click.
        button->click();
        return true;
    }

    bool holdsKey(QWidget* widget, const QKeyEvent* key) {
        if (!widget->hasFocus() || !isValidating(widget)) return false;
        agreed_.clear();
        const bool plain = !(key->modifiers() & (Qt::ControlModifier | Qt::AltModifier));
        if (plain && (key->key() == Qt::Key_Tab || key->key() == Qt::Key_Backtab))
            return !agrees(widget);
        if (key->key() != Qt::Key_Return && key->key() != Qt::Key_Enter)
            return pressesWhatItEnables(widget, key) || typesByAccelerator(*key);
        if (dynamic_cast<Validating*>(widget)->takesEnter()) return false;
        auto* form = qobject_cast<Form*>(widget->window());
        if (form && form->enterGoesOn()) {
            // A key held down must not run through the whole screen.
            const QPointer<QWidget> alive = widget;
            if (!key->isAutoRepeat() && agrees(widget) && alive) form->goOnFrom(widget);
            return true;
        }
        const QPointer<QPushButton> button = defaultButtonOf(widget->window());
        if (!button || passes(button)) return false;
        if (!agrees(widget)) return true;
        if (button && button->isEnabled()) button->setFocus(Qt::TabFocusReason);
        return false;
    }

    /// An accelerator that belongs to nothing would type its letter into the field.
    static bool typesByAccelerator(const QKeyEvent& key) {
        return key.modifiers() == Qt::AltModifier && !key.text().isEmpty() &&
               key.text().front().isPrint();
    }

    /// The accelerator of a disabled button, which what stands in the field may enable: the field
    /// is left first, as with any other accelerator.
    bool pressesWhatItEnables(QWidget* field, const QKeyEvent* key) {
        const QPointer<QAbstractButton> button = disabledButtonOf(field->window(), key);
        if (!button) return false;
        if (!agrees(field) || !button || !button->isEnabled()) return true;
        button->setFocus(Qt::ShortcutFocusReason);
        button->click();
        return true;
    }

    /// The net under the filter: focus that code or a list's popup has moved.
    void focusMoved(QWidget* old, QWidget* now) {
        if (!old || !now || old->window() != now->window()) return;
        QWidget* field = isValidating(old) ? old : passes(old) ? owing_.data() : nullptr;
        owing_ = field && passes(now) ? field : nullptr;
        if (!field || field == now || owing_ || asking_.contains(field)) return;
        const bool agreedBefore = agreed_ == field;
        agreed_.clear();
        if (agreedBefore || !field->isVisible() || !field->isEnabled()) return;
        // The control that got the focus without leave is not asked before it loses it again.
        asking_.append(now);
        agrees(field);
        asking_.removeOne(now);
    }

    QList<QWidget*> asking_;    ///< fields whose leave() runs, the innermost last
    QPointer<QWidget> agreed_;  ///< agreed already to the event that is on its way
    QPointer<QWidget> owing_;   ///< left for a button that passes, not asked yet
    bool swallowed_ = false;
};

}  // namespace

Validating::~Validating() = default;

void passesValidation(Button* button) {
    button->setProperty(PassesProperty, true);
}

void keepFocus() {
    static QPointer<FocusKeeper> keeper;
    if (!keeper) keeper = new FocusKeeper(qApp);
}

bool isAnotherWindows(const QFocusEvent* event) {
    return event->reason() == Qt::ActiveWindowFocusReason ||
           event->reason() == Qt::PopupFocusReason || event->reason() == Qt::MenuBarFocusReason;
}

}  // namespace forms
