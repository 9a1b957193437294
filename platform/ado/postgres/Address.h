// SPDX-License-Identifier: MIT
#pragma once

#include <QByteArray>
#include <QDeadlineTimer>
#include <QString>
#include <vector>

namespace ado::postgres {

/// True for what never leaves this machine: the folder of a local socket, "localhost" and the
/// loopback addresses in their usual form (127.0.0.0/8, ::1). Any other name counts as remote,
/// wherever it leads now, because whoever answers for names may lead it elsewhere.
bool isLocalHost(const QString& host);

/// An option of the client library for a new connection.
struct Option {
    const char* name;
    QByteArray value;
};

/// Where a book is and who opens it.
struct Address {
    QString host;  ///< a name, an address, or a folder with the server's local socket
    QString port;  ///< empty for the server's usual one
    QString user;
    QString password;
    QString catalog;
    int connectSeconds = 15;   ///< after which a server counts as gone
    bool allowsPlain = false;  ///< somebody decided that nothing need be encrypted on the way

    /// Reads "HOST[:PORT][?tls=no]"; an IPv6 address stands in brackets. Fails when the port is
    /// none or another word follows.
    void place(const QString& text);
    /// The server alone, as a `Data Source` names it.
    QString dataSource() const;
    /// Server and book, as texts of failures name them; never the password.
    QString shown() const;
    /// True when anybody on the way to the server can read along.
    bool isReadable() const { return allowsPlain && !isLocalHost(host); }

    /// What a host's name stands for.
    struct Found {
        QByteArray hosts;      ///< for each address the name, parted by commas
        QByteArray addresses;  ///< empty for a local socket
        QString error;         ///< why there is none
        bool isLate = false;   ///< the deadline came first
    };
    /// Fails when the operator gives up.
    Found lookUp(const QDeadlineTimer& deadline) const;
    /// The same as isReadable() once it is known where the name leads.
    bool isReadable(const Found& found) const;
    /// All that the client library needs to know to connect. Without the plain setting a remote
    /// server must encrypt and must prove that it knows the password; where a root certificate is
    /// configured it must also show a certificate for its name that this root has signed.
    std::vector<Option> options(const Found& found) const;
};

}  // namespace ado::postgres
