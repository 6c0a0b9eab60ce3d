"""Telephony servers that run."""

import os
import signal
import subprocess

from client import Client
from programs import TELEPHONYD, Scratch
from telephony import LOCAL_PORT


class Served(Scratch):
    """A test with telephony servers in a port directory of its own."""

    def setUp(self):
        super().setUp()
        os.mkdir(self.path("ports"), 0o700)
        self.environment = dict(os.environ, PELORUS_PORT_DIRECTORY=self.path("ports"))

    def serve(self, *arguments):
        server = subprocess.Popen([TELEPHONYD, *arguments], env=self.environment, stderr=subprocess.PIPE, text=True)
        self.addCleanup(server.stderr.close)
        self.addCleanup(server.wait)
        self.addCleanup(server.kill)
        self.assertEqual(server.stderr.readline(),
                         "listening on %s/io.pelorus.TelephonyServer\n" % self.path("ports"))
        return server

    def end(self, server, number=signal.SIGTERM):
        server.send_signal(number)
        self.assertEqual(server.wait(10), 0)
        self.assertEqual(os.listdir(self.path("ports")), [])

    def client(self, name=LOCAL_PORT):
        client = Client(self.path("ports"), name)
        self.addCleanup(client.close)
        return client
