# SPDX-License-Identifier: MIT
"""The entry screen as a typist goes through it."""

ENTRY = "Lançamento (Plano de Saúde)"
EXIT = "Sair de Lançamentos"
MAIN = "Zelmars"
MEMBER = "100015"


def choose_member_and_person(desktop, *way_to_person):
    desktop.at(ENTRY)
    desktop.type(MEMBER)
    desktop.keys("Tab")
    desktop.at("Quotizações")
    desktop.keys("alt+n")
    desktop.at(ENTRY)
    choose_person(desktop, *way_to_person)


def choose_person(desktop, *way):
    desktop.keys("alt+i")
    desktop.at("Escolher Familiar")
    desktop.keys(*way, "Return")
    desktop.at(ENTRY)


def fill_in_fields(desktop, *texts):
    """Types one field after the other, beginning with the date, where the person leaves off."""
    for text in texts:
        if text:
            desktop.type(text)
        desktop.keys("Tab")


def post(desktop):
    desktop.ask("alt+o")
    desktop.keys("alt+s")


def leave(desktop):
    desktop.at(EXIT)
    desktop.keys("alt+s", "Return")
    desktop.gone(EXIT)
