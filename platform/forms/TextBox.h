// SPDX-License-Identifier: MIT
#pragma once

#include <QLineEdit>
#include <functional>

#include "platform/forms/Bound.h"
#include "platform/forms/Validation.h"

namespace forms {

/// Colours that carry meaning: the menu's grey for nothing chosen, the window's for filled.
enum class BackColor { Menu, Window };

/// A line of text, bound or not.
///
/// A bound box shows its column's value in the display format, and the plain number while it has
/// the focus. Leaving it runs, in this order: the validation handler, which may refuse; then, if a
/// person has changed the text, the write to the column. A text that the column's type does not
/// take is refused with a box that says so, and the focus stays. An empty text is written as null
/// to a column that is no text.
///
/// In a box with a number format the decimal key of the numeric pad types the locale's mark.
class TextBox : public QLineEdit, public Bound, public Validating {
    Q_OBJECT
public:
    explicit TextBox(const QString& name, QWidget* parent = nullptr);

    /// The text as it stands in the box.
    QString Text() const { return text(); }
    /// Sets the text and, when bound, writes it to the row at once, as typing and leaving would.
    /// Fails with TypeMismatch when the column does not take it.
    void setText(const QString& text);
    /// Sets a typed value: shown in the display format, written to the row when bound.
    void setValue(const QVariant& value);
    void Clear() { setText(QString()); }

    /// A display format of core/Format.h.
    void setFormat(QStringView format);
    /// Locked: shown and selectable, but nobody can type into it. Code still can.
    void setLocked(bool locked);
    /// Display only: locked, out of the tab order, and told apart by colour.
    void setDisplayOnly();
    void setBackColor(BackColor color);
    BackColor backColor() const { return backColor_; }
    /// Selects the whole text.
    void SelectAll() { selectAll(); }

    std::function<void()> onGotFocus;
    /// Sets `cancel` to keep the focus in the box.
    std::function<void(bool& cancel)> onValidate;

    bool leave() override;

protected:
    void refreshFromRow() override;
    void focusInEvent(QFocusEvent* event) override;
    void focusOutEvent(QFocusEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;

private:
    QVariant convert(const QString& text) const;
    void showValue(const QVariant& value);
    QString format_;
    QVariant shown_;
    bool edited_ = false;
    BackColor backColor_ = BackColor::Window;
};

}  // namespace forms
