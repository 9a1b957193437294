// SPDX-License-Identifier: MIT
#pragma once

#include <QByteArray>
#include <QDate>
#include <QString>
#include <QTemporaryDir>
#include <QVariant>
#include <initializer_list>
#include <utility>

#include "tests/support/BookHandle.h"

namespace support {

// Rows for the builders of Book. Name what the test is about and leave the rest; an invalid
// QVariant is null. Dates may be given as QDate.

/// In order in every respect: enrolled, with a valid bank number, without a waiting period.
struct MemberRow {
    QString no_kor = QStringLiteral("100015");
    QVariant nome = QStringLiteral("António Manuel Silva Matos");
    QVariant nome_guerra = QStringLiteral("António Matos");
    QVariant nib = QStringLiteral("001300000000000000186");
    QVariant zelmar = 1;
    QVariant zelmar_data_carencia = {};
    QVariant localidade1 = QStringLiteral("Lisboa");
};

/// A person of a member's family; the member himself has the code "A".
struct PersonRow {
    qint64 socio_id = 0;
    QVariant codABC = QStringLiteral("B");
    QVariant nome = QStringLiteral("Maria da Luz Matos");
    QVariant data_nascimento = {};
    QVariant data_carencia = {};
};

/// Without rubrica_id_main a main rubric. Without a ceiling there is none, but mind that a child
/// rubric with a null `socio` or `familiar` leaves that person nothing.
struct RubricRow {
    QVariant rubrica_id_main = {};
    QVariant code = QStringLiteral("01");
    QVariant percent = {};  // 0..1, a fraction
    QVariant agregado = {};
    QVariant socio = {};
    QVariant familiar = {};
    QVariant total_familia = {};
    QVariant franquia = {};
};

/// A book of its own for one test, on the run's engine: the schema with its code lists, and a
/// registry folder (ZELMARS_REGISTRY) whose five values name it, so that General::Login finds it.
/// Both are gone with the object. Make one at a time.
///
///     support::Book book;
///     const qint64 socio = book.member({.no_kor = "100015"});
///     const qint64 child = book.person({.socio_id = socio, .codABC = "C1"});
///     …
///     EXPECT_EQ(book.value("select credito from tbZelmar_Movimentos").toDouble(), 14);
///
/// Statements run on a handle of its own, outside the row-set layer, in the engine's dialect; a
/// failing one throws std::runtime_error with the engine's text.
class Book {
public:
    /// Empty: schema, code lists, counters at 1. Sample: the sample book as of core::today().
    using Content = BookHandle::Content;
    explicit Book(Content content = Content::Empty);
    ~Book();
    Book(const Book&) = delete;
    Book& operator=(const Book&) = delete;

    /// Where a book file lies.
    QString folder() const { return root_.path(); }
    QString catalogue() const { return handle_->catalogue(); }
    QString dataSource() const { return handle_->dataSource(); }
    /// Who the values let log in.
    QString user() const { return handle_->user(); }
    QString registryFolder() const { return root_.filePath(QStringLiteral("registry")); }
    /// Of the plain provider, as a login would set it, and of the shaping one.
    QString connectionString() const { return handle_->connectionString(); }
    QString shapingConnectionString() const { return handle_->shapingConnectionString(); }

    void exec(const QString& statements) { handle_->rows(statements); }
    /// The first column of the first row as text; invalid for null and for no row.
    QVariant value(const QString& statement);
    /// All rows: columns parted by '|', rows by '\n', null as "NULL".
    QString text(const QString& statement);
    /// Every row of every table.
    QString everything();
    /// Number of rows of a table, `where` being a condition or empty.
    qint64 count(const QString& table, const QString& where = {});

    // What goes wrong in an office. See BookHandle.
    void hold(const QString& table) { handle_->hold(table); }
    void letGo() { exec(QStringLiteral("commit")); }
    void refuse(const QString& write, const QString& text) { handle_->refuse(write, text); }
    void refuseNoMore() { handle_->refuseNoMore(); }

    /// Inserts one row and gives its key. Columns left out take their defaults.
    qint64 insert(const QString& table,
                  std::initializer_list<std::pair<const char*, QVariant>> columns);

    qint64 member(const MemberRow& row);
    qint64 person(const PersonRow& row);
    qint64 rubric(const RubricRow& row);
    /// A child rubric: under a main rubric without ceilings unless `row` names one, and with
    /// `percent` 0.8, `socio` and `familiar` 1,000,000 where `row` leaves them null.
    qint64 childRubric(RubricRow row);
    qint64 hospital(const QString& code = QStringLiteral("H01"),
                    const QString& nome = QStringLiteral("Hospital da Luz Nova"));
    /// The premium paid up to the month of core::today(), nothing due.
    void premiumInOrder(qint64 socio_id);

private:
    QTemporaryDir root_;
    QByteArray registryBefore_;
    std::unique_ptr<BookHandle> handle_;
};

}  // namespace support
