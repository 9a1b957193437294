# SPDX-License-Identifier: MIT
"""Which window is in front after boxes, where a window manager decides on it.

Usage: windows_in_front.py FOLDER_OF_THE_PROGRAMS
"""

import os
import sys

from desktop import Failed
from entry import ENTRY, MAIN, choose_member_and_person, fill_in_fields, leave
from play import play

EXTRACT = "Extrato de Quotizações"
WITHOUT_BANK_NUMBER = "100023"


def premium_extract(desktop):
    """The premium account stays in front of the entry when the questions about the bank number have followed it."""
    desktop.type(WITHOUT_BANK_NUMBER)
    desktop.keys("Tab")
    desktop.at("Quotizações")
    desktop.keys("alt+s")
    desktop.at("Zelmars")
    desktop.keys("Return")
    desktop.at("Associados")
    desktop.keys("alt+n")
    desktop.at(EXTRACT)
    desktop.settled(EXTRACT)
    desktop.keys("alt+s")
    desktop.at(ENTRY)


def entry_under_way(desktop, main):
    """An entry under way comes to the front when another one is asked for."""
    desktop.turn_to(main)
    desktop.ask("ctrl+n")
    desktop.keys("Return")
    desktop.at(ENTRY)
    desktop.settled(ENTRY)


def confirmation(desktop, program):
    """The box leaves the results of the try-out in sight, and so does its frame."""
    desktop.keys("alt+k")
    desktop.keys("ctrl+a")
    choose_member_and_person(desktop)
    fill_in_fields(desktop, "h", "4711", "87,35", "0", "23", "", "", "5.02", "")
    entry = desktop.place_of(desktop.window_of(program, ENTRY))
    box = desktop.place_of(desktop.ask("alt+o"))
    results = (entry["Y"] + entry["HEIGHT"] * 3 // 4, entry["Y"] + entry["HEIGHT"] * 9 // 10)
    print(f"  results {results}, box {box['Y']} to {box['Y'] + box['HEIGHT']}")
    if box["Y"] < results[1] and box["Y"] + box["HEIGHT"] > results[0]:
        raise Failed("the question covers the results")
    desktop.keys("alt+n")
    desktop.at(ENTRY)


def windows(desktop, programs, _book):
    program = desktop.start([os.path.join(programs, "zelmars")])
    desktop.at(MAIN)
    main = desktop.window_of(program, MAIN)
    desktop.keys("ctrl+n")
    desktop.at(ENTRY)
    premium_extract(desktop)
    entry_under_way(desktop, main)
    confirmation(desktop, program)
    desktop.ask("Escape")
    desktop.keys("alt+s")
    leave(desktop)
    desktop.at(MAIN)


if __name__ == "__main__":
    play(windows, *sys.argv[1:])
