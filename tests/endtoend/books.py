# SPDX-License-Identifier: MIT
"""Sample books on both engines, and a look into them with the engines' own tools."""

import json
import os
import sqlite3
import struct
import subprocess
from contextlib import closing


def single(value):
    """The nearest 32-bit float, as the calculation works."""
    return struct.unpack("f", struct.pack("f", value))[0]


class Helper:
    """A helper process; it ends when it is let go."""

    def __init__(self, programs, environment, word):
        self.process = subprocess.Popen(
            [os.path.join(programs, "endtoend_helper"), word], env=environment, text=True,
            stdin=subprocess.PIPE, stdout=subprocess.PIPE)

    def __enter__(self):
        return self

    def __exit__(self, *_):
        self.process.stdin.close()
        self.process.stdout.close()
        self.process.wait(20)

    def answer(self):
        return self.process.stdout.readline().strip()

    def hold(self, seconds, query):
        """Holds the rows of a query one after the other and keeps the last; "held", or why
        not after so many seconds."""
        self.process.stdin.write(f"{seconds} {query}\n")
        self.process.stdin.flush()
        return self.answer()


class SqliteBook:
    def __init__(self, folder):
        self.file = folder + "/zelmars.db"

    def rows(self, query, *values):
        with closing(sqlite3.connect(f"file:{self.file}?mode=ro", uri=True)) as book:
            book.row_factory = sqlite3.Row
            return [{name.lower(): row[name] for name in row.keys()}
                    for row in book.execute(query, values)]

    def write(self, queries):
        with closing(sqlite3.connect(self.file)) as book:
            book.executescript(queries)

    def row(self, query, *values):
        return next(iter(self.rows(query, *values)), None)


class ServerBook(SqliteBook):
    def __init__(self, host):
        self.host = host

    def rows(self, query, *values):
        for value in values:
            query = query.replace("?", f"'{value}'", 1)
        lines = self._psql(f"SELECT row_to_json(t) FROM ({query}) t").splitlines()
        # The server shows a 32-bit float by its shortest decimal.
        return [{name: single(value) if name.endswith("_ac") and value is not None else value
                 for name, value in json.loads(line).items()} for line in lines]


    def write(self, queries):
        self._psql(queries)

    def _psql(self, queries):
        return subprocess.run(["psql", "-XAtq", "-h", self.host, "-U", "dono", "zelmars"],
                              input=queries, check=True, text=True,
                              stdout=subprocess.PIPE).stdout


def make_book(programs, environment, own, host=None, content=("--sample",)):
    """A book in a folder, or on the server at that host, which the registry then names."""
    def zelmars(*words):
        subprocess.run([os.path.join(programs, "zelmars"), *words], check=True,
                       stdout=subprocess.DEVNULL,
                       env=dict(environment, QT_QPA_PLATFORM="offscreen",
                                ZELMARS_ADMIN_PASSWORD="-", ZELMARS_USER_PASSWORD="segredo"))
    zelmars("register")
    if host:
        zelmars("init", "--server", "postgresql:" + host, "--catalog", "zelmars", "--admin", "dono",
                *content)
        return ServerBook(host)
    zelmars("init", *content, own + "/book")
    return SqliteBook(own + "/book")
