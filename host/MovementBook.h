// SPDX-License-Identifier: MIT
#pragma once

#include <QVariant>
#include <functional>
#include <memory>
#include <stop_token>
#include <vector>

#include "host/BookSettings.h"
#include "host/MovementSearch.h"
#include "platform/ado/Connection.h"

namespace host {

/// One movement as the list shows it.
struct MovementRow {
    enum Column {
        Number,
        Date,
        StaffNumber,
        Name,
        Person,
        Type,
        Document,
        Value,
        Credit,
        Debit,
        ColumnCount
    };
    qint32 movimento_id = 0;
    QVariant values[ColumnCount];
};

/// Reads the movements in force of one book, on a connection of its own. Reads only. Every failure
/// is a core::Failure. One object belongs to one thread.
class MovementBook {
public:
    explicit MovementBook(const BookSettings& settings);

    /// The newest movements, at most `count`, with the names of their persons.
    std::shared_ptr<MovementSearch> newest(int count) const;
    /// Told how many movements have been read, every now and then.
    using Progress = std::function<void(int movements)>;
    /// All movements and the names of all persons; null when it was stopped.
    std::shared_ptr<MovementSearch> all(const std::stop_token& stop,
                                        const Progress& progress) const;
    /// Takes in what was posted since, and what those rows annul; returns how many movements were
    /// posted.
    int takeNewer(MovementSearch& search) const;

    /// Whether it holds the members whom every sample book has.
    bool isSample() const;

    /// What the list shows of some movements, in any order; missing ones are left out.
    std::vector<MovementRow> rows(const std::vector<qint32>& keys) const;

private:
    std::vector<qint32> numbers(const QString& query) const;
    QDate lastDay(const QString& table) const;
    std::vector<qint32> newestKeys(int count) const;
    std::vector<MovementKey> named(const std::vector<qint32>& keys, MovementSearch& search) const;
    void takeAnnulled(MovementSearch& search, qint32 socio_id) const;
    ado::ConnectionPtr connection_;
};

}  // namespace host
