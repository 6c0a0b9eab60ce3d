"""How the cost of decoding grows."""

from .processes import median
from .recordings import LTE
from .text import megabytes, number, seconds, table

LENGTHS = (10_000, 100_000, 1_000_000)
NEIGHBOURS = (0, 1, 2, 4, 8, 16, 32)
REPORTS = 50_000


def decode(programs, recording, *options):
    return [programs / "pelorusctl", "decode", "--technology", LTE, *options, recording]


def length(programs, recordings, measure, rounds):
    rows = []
    for count in LENGTHS:
        recording = recordings.simulated(count)
        for shown, options in (("at the end", ()), ("every 2 s", ("--every", "2"))):
            runs = measure.several(decode(programs, recording, *options), rounds)
            processor = median(runs, "processor")
            rows.append([f"{count:,}", shown, seconds(processor), f"{number(count / processor)} messages/s",
                         megabytes(median(runs, "peak"))])
    return table(["messages", "tree shown", "processor time", "rate", "peak resident"], rows)


def neighbours(programs, recordings, measure, rounds):
    nothing = median(measure.several(decode(programs, recordings.without_messages()), rounds), "processor")
    rows = []
    first = None
    for each in NEIGHBOURS:
        runs = measure.several(decode(programs, recordings.neighbours(each, REPORTS)), rounds)
        report = (median(runs, "processor") - nothing) / REPORTS
        first = report if first is None else first
        rows.append([each, seconds(report), seconds((report - first) / each) if each else "",
                     megabytes(median(runs, "peak"))])
    return table(["neighbours", "processor time a report", "of it for each neighbour", "peak resident"], rows)
