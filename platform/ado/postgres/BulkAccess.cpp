// SPDX-License-Identifier: MIT
#include "platform/ado/postgres/BulkAccess.h"

#include <libpq-fe.h>

#include <QRegularExpression>
#include <charconv>
#include <cstring>

#include "platform/ado/postgres/Dialect.h"
#include "platform/ado/postgres/Failures.h"
#include "platform/ado/postgres/Handle.h"
#include "platform/ado/postgres/Types.h"
#include "platform/core/Failure.h"

namespace ado::postgres {

using namespace Qt::StringLiterals;

namespace {

/// SQLSTATE of a failure of which the server tells nothing.
constexpr auto ConnectionLost = "08006";

/// Bytes of a table that are gathered before they go to the server, which takes the rows of one
/// table at a time.
constexpr qsizetype Enough = 256 * 1024;

// One row is a column of a table with its type; the last one tells whether it belongs to the key.
constexpr auto Columns =
    "SELECT c.relname, a.attname, a.atttypid, a.atttypmod, EXISTS ("
    "       SELECT FROM pg_index i"
    "        WHERE i.indrelid = c.oid AND i.indisprimary AND a.attnum = ANY (i.indkey))"
    "  FROM pg_class c JOIN pg_attribute a ON a.attrelid = c.oid"
    " WHERE c.relnamespace = 'public'::regnamespace AND c.relkind = 'r'"
    "   AND a.attnum > 0 AND NOT a.attisdropped"
    " ORDER BY c.relname, a.attnum";

// One row is a table that generates its keys, and the sequence they come from.
constexpr auto Generated =
    "SELECT c.relname, pg_get_serial_sequence(c.oid::regclass::text, a.attname)"
    "  FROM pg_class c JOIN pg_attribute a ON a.attrelid = c.oid"
    " WHERE c.relnamespace = 'public'::regnamespace AND a.attidentity = 'd'";

/// Held by whoever imports, of each catalogue; any number that nothing else uses.
const QByteArray ImportLock = "7305190";

constexpr auto ContinueBehindHighest = R"(
DO $$
DECLARE
    generated record;
    highest bigint;
    following bigint;
BEGIN
    FOR generated IN
        SELECT attrelid::regclass AS relation, attname AS key,
               pg_get_serial_sequence(attrelid::regclass::text, attname) AS sequence
          FROM pg_attribute
         WHERE attidentity = 'd'
           AND attrelid IN (SELECT oid FROM pg_class WHERE relnamespace = 'public'::regnamespace)
    LOOP
        EXECUTE format('SELECT max(%I) FROM %s', generated.key, generated.relation) INTO highest;
        EXECUTE format('SELECT last_value + is_called::int FROM %s', generated.sequence)
            INTO following;
        IF highest >= following THEN
            EXECUTE format('ALTER TABLE %s ALTER COLUMN %I RESTART WITH %s',
                           generated.relation, generated.key, highest + 1);
        END IF;
    END LOOP;
END $$)";

struct Free {
    void operator()(char* text) const { PQfreemem(text); }
};

QByteArray taken(char* text) {
    return std::unique_ptr<char, Free>(text).get();
}

QByteArray textAt(const PGresult* row, int column) {
    return {PQgetvalue(row, 0, column), PQgetlength(row, 0, column)};
}

BulkValue valueOf(std::string_view text, ColumnType type) {
    const Cell cell = cellOf(text, type);
    if (cell.kind == Cell::Integer) return cell.integer;
    if (cell.kind == Cell::Real) return cell.real;
    const QByteArray bytes(text.data(), static_cast<qsizetype>(text.size()));
    if (type != ColumnType::Money) return bytes;
    if (const auto money = core::Money::fromPlainText(QString::fromLatin1(bytes))) return *money;
    throw core::Failure(core::Overflow,
                        u"O montante %1 é grande de mais."_s.arg(QLatin1StringView(bytes)));
}

/// What stands between two separators of a line of the server's, without its marks; they are taken
/// out in place.
std::string_view withoutMarks(char* text, std::size_t length) {
    char* end = text;
    for (const char* at = text; at < text + length; ++at) {
        if (*at == '\\') switch (*++at) {
                case 't':
                    *end++ = '\t';
                    continue;
                case 'n':
                    *end++ = '\n';
                    continue;
                case 'r':
                    *end++ = '\r';
                    continue;
                case 'b':
                    *end++ = '\b';
                    continue;
                case 'f':
                    *end++ = '\f';
                    continue;
                case 'v':
                    *end++ = '\v';
                    continue;
                default:  // the letter itself
                    break;
            }
        *end++ = *at;
    }
    return {text, static_cast<std::size_t>(end - text)};
}

/// The values of a line that the server sent, in the form in which it also takes them. The line is
/// used up.
void split(char* line, const std::vector<ColumnType>& types, BulkRow& values) {
    for (std::size_t at = 0; at < values.size(); ++at) {
        const std::size_t length = std::strcspn(line, "\t\n");
        const std::string_view text(line, length);
        if (text == "\\N")
            values[at] = {};
        else
            values[at] = valueOf(withoutMarks(line, length), types[at]);
        line += length + 1;
    }
}

/// A text in the form in which the server takes lines: what parts columns and lines is marked.
void append(QByteArray& line, const QByteArray& text) {
    for (const char each : text) {
        switch (each) {
            case '\\':
                line += "\\\\";
                break;
            case '\t':
                line += "\\t";
                break;
            case '\n':
                line += "\\n";
                break;
            case '\r':
                line += "\\r";
                break;
            default:
                line += each;
        }
    }
}

/// A value as the server reads it; empty for null.
QByteArray plainText(const BulkValue& value) {
    if (const auto* number = std::get_if<qint64>(&value)) return QByteArray::number(*number);
    if (const auto* money = std::get_if<core::Money>(&value))
        return money->toPlainText().toLatin1();
    if (const auto* text = std::get_if<QByteArray>(&value)) return *text;
    const auto* real = std::get_if<double>(&value);
    if (!real) return {};
    char digits[32];
    const auto end = std::to_chars(std::begin(digits), std::end(digits), *real);
    return {digits, end.ptr - digits};
}

void append(QByteArray& line, const BulkValue& value) {
    if (value.index() == 0)
        line += "\\N";
    else if (const auto* text = std::get_if<QByteArray>(&value))
        append(line, *text);
    else
        line += plainText(value);
}

/// The row that the server stumbled over. It counts the lines of what it was given; people know a
/// row by what stands in it.
QString stumblingBlock(const QString& failure, const QByteArray& lines) {
    static const QRegularExpression numbered(u"COPY [^,]+, \\w+ (\\d+)"_s);
    const int number = numbered.match(failure).captured(1).toInt();
    if (number < 1) return {};
    QString row = QString::fromUtf8(lines.split('\n').value(number - 1)).left(200);
    return u"\nLinha: "_s + row.replace(u'\t', u" | "_s);
}

}  // namespace

BulkAccess::BulkAccess(const Address& address) : connection_(Handle::connected(address)) {
    PQsetNoticeProcessor(
        connection_, [](void*, const char*) {}, nullptr);
    try {
        execute(
            "SET search_path = public, pg_temp; SET datestyle = ISO, MDY;"
            "SET extra_float_digits = 1; SET jit = off");
    } catch (...) {
        PQfinish(connection_);
        throw;
    }
}

// The server undoes by itself what was not committed.
BulkAccess::~BulkAccess() {
    PQfinish(connection_);
}

void BulkAccess::execute(const QByteArray& statements) {
    PQclear(checked(PQexec(connection_, statements.constData())));
}

qint64 BulkAccess::number(const QByteArray& query) {
    const Result result(checked(PQexec(connection_, query.constData())));
    if (PQntuples(result.get()) == 0) return 0;
    const QByteArray text = textAt(result.get(), 0);
    return text == "t" ? 1 : text.toLongLong();
}

void BulkAccess::begin(Purpose purpose) {
    purpose_ = purpose;
    if (purpose == Purpose::Reading) {
        execute("BEGIN ISOLATION LEVEL REPEATABLE READ READ ONLY");
        return;
    }
    if (purpose == Purpose::Importing) {
        // Whoever imports next waits before the book that he is going to see is settled.
        execute("SET lock_timeout = '30s'");
        number("SELECT pg_advisory_lock(" + ImportLock + ")");
        execute("BEGIN ISOLATION LEVEL REPEATABLE READ");
        return;
    }
    execute("BEGIN");
    QByteArray names;
    for (const TableShape& shape : tables()) names += (names.isEmpty() ? "" : ", ") + shape.name;
    if (names.isEmpty()) return;
    // Whoever holds a row for longer than any posting takes is told of, rather than waited for.
    execute("SET LOCAL lock_timeout = '30s'");
    execute("LOCK TABLE " + names + " IN SHARE ROW EXCLUSIVE MODE");
}

void BulkAccess::commit() {
    if (purpose_ == Purpose::Importing) flush();
    if (purpose_ == Purpose::Filling || purpose_ == Purpose::Changing) {
        flush();
        execute(ContinueBehindHighest);
        execute("ANALYZE");
    }
    execute("COMMIT");
}

std::vector<TableShape> BulkAccess::tables() {
    std::vector<TableShape> shapes;
    eachResult(Columns, [&](const PGresult* row) {
        const QByteArray table = textAt(row, 0);
        const QByteArray column = textAt(row, 1);
        if (shapes.empty() || shapes.back().name != table) shapes.push_back({table, {}, {}});
        const bool isHidden = column == HiddenIdentity;
        if (isHidden || (textAt(row, 4) == "t" && !order_.contains(table))) order_[table] = column;
        if (isHidden) return;
        shapes.back().columns.push_back(column);
        shapes.back().types.push_back(typeOf(textAt(row, 2).toUInt(), textAt(row, 3).toInt()));
    });
    return shapes;
}

void BulkAccess::eachRow(const TableShape& shape, const std::function<void(const BulkRow&)>& row) {
    PQclear(
        checked(PQexec(connection_, "COPY (SELECT " + shape.columnList() + " FROM " + shape.name +
                                        " ORDER BY " + order_.at(shape.name) + ") TO STDOUT")));
    BulkRow values(shape.types.size());
    char* line = nullptr;
    while (PQgetCopyData(connection_, &line, 0) > 0) {
        const std::unique_ptr<char, Free> kept(line);
        split(line, shape.types, values);
        row(values);
    }
    while (PGresult* end = PQgetResult(connection_)) PQclear(checked(end));
}

std::set<QByteArray> BulkAccess::parts() {
    std::set<QByteArray> names;
    for (const QString& name :
         texts("SELECT relname FROM pg_class WHERE relnamespace = 'public'::regnamespace AND "
               "relkind IN ('r', 'v', 'i')"))
        names.insert(name.toUtf8());
    return names;
}

QStringList BulkAccess::texts(const QByteArray& query) {
    QStringList texts;
    eachResult(query, [&](const PGresult* row) { texts << QString::fromUtf8(textAt(row, 0)); });
    return texts;
}

Totals BulkAccess::totals(const TableShape& shape) {
    QByteArray text = "SELECT count(*)";
    for (std::size_t at = 0; at < shape.types.size(); ++at)
        if (shape.types[at] == ColumnType::Money)
            text += ", (coalesce(sum(" + shape.columns[at] + "), 0) * 10000)::bigint";
    Totals totals;
    eachResult(text + " FROM " + shape.name, [&](const PGresult* row) {
        totals.rows = textAt(row, 0).toLongLong();
        for (int at = 1; at < PQnfields(row); ++at)
            totals.sums.push_back(textAt(row, at).toLongLong());
    });
    return totals;
}

std::map<QByteArray, qint64> BulkAccess::lastKeys() {
    std::map<QByteArray, QByteArray> sequences;
    eachResult(Generated, [&](const PGresult* row) { sequences[textAt(row, 0)] = textAt(row, 1); });
    std::map<QByteArray, qint64> keys;
    for (const auto& [table, sequence] : sequences)
        keys[table] = number("SELECT last_value - (NOT is_called)::int FROM " + sequence);
    return keys;
}

void BulkAccess::add(const TableShape& shape, const BulkRow& row) {
    Pending& pending = pending_[&shape];
    pending.columns = row.size();
    for (std::size_t at = 0; at < row.size(); ++at) {
        if (at > 0) pending.lines += '\t';
        append(pending.lines, row[at]);
    }
    pending.lines += '\n';
    if (pending.lines.size() >= Enough) flush(shape, pending);
}

void BulkAccess::change(const TableShape& shape, const BulkRow& row) {
    QByteArray& name = changes_[&shape];
    if (name.isEmpty()) {
        name = "change" + QByteArray::number(changes_.size());
        PQclear(checked(PQprepare(connection_, name, shape.changeStatement("$"), 0, nullptr)));
    }
    std::vector<QByteArray> texts;
    for (const BulkValue& value : row) texts.push_back(plainText(value));
    std::vector<const char*> values;
    for (std::size_t at = 0; at < row.size(); ++at)
        values.push_back(row[at].index() == 0 ? nullptr : texts[at].constData());
    const Result result(checked(PQexecPrepared(connection_, name, static_cast<int>(values.size()),
                                               values.data(), nullptr, nullptr, 0)));
    if (qstrcmp(PQcmdTuples(result.get()), "0") == 0) shape.failForMissingRow();
}

void BulkAccess::clear(const TableShape& shape) {
    flush();
    execute("DELETE FROM " + shape.name);
}

void BulkAccess::flush() {
    for (auto& [shape, pending] : pending_) flush(*shape, pending);
    pending_.clear();
    for (const auto& [shape, name] : changes_) execute("DEALLOCATE " + name);
    changes_.clear();
}

void BulkAccess::flush(const TableShape& shape, Pending& pending) {
    if (pending.lines.isEmpty()) return;
    const QByteArray statement =
        "COPY " + shape.name + " (" + shape.columnList(pending.columns) + ") FROM STDIN";
    try {
        copyIn(statement, pending.lines);
    } catch (const core::Failure& failure) {
        throw core::Failure(failure.number(),
                            failure.text() + stumblingBlock(failure.text(), pending.lines),
                            failure.code());
    }
    pending.lines.resize(0);
}

void BulkAccess::continueAfter(const TableShape& shape, qint64 lastKey) {
    // A generated key is the first column of its table.
    execute("ALTER TABLE " + shape.name + " ALTER COLUMN " + shape.columns.front() +
            " RESTART WITH " + QByteArray::number(lastKey + 1));
}

QByteArray BulkAccess::name(const QString& text) const {
    const QByteArray utf8 = text.toUtf8();
    return taken(PQescapeIdentifier(connection_, utf8, static_cast<size_t>(utf8.size())));
}

QByteArray BulkAccess::literal(const QString& text) const {
    const QByteArray utf8 = text.toUtf8();
    return taken(PQescapeLiteral(connection_, utf8, static_cast<size_t>(utf8.size())));
}

QByteArray BulkAccess::encrypted(const QString& password, const QString& role) const {
    char* secret = PQencryptPasswordConn(connection_, password.toUtf8(), role.toUtf8(), nullptr);
    if (!secret) fail(nullptr);
    return taken(secret);
}

/// Calls for each row, one at a time. The row is the only one of the result it comes in.
void BulkAccess::eachResult(const QByteArray& query,
                            const std::function<void(const PGresult*)>& row) {
    if (!PQsendQuery(connection_, query.constData())) fail(nullptr);
    PQsetSingleRowMode(connection_);
    while (PGresult* next = PQgetResult(connection_)) {
        const Result result(checked(next));
        if (PQresultStatus(next) == PGRES_SINGLE_TUPLE) row(next);
    }
}

/// Runs a COPY … FROM STDIN and reads the answers to the end; fails with the first one that tells
/// of a failure.
void BulkAccess::copyIn(const QByteArray& statement, const QByteArray& lines) {
    execute(statement);
    if (PQputCopyData(connection_, lines.constData(), static_cast<int>(lines.size())) != 1 ||
        PQputCopyEnd(connection_, nullptr) != 1)
        fail(nullptr);
    Result failed;
    while (PGresult* next = PQgetResult(connection_)) {
        Result result(next);
        if (!failed && PQresultStatus(next) != PGRES_COMMAND_OK) failed = std::move(result);
    }
    if (failed) fail(failed.get());
}

/// The result itself, unless it tells of a failure.
PGresult* BulkAccess::checked(PGresult* result) const {
    switch (PQresultStatus(result)) {
        case PGRES_COMMAND_OK:
        case PGRES_TUPLES_OK:
        case PGRES_SINGLE_TUPLE:
        case PGRES_COPY_IN:
        case PGRES_COPY_OUT:
            return result;
        default:
            const Result failed(result);
            fail(failed.get());
    }
}

void BulkAccess::fail(const PGresult* result) const {
    QStringList lines;
    for (const int part : {PG_DIAG_MESSAGE_PRIMARY, PG_DIAG_MESSAGE_DETAIL, PG_DIAG_CONTEXT})
        if (const char* text = PQresultErrorField(result, part)) lines << QString::fromUtf8(text);
    if (lines.isEmpty()) lines << QString::fromUtf8(PQerrorMessage(connection_)).simplified();
    const char* code = PQresultErrorField(result, PG_DIAG_SQLSTATE);
    throw failure(QString::fromLatin1(code ? code : ConnectionLost), lines.join(u'\n'));
}

}  // namespace ado::postgres
