# SPDX-License-Identifier: MIT
"""The transfers of a day typed into a stand-in for the bank's program, by the real screen and with
real keys: what the stand-in wrote down is the list, letter by letter.

Usage: banca.py FOLDER_OF_THE_PROGRAMS [sqlite|postgresql [FOLDER_FOR_PICTURES [ROWS]]]
"""

import json
import os
import sys
from datetime import date

from books import ServerBook
from desktop import Failed, wait_until
from play import play

MAIN = "Zelmars - "
PAYMENTS = "Listagem de Pagamentos"
BANK = "Banca Eletrónica"
INTERBANK = "Transferências Interbancárias"
INTERNAL = "Transferências Internas"
PATH = r"C:\Programas\Bnubanca\gcsvcman.exe"
NAMES = ["Zé d'Além", 'A "Grande"', "Çãõ Éü", "+^%~(){}[]", "x'; DROP TABLE tbSocios; --",
         "{ENTER}", "50% +1", "Ana & Rui <x>", "  dois  espaços", "ñ ß œ"]


# Seconds: until the rows begin, with all that is late, and for a row. Much more than it takes, for a
# machine with other work.
BEFORE_ROWS = 90
A_ROW = 5


class Bank:
    """The stand-in as programs.ini names it, with manners of its own for each run."""

    def __init__(self, desktop, programs):
        self.desktop = desktop
        self.program = os.path.join(os.path.abspath(programs), "bank_terminal")
        self.folder = desktop.environment["XDG_CONFIG_HOME"]
        self.runs = 0

    def behave(self, *manners):
        self.runs += 1
        self.record = os.path.join(self.folder, f"record-{self.runs}")
        os.makedirs(self.folder + "/zelmars", exist_ok=True)
        with open(self.folder + "/zelmars/programs.ini", "w", encoding="utf-8") as programs:
            programs.write(f"# O programa do banco\n{PATH.lower()} = {self.program} "
                           f"--record {self.record} {' '.join(manners)}\n")

    def lines(self):
        if not os.path.exists(self.record):
            return []
        with open(self.record, encoding="utf-8") as record:
            return [json.loads(line) for line in record.read().splitlines()]

    def transfers(self):
        return [line for line in self.lines() if "erased" not in line]

    def rows_done(self):
        return len(self.lines()) - len(self.transfers())

    def quit(self):
        self.desktop.run(["pkill", "-f", "--", f"--record {self.record} "])


def pay(book, rows):
    """So many transfers of today and no others, with names that are hard to type."""
    today = date.today().isoformat() + " 00:00:00"
    members = [row["socio_id"] for row in book.rows(
        "SELECT socio_id FROM tbSocios WHERE nib IS NOT NULL AND socio_id IN "
        "(SELECT socio_id FROM tbZelmar_Movimentos) ORDER BY socio_id")][:rows]
    text = (f"UPDATE tbZelmar_Movimentos SET modo_pagamento = 'NUM' WHERE data >= '{today}';")
    for number, member in enumerate(members):
        name = NAMES[number % len(NAMES)].replace("'", "''")
        nib = ("0013" if number % 3 == 0 else "0035") + f"{member:017d}"
        text += (f"UPDATE tbSocios SET nome_guerra = '{name}', nib = '{nib}' "
                 f"WHERE socio_id = {member};"
                 "INSERT INTO tbZelmar_Movimentos (movimento_no, socio_id, data, tipo, "
                 f"modo_pagamento, debito) VALUES ({90000 + number}, {member}, '{today}', 'DOC', "
                 f"'TRF', {number * 7.25 + 1.5});")
    book.write(text)
    found = book.rows(
        "SELECT s.nib, s.nome_guerra, s.no_kor, sum(m.debito) AS tdebito FROM tbZelmar_Movimentos m "
        f"JOIN tbSocios s ON m.socio_id = s.socio_id WHERE m.data = '{today}' AND "
        "m.modo_pagamento = 'TRF' GROUP BY m.socio_id, s.nib, s.nome_guerra, s.no_kor "
        "ORDER BY m.socio_id")
    if len(found) != rows:
        raise Failed(f"{len(found)} transfers and not {rows}")
    return [wanted(row) for row in found]


def wanted(row):
    """What the stand-in is to be given for a row."""
    internal = row["nib"].startswith("0013")
    name = row["nome_guerra"]
    return {"module": INTERNAL if internal else INTERBANK, "paying": "11223344556677",
            "account": row["nib"][4:8] + row["nib"][9:19] if internal else row["nib"],
            "fixed": "12", "description": f"{name} - {row['no_kor']}", "currency": "PTE",
            "amount": f"{float(row['tdebito']):.4f}".rstrip("0").rstrip(".").replace(".", ","),
            "name": name}


def start(desktop):
    """From the main window to the first step."""
    desktop.at(MAIN)
    desktop.keys("ctrl+p")
    desktop.at(PAYMENTS)
    desktop.keys("alt+b")
    desktop.at(BANK)
    desktop.keys("alt+c")


def leave(desktop, host):
    """By "&Sair", which leaves the operator in the bank's program."""
    desktop.turn_to(desktop.window_of(host, BANK))
    desktop.at(BANK)
    desktop.show("banca")
    desktop.keys("alt+s")
    desktop.at(INTERBANK)


def compare(found, expected):
    for number, (given, row) in enumerate(zip(found, expected), 1):
        if given != row:
            raise Failed(f"row {number} is {given} and not {row}")
    if len(found) != len(expected):
        raise Failed(f"{len(found)} transfers and not {len(expected)}")


def back(desktop, host, bank):
    bank.quit()
    desktop.turn_to(desktop.window_of(host, MAIN))
    desktop.at(MAIN)


def whole_run(desktop, host, bank, expected):
    """A late log-in, and a module that is not open yet at the first row."""
    bank.behave("--login-after", "2500", "--modules-after", "4000")
    start(desktop)
    wait_until("all rows are typed", lambda: bank.rows_done() == len(expected),
               BEFORE_ROWS + A_ROW * len(expected))
    desktop.at("Transferências")
    desktop.settled("Transferências")
    compare(bank.transfers(), expected)
    leave(desktop, host)
    back(desktop, host, bank)
    print(f"  typed: {len(expected)}")


def lost_window(desktop, host, bank, expected):
    bank.behave("--login-after", "100", "--lose-window-at", "7")
    start(desktop)
    wait_until("six rows are typed", lambda: bank.rows_done() == 6, BEFORE_ROWS + A_ROW * 6)
    desktop.settled("")  # a moment in which more could be typed
    compare(bank.transfers(), expected[:6])
    wait_until("the module is there again", lambda: desktop.run(
        ["xdotool", "search", "--onlyvisible", "--name", f"^{expected[6]['module']}$"]))
    desktop.at(expected[6]["module"])
    desktop.turn_to(desktop.window_of(host, BANK))
    desktop.at(BANK)
    desktop.keys("alt+c")
    wait_until("all rows are typed again", lambda: bank.rows_done() == 6 + len(expected),
               BEFORE_ROWS + A_ROW * len(expected))
    desktop.at("Transferências")
    desktop.settled("Transferências")
    compare(bank.transfers(), expected[:6] + expected)
    leave(desktop, host)
    back(desktop, host, bank)
    print("  lost at row 7, typed again from row 1")


def without_number(desktop, host, bank, book):
    """A bank number that is null stops the run where it would be typed; aborting asks."""
    member = book.row("SELECT min(socio_id) AS s FROM tbZelmar_Movimentos WHERE movimento_no = 90000")
    book.write(f"UPDATE tbSocios SET nib = NULL WHERE socio_id = {member['s']};")
    bank.behave("--login-after", "100")
    start(desktop)
    desktop.at("Manutenção de NIB's")
    desktop.settled("Manutenção de NIB's")
    if bank.lines():
        raise Failed(f"{bank.lines()} was typed")
    desktop.turn_to(desktop.window_of(host, BANK))
    desktop.at(BANK)
    desktop.ask("alt+a")
    desktop.keys("alt+n")
    desktop.at(BANK)
    desktop.ask("alt+a")
    desktop.keys("alt+s")
    desktop.gone(BANK)
    back(desktop, host, bank)
    print("  stopped at a null number, aborted")


def nothing_to_pay(desktop, host, bank, book):
    book.write("UPDATE tbZelmar_Movimentos SET modo_pagamento = 'NUM' WHERE movimento_no >= 90000;")
    bank.behave("--login-after", "100")
    start(desktop)
    desktop.at(INTERNAL)
    desktop.settled(INTERNAL)
    wait_until("the run has ended", lambda: desktop.turn_to(desktop.window_of(host, BANK)) or
               desktop.active_title() == BANK)
    desktop.settled(BANK)
    desktop.settled(BANK)
    desktop.settled(BANK)
    leave(desktop, host)
    if bank.lines():
        raise Failed(f"{bank.lines()} was typed")
    back(desktop, host, bank)
    print("  nothing to pay")


def banca(desktop, programs, book):
    rows = int(sys.argv[4]) if len(sys.argv) > 4 else 20
    expected = pay(book, rows)
    host = desktop.start([os.path.join(programs, "zelmars")])
    bank = Bank(desktop, programs)
    whole_run(desktop, host, bank, expected)
    if isinstance(book, ServerBook):
        return
    expected = expected[:10]
    book.write(f"UPDATE tbZelmar_Movimentos SET modo_pagamento = 'NUM' WHERE movimento_no >= 90010;")
    lost_window(desktop, host, bank, expected)
    without_number(desktop, host, bank, book)
    nothing_to_pay(desktop, host, bank, book)


if __name__ == "__main__":
    play(banca, *sys.argv[1:4])
