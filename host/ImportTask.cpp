// SPDX-License-Identifier: MIT
#include "host/ImportTask.h"

#include <QFileInfo>

#include "database/Version.h"
#include "host/BookTasks.h"
#include "host/Console.h"
#include "host/import/Import.h"
#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

using importing::Outcome;
using importing::Plan;

bool neverGivesUp(qsizetype, qsizetype) {
    return true;
}

void tellRows(const Plan& plan, bool onlyRefused) {
    QTextStream out(stdout);
    for (const importing::PlannedRow& row : plan.rows) {
        if (onlyRefused && row.outcome != Outcome::Refused) continue;
        out << u"linha %1: %2: %3"_s.arg(row.line).arg(importing::outcomeText(row.outcome),
                                                       row.key);
        if (!row.detail.isEmpty()) out << u": "_s << row.detail;
        out << '\n';
    }
}

/// The status after a look, or a try, that left the book as it was because rows were refused.
int statusOf(const Plan& plan) {
    return plan.count(Outcome::Refused) == 0 ? 0 : 1;
}

int importUntrapped(const CommandLine& line) {
    const database::BookPlace place = placeOf(line, false);
    database::refuseOtherVersion(place);
    const importing::Wish wish{importing::descriptionOf(line.kind)->kind,
                               QFileInfo(line.file).absoluteFilePath()};
    say(u"Livro: %1"_s.arg(place.shown()));
    if (line.dryRun) {
        const Plan plan = importing::preview(wish, place, neverGivesUp).value();
        tellRows(plan, false);
        say(u"Nada foi gravado. Aconteceria: %1."_s.arg(plan.summary()));
        return statusOf(plan);
    }
    const auto refused =
        line.withoutRefused ? importing::Refused::LeaveOut : importing::Refused::WriteNothing;
    const importing::Result result =
        importing::importFile(wish, place, refused, nullptr, neverGivesUp).value();
    tellRows(result.plan, true);
    if (result.isWritten) {
        say(u"Importado: %1."_s.arg(result.plan.summary()));
        return 0;
    }
    if (!result.plan.hasWork() && (line.withoutRefused || statusOf(result.plan) == 0)) {
        say(u"Não havia nada a gravar: %1."_s.arg(result.plan.summary()));
        return 0;
    }
    complain(
        u"Nada foi importado: %1. Para importar sem as linhas recusadas, acrescente "
        "«--without-refused»."_s.arg(result.plan.summary()));
    return statusOf(result.plan);
}

}  // namespace

int importIntoBook(const CommandLine& line) {
    constexpr int CouldNotImport = 2;
    try {
        return importUntrapped(line);
    } catch (const core::Failure& failure) {
        complain(failure.text());
        return CouldNotImport;
    }
}

}  // namespace host
