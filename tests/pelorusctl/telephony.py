"""A telephony server that does what a test says: its own implementation of ports and frames."""

import os
import plistlib
import socket
import struct
import time

LOCAL_PORT = "io.pelorus.BasebandStateReport.LogChannel"
ONE_WAY, REQUEST, REPLY = 0, 1, 2
PATIENCE = 12  # seconds; no client takes longer for its next step


def frame(payload, kind=ONE_WAY, sequence=0, message_id=0):
    length = 0xFFFFFFFF if payload is None else len(payload)
    return struct.pack("<IiII", length, message_id, kind, sequence) + (payload or b"")


def receive(connection):
    """The next frame as (payload, message id, kind, sequence); None when the peer is gone."""
    def exactly(count):
        data = b""
        while len(data) < count:
            try:
                piece = connection.recv(count - len(data))
            except ConnectionResetError:
                return None
            if not piece:
                return None
            data += piece
        return data

    header = exactly(16)
    if header is None:
        return None
    length, message_id, kind, sequence = struct.unpack("<IiII", header)
    payload = None if length == 0xFFFFFFFF else exactly(length)
    return payload, message_id, kind, sequence


def listen(directory, name):
    listener = socket.socket(socket.AF_UNIX)
    listener.bind(os.path.join(directory, name))
    os.chmod(os.path.join(directory, name), 0o600)
    listener.listen()
    listener.settimeout(PATIENCE)
    return listener


def connect(directory, name):
    connection = socket.socket(socket.AF_UNIX)
    connection.settimeout(PATIENCE)
    connection.connect(os.path.join(directory, name))
    return connection


class Request:
    """A client's request for a channel, which waits for its reply."""

    def __init__(self, connection):
        self.connection = connection
        self.connection.settimeout(PATIENCE)
        payload, message_id, kind, self.sequence = receive(connection)
        assert (message_id, kind) == (1, REQUEST)
        assert payload.startswith(b"<?xml")
        assert plistlib.loads(payload) == {"CreateLogChannel": LOCAL_PORT}
        self.time = time.monotonic()

    def reply(self, content):
        payload = content if isinstance(content, bytes) else plistlib.dumps(content)
        self.raw(frame(payload, REPLY, self.sequence, 1))

    def raw(self, data):
        try:
            self.connection.sendall(data)
        except OSError:  # a client that waits no longer
            pass

    def close(self):
        self.connection.close()


class Channel:
    """An established channel: `data` goes to the client, `commands` come from it."""

    def __init__(self, data, commands):
        self.data = data
        self.commands = commands
        self.start_command = None

    def send(self, message, message_id=0):
        self.data.sendall(frame(message, message_id=message_id))

    def close(self):
        self.data.close()
        self.commands.close()


class TelephonyServer:
    def __init__(self, directory):
        self.directory = directory
        self.listener = listen(directory, "io.pelorus.TelephonyServer")
        self.command_listener = listen(directory, "test.Commands")
        self.sockets = [self.listener, self.command_listener]

    def kept(self, connection):
        self.sockets.append(connection)
        return connection

    def request(self):
        return Request(self.kept(self.listener.accept()[0]))

    def answered(self, request):
        """The channel that a granted request leads to, up to the question for the technology."""
        request.reply({"Error": 0, "RemotePort": "test.Commands"})
        commands = self.kept(self.command_listener.accept()[0])
        commands.settimeout(PATIENCE)
        channel = Channel(self.kept(connect(self.directory, LOCAL_PORT)), commands)
        payload, message_id, kind, sequence = receive(commands)
        assert (message_id, kind) == (0, REQUEST)
        assert payload.startswith(b"<?xml")
        assert plistlib.loads(payload) == {"GetTechnology": "GetTechnology"}
        return channel, sequence

    def channel(self, technology="Osprey LTE", request=None):
        """Grants a request, the next one unless it is given, and answers what the client asks."""
        channel, sequence = self.answered(request or self.request())
        channel.commands.sendall(frame(plistlib.dumps({"GetTechnology": technology}), REPLY, sequence))
        payload, message_id, kind, _ = receive(channel.commands)
        assert (message_id, kind) == (0, ONE_WAY)
        assert payload.startswith(b"<?xml")
        channel.start_command = plistlib.loads(payload)
        return channel

    def close(self):
        for each in self.sockets:
            each.close()
