// SPDX-License-Identifier: MIT
#include "host/bankfile/TransferRows.h"

#include <map>

#include "payments/PaymentQueries.h"
#include "platform/ado/Recordset.h"
#include "platform/core/Failure.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace bankfile {

namespace {

/// The movements of one member, or of nobody, in one of the two tables.
struct Group {
    core::Money sum;
    std::vector<MovementKey> movements;
    std::vector<qint64> numbers;
    bool isTaken = false;  ///< a line of the list stands for it
};

using MemberKey = std::optional<qint64>;
using Groups = std::map<MemberKey, std::vector<Group>>;

/// An amount of whatever kind the engine gives for a column or a sum; null is 0.
core::Money moneyOf(const QVariant& value) {
    if (core::isNull(value)) return {};
    if (value.metaType() == QMetaType::fromType<core::Money>()) return value.value<core::Money>();
    return core::Money::fromDouble(core::toDouble(value));
}

std::optional<qint64> numberOf(const QVariant& value) {
    return core::isNull(value) ? std::nullopt : std::optional(value.toLongLong());
}

ado::RecordsetPtr opened(const QString& query, const ado::ConnectionPtr& connection) {
    const ado::RecordsetPtr rows = ado::Recordset::create();
    rows->Open(query, connection);
    return rows;
}

void gather(Groups& groups, const QString& query, const ado::ConnectionPtr& connection, bool left) {
    std::map<MemberKey, Group> found;
    const ado::RecordsetPtr rows = opened(query, connection);
    for (; !rows->atEnd(); rows->MoveNext()) {
        Group& group = found[numberOf(rows->value(2))];
        group.sum = group.sum + moneyOf(rows->value(3));
        group.movements.push_back({left, rows->value(0).toLongLong()});
        if (const auto number = numberOf(rows->value(1))) group.numbers.push_back(*number);
    }
    for (auto& [member, group] : found) groups[member].push_back(std::move(group));
}

/// The movements behind a line. A number that stands in both tables has two groups, and the sum
/// tells them apart; null when no movements come to that sum.
Group* groupOf(Groups& groups, const MemberKey& member, core::Money sum) {
    for (Group& group : groups[member]) {
        if (group.isTaken || group.sum != sum) continue;
        group.isTaken = true;
        return &group;
    }
    return nullptr;
}

/// Nothing when the movements do not come to the sums of the list.
std::optional<std::vector<TransferRow>> tryToRead(const ado::ConnectionPtr& connection,
                                                  const QDate& first, const QDate& last) {
    Groups groups;
    for (const bool left : {false, true})
        gather(groups, payments::transferMovementsQuery(first, last, left), connection, left);
    std::vector<TransferRow> transfers;
    const ado::RecordsetPtr rows = opened(payments::transferListQuery(first, last), connection);
    for (; !rows->atEnd(); rows->MoveNext()) {
        const core::Money amount = moneyOf(rows->value(4));
        Group* const group = groupOf(groups, numberOf(rows->value(0)), amount);
        if (!group) return std::nullopt;
        transfers.push_back({.staffNumber = core::toText(rows->value(1)),
                             .name = core::toText(rows->value(2)),
                             .nib = core::toText(rows->value(3)),
                             .amount = amount,
                             .movements = std::move(group->movements),
                             .numbers = std::move(group->numbers)});
    }
    return transfers;
}

}  // namespace

std::vector<TransferRow> readTransferRows(const QString& connection, const QDate& first,
                                          const QDate& last) {
    constexpr int Tries = 3;
    const auto book = std::make_shared<ado::Connection>();
    book->ConnectionString = connection;
    book->Open();
    for (int tried = 0; tried < Tries; ++tried)
        if (auto rows = tryToRead(book, first, last)) return *std::move(rows);
    throw core::Failure(core::InvalidCall,
                        u"Os movimentos mudaram enquanto eram lidos, e as somas da listagem não "
                        "condizem com eles. Tente outra vez."_s);
}

}  // namespace bankfile
