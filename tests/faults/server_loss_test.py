#!/usr/bin/env python3
"""A telephony server that is killed, held, or started anew while it streams: the monitor comes back, and loses nothing
of what reached it. The scenarios wait for time-outs, so all run at once."""

import contextlib
import os
import signal
import subprocess
import tempfile
import time
import unittest

from faults import DEADLY, MILLION, Live, Scenarios, captured, numbered, numbered_recording, runs
from programs import TELEPHONYD, main
from stage import PCI, REFRESH, RETRY, Stage, expect
from telephony import frame
from terminal import Terminal

SCENARIOS = Scenarios()
RATE = 1000  # messages a second
LATE = 10  # seconds that a busy machine may add


class Place:
    """A port directory, and the servers and monitors in it."""

    def __init__(self):
        self.stack = contextlib.ExitStack()
        self.directory = self.stack.enter_context(tempfile.TemporaryDirectory())
        self.recordings = 0

    def __enter__(self):
        return self

    def __exit__(self, *_):
        self.stack.close()

    def serve(self, content, *arguments):
        """A server that replays a recording."""
        self.recordings += 1
        recording = os.path.join(self.directory, "recording%d" % self.recordings)
        with open(recording, "wb") as file:
            file.write(content)
        server = subprocess.Popen([TELEPHONYD, "--replay", recording, "--technology", "Osprey LTE", *arguments],
                                  env=dict(os.environ, PELORUS_PORT_DIRECTORY=self.directory),
                                  stderr=subprocess.PIPE, text=True)
        self.stack.callback(server.stderr.close)
        self.stack.callback(server.wait)
        self.stack.callback(server.kill)
        assert "listening on" in server.stderr.readline()
        return server

    def stream(self, first):
        """A server that streams numbered messages, for longer than any scenario takes."""
        return self.serve(numbered_recording(first, 25 * RATE, RATE))

    def last_words(self, first, count):
        """A server that streams so many messages, and then the one that ends the monitor."""
        return self.serve(numbered_recording(first, count, last=[DEADLY]), "--speed", "0")

    def live(self):
        live = Live(self.directory)
        self.stack.callback(live.close)
        return live


def kill(server):
    server.kill()
    server.wait()


def expect_capture(live, last_run):
    """The monitor has ended by DEADLY; what it captured has no gaps, and ends with that run. Gives the runs."""
    status, errors = live.end()
    expect(status, -signal.SIGABRT)
    assert "LogCode_0xFF0000::UnknownDataException" in errors, errors
    found = runs(captured(live.state))
    expect(found[-1], last_run)
    return found


@SCENARIOS.add
def killed_under_load():
    with Place() as place:
        server = place.stream(0)
        live = place.live()
        live.wait_for_update()
        kill(server)
        time.sleep(REFRESH + 1)  # the attempt to come back at once finds nobody
        place.last_words(MILLION, 5000)
        first, last = expect_capture(live, [MILLION, MILLION + 4999])
        expect(first[0], 0)
        assert first[1] > RATE / 2, (first, last)


@SCENARIOS.add
def killed_while_the_monitor_is_held():
    with Stage("--json") as stage:
        channel = stage.server.channel()
        channel.send(numbered(0))
        expect(stage.update()[PCI], "0")
        stage.process.send_signal(signal.SIGSTOP)
        sent = 1
        channel.data.setblocking(False)
        with contextlib.suppress(BlockingIOError):  # until the socket is full
            while True:
                whole = frame(numbered(sent))
                assert channel.data.send(whole) == len(whole)
                sent += 1
        channel.close()
        time.sleep(REFRESH + 0.5)  # its next refresh is overdue, so it notices the loss before it reads the rest
        stage.process.send_signal(signal.SIGCONT)
        channel = stage.server.channel()
        channel.send(DEADLY)
        stage.expect_end(-signal.SIGABRT)
        assert sent > 100, sent
        expect(runs(captured(os.path.join(stage.directory, "state"))), [[0, sent - 1]])


@SCENARIOS.add
def held_for_longer_than_the_time_outs_while_it_streams():
    with Place() as place:
        server = place.stream(0)
        live = place.live()
        live.wait_for_update()
        server.send_signal(signal.SIGSTOP)
        time.sleep(2 * REFRESH + 0.5)
        count = len(live.updates)
        time.sleep(REFRESH)
        expect(len(live.updates), count)  # nothing came, so nothing is shown anew
        expect(live.process.poll(), None)
        server.send_signal(signal.SIGCONT)
        live.wait_for_update(count)
        kill(server)
        expect([line for line in server.stderr if ": client connected," in line],
               ["Osprey LTE: channel 1: client connected, io.pelorus.BasebandStateReport.LogChannel\n"])
        place.last_words(MILLION, 10)
        expect(len(expect_capture(live, [MILLION, MILLION + 9])), 2)  # and no message was left out while it was held


@SCENARIOS.add
def held_while_the_monitor_starts():
    with Place() as place:
        server = place.last_words(0, 5000)
        server.send_signal(signal.SIGSTOP)
        live = place.live()
        time.sleep(RETRY / 2)  # longer than both time-outs of a request
        expect((live.process.poll(), live.updates), (None, []))
        server.send_signal(signal.SIGCONT)
        expect(expect_capture(live, [0, 4999]), [[0, 4999]])  # the request that nobody waits for streams nothing


@SCENARIOS.add
def started_anew_under_load_again_and_again():
    with Place() as place:
        server = place.stream(0)
        live = place.live()
        for round_ in range(1, 3):
            live.wait_for_cell(round_ - 1)
            server.terminate()
            expect(server.wait(LATE), 0)
            server = place.stream(round_ * MILLION)
        live.wait_for_cell(2)
        kill(server)
        place.last_words(3 * MILLION, 10)
        found = expect_capture(live, [3 * MILLION, 3 * MILLION + 9])
        # The first displays are no longer among the five; each run begins with its server, and is whole.
        assert len(found) >= 2, found
        for first, last in found[1:]:
            expect(first % MILLION, 0)
            assert last > first, found


@SCENARIOS.add
def says_that_it_is_connecting_meanwhile():
    with Place() as place:
        server = place.stream(0)
        terminal = Terminal(place.directory)
        place.stack.callback(terminal.close)
        terminal.wait_for(terminal.shows("Updated "), REFRESH + LATE)
        kill(server)
        terminal.wait_for(terminal.shows("Connecting..."), REFRESH + LATE)
        server = place.stream(MILLION)
        terminal.wait_for(terminal.shows("Updated "), RETRY + REFRESH + LATE)


class ServerLossTest(unittest.TestCase):
    def test_every_scenario(self):
        SCENARIOS.run(self)


if __name__ == "__main__":
    main()
