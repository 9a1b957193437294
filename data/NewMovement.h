// SPDX-License-Identifier: MIT
#pragma once

#include "data/Operations.h"

/// What every new movement goes through, whatever its type.
namespace data {

/// Returns no movement, but all their columns.
inline constexpr QStringView NoMovementQuery =
    u"select * from tbzelmar_movimentos where movimento_id = 0";

/// The empty row set to which a screen adds its new row. Empty texts receive their defaults: the
/// connection "MSAccess" and the query that returns no movement. Fails as opening does.
ado::RecordsetPtr openNewMovement(QString& strConMember, QString& strSQL);

/// One row: the counters.
inline constexpr QStringView CounterQuery = u"select * from tbContadores";

/// Draws the next movement number from the counter, whose row is held meanwhile, so that no other
/// workstation is given the same. Fails when what follows it cannot be stored.
///
/// A counter without a row gives the number 1 and stores 1, so the next draw gives 1 once more.
/// Intentional: this repetition stays.
qint32 drawMovementNumber();

/// Asks whether to finish the posting.
bool confirmPosting(const QString& caption);

/// A typed value that may be a slip of the keyboard.
struct Typed {
    QString column;  ///< of the movement: a date or an amount
    QString name;    ///< as the question calls it: "A data do documento"
};

/// Asks about each date more than five years back or one ahead, and each amount above a million
/// euros, unless the operator said yes to the same value before. True when nothing is in doubt.
bool confirmUnusual(const ado::Recordset& movement, std::initializer_list<Typed> values,
                    const QString& caption, Operation& posting);

/// False, and told, when the movement has no date.
bool checkDated(const ado::Recordset& movement, const QString& caption);

/// Readies a movement that has no document for being saved: it is the member's, its document's
/// value is 0, and no failure is pending.
void readyWithoutDocument(ado::Recordset& movement, qint32 socio_id);

/// Draws the movement's number and saves the pending row: two writes, the counter first. A row
/// whose number cannot be drawn is not saved. From then on `posting` is registered and lacks the
/// accumulator.
void numberAndSave(ado::Recordset& movement, Operation& posting);

/// A further "&OK" on a posting that is registered: adds the movement to the accumulators as it
/// stands in the book, whatever was typed since. True when nothing is missing any more; otherwise
/// the operator was told, as by accumulatedOrTold().
bool finishPosting(Operation& posting, const MovementRules& rules, ado::Recordset& record,
                   const QString& caption);

/// True when no failure is pending. Otherwise shows its text, then says that nothing could be
/// registered.
bool savedOrTold(const QString& caption);

}  // namespace data
