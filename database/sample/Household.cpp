// SPDX-License-Identifier: MIT
#include "database/sample/Household.h"

#include <algorithm>

#include "database/sample/FixedMembers.h"
#include "database/sample/Names.h"

namespace database::sample {

namespace {

constexpr quint64 Seed = 0x5A454C4D41525321;
constexpr int MostRelatives = 7;

/// Kinship in the order in which a family is filled, and how many of a hundred have it. Children
/// are numbered as they come.
struct Kin {
    const char* code;
    int percent;
};
constexpr std::array<Kin, 9> Kinship{{{"B", 75},
                                      {"C", 85},
                                      {"C", 75},
                                      {"C", 40},
                                      {"D2", 20},
                                      {"D1", 12},
                                      {"E2", 8},
                                      {"C", 10},
                                      {"H", 5}}};

Person relative(const Household& household, const QByteArray& codABC, QDate asOf, Random& random) {
    const QDate parent = household.persons.front().birth;
    const bool woman = codABC == "D2" || codABC == "E2" || (codABC != "D1" && random.chance(50));
    Person person;
    person.codABC = codABC;
    person.nome = givenName(random, woman) + ' ' + surname(random) + ' ' +
                  household.nome.mid(household.nome.lastIndexOf(' ') + 1);
    switch (codABC[0]) {
        case 'C':
            // One in twelve stands within two months of the age limit.
            person.birth = random.chance(8)
                               ? asOf.addDays(-ChildLimitDays + random.between(-60, 60))
                               : std::min(parent.addDays(random.between(8000, 14000)),
                                          asOf.addDays(-random.between(30, 3000)));
            break;
        case 'D':
        case 'E':
            person.birth = parent.addDays(-random.between(7500, 11500));
            break;
        default:
            person.birth = parent.addDays(random.between(-2500, 2500));
    }
    if (random.chance(4)) person.waiting = asOf.addDays(random.between(-60, 150));
    return person;
}

/// The first child is the eldest.
void sortChildren(Household& household) {
    std::vector<Person*> children;
    std::vector<QDate> births;
    for (Person& person : household.persons) {
        if (!person.codABC.startsWith('C')) continue;
        children.push_back(&person);
        births.push_back(person.birth);
    }
    std::sort(births.begin(), births.end());
    for (size_t at = 0; at < births.size(); ++at) children[at]->birth = births[at];
}

/// Leaves the number out, or cuts it, for a few.
QByteArray bankNumberOrNot(Random& random) {
    const QByteArray nib = bankNumber(random);
    if (random.chance(3)) return {};
    if (random.chance(2)) return nib.left(random.between(17, 20));
    return nib;
}

void describeMember(Household& household, QDate asOf, Random& random) {
    const bool woman = random.chance(45);
    const QByteArray given = givenName(random, woman);
    const QByteArray last = surname(random);
    household.nome = given + ' ' + givenName(random, woman) + ' ' + surname(random) + ' ' + last;
    household.nome_guerra = given + ' ' + last;
    household.nib = bankNumberOrNot(random);
    household.enrolled = !random.chance(5);
    const int standing = random.below(100);
    household.premium = standing < 85   ? Premium::InOrder
                        : standing < 92 ? Premium::Arrears
                        : standing < 96 ? Premium::Unpaid
                                        : Premium::Never;
    household.monthsBehind = random.between(2, 9);
    if (random.chance(4)) household.waiting = asOf.addDays(random.between(-90, 120));
    household.persons.push_back({"A", household.nome,
                                 asOf.addDays(-random.between(25 * 365, 68 * 365)),
                                 household.waiting});
}

}  // namespace

bool Person::coveredOn(QDate day) const {
    if (waiting.isValid() && waiting >= day) return false;
    return !codABC.contains('C') || day.addDays(-ChildLimitDays) < birth;
}

Households::Households(const BookSizes& sizes, QDate asOf)
    : asOf_(asOf),
      members_(std::max(sizes.members, FixedMembers)),
      left_(std::clamp(sizes.membersLeft, 0, (members_ - FixedMembers) / 2)),
      membersToCome_(members_),
      relativesToCome_(std::clamp(sizes.relatives, 3 * FixedMembers, MostRelatives * members_)) {}

/// Those who have left are spread evenly over the numbers, never at the end: a number that a member
/// took along is not given again.
bool Households::leftAt(int index) const {
    if (index < FixedMembers || left_ == 0) return false;
    const int open = members_ + left_ - FixedMembers;
    return qint64{index - FixedMembers} * left_ % open < left_;
}

std::optional<Household> Households::next() {
    if (index_ == members_ + left_) return std::nullopt;
    Random random(Seed, static_cast<quint64>(index_));
    Household household;
    household.socio_id = index_ + 1;
    household.left = leftAt(index_);
    household.no_kor = staffNumber(index_ + 1);
    household.taxNumber = taxNumber(random);
    const Address home = address(random);
    household.street = home.street;
    household.postalCode = home.postalCode;
    household.town = home.town;
    if (index_ < FixedMembers) {
        describeFixedMember(household, index_, asOf_, random);
        relativesToCome_ -= static_cast<int>(household.persons.size()) - 1;
        --membersToCome_;
    } else {
        describeMember(household, asOf_, random);
        addRelatives(household, drawRelatives(household.left, random), random);
        const bool bankNumberStands = household.nib.size() == 21;
        household.hasMovements =
            household.enrolled && bankNumberStands && !household.waiting.isValid();
    }
    ++index_;
    return household;
}

int Households::drawRelatives(bool left, Random& random) {
    if (left) return random.between(0, 3);
    const int mean = relativesToCome_ / membersToCome_;
    --membersToCome_;
    // Neither more than there are, nor so few that the families to come could not hold the rest.
    const int fewest = std::max(0, relativesToCome_ - MostRelatives * membersToCome_);
    const int most = std::min(MostRelatives, relativesToCome_);
    const int count = membersToCome_ == 0
                          ? relativesToCome_
                          : std::clamp(random.between(0, 2 * mean + 1), fewest, most);
    relativesToCome_ -= count;
    return count;
}

void Households::addRelatives(Household& household, int count, Random& random) const {
    int children = 0;
    for (size_t at = 0; at < Kinship.size() && count > 0; ++at) {
        const bool needed = static_cast<int>(Kinship.size() - at) == count;
        if (!needed && !random.chance(Kinship[at].percent)) continue;
        QByteArray codABC = Kinship[at].code;
        if (codABC == "C") codABC += QByteArray::number(++children);
        household.persons.push_back(relative(household, codABC, asOf_, random));
        --count;
    }
    sortChildren(household);
}

}  // namespace database::sample
