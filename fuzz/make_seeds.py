#!/usr/bin/env python3
"""Makes the seeds of the fuzzers' corpora from the recordings in resources/samples, and some by hand.

Usage: make_seeds.py PELORUSCTL
Writes fuzz/corpus/NAME/seed-*; what else is in there (findings, for example) stays.
"""

import datetime
import pathlib
import plistlib
import re
import struct
import subprocess
import sys
import tempfile

ROOT = pathlib.Path(__file__).resolve().parent.parent
CORPUS = ROOT / "fuzz" / "corpus"
TECHNOLOGIES = {"LTE": "lte", "GSM": "gsm", "UTRAN2": "utran", "CDMA": "cdma", "IFX": "ifx"}
NAMES = ["Osprey LTE", "Osprey GSM", "Osprey UTRAN2", "Osprey CDMA", "IFX"]  # as Recording.cpp counts them
MESSAGE, FRAMED, PREFIXED, REFRESH, RESTART = range(5)  # Generator.cpp's operations


def write(fuzzer, name, content):
    folder = CORPUS / fuzzer
    folder.mkdir(parents=True, exist_ok=True)
    (folder / f"seed-{name}").write_bytes(bytes(content))


def messages_of(recording):
    """The messages of a pcap file of this byte order."""
    content = recording.read_bytes()
    place = 24
    while place < len(content):
        length = struct.unpack_from("<I", content, place + 8)[0]
        yield content[place + 16:place + 16 + length]
        place += 16 + length


def code_of(message):
    packet = message[2:] if message[0] == 0x81 else message
    return struct.unpack_from("<H", packet, 3)[0] | (0xFF0000 if packet[0] == 0xFF else 0)


def by_code(messages, most):
    """Of each log code the messages that differ most in length."""
    chosen = {}
    for message in messages:
        chosen.setdefault(code_of(message), []).append(message)
    for code, all_of_it in chosen.items():
        ordered = sorted(all_of_it, key=len)
        chosen[code] = list(dict.fromkeys([ordered[0], ordered[-1], all_of_it[len(all_of_it) // 2]]))[:most]
    return chosen


def operation(kind, message=b""):
    return bytes([kind]) + (struct.pack("<H", len(message)) + message if kind < REFRESH else b"")


def generator_seeds():
    for fuzzer, sample in TECHNOLOGIES.items():
        messages = list(messages_of(ROOT / "resources" / "samples" / f"{sample}.pcap"))
        if fuzzer == "IFX":
            for index, message in enumerate(messages[::len(messages) // 3][:3]):
                write(fuzzer, f"message-{index}", bytes([3]) + operation(MESSAGE, message) + operation(REFRESH))
            for name, text in LISTS.items():
                write(fuzzer, name, bytes([0xE0]) + operation(MESSAGE, text))
            continue
        everything = b""
        for code, packets in by_code(messages, 3).items():
            first = bytes([3]) + b"".join(operation(FRAMED, packet) + operation(REFRESH) for packet in packets)
            write(fuzzer, f"{code:04X}", first)
            everything += operation(FRAMED, packets[0])
        write(fuzzer, "everything", bytes([0xE0]) + everything[:6000])
        write(fuzzer, "restart", bytes([1]) + everything[:3000] + operation(RESTART) + operation(REFRESH)
              + operation(RESTART))
        unreadable = bytes([0xFF, 20, 0, 0, 0]) + bytes(8) + b"no list "
        write(fuzzer, "unreadable-files", bytes([2]) + operation(PREFIXED, unreadable))


def plain(text):
    """An XML property list without its document type."""
    return re.sub(rb"<!DOCTYPE[^>]*>\n?", b"", text)


def xml(body, head='<?xml version="1.0" encoding="UTF-8"?>\n'):
    return f'{head}<plist version="1.0">{body}</plist>'.encode()


def binary_list(objects):
    offsets, content = [], b"bplist00"
    for item in objects:
        offsets.append(len(content))
        content += item
    table = len(content)
    content += b"".join(struct.pack(">H", offset) for offset in offsets)
    return content + bytes(6) + bytes([2, 1]) + struct.pack(">QQQ", len(objects), 0, table)


def shared_references(levels, width):
    """A binary list of arrays whose elements are all the next array: width to the power of levels values."""
    objects = [bytes([0xA0 | width]) + bytes([level + 1] * width) for level in range(levels)] + [b"\x51a"]
    return binary_list(objects)


def long_paths(levels, key_length, elements):
    """A binary list of dictionaries in one another, in the last a long array: each element has a long path."""
    key, other, text, array = range(levels, levels + 4)
    objects = [bytes([0xD2, key, other, level + 1 if level + 1 < levels else array, text]) for level in range(levels)]
    objects += [b"\x5F\x11" + struct.pack(">H", key_length) + b"k" * key_length, b"\x51o", b"\x50",
                b"\xAF\x11" + struct.pack(">H", elements) + bytes([text]) * elements]
    return binary_list(objects)


MIXED = {
    "text": "Grüße & <Ümlaute> \U0001F4F6",
    "number": -7, "large": 2**63, "real": 1.5, "truth": True, "when": datetime.datetime(2012, 5, 4, 9, 30),
    "bytes": b"\x00\x01\xff" * 7, "list": [1, [], {}, "x" * 20], "uid": plistlib.UID(5),
}
XML_MIXED = {key: value for key, value in MIXED.items() if key != "uid"}
LISTS = {
    "xml-mixed": plain(plistlib.dumps(XML_MIXED, sort_keys=False)),
    "xml-numbers": xml("<array><integer>-9223372036854775808</integer><integer>18446744073709551615</integer>"
                       "<integer>0x1F</integer><real>1e300</real><real>nan</real><real>-inf</real></array>"),
    "xml-dates": xml("<array><date>0000-01-01T00:00:00Z</date><date>9999-12-31T23:59:59Z</date></array>"),
    "xml-entities": xml("<string>&lt;&amp;&#x1F4F6;&#9;&quot;<![CDATA[<a>]]>b</string>"),
    "xml-repeated-key": xml("<dict><key>a</key><true/><key>a</key><false/></dict>"),
    "xml-comments": xml("<!-- a --><array><!-- b --><data> AAEC /w== </data><string/></array>"),
    "xml-doctype": xml("<string>x</string>", '<?xml version="1.0"?>\n<!DOCTYPE plist PUBLIC "-//Example//DTD PLIST 1.0//EN"'
                       ' "PropertyList-1.0.dtd">'),
    "xml-deep": xml("<array>" * 200 + "</array>" * 200),
    "binary-mixed": plistlib.dumps(MIXED, fmt=plistlib.FMT_BINARY, sort_keys=False),
    "binary-text": plistlib.dumps("Größe", fmt=plistlib.FMT_BINARY),
    "binary-date": plistlib.dumps(datetime.datetime(1, 1, 1, 0, 0, 1), fmt=plistlib.FMT_BINARY),
    "binary-real": plistlib.dumps([1.5, float("nan"), float("-inf")], fmt=plistlib.FMT_BINARY),
    "binary-shared": shared_references(4, 8),
    "binary-much-shared": shared_references(12, 14),
    "binary-long-paths": long_paths(200, 200, 8000),
    "binary-itself": shared_references(1, 1).replace(b"\xa1\x01", b"\xa1\x00"),
}


def frame(identifier, kind, payload, length=None):
    return struct.pack("<IiII", len(payload) if length is None else length, identifier, kind, 3) + payload


def frame_seeds():
    stream = frame(0, 0, b"message") + frame(0, 1, b"") + frame(0, 2, b"", 0xFFFFFFFF) + frame(-1, 2, b"x" * 300)
    write("FrameReader", "whole", b"\0" + stream)
    write("FrameReader", "pieces", bytes([3, 0, 4, 15]) + stream)
    write("FrameReader", "cut-short", bytes([1, 200]) + stream[:-5])
    write("FrameReader", "unknown-kind", b"\0" + stream + frame(0, 3, b""))
    write("FrameReader", "too-long", b"\0" + stream + frame(0, 0, b"", 16 * 1024 * 1024 + 1))
    write("FrameReader", "no-data-but-no-reply", b"\0" + frame(0, 0, b"", 0xFFFFFFFF))
    write("FrameReader", "announced", b"\0" + frame(0, 0, b"much to come", 16 * 1024 * 1024))


def pcap(messages, magic=0xA1B2C3D4):
    return struct.pack("<IHHiIII", magic, 2, 4, 0, 0, 262144, 147) + b"".join(
        struct.pack("<IIII", 1336123800 + index, 5, len(message), len(message)) + message
        for index, message in enumerate(messages))


def block(kind, body):
    body += bytes(-len(body) % 4)
    return struct.pack("<II", kind, len(body) + 12) + body + struct.pack("<I", len(body) + 12)


def pcapng(messages):
    content = block(0x0A0D0D0A, struct.pack("<IHHq", 0x1A2B3C4D, 1, 0, -1)) + block(1, struct.pack("<HHI", 147, 0, 0))
    for index, message in enumerate(messages):
        content += block(6, struct.pack("<IIIII", 0, 0, index * 600_000, len(message), len(message)) + message)
    return content


def recording_seeds(pelorusctl):
    saves, snapshot, every = 0x80, 0x10, 0x40
    for index, (fuzzer, sample) in enumerate(TECHNOLOGIES.items()):
        messages = list(messages_of(ROOT / "resources" / "samples" / f"{sample}.pcap"))
        if fuzzer == "IFX":
            some = messages[:1]
        else:
            some = [packets[0] for packets in by_code(messages, 1).values() if len(packets[0]) < 300][:6]
        recording = pcap(some)
        write("Recording", f"{sample}-pcap", bytes([index | every]) + recording)
        write("Recording", f"{sample}-pcapng", bytes([index | every]) + pcapng(some))
        if fuzzer not in ("LTE", "IFX"):
            continue
        with tempfile.TemporaryDirectory() as scratch:
            pcap_file, save, dlf = (pathlib.Path(scratch) / name for name in ("pcap", "save", "dlf"))
            pcap_file.write_bytes(recording)
            subprocess.run([pelorusctl, "decode", "--technology", NAMES[index], "--resources", ROOT / "resources",
                            "--save", save, "--description", "seed", pcap_file], check=True,
                           stdout=subprocess.DEVNULL)
            write("Recording", f"{sample}-snapshot-decoded", bytes([index]) + plain(save.read_bytes()))
            write("Recording", f"{sample}-snapshot-listed", bytes([snapshot]) + plain(save.read_bytes()))
            if fuzzer == "LTE":
                subprocess.run([pelorusctl, "snapshot", "--extract-dlf", dlf, save], check=True,
                               stdout=subprocess.DEVNULL)
                write("Recording", f"{sample}-dlf", bytes([index | saves]) + dlf.read_bytes())
    small = plistlib.dumps({"Timestamp": "2012-05-04 09:30:00 +0000", "Description": "a", "Data": [
        {"DisplayState": bytes([1, 12, 0, 0x79, 0xB1]) + bytes(8), "Date": "2012-05-04 09:30:00 +0000",
         "Display": {"a": "b"}, "Description": "c"}, {"DLF": b"abc", "Description": "d"}, "e"]},
        fmt=plistlib.FMT_BINARY)
    write("Recording", "small-snapshot-listed", bytes([snapshot | saves]) + small)
    write("Recording", "small-snapshot-decoded", bytes([saves]) + small)


def server_seeds():
    (connect, send_bytes, send_frame, announce, ask, ask_of, connect_channel, technology, start, half, close, read,
     run) = range(13)  # TelephonyServer.cpp's operations
    channel = bytes([connect, ask, 0, run, read, 0, connect_channel, run])
    write("TelephonyServer", "session", channel + bytes([technology, 1, start, 1, run, read, 1, run]))
    write("TelephonyServer", "restarted", channel + bytes([start, 1, run, start, 1, run, close, 1, run] ) + channel)
    write("TelephonyServer", "own-port", bytes([connect, ask_of, 0, 27, 0]) + b"io.pelorus.TelephonyServer" + bytes(
        [run, read, 0, connect_channel, run, start, 1, run]))
    write("TelephonyServer", "no-port", bytes([connect, ask_of, 0, 4, 0]) + b"/a/b" + bytes([run]))
    write("TelephonyServer", "announced", bytes([connect, announce, 0, 0, 1, 0, 0, run, half, 0, run]))
    command = plain(plistlib.dumps({"SetState": "Streaming", "SetOspreyLogCodes": [0xB179], "SetCtExtraCodes": [1]}))
    write("TelephonyServer", "commands", channel + bytes([send_frame, 1, 1, 0]) + struct.pack("<H", len(command))
          + command + bytes([run]))
    garbage = frame(1, 1, b"<plist>")
    write("TelephonyServer", "garbage", bytes([connect, send_bytes, 0]) + struct.pack("<H", len(garbage)) + garbage
          + bytes([run, read, 0]))


def main():
    pelorusctl = sys.argv[1]
    generator_seeds()
    for name, content in LISTS.items():
        write("PropertyList", name, content)
        if name.startswith("binary"):
            write("BinaryPropertyList", name, content)
    write("PropertyListWriter", "mixed", bytes([8, 7, 1]) + b"a\0\2ab" + bytes([1]) + b"b\1" + bytes(7) + b"\5\1c\2"
          + bytes.fromhex("3ff8000000000000") + b"\1d\3\1" + b"\1e\4" + bytes(8) + b"\1f\6\3abc" + b"\1g\7\2\0\1x\1")
    frame_seeds()
    recording_seeds(pelorusctl)
    server_seeds()


if __name__ == "__main__":
    main()
