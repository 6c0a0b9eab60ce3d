"""pelorusctl live on a terminal, read through a small model of one."""

import fcntl
import os
import pty
import re
import select
import struct
import subprocess
import termios
import time

from programs import PELORUSCTL

ENTER, LEAVE = "\x1b[?1049h", "\x1b[?1049l"
PATIENCE = 6  # seconds


class Terminal:
    """A pseudo terminal with pelorusctl live on it."""

    def __init__(self, directory, columns=60, rows=12, **environment):
        self.master, self.slave = pty.openpty()
        self.resize(columns, rows)
        self.settings = termios.tcgetattr(self.slave)
        self.text = ""
        inherited = {key: value for key, value in os.environ.items() if key != "NO_COLOR"}
        self.process = subprocess.Popen(
            [PELORUSCTL, "live"], stdin=self.slave, stdout=self.slave, stderr=self.slave, start_new_session=True,
            env=dict(inherited, TERM="xterm-256color", PELORUS_PORT_DIRECTORY=directory, **environment),
            preexec_fn=lambda: fcntl.ioctl(0, termios.TIOCSCTTY, 0))

    def close(self):
        self.process.kill()
        self.process.wait()
        os.close(self.master)
        os.close(self.slave)

    def resize(self, columns, rows):
        self.columns, self.rows = columns, rows
        fcntl.ioctl(self.slave, termios.TIOCSWINSZ, struct.pack("HHHH", rows, columns, 0, 0))

    def type(self, keys):
        os.write(self.master, keys)

    def read(self, seconds):
        ready, _, _ = select.select([self.master], [], [], max(seconds, 0))
        if ready:
            self.text += os.read(self.master, 65536).decode()
        return bool(ready)

    def wait_for(self, condition, patience=PATIENCE):
        """Reads until the condition of this terminal holds."""
        end = time.monotonic() + patience
        while not condition(self):
            if not self.read(end - time.monotonic()):
                raise AssertionError("not shown: %r" % self.text)

    def exit_status(self):
        status = self.process.wait(PATIENCE)
        while self.read(0):
            pass
        return status

    def lines(self):
        """What the screen shows. A character beyond its edge, or an erasure that takes one back, shows as "!"."""
        screen = [[" "] * self.columns for _ in range(self.rows)]
        row = column = 0
        for piece in re.findall(r"\x1b\[[?\d;]*[A-Za-z]|[^\x1b]", self.text[self.text.rindex(ENTER):]):
            position = re.fullmatch(r"\x1b\[(\d+);1H", piece)
            if position:
                row, column = int(position[1]) - 1, 0
            elif piece == "\x1b[2J":
                screen = [[" "] * self.columns for _ in range(self.rows)]
            elif piece == "\x1b[K":
                edge = min(column, self.columns - 1)
                screen[row][edge:] = ["!" if column == self.columns else " "] + [" "] * (self.columns - edge - 1)
            elif not piece.startswith("\x1b"):
                if column < self.columns:
                    screen[row][column] = piece
                else:
                    screen[row][-1] = "!"
                column += 1
        return ["".join(line).rstrip() for line in screen]

    def shows(self, text):
        return lambda terminal: ENTER in terminal.text and any(text in line for line in terminal.lines())
