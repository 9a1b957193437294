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
    Batch batch;
    PayingAccount payer;
    QString book;  ///< where it lies, for the record
    QString file;
};

/// What becomes of lines of which movements were sent before.
enum class Repetition {
    None,       ///< no file is made
    LeaveOut,   ///< one is made without them
    SendAgain,  ///< one is made with them
};
/// Asked before a file is made in which such lines stand.
using AskRepetition = std::function<Repetition(const std::vector<Repeated>&)>;

/// What stands in a file that was made.
struct Made {
    std::size_t payments;
    core::Money sum;
    QString rounding;  ///< as shownRounding() tells it
};

/// Makes the file, of the lines that can go, and keeps a record of it. The record stands before the
/// file does, as one that is begun, so that no file is ever there without it. Never writes over a
/// file.
/// @return nothing, with nothing made, when `ask` says so
std::optional<Made> makeBankFile(const Order& order, const AskRepetition& ask);

}  // namespace bankfile
