#!/usr/bin/env python3
"""Holds the layers: every #include of the sources has to be one that its folder may have.

Usage: check_layers.py SOURCE_DIRECTORY
Prints each include that breaks a rule, and exits with 1 if there is one.
"""

import pathlib
import re
import sys

INCLUDE = re.compile(r'^\s*#\s*include\s*(<[^>]+>|"[^"]+")')
STANDARD = r"<[a-z0-9_]+>"  # the C++ library's headers have neither a dot nor a slash
FMT = r"<fmt/[a-z]+\.h>"
WIDGETS = re.compile(
    r"<(QtWidgets|QtGui)\b|<Q(Widget|Application|Gui|Window|MainWindow|Dialog|MessageBox|Label|LineEdit|"
    r"(Plain)?TextEdit|(Tool|Push|Abstract|Radio|)Button|Action|Menu|ToolBar|StatusBar|Style|Painter|Frame|"
    r"Stacked|Splitter|Progress|\w*Layout|\w*View|\w*Delegate|\w*Area|\w*Box)\w*>")

# What the files of a folder may include, the longest folder that matches counting. Texts are quoted forms,
# matched whole.
ALLOWED = {
    "platform": [r'"platform/\w+\.h"', STANDARD, FMT, "<locale.h>", "<plist/plist.h>"],
    "platform/recording": [r'"platform/(recording/)?\w+\.h"', STANDARD, FMT, "<pcap/pcap.h>"],
    "platform/scripted": [r'"platform/(scripted/)?\w+\.h"', STANDARD, FMT],
    "platform/linux": [r'"platform/(linux/)?\w+\.h"', r"<.*>"],
    "LogGenerator": [r'"LogGenerator/.*"', r'"platform/\w+\.h"', STANDARD, FMT],
    "model": [r'"model/.*"', r'"LogGenerator/.*"', r'"platform/\w+\.h"', STANDARD, FMT],
    "pelorusctl": [r'"pelorusctl/.*"', r'"model/.*"', r'"LogGenerator/.*"', r'"platform/.*"', r"<.*>"],
    # Of the decoders only where the fields are.
    "telephonyd": [r'"telephonyd/.*"', r'"platform/.*"', r'"LogGenerator/(\w+/)*LogCode_\w+\.h"',
                   r'"LogGenerator/Osprey/(Field|CellMonitorKeys)\.h"', r"<.*>"],
    "app": [r'"app/.*"', r'"model/.*"', r'"platform/.*"', r'"ui_\w+\.h"', r"<.*>"],
    # What the window shows and where is decided without the toolkit.
    "app/content": [r'"app/content/.*"', r'"model/.*"', r'"platform/\w+\.h"', STANDARD, FMT],
}
# The property-list library, and the headers that show it, are for these alone.
PROPERTY_LISTS = re.compile(r"platform/\w*(PropertyList|Plist)\w*\.(h|cpp)")
SHOWS_PLIST = re.compile(r"<plist/.*>|\"platform/PlistNode\.h\"")


def rule_of(path):
    folder = path.parent
    while str(folder) not in ALLOWED:
        folder = folder.parent
    return ALLOWED[str(folder)]


def complaint(path, include):
    if not any(re.fullmatch(form, include) for form in rule_of(path)):
        return "is no business of its folder"
    if SHOWS_PLIST.fullmatch(include) and not PROPERTY_LISTS.fullmatch(str(path)):
        return "is for platform/PropertyList alone"
    if path.parts[0] != "app" and WIDGETS.match(include):
        return "is a widget, and those are for app"
    return None


def layout_headers(root):
    """The headers that telephonyd shares with the decoders, followed to the last: all must be layouts."""
    waiting = [path for path in root.glob("LogGenerator/**/LogCode_*.h")]
    waiting += [root / "LogGenerator/Osprey/Field.h", root / "LogGenerator/Osprey/CellMonitorKeys.h"]
    seen = set()
    while waiting:
        path = waiting.pop()
        if path in seen or not path.exists():
            continue
        seen.add(path)
        for include in includes_of(path):
            if include.startswith('"LogGenerator/'):
                waiting.append(root / include.strip('"'))
    return seen


def includes_of(path):
    for line in path.read_text(encoding="utf-8").splitlines():
        match = INCLUDE.match(line)
        if match:
            yield match.group(1)


def main(root):
    complaints = []
    count = 0
    for folder in ("platform", "LogGenerator", "model", "pelorusctl", "telephonyd", "app"):
        for path in sorted((root / folder).rglob("*")):
            if path.suffix not in (".h", ".cpp"):
                continue
            count += 1
            for include in includes_of(path):
                reason = complaint(path.relative_to(root), include)
                if reason:
                    complaints.append(f"{path.relative_to(root)}: {include} {reason}")
    for path in sorted(layout_headers(root)):
        if path.with_suffix(".cpp").exists():
            complaints.append(f"{path.relative_to(root)}: a layout that telephonyd shares has a .cpp file")
    print("\n".join(complaints) if complaints else f"{count} files keep to their layers")
    return 1 if complaints or count == 0 else 0


if __name__ == "__main__":
    sys.exit(main(pathlib.Path(sys.argv[1])))
