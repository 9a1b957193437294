// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <QStringList>

namespace ado::sqlite {

/// Copies a book as it stands at one moment, whatever others write meanwhile, into a new file that
/// is complete and on the disk when it gets its name. Fails when there is a file of that name, and
/// leaves nothing then.
void backUp(const QString& book, const QString& file);

/// Fails unless the file is a whole database in which every page and index agrees and which has the
/// tables.
void prove(const QString& file, const QStringList& tables);

/// The number in the first row of a table in such a file; 0 when there is none.
qint64 numberIn(const QString& file, const QString& table, const QString& column);

/// Puts the content of such a file in the place of the book's, in one step; the book is made when
/// there is none.
void restore(const QString& file, const QString& book);

/// Who else on this machine has the book open, one entry a program.
QStringList othersIn(const QString& book);

}  // namespace ado::sqlite
