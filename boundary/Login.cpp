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

/// Reads the five texts up to the first that is missing; those before it stay.
bool readConfiguration(LoginState& state) {
    const QString missing = state.take([](const QString& name) -> std::optional<QString> {
        QString path = u"HKEY_LOCAL_MACHINE\\"_s + LoginState::key();
        const QVariant value = GetRegistryValue(path, name);
        if (core::isNull(value)) return {};
        return value.toString();
    });
    return missing.isEmpty();
}

void reopen(const ado::ConnectionPtr& connection, const QString& connectionString) {
    if (connection->State() == ado::adStateOpen) connection->Close();
    connection->ConnectionString = connectionString;
    connection->Open();
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
    reopen(dtZelmars::instance().MSAccess(), state.connectionString());
    reopen(dtZelmars::instance().SqlServer(), state.shapingConnectionString());
    // Intentional: a failure that was passed over before the login counts as a failed login, so
    // that no operation begins on top of one.
    if (core::err().number() != 0) return false;
    state.bLoggedIn = true;
    reopenLists();
    return true;
}

}  // namespace boundary
