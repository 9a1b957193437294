// SPDX-License-Identifier: MIT
#pragma once

#include <QByteArray>
#include <QDate>
#include <optional>
#include <vector>

#include "database/Book.h"
#include "database/sample/Random.h"

namespace database::sample {

struct Person {
    QByteArray codABC;
    QByteArray nome;
    QDate birth;
    QDate waiting;  // last day of the waiting period; invalid without one

    /// Whether the plan takes a document of this person on that day.
    bool coveredOn(QDate day) const;
};

/// A child of so many days is refused; one of a day less is accepted.
inline constexpr int ChildLimitDays = 9132;

/// How a member stands with the premium.
enum class Premium { InOrder, Arrears, Unpaid, Never };

/// A member with his family; the first person is the member himself.
struct Household {
    int socio_id = 0;
    bool left = false;
    QByteArray no_kor;
    QByteArray nome;
    QByteArray nome_guerra;
    QByteArray nib;
    bool enrolled = true;
    QDate waiting;
    QByteArray taxNumber;
    QByteArray street;
    QByteArray postalCode;
    QByteArray town;
    Premium premium = Premium::InOrder;
    int monthsBehind = 0;  // of arrears
    std::vector<Person> persons;
    /// False for the members at fixed numbers, and where no document could have been posted.
    bool hasMovements = true;
};

/// Number of members at fixed numbers; they come first.
inline constexpr int FixedMembers = 10;
/// The last of them owes the plan so much from before the first closed year.
inline constexpr qint64 FixedDebtUnits = 4123500;

/// Yields the households one after the other, always the same for the same sizes and day.
class Households {
public:
    Households(const BookSizes& sizes, QDate asOf);
    /// Nothing behind the last one.
    std::optional<Household> next();
    int count() const { return members_ + left_; }

private:
    bool leftAt(int index) const;
    void addRelatives(Household& household, int count, Random& random) const;
    int drawRelatives(bool left, Random& random);

    QDate asOf_;
    int members_;
    int left_;
    int index_ = 0;
    int membersToCome_;
    int relativesToCome_;
};

}  // namespace database::sample
