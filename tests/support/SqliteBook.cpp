// SPDX-License-Identifier: MIT
#include "tests/support/BookHandle.h"

#include <sqlite3.h>

#include <QFile>
#include <QTemporaryDir>
#include <stdexcept>

#include "database/Book.h"

using namespace Qt::StringLiterals;

namespace support {

namespace {

/// A book made once in the process and copied for each test.
QString pattern(BookHandle::Content content) {
    static QTemporaryDir folders;
    const bool sample = content == BookHandle::Content::Sample;
    const QString folder = folders.filePath(sample ? u"sample"_s : u"empty"_s);
    const QString file = database::bookFile(folder, u"zelmars"_s);
    if (!QFile::exists(file)) {
        database::createBook(folder, u"zelmars"_s);
        if (sample) database::fillSample(folder, u"zelmars"_s);
    }
    return file;
}

QString cell(sqlite3_stmt* statement, int column) {
    switch (sqlite3_column_type(statement, column)) {
        case SQLITE_NULL:
            return {};
        case SQLITE_FLOAT:
            return printed(sqlite3_column_double(statement, column));
        default: {
            const auto* text = sqlite3_column_text(statement, column);
            return QString::fromUtf8(reinterpret_cast<const char*>(text));
        }
    }
}

class SqliteBook final : public BookHandle {
public:
    SqliteBook(Content content, const QString& folder);
    ~SqliteBook() override;

    QString dataSource() const override { return QStringLiteral("sqlite:") + folder_; }
    QString catalogue() const override { return QStringLiteral("zelmars"); }
    QString user() const override { return QStringLiteral("zelmars"); }
    QList<QStringList> rows(const QString& statements) override;
    QStringList tables() override;
    void hold(const QString& table) override;
    void refuse(const QString& write, const QString& text) override;
    void refuseNoMore() override;

private:
    QString folder_;
    sqlite3* handle_ = nullptr;
};

SqliteBook::SqliteBook(Content content, const QString& folder) : folder_(folder) {
    const QString file = database::bookFile(folder, catalogue());
    if (!QFile::copy(pattern(content), file)) throw std::runtime_error("no copy of the book");
    sqlite3_open(file.toUtf8().constData(), &handle_);
    sqlite3_busy_timeout(handle_, 5000);
}

SqliteBook::~SqliteBook() {
    sqlite3_close(handle_);
}

QList<QStringList> SqliteBook::rows(const QString& statements) {
    const QByteArray text = statements.toUtf8();
    QList<QStringList> rows;
    for (const char* rest = text.constData(); *rest != 0;) {
        sqlite3_stmt* statement = nullptr;
        int result = sqlite3_prepare_v2(handle_, rest, -1, &statement, &rest);
        if (statement) rows.clear();
        while (result != SQLITE_DONE && statement &&
               (result = sqlite3_step(statement)) == SQLITE_ROW) {
            QStringList row;
            for (int at = 0; at < sqlite3_column_count(statement); ++at) row << cell(statement, at);
            rows << row;
        }
        sqlite3_finalize(statement);
        if (result != SQLITE_DONE && result != SQLITE_OK)
            throw std::runtime_error(std::string(sqlite3_errmsg(handle_)) + ": " +
                                     text.toStdString());
    }
    return rows;
}

QStringList SqliteBook::tables() {
    QStringList names;
    for (const QStringList& row :
         rows(u"select name from sqlite_schema where type = 'table' order by name"_s))
        names << row[0];
    return names;
}

void SqliteBook::hold(const QString&) {
    rows(u"begin immediate"_s);
}

void SqliteBook::refuse(const QString& write, const QString& text) {
    rows(u"create trigger refuses before %1 begin select raise(abort, '%2'); end"_s.arg(write,
                                                                                        text));
}

void SqliteBook::refuseNoMore() {
    rows(u"drop trigger refuses"_s);
}

}  // namespace

std::unique_ptr<BookHandle> BookHandle::makeFile(Content content, const QString& folder) {
    return std::make_unique<SqliteBook>(content, folder);
}

}  // namespace support
