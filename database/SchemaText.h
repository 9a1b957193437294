// SPDX-License-Identifier: MIT
#pragma once

#include <QByteArray>
#include <QString>

namespace database {

/// A file of the folder schema, as it was when the program was built. Fails when it is missing.
QByteArray schemaText(const QString& name);

}  // namespace database
