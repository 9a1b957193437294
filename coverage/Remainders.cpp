// SPDX-License-Identifier: MIT
#include "coverage/Remainders.h"

#include "coverage/Calculation.h"
#include "coverage/Queries.h"
#include "data/Codes.h"
#include "data/RowSets.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace coverage {

namespace {

/// Null counts as 0, as it does to the lookups of the try-out.
Single single(const QVariant& value) {
    return core::isNullOrEmpty(value) ? Single() : Single(value);
}

/// Reads sums by a number, or by a number and a person.
template <class Take>
void eachRow(const QString& query, const Take& take) {
    const ado::RecordsetPtr rows = data::openToRead(query);
    for (; !rows->atEnd(); rows->MoveNext()) take(*rows);
    rows->Close();
}

QHash<qint32, Single> sumsBy(const QString& column, const QString& query) {
    QHash<qint32, Single> sums;
    eachRow(query, [&](const ado::Recordset& row) {
        const QVariant key = row.Collect(column);
        if (!core::isNull(key)) sums.insert(core::toLong(key), single(row.Collect(u"soma"_s)));
    });
    return sums;
}

}  // namespace

Remainders::Remainders(qint32 socio_id) {
    readRubrics();
    readAccumulators(socio_id);
    readSums(socio_id);
}

void Remainders::readRubrics() {
    eachRow(queries::rubrics(), [&](const ado::Recordset& row) {
        const qint32 rubrica_id = core::toLong(row.Collect(u"rubrica_id"_s));
        const QVariant main = row.Collect(u"rubrica_id_main"_s);
        rubrics_.insert(rubrica_id, {.main = core::isNull(main) ? 0 : core::toLong(main),
                                     .name = core::toText(row.Collect(u"completo"_s)),
                                     .ofMember = limitsOf(row, true),
                                     .ofRelative = limitsOf(row, false),
                                     .franchise = single(row.Collect(u"franquia"_s))});
        if (!core::isNull(main)) order_.push_back(rubrica_id);
    });
}

/// Of several rows of one person and rubric the first counts, as it does to a lookup.
void Remainders::readAccumulators(qint32 socio_id) {
    eachRow(queries::accumulatorsOf(socio_id), [&](const ado::Recordset& row) {
        const QVariant rubric = row.Collect(u"rubrica_id"_s);
        if (core::isNull(rubric)) return;
        const Key key(core::toLong(rubric), core::toText(row.Collect(u"codABC"_s)));
        const QVariant documents = row.Collect(u"no_docs"_s);
        if (own_.contains(key)) return;
        own_.insert(key,
                    {.credit = single(row.Collect(u"credito_ac"_s)),
                     .documents = core::isNullOrEmpty(documents) ? 0 : core::toLong(documents)});
    });
}

void Remainders::readSums(qint32 socio_id) {
    const QString rubric = u"rubrica_id"_s;
    const QString main = u"rubrica_id_main"_s;
    household_ = sumsBy(rubric, queries::creditsBy(rubric, socio_id));
    relatives_ = sumsBy(rubric, queries::creditsOfRelativesBy(rubric, socio_id));
    groupHousehold_ = sumsBy(main, queries::creditsBy(main, socio_id));
    groupRelatives_ = sumsBy(main, queries::creditsOfRelativesBy(main, socio_id));
    eachRow(queries::creditsBy(main + u", codABC"_s, socio_id), [&](const ado::Recordset& row) {
        const QVariant key = row.Collect(main);
        if (!core::isNull(key))
            groupPerson_.insert({core::toLong(key), core::toText(row.Collect(u"codABC"_s))},
                                single(row.Collect(u"soma"_s)));
    });
    eachRow(queries::franchises(socio_id), [&](const ado::Recordset& row) {
        const QVariant key = row.Collect(rubric);
        const QVariant net = row.Collect(u"t_iliquido"_s);
        const QVariant credit = row.Collect(u"t_credito"_s);
        if (core::isNull(key) || core::isNull(net) || core::isNull(credit)) return;
        franchiseSpent_.insert(core::toLong(key),
                               spentFranchise(core::toDouble(net), core::toDouble(credit)));
    });
}

Accumulated Remainders::accumulated(qint32 rubrica_id, qint32 main, const QString& codABC) const {
    const Own own = own_.value({rubrica_id, codABC});
    return {.creditOfPerson = own.credit,
            .documents = own.documents,
            .creditOfHousehold = household_.value(rubrica_id),
            .creditOfRelatives = relatives_.value(rubrica_id),
            .groupCreditOfPerson = groupPerson_.value({main, codABC}),
            .groupCreditOfHousehold = groupHousehold_.value(main),
            .groupCreditOfRelatives = groupRelatives_.value(main)};
}

std::vector<Remainder> Remainders::of(const QString& codABC) const {
    const bool isMembers = codABC == data::person::Member;
    std::vector<Remainder> all;
    for (const qint32 rubrica_id : order_) {
        const Rubric rubric = rubrics_.value(rubrica_id);
        Remainder left{.rubrica_id = rubrica_id,
                       .name = rubric.name,
                       .limits = isMembers ? rubric.ofMember : rubric.ofRelative,
                       .used = accumulated(rubrica_id, rubric.main, codABC),
                       .ceilings = {},
                       .franchise = rubric.franchise,
                       .franchiseLeft = {}};
        left.ceilings = ownCeilings(left.limits, left.used);
        const auto main = rubrics_.constFind(rubric.main);
        const auto add = [&](const std::vector<Ceiling>& more) {
            left.ceilings.insert(left.ceilings.end(), more.begin(), more.end());
        };
        if (main != rubrics_.constEnd())
            add(groupCeilings(isMembers ? main->ofMember : main->ofRelative, left.used));
        add(documentCeilings(left.limits));
        left.franchiseLeft = franchiseLeft(rubric.franchise, franchiseSpent_.value(rubrica_id));
        all.push_back(std::move(left));
    }
    return all;
}

}  // namespace coverage
