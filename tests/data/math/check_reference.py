#!/usr/bin/env python3
"""Holds rows of the tables against other methods: mpmath's own functions, quadrature of densities, plain sums.

    check_reference.py [--rows N]

Takes N rows of each table, evenly spread, leaves out what the other method cannot do in reasonable time, and
prints for each value how many rows were compared and the largest relative difference. Fails above 1e-20.
"""
import argparse
import csv
import os
import sys

from mpmath import mp, mpf

mp.dps = 45
LIMIT = mpf("1e-20")


def integral(density, low, high, middle, width):
    """Over [low, high], in pieces around the bulk of the density near `middle`."""
    points = sorted({p for p in [middle + width * k for k in (-60, -30, -15, -8, -4, -2, -1, 0, 1, 2, 4, 8, 15, 30, 60)]
                     if low < p < high} | {low, high})
    return mp.quad(density, points, maxdegree=9)


def normal(x):
    return {"cdf": mp.erfc(-x / mp.sqrt(2)) / 2}


def log_gamma(x):
    return {"value": mp.loggamma(x)}


def gamma(x, a):
    if a > 3000 or a < 20 and x > 3000:
        # The density's logarithm, so that no power overflows.
        if abs(x - a) > 6 * mp.sqrt(a):
            return None
        log_front = -mp.loggamma(a)
        value = integral(lambda t: mp.exp((a - 1) * mp.log(t) - t + log_front), mpf(0), x, a, mp.sqrt(a))
        return {"cdf": value} if value < mpf("0.999") else None
    with mp.workdps(400):
        return {"cdf": mp.gammainc(a, 0, x, regularized=True), "sig": mp.gammainc(a, x, mp.inf, regularized=True)}


def incomplete_beta(a, b, x, y):
    """By hypergeometric series with whatever digits the tail asks for, or by quadrature."""
    if max(a, b) > 2000:
        mean, sd = a / (a + b), mp.sqrt(a * b / (a + b)) / (a + b)
        if min(a, b) < 30 or abs(x - mean) > 6 * sd:
            return None
        front = mp.loggamma(a + b) - mp.loggamma(a) - mp.loggamma(b)
        lower = integral(lambda t: mp.exp((a - 1) * mp.log(t) + (b - 1) * mp.log(1 - t) + front), mpf(0), x, mean, sd)
        return (lower, None) if lower < mpf("0.999") else None
    with mp.workdps(400):
        if y * 1000 < 1 or x * 1000 < 1:
            return None
        return mp.betainc(a, b, 0, x, regularized=True), mp.betainc(b, a, 0, y, regularized=True)


def pair(tails):
    return tails and {name: value for name, value in zip(("cdf", "sig"), tails) if value is not None}


def beta(x, a, b):
    return pair(incomplete_beta(a, b, x, 1 - x))


def f(x, df1, df2):
    return pair(incomplete_beta(df1 / 2, df2 / 2, df1 * x / (df1 * x + df2), df2 / (df1 * x + df2)))


def t(x, df):
    tails = incomplete_beta(df / 2, mpf(1) / 2, df / (df + x * x), x * x / (df + x * x))
    if not tails or tails[0] is None:
        return None
    return {"cdf" if x < 0 else "sig": tails[0] / 2}


def binomial(k, n, p):
    if n > 3000:
        return {"pdf": mp.binomial(n, k) * p ** int(k) * (1 - p) ** int(n - k)}
    with mp.workdps(100):
        terms = [mp.binomial(n, j) * p ** j * (1 - p) ** int(n - j) for j in range(int(k) + 1)]
        return {"pdf": terms[-1], "cdf": mp.fsum(terms)}


def hypergeometric(k, total, successes, draws):
    if total > 3000:
        return None
    k, total, successes, draws = (int(v) for v in (k, total, successes, draws))
    least = max(0, draws + successes - total)
    choices = sum(choose(successes, j) * choose(total - successes, draws - j) for j in range(least, k + 1))
    return {"cdf": mpf(choices) / choose(total, draws)}


def choose(n, k):
    from math import comb
    return comb(n, k)


def noncentral_chi(x, df, nc):
    if nc > 300 or x > 2000 or df > 1000:
        return None
    with mp.workdps(60):
        half, total, j, weight = nc / 2, mpf(0), 0, mp.exp(-nc / 2)
        while j < half or weight > mpf("1e-400"):
            total += weight * mp.gammainc(df / 2 + j, 0, x / 2, regularized=True)
            j += 1
            weight *= half / j
            if j > half and weight < total * mpf("1e-40"):
                break
        return {"cdf": total}


def noncentral_f(x, df1, df2, nc):
    if nc > 100 or max(df1, df2) > 300:
        return None
    u, v = df1 * x / (df1 * x + df2), df2 / (df1 * x + df2)
    half, total, j, weight = nc / 2, mpf(0), 0, mp.exp(-nc / 2)
    while True:
        tails = incomplete_beta(df1 / 2 + j, df2 / 2, u, v)
        if tails is None:
            return None
        total += weight * tails[0]
        j += 1
        weight *= half / j
        if j > half and weight < total * mpf("1e-40"):
            return {"cdf": total}


def noncentral_t(x, df, nc):
    """P(Z + nc <= x S), over the distribution of S = sqrt(chi-square / df)."""
    if abs(nc) > 30 or df > 1000 or df < 5 or abs(x) > 50:
        return None
    front = mp.log(2) + df / 2 * mp.log(df / 2) - mp.loggamma(df / 2)

    def density(s):
        return mp.exp(front + (df - 1) * mp.log(s) - df * s * s / 2) * mp.erfc((nc - x * s) / mp.sqrt(2)) / 2

    width = 1 / mp.sqrt(2 * df)
    value = mp.quad(density, [mpf(0)] + [p for p in (1 + width * k / 2 for k in range(-30, 61, 3)) if p > 0]
                    + [1 + 60 * width], maxdegree=10)
    # Where the integrand's bulk lies elsewhere the pieces do not fit.
    return {"cdf": value} if value > mpf("1e-15") else None


METHODS = {"normal": normal, "lgamma": log_gamma, "gamma": gamma, "beta": beta, "f": f, "t": t, "binomial": binomial,
           "hypergeometric": hypergeometric, "noncentral_chi": noncentral_chi, "noncentral_f": noncentral_f,
           "noncentral_t": noncentral_t}


def main():
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("--rows", type=int, default=60)
    parser.add_argument("--folder", default=os.path.dirname(os.path.abspath(__file__)))
    options = parser.parse_args()
    failed = False
    for name, method in METHODS.items():
        with open(os.path.join(options.folder, name + ".csv"), newline="", encoding="ascii") as file:
            rows = list(csv.DictReader(file))
        worst = {}
        for row in rows[::max(1, len(rows) // options.rows)]:
            values = ("cdf", "sig", "pdf", "value", "quantile", "nc_root", "middle")
            arguments = [mpf(float(text)) for column, text in row.items() if column not in values]
            for column, other in (method(*arguments) or {}).items():
                difference = abs(mpf(row[column]) / other - 1)
                count, largest, _ = worst.get(column, (0, mpf(-1), None))
                worst[column] = (count + 1, max(largest, difference),
                                 worst[column][2] if difference <= largest else row)
        for column, (count, largest, row) in worst.items():
            print(f"{name} {column}: {count} rows, largest difference {mp.nstr(largest, 3)}", flush=True)
            if largest > LIMIT:
                failed = True
                print(f"  at {row}")
    return 1 if failed else 0


if __name__ == "__main__":
    sys.exit(main())
