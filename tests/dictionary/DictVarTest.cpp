#include "kestrel/dictionary/DictVar.h"

#include <gtest/gtest.h>

#include <memory>
#include <set>

#include "kestrel/dictionary/MissingValueSet.h"
#include "kestrel/dictionary/ScoreCatNumericEncoder.h"
#include "kestrel/dictionary/ValueLabelSet.h"
#include "kestrel/dictionary/ValueProbability.h"
#include "kestrel/dictionary/ValueProbabilitySet.h"
#include "kestrel/dictionary/VarStats.h"
#include "tests/dictionary/TestValues.h"

namespace MCKestrel_800 {
namespace {

using V = ScoreDictVar;

constexpr V::VariableType kUnknownType = static_cast<V::VariableType>(3);
constexpr V::MeasureLevel kUnknownLevel = static_cast<V::MeasureLevel>(9);

TEST(DictVar, StartsWithTheDocumentedValues) {
  DictVar var("x", V::kNUMERIC_VAR);
  const DictVar& constant = var;
  EXPECT_EQ(var.GetName(), "x");
  EXPECT_EQ(var.GetLabel(), "");
  EXPECT_EQ(var.GetVarType(), V::kNUMERIC_VAR);
  EXPECT_EQ(var.GetDateTimeType(), kNoDateTime);
  EXPECT_EQ(var.GetNumericDataType(), V::kUnspecified);
  EXPECT_EQ(var.GetMLevel(), V::kContinuous);
  EXPECT_EQ(var.GetDecimal(), 0);
  EXPECT_EQ(var.GetWidth(), -1);
  EXPECT_EQ(var.GetMissingValues(), nullptr);
  EXPECT_EQ(var.GetValueLabels(), nullptr);
  EXPECT_EQ(var.GetVarStats(), nullptr);
  EXPECT_EQ(var.GetValueIndex(), -1);
  EXPECT_EQ(var.GetEncodedValueIndex(), -1);
  EXPECT_FALSE(var.GetNoSpaceTrim());
  EXPECT_FALSE(var.GetEmptyStringOK());
  EXPECT_EQ(var.GetXMeasure(), "");
  EXPECT_FALSE(var.IsFlagVariable());
  EXPECT_TRUE(var.IsUsageTypeEnable());
  EXPECT_EQ(var.GetOutlierHandleMethod(), 0);
  EXPECT_EQ(var.GetDefValue(), nullptr);
  EXPECT_EQ(var.GetValueProbabilities(), nullptr);
  EXPECT_EQ(var.GetEncoder(), nullptr);
  EXPECT_EQ(constant.GetEncoder(), nullptr);
  EXPECT_FALSE(var.IsEmptyCateValues());
  EXPECT_EQ(var.GetFalgTypeTrueValue(), "");
  EXPECT_FALSE(var.IsDerivedVariable());
  EXPECT_EQ(var.GetNumberOfCats(), 1);
}

TEST(DictVar, EnumerationsHaveTheirFixedNumbers) {
  EXPECT_EQ(static_cast<int>(V::kNUMERIC_VAR), 0);
  EXPECT_EQ(static_cast<int>(V::STRING_VAR), 1);
  EXPECT_EQ(static_cast<int>(V::kDATETIME_VAR), 4);
  EXPECT_EQ(static_cast<int>(V::kContinuous), 0);
  EXPECT_EQ(static_cast<int>(V::kOrdinal), 1);
  EXPECT_EQ(static_cast<int>(V::kNominal), 2);
  EXPECT_EQ(static_cast<int>(V::DateTimeType::kDateTimeSecondsSince1980), 12);
}

void SetEveryField(DictVar& var) {
  EXPECT_TRUE(var.SetName("y"));
  var.SetLabel("label");
  var.SetVarType(V::STRING_VAR);
  var.SetDateTimeType(kTime);
  var.SetNumericDataType(V::kInteger);
  var.SetMLevel(V::kNominal);
  var.SetFormat(2, 8);
  var.SetValueIndex(3);
  var.SetEncodedValueIndex(4);
  var.SetNoSpaceTrim(true);
  var.SetEmptyStringOK(true);
  var.SetXMeasure("m");
  EXPECT_TRUE(var.SetFlagVariable(true));
  var.SetUsageType(false);
  var.SetOutlierHandleMethod(V::kAsExtremeValues);
  var.SetEmptyCateValues(true);
  var.SetFalgTypeTrueValue("yes");
  auto* missing = new MissingValueSet;
  missing->Add(NewSingle("n/a"));
  var.SetMissingValues(missing);
  EXPECT_TRUE(var.AddScoreValueLabel(NewText("a"), "A"));
  var.SetVarStats(new VarStats(1, 2, 3, 4));
  var.SetDefValue(NewText("a"));
  auto* probabilities = new ValueProbabilitySet;
  probabilities->Add(new ValueProbability(NewText("a"), 0.5));
  var.SetValueProbabilities(probabilities);
  auto* encoder = new ScoreCatNumericEncoder;
  encoder->Encode(7.0);
  var.SetEncoder(encoder);
}

void ExpectEveryField(const DictVar& var) {
  EXPECT_EQ(var.GetName(), "y");
  EXPECT_EQ(var.GetLabel(), "label");
  EXPECT_EQ(var.GetVarType(), V::STRING_VAR);
  EXPECT_TRUE(var.IsString());
  EXPECT_EQ(var.GetDateTimeType(), kTime);
  EXPECT_EQ(var.GetNumericDataType(), V::kInteger);
  EXPECT_EQ(var.GetMLevel(), V::kNominal);
  EXPECT_EQ(var.GetDecimal(), 2);
  EXPECT_EQ(var.GetWidth(), 8);
  EXPECT_EQ(var.GetValueIndex(), 3);
  EXPECT_EQ(var.GetEncodedValueIndex(), 4);
  EXPECT_TRUE(var.GetNoSpaceTrim());
  EXPECT_TRUE(var.GetEmptyStringOK());
  EXPECT_EQ(var.GetXMeasure(), "m");
  EXPECT_TRUE(var.IsFlagVariable());
  EXPECT_FALSE(var.IsUsageTypeEnable());
  EXPECT_EQ(var.GetOutlierHandleMethod(), 2);
  EXPECT_TRUE(var.IsEmptyCateValues());
  EXPECT_EQ(var.GetFalgTypeTrueValue(), "yes");
  const StringValue a("a");
  const StringValue absent("n/a");
  EXPECT_TRUE(var.IsMissingValue(&absent));
  EXPECT_TRUE(var.IsValidValue(&a));
  EXPECT_EQ(var.GetLabelOfValue(&a), "A");
  EXPECT_EQ(var.GetVarStats()->GetStddev(), 4);
  EXPECT_EQ(var.GetDefValue()->GetString(), "a");
  EXPECT_EQ(var.GetValueProbabilities()->GetProbabilityOfValue(&a), 0.5);
  EXPECT_EQ(var.GetEncoder()->DecodeNum(0), 7);
  EXPECT_EQ(var.GetNumberOfCats(), 1);
}

TEST(DictVar, HoldsWhatItsSettersAreGiven) {
  DictVar var("x", V::kNUMERIC_VAR);
  SetEveryField(var);
  ExpectEveryField(var);
  var.SetDecimal(5);
  var.SetWidth(9);
  EXPECT_EQ(var.GetDecimal(), 5);
  EXPECT_EQ(var.GetWidth(), 9);
}

TEST(DictVar, CopiesAreDeepAndAssignmentFreesWhatWasOwned) {
  auto var = std::make_unique<DictVar>("x", V::kNUMERIC_VAR);
  SetEveryField(*var);
  const DictVar copy(*var);
  const std::unique_ptr<DictVar> clone(var->Clone());
  DictVar assigned("old", V::kNUMERIC_VAR);
  SetEveryField(assigned);
  assigned.SetName("old");
  assigned = *var;
  EXPECT_NE(copy.GetMissingValues(), var->GetMissingValues());
  EXPECT_NE(copy.GetValueLabels(), var->GetValueLabels());
  EXPECT_NE(copy.GetVarStats(), var->GetVarStats());
  EXPECT_NE(copy.GetDefValue(), var->GetDefValue());
  EXPECT_NE(copy.GetValueProbabilities(), var->GetValueProbabilities());
  EXPECT_NE(copy.GetEncoder(), static_cast<const DictVar&>(*var).GetEncoder());
  var.reset();
  ExpectEveryField(copy);
  ExpectEveryField(*clone);
  ExpectEveryField(assigned);
  const DictVar& same = assigned;
  assigned = same;
  ExpectEveryField(assigned);
  assigned = DictVar("bare", V::kNUMERIC_VAR);
  EXPECT_EQ(assigned.GetMissingValues(), nullptr);
  EXPECT_EQ(assigned.GetEncoder(), nullptr);
  const NumericValue one(1);
  EXPECT_TRUE(assigned.IsValidValue(&one));
}

TEST(DictVar, SettersLeaveTheFormerObjectToTheCaller) {
  DictVar var("x", V::kNUMERIC_VAR);
  SetEveryField(var);
  const std::unique_ptr<ScoreMissingValueSet> missing(var.GetMissingValues());
  const std::unique_ptr<ScoreValueLabelSet> labels(var.GetValueLabels());
  const std::unique_ptr<ScoreVarStats> stats(var.GetVarStats());
  const std::unique_ptr<ScoreValue> value(var.GetDefValue());
  const std::unique_ptr<ScoreValueProbabilitySet> probabilities(var.GetValueProbabilities());
  const std::unique_ptr<ScoreEncoder> encoder(var.GetEncoder());
  var.SetMissingValues(nullptr);
  var.SetValueLabels(new ValueLabelSet);
  var.SetVarStats(new VarStats);
  var.SetDefValue(nullptr);
  var.SetValueProbabilities(new ValueProbabilitySet);
  var.SetEncoder(nullptr);
  EXPECT_EQ(missing->Size(), 1u);
  EXPECT_EQ(labels->Size(), 1u);
  const StringValue absent("n/a");
  EXPECT_FALSE(var.IsMissingValue(&absent));
}

TEST(DictVar, EqualityIsThatOfTheNames) {
  const DictVar a("a", V::kNUMERIC_VAR);
  const DictVar alsoA("a", V::STRING_VAR);
  const DictVar upper("A", V::kNUMERIC_VAR);
  EXPECT_TRUE(a == alsoA);
  EXPECT_FALSE(a == upper);
}

TEST(DictVar, RefusesAnEmptyName) {
  DictVar var("x", V::kNUMERIC_VAR);
  EXPECT_FALSE(var.SetName(""));
  EXPECT_EQ(var.GetName(), "x");
}

TEST(DictVar, TextFlagsAreForTextVariablesAlone) {
  for (const V::VariableType type : {V::kNUMERIC_VAR, V::STRING_VAR, V::kDATETIME_VAR, kUnknownType}) {
    DictVar var("x", type);
    var.SetNoSpaceTrim(true);
    var.SetEmptyStringOK(true);
    EXPECT_EQ(var.GetNoSpaceTrim(), type == V::STRING_VAR) << type;
    EXPECT_EQ(var.GetEmptyStringOK(), type == V::STRING_VAR) << type;
    EXPECT_EQ(var.IsString(), type == V::STRING_VAR) << type;
  }
}

TEST(DictVar, OnlyACategoricalVariableIsAFlag) {
  DictVar var("x", V::kNUMERIC_VAR);
  EXPECT_FALSE(var.SetFlagVariable(true));
  EXPECT_FALSE(var.IsFlagVariable());
  var.SetMLevel(kUnknownLevel);
  EXPECT_FALSE(var.SetFlagVariable(true));
  for (const V::MeasureLevel level : {V::kOrdinal, V::kNominal}) {
    var.SetMLevel(level);
    EXPECT_TRUE(var.SetFlagVariable(true));
    EXPECT_TRUE(var.IsFlagVariable());
    EXPECT_TRUE(var.SetFlagVariable(false));
  }
}

TEST(DictVar, NumberOfCatsFollowsLevelAndLabels) {
  DictVar var("x", V::kNUMERIC_VAR);
  EXPECT_EQ(var.GetNumberOfCats(), 1);
  var.SetMLevel(V::kNominal);
  EXPECT_EQ(var.GetNumberOfCats(), 0);
  var.AddScoreValueLabel(NewNumber(1), "one");
  var.AddScoreValueLabel(NewNumber(2), "two");
  EXPECT_EQ(var.GetNumberOfCats(), 2);
  var.SetMLevel(V::kContinuous);
  EXPECT_EQ(var.GetNumberOfCats(), 1);
}

TEST(DictVar, LabelOfValueIsEmptyWithoutLabels) {
  DictVar var("x", V::kNUMERIC_VAR);
  const NumericValue one(1);
  EXPECT_EQ(var.GetLabelOfValue(&one), "");
  var.AddScoreValueLabel(NewNumber(1), "one");
  EXPECT_EQ(var.GetLabelOfValue(&one), "one");
  EXPECT_EQ(var.GetLabelOfValue(nullptr), "");
}

TEST(DictVar, ToMyValueFollowsTheStorageKind) {
  const std::unique_ptr<ScoreValue> number(DictVar("x", V::kNUMERIC_VAR).ToMyValue("2.5"));
  EXPECT_EQ(number->GetType(), ScoreValue::kNumeric);
  EXPECT_EQ(number->GetDouble(), 2.5);
  const std::unique_ptr<ScoreValue> none(DictVar("x", V::kNUMERIC_VAR).ToMyValue("abc"));
  EXPECT_TRUE(none->IsSystemMissingValue());
  const std::unique_ptr<ScoreValue> text(DictVar("x", V::STRING_VAR).ToMyValue("2.5 "));
  EXPECT_EQ(text->GetType(), ScoreValue::kString);
  EXPECT_EQ(text->GetString(), "2.5 ");
  EXPECT_EQ(DictVar("x", V::kDATETIME_VAR).ToMyValue("2.5"), nullptr);
  EXPECT_EQ(DictVar("x", kUnknownType).ToMyValue("2.5"), nullptr);
}

TEST(DictVar, AddScoreValueLabelKeepsTheOwnershipRules) {
  DictVar var("x", V::kNUMERIC_VAR);
  EXPECT_FALSE(var.AddScoreValueLabel(nullptr, "label"));
  ASSERT_NE(var.GetValueLabels(), nullptr);
  EXPECT_EQ(var.GetValueLabels()->Size(), 0u);

  DictVar other("x", V::kNUMERIC_VAR);
  const std::unique_ptr<ScoreValue> refused(NewNumber(1));
  EXPECT_FALSE(other.AddScoreValueLabel(refused.get(), ""));
  ASSERT_NE(other.GetValueLabels(), nullptr);
  EXPECT_EQ(other.GetValueLabels()->Size(), 0u);
  EXPECT_EQ(refused->GetDouble(), 1);

  EXPECT_TRUE(var.AddScoreValueLabel(NewNumber(1), "one"));
  // A duplicate is deleted: the leak check of the sanitizer build watches it.
  EXPECT_FALSE(var.AddScoreValueLabel(NewNumber(1), "again"));
  EXPECT_EQ(var.GetValueLabels()->Size(), 1u);
  const NumericValue one(1);
  EXPECT_EQ(var.GetLabelOfValue(&one), "one");
}

TEST(DictVar, AddScoreValueLabelFreesTheValueWhenAForeignSetRefuses) {
  DictVar var("x", V::kNUMERIC_VAR);
  auto* set = new ForeignLabelSet;
  set->refuses = true;
  var.SetValueLabels(set);
  EXPECT_FALSE(var.AddScoreValueLabel(NewNumber(1), "one"));
  set->refuses = false;
  EXPECT_TRUE(var.AddScoreValueLabel(NewNumber(1), "one"));
  EXPECT_FALSE(var.AddScoreValueLabel(NewNumber(1), "one"));
}

enum Sets { kOwnSets, kForeignSets };

/// A variable with labels for 1 and 2 (as numbers, texts or dates) and a missing range of 1 to 9.
std::unique_ptr<DictVar> LabelledVar(V::VariableType type, Sets sets) {
  auto var = std::make_unique<DictVar>("x", type);
  var->SetMLevel(V::kNominal);
  ScoreMissingValueSet* missing = nullptr;
  if (sets == kForeignSets) {
    missing = new ForeignMissingSet;
    auto* labels = new ForeignLabelSet;
    labels->Add(nullptr);
    labels->Add(new ForeignLabel(nullptr, "no value"));
    var->SetValueLabels(labels);
  } else {
    missing = new MissingValueSet;
  }
  for (const int i : {1, 2}) {
    ScoreValue* value = nullptr;
    if (type == V::STRING_VAR) value = NewText(std::to_string(i));
    if (type == V::kNUMERIC_VAR) value = NewNumber(i);
    if (type == V::kDATETIME_VAR) value = NewDate(i);
    var->AddScoreValueLabel(value, "label");
  }
  missing->Add(new Range(1, 9, true, true));
  for (const int i : {1, 5}) {
    missing->Add(NewSingle(std::to_string(i)));
    missing->Add(new Range(NewDate(i)));
  }
  var->SetMissingValues(missing);
  return var;
}

TEST(DictVar, ALabelledNumberIsNeverUserMissingButALabelledTextIs) {
  struct Row {
    V::VariableType type;
    std::shared_ptr<ScoreValue> value;
    bool missing;
    bool valid;
    const char* why;
  };
  const auto number = [](double d) { return std::make_shared<NumericValue>(d); };
  const auto text = [](const char* t) { return std::make_shared<StringValue>(t); };
  const auto date = [](double d) { return std::make_shared<DateTimeValue>(d, kDateTimeVal); };
  const Row rows[] = {
      {V::kNUMERIC_VAR, number(1), false, true, "the label wins"},
      {V::kNUMERIC_VAR, number(5), true, false, "in the missing range"},
      {V::kNUMERIC_VAR, number(3), true, false, "in the missing range, no label"},
      {V::kNUMERIC_VAR, number(2), false, true, "the label wins"},
      {V::kNUMERIC_VAR, number(10), false, false, "outside the range, but no category"},
      {V::kNUMERIC_VAR, number(NumericValue::gSysmisValue), true, false, "system-missing"},
      {V::kNUMERIC_VAR, text("1"), true, false, "a text is missing as a single value, and no category"},
      {V::STRING_VAR, text("1"), true, false, "missing although it carries a label"},
      {V::STRING_VAR, text("5"), true, false, "missing"},
      {V::STRING_VAR, text("2"), false, true, "a category"},
      {V::STRING_VAR, text("2 "), false, true, "trailing blanks do not count"},
      {V::STRING_VAR, text("3"), false, false, "no category"},
      {V::STRING_VAR, number(NumericValue::gSysmisValue), false, false, "no marker for a text variable"},
      {V::kDATETIME_VAR, date(1), false, true, "the label wins"},
      {V::kDATETIME_VAR, date(5), true, false, "missing"},
      {V::kDATETIME_VAR, date(7), false, false, "no category"},
      {V::kDATETIME_VAR, date(NumericValue::gSysmisValue), true, false, "system-missing"},
      {V::kDATETIME_VAR, nullptr, true, false, "null"},
      {V::STRING_VAR, nullptr, true, false, "null"},
  };
  for (const Sets sets : {kOwnSets, kForeignSets}) {
    for (const Row& row : rows) {
      const auto var = LabelledVar(row.type, sets);
      EXPECT_EQ(var->IsMissingValue(row.value.get()), row.missing) << row.type << " " << row.why;
      EXPECT_EQ(var->IsValidValue(row.value.get()), row.valid) << row.type << " " << row.why;
    }
  }
}

TEST(DictVar, TheOutsideOfTheRangeIsNotValidWithoutALabel) {
  DictVar var("x", V::kNUMERIC_VAR);
  var.SetMLevel(V::kNominal);
  var.AddScoreValueLabel(NewNumber(1), "one");
  var.AddScoreValueLabel(NewNumber(2), "two");
  const NumericValue three(3);
  EXPECT_FALSE(var.IsMissingValue(&three));
  EXPECT_FALSE(var.IsValidValue(&three));
}

TEST(DictVar, SystemMissingIsMissingWhereTheVariableIsNoText) {
  const NumericValue missing;
  EXPECT_TRUE(DictVar("x", V::kNUMERIC_VAR).IsMissingValue(&missing));
  EXPECT_TRUE(DictVar("x", V::kDATETIME_VAR).IsMissingValue(&missing));
  EXPECT_FALSE(DictVar("x", V::STRING_VAR).IsMissingValue(&missing));
  EXPECT_FALSE(DictVar("x", kUnknownType).IsMissingValue(&missing));
}

TEST(DictVar, ALabelOnSystemMissingDoesNotMakeItPresent) {
  DictVar var("x", V::kNUMERIC_VAR);
  var.SetMLevel(V::kNominal);
  var.AddScoreValueLabel(new NumericValue, "missing");
  const NumericValue missing;
  EXPECT_TRUE(var.IsMissingValue(&missing));
}

TEST(DictVar, ValidityWithoutLabelsFollowsTheValueType) {
  const NumericValue number(1);
  const StringValue text("a");
  const DateTimeValue date(1.0, kDateVal);
  struct Row {
    V::VariableType type;
    const ScoreValue* value;
    bool valid;
  };
  const Row rows[] = {
      {V::kNUMERIC_VAR, &number, true},   {V::kNUMERIC_VAR, &date, true},  {V::kNUMERIC_VAR, &text, false},
      {V::kNUMERIC_VAR, nullptr, false},  {V::STRING_VAR, &number, true},  {V::STRING_VAR, &text, true},
      {V::STRING_VAR, nullptr, false},    {V::kDATETIME_VAR, &text, true}, {V::kDATETIME_VAR, &date, true},
      {V::kDATETIME_VAR, nullptr, false}, {kUnknownType, &number, true},
  };
  for (const Row& row : rows) {
    for (const V::MeasureLevel level : {V::kContinuous, V::kOrdinal, V::kNominal}) {
      DictVar var("x", row.type);
      var.SetMLevel(level);
      EXPECT_EQ(var.IsValidValue(row.value), row.valid) << row.type << " " << level;
      // A set without entries counts as none.
      var.SetValueLabels(new ValueLabelSet);
      EXPECT_EQ(var.IsValidValue(row.value), row.valid) << row.type << " " << level;
    }
  }
}

TEST(DictVar, AContinuousVariableWithLabelsTakesWhateverIsNotMissing) {
  DictVar var("x", V::kNUMERIC_VAR);
  var.AddScoreValueLabel(NewNumber(1), "one");
  const NumericValue five(5);
  const NumericValue missing;
  const StringValue text("a");
  EXPECT_TRUE(var.IsValidValue(&five));
  EXPECT_TRUE(var.IsValidValue(&text));
  EXPECT_FALSE(var.IsValidValue(&missing));
}

TEST(DictVar, NoSpaceTrimMatchesCategoriesExactly) {
  for (const bool exact : {false, true}) {
    DictVar var("x", V::STRING_VAR);
    var.SetMLevel(V::kNominal);
    var.SetNoSpaceTrim(exact);
    var.AddScoreValueLabel(NewText("a"), "A");
    var.AddScoreValueLabel(NewText("b "), "B");
    struct Row {
      const char* text;
      bool exactly;
      bool trimmed;
    };
    for (const Row& row : {Row{"a", true, true}, Row{"a ", false, true}, Row{"b", false, true},
                           Row{"b ", true, true}, Row{" a", false, false}, Row{"", false, false}}) {
      const StringValue value(row.text);
      EXPECT_EQ(var.IsValidValue(&value), exact ? row.exactly : row.trimmed) << row.text;
    }
  }
}

TEST(DictVar, ANumberAmongTheCategoriesOfATextVariableMatchesEverything) {
  // `Equal` of a number is true whatever it is asked.
  DictVar var("x", V::STRING_VAR);
  var.SetMLevel(V::kNominal);
  for (int i = 0; i < 40; ++i)
    var.AddScoreValueLabel(NewText("t" + std::to_string(i)), "text");
  const StringValue other("other");
  EXPECT_FALSE(var.IsValidValue(&other));
  var.AddScoreValueLabel(NewNumber(1), "number");
  EXPECT_TRUE(var.IsValidValue(&other));
  const ValueLbl number(NewNumber(1), "number");
  EXPECT_TRUE(var.GetValueLabels()->Remove(&number));
  EXPECT_FALSE(var.IsValidValue(&other));
}

/// The rules of missing and valid values as they read, over plain lists.
struct PlainRules {
  const DictVar& var;

  bool IsMissing(const ScoreValue* value) const {
    const bool numericLike = !var.IsString();
    if (numericLike && value->IsSystemMissingValue()) return true;
    bool missing = false;
    for (const ScoreValueRange* range : var.GetMissingValues()->GetMissingValues()) {
      missing = missing || range->IsInRange(value);
    }
    if (!missing || !numericLike) return missing;
    for (const ScoreValueLabel* label : var.GetValueLabels()->GetAllValueLabels()) {
      if (*value == *label->GetValue()) return false;
    }
    return true;
  }
  bool IsValid(const ScoreValue* value) const {
    if (IsMissing(value)) return false;
    for (const ScoreValueLabel* label : var.GetValueLabels()->GetAllValueLabels()) {
      const ScoreValue* own = label->GetValue();
      if (var.IsString() ? own->Equal(value, var.GetNoSpaceTrim(), false) : *value == *own) return true;
    }
    return false;
  }
};

TEST(DictVar, LargeSetsGiveTheAnswersOfAWalk) {
  for (const V::VariableType type : {V::kNUMERIC_VAR, V::STRING_VAR}) {
    for (const bool noSpaceTrim : {false, true}) {
      DictVar var("x", type);
      var.SetMLevel(V::kOrdinal);
      var.SetNoSpaceTrim(noSpaceTrim);
      auto* missing = new MissingValueSet;
      var.SetMissingValues(missing);
      const auto value = [&](int i) -> std::unique_ptr<ScoreValue> {
        if (type == V::kNUMERIC_VAR) return std::make_unique<NumericValue>(i * (1 + (i % 3) * 1e-14));
        return std::make_unique<StringValue>("v" + std::to_string(i) +
                                             std::string(static_cast<std::size_t>(i % 3), ' '));
      };
      for (int i = 0; i < 600; i += 2)
        var.AddScoreValueLabel(value(i).release(), "label");
      for (int i = 0; i < 600; i += 3)
        missing->Add(new Range(value(i).release()));
      missing->Add(new Range(250, 260, true, false));
      const PlainRules rules{var};
      for (int i = 0; i < 700; ++i) {
        for (const int shift : {0, 1}) {
          std::unique_ptr<ScoreValue> asked = value(i);
          if (shift != 0 && type == V::kNUMERIC_VAR)
            asked = std::make_unique<NumericValue>(i * (1 + 2.2e-14));
          if (shift != 0 && type == V::STRING_VAR)
            asked = std::make_unique<StringValue>("v" + std::to_string(i) + " ");
          ASSERT_EQ(var.IsMissingValue(asked.get()), rules.IsMissing(asked.get()))
              << type << " " << i << " " << shift;
          ASSERT_EQ(var.IsValidValue(asked.get()), rules.IsValid(asked.get()))
              << type << " " << i << " " << shift;
        }
      }
    }
  }
}

TEST(DictVar, DisplayNamesTypeAndLevel) {
  struct Row {
    V::VariableType type;
    V::MeasureLevel level;
    const char* text;
  };
  const Row rows[] = {
      {V::kNUMERIC_VAR, V::kContinuous, "Var Type = kNUMERIC_VAR; Var level =  Continuous; \n"},
      {V::STRING_VAR, V::kOrdinal, "Var Type = STRING_VAR; Var level =  Ordinal; \n"},
      {V::kDATETIME_VAR, V::kNominal, "Var level =  Nominal; \n"},
      {kUnknownType, kUnknownLevel, "Var level = unknown;\n"},
  };
  for (const Row& row : rows) {
    DictVar var("n", row.type);
    var.SetLabel("l");
    var.SetMLevel(row.level);
    EXPECT_EQ(DisplayOf(var), std::string("Start ScoreDictVar Display:\nVar Name = n; Var Lable = l; ") +
                                  row.text + "End of ScoreDictVar Display.\n\n");
  }
}

TEST(DictVar, DisplayShowsLabelsMissingValuesAndMeasureInThatOrder) {
  DictVar var("n", V::STRING_VAR);
  var.SetMLevel(V::kNominal);
  var.AddScoreValueLabel(NewText("a"), "A");
  auto* missing = new MissingValueSet;
  missing->Add(NewSingle("z"));
  var.SetMissingValues(missing);
  var.SetXMeasure("m");
  EXPECT_EQ(DisplayOf(var),
            "Start ScoreDictVar Display:\n"
            "Var Name = n; Var Lable = ; Var Type = STRING_VAR; Var level =  Nominal; \n"
            "Start ScoreValueLabelSet Display:\nValue: a;  Label: A\nEnd of ScoreValueLabelSet Display.\n\n"
            " Begin MissingValueSet Display:\n"
            "  Start Range Display   \nMinValue: z;  MaxValue: z; High End included; lower End included\n"
            " End of Range Display\n\n"
            "End MissingValueSet Display.\n"
            "x-Measure: m\n"
            "End of ScoreDictVar Display.\n\n");
}

}  // namespace
}  // namespace MCKestrel_800
