// SPDX-License-Identifier: MIT
#pragma once

#include <QComboBox>
#include <functional>

#include "platform/forms/TypedField.h"

class QStringListModel;

namespace forms {

/// A list from a row set: shows one column, stores another in the column it is bound to. A person
/// types a part of an entry, and leaving takes the first entry that it fits (matching()); Alt+Down
/// opens the list. An emptied text is no choice. A text that fits no entry stays and is refused
/// with a box. When the list's row set is opened again the combo takes the list anew and keeps what
/// was chosen.
class DataCombo : public QComboBox, public TypedField {
    Q_OBJECT
public:
    explicit DataCombo(const QString& name, QWidget* parent = nullptr);

    /// The rows may be closed still: the list comes when they are opened.
    void setList(const ado::RecordsetPtr& rows, const QString& listField,
                 const QString& boundColumn);

    QString Text() const { return currentText(); }
    /// The stored value of the entry shown; null when the text is no entry of the list.
    QVariant BoundText() const;
    /// Chooses the entry with that stored value and writes it to the row when bound. A value that
    /// is not in the list is written all the same and shown as no choice.
    void setBoundText(const QVariant& value);

    /// What is stored when a person wipes a choice; null without this.
    void setWipedValue(const QVariant& value) { wiped_ = value; }

    /// Locked: shown, but nobody can choose. Code still can.
    void setLocked(bool locked);

    /// Runs on receiving the focus and on a click into the list.
    std::function<void()> onGotFocus;
    /// Runs when the focus leaves, after the choice was written to the row.
    std::function<void()> onLostFocus;

    bool eventFilter(QObject* watched, QEvent* event) override;

protected:
    bool mayLeave() override;
    bool take() override;
    void showRow() override { choose(rowValue()); }
    void focusInEvent(QFocusEvent* event) override;
    void focusOutEvent(QFocusEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void wheelEvent(QWheelEvent* event) override;
    void showPopup() override;

private:
    void fill();
    void choose(const QVariant& value);
    void tint(bool focused);
    void offerMatches();
    bool settleTypedText();
    int entryFor(const QString& typed) const;
    QStringList entries() const;
    int listWidth() const;
    bool writeChoice();
    QStringListModel* offered_;  ///< the entries that fit what is being typed
    ado::RecordsetPtr list_;
    QString listField_;
    QString boundColumn_;
    QVariant chosen_;  ///< the stored value, also one that is not in the list
    QVariant wiped_;
    bool locked_ = false;
};

}  // namespace forms
