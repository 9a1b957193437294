// SPDX-License-Identifier: MIT
#pragma once

#include <QElapsedTimer>

#include "platform/ado/sqlite/BookFile.h"
#include "platform/ado/sqlite/Dialect.h"
#include "platform/ado/sqlite/Handle.h"
#include "platform/ado/sqlite/Locks.h"

namespace ado::sqlite {

/// A book in one SQLite file. Each pass reads on a handle of its own as long as it lasts, writes go
/// through another one: so a scan never hides later writes from the other reads, and a write never
/// stands in the way of a scan.
class Session final : public ado::Session,
                      public Schema,
                      public std::enable_shared_from_this<Session> {
public:
    /// Opens the existing book FOLDER/catalog.db.
    Session(const QString& folder, const QString& catalog, int timeoutSeconds);

    std::shared_ptr<ado::Pass> open(const Query& statement, const QString& table) override;
    bool isTable(QStringView name) override;
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
    void setTimeout(int seconds) override;
    const QString& book() const override { return file_.path(); }

    std::optional<ColumnType> columnType(QStringView table, QStringView column) override;
    QString identity(QStringView table) override {
        return isTable(table) ? QString::fromLatin1(Identity) : QString();
    }

    // For the passes: a reader that nobody else steps on, and its way back.
    std::shared_ptr<Handle> takeReader();
    void giveBack(std::shared_ptr<Handle> reader);
    /// The statement, prepared on that reader, its values bound.
    std::unique_ptr<SqliteQuery> prepare(Handle& reader, const Query& statement, bool withIdentity);

private:
    static void requireContent(Handle& handle);
    Handle& reader();
    Handle& writer();
    std::unique_ptr<Handle> opened(Handle::Role role) const;
    /// Runs a write with its values; gives the number of rows that it touched.
    int execute(const QByteArray& text, const std::vector<QVariant>& values);
    /// Runs writes in one commit; none of them stands when one fails.
    template <class Writes>
    void together(const Writes& writes);
    /// Runs a write of one statement, which commits unless it is gathered.
    template <class Write>
    void alone(const Write& write);
    /// Commits what is gathered so far.
    void commitGathered();
    void accompany(const Accompanying& with, RowIdentity row);
    /// Declared type of a view's column.
    std::optional<ColumnType> viewColumnType(QStringView view, QStringView column);

    BookFile file_;
    int timeout_;
    std::vector<std::shared_ptr<Handle>> readers_;  ///< idle ones
    std::unique_ptr<Handle> writer_;                ///< opened by the first write
    Locks locks_;

    /// The insert and the removal that were made last.
    struct Insert {
        QString table;
        QStringList columns;
        QByteArray text;
    };
    Insert inserted_;
    struct Removal {
        QString table;
        QByteArray text;
    };
    Removal removed_;

    bool isGathering_ = false;
    bool holdsGathered_ = false;  ///< the writer is in the midst of a transaction
    int gatheredWrites_ = 0;      ///< in it
    QElapsedTimer gathered_;      ///< since it began
};

}  // namespace ado::sqlite
