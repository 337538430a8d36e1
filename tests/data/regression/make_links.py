#!/usr/bin/env python3
"""Writes links.csv: the functions behind the names of normalisations, to 60 digits and rounded once; and
shares.csv: the shares of three values' functions in their sum, with as many digits as they need.

Needs mpmath. Arguments are doubles taken exactly; results that are no normal double are left out, and so are
differences of "none", which are plain subtractions. Shares below 1e-100 are written as 0.
"""
import csv
import os

from mpmath import atan, erfc, exp, expm1, mp, mpf, pi, sqrt

mp.dps = 60

BELOW = {
    "none": lambda y: y,
    "logit": lambda y: 1 / (1 + exp(-y)),
    "probit": lambda y: erfc(-y / sqrt(2)) / 2,
    "cloglog": lambda y: -expm1(-exp(y)),
    "loglog": lambda y: exp(-exp(-y)),
    "cauchit": lambda y: mpf(1) / 2 + atan(y) / pi,
    "exp": exp,
}
# The upper tails, written so that 60 digits are enough for them, too.
ABOVE = {
    "none": lambda y: 1 - y,
    "logit": lambda y: 1 / (1 + exp(y)),
    "probit": lambda y: erfc(y / sqrt(2)) / 2,
    "cloglog": lambda y: exp(-exp(y)),
    "loglog": lambda y: -expm1(-exp(-y)),
    "cauchit": lambda y: mpf(1) / 2 - atan(y) / pi,
    "exp": lambda y: -expm1(y),
}

POINTS = [-700.0, -300.5, -37.25, -30.0, -8.5, -6.25, -3.3, -2.0, -1.0, -0.7, -0.1, -1e-9, 0.0, 1e-9, 0.1, 0.7, 1.0,
          1.7, 2.0, 3.3, 5.5, 6.25, 8.5, 30.0, 37.25, 300.5, 700.0]
STEPS = [1e-12, 1e-6, 0.01, 0.4, 1.0, 2.5, 20.0]
SMALLEST_NORMAL = mpf(2) ** -1022
LARGEST = mpf(2) ** 1023

# Each as it stands and turned round, so that the largest is not always first.
TRIPLES = [(0.5, -2.0, 1.25), (-0.1, -0.1, -0.1), (3.0, -40.0, -41.5), (-8.5, -9.25, -10.0), (700.0, 2.0, -3.5),
           (-6.0, -6.05, -6.1), (-7.0, -7.001, -7.25), (-8.0, -8.0, -9.0), (-30.0, -30.5, -31.0),
           (-31.0, -31.125, -33.0), (-60.0, -60.01, -61.0), (-100.0, -100.25, -101.0), (-460.0, -460.5, -461.0),
           (-700.0, -702.5, -740.0), (-800.0, -800.5, -801.25), (-5000.0, -5000.0, -5000.001), (-1e6, -1e6 - 1, -2e6),
           (-1e250, -2e250, -3.5e250), (800.0, 801.0, 640.0), (-1e300, 0.25, 5.0)]
# Where mpmath gives up.
LEAST = {"cloglog": -5000, "loglog": -5000, "probit": -2e6}


def row(method, form, low, high, value):
    if value != 0 and abs(value) < SMALLEST_NORMAL or abs(value) > LARGEST:
        return []
    if value == 0 and form == "between":
        return []
    return [[method, form, repr(low), repr(high), repr(float(value))]]


def difference(method, low, high):
    mp.dps = 400
    try:
        if low > 0 and method != "exp":
            return ABOVE[method](mpf(low)) - ABOVE[method](mpf(high))
        return BELOW[method](mpf(high)) - BELOW[method](mpf(low))
    finally:
        mp.dps = 60


# The exponents of mpmath know no underflow, but reducing an argument like 1e600 takes as many digits.
def shares(method, values):
    mp.dps = 1200
    try:
        parts = [BELOW[method](mpf(y)) for y in values]
        total = sum(parts)
        return [part / total for part in parts]
    finally:
        mp.dps = 60


def main():
    rows = []
    for method in BELOW:
        for y in POINTS:
            rows += row(method, "below", y, y, BELOW[method](mpf(y)))
            rows += row(method, "above", y, y, ABOVE[method](mpf(y)))
            if method == "none":
                continue
            for step in STEPS:
                high = y + step
                if high != y:
                    rows += row(method, "between", y, high, difference(method, y, high))
        if method != "none":
            for high in [700.0, 30.0, 1.0]:
                rows += row(method, "between", -700.0, high, difference(method, -700.0, high))
    write("links.csv", ["method", "form", "low", "high", "expected"], rows)
    rows = []
    for method in BELOW:
        for triple in TRIPLES:
            if method == "none" or min(triple) < LEAST.get(method, -1e300):
                continue
            for values in [triple, triple[::-1]]:
                expected = [float(share) if share >= 1e-100 else 0.0 for share in shares(method, values)]
                rows.append([method] + [repr(number) for number in [*values, *expected]])
    write("shares.csv", ["method", "y1", "y2", "y3", "p1", "p2", "p3"], rows)


def write(name, header, rows):
    path = os.path.join(os.path.dirname(os.path.abspath(__file__)), name)
    with open(path, "w", newline="") as out:
        writer = csv.writer(out, lineterminator="\n")
        writer.writerow(header)
        writer.writerows(rows)


if __name__ == "__main__":
    main()
