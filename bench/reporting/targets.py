"""What the programs are compared with, what is asked of them there, and what a profile says of where the rest goes.

A ratio is how many times as good ours is: as fast, as small, as soon there."""

import dataclasses

PACKETS = 300_000


@dataclasses.dataclass(frozen=True)
class Target:
    name: str
    least: float | None = None
    aim: float | None = None
    why: str = ""  # shown where the aim is missed

    def verdict(self, ratio):
        if self.least is None:
            return ""
        if ratio >= (self.least if self.aim is None else self.aim):
            return "yes" if self.aim is None else "the aim"
        return f"{'at least' if ratio >= self.least else '**no**'}: {self.why}"


FIELDS = Target("`tshark -T fields`, 8 fields", 25, 50, "writing rows, then reading the file")
LOGGED = Target("the same with our system log written to a file")
TEXT = Target("`tshark -V`: every row of every message as text, once", 10, 30,
              "nearly all of it goes into the refresh: building the tree and writing its text")
WHOLE = Target("the same, our whole tree after each message")
FRAMING = Target("`tcpdump -r FILE -w /dev/null`: reading and framing", 0.5, 1, "the program's start")
WALK = "walking in memory, dispatch and three fields: "
WALK_LTE = Target(WALK + "Osprey LTE", 1 / 40, 1 / 10,
                  "dispatch and the copy of a packet that waits take four tenths of it, the telephony server's lists a quarter")
FRAMES = Target("a bare socket, a frame a write: receiving and framing", 0.5, 0.8,
                "what each wake-up passes on its way from the socket to the callback")
BATCHES = Target("decoding a recording: receiving 64 frames a write, and decoding", 0.7, 0.9,
                 "what each frame passes on its way from the socket to the callback, and the sender's part")
LIST = Target("libplist's own parse of a binary list of 6 cells: parse and rows", 1, 5,
              "reading the list takes eight tenths of it, much of that in the allocator")
START = Target("tshark's start-up: one packet, on the clock", 20, None, "loading and binding the shared libraries")
PEAK = Target(f"tshark's peak memory, {PACKETS:,} packets", 10, None, "the shared libraries")
GROWTH = Target("our own peak memory of 10,000 messages: 1,000,000", 0.9, None, "what grows with the messages")
