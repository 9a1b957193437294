// SPDX-License-Identifier: MIT
#pragma once

#include <QDate>
#include <QHash>
#include <QString>
#include <array>
#include <limits>
#include <string>
#include <string_view>
#include <vector>

namespace host {

/// What the list looks a movement up and sorts it by.
struct MovementKey {
    static constexpr qint64 NoAmount = std::numeric_limits<qint64>::min();

    qint32 movimento_id = 0;
    qint32 movimento_no = 0;  ///< 0 for none
    qint32 socio_id = 0;
    std::string codABC = {};  // UTF-8, as the other texts
    QDate data = {};
    std::string tipo = {};
    std::string doc_no = {};
    bool activo = true;  ///< stands in the table of the active members
    /// Value, credit and debit, in the least unit of money.
    std::array<qint64, 3> amounts = {NoAmount, NoAmount, NoAmount};
};

/// All movements in force, newest first, in about 60 bytes each, so that a million of them answer
/// a keystroke without asking the database.
///
/// A filter is a list of words; a movement fits when every word fits one of: the beginning of its
/// number, of the staff number, of a word in the member's or relative's name, of a word in the
/// document's number; its type; its date (as core::parseDate reads it, or month-year with "-", "/"
/// or ".").
class MovementSearch {
public:
    /// Adds a movement older than all others; those that come in another order are put into theirs
    /// by sort().
    void append(const MovementKey& movement);
    /// The newest day first, of one day the greatest key.
    void sort();
    /// Adds movements newer than all others, the newest first.
    void prepend(const std::vector<MovementKey>& movements);
    /// Takes in anew a movement that was written again; one that is not here stays unknown.
    void correct(const MovementKey& movement);
    /// Names a member or a relative, before or after his movements; the last name given counts.
    /// A relative without a code is nobody.
    void nameMember(qint32 socio_id, std::string_view no_kor, std::string_view nome);
    void nameRelative(qint32 socio_id, std::string_view codABC, std::string_view nome);

    std::size_t size() const { return items_.size(); }
    qint32 movimento_id(std::size_t position) const { return items_[position].id; }
    /// The greatest key known of the table of the active members, or of those who left; 0 without
    /// any.
    qint32 newest(bool activo) const { return newest_[activo ? 1 : 0]; }
    /// Tells that a table holds a key, whether or not its movement is here.
    void knowKey(bool activo, qint32 movimento_id);

    /// Positions of the movements that fit, newest first.
    std::vector<quint32> find(const QString& filter) const;

private:
    friend class MovementOrder;
    struct Item {
        qint32 id;
        qint32 number;
        quint32 person;
        qint32 day;        // Julian day, 0 for none
        quint32 document;  // where its folded text begins in texts_
        quint16 documentSize;
        quint16 type;  // position in types_
    };
    struct Person {
        quint32 member;  // whose relative he is; a member is his own
        quint32 words;   // where his words begin in texts_
        quint16 wordsSize;
        quint16 staffSize;  // of them, the words of the staff number, which come first
    };
    class Word;

    Item itemOf(const MovementKey& movement);
    quint32 memberAt(qint32 socio_id);
    quint32 relativeAt(qint32 socio_id, std::string_view codABC);
    quint32 addPerson(quint64 key, quint32 member);
    void name(quint32 person, const std::string& staff, const std::string& nome);
    quint16 typeAt(const std::string& tipo);
    std::string_view text(quint32 from, quint16 size) const;

    std::vector<Item> items_;
    std::vector<std::array<qint64, 3>> amounts_;  // of the items
    std::vector<Person> persons_;
    QHash<quint64, quint32> personAt_;   // by socio_id, shifted left, plus the position in codes_
                                         // plus 1; 0 for the member
    std::vector<std::string> types_;     // folded
    std::vector<std::string> rawTypes_;  // as they were given, at the same positions
    std::vector<std::string> codes_;
    std::string texts_;          // folded; each word behind a blank
    qint32 newest_[2] = {0, 0};  // of those who left, of the active
};

}  // namespace host
