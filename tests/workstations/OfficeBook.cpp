// SPDX-License-Identifier: MIT
// The office's book: 50 households of three, one more for each workstation, and six rubrics.
#include <libpq-fe.h>

#include <QCoreApplication>
#include <QDir>
#include <QProcess>
#include <QVariantMap>

#include "database/Book.h"
#include "database/ServerBook.h"
#include "platform/ado/Recordset.h"
#include "platform/core/Failure.h"
#include "platform/registry/Registry.h"
#include "tests/support/Server.h"
#include "tests/workstations/Jobs.h"
#include "tests/workstations/Office.h"

using namespace Qt::StringLiterals;

namespace office {

namespace {

QString makeCatalogue() {
    static int made = 0;
    const QString name = u"escritorio%1"_s.arg(++made);
    PGconn* server = PQsetdbLogin(support::Server::instance().folder().toUtf8(), nullptr, nullptr,
                                  nullptr, "postgres", support::Server::User, nullptr);
    PGresult* result = PQexec(server, "CREATE DATABASE " + name.toUtf8());
    const QString text = QString::fromUtf8(PQresultErrorMessage(result));
    PQclear(result);
    PQfinish(server);
    if (!text.isEmpty()) throw core::Failure(core::DatabaseFailure, text);
    return name;
}

void add(const ado::RecordsetPtr& rows, const QVariantMap& values) {
    rows->AddNew();
    for (auto value = values.begin(); value != values.end(); ++value)
        rows->setCollect(value.key(), value.value());
    rows->Update();
}

}  // namespace

void Office::makeBook() {
    catalogue_ = u"zelmars"_s;
    if (engine_ == Engine::Sqlite) {
        dataSource_ = u"sqlite:"_s + folder_.path();
        database::createBook(folder_.path(), catalogue_);
        return;
    }
    catalogue_ = makeCatalogue();
    const QString host = support::Server::instance().folder();
    dataSource_ = u"postgresql:"_s + host;
    database::createBook({host, {}, QString::fromLatin1(support::Server::User), {}, catalogue_});
}

void Office::fillBook(int workstations) {
    const ado::ConnectionPtr book = connect(30);
    const auto table = [&](const QString& name) {
        const ado::RecordsetPtr rows = ado::Recordset::create();
        rows->Open(u"select * from "_s + name, book, ado::adOpenStatic, ado::adLockOptimistic);
        return rows;
    };
    const ado::RecordsetPtr members = table(u"tbSocios"_s);
    for (int id = 1; id <= SharedHouseholds + workstations; ++id)
        add(members, {{u"socio_id"_s, id},
                      {u"no_kor"_s, QString::number(100'000 + id)},
                      {u"nome"_s, u"Associado %1"_s.arg(id)},
                      {u"nib"_s, QString(21, u'1')},
                      {u"zelmar"_s, 1}});
    const ado::RecordsetPtr rubrics = table(u"tbZelmar_Plafonds"_s);
    add(rubrics, {{u"rubrica_id"_s, MainRubric}, {u"code"_s, u"1"_s}, {u"agregado"_s, 40'000}});
    const auto addRubric = [&](int id, double percent, const QVariantMap& ceilings) {
        QVariantMap values{{u"rubrica_id"_s, id},   {u"rubrica_id_main"_s, MainRubric},
                           {u"code"_s, u"1"_s},     {u"percent"_s, percent},
                           {u"socio"_s, 1'000'000}, {u"familiar"_s, 1'000'000}};
        values.insert(ceilings);
        add(rubrics, values);
    };
    addRubric(2, SharedPercents[0], {});
    addRubric(3, SharedPercents[1], {{u"franquia"_s, 10}});
    addRubric(4, SharedPercents[2], {{u"agregado"_s, 1'000}});
    addRubric(5, SharedPercents[3], {{u"total_familia"_s, 2'000}});
    addRubric(PrivateRubric, PrivatePercent, {});
}

void Office::nameBook() const {
    const std::pair<QString, QString> values[] = {
        {u"dtSecurityInfo"_s, u"True"_s}, {u"dtUser"_s, QString::fromLatin1(support::Server::User)},
        {u"dtPassword"_s, QString()},     {u"dtInitialCatalog"_s, catalogue_},
        {u"dtDataSource"_s, dataSource_},
    };
    for (const auto& [name, value] : values)
        registry::writeValue(registry::Hive::LocalMachine, u"SOFTWARE\\Norvanta\\Corvenda"_s, name,
                             value);
}

void Office::registerComponent() const {
    if (QProcess::execute(QCoreApplication::applicationDirPath() + u"/zelmars"_s,
                          {u"register"_s}) != 0)
        throw core::Failure(core::CannotCreateObject, u"the component is not registered"_s);
}

ado::ConnectionPtr Office::connect(int timeoutSeconds) const {
    auto book = std::make_shared<ado::Connection>();
    book->ConnectionString =
        u"Provider=SQLOLEDB.1;User ID=%1;Password=;Initial Catalog=%2;Data Source=%3"_s.arg(
            QString::fromLatin1(support::Server::User), catalogue_, dataSource_);
    book->CommandTimeout = timeoutSeconds;
    book->Open();
    return book;
}

void Office::emptyCounter() {
    const ado::RecordsetPtr counter = ado::Recordset::create();
    counter->Open(u"select * from tbContadores"_s, connect(30), ado::adOpenStatic,
                  ado::adLockOptimistic);
    counter->Delete();
    wasEmpty_ = true;
}

}  // namespace office
