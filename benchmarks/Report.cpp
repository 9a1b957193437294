// SPDX-License-Identifier: MIT
#include "benchmarks/Report.h"

#include <QElapsedTimer>
#include <QFile>
#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QStringList>
#include <algorithm>
#include <cstdio>

using namespace Qt::StringLiterals;

namespace benchmarks {

namespace {

constexpr int Rounds = 15;

/// Milliseconds a call.
double timed(int calls, const std::function<void()>& work) {
    QElapsedTimer clock;
    clock.start();
    for (int call = 0; call < calls; ++call) work();
    return static_cast<double>(clock.nsecsElapsed()) / 1e6 / calls;
}

double middle(std::vector<double> values) {
    std::sort(values.begin(), values.end());
    return values[values.size() / 2];
}

}  // namespace

bool Report::wanted(const QString& name) const {
    return names_.isEmpty() || std::any_of(names_.begin(), names_.end(), [&](const QString& each) {
               return name.startsWith(each);
           });
}

void Report::pair(const QString& name, double limit, int calls, const std::function<void()>& ours,
                  const std::function<void()>& bare) {
    if (!wanted(name)) return;
    std::vector<double> ourTimes, bareTimes;
    timed(calls, ours);  // warm up
    timed(calls, bare);
    for (int round = 0; round < Rounds; ++round) {
        // Each of the two goes first in turn: the second one finds the memory filled.
        const bool oursFirst = round % 2 == 0;
        double ourTime = oursFirst ? timed(calls, ours) : 0;
        const double bareTime = timed(calls, bare);
        if (!oursFirst) ourTime = timed(calls, ours);
        ourTimes.push_back(ourTime);
        bareTimes.push_back(bareTime);
    }
    ratio(name, limit, ourTimes, bareTimes);
}

double Report::median(int calls, const std::function<void()>& work) const {
    return medianOf(calls, [&] { return timed(1, work); });
}

double Report::medianOf(int runs, const std::function<double()>& measure) const {
    measure();  // warm up
    std::vector<double> values;
    for (int run = 0; run < runs; ++run) values.push_back(measure());
    return middle(values);
}

void Report::ratio(const QString& name, double limit, const std::vector<double>& ours,
                   const std::vector<double>& bare) {
    std::vector<double> ratios;
    for (std::size_t round = 0; round < ours.size(); ++round)
        ratios.push_back(ours[round] / bare[round]);
    if (wanted(name)) add({name, u"ms"_s, middle(ours), middle(bare), middle(ratios), limit});
}

void Report::value(const QString& name, const QString& unit, double limit, double value) {
    if (wanted(name)) add({name, unit, value, 0, value, limit});
}

void Report::add(const Row& row) {
    if (rows_.empty())
        std::printf("%-44s %12s %12s %8s %8s\n", "name", "ours", "bare", "ratio", "limit");
    const QByteArray ours = QByteArray::number(row.ours, 'f', 4) + ' ' + row.unit.toUtf8();
    const QByteArray bare =
        row.bare > 0 ? QByteArray::number(row.bare, 'f', 4) + ' ' + row.unit.toUtf8() : "-";
    const QByteArray ratio = row.bare > 0 ? QByteArray::number(row.value, 'f', 2) : "-";
    std::printf("%-44s %12s %12s %8s %8g%s\n", qUtf8Printable(row.name), ours.constData(),
                bare.constData(), ratio.constData(), row.limit, row.met() ? "" : "  NOT MET");
    std::fflush(stdout);
    rows_.push_back(row);
}

bool Report::write(const QString& file) const {
    QJsonArray all;
    for (const Row& row : rows_)
        all.append(QJsonObject{{u"name"_s, row.name},
                               {u"unit"_s, row.unit},
                               {u"ours"_s, row.ours},
                               {u"bare"_s, row.bare > 0 ? QJsonValue(row.bare) : QJsonValue()},
                               {u"ratio"_s, row.bare > 0 ? QJsonValue(row.value) : QJsonValue()},
                               {u"limit"_s, row.limit},
                               {u"met"_s, row.met()}});
    QFile out(file);
    return out.open(QIODevice::WriteOnly) && out.write(QJsonDocument(all).toJson()) > 0;
}

bool Report::allMet() const {
    return std::all_of(rows_.begin(), rows_.end(), [](const Row& row) { return row.met(); });
}

}  // namespace benchmarks
