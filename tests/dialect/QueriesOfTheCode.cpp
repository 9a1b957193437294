// SPDX-License-Identifier: MIT
#include "tests/dialect/QueriesOfTheCode.h"

#include "boundary/Registo.h"
#include "boundary/environment/dtZelmars.h"
#include "coverage/Queries.h"
#include "data/Annulment.h"
#include "data/Members.h"
#include "data/NewMovement.h"
#include "data/Premium.h"
#include "payments/ChequeNumber.h"
#include "receipts/receipt.h"
#include "receipts/reposition.h"
#include "reports/ExtractQuery.h"

using namespace Qt::StringLiterals;

namespace {

// A member with documents, the rubric of one and its main rubric; the same of a member who left.
constexpr qint32 Member = 44;
constexpr int Rubric = 2;
constexpr int MainRubric = 1;
constexpr int Movement = 7003;
constexpr qint32 MemberWhoLeft = 11;
constexpr int RubricOfThatMember = 8;
constexpr int MovementOfThatMember = 7002;

/// The named commands as they were designed; their dates are those of an old design.
QList<Listed> commands() {
    const QStringList without{u"Print_frmTRF_TRF"_s, u"Print_frmTRF_CHQ"_s,
                              u"Print_frmListagemHospitais"_s};
    auto& environment = environment::dtZelmars::instance();
    QList<Listed> all;
    for (const QString& name : environment.commandNames())
        all << Listed{name, environment.Commands(name).CommandText, !without.contains(name)};
    return all;
}

QList<Listed> ofMovementsAndMembers() {
    return {
        {u"new movement"_s, data::NoMovementQuery.toString(), false},
        {u"movement in force"_s, boundary::movementInForceQuery(Movement)},
        {u"counter"_s, data::CounterQuery.toString()},
        {u"cheque number"_s, payments::ChequesStatement.toString()},
        {u"member by number"_s, data::memberQuery(u"100015"_s)},
        {u"member by number, unknown"_s, data::memberQuery(u"abc"_s), false},
        {u"member by id"_s, data::memberQuery(Member)},
        {u"premium"_s, data::premiumQuery(Member)},
        {u"person"_s, data::personQuery(2)},
        {u"movement to annul"_s, data::movementQuery(u"tbZelmar_Movimentos"_s, Movement)},
        {u"movement to annul of a member who left"_s,
         data::movementQuery(u"tbZelmar_Movimentos_Inactivos"_s, MovementOfThatMember)},
    };
}

/// What is left to a member, all rubrics at once.
QList<Listed> ofRemainders() {
    using namespace coverage::queries;
    return {
        {u"rubrics"_s, rubrics()},
        {u"accumulators of a family"_s, accumulatorsOf(Member)},
        {u"credits by rubric"_s, creditsBy(u"rubrica_id"_s, Member)},
        {u"credits by group and person"_s, creditsBy(u"rubrica_id_main, codABC"_s, Member)},
        {u"credits of relatives by group"_s, creditsOfRelativesBy(u"rubrica_id_main"_s, Member)},
        {u"franchises"_s, franchises(Member)}};
}

QList<Listed> ofAccumulators() {
    using namespace coverage::queries;
    const QString left = u"tbSocios_Acumulados_Inactivos"_s;
    const QString own = u"A"_s;
    const QString active = u"tbSocios_Acumulados"_s;
    return {
        {u"member for posting"_s, member(Member)},
        {u"rubric"_s, rubric(Rubric)},
        {u"accumulator"_s, accumulator(Rubric, Member, own)},
        {u"accumulator of a member who left"_s,
         accumulator(RubricOfThatMember, MemberWhoLeft, own, left)},
        {u"all accumulators"_s, accumulators()},
        {u"credit of the household"_s, creditOfHousehold(Rubric, Member)},
        {u"credit of the relatives"_s, creditOfRelatives(Rubric, Member)},
        {u"credit of the group, person"_s, groupCreditOfPerson(MainRubric, own, Member)},
        {u"credit of the group, household"_s, groupCreditOfHousehold(MainRubric, Member)},
        {u"credit of the group, relatives"_s, groupCreditOfRelatives(MainRubric, Member)},
        {u"balance"_s, balance(Member)},
        {u"franchise"_s, franchise(Member, Rubric)},
        {u"account-level accumulator"_s, receipts::accountQuery(active, 12)},
        {u"accumulators of a member"_s, receipts::accumulatorsQuery(active, Member)},
        {u"accumulators of a member who left"_s, receipts::accumulatorsQuery(left, MemberWhoLeft)},
        {u"accumulator of a reposition"_s, receipts::accumulatorQuery(active, Member, Rubric, own)},
        {u"accumulator of a reposition without a rubric"_s,
         receipts::accumulatorQuery(active, Member, {}, {}), false},
    };
}

QList<Listed> printed() {
    QList<Listed> all;
    for (const auto& [socio_id, doc_no, whose] :
         {std::tuple(Member, u"813825"_s, u"a member"_s),
          std::tuple(MemberWhoLeft, u"836504"_s, u"a member who left"_s)})
        for (const bool detailed : {true, false})
            for (const bool byDocument : {false, true})
                all << Listed{u"statement, %1 by %2, of %3"_s.arg(
                                  detailed ? u"detailed"_s : u"summary"_s,
                                  byDocument ? u"document"_s : u"date"_s, whose),
                              reports::extractQuery({.socio_id = socio_id,
                                                     .detailed = detailed,
                                                     .byDocument = byDocument,
                                                     .first = QDate(2026, 1, 1),
                                                     .last = QDate(2026, 12, 31),
                                                     .doc_no = doc_no})};
    return all;
}

}  // namespace

QList<Listed> statementsOfTheCode() {
    return commands() + ofMovementsAndMembers() + ofAccumulators() + ofRemainders() + printed();
}
