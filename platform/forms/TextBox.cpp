// SPDX-License-Identifier: MIT
#include "platform/forms/TextBox.h"

#include <QFocusEvent>
#include <QKeyEvent>
#include <QStyleOptionFrame>

#include "platform/core/Clock.h"
#include "platform/core/Format.h"
#include "platform/core/Values.h"
#include "platform/forms/Form.h"
#include "platform/forms/Look.h"
#include "platform/forms/TypedText.h"

namespace forms {

TextBox::TextBox(const QString& name, QWidget* parent) : QLineEdit(parent) {
    setObjectName(name);
    connect(this, &QLineEdit::textEdited, this, [this] { edited_ = true; });
}

void TextBox::setText(const QString& text) {
    edited_ = false;
    if (hasRow())
        setValue(convert(text));
    else
        showValue(text.isEmpty() ? QVariant() : QVariant(text));
}

void TextBox::setValue(const QVariant& value) {
    edited_ = false;
    if (hasRow()) writeRow(value);
    showValue(hasRow() ? rowValue() : value);
}

void TextBox::setFormat(QStringView format) {
    format_ = format.toString();
    setAlignment((isNumeric() ? Qt::AlignRight : Qt::AlignLeft) | Qt::AlignVCenter);
    if (!edited_) showValue(shown_);
}

bool TextBox::isNumeric() const {
    return format_ == core::format::Money || format_ == core::format::Amount ||
           format_ == core::format::Rate;
}

bool TextBox::isDate() const {
    return format_ == core::format::Date;
}

void TextBox::limitToColumn() {
    if (!hasRow()) return;
    const int size = DataSource()->Recordset()->Fields(DataField()).DefinedSize();
    if (size > 0) setMaxLength(size);
}

void TextBox::setLocked(bool locked) {
    setReadOnly(locked);
}

void TextBox::setDisplayOnly() {
    setLocked(true);
    setFocusPolicy(Qt::ClickFocus);
    setBackColor(BackColor::Menu);
}

void TextBox::setBackColor(BackColor color) {
    backColor_ = color;
    update();
}

void TextBox::initStyleOption(QStyleOptionFrame* option) const {
    QLineEdit::initStyleOption(option);
    if (backColor_ == BackColor::Menu)
        option->palette.setColor(QPalette::Base, option->palette.color(QPalette::Window));
    else if (hasFocus() && !isReadOnly())
        option->palette.setColor(QPalette::Base, focusedGround(option->palette));
}

QVariant TextBox::convert(const QString& text) const {
    if (hasRow()) return fromTypedText(text, DataSource()->Recordset()->Fields(DataField()).Type());
    if (text.isEmpty()) return {};
    if (isDate()) return fromTypedDate(text);
    const std::optional<double> number =
        isNumeric() ? core::parseNumber(text) : std::optional<double>();
    return number ? QVariant(*number) : QVariant(text);
}

void TextBox::showValue(const QVariant& value) {
    shown_ = value;
    edited_ = false;
    const QString text = core::formatted(value, entered_ ? QStringView() : QStringView(format_));
    if (text != QLineEdit::text()) QLineEdit::setText(text);
}

void TextBox::refreshFromRow() {
    if (!edited_) showValue(rowValue());
}

void TextBox::rowReplaced() {
    showValue(rowValue());
}

/// Pasted blanks are no part of a number, a date or a name's number.
void TextBox::cutBlanks() {
    const QString text = QLineEdit::text().trimmed();
    if (edited_ && !format_.isEmpty() && text != QLineEdit::text()) QLineEdit::setText(text);
}

bool TextBox::leave() {
    cutBlanks();
    bool cancel = false;
    if (onValidate && !handle([this, &cancel] { onValidate(cancel); })) return false;
    if (cancel) return false;
    if (!edited_) return true;
    if (writeEntered([this] { setValue(convert(QLineEdit::text())); })) return true;
    edited_ = true;
    return false;
}

void TextBox::focusInEvent(QFocusEvent* event) {
    const bool entering = !entered_;
    entered_ = true;
    if (entering && !edited_) showValue(shown_);
    QLineEdit::focusInEvent(event);
    if (entering && !isAnotherWindows(event))
        keepSelection_ = event->reason() == Qt::MouseFocusReason;
    if (entering) handle(onGotFocus);
}

void TextBox::focusOutEvent(QFocusEvent* event) {
    QLineEdit::focusOutEvent(event);
    if (isAnotherWindows(event)) return;
    entered_ = false;
    keepSelection_ = false;
    if (!edited_) showValue(shown_);
}

void TextBox::keyPressEvent(QKeyEvent* event) {
    const bool mark = event->key() == Qt::Key_Period || event->key() == Qt::Key_Comma;
    if (mark && (event->modifiers() & Qt::KeypadModifier) && isNumeric() && !isReadOnly()) {
        insert(core::decimalMark());
        edited_ = true;
        return;
    }
    const auto modifiers = event->modifiers() & ~Qt::KeypadModifier;
    const bool arrow = event->key() == Qt::Key_Up || event->key() == Qt::Key_Down;
    if (arrow && modifiers == Qt::NoModifier && isDate() && !isReadOnly())
        return stepDay(event->key() == Qt::Key_Up ? 1 : -1);
    QLineEdit::keyPressEvent(event);
}

void TextBox::stepDay(int days) {
    const std::optional<QDate> day = core::parseDate(text());
    if (!day && !text().trimmed().isEmpty()) return;
    const QDate next = day ? day->addDays(days) : core::today();
    QLineEdit::setText(core::formatted(next, core::format::Date));
    selectAll();
    // As if it had been typed.
    edited_ = true;
    emit textEdited(text());
}

void TextBox::mousePressEvent(QMouseEvent* event) {
    const bool keep = keepSelection_ && hasSelectedText();
    keepSelection_ = false;
    QLineEdit::mousePressEvent(event);
    if (keep) selectAll();
}

void setBackColor(const std::initializer_list<TextBox*>& boxes, BackColor color) {
    for (TextBox* box : boxes) box->setBackColor(color);
}

void greyOut(const std::initializer_list<TextBox*>& boxes) {
    setBackColor(boxes, BackColor::Menu);
    for (TextBox* box : boxes) box->Clear();
}

}  // namespace forms
