// SPDX-License-Identifier: MIT
#pragma once

#include <QByteArray>
#include <QString>
#include <functional>

struct pg_conn;
struct pg_result;

namespace database {

/// A catalogue of a PostgreSQL server and who opens it.
struct ServerCatalogue {
    QString host;  ///< a name, an address, or a folder with the server's local socket
    QString port;  ///< empty for the server's usual one
    QString user;
    QString password;
    QString name;
    bool allowsPlain = false;  ///< a remote server need not encrypt

    /// The catalogue of a server named "HOST[:PORT][?tls=no]". Fails when the port is none.
    static ServerCatalogue at(const QString& place, const QString& name);
    /// Server and catalogue, for people; never the password.
    QString shown() const;
    /// What a workstation's `dtDataSource` says of the server.
    QString dataSource() const;
};

}  // namespace database

/// The server's connection with an owner. Failures are core::Failure with the server's text and its
/// SQLSTATE.
namespace database::postgres {

/// An open catalogue.
class Database {
public:
    /// Fails with a text that says what was tried, also for a server that is too old.
    explicit Database(const ServerCatalogue& catalogue);
    ~Database();
    Database(const Database&) = delete;
    Database& operator=(const Database&) = delete;

    /// Runs statements that give no rows (or whose rows nobody wants), separated by ';'.
    void run(const QByteArray& statements);
    /// The first column of the first row as a whole number; 0 when there is none. "t" counts as 1.
    qint64 number(const QByteArray& statement);
    /// Calls for each row, one at a time, so that memory does not grow with their number. The row
    /// is the only one of the result it comes in.
    void eachRow(const QByteArray& statement, const std::function<void(const pg_result*)>& row);
    /// Runs a COPY … FROM STDIN with these lines, in the server's text form.
    void copyIn(const QByteArray& statement, const QByteArray& lines);

    // Texts as parts of a statement.
    QByteArray name(const QString& text) const;
    QByteArray literal(const QString& text) const;
    /// A role's password as the server keeps it, so that no log ever sees the password.
    QByteArray encrypted(const QString& password, const QString& role) const;

private:
    pg_result* checked(pg_result* result) const;
    [[noreturn]] void fail(const pg_result* result) const;
    void finish();

    pg_conn* connection_ = nullptr;
};

/// A transaction, undone unless commit() is reached.
class Transaction {
public:
    explicit Transaction(Database& book) : book_(book) { book_.run("BEGIN"); }
    ~Transaction();
    Transaction(const Transaction&) = delete;
    Transaction& operator=(const Transaction&) = delete;

    void commit();

private:
    Database& book_;
    bool isOpen_ = true;
};

}  // namespace database::postgres
