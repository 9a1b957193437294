// SPDX-License-Identifier: MIT
#pragma once

#include <QList>
#include <QString>
#include <optional>
#include <utility>

/// Hives of named text values, kept in files: `HKEY_LOCAL_MACHINE.ini` and its companions, one INI
/// file a hive, a key's path as the group. Where they lie:
///   - the folder named by the environment variable ZELMARS_REGISTRY, and nowhere else, if it is
///   set;
///   - otherwise $XDG_CONFIG_HOME/zelmars/registry/ of the user, and below it, for what is missing
///     there, /etc/zelmars/registry/ of the machine.
/// A missing value and an empty one stay apart. A file that cannot be understood, or that holds a
/// password and is open to others, is refused with a core::Failure that names it. SettingsFile.h
/// tells how a file is written.
namespace registry {

/// The handles of the hives; 0 is none.
enum class Hive : quint32 {
    None = 0,
    ClassesRoot = 0x80000000,
    CurrentUser = 0x80000001,
    LocalMachine = 0x80000002,
    Users = 0x80000003,
    PerformanceData = 0x80000004,
    CurrentConfig = 0x80000005,
    DynData = 0x80000006,
};

/// The hive of a name, exact with case; None for any other text.
Hive hiveNamed(QStringView name);

/// An open key. Closing it twice, or never, does no harm.
class Key {
public:
    /// Opens a key for reading; nothing when no value lies under it. An empty path is the hive
    /// itself, which always opens.
    static std::optional<Key> open(Hive hive, const QString& path);

    /// The text of a value; nothing when it is missing. A backslash-separated path names the key.
    std::optional<QString> value(const QString& name) const;

private:
    Key(Hive hive, const QString& path) : hive_(hive), path_(path) {}
    Hive hive_;
    QString path_;
};

/// Characters of the longest value that a login reads; a longer one counts as missing.
inline constexpr int LongestValue = 254;

/// Names of values and what they hold.
using Values = QList<std::pair<QString, QString>>;

/// Writes values into the folder that belongs to the user (or to ZELMARS_REGISTRY): all of them or,
/// when it fails or the program ends meanwhile, none. The file is readable by its owner only. A
/// file that others can read is refused with a Failure whose text names it and the command that
/// mends it, so that a password never lands in an open file.
void writeValues(Hive hive, const QString& path, const Values& values);
/// The same for one value; an empty name is the key's own value.
void writeValue(Hive hive, const QString& path, const QString& name, const QString& value);

/// Removes a key, or a value, with all that lies under it. One that is not there does no harm.
void removeKey(Hive hive, const QString& path);

/// The folder that writeValue writes to.
QString writableFolder();

}  // namespace registry
