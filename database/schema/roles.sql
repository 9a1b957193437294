-- SPDX-License-Identifier: MIT
-- Who may do what in a book on a server. Names in braces are put in by the program. Run by an
-- administrator in the book's catalogue, after its tables were made.

-- Nobody enters the catalogue, or puts anything of his own into it, who is not named here.
REVOKE ALL ON DATABASE {catalogue} FROM PUBLIC;
REVOKE CREATE ON SCHEMA public FROM PUBLIC;
GRANT CONNECT ON DATABASE {catalogue} TO {operator};
GRANT USAGE ON SCHEMA public TO {operator};

-- Nor can anybody else's schema or temporary table stand before the book's own names.
ALTER ROLE {operator} IN DATABASE {catalogue} SET search_path = public, pg_temp;
REVOKE USAGE ON LANGUAGE plpgsql FROM PUBLIC;

-- Screens read everything and write the columns that are listed, and nothing else. Generated keys
-- are left out, so that nobody gives one himself; no movement, member or counter is ever deleted.
REVOKE ALL ON ALL TABLES IN SCHEMA public FROM {operator};
GRANT SELECT ON ALL TABLES IN SCHEMA public TO {operator};

-- A movement is posted whole, but for its key. What an annulment marks is all that changes in it
-- later.
DO $do$
BEGIN
    EXECUTE (
        SELECT format('GRANT INSERT (%s), UPDATE (tipo, modo_pagamento) ON %s TO %s',
                      string_agg(attname, ', '), attrelid::regclass, $name${operator}$name$)
          FROM pg_attribute
         WHERE attrelid = 'tbZelmar_Movimentos'::regclass AND attnum > 0 AND NOT attisdropped
           AND attname NOT IN ('movimento_id', 'upsize_ts')
         GROUP BY attrelid);
END $do$;
-- Of a member who has left, movements are only annulled: the mark and the correcting row.
GRANT INSERT (
        movimento_no, socio_id, codABC, rubrica_id, hospital_id, data, tipo, doc_data, doc_no,
        doc_valor, credito, debito),
    UPDATE (tipo, modo_pagamento)
    ON tbZelmar_Movimentos_Inactivos TO {operator};

-- A receipt or a reposition writes also whose row it is, into the row that it found by that.
GRANT INSERT (socio_id, codABC, rubrica_id, rubrica_id_main, debito_ac, credito_ac, no_docs),
    UPDATE (socio_id, codABC, rubrica_id, debito_ac, credito_ac, no_docs)
    ON tbSocios_Acumulados TO {operator};
GRANT INSERT (debito_ac, credito_ac), UPDATE (debito_ac, credito_ac, no_docs)
    ON tbSocios_Acumulados_Inactivos TO {operator};

GRANT INSERT (zelmars), UPDATE (zelmars) ON tbContadores TO {operator};
GRANT INSERT (cheque_no), UPDATE (cheque_no) ON tbCheques TO {operator};

-- The member file changes what it shows, but for the number; members come and go by other programs.
GRANT UPDATE (
        nome, nome_guerra, nib, zelmar, zelmar_data_carencia, no_contribuinte, morada1,
        code_postal1, localidade1)
    ON tbSocios TO {operator};

-- The manager writes, besides, what documents are judged by: rubrics and hospitals, but for their
-- keys.
GRANT CONNECT ON DATABASE {catalogue} TO {manager};
GRANT USAGE ON SCHEMA public TO {manager};
REVOKE ALL ON ALL TABLES IN SCHEMA public FROM {manager};
DO $do$
DECLARE
    managed record;
BEGIN
    FOR managed IN
        SELECT attrelid::regclass AS relation, string_agg(attname, ', ') AS columns
          FROM pg_attribute
         WHERE attrelid IN ('tbZelmar_Plafonds'::regclass, 'tbHospitais'::regclass)
           AND attnum > 0 AND NOT attisdropped AND attname NOT IN ('rubrica_id', 'hospital_id')
         GROUP BY attrelid
    LOOP
        EXECUTE format('GRANT SELECT, INSERT (%s), UPDATE (%s), DELETE ON %s TO %s',
                       managed.columns, managed.columns, managed.relation,
                       $name${manager}$name$);
    END LOOP;
END $do$;

-- Files of other programs bring members, relatives and premiums, by the manager's import; what came
-- before changes only in what a file can name.
GRANT SELECT,
    INSERT (
        no_kor, nome, nome_guerra, nib, zelmar, zelmar_data_carencia, no_contribuinte, morada1,
        code_postal1, localidade1),
    UPDATE (
        nome, nome_guerra, nib, zelmar, zelmar_data_carencia, no_contribuinte, morada1,
        code_postal1, localidade1)
    ON tbSocios TO {manager};
GRANT SELECT, INSERT (socio_id, codABC, nome, data_nascimento, data_carencia),
    UPDATE (nome, data_nascimento, data_carencia)
    ON tbSocios_Familias TO {manager};
GRANT SELECT, INSERT (socio_id, ult_ano, ult_mes, total_quotas, total_pago),
    UPDATE (ult_ano, ult_mes, total_quotas, total_pago)
    ON tbQuotas_Socios TO {manager};
GRANT SELECT ON tbSocios_Inactivos, tbSocios_Familias_CodeABC TO {manager};

-- The manager's bulk jobs: the repair of null amounts, the accumulators made anew, and the close,
-- which moves all movements to history and opens the new year. What is in history stays there.
DO $do$
DECLARE
    movements record;
BEGIN
    FOR movements IN
        SELECT attrelid::regclass AS relation, string_agg(attname, ', ') AS columns
          FROM pg_attribute
         WHERE attrelid IN ('tbZelmar_Movimentos'::regclass,
                            'tbZelmar_Movimentos_Inactivos'::regclass,
                            'tbZelmar_Movimentos_Historico'::regclass)
           AND attnum > 0 AND NOT attisdropped
           AND attname NOT IN ('movimento_id', 'upsize_ts', '_linha')
         GROUP BY attrelid
    LOOP
        EXECUTE format('GRANT SELECT, INSERT (%s), UPDATE (incidencia, recebido, doc_valor, debito,'
                       ' credito) ON %s TO %s',
                       movements.columns, movements.relation, $name${manager}$name$);
    END LOOP;
END $do$;
GRANT DELETE ON tbZelmar_Movimentos, tbZelmar_Movimentos_Inactivos TO {manager};
GRANT SELECT, INSERT (socio_id, codABC, rubrica_id, rubrica_id_main, debito_ac, credito_ac, no_docs),
    DELETE
    ON tbSocios_Acumulados, tbSocios_Acumulados_Inactivos TO {manager};
GRANT SELECT, INSERT (zelmars), UPDATE (zelmars) ON tbContadores TO {manager};

-- The journal of operations, whose rows ride in the commits of other writes. A posting's row goes
-- once nothing is missing any more.
GRANT INSERT (
        operacao_id, operacao, passo, ficheiro, movimento_id, movimento_no, socio_id, tipo,
        correcao_no, quem, quando),
    UPDATE (passo, correcao_no, concluida), DELETE
    ON tbOperacoes TO {operator};
-- An annulment's row stays: it says who annulled.
ALTER TABLE tbOperacoes ENABLE ROW LEVEL SECURITY;
DROP POLICY IF EXISTS ler ON tbOperacoes;
CREATE POLICY ler ON tbOperacoes FOR SELECT USING (true);
DROP POLICY IF EXISTS acrescentar ON tbOperacoes;
CREATE POLICY acrescentar ON tbOperacoes FOR INSERT WITH CHECK (true);
DROP POLICY IF EXISTS mudar ON tbOperacoes;
CREATE POLICY mudar ON tbOperacoes FOR UPDATE USING (true);
DROP POLICY IF EXISTS apagar ON tbOperacoes;
CREATE POLICY apagar ON tbOperacoes FOR DELETE USING (operacao = 'LAN');

-- A SELECT can call functions. These do more than read, and some of them also where nothing may be
-- written: they keep large objects, send messages, end or stop other workstations' statements, run
-- a text as a statement, change settings, sleep. Rights to all other functions of that kind are
-- the administrator's from the start, and those of sequences depend on the sequence.
DO $$
DECLARE
    harmful regprocedure;
BEGIN
    FOR harmful IN
        SELECT oid FROM pg_proc
         WHERE pronamespace = 'pg_catalog'::regnamespace
           AND (proname ~ '^lo_|^pg_sleep|^(query|cursor)_to_xml|^(table|schema|database)_to_xml'
                OR proname IN ('loread', 'lowrite', 'set_config', 'setseed', 'ts_stat', 'ts_rewrite',
                               'pg_terminate_backend', 'pg_cancel_backend', 'pg_notify',
                               'pg_logical_emit_message', 'pg_export_snapshot'))
    LOOP
        EXECUTE format('REVOKE EXECUTE ON FUNCTION %s FROM PUBLIC', harmful);
    END LOOP;
END $$;

-- The manager keeps backups: the server's own program reads where keys go on, and sets its settings
-- by one of those functions.
GRANT SELECT ON ALL SEQUENCES IN SCHEMA public TO {manager};
GRANT EXECUTE ON FUNCTION pg_catalog.set_config(text, text, boolean) TO {manager};
