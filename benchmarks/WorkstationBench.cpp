// SPDX-License-Identifier: MIT
// Eight workstations that post at once, on both engines, against eight processes that do the bare
// statements and locks; and workstations that are killed at random instants.
#include <QCoreApplication>
#include <cstdio>

#include "benchmarks/Benches.h"
#include "tests/workstations/Office.h"

using namespace Qt::StringLiterals;

namespace benchmarks {

namespace {

constexpr int Workstations = 8;
constexpr int Postings = 1000;
constexpr int Kills = 200;
/// Shorter stretches of work, each on a book of its own, measured in turn.
constexpr int Rounds = 5;
constexpr int RoundPostings = 200;

/// At least 0.6 of the postings that the bare statements reach in the same time.
constexpr double Throughput = 1 / 0.6;

/// Prints a stretch of work. What is wrong in the book is counted over all of them.
void tell(const office::Outcome& outcome, int& faults) {
    std::printf("  %s\n", qUtf8Printable(outcome.text()));
    for (const QString& fault : outcome.faults.mid(0, 10))
        std::printf("    %s\n", qUtf8Printable(fault));
    std::fflush(stdout);
    faults += static_cast<int>(outcome.faults.size());
}

/// Milliseconds of the whole office for one posting.
double pace(const office::Outcome& outcome) {
    return outcome.seconds * 1000 / outcome.posted;
}

void measurePostings(Report& report, office::Engine engine, const QString& name) {
    if (!report.wanted(name)) return;
    const QString bareProgram = QCoreApplication::applicationDirPath() + u"/bare_workstation"_s;
    std::vector<double> ours, bare;
    int faults = 0;
    for (int round = 0; round < Rounds; ++round) {
        for (const bool isOurs : {round % 2 == 0, round % 2 != 0}) {
            office::Office office(engine, Workstations);
            const office::Outcome outcome =
                office.work(Workstations, RoundPostings, isOurs ? QString() : bareProgram);
            // The bare sums are the engine's own, not 32-bit floats: nobody audits them.
            if (isOurs) tell(outcome, faults);
            (isOurs ? ours : bare).push_back(pace(outcome));
        }
    }
    report.ratio(name, Throughput, ours, bare);
    office::Office office(engine, Workstations);
    tell(office.work(Workstations, Postings), faults);
    report.value(name + u" faults"_s, u""_s, 0, faults);
}

void measureKills(Report& report, office::Engine engine, const QString& name) {
    if (!report.wanted(name)) return;
    office::Office office(engine, Kills + Workstations);
    int faults = 0;
    const office::Outcome outcome = office.workThroughKills(4, Kills);
    tell(outcome, faults);
    tell(office.work(4, 50), faults);
    report.value(name + u" release"_s, u"ms"_s, 1000, outcome.slowestRelease);
    report.value(name + u" faults"_s, u""_s, 0, faults);
}

}  // namespace

void measureWorkstations(Report& report) {
    using office::Engine;
    measurePostings(report, Engine::Sqlite, u"workstations/sqlite"_s);
    measurePostings(report, Engine::Postgres, u"workstations/postgresql"_s);
    measureKills(report, Engine::Sqlite, u"workstations killed/sqlite"_s);
    measureKills(report, Engine::Postgres, u"workstations killed/postgresql"_s);
}

}  // namespace benchmarks
