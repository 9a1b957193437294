# SPDX-License-Identifier: MIT
"""What is cut short is finished once: clerks are killed between two writes of a posting or an
annulment, and two annul one movement at the same moment.

Usage: cut.py FOLDER_OF_THE_PROGRAMS sqlite|postgresql [PAIRS]

The last line says how many checks held.
"""

import os
import subprocess
import sys
import tempfile
from contextlib import ExitStack

sys.path.insert(0, os.path.join(os.path.dirname(__file__), "..", "endtoend"))
from books import Helper, make_book
from desktop import surroundings, wait_until

MEMBERS = """
INSERT INTO tbSocios (socio_id, no_kor, nome, nib, zelmar) VALUES
    (1, '100001', 'Ana', '111111111111111111111', 1), (2, '100002', 'Rui', '1', 1);
INSERT INTO tbSocios_Acumulados (socio_id, codABC, rubrica_id, rubrica_id_main, debito_ac,
                                 credito_ac, no_docs) VALUES
    (1, 'A', 7, 1, {pairs} + 100, {pairs} + 40, {pairs} + 2), (2, NULL, 0, 0, 0, {pairs}, 0);
INSERT INTO tbZelmar_Movimentos (movimento_id, movimento_no, socio_id, codABC, rubrica_id, tipo,
                                 doc_valor, credito, debito) VALUES
    (901, 901, 1, 'A', 7, 'DOC', 60, 20, 50), (902, 902, 1, 'A', 7, 'HOS', 60, 20, 50);
"""
ACCOUNT = "select * from tbSocios_Acumulados where socio_id = "


class Clerk:
    def __init__(self, programs, environment):
        self.process = subprocess.Popen(
            [os.path.join(programs, "clerk")], env=environment, text=True,
            stdin=subprocess.PIPE, stdout=subprocess.PIPE)
        assert self.process.stdout.readline() == "ready\n"

    def ask(self, words):
        self.process.stdin.write(words + "\n")
        self.process.stdin.flush()

    def answer(self):
        """The boxes, and what came of it."""
        boxes = []
        while not (line := self.process.stdout.readline().strip()).endswith("done"):
            assert line, "the clerk is gone"
            boxes.append(line.removeprefix("box "))
        return boxes, line

    def end(self):
        self.process.kill()
        self.process.wait()
        self.process.stdin.close()
        self.process.stdout.close()


class Checks:
    def __init__(self, programs, engine, pairs, stack):
        self.programs = programs
        own = stack.enter_context(tempfile.TemporaryDirectory())
        self.environment = surroundings(own)
        host = None
        if engine == "postgresql":
            host = stack.enter_context(Helper(programs, self.environment, "server")).answer()
        self.book = make_book(programs, self.environment, own, host, ())
        self.holder = stack.enter_context(Helper(programs, self.environment, "hold"))
        self.book.write(MEMBERS.format(pairs=pairs))
        self.held = self.failed = 0

    def check(self, what, found, expected):
        if found == expected:
            self.held += 1
        else:
            self.failed += 1
            print(f"  FAULT {what}: {found!r}, not {expected!r}")

    def account(self, member):
        row = self.book.row(ACCOUNT + str(member))
        return row["debito_ac"], row["credito_ac"], row["no_docs"]

    def kill_at(self, held_row, job, step):
        """A clerk comes as far as the row that somebody holds, where he is killed."""
        assert self.holder.hold(5, held_row) == "held"
        clerk = Clerk(self.programs, self.environment)
        clerk.ask(job)
        wait_until(f"{job} waits", lambda: self.book.row(
            "SELECT 1 AS one FROM tbOperacoes WHERE passo = ?", step))
        clerk.end()
        # The next one finds the row free at once: a killed process holds nothing.
        assert self.holder.hold(5, "select * from tbSocios where socio_id = 1") == "held"

    def finish_twice_at_once(self, what, lines):
        clerks = [Clerk(self.programs, self.environment) for _ in range(2)]
        for clerk in clerks:
            clerk.ask("finish")
        answers = [clerk.answer() for clerk in clerks]
        first = next((boxes for boxes, _ in answers if boxes[1:] == lines[1:]), answers[0][0])
        self.check(what + ", in words", first, lines)
        self.check(what + ", asked for", [outcome for _, outcome in answers], ["done", "done"])
        clerks[0].ask("finish")
        self.check(what + ", once more", clerks[0].answer(), ([], "done"))
        for clerk in clerks:
            clerk.end()

    def cut_posting(self):
        before = self.account(2)
        self.kill_at(ACCOUNT + "2", "receipt 2 10.5", "ACU")
        self.check("what the killed one had not added", self.account(2), before)
        number = self.book.row("SELECT max(movimento_no) AS n FROM tbZelmar_Movimentos "
                               "WHERE tipo = 'PAG'")["n"]
        self.finish_twice_at_once("posting", [
            f"Lançamento nº {number} de 100002, 10,50: falta somar aos acumulados",
            f"Lançamento nº {number}: concluído."])
        self.check("account", self.account(2), (before[0], before[1] + 10.5, before[2]))
        self.check("receipts", len(self.book.rows(
            "SELECT 1 AS one FROM tbZelmar_Movimentos WHERE tipo = 'PAG' AND credito = 10.5")), 1)

    def cut_annulment(self, number, held_row, step, missing):
        before = self.account(1)
        self.kill_at(held_row, f"annul {number}", step)
        self.check("what the killed one had not taken back", self.account(1), before)
        self.finish_twice_at_once("annulment", [
            f"Anulação do nº {number} de 100001, 20,00: {missing}",
            f"Anulação do nº {number}: concluído."])
        self.check("account", self.account(1), (before[0] - 50, before[1] - 20, before[2] - 1))
        self.check("correcting rows", len(self.book.rows(
            "SELECT 1 AS one FROM tbZelmar_Movimentos WHERE tipo = 'COR'")), number - 900)

    def race(self, pairs):
        """Two clerks annul one movement at the same moment: a document and a receipt by turns."""
        self.book.write("".join(
            "INSERT INTO tbZelmar_Movimentos (movimento_id, movimento_no, socio_id, codABC, "
            "rubrica_id, tipo, credito, debito) VALUES "
            + (f"({key}, {key}, 1, 'A', 7, 'DOC', 1, 1);" if key % 2 else
               f"({key}, {key}, 2, NULL, NULL, 'PAG', 1, 0);")
            for key in range(1000, 1000 + pairs)))
        corrected = len(self.book.rows("SELECT 1 AS one FROM tbZelmar_Movimentos "
                                       "WHERE tipo = 'COR'"))
        accounts = self.account(1), self.account(2)
        clerks = [Clerk(self.programs, self.environment) for _ in range(2)]
        late = 0
        for key in range(1000, 1000 + pairs):
            for clerk in clerks:
                clerk.ask(f"annul {key}")
            boxes = [box for clerk in clerks for box in clerk.answer()[0]]
            late += len(boxes) == 1 and boxes[0].startswith(f"O movimento nº {key} já foi anulado"
                                                            " por ")
        for clerk in clerks:
            clerk.end()
        half = pairs // 2
        self.check("told by whom", late, pairs)
        self.check("correcting rows of the race", len(self.book.rows(
            "SELECT 1 AS one FROM tbZelmar_Movimentos WHERE tipo = 'COR'")) - corrected, pairs)
        (debit, credit, documents), (own_debit, own_credit, own) = accounts
        self.check("accounts after the race", (self.account(1), self.account(2)),
                   ((debit - half, credit - half, documents - half),
                    (own_debit, own_credit - half, own)))
        self.check("unfinished", self.book.rows(
            "SELECT 1 AS one FROM tbOperacoes WHERE passo IS NOT NULL"), [])


def main(programs, engine, pairs="40"):
    with ExitStack() as stack:
        checks = Checks(programs, engine, int(pairs), stack)
        checks.cut_posting()
        checks.cut_annulment(901, "select * from tbContadores", "COR",
                             "falta o movimento de correção e tirar dos acumulados")
        checks.cut_annulment(902, ACCOUNT + "1", "ACU", "falta tirar dos acumulados")
        checks.race(int(pairs))
        print(f"{checks.held} passed, {checks.failed} failed")
    sys.exit(1 if checks.failed else 0)


if __name__ == "__main__":
    main(*sys.argv[1:])
