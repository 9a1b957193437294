// SPDX-License-Identifier: MIT
#include "platform/ado/MissingPart.h"

namespace ado {

using namespace Qt::StringLiterals;

namespace {

constexpr qsizetype LongestStatement = 160;  // characters that are shown

/// A server tells by its code (undefined table, undefined column), the engine of files, which has
/// one code for all faults of a statement, by its words.
bool isMissingPart(const core::Failure& failure) {
    if (failure.code() == "42P01"_L1 || failure.code() == "42703"_L1) return true;
    return failure.code() == "1"_L1 && (failure.text().startsWith("no such table"_L1) ||
                                        failure.text().startsWith("no such column"_L1) ||
                                        failure.text().contains("has no column named"_L1));
}

}  // namespace

core::Failure explained(const core::Failure& failure, const QString& tried) {
    if (!isMissingPart(failure)) return failure;
    QString shown = tried.simplified();
    if (shown.size() > LongestStatement) shown = shown.left(LongestStatement - 1) + u'…';
    return core::Failure(
        failure.number(),
        u"Ao livro falta uma tabela ou uma coluna. Tentou-se «%1». A base de dados "
        u"respondeu: «%2»."_s.arg(shown, failure.text()),
        failure.code());
}

}  // namespace ado
