// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <memory>
#include <string>
#include <vector>

#include "platform/ado/Recordset.h"

namespace companions {

/// A member as the search window shows him.
struct Member {
    qint32 socioId = 0;
    QString number;
    QString name;
    QString shortName;
    QString locality;
    bool enrolled = false;  ///< takes part in the plan
};

/// The active members, held for searching: some 150 bytes a member, so that a keystroke among
/// 100,000 of them costs milliseconds and no query.
class MemberIndex {
public:
    /// Reads all active members, by name.
    static std::shared_ptr<const MemberIndex> read(const ado::ConnectionPtr& connection);
    /// The members as they were last read from that book in this process; null when they never
    /// were.
    static std::shared_ptr<const MemberIndex> lastRead(const ado::ConnectionPtr& connection);

    int size() const { return static_cast<int>(entries_.size()); }
    Member at(int position) const;
    qint32 socioId(int position) const { return entries_[static_cast<size_t>(position)].socioId; }

    /// Positions of the members for whom each typed word begins a word of the name or the number,
    /// in any order, without regard to accents and case. All members when nothing is typed. A
    /// number typed in full comes first.
    std::vector<int> matching(const QString& typed) const;

private:
    // Stretches of shown_ and words_.
    struct Entry {
        qint32 socioId;
        bool enrolled;
        quint32 shownBegin, shownEnd;
        quint32 wordsBegin, nameBegin, wordsEnd;
    };
    /// Adds the member of a row of the query.
    void add(const ado::Recordset& row);
    /// Puts the members in the order of their names, without regard to accents and case.
    void sort();
    std::string_view words(const Entry& entry) const;
    std::string_view nameWords(const Entry& entry) const;

    std::vector<Entry> entries_;
    std::string shown_;  // UTF-8: number, name, short name, locality, one a line
    std::string words_;  // folded: " number word word …"
};

}  // namespace companions
