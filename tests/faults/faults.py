"""What the tests of faults have in common: numbered messages, monitors that are watched, and memory that is measured."""

import concurrent.futures
import functools
import glob
import json
import os
import pathlib
import plistlib
import struct
import subprocess
import sys
import threading
import time
import unittest

sys.path.insert(0, str(pathlib.Path(__file__).resolve().parent.parent / "pelorusctl"))

from programs import PELORUSCTL, TELEPHONYD, leaves, main  # noqa: E402
from recordings import START, internal, lte_cell, pcap  # noqa: E402
from stage import PCI  # noqa: E402

MILLION = 1000000
PATIENCE = 30  # seconds; far more than anything takes on a machine that has time
DEADLY = internal(0, b"no property list")  # ends a monitor, which saves what it captured


def wait_for(what, condition, patience=PATIENCE):
    """The first true answer of the condition."""
    end = time.monotonic() + patience
    while True:
        answer = condition()
        if answer:
            return answer
        if time.monotonic() > end:
            raise AssertionError("waited in vain for " + what)
        time.sleep(0.02)


cell_of = functools.lru_cache(lte_cell)


def numbered(number):
    """A message that carries its number as the time stamp, and shows how many millions that is."""
    data = bytearray(cell_of(number // MILLION))
    struct.pack_into("<Q", data, 5, number)
    return bytes(data)


def numbers(raw):
    """Those of back-to-back numbered messages; of others there are none."""
    found, offset = [], 0
    while offset < len(raw):
        log_type, length, code, number = struct.unpack_from("<BHHQ", raw, offset)
        if (log_type, code) == (1, 0xB0C2):
            found.append(number)
        offset += 1 + length
    return found


def numbered_recording(first, count, per_second=1000, last=()):
    """A pcap file of numbered messages, evenly in time, and of others behind them."""
    messages = [numbered(number) for number in range(first, first + count)] + list(last)
    return pcap((START * 10**9 + place * 10**9 // per_second, data) for place, data in enumerate(messages))


def runs(found):
    """Numbers as [first, last] of each run without a gap."""
    ranges = []
    for number in found:
        if ranges and ranges[-1][1] + 1 == number:
            ranges[-1][1] = number
        else:
            ranges.append([number, number])
    return ranges


def resident(process):
    """Kilobytes of memory that a process has."""
    with open("/proc/%d/status" % process.pid) as status:
        for line in status:
            if line.startswith("VmRSS:"):
                return int(line.split()[1])
    raise AssertionError("process %d has no memory" % process.pid)


def saved(state):
    """What the only snapshot file below that directory holds."""
    [path] = glob.glob(os.path.join(state, "pelorus/CrashReporter/PelorusSnapshot-*.pelorus"))
    with open(path, "rb") as file:
        return plistlib.load(file)


def captured(state):
    """The numbers of the messages in that snapshot."""
    return numbers(b"".join(entry.get("DisplayState", b"") for entry in saved(state)["Data"]))


class Live:
    """pelorusctl live --json, whose updates are taken as they come."""

    def __init__(self, directory, state=None, arguments=(), **environment):
        self.state = state or os.path.join(directory, "state")
        self.updates = []  # (when, time of the last message, leaves by path)
        self.process = subprocess.Popen(
            [PELORUSCTL, "live", "--json", *arguments], stdin=subprocess.DEVNULL, stdout=subprocess.PIPE,
            stderr=subprocess.PIPE, text=True,
            env=dict(os.environ, PELORUS_PORT_DIRECTORY=directory, XDG_STATE_HOME=self.state, **environment))
        self.reader = threading.Thread(target=self.read, daemon=True)
        self.reader.start()

    def read(self):
        for text in self.process.stdout:
            line = json.loads(text)
            self.updates.append((time.monotonic(), line["time"], leaves(line["tree"])))

    def wait_for_update(self, behind=None, patience=PATIENCE):
        """Until there is one more, or more than so many."""
        count = len(self.updates) if behind is None else behind
        wait_for("update %d" % (count + 1), lambda: len(self.updates) > count, patience)

    def wait_for_cell(self, cell):
        """Until it shows the cell of that physical identity."""
        wait_for("cell %d" % cell, lambda: self.updates and self.updates[-1][2].get(PCI) == str(cell))

    def end(self):
        """Its exit status and what it said, once it has ended on its own."""
        status = self.process.wait(PATIENCE)
        self.reader.join(PATIENCE)
        return status, self.process.stderr.read()

    def close(self):
        self.process.kill()
        self.process.wait()
        self.reader.join(PATIENCE)
        self.process.stdout.close()
        self.process.stderr.close()


def main_at_once():
    """Runs each test of the script in a process of its own, all at once: they mostly wait. With further arguments, as
    usual."""
    if len(sys.argv) > 3:
        main()

    def run(test):
        return subprocess.run([sys.executable, "-B", sys.argv[0], PELORUSCTL, TELEPHONYD, "-v", test],
                              stdin=subprocess.DEVNULL, capture_output=True, text=True, check=False)

    classes = unittest.defaultTestLoader.loadTestsFromModule(sys.modules["__main__"])
    names = ["%s.%s" % (type(test).__name__, test._testMethodName) for tests in classes for test in tests]
    with concurrent.futures.ThreadPoolExecutor(len(names)) as pool:
        runs_ = list(pool.map(run, names))
    for done in runs_:
        sys.stderr.write(done.stderr if done.returncode else done.stderr.splitlines(True)[0])
    sys.exit(any(done.returncode for done in runs_) or not names)


class Scenarios:
    """Functions that wait for time-outs, all run at once."""

    def __init__(self):
        self.functions = {}

    def add(self, function):
        self.functions[function.__name__] = function
        return function

    def run(self, test):
        """Each as a part of the test."""
        with concurrent.futures.ThreadPoolExecutor(len(self.functions)) as pool:
            results = {name: pool.submit(function) for name, function in self.functions.items()}
            for name, result in results.items():
                with test.subTest(name):
                    result.result()
