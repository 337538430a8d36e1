#!/usr/bin/env python3
"""Writes the tables of distribution functions that tests and the accuracy report judge by.

    make_reference.py [--rows N] [--only FAMILY]

One row: the arguments as exact doubles, then the values, computed with 60 digits and more and written with 25.
`quantile` is the inverse at the double nearest to `cdf` (left out where that is 1), `nc_root` the non-centrality
that gives that double (left out where it is ill-determined), `middle` a probability whose binomial quantile is k.
Points cover both tails down to 1e-300, the neighbourhood of the mean and parameters from 0.1 to 1e7, all from one
seed. check_reference.py holds the values against other methods. Needs mpmath; takes about 45 minutes.
"""
import argparse
import csv
import math
import os
import random
import time
from decimal import Decimal as D

import reference_functions as f

SMALLEST, LARGEST = D("1e-300"), 1e300


# --- Points ------------------------------------------------------------------------------------------------------


def short(x, digits=7):
    """The double nearest to a short decimal, so that the tables stay small."""
    return float(f"{x:.{digits}g}")


def log_between(r, low, high):
    return math.exp(r.uniform(math.log(low), math.log(high)))


def shape(r, low=0.1, high=1e7):
    """Mostly anything; sometimes a small whole or half number, sometimes the ends."""
    kind = r.random()
    if kind < 0.15:
        return r.randint(1, 200) / 2
    if kind < 0.19:
        return r.choice([low, 0.5, 1.0, 2.0, 10.0, 20.0, 30.0, 100.0, 1e3, 1e4, 1e5, 1e6, high])
    return short(log_between(r, low, high), 6)


def depth(r):
    """How far out a point shall be: minus the logarithm of the tail's probability, about."""
    kind = r.random()
    if kind < 0.4:
        return r.uniform(0, 690)
    if kind < 0.85:
        return log_between(r, 1e-3, 40)
    return log_between(r, 1e-14, 1e-2)


def solve(rate, target, low, high):
    """Where a function that rises from low to high (in the logarithm of its argument's distance) meets target."""
    for _ in range(70):
        middle = (low + high) / 2
        if rate(middle) < target:
            low = middle
        else:
            high = middle
    return low


def gamma_point(r, a):
    """x whose tail is about exp(-depth), by Chernoff's bound."""
    target, sign = depth(r) / a, r.choice([-1, 1])
    # With x = a e^u: x/a - 1 - ln(x/a) = e^u - 1 - u.
    u = sign * solve(lambda v: math.expm1(sign * v) - sign * v, target, 0.0, 690.0 if sign < 0 else 20.0)
    return a * math.exp(u)


def beta_point(r, a, b):
    """x and 1 - x, likewise."""
    target, sign, mean = depth(r), r.choice([-1, 1]), math.log(a / b)

    def rate(v):
        # x = 1 / (1 + e^-u); the divergence of (a, b) / (a + b) from (x, 1 - x), times a + b.
        u = mean + sign * v
        log_x, log_y = -math.log1p(math.exp(-u)) if u > -700 else u, -u - math.log1p(math.exp(-u)) if u > -700 else 0.0
        at_mean = a * -math.log1p(b / a) + b * -math.log1p(a / b)
        return at_mean - a * log_x - b * log_y

    u = mean + sign * solve(rate, target, 0.0, 680.0)
    return 1 / (1 + math.exp(-u)), 1 / (1 + math.exp(u))


def near_or_far_from_one(r, x, y):
    return short(x) if x < 0.9 else 1 - short(y, r.choice([2, 4, 6]))


# --- Rows --------------------------------------------------------------------------------------------------------


def refined(x, cdf, tails, density, slope):
    """The quantile of the double nearest to cdf, which is near x; slope(x) is density'/density. None where
    that double is 1."""
    p = D(float(cdf))
    if p >= 1 or p <= 0:
        return None
    for _ in range(6):
        step = (p - cdf) / density(x)
        correction = step - step * step * slope(x) / 2
        curvature = abs(step) * (abs(slope(x)) + 1 / abs(x))
        x += correction
        if curvature < D("1e-9"):
            return x
        if curvature > 1:
            return None
        cdf = tails(x)[0]
    return x


def usable(*values):
    return all(v > SMALLEST for v in values)


def normal_row(r):
    x = short(r.choice([-1, 1]) * (r.uniform(0, 37.4) if r.random() < 0.5 else log_between(r, 1e-12, 10)))
    z = D(x)
    cdf, sig = f.normal_tails(z)
    if not usable(cdf, sig):
        return None
    return [x], [cdf, refined(z, cdf, f.normal_tails, f.normal_density, lambda v: -v)]


def t_row(r):
    df = shape(r)
    tail = 2 * depth(r) / (df + 1)
    if tail > 1300:
        return None
    x = short(r.choice([-1, 1]) * (math.sqrt(df * math.expm1(tail)) if tail < 700 else
                                   math.exp(min((math.log(df) + tail) / 2, 690.0))))
    df, z = D(df), D(x)
    cdf, sig = f.t_tails(z, df)
    if not usable(cdf, sig):
        return None
    quantile = refined(z, cdf, lambda v: f.t_tails(v, df), lambda v: f.t_density(v, df),
                       lambda v: -(df + 1) * v / (df + v * v))
    return [x, df], [cdf, sig, quantile]


def gamma_row(r):
    a = shape(r)
    x = short(gamma_point(r, a))
    if not 1e-300 < x < LARGEST:
        return None
    a, z = D(a), D(x)
    cdf, sig = f.gamma_tails(a, z)
    if not usable(cdf, sig):
        return None
    quantile = refined(z, cdf, lambda v: f.gamma_tails(a, v), lambda v: f.gamma_density(a, v),
                       lambda v: (a - 1) / v - 1)
    return [x, a], [cdf, sig, quantile]


def f_row(r):
    df1, df2 = shape(r), shape(r)
    share, rest = beta_point(r, df1 / 2, df2 / 2)
    x = short(share / rest * (df2 / df1))
    if not 1e-290 < x < 1e290:
        return None
    df1, df2, z = D(df1), D(df2), D(x)
    cdf, sig = f.f_tails(z, df1, df2)
    if not usable(cdf, sig):
        return None
    quantile = refined(z, cdf, lambda v: f.f_tails(v, df1, df2), lambda v: f.f_density(v, df1, df2),
                       lambda v: (df1 / 2 - 1) / v - (df1 + df2) / 2 * df1 / (df2 + df1 * v))
    return [x, df1, df2], [cdf, sig, quantile]


def beta_row(r):
    a, b = shape(r), shape(r)
    x = near_or_far_from_one(r, *beta_point(r, a, b))
    if not 1e-300 < x < 1:
        return None
    a, b, z = D(a), D(b), D(x)
    cdf, sig = f.beta_tails(a, b, z, 1 - z)
    if not usable(cdf, sig):
        return None
    quantile = refined(z, cdf, lambda v: f.beta_tails(a, b, v, 1 - v), lambda v: f.beta_density(a, b, v, 1 - v),
                       lambda v: (a - 1) / v - (b - 1) / (1 - v))
    return [x, a, b], [cdf, sig, quantile]


def binomial_row(r):
    n = r.randint(1, 60) if r.random() < 0.2 else int(log_between(r, 2, 1e7))
    kind = r.random()
    p = short(r.random() if kind < 0.5 else log_between(r, 1e-9, 1), 5)
    if kind > 0.8:
        p = 1 - p
    if not 0 < p < 1:
        return None
    share = beta_point(r, n * p, n * (1 - p))[0]
    k = min(n, max(0, round(n * share)))
    point, cdf = f.binomial(D(k), D(n), D(p))
    if not usable(point, cdf):
        return None
    # What has to lead back to k; none where a double cannot tell the probability of k from 0.
    middle = float(cdf - point / 2) if point > D("1e-9") * cdf else None
    return [D(k), D(n), p], [point, cdf, middle]


def hypergeometric_row(r):
    total = r.randint(2, 100) if r.random() < 0.2 else int(log_between(r, 10, 1e7))
    successes, draws = (min(total, max(1, int(total * (r.random() if r.random() < 0.6 else log_between(r, 1e-5, 1)))))
                        for _ in range(2))
    least, most = max(0, draws + successes - total), min(draws, successes)
    if least == most:
        return None
    mean = draws * successes / total
    sd = math.sqrt(max(mean * (1 - successes / total) * (total - draws) / max(1, total - 1), 1e-6))
    k = round(mean + r.choice([-1, 1]) * sd * (r.uniform(0, 37) if r.random() < 0.5 else log_between(r, 1e-3, 5)))
    k = min(most, max(least, k))
    cdf = f.hypergeometric(D(k), D(total), D(successes), D(draws))
    if not usable(cdf):
        return None
    return [D(k), D(total), D(successes), D(draws)], [cdf]


def noncentrality(r, high):
    return short(log_between(r, 0.01, high), 5)


def noncentral_chi_row(r):
    df, nc = shape(r, 0.1, 1e5), noncentrality(r, 1e4)
    mean, sd = df + nc, math.sqrt(2 * (df + 2 * nc))
    # As if a central one of the same mean and variance.
    x = short(gamma_point(r, (mean / sd) ** 2) * sd * sd / mean)
    if not 1e-300 < x < LARGEST:
        return None
    cdf, slope = f.noncentral_chi(D(x), D(df), D(nc))
    return noncentral_values([x, df, nc], cdf, slope, nc)


def noncentral_f_row(r):
    df1, df2, nc = shape(r, 0.1, 1e5), shape(r, 0.1, 1e5), noncentrality(r, 1e4)
    stretch = (df1 + nc) / df1
    share, rest = beta_point(r, (df1 + nc) ** 2 / (df1 + 2 * nc) / 2, df2 / 2)
    x = short(share / rest * df2 / ((df1 + nc) ** 2 / (df1 + 2 * nc)) * stretch)
    if not 1e-290 < x < 1e290:
        return None
    cdf, slope = f.noncentral_f(D(x), D(df1), D(df2), D(nc))
    return noncentral_values([x, df1, df2, nc], cdf, slope, nc)


def noncentral_t_row(r):
    df, nc = shape(r, 0.5, 1e5), r.choice([-1, 1]) * noncentrality(r, 50)
    spread = math.sqrt(1 + nc * nc / (2 * df)) if df > 2 else abs(nc) + 1
    tail = min(2 * depth(r) / (df + 1), 600)
    x = short(nc + r.choice([-1, 1]) * spread * math.sqrt(df * math.expm1(tail)))
    if not 1e-290 < abs(x) < 1e140:
        return None
    cdf, slope = f.noncentral_t(D(x), D(df), D(nc))
    return noncentral_values([x, df, nc], cdf, slope, nc)


def noncentral_values(arguments, cdf, slope, nc):
    """The root for the non-centrality where an error of the probability, relatively, is not enlarged in it."""
    if not usable(cdf) or 1 - cdf < D("1e-40"):
        return None
    p, root = D(float(cdf)), None
    if p < 1 and cdf < abs(slope * D(nc)):
        # The step is 1e-16 of nc, so that its square does not count.
        root = D(nc) + (p - cdf) / slope
    return arguments, [cdf, root]


def lgamma_row(r):
    kind = r.random()
    if kind < 0.3:
        x = short(r.choice([1, 2]) + r.choice([-1, 1]) * log_between(r, 1e-12, 0.9), 12)
    elif kind < 0.6:
        x = short(r.uniform(0.01, 200))
    else:
        x = short(log_between(r, 1e-300, 1e300) if kind < 0.8 else log_between(r, 1e-3, 1e8))
    value = f.lgamma(D(x))
    return ([x], [value]) if x not in (1.0, 2.0) else None


# name of the table: arguments, values, rows, what makes a row. Some rows stay without a quantile.
FAMILIES = {
    "normal": ("x", "cdf quantile", 13000, normal_row),
    "lgamma": ("x", "value", 10000, lgamma_row),
    "t": ("x df", "cdf sig quantile", 13000, t_row),
    "gamma": ("x shape", "cdf sig quantile", 13000, gamma_row),
    "f": ("x df1 df2", "cdf sig quantile", 13000, f_row),
    "beta": ("x a b", "cdf sig quantile", 13000, beta_row),
    "binomial": ("k n p", "pdf cdf middle", 10000, binomial_row),
    "hypergeometric": ("k total successes draws", "cdf", 10000, hypergeometric_row),
    "noncentral_chi": ("x df nc", "cdf nc_root", 10000, noncentral_chi_row),
    "noncentral_f": ("x df1 df2 nc", "cdf nc_root", 10000, noncentral_f_row),
    "noncentral_t": ("x df nc", "cdf nc_root", 10000, noncentral_t_row),
}

# Tables that go on, with such rows alone, until this many have their last value: about half of the searches for a
# non-centrality are ill-determined.
COMPLETE = {"noncentral_chi": 10000, "noncentral_f": 10000, "noncentral_t": 10000}


def argument_text(x):
    return repr(float(x)).removesuffix(".0")


def value_text(value):
    if value is None:
        return ""
    if isinstance(value, float):
        return argument_text(value)
    with f.Digits(25):
        return str((+value).normalize()).lower().replace("e+", "e")


def write_table(folder, name, rows):
    arguments, values, wanted, make = FAMILIES[name]
    wanted, enough = rows or wanted, 0 if rows else COMPLETE.get(name, 0)
    r = random.Random(f"{name} 1")
    seen, complete, start = set(), 0, time.process_time()
    with open(os.path.join(folder, name + ".csv"), "w", newline="", encoding="ascii") as file:
        out = csv.writer(file, lineterminator="\n")
        out.writerow(arguments.split() + values.split())
        while len(seen) < wanted or complete < enough:
            row = make(r)
            if row is None or len(seen) >= wanted and row[1][-1] is None:
                continue
            cells = tuple(argument_text(x) for x in row[0])
            if cells in seen:
                continue
            seen.add(cells)
            complete += row[1][-1] is not None
            out.writerow(list(cells) + [value_text(v) for v in row[1]])
    print(f"{name}: {len(seen)} rows in {time.process_time() - start:.0f} s", flush=True)


def main():
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("--rows", type=int)
    parser.add_argument("--only", choices=FAMILIES)
    parser.add_argument("--folder", default=os.path.dirname(os.path.abspath(__file__)))
    options = parser.parse_args()
    for name in [options.only] if options.only else FAMILIES:
        write_table(options.folder, name, options.rows)


if __name__ == "__main__":
    main()
