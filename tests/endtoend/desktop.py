# SPDX-License-Identifier: MIT
"""A virtual display with a window manager, and a person at its keyboard."""

import os
import re
import signal
import subprocess
import time

PATIENCE = 40  # seconds that anything may take before it counts as failed


class Failed(Exception):
    pass


def wait_until(what, condition, patience=PATIENCE):
    """Waits until condition() gives something true, and gives that."""
    deadline = time.monotonic() + patience
    while time.monotonic() < deadline:
        found = condition()
        if found:
            return found
        time.sleep(0.02)
    raise Failed("waited in vain until " + what)


def surroundings(own, pictures=None):
    """The environment of all programs; what they keep lies in the folder `own`."""
    return dict(os.environ, ZELMARS_REGISTRY=own + "/registry", XDG_CONFIG_HOME=own,
                XDG_RUNTIME_DIR=own, TZ="Europe/Lisbon", LC_ALL="C.UTF-8", PICTURES=pictures or "")


class Desktop:
    """Starts Xvfb and openbox on a free display; stops them and all programs at the end."""

    def __init__(self, environment):
        self.programs = []
        self.pressed = 0  # keys so far; Alt with a letter is one
        # The server picks the number of a free display and writes it to the pipe.
        readable, writable = os.pipe()
        self._start(
            ["Xvfb", "-displayfd", str(writable), "-screen", "0", "1280x800x24", "-nolisten", "tcp"],
            dict(os.environ), pass_fds=[writable])
        os.close(writable)
        with os.fdopen(readable) as pipe:
            number = pipe.readline().strip()
        if not number:
            raise Failed("the virtual display did not start")
        self.environment = dict(environment, DISPLAY=":" + number, QT_QPA_PLATFORM="xcb")
        ready = os.path.join(environment["XDG_RUNTIME_DIR"], "window-manager")
        self._start(["openbox", "--startup", "touch " + ready], self.environment)
        wait_until("a window manager is there", lambda: os.path.exists(ready))

    def __enter__(self):
        return self

    def __exit__(self, *_):
        for program in reversed(self.programs):
            if program.poll() is None:
                program.send_signal(signal.SIGTERM)
                try:
                    program.wait(5)
                except subprocess.TimeoutExpired:
                    program.kill()

    def _start(self, command, environment, pass_fds=()):
        program = subprocess.Popen(command, env=environment, pass_fds=pass_fds,
                                   stdout=subprocess.DEVNULL)
        self.programs.append(program)
        return program

    def start(self, command):
        return self._start(command, self.environment)

    def run(self, command):
        return subprocess.run(command, env=self.environment, stdout=subprocess.PIPE,
                              stderr=subprocess.DEVNULL, text=True, check=False).stdout

    def active_title(self):
        return self.run(["xdotool", "getactivewindow", "getwindowname"]).strip()

    def window_of(self, program, title):
        """The program's visible window of that title, once there is one; the newest of several."""
        def search():
            return self.run(["xdotool", "search", "--all", "--onlyvisible", "--pid",
                             str(program.pid), "--name", re.escape(title)]).split()
        return max(wait_until(f"«{title}» is there", search), key=int)

    def turn_to(self, window):
        self.run(["xdotool", "windowactivate", "--sync", window])

    def at(self, title):
        """Waits until the window with that title (or the beginning of it) has the keyboard."""
        wait_until(f"«{title}» has the keyboard (now «{self.active_title()}»)",
                   lambda: self.active_title().startswith(title))

    def settled(self, title):
        """Fails when another window comes to the front of that one a moment later."""
        deadline = time.monotonic() + 0.5
        while time.monotonic() < deadline:
            if not self.active_title().startswith(title):
                raise Failed(f"«{self.active_title()}» came in front of «{title}»")
            time.sleep(0.05)

    def place_of(self, window):
        """X, Y, WIDTH and HEIGHT of a window, without its frame."""
        lines = self.run(["xdotool", "getwindowgeometry", "--shell", window]).split()
        return {name: int(value) for name, value in (line.split("=") for line in lines)}

    def gone(self, title):
        wait_until(f"«{title}» has gone", lambda: not self.active_title().startswith(title))

    def keys(self, *names):
        self.pressed += len(names)
        self.run(["xdotool", "key", "--clearmodifiers", "--delay", "20", *names])

    def type(self, text):
        self.pressed += len(text)
        self.run(["xdotool", "type", "--delay", "15", text])

    def ask(self, key):
        """Presses a key that brings a box, and waits for it; the box's window. Boxes often bear
        the title of their screen."""
        screen = self._active_window()
        self.keys(key)
        return wait_until("a box comes", lambda: self._other_window(screen))

    def _active_window(self):
        return self.run(["xdotool", "getactivewindow"]).strip()

    def _other_window(self, window):
        active = self._active_window()
        return active if active != window else None

    def show(self, name):
        """Keeps a picture of the display, where pictures are wanted."""
        folder = self.environment.get("PICTURES")
        if folder:
            self.run(["import", "-window", "root", os.path.join(folder, name + ".png")])
