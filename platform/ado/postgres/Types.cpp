// SPDX-License-Identifier: MIT
#include "platform/ado/postgres/Types.h"

#include <QDateTime>
#include <charconv>

#include "platform/ado/engine/ColumnValue.h"
#include "platform/core/Money.h"

namespace ado::postgres {

namespace {

/// Object identifiers of the server's own types; they never change.
enum TypeId : Oid {
    Int8 = 20,
    Int2 = 21,
    Int4 = 23,
    PlainText = 25,
    Float4 = 700,
    Float8 = 701,
    Char = 1042,
    VarChar = 1043,
    Date = 1082,
    Timestamp = 1114,
    TimestampWithZone = 1184,
    Numeric = 1700,
};

/// A modifier counts its own four bytes in; below them stands the scale of a numeric.
constexpr int ModifierSize = 4;

bool isAmount(int modifier) {
    return modifier >= ModifierSize && ((modifier - ModifierSize) & 0x7FF) == 4;
}

int sizeOf(ColumnType type, Oid server, int modifier) {
    switch (type) {
        case ColumnType::Integer16:
            return 2;
        case ColumnType::Integer32:
        case ColumnType::Single:
            return 4;
        case ColumnType::Text:
            return server == PlainText ? 0 : qMax(modifier - ModifierSize, 0);
        case ColumnType::Other:
            return 0;
        default:
            return 8;
    }
}

template <class Number>
QByteArray shortest(Number number) {
    char text[32];
    const auto end = std::to_chars(std::begin(text), std::end(text), number);
    return QByteArray(text, end.ptr - text);
}

}  // namespace

ColumnType typeOf(Oid type, int modifier) {
    switch (type) {
        case Int2:
            return ColumnType::Integer16;
        case Int4:
            return ColumnType::Integer32;
        case Int8:
            return ColumnType::Integer64;
        case Float4:
            return ColumnType::Single;
        case Float8:
            return ColumnType::Double;
        case Numeric:
            return isAmount(modifier) ? ColumnType::Money : ColumnType::Double;
        case Date:
        case Timestamp:
        case TimestampWithZone:
            return ColumnType::DateTime;
        case PlainText:
        case Char:
        case VarChar:
            return ColumnType::Text;
        default:
            return ColumnType::Other;
    }
}

Column describe(const PGresult* result, int column) {
    const Oid server = PQftype(result, column);
    const int modifier = PQfmod(result, column);
    Column described;
    described.name = QString::fromUtf8(PQfname(result, column));
    described.type = typeOf(server, modifier);
    described.definedSize = sizeOf(described.type, server, modifier);
    return described;
}

Cell cellOf(const PGresult* result, int row, int column) {
    return cellOf(result, row, column, typeOf(PQftype(result, column), PQfmod(result, column)));
}

Cell cellOf(const PGresult* result, int row, int column, ColumnType type) {
    if (PQgetisnull(result, row, column)) return {};
    return cellOf({PQgetvalue(result, row, column),
                   static_cast<std::size_t>(PQgetlength(result, row, column))},
                  type);
}

Cell cellOf(std::string_view text, ColumnType type) {
    const char* const end = text.data() + text.size();
    Cell cell;
    switch (type) {
        case ColumnType::Integer16:
        case ColumnType::Integer32:
        case ColumnType::Integer64:
            cell.kind = Cell::Integer;
            std::from_chars(text.data(), end, cell.integer);
            break;
        case ColumnType::Single: {
            // Rounded once: by way of a 64-bit float it could come to a neighbour.
            float single = 0;
            cell.kind = Cell::Real;
            std::from_chars(text.data(), end, single);
            cell.real = single;
            break;
        }
        case ColumnType::Double:
            cell.kind = Cell::Real;
            std::from_chars(text.data(), end, cell.real);
            break;
        default:
            cell.kind = Cell::Text;
            cell.text = text;
    }
    return cell;
}

std::optional<QByteArray> parameterOf(const QVariant& value) {
    if (!value.isValid()) return std::nullopt;
    if (value.typeId() == qMetaTypeId<core::Money>())
        return value.value<core::Money>().toPlainText().toLatin1();
    switch (value.typeId()) {
        case QMetaType::Float:
            return shortest(value.toFloat());
        case QMetaType::Double:
            return shortest(value.toDouble());
        case QMetaType::QDateTime:
            return storedForm(value.toDateTime()).toLatin1();
        case QMetaType::QByteArray:
            return value.toByteArray();
        default:
            return value.toString().toUtf8();
    }
}

}  // namespace ado::postgres
