# SPDX-License-Identifier: MIT
"""A member's account by key presses alone: a receipt posted and annulled, documents of a member and
of one who has left annulled, repositions with and without a rubric; the rows in the book.

Usage: account.py FOLDER_OF_THE_PROGRAMS [sqlite|postgresql [FOLDER_FOR_PICTURES]]
"""

import os
import sys
from datetime import date

from books import single
from desktop import Failed, wait_until
from entry import ENTRY, MAIN, MEMBER
from play import play

ACCOUNT = "Lançamento de Zelmar"
COLUMNS = ("movimento_no, socio_id, tipo, modo_pagamento, data, codABC, rubrica_id, doc_valor, "
           "credito, debito, liquido, created_by")


def expect(what, found, wanted):
    print(f"  {what}: {found}")
    if found != wanted:
        raise Failed(f"{what} is {found!r} and not {wanted!r}")


def newest(book, inactive=False):
    table = "tbZelmar_Movimentos" + ("_Inactivos" if inactive else "")
    return book.row(f"SELECT {COLUMNS} FROM {table} ORDER BY movimento_id DESC LIMIT 1")


def confirm(desktop, key, title):
    desktop.ask(key)
    desktop.at(title)
    desktop.keys("alt+s")


def typed(desktop, *texts):
    for text in texts:
        if text:
            desktop.type(text)
        desktop.keys("Tab")


def open_account(desktop, key):
    desktop.at(MAIN)
    desktop.keys(key)
    desktop.at(ACCOUNT)
    typed(desktop, MEMBER)


def posted(desktop, book, counter):
    confirm(desktop, "alt+o", ACCOUNT)
    wait_until("the movement is posted",
               lambda: book.row("SELECT zelmars FROM tbContadores")["zelmars"] == counter + 1)
    desktop.at(MAIN)
    row = newest(book)
    print(" ", row)
    expect("number", row["movimento_no"], counter)
    return row


def receipt(desktop, book, counter):
    open_account(desktop, "ctrl+r")
    typed(desktop, "", "", "150,25", "", "4711", "entregue em mão")
    desktop.show("recebimento")
    row = posted(desktop, book, counter)
    expect("receipt", (row["tipo"], row["modo_pagamento"], row["credito"], row["debito"]),
           ("PAG", "CHQ", 150.25, 0))
    account = ("SELECT credito_ac FROM tbSocios_Acumulados WHERE socio_id = ? "
               "AND rubrica_id_main = 0")
    expect("account", book.rows(account, row["socio_id"]), [{"credito_ac": single(150.25)}])

    # It stands on top of the list without a refresh.
    desktop.keys("Escape", "Return")
    desktop.at(ACCOUNT)
    desktop.show("recebimento-registado")
    confirm(desktop, "alt+a", "Anular Recebimento")
    desktop.at(MAIN)
    correcting = newest(book)
    print(" ", correcting)
    expect("correcting row", (correcting["movimento_no"], correcting["tipo"], correcting["credito"],
                              correcting["debito"]), (counter + 1, "COR", -150.25, 0))
    expect("annulled", book.rows("SELECT tipo, modo_pagamento FROM tbZelmar_Movimentos "
                                 "WHERE movimento_no = ?", counter),
           [{"tipo": "ANL", "modo_pagamento": "ANL"}])
    expect("account", book.rows(account, row["socio_id"]), [{"credito_ac": 0}])


def document(desktop, book, counter, suffix):
    row = book.row(
        "SELECT movimento_id, movimento_no, socio_id, codABC, rubrica_id, no_kor, credito, debito "
        "FROM vwZelmars_Movimentos_Vigor WHERE tipo = 'DOC' AND ficheiro = ? "
        "ORDER BY movimento_no DESC LIMIT 1", "INACTIVO" if suffix else "ACTIVO")
    totals = (f"SELECT credito_ac, debito_ac, no_docs FROM tbSocios_Acumulados{suffix} "
              "WHERE socio_id = ? AND codABC = ? AND rubrica_id = ?",
              row["socio_id"], row["codabc"], row["rubrica_id"])
    before = book.row(*totals)
    desktop.at(MAIN)
    desktop.keys("ctrl+f")
    desktop.type(f"{row['movimento_no']} {row['no_kor']} doc")
    desktop.keys("Return")
    desktop.at(ENTRY)
    desktop.show("documento" + suffix)
    confirm(desktop, "alt+a", "Anular Lançamento")
    desktop.at(MAIN)
    desktop.keys("ctrl+f", "Escape")
    desktop.show("lista" + suffix)
    correcting = newest(book, bool(suffix))
    print(" ", correcting)
    expect("correcting row", (correcting["movimento_no"], correcting["tipo"], correcting["credito"],
                              correcting["debito"], correcting["liquido"]),
           (counter, "COR", -row["credito"], -row["debito"], None))
    expect("annulled", book.rows(f"SELECT tipo, modo_pagamento FROM tbZelmar_Movimentos{suffix} "
                                 "WHERE movimento_id = ?", row["movimento_id"]),
           [{"tipo": "ANL", "modo_pagamento": "ANL"}])
    expect("totals", book.row(*totals),
           {"credito_ac": single(before["credito_ac"] - row["credito"]),
            "debito_ac": single(before["debito_ac"] - row["debito"]),
            "no_docs": before["no_docs"] - 1})


def repositions(desktop, book, counter):
    rubric = book.row("SELECT rubrica_id FROM tbZelmar_Plafonds WHERE code = '5.02'")["rubrica_id"]
    open_account(desktop, "ctrl+k")
    desktop.keys("alt+i")
    desktop.at("Escolher Familiar")
    desktop.keys("Return")
    desktop.at(ACCOUNT)
    typed(desktop, "", "5.02", "", "12,5", "0", "acerto")
    desktop.show("correccao")
    with_rubric = posted(desktop, book, counter)
    desktop.keys("Return")
    desktop.at(ACCOUNT)
    desktop.show("correccao-registada")
    desktop.keys("alt+s")

    open_account(desktop, "ctrl+k")
    typed(desktop, "", "", "", "", "", "0", "7,75")
    without = posted(desktop, book, counter + 1)
    expect("repositions", [(row["tipo"], row["codabc"], row["rubrica_id"], row["debito"],
                             row["credito"]) for row in (with_rubric, without)],
           [("REP", "A", rubric, 12.5, 0), ("REP", None, 0, 0, 7.75)])
    expect("totals", book.rows(
        "SELECT codABC, rubrica_id, debito_ac, credito_ac FROM tbSocios_Acumulados "
        "WHERE socio_id = ? AND rubrica_id IS NOT NULL ORDER BY rubrica_id DESC",
        with_rubric["socio_id"]),
        [{"codabc": "A", "rubrica_id": rubric, "debito_ac": 12.5, "credito_ac": 0},
         {"codabc": None, "rubrica_id": 0, "debito_ac": 0, "credito_ac": 7.75}])


def account(desktop, programs, book):
    counter = book.row("SELECT zelmars FROM tbContadores")["zelmars"]
    desktop.start([os.path.join(programs, "zelmars")])
    receipt(desktop, book, counter)
    document(desktop, book, counter + 2, "")
    repositions(desktop, book, counter + 3)
    document(desktop, book, counter + 5, "_Inactivos")
    expect("next number", book.row("SELECT zelmars FROM tbContadores")["zelmars"], counter + 6)
    expect("days of the rows", {str(row["data"])[:10] for row in book.rows(
        "SELECT data FROM vwZelmars_Movimentos_Vigor WHERE movimento_no >= ?", counter)},
        {date.today().isoformat()})


if __name__ == "__main__":
    play(account, *sys.argv[1:])
