// SPDX-License-Identifier: MIT
#include "platform/ado/engine/RowStore.h"

#include <algorithm>
#include <cstring>

#include "platform/ado/engine/RowFile.h"

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

/// Bytes that are read from a file at once; rows are mostly asked for one behind the other.
constexpr std::size_t Stretch = 64 << 10;

}  // namespace

/// The rows that were set aside, in the pieces in which that was done.
struct RowStore::Aside {
    struct Piece {
        std::size_t start;
        qint64 place;  ///< in the file
    };
    std::shared_ptr<RowFile> file;
    std::vector<Piece> pieces;
    std::vector<char> stretch;  ///< read last
    std::size_t start = 0;      ///< of the stretch
};

void RowStore::setAside(const std::shared_ptr<RowFile>& file) {
    if (bytes_.empty()) return;
    if (!aside_) aside_ = std::make_shared<Aside>(Aside{file, {}, {}});
    aside_->pieces.push_back({before_, file->append(bytes_.data(), bytes_.size())});
    before_ += bytes_.size();
    bytes_ = {};
}

/// The bytes of a row.
const char* RowStore::packed(std::size_t start, std::size_t end) const {
    if (start >= before_) return bytes_.data() + (start - before_);
    if (start < aside_->start || end > aside_->start + aside_->stretch.size()) {
        const auto behind =
            std::upper_bound(aside_->pieces.begin(), aside_->pieces.end(), start,
                             [](std::size_t at, const auto& piece) { return at < piece.start; });
        const std::size_t endOfPiece = behind == aside_->pieces.end() ? before_ : behind->start;
        const auto& piece = *std::prev(behind);
        aside_->start = before_;  // of no row, in case the reading fails
        aside_->stretch.resize(std::max(end - start, std::min(Stretch, endOfPiece - start)));
        aside_->file->read(piece.place + static_cast<qint64>(start - piece.start),
                           aside_->stretch.data(), aside_->stretch.size());
        aside_->start = start;
    }
    return aside_->stretch.data() + (start - aside_->start);
}

void RowStore::clear() {
    bytes_.clear();
    before_ = 0;
    aside_.reset();
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
    starts_.push_back(before_ + bytes_.size());
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
    const std::size_t start = starts_[place];
    const std::size_t behind =
        place + 1 < starts_.size() ? starts_[place + 1] : before_ + bytes_.size();
    const char* at = packed(start, behind);
    const char* const end = at + (behind - start);
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
