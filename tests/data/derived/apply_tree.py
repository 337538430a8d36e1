"""Apply expressions: trees whose nodes are functions, fields and constants.

What a node is - a number, a text or a date/time - is known before any case: a field's by its variable, a constant's by
its dataType, a function's by its result. Where another kind is needed, a text counts as the missing number, a number as
the empty text, a date/time as the number of its seconds. What "if" chooses is asked for the kind that is needed of the
"if", whatever the other argument is; where none is needed, the value is that of the chosen argument as it is. An absent
argument is the missing value of the second one's kind.

"mapMissingTo" stands for a number that is missing, also where "if" or the imputation has something else to give and a
number is needed of it.
"""
import math

import functions
from fields import children, local_name
from functions import finite
from values import (EMPTY, MISSING, MOMENT, NUMBER, TEXT, Moment, Text, date_of_days, is_system_missing, kind_of_type,
                    kind_of_value, listed_value, nothing, number_from_text, number_that_is, numbers_equal, text_of,
                    value_from_text, values_equal)

DIFFERENCES = {
    "date_years_difference": (86400.0, 365.25), "date_months_difference": (86400.0, 30.4375),
    "date_days_difference": (86400.0, 1.0), "time_hours_difference": (3600.0, 1.0),
    "time_minutes_difference": (60.0, 1.0), "time_seconds_difference": (1.0, 1.0),
}
IMPUTATION = "imputeCatFieldMissingAgainstConTarget"
PARTS = ("year-from-date", "month-from-date", "day-from-date", "hour-from-time", "minute-from-time", "second-from-time")


def as_number(value):
    return MISSING if isinstance(value, Text) else value.seconds if isinstance(value, Moment) else value


def as_text(value):
    return value if isinstance(value, Text) else EMPTY


def as_moment(value):
    return value if isinstance(value, Moment) else Moment(MISSING, "dateTime")


AS_KIND = {NUMBER: as_number, TEXT: as_text, MOMENT: as_moment}


def part_of_moment(seconds, name):
    """Days are cut toward zero, the time of day counts upwards."""
    whole = int(seconds)
    if name in PARTS[:3]:
        days = abs(whole) // 86400
        return float(date_of_days(days if whole >= 0 else -days)[PARTS.index(name)])
    time = whole % 86400
    return float((time // 3600, time // 60 % 60, time % 60)[PARTS.index(name) - 3])


class Leaf:
    def value_as(self, case, kind):
        return AS_KIND[kind](self.value(case))


class FieldNode(Leaf):
    def __init__(self, element, document):
        self.field = document.field(element.get("field"))
        self.kind = self.field.kind
        text = element.get("mapMissingTo")
        self.replacement = None if text is None else listed_value(text, self.field.data_type)

    def is_missing(self, case):
        """Before any replacement."""
        return self.field.is_missing(case.value(self.field))

    def value(self, case):
        value = case.value(self.field)
        if self.replacement is not None and self.field.is_missing(value):
            return self.replacement
        return nothing(self.kind) if value is None else value


class ConstantNode(Leaf):
    def __init__(self, element, _):
        data_type = element.get("dataType", "double")
        self.constant = value_from_text(element.text or "", data_type)
        self.kind = kind_of_type(data_type)

    def value(self, _):
        return self.constant


class FunctionNode:
    def __init__(self, element, document):
        self.name = element.get("function")
        self.arguments = [NODES[local_name(child)](child, document) for child in children(element, *NODES)]
        self.arrays = [array_values(child) for child in children(element, "Array")]
        if self.name in ("isIn", "isNotIn") and not self.arrays:
            self.take_listed_constants()
        self.document = document
        self.kind = self.result_kind()
        text = element.get("mapMissingTo")
        self.replacement = None if text is None else number_from_text(text)

    def take_listed_constants(self):
        """The list may stand as constants behind the value, too."""
        values = [constant.value(None) for constant in self.arguments[1:]]
        self.arguments, self.arrays = self.arguments[:1], [values]

    def result_kind(self):
        if self.name in functions.TEXTS or self.name in ("concat", "substr"):
            return TEXT
        decider = {"if": 1, IMPUTATION: 0}.get(self.name)
        return NUMBER if decider is None else self.arguments[decider].kind

    def value(self, case):
        if self.name != "if":
            return self.value_as(case, self.kind)
        chosen = self.choice(case, *self.arguments)
        value = chosen.value(case) if chosen else nothing(self.kind)
        return self.number_or_replacement(value) if kind_of_value(value) == NUMBER else value

    def value_as(self, case, kind):
        if self.name == "if":
            chosen = self.choice(case, *self.arguments)
            value = chosen.value_as(case, kind) if chosen else nothing(kind)
        elif self.name == IMPUTATION:
            value = AS_KIND[kind](self.compute(case))
        else:
            value = AS_KIND[self.kind](self.compute(case))
            return AS_KIND[kind](value if self.kind != NUMBER else self.number_or_replacement(value))
        return value if kind != NUMBER else self.number_or_replacement(value)

    def number_or_replacement(self, number):
        number = finite(lambda: number)
        return self.replacement if number == MISSING and self.replacement is not None else number

    def numbers(self, case):
        return [argument.value_as(case, NUMBER) for argument in self.arguments]

    def compute(self, case):
        name = self.name
        if name in functions.SCALARS:
            count, function = functions.SCALARS[name]
            numbers = self.numbers(case)
            return finite(function, case.rough, *numbers[:count])
        if name in functions.LISTS:
            return finite(functions.LISTS[name], case.rough, self.numbers(case))
        if name in functions.TEXTS:
            return functions.TEXTS[name](self.arguments[0].value_as(case, TEXT))
        return self.SPECIAL[name](self, case, *self.arguments)

    # --- Functions by themselves. The arguments are nodes.

    def concat(self, case, *arguments):
        return functions.concatenation([argument.value_as(case, TEXT) for argument in arguments])

    def substr(self, case, text, start):
        return functions.substring(text.value_as(case, TEXT), start.value_as(case, NUMBER))

    def length(self, case, text):
        text = text.value_as(case, TEXT)
        return float(text.length or len(text.data))

    def sysmis(self, case, argument):
        return 1.0 if is_system_missing(argument.value(case)) else 0.0

    def number(self, case, argument):
        value = argument.value(case)
        return number_that_is(value.data) if isinstance(value, Text) else value

    def difference(self, case, first, second):
        seconds, other = first.value_as(case, MOMENT).seconds, second.value_as(case, NUMBER)
        if MISSING in (seconds, other):
            return MISSING
        first_unit, second_unit = DIFFERENCES[self.name]
        return (seconds - other) / first_unit / second_unit

    def part(self, case, argument):
        seconds = argument.value_as(case, MOMENT).seconds
        return MISSING if seconds == MISSING else part_of_moment(seconds, self.name)

    def outlier_handle(self, case, value, method, centre, a, b, n):
        x, c, a, b, n = (node.value_as(case, NUMBER) for node in (value, centre, a, b, n))
        if MISSING in (x, c, a, b, n):
            return MISSING
        width = a * b / math.sqrt(n)
        low, high = c - width, c + width
        takes_bounds = method.value_as(case, TEXT).data == b"asExtremeValues"
        if x < low:
            return low if takes_bounds else MISSING
        if x > high:
            return high if takes_bounds else MISSING
        return x

    def is_missing(self, case, argument):
        return 1.0 if argument.is_missing(case) else 0.0

    def is_not_missing(self, case, argument):
        return 0.0 if argument.is_missing(case) else 1.0

    def equal(self, case, first, second):
        return 1.0 if values_equal(first.value(case), second.value(case)) else 0.0

    def not_equal(self, case, first, second):
        return 1.0 - self.equal(case, first, second)

    def is_in(self, case, argument):
        value = argument.value(case)
        return 1.0 if any(values_equal(value, listed) for listed in self.arrays[0]) else 0.0

    def is_not_in(self, case, argument):
        return 1.0 - self.is_in(case, argument)

    def choice(self, case, condition, second, third=None):
        """The chosen argument, None when it is absent."""
        return second if numbers_equal(condition.value_as(case, NUMBER), 1.0) else third

    def impute(self, case, category, number):
        # A host that has no text for a record's slot leaves it empty.
        given = category.value(case)
        if not category.is_missing(case) and given != EMPTY:
            return given
        t = number.value_as(case, NUMBER)
        if t == MISSING:
            return nothing(self.kind)
        means, variances = self.arrays
        distances = [abs(t - m) / math.sqrt(v) for m, v in zip(means, variances)]
        return category.field.labels[distances.index(min(distances))]

    SPECIAL = {
        "concat": concat, "substr": substr, "length": length, "sysmis": sysmis, "value": number,
        "recast_to_ordinal": number, "recast_to_scale": number, "outlierHandle": outlier_handle,
        "isMissing": is_missing, "isNotMissing": is_not_missing, "equal": equal, "notEqual": not_equal,
        "isIn": is_in, "isNotIn": is_not_in, IMPUTATION: impute,
        **dict.fromkeys(DIFFERENCES, difference), **dict.fromkeys(PARTS, part),
    }


class ApplyTree(FunctionNode):
    """The whole of an Apply expression."""


NODES = {"Apply": FunctionNode, "FieldRef": FieldNode, "Constant": ConstantNode}


def array_values(element):
    """The values of an Array: texts may stand in quotes, numbers are separated by blanks."""
    text = element.text or ""
    if element.get("type") != "string":
        return [float(piece) for piece in text.split()]
    values, at = [], 0
    while at < len(text):
        if text[at].isspace():
            at += 1
        elif text[at] == '"':
            piece, at = quoted(text, at + 1)
            values.append(text_of(piece))
        else:
            end = at
            while end < len(text) and not text[end].isspace():
                end += 1
            values.append(text_of(text[at:end]))
            at = end
    return values


def quoted(text, at):
    """A text up to the closing quote, and the place behind it. A backslash keeps the next character from closing."""
    piece = ""
    while text[at] != '"':
        if text[at] == "\\":
            at += 1
        piece += text[at]
        at += 1
    return piece, at + 1
