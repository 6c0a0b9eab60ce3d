#!/usr/bin/python3
"""The window with real telephony servers over real sockets.

Usage: window_test.py PELORUSCTL PELORUS_TELEPHONYD PELORUS DIRECTORY_FOR_PICTURES [TEST...]
"""

import concurrent.futures
import glob
import json
import os
import plistlib
import signal
import stat
import subprocess
import sys
import time
import unittest

PELORUS, PICTURES = sys.argv[3:5]
del sys.argv[3:5]
sys.path.insert(0, os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", "pelorusctl"))

from desktop import Desktop, Monitor, colour, wait_for  # noqa: E402
from programs import TELEPHONYD, Scratch, ctl, main  # noqa: E402
from recordings import internal, lte_cell  # noqa: E402
from telephony import TelephonyServer  # noqa: E402

REFRESH, BACK = 2.0, 6.0  # seconds
SLACK = 2.5 # of a machine that does other things as well
DESKTOP = None


def setUpModule():
    global DESKTOP
    os.makedirs(PICTURES, exist_ok=True)
    DESKTOP = Desktop()


def tearDownModule():
    DESKTOP.close()


class Window(Scratch):
    def setUp(self):
        super().setUp()
        self.monitor = None

    def serve(self, *arguments):
        """A telephony server that listens."""
        process = subprocess.Popen([TELEPHONYD, *arguments], stderr=subprocess.PIPE, text=True,
                                   env=dict(os.environ, PELORUS_PORT_DIRECTORY=self.directory))
        self.addCleanup(process.stderr.close)
        self.addCleanup(process.wait)
        self.addCleanup(process.kill)
        self.assertIn("listening on", process.stderr.readline())
        return process

    def open(self, *arguments, **options):
        self.monitor = Monitor(PELORUS, self.directory, *arguments, **options)
        self.addCleanup(self.monitor.kill)
        return self.monitor

    def picture(self, name):
        self.monitor.picture(os.path.join(PICTURES, name + ".png"))

    def snapshots(self):
        return glob.glob(self.path("state/pelorus/CrashReporter/PelorusSnapshot-*.pelorus"))


class WithHandset(Window):
    def test_drills_down_and_comes_back_when_the_server_does(self):
        server = self.serve("--simulate", "Osprey LTE", "--rate", "50")
        monitor = self.open(size=(480, 760))
        wait_for("the first update", lambda: monitor.shows("Updated 20"))
        self.picture("root")
        sections = [name for name, _ in monitor.rows()]
        self.assertEqual(sections[:3], ["Serving cell", "Measurements", "Neighbor cells"])
        monitor.open_row(1, "Measurements")
        monitor.open_row(0, "Serving Cell Measurements")
        first = monitor.rows()
        self.assertRegex(monitor.value("Measured RSRP"), r"^-\d+\.\d\d dBm$")
        wait_for("another value", lambda: monitor.rows() != first, 4 * REFRESH)
        self.picture("measurements")

        before = [name for name, _ in monitor.rows()]
        server.kill()
        lost = time.monotonic()
        wait_for("Connecting...", lambda: monitor.shows("Connecting..."), REFRESH + SLACK)
        self.assertLess(time.monotonic() - lost, REFRESH + SLACK)
        self.assertTrue(monitor.is_busy())
        self.assertEqual([name for name, _ in monitor.rows()], before)
        self.picture("connecting")

        self.serve("--simulate", "Osprey LTE", "--rate", "50")
        wait_for("the connection", lambda: not monitor.shows("Connecting..."), BACK + SLACK)
        self.assertEqual(monitor.title(), "Serving Cell Measurements")
        self.assertFalse(monitor.is_busy())
        again = monitor.rows()
        wait_for("another value", lambda: monitor.rows() != again, 4 * REFRESH)
        monitor.keys("BackSpace")
        wait_for("the parent", lambda: monitor.title() == "Measurements")
        monitor.keys("alt+Left")
        wait_for("the root", lambda: monitor.title() == "Pelorus")
        monitor.keys("ctrl+q")
        self.assertEqual(monitor.wait()[0], 0)

    def test_saves_a_snapshot_that_can_be_read(self):
        self.serve("--simulate", "Osprey LTE", "--rate", "50")
        monitor = self.open(size=(360, 640))
        wait_for("the first update", lambda: monitor.shows("Updated 20"))
        monitor.keys("ctrl+s")
        wait_for("the save screen", lambda: "Snapshot" in monitor.labels())
        wait_for("its list", lambda: len(list(monitor.each("list"))) == 1)
        monitor.type("In the lift")
        self.picture("save")
        monitor.keys("Return")
        self.assertEqual(self.snapshots(), [])
        monitor.keys("ctrl+s")
        wait_for("the name of the file", lambda: monitor.shows("Saved PelorusSnapshot-"))
        self.picture("saved")
        [path] = self.snapshots()
        report = json.loads(ctl("snapshot", "--json", path).stdout)
        self.assertEqual(report["description"], "In the lift")
        self.assertRegex(report["timestamp"], r"^20\d\d-\d\d-\d\d \d\d:\d\d:\d\d \+0000$")
        self.assertRegex(report["entries"][-1]["description"], r"^DLF binary \(\d+ bytes\)$")
        wait_for("the status", lambda: monitor.shows("Updated 20"))


    def test_is_dark_where_the_desktop_is(self):
        self.serve("--simulate", "Osprey GSM", "--rate", "50")
        portal = DESKTOP.prefer_dark()
        self.addCleanup(portal.close_sync, None)
        monitor = self.open(size=(360, 640))
        wait_for("the first update", lambda: monitor.shows("Updated 20"))
        monitor.open_row(1, monitor.rows()[1][0])
        self.picture("dark")
        self.assertEqual(max(colour(os.path.join(PICTURES, "dark.png"), 3, 560)), 0x1f)


class WithServerOfOurOwn(Window):
    def setUp(self):
        super().setUp()
        self.server = TelephonyServer(self.directory)
        self.addCleanup(self.server.close)

    def connect(self, *technology):
        """A monitor and its channel, which is granted while the window opens: the monitor waits for a second only."""
        with concurrent.futures.ThreadPoolExecutor() as pool:
            channel = pool.submit(self.server.channel, *technology)
            return self.open(), channel.result()

    def test_a_section_that_vanishes_takes_its_panes_along(self):
        monitor, channel = self.connect("IFX")
        cells = {"Serving": {"Cell": "7", "Band": "3"}, "State": "Idle"}
        channel.send(plistlib.dumps({"Radio": cells, "Version": "1"}))
        wait_for("the rows", lambda: monitor.rows() == [("Radio", ""), ("Version", "1")])
        monitor.open_row(0, "Radio")
        self.assertCountEqual(monitor.rows(), [("Serving", ""), ("State", "Idle")])
        monitor.open_row([name for name, _ in monitor.rows()].index("Serving"), "Serving")
        self.assertCountEqual(monitor.rows(), [("Cell", "7"), ("Band", "3")])
        channel.send(plistlib.dumps({"Radio": {"State": "Searching", "Level": "-90"}, "Version": "2"}))
        wait_for("the parent", lambda: monitor.title() == "Radio")
        self.assertCountEqual(monitor.rows(), [("State", "Searching"), ("Level", "-90")])
        monitor.keys("BackSpace")
        wait_for("the root", lambda: monitor.rows() == [("Radio", ""), ("Version", "2")])

    def test_an_exception_ends_the_program_and_saves_what_was_captured(self):
        monitor, channel = self.connect()
        channel.send(lte_cell(1))
        wait_for("an update", lambda: monitor.shows("Updated 20"))
        channel.send(internal(0, b"no property list"))
        status, _, errors = monitor.wait()
        self.assertEqual(status, -signal.SIGABRT)
        self.assertIn("ended by LogCode_0xFF0000::UnknownDataException", errors)
        [path] = self.snapshots()
        with open(path, "rb") as file:
            self.assertEqual(plistlib.load(file)["Description"],
                             "Recovered after LogCode_0xFF0000::UnknownDataException")

    def test_fits_on_a_screen_that_is_small_for_its_density(self):
        os.environ["QT_SCALE_FACTOR"] = "1.5"
        self.addCleanup(os.environ.pop, "QT_SCALE_FACTOR")
        monitor, _ = self.connect()
        self.assertEqual(monitor.size(), (720, 900))

    def test_its_end_tells_the_home_screen_and_leaves_nothing(self):
        monitor, _ = self.connect()
        listener = subprocess.Popen(["dbus-monitor", "--session", "interface='io.pelorus.HomeScreen'"],
                                    stdout=subprocess.PIPE, text=True)
        self.addCleanup(listener.stdout.close)
        self.addCleanup(listener.wait)
        self.addCleanup(listener.kill)
        self.assertIn("NameAcquired", listener.stdout.readline())
        self.assertEqual(monitor.end()[::2], (0, ""))
        while "member=PreferencesChanged" not in (line := listener.stdout.readline()):
            self.assertTrue(line)
        self.assertEqual([listener.stdout.readline().strip() for _ in range(2)],
                         ['string "io.pelorus.HomeScreen"', 'string "HBShowGSMRSSI"'])
        with open(self.path("config/io.pelorus/HomeScreen.conf"), encoding="utf-8") as file:
            self.assertIn("HBShowGSMRSSI=false", file.read())
        self.assertEqual(glob.glob(self.path("io.pelorus.*LogChannel")), [])


class WithoutDisplay(Scratch):
    def run_pelorus(self, **changes):
        environment = {name: value for name, value in os.environ.items()
                       if name not in ("DISPLAY", "WAYLAND_DISPLAY", "QT_QPA_PLATFORM")}
        environment.update(PELORUS_PORT_DIRECTORY=self.directory, **changes)
        return subprocess.run([PELORUS], env=environment, capture_output=True, text=True, timeout=20, check=False)

    def test_says_so_in_one_line(self):
        result = self.run_pelorus()
        self.assertEqual((result.returncode, result.stdout), (69, ""))
        self.assertEqual(result.stderr, "pelorus: there is no display: neither DISPLAY nor WAYLAND_DISPLAY is set; "
                                        '"pelorusctl live" shows the monitor in a terminal\n')

    def test_says_so_when_the_display_is_not_there(self):
        result = self.run_pelorus(DISPLAY=":4711")
        self.assertEqual((result.returncode, result.stdout), (69, ""))
        self.assertEqual(len(result.stderr.splitlines()), 1, result.stderr)
        self.assertIn('DISPLAY is ":4711"', result.stderr)


class WithAPortDirectoryOfOthers(Window):
    def setUp(self):
        super().setUp()
        os.chmod(self.directory, stat.S_IRWXU | stat.S_IWGRP | stat.S_IWOTH)

    def ended(self, status, _, errors):
        self.assertEqual(status, 1)
        self.assertEqual(errors, f"pelorus: port directory {self.directory}: other users can write to it (mode 0722)\n")

    def test_tells_on_the_screen_why_it_does_not_start(self):
        monitor = self.open()
        wait_for("the reason", lambda: any(self.directory in label for label in monitor.labels()))
        self.picture("refused")
        self.assertIsNone(monitor.process.poll())
        monitor.keys("Escape")
        self.ended(*monitor.wait())

    def test_ends_by_a_signal(self):
        monitor = self.open()
        wait_for("the reason", lambda: any(self.directory in label for label in monitor.labels()))
        self.ended(*monitor.end())

    def test_waits_for_nobody_without_a_screen(self):
        result = subprocess.run([PELORUS, "-platform", "offscreen"], capture_output=True, text=True, timeout=20, check=False,
                                env=dict(os.environ, PELORUS_PORT_DIRECTORY=self.directory))
        self.ended(result.returncode, result.stdout, result.stderr)


if __name__ == "__main__":
    main()
