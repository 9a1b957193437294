// SPDX-License-Identifier: MIT
#include "platform/ado/engine/RowStore.h"

#include <cstring>

namespace ado {

namespace {

template <class Value>
void put(std::vector<char>& bytes, const Value& value) {
    const std::size_t at = bytes.size();
    bytes.resize(at + sizeof value);
    std::memcpy(bytes.data() + at, &value, sizeof value);
}

template <class Value>
Value get(const char* from) {
    Value value;
    std::memcpy(&value, from, sizeof value);
    return value;
}

/// Bytes that a packed cell takes, its kind included.
std::size_t packedSize(const char* at) {
    switch (static_cast<Cell::Kind>(*at)) {
        case Cell::Null:
            return 1;
        case Cell::Text:
            return 1 + sizeof(quint32) + get<quint32>(at + 1);
        default:
            return 1 + sizeof(qint64);
    }
}

}  // namespace

void RowStore::clear() {
    bytes_.clear();
    starts_.clear();
    identities_.clear();
}

void RowStore::shrinkTo(qint64 count) {
    const auto left = static_cast<std::size_t>(count);
    if (left < starts_.size()) bytes_.resize(starts_[left]);
    starts_.resize(std::min(left, starts_.size()));
    identities_.resize(starts_.size());
    bytes_.shrink_to_fit();
    starts_.shrink_to_fit();
    identities_.shrink_to_fit();
}

void RowStore::append(const Pass& pass) {
    beginRow(pass.identity());
    const int columns = pass.columnCount();
    for (int column = 0; column < columns; ++column) add(pass.cell(column));
}

void RowStore::beginRow(RowIdentity identity) {
    starts_.push_back(bytes_.size());
    identities_.push_back(identity);
}

void RowStore::add(const Cell& cell) {
    bytes_.push_back(static_cast<char>(cell.kind));
    switch (cell.kind) {
        case Cell::Null:
            break;
        case Cell::Integer:
            put(bytes_, cell.integer);
            break;
        case Cell::Real:
            put(bytes_, cell.real);
            break;
        case Cell::Text:
            put(bytes_, static_cast<quint32>(cell.text.size()));
            bytes_.insert(bytes_.end(), cell.text.begin(), cell.text.end());
    }
}

Cell RowStore::cell(qint64 row, int column) const {
    const auto place = static_cast<std::size_t>(row);
    const char* at = bytes_.data() + starts_[place];
    const char* const end =
        bytes_.data() + (place + 1 < starts_.size() ? starts_[place + 1] : bytes_.size());
    for (; column > 0 && at < end; --column) at += packedSize(at);
    Cell cell;
    if (at >= end) return cell;
    cell.kind = static_cast<Cell::Kind>(*at++);
    switch (cell.kind) {
        case Cell::Null:
            break;
        case Cell::Integer:
            cell.integer = get<qint64>(at);
            break;
        case Cell::Real:
            cell.real = get<double>(at);
            break;
        case Cell::Text:
            cell.text = {at + sizeof(quint32), get<quint32>(at)};
    }
    return cell;
}

}  // namespace ado
