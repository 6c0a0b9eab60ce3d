#!/usr/bin/env python3
"""pelorusctl as somebody else uses it: files in, text and files out."""

import json
import os
import plistlib
import re
import struct
import subprocess
import unittest

from programs import PELORUSCTL, Scratch, ctl, main, trees
from recordings import LTE_ANTENNAS, START, dlf, internal, lte_cell, message, pcap, pcapng, snapshot

LTE = ("--technology", "Osprey LTE")
CELL = "/Serving cell/Serving Cell Info/"
SECOND = 10**9


def at(seconds, data):
    return (int((START + seconds) * SECOND), data)


class DecodeTest(Scratch):
    def decode(self, content, *arguments, technology="Osprey LTE"):
        return ctl("decode", "--technology", technology, *arguments, self.write("recording", content))

    def shown(self, content, *arguments):
        """What each refresh shows."""
        run = self.decode(content, "--json", *arguments)
        self.assertEqual((run.returncode, run.stderr), (0, ""))
        return trees(run.stdout)

    def test_shows_the_serving_cell(self):
        [(time, rows)] = self.shown(pcap([at(0.25, lte_cell(77)), at(1.5, LTE_ANTENNAS)]))
        self.assertEqual(time, START + 1.5)
        self.assertEqual({path[len(CELL):]: value for path, value in rows.items() if path.startswith(CELL)},
                         {"Physical Cell ID": "77", "Download Frequency": "1575", "Upload Frequency": "19575",
                          "Download Bandwidth": "10 MHz", "Upload Bandwidth": "Unknown", "Cell Identity": "-2",
                          "Tracking Area Code": "4660", "Freq Band Indicator": "3", "Num Tx Antennas": "2"})

    def test_prints_an_indented_tree(self):
        run = self.decode(pcap([at(0, lte_cell(77))]))
        lines = run.stdout.splitlines()
        self.assertEqual(lines[:4], ["Pelorus", "  Serving cell", "    Serving Cell Info",
                                     "      Physical Cell ID: 77"])
        self.assertIn("      Download Bandwidth: 10 MHz", lines)
        self.assertEqual((run.returncode, run.stderr), (0, ""))

    def test_reads_every_kind_of_recording(self):
        first, second = lte_cell(1), lte_cell(503)
        nanoseconds = [(START * SECOND + 250_000_000, first), (START * SECOND + 1_000_000_128, second)]
        for content, time in [
                (pcap(nanoseconds), START + 1.0),
                (pcap(nanoseconds, byte_order=">"), START + 1.0),
                (pcap(nanoseconds, nano=True), START + 1.000000128),
                (pcapng(nanoseconds), START + 1.000000128),
                (snapshot([first, b"\x81\x00" + second]), START),
                (dlf([first, second]), START)]:
            [(last, rows)] = self.shown(content)
            self.assertEqual((last, rows[CELL + "Physical Cell ID"]), (time, "503"), content[:8])

    def test_refreshes_at_ticks_of_recorded_time(self):
        times = [0, 1, 2, 2.000001, 9.5, 10, 10.5]
        refreshes = self.shown(pcap([at(time, lte_cell(number)) for number, time in enumerate(times)]),
                               "--every", "2")
        self.assertEqual([(time, rows[CELL + "Physical Cell ID"]) for time, rows in refreshes],
                         [(START + 2, "2"), (START + 2.000001, "3"), (START + 10, "5"), (START + 10.5, "6")])

    def test_shows_the_tree_once_without_any_message(self):
        run = self.decode(pcap([]), "--json")
        self.assertEqual(run.stdout,
                         '{"time":null,"tree":{"name":"Pelorus","path":"/","value":"(unknown)"}}\n')
        self.assertEqual(self.decode(pcap([])).stdout, "Pelorus: (unknown)\n")
        self.assertEqual(self.decode(pcap([]), "--every", "2").stdout, "")

    def test_takes_templates_from_elsewhere(self):
        os.mkdir(self.path("own"))
        self.write("own/LTE.plist",
                   b'<plist version="1.0"><dict><key>Mine</key><dict><key>Serving Cell Info</key>'
                   b'<dict><key>Note</key><string>kept</string></dict></dict></dict></plist>')
        run = self.decode(pcap([at(0, LTE_ANTENNAS)]), "--resources", self.path("own"))
        self.assertEqual(run.stdout, "Pelorus\n  Mine\n    Serving Cell Info\n      Note: kept\n"
                                     "      Num Tx Antennas: 2\n")

    def test_shows_nothing_from_a_directory_without_templates(self):
        os.mkdir(self.path("empty"))
        run = self.decode(pcap([at(0, LTE_ANTENNAS)]), "--resources", self.path("empty"), "--system-log", "-")
        self.assertEqual((run.returncode, run.stdout), (0, "Pelorus: (unknown)\n"))
        self.assertIn("<3>Cannot load template for display\n", run.stderr)

    def test_writes_the_system_log_line_by_line(self):
        content = pcap([at(0, LTE_ANTENNAS), at(1, message(0xB0C2, 37)), at(2, message(7, 20, log_type=2)),
                        at(3, b"\x01short"), at(4, internal(1, plistlib.dumps({"no": "list"}))),
                        at(5, internal(1, b"bplist00nonsense"))])
        run = self.decode(content, "--system-log", self.path("log"))
        self.assertEqual((run.returncode, run.stderr), (0, ""))
        text = self.read("log").decode()
        self.assertTrue(text.endswith("\n"))
        lines = text.splitlines()
        self.assertEqual([line for line in lines if not re.fullmatch(r"<[0-9]>[^\n]+", line)], [])
        self.assertEqual(lines[0], "<3>Creating LTELogGenerator object")
        self.assertEqual([line for line in lines if re.search("LTE Serving|unknown|Invalid|Cell (Info )?Array", line)],
                         ["<4>LTE Serving Cell Info", "<3>Received an unknown log message: 45249",
                          "<4>LTE Serving Cell Info", "<3>Invalid log type: 2. Dropping.",
                          "<4>LTE Serving Cell Info", "<3>Failed to get Cell Array",
                          "<4>LTE Serving Cell Info", "<3>Cell Info Array data could not be constructed",
                          "<3>Failed to get Cell Array"])
        addresses = re.compile("0x[0-9a-f]+")
        run = self.decode(content, "--system-log", "-")
        self.assertEqual(addresses.sub("%p", run.stderr), addresses.sub("%p", text))

    def test_saves_what_the_save_screen_would(self):
        first, second = lte_cell(1), b"\x81\x00" + lte_cell(2)
        run = self.decode(pcap([at(0, first), at(3, second), at(3.5, first)]), "--every", "2",
                          "--save", self.path("saved"), "--description", "\u00e9 <here> & \"there\"")
        self.assertEqual((run.returncode, run.stderr), (0, ""))
        self.assertTrue(self.read("saved").startswith(b"<?xml"))
        saved = plistlib.loads(self.read("saved"))
        self.assertEqual(list(saved), ["Timestamp", "Data", "Description"])
        self.assertEqual(saved["Description"], "\u00e9 <here> & \"there\"")
        date = r"\d{4}-\d\d-\d\d \d\d:\d\d:\d\d \+0000"
        self.assertRegex(saved["Timestamp"], "^%s$" % date)
        *entries, last = saved["Data"]
        self.assertEqual([entry["DisplayState"] for entry in entries], [first, second + first])
        for entry, pci in zip(entries, ["1", "1"]):
            self.assertEqual(list(entry), ["DisplayState", "Display", "ExtraInfo", "Date", "Description"])
            self.assertEqual(entry["Display"]["01;Serving cell"]["Serving Cell Info"]["Physical Cell ID"], pci)
            self.assertEqual(entry["ExtraInfo"], {})
            self.assertRegex(entry["Date"], "^%s$" % date)
            self.assertRegex(entry["Description"], r"^Snapshot \(%s\)$" % date)
        records = first[1:] + (second + first)[1:]
        self.assertEqual(last["Description"], "DLF binary (%d bytes)" % (161 + len(records)))
        self.assertEqual(list(last), ["Description", "DLF"])
        report = last["DLF"][:161]
        self.assertEqual(report[:16], bytes.fromhex("a100 fd1f 0000000000000000 0100 0100"))
        self.assertEqual(report[16:39], b"Peloru\0" + b"EXECUTABLE_NAME\0")
        self.assertRegex(report[63:81], rb"^[A-Z][a-z]{2} [ \d]\d \d{4} \d\d:\d\d\0$")
        self.assertEqual(last["DLF"][161:], records)

    def test_keeps_five_refreshes(self):
        self.decode(pcap([at(2 * number, lte_cell(number)) for number in range(7)]), "--every", "1",
                    "--save", self.path("saved"))
        saved = plistlib.loads(self.read("saved"))
        self.assertEqual([entry.get("DisplayState") for entry in saved["Data"]],
                         [lte_cell(number) for number in range(2, 7)] + [None])
        self.assertEqual(saved["Description"], "")

    def test_decodes_its_own_snapshot_and_dlf_to_the_same_tree(self):
        run = self.decode(pcap([at(number, lte_cell(number)) for number in range(9)] + [at(10, LTE_ANTENNAS)]),
                          "--save", self.path("saved"))
        self.assertIn("Physical Cell ID: 8\n", run.stdout)
        extract = ctl("snapshot", "--extract-dlf", self.path("dlf"), self.path("saved"))
        self.assertEqual((extract.returncode, extract.stderr), (0, ""))
        for name in ("saved", "dlf"):
            again = ctl("decode", *LTE, self.path(name))
            self.assertEqual((again.returncode, again.stderr, again.stdout), (0, "", run.stdout), name)

    def test_shows_ifx_lists_and_drops_what_is_none(self):
        first = plistlib.dumps({"Cell": {"Channel": {"ARFCN": "62"}, "BSIC": "2-2"}, "Neighbors": ["ARFCN", "70"]})
        second = plistlib.dumps({"Cell": {"Channel": {"ARFCN": "78"}}}, fmt=plistlib.FMT_BINARY)
        content = pcap([at(0, first), at(10, b"<plist>" + b"<array>" * 9_000), at(12, plistlib.dumps({"Cell": 78})),
                        at(14, b""), at(20, second)])
        run = self.decode(content, "--json", "--every", "2", "--system-log", self.path("log"), "--save",
                          self.path("saved"), technology="IFX")
        self.assertEqual((run.returncode, run.stderr), (0, ""))
        before = {"/Cell/Channel": "62", "/Cell/BSIC": "2-2", "/Neighbors/0": "70"}
        self.assertEqual([rows for _, rows in trees(run.stdout)], [before] * 4 + [{"/Cell": "78"}])
        errors = [line for line in self.read("log").decode().splitlines() if line.startswith("<3>")]
        self.assertEqual(errors, ["<3>Could not deserialize the object",
                                  "<3>Unknown object of type Integer encountered",
                                  "<3>Could not deserialize the object"])
        saved = plistlib.loads(self.read("saved"))["Data"]
        self.assertEqual(len(saved), 5)  # and no DLF file
        self.assertEqual(saved[-1]["DisplayState"], {"Cell": {"Channel": {"ARFCN": "78"}}})
        self.assertEqual(saved[-1]["Display"], {"Cell": "78"})

    def test_shows_the_samples(self):
        samples = os.path.join(os.path.dirname(os.path.abspath(__file__)), "../../resources/samples")
        for name, technology in (("cdma", "Osprey CDMA"), ("gsm", "Osprey GSM"), ("ifx", "IFX"), ("lte", "Osprey LTE"),
                                 ("utran", "Osprey UTRAN2")):
            run = ctl("decode", "--technology", technology, "--system-log", self.path("log"),
                      os.path.join(samples, name + ".pcap"))
            self.assertEqual((run.returncode, run.stderr), (0, ""))
            self.assertGreater(run.stdout.count("\n"), 30, name)
            complaints = re.findall("<3>.*(?:ould not|ailed|Cannot|Log code|Invalid|Unknown).*",
                                    self.read("log").decode())
            self.assertEqual(complaints, [], name)

    def test_ends_by_the_exception_of_an_unreadable_sim_payload(self):
        run = self.decode(pcap([at(0, lte_cell(5)), at(10, lte_cell(6)), at(20, internal(0, b"no list"))]),
                          "--json", "--every", "2", "--system-log", self.path("log"))
        self.assertEqual(run.returncode, -6)
        self.assertEqual([rows[CELL + "Physical Cell ID"] for _, rows in trees(run.stdout)], ["5", "6"])
        lines = self.read("log").decode().splitlines()
        self.assertIn("<3>SIM File dictionary data could not be constructed", lines)
        self.assertRegex(lines[-1], "LogCode_0xFF0000::UnknownDataException")

    def test_ends_by_the_exception_of_a_record_beyond_the_packet(self):
        content = pcap([at(0, message(0xD00A, 190, [(16, "B", 2 << 1)]))])
        run = self.decode(content, "--system-log", self.path("log"), technology="Osprey UTRAN2")
        self.assertEqual((run.returncode, run.stdout), (-6, ""))
        lines = self.read("log").decode().splitlines()
        self.assertIn("<4>NeighbhorMeasurements List", lines)
        self.assertRegex(lines[-1], "ArrayOutOfBoundsException")

    def test_survives_hostile_property_lists(self):
        entities = "".join('<!ENTITY e%d "%s">' % (number, "&e%d;" % (number - 1) * 10) for number in range(1, 9))
        hostile = [
            b"<plist>" + b"<array>" * 9_000,
            ("<!DOCTYPE p [<!ENTITY e0 'x'>%s]><plist><string>&e8;</string></plist>" % entities).encode(),
            b"<!DOCTYPE p [<!ENTITY f SYSTEM 'file:///etc/passwd'>]><plist><string>&f;</string></plist>",
            # an array that holds itself, one whose count lies, offsets beyond the end
            b"bplist00\xa1\x00" + bytes([8]) + struct.pack(">6xBBQQQ", 1, 1, 1, 0, 10),
            b"bplist00\xaf\x13" + b"\xff" * 8 + bytes([8]) + struct.pack(">6xBBQQQ", 1, 1, 1, 0, 18),
            b"bplist00" + struct.pack(">6xBBQQQ", 8, 8, 2**61, 2**63, 2**64 - 1),
            b"bplist00", b"", b"\xff" * 64]
        content = pcap([at(number, internal(1 + number % 2, payload)) for number, payload in
                        enumerate(hostile + hostile[1:])] + [at(99, lte_cell(9))])
        [(_, rows)] = self.shown(content)
        self.assertEqual(rows[CELL + "Physical Cell ID"], "9")

    def test_reads_a_long_recording_in_little_memory(self):
        count, length = 300_000, 338
        with open(self.path("long"), "wb") as file:
            file.write(pcap([]))
            for number in range(count):
                file.write(pcap([at(number / 1000, lte_cell(number % 504, length))])[24:])
        self.assertGreater(os.path.getsize(self.path("long")), 100_000_000)
        for every, expected in (["--every", "2"], 150), ([], 1):
            with open(self.path("out"), "wb") as out, subprocess.Popen(
                    [PELORUSCTL, "decode", *LTE, "--json", *every, self.path("long")], stdout=out) as process:
                _, status, usage = os.wait4(process.pid, 0)
                process.returncode = os.waitstatus_to_exitcode(status)
            self.assertEqual(process.returncode, 0)
            self.assertLess(usage.ru_maxrss, 64 * 1024)  # KiB, with the libraries
            refreshes = trees(self.read("out").decode())
            self.assertEqual(len(refreshes), expected)
            self.assertEqual(refreshes[-1][1][CELL + "Physical Cell ID"], str((count - 1) % 504))

    def test_shows_what_came_before_a_break(self):
        run = self.decode(pcap([at(0, lte_cell(4)), at(1, lte_cell(5))])[:-10])
        self.assertEqual(run.returncode, 1)
        self.assertIn("Physical Cell ID: 4\n", run.stdout)
        self.assertEqual(run.stderr.count("\n"), 1)
        self.assertIn(self.path("recording"), run.stderr)


class SnapshotTest(Scratch):
    def setUp(self):
        super().setUp()
        self.recording = self.write("recording", pcap([at(0, lte_cell(1)), at(5, lte_cell(2))]))
        ctl("decode", *LTE, "--every", "1", "--save", self.path("saved"), "--description", "two\nlines",
            self.recording)

    def test_tells_what_is_in_a_snapshot(self):
        run = ctl("snapshot", self.path("saved"))
        self.assertEqual((run.returncode, run.stderr), (0, ""))
        time, description, *entries = run.stdout.splitlines()
        self.assertRegex(time, r"^Timestamp: \d{4}-\d\d-\d\d \d\d:\d\d:\d\d \+0000$")
        self.assertEqual(description, "Description: two\\nlines")
        self.assertEqual(len(entries), 3)
        for entry in entries[:2]:
            self.assertRegex(entry, r"^Snapshot \(.* \+0000\): \d+ rows, 38 bytes of raw messages$")
        self.assertEqual(entries[2], "DLF binary (235 bytes): 235 bytes of DLF")

    def test_tells_the_same_as_json(self):
        run = ctl("snapshot", "--json", self.path("saved"))
        self.assertEqual((run.returncode, run.stderr, run.stdout.count("\n")), (0, "", 1))
        told = json.loads(run.stdout)
        saved = plistlib.loads(self.read("saved"))
        self.assertEqual((told["timestamp"], told["description"]), (saved["Timestamp"], "two\nlines"))
        self.assertEqual([entry["description"] for entry in told["entries"]],
                         [entry["Description"] for entry in saved["Data"]])
        self.assertEqual([entry.get("rawBytes") for entry in told["entries"]], [38, 38, None])
        self.assertEqual(told["entries"][2]["dlfBytes"], 235)

    def test_takes_the_dlf_file_out(self):
        run = ctl("snapshot", "--extract-dlf", self.path("dlf"), self.path("saved"))
        self.assertEqual((run.returncode, run.stderr), (0, ""))
        self.assertEqual(self.read("dlf"), plistlib.loads(self.read("saved"))["Data"][2]["DLF"])

    def test_says_when_there_is_no_dlf_file(self):
        plain = self.write("plain", snapshot([lte_cell(1)]))
        run = ctl("snapshot", "--extract-dlf", self.path("dlf"), plain)
        self.assertEqual((run.returncode, run.stderr), (1, "pelorusctl: %s: carries no DLF file\n" % plain))
        self.assertFalse(os.path.exists(self.path("dlf")))

    def test_reads_snapshots_of_others(self):
        for form in (plistlib.FMT_XML, plistlib.FMT_BINARY):
            other = self.write("other", plistlib.dumps({"Timestamp": "now", "Data": [{}, 7, "x"]}, fmt=form))
            run = ctl("snapshot", other)
            self.assertEqual((run.returncode, run.stdout),
                             (0, "Timestamp: now\nDescription: \n" + "(no description)\n" * 3))


class StartCommandTest(unittest.TestCase):
    def command(self, technology):
        run = ctl("start-command", "--technology", technology)
        self.assertEqual((run.returncode, run.stderr), (0, ""))
        self.assertTrue(run.stdout.startswith("<?xml"))
        return plistlib.loads(run.stdout.encode())

    def test_names_the_log_codes_of_lte(self):
        command = self.command("Osprey LTE")
        self.assertEqual(sorted(command), ["SetCtExtraCodes", "SetOspreyLogCodes", "SetState"])
        self.assertEqual(command["SetState"], "Streaming")
        self.assertEqual(sorted(command["SetOspreyLogCodes"]), [45249, 45250, 45433, 45439, 45440, 45446])
        self.assertEqual(sorted(command["SetCtExtraCodes"]), [0, 1, 2])

    def test_names_the_log_codes_of_the_other_templates(self):
        for technology, some in (("Osprey GSM", {0x51FB, 0x4127}), ("Osprey UTRAN2", {0xD00A, 0xD00E})):
            command = self.command(technology)
            self.assertEqual(command["SetState"], "Streaming")
            self.assertLessEqual(some, set(command["SetOspreyLogCodes"]), technology)
            self.assertEqual(sorted(command["SetCtExtraCodes"]), [0, 1, 2])

    def test_names_the_log_codes_of_cdma_in_their_order(self):
        self.assertEqual(self.command("Osprey CDMA"), {
            "SetState": "Streaming",
            "SetOspreyLogCodes": [4234, 4483, 4498, 4790, 4508, 4509, 4734, 4943]})

    def test_has_one_for_every_technology(self):
        self.assertTrue(self.command("IFX"))


class WrongUsageTest(Scratch):
    def test_ends_with_status_2_and_says_why(self):
        for arguments in (
                [], ["nonsense"], ["--nonsense"], ["live", "more"], ["live", "--count", "0"],
                ["live", "--count", "-1"], ["live", "--count", "two"], ["live", "--count", "1.5"],
                ["decode", "file"], ["decode", *LTE], ["decode", "--technology", "Osprey lte", "file"],
                ["decode", "--technology", "", "file"], ["decode", *LTE, *LTE, "file"],
                ["decode", *LTE, "file", "more"], ["decode", *LTE, "--nonsense", "file"],
                ["decode", *LTE, "--every", "0", "file"], ["decode", *LTE, "--every", "-2", "file"],
                ["decode", *LTE, "--every", "nan", "file"], ["decode", *LTE, "--every", "x", "file"],
                ["decode", *LTE, "--every", "1s", "file"], ["snapshot"], ["snapshot", "a", "b"],
                ["start-command"], ["start-command", "--technology", "LTE"]):
            run = ctl(*arguments)
            self.assertEqual((run.returncode, run.stdout), (2, ""), arguments)
            self.assertNotEqual(run.stderr, "", arguments)

    def test_tells_its_version_and_its_use(self):
        run = ctl("--version")
        self.assertEqual((run.returncode, run.stderr), (0, ""))
        self.assertRegex(run.stdout, r"^pelorusctl \d+\.\d+\.\d+\n$")
        run = ctl("--help")
        self.assertEqual((run.returncode, run.stderr), (0, ""))
        for command in ("live", "decode", "snapshot", "start-command"):
            self.assertIn(command, run.stdout)
            own = ctl(command, "--help")
            self.assertEqual((own.returncode, own.stderr), (0, ""))
        self.assertIn("--system-log", ctl("decode", "--help").stdout)


class UnreadableTest(Scratch):
    def expect(self, culprit, *arguments):
        run = ctl(*arguments)
        self.assertEqual((run.returncode, run.stdout), (1, ""), arguments)
        self.assertEqual(run.stderr.count("\n"), 1, run.stderr)
        self.assertTrue(run.stderr.startswith("pelorusctl: %s: " % culprit), run.stderr)

    def test_names_the_recording(self):
        for name, content in {
                "empty": b"", "text": b"hello, world\n" * 40, "magic": pcap([])[:4], "ethernet": pcap([], link_type=1),
                "list": plistlib.dumps({"Data": []}), "array": plistlib.dumps(["Timestamp"]),
                "broken list": snapshot([lte_cell(1)])[:200], "bplist": b"bplist00" + bytes(60),
                "data": plistlib.dumps({"Timestamp": "now", "Data": "text"})}.items():
            self.expect(self.write(name, content), "decode", *LTE, self.path(name))
        self.expect(self.path("missing"), "decode", *LTE, self.path("missing"))
        self.expect(self.directory, "decode", *LTE, self.directory)

    def test_names_the_snapshot(self):
        for name, content in {"empty": b"", "text": b"hello", "array": plistlib.dumps([1]), "pcap": pcap([]),
                              "list": plistlib.dumps({"Data": []})}.items():
            self.expect(self.write(name, content), "snapshot", self.path(name))
        self.expect(self.path("missing"), "snapshot", self.path("missing"))
        self.expect(self.directory, "snapshot", self.directory)

    def test_names_the_other_files(self):
        recording = self.write("recording", pcap([]))
        missing = self.path("missing/file")
        self.expect(missing, "decode", *LTE, "--resources", missing, recording)
        self.expect(recording, "decode", *LTE, "--resources", recording, recording)
        self.expect(missing, "decode", *LTE, "--system-log", missing, recording)
        self.expect(missing, "start-command", *LTE, "--resources", missing)
        self.expect(recording, "decode", *LTE, "--system-log", recording, recording)
        self.assertEqual(self.read("recording"), pcap([]))
        self.expect(self.path("two\\nlines"), "snapshot", self.path("two\nlines"))
        run = ctl("decode", *LTE, "--save", missing, recording)
        self.assertEqual((run.returncode, run.stdout), (1, "Pelorus: (unknown)\n"))
        self.assertEqual(run.stderr, "pelorusctl: %s: No such file or directory\n" % missing)

    def test_says_when_its_output_does_not_fit(self):
        recording = self.write("recording", pcap([at(0, lte_cell(1))]))
        with open("/dev/full", "wb") as full:
            run = subprocess.run([PELORUSCTL, "decode", *LTE, recording], stdout=full, stderr=subprocess.PIPE,
                                 text=True, timeout=60, check=False)
        self.assertEqual((run.returncode, run.stderr),
                         (1, "pelorusctl: standard output: No space left on device\n"))


if __name__ == "__main__":
    main()
