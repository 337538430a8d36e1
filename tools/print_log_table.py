#!/usr/bin/env python3
"""Prints kestrel/math/LogTable.h: reciprocals of few bits and their logarithms, with mpmath (60 digits).

Needs mpmath. Write with: python3 tools/print_log_table.py > kestrel/math/LogTable.h
"""
from mpmath import log, mp, mpf

mp.dps = 60

# Numbers are brought between 0.6875 and 1.375; the binade is cut into this many parts by the leading bits.
START = mpf("0.6875")
PARTS = 128
# Of so few bits a reciprocal's product with half a double is exact.
BITS = 11

HEAD = """// Reciprocals of few bits and their logarithms, for SaddlePoint.cpp.
// Printed by tools/print_log_table.py: change it there.

#ifndef KESTREL_MATH_LOGTABLE_H
#define KESTREL_MATH_LOGTABLE_H

namespace MCMath_800 {

struct LogEntry {
  double reciprocal;  ///< Of a number near the middle of the part.
  double high, low;   ///< -ln reciprocal.
};
"""


def parts():
    """The middles of the parts; below 1 they are half as wide as above."""
    for i in range(PARTS):
        start = START + mpf(i) / (2 * PARTS)
        if start < 1:
            yield start + mpf(1) / (4 * PARTS)
        else:
            yield 1 + 2 * (start - 1) + mpf(1) / (2 * PARTS)


def two_doubles(number):
    high = mpf(float(number))
    return float(high), float(number - high)


def main():
    print(HEAD)
    print(f"// Part i begins at {mp.nstr(START, 6)} + i / {2 * PARTS}; from 1 on the parts are twice as wide.")
    print("// clang-format off\nconstexpr LogEntry kLogTable[] = {")
    for middle in parts():
        reciprocal = mp.nint(1 / middle * 2**BITS) / 2**BITS
        high, low = two_doubles(-log(reciprocal))
        print(f"    {{{float(reciprocal)!r}, {high!r}, {low!r}}},")
    print("};\n// clang-format on\n")
    high = mpf(int(log(2) * 2**42)) / 2**42
    print("// ln 2: the first part times any exponent is exact.")
    print(f"constexpr double kLn2High = {float(high)!r};")
    print(f"constexpr double kLn2Low = {float(log(2) - high)!r};")
    print("\n}  // namespace MCMath_800\n\n#endif  // KESTREL_MATH_LOGTABLE_H")


if __name__ == "__main__":
    main()
