// SPDX-License-Identifier: MIT
#pragma once

#include <QList>
#include <QStringList>
#include <memory>

namespace support {

/// True when the books of this run lie on its own PostgreSQL server (the environment variable
/// ZELMARS_TEST_ENGINE is "postgresql"), false when they are SQLite files.
bool onServer();

/// A book of one engine, as any other program makes it and works on it: through the engine's own
/// client library, in the engine's dialect. The book is gone with the handle.
class BookHandle {
public:
    enum class Content { Empty, Sample };
    /// A book of the run's engine; a file lies in the folder.
    static std::unique_ptr<BookHandle> make(Content content, const QString& folder);
    /// A file, copied from one that the process makes once.
    static std::unique_ptr<BookHandle> makeFile(Content content, const QString& folder);
    /// A catalogue of its own on the run's server, copied likewise. The handle is its owner's;
    /// `user` is an operator, who may do what the screens do and nothing else.
    static std::unique_ptr<BookHandle> makeOnServer(Content content);
    virtual ~BookHandle() = default;

    // The values that name the book.
    virtual QString dataSource() const = 0;
    virtual QString catalogue() const = 0;
    virtual QString user() const = 0;
    /// Of the plain provider, as a login sets it.
    QString connectionString() const;
    QString shapingConnectionString() const;

    /// Runs statements and gives the rows of the last one, a null text for null; values are printed
    /// alike on every engine. Throws std::runtime_error with the engine's text.
    virtual QList<QStringList> rows(const QString& statements) = 0;
    virtual QStringList tables() = 0;
    /// Starts a transaction that keeps everybody else from writing to the table until "commit".
    virtual void hold(const QString& table) = 0;
    /// Lets every such write ("insert on tbX", "update on tbX") fail with the text.
    virtual void refuse(const QString& write, const QString& text) = 0;
    virtual void refuseNoMore() = 0;
};

/// A number as every engine's handle prints it: 15 digits, no zeros behind the last decimal.
QString printed(double number);

}  // namespace support
