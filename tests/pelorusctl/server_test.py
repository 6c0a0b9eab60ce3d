#!/usr/bin/env python3
"""pelorus-telephonyd from outside: clients that know nothing of it but its ports."""

import os
import plistlib
import signal
import struct
import subprocess

from programs import PELORUSCTL, TELEPHONYD, ctl, main
from recordings import LTE_ANTENNAS, START, lte_cell, message, pcap, recorded
from served import Served
from telephony import REQUEST, connect, frame, receive


def without_time(data):
    """A message without its time stamp."""
    return data[:5] + data[13:]


class ServerTest(Served):
    def test_replays_to_several_at_once_and_records(self):
        wanted = [lte_cell(1), b"\x81\x00" + lte_cell(2), LTE_ANTENNAS]
        unwanted = [message(0xB0C0, 38), b"short", message(0xB0C2, 38, log_type=3)]
        times = range(START * 10**9, START * 10**9 + 6000, 1000)
        recording = self.write("recording", pcap(zip(times, [data for pair in zip(wanted, unwanted) for data in pair])))
        server = self.serve("--replay", recording, "--technology", "Osprey LTE", "--record", self.path("record"))
        clients = [self.client("test.Local%d" % number) for number in range(3)]
        for client in clients:
            self.assertEqual(client.technology(), "Osprey LTE")
            client.start()
        for client in clients:
            self.assertEqual(client.messages(3), wanted)
            client.close()
        self.end(server)
        self.assertEqual(sorted(recorded(self.read("record"))), sorted(3 * wanted))
        again = ctl("decode", "--technology", "Osprey LTE", self.path("record"))
        self.assertIn("Num Tx Antennas: 2\n", again.stdout)

    def test_tells_the_same_story_for_the_same_seed(self):
        stories = []
        for seed in ("5", "5", "6"):
            server = self.serve("--simulate", "Osprey LTE", "--seed", seed, "--rate", "1000")
            client = self.client()
            client.start()
            stories.append([without_time(data) for data in client.messages(300)])
            client.close()
            self.end(server, signal.SIGINT)
        self.assertEqual(stories[0], stories[1])
        self.assertNotEqual(stories[0], stories[2])

    def test_simulates_every_technology(self):
        for technology in ("IFX", "Osprey GSM", "Osprey CDMA", "Osprey LTE", "Osprey UTRAN2"):
            command = plistlib.loads(ctl("start-command", "--technology", technology).stdout.encode())
            codes = {*command.get("SetOspreyLogCodes", []), *(0xFF0000 + c for c in command.get("SetCtExtraCodes", []))}
            server = self.serve("--simulate", technology, "--rate", "1000", "--record", self.path("record"))
            client = self.client()
            self.assertEqual(client.technology(), technology)
            client.start(command)
            received = client.messages(200)
            client.close()
            self.end(server)
            self.assertEqual(recorded(self.read("record"))[:200], received)
            decoded = ctl("decode", "--technology", technology, self.path("record"))
            self.assertEqual((decoded.returncode, decoded.stderr), (0, ""))
            self.assertGreater(decoded.stdout.count("\n"), 20)
            for data in received:
                if technology == "IFX":
                    self.assertIsInstance(plistlib.loads(data), dict)
                    continue
                log_type, length, code = struct.unpack_from("<BHH", data)
                self.assertIn(code + (0xFF0000 if log_type == 0xFF else 0), codes)
                self.assertEqual(length, len(data) - 1)

    def test_serves_the_monitor(self):
        for technology, row in (("Osprey LTE", r"Physical Cell ID: \d+"), ("Osprey CDMA", r"UATI24: 0x[0-9a-f]{6}"),
                                ("IFX", r"Channel: \d+")):
            server = self.serve("--simulate", technology, "--rate", "500", "--record", self.path("record"))
            run = subprocess.run([PELORUSCTL, "live", "--count", "1"], env=self.environment, capture_output=True,
                                 text=True, timeout=20, check=False)
            self.assertEqual((run.returncode, run.stderr), (0, ""))
            self.assertRegex(run.stdout, r"\n +%s\n" % row)
            self.end(server)
            decoded = ctl("decode", "--technology", technology, self.path("record"))
            self.assertEqual(decoded.returncode, 0)
            self.assertRegex(decoded.stdout, r"\n +%s\n" % row)

    def test_a_second_one_gives_way(self):
        server = self.serve("--simulate", "Osprey LTE")
        second = subprocess.run([TELEPHONYD, "--simulate", "Osprey LTE"], env=self.environment, capture_output=True,
                                text=True, timeout=10, check=False)
        self.assertEqual((second.returncode, second.stdout, second.stderr.count("\n")), (1, "", 1))
        self.assertIn(self.path("ports"), second.stderr)
        self.assertEqual(self.client().technology(), "Osprey LTE")
        self.end(server)

    def test_a_clients_port_name_cannot_pretend_to_be_a_report(self):
        server = self.serve("--simulate", "Osprey LTE")
        client = connect(self.path("ports"), "io.pelorus.TelephonyServer")
        self.addCleanup(client.close)
        name = "nobody\nlistening on /elsewhere"
        client.sendall(frame(plistlib.dumps({"CreateLogChannel": name}), REQUEST, 1, 1))
        self.assertEqual(plistlib.loads(receive(client)[0])["Error"], 1)
        self.assertIn(r'"nobody\nlistening on /elsewhere"', server.stderr.readline())
        self.end(server)

    def test_takes_the_place_of_one_that_was_killed(self):
        server = self.serve("--simulate", "Osprey LTE")
        server.kill()
        server.wait()
        self.assertEqual(os.listdir(self.path("ports")), ["io.pelorus.TelephonyServer"])
        self.end(self.serve("--simulate", "Osprey LTE"))

    def test_ends_with_a_status_that_tells_why(self):
        os.chmod(self.path("ports"), 0o777)
        for status, culprit, arguments in (
                (1, self.path("ports"), ["--simulate", "Osprey LTE"]),
                (1, "/missing", ["--replay", "/missing", "--technology", "IFX"]),
                (2, "", []), (2, "", ["--simulate", "LTE"]), (2, "--technology", ["--replay", "/missing"]),
                (2, "", ["--simulate", "Osprey LTE", "--replay", "/missing", "--technology", "IFX"]),
                (2, "", ["--simulate", "Osprey LTE", "--speed", "-1"])):
            run = subprocess.run([TELEPHONYD, *arguments], env=self.environment, capture_output=True, text=True,
                                 timeout=10, check=False)
            self.assertEqual((run.returncode, run.stdout), (status, ""), arguments)
            self.assertIn(culprit, run.stderr)


if __name__ == "__main__":
    main()
