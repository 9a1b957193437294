-- SPDX-License-Identifier: MIT
-- The book's schema. Names are the system's own; letter case does not matter to any engine.
--
-- It is written in the words of SQLite; another engine translates them. A name in braces stands for
-- the file of that name. Types, as the row-set layer reads them:
--   MONEY     an amount with four decimals
--   REAL      a 32-bit float, DOUBLE a 64-bit one
--   DATETIME  a moment without a zone (here text 'YYYY-MM-DD HH:MM:SS'), a day being its first instant
-- Nothing refers to anything by a constraint: members leave into the tables *_Inactivos, rubrics and
-- hospitals may go while old movements still name them, and the screens rely on being let.

-- Movements --------------------------------------------------------------------------------------

-- One row is one movement of a member's account in the current plan year.
CREATE TABLE tbZelmar_Movimentos (
    movimento_id      INTEGER PRIMARY KEY AUTOINCREMENT,  -- never given twice
    {movement},
    upsize_ts         BIGINT                              -- row version of the former server; unused
);
-- Franchise of the try-out: Sum(liquido), Sum(credito) WHERE socio_id = ? AND rubrica_id = ?, from
-- the index alone, because a member may have very many; extracts: WHERE socio_id = ?
CREATE INDEX ixMovimentos_socio ON tbZelmar_Movimentos (socio_id, rubrica_id, liquido, credito);
-- Payment listings, hospital listing: WHERE data >= ? AND data <= ?
CREATE INDEX ixMovimentos_data ON tbZelmar_Movimentos (data);

-- The same for members who have left.
CREATE TABLE tbZelmar_Movimentos_Inactivos (
    movimento_id      INTEGER PRIMARY KEY AUTOINCREMENT,
    {movement},
    upsize_ts         BIGINT
);
-- The same statements as above, run on this table beside them.
CREATE INDEX ixMovimentos_Inactivos_socio ON tbZelmar_Movimentos_Inactivos (socio_id, rubrica_id);
CREATE INDEX ixMovimentos_Inactivos_data ON tbZelmar_Movimentos_Inactivos (data);

-- Movements of closed years, with the member's name and address as they stood at the close.
CREATE TABLE tbZelmar_Movimentos_Historico (
    ano                 INTEGER,                          -- the year closed
    {movement},
    no_kor              VARCHAR(10),
    nome                VARCHAR(100),
    nome_guerra         VARCHAR(40),
    no_contribuinte     VARCHAR(15),
    nome_familiar       VARCHAR(100),
    morada              VARCHAR(100),
    localidade_completo VARCHAR(70)
);
-- List of closed years: GROUP BY ano; tax declarations: WHERE ano = ? GROUP BY …, no_kor
CREATE INDEX ixHistorico_ano ON tbZelmar_Movimentos_Historico (ano, no_kor);
-- Tax declaration, whether a member has any: WHERE no_kor = ?
CREATE INDEX ixHistorico_no_kor ON tbZelmar_Movimentos_Historico (no_kor);

-- Accumulators -----------------------------------------------------------------------------------
-- Running totals per member, person and rubric. Neither key nor constraint: several equal rows are
-- allowed, and so is null in every column.

CREATE TABLE tbSocios_Acumulados (
    socio_id        INTEGER,
    codABC          VARCHAR(4),
    rubrica_id      INTEGER,
    rubrica_id_main INTEGER,
    debito_ac       REAL,
    credito_ac      REAL,
    no_docs         INTEGER
);
-- Try-out and posting: WHERE rubrica_id = ? AND socio_id = ? AND codABC = ?
CREATE INDEX ixAcumulados_socio ON tbSocios_Acumulados (socio_id, rubrica_id, codABC);
-- Sums of the try-out, from the index alone: WHERE rubrica_id_main = ? AND socio_id = ?; the balance:
-- WHERE socio_id = ?
CREATE INDEX ixAcumulados_grupo
    ON tbSocios_Acumulados (socio_id, rubrica_id_main, codABC, credito_ac, debito_ac);

-- The year close writes one of the two sums here and leaves the other to its default.
CREATE TABLE tbSocios_Acumulados_Inactivos (
    socio_id        INTEGER,
    codABC          VARCHAR(4),
    rubrica_id      INTEGER,
    rubrica_id_main INTEGER,
    debito_ac       REAL DEFAULT 0,
    credito_ac      REAL DEFAULT 0,
    no_docs         INTEGER
);
-- Annulments, as above.
CREATE INDEX ixAcumulados_Inactivos_socio
    ON tbSocios_Acumulados_Inactivos (socio_id, rubrica_id, codABC);

-- Rubrics and hospitals --------------------------------------------------------------------------
-- Keys are never given twice, since closed years go on naming rubrics and hospitals that are gone.

-- A main rubric has a null rubrica_id_main and carries the ceilings of its group. A null ceiling is
-- no ceiling.
CREATE TABLE tbZelmar_Plafonds (
    rubrica_id             INTEGER PRIMARY KEY AUTOINCREMENT,
    rubrica_id_main        INTEGER,
    code                   VARCHAR(10),
    descrit                VARCHAR(80),
    percent                DOUBLE,                        -- 0 to 1, a fraction
    agregado               MONEY,
    socio                  MONEY,
    familiar               MONEY,
    total_familia          MONEY,
    nomax_recibos_socio    INTEGER,
    nomax_recibos_familiar INTEGER,
    socio_min_lan          MONEY,
    socio_max_lan          MONEY,
    familiar_min_lan       MONEY,
    familiar_max_lan       MONEY,
    franquia               MONEY
);

CREATE TABLE tbHospitais (
    hospital_id INTEGER PRIMARY KEY AUTOINCREMENT,
    code        VARCHAR(10),
    nome        VARCHAR(80),
    morada      VARCHAR(100),
    code_postal VARCHAR(10),
    localidade  VARCHAR(50),
    telefone1   VARCHAR(20),
    telefone2   VARCHAR(20),
    fax         VARCHAR(20)
);

-- Counters ---------------------------------------------------------------------------------------
-- One row each, read whole and without a key.

CREATE TABLE tbContadores (
    zelmars INTEGER                                       -- the next movement number
);

CREATE TABLE tbCheques (
    cheque_no BIGINT                                      -- the next cheque number to offer
);

-- Age --------------------------------------------------------------------------------------------

-- Which version of this schema the book has; one row. Books made before there was this table have
-- none and are of version 1.
CREATE TABLE tbVersao (
    versao INTEGER
);

-- Journal ----------------------------------------------------------------------------------------
-- Postings and annulments are several writes, one commit each. A row here is written in the commit
-- of the write that it tells of; it says what is missing of an operation that was cut short. A
-- posting's row goes with its last write; those of annulments stay, to say by whom.

CREATE TABLE tbOperacoes (
    operacao_id  VARCHAR(36) PRIMARY KEY,                 -- chosen by whoever begins the operation
    operacao     VARCHAR(3),                              -- LAN a posting, ANU an annulment
    passo        VARCHAR(3),                              -- missing: COR the correcting row and
                                                          -- then the accumulator, ACU the
                                                          -- accumulator; null: nothing
    ficheiro     VARCHAR(8),                              -- of the movement, as in the view
    movimento_id INTEGER,
    movimento_no INTEGER,
    socio_id     INTEGER,
    tipo         VARCHAR(3),                              -- before an annulment
    correcao_no  INTEGER,                                 -- number of the correcting row
    quem         VARCHAR(100),                            -- user@machine
    quando       DATETIME,                                -- begun
    concluida    DATETIME                                 -- done
);

-- Member file ------------------------------------------------------------------------------------

CREATE TABLE tbSocios (
    socio_id             INTEGER PRIMARY KEY AUTOINCREMENT,
    no_kor               VARCHAR(10),                     -- staff number, what people type
    nome                 VARCHAR(100),
    nome_guerra          VARCHAR(40),
    nib                  VARCHAR(30),                     -- valid with 21 characters
    zelmar               SMALLINT DEFAULT 0,              -- not 0: enrolled in the plan
    zelmar_data_carencia DATETIME,                        -- last day of the waiting period
    no_contribuinte      VARCHAR(15),
    morada1              VARCHAR(100),
    code_postal1         VARCHAR(10),
    localidade1          VARCHAR(50)
);
-- Typing a staff number: WHERE no_kor = ?
CREATE INDEX ixSocios_no_kor ON tbSocios (no_kor);

CREATE TABLE tbSocios_Inactivos (
    socio_id             INTEGER PRIMARY KEY,
    no_kor               VARCHAR(10),
    nome                 VARCHAR(100),
    nome_guerra          VARCHAR(40),
    nib                  VARCHAR(30),
    zelmar               SMALLINT DEFAULT 0,
    zelmar_data_carencia DATETIME,
    no_contribuinte      VARCHAR(15),
    morada1              VARCHAR(100),
    code_postal1         VARCHAR(10),
    localidade1          VARCHAR(50)
);

-- A member's relatives, the member himself (codABC 'A') among them.
CREATE TABLE tbSocios_Familias (
    socio_familia_id INTEGER PRIMARY KEY AUTOINCREMENT,
    socio_id         INTEGER,
    codABC           VARCHAR(4),
    nome             VARCHAR(100),
    data_nascimento  DATETIME,
    data_carencia    DATETIME                             -- last day of the waiting period
);
-- Choosing a person: WHERE socio_id = ?; names beside movements: ON socio_id AND codABC
CREATE INDEX ixFamilias_socio ON tbSocios_Familias (socio_id, codABC);

CREATE TABLE tbSocios_Familias_Inactivos (
    socio_familia_id INTEGER PRIMARY KEY,
    socio_id         INTEGER,
    codABC           VARCHAR(4),
    nome             VARCHAR(100),
    data_nascimento  DATETIME,
    data_carencia    DATETIME
);
-- Names beside movements, as above.
CREATE INDEX ixFamilias_Inactivos_socio ON tbSocios_Familias_Inactivos (socio_id, codABC);

-- The premium: one row per member who ever paid it.
CREATE TABLE tbQuotas_Socios (
    socio_id     INTEGER PRIMARY KEY,
    ult_ano      INTEGER,                                 -- year and month last paid
    ult_mes      INTEGER,
    total_quotas MONEY,                                   -- due
    total_pago   MONEY                                    -- paid
);

CREATE TABLE tbQuotas_Movimentos (
    quota_id INTEGER PRIMARY KEY AUTOINCREMENT,
    socio_id INTEGER,
    data     DATETIME,                                    -- day of the payment
    ano      INTEGER,                                     -- month paid for
    mes      INTEGER,
    valor    MONEY,
    descrit  VARCHAR(80)
);
-- Statement of the premium: WHERE tbQuotas_Movimentos.socio_id = ?
CREATE INDEX ixQuotas_Movimentos_socio ON tbQuotas_Movimentos (socio_id);

-- Code lists -------------------------------------------------------------------------------------

CREATE TABLE tbZelmar_movimentos_tipos (
    code    VARCHAR(3) PRIMARY KEY,
    descrit VARCHAR(40)
);

CREATE TABLE tbModos_Pagamento (
    code    VARCHAR(3) PRIMARY KEY,
    descrit VARCHAR(40)
);

-- `descrit` is the code compared with codABC: with an A the member himself, with a C a child.
CREATE TABLE tbSocios_Familias_CodeABC (
    descrit VARCHAR(4) PRIMARY KEY,
    grau    VARCHAR(40)
);

CREATE TABLE tbOutrasInstituicoes (
    oe_id   INTEGER PRIMARY KEY AUTOINCREMENT,
    descrit VARCHAR(60)
);

CREATE TABLE tbLocalidades (
    code    VARCHAR(10) PRIMARY KEY,                      -- postal code
    descrit VARCHAR(50)
);

-- Movements in force: the current plan year's, of members and of those who have left, whatever
-- their type; what an annulment marked or wrote is among them until the year closes.
-- Opening one: WHERE movimento_id = ?, which reaches the key of either table. The relative's name
-- is looked up, not joined, so that a code given twice in a family does not double a movement.
CREATE VIEW vwZelmars_Movimentos_Vigor AS
SELECT m.*, 'ACTIVO' AS ficheiro, s.no_kor, s.nome,
       (SELECT f.nome FROM tbSocios_Familias f
         WHERE f.socio_id = m.socio_id AND f.codABC = m.codABC
         ORDER BY f.socio_familia_id LIMIT 1) AS familiar
  FROM tbZelmar_Movimentos m LEFT JOIN tbSocios s ON s.socio_id = m.socio_id
UNION ALL
SELECT m.*, 'INACTIVO' AS ficheiro, s.no_kor, s.nome,
       (SELECT f.nome FROM tbSocios_Familias_Inactivos f
         WHERE f.socio_id = m.socio_id AND f.codABC = m.codABC
         ORDER BY f.socio_familia_id LIMIT 1) AS familiar
  FROM tbZelmar_Movimentos_Inactivos m LEFT JOIN tbSocios_Inactivos s ON s.socio_id = m.socio_id;
