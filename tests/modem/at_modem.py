"""A modem that exists only as its answers to AT commands, on an abstract Unix socket that ModemManager connects to."""

import socket
import threading

# Just enough to be registered on LTE (3GPP TS 27.007), lines by command. What is not here is an error.
ANSWERS = {
    "": [], "E0": [], "V1": [], "X4": [], "&C1": [], "+CMEE=1": [], "+IFC=1,1": [], "Z": [], "&F": [],
    "+GCAP": ["+GCAP: +CGSM"],
    "I": ["Test modem"],
    "+CGMI": ["Nobody"], "+CGMM": ["Thin air"], "+CGMR": ["1.0"], "+CGSN": ["123456789012347"],
    "+CIMI": ["001010123456789"],
    "+CNUM": ['+CNUM: ,"+491713920012",145'],
    "+CPIN?": ["+CPIN: READY"],
    '+CLCK=?': ['+CLCK: ("SC")'], '+CLCK="SC",2': ["+CLCK: 0"],
    "+CFUN?": ["+CFUN: 1"], "+CFUN=1": [],
    "+CREG=2": [], "+CGREG=2": [], "+CREG=0": [], "+CGREG=0": [],
    "+CREG?": ['+CREG: 2,1,"31C5","083F7CD",7'], "+CGREG?": ['+CGREG: 2,1,"31C5","083F7CD",7'],
    "+COPS=3,2;+COPS?": ['+COPS: 0,2,"00101",7'], "+COPS=3,0;+COPS?": ['+COPS: 0,0,"Test Network",7'],
    "+COPS=3,2": [], "+COPS=3,0": [], "+COPS?": ['+COPS: 0,2,"00101",7'], "+COPS=0": [],
    "+WS46=?": ["+WS46: (12,22,25,28,29)"], "+WS46?": ["+WS46: 25"],
    "+CGDCONT=?": ['+CGDCONT: (1-8),"IP",,,(0),(0)', '+CGDCONT: (1-8),"IPV6",,,(0),(0)',
                   '+CGDCONT: (1-8),"IPV4V6",,,(0),(0)'],
    "+CGDCONT?": [],
    '+CSCS=?': ['+CSCS: ("IRA","GSM","UCS2")'], "+CMGF=?": ["+CMGF: (0,1)"],
    "+CSQ": ["+CSQ: 20,99"],
    "+CESQ": ["+CESQ: 99,99,255,255,20,80"], "+CESQ=?": ["+CESQ: (0-63,99),(0-7,99),(0-96,255),(0-34,255),(0-34,255),(0-97,255)"],
    # SIM files: 12258 the ICCID (digits swapped), 28589 administrative data, 28486 the provider's name.
    "+CRSM=176,12258,0,0,10": ['+CRSM: 144,0,"98941000002143658779"'],
    "+CRSM=176,28589,0,0,4": ['+CRSM: 144,0,"00000002"'],
    "+CRSM=176,28486,0,0,17": ['+CRSM: 144,0,"0054657374204E6574776F726BFFFFFFFF"'],
}


class AtModem:
    """Answers whoever connects. `unknown` holds the commands that it had no answer to."""

    def __init__(self, name="port0", answers=None):
        self.answers = dict(ANSWERS, **(answers or {}))
        self.unknown = []
        self.port = "abstract:" + name
        self.listener = socket.socket(socket.AF_UNIX, socket.SOCK_STREAM)
        self.listener.bind("\0" + self.port)
        self.listener.listen(4)
        self.connections = []
        threading.Thread(target=self.accept, daemon=True).start()

    def accept(self):
        while True:
            try:
                connection, _ = self.listener.accept()
            except OSError:
                return
            self.connections.append(connection)
            threading.Thread(target=self.serve, args=(connection,), daemon=True).start()

    def serve(self, connection):
        waiting = b""
        while True:
            try:
                data = connection.recv(4096)
            except OSError:
                return
            if not data:
                return
            waiting += data
            while b"\r" in waiting:
                line, waiting = waiting.split(b"\r", 1)
                command = line.decode("ascii", "replace").strip()
                if command:
                    connection.sendall(self.answer(command).encode())

    def answer(self, command):
        if not command.upper().startswith("AT"):
            return "\r\nERROR\r\n"
        lines = self.answers.get(command[2:])
        if lines is None:
            self.unknown.append(command)
            return "\r\nERROR\r\n"
        return "".join("\r\n%s\r\n" % line for line in lines) + "\r\nOK\r\n"

    def close(self):
        self.listener.shutdown(socket.SHUT_RDWR)  # wakes who waits in accept()
        self.listener.close()
        for connection in self.connections:
            connection.close()
