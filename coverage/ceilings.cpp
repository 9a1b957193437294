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

/// Above every ceiling: no ceiling at all.
constexpr float NoCeiling = 2'000'000'000.0F;

/// A ceiling that is null or empty does not exist.
bool exists(const QVariant& ceiling) {
    return !core::isNullOrEmpty(ceiling);
}

QVariant lookup(const QString& statement, const QString& column) {
    return data::DLookup(statement, environment::dtZelmars::instance().MSAccess()->ConnectionString,
                         column);
}

/// What is used up; nothing found is 0.
float used(const QVariant& found) {
    return exists(found) ? core::toSingle(found) : 0.0F;
}

/// What the accumulators say of the member, the person, the rubric and its main rubric.
struct Accumulated {
    float creditoAc = 0;
    qint32 noDocs = 0;
    float sumAgregado = 0;
    float sumFamilia = 0;
    float tAgregadoPessoa = 0;
    float tAgregadoTotal = 0;
    float tAgregadoFamilia = 0;
};

/// The row stays also when the operator gives the entry up.
void addAccumulator(const Entry& entry, const ado::Recordset& rubric) {
    const ado::RecordsetPtr rows = data::openToWrite(statements::accumulators());
    rows->AddNew();
    rows->setCollect(u"Socio_ID"_s, entry.Socio_ID);
    rows->setCollect(u"Rubrica_ID"_s, core::toLong(rubric.Collect(u"Rubrica_ID"_s)));
    rows->setCollect(u"rubrica_id_main"_s, core::toLong(rubric.Collect(u"rubrica_id_main"_s)));
    rows->setCollect(u"codABC"_s, entry.Text3);
    rows->setCollect(u"credito_ac"_s, 0);
    rows->setCollect(u"debito_ac"_s, 0);
    rows->setCollect(u"No_Docs"_s, 0);
    rows->Update();
    rows->Close();
}

Accumulated lookUpAccumulated(const Entry& entry, const ado::Recordset& rubric,
                              Progress& progress) {
    using namespace statements;
    const QVariant& rubrica_id = entry.rubrica_id;
    const qint32 socio_id = entry.Socio_ID;
    const QVariant main = rubric.Collect(u"rubrica_id_main"_s);
    const QString ofPerson = accumulator(rubrica_id, socio_id, entry.Text3);
    Accumulated found;

    const QVariant credit = lookup(ofPerson, u"credito_ac"_s);
    // A row with a null credit counts as not found, so a second row is added.
    if (!exists(credit)) addAccumulator(entry, rubric);
    found.creditoAc = used(credit);
    progress.advance();

    const QVariant documents = lookup(ofPerson, u"no_docs"_s);
    found.noDocs = exists(documents) ? core::toLong(documents) : 0;
    progress.advance();

    const auto sum = [&](float& into, const QString& statement, const QString& column) {
        into = used(lookup(statement, column));
        progress.advance();
    };
    sum(found.sumAgregado, creditOfHousehold(rubrica_id, socio_id), u"sum_credito_agregado"_s);
    sum(found.sumFamilia, creditOfRelatives(rubrica_id, socio_id), u"sum_credito_tfamilia"_s);
    sum(found.tAgregadoPessoa, groupCreditOfPerson(main, entry.Text3, socio_id), u"Tagregado"_s);
    sum(found.tAgregadoTotal, groupCreditOfHousehold(main, socio_id), u"Tagregado"_s);
    sum(found.tAgregadoFamilia, groupCreditOfRelatives(main, socio_id), u"Tagregado"_s);
    return found;
}

/// Lowers `saldo` to the remainder, which is floored at 0.
void narrow(float& saldo, float remainder) {
    saldo = data::MinSingle(saldo, data::MaxSingle(0.0F, remainder));
}

/// The same for a ceiling field, if that ceiling exists.
void narrowBy(float& saldo, const QVariant& ceiling, float usedUp) {
    if (exists(ceiling))
        narrow(saldo, core::toSingle(core::toDouble(ceiling) - static_cast<double>(usedUp)));
}

/// True when the person has no document left.
bool documentsUsedUp(const Entry& entry, const ado::Recordset& rubric, qint32 noDocs) {
    const QVariant maximum =
        rubric.Collect(isMember(entry) ? u"nomax_recibos_socio"_s : u"nomax_recibos_familiar"_s);
    return exists(maximum) && core::toDouble(maximum) - static_cast<double>(noDocs) <= 0;
}

void narrowByGroup(const Entry& entry, const ado::Recordset& rubric, const Accumulated& found,
                   float& saldo, Progress& progress) {
    const ado::RecordsetPtr main =
        data::openToRead(statements::rubric(rubric.Collect(u"rubrica_id_main"_s)));
    if (!main->atEnd()) {
        narrowBy(saldo, main->Collect(isMember(entry) ? u"socio"_s : u"familiar"_s),
                 found.tAgregadoPessoa);
        progress.advance();
        narrowBy(saldo, main->Collect(u"agregado"_s), found.tAgregadoTotal);
        progress.advance();
        if (!isMember(entry))
            narrowBy(saldo, main->Collect(u"total_familia"_s), found.tAgregadoFamilia);
        progress.advance();
    }
    main->Close();
}

}  // namespace

bool applyCeilings(const Entry& entry, const Working& working, Progress& progress, TryOut& run) {
    const ado::Recordset& rubric = *working.rubric;
    const Accumulated found = lookUpAccumulated(entry, rubric, progress);

    float saldo = NoCeiling;
    narrowBy(saldo, rubric.Collect(u"agregado"_s), found.sumAgregado);
    progress.advance();
    if (!isMember(entry)) narrowBy(saldo, rubric.Collect(u"total_familia"_s), found.sumFamilia);
    progress.advance();
    // Always, also without a limit: a missing one leaves nothing.
    narrow(saldo, core::toSingle(static_cast<double>(working.limit - found.creditoAc)));
    progress.advance();

    if (documentsUsedUp(entry, rubric, found.noDocs)) {
        progress.finish();
        core::MsgBox(u"O limite máximo do nº de documentos foi atingido."_s,
                     core::Icon::Information, entry.caption);
        working.rubric->Close();
        return false;
    }
    progress.advance();

    narrowByGroup(entry, rubric, found, saldo, progress);

    const QVariant maximum =
        rubric.Collect(isMember(entry) ? u"socio_max_lan"_s : u"familiar_max_lan"_s);
    // The one limit without a floor: a negative maximum gives a negative remainder.
    if (exists(maximum)) saldo = data::MinSingle(saldo, core::toSingle(maximum));

    entry.record->setCollect(u"saldo_plafond"_s, saldo);
    run.show(&Results::SaldoPlafond, entry.record->Collect(u"saldo_plafond"_s));
    working.rubric->Close();
    return true;
}

}  // namespace coverage
