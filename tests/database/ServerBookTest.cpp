// SPDX-License-Identifier: MIT
// Books on a server: what makes them, and what is left when that fails.
#include "database/ServerBook.h"
#include "platform/ado/postgres/BulkAccess.h"

#include <gtest/gtest.h>

#include <QTemporaryDir>

#include "platform/core/Failure.h"
#include "platform/registry/Registry.h"
#include "tests/support/Server.h"

using namespace Qt::StringLiterals;
using ado::postgres::BulkAccess;

namespace {

constexpr auto Operator = "balcao";

ado::postgres::Address catalogue(const QString& name, const QString& user = {}) {
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
    static BulkAccess& server() {
        static BulkAccess book(catalogue(u"postgres"_s));
        return book;
    }

    QTemporaryDir root_;

private:
    QByteArray registryBefore_ = qgetenv("ZELMARS_REGISTRY");
};

TEST_F(ServerBook, IsWhatTheWorkstationUsesFromThenOn) {
    init(u"balcao1"_s);
    const auto key =
        registry::Key::open(registry::Hive::LocalMachine, u"SOFTWARE\\Norvanta\\Corvenda"_s);
    ASSERT_TRUE(key);
    EXPECT_EQ(key->value(u"dtUser"_s), QString::fromLatin1(Operator));
    EXPECT_EQ(key->value(u"dtPassword"_s), u"segredo"_s);
    EXPECT_EQ(key->value(u"dtInitialCatalog"_s), u"balcao1"_s);
    EXPECT_EQ(key->value(u"dtDataSource"_s),
              u"postgresql:"_s + support::Server::instance().folder());
}

TEST_F(ServerBook, LeavesNothingBehindAFailure) {
    server().execute("CREATE ROLE fechado LOGIN PASSWORD 'outra'");
    server().execute("CREATE ROLE leigo LOGIN");
    server().execute("CREATE DATABASE existe");
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
    BulkAccess existing(catalogue(u"existe"_s));
    const QByteArray objects =
        "SELECT count(*) FROM pg_class WHERE relnamespace = 'public'::regnamespace";
    EXPECT_EQ(existing.number(objects), 0);
    // A catalogue in use, an administrator who is none, an operator who is more than one.
    existing.execute("CREATE TABLE x (a int)");
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
