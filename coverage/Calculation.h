// SPDX-License-Identifier: MIT
#pragma once

#include "platform/core/Single.h"

/// The arithmetic of the plan: what it pays of a document, on plain values. Percentages are
/// fractions, amounts are euros. The order in which a document passes through these functions, and
/// what the book says of it, are the try-out's.
namespace coverage {

using core::Single;

/// What is left where no ceiling binds: above every ceiling.
inline const Single NoCeiling(2'000'000'000.0);

/// The plan's share of an incidence, before ceilings and franchise.
double share(double incidence, Single percent);

/// What a ceiling leaves beside what is used up; never below 0.
Single remainder(double ceiling, Single usedUp);

/// True when none of a number of documents is left.
bool isUsedUp(double maximum, int documents);

/// Gross amount of a document: its share, but no more than was not received from elsewhere.
Single grossAmount(Single share, double incidence, double received);

/// Net amount: no more of the gross amount than the ceilings leave.
Single netAmount(Single gross, Single left);

/// What a family has spent of a rubric's franchise, from the sums of its movements. Below 0 where
/// more was credited than came out net.
Single spentFranchise(double net, double credit);

/// What of a franchise is still to be borne; it grows past the franchise where `spent` is below 0.
Single franchiseLeft(Single franchise, Single spent);

/// The net amount less what is left of the franchise, which brings it to 0 at most.
Single creditAmount(Single net, Single franchise, Single spent);

/// The debit beside a document's credit, so that the member's balance stays as it was.
Single debitAmount(Single credit);

}  // namespace coverage
