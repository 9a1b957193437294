// SPDX-License-Identifier: MIT
#pragma once

#include <QComboBox>
#include <functional>

#include "platform/forms/Bound.h"
#include "platform/forms/Validation.h"

namespace forms {

/// A list from a row set: shows one column, stores another in the column it is bound to. A person
/// types the beginning (or, with the list open, any part) of an entry and Tab takes it; Alt+Down
/// opens the list; an emptied text is no choice. When the list's row set is opened again the combo
/// takes the list anew and keeps what was chosen.
class DataCombo : public QComboBox, public Bound, public Validating {
    Q_OBJECT
public:
    explicit DataCombo(const QString& name, QWidget* parent = nullptr);

    void setList(const ado::RecordsetPtr& rows, const QString& listField,
                 const QString& boundColumn);

    QString Text() const { return currentText(); }
    /// The stored value of the entry shown; null when the text is no entry of the list.
    QVariant BoundText() const;
    /// Chooses the entry with that stored value and writes it to the row when bound. A value that
    /// is not in the list is written all the same and shown as no choice.
    void setBoundText(const QVariant& value);

    void setLocked(bool locked);

    /// Runs on receiving the focus and on a click into the list.
    std::function<void()> onGotFocus;
    /// Runs when the focus leaves, after the choice was written to the row.
    std::function<void()> onLostFocus;

    bool leave() override;

protected:
    void refreshFromRow() override;
    void focusInEvent(QFocusEvent* event) override;
    void focusOutEvent(QFocusEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void wheelEvent(QWheelEvent* event) override;
    void showPopup() override;

private:
    void fill();
    void settleTypedText();
    ado::RecordsetPtr list_;
    QString listField_;
    QString boundColumn_;
    bool locked_ = false;
};

}  // namespace forms
