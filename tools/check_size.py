#!/usr/bin/env python3
"""Fails on a source of more than 600 lines or a header of more than 250: past that there is a second thing in it."""
import os
import subprocess
import sys

LIMIT = {".cpp": 600, ".py": 600, ".h": 250}

# What may be longer, and why.
EXCEPTIONS = {
    "kestrel/math/GammaCoefficients.h": "printed tables of numbers",
}


def main():
    os.chdir(os.path.join(os.path.dirname(os.path.abspath(__file__)), ".."))
    faults = []
    for path in subprocess.run(["git", "ls-files"], capture_output=True, text=True, check=True).stdout.splitlines():
        limit = LIMIT.get(os.path.splitext(path)[1])
        if limit is None or path in EXCEPTIONS or not os.path.exists(path):
            continue
        with open(path, encoding="utf-8") as text:
            lines = sum(1 for _ in text)
        if lines > limit:
            faults.append(f"{path}: {lines} lines, more than {limit}")
    print("\n".join(faults) if faults else "sizes: no file is too long")
    return 1 if faults else 0


if __name__ == "__main__":
    sys.exit(main())
