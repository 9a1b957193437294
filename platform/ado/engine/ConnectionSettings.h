// SPDX-License-Identifier: MIT
#pragma once

#include <QHash>
#include <QString>

namespace ado {

/// The parts of "Key=Value;Key=Value", keys without regard to case. A later value replaces an
/// earlier one; a value may stand in quotes.
class ConnectionSettings {
public:
    explicit ConnectionSettings(const QString& text);
    /// Empty when the string has no such key.
    QString value(const QString& key) const { return values_.value(key.toLower()); }

private:
    QHash<QString, QString> values_;
};

}  // namespace ado
