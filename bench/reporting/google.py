"""The Google benchmarks, read from their JSON."""

import json
import os
import subprocess

from .processes import Spread, one_core
from .text import number, seconds, table

UNITS = {"ns": 1e-9, "us": 1e-6, "ms": 1e-3, "s": 1}


class Benchmarks:
    def __init__(self, directory, scratch, quick):
        self.directory = directory
        self.environment = dict(os.environ, TMPDIR=str(scratch))
        self.quick = quick

    def run(self, program, *options):
        command = [*one_core(), self.directory / f"bench_{program}", "--benchmark_format=json", *options]
        result = subprocess.run(command, check=True, capture_output=True, text=True, env=self.environment)
        found = json.loads(result.stdout)["benchmarks"]
        for entry in found:
            if entry.get("error_occurred"):
                raise RuntimeError(f"bench_{program}: {entry['name']}: {entry['error_message']}")
        return found

    def medians(self, program, pattern=".*"):
        """Of the benchmarks that compare nothing; each with its name before the first slash as "of"."""
        entries = self.run(program, f"--benchmark_filter={pattern}", "--benchmark_report_aggregates_only=true",
                           f"--benchmark_repetitions={3 if self.quick else 7}",
                           f"--benchmark_min_time={0.1 if self.quick else 0.3}")
        return [dict(entry, of=entry["run_name"].split("/")[0]) for entry in entries
                if entry["aggregate_name"] == "median"]

    def comparisons(self, program, pattern="Beside"):
        """By label, or by name where there is none: the ratio, and what ours and the other side did a second."""
        return {entry.get("label") or entry["name"].split("/")[0]: Comparison(entry)
                for entry in self.run(program, f"--benchmark_filter={pattern}")}


class Comparison:
    def __init__(self, entry):
        self.ratio = Spread(entry["low"], entry["ratio"], entry["high"])
        self.ours = entry["ours"]
        self.theirs = entry["theirs"]
        self.bytes = entry.get("bytes")


def processor(entry):
    return entry["cpu_time"] * UNITS[entry["time_unit"]]


def stream(bench):
    rows = {}
    for entry in bench.medians("Stream", "^(walk|decode)/"):
        rows.setdefault(entry["label"], {})[entry["of"]] = entry
    return table(["handset", "bytes a message", "walking", "decoding", "bytes decoded"],
                 [[label, f"{both['decode']['bytes_per_second'] / both['decode']['items_per_second']:.0f}",
                   f"{number(both['walk']['items_per_second'])} messages/s",
                   f"{number(both['decode']['items_per_second'])} messages/s",
                   f"{number(both['decode']['bytes_per_second'] / 1e6)} MB/s"] for label, both in rows.items()])


def sockets(bench):
    return table(["what the callback does", "on the clock"],
                 [[entry["label"], f"{number(entry['items_per_second'])} messages/s"]
                  for entry in bench.medians("Sockets", "^receive/")])


def refresh(bench):
    entry, = bench.medians("Refresh")
    return f"{seconds(processor(entry))} for {entry['nodes']:.0f} nodes."


def panes(bench):
    return table(["rows", "a reload, painted"],
                 [[f"{int(entry['name'].split('/')[1].split('_')[0]):,}", seconds(processor(entry))]
                  for entry in bench.medians("Panes")])


def property_lists(bench):
    return table(["list", "processor time"],
                 [[entry["label"], seconds(processor(entry))] for entry in bench.medians("PropertyLists")])


def ifx(bench):
    return table(["form", "bytes", "processor time", "messages/s"],
                 [[entry["label"], f"{entry['bytes_per_second'] / entry['items_per_second']:,.0f}",
                   seconds(processor(entry)), number(entry["items_per_second"])]
                  for entry in bench.medians("Ifx")])
