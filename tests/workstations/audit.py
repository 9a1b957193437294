# SPDX-License-Identifier: MIT
"""A book held against what the workstations said of it.

A posting is three writes with no transaction around them: counter, movement, accumulator. One that
was cut short by a kill is therefore in one of these states: nothing; a number that no movement
bears; a movement that the accumulator lacks; complete, but not said to be.
"""

from collections import Counter, defaultdict
from itertools import combinations

from books import ServerBook, single
from desktop import wait_until

ACCOUNT = ("socio_id", "codabc", "rubrica_id")


class Audit:
    def __init__(self, book, workstations, numbered_before):
        self.book = book
        self.workstations = {one.number: one for one in workstations}
        self.faults = []
        self.lagging = 0
        if isinstance(book, ServerBook):
            # A query that the server was given before the kill may still be running.
            wait_until("the server does no more for the dead", lambda: not book.rows(
                "SELECT 1 FROM pg_stat_activity WHERE datname = current_database() "
                "AND state = 'active' AND wait_event IS DISTINCT FROM 'ClientRead' "
                "AND pid <> pg_backend_pid()"))
        elif [row for row in book.rows("PRAGMA integrity_check") if "ok" not in row.values()]:
            self.faults.append("the book is broken")
        self.movements = book.rows("SELECT * FROM tbZelmar_Movimentos ORDER BY movimento_no")
        for movement in self.movements:
            workstation, posting = map(int, movement["doc_no"][1:].split("-"))
            movement["posting"] = (workstation, posting)
            movement["is_unsaid"] = posting > self.workstations[workstation].posted
        self.check_postings()
        self.check_numbers(numbered_before)
        self.check_accumulators()

    def require(self, holds, text):
        if not holds:
            self.faults.append(text)

    def check_postings(self):
        """Each posting that was said to be done is there once; of a killed workstation one more
        may be."""
        found = defaultdict(list)
        for movement in self.movements:
            workstation, posting = movement["posting"]
            found[workstation].append(posting)
        self.cut_before_movement = 0
        for number, one in self.workstations.items():
            there = sorted(found[number])
            more = len(there) - one.posted
            self.require(there == list(range(1, len(there) + 1)) and
                         more in ((0, 1) if one.is_killed else (0,)),
                         f"workstation {number} said {one.posted}; there are {there[-3:]}")
            self.cut_before_movement += one.is_killed and more == 0

    def check_numbers(self, numbered_before):
        """No number twice, but the first one of a counter that had no row; none lost, but by a
        kill between counter and movement."""
        given = Counter(movement["movimento_no"] for movement in self.movements)
        twice = {number: times for number, times in given.items() if times > 1}
        self.require(twice == ({} if numbered_before else {1: 2}), f"given several times: {twice}")
        counter = self.book.rows("SELECT zelmars FROM tbContadores")
        self.require(len(counter) == 1, f"the counter has {len(counter)} rows")
        self.lost_numbers = counter[0]["zelmars"] - 1 - len(given)
        self.require(0 <= self.lost_numbers <= self.cut_before_movement,
                     f"{self.lost_numbers} numbers are missing")

    def check_accumulators(self):
        kept = defaultdict(lambda: (0.0, 0.0, 0))
        for row in self.book.rows("SELECT * FROM tbSocios_Acumulados"):
            account = tuple(row[column] for column in ACCOUNT)
            kept[account] = tuple(a + b for a, b in zip(
                kept[account], (row["credito_ac"], row["debito_ac"], row["no_docs"])))
        movements = defaultdict(list)
        for movement in self.movements:
            movements[tuple(movement[column] for column in ACCOUNT)].append(movement)
        for account in kept | movements:
            left_out = self.left_out(kept[account], movements[account])
            self.require(left_out is not None,
                         f"{account}: {kept[account]} does not follow from its movements")
            self.lagging += left_out or 0

    @staticmethod
    def left_out(sums, movements):
        """How many movements the sums lack; None when they do not follow from the movements.

        They are added in the order of the numbers, each time rounded to a 32-bit float; only such
        as nobody said to be done may lack. (Where several workstations post for one account the
        amounts are such that the order does not matter.)"""
        unsaid = [movement for movement in movements if movement["is_unsaid"]]
        for count in range(len(unsaid) + 1):
            for lacking in combinations(unsaid, count):
                credit = debit = 0.0
                added = [movement for movement in movements if movement not in lacking]
                for movement in added:
                    credit = single(credit + movement["credito"])
                    debit = single(debit + movement["debito"])
                if sums == (credit, debit, len(added)):
                    return count
        return None
