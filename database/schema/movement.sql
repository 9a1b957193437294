-- SPDX-License-Identifier: MIT
-- What a movement carries in each table that keeps one.
    movimento_no      INTEGER,                            -- drawn from tbContadores, unique in a year
    socio_id          INTEGER,
    codABC            VARCHAR(4),                         -- whom it is for; null or '' for nobody
    rubrica_id        INTEGER,
    hospital_id       INTEGER,
    oe_id             INTEGER,
    data              DATETIME,                           -- day of entry
    tipo              VARCHAR(3),
    doc_data          DATETIME,
    doc_no            VARCHAR(20),
    doc_valor         MONEY,
    doc_iva           MONEY,
    doc_tx_iva        DOUBLE,                             -- per cent, 0 to 100
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
    created_by        VARCHAR(50)
