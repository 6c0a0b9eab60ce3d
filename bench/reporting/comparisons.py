"""The programs beside others that do the same kind of work, and what is aimed at."""

import dataclasses
import statistics

from .growth import decode
from .processes import Spread
from .recordings import LTE
from .text import megabytes, number, seconds, table, times

PACKETS = 300_000
SHOWN = 90_000  # whole rounds of a handset's nine log codes
FIELDS = ["frame.time_epoch", "gsmtap.type", "gsmtap.arfcn", "gsmtap.signal_dbm", "gsmtap.frame_nr",
          "lte-rrc.physCellId", "lte-rrc.rsrpResult", "lte-rrc.rsrqResult"]


@dataclasses.dataclass(frozen=True)
class Line:
    """One comparison: how many times as good ours is, and the two measurements in words."""
    name: str
    ratio: Spread
    ours: str
    theirs: str
    least: float | None = None
    aim: float | None = None

    def verdict(self, reasons):
        if self.least is None:
            return ""
        if self.aim is not None and self.ratio.median >= self.aim:
            return "the aim"
        if self.ratio.median >= self.least:
            return "yes"
        return f"**no**: {reasons.get(self.name, 'not looked into')}"

    def row(self, reasons):
        low, median, high = (times(value) for value in (self.ratio.low, self.ratio.median, self.ratio.high))
        least, aim = (times(value) if value is not None else "" for value in (self.least, self.aim))
        return [self.name, self.ours, self.theirs, f"{median} ({low} to {high})", least, aim, self.verdict(reasons)]


# Why what is not met is not, as a profile told.
REASONS = {}


def ratios(pairs, what, ours=1.0, theirs=1.0):
    """By how much more the others take; `ours` and `theirs` are how much work each does."""
    return Spread.of([getattr(other, what) / theirs / (getattr(mine, what) / ours) for mine, other in pairs])


def rate(runs, work):
    return f"{number(work / statistics.median(run.processor for run in runs))} messages/s"


class Comparisons:
    def __init__(self, programs, recordings, measure, bench, rounds):
        self.programs = programs
        self.recordings = recordings
        self.measure = measure
        self.bench = bench
        self.rounds = rounds

    def by_processor(self, name, ours, theirs, work, their_work=None, **targets):
        their_work = their_work or work
        pairs = self.measure.pairs(ours, theirs, self.rounds)
        line = Line(name, ratios(pairs, "processor", work, their_work), rate([mine for mine, _ in pairs], work),
                    rate([other for _, other in pairs], their_work), **targets)
        return line, pairs

    def lines(self):
        yield from self.tshark_fields()
        yield from self.tshark_text()
        yield self.by_processor(
            "`tcpdump -r FILE -w /dev/null`: reading and framing",
            decode(self.programs, self.recordings.simulated(PACKETS, "--unknown")),
            ["tcpdump", "-r", self.recordings.simulated(PACKETS, "--unknown"), "-w", "/dev/null"],
            PACKETS, least=0.5, aim=1)[0]
        yield from self.in_memory()
        yield self.tshark_start()

    def tshark_fields(self):
        capture, _ = self.recordings.radio(PACKETS)
        fields = [part for field in FIELDS for part in ("-e", field)]
        theirs = ["tshark", "-n", "-r", capture, "-T", "fields", *fields]
        ours = decode(self.programs, self.recordings.simulated(PACKETS))
        line, pairs = self.by_processor("`tshark -T fields`, 8 fields", ours, theirs, PACKETS, least=25, aim=50)
        yield line
        peaks = [statistics.median(run.peak for run in runs) for runs in zip(*pairs)]
        yield Line(f"tshark's peak memory, {PACKETS:,} packets", ratios(pairs, "peak"), megabytes(peaks[0]),
                   megabytes(peaks[1]), least=10)
        log = self.recordings.directory / "system.log"
        runs = self.measure.several([*ours, "--system-log", log], self.rounds)
        yield Line("the same with the system log written to a file",
                   Spread.of([other.processor / mine.processor for mine, (_, other) in zip(runs, pairs)]),
                   rate(runs, PACKETS), line.theirs)
        log.unlink()

    def tshark_text(self):
        capture, _ = self.recordings.radio(SHOWN)
        theirs = ["tshark", "-n", "-V", "-r", capture]
        once = self.recordings.simulated(SHOWN, "--rounds")
        yield self.by_processor("`tshark -V`: every row of every message as text, once",
                                decode(self.programs, once, "--every", "0.5"), theirs, SHOWN, least=10, aim=30)[0]

    def in_memory(self):
        for label, found in self.bench.comparisons("Stream").items():
            targets = {"least": 1 / 40, "aim": 1 / 10} if label == LTE else {}
            yield rates(f"walking in memory, dispatch and three fields: {label}", found, "messages/s", **targets)
        found = self.bench.comparisons("Sockets")
        yield rates("bare socket, a frame a write: receiving and framing", found["framesBesideRaw"], "messages/s",
                    least=0.5, aim=0.8)
        yield rates("decoding in memory: receiving 64 frames a write, and decoding", found["batchesBesideMemory"],
                    "messages/s", least=0.7, aim=0.9)
        found, = self.bench.comparisons("CellList").values()
        yield rates("libplist's own parse of a binary list of 6 cells: parse and rows", found, "lists/s",
                    least=1, aim=5)

    def tshark_start(self):
        theirs = ["tshark", "-n", "-r", self.recordings.radio(1)[0]]
        pairs = self.measure.pairs(decode(self.programs, self.recordings.simulated(1)), theirs, 3 * self.rounds)
        walls = [statistics.median(run.wall for run in runs) for runs in zip(*pairs)]
        return Line("tshark's start-up: one packet, on the clock", ratios(pairs, "wall"), seconds(walls[0]),
                    seconds(walls[1]), least=20)


def rates(name, found, unit, **targets):
    return Line(name, found.ratio, f"{number(found.ours)} {unit}", f"{number(found.theirs)} {unit}", **targets)


def comparisons(*context):
    return table(["against", "ours", "theirs", "times as good (quartiles)", "at least", "aim", "met"],
                 [line.row(REASONS) for line in Comparisons(*context).lines()])
