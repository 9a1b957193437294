# SPDX-License-Identifier: MIT
"""Sample books on both engines, and a look into them with the engines' own tools."""

import json
import os
import sqlite3
import struct
import subprocess


def single(value):
    """The nearest 32-bit float, as the calculation works."""
    return struct.unpack("f", struct.pack("f", value))[0]


class Helper:
    """A helper process; it says one line and ends when it is let go."""

    def __init__(self, programs, environment, *words):
        self.process = subprocess.Popen(
            [os.path.join(programs, "endtoend_helper"), *words], env=environment, text=True,
            stdin=subprocess.PIPE, stdout=subprocess.PIPE)
        self.said = self.process.stdout.readline().strip()

    def __enter__(self):
        return self

    def __exit__(self, *_):
        self.process.stdin.close()
        self.process.stdout.close()
        self.process.wait(20)


class SqliteBook:
    def __init__(self, folder):
        self.file = folder + "/zelmars.db"

    def rows(self, statement, *values):
        with sqlite3.connect(f"file:{self.file}?mode=ro", uri=True) as book:
            book.row_factory = sqlite3.Row
            return [{name.lower(): row[name] for name in row.keys()}
                    for row in book.execute(statement, values)]

    def row(self, statement, *values):
        return next(iter(self.rows(statement, *values)), None)


class ServerBook(SqliteBook):
    def __init__(self, host):
        self.host = host

    def rows(self, statement, *values):
        for value in values:
            statement = statement.replace("?", f"'{value}'", 1)
        lines = subprocess.run(
            ["psql", "-XAtq", "-h", self.host, "-U", "dono", "zelmars", "-c",
             f"SELECT row_to_json(t) FROM ({statement}) t"],
            check=True, text=True, stdout=subprocess.PIPE).stdout.splitlines()
        # The server shows a 32-bit float by its shortest decimal.
        return [{name: single(value) if name.endswith("_ac") and value is not None else value
                 for name, value in json.loads(line).items()} for line in lines]


def make_sample(programs, environment, own, host=None):
    """A sample book in a folder, or on the server at that host, which the registry then names."""
    def zelmars(*words):
        subprocess.run([os.path.join(programs, "zelmars"), *words], check=True,
                       env=dict(environment, QT_QPA_PLATFORM="offscreen",
                                ZELMARS_ADMIN_PASSWORD="-", ZELMARS_USER_PASSWORD="segredo"))
    zelmars("register")
    if host:
        zelmars("init", "--server", "postgresql:" + host, "--catalog", "zelmars", "--admin", "dono",
                "--sample")
        return ServerBook(host)
    zelmars("init", "--sample", own + "/book")
    return SqliteBook(own + "/book")
