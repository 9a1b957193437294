-- SPDX-License-Identifier: MIT
-- From version 1 to version 2. Books of version 1 are those of several programs: each part may be
-- there already. Written once and not changed later, whatever becomes of the schema, in the words
-- of SQLite, as the schema is.

-- The journal of operations that were cut short.
CREATE TABLE IF NOT EXISTS tbOperacoes (
    operacao_id  VARCHAR(36) PRIMARY KEY,
    operacao     VARCHAR(3),
    passo        VARCHAR(3),
    ficheiro     VARCHAR(8),
    movimento_id INTEGER,
    movimento_no INTEGER,
    socio_id     INTEGER,
    tipo         VARCHAR(3),
    correcao_no  INTEGER,
    quem         VARCHAR(100),
    quando       DATETIME,
    concluida    DATETIME
);

-- Sums of the try-out from the index alone; the first of the two had fewer columns.
DROP INDEX IF EXISTS ixMovimentos_socio;
CREATE INDEX ixMovimentos_socio ON tbZelmar_Movimentos (socio_id, rubrica_id, liquido, credito);
CREATE INDEX IF NOT EXISTS ixAcumulados_grupo
    ON tbSocios_Acumulados (socio_id, rubrica_id_main, codABC, credito_ac, debito_ac);

-- The version itself.
CREATE TABLE IF NOT EXISTS tbVersao (
    versao INTEGER
);
