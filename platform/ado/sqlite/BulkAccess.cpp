// SPDX-License-Identifier: MIT
#include "platform/ado/sqlite/BulkAccess.h"

#include "platform/ado/sqlite/BookFile.h"
#include "platform/ado/sqlite/Types.h"

namespace ado::sqlite {

namespace {

/// Seconds to wait for another program that writes. The work itself takes as long as it takes.
constexpr int Patience = 5;

// A rollback journal notes only what was there before, so filling an empty book writes each page
// once; the write-ahead log would write all of it twice.
constexpr const char* BeginFilling =
    "PRAGMA journal_mode=DELETE; PRAGMA cache_size=-200000; BEGIN EXCLUSIVE";
constexpr const char* BackToDailyWork = "PRAGMA cache_size=-2000; PRAGMA journal_mode=WAL";

QByteArray textAt(sqlite3_stmt* row, int column) {
    const std::string_view text = cellOf(row, column).text;
    return {text.data(), static_cast<qsizetype>(text.size())};
}

/// What stands in a column, whatever it was declared to hold: the engine keeps anything anywhere,
/// and it is for the other side to refuse what does not fit.
BulkValue valueAt(sqlite3_stmt* row, int column, ColumnType type) {
    const Cell cell = cellOf(row, column);
    const bool isMoney = type == ColumnType::Money;
    switch (cell.kind) {
        case Cell::Null:
            return {};
        case Cell::Integer:
            if (isMoney) return core::Money::fromDouble(static_cast<double>(cell.integer));
            return cell.integer;
        case Cell::Real:
            if (isMoney) return core::Money::fromDouble(cell.real);
            return cell.real;
        default:
            return QByteArray(cell.text.data(), static_cast<qsizetype>(cell.text.size()));
    }
}

Cell cellOf(const BulkValue& value) {
    Cell cell;
    if (const auto* number = std::get_if<qint64>(&value)) {
        cell.kind = Cell::Integer;
        cell.integer = *number;
    } else if (const auto* real = std::get_if<double>(&value)) {
        cell.kind = Cell::Real;
        cell.real = *real;
    } else if (const auto* money = std::get_if<core::Money>(&value)) {
        cell.kind = Cell::Real;
        cell.real = money->toDouble();
    } else if (const auto* text = std::get_if<QByteArray>(&value)) {
        cell.kind = Cell::Text;
        cell.text = {text->constData(), static_cast<std::size_t>(text->size())};
    }
    return cell;
}

/// Looks at the journal beside the file before the engine does.
const QString& ownJournal(const QString& file) {
    BookFile(file).refuseForeignJournal();
    return file;
}

}  // namespace

BulkAccess::BulkAccess(const QString& file)
    : handle_(ownJournal(file), Handle::Role::Writer, Patience) {
    handle_.liftLimits();
}

// Whatever fails here failed before, and was told then.
BulkAccess::~BulkAccess() {
    if (!sqlite3_get_autocommit(handle_.get()))
        sqlite3_exec(handle_.get(), "ROLLBACK", nullptr, nullptr, nullptr);
    if (purpose_ == Purpose::Filling)
        sqlite3_exec(handle_.get(), BackToDailyWork, nullptr, nullptr, nullptr);
}

void BulkAccess::begin(Purpose purpose) {
    purpose_ = purpose;
    if (purpose == Purpose::Filling) return execute(BeginFilling);
    execute(purpose == Purpose::Reading ? "BEGIN" : "BEGIN IMMEDIATE");
}

void BulkAccess::commit() {
    execute("COMMIT");
}

qint64 BulkAccess::number(const QByteArray& query) {
    const SqliteStatement statement = handle_.prepare(query);
    return step(statement.get()) ? sqlite3_column_int64(statement.get(), 0) : 0;
}

QStringList BulkAccess::texts(const QByteArray& query) {
    QStringList texts;
    const SqliteStatement statement = handle_.prepare(query);
    while (step(statement.get())) {
        const auto* text = sqlite3_column_text(statement.get(), 0);
        texts << QString::fromUtf8(reinterpret_cast<const char*>(text));
    }
    return texts;
}

/// False at the end.
bool BulkAccess::step(sqlite3_stmt* statement) {
    const int result = handle_.step(statement);
    if (result != SQLITE_ROW && result != SQLITE_DONE) handle_.fail();
    return result == SQLITE_ROW;
}

std::vector<TableShape> BulkAccess::tables() {
    std::vector<TableShape> shapes;
    const SqliteStatement columns = handle_.prepare(
        "SELECT t.name, c.name, c.type FROM sqlite_master t, "
        "pragma_table_info(t.name) c WHERE t.type = 'table' AND "
        "t.name NOT LIKE 'sqlite\\_%' ESCAPE '\\' ORDER BY t.name, c.cid");
    while (step(columns.get())) {
        const QByteArray table = textAt(columns.get(), 0);
        if (shapes.empty() || shapes.back().name != table) shapes.push_back({table, {}, {}});
        shapes.back().columns.push_back(textAt(columns.get(), 1));
        shapes.back().types.push_back(typeOfDeclaration(textAt(columns.get(), 2)));
    }
    return shapes;
}

void BulkAccess::eachRow(const TableShape& shape, const std::function<void(const BulkRow&)>& row) {
    const SqliteStatement rows = handle_.prepare("SELECT " + shape.columnList() + " FROM " +
                                                 shape.name + " ORDER BY _rowid_");
    BulkRow values(shape.types.size());
    while (step(rows.get())) {
        for (std::size_t at = 0; at < values.size(); ++at)
            values[at] = valueAt(rows.get(), static_cast<int>(at), shape.types[at]);
        row(values);
    }
}

std::set<QByteArray> BulkAccess::parts() {
    std::set<QByteArray> names;
    for (const QString& name :
         texts("SELECT name FROM sqlite_master WHERE name NOT LIKE 'sqlite\\_%' ESCAPE '\\'"))
        names.insert(name.toLower().toUtf8());
    return names;
}

Totals BulkAccess::totals(const TableShape& shape) {
    QByteArray text = "SELECT count(*)";
    for (std::size_t at = 0; at < shape.types.size(); ++at)
        if (shape.types[at] == ColumnType::Money)
            text += ", sum(CAST(round(" + shape.columns[at] + " * 10000) AS INTEGER))";
    const SqliteStatement sums = handle_.prepare(text + " FROM " + shape.name);
    step(sums.get());
    Totals totals{sqlite3_column_int64(sums.get(), 0), {}};
    for (int at = 1; at < sqlite3_column_count(sums.get()); ++at)
        totals.sums.push_back(sqlite3_column_int64(sums.get(), at));
    return totals;
}

std::map<QByteArray, qint64> BulkAccess::lastKeys() {
    std::map<QByteArray, qint64> keys;
    const SqliteStatement generated = handle_.prepare(
        "SELECT t.name, coalesce(s.seq, 0) FROM sqlite_master t LEFT JOIN "
        "sqlite_sequence s ON s.name = t.name WHERE t.type = 'table' AND "
        "t.sql LIKE '%AUTOINCREMENT%'");
    while (step(generated.get()))
        keys[textAt(generated.get(), 0).toLower()] = sqlite3_column_int64(generated.get(), 1);
    return keys;
}

void BulkAccess::add(const TableShape& shape, const BulkRow& row) {
    QByteArray& text = insertions_[&shape];
    if (text.isEmpty()) {
        QByteArray marks = QByteArray("?,").repeated(static_cast<qsizetype>(row.size()));
        marks.chop(1);
        text = "INSERT INTO " + shape.name + " (" + shape.columnList(row.size()) + ") VALUES (" +
               marks + ')';
    }
    run(text, row);
}

void BulkAccess::change(const TableShape& shape, const BulkRow& row) {
    QByteArray& text = changes_[&shape];
    if (text.isEmpty()) text = shape.changeStatement("?");
    run(text, row);
    if (sqlite3_changes(handle_.get()) == 0) shape.failForMissingRow();
}

void BulkAccess::run(const QByteArray& text, const BulkRow& row) {
    sqlite3_stmt* statement = handle_.cached(text);
    for (std::size_t at = 0; at < row.size(); ++at)
        bind(statement, static_cast<int>(at) + 1, cellOf(row[at]));
    handle_.run(statement);
}

void BulkAccess::flush() {
    insertions_.clear();
    changes_.clear();
}

void BulkAccess::clear(const TableShape& shape) {
    execute("DELETE FROM " + shape.name);
}

void BulkAccess::continueAfter(const TableShape& shape, qint64 lastKey) {
    const QByteArray name = '\'' + shape.name + '\'';
    execute("DELETE FROM sqlite_sequence WHERE name = " + name +
            "; INSERT INTO sqlite_sequence (name, seq) VALUES (" + name + ", " +
            QByteArray::number(lastKey) + ")");
}

}  // namespace ado::sqlite
