// SPDX-License-Identifier: MIT
#pragma once

#include <functional>

#include "host/bankfile/Batch.h"
#include "host/bankfile/PayingAccount.h"
#include "host/bankfile/SentTransfers.h"

/// The file by which the bank is told to make the transfers of the payment list. Failures are
/// core::Failure.
namespace bankfile {

/// A line of which movements stand in an earlier file already.
struct Repeated {
    QString staffNumber;
    QString name;
    QString reference;
    EarlierFile earlier;

    QString text() const;  ///< for people
};

/// What a file is made of.
struct Order {
    const Batch& batch;
    PayingAccount payer;
    QString book;  ///< where it lies, for the record
    QString file;
};

/// Asked before a file is made in which movements stand that were sent before.
using MayRepeat = std::function<bool(const std::vector<Repeated>&)>;

/// Makes the file, of the lines that can go, and keeps a record of it. The record stands before the
/// file does, as one that is begun, so that no file is ever there without it. Never writes over a
/// file.
/// @return false, with nothing made, when `mayRepeat` says no
bool makeBankFile(const Order& order, const MayRepeat& mayRepeat);

}  // namespace bankfile
