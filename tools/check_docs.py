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
# The helpers of ReaderFault.h, those that sources make of them, and the exception itself.
THROW = re.compile(r"\b(?:Fail(?:At|On\w+|Missing)?|Refuse|KestrelException|MissingNode)\(")


def check_links(path):
    with open(path, encoding="utf-8") as text:
        for number, line in enumerate(text, 1):
            for match in LINK.finditer(line):
                target = match.group(1)
                if not re.match(r"[a-z]+:", target) and not os.path.exists(os.path.join(os.path.dirname(path), target)):
                    yield f"{path}:{number}: {target} is not there"


def sources():
    """Each source of the core and the plug-ins with its text, neighbouring literals joined as the compiler joins them."""
    for folder in ("kestrel", "plugins"):
        for suffix in ("cpp", "h"):
            for path in sorted(glob.glob(f"{folder}/**/*.{suffix}", recursive=True)):
                with open(path, encoding="utf-8") as source:
                    yield path, re.sub(r'"\s*\n\s*"', "", re.sub(r"^\s*//.*$", "", source.read(), flags=re.M))


def plain(literal):
    """A literal as documents have it: without leading line ends and escapes."""
    return re.sub(r"^(\\n)+", "", literal).replace('\\"', '"')


def is_built_of(piece, literals):
    """Whether a text is part of one literal, or an end of one, whole ones and a beginning put together."""
    if any(piece in literal for literal in literals):
        return True
    # Literals of a letter or two would make a puzzle of anything; marks are what messages are joined with.
    whole = [literal for literal in literals if len(literal) > 3 or re.fullmatch(r"\W+", literal)]
    starts = {i for i in range(1, len(piece)) if any(literal.endswith(piece[:i]) for literal in whole)}
    for i in range(1, len(piece)):
        if i in starts:
            if any(literal.startswith(piece[i:]) for literal in whole):
                return True
            starts |= {i + len(literal) for literal in whole if literal and piece.startswith(literal, i)}
    return False


def check_rows(path, rows):
    """Each text of the table stands in the sources; names in angle brackets stand for what is put in at run time."""
    literals = {plain(literal) for _, code in sources() for literal in STRING.findall(code)}
    for number, message in rows:
        for piece in re.split(r"<[a-z ]+>", message):
            if piece.strip() and not is_built_of(piece, literals):
                yield f"{path}: code {number}: no source holds the text {piece!r}"


def throwing_calls(code):
    """The arguments of every call that ends in a KestrelException."""
    for call in THROW.finditer(code):
        depth, end, in_string = 1, call.end(), False
        while depth:
            if code[end] == '"' and code[end - 1] != "\\":
                in_string = not in_string
            elif not in_string:
                depth += {"(": 1, ")": -1}.get(code[end], 0)
            end += 1
        yield call.start(), code[call.end():end - 1]


def check_messages(path, rows):
    """Each text that a source throws stands in a row, of the code that it is thrown with where the call says it."""
    with open("kestrel/foundation/KestrelException.h", encoding="utf-8") as header:
        codes = dict(re.findall(r"\b(k[A-Z]\w*) = (\d+),", header.read()))
    for source, code in sources():
        constants = dict(re.findall(r'constexpr char (k\w+)\[\] = "((?:[^"\\\n]|\\.)*)"', code))
        for at, arguments in throwing_calls(code):
            thrown = re.findall(r"KestrelException::(k\w+)", arguments)
            texts = STRING.findall(arguments) + [constants[name] for name in re.findall(r"\bk[A-Z]\w*", arguments)
                                                 if name in constants]
            for text in map(plain, texts):
                if not any(text in message and (not thrown or number == codes[thrown[0]]) for number, message in rows):
                    line = code.count("\n", 0, at) + 1
                    yield f"{source}: {path} has no row for the text {text!r} (near line {line})"


def main():
    os.chdir(os.path.join(os.path.dirname(os.path.abspath(__file__)), ".."))
    documents = subprocess.run(["git", "ls-files", "*.md"], capture_output=True, text=True, check=True).stdout.splitlines()
    faults = [fault for path in documents for fault in check_links(path)]
    with open("docs/errors.md", encoding="utf-8") as document:
        rows = ROW.findall(document.read())
    faults += check_rows("docs/errors.md", rows)
    faults += check_messages("docs/errors.md", rows)
    print("\n".join(faults) if faults else "documents: links and error texts are right")
    return 1 if faults else 0


if __name__ == "__main__":
    sys.exit(main())
