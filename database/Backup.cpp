// SPDX-License-Identifier: MIT
#include "database/Backup.h"

#include <QFile>

#include "database/Book.h"
#include "database/Schema.h"
#include "database/Version.h"
#include "platform/ado/postgres/Backup.h"
#include "platform/ado/postgres/BulkAccess.h"
#include "platform/ado/sqlite/Backup.h"
#include "platform/ado/sqlite/BulkAccess.h"
#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace database {

namespace {

/// Without these a file is no book.
const QStringList Tables{u"tbZelmar_Movimentos"_s,
                         u"tbZelmar_Movimentos_Inactivos"_s,
                         u"tbZelmar_Movimentos_Historico"_s,
                         u"tbSocios"_s,
                         u"tbZelmar_Plafonds"_s,
                         u"tbContadores"_s};

QString fileOf(const BookPlace& book) {
    return bookFile(book.folder, book.name);
}

void refuseFilled(const BookPlace& book) {
    const auto isFilled = [](ado::BulkAccess& opened) {
        return opened.number(
                   "SELECT CASE WHEN EXISTS (SELECT 1 FROM tbSocios) OR EXISTS (SELECT 1 FROM "
                   "tbZelmar_Movimentos) THEN 1 ELSE 0 END") != 0;
    };
    if (book.isOnServer()) {
        ado::postgres::BulkAccess opened(book.server);
        if (!isFilled(opened)) return;
    } else if (!QFile::exists(fileOf(book))) {
        return;
    }
    throw core::Failure(core::InvalidCall,
                        u"Já existe o livro «%1». Para o substituir pela cópia, acrescente "
                        "«--replace»: o que ele tem agora perde-se."_s.arg(book.shown()));
}

void refuseNewerBackup(const QString& file, const BookPlace& book) {
    if (const int version = versionInBackup(file, book); version > SchemaVersion)
        throw core::Failure(core::InvalidCall, newerText(version, file));
}

/// A server's own program leaves the tables alone that an older backup does not know. The book must
/// not pass for newer than its content, also where the work ends in between, since the steps to a
/// newer version may be taken twice; and the operations of its journal are those of other
/// movements.
void restoreOnServer(const QString& file, const BookPlace& book) {
    const std::unique_ptr<ado::BulkAccess> opened = openedAnyway(book);
    const std::set<QByteArray> parts = opened->parts();
    if (parts.contains("tbversao"))
        opened->execute("UPDATE tbVersao SET versao = " +
                        QByteArray::number(versionInBackup(file, book)));
    ado::postgres::restore(file, book.server);
    if (parts.contains("tboperacoes") && !ado::postgres::hasTable(file, u"tbOperacoes"_s))
        opened->execute("DELETE FROM tbOperacoes");
}

}  // namespace

int versionInBackup(const QString& file, const BookPlace& book) {
    const auto numberIn = book.isOnServer() ? ado::postgres::numberIn : ado::sqlite::numberIn;
    return qMax(1, static_cast<int>(numberIn(file, u"tbversao"_s, u"versao"_s)));
}

bool canBackUp(const BookPlace& book) {
    return !book.isOnServer() || ado::postgres::canBackUp();
}

void backUpBook(const BookPlace& book, const QString& file) {
    opened(book);  // fails for one that is not there, or is newer than the program
    if (book.isOnServer()) return ado::postgres::backUp(book.server, file);
    ado::sqlite::backUp(fileOf(book), file);
}

void restoreBook(const QString& file, const BookPlace& book, bool replace) {
    if (!QFile::exists(file))
        throw core::Failure(core::InvalidCall, u"Não existe o ficheiro «%1»."_s.arg(file));
    if (!replace) refuseFilled(book);
    if (book.isOnServer()) {
        ado::postgres::prove(file, Tables);
        refuseNewerBackup(file, book);
        return restoreOnServer(file, book);
    }
    ado::sqlite::prove(file, Tables);
    refuseNewerBackup(file, book);
    const QStringList others = othersIn(book);
    if (!others.isEmpty())
        throw core::Failure(core::InvalidCall,
                            u"O livro «%1» está aberto por %2. Nada foi reposto."_s.arg(
                                book.shown(), others.join(u", "_s)));
    if (!QFile::exists(fileOf(book))) {
        const BookOwners owners;
        owners.makeFolder(book.folder);
        owners.makeFile(fileOf(book));
    }
    ado::sqlite::restore(file, fileOf(book));
}

QStringList othersIn(const BookPlace& book) {
    return book.isOnServer() ? ado::postgres::othersIn(book.server)
                             : ado::sqlite::othersIn(fileOf(book));
}

}  // namespace database
