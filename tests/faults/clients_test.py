#!/usr/bin/env python3
"""Many clients at one server, and clients that do not read: everybody gets everything, or the error that is due."""

import os
import plistlib
import resource
import selectors
import signal
import subprocess
import time

from faults import DEADLY, PATIENCE, Live, captured, numbered, numbered_recording, resident, runs
from programs import main
from served import Served
from telephony import LOCAL_PORT, REQUEST, connect, frame, listen, receive

MANY = 50
MOST = 256  # channels that a server has
MESSAGES = 20000
MEGABYTE = 1024  # in kilobytes


class Taker:
    """Takes what a client gets, as fast as it comes, and compares it with a stream that repeats."""

    def __init__(self, client, stream):
        self.client, self.stream = client, stream
        self.place = self.total = 0
        client.data.setblocking(False)

    def take(self):
        piece = self.client.data.recv(1 << 18)
        assert piece, "the server hung up"
        self.total += len(piece)
        while piece:
            part = self.stream[self.place:self.place + len(piece)]
            assert piece[:len(part)] == part, "not what was sent, within the %d bytes so far" % self.total
            piece = piece[len(part):]
            self.place = (self.place + len(part)) % len(self.stream)


def take_all(takers, bytes_each, while_waiting=lambda: None):
    """Until each has taken so many bytes; gives the seconds."""
    began = time.monotonic()
    with selectors.DefaultSelector() as selector:
        for taker in takers:
            if taker.total < bytes_each:
                selector.register(taker.client.data, selectors.EVENT_READ, taker)
        while selector.get_map():
            ready = selector.select(PATIENCE)
            assert ready, "nothing comes"
            for key, _ in ready:
                key.data.take()
                if key.data.total >= bytes_each:
                    selector.unregister(key.fileobj)
            while_waiting()
    return time.monotonic() - began


class Memory:
    """The most that a process had, looked at now and then."""

    def __init__(self, process):
        self.process = process
        self.first = self.most = resident(process)
        self.looks = 0

    def look(self):
        self.looks += 1
        if self.looks % 20 == 0:
            self.most = max(self.most, resident(self.process))

    def growth(self):
        return max(self.most, resident(self.process)) - self.first


class Clients(Served):
    def setUp(self):
        super().setUp()
        _, hard = resource.getrlimit(resource.RLIMIT_NOFILE)
        resource.setrlimit(resource.RLIMIT_NOFILE, (hard, hard))
        self.stream = b"".join(frame(numbered(number)) for number in range(MESSAGES))
        self.recording = self.write("recording", numbered_recording(0, MESSAGES))

    def replay(self, *arguments):
        server = self.serve("--replay", self.recording, "--technology", "Osprey LTE", "--speed", "0", *arguments)
        # What it says of its channels is more than a pipe holds.
        self.addCleanup(subprocess.Popen(["cat"], stdin=server.stderr, stdout=subprocess.DEVNULL).wait)
        self.addCleanup(server.kill)
        return server

    def clients(self, count):
        return [self.client("test.Local%d" % number) for number in range(count)]

    def request_channel(self, name="test.Refused"):
        """The server's answer to one more."""
        directory = self.path("ports")
        if not os.path.exists(os.path.join(directory, name)):
            self.addCleanup(listen(directory, name).close)
        with connect(directory, "io.pelorus.TelephonyServer") as server:
            server.sendall(frame(plistlib.dumps({"CreateLogChannel": name}), REQUEST, 1, 1))
            return plistlib.loads(receive(server)[0])


class ManyClientsTest(Clients):
    def test_fifty_get_everything(self):
        server = self.replay()
        memory = Memory(server)
        takers = [Taker(client, self.stream) for client in self.clients(MANY)]
        for taker in takers:
            taker.client.start()
        take_all(takers, len(self.stream), memory.look)
        for taker in takers:
            self.assertEqual(taker.total, len(self.stream))
            with self.assertRaises(BlockingIOError):  # and nothing else
                taker.client.data.recv(1)
        # Each may have a megabyte that waits to be sent, and as much again while it is moved.
        self.assertLess(memory.growth(), 2 * MANY * MEGABYTE + 10 * MEGABYTE)

    def test_one_more_than_there_can_be_is_refused(self):
        server = self.replay("--loop")
        memory = Memory(server)
        clients = self.clients(MOST)
        for _ in range(3):
            self.assertEqual(self.request_channel(), {"Error": 3})
        live = Live(self.path("ports"))
        self.addCleanup(live.close)
        takers = [Taker(client, self.stream) for client in clients]
        for taker in takers:
            taker.client.start()
        take_all(takers, len(self.stream) // 10, memory.look)
        self.assertEqual((live.process.poll(), live.updates), (None, []))
        clients[7].close()
        live.wait_for_update()  # it tries again on its own
        for taker in takers[8:]:
            taker.take()
        self.assertLess(memory.growth(), 2 * MOST * MEGABYTE + 10 * MEGABYTE)
        live.process.send_signal(signal.SIGTERM)
        self.assertEqual(live.end(), (0, ""))
        self.assertEqual(self.client(LOCAL_PORT).technology(), "Osprey LTE")


class ClientThatDoesNotReadTest(Clients):
    ROUNDS = 8  # of the recording, for those who read

    def test_costs_the_others_nothing(self):
        server = self.replay("--loop")
        idle, *readers = self.clients(4)
        takers = [Taker(client, self.stream) for client in readers]
        for taker in takers:
            taker.client.start()
        memory = Memory(server)
        alone = take_all(takers, self.ROUNDS * len(self.stream))
        idle.start()
        beside = take_all(takers, 2 * self.ROUNDS * len(self.stream), memory.look)
        self.assertLess(beside, 5 * alone + 5)
        # A megabyte waits for the one that does not read, however many the others take.
        self.assertLess(memory.growth(), 8 * MEGABYTE)

        late = Taker(idle, self.stream)
        take_all([late], 3 * len(self.stream))  # it finds all of it, from the first message on

    def test_monitor_that_is_held_loses_nothing(self):
        recording = self.write("deadly", numbered_recording(0, MESSAGES, last=[DEADLY]))
        server = self.serve("--replay", recording, "--technology", "Osprey LTE", "--speed", "0")
        memory = Memory(server)
        live = Live(self.path("ports"))
        self.addCleanup(live.close)
        while "client streaming" not in server.stderr.readline():
            pass
        live.process.send_signal(signal.SIGSTOP)
        taker = Taker(self.client("test.Other"), self.stream + frame(DEADLY))
        taker.client.start()
        take_all([taker], len(taker.stream), memory.look)
        self.assertLess(memory.growth(), 8 * MEGABYTE)
        live.process.send_signal(signal.SIGCONT)
        self.assertEqual(live.end()[0], -signal.SIGABRT)
        self.assertEqual(runs(captured(live.state)), [[0, MESSAGES - 1]])


if __name__ == "__main__":
    main()
