# SPDX-License-Identifier: MIT
"""The small book that deeds are done in, and a look into books after faults."""

import hashlib
import os
import sqlite3
from contextlib import closing

CONTENT = """
INSERT INTO tbSocios (socio_id, no_kor, nome, nib, zelmar) VALUES
    (1, '100001', 'Ana', '111111111111111111111', 1), (2, '100002', 'Rui', '1', 1);
INSERT INTO tbZelmar_Plafonds (rubrica_id, rubrica_id_main, code, descrit, percent, agregado,
                               socio) VALUES
    (1, NULL, '1', 'Consultas', NULL, 40000, NULL), (2, 1, '1.1', 'Geral', 0.5, NULL, 1000),
    (3, NULL, '2', 'Outras', NULL, 40000, NULL), (4, 3, '2.1', 'Vacinas', 0.8, NULL, 200);
INSERT INTO tbHospitais (hospital_id, code, nome) VALUES (1, 'H01', 'Hospital do Mar');
DELETE FROM tbContadores; INSERT INTO tbContadores (zelmars) VALUES (910);
DELETE FROM tbCheques; INSERT INTO tbCheques (cheque_no) VALUES (500);
INSERT INTO tbZelmar_Movimentos (movimento_id, movimento_no, socio_id, codABC, rubrica_id, data,
                                 tipo, doc_no, doc_valor, recebido, incidencia, credito, debito,
                                 modo_pagamento) VALUES
    (901, 901, 1, 'A', 2, '2026-03-01', 'DOC', 'D901', 60, 0, NULL, 20, 50, 'TRF'),
    (902, 902, 1, 'A', 2, '2026-03-02', 'HOS', 'H902', 60, 0, 60, 20, 50, 'CHQ'),
    (903, 903, 2, NULL, NULL, '2026-03-03', 'PAG', NULL, 0, 0, NULL, 30, 0, 'CHQ'),
    (904, 904, 2, NULL, NULL, '2026-03-04', 'REP', NULL, 0, 0, NULL, 0, 75, 'CHQ');
INSERT INTO tbSocios_Acumulados (socio_id, codABC, rubrica_id, rubrica_id_main, debito_ac,
                                 credito_ac, no_docs) VALUES
    (1, 'A', 2, 1, 100, 40, 2), (2, NULL, 0, 0, 75, 30, 2);
"""

# What differs between two runs of the same deed.
PASSING = {"operacao_id", "quem", "quando", "concluida", "movimento_id", "movimento_no",
           "correcao_no", "operador", "created_by", "created_date", "cheque", "_linha"}


class Broken(Exception):
    pass


def rows_of(path):
    """All rows of a book, {table: rows}; None where there is none. The book has to be whole."""
    if not os.path.exists(path):
        return None
    with closing(sqlite3.connect(path, isolation_level=None)) as book:
        try:
            found = [row[0] for row in book.execute("PRAGMA integrity_check")]
            if found != ["ok"]:
                raise Broken(f"integrity: {found[:3]}")
            tables = [row[0] for row in book.execute(
                "SELECT name FROM sqlite_schema WHERE type = 'table' ORDER BY name")]
            if "tbSocios" not in tables:
                raise Broken(f"no book, but tables {tables[:3]}")
            return {table: book.execute(f"SELECT * FROM \"{table}\"").fetchall()
                    for table in tables}
        except sqlite3.DatabaseError as failure:
            raise Broken(str(failure)) from failure


def digest(rows):
    return hashlib.md5(repr(rows).encode()).hexdigest() if rows is not None else "absent"


def digest_of_any_run(path):
    """A state that is the same in every run of a deed."""
    rows = rows_of(path)
    return digest(rows and lasting(path, list(rows)))


def difference(before, after):
    """What a write did, in short: "tbContadores~1 tbOperacoes+1"."""
    if before is None or after is None:
        return "absent" if after is None else "made"
    told = []
    for table in sorted(after.keys() | before.keys()):
        old, new = before.get(table, []), after.get(table, [])
        if old == new or table == "sqlite_sequence":
            continue
        more = len(new) - len(old)
        told.append(table + (f"+{more}" if more > 0 else f"{more}" if more < 0 else "~"))
    return " ".join(told)


def lasting(path, tables):
    """The rows of those of the tables that are there, as they are after any run that went well:
    without keys, numbers, times."""
    with closing(sqlite3.connect(path)) as book:
        found = {}
        there = {row[0] for row in book.execute("SELECT name FROM sqlite_schema")}
        for table in there.intersection(tables):
            rows = book.execute(f"SELECT * FROM {table}")
            names = [column[0] for column in rows.description]
            found[table] = sorted(repr([(name, value) for name, value in zip(names, row)
                                        if name.lower() not in PASSING]) for row in rows)
        return found
