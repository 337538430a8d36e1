"""The data fields of a document, and what data and derived fields have in common: which of their values are missing."""
from values import (MOMENT, TEXT, Interval, OneValue, is_system_missing, kind_of_type, moment_from_number,
                    number_from_text, value_from_text, values_equal)

INFINITY = float("inf")


def local_name(element):
    return element.tag.rpartition("}")[2]


def children(element, *names):
    return [child for child in element if local_name(child) in names]


def extensions(element):
    """Names and values of the extensions right below an element."""
    return [(child.get("name"), child.get("value")) for child in children(element, "Extension")]


class Field:
    def __init__(self, element):
        self.name = element.get("name")
        self.data_type = element.get("x-storageType") or element.get("dataType")
        self.kind = kind_of_type(self.data_type)
        self.optype = element.get("optype")
        self.width = -1
        self.missing = []
        self.labels = []
        for name, value in extensions(element):
            if name in ("width", "stringLength"):
                self.width = int(value)

    def add_values(self, element):
        """The Value children, and the bounds of an invalid range beside them."""
        for child in children(element, "Value"):
            value = self.listed_value(child.get("value"))
            if child.get("property", "valid") == "valid":
                self.labels.append(value)
            else:
                self.missing.append(OneValue(value))
        self.add_invalid_range(element)

    def add_missing(self, element):
        """An extension "MissingValues", whose values are all missing."""
        self.missing += [OneValue(self.listed_value(child.get("value"))) for child in children(element, "Value")]
        self.add_invalid_range(element)

    def listed_value(self, text):
        # A date/time in a list is a number in the field's own unit.
        if self.kind == MOMENT:
            return moment_from_number(number_from_text(text), self.data_type)
        return value_from_text(text, self.data_type)

    def add_invalid_range(self, element):
        bounds = {"invalidRangeLower": -INFINITY, "invalidRangeUpper": INFINITY}
        given = {name: number_from_text(value) for name, value in extensions(element) if name in bounds}
        if given:
            bounds.update(given)
            self.missing.append(Interval(bounds["invalidRangeLower"], bounds["invalidRangeUpper"], True, True))

    def add_outside(self, interval):
        """A document's Interval says what is valid; what lies outside is missing."""
        left, right, closure = interval.get("leftMargin"), interval.get("rightMargin"), interval.get("closure", "")
        if left:
            self.missing.append(Interval(-INFINITY, float(left), True, not closure.startswith("closed")))
        if right:
            self.missing.append(Interval(float(right), INFINITY, not closure.endswith("Closed"), True))

    def is_missing(self, value):
        if value is None:
            return True
        if self.kind != TEXT and is_system_missing(value):
            return True
        if not any(missing.holds_value(value) for missing in self.missing):
            return False
        # A number that is given a label is a category, also where a missing interval covers it.
        return self.kind == TEXT or not any(values_equal(value, label) for label in self.labels)


def read_data_fields(dictionary):
    fields = {}
    for element in children(dictionary, "DataField"):
        field = Field(element)
        field.add_values(element)
        for interval in children(element, "Interval"):
            field.add_outside(interval)
        fields[field.name] = field
    return fields

