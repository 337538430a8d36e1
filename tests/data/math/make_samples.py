#!/usr/bin/env python3
"""Writes percentile.csv and median_interval.csv: percentiles and the median's confidence interval in exact fractions.

A sample is given by three numbers, `seed`, `n` and `kind`, from which sample() makes its values and weights; the
tests make the same. Shares and levels stand for the short decimals that they are printed as. Definitions are those
of R. J. Hyndman and Y. Fan, "Sample quantiles in statistical packages" (1996), on the sample in which a value of a
whole weight w stands w times; other weights take the line through the cumulated ones.
"""
import csv
import os
import random
from decimal import Decimal, localcontext
from fractions import Fraction
from math import comb, floor

PLAIN, WHOLE, QUARTERS = range(3)
# Definitions 4 to 9: the position W p + start + slope p.
LINES = {4: (Fraction(0), Fraction(0)), 5: (Fraction(1, 2), Fraction(0)), 6: (Fraction(0), Fraction(1)),
         7: (Fraction(1), Fraction(-1)), 8: (Fraction(1, 3), Fraction(1, 3)), 9: (Fraction(3, 8), Fraction(1, 4))}
CLOSEST, HINGES = 3, 10


def sample(seed, n, kind):
    """Pairs of a value and its weight; every fourth seed leaves some cases without a value."""
    state, cases = seed, []

    def draw(count):
        nonlocal state
        state = (state * 1103515245 + 12345) % 2**31
        return (state >> 8) % count

    spread = 6 if seed % 3 == 0 else 1000
    for _ in range(n):
        value = Fraction(draw(spread) + 8, 8)
        weight = Fraction(1)
        if kind != PLAIN:
            weight = Fraction(draw(4)) if kind == WHOLE else Fraction(draw(8) + 1, 4)
        if not (draw(5) == 0 and seed % 4 == 0):
            cases.append((value, weight))
    return cases


def by_rank(ordered, position, method, p):
    """Definitions on the sample written out."""
    count = len(ordered)

    def at(rank):
        return ordered[min(max(rank, 1), count) - 1]

    lower = floor(position)
    rest = position - lower
    if method == 1:
        return at(lower if rest == 0 else lower + 1)
    if method == 2:
        return at(lower + 1) if rest else (at(lower) + at(lower + 1)) / 2
    if method == CLOSEST:
        up = rest > Fraction(1, 2) or rest == Fraction(1, 2) and lower % 2 == 1
        return at(lower + 1 if up else lower)
    return at(lower) + rest * (at(lower + 1) - at(lower))


def by_weight(cases, position, method):
    """The same for weights that are not whole: a line over the first unit of each value's weight."""
    weights = {}
    for value, weight in cases:
        weights[value] = weights.get(value, 0) + weight
    knots = [(value, weight) for value, weight in sorted(weights.items()) if weight > 0]
    reached, before = Fraction(0), knots[0][0]
    for index, (value, weight) in enumerate(knots):
        if method == 1 and position <= reached + weight:
            return value
        if method == 2 and position < reached + weight:
            return value
        if method == 2 and position == reached + weight:
            return (value + knots[min(index + 1, len(knots) - 1)][0]) / 2
        if method > 2 and position <= reached + weight:
            return before + min(Fraction(1), (position - reached) / min(weight, Fraction(1))) * (value - before)
        reached, before = reached + weight, value
    return before


def percentile(cases, kind, p, method):
    total = sum(weight for _, weight in cases)
    if method == HINGES:
        depth = Fraction(floor((total + 3) / 2), 2)
        position = {Fraction(1, 4): depth, Fraction(1, 2): (total + 1) / 2, Fraction(3, 4): total + 1 - depth}[p]
    else:
        start, slope = LINES.get(method, (Fraction(0), Fraction(0)))
        position = max(Fraction(0), total * p + start + slope * p)
    if kind == QUARTERS:
        return by_weight(cases, position, method)
    return by_rank(sorted(value for value, weight in cases for _ in range(int(weight))), position, method, p)


def percentile_rows(r):
    for index in range(10500):
        method = 1 + index % 10
        n = r.choice([1, 2, 3, r.randint(1, 12), r.randint(1, 60), r.randint(1, 200)])
        seed = r.randint(1, 10**6)
        # What is closest, and what a hinge is, is said of ranks.
        kind = r.choice([PLAIN, WHOLE] if method in (CLOSEST, HINGES) else [PLAIN, WHOLE, QUARTERS])
        p = r.choice(["0.25", "0.5", "0.75"]) if method == HINGES or r.random() < 0.2 else r.choice(
            ["0", "1", "0.05", "0.95", f"{r.randint(1, 99) / 100:g}", f"{r.randint(1, 999) / 1000:g}"])
        cases = sample(seed, n, kind)
        if sum(weight for _, weight in cases) > 0:
            yield seed, n, kind, p, method, percentile(cases, kind, Fraction(p), method)


def median_interval(n, level):
    """The rank and the coverage 1 - 2 P(X < rank), X binomial, at the largest rank that keeps the level."""
    below, rank, coverage = 0, 0, None
    while True:
        below += comb(n, rank)
        covered = 1 - Fraction(2 * below, 2**n)
        if covered < level:
            return rank, coverage
        rank, coverage = rank + 1, covered


def median_rows(r):
    for n in range(1, 301):
        levels = {"0.5", "0.9", "0.95", "0.99"} | {f"{r.randint(1, 999) / 1000:g}" for _ in range(31)}
        # Levels that a rank meets exactly.
        levels |= {str(Decimal(1) - Decimal(2 * sum(comb(n, k) for k in range(rank))) / 2**n)
                   for rank in (1, 2, 3) if n < 15}
        for level in sorted(levels):
            if 0 < Fraction(level) < 1:
                rank, coverage = median_interval(n, Fraction(level))
                if rank > 0:
                    yield n, level, coverage, rank, n + 1 - rank


def text(value):
    if not isinstance(value, Fraction):
        return str(value)
    with localcontext() as context:
        context.prec = 25
        return str((Decimal(value.numerator) / Decimal(value.denominator)).normalize()).lower().replace("e+", "e")


def write(name, columns, rows):
    folder = os.path.dirname(os.path.abspath(__file__))
    with open(os.path.join(folder, name), "w", newline="", encoding="ascii") as file:
        out = csv.writer(file, lineterminator="\n")
        out.writerow(columns)
        out.writerows([text(cell) for cell in row] for row in rows)


def main():
    write("percentile.csv", "seed n kind p method value".split(), percentile_rows(random.Random("percentile 1")))
    write("median_interval.csv", "n level coverage lower upper".split(), median_rows(random.Random("median 1")))


if __name__ == "__main__":
    main()
