"""pelorusctl live before a telephony server that does what a test says."""

import json
import os
import select
import subprocess
import tempfile

from programs import PELORUSCTL, leaves
from telephony import TelephonyServer

PCI = "/Serving cell/Serving Cell Info/Physical Cell ID"
REFRESH, RETRY, SLACK = 2.0, 5.0, 1.5


class Stage:
    """A directory with a telephony server, and a monitor that runs in it."""

    def __init__(self, *arguments):
        self.scratch = tempfile.TemporaryDirectory()
        self.directory = self.scratch.name
        self.server = TelephonyServer(self.directory)
        self.last_time = None
        environment = dict(os.environ, PELORUS_PORT_DIRECTORY=self.directory,
                           XDG_STATE_HOME=os.path.join(self.directory, "state"))
        self.process = subprocess.Popen([PELORUSCTL, "live", *arguments], env=environment,
                                        stdin=subprocess.DEVNULL, stdout=subprocess.PIPE, stderr=subprocess.PIPE,
                                        bufsize=0)  # or select() would not see what is read ahead

    def __enter__(self):
        return self

    def __exit__(self, *_):
        self.process.kill()
        self.process.communicate()
        self.server.close()
        self.scratch.cleanup()

    def update(self):
        """The next update of --json, which comes within a refresh; its leaves by path."""
        ready, _, _ = select.select([self.process.stdout], [], [], REFRESH + SLACK)
        assert ready, "no update"
        line = json.loads(self.process.stdout.readline())
        self.last_time = line["time"]
        return leaves(line["tree"])

    def expect_silence(self, seconds):
        ready, _, _ = select.select([self.process.stdout], [], [], seconds)
        assert not ready, "an update: %r" % ready[0].readline()

    def expect_end(self, status):
        output, errors = self.process.communicate(timeout=REFRESH + SLACK)
        assert self.process.returncode == status, (self.process.returncode, errors)
        return output.decode(), errors.decode()


def expect(actual, expected):
    assert actual == expected, "%r is not %r" % (actual, expected)
