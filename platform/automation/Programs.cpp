// SPDX-License-Identifier: MIT
#include "platform/automation/Programs.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QProcess>
#include <QStandardPaths>
#include <optional>

#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace automation {

namespace {

constexpr auto OfTheMachine = "/etc/zelmars/programs.ini"_L1;

/// What a file says about a path; nothing when it does not, or is not there.
std::optional<QString> lineFor(const QString& path, const QString& fileName) {
    QFile file(fileName);
    if (!file.open(QIODevice::ReadOnly)) return std::nullopt;
    while (!file.atEnd()) {
        const QString line = QString::fromUtf8(file.readLine()).trimmed();
        if (line.startsWith(u'#') || line.startsWith(u';')) continue;
        const qsizetype mark = line.indexOf(u'=');
        if (mark > 0 && line.first(mark).trimmed().compare(path, Qt::CaseInsensitive) == 0)
            return line.mid(mark + 1).trimmed();
    }
    return std::nullopt;
}

}  // namespace

QString programsFile() {
    return QStandardPaths::writableLocation(QStandardPaths::GenericConfigLocation) +
           u"/zelmars/programs.ini"_s;
}

QStringList programFor(const QString& path) {
    for (const QString& file : {programsFile(), QString(OfTheMachine)}) {
        const std::optional<QString> line = lineFor(path, file);
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
                            path, programsFile(), OfTheMachine));
}

}  // namespace automation
