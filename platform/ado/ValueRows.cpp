// SPDX-License-Identifier: MIT
#include "platform/ado/ValueRows.h"

#include "platform/ado/engine/ColumnValue.h"
#include "platform/core/Values.h"

namespace ado {

int ValueRows::indexOf(QStringView name) const {
    for (int column = 0; column < columnCount(); ++column)
        if (this->column(column).name.compare(name, Qt::CaseInsensitive) == 0) return column;
    return -1;
}

bool ValueRows::step() {
    return ++at_ < static_cast<qint64>(rows_.size());
}

Cell ValueRows::cell(int column) const {
    const QVariant value = rows_[static_cast<std::size_t>(at_)].value(column);
    if (core::isNull(value)) return {};
    switch (this->column(column).type) {
        case ColumnType::Integer16:
        case ColumnType::Integer32:
        case ColumnType::Integer64:
            return {.kind = Cell::Integer, .integer = value.toLongLong(), .text = {}};
        case ColumnType::Single:
        case ColumnType::Double:
        case ColumnType::Money:
            return {.kind = Cell::Real, .real = core::toDouble(value), .text = {}};
        case ColumnType::DateTime:
            text_ = storedForm(value.toDateTime()).toLatin1();
            break;
        case ColumnType::Text:
        case ColumnType::Other:
            text_ = core::toText(value).toUtf8();
            break;
    }
    return {.kind = Cell::Text,
            .text = std::string_view(text_.constData(), static_cast<std::size_t>(text_.size()))};
}

}  // namespace ado
