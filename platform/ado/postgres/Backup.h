// SPDX-License-Identifier: MIT
#pragma once

#include <QStringList>

#include "platform/ado/postgres/Address.h"

namespace ado::postgres {

/// True when the server's own programs for backups are installed on this machine.
bool canBackUp();

/// Copies a book as it stands at one moment into a new file, by the server's own program. Fails
/// when there is a file of that name, and leaves nothing then.
void backUp(const Address& book, const QString& file);

/// Fails unless the file is such a copy and has the tables.
void prove(const QString& file, const QStringList& tables);

/// The number in the first row of a table in such a file; 0 when there is none.
qint64 numberIn(const QString& file, const QString& table, const QString& column);

/// True when such a file has the table.
bool hasTable(const QString& file, const QString& table);

/// Puts the content of such a file in the place of the book's, in one step. The catalogue has to be
/// there; the address is its administrator's.
void restore(const QString& file, const Address& book);

/// Who else has the book open, one entry a connection of another program. Whom the server does not
/// let this user see is "outro posto".
QStringList othersIn(const Address& book);

}  // namespace ado::postgres
