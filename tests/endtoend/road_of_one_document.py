# SPDX-License-Identifier: MIT
"""A medical document and a hospital bill, from the main window to the book, by key presses alone.

The amounts in the book are compared with a calculation of this script's own, from the rubric's row.
Usage: road_of_one_document.py FOLDER_OF_THE_PROGRAMS [sqlite|postgresql [FOLDER_FOR_PICTURES]]
"""

import os
import sys
from datetime import date
from decimal import ROUND_HALF_UP, Decimal

from books import single
from desktop import Failed, wait_until
from entry import (ENTRY, EXIT, MAIN, MEMBER, choose_member_and_person, choose_person,
                   fill_in_fields, leave, post)
from play import play


def money(value):
    """What a money column keeps of a number: four decimals."""
    return float(Decimal(value).quantize(Decimal("0.0001"), ROUND_HALF_UP))


def rubric_of(book, code):
    return book.row("SELECT * FROM tbZelmar_Plafonds WHERE code = ?", code)


def room_of(book, rubric, person):
    """The lowest ceiling of a family that has used nothing yet."""
    main = book.row("SELECT * FROM tbZelmar_Plafonds WHERE rubrica_id = ?",
                    rubric["rubrica_id_main"])
    own = "socio" if person == "A" else "familiar"
    ceilings = [rubric[own] or 0, rubric["agregado"], main[own], main["agregado"],
                rubric[own + "_max_lan"]]
    if person != "A":
        ceilings += [rubric["total_familia"], main["total_familia"]]
    return min(c for c in ceilings if c is not None)


def expect(row, **wanted):
    for column, value in wanted.items():
        found = row[column.lower()]
        if found != value:
            raise Failed(f"{column} is {found!r} and not {value!r}")
        print(f"  {column:16} {found}")


def medical_document(desktop, book, today):
    """Glasses for 87,35 at rate 23, for the member himself."""
    rubric = rubric_of(book, "5.02")
    desktop.at(MAIN)
    desktop.keys("ctrl+n")
    choose_member_and_person(desktop)
    fill_in_fields(desktop, today, "4711", "87,35", "0", "23", "", "Lentes", rubric["code"], "")
    desktop.keys("alt+e")
    wait_until("the try-out has added its accumulator row", lambda: book.row(
        "SELECT 1 FROM tbSocios_Acumulados a JOIN tbSocios s ON s.socio_id = a.socio_id "
        "WHERE s.no_kor = ? AND a.rubrica_id = ? AND a.codABC = 'A'", MEMBER,
        rubric["rubrica_id"]))
    desktop.show("ensaio")
    post(desktop)
    desktop.at(EXIT)

    share = money(87.35 * single(rubric["percent"]))
    room = money(single(room_of(book, rubric, "A")))
    net = money(min(single(share), single(87.35), single(room)))
    franchise = single(rubric["franquia"] or 0)
    credit = money(single(single(net) - franchise)) if franchise < single(net) else 0.0
    row = newest(book)
    expect(row, tipo="DOC", codABC="A", doc_no="4711", doc_valor=87.35, doc_tx_iva=23,
           doc_iva=money(round((single(87.35) - single(87.35) / 1.23) * 100) / 100), recebido=0,
           incidencia=87.35, comparticipacao=share, saldo_plafond=room, saldo_acumulado=0,
           iliquido=share, liquido=net, credito=credit, debito=credit, modo_pagamento="TRF",
           rubrica_id=rubric["rubrica_id"], cheque=None)
    return row


def hospital_bill(desktop, book, today):
    """A bill of 1.250,00 with an incidence of 1.000,00 for the spouse, by cheque 500."""
    rubric = rubric_of(book, "7.01")
    hospital = book.row("SELECT * FROM tbHospitais ORDER BY nome LIMIT 1")
    desktop.at(MAIN)
    desktop.keys("ctrl+h")
    choose_member_and_person(desktop, "Down")
    fill_in_fields(desktop, today, "H-2001", "1250", "1000", "6", "", "Internamento",
                   rubric["code"], hospital["code"], "")
    desktop.keys("alt+e")
    desktop.show("ensaio-hospital")
    post(desktop)
    desktop.at("Pagamento por Cheque")
    desktop.keys("ctrl+a")
    desktop.type("500")
    desktop.keys("Return")
    desktop.at(EXIT)

    share = money(1000 * single(rubric["percent"]))
    room = money(single(room_of(book, rubric, "B")))
    net = money(min(single(share), single(room)))
    row = newest(book)
    expect(row, tipo="HOS", codABC="B", doc_no="H-2001", doc_valor=1250, incidencia=1000,
           comparticipacao=share, saldo_plafond=room, saldo_acumulado=None, iliquido=share,
           liquido=net, debito=1250, modo_pagamento="CHQ", cheque=500,
           hospital_id=hospital["hospital_id"])
    expect(book.row("SELECT * FROM tbCheques"), cheque_no=501)
    return row


def newest(book):
    return book.row("SELECT * FROM tbZelmar_Movimentos ORDER BY movimento_id DESC LIMIT 1")


def check_accumulators(book, *rows):
    for row in rows:
        expect(book.row("SELECT * FROM tbSocios_Acumulados WHERE socio_id = ? AND codABC = ? "
                        "AND rubrica_id = ?", row["socio_id"], row["codabc"], row["rubrica_id"]),
               credito_ac=single(row["credito"]), debito_ac=single(row["debito"]), no_docs=1)


def road(desktop, programs, book):
    today = date.today().strftime("%d-%m-%Y")
    counter = book.row("SELECT zelmars FROM tbContadores")["zelmars"]
    desktop.start([os.path.join(programs, "zelmars")])

    document = medical_document(desktop, book, today)
    expect(document, movimento_no=counter)
    desktop.keys("Return")  # «Continuar a registar com o mesmo Associado» is chosen already
    desktop.at(ENTRY)
    # The member is known: the person can be chosen at once.
    choose_person(desktop)
    desktop.show("mesmo-associado")
    desktop.ask("alt+c")
    desktop.keys("alt+s")
    leave(desktop)

    bill = hospital_bill(desktop, book, today)
    expect(bill, movimento_no=counter + 1)
    expect(book.row("SELECT zelmars FROM tbContadores"), zelmars=counter + 2)
    check_accumulators(book, document, bill)
    leave(desktop)

    # The newest movement stands on top of the list, and Enter opens it read-only.
    desktop.at(MAIN)
    desktop.keys("F5", "Return")
    desktop.at(ENTRY + " - Hospital")
    desktop.show("movimento")
    desktop.keys("alt+s")
    desktop.at(MAIN)
    desktop.show("lista")


if __name__ == "__main__":
    play(road, *sys.argv[1:])
