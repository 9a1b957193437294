// SPDX-License-Identifier: MIT
#pragma once

#include <QPlainTextEdit>

#include "platform/forms/TypedField.h"

namespace forms {

/// Several lines of plain text, bound to a text column or not. Enter begins a new line, Tab goes on
/// to the next control. A bound box writes what a person has typed when it is left, as a TextBox
/// does.
class MultiLineBox : public QPlainTextEdit, public TypedField {
    Q_OBJECT
public:
    explicit MultiLineBox(const QString& name, QWidget* parent = nullptr);

    /// The lines, parted by "\n".
    QString Text() const { return toPlainText(); }
    /// Locked: shown and selectable, but nobody can type into it.
    void setLocked(bool locked);

    /// Five lines high.
    QSize sizeHint() const override;
    bool takesEnter() const override { return true; }

signals:
    /// A person has changed the text.
    void textEdited();

protected:
    bool take() override;
    void showRow() override;
    void focusInEvent(QFocusEvent* event) override;
    void focusOutEvent(QFocusEvent* event) override;

private:
    bool showing_ = false;  ///< code is changing the text
};

}  // namespace forms
