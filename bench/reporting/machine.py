"""What the numbers were measured on."""

import datetime
import os
import pathlib
import platform
import re
import subprocess


def first_line(*command):
    return subprocess.run(command, capture_output=True, text=True, check=True).stdout.splitlines()[0]


def processor_name():
    match = re.search(r"^model name\s*:\s*(.+)$", pathlib.Path("/proc/cpuinfo").read_text(), re.MULTILINE)
    return " ".join(match.group(1).split()) if match else platform.machine()


def version_of(package):
    return first_line("dpkg-query", "-W", "-f", "${Version}\n", package)


def describe(root, compiler):
    cores = len(os.sched_getaffinity(0))
    memory = os.sysconf("SC_PHYS_PAGES") * os.sysconf("SC_PAGE_SIZE") / 1e9
    debian = pathlib.Path("/etc/debian_version").read_text().strip()
    commit = first_line("git", "-C", str(root), "rev-parse", "--short=10", "HEAD")
    changed = subprocess.run(["git", "-C", str(root), "status", "--porcelain", "--", ".", ":!docs"],
                             capture_output=True, text=True, check=True).stdout
    load = os.getloadavg()[0]
    return (f"Measured on {datetime.date.today()} at commit {commit}{' and changes to it' if changed else ''}: "
            f"{processor_name()}, {cores} core{'s' if cores > 1 else ''}, {memory:.0f} GB, Debian {debian}, "
            f"Linux {platform.release().split('-')[0]}, {first_line(compiler, '--version')}, release build; "
            f"{load:.1f} processes wanted to run in the minute before.")
