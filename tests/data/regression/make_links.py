#!/usr/bin/env python3
"""Writes links.csv: the distribution functions behind the link names, to 60 digits and rounded once.

Needs mpmath. Arguments are doubles taken exactly; results that are no normal double are left out, and so are
differences of "none", which are plain subtractions.
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
}
# The upper tails, written so that 60 digits are enough for them, too.
ABOVE = {
    "none": lambda y: 1 - y,
    "logit": lambda y: 1 / (1 + exp(y)),
    "probit": lambda y: erfc(y / sqrt(2)) / 2,
    "cloglog": lambda y: exp(-exp(y)),
    "loglog": lambda y: -expm1(-exp(-y)),
    "cauchit": lambda y: mpf(1) / 2 - atan(y) / pi,
}

POINTS = [-700.0, -300.5, -37.25, -30.0, -8.5, -6.25, -3.3, -2.0, -1.0, -0.7, -0.1, -1e-9, 0.0, 1e-9, 0.1, 0.7, 1.0,
          1.7, 2.0, 3.3, 5.5, 6.25, 8.5, 30.0, 37.25, 300.5, 700.0]
STEPS = [1e-12, 1e-6, 0.01, 0.4, 1.0, 2.5, 20.0]
SMALLEST_NORMAL = mpf(2) ** -1022


def row(method, form, low, high, value):
    if value != 0 and abs(value) < SMALLEST_NORMAL:
        return []
    if value == 0 and form == "between":
        return []
    return [[method, form, repr(low), repr(high), repr(float(value))]]


def difference(method, low, high):
    mp.dps = 400
    try:
        if low > 0:
            return ABOVE[method](mpf(low)) - ABOVE[method](mpf(high))
        return BELOW[method](mpf(high)) - BELOW[method](mpf(low))
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
    path = os.path.join(os.path.dirname(os.path.abspath(__file__)), "links.csv")
    with open(path, "w", newline="") as out:
        writer = csv.writer(out, lineterminator="\n")
        writer.writerow(["method", "form", "low", "high", "expected"])
        writer.writerows(rows)


if __name__ == "__main__":
    main()
