"""What the programs are fed: recordings and captures, each made when it is first asked for."""

import functools
import random
import struct
import subprocess

from .gsmtap import write_capture
from .pcap import file_header, record_header

LTE = "Osprey LTE"
USER0 = 147


class Recordings:
    def __init__(self, directory, writer):
        self.directory = directory
        self.writer = writer

    @functools.cache
    def simulated(self, count, *options):
        """Messages of a simulated LTE handset."""
        path = self.directory / f"lte-{count}{''.join(options)}.pcap"
        subprocess.run([self.writer, LTE, str(count), path, *options], check=True)
        return self.read_once(path)

    @functools.cache
    def radio(self, count):
        """A GSMTAP capture."""
        path = self.directory / f"gsmtap-{count}.pcap"
        write_capture(path, count)
        return self.read_once(path)

    @functools.cache
    def neighbours(self, each, count):
        """Reports of so many neighbours each, no two alike one behind the other."""
        path = self.directory / f"neighbours-{each}.pcap"
        choice = random.Random(1)
        pool = [neighbour_report(each, choice) for _ in range(1000)]
        with open(path, "wb", buffering=1 << 20) as file:
            file.write(file_header(USER0))
            for number in range(count):
                message = pool[number % len(pool)]
                file.write(record_header(number / 1000, len(message)) + message)
        return self.read_once(path)

    @functools.cache
    def without_messages(self):
        path = self.directory / "empty.pcap"
        path.write_bytes(file_header(USER0))
        return path

    @staticmethod
    def read_once(path):
        """Into the page cache."""
        path.read_bytes()
        return path


def neighbour_report(count, choice):
    """Log code 0xB180. It tells the number of cells less one, so none is a packet without the cells."""
    cells = b"".join(choice.randbytes(20) for _ in range(count))
    bits = choice.randrange(64) | max(count - 1, 0) << 6
    body = struct.pack("<HQB3xHH", 0xB180, 0, 1, choice.randrange(6000), bits) + cells
    return struct.pack("<BH", 1, len(body) + 2) + body
