// SPDX-License-Identifier: MIT
// Who may do what in a book on a server: the operator logs in and tries.
#include <gtest/gtest.h>

#include "database/ServerBook.h"
#include "platform/ado/Connection.h"
#include "platform/ado/Recordset.h"
#include "platform/ado/postgres/BulkAccess.h"
#include "platform/core/Failure.h"
#include "tests/support/Server.h"

using namespace Qt::StringLiterals;
using ado::postgres::BulkAccess;

namespace {

constexpr auto Operator = "posto";

ado::postgres::Address catalogue(const char* user) {
    return {.host = support::Server::instance().folder(),
            .port = {},
            .user = QString::fromLatin1(user),
            .password = u"segredo"_s,
            .catalog = u"direitos"_s};
}

class Rights : public testing::Test {
protected:
    static void SetUpTestSuite() {
        database::initBook(catalogue(support::Server::User),
                           {QString::fromLatin1(Operator), u"segredo"_s}, true);
    }

    /// The SQLSTATE with which the server refuses a statement; empty when it takes it. Nothing of
    /// it stays.
    std::string refusal(const char* statement) {
        book_.execute("BEGIN");
        std::string code;
        try {
            book_.execute(statement);
        } catch (const core::Failure& failure) {
            code = failure.code().toStdString();
        }
        book_.execute("ROLLBACK");
        return code;
    }
    void expectTaken(std::initializer_list<const char*> statements) {
        for (const char* statement : statements) EXPECT_EQ(refusal(statement), "") << statement;
    }
    void expectRefused(std::initializer_list<const char*> statements) {
        for (const char* statement : statements)
            EXPECT_EQ(refusal(statement), "42501") << statement;
    }

    BulkAccess book_{catalogue(Operator)};
};

TEST_F(Rights, AreEnoughForWhatTheScreensWrite) {
    expectTaken({
        "SELECT count(*) FROM vwZelmars_Movimentos_Vigor",
        "SELECT * FROM tbSocios, tbQuotas_Socios, tbZelmar_Movimentos_Historico LIMIT 1",
        // An entry, a receipt, a reposition; the two rows of an annulment.
        "INSERT INTO tbZelmar_Movimentos (codABC, doc_data, doc_no, doc_valor, recebido, "
        "doc_tx_iva,"
        " doc_iva, oe_id, obs, data, tipo, rubrica_id, hospital_id, modo_pagamento, incidencia,"
        " saldo_acumulado, iliquido, liquido, credito, debito, comparticipacao, saldo_plafond,"
        " created_by, socio_id, movimento_no, cheque) SELECT codABC, doc_data, doc_no, doc_valor,"
        " recebido, doc_tx_iva, doc_iva, oe_id, obs, data, tipo, rubrica_id, hospital_id,"
        " modo_pagamento, incidencia, saldo_acumulado, iliquido, liquido, credito, debito,"
        " comparticipacao, saldo_plafond, created_by, socio_id, movimento_no, cheque"
        " FROM tbZelmar_Movimentos LIMIT 1 RETURNING movimento_id",
        "INSERT INTO tbZelmar_Movimentos (descrit, credito) VALUES ('x', 1) RETURNING movimento_id",
        "UPDATE tbZelmar_Movimentos SET tipo = 'ANL', modo_pagamento = 'ANL' WHERE movimento_id = "
        "1",
        "UPDATE tbZelmar_Movimentos_Inactivos SET tipo = 'ANL', modo_pagamento = 'ANL'"
        " WHERE movimento_id = 1",
        "INSERT INTO tbZelmar_Movimentos_Inactivos (data, tipo, socio_id, codABC, rubrica_id,"
        " doc_no, doc_data, doc_valor, credito, debito, hospital_id, movimento_no)"
        " VALUES (now(), 'COR', 1, 'A', 1, '1', now(), 1, 1, 0, 1, 1) RETURNING movimento_id",
        "INSERT INTO tbSocios_Acumulados (socio_id, codABC, rubrica_id, rubrica_id_main, debito_ac,"
        " credito_ac, no_docs) VALUES (1, 'A', 1, 0, 0, 0, 0) RETURNING _linha",
        "UPDATE tbSocios_Acumulados SET socio_id = 1, codABC = 'A', rubrica_id = 1, debito_ac = 1,"
        " credito_ac = 1, no_docs = 1 WHERE _linha = 1",
        "INSERT INTO tbSocios_Acumulados_Inactivos (debito_ac, credito_ac) VALUES (NULL, NULL)"
        " RETURNING _linha",
        "UPDATE tbSocios_Acumulados_Inactivos SET debito_ac = 1, credito_ac = 1, no_docs = 1",
        "UPDATE tbContadores SET zelmars = 1",
        "INSERT INTO tbContadores (zelmars) VALUES (1)",
        "UPDATE tbCheques SET cheque_no = 1",
        "INSERT INTO tbCheques (cheque_no) VALUES (1)",
        "UPDATE tbSocios SET nome = 'x', nome_guerra = 'x', nib = 'x', zelmar = 1,"
        " zelmar_data_carencia = now(), no_contribuinte = 'x', morada1 = 'x', code_postal1 = 'x',"
        " localidade1 = 'x' WHERE socio_id = 1",
        "SELECT pg_advisory_lock(1), pg_advisory_unlock(1)",
    });
}

TEST_F(Rights, LeaveWhatIsPostedAsItIs) {
    expectRefused({
        "UPDATE tbZelmar_Movimentos SET credito = 1",
        "UPDATE tbZelmar_Movimentos SET debito = 1",
        "UPDATE tbZelmar_Movimentos SET liquido = 1",
        "UPDATE tbZelmar_Movimentos SET doc_valor = 1",
        "UPDATE tbZelmar_Movimentos SET created_by = 'x'",
        "UPDATE tbZelmar_Movimentos SET socio_id = 1",
        "UPDATE tbZelmar_Movimentos SET movimento_id = 1",
        "UPDATE tbZelmar_Movimentos SET movimento_no = 1",
        "UPDATE tbZelmar_Movimentos SET data = now()",
        "UPDATE tbZelmar_Movimentos SET cheque = 1",
        "UPDATE tbZelmar_Movimentos SET tipo = 'ANL', credito = 0",
        "UPDATE tbZelmar_Movimentos_Inactivos SET credito = 1",
        "UPDATE tbZelmar_Movimentos_Inactivos SET created_by = 'x'",
        "INSERT INTO tbZelmar_Movimentos (movimento_id) VALUES (1)",
        "INSERT INTO tbZelmar_Movimentos (movimento_id, tipo) OVERRIDING SYSTEM VALUE"
        " VALUES (1, 'DOC')",
        "INSERT INTO tbZelmar_Movimentos (upsize_ts) VALUES (1)",
        "INSERT INTO tbZelmar_Movimentos VALUES (1, 1)",
        "INSERT INTO tbZelmar_Movimentos (movimento_no) VALUES (1)"
        " ON CONFLICT (movimento_id) DO UPDATE SET credito = 1",
        "INSERT INTO tbZelmar_Movimentos_Inactivos (movimento_id) VALUES (1)",
        "INSERT INTO tbZelmar_Movimentos_Inactivos (created_by) VALUES ('x')",
        "INSERT INTO tbZelmar_Movimentos_Historico (ano) VALUES (2020)",
        "UPDATE tbZelmar_Movimentos_Historico SET credito = 1",
        "DELETE FROM tbZelmar_Movimentos",
        "DELETE FROM tbZelmar_Movimentos_Inactivos",
        "DELETE FROM tbZelmar_Movimentos_Historico",
        "TRUNCATE tbZelmar_Movimentos",
        "TRUNCATE tbZelmar_Movimentos_Historico",
        "SELECT * FROM tbZelmar_Movimentos_Historico FOR UPDATE",
        "COPY tbZelmar_Movimentos FROM STDIN",
    });
}

TEST_F(Rights, LeaveEverythingElseInTheBookAsItIs) {
    expectRefused({
        "UPDATE tbOperacoes SET quem = 'x'",
        "UPDATE tbOperacoes SET movimento_id = 1",
        "TRUNCATE tbOperacoes",
        "DELETE FROM tbContadores",
        "DELETE FROM tbCheques",
        "TRUNCATE tbCheques",
        "UPDATE tbCheques SET _linha = DEFAULT",
        "LOCK TABLE tbContadores",
        "DELETE FROM tbSocios_Acumulados",
        "DELETE FROM tbSocios_Acumulados_Inactivos",
        "UPDATE tbSocios_Acumulados SET rubrica_id_main = 1",
        "INSERT INTO tbSocios_Acumulados (_linha) OVERRIDING SYSTEM VALUE VALUES (1)",
        "INSERT INTO tbSocios_Acumulados_Inactivos (socio_id) VALUES (1)",
        "UPDATE tbSocios_Acumulados_Inactivos SET socio_id = 1",
        "UPDATE tbSocios SET socio_id = 1",
        "UPDATE tbSocios SET no_kor = '1'",
        "INSERT INTO tbSocios (nome) VALUES ('x')",
        "DELETE FROM tbSocios",
        "UPDATE tbSocios_Inactivos SET nib = 'x'",
        "DELETE FROM tbSocios_Inactivos",
        "UPDATE tbSocios_Familias SET codABC = 'A'",
        "INSERT INTO tbSocios_Familias (nome) VALUES ('x')",
        "DELETE FROM tbSocios_Familias_Inactivos",
        "UPDATE tbQuotas_Socios SET total_pago = 1",
        "INSERT INTO tbQuotas_Movimentos (valor) VALUES (1)",
        "UPDATE tbZelmar_Plafonds SET percent = 1",
        "INSERT INTO tbZelmar_Plafonds (code) VALUES ('x')",
        "DELETE FROM tbZelmar_Plafonds",
        "UPDATE tbHospitais SET nome = 'x'",
        "DELETE FROM tbHospitais",
        "DELETE FROM tbModos_Pagamento",
        "INSERT INTO tbZelmar_movimentos_tipos (code) VALUES ('x')",
        "UPDATE tbLocalidades SET descrit = 'x'",
        "SELECT nextval('tbzelmar_movimentos_movimento_id_seq')",
        "SELECT setval('tbzelmar_movimentos_movimento_id_seq', 1)",
        "DROP TABLE tbCheques",
        "ALTER TABLE tbCheques ADD x int",
        "ALTER TABLE tbZelmar_Movimentos DISABLE TRIGGER ALL",
        "CREATE INDEX ON tbCheques (cheque_no)",
        "CREATE TRIGGER x BEFORE INSERT ON tbCheques EXECUTE FUNCTION "
        "suppress_redundant_updates_trigger()",
        "CREATE RULE x AS ON DELETE TO tbCheques DO INSTEAD NOTHING",
        "CREATE POLICY x ON tbCheques",
        "COMMENT ON TABLE tbCheques IS 'x'",
        "GRANT direitos_dono TO posto",
    });
}

TEST_F(Rights, ReachNothingBesideTheBook) {
    expectRefused({
        "CREATE TABLE x (a int)",
        "CREATE TABLE public.tbCheques2 AS SELECT * FROM tbCheques",
        "CREATE TEMP TABLE tbCheques (cheque_no int)",
        "SELECT * INTO TEMP x FROM tbCheques",
        "CREATE VIEW x AS SELECT 1",
        "CREATE SEQUENCE x",
        "CREATE TYPE x AS (a int)",
        "CREATE FUNCTION x() RETURNS int LANGUAGE sql AS 'SELECT 1'",
        "CREATE FUNCTION pg_temp.x() RETURNS int LANGUAGE sql AS 'SELECT 1'",
        "CREATE FUNCTION x() RETURNS int LANGUAGE plpgsql AS 'BEGIN RETURN 1; END'",
        "DO 'BEGIN END'",
        "CREATE OPERATOR + (LEFTARG = text, RIGHTARG = text, FUNCTION = textcat)",
        "CREATE SCHEMA x",
        "CREATE EXTENSION pgcrypto",
        "CREATE ROLE x",
        "ALTER ROLE dono PASSWORD 'x'",
        "ALTER ROLE posto SUPERUSER",
        "ALTER ROLE posto CREATEDB",
        "ALTER DATABASE direitos SET search_path = x",
        "SET ROLE direitos_dono",
        "SET SESSION AUTHORIZATION dono",
        "SET session_replication_role = replica",
        "COPY tbCheques TO PROGRAM 'true'",
        "COPY tbCheques TO '/tmp/x'",
        "SELECT rolpassword FROM pg_authid",
        "SELECT passwd FROM pg_shadow",
        "SELECT pg_read_file('/etc/passwd')",
        "SELECT pg_ls_dir('.')",
        "SELECT lo_create(0)",
        "SELECT lo_creat(-1)",
        "SELECT lo_from_bytea(0, '')",
        "SELECT lo_unlink(1)",
        "SELECT lo_import('/etc/passwd')",
        "SELECT lo_open(1, 131072)",
        "SELECT pg_terminate_backend(1)",
        "SELECT pg_cancel_backend(1)",
        "SELECT set_config('default_transaction_read_only', 'off', false)",
        "SELECT query_to_xml('select 1', true, true, '')",
        "SELECT pg_notify('a', 'b')",
        "SELECT pg_sleep(0)",
        "SELECT pg_logical_emit_message(false, 'a', 'b')",
        "SELECT pg_export_snapshot()",
        "SELECT pg_switch_wal()",
        "SELECT pg_reload_conf()",
        "CHECKPOINT",
    });
}

TEST_F(Rights, OfTheManagerAreMasterDataAndTheTurnOfTheYear) {
    BulkAccess administration(catalogue(support::Server::User));
    administration.execute("GRANT direitos_gestor TO posto");
    expectTaken({
        "INSERT INTO tbZelmar_Plafonds (code, rubrica_id_main, percent) VALUES ('x', 1, 1)",
        "UPDATE tbZelmar_Plafonds SET percent = 1, agregado = NULL, franquia = 3",
        "DELETE FROM tbZelmar_Plafonds",
        "INSERT INTO tbHospitais (code, nome) VALUES ('x', 'y')",
        "UPDATE tbHospitais SET nome = 'x'",
        "DELETE FROM tbHospitais",
        "UPDATE tbZelmar_Movimentos_Historico SET credito = 1, debito = 0, recebido = 0",
        "INSERT INTO tbZelmar_Movimentos_Historico (ano, socio_id, no_kor) VALUES (2025, 1, '1')",
        "DELETE FROM tbZelmar_Movimentos",
        "DELETE FROM tbZelmar_Movimentos_Inactivos",
        "INSERT INTO tbZelmar_Movimentos_Inactivos (socio_id, tipo, debito) VALUES (1, 'SA', 1)",
        "DELETE FROM tbSocios_Acumulados",
        "DELETE FROM tbSocios_Acumulados_Inactivos",
        "INSERT INTO tbSocios_Acumulados_Inactivos (socio_id, no_docs) VALUES (1, 2)",
    });
    expectRefused({
        "UPDATE tbZelmar_Plafonds SET rubrica_id = 1",
        "INSERT INTO tbHospitais (hospital_id) VALUES (1)",
        "TRUNCATE tbHospitais",
        "DELETE FROM tbZelmar_Movimentos_Historico",
        "UPDATE tbZelmar_Movimentos_Historico SET ano = 1",
        "UPDATE tbZelmar_Movimentos SET movimento_id = 1",
        "DELETE FROM tbContadores",
        "DELETE FROM tbSocios",
    });
    administration.execute("REVOKE direitos_gestor FROM posto");
    expectRefused({"DELETE FROM tbHospitais"});
}

TEST_F(Rights, FindTheBooksOwnTablesWhateverStandsElsewhere) {
    BulkAccess administration(catalogue(support::Server::User));
    EXPECT_EQ(administration.number("SELECT count(*) FROM pg_db_role_setting WHERE setrole ="
                                    " 'posto'::regrole AND 'search_path=public, pg_temp' ="
                                    " ANY (setconfig)"),
              1);
    administration.execute(
        "CREATE SCHEMA isco AUTHORIZATION posto; CREATE TABLE isco.tbCheques (cheque_no bigint);"
        "ALTER TABLE isco.tbCheques OWNER TO posto;"
        "ALTER ROLE posto IN DATABASE direitos SET search_path = isco, public");
    BulkAccess fresh(catalogue(Operator));
    EXPECT_EQ(fresh.number("SELECT count(*) FROM tbCheques"), 1);
    const auto connection = std::make_shared<ado::Connection>();
    connection->ConnectionString =
        u"User ID=posto;Initial Catalog=direitos;Data Source="_s + catalogue(Operator).dataSource();
    connection->Open();
    const ado::RecordsetPtr rows = ado::Recordset::create();
    rows->Open(u"select * from tbCheques"_s, connection, ado::adOpenStatic, ado::adLockReadOnly,
               ado::adCmdUnknown);
    EXPECT_FALSE(rows->atEnd());
    administration.execute("DROP SCHEMA isco CASCADE");
}

}  // namespace
