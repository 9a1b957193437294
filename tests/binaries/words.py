#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Help, manual pages and completion know the same commands and options: words.py ROOT"""
import pathlib
import re
import sys


def words(text):
    """Commands, operations, kinds of work and options named in a text."""
    options = set(re.findall(r"(?<![\w-])--[a-z][a-z-]+", text))
    commands = {"init", "copy", "check", "backup", "restore", "upgrade", "bankfile", "documents",
                "import", "register", "letters", "declarations", "extracts", "members", "relatives",
                "premiums", "rubrics", "hospitals"}
    operations = set(re.findall(r"\b(?:NewMovimento|Registo|Recebimento|Correcao|Extratos|"
                                r"L[a-z]*pagamentos|LPagamentos|Ldividas|Lcartasdividas|Lhospitais|"
                                r"Call[A-Z]\w+|Login)\b", text))
    return options | operations | {each for each in commands if re.search(rf"\b{each}\b", text)}


def commands_of(help_text):
    """The commands that the help shows at the beginning of a line."""
    return set(re.findall(r"^  zelmars ([a-z]+)", help_text, re.MULTILINE))


def main(root):
    """Prints what one of them has and another has not."""
    root = pathlib.Path(root)
    texts = {"help.txt": (root / "host/help.txt").read_text(),
             "zelmars.1": (root / "share/man/zelmars.1").read_text().replace("\\-", "-"),
             "pt/zelmars.1": (root / "share/man/pt/zelmars.1").read_text().replace("\\-", "-"),
             "completion": (root / "share/zelmars.bash-completion").read_text()}
    known = {name: words(text) for name, text in texts.items()}
    faults = []
    for name, found in known.items():
        for other, others in known.items():
            faults += [f"{name} has {word}, {other} has not" for word in sorted(found - others)]
    commands = commands_of(texts["help.txt"])
    faults += [f"no rule of this test knows the command {each}"
               for each in sorted(commands - known["help.txt"])]
    print(*faults, f"{len(known['help.txt'])} words, {len(commands)} commands", sep="\n")
    return 1 if faults or len(commands) < 10 else 0


if __name__ == "__main__":
    sys.exit(main(sys.argv[1]))
