// SPDX-License-Identifier: MIT
// Where a server is: names are looked up here and not by the client library, which would wait for a
// silent name server as long as that pleases.
#include <netdb.h>
#include <sys/socket.h>

#include <chrono>
#include <future>
#include <thread>

#include "platform/ado/PostgresHandle.h"
#include "platform/core/Failure.h"

namespace ado {

using namespace Qt::StringLiterals;

namespace {

PostgresAddress::Found addressesOf(const QByteArray& host) {
    addrinfo wanted{};
    wanted.ai_socktype = SOCK_STREAM;
    addrinfo* list = nullptr;
    PostgresAddress::Found found;
    if (const int error = getaddrinfo(host.constData(), nullptr, &wanted, &list); error != 0) {
        found.error = u"o nome «%1» não foi encontrado (%2)."_s.arg(
            QString::fromUtf8(host), QString::fromLocal8Bit(gai_strerror(error)));
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

}  // namespace

void PostgresAddress::place(const QString& text) {
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
}

QString PostgresAddress::shown() const {
    const bool isNumeric = host.contains(u':') && host[0] != u'/' && host[0] != u'[';
    const QString place = isNumeric ? u'[' + host + u']' : host;
    return u"postgresql:"_s + place + (port.isEmpty() ? QString() : u':' + port) + u'/' + catalog;
}

PostgresAddress::Found PostgresAddress::lookUp(const QDeadlineTimer& deadline) const {
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
    found.isLate = answer.wait_for(std::chrono::milliseconds(deadline.remainingTime())) !=
                   std::future_status::ready;
    return found.isLate ? found : answer.get();
}

}  // namespace ado
