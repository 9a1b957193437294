// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <memory>

#include "platform/ado/Constants.h"

namespace ado {

class Session;

/// A connection to a book, opened from its connection string. The engine is chosen by the string's
/// `Data Source`: `sqlite:FOLDER` (the book is FOLDER/`Initial Catalog`.db) or
/// `postgresql:HOST[:PORT]`. Provider "MSDataShape.1" makes SHAPE queries known to it.
class Connection {
public:
    explicit Connection(const QString& name = {});
    ~Connection();
    Connection(const Connection&) = delete;
    Connection& operator=(const Connection&) = delete;

    QString Name;              ///< as the data environment knows it; may be empty
    QString ConnectionString;  ///< takes effect at the next Open
    int CommandTimeout = 30;   ///< seconds that a query or a lock waits before it fails

    ObjectState State() const { return session_ ? adStateOpen : adStateClosed; }
    /// Opens an existing book; never makes one. Fails with the engine's text, or with a text that
    /// names the known forms of `Data Source`; ObjectOpen when it is open already.
    void Open();
    /// Fails with ObjectClosed when it is closed already. Row sets opened through it keep their
    /// rows, a pending row included, and write through the connection once it is open again.
    void Close();

    /// The open session, for the row sets. Fails with ObjectClosed when the connection is closed.
    const std::shared_ptr<Session>& session() const;
    /// True when the book has a table of that name, which books of older programs may lack.
    bool hasTable(QStringView name) const;
    /// True when its user has the right to add, change and delete rows of a table.
    bool mayWrite(const QString& table) const;
    /// True when the provider of the connection string shapes.
    bool shapes() const;

private:
    std::shared_ptr<Session> session_;
    bool shapes_ = false;
};

using ConnectionPtr = std::shared_ptr<Connection>;

/// True when a `Data Source` leads to a server on another machine and gives encryption up
/// ("?tls=no"), so that anybody on the way can read along. False for a source that leads nowhere.
bool isReadableOnTheWay(const QString& dataSource);

}  // namespace ado
