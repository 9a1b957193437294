// SPDX-License-Identifier: MIT
#include "database/Book.h"

#include <QDir>
#include <QFile>
#include <QScopeGuard>

#include "database/SchemaText.h"
#include "database/Sqlite.h"
#include "database/SqliteBookWriter.h"
#include "database/sample/SampleBook.h"
#include "platform/core/Clock.h"
#include "platform/core/Failure.h"
#include "platform/registry/Registry.h"

using namespace Qt::StringLiterals;

namespace database {

namespace {

void removeBook(const QString& file) {
    for (const QString& suffix : {u""_s, u"-wal"_s, u"-shm"_s, u"-journal"_s})
        QFile::remove(file + suffix);
}

/// Makes the book under a name of its own first; the book's name appears when all of it stands.
void makeStaged(const QString& file, const std::function<void(sqlite::Database&)>& fill) {
    const QString staged = file + u".novo"_s;
    removeBook(staged);
    auto cleanup = qScopeGuard([&] { removeBook(staged); });
    {
        sqlite::Database book(staged, sqlite::Database::Mode::CreateNew);
        book.run("PRAGMA journal_mode=WAL; PRAGMA synchronous=FULL; BEGIN");
        book.run(schemaText(u"sqlite.sql"_s));
        book.run(schemaText(u"codes.sql"_s));
        book.run("COMMIT");
        if (fill) fill(book);
    }
    if (!QFile::rename(staged, file))  // never over an existing file
        throw core::Failure(core::InvalidCall, u"Não foi possível criar o livro «%1»."_s.arg(file));
    cleanup.dismiss();
}

}  // namespace

QString bookFile(const QString& folder, const QString& catalogue) {
    return QDir(folder).absoluteFilePath(catalogue + u".db"_s);
}

void createBook(const QString& folder, const QString& catalogue,
                const std::function<void(sqlite::Database&)>& fill) {
    const QString file = bookFile(folder, catalogue);
    if (QFile::exists(file) || QFileInfo(file).isSymLink())
        throw core::Failure(core::InvalidCall,
                            u"Já existe o livro «%1». Não foi alterado."_s.arg(file));
    const bool madeFolder = !QDir(folder).exists();
    if (!QDir().mkpath(folder))
        throw core::Failure(core::InvalidCall,
                            u"Não foi possível criar a pasta «%1»."_s.arg(folder));
    auto cleanup = qScopeGuard([&] {
        if (madeFolder) QDir().rmdir(folder);
    });
    makeStaged(file, fill);
    cleanup.dismiss();
}

void writeSettings(const LoginValues& values) {
    const QString key = u"SOFTWARE\\Norvanta\\Corvenda"_s;
    const auto write = [&](const QString& name, const QString& value) {
        registry::writeValue(registry::Hive::LocalMachine, key, name, value);
    };
    write(u"dtSecurityInfo"_s, u"True"_s);
    write(u"dtUser"_s, values.user);
    write(u"dtPassword"_s, values.password);
    write(u"dtInitialCatalog"_s, values.catalogue);
    write(u"dtDataSource"_s, values.dataSource);
}

void writeSettings(const QString& folder, const QString& catalogue) {
    writeSettings({u"zelmars"_s, {}, catalogue, u"sqlite:"_s + QDir(folder).absolutePath()});
}

void fillSample(const QString& folder, const QString& catalogue, const BookSizes& sizes,
                QDate asOf) {
    sqlite::Database book(bookFile(folder, catalogue), sqlite::Database::Mode::OpenExisting);
    if (book.number("SELECT EXISTS (SELECT 1 FROM tbSocios)"
                    " OR EXISTS (SELECT 1 FROM tbZelmar_Movimentos)") != 0)
        throw core::Failure(
            core::InvalidCall,
            u"O livro «%1» já tem associados ou movimentos."_s.arg(bookFile(folder, catalogue)));
    SqliteBookWriter writer(book);
    sample::fill(writer, sizes, asOf.isValid() ? asOf : core::today());
    writer.commit();
}

void initBook(const QString& folder, bool sample) {
    const QString catalogue = u"zelmars"_s;
    const bool madeFolder = !QDir(folder).exists();
    createBook(folder, catalogue);
    auto cleanup = qScopeGuard([&] {
        removeBook(bookFile(folder, catalogue));
        if (madeFolder) QDir().rmdir(folder);
    });
    if (sample) fillSample(folder, catalogue);
    writeSettings(folder, catalogue);
    cleanup.dismiss();
}

}  // namespace database
