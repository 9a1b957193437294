// SPDX-License-Identifier: MIT
#include "benchmarks/Books.h"

#include <QDir>
#include <QFileInfo>
#include <cstdio>

#include "benchmarks/Bare.h"
#include "boundary/Login.h"
#include "database/Book.h"

using namespace Qt::StringLiterals;

namespace benchmarks {

namespace {

/// One fixed day, so that a book made earlier and one made today hold the same.
const QDate AsOf(2026, 11, 20);

Book book(const QString& name, const database::BookSizes& sizes) {
    Book made{QDir::current().absoluteFilePath(u"build/bench/books/"_s + name)};
    if (!QFileInfo::exists(made.file())) {
        std::printf("Making the book %s …\n", qUtf8Printable(name));
        std::fflush(stdout);
        // Under another name first, so that a book that was cut short is never taken for whole.
        const QString half = made.folder + u"-half"_s;
        QDir(half).removeRecursively();
        database::createBook(half, u"zelmars"_s);
        database::fillSample(half, u"zelmars"_s, sizes, AsOf);
        QDir().rename(half, made.folder);
    }
    return made;
}

std::vector<Case> cases(const Book& book, const QByteArray& statement) {
    const Bare bare(book.file());
    sqlite3_stmt* rows = nullptr;
    sqlite3_prepare_v2(bare.handle(), statement.constData(), -1, &rows, nullptr);
    std::vector<Case> found;
    while (sqlite3_step(rows) == SQLITE_ROW)
        found.push_back(
            {sqlite3_column_int(rows, 0),
             QString::fromUtf8(reinterpret_cast<const char*>(sqlite3_column_text(rows, 1))),
             sqlite3_column_int(rows, 2)});
    sqlite3_finalize(rows);
    return found;
}

}  // namespace

QString Book::file() const {
    return database::bookFile(folder, u"zelmars"_s);
}

Book sampleBook() {
    return book(u"sample"_s, {});
}

Book largeBook() {
    database::BookSizes sizes;
    sizes.members = 100'000;
    sizes.relatives = 230'000;
    sizes.membersLeft = 2'000;
    sizes.movements = 1'000'000;
    sizes.historyPerYear = 3'500;
    sizes.accumulators = 1'000'000;
    return book(u"large"_s, sizes);
}

void use(const Book& book) {
    database::writeSettings(book.folder, u"zelmars"_s);
    boundary::Login();
}

std::vector<Case> usedCases(const Book& book, int count) {
    // Spread over the book by the remainder of a product with a prime.
    return cases(book,
                 "SELECT a.socio_id, a.codABC, a.rubrica_id FROM tbSocios_Acumulados a "
                 "JOIN tbSocios s ON s.socio_id = a.socio_id "
                 "WHERE a.rubrica_id > 0 AND length(s.nib) = 21 AND a.rowid IN "
                 "(SELECT rowid FROM tbSocios_Acumulados ORDER BY (rowid * 7919) % 100003 LIMIT " +
                     QByteArray::number(count * 3) + ") LIMIT " + QByteArray::number(count));
}

std::vector<Case> freshCases(const Book& book, int count) {
    return cases(book,
                 "SELECT s.socio_id, 'A', p.rubrica_id FROM "
                 "(SELECT socio_id FROM tbSocios WHERE length(nib) = 21 "
                 "ORDER BY (socio_id * 7919) % 100003 LIMIT 300) s, tbZelmar_Plafonds p "
                 "WHERE p.rubrica_id_main IS NOT NULL AND NOT EXISTS "
                 "(SELECT 1 FROM tbSocios_Acumulados a WHERE a.socio_id = s.socio_id AND "
                 "a.codABC = 'A' AND a.rubrica_id = p.rubrica_id) LIMIT " +
                     QByteArray::number(count));
}

}  // namespace benchmarks
