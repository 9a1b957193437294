// SPDX-License-Identifier: MIT
#pragma once

#include <QDateTime>
#include <QLockFile>
#include <map>

#include "host/bankfile/Batch.h"

namespace bankfile {

/// A transfer that was written to a file for the bank.
struct SentTransfer {
    QString staffNumber;
    core::Money amount;
    QString reference;
    std::vector<MovementKey> movements;
};

/// A file that was made for the bank, or begun.
struct SentFile {
    QDateTime when;
    QString who;
    QString file;
    QString book;  ///< where it lies
    /// False when the program ended before it could say so: the file is there whole, or not at all.
    bool isDone = false;
    std::vector<SentTransfer> transfers = {};

    core::Money sum() const;
};

/// Of a movement that stands in a file already.
struct EarlierFile {
    QString file;
    QDateTime when;
    bool isDone = false;
};
using SentMovements = std::map<MovementKey, EarlierFile>;

/// What this user has made for the bank, on this machine: one record a file, below
/// `$XDG_DATA_HOME/zelmars/transferencias`, readable by its owner only. A record appears in one go,
/// so that none is ever half written; whether its file was begun or done is told by its own name.
/// Failures are core::Failure.
class SentTransfers {
public:
    /// Fails when the folder cannot be made.
    SentTransfers();

    /// Keeps other programs from making a file until the object is gone. Fails when another one
    /// does so for longer than a few seconds.
    void lock();

    /// The newest first. Fails when a record cannot be understood.
    std::vector<SentFile> files() const;
    /// The movements of a book that stand in a file, each with the newest such file.
    SentMovements movementsOf(const QString& book) const;

    // A record's name: letters, digits and "-".

    /// Keeps a record of a file that is about to be made.
    void begin(const QString& name, const SentFile& sent) const;
    /// The file is there.
    void finish(const QString& name) const;
    /// There is no such file.
    void giveUp(const QString& name) const;

private:
    QString begunPath(const QString& name) const;
    QString folder_;
    QLockFile lock_;
};

}  // namespace bankfile
