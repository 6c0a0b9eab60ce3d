#!/usr/bin/env python3
"""A long session in fast-forward: a handset at 1,000 messages a second and its monitor, whose clocks run 150 times as
fast, so that refreshes, history and raw messages are as in the hours that they take for theirs. Memory must not grow.

Usage: endurance_test.py PELORUSCTL PELORUS_TELEPHONYD [HOURS]
Without HOURS it is a quarter of one, about 8 seconds; 8 hours (28.8 million messages) take about 4 minutes.
"""

import pathlib
import re
import signal
import struct
import subprocess
import sys
import threading
import time
import unittest

from faults import resident
from programs import PELORUSCTL, TELEPHONYD, main
from served import Served

HOURS = float(sys.argv.pop(3)) if len(sys.argv) > 3 else 0.25
RATE = 1000  # messages a second
MESSAGES = int(HOURS * 3600 * RATE)
FAST = 150
REFRESH = 2.0
STALL = 60  # seconds without a single message
MEGABYTE = 1024  # in kilobytes
FAKETIME = next(pathlib.Path("/usr/lib").glob("*/faketime/libfaketime.so.1"), None)


class Counter:
    """Counts the messages of a recording that comes through a pipe."""

    def __init__(self, pipe):
        self.messages = 0
        self.pipe = pipe
        self.thread = threading.Thread(target=self.run, daemon=True)
        self.thread.start()

    def run(self):
        self.pipe.read(24)  # the recording's header
        rest = b""
        length = struct.Struct("<8xI4x")
        while True:
            piece = self.pipe.read1(1 << 20)
            if not piece:
                return
            rest += piece
            place = count = 0
            while place + 16 <= len(rest):
                end = place + 16 + length.unpack_from(rest, place)[0]
                if end > len(rest):
                    break
                place, count = end, count + 1
            rest = rest[place:]
            self.messages += count


class Updates:
    """Counts the monitor's updates; the last one's time."""

    def __init__(self, pipe):
        self.count = 0
        self.first = self.last = None
        self.pipe = pipe
        self.thread = threading.Thread(target=self.run, daemon=True)
        self.thread.start()

    def run(self):
        for line in self.pipe:
            self.last = float(re.match(rb'{"time":([0-9.]+)', line)[1])
            self.first = self.first or self.last
            self.count += 1


@unittest.skipUnless(FAKETIME, "libfaketime (Debian package faketime) is not installed: no session is fast-forwarded")
class EnduranceTest(Served):
    def run_fast(self, *command, **pipes):
        process = subprocess.Popen(command, stdin=subprocess.DEVNULL, stdout=subprocess.PIPE, **pipes,
                                   env=dict(self.environment, LD_PRELOAD=str(FAKETIME), FAKETIME="+0 x%d" % FAST,
                                            XDG_STATE_HOME=self.path("state")))
        self.addCleanup(process.stdout.close)
        self.addCleanup(process.wait)
        self.addCleanup(process.kill)
        return process

    def test_memory_stays_as_it_is(self):
        server = self.run_fast(TELEPHONYD, "--simulate", "Osprey LTE", "--rate", str(RATE), "--record", "/dev/stdout",
                               stderr=subprocess.PIPE)
        self.addCleanup(server.stderr.close)
        self.assertIn(b"listening on", server.stderr.readline())
        monitor = self.run_fast(PELORUSCTL, "live", "--json")
        counter, updates = Counter(server.stdout), Updates(monitor.stdout)
        began = time.monotonic()
        looks = []  # (messages, kilobytes of the server, of the monitor), at each hundredth
        while len(looks) < 100:
            self.wait_for_message(counter, MESSAGES * (len(looks) + 1) // 100)
            looks.append((counter.messages, resident(server), resident(monitor)))
        seconds = time.monotonic() - began
        session = updates.last - updates.first
        for percent in (10, 50, 100):
            print("%3d %%: %8d messages, server %d kB, monitor %d kB" % (percent, *looks[percent - 1]))
        print("most: server %d kB, monitor %d kB" % tuple(max(look[place] for look in looks) for place in (1, 2)))
        print("%d updates, %.0f s of session in %.0f s" % (updates.count, session, seconds), flush=True)

        for place in (1, 2):
            early = max(look[place] for look in looks[:10])
            late = max(look[place] for look in looks[10:])
            self.assertLess(late, early + 6 * MEGABYTE)
            self.assertLess(late, 100 * MEGABYTE)
        # A busy machine cannot keep up with so fast a clock; most refreshes came all the same, each with its news.
        self.assertGreater(updates.count, session / REFRESH / 5)
        for process, reader in ((monitor, updates), (server, counter)):
            process.send_signal(signal.SIGTERM)
            self.assertEqual(process.wait(30), 0)
            reader.thread.join()

    def wait_for_message(self, counter, number):
        moved, last = time.monotonic(), counter.messages
        while counter.messages < number:
            time.sleep(0.01)
            if counter.messages != last:
                moved, last = time.monotonic(), counter.messages
            self.assertLess(time.monotonic() - moved, STALL, "no message after %d" % last)


if __name__ == "__main__":
    main()
