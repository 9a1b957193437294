# SPDX-License-Identifier: MIT
"""Counts the key presses of an ordinary document, from the blank entry screen to the posted row.

Ordinary: of a member in order, for himself, of this month, with nothing received elsewhere and no
VAT. Every press counts, those that answer boxes and choose in windows too; Alt with a letter is
one. Data is what ends up in the row: the characters of the member's number, the day, the number
and the value of the document, what was received and the rubric's code, and the key with which the
typist hands each of them over. The rest is what the screen asks of him beyond the data.
Usage: keys_of_one_document.py FOLDER_OF_THE_PROGRAMS
"""

import os
import sys
from datetime import date

from desktop import Failed
from entry import ENTRY, EXIT, MAIN, MEMBER
from play import play

MOST = 30
MOST_BEYOND_DATA = 6


def document(desktop, programs, book):
    desktop.start([os.path.join(programs, "zelmars")])
    desktop.at(MAIN)
    desktop.keys("ctrl+n")
    desktop.at(ENTRY)
    blank = desktop.pressed
    beyond = 0

    def hand_over(text, key):
        desktop.type(text)
        desktop.keys(key)

    def beside(key, window):
        nonlocal beyond
        desktop.keys(key)
        beyond += 1
        desktop.at(window)

    # Choosing the person takes the focus off the number, so that the member is looked up on the way.
    hand_over(MEMBER, "alt+i")
    desktop.at("Quotizações")
    beside("Return", "Escolher Familiar")
    beside("Return", ENTRY)
    hand_over(date.today().strftime("%d"), "Return")
    hand_over("4711", "Return")
    hand_over("87,35", "Return")
    hand_over("0", "alt+r")
    desktop.type("502")
    desktop.show("teclas")
    desktop.ask("alt+o")
    beyond += 1
    beside("Return", EXIT)

    pressed = desktop.pressed - blank
    print(f"  {pressed} key presses, {beyond} of them beyond the data")
    row = book.row("SELECT m.*, p.code FROM tbZelmar_Movimentos m JOIN tbZelmar_Plafonds p "
                   "ON p.rubrica_id = m.rubrica_id ORDER BY m.movimento_id DESC LIMIT 1")
    stored = (str(row["doc_data"])[:10], row["doc_no"], row["doc_valor"], row["recebido"],
              row["doc_tx_iva"], row["code"], row["codabc"])
    wanted = (date.today().isoformat(), "4711", 87.35, 0, 0, "5.02", "A")
    if stored != wanted:
        raise Failed(f"the row holds {stored} and not {wanted}")
    if pressed > MOST or beyond > MOST_BEYOND_DATA:
        raise Failed(f"more than {MOST} presses, or than {MOST_BEYOND_DATA} beyond the data")


if __name__ == "__main__":
    play(document, *sys.argv[1:])
