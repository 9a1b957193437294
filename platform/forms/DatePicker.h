// SPDX-License-Identifier: MIT
#pragma once

#include "platform/forms/TextBox.h"

namespace forms {

/// A date that is typed or picked from a calendar (the button in the field, or Alt+Down), and can
/// be emptied. A text that is no date is refused with a box, and the focus stays.
class DatePicker : public TextBox {
    Q_OBJECT
public:
    explicit DatePicker(const QString& name, QWidget* parent = nullptr);
    /// The first instant of the day; null when the field is empty or holds no date.
    QVariant Value() const;

protected:
    QVariant convert(const QString& text) const override;
    void keyPressEvent(QKeyEvent* event) override;
    void changeEvent(QEvent* event) override;

private:
    void openCalendar();
    QAction* open_ = nullptr;
};

}  // namespace forms
