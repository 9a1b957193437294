// SPDX-License-Identifier: MIT
#pragma once

#include "coverage/Explanation.h"
#include "platform/forms/Controls.h"
#include "platform/forms/Form.h"

class QTableWidget;

namespace entry {

/// Why a try-out came to its amounts: a list to be read, which changes nothing of the entry.
class frmExplicacao : public forms::Form {
    Q_OBJECT
public:
    explicit frmExplicacao(const coverage::Explanation& told);

private:
    void fill(const coverage::Explanation& told);
    void layOut(const QString& inShort);

    QTableWidget* Grid1;
    forms::Button* Command1;
};

}  // namespace entry
