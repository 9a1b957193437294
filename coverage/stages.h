// SPDX-License-Identifier: MIT
#pragma once

#include "coverage/Calculation.h"
#include "coverage/Progress.h"
#include "coverage/TryOut.h"

/// The stages of a try-out, in the order in which a document passes through them, and of its
/// annulment.
namespace coverage {

/// A try-out under way: the document, what is known so far, and who is shown it.
class Course {
public:
    Course(const Document& of, TryOut& as) : document(of), run(as), told(as.explanation) {}

    const Document& document;
    TryOut& run;
    Progress progress;
    ado::RecordsetPtr rubric;  ///< the rubric's row, open until the ceilings are done
    Explanation& told;         ///< what is known so far, for a person who asks why

    /// A column of the movement.
    QVariant value(const QString& column) const { return document.record->Collect(column); }
    Single single(const QString& column) const { return Single(value(column)); }

    /// Writes a column of the movement.
    void keep(const QString& column, const QVariant& value) {
        document.record->setCollect(column, value);
    }
    void show(Result result, const QVariant& value) {
        if (run.onShown) run.onShown(result, value);
    }
    /// Shows a result and ends its step.
    void reach(Result result, const QVariant& value) {
        show(result, value);
        progress.advance();
    }
    /// Writes a result and shows what its column keeps of it.
    void reach(Result result, const QString& column, const QVariant& value) {
        keep(column, value);
        reach(result, this->value(column));
    }
};

/// Writes what is left of all ceilings into `saldo_plafond`. False when the number of documents is
/// used up: the box was shown and the try-out ends.
bool applyCeilings(Course& course);

/// Writes balance, gross, net, credit and debit.
void setAmounts(Course& course);

/// Sets what the correcting row of an annulled document keeps of it.
void setCorrectingRow(const ado::Recordset& shown, ado::Recordset& correcting);
/// Takes an annulled document back from its accumulators.
void takeBack(const ado::Recordset& shown, const ado::Accompaniment& with);

}  // namespace coverage
