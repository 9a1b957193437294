# SPDX-License-Identifier: MIT
"""What stands on a server after its conversation with the program was broken at any message.

Usage: wire.py FOLDER_OF_THE_PROGRAMS short|long [DEED...]

Each deed is done once whole, which shows the states that its order of writes allows. Then it is done
again and again with one message broken. What stands has to be one of those states; the next presses
of the same button, in the same program, or else a program that is started afresh, leave the deed
done once.
"""

import os
import random
import subprocess
import sys
import tempfile
import time
from contextlib import ExitStack

sys.path.insert(0, os.path.join(os.path.dirname(__file__), "..", "endtoend"))
from book import CONTENT, PASSING
from books import Helper, make_book
from deeds import DEEDS
from desktop import PATIENCE, surroundings, wait_until
from faults import Fault
from proxy import WAYS, Proxy

SHORT = 5  # broken conversations of each deed
LONG = 130
PRESSES = 3  # in the same program, before somebody gives up and starts it afresh


class Deeds:
    """The program of deeds; each line that it was given is answered."""

    def __init__(self, program, environment):
        self.process = subprocess.Popen([program], env=environment, text=True,
                                        stdin=subprocess.PIPE, stdout=subprocess.PIPE,
                                        stderr=subprocess.DEVNULL)
        self.said = []
        self.is_ready = self.process.stdout.readline() == "ready\n"

    def do(self, line):
        self.process.stdin.write(line + "\n")
        self.process.stdin.flush()
        while said := self.process.stdout.readline().strip():
            self.said.append(said)
            if said.endswith("done"):
                return said == "done"
        raise Fault(f"the program ended: {self.said}")

    def end(self):
        self.process.stdin.close()
        self.process.stdout.close()
        self.process.wait(PATIENCE)

    def __enter__(self):
        return self

    def __exit__(self, kind, *_):
        if kind:
            self.process.kill()
        self.end()


class Wire:
    def __init__(self, programs, stack):
        own = stack.enter_context(tempfile.TemporaryDirectory())
        self.programs = programs
        self.environment = dict(surroundings(own), QT_QPA_PLATFORM="offscreen")
        host = stack.enter_context(Helper(programs, self.environment, "server")).answer()
        self.book = make_book(programs, self.environment, own, host, ())
        self.proxy = Proxy(host)
        stack.callback(self.proxy.close)
        settings = own + "/registry/HKEY_LOCAL_MACHINE.ini"
        with open(settings, encoding="utf-8") as file:
            text = file.read()
        with open(settings, "w", encoding="utf-8") as file:
            file.write(text.replace("postgresql:" + host, f"postgresql:127.0.0.1:{self.proxy.port}"))
        self.book.write("GRANT zelmars_gestor TO zelmars;" + CONTENT + """
            CREATE SCHEMA inicio;
            DO $$ DECLARE t text; BEGIN
                FOR t IN SELECT tablename FROM pg_tables WHERE schemaname = 'public' LOOP
                    EXECUTE format('CREATE TABLE inicio.%I AS TABLE public.%I', t, t);
                END LOOP;
            END $$;
            CREATE FUNCTION inicio.volta() RETURNS void LANGUAGE plpgsql AS $$
            DECLARE t text; BEGIN
                FOR t IN SELECT tablename FROM pg_tables WHERE schemaname = 'inicio' LOOP
                    EXECUTE format('DELETE FROM public.%I', t);
                    EXECUTE format('INSERT INTO public.%I OVERRIDING SYSTEM VALUE '
                                   'SELECT * FROM inicio.%I', t, t);
                END LOOP;
                PERFORM setval(pg_get_serial_sequence(k[1], k[2]), 1000) FROM (VALUES
                    (ARRAY['tbzelmar_movimentos', 'movimento_id']),
                    (ARRAY['tbhospitais', 'hospital_id']),
                    (ARRAY['tbzelmar_plafonds', 'rubrica_id'])) v (k);
            END $$;""")
        # All rows of all tables, but for what differs from run to run.
        self.look = " UNION ALL ".join(
            f"SELECT '{table}' AS name, coalesce(string_agg(r::text, ' ' ORDER BY r::text), '') "
            f"AS rows "
            f"FROM (SELECT {columns} FROM {table}) r"
            for table, columns in self.columns().items())

    def columns(self):
        found = {}
        for row in self.book.rows("""SELECT table_name::text AS name, column_name::text AS part
                FROM information_schema.columns WHERE table_schema = 'public' AND table_name IN
                (SELECT tablename FROM pg_tables WHERE schemaname = 'public')
                ORDER BY table_name, ordinal_position"""):
            if row["part"] not in PASSING:
                found.setdefault(row["name"], []).append(row["part"])
        return {table: ", ".join(columns) for table, columns in found.items()}

    def state(self):
        return {row["name"]: row["rows"] for row in self.book.rows(self.look)}

    def reset(self):
        wait_until("nobody has the book open", lambda: not self.book.rows(
            "SELECT 1 FROM pg_stat_activity WHERE datname = 'zelmars' AND usename = 'zelmars'"))
        self.reset_rows()

    def reset_rows(self):
        self.book.write("SELECT inicio.volta();")

    def start(self):
        deeds = Deeds(self.programs + "/deed", self.environment)
        if not deeds.is_ready:
            raise Fault("the program does not start")
        return deeds

    def once(self, deed):
        """The deed done once: the states that it leads through, and the last one."""
        self.reset()
        states = [self.state()]

        def note():
            state = self.state()
            if state != states[-1]:
                states.append(state)

        with self.start() as deeds:
            self.proxy.on_answer = note
            self.proxy.arm()
            is_done = deeds.do(deed.line)
            self.proxy.on_answer = None
            count = self.proxy.count
        if not is_done:
            raise Fault(f"the deed is not done: {deeds.said}")
        note()
        return states, count

    def break_one(self, deed, states, at, way):
        """How many presses it took."""
        self.reset()
        presses = 1
        with self.start() as deeds:
            self.proxy.arm(at, way)
            is_done = deeds.do(deed.line)
            self.proxy.arm()
            # What the server was told before may still be running.
            wait_until("the server rests", lambda: not self.book.rows(
                "SELECT 1 FROM pg_stat_activity WHERE usename = 'zelmars' AND state = 'active'"))
            if (state := self.state()) not in states:
                raise Fault(f"a state of its own: {self.distance(state, states[-1])}")
            while deed.presses and not is_done and presses < PRESSES:
                is_done = deeds.do(deed.presses[0])
                presses += 1
            if deed.presses and not is_done:
                raise Fault(f"not done by {PRESSES} presses: {deeds.said}")
        if deed.presses and self.lacks(deed, states):
            raise Fault(f"said to be done: {self.distance(self.state(), states[-1])}")
        if self.lacks(deed, states):
            self.start_afresh(deed, states)
        return presses

    def start_afresh(self, deed, states):
        with self.start() as deeds:
            deeds.do("finish")
            if deed.repair:
                self.reset_rows()  # the backup that goes before such a deed
            if self.lacks(deed, states) and not deeds.do(deed.line):
                raise Fault(f"not done afresh: {deeds.said}")
        if self.lacks(deed, states):
            raise Fault(f"in the end {self.distance(self.state(), states[-1])}")

    def lacks(self, deed, states):
        """Whether anything of what the deed leaves is not there, or there twice."""
        state = self.state()
        return any(state[table] != states[-1][table] for table in map(str.lower, deed.tables))

    @staticmethod
    def distance(state, wanted):
        return [(table, rows, wanted[table]) for table, rows in state.items()
                if rows != wanted[table]]


def main(programs, form, *names):
    wanted = LONG if form == "long" else SHORT
    broken = faults = 0
    with ExitStack() as stack:
        wire = Wire(programs, stack)
        for deed in DEEDS:
            if not deed.line or deed.many > 1 or names and deed.name not in names:
                continue
            began, luck, tried, again = time.monotonic(), random.Random(deed.name), 0, 0
            try:
                states, count = wire.once(deed)
                for at in sorted(luck.sample(range(1, count + 1), min(count, wanted))):
                    way = luck.choice(WAYS)
                    what = f"{way} at {at} of {count}"
                    again += wire.break_one(deed, states, at, way) > 1
                    tried += 1
                print(f"{deed.name}: {count} messages, {len(states)} states, {tried} broken, "
                      f"{again} ended by another press, {time.monotonic() - began:.0f} s",
                      flush=True)
            except Fault as failure:
                faults += 1
                print(f"FAULT {deed.name}: {what if tried else ''}: {failure}", flush=True)
            broken += tried
    print(f"{broken} broken conversations, {faults} faults")
    sys.exit(1 if faults else 0)


if __name__ == "__main__":
    main(*sys.argv[1:])
