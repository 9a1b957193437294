// SPDX-License-Identifier: MIT
#include "companions/Reach.h"

#include "platform/core/Failure.h"
#include "platform/registry/LoginValues.h"

using namespace Qt::StringLiterals;

namespace companions {
namespace {

using registry::LoginValues;

/// Opens the book that the values name.
ado::ConnectionPtr opened(const std::function<std::optional<QString>(const QString&)>& value) {
    LoginValues values;
    const QString missing = values.take(value);
    if (!missing.isEmpty())
        throw core::Failure(core::NoSuchItem, u"Falta o valor %1 em HKEY_LOCAL_MACHINE\\%2."_s.arg(
                                                  missing, LoginValues::key()));
    auto connection = std::make_shared<ado::Connection>();
    connection->ConnectionString = values.connectionString();
    connection->Open();
    return connection;
}

}  // namespace

ado::ConnectionPtr reach() {
    return opened(LoginValues::stored);
}

ado::ConnectionPtr reach(const QString& user, const QString& password) {
    return opened([&](const QString& name) -> std::optional<QString> {
        if (name == "dtUser"_L1) return user;
        if (name == "dtPassword"_L1) return password;
        return LoginValues::stored(name);
    });
}

const ado::ConnectionPtr& loggedIn(const ado::ConnectionPtr& connection) {
    if (!connection)
        throw core::Failure(core::InvalidCall, u"É preciso chamar Login antes deste membro."_s);
    return connection;
}

}  // namespace companions
