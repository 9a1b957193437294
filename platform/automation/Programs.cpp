// SPDX-License-Identifier: MIT
#include "platform/automation/Programs.h"

#include <QDir>
#include <QFileInfo>
#include <QProcess>
#include <optional>

#include "platform/core/Configuration.h"
#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace automation {

namespace {
const QString FileName = u"programs.ini"_s;
}  // namespace

QString programsFile() {
    return core::configurationFiles(FileName).first();
}

QStringList programFor(const QString& path) {
    const QStringList files = core::configurationFiles(FileName);
    for (const QString& file : files) {
        const std::optional<QString> line = core::lineFor(path, file);
        if (!line) continue;
        const QStringList words = QProcess::splitCommand(*line);
        const QFileInfo program(words.value(0));
        if (words.isEmpty() || !program.isAbsolute() || !program.isExecutable() ||
            !program.isFile())
            throw core::Failure(
                core::InvalidCall,
                u"O programa «%1», que %2 indica para %3, não existe ou não se pode executar. "
                "Indique o seu caminho completo."_s.arg(words.value(0),
                                                        QDir::toNativeSeparators(file), path));
        return words;
    }
    throw core::Failure(core::InvalidCall,
                        u"Não se sabe que programa é %1. Escreva no ficheiro %2 (ou, para todos os "
                        "utilizadores, %3) uma linha como:\n%1 = /caminho/do/programa"_s.arg(
                            path, files.first(), files.last()));
}

}  // namespace automation
