#!/usr/bin/env python3
"""Computes the derived fields of a document for each case of a table.

    ./evaluate.py MODEL.xml DATA.csv        writes a table of the derived fields to standard output

It was written from the description of the language, apart from the library and without a look at it, so that the two
can be held against each other. It goes the plainest way and is slow.

The table has a header line with the fields' names. An empty cell is a missing number or date/time, or no text at all;
dates and times are written as their field's dataType says. A column of another name is left alone.
"""
import csv
import sys
import xml.etree.ElementTree as ElementTree

from apply_tree import ApplyTree
from fields import Field, children, extensions, local_name, read_data_fields
from functions import Rounding, finite
from values import (MISSING, MOMENT, NUMBER, TEXT, Interval, Moment, Text, is_system_missing, kind_of_value,
                    listed_value, nothing, number_from_text, number_of_text, text_of, text_of_moment, text_of_number,
                    value_from_text, values_equal)


def number_of(value):
    """What any value gives as a number."""
    if isinstance(value, Text):
        return number_of_text(value.data)
    return value.seconds if isinstance(value, Moment) else value


def written(value):
    """What any value gives as a text."""
    if isinstance(value, Text):
        return text_of(value.data)
    return text_of(text_of_moment(value) if isinstance(value, Moment) else text_of_number(value))


def cut(data, width):
    """At most so many bytes, and no part of a character."""
    while 0 < width < len(data) and data[width] & 0xC0 == 0x80:
        width -= 1
    return data[:width]


# --- Expressions --------------------------------------------------------------------------------------------------


class Expression:
    """What stands in a DerivedField. `source` is the field that it reads, if it reads one."""

    def __init__(self, element, field, document):
        self.element, self.field = element, field
        self.source = document.field(self.source_name()) if self.source_name() else None
        self.replacement = self.literal("mapMissingTo")
        self.default = self.literal("defaultValue")
        self.sysmis_replacement = None
        self.else_copy = self.missing_copy = False
        for name, value in extensions(element) + extensions(field.element):
            self.recode(name, value)

    def source_name(self):
        return self.element.get("field")

    def literal(self, attribute):
        text = self.element.get(attribute)
        return None if text is None else listed_value(text, self.field.data_type)

    def recode(self, name, value):
        if name == "recodeElseCopy":
            self.else_copy = True
        elif name == "recodeMissingCopy":
            self.missing_copy = True
        elif name == "mapSysmisTo":
            self.sysmis_replacement = listed_value(value, self.field.data_type)
        elif name == "recodeMissingSysmis":
            self.replacement, self.missing_copy = MISSING, False

    def nothing(self):
        return nothing(self.field.kind, self.field.data_type)

    def given(self, replacement):
        """Whether a replacement is set; a missing number replaces nothing."""
        return replacement is not None and not is_system_missing(replacement)

    def copied(self, value):
        """The input as a value of the field's own kind."""
        if self.field.kind == TEXT:
            return written(value)
        if self.field.kind == NUMBER:
            return number_of(value)
        return value if isinstance(value, Moment) else self.nothing()

    def missing_or_invalid(self, value):
        """What becomes of an input that nothing matched."""
        if not self.source.is_missing(value):
            if self.default is not None:
                return self.default
            return self.copied(value) if self.else_copy else self.nothing()
        if self.source.kind == NUMBER and is_system_missing(value) and self.given(self.sysmis_replacement):
            return self.sysmis_replacement
        if self.given(self.replacement):
            return self.replacement
        return self.copied(value) if self.missing_copy or self.else_copy else self.nothing()


class Constant(Expression):
    def value(self, case):
        return value_from_text(self.element.text or "", self.field.data_type)


class FieldRef(Expression):
    def literal(self, attribute):
        text = self.element.get(attribute)
        return None if text is None else listed_value(text, self.source.data_type)

    def value(self, case):
        value = case.value(self.source)
        if value is not None and self.replacement is not None and self.source.is_missing(value):
            return self.replacement
        # A text is copied without the length beside it.
        return text_of(value.data) if isinstance(value, Text) else value


class NormContinuous(Expression):
    def __init__(self, element, field, document):
        super().__init__(element, field, document)
        points = [(float(p.get("orig")), float(p.get("norm"))) for p in children(element, "LinearNorm")]
        self.orig, self.norm = [p[0] for p in points], [p[1] for p in points]
        self.lines = []
        for (x, a), (y, b) in zip(points, points[1:]):
            self.lines.append((1.0, 0.0) if x == y else ((b - a) / (y - x), (a * y - x * b) / (y - x)))

    def value(self, case):
        value = case.value(self.source)
        if value is None or self.field.kind != NUMBER:
            return None
        if self.source.is_missing(value):
            return self.replacement
        return self.curve(number_of(value), case.rough)

    def curve(self, x, rough):
        def on_line(line):
            return finite(lambda: rough(x * line[0] + line[1]))
        low, high = min(self.orig), max(self.orig)
        if low <= x <= high:
            if len(self.lines) < 2:
                return on_line(self.lines[0])
            for line, start, end in zip(self.lines, self.orig, self.orig[1:]):
                if start <= x <= end:
                    return on_line(line)
            return x
        is_low = abs(x - low) <= abs(x - high)
        if self.element.get("outliers") == "asExtremeValues":
            return self.norm[0 if is_low else -1]
        # Outliers that are to be missing go on along the line, too; with one line alone, both stay as they are.
        return x if len(self.lines) < 2 else on_line(self.lines[0 if is_low else -1])


class Encoding(Expression):
    """Pairs of a value and what it becomes. The first that equals the input decides, be the input missing or not."""
    pairs = ()

    def value(self, case):
        value = case.value(self.source)
        if value is None:
            return None if self.field.kind == TEXT or not self.given(self.replacement) else self.replacement
        for original, encoded in self.pairs:
            if values_equal(value, original):
                return encoded
        return self.missing_or_invalid(value)


class NormDiscrete(Encoding):
    def __init__(self, element, field, document):
        super().__init__(element, field, document)
        self.pairs = [(listed_value(element.get("value"), self.source.data_type), 1.0)]
        self.default, self.else_copy = 0.0, False


class MapValues(Encoding):
    def __init__(self, element, field, document):
        super().__init__(element, field, document)
        column = children(element, "FieldColumnPair")[0].get("column")
        self.pairs = []
        for child in element:
            if local_name(child) == "Extension" and child.get("name") == "recodeTargetSysmis":
                self.pairs.append((number_from_text(child.get("value")), MISSING))
            elif local_name(child) == "InlineTable":
                for row in children(child, "row"):
                    self.pairs.append((listed_value(self.cell(row, column), self.source.data_type),
                                       listed_value(self.cell(row, element.get("outputColumn")), field.data_type)))

    def source_name(self):
        return children(self.element, "FieldColumnPair")[0].get("field")

    @staticmethod
    def cell(row, name):
        return children(row, name)[0].text or ""


class Discretize(Expression):
    def __init__(self, element, field, document):
        super().__init__(element, field, document)
        self.bins = []
        for child in element:
            if local_name(child) == "DiscretizeBin":
                text = child.get("binValue")
                value = None if text is None else listed_value(text, field.data_type)
                self.bins.append((self.interval(child), value))
            elif child.get("name") == "recodeTargetSysmis":
                self.bins.append((self.interval(child), self.nothing()))
            elif child.get("name") == "recodeIntervalCopy":
                self.bins.append((self.interval(child), None))

    @staticmethod
    def interval(element):
        interval = children(element, "Interval")[0]
        closure = interval.get("closure")
        return Interval(float(interval.get("leftMargin", "-inf")), float(interval.get("rightMargin", "inf")),
                        closure.startswith("closed"), closure.endswith("Closed"))

    def value(self, case):
        value = case.value(self.source)
        if value is None or kind_of_value(value) == TEXT:
            return self.replacement if self.given(self.replacement) else None
        for interval, binned in self.bins:
            if interval.holds(number_of(value)):
                return value if binned is None else binned
        return self.missing_or_invalid(value)


class Apply(Expression):
    def __init__(self, element, field, document):
        self.tree = ApplyTree(element, document)
        self.field = field

    def value(self, case):
        return self.tree.value_as(case, self.field.kind)


EXPRESSIONS = {kind.__name__: kind for kind in (Constant, FieldRef, NormContinuous, NormDiscrete, MapValues, Discretize,
                                                Apply)}


# --- Fields, documents and cases ----------------------------------------------------------------------------------


class DerivedField(Field):
    def __init__(self, element, document):
        super().__init__(element)
        self.element = element
        self.width = int(element.get("width") or element.get("stringLength") or self.width)
        self.add_values(element)
        for extension in children(element, "Extension"):
            if extension.get("name") == "MissingValues":
                self.add_missing(extension)
        expression, = children(element, *EXPRESSIONS)
        self.expression = EXPRESSIONS[local_name(expression)](expression, self, document)

    def value(self, case):
        value = self.expression.value(case)
        if value is None or kind_of_value(value) != self.kind:
            return nothing(self.kind, self.data_type)
        if self.kind == TEXT and 0 <= self.width < len(value.data):
            return Text(cut(value.data, self.width), self.width)
        return Moment(value.seconds, self.data_type) if self.kind == MOMENT else value


class Document:
    def __init__(self, root):
        self.data_fields = read_data_fields(children(root, "DataDictionary")[0])
        self.derived_fields = {}
        for transformations in children(root, "TransformationDictionary"):
            for element in children(transformations, "DerivedField"):
                field = DerivedField(element, self)
                self.derived_fields[field.name] = field

    def field(self, name):
        return self.data_fields.get(name) or self.derived_fields[name]

    def values(self, given, rough=Rounding()):
        """The derived fields' values for a case, which is given as values by names."""
        case = Case(given, rough)
        return [field.value(case) for field in self.derived_fields.values()]


class Case:
    def __init__(self, given, rough):
        self.given, self.rough = given, rough
        self.computed = {}

    def value(self, field):
        """The case's own value; failing that, for a derived field, the computed one."""
        value = self.given.get(field.name)
        if value is not None or not isinstance(field, DerivedField):
            return value
        if field.name not in self.computed:
            self.computed[field.name] = field.value(self)
        return self.computed[field.name]


# --- Tables -------------------------------------------------------------------------------------------------------


def value_of_cell(cell, field):
    if cell == "":
        return None if field.kind == TEXT else nothing(field.kind, field.data_type)
    return value_from_text(cell, field.data_type)


def cell_of_value(value):
    if isinstance(value, Text):
        return value.data.decode("utf-8", "replace")
    if is_system_missing(value):
        return ""
    return text_of_moment(value) if isinstance(value, Moment) else repr(value)


def write_table(document, rows, out):
    writer = csv.writer(out, lineterminator="\n")
    writer.writerow(document.derived_fields)
    for row in rows:
        given = {name: value_of_cell(cell, document.data_fields[name]) for name, cell in row.items()
                 if name in document.data_fields}
        writer.writerow([cell_of_value(value) for value in document.values(given)])


def main():
    if len(sys.argv) != 3:
        sys.exit(__doc__)
    document = Document(ElementTree.parse(sys.argv[1]).getroot())
    with open(sys.argv[2], encoding="utf-8", newline="") as data:
        write_table(document, csv.DictReader(data), sys.stdout)


if __name__ == "__main__":
    main()
