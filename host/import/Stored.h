// SPDX-License-Identifier: MIT
#pragma once

#include <QHash>
#include <QSet>
#include <functional>
#include <map>
#include <optional>

#include "host/import/Kinds.h"
#include "platform/ado/engine/BulkAccess.h"

namespace importing {

/// Calls for each row of a table, with the values of some columns in their order.
void eachRow(ado::BulkAccess& book, const QByteArray& table, const std::vector<QByteArray>& columns,
             const std::function<void(const ado::BulkRow&)>& take);

/// What a book holds of a kind before an import, and what it refers to.
class Stored {
public:
    /// The texts of the key's columns.
    using Key = QStringList;
    struct Row {
        qint64 key = 0;  ///< the table's own
        std::map<QByteArray, ado::BulkValue> values;
    };
    /// Stands for several members, or groups, of one number.
    static constexpr qint64 Several = -1;

    /// Reads the book.
    Stored(const Description& description, ado::BulkAccess& book);

    /// Null when the book has none.
    const Row* find(const Key& key) const;
    /// True when several rows have that key.
    bool isAmbiguous(const Key& key) const { return ambiguous_.contains(key); }

    /// The member of a staff number, the group of a code; nothing when there is none.
    std::optional<qint64> member(const QString& no_kor) const { return found(members_, no_kor); }
    std::optional<qint64> group(const QString& code) const { return found(groups_, code); }
    /// Whether a staff number is that of a member who has left.
    bool hasLeft(const QString& no_kor) const { return left_.contains(no_kor); }
    bool isPersonCode(const QString& code) const { return personCodes_.contains(code); }

private:
    static std::optional<qint64> found(const QHash<QString, qint64>& all, const QString& text);
    void readRows(const Description& description, ado::BulkAccess& book);

    QHash<Key, Row> rows_;
    QSet<Key> ambiguous_;
    QHash<QString, qint64> members_;
    QHash<QString, qint64> groups_;
    QSet<QString> left_;
    QSet<QString> personCodes_;
};

}  // namespace importing
