// SPDX-License-Identifier: MIT
#pragma once

#include <QHash>
#include <QSet>

#include "platform/ado/engine/Session.h"
#include "platform/ado/postgres/Texts.h"

namespace core {
class Failure;
}

namespace ado::postgres {

/// A book on a PostgreSQL server. Passes read on connections of their own, taken from a small pool;
/// writes, fresh reads of single rows and the locks share another one, so that a write never goes
/// out when the connection that held its lock is gone. A connection that was lost is made anew by
/// the next operation.
///
/// A row's identity is its table's key where that is one integer column, else the column
/// HiddenIdentity, which the server generates and no set shows.
class Session final : public ado::Session,
                      public Schema,
                      public std::enable_shared_from_this<Session> {
public:
    /// Connects to an existing book.
    Session(const Address& address, int timeoutSeconds);

    std::shared_ptr<ado::Pass> open(const Query& statement, const QString& table) override;
    bool isTable(QStringView name) override;
    bool mayWrite(const QString& table) override;
    bool read(const QString& table, RowIdentity row, RowStore& into) override;
    RowIdentity insert(const QString& table, const QStringList& columns,
                       const std::vector<QVariant>& values, const Accompaniment& with) override;
    bool update(const QString& table, RowIdentity row, const QStringList& columns,
                const std::vector<QVariant>& values, const Accompaniment& with) override;
    bool remove(const QString& table, RowIdentity row) override;
    std::unique_ptr<RowLock> lock(const QString& table, RowIdentity row, int timeoutSeconds,
                                  RowStore& into) override;
    void gather() override;
    void settle() override;
    bool isGathering() const override { return isGathering_; }
    void setTimeout(int seconds) override { timeout_ = seconds; }
    const QString& book() const override { return book_; }

    std::optional<ColumnType> columnType(QStringView table, QStringView column) override;
    QString identity(QStringView table) override;

    // For the passes: a reader that nobody else uses, and its way back.
    std::shared_ptr<Handle> takeReader();
    void giveBack(std::shared_ptr<Handle> reader);
    /// The statement in the server's dialect.
    QByteArray translated(const Query& statement, bool withIdentity) {
        return texts_.whole(statement, withIdentity);
    }
    /// The first rows of a statement, `limit` being what says how many.
    Result firstRows(Handle& reader, const Query& statement, bool withIdentity,
                     const QByteArray& limit);
    // For the locks. Letting go of a row never fails.
    void unlock(const QByteArray& key) noexcept;
    bool isHeld(const QByteArray& key) const;

private:
    /// What the server's catalogue says about a table or view.
    struct Table {
        QHash<QString, ColumnType> types;  ///< by column
        QString identity;                  ///< empty for a view
        QByteArray select;                 ///< reads the visible columns of the row $1
    };
    /// Null when there is none of that name.
    const Table* find(QStringView name);
    Handle& writer();
    /// To write the row with; fails with RowInUse when its lock went with a connection.
    Handle& writerOf(const QString& table, RowIdentity row);
    /// Forgets what was read of the catalogue when the pass over a table shows another one.
    void compare(const QString& table, const ado::Pass& pass);
    /// Forgets it when a failure tells of a missing table or column.
    void notice(const core::Failure& failure);
    /// Does something with the server that the catalogue has to do with.
    template <class Work>
    Result noticing(const Work& work);
    Result write(Handle& handle, const std::vector<Call>& calls);
    /// Keeps a write for later, and sends those before it when there are enough.
    void keepForLater(Call call);
    enum class Reach { Memory, Disk };
    /// Sends what is gathered, to reach the server's memory or its disk.
    void sendGathered(Reach reach);
    /// Sends writes in one commit. When one of them fails those before it are stored, one by one,
    /// and its failure is told.
    void sendTogether(const std::vector<Call>& calls);
    void setReach(Reach reach);
    Call selectRow(const QString& table, RowIdentity row);
    /// Appends the one row that was found, if any; false when there is none.
    static bool append(const PGresult* found, RowIdentity row, RowStore& into);
    QString holderOf(const QByteArray& key);

    Address address_;
    QString book_;
    int timeout_;
    Texts texts_{*this};
    QHash<QString, Table> tables_;
    std::vector<std::shared_ptr<Handle>> readers_;  ///< idle ones
    std::unique_ptr<Handle> writer_;                ///< made by its first use
    QSet<QByteArray> locked_;                       ///< keys of the rows held
    QSet<QByteArray> broken_;                       ///< of those that went with a connection
    bool isGathering_ = false;
    std::vector<Call> gathered_;  ///< writes that were not sent yet
};

}  // namespace ado::postgres
