// SPDX-License-Identifier: MIT
#include "tests/support/BookHandle.h"

#include <libpq-fe.h>

#include <stdexcept>

#include "database/ServerBook.h"
#include "tests/support/Server.h"

using namespace Qt::StringLiterals;

namespace support {

namespace {

constexpr auto Operator = "operador"_L1;

// Types of the server's catalogue, by their fixed numbers.
enum Type : Oid { Boolean = 16, Single = 700, Double = 701, Numeric = 1700 };

PGconn* connect(const QString& catalogue) {
    PGconn* handle = PQsetdbLogin(Server::instance().folder().toUtf8(), nullptr, nullptr, nullptr,
                                  catalogue.toUtf8(), Server::User, nullptr);
    PQsetClientEncoding(handle, "UTF8");
    return handle;
}

/// An amount without the zeros behind its last decimal.
QString withoutZeros(QByteArray number) {
    while (number.contains('.') && (number.endsWith('0') || number.endsWith('.'))) number.chop(1);
    return QString::fromLatin1(number);
}

QString cell(const PGresult* result, int row, int column) {
    if (PQgetisnull(result, row, column)) return {};
    const QByteArray text = PQgetvalue(result, row, column);
    switch (PQftype(result, column)) {
        case Boolean:
            return text == "t" ? u"1"_s : u"0"_s;
        case Single:
            return printed(static_cast<double>(text.toFloat()));
        case Double:
            return printed(text.toDouble());
        case Numeric:
            return withoutZeros(text);
        default:
            return QString::fromUtf8(text);
    }
}

QList<QStringList> run(PGconn* handle, const QString& statements) {
    const std::unique_ptr<PGresult, decltype(&PQclear)> result(PQexec(handle, statements.toUtf8()),
                                                               &PQclear);
    const ExecStatusType status = PQresultStatus(result.get());
    if (status != PGRES_COMMAND_OK && status != PGRES_TUPLES_OK && status != PGRES_EMPTY_QUERY)
        throw std::runtime_error(PQerrorMessage(handle) + statements.toStdString());
    QList<QStringList> rows;
    for (int row = 0; row < PQntuples(result.get()); ++row) {
        QStringList cells;
        for (int at = 0; at < PQnfields(result.get()); ++at) cells << cell(result.get(), row, at);
        rows << cells;
    }
    return rows;
}

/// Makes and drops catalogues.
void administer(const QString& statement) {
    static const std::unique_ptr<PGconn, decltype(&PQfinish)> handle(connect(u"postgres"_s),
                                                                     &PQfinish);
    run(handle.get(), statement);
}

/// A catalogue made once in the process, as an administrator makes it, and copied for each test.
QString pattern(BookHandle::Content content) {
    static QStringList made;
    const bool sample = content == BookHandle::Content::Sample;
    const QString name = sample ? u"exemplo"_s : u"vazio"_s;
    if (made.contains(name)) return name;
    database::initBook({.host = Server::instance().folder(),
                        .port = {},
                        .user = QString::fromLatin1(Server::User),
                        .password = {},
                        .catalog = name},
                       {.user = Operator, .password = u"segredo"_s}, sample);
    made << name;
    return name;
}

class PostgresBook final : public BookHandle {
public:
    explicit PostgresBook(Content content);
    ~PostgresBook() override;

    QString dataSource() const override;
    QString catalogue() const override { return catalogue_; }
    QString user() const override;
    QList<QStringList> rows(const QString& statements) override;
    QStringList tables() override;
    void hold(const QString& table) override;
    void refuse(const QString& write, const QString& text) override;
    void refuseNoMore() override;

private:
    QString catalogue_;
    pg_conn* handle_ = nullptr;
};

PostgresBook::PostgresBook(Content content) {
    static int made = 0;
    catalogue_ = u"livro%1"_s.arg(++made);
    administer(u"create database %1 template %2"_s.arg(catalogue_, pattern(content)));
    handle_ = connect(catalogue_);
    // Rights to a catalogue are not copied with it; nor are there any to what a test adds.
    rows(
        u"revoke all on database %1 from public; grant connect on database %1 to %2;"
        "alter default privileges grant select, insert, update, delete on tables to %2"_s.arg(
            catalogue_, Operator));
}

PostgresBook::~PostgresBook() {
    PQfinish(handle_);
    administer(u"drop database %1 with (force)"_s.arg(catalogue_));
}

QString PostgresBook::dataSource() const {
    return u"postgresql:"_s + Server::instance().folder();
}

QString PostgresBook::user() const {
    return Operator;
}

QList<QStringList> PostgresBook::rows(const QString& statements) {
    return run(handle_, statements);
}

QStringList PostgresBook::tables() {
    QStringList names;
    for (const QStringList& row : rows(u"select relname from pg_class where relkind = 'r' and "
                                       "relnamespace = 'public'::regnamespace order by 1"_s))
        names << row[0];
    return names;
}

void PostgresBook::hold(const QString& table) {
    rows(u"begin; lock table %1 in share mode"_s.arg(table));
}

void PostgresBook::refuse(const QString& write, const QString& text) {
    rows(
        u"create function refuses() returns trigger language plpgsql as "
        "$$ begin raise exception '%2'; end $$;"
        "create trigger refuses before %1 for each row execute function refuses()"_s.arg(write,
                                                                                         text));
}

void PostgresBook::refuseNoMore() {
    rows(u"drop function refuses() cascade"_s);
}

}  // namespace

std::unique_ptr<BookHandle> BookHandle::makeOnServer(Content content) {
    return std::make_unique<PostgresBook>(content);
}

}  // namespace support
