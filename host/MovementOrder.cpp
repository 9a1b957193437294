// SPDX-License-Identifier: MIT
#include "host/MovementOrder.h"

#include <algorithm>
#include <utility>

namespace host {

namespace {

/// A number with a sign as one without, so that their orders are the same.
quint64 unsignedOrder(qint64 number) {
    return quint64(number) ^ (quint64(1) << 63);
}

/// The first eight bytes of a text as a number; numbers are in the order of the texts.
quint64 head(std::string_view text) {
    quint64 bytes = 0;
    for (std::size_t at = 0; at < 8; ++at)
        bytes = bytes << 8 | (at < text.size() ? static_cast<unsigned char>(text[at]) : 0);
    return bytes;
}

/// For each text its rank among all of them; equal texts have the same rank.
template <class TextAt>
std::vector<quint32> ranks(std::size_t count, const TextAt& textAt) {
    std::vector<std::pair<quint64, quint32>> texts(count);
    for (std::size_t at = 0; at < count; ++at) texts[at] = {head(textAt(at)), quint32(at)};
    std::sort(texts.begin(), texts.end(), [&](const auto& a, const auto& b) {
        return a.first != b.first ? a.first < b.first : textAt(a.second) < textAt(b.second);
    });
    std::vector<quint32> ranks(count);
    quint32 rank = 0;
    for (std::size_t at = 0; at < count; ++at) {
        if (at > 0 && textAt(texts[at].second) != textAt(texts[at - 1].second)) ++rank;
        ranks[texts[at].second] = rank;
    }
    return ranks;
}

}  // namespace

std::vector<quint32> MovementOrder::by(MovementRow::Column column, Qt::SortOrder order) const {
    const Keys keys = this->keys(column);
    std::vector<std::pair<quint64, quint32>> sorted(keys.size());
    for (std::size_t at = 0; at < keys.size(); ++at)
        sorted[at] = {order == Qt::AscendingOrder ? keys[at] : ~keys[at], quint32(at)};
    std::sort(sorted.begin(), sorted.end());
    std::vector<quint32> positions;
    positions.reserve(sorted.size());
    for (const auto& each : sorted) positions.push_back(each.second);
    return positions;
}

MovementOrder::Keys MovementOrder::keys(MovementRow::Column column) const {
    Keys keys;
    switch (column) {
        case MovementRow::StaffNumber:
            return personKeys(PersonText::Staff);
        case MovementRow::Name:
            return personKeys(PersonText::Name);
        case MovementRow::Person:
            return personKeys(PersonText::Relative);
        case MovementRow::Type:
            return typeKeys();
        case MovementRow::Document:
            return documentKeys();
        case MovementRow::Value:
        case MovementRow::Credit:
        case MovementRow::Debit:
            for (const auto& amounts : search_.amounts_)
                keys.push_back(unsignedOrder(amounts[std::size_t(column - MovementRow::Value)]));
            return keys;
        case MovementRow::Number:
            for (const auto& item : search_.items_) keys.push_back(unsignedOrder(item.number));
            return keys;
        case MovementRow::Date:
        case MovementRow::ColumnCount:
            break;
    }
    for (const auto& item : search_.items_) keys.push_back(unsignedOrder(item.day));
    return keys;
}

MovementOrder::Keys MovementOrder::personKeys(PersonText which) const {
    const auto textAt = [&](std::size_t at) { return text(search_.persons_[at], which); };
    std::vector<quint32> ranked = ranks(search_.persons_.size(), textAt);
    Keys keys;
    for (const auto& item : search_.items_) {
        const quint32 member = search_.persons_[item.person].member;
        const quint32 person = which == PersonText::Relative ? item.person : member;
        const bool isNobody = which == PersonText::Relative && person == member;
        const quint64 longerLater =
            which == PersonText::Staff ? quint64(textAt(person).size()) << 32 : 0;
        keys.push_back(isNobody ? 0 : longerLater + ranked[person] + 1);
    }
    return keys;
}

MovementOrder::Keys MovementOrder::documentKeys() const {
    const std::vector<quint32> ranked = ranks(search_.items_.size(), [&](std::size_t at) {
        const auto& item = search_.items_[at];
        return search_.text(item.document, item.documentSize);
    });
    return Keys(ranked.begin(), ranked.end());
}

MovementOrder::Keys MovementOrder::typeKeys() const {
    const std::vector<quint32> ranked = ranks(search_.types_.size(), [&](std::size_t at) {
        return std::string_view(search_.types_[at]);
    });
    Keys keys;
    for (const auto& item : search_.items_) keys.push_back(ranked[item.type]);
    return keys;
}

std::string_view MovementOrder::text(const MovementSearch::Person& person, PersonText which) const {
    const std::string_view words = search_.text(person.words, person.wordsSize);
    if (which == PersonText::Staff) return words.substr(0, person.staffSize);
    return which == PersonText::Name ? words.substr(person.staffSize) : words;
}

}  // namespace host
