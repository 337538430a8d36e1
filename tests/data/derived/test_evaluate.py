#!/usr/bin/env python3
"""Holds the evaluator against values that were worked out by hand."""
import math
import os
import sys
import unittest
import xml.etree.ElementTree as ElementTree

sys.path.insert(0, os.path.dirname(os.path.abspath(__file__)))
from evaluate import Document  # noqa: E402
from values import DAY, MISSING, Moment, Text, moment_from_number, moment_from_text, text_of  # noqa: E402

S = MISSING
DATA = """
  <DataField name="x" optype="continuous" dataType="double"><Value value="-99" property="missing"/></DataField>
  <DataField name="y" optype="continuous" dataType="double">
    <Interval closure="closedOpen" leftMargin="0" rightMargin="10"/></DataField>
  <DataField name="z" optype="continuous" dataType="double"/>
  <DataField name="n" optype="categorical" dataType="integer"><Value value="1"/><Value value="2"/>
    <Extension name="invalidRangeLower" value="0"/><Extension name="invalidRangeUpper" value="9"/></DataField>
  <DataField name="t" optype="categorical" dataType="string"><Value value="red"/><Value value="blue"/>
    <Value value="n/a" property="missing"/></DataField>
  <DataField name="u" optype="categorical" dataType="string"/>
  <DataField name="d" optype="continuous" dataType="date"/>
  <DataField name="e" optype="continuous" dataType="dateDaysSince[1960]"/>
  <DataField name="h" optype="continuous" dataType="time"/>"""


def document(*derived):
    fields = "".join(f'<DerivedField name="f{i}" optype="continuous" {text}</DerivedField>'
                     for i, text in enumerate(derived))
    return Document(ElementTree.fromstring(
        f"<PMML><DataDictionary>{DATA}</DataDictionary><TransformationDictionary>{fields}"
        "</TransformationDictionary></PMML>"))


def number(expression):
    return f'dataType="double">{expression}'


def text(expression):
    return f'dataType="string">{expression}'


def constants(values):
    """Arguments: a number, a text in quotes, S, or the name of a field."""
    parts = []
    for value in values.split():
        if value == "S":
            parts.append('<FieldRef field="z"/>')
        elif value.startswith("'"):
            parts.append(f'<Constant dataType="string">{value[1:-1]}</Constant>')
        elif value[0].isalpha():
            parts.append(f'<FieldRef field="{value}"/>')
        else:
            parts.append(f"<Constant>{value}</Constant>")
    return "".join(parts)


def chosen(values, other="", attributes=""):
    """An "if" by the field y."""
    return f'<Apply function="if"{attributes}>{constants("y " + values + " " + other)}</Apply>'


class TestEvaluator(unittest.TestCase):
    def expect(self, derived, given, wanted):
        """What the last of the derived fields is."""
        found = document(*([derived] if isinstance(derived, str) else derived)).values(given)[-1]
        if isinstance(wanted, float) and isinstance(found, float):
            self.assertTrue(found == wanted or math.isclose(found, wanted, rel_tol=1e-13), f"{derived}: {found}")
        elif isinstance(wanted, str):
            self.assertEqual((found.data, found.length), (wanted.encode(), len(wanted.encode())), derived)
        else:
            self.assertEqual(found, wanted, derived)

    def test_functions_of_numbers(self):
        for function, arguments, wanted in [
                ("+", "1 2", 3.0), ("+", "1 S", S), ("-", "5 3", 2.0), ("-", "S 3", S), ("*", "4 2.5", 10.0),
                ("/", "1 0", S), ("/", "S 0", S), ("/", "7 2", 3.5), ("+", "1e308 1e308", S),
                ("pow", "2 3.9", 8.0), ("pow", "2 -2", 0.25), ("pow", "0 -1", S), ("pow", "0 0", 1.0),
                ("pow", "3 S", S),
                ("abs", "-2.5", 2.5), ("abs", "S", S), ("exp", "0", 1.0), ("exp", "709.5", S), ("exp", "-708", 0.0),
                ("exp", "S", S), ("log10", "1000", 3.0), ("lg10", "0", S), ("ln", "-1", S), ("ln", "1", 0.0),
                ("mod", "-7 3", -1.0), ("mod", "7 -3", 1.0), ("mod", "7 0", S), ("mod", "1e300 1", S),
                ("round", "2.5", 3.0), ("round", "-2.5", -3.0), ("round", "-2.4", -2.0), ("round", "3e9", S),
                ("sqrt", "9", 3.0), ("sqrt", "-1", S), ("trunc", "-2.7", -2.0), ("trunc", "2147483647", S),
                ("cdfnorm", "0", 0.5), ("cdfnorm", "1.959963984540054", 0.975), ("cdfnorm", "S", S),
                ("threshold", "2 1", 1.0), ("threshold", "1 1", 0.0), ("threshold", "S 1", 0.0),
                ("floor", "-1.5", -2.0), ("ceil", "-1.5", -1.0), ("floor", "S", S)]:
            with self.subTest(function=function, arguments=arguments):
                self.expect(number(f'<Apply function="{function}">{constants(arguments)}</Apply>'), {}, wanted)

    def test_functions_of_lists(self):
        for function, arguments, wanted in [
                ("sum", "1 S 3", 4.0), ("sum", "S S", S), ("mean", "1 S 3", 2.0), ("avg", "S", S),
                ("min", "3 S 2", 2.0),
                ("max", "3 S 2", 3.0), ("product", "2 S 4", 8.0), ("product", "", S), ("median", "3 1 S 2", 2.0),
                ("median", "4 1 3 2", 2.5), ("sd", "1", S), ("sd", "1 2 3 4", math.sqrt(5 / 3)), ("sd", "2 2", 0.0),
                ("variance", "1 2 3 4", 5 / 3), ("variance", "1 S", S), ("cdf.normal", "12 10 2", 0.8413447460685429),
                ("cdf.normal", "1 1 0", S), ("idf.normal", "0.5 7 2", 7.0), ("idf.normal", "1 0 1", S),
                ("idf.normal", "0.975 0 1", 1.959963984540054), ("pdf.normal", "0 0 1", 0.3989422804014327),
                ("pdf.normal", "40 0 1", 0.0), ("pdf.normal", "1 0 0", S), ("lessThan", "S 1", 1.0),
                ("lessThan", "1 1", 0.0), ("lessOrEqual", "1 1", 1.0), ("greaterThan", "1 S", 1.0),
                ("greaterOrEqual", "S S", 1.0), ("and", "S 1", 1.0), ("and", "0 1", 0.0), ("and", "", 0.0),
                ("or", "0 S", 1.0), ("or", "0 0", 0.0), ("not", "0", 1.0), ("not", "S", 0.0)]:
            with self.subTest(function=function, arguments=arguments):
                self.expect(number(f'<Apply function="{function}">{constants(arguments)}</Apply>'), {}, wanted)

    def test_functions_of_texts(self):
        u = {"u": text_of(" \tAb c\t ")}
        for function, arguments, given, wanted in [
                ("concat", "'ab' u", {"u": text_of("Zoë")}, "abZoë"), ("concat", "'ab' u", {}, "ab"),
                ("concat", "", {}, ""),
                ("lower", "'AbÉ'", {}, "abÉ"), ("uppercase", "'abé'", {}, "ABé"), ("ltrim", "u", u, "Ab c\t "),
                ("rtrim", "u", u, " \tAb c"), ("trimend", "u", {}, ""), ("lowercase", "7", {}, "")]:
            with self.subTest(function=function, arguments=arguments):
                self.expect(text(f'<Apply function="{function}">{constants(arguments)}</Apply>'), given, wanted)
        # The length beside a text that was cut off at its start is the place where it was cut.
        for start, wanted in [("3", Text(b"cdef", 3)), ("2.9", Text(b"bcdef", 2)), ("0", Text(b"", 6)),
                              ("6", Text(b"", 6)),
                              ("S", Text(b"", 6)), ("-1", Text(b"", 6))]:
            arguments = constants("'abcdef' " + start)
            self.expect(text(f'<Apply function="substr">{arguments}</Apply>'), {}, wanted)
        self.expect(number('<Apply function="length"><FieldRef field="u"/></Apply>'), {"u": text_of("Zoë ")}, 5.0)
        self.expect(number('<Apply function="length"><FieldRef field="u"/></Apply>'), {}, 0.0)

    def test_dates_and_times(self):
        day = {"d": moment_from_text("2000-02-29", "date"), "e": moment_from_number(0.0, "dateDaysSince[1960]"),
               "h": moment_from_text("23:59:58", "time")}
        self.assertEqual(day["d"].seconds, 951782400.0)
        for function, arguments, wanted in [
                ("year-from-date", "d", 2000.0), ("month-from-date", "d", 2.0), ("day-from-date", "d", 29.0),
                ("hour-from-time", "h", 23.0), ("minute-from-time", "h", 59.0), ("second-from-time", "h", 58.0),
                ("year-from-date", "e", 1960.0), ("date_days_difference", "d e", 14669.0),
                ("date_years_difference", "d e", 14669.0 / 365.25),
                ("date_months_difference", "e d", -14669.0 / 30.4375),
                ("time_hours_difference", "h 3598", 82800.0 / 3600), ("time_minutes_difference", "h 58", 1439.0),
                ("time_seconds_difference", "h S", S), ("time_seconds_difference", "5 h", S),
                ("year-from-date", "x", S),
                ("-", "d e", 14669.0 * DAY), ("equal", "d d", 1.0), ("equal", "d 951782400", 0.0)]:
            with self.subTest(function=function, arguments=arguments):
                self.expect(number(f'<Apply function="{function}">{constants(arguments)}</Apply>'), day, wanted)
        before = {"d": Moment(-1.0, "date")}
        self.expect(number('<Apply function="year-from-date"><FieldRef field="d"/></Apply>'), before, 1970.0)
        self.expect(number('<Apply function="hour-from-time"><FieldRef field="d"/></Apply>'), before, 23.0)

    def test_choices_of_several_kinds(self):
        given = {"t": text_of("abc"), "d": Moment(86400.0, "date")}
        replaced = ' mapMissingTo="7"'
        for left, right, when_true, when_false in [
                (chosen("d", "86400"), "d", 1.0, 0.0), (chosen("d", "86400"), "86400", 0.0, 1.0),
                (chosen("t", "5"), "5", 0.0, 1.0), (chosen("t", "5"), "t", 1.0, 0.0),
                (chosen("t", "5"), chosen("t", "6"), 1.0, 0.0), (chosen("t", "5"), chosen("5", "t"), 0.0, 0.0),
                (chosen("t"), "''", 0.0, 1.0), (chosen("t", "z"), "S", 0.0, 1.0),
                (chosen("t", "z", replaced), "7", 0.0, 1.0), (chosen("h", "d", replaced), "e", 1.0, 0.0)]:
            right = right if right.startswith("<") else constants(right)
            for y, wanted in [(1.0, when_true), (0.0, when_false)]:
                with self.subTest(left=left, right=right, y=y):
                    self.expect(number(f'<Apply function="equal">{left}{right}</Apply>'), {**given, "y": y}, wanted)
                    self.expect(number(f'<Apply function="notEqual">{right}{left}</Apply>'), {**given, "y": y},
                                1.0 - wanted)
        # A date/time field takes dates and times alone, and no number in place of a missing one.
        for tree, when_true, when_false in [
                (f'<Apply function="+">{constants("1 2")}</Apply>', S, S), (chosen("d", "5"), 86400.0, S),
                (chosen("5", "d"), S, 86400.0), (chosen("d", "", replaced), 86400.0, S)]:
            for y, wanted in [(1.0, when_true), (0.0, when_false)]:
                self.expect(f'dataType="date">{tree}', {**given, "y": y}, Moment(wanted, "date"))
        # A missing number is replaced in the tree of a text, too.
        start = chosen("2", "z", ' mapMissingTo="3"')
        for y, wanted in [(1.0, Text(b"bcd", 2)), (0.0, Text(b"cd", 3))]:
            given = {"y": y, "u": text_of("abcd")}
            self.expect(text(f'<Apply function="substr"><FieldRef field="u"/>{start}</Apply>'), given, wanted)

    def test_tests_and_choices(self):
        given = {"x": -99.0, "y": 10.0, "t": text_of("n/a"), "u": text_of("red  "), "n": 5.0}
        array = '<Array type="string" n="2">"red" blue</Array>'
        for expression, wanted in [
                ('function="isMissing"><FieldRef field="x"/>', 1.0),
                ('function="isMissing"><FieldRef field="y"/>', 1.0),
                ('function="isMissing"><FieldRef field="x" mapMissingTo="1"/>', 1.0),
                ('function="isNotMissing"><FieldRef field="u"/>', 1.0),
                ('function="isMissing"><FieldRef field="n"/>', 1.0),
                ('function="isMissing"><FieldRef field="d"/>', 1.0), ('function="sysmis"><FieldRef field="x"/>', 0.0),
                ('function="sysmis"><FieldRef field="z"/>', 1.0),
                ('function="abs"><FieldRef field="x" mapMissingTo="-3"/>', 3.0),
                ('function="abs" mapMissingTo="8"><FieldRef field="z"/>', 8.0),
                ('function="abs"><FieldRef field="x"/>', 99.0),
                ('function="isIn"><FieldRef field="u"/>' + array, 1.0),
                ('function="isNotIn"><FieldRef field="t"/>' + array, 1.0),
                ('function="isIn"><FieldRef field="x"/>' + array, 0.0),
                ('function="equal">' + constants("u 'red'"), 1.0),
                ('function="equal">' + constants("1 '1'"), 0.0), ('function="notEqual">' + constants("S S"), 0.0),
                ('function="if">' + constants("1 2 3"), 2.0), ('function="if">' + constants("2 2 3"), 3.0),
                ('function="if">' + constants("0 2"), S), ('function="if" mapMissingTo="4">' + constants("0 2"), 4.0),
                ('function="if">' + constants("S 2 'a'"), S), ('function="value">' + constants("t"), S),
                ('function="outlierHandle">' + constants("9 'asExtremeValues' 5 2 3 4"), 8.0),
                ('function="outlierHandle">' + constants("9 'asIs' 5 2 3 4"), S),
                ('function="outlierHandle">' + constants("8 'asIs' 5 2 3 4"), 8.0),
                ('function="outlierHandle">' + constants("1 'asExtremeValues' 5 2 3 4"), 2.0)]:
            with self.subTest(expression=expression):
                self.expect(number(f"<Apply {expression}</Apply>"), given, wanted)
        self.expect(number('<Apply function="isIn">' + chosen("t", "5") + array + "</Apply>"), {**given, "y": 1.0}, 0.0)
        self.expect(number('<Apply function="isIn">' + chosen("5", "u") + array + "</Apply>"), {**given, "y": 0.0}, 1.0)
        impute = ('<Apply function="imputeCatFieldMissingAgainstConTarget"><FieldRef field="t"/><FieldRef field="z"/>'
                  '<Array type="real" n="2">0 10</Array><Array type="real" n="2">1 4</Array></Apply>')
        self.expect(text(impute), {"t": text_of("n/a"), "z": 3.0}, "red")
        self.expect(text(impute), {"z": 4.0}, "blue")
        self.expect(text(impute), {"t": text_of("other"), "z": 4.0}, "other")
        self.expect(text(impute), {}, "")

    def test_choices_of_different_kinds(self):
        given = {"z": 5.0, "t": text_of("red"), "d": moment_from_text("2000-02-29", "date")}
        seconds = 951782400.0

        def choice(arguments, attributes=""):
            return f'<Apply function="if" {attributes}>{constants(arguments)}</Apply>'

        def call(function, *arguments):
            return f'<Apply function="{function}">{"".join(arguments)}</Apply>'
        for arguments, as_number, as_text, as_day in [
                ("1 t z", S, "red", S), ("0 t z", 5.0, "", S), ("1 z t", 5.0, "", S), ("0 z t", S, "red", S),
                ("1 d z", seconds, "", seconds), ("0 d z", 5.0, "", S), ("0 z d", seconds, "", seconds),
                ("1 t d", S, "red", S), ("0 t d", seconds, "", seconds), ("0 t", S, "", S), ("0 z", S, "", S)]:
            with self.subTest(arguments=arguments):
                chosen = choice(arguments)
                sum_of_it = S if as_number == S else as_number + 1.0
                year = S if as_day == S else 2000.0
                self.expect(number(chosen), given, as_number)
                self.expect(text(chosen), given, as_text)
                self.expect('dataType="date">' + chosen, given, Moment(as_day, "date"))
                self.expect(number(call("+", chosen, constants("1"))), given, sum_of_it)
                self.expect(text(call("uppercase", chosen)), given, as_text.upper())
                self.expect(number(call("year-from-date", chosen)), given, year)
                # Through one more choice, whose own kind is another.
                for other in ("z", "t", "d"):
                    nested = call("if", constants("0 " + other), chosen)
                    self.expect(number(call("+", nested, constants("1"))), given, sum_of_it)
                    self.expect(text(nested), given, as_text)
                    self.expect(number(call("year-from-date", nested)), given, year)
        # What replaces a missing number stands in for nothing else.
        replaced = 'mapMissingTo="7"'
        self.expect(number(choice("1 t z", replaced)), given, 7.0)
        self.expect(number(call("+", choice("1 t d", replaced), constants("1"))), given, 8.0)
        self.expect(text(choice("0 t z", replaced)), given, "")
        self.expect(number(call("year-from-date", choice("0 d z", replaced))), given, S)

    def test_curves(self):
        def curve(points, attributes=""):
            pieces = "".join(f'<LinearNorm orig="{a}" norm="{b}"/>' for a, b in points)
            return number(f'<NormContinuous field="x" {attributes}>{pieces}</NormContinuous>')
        two, three = [(0, 0), (1, 10)], [(0, 0), (1, 10), (3, 50)]
        for points, attributes, x, wanted in [
                (two, "", 0.5, 5.0), (two, "", 2.0, 2.0), (two, 'outliers="asMissingValues"', 2.0, 2.0),
                (two, 'outliers="asExtremeValues"', 2.0, 10.0), (three, "", 1.0, 10.0), (three, "", 4.0, 70.0),
                (three, "", -1.0, -10.0), (three, 'outliers="asExtremeValues"', -1.0, 0.0), (three, "", 3.0, 50.0),
                (three, 'mapMissingTo="7"', -99.0, 7.0), (three, "", -99.0, S), (three, 'mapMissingTo="7"', None, S),
                (three, 'mapMissingTo="7"', S, 7.0), ([(1, 5), (1, 9)], "", 1.0, 1.0),
                ([(3, 7), (1, 5), (2, 6)], 'outliers="asExtremeValues"', 9.0, 6.0)]:
            with self.subTest(points=points, attributes=attributes, x=x):
                self.expect(curve(points, attributes), {"x": x}, wanted)

    def test_encodings(self):
        rows = "".join(f"<row><in>{a}</in><out>{b}</out></row>" for a, b in [(1, 10), (1, 11), (-99, 12)])

        def mapped(field, attributes="", more=""):
            return (f'<MapValues outputColumn="out" {attributes}>{more}<FieldColumnPair field="{field}" column="in"/>'
                    f"<InlineTable>{rows}</InlineTable></MapValues>")
        copy, missing_copy = '<Extension name="recodeElseCopy"/>', '<Extension name="recodeMissingCopy"/>'
        sysmis = '<Extension name="mapSysmisTo" value="77"/>'
        for attributes, more, x, wanted in [
                ("", "", 1.0, 10.0), ("", "", -99.0, 12.0), ("", "", 5.0, S), ('defaultValue="3"', "", 5.0, 3.0),
                ("", copy, 5.0, 5.0), ('defaultValue="3"', "", S, S), ('mapMissingTo="4"', "", S, 4.0),
                ('mapMissingTo="4"', sysmis, S, 77.0), ('mapMissingTo="4"', "", None, 4.0), ("", missing_copy, S, S),
                ("", '<Extension name="recodeTargetSysmis" value="1"/>', 1.0, S)]:
            with self.subTest(attributes=attributes, more=more, x=x):
                self.expect(number(mapped("x", attributes, more)), {"x": x}, wanted)
        for attributes, more, y, wanted in [
                ('mapMissingTo="4"', "", 11.0, 4.0), ("", missing_copy, 11.0, 11.0), ("", copy, 11.0, 11.0),
                ("", "", 11.0, S), ("", '<Extension name="recodeMissingSysmis"/>' + copy, 11.0, 11.0)]:
            self.expect(number(mapped("y", attributes, more)), {"y": y}, wanted)
        for attributes, more, x, wanted in [
                ("", "", 1.0, "10"), ('defaultValue="d"', "", 5.0, "d"), ("", copy, 2.5, "2.5"), ("", "", S, ""),
                ('mapMissingTo="m"', "", S, "m"), ('mapMissingTo="m"', "", None, "")]:
            self.expect(text(mapped("x", attributes, more)), {"x": x}, wanted)
        # Dates may be listed as such or as numbers in the field's unit.
        days = "".join(f"<row><in>{a}</in><out>{b}</out></row>" for a, b in [("1970-01-02", 1), (172800, 2)])
        for seconds, wanted in [(86400.0, 1.0), (172800.0, 2.0), (S, S), (1.0, S)]:
            table = ('<MapValues outputColumn="out"><FieldColumnPair field="d" column="in"/>'
                     f"<InlineTable>{days}</InlineTable></MapValues>")
            self.expect(number(table), {"d": Moment(seconds, "date")}, wanted)
        discrete = '<NormDiscrete field="t" value="red" {}/>'
        for attributes, t, wanted in [("", "red ", 1.0), ("", "blue", 0.0), ("", "n/a", S),
                                      ('mapMissingTo="5"', "n/a", 5.0),
                                      ("", None, S), ("", "", 0.0)]:
            given = {"t": None if t is None else text_of(t)}
            self.expect(number(discrete.format(attributes)), given, wanted)

    def test_bins(self):
        bins = "".join(f'<DiscretizeBin {value}><Interval closure="{closure}" {margins}/></DiscretizeBin>'
                       for value, closure, margins in [
                           ('binValue="1"', "openOpen", 'rightMargin="0"'),
                           ('binValue="2"', "closedOpen", 'leftMargin="0" rightMargin="10"'),
                           ("", "openClosed", 'leftMargin="10" rightMargin="20"')])
        for attributes, x, wanted in [
                ("", -5.0, 1.0), ("", 0.0, 2.0), ("", 10.0, S), ("", 12.5, 12.5), ("", 20.0, 20.0), ("", 21.0, S),
                ('defaultValue="9"', 10.0, 9.0), ("", -99.0, 1.0), ('mapMissingTo="8"', S, 8.0),
                ('mapMissingTo="8"', None, 8.0)]:
            with self.subTest(attributes=attributes, x=x):
                self.expect(number(f'<Discretize field="x" {attributes}>{bins}</Discretize>'), {"x": x}, wanted)
        self.expect(number(f'<Discretize field="t" mapMissingTo="8">{bins}</Discretize>'), {"t": text_of("red")}, 8.0)
        self.expect(text(f'<Discretize field="d">{bins}</Discretize>'), {"d": Moment(-5.0, "date")}, "1")

    def test_copies_and_chains(self):
        self.expect(number('<FieldRef field="x" mapMissingTo="3"/>'), {"x": -99.0}, 3.0)
        self.expect(number('<FieldRef field="x" mapMissingTo="3"/>'), {}, S)
        self.expect(number('<FieldRef field="x"/>'), {"x": -99.0}, -99.0)
        self.expect('dataType="string"><Extension name="width" value="3"/><FieldRef field="u"/>',
                    {"u": text_of("abcd")}, "abc")
        cut = text(f'<Apply function="substr">{constants("u 3")}</Apply>')
        for copied, wanted in [("f0", 3.0), ("f1", 4.0)]:
            length = number(f'<Apply function="length">{constants(copied)}</Apply>')
            self.expect([cut, text('<FieldRef field="f0"/>'), length], {"u": text_of("abcdef")}, wanted)
        self.expect(number("<Constant>no number</Constant>"), {}, S)
        chain = [number('<FieldRef field="x"/>'), number(f'<Apply function="+">{constants("f0 1")}</Apply>'),
                 number('<FieldRef field="f1"/>')]
        self.expect(chain, {"x": 4.0}, 5.0)
        self.expect(chain, {"x": 4.0, "f0": 10.0}, 11.0)
        self.expect(chain, {"x": 4.0, "f0": None}, 5.0)
        # What a derived field declares missing is missing to those that read it.
        self.expect(['dataType="double"><Value value="4" property="missing"/><FieldRef field="x"/>',
                     number('<FieldRef field="f0" mapMissingTo="0"/>')], {"x": 4.0}, 0.0)


if __name__ == "__main__":
    unittest.main()
