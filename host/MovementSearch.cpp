// SPDX-License-Identifier: MIT
#include "host/MovementSearch.h"

#include <QStringList>
#include <algorithm>
#include <numeric>
#include <tuple>

#include "platform/core/Folding.h"
#include "platform/core/Format.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

/// Where a text stands in a short list; it is added when it is new.
quint16 positionOf(std::string_view text, std::vector<std::string>& list) {
    const auto known = std::find(list.begin(), list.end(), text);
    if (known != list.end()) return quint16(known - list.begin());
    list.emplace_back(text);
    return quint16(list.size() - 1);
}

/// A text without blanks at its ends, and with one only where there are several.
std::string simplified(const std::string& text) {
    const bool isSimple = text.find("  ") == text.npos &&
                          text.find_first_of("\t\n\r") == text.npos && !text.starts_with(' ') &&
                          !text.ends_with(' ');
    return isSimple ? text : QString::fromStdString(text).simplified().toStdString();
}

constexpr std::size_t LongestText = 1000;  // what can be searched for, in bytes

/// The days that somebody means who types a day into a filter, as he would into a field, or a month
/// of a year ("11-2026").
struct TypedDays {
    explicit TypedDays(const QString& word) {
        if (const std::optional<QDate> day = core::parseDate(word)) {
            first = last = *day;
            return;
        }
        const QStringList parts =
            QString(word).replace('/'_L1, '-'_L1).replace('.'_L1, '-'_L1).split('-'_L1);
        if (parts.size() != 2 || parts[1].size() != 4) return;
        first = QDate(parts[1].toInt(), parts[0].toInt(), 1);
        last = first.addMonths(1).addDays(-1);
    }
    bool fit(QDate day) const { return first.isValid() && day >= first && day <= last; }

    QDate first;
    QDate last;
};

/// A number without leading zeros; 0 for anything else.
quint32 wholeNumber(const QString& word) {
    return word.startsWith('0'_L1) ? 0 : word.toUInt();
}

}  // namespace

/// One word of a filter. What it says of the persons is worked out once for all, in the order in
/// which their names lie in memory.
class MovementSearch::Word {
public:
    Word(const MovementSearch& search, const QString& text)
        : search_(search),
          inDocument_(' ' + core::folded(text)),
          days_(text),
          number_(wholeNumber(text)) {
        for (const std::string& type : search.types_)
            fitsType_.push_back(type == core::folded(text) ? 1 : 0);
        askPersons(core::foldedWords(text));
    }

    bool fits(const Item& item) const {
        return fitsType_[item.type] || fitsPerson_[item.person] || fitsNumber(item.number) ||
               isIn(inDocument_, search_.text(item.document, item.documentSize)) ||
               fitsDay(item.day);
    }

private:
    /// Whether a word of the text begins with this one. Each word of the text stands behind a
    /// blank.
    static bool isIn(std::string_view beginning, std::string_view text) {
        if (beginning.size() < 2) return false;
        std::size_t at = 0;
        while (at != std::string_view::npos && at + beginning.size() <= text.size()) {
            if (text[at + 1] == beginning[1] && text.substr(at, beginning.size()) == beginning)
                return true;
            at = text.find(' ', at + 1);
        }
        return false;
    }
    void askPersons(const std::string& words) {
        fitsPerson_.resize(search_.persons_.size(), 0);
        for (std::size_t at = 0; at < fitsPerson_.size(); ++at) {
            const Person& person = search_.persons_[at];
            fitsPerson_[at] = isIn(words, search_.text(person.words, person.wordsSize)) ? 1 : 0;
        }
        for (std::size_t at = 0; at < fitsPerson_.size(); ++at)
            fitsPerson_[at] |= fitsPerson_[search_.persons_[at].member];
    }
    bool fitsNumber(qint32 number) const {
        if (number_ == 0 || number <= 0) return false;
        auto rest = static_cast<quint32>(number);
        while (rest > number_) rest /= 10;
        return rest == number_;
    }
    bool fitsDay(qint32 day) const { return day != 0 && days_.fit(QDate::fromJulianDay(day)); }

    const MovementSearch& search_;
    std::string inDocument_;
    TypedDays days_;
    quint32 number_;  // 0 for none
    std::vector<quint8> fitsType_;
    std::vector<quint8> fitsPerson_;
};

void MovementSearch::append(const MovementKey& movement) {
    items_.push_back(itemOf(movement));
    amounts_.push_back(movement.amounts);
}

void MovementSearch::prepend(const std::vector<MovementKey>& movements) {
    std::vector<Item> newer;
    std::vector<std::array<qint64, 3>> amounts;
    for (const MovementKey& movement : movements) {
        newer.push_back(itemOf(movement));
        amounts.push_back(movement.amounts);
    }
    items_.insert(items_.begin(), newer.begin(), newer.end());
    amounts_.insert(amounts_.begin(), amounts.begin(), amounts.end());
}

void MovementSearch::sort() {
    std::vector<quint32> order(items_.size());
    std::iota(order.begin(), order.end(), 0U);
    std::sort(order.begin(), order.end(), [this](quint32 a, quint32 b) {
        return std::tie(items_[a].day, items_[a].id) > std::tie(items_[b].day, items_[b].id);
    });
    std::vector<Item> items;
    std::vector<std::array<qint64, 3>> amounts;
    items.reserve(order.size());
    amounts.reserve(order.size());
    for (const quint32 position : order) {
        items.push_back(items_[position]);
        amounts.push_back(amounts_[position]);
    }
    items_ = std::move(items);
    amounts_ = std::move(amounts);
}

void MovementSearch::correct(const MovementKey& movement) {
    const auto known = std::find_if(items_.begin(), items_.end(), [&](const Item& item) {
        return item.id == movement.movimento_id;
    });
    if (known == items_.end()) return;
    *known = itemOf(movement);
    amounts_[std::size_t(known - items_.begin())] = movement.amounts;
}

void MovementSearch::knowKey(bool activo, qint32 movimento_id) {
    qint32& newest = newest_[activo ? 1 : 0];
    newest = std::max(newest, movimento_id);
}

void MovementSearch::nameMember(qint32 socio_id, std::string_view no_kor, std::string_view nome) {
    name(memberAt(socio_id), core::foldedWords(no_kor), core::foldedWords(nome));
}

void MovementSearch::nameRelative(qint32 socio_id, std::string_view codABC, std::string_view nome) {
    if (codABC.empty()) return;
    name(relativeAt(socio_id, codABC), {}, core::foldedWords(nome));
}

std::vector<quint32> MovementSearch::find(const QString& filter) const {
    std::vector<Word> words;
    for (const QString& text : filter.simplified().split(' '_L1, Qt::SkipEmptyParts))
        words.emplace_back(*this, text);
    std::vector<quint32> found;
    for (std::size_t position = 0; position < items_.size(); ++position) {
        const auto fits = [&](const Word& word) { return word.fits(items_[position]); };
        if (std::all_of(words.begin(), words.end(), fits)) found.push_back(quint32(position));
    }
    return found;
}

MovementSearch::Item MovementSearch::itemOf(const MovementKey& movement) {
    knowKey(movement.activo, movement.movimento_id);
    const std::string document =
        ' ' + core::folded(simplified(movement.doc_no)).substr(0, LongestText);
    const Item item{movement.movimento_id,
                    movement.movimento_no,
                    relativeAt(movement.socio_id, movement.codABC),
                    movement.data.isValid() ? qint32(movement.data.toJulianDay()) : 0,
                    quint32(texts_.size()),
                    quint16(document.size()),
                    typeAt(movement.tipo)};
    texts_ += document;
    return item;
}

/// Of a few types, each folded once.
quint16 MovementSearch::typeAt(const std::string& tipo) {
    const quint16 position = positionOf(tipo, rawTypes_);
    if (position == types_.size()) types_.push_back(core::folded(std::string_view(tipo)));
    return position;
}

quint32 MovementSearch::memberAt(qint32 socio_id) {
    const quint64 key = quint64(quint32(socio_id)) << 16;
    const auto known = personAt_.constFind(key);
    return known != personAt_.constEnd() ? *known : addPerson(key, quint32(persons_.size()));
}

quint32 MovementSearch::relativeAt(qint32 socio_id, std::string_view codABC) {
    if (codABC.empty()) return memberAt(socio_id);
    const auto code = quint64(positionOf(codABC, codes_)) + 1;
    const quint64 key = quint64(quint32(socio_id)) << 16 | code;
    const auto known = personAt_.constFind(key);
    return known != personAt_.constEnd() ? *known : addPerson(key, memberAt(socio_id));
}

quint32 MovementSearch::addPerson(quint64 key, quint32 member) {
    const auto person = quint32(persons_.size());
    persons_.push_back({member, 0, 0, 0});
    personAt_.insert(key, person);
    return person;
}

void MovementSearch::name(quint32 at, const std::string& staff, const std::string& nome) {
    Person& person = persons_[at];
    const std::string words = staff + nome;
    if (text(person.words, person.wordsSize) == words) return;
    person.words = quint32(texts_.size());
    person.wordsSize = quint16(std::min(words.size(), LongestText));
    person.staffSize = quint16(std::min(staff.size(), LongestText));
    texts_.append(words, 0, person.wordsSize);
}

std::string_view MovementSearch::text(quint32 from, quint16 size) const {
    return std::string_view(texts_).substr(from, size);
}

}  // namespace host
