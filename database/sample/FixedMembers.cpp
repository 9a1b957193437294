// SPDX-License-Identifier: MIT
#include "database/sample/FixedMembers.h"

#include "database/sample/Names.h"

namespace database::sample {

namespace {

// Their places in the list of names.
enum : int {
    WithoutBankNumber = 1,
    ShortBankNumber,
    InArrears,
    Waiting,
    NotEnrolled,
    ChildTooOld,
    NeverPaid,
    PremiumDue
};

constexpr std::array<std::array<const char*, 2>, FixedMembers> Names{{
    {"António Manuel Silva Matos", "António Matos"},
    {"Maria João Pires Teles", "Maria Teles"},
    {"José Carlos Lobo Nunes", "José Nunes"},
    {"Ana Paula Reis Fonseca", "Ana Fonseca"},
    {"Rui Miguel Castro Vaz", "Rui Vaz"},
    {"Helena Sofia Dias Couto", "Helena Couto"},
    {"Joaquim Alves Guerra", "Joaquim Guerra"},
    {"Teresa Isabel Brito Faria", "Teresa Faria"},
    {"Fernando Jorge Melo Serra", "Fernando Serra"},
    {"Luísa Margarida Paz Leal", "Luísa Leal"},
}};

Person person(const char* codABC, const char* given, const Household& household, QDate birth) {
    const QByteArray last = household.nome.mid(household.nome.lastIndexOf(' ') + 1);
    return {codABC, QByteArray(given) + ' ' + last, birth, {}};
}

}  // namespace

void describeFixedMember(Household& household, int index, QDate asOf, Random& random) {
    const std::array<const char*, 2>& names = Names[static_cast<size_t>(index)];
    household.nome = names[0];
    household.nome_guerra = names[1];
    household.hasMovements = false;
    const QByteArray nib = bankNumber(random);
    household.nib = index == WithoutBankNumber ? QByteArray()
                    : index == ShortBankNumber ? nib.left(20)
                                               : nib;
    household.enrolled = index != NotEnrolled;
    household.premium = index == InArrears    ? Premium::Arrears
                        : index == NeverPaid  ? Premium::Never
                        : index == PremiumDue ? Premium::Unpaid
                                              : Premium::InOrder;
    household.monthsBehind = 5;
    household.persons.push_back({"A", household.nome, asOf.addDays(-45 * 365), {}});
    household.persons.push_back(
        person("B", index % 2 == 0 ? "Marta" : "Pedro", household, asOf.addDays(-43 * 365)));
    if (index == ChildTooOld) {
        household.persons.push_back(
            person("C1", "Tomás", household, asOf.addDays(-ChildLimitDays)));
        household.persons.push_back(
            person("C2", "Inês", household, asOf.addDays(1 - ChildLimitDays)));
    } else {
        household.persons.push_back(person("C1", "Leonor", household, asOf.addYears(-12)));
    }
    if (index == Waiting) {
        household.waiting = asOf.addDays(30);
        for (Person& each : household.persons) each.waiting = household.waiting;
    }
}

}  // namespace database::sample
