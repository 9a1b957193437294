-- SPDX-License-Identifier: MIT
-- The schema of the first books in files, word for word but for its comments.
CREATE TABLE tbZelmar_Movimentos (
    movimento_id      INTEGER PRIMARY KEY AUTOINCREMENT,
    movimento_no      INTEGER,
    socio_id          INTEGER,
    codABC            VARCHAR(4),
    rubrica_id        INTEGER,
    hospital_id       INTEGER,
    oe_id             INTEGER,
    data              DATETIME,
    tipo              VARCHAR(3),
    doc_data          DATETIME,
    doc_no            VARCHAR(20),
    doc_valor         MONEY,
    doc_iva           MONEY,
    doc_tx_iva        DOUBLE,
    recebido          MONEY,
    incidencia        MONEY,
    comparticipacao   MONEY,
    saldo_plafond     MONEY,
    saldo_acumulado   MONEY,
    iliquido          MONEY,
    liquido           MONEY,
    credito           MONEY,
    debito            MONEY,
    modo_pagamento    VARCHAR(3),
    cheque            BIGINT,
    descrit           TEXT,
    obs               TEXT,
    created_by        VARCHAR(50),
    upsize_ts         BIGINT
);
CREATE INDEX ixMovimentos_socio ON tbZelmar_Movimentos (socio_id, rubrica_id);
CREATE INDEX ixMovimentos_data ON tbZelmar_Movimentos (data);
CREATE TABLE tbZelmar_Movimentos_Inactivos (
    movimento_id      INTEGER PRIMARY KEY AUTOINCREMENT,
    movimento_no      INTEGER,
    socio_id          INTEGER,
    codABC            VARCHAR(4),
    rubrica_id        INTEGER,
    hospital_id       INTEGER,
    oe_id             INTEGER,
    data              DATETIME,
    tipo              VARCHAR(3),
    doc_data          DATETIME,
    doc_no            VARCHAR(20),
    doc_valor         MONEY,
    doc_iva           MONEY,
    doc_tx_iva        DOUBLE,
    recebido          MONEY,
    incidencia        MONEY,
    comparticipacao   MONEY,
    saldo_plafond     MONEY,
    saldo_acumulado   MONEY,
    iliquido          MONEY,
    liquido           MONEY,
    credito           MONEY,
    debito            MONEY,
    modo_pagamento    VARCHAR(3),
    cheque            BIGINT,
    descrit           TEXT,
    obs               TEXT,
    created_by        VARCHAR(50),
    upsize_ts         BIGINT
);
INSERT INTO sqlite_sequence (name, seq) VALUES ('tbZelmar_Movimentos_Inactivos', 1000000000);
CREATE INDEX ixMovimentos_Inactivos_socio ON tbZelmar_Movimentos_Inactivos (socio_id, rubrica_id);
CREATE INDEX ixMovimentos_Inactivos_data ON tbZelmar_Movimentos_Inactivos (data);
CREATE TABLE tbZelmar_Movimentos_Historico (
    ano                 INTEGER,
    movimento_no        INTEGER,
    socio_id            INTEGER,
    codABC              VARCHAR(4),
    rubrica_id          INTEGER,
    hospital_id         INTEGER,
    oe_id               INTEGER,
    data                DATETIME,
    tipo                VARCHAR(3),
    doc_data            DATETIME,
    doc_no              VARCHAR(20),
    doc_valor           MONEY,
    doc_iva             MONEY,
    doc_tx_iva          DOUBLE,
    recebido            MONEY,
    incidencia          MONEY,
    comparticipacao     MONEY,
    saldo_plafond       MONEY,
    saldo_acumulado     MONEY,
    iliquido            MONEY,
    liquido             MONEY,
    credito             MONEY,
    debito              MONEY,
    modo_pagamento      VARCHAR(3),
    cheque              BIGINT,
    descrit             TEXT,
    obs                 TEXT,
    created_by          VARCHAR(50),
    no_kor              VARCHAR(10),
    nome                VARCHAR(100),
    nome_guerra         VARCHAR(40),
    no_contribuinte     VARCHAR(15),
    nome_familiar       VARCHAR(100),
    morada              VARCHAR(100),
    localidade_completo VARCHAR(70)
);
CREATE INDEX ixHistorico_ano ON tbZelmar_Movimentos_Historico (ano, no_kor);
CREATE INDEX ixHistorico_no_kor ON tbZelmar_Movimentos_Historico (no_kor);
CREATE TABLE tbSocios_Acumulados (
    socio_id        INTEGER,
    codABC          VARCHAR(4),
    rubrica_id      INTEGER,
    rubrica_id_main INTEGER,
    debito_ac       REAL,
    credito_ac      REAL,
    no_docs         INTEGER
);
CREATE INDEX ixAcumulados_socio ON tbSocios_Acumulados (socio_id, rubrica_id, codABC);
CREATE TABLE tbSocios_Acumulados_Inactivos (
    socio_id        INTEGER,
    codABC          VARCHAR(4),
    rubrica_id      INTEGER,
    rubrica_id_main INTEGER,
    debito_ac       REAL DEFAULT 0,
    credito_ac      REAL DEFAULT 0,
    no_docs         INTEGER
);
CREATE INDEX ixAcumulados_Inactivos_socio
    ON tbSocios_Acumulados_Inactivos (socio_id, rubrica_id, codABC);
CREATE TABLE tbZelmar_Plafonds (
    rubrica_id             INTEGER PRIMARY KEY AUTOINCREMENT,
    rubrica_id_main        INTEGER,
    code                   VARCHAR(10),
    descrit                VARCHAR(80),
    percent                DOUBLE,
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
CREATE TABLE tbContadores (
    zelmars INTEGER
);
CREATE TABLE tbCheques (
    cheque_no BIGINT
);
CREATE TABLE tbSocios (
    socio_id             INTEGER PRIMARY KEY AUTOINCREMENT,
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
CREATE TABLE tbSocios_Familias (
    socio_familia_id INTEGER PRIMARY KEY AUTOINCREMENT,
    socio_id         INTEGER,
    codABC           VARCHAR(4),
    nome             VARCHAR(100),
    data_nascimento  DATETIME,
    data_carencia    DATETIME
);
CREATE INDEX ixFamilias_socio ON tbSocios_Familias (socio_id, codABC);
CREATE TABLE tbSocios_Familias_Inactivos (
    socio_familia_id INTEGER PRIMARY KEY,
    socio_id         INTEGER,
    codABC           VARCHAR(4),
    nome             VARCHAR(100),
    data_nascimento  DATETIME,
    data_carencia    DATETIME
);
CREATE INDEX ixFamilias_Inactivos_socio ON tbSocios_Familias_Inactivos (socio_id, codABC);
CREATE TABLE tbQuotas_Socios (
    socio_id     INTEGER PRIMARY KEY,
    ult_ano      INTEGER,
    ult_mes      INTEGER,
    total_quotas MONEY,
    total_pago   MONEY
);
CREATE TABLE tbQuotas_Movimentos (
    quota_id INTEGER PRIMARY KEY AUTOINCREMENT,
    socio_id INTEGER,
    data     DATETIME,
    ano      INTEGER,
    mes      INTEGER,
    valor    MONEY,
    descrit  VARCHAR(80)
);
CREATE INDEX ixQuotas_Movimentos_socio ON tbQuotas_Movimentos (socio_id);
CREATE TABLE tbZelmar_movimentos_tipos (
    code    VARCHAR(3) PRIMARY KEY,
    descrit VARCHAR(40)
);
CREATE TABLE tbModos_Pagamento (
    code    VARCHAR(3) PRIMARY KEY,
    descrit VARCHAR(40)
);
CREATE TABLE tbSocios_Familias_CodeABC (
    descrit VARCHAR(4) PRIMARY KEY,
    grau    VARCHAR(40)
);
CREATE TABLE tbOutrasInstituicoes (
    oe_id   INTEGER PRIMARY KEY AUTOINCREMENT,
    descrit VARCHAR(60)
);
CREATE TABLE tbLocalidades (
    code    VARCHAR(10) PRIMARY KEY,
    descrit VARCHAR(50)
);
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
