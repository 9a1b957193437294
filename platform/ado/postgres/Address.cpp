// SPDX-License-Identifier: MIT
// Where a server is: names are looked up here and not by the client library, which would wait for a
// silent name server as long as that pleases. And what a connection to it must prove before it gets
// a password.
#include "platform/ado/postgres/Address.h"

#include <arpa/inet.h>
#include <netdb.h>
#include <sys/socket.h>

#include <QDir>
#include <QFile>
#include <chrono>
#include <future>
#include <thread>

#include "platform/ado/engine/EngineTexts.h"
#include "platform/ado/engine/RowHolders.h"
#include "platform/core/Failure.h"
#include "platform/core/Wait.h"

namespace ado::postgres {

using namespace Qt::StringLiterals;

namespace {

/// After which the windows get a turn.
constexpr std::chrono::milliseconds WaitSlice(50);

Address::Found addressesOf(const QByteArray& host) {
    addrinfo wanted{};
    wanted.ai_socktype = SOCK_STREAM;
    addrinfo* list = nullptr;
    Address::Found found;
    if (const int error = getaddrinfo(host.constData(), nullptr, &wanted, &list); error != 0) {
        found.error = withDetails(
            u"O servidor «%1» não foi encontrado. Veja se o nome está certo e se a rede está "
            "ligada."_s.arg(QString::fromUtf8(host)),
            QString::fromLocal8Bit(gai_strerror(error)));
        return found;
    }
    for (const addrinfo* each = list; each; each = each->ai_next) {
        char text[NI_MAXHOST];
        if (getnameinfo(each->ai_addr, each->ai_addrlen, text, sizeof text, nullptr, 0,
                        NI_NUMERICHOST) != 0)
            continue;
        // The library wants a name beside each address.
        found.hosts += (found.hosts.isEmpty() ? "" : ",") + host;
        found.addresses += (found.addresses.isEmpty() ? "" : ",") + QByteArray(text);
    }
    freeaddrinfo(list);
    return found;
}

/// Where the certificate of whoever signs the servers' certificates lies: the client library's own
/// places first, then the one for everybody who works here. Empty when there is none.
QByteArray rootCertificate() {
    if (const QByteArray named = qgetenv("PGSSLROOTCERT"); !named.isEmpty()) return named;
    for (const QString& file :
         {QDir::homePath() + u"/.postgresql/root.crt"_s, u"/etc/zelmars/root.crt"_s})
        if (QFile::exists(file)) return QFile::encodeName(file);
    return {};
}

/// Also "localhost" may be made to lead elsewhere: every address that it stands for counts.
bool isLocal(const QString& host, const QByteArray& addresses) {
    if (!isLocalHost(host)) return false;
    for (const QByteArray& address : addresses.split(','))
        if (!address.isEmpty() && !isLocalHost(QString::fromLatin1(address))) return false;
    return true;
}

}  // namespace

bool isLocalHost(const QString& host) {
    // The library would take a list for several hosts, of which only the first was looked at.
    if (host.contains(u',')) return false;
    if (host.startsWith(u'/') || host.startsWith(u'@')) return true;
    if (host.compare("localhost"_L1, Qt::CaseInsensitive) == 0) return true;
    const QByteArray text = host.toUtf8();
    in_addr four{};
    if (inet_pton(AF_INET, text.constData(), &four) == 1) return text.startsWith("127.");
    in6_addr six{};
    return inet_pton(AF_INET6, text.constData(), &six) == 1 && IN6_IS_ADDR_LOOPBACK(&six);
}

void Address::place(const QString& whole) {
    const QString word = whole.section(u'?', 1).trimmed();
    const QString text = whole.section(u'?', 0, 0);
    const qsizetype colon = text.lastIndexOf(u':');
    if (colon > text.lastIndexOf(u']')) {
        host = text.left(colon);
        port = text.mid(colon + 1).trimmed();
        bool isNumber = false;
        const int number = port.toInt(&isNumber);
        if (!isNumber || number < 1 || number > 65535)
            throw core::Failure(
                core::InvalidCall,
                u"Não foi possível abrir o livro «%1»: a porta «%2» não existe."_s.arg(shown(),
                                                                                       port));
    } else {
        host = text;
    }
    host = host.trimmed();
    if (host.startsWith(u'[') && host.endsWith(u']')) host = host.mid(1, host.size() - 2);
    allowsPlain = word == "tls=no"_L1;
    if (whole.contains(u'?') && !allowsPlain)
        throw core::Failure(
            core::InvalidCall,
            u"Não foi possível abrir o livro «%1»: «?%2» não se conhece; só «?tls=no»."_s.arg(
                shown(), word));
}

bool Address::isReadable(const Found& found) const {
    return allowsPlain && !isLocal(host, found.addresses);
}

QString Address::shown() const {
    return dataSource() + u'/' + catalog;
}

QString Address::dataSource() const {
    const bool isNumeric = host.contains(u':') && host[0] != u'/' && host[0] != u'[';
    const QString place = isNumeric ? u'[' + host + u']' : host;
    return u"postgresql:"_s + place + (port.isEmpty() ? QString() : u':' + port) +
           (allowsPlain ? u"?tls=no"_s : QString());
}

Address::Found Address::lookUp(const QDeadlineTimer& deadline) const {
    Found found;
    found.hosts = host.toUtf8();
    const bool isSocket = host.startsWith(u'/') || host.startsWith(u'@');
    if (isSocket) return found;
    // The thread goes on alone when nobody waits for it any more.
    std::promise<Found> promise;
    std::future<Found> answer = promise.get_future();
    std::thread([name = found.hosts, given = std::move(promise)]() mutable {
        given.set_value(addressesOf(name));
    }).detach();
    core::Wait waiting(u"À espera do endereço do servidor «%1»."_s.arg(host));
    while (answer.wait_for(WaitSlice) != std::future_status::ready) {
        if (!waiting.goesOn()) throw givenUp();
        found.isLate = deadline.hasExpired();
        if (found.isLate) return found;
    }
    return answer.get();
}

std::vector<Option> Address::options(const Found& found) const {
    std::vector<Option> options{
        {"host", found.hosts},
        {"hostaddr", found.addresses},
        {"port", port.toUtf8()},
        {"user", user.toUtf8()},
        {"password", password.toUtf8()},
        {"dbname", catalog.toUtf8()},
        {"client_encoding", "UTF8"},
        {"application_name", workstation()},
        // Milliseconds after which a server that is gone is noticed, however long a statement runs.
        {"tcp_user_timeout", "30000"},
    };
    if (isLocal(host, found.addresses)) return options;
    options.push_back({"gssencmode", "disable"});
    if (allowsPlain) {
        options.push_back({"sslmode", "disable"});
        return options;
    }
    const QByteArray root = rootCertificate();
    options.push_back({"sslmode", root.isEmpty() ? "require" : "verify-full"});
    options.push_back({"sslrootcert", root});
    options.push_back({"channel_binding", "require"});
    return options;
}

}  // namespace ado::postgres
