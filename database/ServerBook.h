// SPDX-License-Identifier: MIT
#pragma once

#include "database/Book.h"
#include "platform/ado/postgres/Address.h"

/// Makes books on a PostgreSQL server. Every failure is a core::Failure with a Portuguese text or
/// the server's own.
namespace database {

/// Makes the tables of an empty book in an existing catalogue: code lists, and counters that start
/// at 1. Fails, changing nothing, when tables of a book are there already.
void createBook(const ado::postgres::Address& catalogue);

/// Fills an empty book with the sample content, the same as in a file. Fails, leaving the book as
/// it was, if it has members already.
void fillSample(const ado::postgres::Address& catalogue, const BookSizes& sizes = {},
                QDate asOf = {});

/// Who works with a new book on a server.
struct ServerOperator {
    QString user;  ///< made with the password if the server does not know it
    QString password;
};

/// `zelmars init --server`: makes the catalogue if it is missing, the book in it, with or without
/// the sample content, a role that owns the book (the catalogue's name and "_dono"; nobody logs in
/// as it), a role for those who manage it ("_gestor", which the administrator gives), and the
/// operator, who may do what the daily screens do and nothing else. Logs in as the operator to see
/// that it works, and writes the five values that name the book. `catalogue` is entered by its
/// user, who must be an administrator of the server. Nothing stays behind a failure; a call that
/// was cut off is ended by the same call.
void initBook(const ado::postgres::Address& catalogue, const ServerOperator& worker, bool sample);

}  // namespace database
