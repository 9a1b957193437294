#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""What is installed works by itself: installed.py CMAKE BUILD SOURCE

Installs BUILD into a folder, carries that somewhere else, and lets the program register itself, make a
book and open an operation there, with nothing of the build or source tree to be found.
"""
import os
import pathlib
import re
import subprocess
import sys
import tempfile


def run(*words, **settings):
    """What a command says on both streams; fails with it when it fails."""
    done = subprocess.run(words, stdout=subprocess.PIPE, stderr=subprocess.STDOUT, text=True,
                          check=False, timeout=60, **settings)
    if done.returncode != 0:
        raise SystemExit(f"{' '.join(map(str, words))}: {done.returncode}\n{done.stdout}")
    return done.stdout


def traces(root, trees):
    """Shared objects and programs whose paths for libraries lead out of the installation."""
    for path in root.rglob("*"):
        if path.is_symlink() or not path.is_file() or path.read_bytes()[:4] != b"\x7fELF":
            continue
        found = re.findall(r"R(?:UN)?PATH\)\s+.*\[(.*)\]", run("readelf", "-d", path))
        if found != ["$ORIGIN"] or any(tree in "".join(found) for tree in trees):
            yield f"{path.name}: {found}"


def main(cmake, build, source):
    """Fails with the first thing that is not as it should be."""
    with tempfile.TemporaryDirectory() as folder:
        first, root = pathlib.Path(folder, "first"), pathlib.Path(folder, "elsewhere")
        run(cmake, "--install", build, "--prefix", first)
        first.rename(root)
        wrong = list(traces(root, (build, source)))
        if wrong:
            raise SystemExit("\n".join(wrong))
        home = pathlib.Path(folder, "home")
        home.mkdir()
        environment = {"HOME": str(home), "PATH": os.environ["PATH"], "LC_ALL": "C.UTF-8",
                       "QT_QPA_PLATFORM": "offscreen", "XDG_RUNTIME_DIR": str(home)}
        home.chmod(0o700)
        program = root / "bin" / "zelmars"
        settings = {"env": environment, "cwd": home}
        version = run(program, "--version", **settings)
        run(program, "init", "--sample", home / "livro", **settings)
        run(program, "check", **settings)
        # An operation shows its screen; that it does so is told by the program going on.
        with subprocess.Popen([program, "NewMovimento"], stderr=subprocess.PIPE, text=True,
                              **settings) as shown:
            try:
                said = shown.communicate(timeout=3)[1]
                raise SystemExit(f"NewMovimento ended: {shown.returncode}\n{said}")
            except subprocess.TimeoutExpired:
                shown.kill()
                said = shown.communicate()[1]
        registry = (home / ".config/zelmars/registry/HKEY_CLASSES_ROOT.ini").read_text()
        for name in ("Zelmars", "Lumbra", "Tiqueta", "Vorlane"):
            if not re.search(rf"{re.escape(str(root))}/.*lib{name}\.so", registry):
                raise SystemExit(f"{name} is not registered in {registry}")
        print(version, said)


if __name__ == "__main__":
    main(*sys.argv[1:])
