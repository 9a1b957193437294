// SPDX-License-Identifier: MIT
#include "reports/Organisation.h"

#include "platform/core/Configuration.h"

using namespace Qt::StringLiterals;

namespace reports {

namespace {

QString valueOr(const QString& preset, const QString& key) {
    for (const QString& file : core::configurationFiles(u"organizacao.ini"_s))
        if (const std::optional<QString> value = core::lineFor(key, file);
            value && !value->isEmpty())
            return *value;
    return preset;
}

}  // namespace

QString organisationName() {
    return valueOr(u"Tesmar Nacional"_s, u"nome"_s);
}

QString organisationAddress() {
    return valueOr(u"Lisboa"_s, u"morada"_s);
}

}  // namespace reports
