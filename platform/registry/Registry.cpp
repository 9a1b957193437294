// SPDX-License-Identifier: MIT
#include "platform/registry/Registry.h"

#include <QDir>
#include <QFileInfo>
#include <QSettings>
#include <QStandardPaths>
#include <QStringList>
#include <algorithm>
#include <array>

#include "platform/core/Failure.h"

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

/// The folders that are read, the one that overrides the others first.
QStringList readFolders() {
    const QString own = writableFolder();
    if (!qEnvironmentVariableIsEmpty("ZELMARS_REGISTRY")) return {own};
    return {own, u"/etc/zelmars/registry"_s};
}

QString fileOf(const QString& folder, Hive hive) {
    return folder + u'/' + hiveName(hive) + u".ini"_s;
}

/// A key's path, or a value's, as the settings file spells it. The value without a name stands
/// under the path of its key.
QString entryName(QString path, const QString& name) {
    path.replace(u'\\', u'/');
    if (path.isEmpty()) return name;
    return name.isEmpty() ? path : path + u'/' + name;
}

/// True for the entry itself and for all that lies under it; for an empty name for everything.
bool liesUnder(const QString& entry, const QString& name) {
    return name.isEmpty() || entry.compare(name, Qt::CaseInsensitive) == 0 ||
           entry.startsWith(name + u'/', Qt::CaseInsensitive);
}

/// The entry of that name as the file spells it: names are found without regard to case.
QString spelling(const QSettings& file, const QString& name) {
    for (const QString& entry : file.allKeys())
        if (entry.compare(name, Qt::CaseInsensitive) == 0) return entry;
    return {};
}

/// A text with commas that somebody typed into the file without quotes arrives as a list.
QString text(const QVariant& stored) {
    return stored.typeId() == QMetaType::QStringList ? stored.toStringList().join(u',')
                                                     : stored.toString();
}

[[noreturn]] void refuseToWrite(const QString& file, const QString& why) {
    throw core::Failure(core::InvalidCall,
                        u"Não foi possível guardar o valor no ficheiro %1: %2"_s.arg(file, why));
}

/// Makes the file, readable by its owner only, before anything is written to it.
void prepareForSecrets(const QString& name) {
    QFile file(name);
    constexpr QFile::Permissions ownerOnly = QFile::ReadOwner | QFile::WriteOwner;
    if (!file.exists()) {
        QDir().mkpath(QFileInfo(name).path());
        if (!file.open(QFile::WriteOnly | QFile::NewOnly, ownerOnly))
            refuseToWrite(name, file.errorString());
        return;
    }
    constexpr QFile::Permissions others = QFile::ReadGroup | QFile::WriteGroup | QFile::ExeGroup |
                                          QFile::ReadOther | QFile::WriteOther | QFile::ExeOther;
    if (file.permissions() & others)
        refuseToWrite(name,
                      u"outros utilizadores têm acesso a ele, e pode conter uma palavra "
                      "passe. Corrija-o com o comando: chmod 600 '%1'"_s.arg(name));
}

void writeOut(QSettings& file) {
    file.sync();
    if (file.status() != QSettings::NoError)
        refuseToWrite(file.fileName(), u"o ficheiro não pôde ser escrito."_s);
}

}  // namespace

Hive hiveNamed(QStringView name) {
    for (const auto& [hive, known] : HiveNames)
        if (known == name) return hive;
    return Hive::None;
}

QString hiveName(Hive hive) {
    for (const auto& [known, name] : HiveNames)
        if (known == hive) return name.toString();
    return {};
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
        const QStringList entries = QSettings(fileOf(folder, hive), QSettings::IniFormat).allKeys();
        if (std::any_of(entries.begin(), entries.end(),
                        [&](const QString& entry) { return liesUnder(entry, name); }))
            return Key(hive, path);
    }
    return std::nullopt;
}

std::optional<QString> Key::value(const QString& name) const {
    const QString wanted = entryName(path_, name);
    for (const QString& folder : readFolders()) {
        const QSettings file(fileOf(folder, hive_), QSettings::IniFormat);
        const QString entry = spelling(file, wanted);
        if (!entry.isEmpty()) return text(file.value(entry));
    }
    return std::nullopt;
}

void writeValue(Hive hive, const QString& path, const QString& name, const QString& value) {
    const QString fileName = fileOf(writableFolder(), hive);
    prepareForSecrets(fileName);
    QSettings file(fileName, QSettings::IniFormat);
    const QString wanted = entryName(path, name);
    const QString entry = spelling(file, wanted);
    file.setValue(entry.isEmpty() ? wanted : entry, value);
    writeOut(file);
}

void removeKey(Hive hive, const QString& path) {
    const QString fileName = fileOf(writableFolder(), hive);
    if (!QFile::exists(fileName)) return;
    QSettings file(fileName, QSettings::IniFormat);
    for (const QString& entry : file.allKeys())
        if (liesUnder(entry, entryName(path, {}))) file.remove(entry);
    writeOut(file);
}

}  // namespace registry
