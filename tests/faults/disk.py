# SPDX-License-Identifier: MIT
"""What a disk holds at any moment of a run that the preloaded library wrote down.

A kill leaves all that was written. A power cut leaves what was made durable, and of the rest
whatever the disk happened to have taken: any of the later writes, the last one perhaps torn between
two sectors, and the first so many of the later changes of names.
"""

import os
import struct
from collections import defaultdict

SECTOR = 512
HEAD = struct.Struct("<cQQQ")


def changes_of(log):
    """The changes that a log tells of: (kind, file, offset, data)."""
    with open(log, "rb") as file:
        while head := file.read(HEAD.size):
            kind, inode, offset, length = HEAD.unpack(head)
            yield kind.decode(), inode, offset, file.read(length)


class Disk:
    """The files below a folder, as they go through one change after the other."""

    def __init__(self, folder):
        self.files = {}  # inode: contents with all changes
        self.names = {}  # path: inode
        for place, _, names in os.walk(folder):
            for name in names:
                path = os.path.join(place, name)
                if path.endswith("-shm"):
                    continue
                with open(path, "rb") as file:
                    self.files[os.stat(path).st_ino] = bytearray(file.read())
                self.names[path] = os.stat(path).st_ino
        self.kept = {inode: bytes(content) for inode, content in self.files.items()}
        self.later = defaultdict(list)  # inode: writes and cuts that are not durable yet
        self.kept_names = dict(self.names)
        self.later_names = []

    def take(self, kind, inode, offset, data):
        if kind in "WT":
            self.later[inode].append((kind, offset, data))
            change(self.files.setdefault(inode, bytearray()), kind, offset, data)
            self.kept.setdefault(inode, b"")
        elif kind == "S":
            self.kept[inode] = bytes(self.files.get(inode, b""))
            self.later[inode].clear()
        elif kind == "D":
            folder = data.decode()
            self.later_names = [each for each in self.later_names
                                if not (apply_name(self.kept_names, each, folder))]
        else:
            self.take_name(kind, inode, data)

    def take_name(self, kind, inode, data):
        if kind == "C":
            if inode not in self.names.values():
                # A number that a file which is gone had before.
                self.files[inode], self.kept[inode] = bytearray(), b""
                self.later[inode].clear()
            else:
                self.later[inode].append(("T", 0, b""))
                self.files[inode].clear()
        if data:
            entry = (kind, inode, [os.fsdecode(path) for path in data.split(b"\0")])
            apply_name(self.names, entry)
            self.later_names.append(entry)

    def killed(self):
        """What stands after a kill: {path: contents}."""
        return {path: bytes(self.files[inode]) for path, inode in self.names.items()}

    def cut(self, luck=None, with_names=False):
        """What stands after a power cut. Without `luck` nothing is kept that was not durable, but
        for the names if they are wanted; with it each later write is kept or not."""
        names = dict(self.kept_names)
        count = len(self.later_names) if with_names else luck.randint(
            0, len(self.later_names)) if luck else 0
        for entry in self.later_names[:count]:
            apply_name(names, entry)
        return {path: self._content(inode, luck) for path, inode in names.items()}

    def _content(self, inode, luck):
        kept = self.kept.get(inode, b"")
        if not luck or not self.later[inode]:
            return kept
        content = bytearray(kept)
        share = luck.random()
        for kind, offset, data in self.later[inode]:
            if luck.random() >= share:
                continue
            if kind == "W" and luck.random() < 0.2:
                data = data[:luck.randint(0, len(data) // SECTOR) * SECTOR]
            change(content, kind, offset, data)
        return bytes(content)


def change(content, kind, offset, data):
    if kind == "T":
        del content[offset:]
    if len(content) < offset:
        content.extend(bytes(offset - len(content)))
    if kind == "W":
        content[offset:offset + len(data)] = data


def apply_name(names, entry, folder=None):
    """Applies a change of names, if it is one of that folder; whether it was."""
    kind, inode, paths = entry
    if folder is not None and os.path.dirname(paths[-1]) != folder:
        return False
    if kind == "R":
        names.pop(paths[0], None)
        names[paths[1]] = inode
    elif kind == "U":
        names.pop(paths[0], None)
    else:
        names[paths[0]] = inode
    return True


def put(image, folder, place):
    """Lays an image of `folder` down in another place, which held others before."""
    for name in os.listdir(place):
        os.unlink(os.path.join(place, name))
    for path, content in image.items():
        with open(os.path.join(place, os.path.relpath(path, folder)), "wb") as file:
            file.write(content)
