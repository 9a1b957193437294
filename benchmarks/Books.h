// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <vector>

#include "database/Copy.h"
#include "database/ServerBook.h"

namespace benchmarks {

enum class Engine { Sqlite, Postgres };

/// As the rows of the report name it.
QString nameOf(Engine engine);

/// A book that measurements run on; made once and kept beside the build.
struct Book {
    Engine engine = Engine::Sqlite;
    QString folder;     ///< of the file, or of the server's socket
    QString catalogue;  ///< of a server; an SQLite book has the usual name

    QString file() const;                   ///< of an SQLite book
    ado::postgres::Address server() const;  ///< of a server's book
    database::BookPlace place() const;      ///< for bulk work
    /// What a connection opens it by.
    QString connectionString() const;
};

/// The sample book as every new user gets it.
Book sampleBook(Engine engine = Engine::Sqlite);
/// 100,000 members, 1,000,000 movements, 1,000,000 accumulator rows.
Book largeBook(Engine engine = Engine::Sqlite);

/// The sample with two members who have very much: one has 50,000 movements on a rubric with a
/// franchise, the other 6,000 accumulator rows.
Book heavyBook(Engine engine = Engine::Sqlite);
inline constexpr qint32 MemberOfMovements = 1;
inline constexpr qint32 MemberOfAccumulators = 3;
inline constexpr qint32 FranchiseRubric = 5;

/// Whether copies lie in memory. Waiting for a disk hides what a layer adds to its engine, and on a
/// slow one a hundred thousand commits take minutes: the figures are those without it, on both
/// sides alike. Where the system has no such memory, copies lie beside the books.
bool copiesInMemory();

/// A copy of a book for measurements that write much; gone with this.
class BookCopy {
public:
    explicit BookCopy(const Book& original);
    ~BookCopy();
    BookCopy(const BookCopy&) = delete;
    BookCopy& operator=(const BookCopy&) = delete;

    const Book& book() const { return book_; }

private:
    Book book_;
};

/// Points the registry at the book and logs the component in. Fails as the login does.
void use(const Book& book);

/// A member, a person of his family and a rubric.
struct Case {
    qint32 socio_id;
    QString codABC;
    qint32 rubrica_id;
};

// Both look into an SQLite book; a server's book of the same size holds the same.

/// Cases whose accumulator row exists already, spread over the book.
std::vector<Case> usedCases(const Book& book, int count);
/// Cases that have none yet.
std::vector<Case> freshCases(const Book& book, int count);

}  // namespace benchmarks
