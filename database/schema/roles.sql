-- SPDX-License-Identifier: MIT
-- Who may do what in a book on a server. Names in braces are put in by the program. Run by an
-- administrator in the book's catalogue, after its tables were made.

-- Nobody enters the catalogue, or puts anything of his own into it, who is not named here.
REVOKE ALL ON DATABASE {catalogue} FROM PUBLIC;
REVOKE CREATE ON SCHEMA public FROM PUBLIC;
GRANT CONNECT ON DATABASE {catalogue} TO {operator};
GRANT USAGE ON SCHEMA public TO {operator};

-- Screens read everything and write what is listed. Generated keys need no right of their own.
GRANT SELECT ON ALL TABLES IN SCHEMA public TO {operator};
GRANT INSERT, UPDATE, DELETE ON
    tbZelmar_Movimentos, tbZelmar_Movimentos_Inactivos, tbZelmar_Movimentos_Historico,
    tbSocios_Acumulados, tbSocios_Acumulados_Inactivos,
    tbZelmar_Plafonds, tbHospitais, tbContadores, tbCheques
    TO {operator};
-- The journal of operations, whose rows ride in the commits of other writes.
GRANT INSERT, UPDATE, DELETE ON tbOperacoes TO {operator};
-- The member file changes what it shows; members come and go by other programs.
GRANT UPDATE ON tbSocios TO {operator};

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
