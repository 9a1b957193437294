# SPDX-License-Identifier: MIT
"""An office: several workstations, each a process with the component, post on one book at once.

Usage: office.py FOLDER_OF_THE_PROGRAMS sqlite|postgresql            all three, with small figures
       office.py … work WORKSTATIONS POSTINGS [PROGRAM]              everybody posts so many
       office.py … first WORKSTATIONS POSTINGS                       on a counter without a row
       office.py … kill WORKSTATIONS KILLS                           one after the other is killed

PROGRAM stands in the place of a workstation and is not audited. The last line of each is
"SECONDS-FOR-ALL POSTINGS FAULTS SLOWEST-RELEASE-IN-MS".
"""

import os
import random
import selectors
import subprocess
import sys
import tempfile
import time
from contextlib import ExitStack

sys.path.insert(0, os.path.join(os.path.dirname(__file__), "..", "endtoend"))
from audit import Audit
from books import Helper, make_book
from cut import Clerk
from desktop import PATIENCE, surroundings

HOUSEHOLDS = 50  # whom all post for; as the workstations know it
KILL_WITHIN = 0.04  # seconds from one kill to the next, drawn below this
# Shares that keep sums of whole euros exact in a 32-bit float; only the last rubric, for members
# of one workstation each, has another.
RUBRICS = """
INSERT INTO tbZelmar_Plafonds (rubrica_id, rubrica_id_main, code, percent, agregado, socio,
                               familiar, total_familia, franquia) VALUES
    (1, NULL, '1', NULL, 40000, NULL, NULL, NULL, NULL),
    (2, 1, '1.1', 1, NULL, 1000000, 1000000, NULL, NULL),
    (3, 1, '1.2', 0.5, NULL, 1000000, 1000000, NULL, 10),
    (4, 1, '1.3', 0.25, 1000, 1000000, 1000000, NULL, NULL),
    (5, 1, '1.4', 0.75, NULL, 1000000, 1000000, 2000, NULL),
    (6, 1, '1.5', 0.8, NULL, 1000000, 1000000, NULL, NULL);
"""


class Workstation:
    """A process; `posted` are the postings that it said were done."""

    def __init__(self, number, program, postings, environment):
        self.number = number
        self.posted = 0
        self.is_ready = self.is_killed = False
        self.rest = b""
        self.process = subprocess.Popen([program, str(number), str(postings)], env=environment,
                                        stdin=subprocess.PIPE, stdout=subprocess.PIPE, bufsize=0)

    def lines(self):
        """What it has said since the last call; None once it has ended."""
        heard = os.read(self.process.stdout.fileno(), 65536)
        *lines, self.rest = (self.rest + heard).split(b"\n")
        return [line.decode() for line in lines] if heard else None

    def begin(self):
        self.process.stdin.write(b"\n")

    def kill(self):
        self.is_killed = True
        self.process.kill()


class Office:
    def __init__(self, programs, engine, stack):
        self.programs = programs
        own = stack.enter_context(tempfile.TemporaryDirectory())
        self.environment = surroundings(own)
        host = None
        if engine == "postgresql":
            host = stack.enter_context(Helper(programs, self.environment, "server")).answer()
        self.book = make_book(programs, self.environment, own, host, ())
        self.holder = stack.enter_context(Helper(programs, self.environment, "hold"))
        self.workstations = []
        self.book.write(RUBRICS + "".join(
            "INSERT INTO tbSocios (socio_id, no_kor, nome, nib, zelmar) VALUES "
            f"({n}, '{100000 + n}', 'Associado {n}', '{'1' * 21}', 1);" for n in range(1, 501)))
        self.faults = []
        self.slowest = self.release = 0  # milliseconds

    def run(self, count, postings, kills=0, program="workstation"):
        """So many workstations post at once; each killed one is followed by another. Gives the
        seconds that it took and how many were posted."""
        self.selector = selectors.DefaultSelector()
        self.program, self.postings, self.kills = program, postings, kills
        self.shift, self.began = [], None
        for _ in range(count):
            self.start()
        next_kill = None
        while self.selector.get_map():
            pause = max(0, next_kill - time.monotonic()) if next_kill else PATIENCE
            events = self.selector.select(pause)
            for key, _ in events:
                self.hear(key.data, count)
            if not events and not next_kill:
                self.faults.append("nobody posts any more")
                self.kill_all()
            if self.kills and self.began and time.monotonic() >= (next_kill or 0):
                self.kill_one(count)
                next_kill = time.monotonic() + random.random() * KILL_WITHIN if self.kills else None
        return time.monotonic() - self.began, sum(one.posted for one in self.shift)

    def start(self):
        made = Workstation(len(self.workstations) + 1, os.path.join(self.programs, self.program),
                           self.postings, self.environment)
        self.workstations.append(made)
        self.shift.append(made)
        self.selector.register(made.process.stdout, selectors.EVENT_READ, made)

    def hear(self, one, count):
        lines = one.lines()
        if lines is None:
            self.end(one)
            if one.is_killed and self.kills:
                self.start()
            return
        if "ready" in lines:
            self.admit(one, count)
        self.note(one, lines)

    def admit(self, one, count):
        """All begin together; one that replaces a killed one begins at once."""
        one.is_ready = True
        if self.began:
            one.begin()
        elif sum(each.is_ready for each in self.shift) == count:
            self.began = time.monotonic()
            for each in self.shift:
                each.begin()

    def note(self, one, lines):
        for line in lines:
            word, _, rest = line.partition(" ")
            if word.isdigit():
                one.posted += 1
                self.slowest = max(self.slowest, int(rest) / 1000)
                if int(word) != one.posted:
                    self.faults.append(f"workstation {one.number} said {line}")
            elif word != "ready":
                self.faults.append(f"workstation {one.number}: {line}")

    def end(self, one):
        self.selector.unregister(one.process.stdout)
        code = one.process.wait()
        one.process.stdin.close()
        one.process.stdout.close()
        if not one.is_killed and (code != 0 or one.posted != self.postings):
            self.faults.append(f"workstation {one.number} ended with {code} after {one.posted}")

    def kill_one(self, count):
        """Only while all others but one at least are posting. What the killed one held is free:
        the counter, which everybody needs, can be held."""
        posting = [one for one in self.shift if one.posted and not one.is_killed]
        if len(posting) < count - 1:
            return
        random.choice(posting).kill()
        began = time.monotonic()
        self.hold(30, "select * from tbContadores")
        self.release = max(self.release, (time.monotonic() - began) * 1000)
        self.hold(30, "select * from tbContadores where zelmars is null")
        self.kills -= 1
        if not self.kills:
            self.kill_all()

    def kill_all(self):
        for one in self.shift:
            if one.process.returncode is None and not one.is_killed:
                one.kill()

    def hold(self, seconds, query):
        answer = self.holder.hold(seconds, query)
        if answer != "held":
            self.faults.append(answer)

    def audit(self, numbered_before=True):
        """Holds the book against what was said; nobody works any more, so every row is free."""
        audit = Audit(self.book, self.workstations, numbered_before)
        self.faults += audit.faults
        for table in ("tbContadores", "tbCheques", "tbSocios_Acumulados"):
            self.hold(1, "select * from " + table)
        killed = sum(one.is_killed for one in self.workstations)
        if killed:
            print(f"  {killed} killed, leaving {audit.lost_numbers} unused numbers and "
                  f"{audit.lagging} movements that the accumulators lack; the counter held again "
                  f"after at most {self.release:.0f} ms")
        return audit.lagging

    def finish(self):
        """The next one who starts the program finishes what the killed ones left."""
        clerk = Clerk(self.programs, self.environment)
        clerk.ask("finish")
        boxes, _ = clerk.answer()
        clerk.end()
        self.faults += [box for box in boxes[1::2] if not box.endswith(": concluído.")]
        return len(boxes) // 2


def work(office, workstations, postings, program="workstation"):
    # An editing screen that stays open over lunch: nobody who posts waits for its row.
    with Helper(office.programs, office.environment, "hold") as screen:
        if screen.hold(5, "Select * from tbZelmar_Plafonds where rubrica_id = 2") != "held":
            office.faults.append("the rubric is not held")
        result = office.run(int(workstations), int(postings), program=program)
    if program == "workstation":
        office.audit()
    return result


def first(office, workstations, postings):
    office.book.write("DELETE FROM tbContadores;")
    result = office.run(int(workstations), int(postings))
    office.audit(numbered_before=False)
    return result


def kill(office, workstations, kills):
    result = office.run(int(workstations), 1_000_000, kills=int(kills))
    office.run(int(workstations), 10)
    lagging = office.audit()
    finished = office.finish()
    if finished != lagging or office.audit() != 0:
        office.faults.append(f"{finished} of {lagging} postings were finished")
    return result


def main(programs, engine, *words):
    small = [("work", 8, 60), ("first", 8, 5), ("kill", 4, 20)]
    faults = 0
    for task, *figures in [words] if words else small:
        with ExitStack() as stack:
            office = Office(programs, engine, stack)
            seconds, posted = globals()[task](office, *figures)
            print(f"  {engine} {' '.join(map(str, [task, *figures]))}: "
                  f"{posted} postings in {seconds:.2f} s, "
                  f"{posted / seconds:.0f} a second, the slowest {office.slowest:.0f} ms")
            for fault in office.faults[:20]:
                print("  FAULT", fault)
            print(f"{seconds:.4f} {posted} {len(office.faults)} {office.release:.1f}", flush=True)
            faults += len(office.faults)
    if not words:
        print(f"{0 if faults else 1} passed, {1 if faults else 0} failed")
    sys.exit(1 if faults else 0)


if __name__ == "__main__":
    main(*sys.argv[1:])
