-- SPDX-License-Identifier: MIT
-- The code lists, the counters and the version of a new book; the same text for every engine.

INSERT INTO tbVersao (versao) VALUES ({version});

INSERT INTO tbZelmar_movimentos_tipos (code, descrit) VALUES
    ('ANL', 'Anulado'),
    ('COR', 'Correcção de anulação'),
    ('DOC', 'Documento médico'),
    ('HOS', 'Documento hospitalar'),
    ('PAG', 'Recebimento'),
    ('REP', 'Reposição'),
    ('SA', 'Saldo de abertura');

INSERT INTO tbModos_Pagamento (code, descrit) VALUES
    ('ANL', 'Anulado'),
    ('CHQ', 'Cheque'),
    ('DEP', 'Depósito bancário'),
    ('NUM', 'Numerário'),
    ('TRF', 'Transferência bancária'),
    ('VEN', 'Desconto no vencimento');

INSERT INTO tbSocios_Familias_CodeABC (descrit, grau) VALUES
    ('A', 'Titular'),
    ('B', 'Cônjuge'),
    ('C1', '1.º filho(a)'),
    ('C2', '2.º filho(a)'),
    ('C3', '3.º filho(a)'),
    ('C4', '4.º filho(a)'),
    ('C5', '5.º filho(a)'),
    ('C6', '6.º filho(a)'),
    ('D1', 'Pai'),
    ('D2', 'Mãe'),
    ('E1', 'Sogro'),
    ('E2', 'Sogra'),
    ('F', 'Irmão ou irmã'),
    ('G', 'Neto(a)'),
    ('H', 'Outro familiar');

INSERT INTO tbOutrasInstituicoes (descrit) VALUES
    ('ADSE'),
    ('Serviço Nacional de Saúde'),
    ('Segurança Social'),
    ('ADM - Assistência na Doença aos Militares'),
    ('SAD - GNR'),
    ('SAD - PSP'),
    ('SAMS'),
    ('Seguro de acidentes de trabalho'),
    ('Seguro automóvel'),
    ('Seguro escolar'),
    ('Seguradora de saúde'),
    ('Outra entidade');

INSERT INTO tbLocalidades (code, descrit) VALUES
    ('1050-012', 'Lisboa'),
    ('1170-283', 'Lisboa'),
    ('1500-640', 'Lisboa'),
    ('1885-016', 'Moscavide'),
    ('2005-177', 'Santarém'),
    ('2400-137', 'Leiria'),
    ('2560-306', 'Torres Vedras'),
    ('2610-180', 'Amadora'),
    ('2655-319', 'Ericeira'),
    ('2675-389', 'Odivelas'),
    ('2710-428', 'Sintra'),
    ('2750-312', 'Cascais'),
    ('2780-271', 'Oeiras'),
    ('2800-114', 'Almada'),
    ('2830-145', 'Barreiro'),
    ('2900-028', 'Setúbal'),
    ('3000-213', 'Coimbra'),
    ('3510-086', 'Viseu'),
    ('3800-164', 'Aveiro'),
    ('4050-253', 'Porto'),
    ('4400-124', 'Vila Nova de Gaia'),
    ('4450-208', 'Matosinhos'),
    ('4700-319', 'Braga'),
    ('4800-412', 'Guimarães'),
    ('4900-357', 'Viana do Castelo'),
    ('5000-651', 'Vila Real'),
    ('5300-145', 'Bragança'),
    ('6000-234', 'Castelo Branco'),
    ('6300-559', 'Guarda'),
    ('7000-503', 'Évora'),
    ('7300-110', 'Portalegre'),
    ('7800-459', 'Beja'),
    ('8000-138', 'Faro'),
    ('8500-510', 'Portimão'),
    ('9000-060', 'Funchal'),
    ('9500-150', 'Ponta Delgada');

-- Numbering starts at 1. Without this row the first number would be given twice.
INSERT INTO tbContadores (zelmars) VALUES (1);
INSERT INTO tbCheques (cheque_no) VALUES (1);
