// SPDX-License-Identifier: MIT
#include "platform/registry/Registry.h"

#include <QFileInfo>
#include <QLockFile>
#include <QStandardPaths>
#include <algorithm>
#include <array>

#include "platform/core/Failure.h"
#include "platform/core/PrivateFiles.h"
#include "platform/registry/SettingsFile.h"

using namespace Qt::StringLiterals;

namespace registry {

namespace {

constexpr std::array<std::pair<Hive, QStringView>, 7> HiveNames{{
    {Hive::ClassesRoot, u"HKEY_CLASSES_ROOT"},
    {Hive::CurrentUser, u"HKEY_CURRENT_USER"},
    {Hive::LocalMachine, u"HKEY_LOCAL_MACHINE"},
    {Hive::Users, u"HKEY_USERS"},
    {Hive::PerformanceData, u"HKEY_PERFORMANCE_DATA"},
    {Hive::CurrentConfig, u"HKEY_CURRENT_CONFIG"},
    {Hive::DynData, u"HKEY_DYN_DATA"},
}};

/// The administrator's folder, for all users of the machine.
const QString MachineFolder = u"/etc/zelmars/registry"_s;

/// The folders that are read, the one that overrides the others first.
QStringList readFolders() {
    const QString own = writableFolder();
    if (!qEnvironmentVariableIsEmpty("ZELMARS_REGISTRY")) return {own};
    return {own, MachineFolder};
}

QString hiveName(Hive hive) {
    for (const auto& [known, name] : HiveNames)
        if (known == hive) return name.toString();
    return {};
}

QString fileOf(const QString& folder, Hive hive) {
    return folder + u'/' + hiveName(hive) + u".ini"_s;
}

SettingsFile fileIn(const QString& folder, Hive hive) {
    using Readers = SettingsFile::Readers;
    return SettingsFile(fileOf(folder, hive),
                        folder == MachineFolder ? Readers::Group : Readers::Owner);
}

/// A key's path, or a value's, as the settings file spells it. The value without a name stands
/// under the path of its key.
QString entryName(QString path, const QString& name) {
    path.replace(u'\\', u'/');
    if (path.isEmpty()) return name;
    return name.isEmpty() ? path : path + u'/' + name;
}

[[noreturn]] void refuseToWrite(const QString& file, const QString& why) {
    throw core::Failure(core::InvalidCall,
                        u"Não foi possível guardar o valor no ficheiro %1: %2"_s.arg(file, why));
}

/// How long another program is given to write the same file, in milliseconds.
constexpr int LockWait = 10'000;

/// A settings file that is about to be changed. Meanwhile nobody else changes it.
class ChangedFile {
public:
    explicit ChangedFile(const QString& name) : lock_(prepared(name) + u".lock"_s) {
        if (!lock_.tryLock(LockWait))
            refuseToWrite(name,
                          u"a pasta não se deixa escrever, ou outro programa está a "
                          "escrevê-lo."_s);
        file.emplace(name);
    }

    std::optional<SettingsFile> file;

private:
    /// Makes the folder where it is missing, and refuses a file that others can read before a
    /// password lands in it.
    static const QString& prepared(const QString& name) {
        if (!core::makePrivateFolder(QFileInfo(name).path()))
            refuseToWrite(name, u"a pasta não pôde ser criada."_s);
        if (QFile::exists(name) && !core::isPrivate(name))
            refuseToWrite(name,
                          u"outros utilizadores têm acesso a ele, e pode conter uma palavra "
                          "passe. Corrija-o com o comando: chmod 600 '%1'"_s.arg(name));
        return name;
    }

    QLockFile lock_;
};

}  // namespace

Hive hiveNamed(QStringView name) {
    for (const auto& [hive, known] : HiveNames)
        if (known == name) return hive;
    return Hive::None;
}

QString writableFolder() {
    const QString chosen = qEnvironmentVariable("ZELMARS_REGISTRY");
    if (!chosen.isEmpty()) return chosen;
    return QStandardPaths::writableLocation(QStandardPaths::GenericConfigLocation) +
           u"/zelmars/registry"_s;
}

std::optional<Key> Key::open(Hive hive, const QString& path) {
    const QString name = entryName(path, {});
    if (name.isEmpty()) return Key(hive, path);
    for (const QString& folder : readFolders()) {
        const QStringList settings = fileIn(folder, hive).settings();
        if (std::any_of(settings.begin(), settings.end(),
                        [&](const QString& setting) { return liesUnder(setting, name); }))
            return Key(hive, path);
    }
    return std::nullopt;
}

std::optional<QString> Key::value(const QString& name) const {
    const QString wanted = entryName(path_, name);
    for (const QString& folder : readFolders()) {
        if (const auto text = fileIn(folder, hive_).value(wanted)) return text;
    }
    return std::nullopt;
}

void writeValues(Hive hive, const QString& path, const Values& values) {
    ChangedFile changed(fileOf(writableFolder(), hive));
    for (const auto& [name, value] : values) changed.file->set(entryName(path, name), value);
    changed.file->write();
}

void writeValue(Hive hive, const QString& path, const QString& name, const QString& value) {
    writeValues(hive, path, {{name, value}});
}

void removeKey(Hive hive, const QString& path) {
    const QString name = fileOf(writableFolder(), hive);
    if (!QFile::exists(name)) return;
    ChangedFile changed(name);
    changed.file->remove(entryName(path, {}));
    changed.file->write();
}

}  // namespace registry
