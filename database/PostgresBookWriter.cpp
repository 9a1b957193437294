// SPDX-License-Identifier: MIT
#include "database/PostgresBookWriter.h"

#include <QRegularExpression>
#include <charconv>

#include "platform/core/Failure.h"

namespace database {

using namespace Qt::StringLiterals;

namespace {

/// Bytes of a table that are gathered before they go to the server, which takes the rows of one
/// table at a time.
constexpr qsizetype Enough = 256 * 1024;

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

void append(QByteArray& line, const Value& value) {
    if (const auto* number = std::get_if<qint64>(&value)) {
        line += QByteArray::number(*number);
    } else if (const auto* real = std::get_if<double>(&value)) {
        char digits[32];
        const auto end = std::to_chars(std::begin(digits), std::end(digits), *real);
        line.append(digits, end.ptr - digits);
    } else if (const auto* money = std::get_if<core::Money>(&value)) {
        line += money->toPlainText().toLatin1();
    } else if (const auto* text = std::get_if<QByteArray>(&value)) {
        append(line, *text);
    } else {
        line += "\\N";
    }
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

void PostgresBookWriter::add(const Table& table, const std::vector<Value>& values) {
    Q_ASSERT(values.size() == table.columns.size());
    QByteArray& lines = pending_[&table];
    for (size_t at = 0; at < values.size(); ++at) {
        if (at > 0) lines += '\t';
        append(lines, values[at]);
    }
    lines += '\n';
    if (lines.size() >= Enough) flush(table, lines);
}

void PostgresBookWriter::clear(const Table& table) {
    flush();
    book_.run("DELETE FROM " + table.name);
}

void PostgresBookWriter::flush() {
    for (auto& [table, lines] : pending_) flush(*table, lines);
}

void PostgresBookWriter::flush(const Table& table, QByteArray& lines) {
    if (lines.isEmpty()) return;
    try {
        book_.copyIn("COPY " + table.name + " (" + table.columnList() + ") FROM STDIN", lines);
    } catch (const core::Failure& failure) {
        throw core::Failure(failure.number(),
                            failure.text() + stumblingBlock(failure.text(), lines), failure.code());
    }
    lines.resize(0);
}

void PostgresBookWriter::continueAfter(const Table& table, qint64 lastKey) {
    // A generated key is the first column of its table.
    book_.run("ALTER TABLE " + table.name + " ALTER COLUMN " + table.columns.front() +
              " RESTART WITH " + QByteArray::number(lastKey + 1));
}

void PostgresBookWriter::finish() {
    flush();
    book_.run(ContinueBehindHighest);
    book_.run("ANALYZE");
}

}  // namespace database
