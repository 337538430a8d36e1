#!/usr/bin/env python3
"""Fails on what Microsoft's compiler refuses, or computes otherwise, and compilers elsewhere say nothing about.

Looked at is the code that is built for Windows: neither *_posix.cpp nor what stands under #if for another system or
compiler. tools/windows/msvc-check asks a compiler for the rest.
"""
import os
import re
import subprocess
import sys

PLACES = ["kestrel", "plugins", "apps", "cmake/PluginVersion.cpp", "tests/model/plugins"]

# What must not stand in code, and why.
WORDS = [
    (r"__attribute__|\[\[(?:gnu|clang)::", "an attribute of other compilers"),
    (r"\b__builtin_\w+", "a builtin of other compilers"),
    (r"\b(?:__int128|__float128|_Float16)\b", "a type of other compilers"),
    (r"\b(?:typeof|__(?:typeof|extension|thread|restrict|asm)(?:__)?|__PRETTY_FUNCTION__|asm)\b",
     "a keyword of other compilers"),
    (r"^\s*#\s*pragma\s+(?:GCC|clang)\b|\b_Pragma\b", "a pragma of other compilers"),
    (r"^\s*#\s*(?:include_next|warning|ident)\b", "a directive of other compilers"),
    (r"^\s*#\s*include\s*<(?:unistd|dlfcn|pthread|strings|alloca|dirent|cxxabi|endian|sched|poll|"
     r"(?:sys|bits|ext|netinet|arpa)/[^>]*|experimental/[^>]*)(?:\.h)?>", "a header of other systems"),
    (r"\bssize_t\b", "a type of other systems: std::ptrdiff_t"),
    (r"\b(?:strn?casecmp|timegm|(?:gm|local)time_r|strtok_r|strndup|(?:un)?setenv|v?asprintf|alloca|sincos|"
     r"[fs]eeko|ftello|popen|usleep|lgamma_r|drand48)\s*\(", "a function of other systems"),
    (r"\bM_(?:E|PI|LN|LOG|SQRT|1_PI|2_PI|2_SQRTPI)\w*\b", "Microsoft's <cmath> does not define it"),
    (r"\b(?:and|or|not|xor|bitand|bitor|compl)(?:_eq)?\b", "taken for a name unless a header is included: a sign"),
    (r"\blong\s+double\b|(?<![\w.])(?:\d[\d']*\.[\d']*(?:[eE][-+]?\d+)?|\.\d+(?:[eE][-+]?\d+)?|\d+[eE][-+]?\d+)[lL]\b",
     "as narrow as a double there"),
    (r"\bunsigned\s+long\b(?!\s+long)|\bu?long_t\b", "32 bits there: std::size_t or std::uint64_t"),
    (r"(?<![\w.])(?:0[xX][\dA-Fa-f']+|\d[\d']*)(?:[uU]?[lL]|[lL][uU])\b",
     "32 bits there: LL, or a cast to the type that is meant"),
    (r"\b(?:strtou?l|atol|labs|std::stou?l|l(?:round|rint))\b", "32 bits there: std::from_chars or the ll form"),
]
WORDS = [(re.compile(pattern, re.M), why) for pattern, why in WORDS]

# Bytes that a literal may have, by itself and with those that it is joined to.
LONGEST_LITERAL, LONGEST_JOINED = 16380, 65535

# What is defined there; other names may be or not, and both branches are read.
DEFINED = {"_WIN32": True, "_WIN64": True, "_MSC_VER": True}
DEFINED.update({name: False for name in (
    "__GNUC__", "__GNUG__", "__clang__", "__linux__", "__unix__", "__APPLE__", "__MINGW32__", "__MINGW64__",
    "__CYGWIN__")})

TOKEN = re.compile(
    r"""(?P<comment>//(?:\\\n|[^\n])*|/\*.*?\*/)
      | (?P<raw>\b(?:u8|u|U|L)?R"(?P<tag>[^(\s]*)\(.*?\)(?P=tag)")
      | (?P<text>\b(?:u8|u|U|L)?"(?:\\.|[^"\\\n])*"|"(?:\\.|[^"\\\n])*")
      | (?P<character>\b(?:u8|u|U|L)'(?:\\.|[^'\\\n])+'|(?<![0-9A-Fa-f])'(?:\\.|[^'\\\n])+')""", re.S | re.X)
CONDITION = re.compile(r"^\s*#\s*(if|ifdef|ifndef|elif|else|endif)\b(.*)")
INCLUDE = re.compile(r'^\s*#\s*include\b[^\n]*', re.M)


def without_texts(code):
    """The code without comments and texts, its lines as before; and where texts are too long."""
    long_texts, joined, last_end = [], 0, None

    def stand_in(match):
        nonlocal joined, last_end
        lines = "\n" * match.group().count("\n")
        if match.group("comment"):
            return " " + lines
        if match.group("character"):
            return "' '"
        size = len(match.group().encode())
        joined = joined + size if last_end is not None and not code[last_end:match.start()].strip() else size
        last_end = match.end()
        if size > LONGEST_LITERAL or joined > LONGEST_JOINED:
            long_texts.append(code.count("\n", 0, match.start()) + 1)
        return '""' + lines

    # The name of an included file is kept: it is looked at, and it may look like a comment.
    kept = {match.start(): match.end() for match in INCLUDE.finditer(code)}
    out, at = [], 0
    for match in TOKEN.finditer(code):
        line_start = code.rfind("\n", 0, match.start()) + 1
        if kept.get(line_start, 0) > match.start() and not match.group("comment"):
            continue
        out += [code[at:match.start()], stand_in(match)]
        at = match.end()
    return "".join(out) + code[at:], long_texts


def holds(condition, rest):
    """True, False or None (not known) for the condition of #if, #ifdef or #ifndef."""
    rest = rest.strip()
    if condition in ("ifdef", "ifndef"):
        known = DEFINED.get(rest)
        return known if known is None or condition == "ifdef" else not known
    terms = []
    for term in rest.split("&&"):
        match = re.fullmatch(r"\s*(!?)\s*defined\s*\(?\s*(\w+)\s*\)?\s*", term)
        known = DEFINED.get(match.group(2)) if match else None
        terms.append(known if known is None or not match.group(1) else not known)
    if False in terms:
        return False
    return True if all(terms) else None


def for_windows(code):
    """The code without the lines that are for other systems or compilers; they stay as empty ones."""
    out, stack = [], []  # per open #if: whether this branch is read, whether a branch was surely taken
    for line in code.split("\n"):
        match = CONDITION.match(line)
        if match:
            word, rest = match.groups()
            if word in ("if", "ifdef", "ifndef"):
                truth = holds(word, rest)
                stack.append([truth is not False, truth is True])
            elif word == "endif" and stack:
                stack.pop()
            elif stack:
                truth = holds("if", rest) if word == "elif" else None
                stack[-1] = [not stack[-1][1] and truth is not False, stack[-1][1] or truth is True]
            out.append("")
        else:
            out.append(line if all(read for read, _ in stack) else "")
    return "\n".join(out)


CLASS = re.compile(r"\b(?:class|struct)\s+(KESTREL_API\s+)?(\w+)(?:\s+final)?\s*(?::(?!:)([^{};()]*))?\{")
ACCESS = re.compile(r"^\s*(?:(?:public|protected|private)\s*:(?!:)\s*)*")
UNCOPYABLE = re.compile(r"\b(?:unique_ptr|(?:\w+_)?mutex|atomic\w*|thread|future|promise|condition_variable|once_flag)\b")


def matching(code, opening):
    """Behind the brace that closes the one at opening."""
    depth = 0
    for match in re.compile(r"[{}]").finditer(code, opening):
        depth += 1 if match.group() == "{" else -1
        if depth == 0:
            return match.end()
    return len(code)


def declarations(body):
    """The declarations of a class's body: (text up to its brace or end, whether it has a body in braces)."""
    at = start = 0
    while at < len(body):
        if body[at] == "{":
            head = ACCESS.sub("", body[start:at]).strip()
            at = matching(body, at)
            yield head, True
            # What follows a class, an enumeration or an initialiser up to its semicolon is no declaration.
            rest = re.compile(r"\s*[\w\s,*=]*;" if not head.endswith((")", "const", "override", "noexcept", "final"))
                              else r"\s*;?").match(body, at)
            at = start = rest.end() if rest else at
        elif body[at] == ";":
            yield ACCESS.sub("", body[start:at]).strip(), False
            at = start = at + 1
        else:
            at += 1


class Class:
    """A class as its header shows it."""

    def __init__(self, path, line, match, body):
        self.place = f"{path}:{line}"
        self.exported, self.name = match.group(1) is not None, match.group(2)
        self.bases = re.findall(r"(\w+)\s*(?:<[^,]*>)?\s*(?:,|$)", match.group(3) or "")
        self.declarations = list(declarations(body))

    def virtuals(self):
        for head, has_body in self.declarations:
            if "(" in head and re.search(r"\b(?:virtual|override)\b|\)[^()]*\bfinal\b", head):
                yield head, has_body

    def key_function(self):
        """The name of the first virtual function that is neither pure nor defined in the class."""
        for head, has_body in self.virtuals():
            if not has_body and not re.search(r"=\s*(?:0|default|delete)\s*$|^inline\b", head):
                return re.search(r"(~?\w+|operator\s*[^\s(]+)\s*\(", head).group(1)
        return None

    def says_copies(self):
        """Whether both copies are declared, or moving is, with which there are none."""
        heads = [head for head, _ in self.declarations]
        return (any(re.search(rf"\b{self.name}\s*\(\s*const\s+{self.name}\s*&", head) for head in heads) and
                any(re.search(rf"\boperator=\s*\(\s*(?:const\s+)?{self.name}\b(?!\s*&&)", head) for head in heads) or
                any(re.search(rf"\b{self.name}\s*\(\s*{self.name}\s*&&", head) for head in heads))

    def uncopyable(self):
        """The first member variable that cannot be copied."""
        for head, _ in self.declarations:
            if not head.startswith(("static ", "using ", "friend ", "class ", "struct ", "enum ")) and \
                    "(" not in head.split("=")[0] and UNCOPYABLE.search(head):
                return head
        return None


def classes_of(path, code):
    for match in CLASS.finditer(code):
        end = matching(code, match.end() - 1)
        yield Class(path, code.count("\n", 0, match.start()) + 1, match, code[match.end():end - 1])


def check_classes(code_of):
    classes = {}
    for path in code_of:
        if path.endswith(".h"):
            for found in classes_of(path, code_of[path]):
                if found.exported or found.name not in classes:
                    classes[found.name] = found
    sources = "\n".join(code for path, code in code_of.items() if path.endswith(".cpp"))
    # A definition stands at the start of a line or behind its type; a call through the class is indented.
    defined = {(owner, re.sub(r"\s", "", name)) for owner, name in
               re.findall(r"^(?=\S)[^;{}()]*?\b(\w+)::(~?\w+|operator\s*[^\s(]+)\s*\(", "\n" + sources, re.M)}

    def is_polymorphic(name):
        found = classes.get(name)
        return found is not None and (any(True for _ in found.virtuals()) or any(map(is_polymorphic, found.bases)))

    for found in classes.values():
        if not found.exported:
            continue
        if is_polymorphic(found.name):
            key = found.key_function()
            if key is None:
                yield f"{found.place}: {found.name} is exported and every virtual function of its own is pure or in the " \
                      "class: define one in a source, such as the destructor, so that the core alone has its table"
            elif (found.name, re.sub(r"\s", "", key)) not in defined:
                yield f"{found.place}: {found.name} is exported and {key}, which its table goes with, is in no source"
        member = found.uncopyable()
        if member and not found.says_copies():
            yield f"{found.place}: {found.name} is exported, which makes its copies, and \"{member}\" has none: delete them"


def check_words(path, code):
    for pattern, why in WORDS:
        for match in pattern.finditer(code):
            line = code.count("\n", 0, match.end()) + 1
            verb = " is" if why.startswith(("a ", "an ")) else ":"
            yield f"{path}:{line}: \"{match.group().strip()}\"{verb} {why}"


def check(texts):
    """The faults in {path: text}."""
    faults, code_of = [], {}
    for path, text in texts.items():
        code, long_texts = without_texts(text)
        code_of[path] = for_windows(code)
        faults += check_words(path, code_of[path])
        faults += [f"{path}:{line}: longer than Microsoft's compiler takes" for line in long_texts]
        if not text.isascii():
            line = next(number for number, line in enumerate(text.split("\n"), 1) if not line.isascii())
            faults.append(f"{path}:{line}: beyond ASCII, read in whatever code page the system has: \\x or \\u")
    return faults + list(check_classes(code_of))


def main():
    os.chdir(os.path.join(os.path.dirname(os.path.abspath(__file__)), ".."))
    paths = subprocess.run(["git", "ls-files", *PLACES], capture_output=True, text=True, check=True).stdout.split()
    texts = {}
    for path in paths:
        if path.endswith((".h", ".cpp", ".inc")) and not path.endswith("_posix.cpp") and os.path.exists(path):
            with open(path, encoding="utf-8") as text:
                texts[path] = text.read()
    faults = check(texts)
    print("\n".join(faults) if faults else "portable: nothing that Microsoft's compiler would refuse")
    return 1 if faults else 0


if __name__ == "__main__":
    sys.exit(main())
