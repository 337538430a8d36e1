#!/usr/bin/env python3
"""Prints kestrel/kestrel.h, which includes every public header. With --check, fails when the file is not that text.

A header is public when it exports something (KESTREL_API) or when a public one includes it; the others are the core's
own. `cmake --install` lays down what kestrel.h lists.
"""
import glob
import os
import re
import sys

HEAD = """// Every public header of the library. Hosts that only score need few of them and compile faster with those
// alone; the headers of translate/ also need the XML parser's.

#ifndef KESTREL_KESTREL_H
#define KESTREL_KESTREL_H

"""
TAIL = """
#endif  // KESTREL_KESTREL_H
"""


def public_headers():
    sources = {}
    for path in glob.glob("kestrel/*/*.h"):
        with open(path, encoding="utf-8") as header:
            sources[path.replace(os.sep, "/")] = header.read()
    public = set()
    waiting = [path for path, source in sources.items() if re.search(r"\bKESTREL_API\b", source)]
    while waiting:
        path = waiting.pop()
        if path not in public:
            public.add(path)
            waiting += [name for name in re.findall(r'^#include "(kestrel/[^"]+\.h)"', sources[path], re.M)]
    return sorted(public)


def text():
    headers = public_headers()
    return HEAD + "".join(f'#include "{header}"\n' for header in headers) + TAIL


def main():
    os.chdir(os.path.join(os.path.dirname(os.path.abspath(__file__)), ".."))
    if "--check" not in sys.argv:
        sys.stdout.write(text())
        return 0
    with open("kestrel/kestrel.h", encoding="utf-8") as header:
        if header.read() == text():
            return 0
    print("kestrel/kestrel.h is not up to date: python3 tools/print_kestrel_header.py > kestrel/kestrel.h")
    return 1


if __name__ == "__main__":
    sys.exit(main())
