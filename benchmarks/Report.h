// SPDX-License-Identifier: MIT
#pragma once

#include <QStringList>
#include <functional>
#include <vector>

namespace benchmarks {

/// One row of the result: a pair with its ratio, or one value with its limit.
struct Row {
    QString name;
    QString unit;
    double ours = 0;
    double bare = 0;   ///< 0 for a row without a counterpart
    double value = 0;  ///< what is held against the limit: the ratio, or `ours`
    double limit = 0;
    bool met() const { return value <= limit; }
};

/// Measures, prints and keeps the rows.
class Report {
public:
    /// @param names  beginnings of the names to measure; none measures all
    explicit Report(const QStringList& names) : names_(names) {}

    bool wanted(const QString& name) const;

    /// Runs both in turn, round by round, and holds the median of the rounds' ratios against the
    /// limit. Times are milliseconds a call.
    /// @param calls  calls in one round
    void pair(const QString& name, double limit, int calls, const std::function<void()>& ours,
              const std::function<void()>& bare);

    /// The median time of a call in milliseconds.
    double median(int calls, const std::function<void()>& work) const;
    /// The median of what a measurement gives, after one run to warm up.
    double medianOf(int runs, const std::function<double()>& measure) const;
    /// Times that were measured in turn, round by round: holds the median of the rounds' ratios
    /// against the limit.
    void ratio(const QString& name, double limit, const std::vector<double>& ours,
               const std::vector<double>& bare);

    /// A value that was measured elsewhere.
    void value(const QString& name, const QString& unit, double limit, double value);

    /// Writes all rows as JSON. Fails with false when the file cannot be written.
    bool write(const QString& file) const;
    bool allMet() const;

private:
    void add(const Row& row);
    QStringList names_;
    std::vector<Row> rows_;
};

}  // namespace benchmarks
