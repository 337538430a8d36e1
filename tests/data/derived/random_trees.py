"""Random Apply expressions for make_documents.py."""
from xml.sax.saxutils import escape, quoteattr

from functions import LISTS, SCALARS, TEXTS
from random_fields import NO_MOMENTS, NUMBERS, random_literal, written_number
from values import DATE_TYPES, MOMENT, NUMBER, TEXT

# Readers hold the arguments of these against a list: functions that give numbers, or texts, and those alone.
STRICT_LISTS = ["max", "mean", "avg", "min", "sd", "sum", "variance", "median", "product"]
NUMBER_FUNCTIONS = STRICT_LISTS + [
    "+", "-", "*", "/", "pow", "abs", "exp", "log10", "lg10", "ln", "mod", "round", "sqrt", "trunc", "cdf.normal",
    "cdfnorm",
    "idf.normal", "pdf.normal", "sysmis", "if", "length"]
TEXT_FUNCTIONS = ["concat", "lower", "lowercase", "ltrim", "rtrim", "trimend", "uppercase"]
DIFFERENCES = ["date_years_difference", "date_months_difference", "date_days_difference", "time_hours_difference",
               "time_minutes_difference", "time_seconds_difference"]
PARTS = ["year-from-date", "month-from-date", "day-from-date", "hour-from-time", "minute-from-time", "second-from-time"]
TESTS = ["isMissing", "isNotMissing", "equal", "notEqual", "isIn", "isNotIn", "lessThan", "lessOrEqual", "greaterThan",
         "greaterOrEqual", "and", "or", "not", "threshold"]
VALUES = ["value", "recast_to_ordinal", "recast_to_scale"]
BY_KIND = {
    NUMBER: sorted(set(SCALARS) | set(LISTS) | set(DIFFERENCES) | set(PARTS) | set(TESTS) | set(VALUES)
                   | {"length", "sysmis", "outlierHandle", "if", "imputeCatFieldMissingAgainstConTarget"}),
    TEXT: sorted(set(TEXTS) | {"concat", "substr", "if", "imputeCatFieldMissingAgainstConTarget"}),
    MOMENT: ["if"],
}
CHOICES = ["if", "imputeCatFieldMissingAgainstConTarget"]
PAIRS = ["equal", "notEqual", "lessThan", "lessOrEqual", "greaterThan", "greaterOrEqual"]


class RandomTree:
    """Makes trees over fields: those that may be read."""

    def __init__(self, rng, fields):
        self.rng, self.fields = rng, fields

    def of_kind(self, kind, *unless):
        return [field for field in self.fields if field.kind == kind and field not in unless]

    # --- Leaves

    def reference(self, field, may_replace=True):
        replaced = ""
        if may_replace and self.rng.random() < 0.2:
            replaced = f" mapMissingTo={quoteattr(random_literal(self.rng, field.data_type))}"
        return f"<FieldRef field={quoteattr(field.name)}{replaced}/>"

    def constant(self, kind, texts=None):
        rng = self.rng
        data_type = {NUMBER: "double", TEXT: "string"}.get(kind) or rng.choice(sorted(DATE_TYPES))
        text = rng.choice(texts) if texts else random_literal(rng, data_type)
        if kind == MOMENT and rng.random() < 0.1:
            text = rng.choice(NO_MOMENTS)
        if kind == NUMBER and rng.random() < 0.3:
            data_type = rng.choice(["integer", "double"]) if "." not in text and "e" not in text else "double"
        return f'<Constant dataType="{data_type}">{escape(text)}</Constant>'

    def leaf(self, kind):
        fields = self.of_kind(kind)
        if fields and self.rng.random() < 0.75:
            return self.reference(self.rng.choice(fields))
        return self.constant(kind)

    # --- Arguments

    def argument(self, kind, depth, functions=None):
        """An argument of a kind; rarely one of another, where no list of functions is asked for."""
        rng = self.rng
        if functions is None and rng.random() < 0.04:
            kind = rng.choice([NUMBER, TEXT, MOMENT])
        if depth <= 0 or rng.random() < 0.45:
            return self.leaf(kind)
        names = [name for name in functions or BY_KIND[kind] if name in BY_KIND[kind]]
        return self.apply(rng.choice(names), kind, depth)

    def arguments(self, count, kind, depth, functions=None):
        return "".join(self.argument(kind, depth - 1, functions) for _ in range(count))

    def array(self, kind, literals):
        if kind == TEXT:
            quoted = ['"' + text.replace("\\", "\\\\").replace('"', '\\"') + '"' for text in literals]
            return f'<Array type="string" n="{len(quoted)}">{escape(" ".join(quoted))}</Array>'
        return f'<Array type="real" n="{len(literals)}">{" ".join(literals)}</Array>'

    # --- Functions

    def apply(self, name, kind, depth):
        """A function whose result is of a kind, or what comes nearest when the fields do not allow it."""
        inner = self.inner(name, kind, depth)
        if inner is None:
            return self.leaf(kind)
        replaced = ""
        if (kind == NUMBER or name in CHOICES) and self.rng.random() < 0.2:
            replaced = f' mapMissingTo="{written_number(self.rng.choice(NUMBERS))}"'
        if self.rng.random() < 0.1:
            replaced += f' invalidValueTreatment="{self.rng.choice(["returnInvalid", "asIs", "asMissing"])}"'
        return f"<Apply function={quoteattr(name)}{replaced}>{inner}</Apply>"

    def inner(self, name, kind, depth):
        rng = self.rng
        if name in STRICT_LISTS:
            return self.arguments(rng.choice([1, 2, 3, 4]), NUMBER, depth, NUMBER_FUNCTIONS)
        if name in ("cdf.normal", "pdf.normal"):
            deviation = self.constant(NUMBER, ["0.5", "1", "2.5", "10", "0"])
            return self.arguments(1, NUMBER, depth) + self.leaf(NUMBER) + deviation
        if name == "idf.normal":
            p = (self.constant(NUMBER, ["0.5", "0.975", "0.001", "1e-10", "1"]) if rng.random() < 0.5
                 else f'<Apply function="cdfnorm">{self.leaf(NUMBER)}</Apply>')
            return p + self.leaf(NUMBER) + self.constant(NUMBER, ["0.5", "1", "2.5", "0"])
        if name == "pow":
            return self.arguments(1, NUMBER, depth) + self.constant(NUMBER, ["2", "3", "-1", "-2.9", "0", "0.5", "7"])
        if name in PAIRS:
            return self.pair(name, depth)
        if name in ("and", "or"):
            return "".join(self.apply(rng.choice(TESTS), NUMBER, depth - 1) for _ in range(rng.randint(1, 3)))
        if name == "not":
            return self.apply(rng.choice(TESTS), NUMBER, depth - 1)
        if name in SCALARS:
            return self.arguments(SCALARS[name][0], NUMBER, depth)
        if name in LISTS:
            return self.arguments(2, NUMBER, depth)
        if name in TEXTS:
            return self.arguments(1, TEXT, depth)
        return self.special(name, kind, depth)

    def pair(self, name, depth):
        """Two values to compare; often a field and one of its likely values."""
        rng = self.rng
        kinds = [NUMBER, TEXT, MOMENT] if name in ("equal", "notEqual") else [NUMBER, NUMBER, MOMENT]
        fields = [field for field in self.fields if field.kind in kinds]
        if not fields or rng.random() < 0.4:
            kind = rng.choice(kinds)
            if name in ("equal", "notEqual") and rng.random() < 0.4:
                return self.compared_choices(kind, depth)
            return self.arguments(2, kind, depth)
        field = rng.choice(fields)
        constant = f'<Constant dataType="{field.data_type}">{escape(field.literal(rng))}</Constant>'
        return self.reference(field) + constant

    def compared_choices(self, kind, depth):
        """An "if", whose branches may be of several kinds, with another one or with what may be one of its branches."""
        rng = self.rng
        condition = self.apply(rng.choice(TESTS), NUMBER, depth - 2)
        branches = [self.leaf(rng.choice([kind, NUMBER, TEXT, MOMENT])) for _ in range(rng.choice([1, 2, 2, 2]))]
        replaced = f' mapMissingTo="{written_number(rng.choice(NUMBERS))}"' if rng.random() < 0.2 else ""
        pair = [f'<Apply function="if"{replaced}>{condition}{"".join(branches)}</Apply>',
                rng.choice(branches) if rng.random() < 0.6 else self.apply("if", kind, depth - 1)]
        rng.shuffle(pair)
        return "".join(pair)

    def special(self, name, kind, depth):
        rng = self.rng
        field = rng.choice(self.fields)
        if name in ("isMissing", "isNotMissing"):
            return self.reference(field)
        if name == "sysmis":
            return self.reference(field)
        if name in VALUES:
            fields = self.of_kind(NUMBER) + self.of_kind(TEXT)
            return self.reference(rng.choice(fields)) if fields else None
        if name in ("isIn", "isNotIn"):
            fields = self.of_kind(NUMBER) + self.of_kind(TEXT)
            if not fields:
                return None
            field = rng.choice(fields)
            literals = [field.literal(rng) for _ in range(rng.randint(1, 4))]
            value = self.reference(field)
            if rng.random() < 0.15:
                # The elements of the list are what the second argument is.
                condition = self.apply(rng.choice(TESTS), NUMBER, depth - 2)
                value += self.leaf(rng.choice([NUMBER, TEXT, MOMENT]))
                value = f'<Apply function="if">{condition}{value}</Apply>'
            if rng.random() < 0.15:
                return value + "".join(self.constant(field.kind, [text]) for text in literals)
            return value + self.array(field.kind, literals)
        if name == "length":
            # That of a derived field may be another than its text's.
            derived = [field for field in self.of_kind(TEXT) if field.is_derived]
            if derived and rng.random() < 0.7:
                return self.reference(rng.choice(derived))
            return self.argument(TEXT, depth - 1, TEXT_FUNCTIONS)
        if name == "concat":
            return self.arguments(rng.choice([1, 2, 3]), TEXT, depth, TEXT_FUNCTIONS)
        if name == "substr":
            return self.arguments(1, TEXT, depth) + self.constant(NUMBER, ["0", "1", "2", "3", "4.7", "6", "-1", "100"])
        if name in DIFFERENCES:
            return self.argument(MOMENT, depth - 1) + self.argument(rng.choice([MOMENT, MOMENT, NUMBER]), depth - 1)
        if name in PARTS:
            return self.argument(MOMENT, depth - 1)
        if name == "outlierHandle":
            method = self.constant(TEXT, ["asIs", "asMissingValues", "asExtremeValues"])
            return (self.arguments(1, NUMBER, depth) + method + self.constant(NUMBER, ["0", "2", "50"])
                    + self.constant(NUMBER, ["1", "2.5", "10"]) + self.constant(NUMBER, ["1.96", "3"])
                    + self.constant(NUMBER, ["1", "4", "30"]))
        if name == "if":
            return self.choice(kind, depth)
        return self.impute(kind)

    def choice(self, kind, depth):
        rng = self.rng
        condition = self.apply(rng.choice(TESTS), NUMBER, depth - 1) if rng.random() < 0.85 else self.leaf(NUMBER)
        return condition + "".join(self.branch(kind, depth - 1) for _ in range(rng.choice([1, 2, 2, 2])))

    def branch(self, kind, depth):
        """What an "if" may choose: often of another kind than the one that is needed."""
        if self.rng.random() < 0.3:
            kind = self.rng.choice([NUMBER, TEXT, MOMENT])
        return self.argument(kind, depth, BY_KIND[kind])

    def impute(self, kind):
        categories = [field for field in self.of_kind(kind) if field.has_labels]
        numbers = [field for field in self.of_kind(NUMBER) if field.optype == "continuous"]
        if not categories or not numbers:
            return None
        rng = self.rng
        category, number = (self.reference(rng.choice(found), may_replace=False) for found in (categories, numbers))
        means = [written_number(rng.choice(NUMBERS)) for _ in range(4)]
        variances = [rng.choice(["0.25", "1", "4", "100"]) for _ in range(4)]
        return category + number + self.array(NUMBER, means) + self.array(NUMBER, variances)


def all_functions():
    """Each name with the kind of its result."""
    return [(name, kind) for kind in (NUMBER, TEXT, MOMENT) for name in BY_KIND[kind]]
