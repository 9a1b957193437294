// SPDX-License-Identifier: MIT
#include "platform/ado/postgres/Backup.h"

#include <libpq-fe.h>

#include <QFile>
#include <QFileInfo>
#include <QProcess>
#include <QStandardPaths>

#include "platform/ado/engine/RowHolders.h"
#include "platform/ado/postgres/Handle.h"
#include "platform/core/Failure.h"
#include "platform/core/NewFile.h"

namespace ado::postgres {

using namespace Qt::StringLiterals;

namespace {

const QString Dump = u"pg_dump"_s;
const QString Restore = u"pg_restore"_s;

/// Where the program lies; empty when it is not installed.
QString found(const QString& program) {
    return QStandardPaths::findExecutable(program);
}

/// Runs one of the server's programs; gives what it wrote.
QByteArray run(const QString& program, const QStringList& arguments, const QString& password,
               const QString& what) {
    if (found(program).isEmpty())
        throw core::Failure(
            core::InvalidCall,
            what +
                u" Falta o programa «%1» nesta máquina (pacote postgresql-client)."_s.arg(program));
    QProcess process;
    QProcessEnvironment surroundings = QProcessEnvironment::systemEnvironment();
    surroundings.insert(u"PGPASSWORD"_s, password);
    process.setProcessEnvironment(surroundings);
    process.start(found(program), arguments, QIODevice::ReadOnly);
    process.waitForFinished(-1);
    if (process.exitStatus() == QProcess::NormalExit && process.exitCode() == 0)
        return process.readAllStandardOutput();
    throw core::Failure(
        core::DatabaseFailure,
        what + u' ' + QString::fromUtf8(process.readAllStandardError()).simplified());
}

QStringList placeOf(const Address& book) {
    QStringList place{u"--no-password"_s, u"--host"_s,   book.host,   u"--username"_s,
                      book.user,          u"--dbname"_s, book.catalog};
    if (!book.port.isEmpty()) place << u"--port"_s << book.port;
    return place;
}

/// What the file holds, one thing a line, in lower case.
QByteArray contentOf(const QString& file, const QString& what) {
    return run(Restore, {u"--list"_s, file}, {}, what).toLower();
}

bool lists(const QByteArray& content, const QString& table) {
    return content.contains(" table data public " + table.toLower().toUtf8() + ' ');
}

}  // namespace

bool canBackUp() {
    return !found(Dump).isEmpty();
}

void backUp(const Address& book, const QString& file) {
    const QString what = u"Não foi possível fazer a cópia de segurança «%1»."_s.arg(file);
    const core::NewFile made(file, what);
    // The journal of operations has policies, which let everybody read it.
    run(Dump,
        placeOf(book) << u"--format=custom"_s << u"--enable-row-security"_s << u"--file"_s
                      << made.staged(),
        book.password, what);
    made.commit();
}

void prove(const QString& file, const QStringList& tables) {
    const QString what = u"«%1» não é uma cópia de segurança inteira de um livro."_s.arg(file);
    const QByteArray content = contentOf(file, what);
    for (const QString& table : tables)
        if (!lists(content, table))
            throw core::Failure(core::DatabaseFailure, what + u" Falta a tabela %1."_s.arg(table));
    // All of it can be read to its end.
    run(Restore, {u"--file=/dev/null"_s, file}, {}, what);
}

bool hasTable(const QString& file, const QString& table) {
    return lists(contentOf(file, u"Não foi possível ler a cópia de segurança «%1»."_s.arg(file)),
                 table);
}

qint64 numberIn(const QString& file, const QString& table, const QString& column) {
    const QString what = u"Não foi possível ler a cópia de segurança «%1»."_s.arg(file);
    const QStringList lines =
        QString::fromUtf8(
            run(Restore, {u"--data-only"_s, u"--table"_s, table, u"--file=-"_s, file}, {}, what))
            .split(u'\n');
    // "COPY public.tbversao (versao, _linha) FROM stdin;", and then the rows, parted by tabs.
    for (qsizetype at = 0; at + 1 < lines.size(); ++at) {
        const QStringList columns = lines[at].section(u'(', 1).section(u')', 0, 0).split(u", "_s);
        if (lines[at].startsWith("COPY "_L1) && columns.contains(column))
            return lines[at + 1].split(u'\t').value(columns.indexOf(column)).toLongLong();
    }
    return 0;
}

void restore(const QString& file, const Address& book) {
    run(Restore,
        placeOf(book) << u"--clean"_s << u"--if-exists"_s << u"--single-transaction"_s
                      << u"--exit-on-error"_s << file,
        book.password, u"Não foi possível repor o livro «%1»."_s.arg(book.shown()));
}

QStringList othersIn(const Address& book) {
    Handle handle(book, Handle::Role::Reader);
    QByteArray own;
    for (const int backend : Handle::ownBackends())
        own += (own.isEmpty() ? "" : ",") + QByteArray::number(backend);
    const Result rows = handle.runOnce(
        "SELECT coalesce(application_name, '') FROM pg_stat_activity WHERE datname = "
        "current_database() AND (backend_type = 'client backend' OR backend_type IS NULL) AND pid "
        "NOT IN (" +
        own + ") ORDER BY 1");
    QStringList others;
    for (int row = 0; row < PQntuples(rows.get()); ++row) {
        const QString name = QString::fromUtf8(PQgetvalue(rows.get(), row, 0));
        others << (name.isEmpty() ? OtherWorkstation : name);
    }
    return others;
}

}  // namespace ado::postgres
