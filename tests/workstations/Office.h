// SPDX-License-Identifier: MIT
#pragma once

#include <QStringList>
#include <QTemporaryDir>
#include <map>

#include "platform/ado/Connection.h"

/// An office: several workstations, each a process of its own, on one book.
namespace office {

enum class Engine { Sqlite, Postgres };

/// What a workstation said, to be held against the book.
struct Said {
    int posted = 0;         ///< postings said to be done: 1 to this number
    bool isKilled = false;  ///< one more may be there, or half there
};

/// What came of a stretch of work.
struct Outcome {
    int posted = 0;
    int killed = 0;
    double seconds = 0;         ///< from the first posting to the last
    double slowestPosting = 0;  ///< milliseconds
    double slowestRelease = 0;  ///< milliseconds from a kill until the counter could be held
    int lostNumbers = 0;        ///< drawn by a workstation that was killed before it used them
    int lagging = 0;            ///< movements that the accumulators lack, for the same reason
    QStringList faults;         ///< empty when all was as it has to be
    QString text() const;       ///< one line for people
};

/// A book with households, and the registry folder that names it (ZELMARS_REGISTRY, while this
/// lives).
class Office {
public:
    /// @param workstations  how many may ever work, those in the place of killed ones included;
    ///                      each has a member of its own
    Office(Engine engine, int workstations);
    ~Office();
    Office(const Office&) = delete;
    Office& operator=(const Office&) = delete;

    /// Takes the counter's row away, as on a book that never numbered anything.
    void emptyCounter();
    /// So many workstations post so many documents each, all at once.
    Outcome work(int workstations, int postings, const QString& program = {});
    /// So many workstations post without end; one after the other is killed at a random instant
    /// and another one takes its place.
    Outcome workThroughKills(int workstations, int kills);

    Engine engine() const { return engine_; }
    /// A connection of this process; a refused lock fails after so many seconds.
    ado::ConnectionPtr connect(int timeoutSeconds) const;

private:
    friend class Shift;
    void makeBook();
    void fillBook(int workstations);
    void nameBook() const;
    void registerComponent() const;
    Outcome finish(Outcome outcome);

    Engine engine_;
    QTemporaryDir folder_;
    QByteArray registryBefore_;
    QString catalogue_;
    QString dataSource_;
    bool wasEmpty_ = false;     ///< the first number is given twice
    std::map<int, Said> said_;  ///< by workstation, over all stretches
};

/// Adds to the outcome what in the book does not follow from what the workstations said: numbers,
/// postings, accumulators, locks.
void audit(const ado::ConnectionPtr& book, Engine engine, const std::map<int, Said>& said,
           bool counterWasEmpty, Outcome& outcome);

}  // namespace office
