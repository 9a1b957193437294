// SPDX-License-Identifier: MIT
#include "platform/forms/TextBox.h"

#include <QFocusEvent>
#include <QKeyEvent>
#include <QStyleOptionFrame>

#include "platform/core/Clock.h"
#include "platform/core/Format.h"
#include "platform/core/Values.h"
#include "platform/forms/Fields.h"
#include "platform/forms/Form.h"
#include "platform/forms/Look.h"
#include "platform/forms/TypedText.h"

namespace forms {

namespace {

/// Half of an amount or a date says something else: however narrow the screen, these are whole.
constexpr QStringView DateWidth = u"00-00-0000";
constexpr QStringView AmountWidth = u"€ 9.999,99";

}  // namespace

TextBox::TextBox(const QString& name, QWidget* parent) : QLineEdit(parent) {
    setObjectName(name);
    connect(this, &QLineEdit::textEdited, this, [this] { setEdited(true); });
}

void TextBox::setText(const QString& text) {
    setEdited(false);
    if (hasRow())
        setValue(convert(text));
    else
        showValue(text.isEmpty() ? QVariant() : QVariant(text));
}

void TextBox::setValue(const QVariant& value) {
    setEdited(false);
    if (hasRow()) writeRow(value);
    showValue(hasRow() ? rowValue() : value);
}

void TextBox::setFormat(QStringView format) {
    format_ = format.toString();
    setAlignment((isNumeric() ? Qt::AlignRight : Qt::AlignLeft) | Qt::AlignVCenter);
    if (isNumeric() || isDate())
        setMinimumWidth(widthFor(this, isDate() ? DateWidth : AmountWidth));
    if (!isEdited()) showValue(shown_);
}

bool TextBox::isNumeric() const {
    return format_ == core::format::Money || format_ == core::format::Amount ||
           format_ == core::format::Rate || format_ == core::format::Fraction;
}

bool TextBox::isDate() const {
    return format_ == core::format::Date;
}

void TextBox::limitToColumn() {
    if (!hasRow()) return;
    const int size = DataSource()->Recordset()->Fields(DataField()).DefinedSize();
    if (size <= 0 || size == maxLength()) return;
    // The toolkit puts the caret at the end whenever a length is set.
    const int caret = cursorPosition();
    setMaxLength(size);
    setCursorPosition(caret);
}

void TextBox::storeNullIfEmpty() {
    if (hasRow() && text().isEmpty()) writeRow({});
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
    setEdited(false);
    const QString text = core::formatted(value, isEntered() ? QStringView() : QStringView(format_));
    if (text != QLineEdit::text()) QLineEdit::setText(text);
}

/// Pasted blanks are no part of a number, a date or a name's number.
void TextBox::cutBlanks() {
    const QString text = QLineEdit::text().trimmed();
    if (isEdited() && !format_.isEmpty() && text != QLineEdit::text()) QLineEdit::setText(text);
}

bool TextBox::mayLeave() {
    cutBlanks();
    bool cancel = false;
    if (onValidate && !handle([this, &cancel] { onValidate(cancel); })) return false;
    return !cancel;
}

bool TextBox::take() {
    return writeEntered([this] { setValue(convert(QLineEdit::text())); });
}

void TextBox::focusInEvent(QFocusEvent* event) {
    const bool entering = enters();
    if (entering && !isEdited()) showValue(shown_);
    QLineEdit::focusInEvent(event);
    if (entering && !isAnotherWindows(event))
        keepSelection_ = event->reason() == Qt::MouseFocusReason;
    if (entering) handle(onGotFocus);
}

void TextBox::focusOutEvent(QFocusEvent* event) {
    QLineEdit::focusOutEvent(event);
    if (!leaves(event)) return;
    keepSelection_ = false;
    if (!isEdited()) showValue(shown_);
}

void TextBox::keyPressEvent(QKeyEvent* event) {
    const bool mark = event->key() == Qt::Key_Period || event->key() == Qt::Key_Comma;
    if (mark && (event->modifiers() & Qt::KeypadModifier) && isNumeric() && !isReadOnly()) {
        insert(core::decimalMark());
        setEdited(true);
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
    setEdited(true);
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
