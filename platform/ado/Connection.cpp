// SPDX-License-Identifier: MIT
#include "platform/ado/Connection.h"

#include "platform/ado/ConnectionSettings.h"
#include "platform/ado/postgres/Session.h"
#include "platform/ado/sqlite/Session.h"
#include "platform/core/Failure.h"

namespace ado {

using namespace Qt::StringLiterals;

namespace {

constexpr auto Server = "postgresql"_L1;

struct Source {
    QString engine;  ///< in small letters
    QString place;
};

Source parted(const QString& dataSource) {
    return {dataSource.section(u':', 0, 0).trimmed().toLower(), dataSource.section(u':', 1)};
}

std::shared_ptr<Session> openServer(const ConnectionSettings& settings, const QString& place,
                                    const QString& catalog, int timeoutSeconds) {
    postgres::Address address;
    address.place(place);
    address.catalog = catalog;
    address.user = settings.value(u"User ID"_s);
    address.password = settings.value(u"Password"_s);
    if (const int seconds = settings.value(u"Connect Timeout"_s).toInt(); seconds > 0)
        address.connectSeconds = seconds;
    return std::make_shared<postgres::Session>(address, timeoutSeconds);
}

/// The engine that `Data Source` names, on the book that `Initial Catalog` names.
std::shared_ptr<Session> openSession(const ConnectionSettings& settings, int timeoutSeconds) {
    const QString source = settings.value(u"Data Source"_s).trimmed();
    const QString catalog = settings.value(u"Initial Catalog"_s).trimmed();
    const auto refuse = [&](const QString& why) {
        return core::Failure(
            core::InvalidCall,
            u"Não foi possível abrir a origem dos dados «%1»: %2"_s.arg(source, why));
    };
    const auto& [engine, place] = parted(source);
    const bool isServer = engine == Server;
    if (place.isEmpty() || (!isServer && engine != "sqlite"_L1))
        throw refuse(u"as formas conhecidas são «sqlite:PASTA» e «postgresql:SERVIDOR[:PORTA]»."_s);
    if (catalog.isEmpty()) throw refuse(u"falta o nome do livro (Initial Catalog)."_s);
    if (isServer) return openServer(settings, place, catalog, timeoutSeconds);
    return std::make_shared<sqlite::Session>(place, catalog, timeoutSeconds);
}

}  // namespace

ConnectionSettings::ConnectionSettings(const QString& text) {
    for (qsizetype at = 0; at < text.size();) {
        const qsizetype sign = text.indexOf(u'=', at);
        if (sign < 0) break;
        qsizetype from = sign + 1;
        while (from < text.size() && text[from] == u' ') ++from;
        const QChar quote = from < text.size() ? text[from] : QChar();
        const bool isQuoted =
            (quote == u'"' || quote == u'\'') && text.indexOf(quote, from + 1) > 0;
        const qsizetype close = isQuoted ? text.indexOf(quote, from + 1) : from;
        qsizetype end = text.indexOf(u';', close);
        if (end < 0) end = text.size();
        const QString value =
            isQuoted ? text.mid(from + 1, close - from - 1) : text.mid(from, end - from);
        values_.insert(text.mid(at, sign - at).trimmed().toLower(), value);
        at = end + 1;
    }
}

bool isReadableOnTheWay(const QString& dataSource) {
    const auto& [engine, place] = parted(dataSource);
    if (engine != Server) return false;
    try {
        postgres::Address address;
        address.place(place);
        return address.isReadable();
    } catch (const core::Failure&) {
        return false;
    }
}

Connection::Connection(const QString& name) : Name(name) {}
Connection::~Connection() = default;

void Connection::Open() {
    if (session_) throw core::Failure(core::ObjectOpen, u"A ligação já está aberta."_s);
    const ConnectionSettings settings(ConnectionString);
    session_ = openSession(settings, CommandTimeout);
    shapes_ = settings.value(u"Provider"_s).compare("MSDataShape.1"_L1, Qt::CaseInsensitive) == 0;
}

void Connection::Close() {
    if (!session_) throw core::Failure(core::ObjectClosed, u"A ligação está fechada."_s);
    session_.reset();
}

const std::shared_ptr<Session>& Connection::session() const {
    if (!session_) throw core::Failure(core::ObjectClosed, u"A ligação está fechada."_s);
    return session_;
}

bool Connection::hasTable(QStringView name) const {
    return session()->isTable(name);
}

bool Connection::shapes() const {
    return shapes_;
}

}  // namespace ado
