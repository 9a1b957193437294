// SPDX-License-Identifier: MIT
#pragma once

#include <QByteArray>
#include <QString>

struct sqlite3;
struct sqlite3_stmt;

/// The engine's handles with an owner. Failures are core::Failure with the engine's text.
namespace database::sqlite {

/// An open book file.
class Database {
public:
    enum class Mode { OpenExisting, CreateNew };

    Database(const QString& file, Mode mode);
    ~Database();
    Database(const Database&) = delete;
    Database& operator=(const Database&) = delete;

    /// Runs statements that give no rows (or whose rows nobody wants), separated by ';'.
    void run(const QByteArray& statements);
    /// The first column of the first row as a whole number; 0 when there is none.
    qint64 number(const QByteArray& statement);

    sqlite3* handle() const { return handle_; }
    /// Fails with the engine's text if the result is neither OK, ROW nor DONE.
    void check(int result) const;

private:
    sqlite3* handle_ = nullptr;
};

/// A prepared statement with one row of parameters, run again and again. The bound bytes must
/// live until run().
class Statement {
public:
    Statement(Database& database, const QByteArray& text);
    ~Statement();
    Statement(const Statement&) = delete;
    Statement& operator=(const Statement&) = delete;

    // Parameters count from 1.
    void bindNull(int parameter);
    void bind(int parameter, qint64 value);
    void bind(int parameter, double value);
    void bind(int parameter, const QByteArray& utf8);
    /// Runs to the end and makes the statement ready for the next row.
    void run();
    /// Steps to a row; false at the end.
    bool step();
    sqlite3_stmt* handle() const { return handle_; }

private:
    Database& database_;
    sqlite3_stmt* handle_ = nullptr;
};

}  // namespace database::sqlite
