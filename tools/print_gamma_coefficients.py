#!/usr/bin/env python3
"""Prints kestrel/math/GammaCoefficients.h: approximations around the gamma function, fitted with mpmath (50 digits).

Each is interpolated at Chebyshev points, which is close to the best approximation; its error, measured on a grid, is
printed beside it. Needs mpmath. Write with: python3 tools/print_gamma_coefficients.py > kestrel/math/GammaCoefficients.h
"""
from mpmath import (atanh, bernoulli, cos, fabs, gamma, log, loggamma, lu_solve, matrix, mp, mpf, nstr, pi,
                    polyval, sqrt)

mp.dps = 50

HEAD = """// Approximations around the gamma function, lowest power first; the errors are those of exact arithmetic.
// Printed by tools/print_gamma_coefficients.py: change it there.

#ifndef KESTREL_MATH_GAMMACOEFFICIENTS_H
#define KESTREL_MATH_GAMMACOEFFICIENTS_H

namespace MCMath_800 {
"""


def nodes(low, high, count):
    return [(low + high) / 2 + (high - low) / 2 * cos(pi * (2 * i + 1) / (2 * count)) for i in range(count)]


def fit(function, low, high, above, below=0):
    """Coefficients of numerator and denominator (1 first) of degrees above and below, and their largest error."""
    points = nodes(mpf(low), mpf(high), above + below + 1)
    rows, right = matrix(len(points), len(points)), matrix(len(points), 1)
    for i, x in enumerate(points):
        f = function(x)
        for j in range(above + 1):
            rows[i, j] = x**j
        for j in range(below):
            rows[i, above + 1 + j] = -f * x ** (j + 1)
        right[i] = f
    solved = list(lu_solve(rows, right))
    top, bottom = solved[: above + 1], [mpf(1)] + solved[above + 1 :]
    worst = 0
    for i in range(1, 200):
        x = mpf(low) + (mpf(high) - mpf(low)) * i / 200
        worst = max(worst, fabs(polyval(top[::-1], x) / polyval(bottom[::-1], x) / function(x) - 1))
    return top, bottom, worst


def show(name, coefficients):
    print(f"// clang-format off\nconstexpr double {name}[] = {{")
    for c in coefficients:
        print(f"    {nstr(c, 17)},")
    print("};\n// clang-format on")


def show_fit(name, what, function, low, high, above, below=0):
    top, bottom, worst = fit(function, low, high, above, below)
    print(f"\n// {what}: relative error {nstr(worst, 2)}.")
    show(name, top)
    if below:
        show(name + "Divisor", bottom)


def log_series(s):
    """(atanh(r) - r) / r^3 for s = r^2."""
    r = sqrt(s)
    return (atanh(r) - r) / r**3


def stirling_error(a):
    return loggamma(a) - ((a - mpf(1) / 2) * log(a) - a + log(2 * pi) / 2)


def log_gamma_low(y):
    return loggamma(1 + y) / (y * (y - 1))


def log_gamma_high(z):
    return loggamma(2 + z) / (z * (1 + z))


def stirling_numbers(count):
    """g_k of Gamma*(a) ~ sum g_k / a^k, the exponential of Stirling's series."""
    logarithm = [mpf(0)] * (count + 1)
    for k in range(1, count // 2 + 2):
        if 2 * k - 1 <= count:
            logarithm[2 * k - 1] = bernoulli(2 * k) / (2 * k * (2 * k - 1))
    g = [mpf(1)]
    for n in range(1, count + 1):
        g.append(sum(j * logarithm[j] * g[n - j] for j in range(1, n + 1)) / n)
    return g


def temme(rows, length):
    """The power series of Temme's functions C_k(eta): N. M. Temme, SIAM J. Math. Anal. 10 (1979) 757-766."""
    # mu * mu' = eta * (1 + mu) for mu = lambda - 1 as a series in eta.
    mu = [mpf(0), mpf(1), mpf(1) / 3]
    for n in range(3, length + 3):
        cross = sum(mu[i] * (n + 1 - i) * mu[n + 1 - i] for i in range(2, n))
        mu.append((mu[n - 1] - cross) / (n + 1))
    # 1 / mu = 1 / eta + C_0(eta)
    inverse = [mpf(1)]
    for n in range(1, length + 2):
        inverse.append(-sum(mu[j + 1] * inverse[n - j] for j in range(1, n + 1)))
    first = inverse[1:]
    g = stirling_numbers(rows)
    table, previous = [first], first
    for k in range(1, rows):
        previous = [(-1) ** k * g[k] * first[n] + (n + 2) * previous[n + 2] for n in range(len(previous) - 2)]
        table.append(previous)
    return table


def show_temme():
    reach = mpf(TEMME_REACH)
    series = temme(len(TEMME_DEGREES), 110)
    print(f"\n// C_k(eta) of Temme's uniform expansion, |eta| <= {TEMME_REACH}; in brackets the absolute errors.")
    for k, degree in enumerate(TEMME_DEGREES):
        def value(eta):
            return polyval(series[k][:70][::-1], eta)
        points = nodes(-reach, reach, degree + 1)
        rows = matrix(degree + 1, degree + 1)
        for i, x in enumerate(points):
            for j in range(degree + 1):
                rows[i, j] = x**j
        solved = list(lu_solve(rows, matrix([value(x) for x in points])))
        worst = max(fabs(polyval(solved[::-1], reach * i / 100) - value(reach * i / 100)) for i in range(-100, 101))
        print(f"// k = {k} ({nstr(worst, 2)})")
        show(f"kTemme{k}", solved)


TEMME_REACH = "0.8"
# For a >= 20: C_k counts with a^-k.
TEMME_DEGREES = [18, 15, 14, 12, 10, 9, 8, 6, 5, 3]


def main():
    print(HEAD, end="")
    show_fit("kLogSeries", "(atanh(r) - r) / r^3 in r^2 <= 1/9", log_series, mpf(10) ** -30, mpf(1) / 9, 10)
    show_fit("kLogGamma1", "ln Gamma(1 + y) / (y (y - 1)), 0 <= y <= 1", log_gamma_low, 0, 1, 6, 6)
    show_fit("kLogGamma2", "ln Gamma(2 + z) / (z (1 + z)), 0 <= z <= 1", log_gamma_high, 0, 1, 6, 5)
    show_fit("kStirlingNear", "12 a StirlingError(a) in 1/a, 1 <= a <= 3", lambda v: 12 / v * stirling_error(1 / v), mpf(1) / 3, 1, 7, 6)
    show_fit("kStirlingFar", "12 a StirlingError(a) in 1/a, 3 <= a <= 10", lambda v: 12 / v * stirling_error(1 / v), mpf(1) / 10, mpf(1) / 3, 6, 6)
    show_fit("kReciprocalGamma", "1 / Gamma(1 + a), 0 <= a <= 1", lambda a: 1 / gamma(1 + a), 0, 1, 16)
    print("\n// Stirling's series, B_2k / (2k (2k - 1)), in 1/a^2 after 1/a.")
    show("kStirlingSeries", [bernoulli(2 * k) / (2 * k * (2 * k - 1)) for k in range(1, 10)])
    print("\n// StirlingError of the counts from 0 on, where that of 0 is 0.")
    show("kStirlingOfCount", [mpf(0)] + [stirling_error(mpf(m)) for m in range(1, 16)])
    show_temme()
    print(f"\nconstexpr double kTemmeReach = {TEMME_REACH};\n\n}}  // namespace MCMath_800\n\n#endif  // KESTREL_MATH_GAMMACOEFFICIENTS_H")


if __name__ == "__main__":
    main()
