-- SPDX-License-Identifier: MIT
-- The rights in the first books on servers, word for word but for their comments.
REVOKE ALL ON DATABASE {catalogue} FROM PUBLIC;
REVOKE CREATE ON SCHEMA public FROM PUBLIC;
GRANT CONNECT ON DATABASE {catalogue} TO {operator};
GRANT USAGE ON SCHEMA public TO {operator};
GRANT SELECT ON ALL TABLES IN SCHEMA public TO {operator};
GRANT INSERT, UPDATE, DELETE ON
    tbZelmar_Movimentos, tbZelmar_Movimentos_Inactivos, tbZelmar_Movimentos_Historico,
    tbSocios_Acumulados, tbSocios_Acumulados_Inactivos,
    tbZelmar_Plafonds, tbHospitais, tbContadores, tbCheques
    TO {operator};
DO $$
DECLARE
    harmful regprocedure;
BEGIN
    FOR harmful IN
        SELECT oid FROM pg_proc
         WHERE pronamespace = 'pg_catalog'::regnamespace
           AND (proname ~ '^lo_|^pg_sleep|^(query|cursor)_to_xml|^(table|schema|database)_to_xml'
                OR proname IN ('loread', 'lowrite', 'set_config', 'setseed', 'ts_stat',
                               'pg_terminate_backend', 'pg_cancel_backend', 'pg_notify',
                               'pg_logical_emit_message', 'pg_export_snapshot'))
    LOOP
        EXECUTE format('REVOKE EXECUTE ON FUNCTION %s FROM PUBLIC', harmful);
    END LOOP;
END $$;
