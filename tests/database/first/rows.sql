-- SPDX-License-Identifier: MIT
-- A few rows for each table of the first books, in words that both engines take.
INSERT INTO tbZelmar_movimentos_tipos VALUES ('ANL', 'Anulado'), ('DOC', 'Documento médico'),
    ('COR', 'Correcção de anulação');
INSERT INTO tbModos_Pagamento VALUES ('TRF', 'Transferência bancária'), ('ANL', 'Anulado');
INSERT INTO tbSocios_Familias_CodeABC VALUES ('A', 'Titular'), ('B', 'Cônjuge');
INSERT INTO tbOutrasInstituicoes (oe_id, descrit) VALUES (1, 'ADSE');
INSERT INTO tbLocalidades VALUES ('1000-001', 'Lisboa');
INSERT INTO tbHospitais (hospital_id, code, nome) VALUES (1, 'H01', 'Hospital da Luz Nova');
INSERT INTO tbZelmar_Plafonds (rubrica_id, rubrica_id_main, code, descrit, percent, agregado, socio,
                               familiar)
    VALUES (1, NULL, '01', 'Consultas', NULL, 1500.5, NULL, NULL),
           (2, 1, '01.1', 'Clínica geral', 0.8, NULL, 1000, 750.25);
INSERT INTO tbSocios (socio_id, no_kor, nome, nome_guerra, nib, zelmar)
    VALUES (1, '100015', 'António Manuel Silva Matos', 'António', '001300000000000000186', 1),
           (2, '100023', 'Maria João Pires Teles', NULL, '', 0);
INSERT INTO tbSocios_Inactivos (socio_id, no_kor, nome) VALUES (70, '100099', 'Zulmira Dias');
INSERT INTO tbSocios_Familias (socio_familia_id, socio_id, codABC, nome, data_nascimento)
    VALUES (1, 1, 'A', 'António Manuel Silva Matos', '1960-02-29 00:00:00'),
           (2, 1, 'B', 'Maria da Luz', NULL);
INSERT INTO tbSocios_Familias_Inactivos (socio_familia_id, socio_id, codABC) VALUES (9, 70, 'A');
INSERT INTO tbQuotas_Socios VALUES (1, 2026, 5, 120.4, 120.4);
INSERT INTO tbQuotas_Movimentos (quota_id, socio_id, data, ano, mes, valor)
    VALUES (1, 1, '2026-05-02 00:00:00', 2026, 5, 10.05);
INSERT INTO tbZelmar_Movimentos (movimento_id, movimento_no, socio_id, codABC, rubrica_id, data, tipo,
                                 doc_valor, comparticipacao, liquido, credito, debito, obs, created_by)
    VALUES (1, 1, 1, 'A', 2, '2026-01-15 00:00:00', 'DOC', 87.35, 69.88, 69.88, 69.88, 87.35,
            'à espera; "de" ''tudo''', 'ana'),
           (2, 2, 1, '', NULL, '2026-02-28 23:59:59', 'ANL', NULL, NULL, NULL, 0.1, -0.3, NULL, NULL);
INSERT INTO tbZelmar_Movimentos_Inactivos (movimento_id, movimento_no, socio_id, tipo, credito)
    VALUES (3, 3, 70, 'DOC', 12.3456);
INSERT INTO tbZelmar_Movimentos_Historico (ano, movimento_no, socio_id, tipo, debito, no_kor, nome)
    VALUES (2025, 1, 1, 'DOC', 5, '100015', 'António Matos'), (2025, 1, 1, 'DOC', 5, '100015', '');
INSERT INTO tbSocios_Acumulados (socio_id, codABC, rubrica_id, rubrica_id_main, debito_ac, credito_ac,
                                 no_docs)
    VALUES (1, 'A', 2, 1, 0, 69.88, 1), (7, NULL, NULL, NULL, NULL, 0.5, NULL),
           (7, NULL, NULL, NULL, NULL, 0.5, NULL);
INSERT INTO tbSocios_Acumulados_Inactivos (socio_id, codABC, rubrica_id, credito_ac)
    VALUES (70, 'A', 2, 12.3456);
INSERT INTO tbContadores (zelmars) VALUES (4);
INSERT INTO tbCheques (cheque_no) VALUES (4711);
