// SPDX-License-Identifier: MIT
#include "database/sample/Members.h"

#include <algorithm>

namespace database::sample {

namespace {

using core::Money;

constexpr int Quarter = 3;  // months that are paid together

/// A month's premium: 12,50 for the member and 4,25 for each relative.
Money monthly(const Household& household) {
    const auto relatives = static_cast<qint64>(household.persons.size()) - 1;
    return Money::fromUnits(125000 + 42500 * relatives);
}

Money times(Money amount, int count) {
    return Money::fromUnits(amount.units() * count);
}

void writeMember(Writer& writer, const Household& household) {
    writer.add("tbSocios", household.left,
               {qint64{household.socio_id}, household.no_kor, household.nome, household.nome_guerra,
                household.nib.isEmpty() ? Value(Null) : household.nib,
                qint64{household.enrolled ? 1 : 0}, dayValue(household.waiting),
                household.taxNumber, household.street, household.postalCode, household.town});
}

/// The payments of the year last paid, a quarter at a time.
void writePayments(Writer& writer, const Household& household, int year, int lastMonth, QDate asOf,
                   qint64& lastPayment) {
    for (int before = 0; before < lastMonth; before += Quarter) {
        const int month = std::min(before + Quarter, lastMonth);
        const QDate day = std::min(QDate(year, month, 8), asOf);
        writer.add(
            "tbQuotas_Movimentos",
            {++lastPayment, qint64{household.socio_id}, dayValue(day), qint64{year}, qint64{month},
             times(monthly(household), month - before), QByteArray("Prémio de zelmar")});
    }
}

void writePremium(Writer& writer, const Household& household, QDate asOf, qint64& lastPayment) {
    if (household.premium == Premium::Never) return;
    QDate last = asOf;
    // A month late is still in order, but not across the new year.
    if (household.premium == Premium::InOrder && asOf.month() > 1 && household.socio_id % 2 == 0)
        last = asOf.addMonths(-1);
    int behind = 0;
    if (household.premium == Premium::Unpaid) behind = 2;
    if (household.premium == Premium::Arrears) {
        behind = household.monthsBehind;
        last = asOf.addMonths(-behind);
    }
    const Money paid = times(monthly(household), last.month());
    writer.add("tbQuotas_Socios",
               {qint64{household.socio_id}, qint64{last.year()}, qint64{last.month()},
                paid + times(monthly(household), behind), paid});
    writePayments(writer, household, last.year(), last.month(), asOf, lastPayment);
}

}  // namespace

int writeMembers(Writer& writer, const BookSizes& sizes, QDate asOf) {
    Households households(sizes, asOf);
    int withMovements = 0;
    qint64 socio_familia_id = 0;
    qint64 lastPayment = 0;
    while (const std::optional<Household> household = households.next()) {
        writeMember(writer, *household);
        for (const Person& person : household->persons)
            writer.add("tbSocios_Familias", household->left,
                       {++socio_familia_id, qint64{household->socio_id}, person.codABC, person.nome,
                        dayValue(person.birth), dayValue(person.waiting)});
        if (!household->left && household->enrolled)
            writePremium(writer, *household, asOf, lastPayment);
        if (household->hasMovements) ++withMovements;
    }
    return withMovements;
}

}  // namespace database::sample
