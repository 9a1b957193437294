// SPDX-License-Identifier: MIT
// The frame of a try-out: the checks, the rubric, the minimum, the incidence and the plan's share.
#include "coverage/TryOut.h"
#include "boundary/environment/dtZelmars.h"
#include "coverage/Queries.h"
#include "coverage/stages.h"
#include "data/Codes.h"
#include "platform/core/Format.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace coverage {

namespace {

using core::Icon;

/// Says why a document cannot be tried out; false.
bool refuse(const QString& text, Icon icon = Icon::None, const QString& title = {}) {
    core::MsgBox(text, icon, title);
    return false;
}

/// On a normal entry `incidencia` is filled by the calculation, so the first test bites from the
/// second run on only. It is meant so. A comparison with a null field does not hold.
bool amountsAreSound(const ado::Recordset& record) {
    if (core::compareNumbers(record.Collect(u"recebido"_s), record.Collect(u"incidencia"_s)) > 0)
        return refuse(u"O valor recebido é maior que o valor do documento."_s);
    if (core::compareNumbers(record.Collect(u"recebido"_s), 0) < 0)
        return refuse(u"O valor recebido é inferior a 0."_s);
    if (core::compareNumbers(record.Collect(u"doc_valor"_s), 0) < 0)
        return refuse(u"O valor do documento é inferior a 0."_s);
    return true;
}

bool entryIsComplete(const Entry& entry) {
    const auto missing = [&](const QString& text) {
        return refuse(text, Icon::Information, entry.caption);
    };
    if (entry.bErroEntrada)
        return refuse(
            u"Surgiu um erro grave durante a introdução dos dados no formulário, é "
            "aconcelhável que recomece outro registo."_s,
            Icon::Critical, entry.caption);
    if (entry.DataCombo1.isEmpty()) return missing(u"Tem de Indicar uma rubrica!"_s);
    if (entry.Text3.isEmpty()) return missing(u"Não foi atribuido nenhum código de familiar!"_s);
    if (entry.bHospital && core::isNullOrEmpty(entry.record->Collect(u"incidencia"_s)))
        return missing(u"Tem de indicar o valor de incidência!"_s);
    if (entry.Text6.isEmpty()) return missing(u"Tem de indicar um valor para o documento!"_s);
    if (entry.Text9.isEmpty()) return missing(u"Tem de indicar um valor para o campo Recebido!"_s);
    return true;
}

/// A field of the rubric as a working value; null gives 0.
float singleOrZero(const QVariant& value) {
    return core::isNullOrEmpty(value) ? 0.0F : core::toSingle(value);
}

/// False when the document lies below the rubric's minimum.
bool reachesMinimum(const Entry& entry, const ado::Recordset& rubric, Progress& progress) {
    const QVariant minimum =
        rubric.Collect(isMember(entry) ? u"socio_min_lan"_s : u"familiar_min_lan"_s);
    if (core::isNullOrEmpty(minimum) ||
        !(core::compareNumbers(minimum, entry.record->Collect(u"doc_valor"_s)) > 0))
        return true;
    progress.finish();
    return refuse(u"Este lançamento tem um limite minimo de "_s +
                  core::formatted(minimum, core::format::Money));
}

void setIncidence(const Entry& entry, TryOut& run) {
    if (!entry.bHospital)
        entry.record->setCollect(u"incidencia"_s, entry.record->Collect(u"doc_valor"_s));
    run.show(&Results::Incidencia, entry.record->Collect(u"incidencia"_s));
}

/// The share before franchise and ceilings: incidence times the percentage, a fraction.
void setShare(const Entry& entry, const QVariant& percent, TryOut& run) {
    const double share = core::toDouble(entry.record->Collect(u"incidencia"_s)) *
                         static_cast<double>(core::toSingle(percent));
    entry.record->setCollect(u"comparticipacao"_s, share);
    run.show(&Results::Comparticipacao, entry.record->Collect(u"comparticipacao"_s));
}

}  // namespace

bool isMember(const Entry& entry) {
    return entry.Text3 == data::person::Member;
}

void tryOut(const Entry& entry, TryOut& run) {
    run.bEnsaioValido = false;
    Progress progress;
    if (!amountsAreSound(*entry.record) || !entryIsComplete(entry)) return;

    run.bEnsaioValido = true;
    progress.start();
    Working working;
    working.rubric = ado::Recordset::create();
    working.rubric->Open(statements::rubric(entry.rubrica_id),
                         environment::dtZelmars::instance().MSAccess());
    const ado::Recordset& rubric = *working.rubric;

    working.limit = singleOrZero(rubric.Collect(isMember(entry) ? u"socio"_s : u"familiar"_s));
    run.show(&Results::LimiteAplicavel, working.limit);
    progress.advance();
    if (!reachesMinimum(entry, rubric, progress)) return;

    working.franquia = singleOrZero(rubric.Collect(u"franquia"_s));
    setIncidence(entry, run);
    progress.advance();

    const QVariant percent = rubric.Collect(u"Percent"_s);
    if (core::isNull(percent)) {
        progress.finish();
        run.bEnsaioValido = refuse(
            u"Erro: não foi possível calcular a comparticipação, porque não existe valor para a "
            "percentagem."_s);
        return;
    }
    setShare(entry, percent, run);
    progress.advance();

    if (applyCeilings(entry, working, progress, run)) setAmounts(entry, working, progress, run);
}

}  // namespace coverage
