"""The programs beside others that do the same kind of work, and what is aimed at."""

import statistics

from . import targets
from .growth import decode
from .processes import Spread, median
from .recordings import LTE
from .targets import PACKETS, Target
from .text import megabytes, number, seconds, table, times

SHOWN = 90_000  # whole rounds of a handset's nine log codes
FEW, MANY = 10_000, 1_000_000  # messages, of which flat memory is the same within a tenth
FIELDS = ["frame.time_epoch", "gsmtap.type", "gsmtap.arfcn", "gsmtap.signal_dbm", "gsmtap.frame_nr",
          "lte-rrc.physCellId", "lte-rrc.rsrpResult", "lte-rrc.rsrqResult"]


def row(target, ratio, ours, theirs):
    least, aim = (times(value) if value is not None else "" for value in (target.least, target.aim))
    return [target.name, ours, theirs, f"{times(ratio.median)} ({times(ratio.low)} to {times(ratio.high)})", least, aim,
            target.verdict(ratio.median)]


def both(target, pairs, what, say):
    """`what` each of the two took, in words by `say`."""
    ratio = Spread.of([getattr(theirs, what) / getattr(ours, what) for ours, theirs in pairs])
    return row(target, ratio, *(say(median(runs, what)) for runs in zip(*pairs)))


def rate(work):
    return lambda taken: f"{number(work / taken)} messages/s"


class Comparisons:
    def __init__(self, programs, recordings, measure, bench, rounds):
        self.programs = programs
        self.recordings = recordings
        self.measure = measure
        self.bench = bench
        self.rounds = rounds

    def decode(self, recording, *options):
        return decode(self.programs, recording, *options)

    def rows(self):
        yield from self.beside_fields()
        yield self.growth()
        yield from self.beside_text()
        yield self.beside_framing()
        yield from self.in_memory()
        yield self.beside_start()

    def beside_fields(self):
        fields = [part for field in FIELDS for part in ("-e", field)]
        theirs = ["tshark", "-n", "-r", self.recordings.radio(PACKETS), "-T", "fields", *fields]
        ours = self.decode(self.recordings.simulated(PACKETS))
        pairs = self.measure.pairs(ours, theirs, self.rounds)
        yield both(targets.FIELDS, pairs, "processor", rate(PACKETS))
        log = self.recordings.directory / "system.log"
        logged = self.measure.several([*ours, "--system-log", log], self.rounds)
        log.unlink()
        yield both(targets.LOGGED, [(ours, theirs) for ours, (_, theirs) in zip(logged, pairs)], "processor",
                   rate(PACKETS))
        yield both(targets.PEAK, pairs, "peak", megabytes)

    def growth(self):
        pairs = self.measure.pairs(self.decode(self.recordings.simulated(MANY)),
                                   self.decode(self.recordings.simulated(FEW)), self.rounds)
        return both(targets.GROWTH, pairs, "peak", megabytes)

    def beside_text(self):
        pairs = self.measure.pairs(self.decode(self.recordings.simulated(SHOWN, "--rounds"), "--every", "0.5"),
                                   ["tshark", "-n", "-V", "-r", self.recordings.radio(SHOWN)], self.rounds)
        yield both(targets.TEXT, pairs, "processor", rate(SHOWN))
        # The messages of one measurement are 2 ms apart.
        whole = self.measure.several(self.decode(self.recordings.simulated(SHOWN), "--every", "0.001"), self.rounds)
        yield both(targets.WHOLE, [(ours, theirs) for ours, (_, theirs) in zip(whole, pairs)], "processor", rate(SHOWN))

    def beside_framing(self):
        recording = self.recordings.simulated(PACKETS, "--unknown")
        pairs = self.measure.pairs(self.decode(recording), ["tcpdump", "-r", recording, "-w", "/dev/null"],
                                   3 * self.rounds)
        return both(targets.FRAMING, pairs, "processor", rate(PACKETS))

    def in_memory(self):
        for label, found in self.bench.comparisons("Stream").items():
            yield rates(targets.WALK_LTE if label == LTE else Target(targets.WALK + label), found, "messages/s")
        found = self.bench.comparisons("Sockets")
        yield rates(targets.FRAMES, found["framesBesideRaw"], "messages/s")
        yield rates(targets.BATCHES, found["batchesBesideRecording"], "messages/s")
        found, = self.bench.comparisons("CellList").values()
        yield rates(targets.LIST, found, "lists/s")

    def beside_start(self):
        pairs = self.measure.pairs(self.decode(self.recordings.simulated(1)),
                                   ["tshark", "-n", "-r", self.recordings.radio(1)], 3 * self.rounds)
        return both(targets.START, pairs, "wall", seconds)


def rates(target, found, unit):
    return row(target, found.ratio, f"{number(found.ours)} {unit}", f"{number(found.theirs)} {unit}")


def comparisons(*context):
    return table(["against", "ours", "theirs", "times as good (quartiles)", "at least", "aim", "met"],
                 Comparisons(*context).rows())
