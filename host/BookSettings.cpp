// SPDX-License-Identifier: MIT
#include "host/BookSettings.h"

#include "platform/ado/Connection.h"
#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace host {

BookSettings BookSettings::read() {
    BookSettings settings;
    settings.isComplete = settings.take().isEmpty();
    return settings;
}

BookSettings BookSettings::readOrTell() {
    try {
        return read();
    } catch (const core::Failure& failure) {
        BookSettings settings;
        settings.unreadable = failure.text();
        return settings;
    }
}

database::BookPlace BookSettings::place() const {
    if (!isComplete) throw core::Failure(core::InvalidCall, u"Não há nenhum livro escolhido."_s);
    database::BookPlace place = database::BookPlace::parsed(dtDataSource + u'/' + dtInitialCatalog);
    place.server.user = dtUser;
    place.server.password = dtPassword;
    return place;
}

QString BookSettings::bookText() const {
    const QString warning =
        ado::isReadableOnTheWay(dtDataSource) ? u", ligação não cifrada"_s : QString();
    return u"%1 (%2%3)"_s.arg(dtInitialCatalog, dtDataSource, warning);
}

}  // namespace host
