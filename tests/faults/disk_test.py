#!/usr/bin/env python3
"""Disks that are full or must not be written to, under everything that writes: what was good stays, the error names the
file, and streaming goes on."""

import contextlib
import os
import resource
import signal
import subprocess

from faults import DEADLY, Live, main_at_once, numbered, saved
from programs import PELORUSCTL, TELEPHONYD, ctl
from recordings import START, lte_cell, pcap, recorded
from served import Served

ROOM = 256 * 1024  # bytes of the small disk
FULL = "No space left on device"
CELLS = 10000  # messages whose snapshot is larger than the small disk


def small_files():
    """No file of the program grows beyond this: what is left of a full disk where none can be mounted."""
    signal.signal(signal.SIGXFSZ, signal.SIG_IGN)
    resource.setrlimit(resource.RLIMIT_FSIZE, (ROOM, ROOM))


class Disk(Served):
    def setUp(self):
        super().setUp()
        self.recording = self.write("recording", pcap((START * 10**9 + number * 10**6, lte_cell(number % 504))
                                                      for number in range(CELLS)))

    def mount(self, read_only=False):
        """A small disk of its own, or the test is left out aloud."""
        disk = self.path("disk")
        os.makedirs(disk, exist_ok=True)
        options = "size=%d%s" % (ROOM, ",ro" if read_only else "")
        done = subprocess.run(["mount", "-t", "tmpfs", "-o", options, "tmpfs", disk], capture_output=True, text=True,
                              check=False)
        if done.returncode != 0:
            self.skipTest("no disk can be mounted here: " + done.stderr.strip())
        self.addCleanup(subprocess.run, ["umount", "-l", disk], check=True)
        return disk

    def make_read_only(self, disk):
        subprocess.run(["mount", "-o", "remount,ro", disk], check=True)

    def fill(self, disk):
        """Leaves no byte; further files can still be named."""
        with open(os.path.join(disk, "filler"), "wb", buffering=0) as file, contextlib.suppress(OSError):
            while True:
                file.write(bytes(4096))

    def expect_failure(self, run, file, why):
        self.assertEqual((run.returncode, run.stdout), (1, ""))
        self.assertEqual(run.stderr, "pelorusctl: %s: %s\n" % (file, why))

    def decode_to(self, file, **options):
        run = ctl("decode", "--technology", "Osprey LTE", "--save", file, self.recording, **options)
        self.assertIn("Physical Cell ID: ", run.stdout)  # shown all the same
        run.stdout = ""
        return run

    def old_file(self, disk, name="old"):
        with open(os.path.join(disk, name), "wb") as file:
            file.write(b"a good one")
        return file.name

    def expect_old(self, file):
        with open(file, "rb") as content:
            self.assertEqual(content.read(), b"a good one")
        self.assertEqual(sorted(set(os.listdir(os.path.dirname(file))) - {"filler"}), [os.path.basename(file)])


class SavingTest(Disk):
    def snapshot(self):
        """A snapshot with a DLF file that is larger than the small disk."""
        file = self.path("snapshot")
        self.assertEqual(self.decode_to(file).returncode, 0)
        return file

    def test_decode_save_on_a_full_disk_leaves_the_old_file(self):
        old = self.old_file(self.mount())
        self.expect_failure(self.decode_to(old), old, FULL)
        self.expect_old(old)
        self.fill(self.path("disk"))
        self.expect_failure(self.decode_to(old), old, FULL)
        self.expect_old(old)

    def test_decode_save_where_nothing_may_be_written(self):
        disk = self.mount()
        old = self.old_file(disk)
        self.make_read_only(disk)
        self.expect_failure(self.decode_to(old), old, "Read-only file system")
        self.expect_old(old)
        new = os.path.join(disk, "new")
        self.expect_failure(self.decode_to(new), new, "Read-only file system")

    def test_decode_save_beyond_a_limit(self):
        os.mkdir(self.path("disk"))
        old = self.old_file(self.path("disk"))
        new = self.path("disk/new")
        for file in (old, new):
            self.expect_failure(self.decode_to(file, preexec_fn=small_files), file, "File too large")
            self.expect_old(old)  # and of the new one nothing is left

    def test_extracted_dlf_on_a_full_disk_leaves_the_old_file(self):
        snapshot = self.snapshot()
        old = self.old_file(self.mount())
        run = ctl("snapshot", "--extract-dlf", old, snapshot)
        run.stdout = ""
        self.expect_failure(run, old, FULL)
        self.expect_old(old)
        self.make_read_only(self.path("disk"))
        run = ctl("snapshot", "--extract-dlf", old, snapshot)
        run.stdout = ""
        self.expect_failure(run, old, "Read-only file system")
        self.expect_old(old)

    def test_extracted_dlf_beyond_a_limit(self):
        snapshot = self.snapshot()
        os.mkdir(self.path("disk"))
        old = self.old_file(self.path("disk"))
        run = ctl("snapshot", "--extract-dlf", old, snapshot, preexec_fn=small_files)
        run.stdout = ""
        self.expect_failure(run, old, "File too large")
        self.expect_old(old)
        self.assertEqual(ctl("snapshot", "--extract-dlf", old, snapshot).returncode, 0)
        with open(self.recording, "rb") as recording, open(old, "rb") as extracted:
            self.assertEqual(extracted.read()[161:], b"".join(recorded(recording.read()))[1:])

    def test_files_that_take_nothing(self):
        self.expect_failure(self.decode_to("/dev/full"), "/dev/full", FULL)
        run = ctl("decode", "--technology", "Osprey LTE", "--system-log", "/dev/full", self.recording)
        self.assertEqual(run.returncode, 1)
        self.assertEqual(run.stderr, "pelorusctl: /dev/full: %s\n" % FULL)


class LiveTest(Disk):
    def monitor(self, state=None):
        live = Live(self.path("ports"), state)
        self.addCleanup(live.close)
        return live

    def serve_deadly(self):
        """A server whose last message ends the monitor."""
        content = pcap((START * 10**9, data) for data in [*map(numbered, range(CELLS)), DEADLY])
        return self.serve("--replay", self.write("deadly", content), "--technology", "Osprey LTE", "--speed", "0")

    def expect_end(self, live, place, why):
        status, errors = live.end()
        self.assertEqual(status, -signal.SIGABRT)
        self.assertRegex(errors, r"(?m)^pelorusctl: ended by LogCode_0xFF0000::UnknownDataException; what was captured "
                                 r"cannot be saved: %s/pelorus/CrashReporter/PelorusSnapshot-\d+\.pelorus: %s$"
                         % (place, why))

    def test_recovered_snapshot_on_a_full_disk(self):
        disk = self.mount()
        reports = os.path.join(disk, "pelorus/CrashReporter")
        os.makedirs(reports)
        old = self.old_file(reports, "PelorusSnapshot-1336123800.pelorus")
        self.serve_deadly()
        self.expect_end(self.monitor(disk), disk, FULL)
        self.expect_old(old)

    def test_recovered_snapshot_where_nothing_may_be_written(self):
        disk = self.mount()
        os.makedirs(os.path.join(disk, "pelorus/CrashReporter"))
        self.make_read_only(disk)
        self.serve_deadly()
        self.expect_end(self.monitor(disk), disk, "Read-only file system")

    def test_recovered_snapshot_where_there_is_room(self):
        self.serve_deadly()
        live = self.monitor()
        status, errors = live.end()
        self.assertEqual(status, -signal.SIGABRT)
        self.assertIn("what was captured is in %s/pelorus/CrashReporter\n" % live.state, errors)
        self.assertEqual(saved(live.state)["Description"], "Recovered after LogCode_0xFF0000::UnknownDataException")

    def test_output_that_takes_nothing_ends_it_at_once(self):
        for arguments in ([], ["--json"]):
            server = self.serve("--simulate", "Osprey LTE", "--rate", "100")
            with open("/dev/full", "wb") as full:
                run = subprocess.run([PELORUSCTL, "live", *arguments], env=self.environment, stdin=subprocess.DEVNULL,
                                     stdout=full, stderr=subprocess.PIPE, text=True, timeout=20, check=False)
            self.assertEqual((run.returncode, run.stderr), (1, "pelorusctl: standard output: %s\n" % FULL))
            self.end(server)


class RecordingTest(Disk):
    def expect_cut(self, file, why, **options):
        """A server streams on when its recording ends, says so once, and its status tells in the end."""
        server = subprocess.Popen([TELEPHONYD, "--simulate", "Osprey LTE", "--rate", "20000", "--record", file],
                                  env=self.environment, stderr=subprocess.PIPE, text=True, **options)
        self.addCleanup(server.stderr.close)
        self.addCleanup(server.wait)
        self.addCleanup(server.kill)
        self.assertIn("listening on", server.stderr.readline())
        client = self.client()
        client.start()
        line = ""
        received = []
        while "cannot be written" not in line:
            received += client.messages(1000)
            line = server.stderr.readline()
        self.assertEqual(line, "%s: cannot be written any more, the recording ends here: %s\n" % (file, why))
        received += client.messages(20000)  # streaming goes on
        client.close()
        server.send_signal(signal.SIGTERM)
        self.assertEqual(server.wait(10), 1)
        self.assertNotIn("cannot be written", server.stderr.read())
        self.assertEqual(os.listdir(self.path("ports")), [])
        return received

    def expect_start(self, file, received):
        """The recording holds the first messages, and perhaps half of one more."""
        with open(file, "rb") as content:
            whole = recorded(content.read())
        self.assertGreater(len(whole), 100)
        self.assertEqual(whole[:-1], received[:len(whole) - 1])
        run = ctl("decode", "--technology", "Osprey LTE", file)
        self.assertIn("Physical Cell ID: ", run.stdout)

    def test_on_a_full_disk(self):
        file = os.path.join(self.mount(), "record")
        self.expect_start(file, self.expect_cut(file, FULL))

    def test_beyond_a_limit(self):
        file = self.path("record")
        self.expect_start(file, self.expect_cut(file, "File too large", preexec_fn=small_files))

    def test_where_nothing_may_be_written(self):
        file = os.path.join(self.mount(read_only=True), "record")
        run = subprocess.run([TELEPHONYD, "--simulate", "Osprey LTE", "--record", file], env=self.environment,
                             capture_output=True, text=True, timeout=10, check=False)
        self.assertEqual((run.returncode, run.stdout), (1, ""))
        self.assertEqual(run.stderr, "pelorus-telephonyd: %s: Read-only file system\n" % file)
        self.assertEqual(os.listdir(self.path("ports")), [])

    def test_on_a_file_that_takes_nothing(self):
        self.expect_cut("/dev/full", FULL)


if __name__ == "__main__":
    main_at_once()
