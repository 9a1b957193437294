// SPDX-License-Identifier: MIT
#include "data/MovementNote.h"

#include "data/Codes.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace data {

namespace {

QString stateOf(const ado::Recordset& shown) {
    if (core::toText(shown.Collect(u"tipo"_s)) == tipo::Annulled) return u"Anulado"_s;
    return core::toText(shown.Collect(u"ficheiro"_s)) == ficheiro::Active
               ? u"Em vigor"_s
               : u"Em vigor, associado inactivo"_s;
}

}  // namespace

QString noteOf(const ado::Recordset& shown) {
    const auto part = [&shown](const QString& words, const QString& column) {
        const QVariant value = shown.Collect(column);
        return core::isNullOrEmpty(value) ? QString() : words + core::toText(value);
    };
    QStringList details{part(u"Lançado por "_s, u"created_by"_s), part(u"Cheque "_s, u"cheque"_s),
                        stateOf(shown)};
    details.removeAll(QString());
    return part(u"Movimento nº "_s, u"movimento_no"_s) + u'\n' + details.join(u" · "_s);
}

}  // namespace data
