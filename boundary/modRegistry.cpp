// SPDX-License-Identifier: MIT
#include "boundary/modRegistry.h"

#include "platform/core/MsgBox.h"

using namespace Qt::StringLiterals;

namespace boundary {

namespace {

/// The hive of the last path that could be split; a path that cannot goes on with it.
thread_local registry::Hive currentHive = registry::Hive::None;

/// The text as the buffer gives it back: blanks are trimmed before the closing zero is dropped, so
/// the zero shields those at the end.
QString trimmedUpToTheZero(const QString& stored) {
    qsizetype first = 0;
    while (first < stored.size() && stored[first] == u' ') ++first;
    return u""_s + stored.mid(first);
}

}  // namespace

QVariant GetRegistryValue(QString& strKeyPath, const QString& strValueName) {
    ParseKeyPath(strKeyPath, currentHive);
    if (currentHive == registry::Hive::None) return u""_s;
    const auto key = registry::Key::open(currentHive, strKeyPath);
    if (!key) return {};
    const std::optional<QString> stored = key->value(strValueName);
    if (!stored || stored->size() > registry::LongestValue) return {};
    return trimmedUpToTheZero(*stored);
}

void ParseKeyPath(QString& strKeyPath, registry::Hive& hHive) {
    const qsizetype backslash = strKeyPath.indexOf(u'\\');
    if (!strKeyPath.startsWith("HKEY_"_L1) || strKeyPath.endsWith(u'\\')) {
        core::MsgBox(u"Formato Incorrecto:\n\n"_s + strKeyPath);
        return;
    }
    if (backslash >= 0) {
        hHive = GetHive(strKeyPath.left(backslash));
        strKeyPath = strKeyPath.mid(backslash + 1);
    } else {
        hHive = GetHive(strKeyPath);
        strKeyPath = u""_s;
    }
}

registry::Hive GetHive(const QString& strHive) {
    return registry::hiveNamed(strHive);
}

}  // namespace boundary
