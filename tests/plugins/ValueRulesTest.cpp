#include "plugins/support/ValueRules.h"

#include <gtest/gtest.h>

#include <limits>
#include <memory>
#include <random>
#include <string>
#include <vector>

#include "kestrel/dictionary/DictVar.h"
#include "kestrel/dictionary/MissingValueSet.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/predicates/Range.h"
#include "kestrel/translate/PMMLTranslator.h"

namespace {

using namespace MCKestrel_800;

/// Draws variables and values from small pools, so that labels, missing values and case values often meet.
class Chance {
 public:
  explicit Chance(unsigned seed) : generator_(seed) {}

  int Below(int count) { return static_cast<int>(generator_() % static_cast<unsigned>(count)); }
  bool OneIn(int count) { return Below(count) == 0; }

  double Number() {
    constexpr double kPool[] = {0.0, -0.0, 1.0, 2.0, 3.0, 5.0, 7.5, 1e-300, -4.0, 1e20, -1e20, 1e308};
    double number = kPool[Below(static_cast<int>(std::size(kPool)))];
    if (OneIn(4)) number *= 1.0 + (Below(5) - 2) * 1.1e-14;
    if (OneIn(30)) number = std::numeric_limits<double>::infinity();
    if (OneIn(30)) number = -std::numeric_limits<double>::infinity();
    if (OneIn(30)) number = std::numeric_limits<double>::quiet_NaN();
    if (OneIn(20)) number = NumericValue::gSysmisValue;
    return number;
  }

  std::string Text() {
    constexpr const char* kPool[] = {
        "", "a", "b", " a", "ab", "a longer text than eight", "a longer text than nine", "1", "\xC3\xA4"};
    std::string text = kPool[Below(static_cast<int>(std::size(kPool)))];
    if (OneIn(3)) text.append(static_cast<size_t>(1 + Below(3)), ' ');
    return text;
  }

  /// A value of the variable's kind as a rule, of any kind at times.
  std::unique_ptr<ScoreValue> Value(const ScoreDictVar& variable) {
    int kind = variable.GetVarType() == ScoreDictVar::STRING_VAR ? 1 : 0;
    if (variable.GetVarType() == ScoreDictVar::kDATETIME_VAR && OneIn(2)) kind = 2;
    if (OneIn(6)) kind = Below(3);
    if (kind == 0) return std::make_unique<NumericValue>(Number());
    if (kind == 1) return std::make_unique<StringValue>(Text());
    return std::make_unique<DateTimeValue>(Number(), kDateTimeSecondsSince1970);
  }

  std::unique_ptr<DictVar> Variable() {
    constexpr ScoreDictVar::VariableType kTypes[] = {ScoreDictVar::kNUMERIC_VAR, ScoreDictVar::STRING_VAR,
                                                     ScoreDictVar::kNUMERIC_VAR, ScoreDictVar::kDATETIME_VAR};
    auto variable = std::make_unique<DictVar>("v", kTypes[Below(4)]);
    variable->SetMLevel(static_cast<ScoreDictVar::MeasureLevel>(Below(3)));
    if (OneIn(3)) variable->SetNoSpaceTrim(true);
    if (OneIn(2)) variable->SetEmptyStringOK(true);
    if (!OneIn(3)) AddMissing(*variable);
    if (!OneIn(3)) AddLabels(*variable);
    if (!OneIn(4)) PMMLTranslator::SetupCatEncoder(variable.get());
    return variable;
  }

 private:
  void AddMissing(DictVar& variable) {
    auto missing = std::make_unique<MissingValueSet>();
    for (int i = Below(4); i > 0; --i) {
      std::unique_ptr<Range> range;
      const int kind = Below(4);
      if (kind == 0) range = std::make_unique<Range>(Value(variable).release());
      if (kind == 1) range = std::make_unique<Range>(Number(), Number(), OneIn(2), OneIn(2));
      if (kind == 2) {
        range =
            std::make_unique<Range>(Value(variable).release(), Value(variable).release(), OneIn(2), OneIn(2));
      }
      if (kind == 3) range = std::make_unique<Range>(nullptr, new NumericValue(Number()), OneIn(2), OneIn(2));
      if (missing->Add(range.get())) range.release();
    }
    variable.SetMissingValues(missing.release());
  }

  void AddLabels(DictVar& variable) {
    for (int i = Below(6); i >= 0; --i) {
      std::unique_ptr<ScoreValue> value = Value(variable);
      if (i == 0 && OneIn(2)) {
        // An empty label is refused, but leaves an empty set where there was none.
        variable.AddScoreValueLabel(value.get(), "");
      } else {
        variable.AddScoreValueLabel(value.release(), "label");
      }
    }
  }

  std::mt19937 generator_;
};

std::string Describe(const ScoreDictVar& variable, const ScoreValue& value) {
  std::string text =
      "value of type " + std::to_string(value.GetType()) + ": \"" + value.GetString() + "\"; variable ";
  text += std::to_string(variable.GetVarType()) + ", level " + std::to_string(variable.GetMLevel());
  if (variable.GetValueLabels() != nullptr) {
    for (const ScoreValueLabel* label : variable.GetValueLabels()->GetAllValueLabels()) {
      text += ", label \"" + label->GetValue()->GetString() + "\"";
    }
  }
  return text;
}

/// The first category that the value matches, both of the variable's own kind; null when there is none.
const ScoreValue* FirstLabelOf(const ScoreDictVar& variable, const ScoreValue& value) {
  if (variable.GetMLevel() == ScoreDictVar::kContinuous || variable.GetValueLabels() == nullptr)
    return nullptr;
  for (const ScoreValueLabel* label : variable.GetValueLabels()->GetAllValueLabels()) {
    const ScoreValue* listed = label->GetValue();
    const bool is_match = variable.GetVarType() == ScoreDictVar::STRING_VAR
                              ? listed->Equal(&value, variable.GetNoSpaceTrim(), variable.GetEmptyStringOK())
                              : value == *listed;
    if (!is_match) continue;
    const bool fits = value.GetType() == listed->GetType() &&
                      static_cast<int>(value.GetType()) == static_cast<int>(variable.GetVarType());
    return fits ? listed : nullptr;
  }
  return nullptr;
}

TEST(ValueRules, SayWhatTheVariableSays) {
  Chance chance(20261121);
  int seen[3] = {};
  int codes_seen = 0;
  for (int round = 0; round < 6000; ++round) {
    const std::unique_ptr<DictVar> variable = chance.Variable();
    ValueRules rules(*variable);
    rules.Seal();
    EXPECT_EQ(rules.Judge(nullptr), ValueRules::kMissing);
    for (int i = 0; i < 30; ++i) {
      const std::unique_ptr<ScoreValue> value = chance.Value(*variable);
      const ValueRules::Verdict expected = variable->IsMissingValue(value.get()) ? ValueRules::kMissing
                                           : variable->IsValidValue(value.get()) ? ValueRules::kValid
                                                                                 : ValueRules::kInvalid;
      const ValueRules::Verdict actual = rules.Judge(value.get());
      ASSERT_EQ(actual, expected) << Describe(*variable, *value) << ", round " << round;
      ++seen[actual];
      const ScoreValue* label = expected == ValueRules::kValid ? FirstLabelOf(*variable, *value) : nullptr;
      if (label == nullptr || variable->GetEncoder() == nullptr) continue;
      ++codes_seen;
      ASSERT_EQ(rules.FindCode(*value), variable->GetEncoder()->EncodeConst(label))
          << Describe(*variable, *value) << ", round " << round;
    }
  }
  for (const int count : seen)
    EXPECT_GT(count, 5000);
  EXPECT_GT(codes_seen, 5000);
}

TEST(ValueRules, AddedCategoriesGetTheNextCodes) {
  const DictVar text("t", ScoreDictVar::STRING_VAR);
  ValueRules rules(text);
  EXPECT_EQ(rules.AddCategory(StringValue("b")), 0);
  EXPECT_EQ(rules.AddCategory(StringValue("a")), 1);
  EXPECT_EQ(rules.AddCategory(StringValue("b  ")), 0);
  EXPECT_EQ(rules.AddCategory(NumericValue(1.0)), ValueRules::kUnknown);
  rules.Seal();
  EXPECT_EQ(rules.GetCodeCount(), 2);
  EXPECT_EQ(rules.FindCode(StringValue("a ")), 1);
  EXPECT_EQ(rules.FindCode(StringValue("c")), ValueRules::kUnknown);

  const DictVar number("n", ScoreDictVar::kNUMERIC_VAR);
  ValueRules numbers(number);
  EXPECT_EQ(numbers.AddCategory(NumericValue(3.0)), 0);
  EXPECT_EQ(numbers.AddCategory(NumericValue(1.0)), 1);
  EXPECT_EQ(numbers.AddCategory(NumericValue(3.0 * (1.0 + 1e-15))), 0);
  EXPECT_EQ(numbers.AddCategory(NumericValue(std::numeric_limits<double>::infinity())), ValueRules::kUnknown);
  EXPECT_EQ(numbers.AddCategory(StringValue("3")), ValueRules::kUnknown);
  numbers.Seal();
  EXPECT_EQ(numbers.FindCode(NumericValue(1.0)), 1);
  EXPECT_EQ(numbers.FindCode(NumericValue(2.0)), ValueRules::kUnknown);
}

TEST(ValueRules, AListOfCategoriesTakesNoMore) {
  DictVar variable("g", ScoreDictVar::STRING_VAR);
  variable.SetMLevel(ScoreDictVar::kNominal);
  variable.AddScoreValueLabel(new StringValue("a"), "A");
  ValueRules rules(variable);
  EXPECT_EQ(rules.AddCategory(StringValue("a")), 0);
  EXPECT_EQ(rules.AddCategory(StringValue("z")), ValueRules::kUnknown);
  rules.Seal();
  EXPECT_EQ(rules.GetCodeCount(), 1);
  EXPECT_EQ(rules.JudgeText("z"), ValueRules::kInvalid);
}

TEST(TextCodes, FindsEachOfManyTexts) {
  TextCodes codes(false);
  EXPECT_EQ(codes.Find("anything"), TextCodes::kUnknown);
  for (int i = 0; i < 20000; ++i)
    EXPECT_EQ(codes.Add("category " + std::to_string(i * 7), i), i);
  for (int i = 0; i < 20000; ++i)
    ASSERT_EQ(codes.Find("category " + std::to_string(i * 7) + " "), i);
  EXPECT_EQ(codes.Find("category 1"), TextCodes::kUnknown);
  EXPECT_EQ(codes.Find(std::string("category 0\0", 11)), TextCodes::kUnknown);
}

TEST(NumberCodes, FindsEachOfManyNumbers) {
  NumberCodes codes;
  for (int i = 0; i < 20000; ++i)
    EXPECT_EQ(codes.Add((i * 7919) % 20011, i), i);
  codes.Seal();
  for (int i = 0; i < 20000; ++i)
    ASSERT_EQ(codes.Find((i * 7919) % 20011), i);
  EXPECT_EQ(codes.Find(0.5), NumberCodes::kUnknown);
}

}  // namespace
