// SPDX-License-Identifier: MIT
#pragma once

#include "coverage/CeilingRule.h"

namespace coverage {

/// How a try-out came to its amounts, for a person who asks why; what it did not reach is as
/// constructed. Amounts that a column keeps are null until they are reached.
struct Explanation {
    enum class End {
        Refused,          ///< before anything was worked out
        BelowMinimum,     ///< the document's value lies below the rubric's minimum
        NoPercentage,     ///< the rubric has no percentage
        NoDocumentsLeft,  ///< the number of documents is used up
        Reached,          ///< all amounts were worked out
    };
    End end = End::Refused;
    bool isHospital = false;
    bool isMembers = false;  ///< the member's own document, and not a relative's
    Limits limits = {};      ///< of the rubric, for this person
    Accumulated used = {};
    QVariant documentValue = {};
    QVariant received = {};  ///< from elsewhere
    QVariant incidence = {};
    Single percent = {};  ///< a fraction
    QVariant share = {};  ///< the plan's, before any ceiling
    std::vector<Ceiling> ceilings = {};
    QVariant left = {};  ///< of the ceiling of which least is left
    QVariant gross = {};
    QVariant net = {};
    Single franchise = {};
    Single franchiseSpent = {};
    QVariant credit = {};
    QVariant debit = {};
};

}  // namespace coverage
