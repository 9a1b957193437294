#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""A folder includes only what lies below it: floors.py ROOT

Reads the includes of all sources under ROOT and prints those that go up, or out of an engine's
folder.
"""
import pathlib
import re
import sys

GROUND = {
    "platform/core": "",
    "platform/registry": "platform/core",
    "platform/com": "platform/core platform/registry",
    "platform/ado/engine": "platform/core",
    "platform/ado/dialect": "platform/core platform/ado/engine",
    "platform/ado/sqlite": "platform/core platform/ado/engine platform/ado/dialect",
    "platform/ado/postgres": "platform/core platform/ado/engine platform/ado/dialect",
    "platform/ado": "platform/core platform/ado/engine platform/ado/dialect platform/ado/sqlite "
                    "platform/ado/postgres",
    "platform/forms": "platform/core platform/ado platform/ado/engine",
    "platform/printing": "platform/core platform/ado platform/ado/engine platform/forms",
    "platform/automation": "platform/core",
}
BASE = "platform/core platform/registry platform/com platform/ado platform/ado/engine"
ROOM = BASE + " platform/forms platform/printing boundary/environment data"
FLOORS = GROUND | {
    "boundary/environment": BASE,
    "data": BASE + " boundary/environment",
    "coverage": ROOM,
    "masterdata": ROOM,
    "payments": ROOM + " platform/automation reports",
    "reports": ROOM,
    "receipts": ROOM,
    "yearend": ROOM,
    "entry": ROOM + " coverage payments reports",
    "boundary": ROOM + " coverage masterdata payments reports receipts yearend entry",
    "companions": BASE + " platform/forms",
    "database": BASE + " platform/ado/sqlite platform/ado/postgres",
    "host/bankfile": BASE + " payments",
    "host/import": BASE + " data database host/bankfile",
    "host": ROOM + " coverage receipts reports database host/bankfile host/import",
    "tour": ROOM + " database host",
}
# The plan's arithmetic, on plain values, serves the sample books as well; where a server is, a
# plain value too, is asked on a form of the host.
FURTHER = {("database", "coverage/Calculation.h"), ("host", "platform/ado/postgres/Address.h")}
CLIENT_LIBRARIES = {"sqlite3.h", "libpq-fe.h"}
OWN_CLIENTS = {"platform/ado/sqlite", "platform/ado/postgres"}
NOT_DELIVERED = {"build", "tests", "benchmarks"}
INCLUDE = re.compile(r'^\s*#\s*include\s*(["<])([^">]+)[">]', re.MULTILINE)


def floor(path):
    """The folder of the table that a file lies in; the deepest one."""
    folders = [folder for folder in FLOORS if path.startswith(folder + "/")]
    return max(folders, key=len, default=None)


def faults(path, text):
    """What a file includes and must not."""
    own = floor(path)
    allowed = FLOORS[own].split() if own else []
    for sign, included in INCLUDE.findall(text):
        other = floor(included)
        if included in CLIENT_LIBRARIES:
            right = own in OWN_CLIENTS
        elif sign == "<" or included.endswith(".moc"):
            right = True
        else:
            right = other is not None and \
                (other == own or other in allowed or (own, included) in FURTHER)
        if own is None or not right:
            yield f"{path} includes {included}"


def main(root):
    """Prints the faults; 1 when there are any or nothing was looked at."""
    root = pathlib.Path(root)
    folders = [each for each in root.iterdir()
               if each.is_dir() and each.name not in NOT_DELIVERED and each.name[0] != "."]
    sources = [path.relative_to(root).as_posix() for folder in folders
               for ending in ("*.h", "*.cpp") for path in folder.rglob(ending)]
    found = [fault for path in sources
             for fault in faults(path, (root / path).read_text(encoding="utf-8"))]
    print(*found, f"{len(sources)} files, {len(found)} faults", sep="\n")
    return 1 if found or len(sources) < 100 else 0


if __name__ == "__main__":
    sys.exit(main(sys.argv[1]))
