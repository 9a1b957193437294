// SPDX-License-Identifier: MIT
#include "database/Backup.h"

#include <QFile>

#include "database/Book.h"
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

}  // namespace

bool canBackUp(const BookPlace& book) {
    return !book.isOnServer() || ado::postgres::canBackUp();
}

void backUpBook(const BookPlace& book, const QString& file) {
    if (book.isOnServer()) return ado::postgres::backUp(book.server, file);
    if (!QFile::exists(fileOf(book)))
        throw core::Failure(core::InvalidCall, u"Não existe o livro «%1»."_s.arg(fileOf(book)));
    ado::sqlite::backUp(fileOf(book), file);
}

void restoreBook(const QString& file, const BookPlace& book, bool replace) {
    if (!QFile::exists(file))
        throw core::Failure(core::InvalidCall, u"Não existe o ficheiro «%1»."_s.arg(file));
    if (!replace) refuseFilled(book);
    if (book.isOnServer()) {
        ado::postgres::prove(file, Tables);
        return ado::postgres::restore(file, book.server);
    }
    ado::sqlite::prove(file, Tables);
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
