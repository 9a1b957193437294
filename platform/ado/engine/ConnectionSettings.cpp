// SPDX-License-Identifier: MIT
#include "platform/ado/engine/ConnectionSettings.h"

namespace ado {

ConnectionSettings::ConnectionSettings(const QString& text) {
    for (qsizetype at = 0; at < text.size();) {
        const qsizetype sign = text.indexOf(u'=', at);
        if (sign < 0) break;
        qsizetype from = sign + 1;
        while (from < text.size() && text[from] == u' ') ++from;
        const QChar quote = from < text.size() ? text[from] : QChar();
        const bool isQuoted =
            (quote == u'"' || quote == u'\'') && text.indexOf(quote, from + 1) > 0;
        const qsizetype close = isQuoted ? text.indexOf(quote, from + 1) : from;
        qsizetype end = text.indexOf(u';', close);
        if (end < 0) end = text.size();
        const QString value =
            isQuoted ? text.mid(from + 1, close - from - 1) : text.mid(from, end - from);
        values_.insert(text.mid(at, sign - at).trimmed().toLower(), value);
        at = end + 1;
    }
}

}  // namespace ado
