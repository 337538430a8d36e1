"""The built-in functions of Apply expressions that take numbers to a number or a text to a text.

`rough` (a Rounding) is applied to what another implementation may round otherwise; see there.
"""
import math
import statistics

from values import EMPTY, MISSING, Text

LOG_OF_LARGEST = 709.0


class Rounding:
    """Makes results wrong by a few units in their last place, upwards, downwards or at random. Whoever makes cases for
    a comparison computes them with several of these and leaves out those where it matters."""

    def __init__(self, error=0.0, rng=None):
        self.error, self.rng = error, rng

    def __call__(self, x, steps=1.0):
        if self.error == 0.0 or x == MISSING:
            return x
        return x * (1.0 + self.error * steps * (self.rng.choice((-1, 1)) if self.rng else 1))


def none_missing(*numbers):
    return all(x != MISSING for x in numbers)


def present(numbers):
    return [x for x in numbers if x != MISSING]


# --- One or two numbers -------------------------------------------------------------------------------------------


def power(x, y, rough):
    y = y if y == MISSING or not math.isfinite(y) else float(int(y))
    if not none_missing(x, y):
        return MISSING
    exponent, result, base = abs(int(y)), 1.0, x
    while exponent:
        if exponent & 1:
            result *= base
        base *= base
        exponent >>= 1
    if y >= 0:
        return rough(result, 1 + abs(y))
    return MISSING if result == 0.0 else rough(1.0 / result, 1 + abs(y))


def modulo(x, y):
    if y == 0.0 or not none_missing(x, y):
        return MISSING
    quotient = x / y
    if not -2147483648.0 < quotient < 2147483647.0:
        return MISSING
    return x - math.trunc(quotient) * y


def exponential(x, rough):
    if x == MISSING or x > LOG_OF_LARGEST:
        return MISSING
    return 0.0 if x <= -708.0 else rough(math.exp(x), 1 + abs(x))


def rounded(x):
    if not -2147483648.0 < x < 2147483647.0:
        return MISSING
    t = float(math.trunc(x))
    if x > 0.0:
        return t + 1.0 if abs(x) - abs(t) >= 0.5 else t
    return t - 1.0 if x < 0.0 and abs(x) - abs(t) >= 0.5 else t


def truncated(x):
    return float(math.trunc(x)) if -2147483648.0 < x < 2147483647.0 else MISSING


def normal_probability(z, rough):
    """P(Z <= z); in the lower tail by the complement, where nothing cancels, down to the guard of exponentials."""
    if z == 0.0:
        return 0.5
    root = math.sqrt(2.0)
    if z > 0.0:
        return rough((math.erf(z / root) + 1.0) / 2.0)
    complement = rough(math.erfc(-z / root), 1.0 + z * z)
    return complement / 2.0 if complement >= math.exp(-708.0) else 0.0


def whole(x, cut):
    return MISSING if x == MISSING else float(cut(x))


# Name: number of arguments and the function of (rounding, arguments...).
SCALARS = {
    "+": (2, lambda rough, x, y: x + y if none_missing(x, y) else MISSING),
    "pow": (2, lambda rough, x, y: power(x, y, rough)),
    "abs": (1, lambda rough, x: x if x == MISSING else abs(x)),
    "exp": (1, lambda rough, x: exponential(x, rough)),
    "log10": (1, lambda rough, x: rough(math.log10(x)) if x > 0.0 else MISSING),
    "ln": (1, lambda rough, x: rough(math.log(x)) if x > 0.0 else MISSING),
    "mod": (2, lambda rough, x, y: modulo(x, y)),
    "round": (1, lambda rough, x: rounded(x)),
    "sqrt": (1, lambda rough, x: math.sqrt(x) if x >= 0.0 else MISSING),
    "trunc": (1, lambda rough, x: truncated(x)),
    "cdfnorm": (1, lambda rough, x: MISSING if x == MISSING else normal_probability(x, rough)),
    "threshold": (2, lambda rough, x, y: 1.0 if x > y else 0.0),
    "floor": (1, lambda rough, x: whole(x, math.floor)),
    "ceil": (1, lambda rough, x: whole(x, math.ceil)),
}
SCALARS["lg10"] = SCALARS["log10"]


# --- Lists of numbers ---------------------------------------------------------------------------------------------


def two(operation):
    """Of exactly two numbers, neither of them missing."""
    return lambda rough, v: operation(*v) if len(v) == 2 and none_missing(*v) else MISSING


def quotient(rough, v):
    if len(v) != 2 or v[1] == 0.0 or not none_missing(*v):
        return MISSING
    return v[0] / v[1]


def of_present(operation):
    """Of those numbers that are not missing; missing when all are."""
    return lambda rough, v: operation(rough, present(v)) if present(v) else MISSING


def total(rough, v):
    result = 0.0
    for x in v:
        result += x
    return result


def mean(rough, v):
    """A sum that is too large does not make it missing."""
    result = total(rough, v) / len(v)
    return result if math.isfinite(result) else rough(total(rough, [x / len(v) for x in v]), len(v))


def product(rough, v):
    result = 1.0
    for x in v:
        result *= x
    return result


def median(rough, v):
    v = sorted(v)
    middle = len(v) // 2
    return v[middle] if len(v) % 2 else mean(rough, v[middle - 1:middle + 1])


def deviation(rough, v):
    v = present(v)
    if len(v) <= 1:
        return MISSING
    centre = mean(rough, v)
    scale, squares = 0.0, 1.0
    for d in (abs(x - centre) for x in v):
        if d == 0.0:
            continue
        if d > scale:
            squares, scale = 1.0 + squares * (scale / d) ** 2, d
        else:
            squares += (d / scale) ** 2
    return rough(scale * math.sqrt(squares / (len(v) - 1)), 10.0 + 10.0 * abs(centre) / scale if scale else 1.0)


def variance(rough, v):
    sd = deviation(rough, v)
    return MISSING if sd == MISSING else sd * sd


def normal(operation):
    """Of (x, mean, standard deviation)."""
    return lambda rough, v: operation(rough, *v) if len(v) == 3 and none_missing(*v) and v[2] > 0.0 else MISSING


def quantile(rough, p, mean, sd):
    if not 0.0 < p < 1.0:
        return MISSING
    if p == 0.5:
        return mean
    return rough(statistics.NormalDist().inv_cdf(p), 10.0) * sd + mean


def density(rough, x, mean, sd):
    z = (x - mean) / sd
    return (0.0 if abs(z) > 37.61 else rough(math.exp(-0.5 * z * z) / math.sqrt(6.283185307179586), 1 + z * z)) / sd


def compared(operation):
    """Of exactly two numbers, the missing one being the number that it is."""
    return lambda rough, v: 1.0 if len(v) == 2 and operation(*v) else 0.0


LISTS = {
    "-": two(lambda a, b: a - b),
    "*": two(lambda a, b: a * b),
    "/": quotient,
    "sum": of_present(total),
    "mean": of_present(mean),
    "min": of_present(lambda rough, v: min(v)),
    "max": of_present(lambda rough, v: max(v)),
    "product": of_present(product),
    "median": of_present(median),
    "sd": deviation,
    "variance": variance,
    "cdf.normal": normal(lambda rough, x, mean, sd: normal_probability((x - mean) / sd, rough)),
    "idf.normal": normal(quantile),
    "pdf.normal": normal(density),
    "lessThan": compared(lambda a, b: a < b),
    "lessOrEqual": compared(lambda a, b: a <= b),
    "greaterThan": compared(lambda a, b: a > b),
    "greaterOrEqual": compared(lambda a, b: a >= b),
    "and": lambda rough, v: 1.0 if v and all(x != 0.0 for x in v) else 0.0,
    "or": lambda rough, v: 1.0 if any(x != 0.0 for x in v) else 0.0,
    "not": lambda rough, v: 1.0 if len(v) == 1 and v[0] == 0.0 else 0.0,
}
LISTS["avg"] = LISTS["mean"]


def finite(function, *arguments):
    """What is no number, infinite or beyond the largest one is missing."""
    try:
        result = function(*arguments)
    except OverflowError:
        return MISSING
    return result if math.isfinite(result) else MISSING


# --- Texts --------------------------------------------------------------------------------------------------------


def substring(text, start):
    if not text.data:
        return EMPTY
    start = int(start) if abs(start) < 1e9 else 0
    if 1 <= start < len(text.data):
        return Text(text.data[start - 1:], start)
    return Text(b"", max(text.length, 0))


def cased(table):
    return lambda text: Text(table(text.data), text.length)


def trimmed(strip):
    def function(text):
        data = strip(text.data)
        return Text(data, max(text.length, 0) - (len(text.data) - len(data)))
    return function


def concatenation(texts):
    return Text(b"".join(t.data for t in texts), sum(t.length for t in texts)) if texts else EMPTY


# Python's bytes change the case of ASCII letters alone.
TEXTS = {
    "lower": cased(bytes.lower),
    "lowercase": cased(bytes.lower),
    "uppercase": cased(bytes.upper),
    "ltrim": trimmed(lambda data: data.lstrip(b" \t")),
    "rtrim": trimmed(lambda data: data.rstrip(b" \t")),
    "trimend": trimmed(lambda data: data.rstrip(b" \t")),
}
