// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/postgres/BulkAccess.h"

/// Who may do what in a book on a server.
namespace database {

// Nobody logs in as one of these.
QString ownerRole(const QString& catalogue);    ///< owns the book's tables
QString managerRole(const QString& catalogue);  ///< is given to those who manage the book

/// Fails unless the one who entered is an administrator of the server.
void refuseOthersThanAdministrator(ado::postgres::BulkAccess& server, const QString& user);

/// Gives an operator and the managers of a book their rights, and takes from them all others. The
/// roles have to be there.
void giveRights(ado::postgres::BulkAccess& book, const QString& catalogue, const QString& worker);

/// Gives those who are operators of a book already, and its managers, the rights of a new book. A
/// book without operators, as the server's owner may use it alone, stays without.
void renewRights(ado::postgres::BulkAccess& book, const QString& catalogue);

/// What is made until RESET ROLE, or the end of the transaction, belongs to the book's owner.
void becomeOwner(ado::postgres::BulkAccess& book);

}  // namespace database
