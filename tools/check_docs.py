#!/usr/bin/env python3
"""Fails when a document links to a file that is not there, or when docs/errors.md and the sources disagree on a text."""
import glob
import os
import re
import subprocess
import sys

LINK = re.compile(r"\]\(([^)#\s]+)(#[^)]*)?\)")
ROW = re.compile(r"^\| (\d+) \| `(.+?)` \|", re.M)
STRING = re.compile(r'"((?:[^"\\\n]|\\.)*)"')


def check_links(path):
    with open(path, encoding="utf-8") as text:
        for number, line in enumerate(text, 1):
            for match in LINK.finditer(line):
                target = match.group(1)
                if not re.match(r"[a-z]+:", target) and not os.path.exists(os.path.join(os.path.dirname(path), target)):
                    yield f"{path}:{number}: {target} is not there"


def source_texts():
    """Every string literal of the core and the plug-ins, neighbours joined as the compiler joins them."""
    texts = set()
    for path in glob.glob("kestrel/**/*.cpp", recursive=True) + glob.glob("kestrel/**/*.h", recursive=True) + glob.glob(
            "plugins/**/*.cpp", recursive=True) + glob.glob("plugins/**/*.h", recursive=True):
        with open(path, encoding="utf-8") as source:
            code = re.sub(r'"\s*\n\s*"', "", source.read())
        texts.update(STRING.findall(code))
    return texts


def check_errors(path):
    """Each text of the table stands in the sources; names in angle brackets stand for what is put in at run time."""
    texts = source_texts()
    with open(path, encoding="utf-8") as document:
        for code, message in ROW.findall(document.read()):
            for piece in re.split(r"<[a-z ]+>", message):
                wanted = piece.replace('"', '\\"')
                if wanted.strip() and not any(wanted in text for text in texts):
                    yield f"{path}: code {code}: no source holds the text {piece!r}"


def main():
    os.chdir(os.path.join(os.path.dirname(os.path.abspath(__file__)), ".."))
    documents = subprocess.run(["git", "ls-files", "*.md"], capture_output=True, text=True, check=True).stdout.splitlines()
    faults = [fault for path in documents for fault in check_links(path)]
    faults += check_errors("docs/errors.md")
    print("\n".join(faults) if faults else "documents: links and error texts are right")
    return 1 if faults else 0


if __name__ == "__main__":
    sys.exit(main())
