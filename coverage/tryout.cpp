// SPDX-License-Identifier: MIT
// The frame of a try-out: the checks, the rubric, the minimum, the incidence and the plan's share.
#include "coverage/TryOut.h"
#include "coverage/Queries.h"
#include "coverage/stages.h"
#include "data/Codes.h"
#include "data/RowSets.h"
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

/// Intentional: outside hospitals `incidencia` is filled by the calculation, so the first test
/// bites from the second run on only. A comparison with a null field does not hold.
bool amountsAreSound(const ado::Recordset& record) {
    if (core::compareNumbers(record.Collect(u"recebido"_s), record.Collect(u"incidencia"_s)) > 0)
        return refuse(u"O valor recebido é maior que o valor do documento."_s);
    if (core::compareNumbers(record.Collect(u"recebido"_s), 0) < 0)
        return refuse(u"O valor recebido é inferior a 0."_s);
    if (core::compareNumbers(record.Collect(u"doc_valor"_s), 0) < 0)
        return refuse(u"O valor do documento é inferior a 0."_s);
    return true;
}

bool isComplete(const Document& document) {
    const auto missing = [&](const QString& text) {
        return refuse(text, Icon::Information, document.caption);
    };
    if (document.bErroEntrada)
        return refuse(
            u"Surgiu um erro grave durante a introdução dos dados no formulário, é "
            "aconcelhável que recomece outro registo."_s,
            Icon::Critical, document.caption);
    if (document.rubric.isEmpty()) return missing(u"Tem de Indicar uma rubrica!"_s);
    if (document.personCode.isEmpty())
        return missing(u"Não foi atribuido nenhum código de familiar!"_s);
    if (document.isHospital && core::isNullOrEmpty(document.record->Collect(u"incidencia"_s)))
        return missing(u"Tem de indicar o valor de incidência!"_s);
    if (document.documentValue.isEmpty())
        return missing(u"Tem de indicar um valor para o documento!"_s);
    if (document.receivedOrIncidence.isEmpty())
        return missing(u"Tem de indicar um valor para o campo Recebido!"_s);
    return true;
}

/// A field of the rubric as a working value; null gives 0.
Single singleOrZero(const QVariant& value) {
    return core::isNullOrEmpty(value) ? Single() : Single(value);
}

/// Ends the try-out with a box; false.
bool endWith(Course& course, Explanation::End end, const QString& text) {
    course.told.end = end;
    course.progress.finish();
    return refuse(text);
}

/// False when the document lies below the rubric's minimum.
bool reachesMinimum(Course& course) {
    const QVariant& minimum = course.told.limits.minimum;
    if (core::isNullOrEmpty(minimum) ||
        !(core::compareNumbers(minimum, course.value(u"doc_valor"_s)) > 0))
        return true;
    return endWith(course, Explanation::End::BelowMinimum,
                   u"Este lançamento tem um limite minimo de "_s +
                       core::formatted(minimum, core::format::Money));
}

/// Limit, incidence and the plan's share. False when the try-out ends here: the box was shown.
bool workOutShare(Course& course) {
    const ado::Recordset& rubric = *course.rubric;
    Explanation& told = course.told;
    told.limits = limitsOf(rubric, told.isMembers);
    course.reach(Result::LimiteAplicavel, singleOrZero(told.limits.person));
    if (!reachesMinimum(course)) return false;

    told.franchise = singleOrZero(rubric.Collect(u"franquia"_s));
    if (!course.document.isHospital) course.keep(u"incidencia"_s, course.value(u"doc_valor"_s));
    told.incidence = course.value(u"incidencia"_s);
    course.reach(Result::Incidencia, told.incidence);

    const QVariant percent = rubric.Collect(u"Percent"_s);
    if (core::isNull(percent)) {
        course.run.bEnsaioValido = endWith(
            course, Explanation::End::NoPercentage,
            u"Erro: não foi possível calcular a comparticipação, porque não existe valor para a "
            "percentagem."_s);
        return false;
    }
    told.percent = Single(percent);
    course.reach(Result::Comparticipacao, u"comparticipacao"_s,
                 share(core::toDouble(told.incidence), told.percent));
    told.share = course.value(u"comparticipacao"_s);
    return true;
}

}  // namespace

void tryOut(const Document& document, TryOut& run) {
    run.bEnsaioValido = false;
    run.explanation = {.isHospital = document.isHospital,
                       .isMembers = document.personCode == data::person::Member,
                       .documentValue = document.record->Collect(u"doc_valor"_s),
                       .received = document.record->Collect(u"recebido"_s)};
    Course course(document, run);
    if (!amountsAreSound(*document.record) || !isComplete(document)) return;

    run.bEnsaioValido = true;
    course.progress.start();
    course.rubric = data::openToRead(queries::rubric(document.rubrica_id));
    if (workOutShare(course) && applyCeilings(course)) setAmounts(course);
}

}  // namespace coverage
