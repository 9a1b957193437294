// SPDX-License-Identifier: MIT
// What is left of all ceilings that bind a document: each gives a remainder, floored at 0, and the
// lowest remainder wins. The number of documents is the one limit that stops the try-out.
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

/// What the accumulators say of the member, the person, the rubric and its main rubric.
struct Accumulated {
    Single creditOfPerson;
    qint32 documents = 0;
    Single creditOfHousehold;
    Single creditOfRelatives;
    Single groupCreditOfPerson;
    Single groupCreditOfHousehold;
    Single groupCreditOfRelatives;
};

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

/// Lowers what is left to what a ceiling leaves, if that ceiling exists; one step of the progress.
void narrow(Course& course, Single& left, const QVariant& ceiling, Single usedUp) {
    if (exists(ceiling)) left = data::MinSingle(left, remainder(core::toDouble(ceiling), usedUp));
    course.progress.advance();
}

/// A ceiling for relatives alone; for the member there is none.
QVariant ofRelatives(const Course& course, const ado::Recordset& rubric) {
    return course.isMembers() ? QVariant() : rubric.Collect(u"total_familia"_s);
}

void narrowByGroup(Course& course, const Accumulated& found, Single& left) {
    const ado::RecordsetPtr main =
        data::openToRead(queries::rubric(course.rubric->Collect(u"rubrica_id_main"_s)));
    if (!main->atEnd()) {
        narrow(course, left, main->Collect(course.isMembers() ? u"socio"_s : u"familiar"_s),
               found.groupCreditOfPerson);
        narrow(course, left, main->Collect(u"agregado"_s), found.groupCreditOfHousehold);
        narrow(course, left, ofRelatives(course, *main), found.groupCreditOfRelatives);
    }
    main->Close();
}

}  // namespace

bool applyCeilings(Course& course) {
    const ado::Recordset& rubric = *course.rubric;
    const Accumulated found = lookUpAccumulated(course);

    Single left = NoCeiling;
    narrow(course, left, rubric.Collect(u"agregado"_s), found.creditOfHousehold);
    narrow(course, left, ofRelatives(course, rubric), found.creditOfRelatives);
    // Intentional: always, so that a missing limit leaves nothing.
    narrow(course, left, course.limit, found.creditOfPerson);

    const QVariant documents =
        rubric.Collect(course.isMembers() ? u"nomax_recibos_socio"_s : u"nomax_recibos_familiar"_s);
    if (exists(documents) && isUsedUp(core::toDouble(documents), found.documents)) {
        course.progress.finish();
        core::MsgBox(u"O limite máximo do nº de documentos foi atingido."_s,
                     core::Icon::Information, course.document.caption);
        course.rubric->Close();
        return false;
    }
    course.progress.advance();

    narrowByGroup(course, found, left);

    const QVariant most =
        rubric.Collect(course.isMembers() ? u"socio_max_lan"_s : u"familiar_max_lan"_s);
    // Intentional: the one limit without a floor; a negative maximum gives a negative remainder.
    if (exists(most)) left = data::MinSingle(left, Single(most));

    course.keep(u"saldo_plafond"_s, left);
    course.show(Result::SaldoPlafond, course.value(u"saldo_plafond"_s));
    course.rubric->Close();
    return true;
}

}  // namespace coverage
