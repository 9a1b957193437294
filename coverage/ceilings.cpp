// SPDX-License-Identifier: MIT
// What is left of all ceilings that bind a document: the lowest remainder wins. The number of
// documents is the one limit that stops the try-out.
#include "boundary/environment/dtZelmars.h"
#include "coverage/Queries.h"
#include "coverage/stages.h"
#include "data/Procedures.h"
#include "data/RowSets.h"
#include "data/modDlookup.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace coverage {

namespace {

/// A ceiling that is null or empty does not exist.
bool exists(const QVariant& ceiling) {
    return !core::isNullOrEmpty(ceiling);
}

/// The row stays also when the operator gives the entry up.
void addAccumulator(const Course& course) {
    const ado::RecordsetPtr rows = data::openToWrite(queries::accumulators());
    rows->AddNew();
    rows->setCollect(u"Socio_ID"_s, course.document.socio_id);
    rows->setCollect(u"Rubrica_ID"_s, core::toLong(course.rubric->Collect(u"Rubrica_ID"_s)));
    rows->setCollect(u"rubrica_id_main"_s,
                     core::toLong(course.rubric->Collect(u"rubrica_id_main"_s)));
    rows->setCollect(u"codABC"_s, course.document.personCode);
    rows->setCollect(u"credito_ac"_s, 0);
    rows->setCollect(u"debito_ac"_s, 0);
    rows->setCollect(u"No_Docs"_s, 0);
    rows->Update();
    rows->Close();
}

Accumulated lookUpAccumulated(Course& course) {
    using namespace queries;
    const QVariant& rubrica_id = course.document.rubrica_id;
    const qint32 socio_id = course.document.socio_id;
    const QString& person = course.document.personCode;
    const QVariant main = course.rubric->Collect(u"rubrica_id_main"_s);
    const QString ofPerson = accumulator(rubrica_id, socio_id, person);
    const QString& connection = environment::dtZelmars::instance().MSAccess()->ConnectionString;
    Accumulated found;

    const QVariant credit = data::DLookup(ofPerson, connection, u"credito_ac"_s);
    // A row with a null credit counts as not found, so a second row is added.
    if (exists(credit))
        found.creditOfPerson = Single(credit);
    else
        addAccumulator(course);
    course.progress.advance();

    const QVariant documents = data::DLookup(ofPerson, connection, u"no_docs"_s);
    if (exists(documents)) found.documents = core::toLong(documents);
    course.progress.advance();

    const struct {
        Single& into;
        QString query;
        QString column;
    } sums[] = {
        {found.creditOfHousehold, creditOfHousehold(rubrica_id, socio_id),
         u"sum_credito_agregado"_s},
        {found.creditOfRelatives, creditOfRelatives(rubrica_id, socio_id),
         u"sum_credito_tfamilia"_s},
        {found.groupCreditOfPerson, groupCreditOfPerson(main, person, socio_id), u"Tagregado"_s},
        {found.groupCreditOfHousehold, groupCreditOfHousehold(main, socio_id), u"Tagregado"_s},
        {found.groupCreditOfRelatives, groupCreditOfRelatives(main, socio_id), u"Tagregado"_s},
    };
    for (const auto& [into, query, column] : sums) {
        const QVariant sum = data::DLookup(query, connection, column);
        if (exists(sum)) into = Single(sum);
        course.progress.advance();
    }
    return found;
}

/// Adds ceilings to those that bind; a step of the progress for each that there could be.
void take(Course& course, const std::vector<Ceiling>& ceilings, int steps) {
    std::vector<Ceiling>& all = course.told.ceilings;
    all.insert(all.end(), ceilings.begin(), ceilings.end());
    for (int step = 0; step < steps; ++step) course.progress.advance();
}

void takeGroup(Course& course) {
    const ado::RecordsetPtr main =
        data::openToRead(queries::rubric(course.rubric->Collect(u"rubrica_id_main"_s)));
    const Explanation& told = course.told;
    if (!main->atEnd()) take(course, groupCeilings(limitsOf(*main, told.isMembers), told.used), 3);
    main->Close();
}

}  // namespace

bool applyCeilings(Course& course) {
    Explanation& told = course.told;
    told.used = lookUpAccumulated(course);
    take(course, ownCeilings(told.limits, told.used), 3);

    if (documentsAreUsedUp(told.limits, told.used)) {
        told.end = Explanation::End::NoDocumentsLeft;
        course.progress.finish();
        core::MsgBox(u"O limite máximo do nº de documentos foi atingido."_s,
                     core::Icon::Information, course.document.caption);
        course.rubric->Close();
        return false;
    }
    course.progress.advance();

    takeGroup(course);
    take(course, documentCeilings(told.limits), 0);

    course.keep(u"saldo_plafond"_s, leftOf(told.ceilings));
    told.left = course.value(u"saldo_plafond"_s);
    course.show(Result::SaldoPlafond, told.left);
    course.rubric->Close();
    return true;
}

}  // namespace coverage
