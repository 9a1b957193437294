// SPDX-License-Identifier: MIT
#include "companions/search/MemberIndex.h"

#include <QtEndian>
#include <algorithm>
#include <array>

#include "platform/core/Folding.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace companions {
namespace {

// One row a member. Sorted here: the engine takes seconds to order 100,000 names.
const auto AllMembers =
    u"SELECT socio_id, no_kor, nome, nome_guerra, localidade1, zelmar FROM tbSocios"_s;

// The words of a folded text, each once, each with its leading blank.
std::vector<std::string> wordsOf(const std::string& text) {
    std::vector<std::string> words;
    for (size_t begin = 0; begin < text.size();) {
        const size_t end = std::min(text.find(' ', begin + 1), text.size());
        words.push_back(text.substr(begin, end - begin));
        begin = end;
    }
    std::sort(words.begin(), words.end());
    words.erase(std::unique(words.begin(), words.end()), words.end());
    return words;
}

/// The members of the book that was searched last.
struct Kept {
    QString book;
    std::shared_ptr<const MemberIndex> members;
};

Kept& kept() {
    static Kept only;
    return only;
}

}  // namespace

std::shared_ptr<const MemberIndex> MemberIndex::read(const ado::ConnectionPtr& connection) {
    const auto rows = ado::Recordset::create();
    rows->Open(AllMembers, connection);
    const auto fresh = std::make_shared<MemberIndex>();
    if (const auto before = lastRead(connection)) {
        fresh->entries_.reserve(before->entries_.size() + 1);
        fresh->shown_.reserve(before->shown_.size());
        fresh->words_.reserve(before->words_.size());
    }
    for (; !rows->atEnd(); rows->MoveNext()) fresh->add(*rows);
    fresh->sort();
    kept() = {connection->ConnectionString, fresh};
    return fresh;
}

std::shared_ptr<const MemberIndex> MemberIndex::lastRead(const ado::ConnectionPtr& connection) {
    return kept().book == connection->ConnectionString ? kept().members : nullptr;
}

void MemberIndex::add(const ado::Recordset& row) {
    Entry entry{};
    entry.socioId = static_cast<qint32>(row.readCell(0).integer);
    const QVariant zelmar = row.value(5);
    entry.enrolled = !core::isNull(zelmar) && core::toDouble(zelmar) != 0;
    entry.shownBegin = static_cast<quint32>(shown_.size());
    for (const int column : {1, 2, 3, 4}) {
        const size_t begin = shown_.size();
        shown_ += row.readCell(column).text;
        std::replace(shown_.begin() + static_cast<std::ptrdiff_t>(begin), shown_.end(), '\n', ' ');
        shown_ += '\n';
    }
    entry.shownEnd = static_cast<quint32>(shown_.size());
    entry.wordsBegin = static_cast<quint32>(words_.size());
    core::appendFoldedWords(words_, row.readCell(1).text);
    entry.nameBegin = static_cast<quint32>(words_.size());
    core::appendFoldedWords(words_, row.readCell(2).text);
    entry.wordsEnd = static_cast<quint32>(words_.size());
    entries_.push_back(entry);
}

void MemberIndex::sort() {
    // Two numbers of a name's first bytes tell nearly all names apart, and lie side by side.
    struct Key {
        std::array<quint64, 2> head;
        quint32 position;
    };
    std::vector<Key> keys(entries_.size());
    for (quint32 at = 0; at < keys.size(); ++at) {
        std::array<char, 16> head{};
        nameWords(entries_[at]).copy(head.data(), head.size());
        keys[at] = {{qFromBigEndian<quint64>(head.data()), qFromBigEndian<quint64>(&head[8])}, at};
    }
    std::sort(keys.begin(), keys.end(), [this](const Key& a, const Key& b) {
        if (a.head != b.head) return a.head < b.head;
        const int order = nameWords(entries_[a.position]).compare(nameWords(entries_[b.position]));
        return order == 0 ? a.position < b.position : order < 0;
    });
    std::vector<Entry> sorted;
    sorted.reserve(entries_.size());
    for (const Key& key : keys) sorted.push_back(entries_[key.position]);
    entries_ = std::move(sorted);
}

Member MemberIndex::at(int position) const {
    const Entry& entry = entries_[static_cast<size_t>(position)];
    const auto lines = QString::fromUtf8(shown_.data() + entry.shownBegin,
                                         static_cast<qsizetype>(entry.shownEnd - entry.shownBegin))
                           .split(u'\n');
    return {entry.socioId, lines[0], lines[1], lines[2], lines[3], entry.enrolled};
}

std::string_view MemberIndex::words(const Entry& entry) const {
    return std::string_view(words_).substr(entry.wordsBegin, entry.wordsEnd - entry.wordsBegin);
}

std::string_view MemberIndex::nameWords(const Entry& entry) const {
    return std::string_view(words_).substr(entry.nameBegin, entry.wordsEnd - entry.nameBegin);
}

std::vector<int> MemberIndex::matching(const QString& typed) const {
    const std::string text = core::foldedWords(typed);
    const auto wanted = wordsOf(text);
    std::vector<int> found;
    for (size_t i = 0; i < entries_.size(); ++i) {
        const auto all = words(entries_[i]);
        const auto has = [&](const std::string& word) { return all.find(word) != all.npos; };
        if (std::all_of(wanted.begin(), wanted.end(), has)) found.push_back(static_cast<int>(i));
    }
    const std::string exact = text + ' ';
    std::stable_partition(found.begin(), found.end(), [&](int i) {
        return words(entries_[static_cast<size_t>(i)]).starts_with(exact);
    });
    return found;
}

}  // namespace companions
