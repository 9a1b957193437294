// SPDX-License-Identifier: MIT
#pragma once

#include "database/Check.h"
#include "platform/forms/Controls.h"
#include "platform/forms/Form.h"

class QPlainTextEdit;

namespace host {

/// What a check of the book found.
struct CheckResult {
    QString book = {};          ///< where it lies, for people
    QStringList findings = {};  ///< a line each; not more than a window can show
    database::CheckSummary summary = {};

    /// All of it, as it is shown and kept.
    QString text() const;
};

/// Checks the book of the settings, beside the windows. Fails as the check does.
CheckResult checkedBook();

/// Shows what a check found; the text can be kept.
class frmVerificacao : public forms::Form {
    Q_OBJECT
public:
    explicit frmVerificacao(const CheckResult& result);

private:
    void Command1_Click();

    QPlainTextEdit* Text1;
    forms::Button* Command1;
    forms::Button* Command2;
};

}  // namespace host
