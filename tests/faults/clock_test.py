#!/usr/bin/env python3
"""A wall clock that is set while everything runs: what waits, waits on; what is dated has the new date."""

import os
import pathlib
import signal
import subprocess
import time
import unittest

from faults import Live, main_at_once
from programs import TELEPHONYD, ctl
from recordings import recorded
from served import Served

FAKETIME = next(pathlib.Path("/usr/lib").glob("*/faketime/libfaketime.so.1"), None)
REFRESH, RETRY = 2.0, 5.0
DAY = 86400
SLACK = 8  # seconds that a busy machine may add; the jumps are far longer


@unittest.skipUnless(FAKETIME, "libfaketime (Debian package faketime) is not installed: no clock is set")
class ClockTest(Served):
    def setUp(self):
        super().setUp()
        self.set_clock(0)
        self.faked = {"LD_PRELOAD": str(FAKETIME), "FAKETIME_TIMESTAMP_FILE": self.path("clock"),
                      "FAKETIME_NO_CACHE": "1", "FAKETIME_DONT_FAKE_MONOTONIC": "1"}
        self.environment.update(self.faked)

    def set_clock(self, offset):
        self.offset = offset
        with open(self.path("clock.new"), "w", encoding="ascii") as file:
            file.write("%+d\n" % offset)
        os.rename(self.path("clock.new"), self.path("clock"))

    def serve(self, *arguments):
        server = subprocess.Popen([TELEPHONYD, "--simulate", "Osprey LTE", *arguments], env=self.environment,
                                  stderr=subprocess.PIPE, text=True)
        self.addCleanup(server.stderr.close)
        self.addCleanup(server.wait)
        self.addCleanup(server.kill)
        self.assertIn("listening on", server.stderr.readline())
        return server

    def monitor(self):
        live = Live(self.path("ports"), **self.faked)
        self.addCleanup(live.close)
        return live

    def expect_updates(self, live, count):
        """So many more, at the refresh's pace, each of a message of just now on the clock that is set."""
        before = time.monotonic()
        for _ in range(count):
            live.wait_for_update(patience=REFRESH + SLACK)
            when, of_message, _ = live.updates[-1]
            self.assertLess(abs(of_message - (time.time() + self.offset)), REFRESH + SLACK)
            self.assertLess(when - before, REFRESH + SLACK)
            before = when

    def test_refreshes_go_on_through_every_jump(self):
        server = self.serve("--rate", "200", "--record", self.path("record"))
        live = self.monitor()
        self.expect_updates(live, 1)
        for offset in (400 * DAY, -DAY):
            self.set_clock(offset)
            began, count = time.monotonic(), len(live.updates)
            self.expect_updates(live, 1)  # may be of the clock before
            self.expect_updates(live, 1)
            lasted = time.monotonic() - began
            self.assertGreater(lasted, REFRESH / 2)  # nor did they come in a heap
            self.assertLess(len(live.updates) - count, lasted / REFRESH + 2)
        live.process.send_signal(signal.SIGTERM)
        self.assertEqual(live.end(), (0, ""))
        self.end(server)
        # The pace of the stream did not change, and the recording can be read whatever its times do.
        messages = len(recorded(self.read("record")))
        seconds = live.updates[-1][0] - live.updates[0][0]
        self.assertGreater(messages, 200 * seconds / 3)
        self.assertLess(messages, 200 * (seconds + REFRESH + SLACK))
        decoded = ctl("decode", "--technology", "Osprey LTE", "--json", "--every", "2", self.path("record"))
        self.assertEqual((decoded.returncode, decoded.stderr), (0, ""))
        self.assertLess(decoded.stdout.count("\n"), seconds + SLACK)

    def expect_retry_after(self, offset):
        live = self.monitor()
        time.sleep(RETRY / 5)  # it has found no server
        self.set_clock(offset)
        self.serve("--rate", "200")
        began = time.monotonic()
        live.wait_for_update()
        waited = time.monotonic() - began
        self.assertGreater(waited, REFRESH)  # neither at once
        self.assertLess(waited, RETRY + REFRESH + SLACK)  # nor a day later
        live.process.send_signal(signal.SIGTERM)
        self.assertEqual(live.end(), (0, ""))

    def test_retry_comes_when_it_is_due_though_the_clock_goes_back(self):
        self.expect_retry_after(-DAY)

    def test_retry_comes_when_it_is_due_though_the_clock_goes_ahead(self):
        self.expect_retry_after(2 * DAY)


if __name__ == "__main__":
    main_at_once()
