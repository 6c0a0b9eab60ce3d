#!/usr/bin/env python3
"""pelorus-telephonyd --modem with the real ModemManager on a bus of its own, whose modem answers AT commands here."""

import os
import pathlib
import re
import shutil
import signal
import socket
import subprocess
import sys
import time
import unittest

HERE = pathlib.Path(__file__).resolve().parent
sys.path.insert(0, str(HERE.parent / "pelorusctl"))

from at_modem import AtModem  # noqa: E402
from programs import PELORUSCTL, TELEPHONYD, Scratch, ctl, main, trees  # noqa: E402

MODEM_MANAGER = shutil.which("ModemManager", path=os.environ["PATH"] + ":/usr/sbin")
NO_DAEMON = "ModemManager is not installed (Debian package modemmanager): the real daemon is not tested"
DROP_IN = HERE.parent.parent / "resources/dbus/io.pelorus.telephonyd.conf"
MM = "org.freedesktop.ModemManager1"
PATIENCE = 40  # seconds for a modem to register

BUS = """<!DOCTYPE busconfig PUBLIC "-//freedesktop//DTD D-BUS Bus Configuration 1.0//EN"
 "http://www.freedesktop.org/standards/dbus/1.0/busconfig.dtd">
<busconfig>
  <type>system</type>
  <listen>unix:path=%s</listen>
  <policy context="default">
    <allow user="*"/><allow own="*"/><allow send_destination="*"/><allow send_type="signal"/>
    <allow receive_type="method_call"/><allow receive_type="method_return"/>
    <allow receive_type="error"/><allow receive_type="signal"/>
  </policy>
  %s
</busconfig>
"""


class BusTest(Scratch):
    """A bus with ModemManager on it; `policies` are files that the bus reads, in that order."""

    def start_bus(self, policies=()):
        os.chmod(self.directory, 0o755)
        address = self.path("bus")
        includes = "".join("<include>%s</include>" % policy for policy in policies)
        self.write("bus.conf", (BUS % (address, includes)).encode())
        bus = subprocess.Popen(["dbus-daemon", "--nofork", "--print-address=1", "--config-file=" + self.path("bus.conf")],
                               stdout=subprocess.PIPE, stderr=subprocess.DEVNULL)
        self.end_later(bus)
        self.assertTrue(bus.stdout.readline())
        bus.stdout.close()
        os.mkdir(self.path("ports"), 0o700)
        self.environment = dict(os.environ, DBUS_SYSTEM_BUS_ADDRESS="unix:path=" + address,
                                DBUS_SESSION_BUS_ADDRESS="unix:path=" + address,
                                PELORUS_PORT_DIRECTORY=self.path("ports"))

    def start_modem_manager(self):
        daemon = subprocess.Popen([MODEM_MANAGER, "--test-session", "--test-enable", "--test-no-udev",
                                   "--test-no-suspend-resume", "--test-no-qrtr", "--no-auto-scan",
                                   "--log-file=" + self.path("modemmanager.log")],
                                  env=self.environment, stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL)
        self.end_later(daemon)
        self.wait_for(lambda: self.call("/org/freedesktop/ModemManager1", "org.freedesktop.DBus.Peer.Ping"))
        return daemon

    def plug_in(self, **answers):
        """A modem on the daemon's bus, enabled."""
        modem = AtModem("pelorus%d.%s" % (os.getpid(), os.path.basename(self.directory)), **answers)
        self.addCleanup(modem.close)
        self.assertTrue(self.call("/org/freedesktop/ModemManager1", MM + ".Test.SetProfile", "string:test1",
                                  "string:generic", "array:string:" + modem.port))
        self.wait_for(lambda: self.call("/org/freedesktop/ModemManager1/Modem/0", MM + ".Modem.Enable", "boolean:true"))
        self.wait_for(lambda: "int32 8" in self.get("Modem", "State"))
        return modem

    def end_later(self, process):
        self.addCleanup(process.wait)
        self.addCleanup(process.kill)

    def wait_for(self, condition):
        deadline = time.monotonic() + PATIENCE
        while not condition():
            self.assertLess(time.monotonic(), deadline, "it does not come")
            time.sleep(0.1)

    def call(self, path, method, *arguments, prefix=()):
        return subprocess.run([*prefix, "dbus-send", "--system", "--print-reply", "--dest=" + MM, path, method,
                               *arguments], env=self.environment, capture_output=True, check=False).returncode == 0

    def error(self, path, method, *prefix):
        return subprocess.run([*prefix, "dbus-send", "--system", "--print-reply", "--dest=" + MM, path, method],
                              env=self.environment, capture_output=True, text=True, check=False).stderr

    def get(self, interface, name):
        return subprocess.run(["dbus-send", "--system", "--print-reply", "--dest=" + MM,
                               "/org/freedesktop/ModemManager1/Modem/0", "org.freedesktop.DBus.Properties.Get",
                               "string:%s.%s" % (MM, interface), "string:" + name],
                              env=self.environment, capture_output=True, text=True, check=False).stdout

    def serve(self, *arguments):
        self.log = open(self.path("server.log"), "w+", encoding="utf-8")
        self.addCleanup(self.log.close)
        server = subprocess.Popen([TELEPHONYD, *arguments], env=self.environment, stderr=self.log)
        self.end_later(server)
        self.wait_for(lambda: "listening on" in self.said())
        return server

    def said(self):
        return pathlib.Path(self.path("server.log")).read_text(encoding="utf-8")

    def live(self, count=1):
        """The rows that the monitor shows at its last update, without the paths to them."""
        run = subprocess.run([PELORUSCTL, "live", "--json", "--count", str(count)], env=self.environment,
                             capture_output=True, text=True, timeout=60, check=False)
        self.assertEqual((run.returncode, run.stderr), (0, ""))
        _, rows = trees(run.stdout)[-1]
        return {path.rsplit("/", 2)[1] + ": " + path.rsplit("/", 1)[1]: value for path, value in rows.items()}


@unittest.skipUnless(MODEM_MANAGER, NO_DAEMON)
class RealDaemonTest(BusTest):
    def setUp(self):
        super().setUp()
        self.start_bus()
        self.daemon = self.start_modem_manager()

    def test_shows_an_lte_modem_and_leaves_it_as_it_was(self):
        modem = self.plug_in()
        server = self.serve("--modem", "--record", self.path("record"))
        rows = self.live()
        self.assertEqual(rows["Serving Cell Info: Tracking Area Code"], "12741", modem.unknown)
        self.assertEqual(rows["Serving Cell Info: Cell Identity"], "8648653")
        self.assertEqual(rows["SIM Info: EF-ICCID"], "89490100001234567897")
        self.assertEqual(rows["SIM Info: EF-MSISDN"], "+491713920012")
        self.assertEqual(rows["SIM Info: EF-PLMN NETWORK NAME"], "Test Network")
        self.assertEqual(rows["SIM Info: EF-ACTING HPLMN"], "00101")
        self.assertIn("modem: Nobody Thin air, device identifier ", self.said())
        self.assertIn("this modem cannot do it", self.said())
        self.wait_for(lambda: "uint32 0" in self.get("Modem.Signal", "Rate"))  # nobody listens any more

        listener = subprocess.Popen([PELORUSCTL, "live", "--json"], env=self.environment, stdout=subprocess.PIPE)
        self.end_later(listener)
        self.addCleanup(listener.stdout.close)
        self.wait_for(lambda: "uint32 2" in self.get("Modem.Signal", "Rate"))
        server.send_signal(signal.SIGTERM)
        self.assertEqual(server.wait(10), 0)
        self.assertIn("uint32 0", self.get("Modem.Signal", "Rate"))
        self.assertEqual([name for name in os.listdir(self.path("ports")) if "TelephonyServer" in name], [])
        decoded = ctl("decode", "--technology", "Osprey LTE", self.path("record"))
        self.assertEqual(decoded.returncode, 0)
        self.assertIn("Tracking Area Code: 12741\n", decoded.stdout)

    def test_shows_a_gsm_modem(self):
        registered = ['+CREG: 2,1,"31C5","F7CD",0']
        self.plug_in(answers={"+CREG?": registered, "+CGREG?": [registered[0].replace("CREG", "CGREG")],
                              "+COPS=3,2;+COPS?": ['+COPS: 0,2,"00101",0'], "+COPS?": ['+COPS: 0,2,"00101",0'],
                              "+CESQ": ["+CESQ: 40,0,255,255,255,255"]})
        self.serve("--modem")
        rows = self.live()
        self.assertEqual(rows["Serving PLMN: Mobile Country Code"], "1")
        self.assertEqual(rows["Serving PLMN: Location Area Code"], "12741")
        self.assertEqual(rows["GSM Serving Cell: Cell ID"], "63437")
        self.assertIn("Osprey GSM: channel 1: client streaming", self.said())

    def test_waits_for_the_modem_and_for_the_daemon(self):
        server = self.serve("--modem")
        self.wait_for(lambda: "ModemManager has no modem; waiting for one" in self.said())
        monitor = subprocess.Popen([PELORUSCTL, "live", "--json", "--count", "1"], env=self.environment,
                                   stdout=subprocess.PIPE, text=True)
        self.end_later(monitor)
        self.addCleanup(monitor.stdout.close)
        self.wait_for(lambda: "no channel (error 2)" in self.said())
        self.plug_in()
        self.assertIn('"89490100001234567897"', monitor.stdout.readline())
        self.daemon.kill()
        self.daemon.wait()
        second = subprocess.Popen([PELORUSCTL, "live"], env=self.environment, stdout=subprocess.DEVNULL)
        self.end_later(second)
        self.wait_for(lambda: "ModemManager has ended; waiting for it" in self.said())
        self.assertIsNone(server.poll())


@unittest.skipUnless(MODEM_MANAGER, NO_DAEMON)
@unittest.skipUnless(os.geteuid() == 0 and shutil.which("setpriv"), "only root can be somebody else")
class BusPolicyTest(BusTest):
    """What ModemManager's own policy, as the system's bus reads it, lets an ordinary user call."""

    NOBODY = ("setpriv", "--reuid=65534", "--regid=65534", "--clear-groups")
    PATH = "/org/freedesktop/ModemManager1/Modem/0"

    def refusal(self, method):
        return self.error(self.PATH, MM + method, *self.NOBODY)

    def own_policy(self):
        for folder in ("/etc/dbus-1/system.d", "/usr/share/dbus-1/system.d"):
            path = os.path.join(folder, MM + ".conf")
            if os.path.exists(path):
                return path
        return self.skipTest("ModemManager comes without a bus policy")

    def test_refuses_cells_to_users(self):
        self.start_bus([self.own_policy()])
        self.start_modem_manager()
        self.assertIn("DBus.Error.AccessDenied", self.refusal(".Modem.GetCellInfo"))
        self.assertIn("DBus.Error.UnknownMethod", self.refusal(".Modem.Location.GetLocation"))  # there is no modem

    def test_the_drop_in_allows_just_that_wherever_it_is_read(self):
        for order in ([self.own_policy(), DROP_IN], [DROP_IN, self.own_policy()]):
            with self.subTest(order=order):
                self.setUp()
                self.start_bus(order)
                self.start_modem_manager()
                self.assertIn("DBus.Error.UnknownMethod", self.refusal(".Modem.GetCellInfo"))
                self.assertIn("DBus.Error.AccessDenied", self.refusal(".Modem.Signal.SetupThresholds"))
                self.assertIn("DBus.Error.AccessDenied", self.refusal(".InhibitDevice"))
                self.doCleanups()


class OnDemandTest(Scratch):
    """The server as the service manager starts it: with a socket that it made."""

    def setUp(self):
        super().setUp()
        os.mkdir(self.path("ports"), 0o700)
        self.environment = dict(os.environ, PELORUS_PORT_DIRECTORY=self.path("ports"))

    def activate(self, path):
        listener = socket.socket(socket.AF_UNIX, socket.SOCK_STREAM)
        self.addCleanup(listener.close)
        listener.bind(path)
        os.chmod(path, 0o600)
        listener.listen()
        descriptor = listener.fileno()
        server = subprocess.Popen(["sh", "-c", 'exec 3<&%d; LISTEN_PID=$$ LISTEN_FDS=1 exec "$0" "$@"' % descriptor,
                                   TELEPHONYD, "--simulate", "Osprey LTE"], env=self.environment,
                                  pass_fds=[descriptor], stderr=subprocess.PIPE, text=True)
        self.addCleanup(server.stderr.close)
        self.addCleanup(server.wait)
        self.addCleanup(server.kill)
        return server

    def test_serves_on_the_socket_and_leaves_its_file(self):
        path = self.path("ports/io.pelorus.TelephonyServer")
        server = self.activate(path)
        self.assertEqual(server.stderr.readline(), "listening on %s\n" % path)
        run = subprocess.run([PELORUSCTL, "live", "--count", "1"], env=self.environment, capture_output=True, text=True,
                             timeout=60, check=False)
        self.assertEqual((run.returncode, run.stderr), (0, ""))
        self.assertRegex(run.stdout, r"\n +Physical Cell ID: \d+\n")
        server.send_signal(signal.SIGTERM)
        self.assertEqual(server.wait(10), 0)
        self.assertTrue(os.path.exists(path))

    def test_takes_no_socket_of_another_place(self):
        server = self.activate(self.path("elsewhere"))
        _, errors = server.communicate(timeout=10)
        self.assertEqual((server.returncode, errors.count("\n")), (1, 1))
        self.assertIn("the socket that was passed listens at " + self.path("elsewhere"), errors)

    @unittest.skipUnless(shutil.which("systemd-analyze"), "systemd-analyze is not installed")
    def test_the_units_are_right(self):
        units = HERE.parent.parent / "resources/systemd"
        text = (units / "pelorus-telephonyd.service").read_text(encoding="utf-8")
        program = os.path.dirname(os.path.abspath(TELEPHONYD))
        self.write("pelorus-telephonyd.service", re.sub("(?m)^ExecStart=", "ExecStart=%s/" % program, text).encode())
        shutil.copy(units / "pelorus-telephonyd.socket", self.directory)
        run = subprocess.run(["systemd-analyze", "verify", "--user", "--man=no", self.path("pelorus-telephonyd.socket"),
                              self.path("pelorus-telephonyd.service")],
                             env=dict(os.environ, XDG_RUNTIME_DIR=self.directory), capture_output=True, text=True,
                             timeout=60, check=False)
        self.assertEqual([line for line in run.stderr.splitlines() if "pelorus" in line], [])


if __name__ == "__main__":
    main()
