#!/usr/bin/env python3
"""Whether check_portable.py finds what it is there for, and nothing else."""
import sys

from check_portable import LONGEST_JOINED, LONGEST_LITERAL, check

HEAD = '#include "kestrel/platform/Export.h"\n'

# Per row: the files, and what the one fault must say; None where there is none.
ROWS = [
    ({"a.cpp": "int f() __attribute__((pure));"}, "a.cpp:1: \"__attribute__\" is an attribute"),
    ({"a.cpp": "[[gnu::noinline]] void f();"}, "an attribute"),
    ({"a.cpp": "int f(int n) {\n  return __builtin_ctz(n);\n}"}, "a.cpp:2: \"__builtin_ctz\""),
    ({"a.cpp": "__int128 wide;"}, "a type of other compilers"),
    ({"a.cpp": "__typeof__(1) n;"}, "a keyword"),
    ({"a.cpp": "#pragma GCC optimize(\"O3\")"}, "a pragma"),
    ({"a.cpp": "#include <unistd.h>"}, "a header"),
    ({"a.cpp": "#include <sys/mman.h>"}, "a header"),
    ({"a.cpp": "ssize_t n;"}, "std::ptrdiff_t"),
    ({"a.cpp": "bool f() { return strcasecmp(a, b) == 0; }"}, "a function"),
    ({"a.cpp": "double pi = M_PI;"}, "<cmath>"),
    ({"a.cpp": "bool f(bool a) { return not a; }"}, "a sign"),
    ({"a.cpp": "long double x;"}, "as narrow"),
    ({"a.cpp": "auto x = 1.5L;"}, "as narrow"),
    ({"a.cpp": "auto x = 1e3L;"}, "as narrow"),
    ({"a.cpp": "unsigned long n;"}, "std::size_t"),
    ({"a.cpp": "auto n = 1L << m;"}, "32 bits"),
    ({"a.cpp": "auto n = 0xFFUL;"}, "32 bits"),
    ({"a.cpp": "auto n = std::strtol(a, b, 10);"}, "32 bits"),
    ({"a.cpp": 'auto a = "' + "a" * LONGEST_LITERAL + '";'}, "longer than"),
    ({"a.cpp": "auto a =" + ('\n"' + "a" * 1000 + '"') * (LONGEST_JOINED // 1000 + 1) + ";"}, "longer than"),
    ({"a.cpp": "int n;\nauto a = \"\u00e4\";"}, "a.cpp:2: beyond ASCII"),
    # Not code, or not for Windows.
    ({"a.cpp": "// long double, and M_PI\n/* ssize_t */ const char* a = \"long double\\\" M_PI\";"}, None),
    ({"a.cpp": "auto n = 1LL; auto m = 1'000'000ULL; auto x = 1.5; unsigned long long k; auto c = 'L';"}, None),
    ({"a.cpp": "#if defined(_WIN32)\nint n;\n#else\nssize_t n;\n#endif"}, None),
    ({"a.cpp": "#ifdef __GNUC__\nssize_t n;\n#endif"}, None),
    ({"a.cpp": "#ifndef _MSC_VER\nssize_t n;\n#endif"}, None),
    ({"a.cpp": "#if defined(_WIN32) && !defined(__GNUC__)\nssize_t n;\n#endif"}, "std::ptrdiff_t"),
    ({"a.cpp": "#ifdef OTHER\nint n;\n#else\nssize_t n;\n#endif"}, "a.cpp:4"),
    # Where a class's table goes.
    ({"a.h": HEAD + "class KESTREL_API A {\n public:\n  virtual ~A();\n};", "a.cpp": "A::~A() = default;"}, None),
    ({"a.h": HEAD + "class KESTREL_API A {\n public:\n  virtual ~A();\n};", "a.cpp": ""}, "a.h:2: A is exported and ~A"),
    ({"a.h": HEAD + "class KESTREL_API A {\n public:\n  virtual ~A() = default;\n  virtual int F() const = 0;\n};"}, "pure"),
    ({"a.h": HEAD + "class KESTREL_API A {\n public:\n  virtual ~A() {}\n  virtual int F() { return 1; }\n};"}, "pure"),
    ({"a.h": HEAD + "class A {\n  virtual int F();\n};\nclass KESTREL_API B : public A {\n  int n_ = 0;\n};"}, "B is exported"),
    ({"a.h": HEAD + "class KESTREL_API A {\n  int F() { return 1; }\n  std::string text_;\n};"}, None),
    ({"a.h": HEAD + "class KESTREL_API A final : public X {\n  enum E { kA };\n  int F() { return 1; }\n"
      "  bool operator==(const A& a) const override;\n};",
      "a.cpp": "bool A::operator==(const A& a) const {\n  return true;\n}"}, None),
    # Copies.
    ({"a.h": HEAD + "class KESTREL_API A {\n  std::vector<std::unique_ptr<int>> all_;\n};"}, "all_"),
    ({"a.h": HEAD + "class KESTREL_API A {\n  std::mutex lock_{};\n};"}, "lock_"),
    ({"a.h": HEAD + "class KESTREL_API A {\n  A(const A&) = delete;\n  std::mutex lock_;\n};"}, "lock_"),
    ({"a.h": HEAD + "class KESTREL_API A {\n  A(const A&) = delete;\n  A& operator=(const A&) = delete;\n"
      "  std::mutex lock_;\n};"}, None),
    ({"a.h": HEAD + "class KESTREL_API A {\n  A(A&&) noexcept;\n  std::unique_ptr<int> one_;\n};"}, None),
    ({"a.h": HEAD + "class KESTREL_API A {\n  std::unique_ptr<int> Make() const;\n};"}, None),
    ({"a.h": HEAD + "class A {\n  std::mutex lock_;\n};"}, None),
]


def main():
    failures = []
    for files, expected in ROWS:
        faults = check(files)
        if expected is None and faults or expected is not None and (len(faults) != 1 or expected not in faults[0]):
            text = "\n".join(files.values())
            failures.append(f"{text[:300]}\n  expected: {expected}\n  but was: {faults}")
    print("\n".join(failures) if failures else f"check_portable: {len(ROWS)} planted texts judged as they should be")
    return 1 if failures else 0


if __name__ == "__main__":
    sys.exit(main())
