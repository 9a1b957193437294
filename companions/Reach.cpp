// SPDX-License-Identifier: MIT
#include "companions/Reach.h"

#include "platform/core/Failure.h"
#include "platform/registry/Registry.h"

using namespace Qt::StringLiterals;

namespace companions {
namespace {

const auto Key = u"SOFTWARE\\Norvanta\\Corvenda"_s;

QString setting(const QString& name) {
    const auto key = registry::Key::open(registry::Hive::LocalMachine, Key);
    const auto value = key ? key->value(name) : std::nullopt;
    if (!value)
        throw core::Failure(core::NoSuchItem,
                            u"Falta o valor %1 em HKEY_LOCAL_MACHINE\\%2."_s.arg(name, Key));
    return *value;
}

}  // namespace

ado::ConnectionPtr reach() {
    return reach(setting(u"dtUser"_s), setting(u"dtPassword"_s));
}

ado::ConnectionPtr reach(const QString& user, const QString& password) {
    const QString security = setting(u"dtSecurityInfo"_s);
    const QString catalogue = setting(u"dtInitialCatalog"_s);
    const QString source = setting(u"dtDataSource"_s);
    auto connection = std::make_shared<ado::Connection>();
    connection->ConnectionString = u"Provider=SQLOLEDB.1;Persist Security Info="_s + security +
                                   u";User ID="_s + user + u";Password="_s + password +
                                   u";Initial Catalog="_s + catalogue + u";Data Source="_s +
                                   source + u";Connect Timeout=15"_s;
    connection->Open();
    return connection;
}

const ado::ConnectionPtr& loggedIn(const ado::ConnectionPtr& connection) {
    if (!connection)
        throw core::Failure(core::InvalidCall, u"É preciso chamar Login antes deste membro."_s);
    return connection;
}

}  // namespace companions
