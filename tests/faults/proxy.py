# SPDX-License-Identifier: MIT
"""Stands between the program and a server, counts the messages that go either way, and breaks one.

Ways: before (the connection ends in place of the message), after (right behind it), half (in the
midst of it), reset (all that is under way is lost), stalled (nothing goes on for a while, and then
the connection ends).
"""

import select
import socket
import struct
import threading
import time

WAYS = ("before", "after", "half", "reset", "stalled")
STALL = 1.5  # seconds
ENCRYPTION_WANTED = (80877103, 80877104)  # instead of a first message


class Proxy:
    """Listens on a port of this machine for a server that listens on a local socket."""

    def __init__(self, server):
        self.server = server
        self.count = self.at = 0
        self.way = None
        self.lock = threading.Lock()
        self.on_answer = None  # called when the server has dealt with a request
        self.listener = socket.create_server(("127.0.0.1", 0))
        self.port = self.listener.getsockname()[1]
        threading.Thread(target=self.accept, daemon=True).start()

    def arm(self, at=0, way=None):
        """Counts from now on; breaks the message of that number once."""
        with self.lock:
            self.count, self.at, self.way = 0, at, way

    def close(self):
        self.listener.close()

    def accept(self):
        while True:
            try:
                client, _ = self.listener.accept()
            except OSError:
                return
            server = socket.socket(socket.AF_UNIX)
            server.connect(self.server + "/.s.PGSQL.5432")
            threading.Thread(target=self.serve, args=(client, server), daemon=True).start()

    def serve(self, client, server):
        """One conversation, until it ends or is broken."""
        client.setsockopt(socket.IPPROTO_TCP, socket.TCP_NODELAY, 1)
        rest = {client: b"", server: b""}
        is_first = True
        try:
            while True:
                for source in select.select(list(rest), [], [])[0]:
                    data = source.recv(65536)
                    if not data:
                        return
                    rest[source] += data
                    target = server if source is client else client
                    while message := next_message(rest[source], is_first and source is client):
                        rest[source] = rest[source][len(message):]
                        if source is client and is_first and code_of(message) in ENCRYPTION_WANTED:
                            client.sendall(b"N")
                            continue
                        is_first = is_first and source is not client
                        if not self.pass_on(message, client, target):
                            return
                        if source is server and message[:1] == b"Z" and self.on_answer:
                            self.on_answer()
        except OSError:
            pass
        finally:
            client.close()
            server.close()

    def pass_on(self, message, client, target):
        with self.lock:
            self.count += 1
            way = self.way if self.count == self.at else None
        if way is None:
            target.sendall(message)
        elif way == "after":
            target.sendall(message)
        elif way == "half":
            target.sendall(message[:len(message) // 2])
        elif way == "reset":
            client.setsockopt(socket.SOL_SOCKET, socket.SO_LINGER, struct.pack("ii", 1, 0))
        elif way == "stalled":
            time.sleep(STALL)
        return way is None


def next_message(data, is_first):
    """The first whole message of what came; the first one of a client has no letter."""
    start = 0 if is_first else 1
    if len(data) < start + 4:
        return b""
    length = start + struct.unpack_from("!I", data, start)[0]
    return data[:length] if len(data) >= length else b""


def code_of(message):
    return struct.unpack_from("!I", message, 4)[0] if len(message) == 8 else 0
