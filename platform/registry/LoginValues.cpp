// SPDX-License-Identifier: MIT
#include "platform/registry/LoginValues.h"

#include "platform/registry/Registry.h"

using namespace Qt::StringLiterals;

namespace registry {

namespace {

struct Value {
    QString name;
    QString LoginValues::*text;
};

const QList<Value>& order() {
    static const QList<Value> values{
        {u"dtSecurityInfo"_s, &LoginValues::dtSecurityInfo},
        {u"dtUser"_s, &LoginValues::dtUser},
        {u"dtPassword"_s, &LoginValues::dtPassword},
        {u"dtInitialCatalog"_s, &LoginValues::dtInitialCatalog},
        {u"dtDataSource"_s, &LoginValues::dtDataSource},
    };
    return values;
}

}  // namespace

std::optional<QString> LoginValues::stored(const QString& name) {
    const auto values = Key::open(Hive::LocalMachine, key());
    return values ? values->value(name) : std::nullopt;
}

QString LoginValues::take(const std::function<std::optional<QString>(const QString&)>& value) {
    for (const auto& [name, text] : order()) {
        const std::optional<QString> found = value(name);
        if (!found) return name;
        this->*text = *found;
    }
    return {};
}

void LoginValues::write() const {
    Values values;
    for (const auto& [name, text] : order()) values.append({name, this->*text});
    writeValues(Hive::LocalMachine, key(), values);
}

QString LoginValues::connectionString() const {
    return u"Provider=SQLOLEDB.1;Persist Security Info="_s + dtSecurityInfo + u";User ID="_s +
           dtUser + u";Password="_s + dtPassword + u";Initial Catalog="_s + dtInitialCatalog +
           u";Data Source="_s + dtDataSource + u";Connect Timeout=15"_s;
}

QString LoginValues::shapingConnectionString() const {
    return u"Provider=MSDataShape.1;Persist Security Info="_s + dtSecurityInfo +
           u";Connect Timeout=15;Data Source="_s + dtDataSource + u";User ID="_s + dtUser +
           u";Password="_s + dtPassword + u";Initial Catalog="_s + dtInitialCatalog +
           u";Data Provider=SQLOLEDB.1"_s;
}

}  // namespace registry
