// SPDX-License-Identifier: MIT
#pragma once

#include <functional>

#include "coverage/TryOut.h"
#include "data/Operations.h"

namespace coverage {

/// A document that is to be posted: what a posting looks at beyond the try-out. The texts are
/// looked at for emptiness only.
struct Posting {
    Document document = {};
    QString paymentMode = {};      ///< as shown
    QVariant modo_pagamento = {};  ///< the mode of payment chosen
    QString movementDate = {};
    QString documentDate = {};
    QString documentNumber = {};
    QString hospital = {};  ///< as shown
    /// Asks for the cheque's number and writes it to the row; returns when its screen has gone.
    /// What it fails with ends the posting before anything is written.
    std::function<void(const ado::RecordsetPtr&)> askCheque = {};
};

/// Turns the pending row into a committed movement: asks, tries out once more, checks, draws the
/// number, saves the row and adds to the accumulators. True when all of it is done; false when it
/// was refused or failed (the operator was told) and the screen stays.
///
/// Counter, movement and accumulator are three writes with no transaction around them: what was
/// written before a failure stays.
/// @param operation  of this posting from its first press of "&OK" to its last: on a movement that
/// an earlier press registered only what is missing is done, and nothing is asked
bool post(const Posting& posting, TryOut& run, data::Operation& operation);

/// Of documents and hospital bills.
const data::MovementRules& documentRules();

}  // namespace coverage
