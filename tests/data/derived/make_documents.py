#!/usr/bin/env python3
"""Makes random documents with derived fields, cases for them and their answers.

    ./make_documents.py                               writes random.txt again, always the same
    ./make_documents.py --check                       fails when random.txt is not what would be written
    ./make_documents.py --seed N --output FILE        others

The file holds one document after the other:

    document 0 begins with a line like this one; then the document itself
    table                   ends it
    x<TAB>t<TAB>|<TAB>f0    names: what the cases give, a bar, the derived fields in the order of the document
    1.5<TAB>"red<TAB>|<TAB>.    one line for each case, and an empty line behind the last

A cell: empty for no value at all, "." for a missing number or date/time, "@" and seconds for a date/time, a quote and a
text (with \\t, \\n, \\\\ and \\xNN) for a text, or a number. A missing text is an empty one. Numbers are written with
repr(). A case may give a value to a derived field, too, which those that read it take then.

A case in which the answer is a matter of the last digits of an inexact function is left out, so that numbers agree to a
relative 1e-12 and all else exactly. What the documents leave out since readers refuse it: bins that overlap, extensions
that contradict each other, functions with arguments that do not fit, references to fields further down.
"""
import argparse
import math
import os
import random
import sys
import xml.etree.ElementTree as ElementTree
from xml.sax.saxutils import escape, quoteattr

from evaluate import Document
from functions import Rounding
from random_fields import (NO_MOMENTS, NUMBERS, RandomField, element, missing_value, random_data_field,
                           random_literal, random_value, value_element, written_number)
from random_trees import RandomTree, all_functions
from values import DATE_TYPES, DAY, MISSING, MOMENT, NUMBER, TEXT, Moment, Text

DOCUMENTS = 260
CASES = 9
CANDIDATES = 30  # of which the most varied cases are kept
SEED = 41
HERE = os.path.dirname(os.path.abspath(__file__))
NAMES = ["x", "y", "light & dark", "a<b", "Größe", "t", "u", "day", "moment"]


# --- Expressions --------------------------------------------------------------------------------------------------


class RandomExpressions:
    """Makes the expression of one derived field. `functions` says which function stands at the root of an Apply."""

    def __init__(self, rng, fields, functions):
        self.rng, self.fields, self.functions = rng, fields, functions

    def any_field(self, *kinds, optypes=("continuous", "categorical", "ordinal")):
        fields = [field for field in self.fields if field.kind in (kinds or (NUMBER, TEXT, MOMENT))
                  and field.optype in optypes]
        return self.rng.choice(fields) if fields else None

    def literals(self, field, count=3):
        return [field.literal(self.rng) for _ in range(count)]

    def attribute(self, name, text, chance=0.4):
        return f" {name}={quoteattr(text)}" if self.rng.random() < chance else ""

    def constant(self, field):
        text = random_literal(self.rng, field.data_type)
        if field.kind != TEXT and self.rng.random() < 0.1:
            text = self.rng.choice(NO_MOMENTS if field.kind == MOMENT else ["no number", "12 apples"])
            return f'<Constant dataType="{field.data_type}">{escape(text)}</Constant>', []
        field.literals = [text]
        return f'<Constant dataType="{field.data_type}">{escape(text)}</Constant>', []

    def field_ref(self, field):
        source = self.any_field(field.kind) if self.rng.random() < 0.95 else self.any_field()
        if source is None:
            return None
        field.literals = source.literals if source.kind == field.kind else field.literals
        replaced = self.attribute("mapMissingTo", source.literal(self.rng))
        return f"<FieldRef field={quoteattr(source.name)}{replaced}/>", []

    def norm_continuous(self, field):
        source = self.any_field(NUMBER, MOMENT, optypes=("continuous",)) or None
        if source is None or field.kind != NUMBER:
            return None
        rng = self.rng
        scale, start = (DAY * 365.0, 0.0) if source.kind == MOMENT else (1.0, rng.choice([-7.0, 0.0, -100.0]))
        count = rng.choice([2, 2, 3, 4, 5])
        orig = sorted(start + scale * rng.choice([0, 1, 2.5, 3, 7, 10, 12.25, 40]) for _ in range(count))
        points = [(x, rng.choice(NUMBERS)) for x in orig]
        if rng.random() < 0.1:
            rng.shuffle(points)
        pieces = "".join(f'<LinearNorm orig="{written_number(x)}" norm="{written_number(y)}"/>' for x, y in points)
        outliers = rng.choice(["", "asIs", "asMissingValues", "asExtremeValues"])
        attributes = self.attribute("mapMissingTo", written_number(rng.choice(NUMBERS)))
        attributes += f' outliers="{outliers}"' if outliers else ""
        return f"<NormContinuous field={quoteattr(source.name)}{attributes}>{pieces}</NormContinuous>", []

    def norm_discrete(self, field):
        source = self.any_field(NUMBER, TEXT, optypes=("categorical", "ordinal"))
        if source is None or field.kind != NUMBER:
            return None
        replaced = self.attribute("mapMissingTo", written_number(self.rng.choice(NUMBERS)))
        field.literals = ["0", "1"]
        return (f"<NormDiscrete field={quoteattr(source.name)} value={quoteattr(source.literal(self.rng))}"
                f" method=\"indicator\"{replaced}/>"), []

    def recodes(self, field, source):
        """Attributes and extensions for what nothing matches and for what is missing."""
        rng = self.rng
        attributes, found = "", []
        draw = rng.random()
        if draw < 0.4:
            attributes += f" defaultValue={quoteattr(random_literal(rng, field.data_type))}"
        elif draw < 0.65 and copies_well(source, field):
            found.append('<Extension name="recodeElseCopy"/>')
        draw = rng.random()
        if draw < 0.4:
            attributes += f" mapMissingTo={quoteattr(random_literal(rng, field.data_type))}"
        elif draw < 0.55 and copies_well(source, field):
            found.append('<Extension name="recodeMissingCopy"/>')
        elif draw < 0.65 and field.kind == NUMBER:
            return attributes, found + ['<Extension name="recodeMissingSysmis"/>']
        if rng.random() < 0.25:
            found.append(f'<Extension name="mapSysmisTo" value={quoteattr(random_literal(rng, field.data_type))}/>')
        return attributes, found

    def parted(self, extensions):
        """Some inside the expression, the others beside it."""
        inside = [text for text in extensions if "recodeMissingSysmis" not in text and self.rng.random() < 0.5]
        return "".join(inside), [text for text in extensions if text not in inside]

    def map_values(self, field):
        rng = self.rng
        source = self.any_field()
        count = rng.choice([0, 1, 2, 3, 4, 6])
        rows = [(source.literal(rng), random_literal(rng, field.data_type)) for _ in range(count)]
        field.literals = [row[1] for row in rows] or [random_literal(rng, field.data_type)]
        attributes, extensions = self.recodes(field, source)
        inside, beside = self.parted(extensions)
        targets = ["", ""]
        if field.kind == NUMBER and rng.random() < 0.25:
            targets[rng.randrange(2)] = (
                f'<Extension name="recodeTargetSysmis" value="{written_number(rng.choice(NUMBERS))}"/>')
        table = "".join(f"<row><in>{escape(a)}</in><out>{escape(b)}</out></row>" for a, b in rows)
        return (f'<MapValues outputColumn="out"{attributes}>{inside}{targets[0]}'
                f'<FieldColumnPair field={quoteattr(source.name)} column="in"/>'
                f"<InlineTable>{table}</InlineTable>{targets[1]}</MapValues>"), beside

    def discretize(self, field):
        rng = self.rng
        source = self.any_field(NUMBER, MOMENT) if rng.random() < 0.95 else self.any_field()
        if source is None:
            return None
        margins = self.margins(source)
        bins, values = [], []
        for low, high in zip(margins, margins[1:]):
            if rng.random() < 0.8:
                value = random_literal(rng, field.data_type)
                if source.kind == field.kind != TEXT and rng.random() < 0.2:
                    value = None
                bins.append((low, high, value))
                values.append(value)
        field.literals = [value for value in values if value is not None] or field.literals
        attributes, extensions = self.recodes(field, source)
        inside, beside = self.parted(extensions)
        order = [bin_element(rng, field, *found) for found in bins]
        rng.shuffle(order)
        if not any(text.startswith("<DiscretizeBin") for text in order):
            return None
        return f"<Discretize field={quoteattr(source.name)}{attributes}>{inside}{''.join(order)}</Discretize>", beside

    def margins(self, source):
        rng = self.rng
        if source.kind == MOMENT:
            points = sorted({float(DAY * rng.choice([-5000, -1, 0, 1, 60, 10957])) for _ in range(3)} | {0.0, 43200.0})
        else:
            points = sorted(set(rng.sample(NUMBERS, rng.randint(2, 4))))
        return [None] + points + [None]

    def apply(self, field):
        name = self.functions(field.kind)
        return RandomTree(self.rng, self.fields).apply(name, field.kind, self.rng.choice([1, 2, 3, 3, 4])), []


def copies_well(source, field):
    """A text is copied into a number only where it starts with one."""
    return source.kind == field.kind or field.kind == TEXT or (field.kind, source.kind) == (NUMBER, MOMENT)


def bin_element(rng, field, low, high, value):
    # Neighbours are disjoint when each holds its left margin at most.
    closure = rng.choice(["closedOpen", "openOpen"])
    margins = "" if low is None else f' leftMargin="{written_number(low)}"'
    margins += "" if high is None else f' rightMargin="{written_number(high)}"'
    interval = f'<Interval closure="{closure}"{margins}/>'
    if value is None:
        copy = rng.choice(["DiscretizeBin", 'Extension name="recodeIntervalCopy"'])
        return f"<{copy}>{interval}</{copy.split()[0]}>"
    if field.kind == NUMBER and rng.random() < 0.1:
        return f'<Extension name="recodeTargetSysmis">{interval}</Extension>'
    return f"<DiscretizeBin binValue={quoteattr(value)}>{interval}</DiscretizeBin>"


# --- Documents ----------------------------------------------------------------------------------------------------


class FunctionDeck:
    """Deals the functions out, each of a kind before any comes again; "length" more often, since it alone shows the
    lengths that texts have beside them, and "if", whose branches are of many kinds."""

    def __init__(self, rng):
        self.rng, self.decks = rng, {NUMBER: [], TEXT: [], MOMENT: []}

    def __call__(self, kind):
        if not self.decks[kind]:
            self.decks[kind] = [name for name, result in all_functions() if result == kind]
            self.decks[kind] += ["length"] * 8 + ["if"] * 5 if kind == NUMBER else ["if"]
            self.rng.shuffle(self.decks[kind])
        return self.decks[kind].pop()


def random_derived_field(rng, name, fields, functions):
    data_type = rng.choice(["double"] * 9 + ["integer"] * 2 + ["string"] * 4 + [rng.choice(sorted(DATE_TYPES))])
    optype = rng.choice(["categorical", "ordinal"]) if data_type == "string" or rng.random() < 0.15 else "continuous"
    while True:
        field = RandomField(name, data_type, optype)
        field.is_derived = True
        field.literals = [random_literal(rng, data_type) for _ in range(3)]
        make = RandomExpressions(rng, fields, functions)
        kinds = [make.constant, make.field_ref, make.norm_continuous, make.norm_discrete]
        kinds += [make.map_values, make.discretize] * 2 + [make.apply] * 8
        found = rng.choice(kinds)(field)
        if found is not None:
            break
    expression, beside = found
    attributes = ""
    if field.kind == TEXT and rng.random() < 0.3:
        name, width = rng.choice(["width", "stringLength"]), rng.choice([0, 1, 3, 3, 5, 40])
        if rng.random() < 0.5:
            beside.append(f'<Extension name="{name}" value="{width}"/>')
        else:
            attributes = f' {name}="{width}"'
    field.values = [random_value(rng, data_type) for _ in range(4)]
    return field, element("DerivedField", field, beside + [expression] + derived_missing(rng, field), attributes)


def derived_missing(rng, field):
    """What a derived field declares missing, to those that read it."""
    if field.kind == MOMENT or field.optype != "continuous" and field.kind == NUMBER or rng.random() > 0.2:
        return []
    missing = value_element(random_literal(rng, field.data_type) if field.kind == NUMBER
                            else rng.choice(field.literals))
    if rng.random() < 0.5:
        return [missing.replace("/>", f' property="{rng.choice(["missing", "invalid"])}"/>')]
    if field.kind == NUMBER and rng.random() < 0.5:
        missing += '<Extension name="invalidRangeLower" value="100"/>'
    return [f'<Extension name="MissingValues">{missing}</Extension>']


def random_document(rng, functions):
    """The text, the data fields and the derived ones."""
    types = ["double", "double", "string", rng.choice(["double", "integer"]), "string", rng.choice(sorted(DATE_TYPES)),
             rng.choice(sorted(DATE_TYPES))][:rng.choice([3, 5, 7, 7])]
    names = rng.sample(NAMES, len(types))
    data, elements = zip(*(random_data_field(rng, name, kind) for name, kind in zip(names, types)))
    derived, transformations = [], []
    for place in range(rng.randint(6, 12)):
        field, text = random_derived_field(rng, f"f{place}", list(data) + derived, functions)
        derived.append(field)
        transformations.append(text)
    lines = ['<PMML xmlns="http://www.dmg.org/PMML-4_4" version="4.4">', "<Header/>",
             f'<DataDictionary numberOfFields="{len(data)}">', *elements, "</DataDictionary>",
             "<TransformationDictionary>",
             *transformations, "</TransformationDictionary>", "</PMML>"]
    return "\n".join(lines), data, derived


# --- Cases --------------------------------------------------------------------------------------------------------


def random_case(rng, given):
    case = {}
    for field in given:
        draw = rng.random()
        case[field.name] = (None if draw < 0.06 else missing_value(field.kind, field.data_type) if draw < 0.12
                            else field.value(rng))
    return case


def same(a, b):
    """Whether two answers agree by far more than the comparison asks for."""
    if isinstance(a, Moment):
        a, b = a.seconds, b.seconds
    if isinstance(a, Text) or MISSING in (a, b):
        return a == b
    return a == b or math.isclose(a, b, rel_tol=3e-13)


def answers(document, case):
    """The derived values, or None when they hang on the last digits of an inexact function."""
    found = document.values(case)
    for error, rng in ((1e-15, None), (-1e-15, None), (1e-15, random.Random(1)), (-1e-15, random.Random(2))):
        if not all(same(a, b) for a, b in zip(found, document.values(case, Rounding(error, rng)))):
            return None
    return found


def varied_cases(rng, document, given):
    """The cases that show the most different answers, from many."""
    candidates = []
    for _ in range(CANDIDATES):
        case = random_case(rng, given)
        found = answers(document, case)
        if found is not None:
            candidates.append((case, found))
    seen, kept = set(), []
    while candidates and len(kept) < CASES:
        news = [sum((place, cell(value)) not in seen for place, value in enumerate(found)) for _, found in candidates]
        case, found = candidates.pop(news.index(max(news)))
        seen.update((place, cell(value)) for place, value in enumerate(found))
        kept.append((case, found))
    return kept


# --- Writing ------------------------------------------------------------------------------------------------------


def written_text(data):
    escapes = {9: "\\t", 10: "\\n", 92: "\\\\"}
    return "".join(escapes.get(byte) or (chr(byte) if 32 <= byte < 127 else f"\\x{byte:02x}") for byte in data)


def cell(value):
    if value is None:
        return ""
    if isinstance(value, Text):
        return '"' + written_text(value.data)
    number = value.seconds if isinstance(value, Moment) else value
    if number == MISSING:
        return "."
    return ("@" if isinstance(value, Moment) else "") + repr(number)


def document_lines(rng, number, functions):
    text, data, derived = random_document(rng, functions)
    document = Document(ElementTree.fromstring(text))
    # A case may hold a derived field's name.
    given = list(data) + ([rng.choice(derived)] if rng.random() < 0.15 else [])
    yield f"document {number}"
    yield text
    yield "table"
    yield "\t".join([field.name for field in given] + ["|"] + [field.name for field in derived])
    for case, found in varied_cases(rng, document, given):
        yield "\t".join([cell(case[field.name]) for field in given] + ["|"] + [cell(value) for value in found])
    yield ""


def all_lines(seed, documents):
    rng = random.Random(seed)
    functions = FunctionDeck(rng)
    for number in range(documents):
        for line in document_lines(rng, number, functions):
            yield from line.split("\n")


def agree(wanted, found):
    """Lines agree but for the last digits of inexact functions, in which C libraries differ."""
    if wanted == found:
        return True
    pairs = list(zip(wanted.split("\t"), found.split("\t")))
    try:
        return wanted.count("\t") == found.count("\t") and all(
            a == b or math.isclose(float(a), float(b), rel_tol=1e-12) for a, b in pairs)
    except ValueError:
        return False


def check(path, lines):
    with open(path, encoding="utf-8", newline="\n") as file:
        wanted = file.read().split("\n")[:-1]
    found = list(lines)
    for number, (a, b) in enumerate(zip(wanted, found), 1):
        if not agree(a, b):
            sys.exit(f"{path}:{number} is not what {os.path.basename(__file__)} writes:\n{a}\n{b}")
    if len(wanted) != len(found):
        sys.exit(f"{path} has {len(wanted)} lines, not {len(found)}")


def main():
    parser = argparse.ArgumentParser(description=__doc__.split("\n\n")[0])
    parser.add_argument("--check", action="store_true")
    parser.add_argument("--seed", type=int, default=SEED)
    parser.add_argument("--documents", type=int, default=DOCUMENTS)
    parser.add_argument("--output", default=os.path.join(HERE, "random.txt"))
    options = parser.parse_args()
    lines = all_lines(options.seed, options.documents)
    if options.check:
        check(options.output, lines)
        return
    with open(options.output, "w", encoding="utf-8", newline="\n") as file:
        file.writelines(line + "\n" for line in lines)


if __name__ == "__main__":
    main()
