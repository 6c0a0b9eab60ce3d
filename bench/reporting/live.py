"""Programs that run on: how soon they are there, and what they use."""

import contextlib
import os
import pathlib
import socket
import statistics
import subprocess
import tempfile
import time

from .recordings import LTE
from .text import megabytes, number, seconds, table

SERVER_PORT = "io.pelorus.TelephonyServer"
RATES = (100, 1000, 5000)
WARM_UP = 5  # seconds that do not count
PATIENCE = 20  # seconds for anything to start


def environment(directory):
    """Settings and ports of their own, no display, no bus: nothing of the user's is touched."""
    kept = {key: value for key, value in os.environ.items()
            if key not in ("DISPLAY", "WAYLAND_DISPLAY", "DBUS_SESSION_BUS_ADDRESS", "XDG_RUNTIME_DIR")}
    return dict(kept, PELORUS_PORT_DIRECTORY=str(directory), XDG_CONFIG_HOME=str(directory),
                XDG_STATE_HOME=str(directory), QT_QPA_PLATFORM="offscreen", TERM="dumb")


@contextlib.contextmanager
def started(command, directory, **options):
    """The program, ended with the block."""
    options = {"stdin": subprocess.DEVNULL, "stdout": subprocess.DEVNULL, "stderr": subprocess.DEVNULL, **options}
    process = subprocess.Popen(command, env=environment(directory), **options)
    try:
        yield process
    finally:
        process.terminate()
        try:
            process.wait(PATIENCE)
        except subprocess.TimeoutExpired:
            process.kill()
            process.wait()
        if process.stderr:
            process.stderr.close()


@contextlib.contextmanager
def port_directory(scratch):
    with tempfile.TemporaryDirectory(dir=scratch) as directory:  # of mode 0700, as it has to be
        yield pathlib.Path(directory)


def until_it_asks(command, scratch):
    """Seconds from the start until a client connects to the telephony server."""
    with port_directory(scratch) as directory, socket.socket(socket.AF_UNIX) as listener:
        listener.bind(str(directory / SERVER_PORT))
        (directory / SERVER_PORT).chmod(0o600)
        listener.listen()
        listener.settimeout(PATIENCE)
        begin = time.monotonic()
        with started(command, directory):
            peer, _ = listener.accept()
            taken = time.monotonic() - begin
            peer.close()
        return taken


def until_it_listens(command, scratch):
    with port_directory(scratch) as directory:
        begin = time.monotonic()
        with started(command, directory, stderr=subprocess.PIPE, text=True) as process:
            line = process.stderr.readline()
            if not line.startswith("listening on"):
                raise RuntimeError(f"{command[0]} says: {line}")
            return time.monotonic() - begin


def start_up(programs, recordings, measure, scratch, rounds):
    def usual(function, *arguments):
        function(*arguments)  # what only the first time costs does not count
        return seconds(statistics.median(function(*arguments) for _ in range(rounds)))

    empty = recordings.without_messages()
    decode = [programs / "pelorusctl", "decode", "--technology", LTE, empty]
    return table(["program", "from its start until", "time"], [
        ["`pelorusctl decode`", "its end, of a recording without messages", usual(lambda: measure.once(decode).wall)],
        ["`pelorusctl live`", "it asks the telephony server for a log channel",
         usual(until_it_asks, [programs / "pelorusctl", "live"], scratch)],
        ["`pelorus`", "the same, its window being shown before (offscreen)",
         usual(until_it_asks, [programs / "pelorus"], scratch)],
        ["`pelorus-telephonyd`", "it listens",
         usual(until_it_listens, [programs / "pelorus-telephonyd", "--simulate", LTE], scratch)]])


def processor_seconds(process):
    """Of all threads, to the nanosecond where ticks of the clock would be too coarse."""
    return sum(int((task / "schedstat").read_text().split()[0])
               for task in pathlib.Path(f"/proc/{process.pid}/task").iterdir()) / 1e9


def resident(process):
    status = pathlib.Path(f"/proc/{process.pid}/status").read_text()
    return {line.split(":")[0]: int(line.split()[1]) for line in status.splitlines() if line.endswith("kB")}["VmHWM"]


def live(programs, scratch, length):
    """All rates and clients at once, each with a server of its own: little of the machine is used."""
    clients = {"`pelorusctl live`": [programs / "pelorusctl", "live"], "`pelorus`": [programs / "pelorus"]}
    with contextlib.ExitStack() as stack:
        running = []
        for rate in RATES:
            for name, command in clients.items():
                directory = stack.enter_context(port_directory(scratch))
                server = stack.enter_context(started([programs / "pelorus-telephonyd", "--simulate", LTE, "--seed",
                                                      "1", "--rate", str(rate)], directory))
                await_path(directory / SERVER_PORT)
                client = stack.enter_context(started(command, directory))
                running.append((rate, name, client, server))
        time.sleep(WARM_UP)
        begin = time.monotonic()
        before = [(processor_seconds(client), processor_seconds(server)) for _, _, client, server in running]
        time.sleep(length)
        after = [(processor_seconds(client), processor_seconds(server)) for _, _, client, server in running]
        passed = time.monotonic() - begin

        def share(index, which):
            return f"{number((after[index][which] - before[index][which]) / passed * 100)} %"

        rows = [[f"{rate:,}", name, share(index, 0), megabytes(resident(client)), share(index, 1)]
                for index, (rate, name, client, server) in enumerate(running)]
    log = ("A system log takes the lines at `/dev/log`." if pathlib.Path("/dev/log").is_socket() else
           "No system log takes the lines, `/dev/log` is not there.")
    head = ["messages/s", "program", "of one core", "peak resident", "the server's part of a core"]
    return f"{table(head, rows)}\n\n{log}"


def await_path(path):
    deadline = time.monotonic() + PATIENCE
    while not path.exists():
        if time.monotonic() > deadline:
            raise RuntimeError(f"{path.name} did not come")
        time.sleep(0.02)
