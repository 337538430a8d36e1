"""Values of cases and documents: how they are read, written and compared.

A number is a float, with MISSING for the one that is missing. A text is a Text: its bytes and the length that is held
beside them. A date, a time of day or both is a Moment in seconds since 1970 (or since midnight), MISSING if undefined.
None is no value at all.
"""
import re
import sys
from typing import NamedTuple

MISSING = -sys.float_info.max
TOLERANCE = 2.22045e-14
DAY = 86400

NUMBER, TEXT, MOMENT = "number", "text", "moment"

# dataType of a date/time field: its number, and how a number of that type becomes seconds: (number + shift) * unit.
DATE_TYPES = {
    "date": (1, 0, 1), "time": (2, 0, 1), "dateTime": (3, 0, 1),
    "dateDaysSince[0]": (4, -719528, DAY), "dateDaysSince[1960]": (5, -3653, DAY),
    "dateDaysSince[1970]": (6, 0, DAY), "dateDaysSince[1980]": (7, 3652, DAY),
    "timeSeconds": (8, 0, 1),
    "dateTimeSecondsSince[0]": (9, -62167219200, 1), "dateTimeSecondsSince[1960]": (10, -315619200, 1),
    "dateTimeSecondsSince[1970]": (11, 0, 1), "dateTimeSecondsSince[1980]": (12, 315532800, 1),
}
DATES = ("date", "dateDaysSince[0]", "dateDaysSince[1960]", "dateDaysSince[1970]", "dateDaysSince[1980]")
TIMES = ("time", "timeSeconds")


class Text(NamedTuple):
    data: bytes
    length: int


class Moment(NamedTuple):
    seconds: float
    data_type: str


EMPTY = Text(b"", 0)


def text_of(data):
    """A text whose length is its own."""
    data = data.encode() if isinstance(data, str) else data
    return Text(data, len(data))


def kind_of_value(value):
    return TEXT if isinstance(value, Text) else MOMENT if isinstance(value, Moment) else NUMBER


def kind_of_type(data_type):
    return TEXT if data_type == "string" else MOMENT if data_type in DATE_TYPES else NUMBER


def nothing(kind, data_type="dateTime"):
    """The missing value of a kind."""
    return EMPTY if kind == TEXT else Moment(MISSING, data_type) if kind == MOMENT else MISSING


def is_system_missing(value):
    """A text never is."""
    return value == MISSING or isinstance(value, Moment) and value.seconds == MISSING


# --- Reading and writing ------------------------------------------------------------------------------------------

NUMBER_AT_START = re.compile(r"[ \t\n\v\f\r]*([+-]?(?:[0-9]+\.?[0-9]*|\.[0-9]+)(?:[eE][+-]?[0-9]+)?)")
INFINITY_AT_START = re.compile(r"[ \t\n\v\f\r]*\+?inf", re.IGNORECASE)


def number_at_start(text):
    """The number that a text starts with, however large, or None. A letter of an exponent has to have digits."""
    match = NUMBER_AT_START.match(text)
    if match is None:
        return None
    rest = text[match.end():]
    if rest[:1] in ("e", "E") and "e" not in match.group(1).lower():
        return None
    return float(match.group(1))


def number_from_text(text):
    """As values are read: missing when there is no number, infinite when it is too large or named so."""
    number = number_at_start(text)
    if number is None:
        return float("inf") if INFINITY_AT_START.match(text) else MISSING
    return MISSING if number == float("-inf") else number


def number_of_text(data):
    """What a text that is asked for its number gives: 0 when it starts with none."""
    number = number_at_start(data.decode("utf-8", "replace"))
    if number is None:
        return 0.0
    return max(-sys.float_info.max, min(sys.float_info.max, number))


def number_that_is(data):
    """What a text reads as when all of it is a number, blanks around it aside; else missing."""
    text = data.decode("utf-8", "replace").strip(" ")
    match = NUMBER_AT_START.fullmatch(text)
    return number_from_text(text) if match and text[:1] > " " else MISSING


def text_of_number(number):
    return "Undefined" if number <= MISSING else "%g" % number


def is_leap(year):
    return year % 4 == 0 and (year % 100 != 0 or year % 400 == 0)


def days_in_month(year, month):
    return [31, 29 if is_leap(year) else 28, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31][month - 1]


def days_before_year(year):
    """From 1 January of the year 1 on."""
    past = year - 1
    return 365 * past + past // 4 - past // 100 + past // 400


def days_of_date(year, month, day):
    """Days since 1 January 1970."""
    days = days_before_year(year) - days_before_year(1970)
    return days + sum(days_in_month(year, m) for m in range(1, month)) + day - 1


def date_of_days(days):
    """Year, month and day, by walking from a near year."""
    year = 1970 + days * 400 // 146097
    while days_of_date(year + 1, 1, 1) <= days:
        year += 1
    while days_of_date(year, 1, 1) > days:
        year -= 1
    rest, month = days - days_of_date(year, 1, 1), 1
    while rest >= days_in_month(year, month):
        rest -= days_in_month(year, month)
        month += 1
    return year, month, rest + 1


def three_numbers(text, separator):
    pieces = text.replace(" ", "").split(separator)
    return [int(piece) for piece in pieces] if len(pieces) == 3 and all(p.isdigit() for p in pieces) else None


def seconds_of_date(text):
    parts = three_numbers(text, "-")
    if parts is None or not 1 <= parts[1] <= 12 or not 1 <= parts[2] <= days_in_month(parts[0], parts[1]):
        return None
    return days_of_date(*parts) * DAY


def seconds_of_time(text):
    parts = three_numbers(text, ":")
    if parts is None or parts[0] > 23 or parts[1] > 59 or parts[2] > 59:
        return None
    return (parts[0] * 60 + parts[1]) * 60 + parts[2]


def moment_from_number(number, data_type):
    if number == MISSING:
        return Moment(MISSING, data_type)
    _, shift, unit = DATE_TYPES[data_type]
    return Moment((number + shift) * float(unit), data_type)


def moment_from_text(text, data_type):
    if data_type == "date":
        seconds = seconds_of_date(text)
    elif data_type == "time":
        seconds = seconds_of_time(text)
    elif data_type == "dateTime":
        date, found, time = text.partition("T")
        day, clock = seconds_of_date(date), seconds_of_time(time)
        seconds = day + clock if found and day is not None and clock is not None else None
    else:
        return moment_from_number(number_from_text(text), data_type)
    return Moment(MISSING if seconds is None else float(seconds), data_type)


def text_of_moment(moment):
    """As dates and times are written; the seconds' fraction is cut off downwards."""
    if moment.seconds == MISSING:
        return "Undefined"
    days, time = divmod(int(moment.seconds // 1), DAY)
    year, month, day = date_of_days(days)
    date = "%s%04d-%02d-%02d" % ("-" if year < 0 else "", abs(year), month, day)
    clock = "%02d:%02d:%02d" % (time // 3600, time // 60 % 60, time % 60)
    return date if moment.data_type in DATES else clock if moment.data_type in TIMES else date + "T" + clock


def value_from_text(text, data_type):
    kind = kind_of_type(data_type)
    if kind == TEXT:
        return text_of(text)
    return number_from_text(text) if kind == NUMBER else moment_from_text(text, data_type)


def listed_value(text, data_type):
    """As expressions list values: in a date/time field these may be numbers in its unit, too."""
    value = value_from_text(text, data_type)
    if kind_of_type(data_type) == MOMENT and is_system_missing(value):
        return moment_from_number(number_from_text(text), data_type)
    return value


# --- Comparing ----------------------------------------------------------------------------------------------------


def numbers_equal(a, b):
    if a == 0.0 and b == 0.0:
        return True
    if a == MISSING or b == MISSING:
        return a == b
    return abs(a - b) < max(abs(a), abs(b)) * TOLERANCE


def values_equal(a, b):
    """By the rule of their kind; values of different kinds are not equal."""
    kind = kind_of_value(a)
    if kind != kind_of_value(b):
        return False
    if kind == TEXT:
        return a.data.rstrip(b" ") == b.data.rstrip(b" ")
    return numbers_equal(a, b) if kind == NUMBER else numbers_equal(a.seconds, b.seconds)


class Interval:
    """Values between two numbers. One whose ends are equal holds just that number, whatever the closure."""

    def __init__(self, low, high, low_included, high_included):
        self.low, self.high = low, high
        self.low_included, self.high_included = low_included, high_included

    def holds(self, x):
        if numbers_equal(self.low, self.high):
            return numbers_equal(x, self.low)
        if x == MISSING:
            return False
        if (self.low_included and numbers_equal(x, self.low)) or (self.high_included and numbers_equal(x, self.high)):
            return True
        return self.low < x < self.high

    def holds_value(self, value):
        """As a missing range is asked: intervals hold numbers alone."""
        return kind_of_value(value) == NUMBER and self.holds(value)


class OneValue:
    def __init__(self, value):
        self.value = value

    def holds_value(self, value):
        return values_equal(value, self.value)
