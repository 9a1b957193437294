// SPDX-License-Identifier: MIT
#pragma once

#include "database/sample/Account.h"
#include "database/sample/Household.h"

namespace database::sample {

/// What a household does in one plan year, one movement after the other.
class Activity {
public:
    Activity(const Household& household, Account& account, Random& random)
        : household_(household), account_(account), random_(random) {}

    /// The next movement, posted to the account. `another` tells that one more follows in this
    /// year, so that an annulled document can have its correction.
    Movement next(QDate day, bool another);

private:
    std::optional<Movement> document(QDate day);
    const Rubric& drawRubric();
    const Person* drawPerson(QDate day, bool child);
    void setBill(Movement& bill);
    void setInvoice(Movement& invoice);
    Movement receipt(QDate day);
    Movement reposition(QDate day);
    Movement correction(QDate day);
    core::Money euros(int low, int high);

    const Household& household_;
    Account& account_;
    Random& random_;
    std::optional<Movement> annulled_;  // waits for its correction
};

}  // namespace database::sample
