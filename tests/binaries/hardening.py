# SPDX-License-Identifier: MIT
"""Checks that what is delivered was built with all its protections. usage: hardening.py FOLDER"""
import pathlib
import re
import subprocess
import sys

ENDBR64 = bytes.fromhex("f30f1efa")  # where a jump through a pointer may end
# Functions that come with the compiler and not from our sources.
FOREIGN = {"_init", "_fini"}
# What is imported by sources that were built with a protection: by each file, or by some, as not
# every library copies into fixed room or indexes a container.
IMPORTS = [
    (r"__stack_chk_fail", all),
    (r"__\w+_chk", any),
    (r"_ZSt21__glibcxx_assert_fail\w+", any),
]


def readelf(*arguments):
    return subprocess.run(["readelf", "-W", *map(str, arguments)], check=True, text=True,
                          capture_output=True, env={"LC_ALL": "C", "PATH": "/usr/bin:/bin"}).stdout


def symbols(file):
    """Value, section and bare name of each dynamic function or object."""
    for line in readelf("--dyn-syms", file).splitlines():
        cells = line.split()
        if len(cells) >= 8 and cells[0].endswith(":") and cells[0] != "Num:":
            yield int(cells[1], 16), cells[3], cells[6], cells[7].split("@")[0]


def text_section(file):
    """Number, address and place in the file of the section with the code."""
    found = re.search(r"\[ *(\d+)\] \.text +PROGBITS +([0-9a-f]+) ([0-9a-f]+)", readelf("-S", file))
    return found[1], int(found[2], 16), int(found[3], 16)


def functions_without_landing(file):
    section, address, offset = text_section(file)
    content = file.read_bytes()
    for value, kind, where, name in symbols(file):
        start = value - address + offset
        if kind == "FUNC" and where == section and name not in FOREIGN:
            if content[start:start + 4] != ENDBR64:
                yield name


def faults(file):
    header, dynamic, segments = readelf("-h", file), readelf("-d", file), readelf("-l", file)
    if "DYN (" not in header:
        yield "is loaded at a fixed place"
    if "INTERP" in segments and not re.search(r"FLAGS_1.* PIE", dynamic):
        yield "is no position-independent program"
    if not re.search(r"FLAGS_1.* NOW", dynamic):
        yield "binds its calls late"
    if "GNU_RELRO" not in segments:
        yield "leaves the linker's tables open"
    if "TEXTREL" in dynamic:
        yield "changes its own code when it is loaded"
    stack = re.search(r"GNU_STACK.*", segments)
    if not stack or re.search(r" R?WE ", stack[0]):
        yield "has a stack that runs code"
    if "X86-64" in header:
        for name in list(functions_without_landing(file))[:3]:
            yield f"has no landing mark in {name}"


def main(folder):
    files = [file for file in sorted(pathlib.Path(folder).iterdir())
             if file.name == "zelmars" or re.fullmatch(r"lib\w[\w-]*\.so", file.name)]
    assert len(files) >= 10, files
    told = [f"{file.name}: {fault}" for file in files for fault in faults(file)]
    for wanted, enough in IMPORTS:
        importing = {file.name: any(re.fullmatch(wanted, name)
                                    for _, _, where, name in symbols(file) if where == "UND")
                     for file in files}
        if not enough(importing.values()):
            lacking = [name for name, imports in importing.items() if not imports]
            told.append(f"{wanted} is not imported by {', '.join(lacking)}")
    print("\n".join(told) or f"{len(files)} files are protected")
    return 1 if told else 0


sys.exit(main(*sys.argv[1:]))
