// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

namespace database {

/// A catalogue of a PostgreSQL server and who owns it.
struct ServerCatalogue {
    QString host;  ///< a name, an address, or a folder with the server's local socket
    QString port;  ///< empty for the server's usual one
    QString user;
    QString password;
    QString name;
};

/// Makes the tables of an empty book in an existing catalogue: code lists, and counters that start
/// at 1. Fails with a core::Failure, changing nothing, when tables of a book are there already.
void createBook(const ServerCatalogue& catalogue);

}  // namespace database
