// SPDX-License-Identifier: MIT
#pragma once

#include <QStringList>
#include <QTemporaryDir>

#include "database/Copy.h"

/// A book as the first program made it, with a few rows in each table; of version 1. On a server it
/// is the catalogue NAME with its owner "NAME_dono" and the operator "posto_NAME".
class FirstBook {
public:
    static database::BookPlace inFile(const QString& folder);
    static database::BookPlace onServer(const QString& name);
    /// A place on the run's server, entered by its administrator.
    static database::BookPlace placeOnServer(const QString& name);

    /// Every row of every table that the first program knew, as texts.
    static QStringList rowsOf(const database::BookPlace& place);
    /// Tables, columns, types, keys, indexes, views and where keys go on, and on a server owners
    /// and rights, as texts; the catalogue's own name in them is "X".
    static QStringList schemaOf(const database::BookPlace& place);
};
