#!/usr/bin/env python3
"""pelorusctl live on a terminal, read through a small model of one."""

import fcntl
import os
import pty
import re
import select
import signal
import struct
import subprocess
import termios
import time

from programs import PELORUSCTL, Scratch, main
from recordings import internal, lte_cell
from telephony import TelephonyServer

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

    def wait_for(self, condition):
        """Reads until the condition of this terminal holds."""
        end = time.monotonic() + PATIENCE
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


class TerminalTest(Scratch):
    def open(self, **arguments):
        self.server = TelephonyServer(self.directory)
        self.addCleanup(self.server.close)
        terminal = Terminal(self.directory, **arguments)
        self.addCleanup(terminal.close)
        return terminal

    def expect_clean(self, terminal):
        self.assertEqual(terminal.exit_status(), 0)
        self.assertEqual(terminal.text.count(ENTER), terminal.text.count(LEAVE))
        tail = terminal.text[terminal.text.rindex(LEAVE):]
        self.assertEqual(tail, LEAVE)
        self.assertGreater(terminal.text.rindex("\x1b[?25h"), terminal.text.rindex("\x1b[?25l"))
        self.assertEqual(termios.tcgetattr(terminal.slave), terminal.settings)

    def test_redraws_in_place_until_control_c(self):
        terminal = self.open()
        terminal.wait_for(terminal.shows("Connecting..."))
        self.assertNotEqual(termios.tcgetattr(terminal.slave), terminal.settings)
        channel = self.server.channel()
        channel.send(lte_cell(321))
        terminal.wait_for(terminal.shows("Updated "))
        lines = terminal.lines()
        self.assertEqual(lines[:3], ["Pelorus", "  Serving cell", "    Serving Cell Info"])
        self.assertRegex(lines[3], r"^      Physical Cell ID +321$")
        self.assertRegex(lines[11], r"^ Updated \d{4}-\d\d-\d\d at \d\d:\d\d:\d\d +1-11 of \d+   q: quit$")
        self.assertIn("\x1b[1;36m", terminal.text)
        before = len(terminal.text)
        channel.send(lte_cell(322))
        terminal.wait_for(terminal.shows("322"))
        self.assertNotIn("Serving cell", terminal.text[before:])  # only what changed is sent
        channel.close()
        terminal.wait_for(terminal.shows("Connecting..."))
        terminal.type(b"\x03")
        self.expect_clean(terminal)

    def test_follows_the_size_of_the_terminal(self):
        terminal = self.open(columns=23, rows=5)
        self.server.channel().send(lte_cell(321))
        terminal.wait_for(terminal.shows("Updated "))
        self.assertEqual(terminal.lines()[4], " Updated " + time.strftime("%Y-%m-%d") + " at\u2026")
        for columns, rows in ((100, 30), (7, 2), (1, 1), (40, 8)):
            terminal.resize(columns, rows)
            os.kill(terminal.process.pid, signal.SIGWINCH)
            drawn = len(terminal.text)
            terminal.wait_for(lambda t, seen=drawn: "\x1b[?2026l" in t.text[seen:])
            terminal.text = ENTER + terminal.text[drawn:]
            self.assertNotIn("!", "".join(terminal.lines()), (columns, rows))
            self.assertTrue(terminal.lines()[0].startswith("Pelorus"[:columns - 1]))
        terminal.type(b"jjj")
        terminal.wait_for(terminal.shows("Tracking Area Code"))
        self.assertRegex(terminal.lines()[0], "Physical Cell ID +321")
        terminal.type(b"q")
        self.assertEqual(terminal.exit_status(), 0)

    def test_shows_no_colours_to_who_wants_none(self):
        terminal = self.open(NO_COLOR="1")
        self.server.channel().send(lte_cell(321))
        terminal.wait_for(terminal.shows("Updated "))
        terminal.type(b"q")
        self.expect_clean(terminal)
        self.assertEqual(set(re.findall(r"\x1b\[([\d;]*)m", terminal.text)), {"0"})

    def test_stops_and_goes_on(self):
        terminal = self.open()
        terminal.wait_for(terminal.shows("Connecting..."))
        channel = self.server.channel()
        terminal.type(b"\x1a")
        _, status = os.waitpid(terminal.process.pid, os.WUNTRACED)
        self.assertTrue(os.WIFSTOPPED(status))
        while terminal.read(0):
            pass
        self.assertTrue(terminal.text.endswith(LEAVE))
        self.assertEqual(termios.tcgetattr(terminal.slave), terminal.settings)
        channel.send(lte_cell(321))
        os.kill(terminal.process.pid, signal.SIGCONT)
        terminal.wait_for(lambda t: t.text.count(ENTER) == 2)
        terminal.wait_for(terminal.shows("321"))
        os.kill(terminal.process.pid, signal.SIGTERM)
        self.expect_clean(terminal)

    def test_leaves_the_terminal_when_it_ends_by_an_exception(self):
        terminal = self.open(XDG_STATE_HOME=self.directory)
        self.server.channel().send(internal(0, b"no list"))
        terminal.wait_for(lambda t: LEAVE in t.text and t.text.endswith("\n"))
        self.assertEqual(terminal.exit_status(), -signal.SIGABRT)
        self.assertIn("LogCode_0xFF0000::UnknownDataException", terminal.text.split(LEAVE)[1])
        self.assertEqual(termios.tcgetattr(terminal.slave), terminal.settings)


if __name__ == "__main__":
    main()
