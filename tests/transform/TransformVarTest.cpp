// Tests of one derived field: its settings, and what each kind of expression makes of a value.

#include "kestrel/transform/TransformVar.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <memory>
#include <sstream>
#include <string>
#include <vector>

#include "kestrel/dictionary/MissingValueSet.h"
#include "kestrel/predicates/Range.h"
#include "tests/transform/DerivedFields.h"

namespace {

using namespace MCKestrel_800;
using namespace kestrel_test;

constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr auto kText = ScoreDictVar::STRING_VAR;
constexpr auto kDateField = ScoreDictVar::kDATETIME_VAR;

std::unique_ptr<TransformVar> Owned(TransformVar* field) {
  return std::unique_ptr<TransformVar>(field);
}

/// Adds the points and the lines between them, as documents have them.
void AddPoints(TransformVar& field, const std::vector<std::pair<double, double>>& points) {
  for (std::size_t i = 0; i < points.size(); ++i) {
    field.AddLinearNorm(points[i].first, points[i].second);
    if (i == 0) continue;
    const auto [left, low] = points[i - 1];
    const auto [right, high] = points[i];
    if (left == right) {
      field.AddNormInfo(1.0, 0.0);
    } else {
      field.AddNormInfo((high - low) / (right - left), (low * right - left * high) / (right - left));
    }
  }
}

TEST(TransformVar, IsADerivedVariable) {
  const TransformVar field("f", ScoreDictVar::kNUMERIC_VAR);
  EXPECT_TRUE(field.IsDerivedVariable());
  const ScoreDictVar& variable = field;
  const std::unique_ptr<ScoreDictVar> clone(variable.Clone());
  EXPECT_TRUE(clone->IsDerivedVariable());
  EXPECT_NE(dynamic_cast<TransformVar*>(clone.get()), nullptr);
}

TEST(TransformVar, TakesOutlierTreatmentsByTheirName) {
  TransformVar field("f", ScoreDictVar::kNUMERIC_VAR);
  EXPECT_EQ(field.GetOutlierTreatment(), ScoreDictVar::kAsIs);
  field.SetOutlierTreatMent("asMissingValues");
  EXPECT_EQ(field.GetOutlierTreatment(), ScoreDictVar::kAsMissingValues);
  field.SetOutlierTreatMent("asExtremeValues");
  for (const char* other : {"", "AsIs", "asis ", "asExtreme"}) {
    field.SetOutlierTreatMent(other);
    EXPECT_EQ(field.GetOutlierTreatment(), ScoreDictVar::kAsExtremeValues) << other;
  }
  field.SetOutlierTreatMent("asIs");
  EXPECT_EQ(field.GetOutlierTreatment(), ScoreDictVar::kAsIs);
}

TEST(TransformVar, CopiesOrReplacesWhatIsLeftOver) {
  TransformVar field("f", ScoreDictVar::kNUMERIC_VAR);
  field.SetRecodeElseCopy(true);
  field.SetRecodeDefaultValue(Number(1));
  EXPECT_FALSE(field.IsRecodeElseCopy());
  field.SetRecodeElseCopy(true);
  EXPECT_EQ(field.GetRecodeDefaultValue(), nullptr);
  EXPECT_TRUE(field.IsRecodeElseCopy());
  field.SetRecodeMissingCopy(true);
  field.SetRecodeMissValueTo(Number(2));
  EXPECT_FALSE(field.IsRecodeMissingCopy());
  field.SetRecodeMissingCopy(true);
  EXPECT_EQ(field.GetRecodeMissValueRep(), nullptr);
  EXPECT_TRUE(field.IsRecodeMissingCopy());
  // The one pair does not touch the other.
  EXPECT_TRUE(field.IsRecodeElseCopy());
}

struct NormRow {
  const char* outliers;
  double x;
  double wanted;
};

TEST(TransformVar, NormalisesBetweenThreePointsAndGoesOnBeyond) {
  for (const NormRow& row : {
           NormRow{"asIs", 0, 10},
           NormRow{"asIs", 0.5, 15},
           NormRow{"asIs", 1, 20},
           NormRow{"asIs", 2, 60},
           NormRow{"asIs", 3, 100},
           NormRow{"asIs", 5, 180},
           NormRow{"asIs", -1, 0},
           NormRow{"asMissingValues", 5, 180},
           NormRow{"asMissingValues", -1, 0},
           NormRow{"asExtremeValues", 5, 100},
           NormRow{"asExtremeValues", -1, 10},
           NormRow{"asExtremeValues", 0, 10},
           NormRow{"asExtremeValues", 3, 100},
       }) {
    TransformVar field("f", ScoreDictVar::kNUMERIC_VAR);
    AddPoints(field, {{0, 10}, {1, 20}, {3, 100}});
    field.SetOutlierTreatMent(row.outliers);
    // A replacement is not asked for outliers.
    field.SetRecodeMissValueTo(Number(-5));
    EXPECT_DOUBLE_EQ(field.GetNormValue(row.x), row.wanted) << row.outliers << " " << row.x;
  }
}

TEST(TransformVar, LeavesOutliersOfTwoPointsAsTheyAre) {
  for (const char* outliers : {"asIs", "asMissingValues"}) {
    TransformVar field("f", ScoreDictVar::kNUMERIC_VAR);
    AddPoints(field, {{0, 10}, {1, 20}});
    field.SetOutlierTreatMent(outliers);
    EXPECT_EQ(field.GetNormValue(0.25), 12.5);
    EXPECT_EQ(field.GetNormValue(7), 7);
    EXPECT_EQ(field.GetNormValue(-7), -7);
  }
  TransformVar field("f", ScoreDictVar::kNUMERIC_VAR);
  AddPoints(field, {{0, 10}, {1, 20}});
  field.SetOutlierTreatMent("asExtremeValues");
  EXPECT_EQ(field.GetNormValue(7), 20);
}

TEST(TransformVar, GivesPointsInAnyOrderTheFirstSegmentThatHolds) {
  TransformVar field("f", ScoreDictVar::kNUMERIC_VAR);
  AddPoints(field, {{5, 50}, {0, 0}, {2, 200}, {1, 7}});
  // [5, 0] is empty, [0, 2] comes first; the middle of the range is in no segment.
  EXPECT_DOUBLE_EQ(field.GetNormValue(1.5), 150);
  EXPECT_EQ(field.GetNormValue(3), 3);
  // The first and the last point as they are stored are the extremes: the last for the far end.
  field.SetOutlierTreatMent("asExtremeValues");
  EXPECT_EQ(field.GetNormValue(-1), 50);
  EXPECT_EQ(field.GetNormValue(9), 7);
}

TEST(TransformVar, GivesEqualPointsALineThatLeavesThingsAsTheyAre) {
  TransformVar field("f", ScoreDictVar::kNUMERIC_VAR);
  AddPoints(field, {{1, 5}, {1, 8}, {2, 9}});
  EXPECT_EQ(field.GetNormValue(1), 1) << "the first segment is the point itself";
  EXPECT_DOUBLE_EQ(field.GetNormValue(1.5), 8.5);
}

TEST(TransformVar, LeavesNumbersWhereThereIsNoFunction) {
  TransformVar no_points("f", ScoreDictVar::kNUMERIC_VAR);
  EXPECT_EQ(no_points.GetNormValue(3), 3);
  TransformVar no_lines("f", ScoreDictVar::kNUMERIC_VAR);
  no_lines.AddLinearNorm(0, 1);
  no_lines.AddLinearNorm(1, 2);
  EXPECT_EQ(no_lines.GetNormValue(0.5), 0.5);
  TransformVar one_point("f", ScoreDictVar::kNUMERIC_VAR);
  one_point.AddLinearNorm(0, 1);
  one_point.AddNormInfo(2, 3);
  EXPECT_EQ(one_point.GetNormValue(10), 23) << "one point has no range, its line holds everywhere";
}

// A tie between the ends goes to the first segment.
TEST(TransformVar, TakesTheFirstSegmentForWhatIsAsFarFromBothEnds) {
  TransformVar field("f", ScoreDictVar::kNUMERIC_VAR);
  AddPoints(field, {{4, 1}, {4, 2}, {4, 9}});
  field.SetOutlierTreatMent("asExtremeValues");
  EXPECT_EQ(field.GetNormValue(5), 1);
}

TEST(TransformVar, ComputesNormalisedFieldsOfNumbersAlone) {
  Data data;
  auto field = Owned(NewField("f", "x", TransExpression::kNormContinuous));
  AddPoints(*field, {{0, 0}, {1, 10}});
  const auto compute = [&] { return field->GetTransformedValue(&data.record, &data.dictionary, nullptr); };
  data.record.SetValue("x", 0.5);
  EXPECT_EQ(compute()->GetDouble(), 5);
  data.record.SetMissingValue("x");
  EXPECT_EQ(compute()->GetDouble(), kSysmis);
  field->SetRecodeMissValueTo(Number(-3));
  EXPECT_EQ(compute()->GetDouble(), -3);
  data.record.Remove("x");
  EXPECT_EQ(compute()->GetDouble(), kSysmis) << "an absent value is not replaced";
  data.record.SetValue("x", kInfinity);
  EXPECT_EQ(compute()->GetDouble(), kSysmis) << "no infinity comes out";
  auto text = Owned(NewField("f", "x", TransExpression::kNormContinuous, kText));
  AddPoints(*text, {{0, 0}, {1, 10}});
  EXPECT_EQ(text->GetTransformedValue(&data.record, &data.dictionary, nullptr)->GetString(), "");
}

TEST(TransformVar, KeepsConstants) {
  struct Row {
    const char* text;
    double wanted;
  };
  for (const Row& row : {Row{"2.5", 2.5}, Row{"abc", kSysmis}, Row{"", kSysmis}, Row{"-1e3", -1000}}) {
    auto field = Owned(NewField("f", "", TransExpression::kConstant));
    field->SetConstString(row.text);
    EXPECT_EQ(field->GetTransformedValue(nullptr, nullptr, nullptr)->GetDouble(), row.wanted) << row.text;
    EXPECT_EQ(field->GetTransformedValue(nullptr, nullptr, nullptr)->GetDouble(), row.wanted) << row.text;
  }
  auto text = Owned(NewField("f", "", TransExpression::kConstant, kText));
  text->SetConstString("abcdef");
  EXPECT_EQ(text->GetTransformedValue(nullptr, nullptr, nullptr)->GetString(), "abcdef");
  text.reset(text->Clone());
  text->SetWidth(4);
  const ScoreValue* const cut = text->GetTransformedValue(nullptr, nullptr, nullptr);
  EXPECT_EQ(cut->GetString(), "abcd");
  EXPECT_EQ(static_cast<const StringValue*>(cut)->GetLength(), 4);
  auto date = Owned(NewField("f", "", TransExpression::kConstant, kDateField));
  date->SetDateTimeType(kDate);
  date->SetConstString("1970-01-02");
  EXPECT_EQ(date->GetTransformedValue(nullptr, nullptr, nullptr)->GetDouble(), 86400);
}

TEST(TransformVar, CutsTextsToTheWidthButNoCharacterInTwo) {
  Data data;
  auto field = Owned(NewField("f", "t", TransExpression::kFieldRef, kText));
  field->SetWidth(3);
  struct Row {
    const char* text;
    const char* wanted;
    int length;
  };
  for (const Row& row : {Row{"ab", "ab", 2}, Row{"abc", "abc", 3}, Row{"abcd", "abc", 3},
                         Row{"ab\xC3\xA9", "ab", 3}, Row{"a\xC3\xA9q", "a\xC3\xA9", 3}, Row{"", "", 0}}) {
    data.record.SetValue("t", row.text);
    const auto* value =
        static_cast<const StringValue*>(field->GetTransformedValue(&data.record, &data.dictionary, nullptr));
    EXPECT_EQ(value->GetText(), row.wanted);
    EXPECT_EQ(value->GetLength(), row.length) << row.text;
  }
}

TEST(TransformVar, RefersToFields) {
  Data data;
  data.dictionary.GetVar("x")->SetMissingValues(new MissingValueSet);
  data.dictionary.GetVar("x")->GetMissingValues()->Add(new Range(Number(99)));
  auto field = Owned(NewReference("f", "x"));
  const auto compute = [&] {
    return field->GetTransformedValue(&data.record, &data.dictionary, nullptr)->GetDouble();
  };
  data.record.SetValue("x", 7);
  EXPECT_EQ(compute(), 7);
  data.record.SetValue("x", 99);
  EXPECT_EQ(compute(), 99) << "what the document calls missing passes as it is";
  field->SetRecodeMissValueTo(Number(-1));
  EXPECT_EQ(compute(), -1);
  data.record.SetMissingValue("x");
  EXPECT_EQ(compute(), -1);
  data.record.Remove("x");
  EXPECT_EQ(compute(), kSysmis) << "an absent value is not replaced";
  auto other_kind = Owned(NewReference("f", "t"));
  data.record.SetValue("t", "12");
  EXPECT_EQ(other_kind->GetTransformedValue(&data.record, &data.dictionary, nullptr)->GetDouble(), kSysmis);
}

/// What a value makes of a map with one row, 1 -> 10 (or "one" -> "first").
struct RecodeRow {
  const char* name;
  bool is_missing;
  bool has_default, has_missing, has_sysmis, else_copy, missing_copy;
  const char* wanted_text;
  double wanted_number;
};

const RecodeRow kRecodeRows[] = {
    {"invalid, nothing set", false, false, false, false, false, false, "", kSysmis},
    {"invalid, default", false, true, true, true, false, false, "default", 70},
    {"invalid, copied", false, false, true, true, true, false, "5", 5},
    {"invalid, missing copy is no else copy", false, false, false, false, false, true, "", kSysmis},
    {"missing, nothing set", true, false, false, false, false, false, "", kSysmis},
    {"missing, default does not count", true, true, false, false, false, false, "", kSysmis},
    {"missing, replaced", true, true, true, false, false, false, "missing", 80},
    {"missing, replaced before copied", true, false, true, false, true, false, "missing", 80},
    {"missing, copied", true, false, false, false, false, true, "9", 9},
    {"missing, copied as what is left over", true, false, false, false, true, false, "9", 9},
    {"user missing is no sysmis", true, false, true, true, false, false, "missing", 80},
};

TEST(TransformVar, RecodesWhatIsMissingOrMatchesNothing) {
  DictVar source("x", ScoreDictVar::kNUMERIC_VAR);
  source.SetMissingValues(new MissingValueSet);
  source.GetMissingValues()->Add(new Range(Number(9)));
  for (const RecodeRow& row : kRecodeRows) {
    for (const bool is_text : {false, true}) {
      auto field = Owned(
          NewField("f", "x", TransExpression::kMapValues, is_text ? kText : ScoreDictVar::kNUMERIC_VAR));
      const auto value = [&](const char* text, double number) {
        return is_text ? static_cast<ScoreValue*>(Text(text)) : Number(number);
      };
      field->AddEncodingMap(Is(Number(1)), value("first", 10));
      if (row.has_default) field->SetRecodeDefaultValue(value("default", 70));
      if (row.has_missing) field->SetRecodeMissValueTo(value("missing", 80));
      if (row.has_sysmis) field->SetRecodeSysmisValue(value("sysmis", 90));
      if (row.else_copy) field->SetRecodeElseCopy(true);
      if (row.missing_copy) field->SetRecodeMissingCopy(true);
      const NumericValue input(row.is_missing ? 9 : 5);
      for (const ScoreValue* result : {field->HandleMissingAndInvalidValue(&source, is_text, &input),
                                       field->GetEncodedValue(&source, &input)}) {
        ASSERT_NE(result, nullptr) << row.name;
        if (is_text) {
          EXPECT_EQ(result->GetString(), row.wanted_text) << row.name;
        } else {
          EXPECT_EQ(result->GetDouble(), row.wanted_number) << row.name;
        }
      }
      const NumericValue one(1);
      EXPECT_EQ(field->GetEncodedValue(&source, &one)->GetString(), is_text ? "first" : "10") << row.name;
    }
  }
}

TEST(TransformVar, ReplacesTheSystemMissingValueOfNumbersFirst) {
  const DictVar number("x", ScoreDictVar::kNUMERIC_VAR);
  const NumericValue sysmis;
  auto field = Owned(NewField("f", "x", TransExpression::kMapValues));
  field->SetRecodeMissValueTo(Number(80));
  field->SetRecodeSysmisValue(Number(90));
  EXPECT_EQ(field->HandleMissingAndInvalidValue(&number, false, &sysmis)->GetDouble(), 90);
  field->SetRecodeSysmisValue(Number(kSysmis));
  EXPECT_EQ(field->HandleMissingAndInvalidValue(&number, false, &sysmis)->GetDouble(), 80);
  field->SetRecodeMissValueTo(Number(kSysmis));
  field->SetRecodeMissingCopy(false);
  EXPECT_EQ(field->HandleMissingAndInvalidValue(&number, false, &sysmis)->GetDouble(), kSysmis);
  auto text = Owned(NewField("f", "x", TransExpression::kMapValues, kText));
  text->SetRecodeMissValueTo(Text("missing"));
  text->SetRecodeSysmisValue(Text("sysmis"));
  EXPECT_EQ(text->HandleMissingAndInvalidValue(&number, true, &sysmis)->GetString(), "sysmis");
  const DictVar date("x", kDateField);
  EXPECT_EQ(text->HandleMissingAndInvalidValue(&date, true, &sysmis)->GetString(), "missing");
}

TEST(TransformVar, TreatsAbsentInputsOfMapsAndBinsApart) {
  const DictVar source("x", ScoreDictVar::kNUMERIC_VAR);
  for (const bool is_text : {false, true}) {
    auto field =
        Owned(NewField("f", "x", TransExpression::kMapValues, is_text ? kText : ScoreDictVar::kNUMERIC_VAR));
    field->SetRecodeMissValueTo(is_text ? static_cast<ScoreValue*>(Text("missing")) : Number(80));
    const ScoreValue* const encoded = field->GetEncodedValue(&source, nullptr);
    EXPECT_EQ(encoded->GetString(), is_text ? "" : "80");
    const ScoreValue* const binned = field->GetBinningValue(&source, nullptr);
    EXPECT_EQ(binned->GetString(), is_text ? "missing" : "80");
    const StringValue text("5");
    EXPECT_EQ(field->GetBinningValue(&source, &text)->GetString(), is_text ? "missing" : "80")
        << "a text is in no bin";
  }
}

TEST(TransformVar, EncodesWithTheFirstRowThatMatches) {
  Data data;
  auto field = Owned(NewField("f", "t", TransExpression::kMapValues));
  field->AddEncodingMap(Is(Text("a")), Number(1));
  field->AddEncodingMap(Is(Text("b ")), Number(2));
  field->AddEncodingMap(Is(Text("a")), Number(3));
  for (int i = 0; i < 30; ++i)
    field->AddEncodingMap(Is(Text("c" + std::to_string(i))), Number(100 + i));
  const auto compute = [&](const char* text) {
    data.record.SetValue("t", text);
    return field->GetTransformedValue(&data.record, &data.dictionary, nullptr)->GetDouble();
  };
  EXPECT_EQ(compute("a"), 1);
  EXPECT_EQ(compute("a  "), 1);
  EXPECT_EQ(compute("b"), 2);
  EXPECT_EQ(compute("c17"), 117);
  EXPECT_EQ(compute(" a"), kSysmis);
  EXPECT_EQ(compute("A"), kSysmis);
}

/// Matches every number above a bound, as a host might.
class Above : public ScoreValueMatcher {
 public:
  explicit Above(double bound) : bound_(bound) {}
  bool Matches(const ScoreValue& value) const override { return value.GetDouble() > bound_; }
  ScoreValueMatcher* Clone() const override { return new Above(bound_); }

 private:
  double bound_;
};

TEST(TransformVar, AsksMatchersOfAHostInTheirTurn) {
  Data data;
  auto field = Owned(NewField("f", "x", TransExpression::kMapValues));
  field->AddEncodingMap(Is(Number(8)), Number(1));
  field->AddEncodingMap(new Above(5), Number(2));
  field->AddEncodingMap(Is(Number(7)), Number(3));
  field->AddEncodingMap(Is(Number(3)), Number(4));
  field->AddEncodingMap(nullptr, Number(5));
  field->AddEncodingMap(Is(nullptr), Number(6));
  const std::unique_ptr<TransformVar> copy(field->Clone());
  field.reset();
  const auto compute = [&](double x) {
    data.record.SetValue("x", x);
    return copy->GetTransformedValue(&data.record, &data.dictionary, nullptr)->GetDouble();
  };
  EXPECT_EQ(compute(8), 1);
  EXPECT_EQ(compute(7), 2);
  EXPECT_EQ(compute(3), 4);
  EXPECT_EQ(compute(1), kSysmis);
  EXPECT_EQ(compute(kInfinity), 2);
}

TEST(TransformVar, GivesTheInputOfABinWithoutValue) {
  Data data;
  auto field = Owned(NewField("f", "x", TransExpression::kDiscretize));
  field->AddBinningValue(new Range(0, 1, true, false), Number(10));
  field->AddBinningValue(new Range(1, 2, true, true), nullptr);
  field->AddBinningValue(new Range(nullptr, Number(0), false, false), Number(-1));
  field->SetRecodeDefaultValue(Number(50));
  struct Row {
    double x, wanted;
  };
  for (const Row& row : {Row{0, 10}, Row{0.5, 10}, Row{1, 1}, Row{1.5, 1.5}, Row{2, 2}, Row{2.5, 50},
                         Row{-3, -1}, Row{-kInfinity, 50}}) {
    data.record.SetValue("x", row.x);
    EXPECT_EQ(field->GetTransformedValue(&data.record, &data.dictionary, nullptr)->GetDouble(), row.wanted)
        << row.x;
  }
  data.record.SetMissingValue("x");
  EXPECT_EQ(field->GetTransformedValue(&data.record, &data.dictionary, nullptr)->GetDouble(), kSysmis);
}

TEST(TransformVar, BinsDatesByTheirSeconds) {
  Data data;
  auto field = Owned(NewField("f", "d", TransExpression::kDiscretize, kText));
  field->AddBinningValue(new Range(0, 86400, true, false), Text("first day"));
  field->SetRecodeDefaultValue(Text("later"));
  data.record.SetValue("d", 10.0, kDateTimeSecondsSince1970);
  EXPECT_EQ(field->GetTransformedValue(&data.record, &data.dictionary, nullptr)->GetString(), "first day");
  data.record.SetValue("d", 90000.0, kDateTimeSecondsSince1970);
  EXPECT_EQ(field->GetTransformedValue(&data.record, &data.dictionary, nullptr)->GetString(), "later");
}

TEST(TransformVar, ShowsItself) {
  const auto shown = [](const TransformVar& field) {
    std::ostringstream out;
    field.Display(out);
    return out.str();
  };
  const char* const labels[] = {"Constant\n",   "FieldRef\n",  "NormContinuous\n", "NormDiscrete\n",
                                "Discretize\n", "MapValues\n", "Apply\n"};
  for (int kind = 0; kind < 7; ++kind) {
    const auto field = Owned(NewField("f", "x", static_cast<TransExpression>(kind)));
    const std::string text = shown(*field);
    EXPECT_EQ(text.rfind(std::string("Start Display Parameters: \n\nEXPRESSION: ") + labels[kind], 0), 0u);
    EXPECT_EQ(text.substr(text.size() - 30), "End one TransformVar display\n\n");
  }
  const auto map = Owned(NewField("f", "t", TransExpression::kMapValues));
  map->AddEncodingMap(Is(Text("a")), Number(1));
  map->AddEncodingMap(Is(Text("b")), Number(2));
  EXPECT_EQ(shown(*map),
            "Start Display Parameters: \n\nEXPRESSION: MapValues\nOriginal values and its encoded values\n"
            "a, 1; b, 2; \nEnd one TransformVar display\n\n");
  const auto bins = Owned(NewField("f", "x", TransExpression::kDiscretize));
  bins->AddBinningValue(new Range(0, 1, true, false), Number(7));
  bins->SetRecodeIntervalCopy(new Range(5, 6, true, true));
  const std::string text = shown(*bins);
  EXPECT_NE(text.find("Discretize\nBin values\n"), std::string::npos);
  EXPECT_NE(text.find("recodeIntervalCopy"), std::string::npos);
}

TEST(TransformVar, CopiesDeeply) {
  Data data;
  auto field = Owned(NewApply("f", Call(kPlusFunction, {FieldLeaf("x"), ConstantLeaf(Number(1))})));
  field->SetRecodeMissValueTo(Number(3));
  TransformVar copy(*field);
  TransformVar assigned("other", kText);
  assigned.AddEncodingMap(Is(Text("a")), Text("b"));
  assigned = *field;
  field.reset();
  data.record.SetValue("x", 4);
  for (TransformVar* made : {&copy, &assigned}) {
    EXPECT_EQ(made->GetName(), "f");
    EXPECT_EQ(made->GetRecodeMissValueRep()->GetDouble(), 3);
    EXPECT_TRUE(made->GetAllEncodedValues().empty());
    EXPECT_EQ(made->GetTransformedValue(&data.record, &data.dictionary, nullptr)->GetDouble(), 5);
  }
}

TEST(TransformVar, NamesTheFieldsThatItReads) {
  using Names = std::vector<std::string>;
  EXPECT_EQ(Owned(NewField("f", "", TransExpression::kConstant))->GetSourceNames(), Names());
  EXPECT_EQ(Owned(NewReference("f", "x"))->GetSourceNames(), Names{"x"});
  FunctionTree* const inner = Call(kMaxFunction, {FieldLeaf("x"), ConstantLeaf(Number(1)), FieldLeaf("b")});
  const auto apply = Owned(NewApply("f", Call(kMinFunction, {FieldLeaf("b"), inner, FieldLeaf("a")})));
  EXPECT_EQ(apply->GetSourceNames(), (Names{"b", "x", "a"}));
  EXPECT_EQ(Owned(NewApply("f", nullptr))->GetSourceNames(), Names());
}

TEST(TransformVar, SeesAChangeOfItsDefinition) {
  Data data;
  data.record.SetValue("x", 1);
  data.record.SetValue("y", 2);
  auto field = Owned(NewReference("f", "x"));
  EXPECT_EQ(field->GetTransformedValue(&data.record, &data.dictionary, nullptr)->GetDouble(), 1);
  field->AddFieldNameAndTransExpression("y", TransExpression::kFieldRef);
  EXPECT_EQ(field->GetTransformedValue(&data.record, &data.dictionary, nullptr)->GetDouble(), 2);
}

TEST(TransformVar, LooksUpDictionariesAndRecordsAnew) {
  auto field = Owned(NewReference("f", "x"));
  field->SetRecodeMissValueTo(Number(-1));
  for (const double missing : {1.0, 2.0}) {
    // Each time at the same place, perhaps; the one before is gone.
    auto data = std::make_unique<Data>();
    data->dictionary.GetVar("x")->SetMissingValues(new MissingValueSet);
    data->dictionary.GetVar("x")->GetMissingValues()->Add(new Range(Number(missing)));
    data->record.SetValue("x", 1);
    EXPECT_EQ(field->GetTransformedValue(&data->record, &data->dictionary, nullptr)->GetDouble(),
              missing == 1 ? -1 : 1);
    CaseRecord other_layout;
    other_layout.Add("y", Number(5));
    other_layout.Add("x", Number(6));
    EXPECT_EQ(field->GetTransformedValue(&other_layout, &data->dictionary, nullptr)->GetDouble(), 6);
  }
}

}  // namespace
