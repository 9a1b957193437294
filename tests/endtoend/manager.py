# SPDX-License-Identifier: MIT
"""A manager's work by key presses alone: a group of rubrics with two rubrics made, changed, refused
and deleted, a document posted against one; hospitals made, chosen, refused and deleted; maintenance;
a close that is prepared by a backup; the rows in the book.

Usage: manager.py FOLDER_OF_THE_PROGRAMS [sqlite|postgresql [FOLDER_FOR_PICTURES]]
"""

import os
import subprocess
import sys
from datetime import date

from books import ServerBook
from desktop import Failed, wait_until
from entry import EXIT, MAIN, choose_member_and_person, fill_in_fields, leave, post
from play import play

RUBRICS = "Tabela de Rubricas e Plafonds"
GROUP = "Rúbricas"
RUBRIC = "Rúbrica"
HOSPITALS = "Tabela de Hospitais"
HOSPITAL = "Hospital"
MAINTENANCE = "Manutenção da Base de Dados"
PREPARING = "Preparar o fecho do ano"
CLOSE = "Fecho do Ano"


def expect(what, found, wanted):
    print(f"  {what}: {found}")
    if found != wanted:
        raise Failed(f"{what} is {found!r} and not {wanted!r}")


def exactly(desktop, title):
    wait_until(f"«{title}» has the keyboard (now «{desktop.active_title()}»)",
               lambda: desktop.active_title() == title)


def answer(desktop, question, key):
    """Presses a key that brings a box, and answers it."""
    desktop.ask(question)
    desktop.keys(key)


def rubrics_of(book):
    return [(row["code"], row["percent"]) for row in book.rows(
        "SELECT code, percent FROM tbZelmar_Plafonds WHERE code LIKE '99%' ORDER BY code")]


def new_rubric(desktop, code, name, percent, refused=None):
    desktop.keys("alt+a")
    exactly(desktop, RUBRIC)
    desktop.type(code)
    desktop.keys("Return")
    desktop.type(name)
    desktop.keys("Return")
    if refused:
        desktop.type(refused)
        answer(desktop, "alt+o", "Return")
        exactly(desktop, RUBRIC)
        desktop.keys("alt+p", "ctrl+a")
    desktop.type(percent)
    for limit in ("alt+s", "alt+f"):
        desktop.keys(limit)
        desktop.type("500")
    desktop.show("rubrica-" + code)
    desktop.keys("alt+o")
    exactly(desktop, GROUP)


def rubrics(desktop, book):
    desktop.at(MAIN)
    desktop.keys("alt+t", "r")
    desktop.at(RUBRICS)
    desktop.keys("alt+a")
    exactly(desktop, GROUP)
    desktop.type("99")
    desktop.keys("Tab")
    desktop.type("Óculos novos")
    new_rubric(desktop, "99.1", "Lentes", "0,8", refused="1,01")
    new_rubric(desktop, "99.2", "Armações", "0,5")
    desktop.keys("alt+s")
    desktop.at(RUBRICS)
    expect("made", rubrics_of(book), [("99", None), ("99.1", 0.8), ("99.2", 0.5)])

    # The first rubric of the group goes, the other is changed.
    desktop.keys("End", "alt+t")
    exactly(desktop, GROUP)
    answer(desktop, "alt+p", "alt+s")
    wait_until("a rubric is deleted", lambda: len(rubrics_of(book)) == 2)
    exactly(desktop, GROUP)
    desktop.keys("alt+e")
    exactly(desktop, RUBRIC)
    desktop.keys("alt+p", "ctrl+a")
    desktop.type("0,6")
    desktop.keys("alt+o")
    exactly(desktop, GROUP)
    desktop.show("grupo")
    desktop.keys("alt+s")
    desktop.at(RUBRICS)
    expect("changed", rubrics_of(book), [("99", None), ("99.2", 0.6)])

    # One that documents name stays.
    desktop.keys("Home", "alt+t")
    exactly(desktop, GROUP)
    count = book.row("SELECT count(*) AS n FROM tbZelmar_Plafonds")["n"]
    box = desktop.ask("alt+p")
    desktop.keys("alt+s")
    wait_until("the refusal comes", lambda: desktop._active_window() != box)
    desktop.keys("Return")
    exactly(desktop, GROUP)
    expect("rubrics", book.row("SELECT count(*) AS n FROM tbZelmar_Plafonds")["n"], count)
    desktop.keys("alt+s")
    desktop.at(RUBRICS)
    desktop.keys("alt+s")
    desktop.at(MAIN)


def new_hospital(desktop, code, name):
    desktop.keys("alt+a")
    exactly(desktop, HOSPITAL)
    desktop.type(code)
    desktop.keys("Tab")
    desktop.type(name)
    desktop.keys("alt+o")
    desktop.at(HOSPITALS)


def documents(desktop, book):
    today = date.today().strftime("%d-%m-%Y")
    desktop.keys("ctrl+n")
    choose_member_and_person(desktop)
    fill_in_fields(desktop, today, "4711", "100", "0", "0", "", "Armação", "99.2", "")
    desktop.keys("alt+e")
    post(desktop)
    desktop.at(EXIT)
    leave(desktop)
    newest = "SELECT * FROM tbZelmar_Movimentos ORDER BY movimento_id DESC LIMIT 1"
    expect("share of the new rubric", book.row(newest)["comparticipacao"], 60)

    desktop.at(MAIN)
    desktop.keys("alt+t", "h")
    desktop.at(HOSPITALS)
    new_hospital(desktop, "H98", "AAA Clínica")
    new_hospital(desktop, "H99", "AAB Clínica")
    desktop.keys("alt+s")
    desktop.at(MAIN)
    desktop.keys("ctrl+h")
    choose_member_and_person(desktop)
    fill_in_fields(desktop, today, "H-1", "100", "50", "0", "", "Consulta", "99.2", "H98", "")
    desktop.keys("alt+e")
    post(desktop)
    desktop.at("Pagamento por Cheque")
    desktop.keys("Return")
    desktop.at(EXIT)
    leave(desktop)
    used = book.row("SELECT hospital_id FROM tbHospitais WHERE code = 'H98'")["hospital_id"]
    expect("hospital", book.row(newest)["hospital_id"], used)

    desktop.at(MAIN)
    desktop.keys("alt+t", "h")
    desktop.at(HOSPITALS)
    desktop.keys("Home")
    box = desktop.ask("alt+p")
    desktop.keys("alt+s")
    wait_until("the refusal comes", lambda: desktop._active_window() != box)
    desktop.keys("Return")
    desktop.at(HOSPITALS)
    desktop.keys("Home", "Down")
    answer(desktop, "alt+p", "alt+s")
    codes = "SELECT code FROM tbHospitais WHERE code IN ('H98', 'H99')"
    wait_until("a hospital is deleted", lambda: book.rows(codes) == [{"code": "H98"}])
    desktop.at(HOSPITALS)
    desktop.keys("alt+s")
    desktop.at(MAIN)


def year_end(desktop, programs, book):
    desktop.keys("alt+a", "m")
    desktop.at(MAINTENANCE)
    box = desktop.ask("alt+i")
    desktop.show("manutencao")
    desktop.keys("Return")
    wait_until("the box has gone", lambda: desktop._active_window() != box)
    desktop.at(MAINTENANCE)
    desktop.keys("alt+f")
    desktop.at(MAIN)

    live = book.row("SELECT count(*) AS n FROM vwZelmars_Movimentos_Vigor")["n"]
    before = book.row("SELECT count(*) AS n FROM tbZelmar_Movimentos_Historico")["n"]
    desktop.keys("alt+a", "f")
    desktop.at(PREPARING)
    backup = os.path.join(desktop.environment["XDG_RUNTIME_DIR"], "antes.copia")
    desktop.keys("ctrl+a")
    desktop.type(backup)
    desktop.show("preparar")
    desktop.keys("alt+f")
    desktop.at(CLOSE)
    if not os.path.getsize(backup):
        raise Failed("there is no backup")
    question = desktop.ask("alt+f")
    desktop.keys("alt+s")
    wait_until("the close has ended", lambda: desktop.active_title() == MAIN and
               desktop._active_window() != question)
    desktop.show("fecho")
    desktop.keys("Return")
    desktop.at(CLOSE)
    desktop.keys("alt+s")
    desktop.at("Zelmars - ")
    opened = book.rows("SELECT tipo, movimento_no FROM vwZelmars_Movimentos_Vigor")
    expect("types", {row["tipo"] for row in opened}, {"SA"})
    expect("numbers", sorted(row["movimento_no"] for row in opened),
           list(range(1, len(opened) + 1)))
    expect("counter", book.row("SELECT zelmars FROM tbContadores")["zelmars"], len(opened) + 1)
    expect("history", book.row("SELECT count(*) AS n FROM tbZelmar_Movimentos_Historico")["n"],
           before + live)
    expect("check", subprocess.run(
        [os.path.join(programs, "zelmars"), "check"], stdout=subprocess.DEVNULL, check=False,
        env=dict(desktop.environment, QT_QPA_PLATFORM="offscreen")).returncode, 0)


def manager(desktop, programs, book):
    if isinstance(book, ServerBook):
        book.write("GRANT zelmars_gestor TO zelmars")
    desktop.start([os.path.join(programs, "zelmars")])
    rubrics(desktop, book)
    documents(desktop, book)
    year_end(desktop, programs, book)


if __name__ == "__main__":
    play(manager, *sys.argv[1:])
