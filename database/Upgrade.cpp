// SPDX-License-Identifier: MIT
#include "database/Upgrade.h"

#include <QDateTime>
#include <QDir>

#include "database/Backup.h"
#include "database/Schema.h"
#include "database/ServerRoles.h"
#include "database/Version.h"
#include "platform/ado/postgres/BulkAccess.h"
#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace database {

namespace {

core::Failure refusal(const QString& text) {
    return {core::InvalidCall, text};
}

void refuseOthers(const BookPlace& place) {
    const QStringList others = othersIn(place);
    if (others.isEmpty()) return;
    throw refusal(u"está aberto por %1. Feche-o em todos os postos e tente de novo."_s.arg(
        others.join(u", "_s)));
}

/// One step of the schema, from the version before.
void takeStep(ado::BulkAccess& book, int version) {
    book.execute(book.translated(schemaText(u"to%1.sql"_s.arg(version))));
    if (version == 2) numberFarAbove(book);
}

void setVersion(ado::BulkAccess& book) {
    book.execute("DELETE FROM tbVersao; INSERT INTO tbVersao (versao) VALUES (" +
                 QByteArray::number(SchemaVersion) + ")");
}

void change(ado::BulkAccess& book, int from) {
    for (int version = from + 1; version <= SchemaVersion; ++version) takeStep(book, version);
    setVersion(book);
}

/// What is made in a book belongs to the one who owns the rest of it; the rights are given by the
/// administrator.
void changeOnServer(ado::postgres::BulkAccess& book, const BookPlace& place, int from) {
    becomeOwner(book);
    change(book, from);
    book.execute("RESET ROLE");
    renewRights(book, place.server.catalog);
}

int upgraded(const BookPlace& place, const QString& backup, const UpgradeListener& listener) {
    refuseOthers(place);
    const std::unique_ptr<ado::BulkAccess> book = opened(place);
    auto* server = dynamic_cast<ado::postgres::BulkAccess*>(book.get());
    if (schemaVersion(*book) == SchemaVersion) return SchemaVersion;
    if (server) refuseOthersThanAdministrator(*server, place.server.user);
    book->begin(ado::BulkAccess::Purpose::Changing);
    // Somebody else may have done it while this program waited for its turn.
    const int from = schemaVersion(*book);
    if (from == SchemaVersion) return from;
    backUpBook(place, backup);
    listener(u"Cópia de segurança: %1"_s.arg(backup));
    if (server)
        changeOnServer(*server, place, from);
    else
        change(*book, from);
    listener(u"Esquema: da versão %1 para a %2"_s.arg(from).arg(SchemaVersion));
    book->commit();
    return from;
}

}  // namespace

QString upgradeBackupFile(const BookPlace& place, int version) {
    const QDir folder(place.isOnServer() ? QDir::homePath() : place.folder);
    const QString name = folder.absoluteFilePath(
        u"%1-versao%2-%3"_s.arg(place.name, QString::number(version),
                                QDateTime::currentDateTime().toString(u"yyyyMMdd-HHmmss"_s)));
    const QString ending = place.isOnServer() ? u".dump"_s : u".db"_s;
    QString file = name + ending;
    for (int number = 2; QFile::exists(file); ++number)
        file = name + u'-' + QString::number(number) + ending;
    return file;
}

int bringUpToDate(const BookPlace& place, const QString& backup, const UpgradeListener& listener) {
    try {
        return upgraded(place, backup, listener);
    } catch (const core::Failure& failure) {
        throw core::Failure(failure.number(),
                            u"O livro «%1» não foi atualizado, e ficou como estava: %2"_s.arg(
                                place.shown(), failure.text()),
                            failure.code());
    }
}

}  // namespace database
