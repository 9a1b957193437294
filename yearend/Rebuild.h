// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

/// The repair of the movements and the rebuild of the accumulators from them.
namespace yearend {

/// The five stages, in their order.
enum class Stage { Movements, MovementsLeft, History, Accumulators, AccumulatorsLeft };

/// Shows how far a rebuild is.
class RebuildView {
public:
    virtual ~RebuildView() = default;
    /// A stage has so many rows to go through; 0 for nothing to do.
    virtual void begun(Stage stage, int rows) = 0;
    virtual void rowDone(Stage stage) = 0;
    virtual void done(Stage stage) = 0;
    /// The long wait before a table is filled: for its old rows to go and the sums to come.
    virtual void waitBegun() = 0;
    virtual void waitDone() = 0;
    /// Called at each row, so that the windows get their turn.
    virtual void serve() = 0;
};

/// Goes through the three tables of movements and makes 0 of each null amount; then makes both
/// tables of accumulators anew from the movements in force: one row for each member, person and
/// rubric, with the sums of debit and credit and the number of movements. History has no
/// accumulators. A failure leaves what was done until then.
void repairAndRebuild(RebuildView& view);

}  // namespace yearend
