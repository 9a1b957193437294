# SPDX-License-Identifier: MIT
"""Runs the work of a script on a sample book of one engine, under a display of its own."""

import sys
import tempfile
from contextlib import ExitStack

from books import Helper, make_book
from desktop import Desktop, Failed, surroundings


def play(work, programs, engine="sqlite", pictures=None):
    """Calls work(desktop, programs, book)."""
    with tempfile.TemporaryDirectory() as own, ExitStack() as stack:
        environment = surroundings(own, pictures)
        host = None
        if engine == "postgresql":
            host = stack.enter_context(Helper(programs, environment, "server")).answer()
        book = make_book(programs, environment, own, host)
        with Desktop(environment) as desktop:
            try:
                work(desktop, programs, book)
            except Failed as failure:
                desktop.show("falhou")
                sys.exit(f"failed: {failure}")
    print("1 passed, 0 failed")
