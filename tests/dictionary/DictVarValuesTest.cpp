// Which values of a case a variable takes for missing and for valid.

#include <gtest/gtest.h>

#include <memory>

#include "kestrel/dictionary/DictVar.h"
#include "kestrel/dictionary/MissingValueSet.h"
#include "kestrel/dictionary/ValueLabelSet.h"
#include "tests/dictionary/TestValues.h"

namespace MCKestrel_800 {
namespace {

using V = ScoreDictVar;

constexpr V::VariableType kUnknownType = static_cast<V::VariableType>(3);

enum Sets { kOwnSets, kForeignSets };

/// A variable with labels for 1 and 2 (as numbers, texts or dates) and a missing range of 1 to 9.
std::unique_ptr<DictVar> LabelledVar(V::VariableType type, Sets sets) {
  auto var = std::make_unique<DictVar>("x", type);
  var->SetMLevel(V::kNominal);
  ScoreMissingValueSet* missing = nullptr;
  if (sets == kForeignSets) {
    missing = new ForeignMissingSet;
    missing->Add(nullptr);
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

}  // namespace
}  // namespace MCKestrel_800
