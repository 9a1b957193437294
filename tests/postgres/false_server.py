#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""A server that is none: it lets everybody ask and wants the password.

false_server.py (clear|md5|late|part) [CERTIFICATE KEY]

Says its port, then one line for each thing that it was told: "tls", "start", "answer …". With a
certificate it offers encryption. "late" begins as an honest server does and asks behind that,
and "part" sends that beginning in two pieces.
"""
import socket
import ssl
import struct
import sys
import time

SSL_REQUEST = 80877103
CLEAR = struct.pack("!cII", b"R", 8, 3)
ASKING = {
    "clear": CLEAR,
    "md5": struct.pack("!cII4s", b"R", 12, 5, b"salt"),
    "part": struct.pack("!cII", b"R", 23, 10) + b"SCR",
    "late": struct.pack("!cII", b"R", 23, 10) + b"SCRAM-SHA-256\0\0" + CLEAR,
}


def exactly(line, size):
    data = b""
    while len(data) < size and (more := line.recv(size - len(data))):
        data += more
    return data


def message(line, typed=True):
    """What stands in the client's next message; nothing when it has gone."""
    head = exactly(line, 5 if typed else 4)
    return exactly(line, struct.unpack("!I", head[-4:])[0] - 4) if head else b""


def say(text):
    print(text, flush=True)


def serve(line, question, context):
    start = message(line, typed=False)
    if struct.unpack("!I", start[:4])[0] == SSL_REQUEST:
        line.sendall(b"S" if context else b"N")
        if context:
            line = context.wrap_socket(line, server_side=True)
            say("tls")
        start = message(line, typed=False)
    if not start:
        return
    say("start")
    line.sendall(question)
    if question == ASKING["part"]:
        # Only once the client has had the chance to take the first part.
        time.sleep(0.3)
        line.sendall(b"AM-SHA-256\0\0" + CLEAR)
    if answer := message(line):
        say("answer " + repr(answer))


def main():
    context = None
    if len(sys.argv) > 2:
        context = ssl.SSLContext(ssl.PROTOCOL_TLS_SERVER)
        context.load_cert_chain(sys.argv[2], sys.argv[3])
    with socket.create_server(("127.0.0.1", 0)) as server:
        say(server.getsockname()[1])
        while True:
            line, _ = server.accept()
            try:
                serve(line, ASKING[sys.argv[1]], context)
            except (OSError, struct.error):
                pass
            line.close()
            say("end")


main()
