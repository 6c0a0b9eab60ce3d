"""Runs the built programs, whose paths are the first two arguments of a test script."""

import json
import os
import resource
import subprocess
import sys
import tempfile
import unittest

PELORUSCTL, TELEPHONYD = sys.argv[1:3]
LIMIT = 60  # seconds that nothing here takes


def without_core():
    resource.setrlimit(resource.RLIMIT_CORE, (0, 0))


def main():
    without_core()  # programs that are to end by a signal leave none
    unittest.main(argv=sys.argv[:1] + sys.argv[3:])


def ctl(*arguments, **options):
    """Runs pelorusctl to its end."""
    return subprocess.run([PELORUSCTL, *map(str, arguments)], stdin=subprocess.DEVNULL, capture_output=True,
                          text=True, timeout=LIMIT, check=False, **options)


def trees(output):
    """The lines of --json as (time, leaves by path)."""
    return [(line["time"], leaves(line["tree"])) for line in map(json.loads, output.splitlines())]


def leaves(node):
    if "value" in node:
        return {node["path"]: node["value"]}
    return {path: value for child in node["children"] for path, value in leaves(child).items()}


class Scratch(unittest.TestCase):
    """A test with a directory of its own."""

    maxDiff = None

    def setUp(self):
        directory = tempfile.TemporaryDirectory()
        self.addCleanup(directory.cleanup)
        self.directory = directory.name

    def path(self, name):
        return os.path.join(self.directory, name)

    def write(self, name, content):
        with open(self.path(name), "wb") as file:
            file.write(content)
        return self.path(name)

    def read(self, name):
        with open(self.path(name), "rb") as file:
            return file.read()
