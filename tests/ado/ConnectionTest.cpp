// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <QDir>
#include <QFile>

#include "SmallBook.h"
#include "platform/ado/DataEnvironment.h"

using namespace Qt::StringLiterals;

namespace {

QString failureOfOpening(const QString& connectionString) {
    ado::Connection connection;
    connection.ConnectionString = connectionString;
    const QString text = failureOf([&] { connection.Open(); });
    EXPECT_EQ(connection.State(), ado::adStateClosed);
    return text;
}

class SmallEnvironment : public ado::DataEnvironment {
public:
    SmallEnvironment() {
        addConnection(u"MSAccess"_s);
        addConnection(u"SqlServer"_s);
        addCommand(u"msHosp"_s, u"SELECT tbHosp.*, code + ' - ' + nome AS completo FROM tbHosp;"_s);
        addCommand(u"outro"_s, u"SELECT 1 AS um"_s);
    }
};

}  // namespace

TEST(Connections, OpenAndCloseOnce) {
    SmallBook book;
    const auto connection = book.connect();
    EXPECT_EQ(connection->State(), ado::adStateOpen);
    EXPECT_EQ(failureNumberOf([&] { connection->Open(); }), core::ObjectOpen);
    connection->Close();
    EXPECT_EQ(connection->State(), ado::adStateClosed);
    EXPECT_EQ(failureNumberOf([&] { connection->Close(); }), core::ObjectClosed);
    EXPECT_EQ(failureNumberOf([&] { openRows(u"select 1"_s, connection); }), core::ObjectClosed);
}

TEST(Connections, ReadTheirStringWithoutRegardToCase) {
    SmallBook book;
    ado::Connection connection;
    connection.ConnectionString =
        u"provider = msdatashape.1;INITIAL CATALOG=livro; data source = SQLite:%1"_s.arg(
            book.folder());
    connection.Open();
    EXPECT_TRUE(connection.shapes());
}

TEST(Connections, SayWhatWasTriedAndMakeNothing) {
    const QTemporaryDir folder;
    const QString path = folder.path();
    const auto of = [](const QString& source, const QString& catalog) {
        return failureOfOpening(u"Initial Catalog=%2;Data Source=%1"_s.arg(source, catalog));
    };
    EXPECT_EQ(
        of(u"sqlite:"_s + path, u"nada"_s),
        u"Não foi possível abrir o livro «%1/nada.db»: unable to open database file"_s.arg(path));
    EXPECT_TRUE(
        of(u"sqlite:"_s + path + u"/nada"_s, u"livro"_s).contains(path + u"/nada/livro.db"_s));
    QFile noBook(folder.filePath(u"texto.db"_s));
    ASSERT_TRUE(noBook.open(QIODevice::WriteOnly));
    noBook.write(QByteArray(5000, 'x'));
    noBook.close();
    EXPECT_TRUE(of(u"sqlite:"_s + path, u"texto"_s).endsWith(u": file is not a database"_s));
    EXPECT_TRUE(of(u"sqlite:"_s + path, {}).contains(u"Initial Catalog"_s));
    EXPECT_TRUE(of(u"oracle:x"_s, u"livro"_s).contains(u"«sqlite:PASTA» e «postgresql:SERVIDOR"_s));
    EXPECT_TRUE(of({}, u"livro"_s).contains(u"sqlite:PASTA"_s));
    EXPECT_TRUE(of(u"postgresql:servidor"_s, u"livro"_s).contains(u"ainda não está disponível"_s));
    EXPECT_EQ(QDir(path).entryList(QDir::Files), QStringList(u"texto.db"_s));
}

TEST(Connections, OpenAnEmptyBookWhoseTablesAreMissing) {
    SmallBook book;
    QFile empty(QDir(book.folder()).filePath(u"vazio.db"_s));
    ASSERT_TRUE(empty.open(QIODevice::WriteOnly));
    empty.close();
    auto connection = std::make_shared<ado::Connection>();
    connection->ConnectionString =
        u"Initial Catalog=vazio;Data Source=sqlite:%1"_s.arg(book.folder());
    connection->Open();
    EXPECT_EQ(failureOf([&] { openRows(u"select * from tbMov"_s, connection); }),
              u"no such table: tbMov"_s);
}

TEST(Connections, SeeTablesMadeLater) {
    SmallBook book;
    const auto connection = book.connect();
    openRows(u"select * from tbMov"_s, connection);
    book.exec(u"CREATE TABLE tbNova (nome TEXT)"_s);
    const auto rows = openRows(u"select * from tbNova"_s, connection);
    rows->AddNew();
    rows->setCollect(u"nome"_s, u"x"_s);
    rows->Update();
    EXPECT_EQ(book.value(u"SELECT nome FROM tbNova"_s), u"x"_s);
}

TEST(DataEnvironments, FindTheirThingsByName) {
    SmallEnvironment environment;
    EXPECT_EQ(environment.Connections(u"sqlserver"_s), environment.Connections(2));
    EXPECT_EQ(environment.commandNames(), QStringList({u"msHosp"_s, u"outro"_s}));
    EXPECT_EQ(environment.Recordsets(u"MSHOSP"_s)->State(), ado::adStateClosed);
    EXPECT_TRUE(failureOf([&] { environment.Commands(u"falta"_s); }).contains(u"falta"_s));
    EXPECT_EQ(failureNumberOf([&] { environment.Connections(u"x"_s); }), core::NoSuchItem);
    EXPECT_EQ(failureNumberOf([&] { environment.Connections(0); }), core::NoSuchItem);
}

TEST(DataEnvironments, HoldTheirRowsInMemoryUntilRequeried) {
    SmallBook book;
    for (int i = 0; i < 100; ++i)
        book.exec(u"INSERT INTO tbHosp(code, nome) VALUES('%1','Hospital')"_s.arg(i));
    SmallEnvironment environment;
    const auto rows = environment.Recordsets(u"msHosp"_s);
    rows->Open(environment.Commands(u"msHosp"_s).CommandText, book.connect());
    book.exec(u"DELETE FROM tbHosp WHERE hosp_id > 1"_s);
    EXPECT_EQ(rows->rowsInMemory(), 100);
    EXPECT_EQ(rows->valueAt(99, 3), u"99 - Hospital"_s);
    EXPECT_EQ(failureNumberOf([&] { rows->setCollect(u"nome"_s, u"x"_s); }), core::NotUpdatable);
    rows->Requery();
    EXPECT_EQ(rows->RecordCount(), 1);
}
