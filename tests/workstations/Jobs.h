// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <random>

/// What the people of an office key in: drawn at random, and the same in every run.
namespace office {

constexpr int SharedHouseholds = 50;   ///< members 1 to 50, whom all workstations post for
constexpr int PostingsPerPrivate = 8;  ///< every so many postings one is for a member of its own

/// Rubrics of the office's book. Shares of the shared ones are quarters, so that sums of whole
/// euros are exact in a 32-bit float whatever their order.
constexpr int MainRubric = 1;
constexpr double SharedPercents[] = {1, 0.5, 0.25, 0.75};  ///< of rubrics 2 to 5
constexpr int PrivateRubric = 6;
constexpr double PrivatePercent = 0.8;

/// One document or hospital bill.
struct Job {
    int socio_id = 0;
    QString codABC;
    int rubrica_id = 0;
    qint64 cents = 0;
    bool isBill = false;
};

/// The posting of that number, from 1 on, at that workstation, from 1 on.
inline Job jobOf(int workstation, int number) {
    std::minstd_rand random(static_cast<unsigned>(workstation * 100'000 + number));
    random.discard(3);
    const auto upTo = [&](int count) {
        return static_cast<int>(random() % static_cast<unsigned>(count));
    };
    static const QString persons[] = {QStringLiteral("A"), QStringLiteral("B"),
                                      QStringLiteral("C1")};
    Job job;
    job.isBill = upTo(5) == 0;
    job.codABC = persons[upTo(3)];
    if (number % PostingsPerPrivate == 0) {
        // Nobody else posts for this one, so that the order of its sums is known.
        job.socio_id = SharedHouseholds + workstation;
        job.rubrica_id = PrivateRubric;
        job.cents = 1 + upTo(20'000);
    } else {
        job.socio_id = 1 + upTo(SharedHouseholds);
        job.rubrica_id = MainRubric + 1 + upTo(4);
        job.cents = 100 * (1 + upTo(200));
    }
    return job;
}

/// The number that a document bears, by which it is found again.
inline QString documentNumber(int workstation, int number) {
    return QStringLiteral("p%1-%2").arg(workstation).arg(number);
}

}  // namespace office
