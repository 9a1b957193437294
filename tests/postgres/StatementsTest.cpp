// SPDX-License-Identifier: MIT
// The statements of the daily work run on the schema as it is made on a server.
#include "ServerBook.h"
#include "boundary/environment/dtZelmars.h"
#include "coverage/Statements.h"
#include "database/ServerBook.h"

using namespace Qt::StringLiterals;

namespace {

class Schema : public ServerBook {
protected:
    Schema() {
        exec(u"DROP VIEW vwMov; DROP TABLE tbMov, tbSoma, tbConta"_s);
        database::createBook(target());
    }
    database::ServerCatalogue target() const {
        return {support::Server::instance().folder(),
                {},
                QString::fromLatin1(support::Server::User),
                {},
                catalog};
    }
};

}  // namespace

TEST_F(Schema, HasItsCodesAndIsMadeOnce) {
    EXPECT_EQ(exec(u"SELECT string_agg(code, ',' ORDER BY code) FROM tbZelmar_movimentos_tipos"_s),
              u"ANL,COR,DOC,HOS,PAG,REP,SA"_s);
    EXPECT_EQ(exec(u"SELECT zelmars FROM tbContadores"_s), u"1"_s);
    EXPECT_EQ(failureOf([&] { database::createBook(target()); }).code(), u"42P07"_s);
    EXPECT_EQ(exec(u"SELECT count(*) FROM tbContadores"_s), u"1"_s);
    EXPECT_EQ(exec(u"INSERT INTO tbZelmar_Movimentos_Inactivos DEFAULT VALUES RETURNING 1; SELECT "
                   u"movimento_id FROM tbZelmar_Movimentos_Inactivos"_s),
              u"1000000001"_s);
}

TEST_F(Schema, TakesEveryNamedCommandAndDailyStatement) {
    exec(
        u"INSERT INTO tbZelmar_Movimentos(socio_id, rubrica_id, liquido, debito, credito, data, "
        u"tipo) VALUES(5, 3, 9, 0.4, 0.3, '2000-02-22', 'TRF'), (6, 3, 9, 0.4001, 0.3, "
        u"'2000-02-22', 'DOC'); INSERT INTO tbSocios_Acumulados VALUES(5, 'B', 3, 1, 0.1, 0.1, 1), "
        u"(5, 'B', 3, 1, 0.1, 0.2, 1)"_s);
    const auto shaping = connect(5, u"MSDataShape.1"_s);
    auto& commands = environment::dtZelmars::instance();
    EXPECT_EQ(commands.commandNames().size(), 13);
    for (const QString& name : commands.commandNames())
        EXPECT_EQ(failureOf([&] { open(commands.Commands(name).CommandText, shaping); }).text(),
                  QString())
            << name.toStdString();
    const auto debts = open(commands.Commands(u"Print_frmListagemDividas"_s).CommandText, shaping);
    EXPECT_EQ(valuesOf(debts, u"socio_id"_s), u"6"_s);

    using namespace coverage::statements;
    for (const QString& statement :
         {rubric(3), accumulator(3, 5, u"C1"_s), creditOfHousehold(3, 5), creditOfRelatives(3, 5),
          groupCreditOfPerson(1, u"B"_s, 5), groupCreditOfHousehold(1, 5),
          groupCreditOfRelatives(1, 5), balance(5), franchise(5, 3), member(5),
          u"SELECT * FROM vwZelmars_Movimentos_Vigor WHERE movimento_id = 5"_s,
          u"select * from tbsocios where no_kor = 100015"_s})
        EXPECT_EQ(failureOf([&] { open(statement, connection); }).text(), QString())
            << statement.toStdString();
    // 32-bit floats are summed in 64 bits, as on the other engine.
    EXPECT_EQ(open(balance(5), connection)->Collect(u"tcredito_ac"_s),
              QVariant(static_cast<double>(0.1F) + static_cast<double>(0.2F)));
}
