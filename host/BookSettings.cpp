// SPDX-License-Identifier: MIT
#include "host/BookSettings.h"

#include "platform/ado/ConnectionSettings.h"
#include "platform/core/Failure.h"
#include "platform/registry/Registry.h"

using namespace Qt::StringLiterals;

namespace host {

BookSettings BookSettings::read() {
    BookSettings settings;
    const auto key =
        registry::Key::open(registry::Hive::LocalMachine, u"SOFTWARE\\Norvanta\\Corvenda"_s);
    if (!key) return settings;
    settings.isComplete = true;
    const auto take = [&](const QString& name, QString& into) {
        const auto value = key->value(name);
        into = value.value_or(QString());
        settings.isComplete = settings.isComplete && value;
    };
    take(u"dtSecurityInfo"_s, settings.securityInfo);
    take(u"dtUser"_s, settings.user);
    take(u"dtPassword"_s, settings.password);
    take(u"dtInitialCatalog"_s, settings.catalogue);
    take(u"dtDataSource"_s, settings.dataSource);
    return settings;
}

BookSettings BookSettings::readOrTell() {
    try {
        return read();
    } catch (const core::Failure& failure) {
        BookSettings settings;
        settings.unreadable = failure.text();
        return settings;
    }
}

QString BookSettings::connectionString() const {
    return u"Provider=SQLOLEDB.1;Persist Security Info=%1;User ID=%2;Password=%3;"
           "Initial Catalog=%4;Data Source=%5;Connect Timeout=15"_s.arg(
               securityInfo, user, password, catalogue, dataSource);
}

QString BookSettings::bookText() const {
    const QString warning =
        ado::isReadableOnTheWay(dataSource) ? u", ligação não cifrada"_s : QString();
    return u"%1 (%2%3)"_s.arg(catalogue, dataSource, warning);
}

}  // namespace host
