// SPDX-License-Identifier: MIT
#include "platform/ado/Connection.h"

#include <QStringList>

#include "platform/ado/engine/ConnectionSettings.h"
#include "platform/ado/postgres/Engine.h"
#include "platform/ado/sqlite/Engine.h"
#include "platform/core/Failure.h"

namespace ado {

using namespace Qt::StringLiterals;

namespace {

/// All that a `Data Source` can name.
const Engine* const Engines[] = {&sqlite::engine(), &postgres::engine()};

/// A `Data Source` in its parts; without an engine when it names none.
struct Source {
    explicit Source(const QString& dataSource) : place(dataSource.section(u':', 1)) {
        const QString name = dataSource.section(u':', 0, 0).trimmed().toLower();
        for (const Engine* each : Engines)
            if (each->name() == name) engine = each;
    }

    const Engine* engine = nullptr;
    QString place;
};

/// The book that `Initial Catalog` names, on the engine that `Data Source` names.
std::shared_ptr<Session> openSession(const ConnectionSettings& settings, int timeoutSeconds) {
    const QString dataSource = settings.value(u"Data Source"_s).trimmed();
    const QString catalog = settings.value(u"Initial Catalog"_s).trimmed();
    const auto refuse = [&](const QString& why) {
        return core::Failure(
            core::InvalidCall,
            u"Não foi possível abrir a origem dos dados «%1»: %2"_s.arg(dataSource, why));
    };
    const Source source(dataSource);
    if (!source.engine || source.place.isEmpty()) {
        QStringList forms;
        for (const Engine* each : Engines) forms << u"«%1»"_s.arg(each->form());
        throw refuse(u"as formas conhecidas são %1."_s.arg(forms.join(u" e "_s)));
    }
    if (catalog.isEmpty()) throw refuse(u"falta o nome do livro (Initial Catalog)."_s);
    return source.engine->open(source.place, catalog, settings, timeoutSeconds);
}

}  // namespace

bool isReadableOnTheWay(const QString& dataSource) {
    const Source source(dataSource);
    return source.engine && source.engine->isReadableOnTheWay(source.place);
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

bool Connection::mayWrite(const QString& table) const {
    return session()->mayWrite(table);
}

bool Connection::hasTable(QStringView name) const {
    return session()->isTable(name);
}

bool Connection::shapes() const {
    return shapes_;
}

}  // namespace ado
