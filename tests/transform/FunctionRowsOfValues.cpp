// Rows of the functions of texts, dates and values of any kind.

#include <limits>

#include "tests/transform/FunctionRows.h"

namespace kestrel_tests {

namespace {

constexpr double S = MCKestrel_800::NumericValue::gSysmisValue;
constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

// 2000-02-29T13:14:15
constexpr double kLeapDay = 951830055.0;

/// The rows of a test with those of its opposite.
std::vector<FunctionRow> WithOpposite(std::vector<FunctionRow> rows, const char* opposite) {
  const std::size_t count = rows.size();
  for (std::size_t i = 0; i < count; ++i) {
    rows.push_back(rows[i]);
    rows.back().name = opposite;
    rows.back().want = 1.0 - rows[i].want.number;
  }
  return rows;
}

const std::vector<FunctionRow> kTextRows = {
    {"concat", {"ab", "cd"}, "abcd", "one after the other"},
    {"concat", {Wide("ab", 5), Wide("cd", 3)}, Wide("abcd", 8), "the widths add up"},
    {"concat", {Wide("ab", 0), "c"}, "abc", "without a width the text's size counts"},
    {"concat", {"a", "", "b "}, "ab ", "empty texts and blanks"},
    {"concat", {"a"}, "a", "one text"},
    {"concat", {}, "", "none"},
    {"concat",
     {Wide("a", 2147483647), Wide("b", 2147483647)},
     Wide("ab", 2147483647),
     "widths that do not add up"},
    {"lower", {"AbC xYz 123"}, "abc xyz 123", "letters alone"},
    {"lower", {"\xC3\x84@[`{"}, "\xC3\x84@[`{", "of ASCII alone, and nothing beside them"},
    {"lower", {Wide("AB", 10)}, Wide("ab", 10), "the width stays"},
    {"lower", {Wide("AB", -1)}, Wide("ab", -1), "whatever it is"},
    {"lower", {Wide("AB", 0)}, "ab", "without a width the text's size counts"},
    {"lower", {""}, "", "nothing"},
    {"lowercase", {"AbC"}, "abc", "letters"},
    {"lowercase", {Wide("AB", 10)}, Wide("ab", 10), "the width stays"},
    {"lowercase", {""}, "", "nothing"},
    {"uppercase", {"AbC xYz 123"}, "ABC XYZ 123", "letters alone"},
    {"uppercase", {"\xC3\xA4@[`{"}, "\xC3\xA4@[`{", "of ASCII alone, and nothing beside them"},
    {"uppercase", {Wide("ab", 10)}, Wide("AB", 10), "the width stays"},
    {"uppercase", {""}, "", "nothing"},
    {"ltrim", {"  a b "}, "a b ", "at the start alone"},
    {"ltrim", {" \t a"}, "a", "tabs too"},
    {"ltrim", {"\n a"}, "\n a", "but no other space"},
    {"ltrim", {Wide("  a", 10)}, Wide("a", 8), "the width loses as much"},
    {"ltrim", {Wide("  a", -5)}, Wide("a", -2), "a negative width counts as 0"},
    {"ltrim", {Wide("  a", 0)}, "a", "without a width the text's size counts"},
    {"ltrim", {"   "}, "", "blanks alone"},
    {"ltrim", {""}, "", "nothing"},
    {"rtrim", {" a b  "}, " a b", "at the end alone"},
    {"rtrim", {"a \t "}, "a", "tabs too"},
    {"rtrim", {"a \n"}, "a \n", "but no other space"},
    {"rtrim", {Wide("a  ", 10)}, Wide("a", 8), "the width loses as much"},
    {"rtrim", {Wide("a  ", -5)}, Wide("a", -2), "a negative width counts as 0"},
    {"rtrim", {"   "}, "", "blanks alone"},
    {"rtrim", {""}, "", "nothing"},
    {"substr", {"abcdef", 3.0}, Wide("cdef", 3), "to the end; the length is the start"},
    {"substr", {"abcdef", 1.0}, Wide("abcdef", 1), "all of it"},
    {"substr", {"abcdef", 5.0}, Wide("ef", 5), "the last start"},
    {"substr", {"abcdef", 6.0}, Wide("", 6), "the text's size is none; the length stays the width"},
    {"substr", {"abcdef", 0.0}, Wide("", 6), "before the start"},
    {"substr", {"abcdef", -1.0}, Wide("", 6), "far before it"},
    {"substr", {"abcdef", 2.9}, Wide("bcdef", 2), "the start is cut"},
    {"substr", {"abcdef", 0.9}, Wide("", 6), "to one before the text"},
    {"substr", {"abcdef", S}, Wide("", 6), "no start"},
    {"substr", {"abcdef", kNaN}, Wide("", 6), "no number"},
    {"substr", {"abcdef", kInfinity}, Wide("", 6), "infinitely far"},
    {"substr", {Wide("abcdef", 10), 7.0}, Wide("", 10), "within the width is not within the text"},
    {"substr", {Wide("abcdef", -3), 0.0}, Wide("", 0), "a negative width counts as 0"},
    {"substr", {"", 1.0}, "", "of nothing"},
    {"substr", {Wide("", 5), 1.0}, "", "of nothing, whatever the width"},
    {"substr", {"a", 1.0}, Wide("", 1), "a single character has no start"},
};

const std::vector<FunctionRow> kDateTimeRows = {
    {"date_years_difference", {Seconds(31557600), 0.0}, 1.0, "a year is 365.25 days"},
    {"date_years_difference", {Seconds(0), 15778800.0}, -0.5, "not rounded, with a sign"},
    {"date_years_difference", {Seconds(S), 0.0}, S, "no date"},
    {"date_years_difference", {Seconds(0), S}, S, "nothing to subtract"},
    {"date_years_difference", {Seconds(kInfinity), 0.0}, S, "infinitely far"},
    {"date_months_difference", {Seconds(2629800), 0.0}, 1.0, "a month is 30.4375 days"},
    {"date_months_difference", {Seconds(S), 0.0}, S, "no date"},
    {"date_months_difference", {Seconds(0), S}, S, "nothing to subtract"},
    {"date_days_difference", {Seconds(172800), 86400.0}, 1.0, "a day"},
    {"date_days_difference", {Seconds(43200), 0.0}, 0.5, "not rounded"},
    {"date_days_difference", {Seconds(S), 0.0}, S, "no date"},
    {"date_days_difference", {Seconds(0), S}, S, "nothing to subtract"},
    {"year-from-date", {Seconds(kLeapDay)}, 2000.0, "a year"},
    {"year-from-date", {Seconds(-1)}, 1970.0, "days are cut toward zero"},
    {"year-from-date", {Seconds(S)}, S, "no date"},
    {"year-from-date", {Seconds(kNaN)}, S, "no number"},
    {"month-from-date", {Seconds(kLeapDay)}, 2.0, "a month"},
    {"month-from-date", {Seconds(S)}, S, "no date"},
    {"day-from-date", {Seconds(kLeapDay)}, 29.0, "a day that not all years have"},
    {"day-from-date", {Seconds(S)}, S, "no date"},
    {"time_hours_difference", {Seconds(5400), 0.0}, 1.5, "not rounded"},
    {"time_hours_difference", {Seconds(S), 0.0}, S, "no time"},
    {"time_hours_difference", {Seconds(0), S}, S, "nothing to subtract"},
    {"time_minutes_difference", {Seconds(90), 60.0}, 0.5, "not rounded"},
    {"time_minutes_difference", {Seconds(S), 0.0}, S, "no time"},
    {"time_minutes_difference", {Seconds(0), S}, S, "nothing to subtract"},
    {"time_seconds_difference", {Seconds(90.5), 100.0}, -9.5, "not rounded"},
    {"time_seconds_difference", {Seconds(S), 0.0}, S, "no time"},
    {"time_seconds_difference", {Seconds(0), S}, S, "nothing to subtract"},
    {"time_seconds_difference", {Seconds(1e308), -1e308}, S, "too large"},
    {"hour-from-time", {Seconds(kLeapDay)}, 13.0, "an hour"},
    {"hour-from-time", {Seconds(-1)}, 23.0, "the time of day counts upwards"},
    {"hour-from-time", {Seconds(S)}, S, "no time"},
    {"minute-from-time", {Seconds(kLeapDay)}, 14.0, "a minute"},
    {"minute-from-time", {Seconds(S)}, S, "no time"},
    {"second-from-time", {Seconds(kLeapDay)}, 15.0, "a second"},
    {"second-from-time", {Seconds(15.9)}, 15.0, "a second that has begun"},
    {"second-from-time", {Seconds(S)}, S, "no time"},
};

const std::vector<FunctionRow> kEqualRows = {
    {"equal", {1.0, 1.0}, 1.0, "equal numbers"},
    {"equal", {1.0, 2.0}, 0.0, "other numbers"},
    {"equal", {1e20, 1.00000000000001e20}, 1.0, "within the tolerance of numbers"},
    {"equal", {"a", "a  "}, 1.0, "trailing blanks do not count"},
    {"equal", {"a", " a"}, 0.0, "leading ones do"},
    {"equal", {"a", "A"}, 0.0, "case counts"},
    {"equal", {1.0, "1"}, 0.0, "a number and a text"},
    {"equal", {Seconds(5), Seconds(5)}, 1.0, "equal dates"},
    {"equal", {Seconds(5), 5.0}, 0.0, "a date and a number"},
    {"equal", {S, S}, 1.0, "two missing numbers are equal"},
    {"equal", {S, 1.0}, 0.0, "missing on the left"},
    {"equal", {1.0, S}, 0.0, "missing on the right"},
    {"equal", {"", ""}, 1.0, "two empty texts"},
    {"equal", {kInfinity, kInfinity}, 0.0, "an infinity equals nothing"},
    {"equal", {}, 0.0, "no arguments"},
    {"equal", {1.0}, 0.0, "one argument"},
    {"equal", {1.0, 1.0, 1.0}, 0.0, "three arguments"},
};

const std::vector<FunctionRow> kIsInRows = {
    {"isIn", {2.0}, 1.0, "among numbers", 0.0, {{1.0, 2.0, 3.0}}},
    {"isIn", {4.0}, 0.0, "not among them", 0.0, {{1.0, 2.0, 3.0}}},
    {"isIn", {2.0000000000000004}, 1.0, "within the tolerance of numbers", 0.0, {{1.0, 2.0}}},
    {"isIn", {"b "}, 1.0, "among texts, but for trailing blanks", 0.0, {{"a", "b"}}},
    {"isIn", {"c"}, 0.0, "not among them", 0.0, {{"a", "b"}}},
    {"isIn", {2.0}, 0.0, "a number among texts", 0.0, {{"1", "2"}}},
    {"isIn", {"2"}, 0.0, "a text among numbers", 0.0, {{1.0, 2.0}}},
    {"isIn", {2.0}, 1.0, "the second of several kinds", 0.0, {{"2", 2.0}}},
    {"isIn", {2.0}, 0.0, "among nothing", 0.0, {{}}},
    {"isIn", {S}, 1.0, "a missing number is among missing ones", 0.0, {{1.0, S}}},
    {"isIn", {S}, 0.0, "and not among others", 0.0, {{1.0, 2.0}}},
    {"isIn", {}, 0.0, "no argument", 0.0, {{1.0}}},
};

constexpr char kExtreme[] = "asExtremeValues";
const std::vector<FunctionRow> kSpecialRows = {
    {"length", {"abc"}, 3.0, "its own length"},
    {"length", {Wide("abc", 10)}, 10.0, "a declared one"},
    {"length", {Wide("abc", 0)}, 3.0, "none declared"},
    {"length", {"a  "}, 3.0, "trailing blanks count"},
    {"length", {""}, 0.0, "of nothing"},
    {"sysmis", {S}, 1.0, "a missing number"},
    {"sysmis", {5.0}, 0.0, "a number"},
    {"sysmis", {"x"}, 0.0, "a text"},
    {"sysmis", {""}, 0.0, "an empty text is not system-missing"},
    {"sysmis", {Seconds(S)}, 1.0, "a missing date"},
    {"sysmis", {Seconds(0)}, 0.0, "a date"},
    {"isMissing", {S}, 1.0, "a missing number"},
    {"isMissing", {5.0}, 0.0, "a number"},
    {"isMissing", {"x"}, 0.0, "a text"},
    {"isMissing", {Seconds(S)}, 1.0, "a missing date"},
    {"isNotMissing", {S}, 0.0, "a missing number"},
    {"isNotMissing", {5.0}, 1.0, "a number"},
    {"isNotMissing", {"x"}, 1.0, "a text"},
    {"isNotMissing", {Seconds(S)}, 0.0, "a missing date"},
    {"if", {1.0, 10.0, 20.0}, 10.0, "true"},
    {"if", {0.0, 10.0, 20.0}, 20.0, "false"},
    {"if", {2.0, 10.0, 20.0}, 20.0, "anything but 1 is false"},
    {"if", {1.0000000000000002, 10.0, 20.0}, 10.0, "within the tolerance of numbers"},
    {"if", {S, 10.0, 20.0}, 20.0, "missing is false"},
    {"if", {1.0, S, 20.0}, S, "a missing choice"},
    {"if", {0.0, 10.0, S}, S, "a missing choice"},
    {"if", {1.0, S, S}, S, "no choice"},
    {"if", {1.0, 10.0}, 10.0, "without an alternative"},
    {"if", {0.0, 10.0}, S, "without the alternative that is asked for"},
    {"if", {1.0, "yes", "no"}, "yes", "texts"},
    {"if", {0.0, "yes", Wide("no", 7)}, Wide("no", 7), "a text with its length"},
    {"outlierHandle", {5.0, kExtreme, 4.0, 2.0, 3.0, 9.0}, 5.0, "inside, 2 to 6"},
    {"outlierHandle", {2.0, kExtreme, 4.0, 2.0, 3.0, 9.0}, 2.0, "the lower bound is inside"},
    {"outlierHandle", {6.0, "asIs", 4.0, 2.0, 3.0, 9.0}, 6.0, "the upper bound is inside"},
    {"outlierHandle", {1.5, kExtreme, 4.0, 2.0, 3.0, 9.0}, 2.0, "below, to the lower bound"},
    {"outlierHandle", {9.0, kExtreme, 4.0, 2.0, 3.0, 9.0}, 6.0, "above, to the upper bound"},
    {"outlierHandle", {1.5, "asMissingValues", 4.0, 2.0, 3.0, 9.0}, S, "below, missing"},
    {"outlierHandle", {9.0, "asMissingValues", 4.0, 2.0, 3.0, 9.0}, S, "above, missing"},
    {"outlierHandle", {9.0, "asIs", 4.0, 2.0, 3.0, 9.0}, S, "as it is has no bound to give"},
    {"outlierHandle", {S, kExtreme, 4.0, 2.0, 3.0, 9.0}, S, "no value"},
    {"outlierHandle", {5.0, kExtreme, S, 2.0, 3.0, 9.0}, S, "no centre"},
    {"outlierHandle", {5.0, kExtreme, 4.0, S, 3.0, 9.0}, S, "no factor"},
    {"outlierHandle", {5.0, kExtreme, 4.0, 2.0, S, 9.0}, S, "no deviation"},
    {"outlierHandle", {5.0, kExtreme, 4.0, 2.0, 3.0, S}, S, "no size"},
    {"outlierHandle", {5.0, kExtreme, 4.0, 2.0, 3.0, 0.0}, 5.0, "a sample of none bounds nothing"},
    {"outlierHandle", {kInfinity, "asIs", 4.0, 2.0, 3.0, 0.0}, S, "an infinity inside"},
};

/// Of the functions that give the number of a value, all with the same rows, and of the imputation.
std::vector<FunctionRow> MakeSpecialRows() {
  std::vector<FunctionRow> rows = kSpecialRows;
  // The same for each function that gives the number of a value.
  for (const char* name : {"value", "recast_to_ordinal", "recast_to_scale"}) {
    rows.push_back({name, {5.5}, 5.5, "a number"});
    rows.push_back({name, {S}, S, "a missing one"});
    rows.push_back({name, {"12.5"}, 12.5, "a text that is a number"});
    rows.push_back({name, {"abc"}, S, "a text that is none"});
    rows.push_back({name, {""}, S, "an empty text"});
  }
  // Categories 1, 2, 3 (or their texts) with these means and variances.
  const std::vector<std::vector<RowValue>> moments = {{10.0, 20.0, 30.0}, {1.0, 1.0, 100.0}};
  const char* const kImpute = "imputeCatFieldMissingAgainstConTarget";
  rows.push_back({kImpute, {2.0, 10.0}, 2.0, "a category that is there", 0.0, moments});
  rows.push_back({kImpute, {S, 11.0}, 1.0, "the nearest", 0.0, moments});
  rows.push_back({kImpute, {S, 22.0}, 3.0, "measured in standard deviations", 0.0, moments});
  rows.push_back({kImpute, {S, 15.0}, 3.0, "the widest is near to most", 0.0, moments});
  rows.push_back({kImpute, {S, S}, S, "nothing to measure", 0.0, moments});
  rows.push_back({kImpute, {2.0, S}, 2.0, "nothing to impute", 0.0, moments});
  rows.push_back({kImpute, {S, 15.0}, 1.0, "the first of two", 0.0, {{10.0, 20.0}, {4.0, 4.0}}});
  return rows;
}

}  // namespace

const std::vector<FunctionRow>& TextRows() {
  return kTextRows;
}

const std::vector<FunctionRow>& DateTimeRows() {
  return kDateTimeRows;
}

const std::vector<FunctionRow>& ValueRows() {
  static const std::vector<FunctionRow> kRows = [] {
    std::vector<FunctionRow> rows = WithOpposite(kEqualRows, "notEqual");
    const std::vector<FunctionRow> lists = WithOpposite(kIsInRows, "isNotIn");
    rows.insert(rows.end(), lists.begin(), lists.end());
    return rows;
  }();
  return kRows;
}

const std::vector<FunctionRow>& SpecialRows() {
  static const std::vector<FunctionRow> kRows = MakeSpecialRows();
  return kRows;
}

}  // namespace kestrel_tests
