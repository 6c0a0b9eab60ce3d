"""Commands that are run to their end and measured, alone and in pairs."""

import dataclasses
import json
import os
import statistics
import subprocess


@dataclasses.dataclass(frozen=True)
class Run:
    wall: float  # seconds on the clock
    processor: float  # seconds of processor time, the kernel's share included
    peak: int  # KiB resident


@dataclasses.dataclass(frozen=True)
class Spread:
    """The median of some measurements and the quartiles around it."""
    low: float
    median: float
    high: float

    @classmethod
    def of(cls, values):
        if len(values) == 1:
            return cls(values[0], values[0], values[0])
        low, median, high = statistics.quantiles(values, n=4, method="inclusive")
        return cls(low, median, high)


def one_core():
    """The prefix of a command that keeps it on one core, the last that we may use."""
    return ["taskset", "-c", str(max(os.sched_getaffinity(0)))]


class Measure:
    """Runs commands on one core through the program bench_Measure."""

    def __init__(self, program):
        self.program = program

    def once(self, command):
        result = subprocess.run([*one_core(), self.program, *command], stdin=subprocess.DEVNULL, check=True,
                                capture_output=True, text=True)
        told = json.loads(result.stdout)
        if told["status"] != 0:
            raise RuntimeError(f"{' '.join(map(str, command))} ended with {told['status']}")
        return Run(told["wall"], told["processor"], told["peak"])

    def several(self, command, rounds):
        """The runs after a first one, which does not count."""
        self.once(command)
        return [self.once(command) for _ in range(rounds)]

    def pairs(self, ours, theirs, rounds):
        """Both in turn, each being the first of its pair every other time: what else the machine does meets both.
        Pairs of runs."""
        self.once(ours)
        found = []
        for number in range(rounds):
            if number % 2:
                mine = self.once(ours)
                other = self.once(theirs)
            else:
                other = self.once(theirs)
                mine = self.once(ours)
            found.append((mine, other))
        return found


def median(runs, what):
    return statistics.median(getattr(run, what) for run in runs)
