#!/usr/bin/env python3
"""Writes family_values.csv: the normal, gamma and beta families at points of every method's range, to 60 digits.

Needs mpmath. Arguments are doubles taken exactly. Values come from series with terms of one sign (and enough digits
where a tail is taken from 1), so that they share no method with the library.
"""
import csv
import os
import random

from mpmath import erf, erfc, erfinv, exp, log, loggamma, mp, mpf, nstr, sqrt

mp.dps = 60
random.seed(708)


def gamma_shares(x, a):
    """P and Q by the series of P, with as many digits as Q takes."""
    mp.dps = 60 + int(x)
    x, a = mpf(x), mpf(a)
    term = total = exp(a * log(x) - x - loggamma(a)) / a
    n = a
    while term > total * mpf(10) ** (-mp.dps):
        n += 1
        term *= x / n
        total += term
    shares = total, 1 - total
    mp.dps = 60
    return shares


def beta_lower(x, y, a, b):
    term = exp(a * log(x) + b * log(y) + loggamma(a + b) - loggamma(a) - loggamma(b)) / a
    total, n = term, mpf(0)
    while term > total * mpf(10) ** (-mp.dps) or (a + b + n) * x > a + 1 + n:
        term *= x * (a + b + n) / (a + 1 + n)
        n += 1
        total += term
    return total


def beta_shares(x, y, a, b):
    mp.dps = 180
    lower = beta_lower(x, y, a, b) if x * b < a * y else 1 - beta_lower(y, x, b, a)
    shares = lower, 1 - lower
    mp.dps = 60
    return shares


def rows():
    for i in range(60):
        x = random.uniform(-7, 7)
        yield "derf", (x,), erf(mpf(x))
        x = random.choice([random.uniform(-6, 26.5), 10 ** random.uniform(-8, 0)])
        yield "derfc", (x,), erfc(mpf(x))
        z = random.uniform(-37.5, 8)
        yield "CdfStdNorm", (z,), erfc(-mpf(z) / sqrt(2)) / 2
        p = random.choice([random.random(), random.random() * 0.2])
        yield "IdfStdNorm", (p,), sqrt(2) * erfinv(2 * mpf(p) - 1)
        x = random.choice([random.uniform(0.01, 12), 10 ** random.uniform(-300, 300), 1 + random.gauss(0, 1e-6), 2 - 1e-9])
        yield "vexadnlgam", (x,), loggamma(mpf(x))
        n = float(random.randint(2, 3000))
        k = float(random.randint(1, int(n) - 1))
        yield "dnlbnc", (n, k), loggamma(mpf(n) + 1) - loggamma(mpf(k) + 1) - loggamma(mpf(n) - mpf(k) + 1)
    for i in range(110):
        df = 10 ** random.uniform(-1.5, 2.6)
        x = random.choice([df * 10 ** random.uniform(-2, 0.7), df * (1 + random.gauss(0, 1) / df**0.5), 10 ** random.uniform(-2, 2)])
        if x <= 0:
            continue
        below, above = gamma_shares(mpf(x) / 2, mpf(df) / 2)
        yield "CdfChi", (x, df), below
        yield "SigChi", (x, df), above
        rate = random.uniform(0.1, 9)
        yield "CdfGam", (x, df, rate), gamma_shares(mpf(x) * mpf(rate), mpf(df))[0]
    for i in range(80):
        a, b = 10 ** random.uniform(-1.3, 2.5), 10 ** random.uniform(-1.3, 2.5)
        x = random.choice([random.betavariate(a, b), random.random(), 10 ** random.uniform(-5, 0)])
        if not 1e-9 < x < 1 - 1e-9:
            continue
        yield "CdfBeta", (x, a, b), beta_shares(mpf(x), 1 - mpf(x), mpf(a), mpf(b))[0]
        f = random.choice([random.uniform(0.01, 4), 10 ** random.uniform(-3, 2)])
        top, rest = mpf(a) * mpf(f), mpf(b)
        below, above = beta_shares(top / (top + rest), rest / (top + rest), mpf(a) / 2, mpf(b) / 2)
        yield "CdfF", (f, a, b), below
        yield "SigF", (f, a, b), above
        t = random.choice([random.gauss(0, 2), random.gauss(0, 30)])
        square = mpf(t) ** 2
        below = beta_shares(a / (a + square), square / (a + square), mpf(a) / 2, mpf(1) / 2)[0] / 2
        yield "SigT", (t, a), below if t > 0 else 1 - below
        yield "CdfT", (t, a), below if t < 0 else 1 - below


def main():
    folder = os.path.dirname(os.path.abspath(__file__))
    with open(os.path.join(folder, "family_values.csv"), "w", newline="", encoding="utf-8") as file:
        writer = csv.writer(file, lineterminator="\n")
        writer.writerow(["function", "first", "second", "third", "value"])
        for function, arguments, value in rows():
            # What is left of a tail that was taken from 1 has at least 25 digits.
            if abs(value) > mpf(10) ** -150 or function in ("CdfStdNorm", "derfc"):
                cells = [repr(float(argument)) for argument in arguments] + [""] * (3 - len(arguments))
                writer.writerow([function] + cells + [nstr(value, 22)])


if __name__ == "__main__":
    main()
