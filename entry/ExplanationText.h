// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <vector>

#include "coverage/Explanation.h"

namespace entry {

/// A line of the answer to "why this amount?". Amounts as they are shown; empty for none.
struct WhyLine {
    QString text;
    QString amount;
    QString used = {};
    QString left = {};
    bool stands = false;  ///< what decided, or what is posted: it stands out
};

/// The answer in one sentence.
QString whyInShort(const coverage::Explanation& told);

/// The answer in lines, in the order in which a try-out goes.
std::vector<WhyLine> whyInLines(const coverage::Explanation& told);

}  // namespace entry
