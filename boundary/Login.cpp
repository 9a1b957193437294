// SPDX-License-Identifier: MIT
#include "boundary/Login.h"

#include "boundary/environment/LoginState.h"
#include "boundary/environment/dtZelmars.h"
#include "boundary/modRegistry.h"
#include "platform/core/Failure.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace boundary {

namespace {

using environment::dtZelmars;
using environment::LoginState;
using environment::loginState;

/// Reads the five texts in their order; stops at the first one that is missing. Those read before
/// it stay.
bool readConfiguration(LoginState& state) {
    const std::pair<QString, QString&> values[] = {
        {u"dtSecurityInfo"_s, state.dtSecurityInfo},
        {u"dtUser"_s, state.dtUser},
        {u"dtPassword"_s, state.dtPassword},
        {u"dtInitialCatalog"_s, state.dtInitialCatalog},
        {u"dtDataSource"_s, state.dtDataSource},
    };
    for (const auto& [name, text] : values) {
        QString path = u"HKEY_LOCAL_MACHINE\\SOFTWARE\\Norvanta\\Corvenda"_s;
        const QVariant value = GetRegistryValue(path, name);
        if (core::isNull(value)) return false;
        text = value.toString();
    }
    return true;
}

void reopen(const ado::ConnectionPtr& connection, const QString& connectionString) {
    if (connection->State() == ado::adStateOpen) connection->Close();
    connection->ConnectionString = connectionString;
    connection->Open();
}

// The texts go in as they stand, without quoting.
QString plainConnectionString(const LoginState& state) {
    return u"Provider=SQLOLEDB.1;Persist Security Info="_s + state.dtSecurityInfo + u";User ID="_s +
           state.dtUser + u";Password="_s + state.dtPassword + u";Initial Catalog="_s +
           state.dtInitialCatalog + u";Data Source="_s + state.dtDataSource +
           u";Connect Timeout=15"_s;
}

QString shapingConnectionString(const LoginState& state) {
    return u"Provider=MSDataShape.1;Persist Security Info="_s + state.dtSecurityInfo +
           u";Connect Timeout=15;Data Source="_s + state.dtDataSource + u";User ID="_s +
           state.dtUser + u";Password="_s + state.dtPassword + u";Initial Catalog="_s +
           state.dtInitialCatalog + u";Data Provider=SQLOLEDB.1"_s;
}

void reopenLists() {
    dtZelmars& environment = dtZelmars::instance();
    for (const QString& name : {u"msRubricas"_s, u"msHospitais"_s, u"msModosPagamento"_s,
                                u"msFamiliares"_s, u"msTipos"_s, u"msOutrasInstituicoes"_s}) {
        const ado::RecordsetPtr list = environment.Recordsets(name);
        if (list->State() != ado::adStateClosed) list->Close();
        list->Open(environment.Commands(name).CommandText, environment.SqlServer());
        list->Requery();
    }
}

}  // namespace

bool Login() {
    LoginState& state = loginState();
    state.bLoggedIn = false;
    if (!readConfiguration(state)) return false;
    reopen(dtZelmars::instance().MSAccess(), plainConnectionString(state));
    reopen(dtZelmars::instance().SqlServer(), shapingConnectionString(state));
    // Meant as it stands: a failure passed over before the login counts as a failed login.
    if (core::err().number() != 0) return false;
    state.bLoggedIn = true;
    reopenLists();
    return true;
}

}  // namespace boundary
