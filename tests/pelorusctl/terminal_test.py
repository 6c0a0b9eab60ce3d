#!/usr/bin/env python3
"""What pelorusctl live shows on a terminal, and how it leaves it."""

import os
import re
import signal
import termios
import time

from programs import Scratch, main
from recordings import internal, lte_cell
from telephony import TelephonyServer
from terminal import ENTER, LEAVE, Terminal


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
