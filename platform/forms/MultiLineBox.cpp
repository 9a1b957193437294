// SPDX-License-Identifier: MIT
#include "platform/forms/MultiLineBox.h"

#include "platform/core/Values.h"
#include "platform/forms/Look.h"

namespace forms {

MultiLineBox::MultiLineBox(const QString& name, QWidget* parent) : QPlainTextEdit(parent) {
    setObjectName(name);
    setTabChangesFocus(true);
    connect(this, &QPlainTextEdit::textChanged, this, [this] {
        if (showing_) return;
        setEdited(true);
        emit textEdited();
    });
}

void MultiLineBox::setLocked(bool locked) {
    setReadOnly(locked);
    QPalette colours;
    if (locked) colours.setColor(QPalette::Base, colours.color(QPalette::Window));
    setPalette(colours);
}

QSize MultiLineBox::sizeHint() const {
    return {QPlainTextEdit::sizeHint().width(), fontMetrics().lineSpacing() * 5 + 12};
}

bool MultiLineBox::take() {
    return !hasRow() || writeEntered([this] { writeRow(Text()); });
}

void MultiLineBox::showRow() {
    const QString text = core::toText(rowValue());
    if (text == Text()) return;
    showing_ = true;
    setPlainText(text);
    showing_ = false;
}

void MultiLineBox::focusInEvent(QFocusEvent* event) {
    QPlainTextEdit::focusInEvent(event);
    if (isReadOnly()) return;
    QPalette colours;
    colours.setColor(QPalette::Base, focusedGround(palette()));
    setPalette(colours);
}

void MultiLineBox::focusOutEvent(QFocusEvent* event) {
    QPlainTextEdit::focusOutEvent(event);
    if (!isAnotherWindows(event) && !isReadOnly()) setPalette(QPalette());
}

}  // namespace forms
