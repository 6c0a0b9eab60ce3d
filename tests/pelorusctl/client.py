"""A client of the telephony server that knows nothing but its ports."""

import os
import plistlib

from telephony import ONE_WAY, REPLY, REQUEST, connect, frame, listen, receive

START_COMMAND = {"SetState": "Streaming", "SetOspreyLogCodes": [0xB0C1, 0xB0C2, 0xB179, 0xB17F, 0xB180, 0xB186],
                 "SetCtExtraCodes": [0, 1, 2]}


class Client:
    """A monitor's end of a channel, made on the port of that name."""

    def __init__(self, directory, name):
        listener = listen(directory, name)
        server = connect(directory, "io.pelorus.TelephonyServer")
        server.sendall(frame(plistlib.dumps({"CreateLogChannel": name}), REQUEST, 7, 1))
        payload, message_id, kind, sequence = receive(server)
        assert (message_id, kind, sequence) == (1, REPLY, 7), (message_id, kind, sequence)
        answer = plistlib.loads(payload)
        assert answer["Error"] == 0, answer
        self.commands = connect(directory, answer["RemotePort"])
        self.data = listener.accept()[0]
        self.data.settimeout(10)
        listener.close()
        os.unlink(os.path.join(directory, name))
        server.close()

    def technology(self):
        self.commands.sendall(frame(plistlib.dumps({"GetTechnology": "GetTechnology"}), REQUEST, 9))
        payload, _, kind, sequence = receive(self.commands)
        assert (kind, sequence) == (REPLY, 9)
        return plistlib.loads(payload)["GetTechnology"]

    def start(self, command=START_COMMAND):
        self.commands.sendall(frame(plistlib.dumps(command)))

    def messages(self, count):
        received = []
        for _ in range(count):
            payload, message_id, kind, _ = receive(self.data)
            assert (message_id, kind) == (0, ONE_WAY)
            received.append(payload)
        return received

    def close(self):
        self.data.close()
        self.commands.close()
