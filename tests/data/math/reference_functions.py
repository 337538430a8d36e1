"""Distribution functions to as many digits as wanted: what make_reference.py makes its tables with.

Every sum has positive terms that fall from the first one on, or is cut where they do, so that nothing cancels
and any size of parameters takes a few ten thousand terms at most. Arguments are Decimals taken exactly; loops
run in the decimal module, whose C code is many times faster than mpmath's Python. Accuracy: the digits of the
context less 25. mpmath supplies erfc, pi and the Bernoulli numbers, and check_reference.py holds the results against it.
"""
import decimal
from decimal import Decimal as D
from functools import lru_cache

from mpmath import mp

DIGITS = 90
HALF = D("0.5")

decimal.setcontext(decimal.Context(prec=DIGITS, Emax=10**15, Emin=-10**15, rounding=decimal.ROUND_HALF_EVEN))


class Digits:
    """More digits for a while."""

    def __init__(self, digits):
        self.digits = digits

    def __enter__(self):
        context = decimal.getcontext()
        self.before = context.prec
        context.prec = self.digits

    def __exit__(self, *_):
        decimal.getcontext().prec = self.before


def precision():
    return decimal.getcontext().prec


def negligible():
    """Below this share of a sum a term does not count."""
    return D(10) ** -(precision() - 2)


def from_mp(value):
    return D(mp.nstr(value, mp.dps))


def to_mp(value):
    return mp.mpf(str(value))


@lru_cache(maxsize=None)
def _pi(digits):
    with mp.workdps(digits + 5):
        return D(mp.nstr(mp.pi, digits + 3))


def pi():
    return _pi(precision())


@lru_cache(maxsize=None)
def _stirling(digits):
    """The coefficients of Stirling's series."""
    coefficients = []
    for k in range(1, digits):
        numerator, denominator = mp.bernfrac(2 * k)
        coefficients.append(D(int(numerator)) / D(int(denominator) * 2 * k * (2 * k - 1)))
    return coefficients


def lgamma(z):
    """Stirling's series, after the recurrence has taken z to where it converges."""
    product = D(1)
    while z < 0.6 * precision():
        product *= z
        z += 1
    total = (z - HALF) * z.ln() - z + (2 * pi()).ln() / 2
    power, square, limit = 1 / z, z * z, negligible()
    for coefficient in _stirling(precision()):
        term = coefficient * power
        total += term
        if abs(term) < limit:
            return total - product.ln()
        power /= square
    raise ArithmeticError("Stirling's series has not converged")


def erfc(x):
    with mp.workdps(precision() + 10):
        return from_mp(mp.erfc(to_mp(x)))


def erf(x):
    with mp.workdps(precision() + 10):
        return from_mp(mp.erf(to_mp(x)))


def normal_tails(z):
    """P(Z <= z) and P(Z > z)."""
    root = D(2).sqrt()
    upper = erfc(abs(z) / root) / 2
    lower = erfc(-abs(z) / root) / 2
    return (upper, lower) if z < 0 else (lower, upper)


def normal_density(z):
    return (-z * z / 2).exp() / (2 * pi()).sqrt()


# --- The incomplete gamma function -------------------------------------------------------------------------------


def gamma_front(a, x):
    """x^a e^-x / Gamma(a + 1)."""
    return (a * x.ln() - x - lgamma(a + 1)).exp()


def rising_sum(x, a, b=None):
    """1 + x / (a+1) + x^2 / ((a+1)(a+2)) + ...; with b, each factor times (b+n)."""
    total, term, limit = D(1), D(1), negligible()
    n = a
    while True:
        n += 1
        term *= x / n
        if b is not None:
            term *= b
            b += 1
        total += term
        if term < limit * total and x * (b if b is not None else 1) < n:
            return total


def gamma_continued_fraction(a, x):
    """Q(a, x) Gamma(a) e^x x^-a for a <= 1 and x that is not small; Legendre's fraction from its end."""
    n = int((2.31 * precision()) ** 2 / (8 * float(x)) * 1.5) + 60
    value = D(0)
    for k in range(n, 0, -1):
        value = k * (k - a) / (x + 2 * k + 1 - a - value)
    return 1 / (x + 1 - a - value)


def gamma_tails(a, x):
    """P(a, x) and Q(a, x)."""
    front = gamma_front(a, x)
    if x <= a:
        lower = front * rising_sum(x, a)
        return lower, 1 - lower
    # Q(a, x) = front * a / x + Q(a - 1, x), down to an a in (0, 1].
    term, total, limit = front * a / x, D(0), negligible()
    while a > 1:
        total += term
        a -= 1
        term *= a / x
        if term < limit * total:
            return 1 - total, total
    front = term * x / a
    if x < 40:
        total += 1 - front * rising_sum(x, a)
    else:
        total += front * a * gamma_continued_fraction(a, x)
    return 1 - total, total


# --- The incomplete beta function --------------------------------------------------------------------------------


def beta_front(a, b, x, y):
    """x^a y^b / B(a, b)."""
    return (a * x.ln() + b * y.ln() - lgamma(a) - lgamma(b) + lgamma(a + b)).exp()


def beta_continued_fraction(a, b, x, y):
    """I_x(a, b) over front / a for b <= 1 and a * y that is not small; the common fraction from its end."""
    pairs = int((2.31 * precision()) ** 2 / (8 * float(a * y)) * 1.5) + 60
    value = D(1)
    for m in range(pairs, -1, -1):
        value = 1 - (a + m) * (a + b + m) * x / ((a + 2 * m) * (a + 2 * m + 1) * value)
        if m > 0:
            value = 1 + m * (b - m) * x / ((a + 2 * m - 1) * (a + 2 * m) * value)
    return 1 / value


def beta_lower(a, b, x, y):
    """I_x(a, b) for x up to the mean."""
    term, total, limit = beta_front(a, b, x, y) / (y * a), D(0), negligible()
    odds = x / y
    # I_x(a, b) = term + I_x(a + 1, b - 1), down to a b in (0, 1].
    while b > 1:
        total += term
        a += 1
        b -= 1
        term *= odds * b / a
        if term < limit * total:
            return total
    if b == 1:
        return total + term
    front = term * a * y
    if x <= D("0.9"):
        return total + front / a * rising_sum(x, a, a + b)
    if a * y < 40:
        return total + 1 - front / b * rising_sum(y, b, a + b)
    return total + front / a * beta_continued_fraction(a, b, x, y)


def beta_tails(a, b, x, y):
    """I_x(a, b) and its complement; y = 1 - x comes with all its digits."""
    if x * (a + b) <= a:
        lower = beta_lower(a, b, x, y)
        return lower, 1 - lower
    upper = beta_lower(b, a, y, x)
    return 1 - upper, upper


def f_tails(x, df1, df2):
    top = df1 * x
    return beta_tails(df1 / 2, df2 / 2, top / (top + df2), df2 / (top + df2))


def t_tails(x, df):
    square = x * x
    lower, upper = beta_tails(HALF, df / 2, square / (square + df), df / (square + df))
    near, far = (1 + lower) / 2, upper / 2
    return (far, near) if x < 0 else (near, far)


# --- Densities ---------------------------------------------------------------------------------------------------


def gamma_density(a, x):
    return gamma_front(a, x) * a / x


def beta_density(a, b, x, y):
    return beta_front(a, b, x, y) / (x * y)


def f_density(x, df1, df2):
    top = df1 * x
    return beta_front(df1 / 2, df2 / 2, top / (top + df2), df2 / (top + df2)) / x


def t_density(x, df):
    log = lgamma((df + 1) / 2) - lgamma(df / 2) - (df * pi()).ln() / 2 - (df + 1) / 2 * (1 + x * x / df).ln()
    return log.exp()


# --- Discrete distributions --------------------------------------------------------------------------------------


def log_choose(n, k):
    return lgamma(n + 1) - lgamma(k + 1) - lgamma(n - k + 1)


def binomial(k, n, p):
    """The point probability and P(X <= k)."""
    q = 1 - p
    point = (log_choose(n, k) + k * p.ln() + (n - k) * q.ln()).exp()
    if k == n:
        return point, D(1)
    return point, beta_tails(n - k, k + 1, q, p)[0]


def hypergeometric(k, total, successes, draws):
    """P(X <= k)."""
    failures = total - successes
    if k >= min(successes, draws):
        return D(1)
    down = k * total <= successes * draws
    if not down:
        k += 1
    term = (log_choose(successes, k) + log_choose(failures, draws - k) - log_choose(total, draws)).exp()
    limit, sum_ = negligible(), D(0)
    while term > limit * sum_:
        sum_ += term
        if down:
            term *= k * (failures - draws + k) / ((successes - k + 1) * (draws - k + 1))
            k -= 1
        else:
            term *= (successes - k) * (draws - k) / ((k + 1) * (failures - draws + k + 1))
            k += 1
    return sum_ if down else 1 - sum_


# --- Non-central distributions -----------------------------------------------------------------------------------


def mixture(weight, half_nc, shift, all_weights, step, ratio, tail):
    """The sum over j of w_j F_j, where w_{j+1} = w_j half_nc / (j + 1 + shift) and F_j - F_{j+1} = step_j.

    Summed by parts, so that every term is positive: the sum over k of step_k (w_0 + ... + w_k). Once all weights
    are in, what is left is their sum times tail(k) = F_k. Also gives the sum of step_k w_k.
    """
    weights, limit = weight, negligible()
    total, slope = step * weights, step * weight
    k = 0
    while True:
        step *= ratio(k)
        k += 1
        weight *= half_nc / (k + shift)
        weights += weight
        term = step * weights
        total += term
        slope += step * weight
        if term < limit * total and ratio(k) * half_nc < HALF * (k + 1):
            return total, slope
        if k > half_nc and weight < limit * weights:
            return total + all_weights * tail(k + 1), slope


def noncentral_chi(x, df, nc):
    """P(X <= x) and its derivative by nc."""
    a, y, half_nc = df / 2, x / 2, nc / 2
    total, slope = mixture((-half_nc).exp(), half_nc, D(0), D(1), gamma_front(a, y), lambda k: y / (a + k + 1),
                           lambda k: gamma_tails(a + k, y)[0])
    return total, -slope / 2


def beta_mixture(weight, half_nc, shift, all_weights, a, b, x, y):
    return mixture(weight, half_nc, shift, all_weights, beta_front(a, b, x, y) / a,
                   lambda k: x * (a + b + k) / (a + k + 1), lambda k: beta_tails(a + k, b, x, y)[0])


def noncentral_f(x, df1, df2, nc):
    """P(X <= x) and its derivative by nc."""
    top, half_nc = df1 * x, nc / 2
    total, slope = beta_mixture((-half_nc).exp(), half_nc, D(0), D(1), df1 / 2, df2 / 2, top / (top + df2),
                                df2 / (top + df2))
    return total, -slope / 2


def noncentral_t_right(x, df, nc):
    """P(0 < X <= x) at x >= 0, and the derivative of P(X <= x) by nc: half of two mixtures of central ones."""
    square, half_nc, size = x * x, nc * nc / 2, abs(nc)
    u, v = square / (square + df), df / (square + df)
    start = (-half_nc).exp()
    even, even_slope = beta_mixture(start, half_nc, D(0), D(1), HALF, df / 2, u, v)
    odd, odd_slope = beta_mixture(size * start * (2 / pi()).sqrt(), half_nc, HALF, erf(size / D(2).sqrt()), D(1),
                                  df / 2, u, v)
    # The weights' derivatives telescope; what is left over is that of P(X <= 0) and of the first odd weight.
    slope = -normal_density(nc) * (v.ln() * df / 2).exp() - (nc * even_slope + size * odd_slope) / 2
    return (even - odd if nc < 0 else even + odd) / 2, slope


def noncentral_t(x, df, nc):
    """P(X <= x) and its derivative by nc. At x < 0 the far tail is what cancellation leaves: it is taken with as
    many digits more."""
    below = normal_tails(nc)[1]
    if x >= 0:
        right, slope = noncentral_t_right(x, df, nc)
        return below + right, slope
    digits = precision()
    for more in (0, 60, 160, 340):
        with Digits(digits + more):
            # P(X <= x; nc) = P(-X >= -x; -nc).
            right, slope = noncentral_t_right(-x, df, -nc)
            value = normal_tails(nc)[1] - right
        if value > D(10) ** -(more + 25):
            break
    return +value, +slope
