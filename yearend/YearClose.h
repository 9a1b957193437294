// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

/// The turn of the plan year.
namespace yearend {

/// Shows how far a close is.
class CloseView {
public:
    virtual ~CloseView() = default;
    /// How far the debts are, of DebtSteps.
    virtual void debtsAt(int step) = 0;
    /// So many movements go to history.
    virtual void historyBegun(int movements) = 0;
    virtual void movementCopied() = 0;
    /// Called at each row, so that the windows get their turn.
    virtual void serve() = 0;
};
inline constexpr int DebtSteps = 6;

/// What a close has come to. The order is that of its writes; a failure leaves what was written.
enum class ClosePhase { Debts, History, Emptying, NewYear, Done };

/// Moves all movements to history, stamped with the year and with the members' names and addresses
/// of today, empties the tables of the year, begins the numbers at 1, and carries each debt above
/// 0.1 over as one movement. The tables of the year are to have been repaired before.
/// @param year   as it was typed; a whole number, or the close fails where it is needed
/// @param phase  follows the work, so that the caller knows what a failure left
void closeYear(const QString& year, CloseView& view, ClosePhase& phase);

}  // namespace yearend
