// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/Connection.h"

namespace companions {

/// Opens the book that this machine's registry names, for the user and password that the
/// registry names too. Fails with a text that says which value is missing, or with the engine's.
ado::ConnectionPtr reach();

/// The same book for another user.
ado::ConnectionPtr reach(const QString& user, const QString& password);

/// The connection of a component that has logged in. Fails with a text when there is none.
const ado::ConnectionPtr& loggedIn(const ado::ConnectionPtr& connection);

}  // namespace companions
