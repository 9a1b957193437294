# SPDX-License-Identifier: MIT
"""What stands after a fault at any change of a book in a file.

Usage: faults.py FOLDER_OF_THE_PROGRAMS short|long [DEED...]

Each deed is done once while the preloaded library writes down every change of the disk. From that
come pictures of the disk after a kill and after a power cut at each change. Each of them has to be a
whole book, in a state that the order of the deed's writes allows, and not before what had been made
durable. From each such state the program is started, finishes what was cut short, and does the deed
again where it was lost: then it stands once. Then the deed is done again and again with one change
broken: killed, failing (EIO, EINTR), on a full disk, written by half; the second press of the
button, or the second run, has to leave it done once.
"""

import concurrent.futures
import copy
import os
import random
import shutil
import subprocess
import sys
import tempfile
import time

sys.path.insert(0, os.path.join(os.path.dirname(__file__), "..", "endtoend"))
from book import CONTENT, Broken, difference, digest, digest_of_any_run, lasting, rows_of
from books import make_book
from deeds import DEEDS
from desktop import PATIENCE, surroundings
from disk import Disk, changes_of, put

SHORT = {"pictures": 250, "places": 4, "ways": 2}
LONG = {"pictures": 6000, "places": 10 ** 6, "ways": 5}
WAYS = ("kill", "eio", "enospc", "short", "eintr")


class Fault(Exception):
    pass


def text_of(*names):
    with open(os.path.join(os.path.dirname(__file__), *names), encoding="utf-8") as file:
        return file.read()


class Runner:
    """Does one deed, whole or broken, in a folder of its own."""

    def __init__(self, programs, deed, own):
        self.programs, self.deed, self.own = programs, deed, own
        self.folder = own + "/book"
        self.book = self.folder + "/zelmars.db"
        self.environment = dict(surroundings(own), QT_QPA_PLATFORM="offscreen")
        for name, text in deed.files.items():
            with open(os.path.join(own, name), "w", encoding="utf-8") as file:
                file.write(text)
        make_book(programs, self.environment, own, content=())
        if deed.schema:
            os.unlink(self.book)
            self.sql(text_of(deed.schema) + CONTENT)
        elif deed.empty:
            for name in os.listdir(self.folder):
                os.unlink(os.path.join(self.folder, name))
        else:
            self.sql(CONTENT)
        if deed.before:
            self.program(deed.before)
        if deed.then:
            self.sql(deed.then)
        self.start = own + "/start"
        self.keep(self.start)

    def sql(self, queries):
        """By the engine's own tool; what it leaves beside the book goes with it."""
        subprocess.run(["sqlite3", self.book], input="PRAGMA journal_mode=WAL;" + queries, text=True,
                       check=True, stdout=subprocess.DEVNULL)

    def keep(self, place):
        shutil.copytree(self.folder, place)

    def reset(self, image=None):
        """The book as it was at the start, or as in an image."""
        for name in os.listdir(self.folder):
            os.unlink(os.path.join(self.folder, name))
        if image is None:
            shutil.copytree(self.start, self.folder, dirs_exist_ok=True)
        else:
            put(image, self.folder, self.folder)

    def broken(self, **settings):
        return dict(self.environment, LD_PRELOAD=self.programs + "/libfaults.so",
                    FAULTS_FOLDER=self.folder,
                    **{"FAULTS_" + name.upper(): str(value) for name, value in settings.items()})

    def program(self, words, environment=None):
        """A command of the program; its status, negative for a kill."""
        words = [word.format(folder=self.folder, own=self.own) for word in words]
        result = subprocess.run([self.programs + "/zelmars", *words], text=True,
                                env=environment or self.environment, stdout=subprocess.PIPE,
                                stderr=subprocess.STDOUT, timeout=PATIENCE)
        self.said = result.stdout
        return result.returncode

    def deed_lines(self, lines, environment=None):
        """Lines for the program of deeds; what it answered to each, shorter when it was killed."""
        words = "".join(line + "\n" for line in lines)
        result = subprocess.run([self.programs + "/deed"], input=words, text=True,
                                env=environment or self.environment, stdout=subprocess.PIPE,
                                stderr=subprocess.PIPE, timeout=PATIENCE)
        self.said = result.stdout + result.stderr
        return [line for line in result.stdout.splitlines() if line in ("done", "not done")]

    # Whole.

    def record(self):
        """Does the deed once under the eyes of the library; what it changed on the disk."""
        self.reset()
        log = self.own + "/log"
        disk = Disk(self.folder)
        start = copy.deepcopy(disk)
        if self.deed.command:
            status = self.program(self.deed.command, self.broken(log=log))
            whole = status == 0
        else:
            answers = self.deed_lines(["begin", self.deed.line], self.broken(log=log, later=1))
            whole = set(answers) == {"done"}
        if not whole:
            raise Fault(f"the deed is not done: {self.said}")
        changes = list(changes_of(log))
        os.unlink(log)
        self.prove_recording(disk, changes)
        self.final = self.lasting()
        return start, changes

    def prove_recording(self, disk, changes):
        """The log has to lead to what is there now."""
        for change in changes:
            disk.take(*change)
        there = {path: bytes(disk.files[inode]) for path, inode in disk.names.items()}
        for name in os.listdir(self.folder):
            path = os.path.join(self.folder, name)
            if name.endswith("-shm"):
                continue
            with open(path, "rb") as file:
                if there.pop(path, None) != file.read():
                    raise Fault(f"the log does not lead to {name}")
        if there:
            raise Fault(f"the log leads to {list(there)}")

    def lasting(self):
        path = self.folder + "/" + self.deed.file
        return lasting(path, self.deed.tables) if os.path.exists(path) else {}

    # After a fault.

    def state(self):
        return digest_of_any_run(self.folder + "/" + self.deed.file)

    def finish(self):
        """The program starts on what stands, finishes what was cut short, and the deed is done
        once more where it was lost."""
        if not self.deed.command:
            self.expect_done(self.deed_lines(["finish"]))
        if self.lasting() != self.final and self.deed.many == 1:
            self.do_again()
        if (found := self.lasting()) != self.final and self.deed.many == 1:
            raise Fault(f"in the end {self.distance(found)}")
        if self.program(["check", "--book", self.deed.checked]) != 0:
            raise Fault(f"check: {self.said}")

    def do_again(self):
        for words in self.deed.repair:
            if self.program(words) != 0:
                raise Fault(f"{words}: {self.said}")
        if not self.deed.command:
            self.expect_done(self.deed_lines([self.deed.line]))
        elif self.program(self.deed.command) != 0:
            raise Fault(f"the second run: {self.said}")

    def expect_done(self, answers):
        if answers != ["done"]:
            raise Fault(f"not done: {self.said}")

    def distance(self, found):
        return [(table, found.get(table), rows) for table, rows in self.final.items()
                if found.get(table) != rows]


def pictures_of(runner, recording, wanted, luck):
    """Looks at pictures of the disk after each change. Gives an image of each state that a
    kill can leave, what each of the writes between them did, and how many different pictures there
    were."""
    disk, changes = recording
    place = tempfile.mkdtemp(prefix="faults", dir="/dev/shm")
    known = {}  # contents: state

    def rows_in(image, what):
        put(image, runner.folder, place)
        try:
            return rows_of(place + "/" + runner.deed.file)
        except Broken as failure:
            raise Fault(f"{what}: {failure}") from failure

    def state_of(image, what):
        key = hash(frozenset(image.items()))
        if key not in known:
            known[key] = digest(rows_in(image, what))
        return known[key]

    states, images, told = [], [], []

    def note(image, what):
        state = state_of(image, what)
        if states and states[-1] == state:
            return
        if states:
            told.append(difference(rows_in(images[-1], what), rows_in(image, what)))
        states.append(state)
        images.append(image)

    def cuts_at(number):
        yield disk.cut()
        yield disk.cut(with_names=True)
        for _ in range(lucky):
            yield disk.cut(luck)

    try:
        note(disk.killed(), "at the start")
        durable = 0  # the first state that a power cut may still leave
        lucky = max(1, wanted // len(changes) - 2)
        step = max(1, 3 * len(changes) // wanted)
        for number, change in enumerate(changes, 1):
            what = f"change {number} of {len(changes)} ({change[0]})"
            disk.take(*change)
            note(disk.killed(), "kill at " + what)
            if change[0] in "SD":
                kept = state_of(disk.cut(), "what is durable at " + what)
                if kept in states[durable:]:
                    durable = states.index(kept, durable)
            if number % step and number != len(changes):
                continue
            for image in cuts_at(number):
                if state_of(image, "power cut at " + what) not in states[durable:]:
                    raise Fault(f"power cut at {what}: a state that is not of {durable} to "
                                f"{len(states) - 1}")
        if states[durable] != states[-1]:
            raise Fault("what was said to be done is not durable")
        return images, told, len(known)
    finally:
        shutil.rmtree(place)


def break_one(runner, allowed, at, way):
    """Does the deed with one change broken, and then once more."""
    runner.reset()
    settings = {"at": at, "how": way} | ({"lasts": 1} if way == "enospc" else {})
    if runner.deed.command:
        runner.program(runner.deed.command, runner.broken(**settings))
    else:
        lines = ["begin", runner.deed.line, "end"] + runner.deed.presses
        answers = runner.deed_lines(lines, runner.broken(later=1, **settings))
        if len(answers) not in (1, len(lines)):
            raise Fault(f"the program ended: {runner.said}")
    if way == "kill" and (state := runner.state()) not in allowed:
        raise Fault(f"after a kill a state of its own: {state}")
    runner.state()
    runner.finish()


def prove(programs, deed, measure):
    """All of it for one deed; what was seen, in one line."""
    began = time.monotonic()
    luck = random.Random(deed.name)
    with tempfile.TemporaryDirectory() as own:
        runner = Runner(programs, deed, own)
        recording = runner.record()
        states, told, pictures = pictures_of(
            runner, recording, measure["pictures"] * deed.many, luck)
        if deed.order is not None and told != deed.order:
            raise Fault(f"the writes are {told}")
        if deed.whole and len(states) != 2:
            raise Fault(f"neither all nor nothing: {told}")
        allowed = set()
        for number, image in enumerate(states):
            runner.reset(image)
            allowed.add(runner.state())
            attempt(f"from state {number}", runner.finish)
        count = len(recording[1])
        places = sorted(luck.sample(range(1, count + 1), min(count, measure["places"])))
        if deed.many > 1:
            places = []  # of a day each posting is one that was broken by itself
        broken = 0
        for at in places:
            for way in luck.sample(WAYS, measure["ways"]):
                attempt(f"{way} at {at} of {count}", break_one, runner, allowed, at, way)
                broken += 1
    return (f"{deed.name}: {count} changes, {len(states)} states, {pictures} pictures, "
            f"{broken} broken runs, {time.monotonic() - began:.0f} s"), pictures, broken


def attempt(what, do, *arguments):
    try:
        do(*arguments)
    except (Fault, Broken, subprocess.TimeoutExpired) as failure:
        raise Fault(f"{what}: {failure}") from failure


def main(programs, form, *names):
    measure = LONG if form == "long" else SHORT
    deeds = [deed for deed in DEEDS if deed.name in names or
             not names and (form == "long" or deed.many == 1)]
    deeds.sort(key=lambda deed: -deed.many)  # the longest first
    pictures = broken = faults = 0
    with concurrent.futures.ProcessPoolExecutor(os.cpu_count()) as pool:
        jobs = {pool.submit(prove, programs, deed, measure): deed for deed in deeds}
        for job in concurrent.futures.as_completed(jobs):
            try:
                line, seen, tried = job.result()
                pictures, broken = pictures + seen, broken + tried
                print(line, flush=True)
            except (Fault, Broken) as failure:
                faults += 1
                print(f"FAULT {jobs[job].name}: {failure}", flush=True)
    print(f"{pictures} pictures, {broken} broken runs, {faults} faults")
    sys.exit(1 if faults else 0)


if __name__ == "__main__":
    main(*sys.argv[1:])
