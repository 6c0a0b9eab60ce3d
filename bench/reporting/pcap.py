"""The headers of a pcap file with microseconds."""

import struct

START = 1767225600  # of what is recorded, in seconds since 1970


def file_header(link_type):
    return struct.pack("<IHHiIII", 0xA1B2C3D4, 2, 4, 0, 0, 65535, link_type)


def record_header(seconds, length):
    """`seconds` since the start."""
    microseconds = round(seconds * 1e6)
    return struct.pack("<IIII", START + microseconds // 1000000, microseconds % 1000000, length, length)
