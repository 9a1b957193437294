# SPDX-License-Identifier: MIT
"""Two programs post a document each at once, while an editing screen holds the rubric's row.

Both are for one person and rubric on one server, keyed in by key presses. Nobody waits for the
held row, and the accumulator has both amounts.
Usage: two_workstations.py FOLDER_OF_THE_PROGRAMS [FOLDER_FOR_PICTURES]
"""

import os
import sys
import time
from datetime import date

from books import Helper, single
from desktop import Failed, wait_until
from entry import ENTRY, EXIT, choose_member_and_person, fill_in_fields
from play import play

AMOUNTS = {"P-1": "40", "P-2": "52,75"}
RUBRIC = "5.02"
# A row that is held is waited for three times as long.
AT_ONCE = 10  # seconds


def require(holds, text):
    if not holds:
        raise Failed(text)


def up_to_the_question(desktop, programs, document, amount):
    """Keys a document in and leaves it at the question whether to post; gives the program and
    the question's window."""
    program = desktop.start([os.path.join(programs, "zelmars"), "NewMovimento"])
    desktop.turn_to(desktop.window_of(program, ENTRY))
    choose_member_and_person(desktop)
    fill_in_fields(desktop, date.today().strftime("%d-%m-%Y"), document, amount, "0", "23", "",
                   "Lentes", RUBRIC, "")
    return program, desktop.ask("alt+o")


def post_both(desktop, programs, book):
    questions = [up_to_the_question(desktop, programs, document, amount)
                 for document, amount in AMOUNTS.items()]
    desktop.show("perguntas")
    # Both wait at the counter, and are let go at the same moment.
    with Helper(programs, desktop.environment, "hold") as gate:
        require(gate.hold(5, "select * from tbContadores") == "held", "the counter is not held")
        for _, question in questions:
            desktop.turn_to(question)
            desktop.keys("alt+s")
        wait_until("both stand at the counter", lambda: len(book.rows(
            "SELECT 1 FROM pg_locks WHERE locktype = 'advisory' AND NOT granted")) == 2)
        began = time.monotonic()
    for program, _ in questions:
        desktop.window_of(program, EXIT)
    took = time.monotonic() - began
    print(f"  both posted {took:.2f} s after they were let go")
    require(took < AT_ONCE, "they waited for the row that is held")
    desktop.show("lançados")


def check_book(book, rubric, counter):
    movements = book.rows("SELECT * FROM tbZelmar_Movimentos WHERE doc_no LIKE 'P-%' "
                          "ORDER BY movimento_no")
    numbers = [row["movimento_no"] for row in movements]
    print("  numbers", numbers, "credits", [row["credito"] for row in movements])
    require(numbers == [counter, counter + 1], "the numbers are not the next two")
    for row in movements:
        typed = float(AMOUNTS[row["doc_no"]].replace(",", "."))
        require(row["doc_valor"] == typed, f"{row['doc_no']} has another value")
    kept = book.row("SELECT * FROM tbSocios_Acumulados WHERE socio_id = ? AND codABC = 'A' "
                    "AND rubrica_id = ?", movements[0]["socio_id"], rubric["rubrica_id"])
    credit = single(sum(row["credito"] for row in movements))
    require((kept["no_docs"], kept["credito_ac"]) == (2, credit),
            f"the accumulator holds {kept} and not {credit}")


def work(desktop, programs, book):
    rubric = book.row("SELECT * FROM tbZelmar_Plafonds WHERE code = ?", RUBRIC)
    counter = book.row("SELECT zelmars FROM tbContadores")["zelmars"]
    row = f"Select * from tbZelmar_Plafonds where rubrica_id = {rubric['rubrica_id']}"
    with Helper(programs, desktop.environment, "hold") as screen:
        require(screen.hold(5, row) == "held", "the rubric is not held")
        post_both(desktop, programs, book)
        check_book(book, rubric, counter)
        with Helper(programs, desktop.environment, "hold") as other:
            refusal = other.hold(1, row)
            print(" ", refusal)
            require("está a ser usada por" in refusal and "@" in refusal,
                    "the row was not held all the time")


if __name__ == "__main__":
    play(work, sys.argv[1], "postgresql", *sys.argv[2:])
