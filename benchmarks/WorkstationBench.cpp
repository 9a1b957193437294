// SPDX-License-Identifier: MIT
// Eight workstations that post at once, on both engines, against eight processes that do the bare
// queries and locks; and workstations that are killed at random instants. The script of the
// tests runs the office.
#include <QCoreApplication>
#include <QProcess>
#include <cstdio>
#include <stdexcept>

#include "benchmarks/Benches.h"

using namespace Qt::StringLiterals;

namespace benchmarks {

namespace {

const QString Workstations = u"8"_s;
const QString Postings = u"1000"_s;
const QString Kills = u"200"_s;
/// Shorter stretches of work, each on a book of its own, measured in turn.
constexpr int Rounds = 5;
const QString RoundPostings = u"200"_s;

/// At least 0.6 of the postings that the bare queries reach in the same time.
constexpr double Throughput = 1 / 0.6;

struct Outcome {
    double pace = 0;  ///< milliseconds of the whole office for one posting
    int faults = 0;
    double release = 0;  ///< milliseconds from a kill until what was held was free
};

/// Runs the office and prints what it says.
Outcome office(const QString& engine, const QStringList& task) {
    QProcess script;
    script.setProcessChannelMode(QProcess::ForwardedErrorChannel);
    script.start(u"python3"_s, QStringList{u"tests/workstations/office.py"_s,
                                           QCoreApplication::applicationDirPath(), engine} +
                                   task);
    script.waitForFinished(-1);
    const QList<QByteArray> lines = script.readAll().trimmed().split('\n');
    const QList<QByteArray> figures = lines.last().split(' ');
    if (figures.size() != 4) throw std::runtime_error("the office did not work");
    for (const QByteArray& line : lines.mid(0, lines.size() - 1))
        std::printf("%s\n", line.constData());
    std::fflush(stdout);
    return {figures[0].toDouble() * 1000 / figures[1].toDouble(), figures[2].toInt(),
            figures[3].toDouble()};
}

void measurePostings(Report& report, const QString& engine) {
    const QString name = u"workstations/"_s + engine;
    if (!report.wanted(name)) return;
    const QStringList round{u"work"_s, Workstations, RoundPostings};
    std::vector<double> ours, bare;
    for (int at = 0; at < Rounds; ++at) {
        // Each of the two goes first in turn: the second one finds the memory filled.
        if (at % 2 != 0) ours.push_back(office(engine, round).pace);
        bare.push_back(office(engine, round + QStringList{u"bare_workstation"_s}).pace);
        if (at % 2 == 0) ours.push_back(office(engine, round).pace);
    }
    report.ratio(name, Throughput, ours, bare);
    report.value(name + u" faults"_s, u""_s, 0,
                 office(engine, {u"work"_s, Workstations, Postings}).faults);
}

void measureKills(Report& report, const QString& engine) {
    const QString name = u"workstations/"_s + engine + u" killed"_s;
    if (!report.wanted(name)) return;
    const Outcome outcome = office(engine, {u"kill"_s, u"4"_s, Kills});
    report.value(name + u", release"_s, u"ms"_s, 1000, outcome.release);
    report.value(name + u", faults"_s, u""_s, 0, outcome.faults);
}

}  // namespace

void measureWorkstations(Report& report) {
    for (const QString& engine : {u"sqlite"_s, u"postgresql"_s}) {
        measurePostings(report, engine);
        measureKills(report, engine);
    }
}

}  // namespace benchmarks
