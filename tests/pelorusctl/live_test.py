#!/usr/bin/env python3
"""pelorusctl live against a telephony server over real sockets. The scenarios wait for time-outs, so all run at once."""

import concurrent.futures
import glob
import os
import plistlib
import signal
import time
import unittest

from programs import Scratch, ctl, main
from recordings import internal, lte_cell
from stage import PCI, REFRESH, RETRY, SLACK, Stage, expect
from telephony import LOCAL_PORT, REPLY, frame

SCENARIOS = {}


def scenario(function):
    SCENARIOS[function.__name__] = function
    return function


@scenario
def shows_an_update_after_data():
    with Stage("--json") as stage:
        channel = stage.server.channel()
        expect(sorted(channel.start_command["SetOspreyLogCodes"]), [45249, 45250, 45433, 45439, 45440, 45446])
        expect(sorted(channel.start_command["SetCtExtraCodes"]), [0, 1, 2])
        expect(channel.start_command["SetState"], "Streaming")
        channel.send(lte_cell(1))
        channel.send(lte_cell(2))
        sent = time.time()
        expect(stage.update()[PCI], "2")
        assert abs(stage.last_time - sent) < 1, stage.last_time - sent  # of the message, not of the refresh
        channel.send(lte_cell(3), message_id=1)  # of no concern
        stage.expect_silence(REFRESH + 0.5)
        for byte in frame(lte_cell(4)) + frame(b"") + frame(lte_cell(5)):
            channel.data.send(bytes([byte]))
        while stage.update()[PCI] != "5":  # a refresh may have come in between
            pass
        stage.process.send_signal(signal.SIGINT)
        expect(stage.expect_end(0), ("", ""))
        assert not os.path.exists(os.path.join(stage.directory, LOCAL_PORT))


@scenario
def ends_after_so_many_updates():
    with Stage("--count", "2") as stage:
        channel = stage.server.channel()
        channel.send(lte_cell(7))
        time.sleep(REFRESH + 0.3)
        channel.send(lte_cell(8))
        output, errors = stage.expect_end(0)
        expect(errors, "")
        expect([line for line in output.splitlines() if "  Physical Cell ID: " in line and "-" not in line],
               ["      Physical Cell ID: 7", "      Physical Cell ID: 8"])
        expect(output.count("Pelorus\n"), 2)


@scenario
def comes_back_with_its_history_and_saves_it_at_its_end():
    with Stage("--json") as stage:
        channel = stage.server.channel()
        channel.send(lte_cell(1))
        expect(stage.update()[PCI], "1")
        lost = time.monotonic()
        channel.close()
        request = stage.server.request()
        assert request.time - lost < REFRESH + SLACK, request.time - lost
        channel = stage.server.channel(request=request)
        channel.send(lte_cell(2))
        rows = stage.update()
        expect(rows[PCI], "2")
        last = internal(0, b"no property list")
        channel.send(lte_cell(3))
        channel.send(last)
        _, errors = stage.expect_end(-signal.SIGABRT)
        assert "LogCode_0xFF0000::UnknownDataException" in errors, errors
        [path] = glob.glob(os.path.join(stage.directory, "state/pelorus/CrashReporter/PelorusSnapshot-*.pelorus"))
        with open(path, "rb") as file:
            saved = plistlib.load(file)
        expect(saved["Description"], "Recovered after LogCode_0xFF0000::UnknownDataException")
        raw = [entry["DisplayState"] for entry in saved["Data"] if "DisplayState" in entry]
        expect(raw[:2], [lte_cell(1), lte_cell(2)])
        assert raw[2].startswith(lte_cell(3)), raw
        report = ctl("snapshot", path)
        expect(report.stdout.splitlines()[1], "Description: Recovered after LogCode_0xFF0000::UnknownDataException")


@scenario
def cuts_off_who_sends_what_is_no_frame():
    with Stage("--json") as stage:
        for nonsense in (b"\x01\x00\x00\x01" + bytes(12),  # 16 MiB and a byte
                         frame(b"x", kind=3), frame(b"x", kind=0xFFFFFFFF)):
            channel = stage.server.channel()
            channel.send(lte_cell(6))
            channel.data.sendall(nonsense)
            expect(channel.data.recv(1), b"")
            expect(stage.update()[PCI], "6")
            channel.close()


@scenario
def survives_a_server_that_dies_inside_a_frame():
    with Stage("--json") as stage:
        channel = stage.server.channel()
        channel.data.sendall(frame(lte_cell(6))[:-1])
        channel.close()
        channel = stage.server.channel()
        channel.send(lte_cell(8))
        expect(stage.update()[PCI], "8")


@scenario
def keeps_its_display_through_a_change_of_technology():
    with Stage("--json") as stage:
        channel = stage.server.channel()
        channel.send(lte_cell(1))
        stage.update()
        channel.close()
        channel = stage.server.channel("IFX")
        channel.send(plistlib.dumps({"Cell": {"Place": "here"}}))
        expect(stage.update(), {"/Cell": "here"})
        channel.close()
        channel = stage.server.channel("Osprey LTE")
        channel.send(lte_cell(2))
        expect(stage.update()[PCI], "2")


# What a server may do instead of granting a channel; after each the monitor is back 5 s later.

def replies(content):
    return lambda server, request: request.reply(content)


def sends(data):
    return lambda server, request: request.raw(data)


def says_nothing(server, request):
    time.sleep(1)


def replies_late(server, request):
    time.sleep(1.3)
    request.reply({"Error": 0, "RemotePort": "test.Commands"})


def hangs_up(server, request):
    request.close()


def dies_inside_the_reply(server, request):
    request.raw(frame(plistlib.dumps({"Error": 0}), REPLY, request.sequence)[:30])
    request.close()


def answers_the_technology(payload, delay=0.0):
    def answer(server, request):
        channel, sequence = server.answered(request)
        time.sleep(delay)
        if payload is not None:
            try:
                channel.commands.sendall(frame(payload, REPLY, sequence))
            except OSError:  # it waits no longer
                pass
    return answer


FAILURES = {
    "error_1": replies({"Error": 1}), "error_2": replies({"Error": 2}), "error_3": replies({"Error": 3}),
    "a_reply_that_is_no_list": replies(b"hello"), "an_empty_reply": replies(b""),
    "a_reply_without_an_error": replies({"RemotePort": "test.Commands"}),
    "no_port": replies({"Error": 0}), "a_port_that_nobody_has": replies({"Error": 0, "RemotePort": "nobody"}),
    "a_port_outside": replies({"Error": 0, "RemotePort": "../../tmp/x"}),
    "no_reply": says_nothing, "a_late_reply": replies_late, "a_hang_up": hangs_up,
    "a_death_inside_the_reply": dies_inside_the_reply,
    "too_long_a_frame": sends(b"\x01\x00\x00\x01" + bytes(12)), "an_unknown_kind": sends(frame(b"x", kind=9)),
    "an_unknown_technology": answers_the_technology(plistlib.dumps({"GetTechnology": "Osprey 5G"})),
    "a_technology_that_is_no_text": answers_the_technology(plistlib.dumps({"GetTechnology": 4})),
    "an_answer_that_is_no_list": answers_the_technology(b"hello"),
    "no_answer": answers_the_technology(None, 1.0),
    "a_late_answer": answers_the_technology(plistlib.dumps({"GetTechnology": "Osprey LTE"}), 1.3),
}


def comes_back_after(fail):
    with Stage("--json", "--count", "1") as stage:
        first = stage.server.request()
        fail(stage.server, first)
        failed = time.monotonic()
        request = stage.server.request()
        waited = request.time - failed
        assert RETRY - 0.8 < waited < RETRY + SLACK, waited
        stage.server.channel(request=request).send(lte_cell(11))
        expect(stage.update()[PCI], "11")
        stage.expect_end(0)


class LiveTest(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        runs = dict(SCENARIOS, **{"comes_back_after_" + name: lambda fail=fail: comes_back_after(fail)
                                  for name, fail in FAILURES.items()})
        cls.pool = concurrent.futures.ThreadPoolExecutor(len(runs))
        cls.results = {name: cls.pool.submit(run) for name, run in runs.items()}

    @classmethod
    def tearDownClass(cls):
        cls.pool.shutdown()

    def test_every_scenario(self):
        for name, result in self.results.items():
            with self.subTest(name):
                result.result()


class PortDirectoryTest(Scratch):
    def expect_refusal(self, directory):
        run = ctl("live", "--count", "1", env=dict(os.environ, PELORUS_PORT_DIRECTORY=directory))
        self.assertEqual((run.returncode, run.stdout, run.stderr.count("\n")), (1, "", 1))
        self.assertIn(directory, run.stderr)

    def test_one_that_others_can_write_to_is_refused(self):
        os.mkdir(self.path("ports"))
        os.chmod(self.path("ports"), 0o770)
        self.expect_refusal(self.path("ports"))

    def test_what_is_no_directory_is_refused(self):
        self.expect_refusal(self.write("file", b""))
        os.symlink(self.directory, self.path("link"))
        self.expect_refusal(self.path("link"))
        self.expect_refusal(self.path("missing/ports"))

    @unittest.skipUnless(os.geteuid() == 0, "only root can give a directory away")
    def test_one_of_another_user_is_refused(self):
        os.mkdir(self.path("ports"), 0o700)
        os.chown(self.path("ports"), 65534, 65534)
        self.expect_refusal(self.path("ports"))


if __name__ == "__main__":
    main()
