// SPDX-License-Identifier: MIT
#include "companions/search/MemberIndex.h"

#include <algorithm>

#include "platform/ado/Recordset.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace companions {
namespace {

const auto AllMembers =
    u"SELECT socio_id, no_kor, nome, nome_guerra, localidade1, zelmar "
    "FROM tbSocios ORDER BY nome"_s;

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

}  // namespace

std::string folded(const QString& text) {
    QString plain;
    plain.reserve(text.size() + 1);
    bool between = true;
    for (const QChar c : text.normalized(QString::NormalizationForm_KD)) {
        if (c.isMark()) continue;
        const bool part = c.isLetterOrNumber() || c.isSurrogate();
        if (part && between) plain += u' ';
        if (part) plain += c.toCaseFolded();
        between = !part;
    }
    return plain.toStdString();
}

void MemberIndex::load(const ado::ConnectionPtr& connection) {
    const auto rows = ado::Recordset::create();
    rows->Open(AllMembers, connection);
    MemberIndex fresh;
    for (; !rows->atEnd(); rows->MoveNext()) {
        const QVariant zelmar = rows->value(5);
        fresh.add({core::toLong(rows->value(0)), core::toText(rows->value(1)),
                   core::toText(rows->value(2)), core::toText(rows->value(3)),
                   core::toText(rows->value(4)),
                   !core::isNull(zelmar) && core::toDouble(zelmar) != 0});
    }
    *this = std::move(fresh);
}

void MemberIndex::add(const Member& member) {
    QStringList shown{member.number, member.name, member.shortName, member.locality};
    shown_ += shown.replaceInStrings(u"\n"_s, u" "_s).join(u'\n').toUtf8();
    words_ += folded(member.number) + folded(member.name);
    entries_.push_back({member.socioId, member.enrolled, static_cast<quint32>(shown_.size()),
                        static_cast<quint32>(words_.size())});
}

Member MemberIndex::at(int position) const {
    const auto i = static_cast<size_t>(position);
    const Entry& entry = entries_[i];
    const auto begin = static_cast<qsizetype>(i == 0 ? 0 : entries_[i - 1].shownEnd);
    const auto texts =
        QString::fromUtf8(shown_.mid(begin, static_cast<qsizetype>(entry.shownEnd) - begin))
            .split(u'\n');
    return {entry.socioId, texts[0], texts[1], texts[2], texts[3], entry.enrolled};
}

std::string_view MemberIndex::words(size_t position) const {
    const size_t begin = position == 0 ? 0 : entries_[position - 1].wordsEnd;
    return std::string_view(words_).substr(begin, entries_[position].wordsEnd - begin);
}

std::vector<int> MemberIndex::matching(const QString& typed) const {
    const std::string text = folded(typed);
    const auto wanted = wordsOf(text);
    std::vector<int> found;
    for (size_t i = 0; i < entries_.size(); ++i) {
        const auto all = words(i);
        const auto has = [&](const std::string& word) { return all.find(word) != all.npos; };
        if (std::all_of(wanted.begin(), wanted.end(), has)) found.push_back(static_cast<int>(i));
    }
    const std::string exact = text + ' ';
    std::stable_partition(found.begin(), found.end(),
                          [&](int i) { return words(static_cast<size_t>(i)).starts_with(exact); });
    return found;
}

}  // namespace companions
