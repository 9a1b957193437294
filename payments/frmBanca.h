// SPDX-License-Identifier: MIT
#pragma once

#include "payments/BankScript.h"
#include "platform/forms/Controls.h"
#include "platform/forms/Form.h"

class QLabel;

namespace payments {

/// Types the transfers into the bank's own program, which has no other way in: it is started, its
/// windows are brought to the front by their titles, and every value goes through the clipboard.
/// Nothing is read back from it, and nothing is written to the book.
///
/// The step that the run is at is the one whose label is bold. The timer presses "&Continuar >",
/// and so may the operator at any moment.
class frmBanca : public forms::Form {
    Q_OBJECT
public:
    frmBanca();

    /// The query of the transfers. Its rows have `nib`, `nome_guerra`, `no_kor`, `tdebito`.
    void setQuery(const QString& query) { query_ = query; }

protected:
    void closeEvent(QCloseEvent* event) override;

private:
    struct Step {
        QLabel* label;
        QLabel* marker;
    };

    Step addStep(const QString& label, const QString& caption, const QString& marker,
                 const QString& unused);
    void layOut();
    bool isAt(const Step& step) const;
    void mark(const Step& step, bool isCurrent);
    void move(const Step& from, const Step& to);

    void Command1_Click();
    void Timer1_Timer();
    void Timer2_Timer();
    void Timer3_Timer();
    void OKButton_Click();
    void openBank();
    void waitForLogin();
    void openModule(const QString& code, forms::Timer* enter);
    void typeTransfers();
    void finish();

    QString query_;
    QWidget* steps_;
    Step open_;
    Step login_;
    Step interbank_;
    Step internal_;
    Step numbers_;
    Step transfers_;
    forms::Button* Command1;
    forms::Button* OKButton;
    forms::Timer* Timer1;  ///< presses "&Continuar >"
    forms::Timer* Timer2;  ///< confirms the code of the interbank module
    forms::Timer* Timer3;  ///< confirms the code of the internal module
};

}  // namespace payments
