#!/usr/bin/env python3
"""Holds how programs are hardened: position-independent, relocations read-only before main, no executable stack,
stack protector, checked library calls.

Usage: check_hardening.py PROGRAM...
Prints what each program lacks, and exits with 1 if one lacks something.
"""

import re
import subprocess
import sys


def lacks(program):
    def read(option):
        return subprocess.run(["readelf", "--wide", option, program], check=True, capture_output=True, text=True,
                              env={"LC_ALL": "C"}).stdout

    segments = read("--segments")
    symbols = read("--dyn-syms")
    holds = {
        "a position-independent executable": re.search(r"type is DYN", segments) and "INTERP" in segments,
        "read-only relocations": "GNU_RELRO" in segments,
        "relocations that are all done at the start": re.search(r"FLAGS_1.*\bNOW\b", read("--dynamic")),
        "a stack that is no code": re.search(r"GNU_STACK(\s+0x\w+){5}\s+RW\s", segments),
        "the stack protector": "__stack_chk_fail" in symbols,
        "checked library calls": re.search(r" __\w+_chk@", symbols),
    }
    return [what for what, held in holds.items() if not held]


failed = False
for name in sys.argv[1:]:
    for what in lacks(name):
        print(f"{name} has not {what}")
        failed = True
sys.exit(1 if failed else 0)
