// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <functional>
#include <optional>

namespace registry {

/// The five values that name the book and its user. Every program of the house reads them at each
/// login; this is the one place that knows where they stand, what they are called and how they make
/// a connection string.
struct LoginValues {
    QString dtSecurityInfo = QStringLiteral("True");
    QString dtUser = {};
    QString dtPassword = {};
    QString dtInitialCatalog = {};
    QString dtDataSource = {};

    /// Their key below HKEY_LOCAL_MACHINE.
    static QString key() { return QStringLiteral("SOFTWARE\\Norvanta\\Corvenda"); }
    /// One of them as it is stored; nothing when it is missing. An empty one is not missing.
    static std::optional<QString> stored(const QString& name);

    /// Takes the five from `value`, which is asked for one after the other in the order above, and
    /// stops at the first that is missing; those before it stay. Fails as `value` does.
    /// @return the name of the missing one; empty when none is missing
    QString take(const std::function<std::optional<QString>(const QString& name)>& value = stored);
    /// Stores the five, all of them or none. Fails as writeValues does.
    void write() const;

    // The texts go in as they stand, without quoting.

    /// The string of a connection with the plain provider.
    QString connectionString() const;
    /// The string of a connection with the provider that understands SHAPE.
    QString shapingConnectionString() const;
};

}  // namespace registry
