"""Log messages, and the files that carry them, built by offset."""

import plistlib
import struct

START = 1336123800  # 2012-05-04 09:30:00 UTC


def message(code, length, fields=(), log_type=1, tail=b""):
    """A message of so many bytes and the tail, with (offset, struct format, value) fields."""
    data = bytearray(length) + tail
    struct.pack_into("<BHH", data, 0, log_type, len(data) - 1, code)
    for offset, form, value in fields:
        struct.pack_into("<" + form, data, offset, value)
    return bytes(data)


def internal(code, payload):
    """A message of the telephony server itself."""
    return message(code, 13, log_type=0xFF, tail=payload)


def lte_cell(pci, length=38):
    """LTE serving cell configuration."""
    return message(0xB0C2, length, [
        (14, "H", pci), (16, "H", 1575), (18, "H", 19575), (20, "B", 50), (21, "B", 7),
        (22, "I", 0xFFFFFFFE), (26, "H", 4660), (28, "I", 3)])


LTE_ANTENNAS = message(0xB0C1, 22, [(20, "B", 2)])


def pcap(messages, nano=False, byte_order="<", link_type=147):
    """A pcap file of (time in nanoseconds, message)."""
    magic, unit = (0xA1B23C4D, 1) if nano else (0xA1B2C3D4, 1000)
    parts = [struct.pack(byte_order + "IHHiIII", magic, 2, 4, 0, 0, 262144, link_type)]
    for time, data in messages:
        parts.append(struct.pack(byte_order + "IIII", time // 10**9, time % 10**9 // unit, len(data), len(data)))
        parts.append(data)
    return b"".join(parts)


def pcapng(messages):
    """A pcapng file with times in nanoseconds."""
    def block(kind, body):
        body += bytes(-len(body) % 4)
        return struct.pack("<II", kind, len(body) + 12) + body + struct.pack("<I", len(body) + 12)

    parts = [block(0x0A0D0D0A, struct.pack("<IHHq", 0x1A2B3C4D, 1, 0, -1)),
             block(1, struct.pack("<HHI", 147, 0, 262144) + struct.pack("<HHB3xHH", 9, 1, 9, 0, 0))]
    for time, data in messages:
        parts.append(block(6, struct.pack("<IIIII", 0, time >> 32, time & 0xFFFFFFFF, len(data), len(data)) + data))
    return b"".join(parts)


def snapshot(buffers, date="2012-05-04 09:30:00 +0000"):
    """A snapshot file with one entry a buffer of raw messages."""
    return plistlib.dumps({
        "Timestamp": date, "Description": "by hand",
        "Data": [{"DisplayState": raw, "Display": {"A": "1"}, "ExtraInfo": {}, "Date": date,
                  "Description": "Snapshot (%s)" % date} for raw in buffers]})


def dlf(messages):
    """A DLF file: a version report, then each message's record."""
    report = bytearray(161)
    struct.pack_into("<HH", report, 0, 161, 0x1FFD)
    struct.pack_into("<HH", report, 12, 1, 1)
    struct.pack_into("<I", report, 81, START)
    return bytes(report) + b"".join(data[1:] for data in messages)


def recorded(content):
    """The messages of a pcap file in this machine's byte order."""
    offset, messages = 24, []
    while offset < len(content):
        length = struct.unpack_from("<I", content, offset + 8)[0]
        messages.append(content[offset + 16:offset + 16 + length])
        offset += 16 + length
    return messages
