// SPDX-License-Identifier: MIT
#pragma once

#include <QDateTime>

#include "host/bankfile/Batch.h"
#include "host/bankfile/PayingAccount.h"

class QIODevice;

namespace bankfile {

/// An order to the bank to make transfers in euro: pain.001.001.09, or the older .03.
struct CreditTransferFile {
    QString message;  ///< names the file to the bank, at most 35 characters; never given twice
    QDateTime made;
    QDate execution;  ///< the day on which the bank is to pay
    PayingAccount payer;
    const std::vector<Payment>& payments;

    /// Writes all of it; the payer has no faults, and there is at least one payment. Fails when the
    /// device does not take it.
    void write(QIODevice& device) const;
};

/// An amount without a third or fourth decimal, as such a file has it: "1234.50".
QString amountText(core::Money amount);

}  // namespace bankfile
