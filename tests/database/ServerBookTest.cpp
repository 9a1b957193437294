// SPDX-License-Identifier: MIT
// Books on a server: what makes them, and who may do what in them.
#include "database/ServerBook.h"

#include <gtest/gtest.h>

#include <QTemporaryDir>

#include "platform/ado/Connection.h"
#include "platform/ado/Recordset.h"
#include "platform/core/Failure.h"
#include "platform/registry/Registry.h"
#include "tests/support/Server.h"

using namespace Qt::StringLiterals;
using database::postgres::Database;

namespace {

constexpr auto Operator = "balcao";

database::ServerCatalogue catalogue(const QString& name, const QString& user = {}) {
    return {support::Server::instance().folder(),
            {},
            user.isEmpty() ? QString::fromLatin1(support::Server::User) : user,
            u"segredo"_s,
            name};
}

/// The failure's text and code; empty when there was none.
template <class Call>
QString failureOf(Call&& call) {
    try {
        call();
    } catch (const core::Failure& failure) {
        return failure.text() + u' ' + failure.code();
    }
    return {};
}

class ServerBook : public testing::Test {
protected:
    void SetUp() override { qputenv("ZELMARS_REGISTRY", root_.path().toUtf8()); }
    void TearDown() override { qputenv("ZELMARS_REGISTRY", registryBefore_); }

    static void init(const QString& name, const QString& user = QString::fromLatin1(Operator)) {
        database::initBook(catalogue(name), {user, u"segredo"_s}, false);
    }
    static Database& server() {
        static Database book(catalogue(u"postgres"_s));
        return book;
    }

    QTemporaryDir root_;

private:
    QByteArray registryBefore_ = qgetenv("ZELMARS_REGISTRY");
};

TEST_F(ServerBook, LetsTheOperatorDoWhatScreensDoAndNothingElse) {
    init(u"balcao1"_s);
    const auto key =
        registry::Key::open(registry::Hive::LocalMachine, u"SOFTWARE\\Norvanta\\Corvenda"_s);
    ASSERT_TRUE(key);
    EXPECT_EQ(key->value(u"dtUser"_s), QString::fromLatin1(Operator));
    EXPECT_EQ(key->value(u"dtPassword"_s), u"segredo"_s);
    EXPECT_EQ(key->value(u"dtInitialCatalog"_s), u"balcao1"_s);
    const auto connection = std::make_shared<ado::Connection>();
    connection->ConnectionString =
        u"User ID=balcao;Password=segredo;Initial Catalog=balcao1;"
        "Data Source="_s +
        key->value(u"dtDataSource"_s).value();
    connection->Open();
    for (const QString& table : {u"tbZelmar_Movimentos"_s, u"tbZelmar_Movimentos_Inactivos"_s,
                                 u"tbZelmar_Movimentos_Historico"_s, u"tbSocios_Acumulados"_s,
                                 u"tbSocios_Acumulados_Inactivos"_s, u"tbZelmar_Plafonds"_s,
                                 u"tbHospitais"_s, u"tbContadores"_s, u"tbCheques"_s}) {
        const ado::RecordsetPtr rows = ado::Recordset::create();
        rows->Open(u"select * from "_s + table, connection, ado::adOpenDynamic,
                   ado::adLockPessimistic, ado::adCmdUnknown);
        EXPECT_EQ(failureOf([&] {
                      rows->AddNew();
                      rows->Update();
                      rows->Delete();
                  }),
                  QString())
            << qPrintable(table);
        rows->Close();
    }

    Database book(catalogue(u"balcao1"_s, QString::fromLatin1(Operator)));
    EXPECT_EQ(book.number("SELECT count(*) FROM vwZelmars_Movimentos_Vigor"), 0);
    for (const char* denied : {"DELETE FROM tbSocios",
                               "DELETE FROM tbModos_Pagamento",
                               "TRUNCATE tbCheques",
                               "CREATE TABLE x (a int)",
                               "CREATE TEMP TABLE x (a int)",
                               "CREATE SCHEMA x",
                               "DROP TABLE tbCheques",
                               "ALTER TABLE tbCheques ADD x int",
                               "SET ROLE balcao1_dono",
                               "CREATE ROLE x",
                               "COPY tbCheques TO PROGRAM 'true'",
                               "SELECT lo_create(0)",
                               "SELECT lo_creat(-1)",
                               "SELECT lo_from_bytea(0, '')",
                               "SELECT lo_unlink(1)",
                               "SELECT lo_import('/etc/passwd')",
                               "SELECT lo_open(1, 131072)",
                               "SELECT pg_terminate_backend(1)",
                               "SELECT pg_cancel_backend(1)",
                               "SELECT nextval('tbzelmar_movimentos_movimento_id_seq')",
                               "SELECT setval('tbzelmar_movimentos_movimento_id_seq', 1)",
                               "SELECT set_config('default_transaction_read_only', 'off', false)",
                               "SELECT query_to_xml('select 1', true, true, '')",
                               "SELECT pg_notify('a', 'b')",
                               "SELECT pg_sleep(0)",
                               "SELECT pg_logical_emit_message(false, 'a', 'b')",
                               "SELECT pg_read_file('/etc/passwd')",
                               "SELECT pg_ls_dir('.')",
                               "SELECT pg_export_snapshot()",
                               "SELECT pg_switch_wal()",
                               "SELECT pg_reload_conf()",
                               "SELECT rolpassword FROM pg_authid"})
        EXPECT_TRUE(failureOf([&] { book.run(denied); }).endsWith(u"42501"_s)) << denied;
}

TEST_F(ServerBook, LeavesNothingBehindAFailure) {
    server().run("CREATE ROLE fechado LOGIN PASSWORD 'outra'");
    server().run("CREATE ROLE leigo LOGIN");
    server().run("CREATE DATABASE existe");
    const auto known = [] {
        return server().number(
            "SELECT (SELECT count(*) FROM pg_database) * 100 + (SELECT count(*) FROM pg_roles)");
    };
    const qint64 before = known();
    const auto expect = [&](const QString& text, const QString& failure) {
        EXPECT_TRUE(failure.contains(text)) << qPrintable(failure);
        EXPECT_EQ(known(), before) << qPrintable(text);
        EXPECT_FALSE(registry::Key::open(registry::Hive::LocalMachine, u"SOFTWARE"_s));
    };
    // In a catalogue of its own and in one that was there: an operator who cannot enter.
    for (const QString& name : {u"falha"_s, u"existe"_s})
        expect(u"password authentication failed"_s, failureOf([&] { init(name, u"fechado"_s); }));
    Database existing(catalogue(u"existe"_s));
    const QByteArray objects =
        "SELECT count(*) FROM pg_class WHERE relnamespace = 'public'::regnamespace";
    EXPECT_EQ(existing.number(objects), 0);
    // A catalogue in use, an administrator who is none, an operator who is more than one.
    existing.run("CREATE TABLE x (a int)");
    expect(u"não está vazio"_s, failureOf([] { init(u"existe"_s); }));
    EXPECT_EQ(existing.number(objects), 1);
    expect(u"não é administrador"_s, failureOf([] {
               database::initBook(catalogue(u"falha"_s, u"leigo"_s), {u"x"_s, u"y"_s}, false);
           }));
    expect(u"tem outros direitos"_s,
           failureOf([] { init(u"falha"_s, QString::fromLatin1(support::Server::User)); }));
    expect(u"palavra-passe"_s, failureOf([] {
               database::initBook(catalogue(u"falha"_s), {u"x"_s, u"a;b"_s}, false);
           }));
}

}  // namespace
