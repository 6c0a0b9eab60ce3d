"""A desktop of the test's own (screen, session bus, accessibility) and the window on it, as a person has them: keys go
in through the screen, and what is shown comes out through accessibility."""

import os
import signal
import subprocess
import threading
import time

import gi

gi.require_version("Atspi", "2.0")
from gi.repository import Atspi, Gio, GLib  # noqa: E402

PATIENCE = 20  # seconds


def wait_for(what, condition, patience=PATIENCE):
    """The first true answer of the condition, which may fail while things change."""
    end = time.monotonic() + patience
    while True:
        try:
            answer = condition()
        except GLib.Error:
            answer = None
        if answer:
            return answer
        if time.monotonic() > end:
            raise AssertionError("waited in vain for " + what)
        time.sleep(0.05)


class Desktop:
    def __init__(self, size="1280x900"):
        read_end, write_end = os.pipe()
        self.screen = subprocess.Popen(
            ["Xvfb", "-displayfd", str(write_end), "-screen", "0", size + "x24", "-nolisten", "tcp"],
            pass_fds=[write_end], stderr=subprocess.DEVNULL)
        os.close(write_end)
        with os.fdopen(read_end) as pipe:
            os.environ["DISPLAY"] = ":" + pipe.readline().strip()
        self.bus = subprocess.Popen(["dbus-daemon", "--session", "--nofork", "--print-address"],
                                    stdout=subprocess.PIPE, stderr=subprocess.DEVNULL, text=True)
        os.environ["DBUS_SESSION_BUS_ADDRESS"] = self.bus.stdout.readline().strip()
        os.environ["QT_LINUX_ACCESSIBILITY_ALWAYS_ON"] = "1"

    def prefer_dark(self):
        """Plays the portal that tells what the user wants."""
        bus = Gio.DBusConnection.new_for_address_sync(
            os.environ["DBUS_SESSION_BUS_ADDRESS"],
            Gio.DBusConnectionFlags.AUTHENTICATION_CLIENT | Gio.DBusConnectionFlags.MESSAGE_BUS_CONNECTION)
        node = Gio.DBusNodeInfo.new_for_xml(
            "<node><interface name='org.freedesktop.portal.Settings'><method name='Read'><arg type='s' direction='in'/>"
            "<arg type='s' direction='in'/><arg type='v' direction='out'/></method></interface></node>")

        def answer(_bus, _sender, _path, _interface, _method, parameters, invocation):
            assert parameters.unpack() == ("org.freedesktop.appearance", "color-scheme")
            invocation.return_value(GLib.Variant("(v)", [GLib.Variant("v", GLib.Variant("u", 1))]))

        bus.register_object("/org/freedesktop/portal/desktop", node.interfaces[0], answer, None, None)
        bus.call_sync("org.freedesktop.DBus", "/org/freedesktop/DBus", "org.freedesktop.DBus", "RequestName",
                      GLib.Variant("(su)", ["org.freedesktop.portal.Desktop", 4]), None,
                      Gio.DBusCallFlags.NONE, -1, None)
        threading.Thread(target=GLib.MainLoop().run, daemon=True).start()
        return bus

    def close(self):
        for process in (self.bus, self.screen):
            process.terminate()
            process.wait()


def colour(picture, x, y):
    """The colour of a picture's pixel as (red, green, blue), each 0 to 255."""
    out = subprocess.run(["convert", picture, "-crop", f"1x1+{x}+{y}", "-depth", "8", "rgb:-"], capture_output=True,
                         timeout=PATIENCE, check=True).stdout
    return tuple(out)


def tool(*arguments):
    return subprocess.run(arguments, capture_output=True, text=True, timeout=PATIENCE, check=True).stdout


class Monitor:
    """A running `pelorus`."""

    def __init__(self, program, directory, *arguments, size=None):
        environment = dict(os.environ, PELORUS_PORT_DIRECTORY=directory, XDG_STATE_HOME=directory + "/state",
                           XDG_CONFIG_HOME=directory + "/config", TZ="UTC")
        started = time.monotonic()
        self.process = subprocess.Popen([program, *arguments], env=environment, stdin=subprocess.DEVNULL,
                                        stdout=subprocess.PIPE, stderr=subprocess.PIPE, text=True)
        self.window = wait_for("the window", self.find_window)
        self.seconds_to_window = time.monotonic() - started
        tool("xdotool", "mousemove", "1", "1", "windowfocus", "--sync", self.window)
        if size:
            tool("xdotool", "windowsize", "--sync", self.window, *map(str, size))
        self.application = wait_for("accessibility", self.find_application)
        self.application.set_cache_mask(Atspi.Cache.NONE)

    def find_window(self):
        found = subprocess.run(["xdotool", "search", "--onlyvisible", "--pid", str(self.process.pid)],
                               capture_output=True, text=True, check=False).stdout.split()
        return found[0] if found else None

    def find_application(self):
        desktop = Atspi.get_desktop(0)
        for index in range(desktop.get_child_count()):
            child = desktop.get_child_at_index(index)
            if child and child.get_process_id() == self.process.pid and child.get_child_count() > 0:
                return child
        return None

    def each(self, role):
        """What is seen of that role, depth first."""
        waiting = [self.application]
        while waiting:
            node = waiting.pop()
            if node.get_role_name() == role and node.get_state_set().contains(Atspi.StateType.SHOWING):
                yield node
            if node.get_role_name() != "list":
                waiting += [child for child in map(node.get_child_at_index, range(node.get_child_count())) if child]

    def rows(self):
        """The rows of the pane as (name, value)."""
        table = [table for table in self.each("list")][0]
        items = [table.get_child_at_index(index) for index in range(table.get_child_count())]
        return [(item.get_name(), item.get_description()) for item in items]

    def value(self, name):
        return dict(self.rows()).get(name)

    def labels(self):
        return [label.get_name() for label in self.each("label")]

    def is_busy(self):
        return any(node.get_name() == "Busy" for node in self.each("animation"))

    def shows(self, start):
        return any(label.startswith(start) for label in self.labels())

    def title(self):
        return [table.get_name() for table in self.each("list")][0]

    def keys(self, *keys):
        tool("xdotool", "key", "--delay", "30", *keys)

    def type(self, text):
        tool("xdotool", "type", "--delay", "15", text)

    def open_row(self, index, title):
        self.keys("Home", *["Down"] * index, "Return")
        wait_for("the pane " + title, lambda: self.title() == title)

    def size(self):
        lines = tool("xdotool", "getwindowgeometry", "--shell", self.window).split()
        geometry = dict(line.split("=") for line in lines)
        return int(geometry["WIDTH"]), int(geometry["HEIGHT"])

    def picture(self, path):
        time.sleep(0.4)  # whatever slides has arrived
        tool("import", "-window", self.window, path)

    def end(self, how=signal.SIGTERM):
        self.process.send_signal(how)
        return self.wait()

    def wait(self):
        output, errors = self.process.communicate(timeout=PATIENCE)
        return self.process.returncode, output, errors

    def kill(self):
        if self.process.poll() is None:
            self.process.kill()
            self.process.communicate()
