// SPDX-License-Identifier: MIT
#pragma once

#include <QLineEdit>
#include <functional>

#include "platform/forms/TypedField.h"

namespace forms {

/// Colours that carry meaning: the menu's grey for nothing chosen, the window's for filled.
enum class BackColor { Menu, Window };

/// A line of text, bound or not.
///
/// A bound box shows its column's value in the display format, and the plain number while it has
/// the focus. Leaving it runs, in this order: the validation handler, which may refuse; then, if a
/// person has changed the text, the conversion to the column's type and the write to the column. A
/// text that the column does not take is refused with a box that says so, and the focus stays. So
/// does a handler that fails. An empty text is written as null to a column that is no text. A row
/// set that is open to read only takes no change: the box shows the row's value again. One that is
/// open to write keeps the change as pending, also where the rows of a view can never be updated.
///
/// In a box with a number format the decimal key of the numeric pad types the locale's mark. In one
/// with the date format the arrows go a day on and back, from today in an empty box. Blanks around
/// what was typed or pasted are cut off when a box with a format is left.
class TextBox : public QLineEdit, public TypedField {
    Q_OBJECT
public:
    explicit TextBox(const QString& name, QWidget* parent = nullptr);

    /// The text as it stands in the box.
    QString Text() const { return text(); }
    /// The value behind the text, with the digits that the display format does not show; of a text
    /// that somebody is typing, what it stands for. Fails with TypeMismatch when it is none.
    QVariant Value() const { return isEdited() ? convert(text()) : shown_; }
    /// Sets the text and, when bound, writes it to the row at once, as typing and leaving would.
    /// Fails with TypeMismatch when the column does not take it.
    void setText(const QString& text);
    /// Sets a typed value: shown in the display format, written to the row when bound.
    void setValue(const QVariant& value);
    void Clear() { setText(QString()); }

    /// A display format of core/Format.h. Number formats align right.
    void setFormat(QStringView format);
    /// An empty bound box stores null. By itself a box stores what it shows only when a person has
    /// changed it. Fails as writing to the column does.
    void storeNullIfEmpty();
    /// Cuts what is typed to the length of the bound column (Field::DefinedSize).
    void limitToColumn();
    /// Locked: shown and selectable, but nobody can type into it. Code still can.
    void setLocked(bool locked);
    /// Display only: locked, out of the tab order, and told apart by colour.
    void setDisplayOnly();
    void setBackColor(BackColor color);
    BackColor backColor() const { return backColor_; }
    /// Selects the whole text.
    void SelectAll() { selectAll(); }

    std::function<void()> onGotFocus;
    /// Sets `cancel` to keep the focus in the box. Runs at each leaving, changed or not.
    std::function<void(bool& cancel)> onValidate;

protected:
    /// The value that a typed text stands for. Fails with TypeMismatch and a text for the operator.
    virtual QVariant convert(const QString& text) const;
    bool mayLeave() override;
    bool take() override;
    void showRow() override { showValue(rowValue()); }
    void focusInEvent(QFocusEvent* event) override;
    void focusOutEvent(QFocusEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;
    void initStyleOption(QStyleOptionFrame* option) const override;

private:
    void showValue(const QVariant& value);
    bool isNumeric() const;
    bool isDate() const;
    void stepDay(int days);
    void cutBlanks();
    QString format_;
    QVariant shown_;              ///< the value behind the text, as long as nobody types
    bool keepSelection_ = false;  ///< the click that brought the focus leaves the selection alone
    BackColor backColor_ = BackColor::Window;
};

/// Colours several boxes alike.
void setBackColor(const std::initializer_list<TextBox*>& boxes, BackColor color);
/// Nothing is chosen any more: grey and empty.
void greyOut(const std::initializer_list<TextBox*>& boxes);

}  // namespace forms
