// SPDX-License-Identifier: MIT
#include "platform/ado/engine/EngineTexts.h"

namespace ado {

using namespace Qt::StringLiterals;

namespace {

constexpr qsizetype LongestQuery = 160;  // characters that are shown

constexpr auto Details = "\n\nPormenores: "_L1;
/// The code of a failure that the operator wanted.
constexpr auto GivenUp = "HY008"_L1;

}  // namespace

QString withDetails(QStringView cause, const QString& words) {
    return cause.toString() + Details + words;
}

core::Failure explained(const core::Failure& failure, const QString& tried) {
    if (!failure.text().startsWith(cause::Missing.toString() + Details)) return failure;
    QString shown = tried.simplified();
    if (shown.size() > LongestQuery) shown = shown.left(LongestQuery - 1) + u'…';
    return {failure.number(), failure.text() + u"\nTentou-se: «%1»"_s.arg(shown), failure.code()};
}

core::Failure perhapsStored(const core::Failure& failure) {
    const bool wanted = failure.code() == GivenUp;
    QString text = wanted ? u"Desistiu de esperar pela resposta."_s : failure.text();
    const qsizetype details = text.indexOf(Details);
    text.insert(details < 0 ? text.size() : details,
                u" A linha pode ter ficado gravada: procure-a antes de repetir."_s);
    return {failure.number(), text, failure.code()};
}

core::Failure givenUp() {
    return {core::DatabaseFailure, u"Desistiu de esperar; nada foi gravado."_s, GivenUp};
}

}  // namespace ado
