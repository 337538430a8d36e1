#!/usr/bin/env python3
"""Fails when a file includes what its room may not, or asks for the operating system outside the rooms for that.

The table below is the one place where a room's neighbours are written down; docs/architecture.md shows it.
"""
import os
import re
import sys

# The core's rooms from the ground up; a room may include itself and those named. platform/Export.h is open to all.
CORE = {
    "platform": [],
    "foundation": ["platform"],
    "math": ["foundation"],
    "predicates": ["foundation", "dictionary"],
    # Of predicates/ the value ranges alone: RANGES below.
    "dictionary": ["foundation"],
    "transform": ["foundation", "math", "dictionary"],
    "translate": ["platform", "foundation", "math", "predicates", "dictionary", "transform"],
    "model": ["platform", "foundation", "math", "predicates", "dictionary", "transform", "translate"],
}
RANGES = {"kestrel/predicates/ScoreValueRange.h", "kestrel/predicates/Range.h"}
RANGE_USERS = {"dictionary", "transform"}
# Where systems may be told apart: what the library asks of them, and what tests do.
SYSTEM_ROOMS = ("kestrel/platform/", "tests/support/")
OPEN_TO_ALL = {"kestrel/platform/Export.h"}

INCLUDE = re.compile(r'^\s*#\s*include\s+"([^"]+)"')
SYSTEM = re.compile(r"^\s*#\s*(if|ifdef|ifndef|elif)\b.*\b(_WIN32|_WIN64|__linux__|__unix__|_MSC_VER|__MINGW\w*)\b")


def may_include(path, target):
    """Whether the file at path may include the project header target."""
    parts, wanted = path.split(os.sep), target.split("/")
    if target in OPEN_TO_ALL:
        return True
    if parts[0] == "kestrel":
        room = parts[1]
        if room.endswith(".h"):  # kestrel/kestrel.h shows the whole core
            return wanted[0] == "kestrel"
        if wanted[0] != "kestrel":
            return False
        if target in RANGES and room in RANGE_USERS:
            return True
        return wanted[1] == room or wanted[1] in CORE[room]
    if parts[0] == "plugins":
        return wanted[0] == "kestrel" or (wanted[0] == "plugins" and wanted[1] in ("support", parts[1]))
    if parts[0] in ("apps", "examples"):
        return wanted[0] == "kestrel" or wanted[:2] == parts[:2]
    return True  # tests, bench and fuzz look everywhere


def check(path):
    with open(path, encoding="utf-8") as lines:
        for number, line in enumerate(lines, 1):
            include = INCLUDE.match(line)
            if include:
                target = include.group(1)
                if not target.startswith(("kestrel/", "plugins/", "apps/", "tests/", "bench/", "fuzz/")):
                    yield f'{path}:{number}: "{target}": say the whole path, such as "kestrel/room/Header.h"'
                elif not os.path.exists(target):
                    yield f'{path}:{number}: "{target}" does not exist'
                elif not may_include(path, target):
                    yield f'{path}:{number}: this room may not include "{target}"'
            elif SYSTEM.match(line) and not path.startswith(SYSTEM_ROOMS):
                yield f"{path}:{number}: what differs between systems belongs into {' or '.join(SYSTEM_ROOMS)}"


def main():
    os.chdir(os.path.join(os.path.dirname(os.path.abspath(__file__)), ".."))
    faults = []
    for top in ("kestrel", "plugins", "apps", "tests", "bench", "fuzz", "examples"):
        for folder, _, names in os.walk(top):
            for name in sorted(names):
                if name.endswith((".h", ".cpp")):
                    faults += check(os.path.join(folder, name))
    for room in sorted(os.listdir("kestrel")):
        if os.path.isdir(os.path.join("kestrel", room)):
            readme = os.path.join("kestrel", room, "README.md")
            if room not in CORE:
                faults.append(f"kestrel/{room}: no such room in the table")
            elif not os.path.exists(readme):
                faults.append(f"{readme} is missing: what the room does, which header to open first")
            elif sum(1 for _ in open(readme, encoding="utf-8")) > 15:
                faults.append(f"{readme} has more than 15 lines")
    print("\n".join(faults) if faults else "rooms: every include is allowed")
    return 1 if faults else 0


if __name__ == "__main__":
    sys.exit(main())
