// SPDX-License-Identifier: MIT
#include "platform/ado/sqlite/Types.h"

#include <QDateTime>
#include <cstdlib>
#include <cstring>

#include "platform/ado/engine/ColumnValue.h"
#include "platform/core/Failure.h"
#include "platform/core/Money.h"

namespace ado::sqlite {

using namespace Qt::StringLiterals;

namespace {

struct Declaration {
    const char* name;
    ColumnType type;
    int bytes;
};

constexpr Declaration Declarations[] = {
    {"INTEGER", ColumnType::Integer32, 4},  {"MONEY", ColumnType::Money, 8},
    {"VARCHAR", ColumnType::Text, 0},       {"REAL", ColumnType::Single, 4},
    {"DATETIME", ColumnType::DateTime, 8},  {"TEXT", ColumnType::Text, 0},
    {"SMALLINT", ColumnType::Integer16, 2}, {"BIGINT", ColumnType::Integer64, 8},
    {"DOUBLE", ColumnType::Double, 8},      {"INT", ColumnType::Integer32, 4},
    {"CHAR", ColumnType::Text, 0},
};

const Declaration* find(const char* declared) {
    if (!declared) return nullptr;
    const std::size_t length = std::strcspn(declared, " (");
    for (const Declaration& known : Declarations)
        if (std::strlen(known.name) == length &&
            sqlite3_strnicmp(known.name, declared, static_cast<int>(length)) == 0)
            return &known;
    return nullptr;
}

/// The double nearest to the amount, if it still is that amount to the fourth decimal.
double exactly(core::Money amount) {
    const double number = amount.toDouble();
    if (core::Money::fromDouble(number) != amount)
        throw core::Failure(
            core::Overflow,
            u"O montante %1 não cabe com quatro casas decimais."_s.arg(amount.toPlainText()));
    return number;
}

void bindText(sqlite3_stmt* statement, int parameter, const QString& text) {
    const QByteArray utf8 = text.toUtf8();
    sqlite3_bind_text(statement, parameter, utf8.constData(), static_cast<int>(utf8.size()),
                      SQLITE_TRANSIENT);
}

}  // namespace

ColumnType typeOfDeclaration(const char* declared) {
    const Declaration* known = find(declared);
    return known ? known->type : ColumnType::Other;
}

Column describe(const char* name, const char* declared) {
    Column column;
    column.name = QString::fromUtf8(name);
    if (const Declaration* known = find(declared)) {
        column.type = known->type;
        column.definedSize = known->bytes;
        const char* bracket = std::strchr(declared, '(');
        if (known->type == ColumnType::Text && bracket) column.definedSize = std::atoi(bracket + 1);
    }
    return column;
}

Cell cellOf(sqlite3_stmt* statement, int column) {
    // Asked of the value itself: half the cost of asking the statement twice.
    sqlite3_value* value = sqlite3_column_value(statement, column);
    Cell cell;
    switch (sqlite3_value_type(value)) {
        case SQLITE_INTEGER:
            cell.kind = Cell::Integer;
            cell.integer = sqlite3_value_int64(value);
            break;
        case SQLITE_FLOAT:
            cell.kind = Cell::Real;
            cell.real = sqlite3_value_double(value);
            break;
        case SQLITE_NULL:
            break;
        default: {
            cell.kind = Cell::Text;
            const auto* text = static_cast<const char*>(sqlite3_value_blob(value));
            cell.text = {text, static_cast<std::size_t>(sqlite3_value_bytes(value))};
        }
    }
    return cell;
}

void bind(sqlite3_stmt* statement, int parameter, const QVariant& value) {
    if (!value.isValid()) {
        sqlite3_bind_null(statement, parameter);
    } else if (value.typeId() == qMetaTypeId<core::Money>()) {
        sqlite3_bind_double(statement, parameter, exactly(value.value<core::Money>()));
    } else {
        switch (value.typeId()) {
            case QMetaType::Float:
            case QMetaType::Double:
                sqlite3_bind_double(statement, parameter, value.toDouble());
                break;
            case QMetaType::QDateTime:
                bindText(statement, parameter, storedForm(value.toDateTime()));
                break;
            case QMetaType::QByteArray: {
                const QByteArray text = value.toByteArray();
                sqlite3_bind_text(statement, parameter, text.constData(),
                                  static_cast<int>(text.size()), SQLITE_TRANSIENT);
                break;
            }
            case QMetaType::QString:
                bindText(statement, parameter, value.toString());
                break;
            default:
                sqlite3_bind_int64(statement, parameter, value.toLongLong());
        }
    }
}

void bind(sqlite3_stmt* statement, int parameter, const Cell& value) {
    switch (value.kind) {
        case Cell::Null:
            sqlite3_bind_null(statement, parameter);
            break;
        case Cell::Integer:
            sqlite3_bind_int64(statement, parameter, value.integer);
            break;
        case Cell::Real:
            sqlite3_bind_double(statement, parameter, value.real);
            break;
        case Cell::Text:
            sqlite3_bind_text(statement, parameter, value.text.data(),
                              static_cast<int>(value.text.size()), SQLITE_TRANSIENT);
    }
}

}  // namespace ado::sqlite
