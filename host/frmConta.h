// SPDX-License-Identifier: MIT
#pragma once

#include "host/MemberAccount.h"
#include "host/RemainderList.h"
#include "platform/forms/Controls.h"
#include "platform/forms/Form.h"

class QComboBox;
class QGridLayout;

namespace host {

class TextTable;

/// A member at a glance: who he is, his account, his last movements, and what the ceilings of the
/// plan leave him and his family. It only shows.
class frmConta : public forms::Form {
    Q_OBJECT
public:
    frmConta(const BookSettings& settings, qint32 socio_id);

    /// Enter or a double click on a movement.
    std::function<void(qint32 movimento_id, const QString& tipo)> onMovement;

private:
    void layOut();
    QWidget* memberFrame();
    QWidget* movementsFrame();
    QWidget* remaindersFrame();
    void showRemainders();
    void Command1_Click();
    PersonRemainders remaindersOf(const MemberAccount::Person& person) const;

    const MemberAccount account_;
    TextTable* Grid1;   ///< movements
    TextTable* Grid2;   ///< what is left
    QComboBox* Combo1;  ///< whose
    forms::Button* Command1;
    forms::Button* Command2;
};

}  // namespace host
