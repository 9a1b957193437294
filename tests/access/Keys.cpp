// SPDX-License-Identifier: MIT
#include <QAbstractButton>
#include <QApplication>
#include <QComboBox>
#include <QLineEdit>
#include <QListView>
#include <QMessageBox>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QShortcutEvent>
#include <QTableView>
#include <QTest>
#include <QTextEdit>

#include "platform/forms/Form.h"
#include "tests/access/Inspection.h"

using namespace Qt::StringLiterals;

namespace inspection {

namespace {

/// Takes what Alt and a letter would set off, and notes it.
class Letters : public QObject {
public:
    explicit Letters(QWidget* window) : window_(window) { qApp->installEventFilter(this); }

    /// The letters that more than one control of the window answers to.
    QStringList shared() {
        QStringList letters;
        for (int key = Qt::Key_A; key <= Qt::Key_Z; ++key) {
            isShared_ = false;
            QTest::keyClick(window_->windowHandle(), static_cast<Qt::Key>(key), Qt::AltModifier);
            if (isShared_) letters << QChar(key);
        }
        return letters;
    }

protected:
    bool eventFilter(QObject* watched, QEvent* event) override {
        if (event->type() == QEvent::Shortcut) {
            isShared_ = isShared_ || static_cast<QShortcutEvent*>(event)->isAmbiguous();
            return true;
        }
        const bool isKey = event->type() == QEvent::KeyPress || event->type() == QEvent::KeyRelease;
        return isKey && watched->isWidgetType();
    }

private:
    QWidget* window_;
    bool isShared_ = false;
};

/// Intentional: the arrow keys of the box above it go through this list.
constexpr QLatin1String MovedFromAbove("lstSocios");

/// Intentional: a year is closed, and prepared for it, by its own button alone.
const QStringList WithoutEnter{u"frmPrepararFecho"_s, u"frmFechoAno"_s};

bool takesInput(const QWidget* control) {
    // The arrow keys go from one option to the next.
    if (!control->isEnabled() || control->inherits("QRadioButton")) return false;
    if (control->objectName() == MovedFromAbove) return false;
    if (const auto* line = qobject_cast<const QLineEdit*>(control)) return !line->isReadOnly();
    return control->inherits("QAbstractButton") || control->inherits("QComboBox") ||
           control->inherits("QAbstractSpinBox") || control->inherits("QAbstractItemView") ||
           control->inherits("QPlainTextEdit") || control->inherits("QTextEdit");
}

bool hasKeyOfItsOwn(const QWidget* control) {
    const auto* button = qobject_cast<const QAbstractButton*>(control);
    return button && !button->shortcut().isEmpty();
}

/// Whether Tab stays inside the control.
bool keepsTab(const QWidget* control) {
    if (const auto* view = qobject_cast<const QAbstractItemView*>(control))
        return view->tabKeyNavigation();
    if (const auto* text = qobject_cast<const QPlainTextEdit*>(control))
        return !text->tabChangesFocus() && !text->isReadOnly();
    if (const auto* text = qobject_cast<const QTextEdit*>(control))
        return !text->tabChangesFocus() && !text->isReadOnly();
    return false;
}

bool isTypedInto(const QWidget* window) {
    const QList<QLineEdit*> lines = window->findChildren<QLineEdit*>();
    return std::any_of(lines.begin(), lines.end(), [](const QLineEdit* line) {
        return line->isVisible() && line->isEnabled() && !line->isReadOnly();
    });
}

bool isEnterExpected(const QWidget* window) {
    if (qobject_cast<const QMessageBox*>(window)) return true;
    // The boxes of a preview's bar take it themselves.
    return qobject_cast<const QDialog*>(window) && isTypedInto(window) &&
           !window->inherits("printing::Preview") && !WithoutEnter.contains(window->objectName());
}

bool enterDoesSomething(const QWidget* window) {
    if (const auto* form = qobject_cast<const forms::Form*>(window); form && form->enterGoesOn())
        return true;
    const QList<QPushButton*> buttons = window->findChildren<QPushButton*>();
    return std::any_of(buttons.begin(), buttons.end(), [](const QPushButton* button) {
        return button->isDefault() && button->isVisible();
    });
}

}  // namespace

QStringList withoutKeys(QWidget* window) {
    QStringList faults;
    for (const QWidget* control : controlsOf(window)) {
        const bool isStop = control->focusPolicy() & Qt::TabFocus;
        if (takesInput(control) && !isStop && !hasKeyOfItsOwn(control))
            faults << placeOf(control) + u"no key leads there"_s;
        if (isStop && keepsTab(control)) faults << placeOf(control) + u"Tab does not leave it"_s;
    }
    for (const QString& letter : Letters(window).shared())
        faults << placeOf(window) + u"two controls share Alt+%1"_s.arg(letter);
    const auto* box = qobject_cast<const QMessageBox*>(window);
    if (isEnterExpected(window) && !enterDoesSomething(window))
        faults << placeOf(window) + u"Enter does nothing"_s;
    // Forms close at Esc by themselves.
    if (box && box->buttons().size() > 1 && !box->escapeButton())
        faults << placeOf(window) + u"Esc does nothing"_s;
    return faults;
}

}  // namespace inspection
