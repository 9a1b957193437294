// SPDX-License-Identifier: MIT
#include "host/BookTasks.h"

#include <unistd.h>

#include <csignal>

#include "database/Backup.h"
#include "database/Book.h"
#include "database/Check.h"
#include "database/Copy.h"
#include "database/QuickCheck.h"
#include "database/Schema.h"
#include "database/ServerBook.h"
#include "database/Upgrade.h"
#include "database/Version.h"
#include "host/BookSettings.h"
#include "host/Console.h"
#include "host/Password.h"
#include "platform/core/Failure.h"
#include "platform/core/Format.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

void enterAsAdministrator(database::BookPlace& place, const QString& admin) {
    place.server.user = admin;
    place.server.password =
        password(AdminPasswordVariable,
                 u"Palavra-passe de «%1» em %2 (vazia, se o servidor não a pedir): "_s.arg(
                     admin, place.shown()));
}

volatile std::sig_atomic_t interrupted = 0;

/// While it lives, Ctrl+C does not end the program: it is noted, and the copying stops at the next
/// step and clears up behind itself.
class Interruptible {
public:
    Interruptible() {
        for (const int signal : {SIGINT, SIGTERM})
            std::signal(signal, [](int) { interrupted = 1; });
    }
    ~Interruptible() {
        for (const int signal : {SIGINT, SIGTERM}) std::signal(signal, SIG_DFL);
    }
    Interruptible(const Interruptible&) = delete;
    Interruptible& operator=(const Interruptible&) = delete;
};

/// At a terminal one line that changes; elsewhere, as in a file, one line for each table.
void showProgress(const database::CopyProgress& progress) {
    if (interrupted) throw core::Failure(core::InvalidCall, u"a cópia foi interrompida."_s);
    static const bool isTerminal = isatty(STDOUT_FILENO);
    if (!isTerminal && !progress.isTableDone) return;
    const qint64 percent = progress.total == 0 ? 100 : progress.allRows * 100 / progress.total;
    const QString line =
        u"%1 %  %2: %3 linhas"_s.arg(percent, 3).arg(progress.table, core::grouped(progress.rows));
    if (isTerminal)
        QTextStream(stdout) << '\r' << line << "\x1b[K" << (progress.isTableDone ? "\n" : "")
                            << Qt::flush;
    else
        say(line);
}

const QString Administrator = u"postgres"_s;

/// The version that a book must have, and what a quick look finds.
int tellQuickFindings(ado::BulkAccess& book, const database::BookPlace& place) {
    const QString unfit = database::whyUnfit(database::schemaVersion(book), place);
    const QStringList findings =
        unfit.isEmpty() ? database::quickFindings(book) : QStringList(unfit);
    for (const QString& finding : findings) say(finding);
    if (findings.isEmpty()) say(u"Não foi encontrado nenhum erro, à primeira vista."_s);
    return findings.isEmpty() ? 0 : 1;
}

}  // namespace

database::BookPlace placeOf(const CommandLine& line, bool asAdministrator) {
    database::BookPlace place =
        line.book.isEmpty() ? BookSettings::read().place() : database::BookPlace::parsed(line.book);
    const bool isKnown = line.book.isEmpty() && line.admin.isEmpty() && !asAdministrator;
    if (place.isOnServer() && !isKnown)
        enterAsAdministrator(place, line.admin.isEmpty() ? Administrator : line.admin);
    return place;
}

int checkBook(const CommandLine& line) {
    constexpr int CouldNotLook = 2;
    try {
        const database::BookPlace place = placeOf(line, false);
        const std::unique_ptr<ado::BulkAccess> book = database::opened(place);
        say(u"Livro: %1"_s.arg(place.shown()));
        if (line.quick) return tellQuickFindings(*book, place);
        const database::CheckSummary summary =
            database::checkBook(*book, [](const QString& finding) { say(finding); });
        say(database::summaryText(summary));
        return summary.findings == 0 ? 0 : 1;
    } catch (const core::Failure& failure) {
        complain(failure.text());
        return CouldNotLook;
    }
}

void backUpBook(const CommandLine& line) {
    const database::BookPlace place = placeOf(line, false);
    const QString file = QFileInfo(line.file).absoluteFilePath();
    database::backUpBook(place, file);
    say(u"Cópia de segurança de %1 em %2"_s.arg(place.shown(), file));
}

void restoreBook(const CommandLine& line) {
    const database::BookPlace place = placeOf(line, true);
    const QString file = QFileInfo(line.file).absoluteFilePath();
    database::restoreBook(file, place, line.replace);
    say(u"Livro %1 reposto a partir de %2"_s.arg(place.shown(), file));
    const int version = database::versionInBackup(file, place);
    if (const QString unfit = database::whyUnfit(version, place); !unfit.isEmpty()) say(unfit);
}

void upgradeBook(const CommandLine& line) {
    const database::BookPlace place = placeOf(line, true);
    const int version = database::schemaVersion(*database::opened(place));
    const QString file = line.file.isEmpty() ? database::upgradeBackupFile(place, version)
                                             : QFileInfo(line.file).absoluteFilePath();
    const int from = database::bringUpToDate(place, file, say);
    if (from == database::SchemaVersion)
        say(u"O livro %1 já é da versão %2; não havia nada a fazer."_s.arg(place.shown())
                .arg(database::SchemaVersion));
    else
        say(u"Livro %1 atualizado."_s.arg(place.shown()));
}

void makeBook(const CommandLine& line) {
    const QString folder = QDir(line.folder).absolutePath();
    if (line.ifNeeded && BookSettings::read().isComplete) return;
    const QString catalogue = u"zelmars"_s;
    if (line.ifNeeded && QFile::exists(database::bookFile(folder, catalogue))) {
        database::writeSettings(folder, catalogue);
        return;
    }
    const database::BookOwners owners =
        line.group.isEmpty() ? database::BookOwners() : database::BookOwners(line.group);
    database::initBook(folder, line.sample, owners);
    say(u"Livro feito em %1"_s.arg(database::bookFile(folder, catalogue)));
}

void makeServerBook(const CommandLine& line) {
    auto place = database::BookPlace::parsed(line.server + u'/' + line.catalogue);
    if (!place.isOnServer())
        throw core::Failure(
            core::InvalidCall,
            u"«%1» não é um servidor; a forma é «postgresql:SERVIDOR[:PORTA]»."_s.arg(line.server));
    enterAsAdministrator(place, line.admin);
    const database::ServerOperator worker{
        line.user,
        password(UserPasswordVariable, u"Palavra-passe do operador «%1»: "_s.arg(line.user))};
    database::initBook(place.server, worker, line.sample);
    say(u"Livro feito em %1. O programa passa a usá-lo como «%2»."_s.arg(place.shown(),
                                                                         worker.user));
}

void copyBook(const CommandLine& line) {
    auto from = database::BookPlace::parsed(line.from);
    auto into = database::BookPlace::parsed(line.into);
    if (from.isOnServer()) enterAsAdministrator(from, line.admin);
    if (into.isOnServer()) enterAsAdministrator(into, line.admin);
    const Interruptible interruptible;
    const database::CopySummary summary = database::copyBook(from, into, showProgress);
    say(u"Copiado de %1 para %2: %3 tabelas, %4 linhas. Os números de linhas e as somas de %5 "
        "colunas de montantes são iguais nos dois livros."_s.arg(
            from.shown(), into.shown(), core::grouped(summary.tables), core::grouped(summary.rows),
            core::grouped(summary.sums)));
}

}  // namespace host
