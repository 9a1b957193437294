// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

namespace environment {

/// The component's state: one copy, shared by all `General` objects and all screens. The five texts
/// keep the values last read, also after a login that failed.
struct LoginState {
    QString dtSecurityInfo;
    QString dtUser;
    QString dtPassword;
    QString dtInitialCatalog;
    QString dtDataSource;
    /// True from the moment both connections opened without error until the next login begins.
    bool bLoggedIn = false;
};

LoginState& loginState();

}  // namespace environment
