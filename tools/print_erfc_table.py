#!/usr/bin/env python3
"""Prints kestrel/math/ErfcTable.h: polynomials of the scaled complementary error function, with mpmath (50 digits).

Each is interpolated at Chebyshev points; the largest relative error, measured on a grid, is printed beside.
Needs mpmath. Write with: python3 tools/print_erfc_table.py > kestrel/math/ErfcTable.h
"""
from mpmath import cos, erfc, exp, fabs, lu_solve, matrix, mp, mpf, nstr, pi, polyval, sqrt

mp.dps = 50

# Parts of [0, END), so narrow that the first coefficient makes up the most of each value.
PER_UNIT = 8
END = 6
DEGREE = 9
FAR_DEGREE = 10

HEAD = """// Polynomials of exp(a^2) erfc(a), lowest power first.
// Printed by tools/print_erfc_table.py: change it there.

#ifndef KESTREL_MATH_ERFCTABLE_H
#define KESTREL_MATH_ERFCTABLE_H

namespace MCMath_800 {
"""


def scaled(a):
    return exp(a * a) * erfc(a)


def far(v):
    """a sqrt(pi) exp(a^2) erfc(a) in v = 1 / a^2."""
    if v == 0:
        return mpf(1)
    a = 1 / sqrt(v)
    return a * sqrt(pi) * scaled(a)


def fit(function, low, high, degree, middle):
    """Coefficients in x - middle, and their largest relative error."""
    nodes = [(low + high) / 2 + (high - low) / 2 * cos(pi * (2 * i + 1) / (2 * degree + 2)) for i in range(degree + 1)]
    rows = matrix(degree + 1, degree + 1)
    for i, x in enumerate(nodes):
        for j in range(degree + 1):
            rows[i, j] = (x - middle) ** j
    solved = list(lu_solve(rows, matrix([function(x) for x in nodes])))
    worst = 0
    for i in range(41):
        x = low + (high - low) * i / 40
        worst = max(worst, fabs(polyval(solved[::-1], x - middle) / function(x) - 1))
    return solved, worst


def main():
    print(HEAD)
    rows, errors = [], []
    for part in range(END * PER_UNIT):
        low, high = mpf(part) / PER_UNIT, mpf(part + 1) / PER_UNIT
        solved, worst = fit(scaled, low, high, DEGREE, (low + high) / 2)
        rows.append(solved)
        errors.append(worst)
    print(f"constexpr int kErfcPartsPerUnit = {PER_UNIT};")
    print(f"constexpr double kErfcEnd = {END};")
    print(f"// In a less the middle of its part: relative error {nstr(max(errors), 2)}.")
    print(f"// clang-format off\nconstexpr double kErfcParts[{END * PER_UNIT}][{DEGREE + 1}] = {{")
    for solved in rows:
        print("    {" + ", ".join(nstr(c, 17) for c in solved) + "},")
    print("};\n// clang-format on\n")
    solved, worst = fit(far, mpf(10) ** -12, mpf(1) / END**2, FAR_DEGREE, 0)
    print(f"// a sqrt(pi) times it in 1 / a^2 from there on: relative error {nstr(worst, 2)}.")
    print("// clang-format off\nconstexpr double kErfcFar[] = {")
    for c in solved:
        print(f"    {nstr(c, 17)},")
    print("};\n// clang-format on\n")
    print("}  // namespace MCMath_800\n\n#endif  // KESTREL_MATH_ERFCTABLE_H")


if __name__ == "__main__":
    main()
