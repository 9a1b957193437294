// SPDX-License-Identifier: MIT
#include "coverage/CeilingRule.h"

#include <algorithm>

#include "coverage/Calculation.h"
#include "data/Procedures.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace coverage {

namespace {

/// A ceiling that is null or empty does not exist.
bool exists(const QVariant& ceiling) {
    return !core::isNullOrEmpty(ceiling);
}

void add(std::vector<Ceiling>& ceilings, Ceiling::Of of, const QVariant& amount, Single used) {
    if (!exists(amount)) return;
    const double ceiling = core::toDouble(amount);
    ceilings.push_back(
        {.of = of, .amount = ceiling, .used = used, .left = remainder(ceiling, used)});
}

}  // namespace

Limits limitsOf(const ado::Recordset& rubric, bool isMembers) {
    const auto either = [&](const QString& member, const QString& relative) {
        return rubric.Collect(isMembers ? member : relative);
    };
    return {.person = either(u"socio"_s, u"familiar"_s),
            .household = rubric.Collect(u"agregado"_s),
            .relatives = isMembers ? QVariant() : rubric.Collect(u"total_familia"_s),
            .perDocument = either(u"socio_max_lan"_s, u"familiar_max_lan"_s),
            .minimum = either(u"socio_min_lan"_s, u"familiar_min_lan"_s),
            .documents = either(u"nomax_recibos_socio"_s, u"nomax_recibos_familiar"_s)};
}

QString ceilingName(Ceiling::Of of, bool isMembers) {
    const QString person = isMembers ? u"o próprio"_s : u"este familiar"_s;
    switch (of) {
        case Ceiling::Of::Household:
            return u"Rubrica: todo o agregado"_s;
        case Ceiling::Of::Relatives:
            return u"Rubrica: os familiares"_s;
        case Ceiling::Of::Person:
            return u"Rubrica: "_s + person;
        case Ceiling::Of::GroupPerson:
            return u"Rubrica principal: "_s + person;
        case Ceiling::Of::GroupHousehold:
            return u"Rubrica principal: todo o agregado"_s;
        case Ceiling::Of::GroupRelatives:
            return u"Rubrica principal: os familiares"_s;
        case Ceiling::Of::Document:
            return u"Máximo por documento"_s;
    }
    return {};
}

std::vector<Ceiling> ownCeilings(const Limits& rubric, const Accumulated& used) {
    std::vector<Ceiling> ceilings;
    add(ceilings, Ceiling::Of::Household, rubric.household, used.creditOfHousehold);
    add(ceilings, Ceiling::Of::Relatives, rubric.relatives, used.creditOfRelatives);
    // In 32 bits from the start, unlike the others.
    const Single limit = exists(rubric.person) ? Single(rubric.person) : Single();
    add(ceilings, Ceiling::Of::Person, limit.toDouble(), used.creditOfPerson);
    return ceilings;
}

std::vector<Ceiling> groupCeilings(const Limits& main, const Accumulated& used) {
    std::vector<Ceiling> ceilings;
    add(ceilings, Ceiling::Of::GroupPerson, main.person, used.groupCreditOfPerson);
    add(ceilings, Ceiling::Of::GroupHousehold, main.household, used.groupCreditOfHousehold);
    add(ceilings, Ceiling::Of::GroupRelatives, main.relatives, used.groupCreditOfRelatives);
    return ceilings;
}

std::vector<Ceiling> documentCeilings(const Limits& rubric) {
    if (!exists(rubric.perDocument)) return {};
    return {{.of = Ceiling::Of::Document,
             .amount = core::toDouble(rubric.perDocument),
             .used = {},
             .left = Single(rubric.perDocument)}};
}

const Ceiling* binding(const std::vector<Ceiling>& ceilings) {
    const auto lowest = std::min_element(
        ceilings.begin(), ceilings.end(),
        [](const Ceiling& one, const Ceiling& other) { return one.left < other.left; });
    return lowest == ceilings.end() ? nullptr : &*lowest;
}

Single leftOf(const std::vector<Ceiling>& ceilings) {
    Single left = NoCeiling;
    for (const Ceiling& ceiling : ceilings) left = data::MinSingle(left, ceiling.left);
    return left;
}

bool documentsAreUsedUp(const Limits& rubric, const Accumulated& used) {
    return exists(rubric.documents) && isUsedUp(core::toDouble(rubric.documents), used.documents);
}

}  // namespace coverage
