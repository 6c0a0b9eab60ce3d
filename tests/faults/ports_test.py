#!/usr/bin/env python3
"""Port directories and sockets that are not what they should be, and connections of another user."""

import os
import pathlib
import plistlib
import signal
import stat
import subprocess
import sys
import time
import unittest

from faults import PATIENCE, Live, main_at_once
from programs import TELEPHONYD, ctl
from recordings import lte_cell
from served import Served
from stage import PCI
from telephony import LOCAL_PORT, REQUEST, TelephonyServer, frame, listen

SERVER_PORT = "io.pelorus.TelephonyServer"
NOBODY = 65534
IS_ROOT = os.geteuid() == 0
NOT_ROOT = "only root can act as another user: connections of another user are not tested"


def as_nobody(code, *arguments):
    """Runs Python code as another user."""
    return subprocess.Popen(["setpriv", "--reuid=%d" % NOBODY, "--regid=%d" % NOBODY, "--clear-groups", sys.executable,
                             "-c", code, *arguments], stdin=subprocess.PIPE, stdout=subprocess.PIPE, text=True,
                            cwd="/")


class Ports(Served):
    def setUp(self):
        super().setUp()
        os.chmod(self.directory, 0o755)  # others may look on

    def start_server(self, **environment):
        return subprocess.run([TELEPHONYD, "--simulate", "Osprey LTE"], env=dict(self.environment, **environment),
                              capture_output=True, text=True, timeout=10, check=False)

    def monitor(self):
        live = Live(self.path("ports"), self.path("state"))
        self.addCleanup(live.close)
        return live

    def end_monitor(self, live):
        live.process.send_signal(signal.SIGTERM)
        self.assertEqual(live.end(), (0, ""))


class DirectoryTest(Ports):
    def expect_refusal(self, directory, why, **environment):
        """By the server and by the monitor, in the same words."""
        environment = environment or {"PELORUS_PORT_DIRECTORY": directory}
        server = self.start_server(**environment)
        live = ctl("live", "--count", "1", env=dict(self.environment, **environment))
        for program, run in (("pelorus-telephonyd", server), ("pelorusctl: live", live)):
            self.assertEqual((run.returncode, run.stdout), (1, ""))
            self.assertEqual(run.stderr, "%s: port directory %s: %s\n" % (program, directory, why))

    def test_one_that_others_can_write_to(self):
        for mode in (0o720, 0o702, 0o777, 0o1777):
            os.chmod(self.path("ports"), mode)
            self.expect_refusal(self.path("ports"), "other users can write to it (mode %04o)" % mode)
            self.assertEqual(os.listdir(self.path("ports")), [])
        os.chmod(self.path("ports"), 0o755)  # may be looked into
        self.end(self.serve("--simulate", "Osprey LTE"))

    @unittest.skipUnless(IS_ROOT, "only root can give a directory away")
    def test_one_of_another_user(self):
        os.chown(self.path("ports"), NOBODY, NOBODY)
        self.expect_refusal(self.path("ports"), "belongs to user 65534, not to user 0")

    def test_symbolic_links_and_files_in_its_place(self):
        os.symlink("ports", self.path("link"))
        self.expect_refusal(self.path("link"), "is a symbolic link")
        os.symlink("missing", self.path("dangling"))
        self.expect_refusal(self.path("dangling"), "is a symbolic link")
        self.expect_refusal(self.write("file", b""), "is not a directory")
        self.expect_refusal(self.path("none/ports"), "cannot be made: No such file or directory")

    def test_is_made_for_its_user_alone_wherever_it_is(self):
        os.rmdir(self.path("ports"))
        umask = os.umask(0)
        self.addCleanup(os.umask, umask)
        server = self.serve("--simulate", "Osprey LTE")
        self.assertEqual(stat.S_IMODE(os.stat(self.path("ports")).st_mode), 0o700)
        self.assertEqual(stat.S_IMODE(os.stat(self.path("ports/" + SERVER_PORT)).st_mode), 0o600)
        client = self.client()
        client.start()
        [port] = [name for name in os.listdir(self.path("ports")) if name != SERVER_PORT]
        self.assertEqual(stat.S_IMODE(os.stat(self.path("ports/" + port)).st_mode), 0o600)
        client.close()
        self.end(server)
        del self.environment["PELORUS_PORT_DIRECTORY"]
        os.mkdir(self.path("pelorus"))
        os.chmod(self.path("pelorus"), 0o777)
        self.expect_refusal(self.path("pelorus"), "other users can write to it (mode 0777)",
                            XDG_RUNTIME_DIR=self.directory)


class SocketTest(Ports):
    def test_what_is_no_socket_stays_where_it_is(self):
        place = self.path("ports/" + SERVER_PORT)
        elsewhere = self.write("elsewhere", b"untouched")
        for put in (lambda: pathlib.Path(place).write_bytes(b"untouched"), lambda: os.symlink(elsewhere, place),
                    lambda: os.symlink("nowhere", place), lambda: os.mkfifo(place), lambda: os.mkdir(place)):
            put()
            before = os.lstat(place)
            run = self.start_server()
            self.assertEqual((run.returncode, run.stdout), (1, ""))
            self.assertEqual(run.stderr, "pelorus-telephonyd: %s: is in the way and not a socket\n" % place)
            self.assertTrue(os.path.samestat(os.lstat(place), before))
            self.assertEqual(self.read("elsewhere"), b"untouched")
            if stat.S_ISDIR(before.st_mode):
                os.rmdir(place)
            else:
                os.unlink(place)
        self.end(self.serve("--simulate", "Osprey LTE"))

    def test_monitor_waits_until_nothing_is_in_its_way(self):
        place = self.path("ports/" + LOCAL_PORT)
        os.symlink("nowhere", place)
        self.serve("--simulate", "Osprey LTE", "--rate", "100")
        live = self.monitor()
        time.sleep(1)
        self.assertEqual((live.process.poll(), live.updates), (None, []))
        self.assertTrue(os.path.islink(place))
        os.unlink(place)
        live.wait_for_update()
        self.end_monitor(live)
        self.assertFalse(os.path.exists(place))

    def test_monitor_waits_for_a_server_that_is_one(self):
        place = self.path("ports/" + SERVER_PORT)
        pathlib.Path(place).write_bytes(b"no socket")
        live = self.monitor()
        time.sleep(1)
        self.assertEqual((live.process.poll(), live.updates), (None, []))
        self.assertEqual(pathlib.Path(place).read_bytes(), b"no socket")
        os.unlink(place)
        self.serve("--simulate", "Osprey LTE", "--rate", "100")
        live.wait_for_update()
        self.end_monitor(live)

    def test_stale_sockets_are_replaced_and_live_ones_kept(self):
        for name in (SERVER_PORT, LOCAL_PORT):
            listen(self.path("ports"), name).close()
        server = self.serve("--simulate", "Osprey LTE", "--rate", "100")
        live = self.monitor()
        live.wait_for_update()
        second = self.monitor()  # its local port's name is taken
        time.sleep(3)
        self.assertEqual((second.process.poll(), second.updates), (None, []))
        live.wait_for_update()
        self.end_monitor(live)
        second.wait_for_update()
        self.end_monitor(second)
        self.end(server)


@unittest.skipUnless(IS_ROOT, NOT_ROOT)
class OtherUserTest(Ports):
    def setUp(self):
        super().setUp()
        os.chmod(self.path("ports"), 0o755)

    def others_request(self):
        """What becomes of another user's request for a channel: "refused", or what the server answers."""
        code = ("import socket, sys\n"
                "peer = socket.socket(socket.AF_UNIX)\n"
                "peer.settimeout(10)\n"
                "try:\n"
                "    peer.connect(sys.argv[1])\n"
                "    peer.sendall(bytes.fromhex(sys.argv[2]))\n"
                "    print('answered', len(peer.recv(100)))\n"
                "except (PermissionError, ConnectionResetError, BrokenPipeError) as error:\n"
                "    print(type(error).__name__)\n")
        request = frame(plistlib.dumps({"CreateLogChannel": "test.Other"}), REQUEST, 1, 1)
        process = as_nobody(code, self.path("ports/" + SERVER_PORT), request.hex())
        return process.communicate(timeout=PATIENCE)[0].strip()

    def test_cannot_reach_the_server(self):
        server = self.serve("--simulate", "Osprey LTE")
        self.assertEqual(self.others_request(), "PermissionError")  # the socket's mode
        os.chmod(self.path("ports/" + SERVER_PORT), 0o666)
        self.assertIn(self.others_request(), ("answered 0", "ConnectionResetError", "BrokenPipeError"))  # hung up on
        self.assertEqual(self.client().technology(), "Osprey LTE")
        server.send_signal(signal.SIGTERM)
        self.assertEqual(server.wait(10), 0)
        self.assertNotIn("test.Other", server.stderr.read())

    def test_cannot_send_the_monitor_messages(self):
        server = TelephonyServer(self.path("ports"))
        self.addCleanup(server.close)
        live = self.monitor()
        channel = server.channel()
        channel.send(lte_cell(1))
        live.wait_for_cell(1)
        os.chmod(self.path("ports/" + LOCAL_PORT), 0o666)
        code = ("import socket, sys\n"
                "peer = socket.socket(socket.AF_UNIX)\n"
                "peer.settimeout(10)\n"
                "peer.connect(sys.argv[1])\n"
                "try:\n"
                "    peer.sendall(bytes.fromhex(sys.argv[2]))\n"
                "    print('read', len(peer.recv(1)))\n"
                "except (ConnectionResetError, BrokenPipeError):\n"
                "    print('read', 0)\n")
        other = as_nobody(code, self.path("ports/" + LOCAL_PORT), frame(lte_cell(2)).hex())
        self.assertEqual(other.communicate(timeout=PATIENCE)[0], "read 0\n")  # hung up on
        channel.send(lte_cell(3))
        live.wait_for_cell(3)
        self.assertNotIn("2", [update[2][PCI] for update in live.updates])
        self.end_monitor(live)

    def test_cannot_pose_as_the_server(self):
        os.mkdir(self.path("theirs"))
        os.chown(self.path("theirs"), NOBODY, NOBODY)
        code = ("import os, socket, sys\n"
                "port = socket.socket(socket.AF_UNIX)\n"
                "port.bind(sys.argv[1])\n"
                "os.chmod(sys.argv[1], 0o666)\n"
                "port.listen()\n"
                "print('listening', flush=True)\n"
                "peer = port.accept()[0]\n"
                "peer.settimeout(10)\n"
                "print('read', len(peer.recv(100)), flush=True)\n"
                "sys.stdin.read()\n")
        other = as_nobody(code, self.path("theirs/port"))
        self.addCleanup(other.communicate)
        self.addCleanup(other.kill)
        self.assertEqual(other.stdout.readline(), "listening\n")
        os.symlink(self.path("theirs/port"), self.path("ports/" + SERVER_PORT))  # as nobody but we could
        live = self.monitor()
        self.assertEqual(other.stdout.readline(), "read 0\n")  # hung up on, and told nothing
        self.assertIsNone(live.process.poll())
        os.unlink(self.path("ports/" + SERVER_PORT))
        self.serve("--simulate", "Osprey LTE", "--rate", "100")
        live.wait_for_update()
        self.end_monitor(live)


if __name__ == "__main__":
    main_at_once()
