// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <QVariant>
#include <array>

#include "platform/registry/Registry.h"

/// Turns a full key path into the read of one value.
namespace boundary {

/// Reads a value, up to 254 characters long. The path loses its hive part on the way, so set it
/// anew before every read.
/// @return the text without the blanks in front (those behind stay); null when the key or the value
/// cannot be read; empty text when the path names no known hive.
QVariant GetRegistryValue(QString& strKeyPath, const QString& strValueName);

/// Splits "HIVE\path" in place: the hive goes to `hHive`, the rest stays. A path that does not
/// begin with "HKEY_" or ends with a backslash gets a message box and changes neither.
void ParseKeyPath(QString& strKeyPath, registry::Hive& hHive);

/// The handle of a hive's name, exact with case; Hive::None (0) for any other text.
registry::Hive GetHive(const QString& strHive);

/// What the registry's result codes mean, for a report of a failed read.
inline constexpr std::array<QStringView, 10> ResultTexts{
    u"A base de dados Registry está danificada!",
    u"Má nome da chave.",
    u"Não foi possível abrir a chave.",
    u"Impossível ler a chave.",
    u"O acesso a esta chave não é permitido.",
    u"Impossível escrever na chave.",
    u"Falta de memória.",
    u"Parametro inválido.",
    u"Existe mais informação do que aquela que foi definida na buffer.",
    u"Erro não reconhecível  ",
};

}  // namespace boundary
