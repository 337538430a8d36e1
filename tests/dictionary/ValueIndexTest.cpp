// Look-ups through an index have to answer exactly as a walk over the elements would. Here they are held
// against such walks, over long random sequences of changes, with values at the edge of the tolerance.

#include "kestrel/dictionary/ValueIndex.h"

#include <gtest/gtest.h>

#include <cstring>
#include <limits>
#include <memory>
#include <random>

#include "kestrel/dictionary/DictVar.h"
#include "kestrel/dictionary/MissingValueSet.h"
#include "kestrel/dictionary/ValueLabelSet.h"
#include "kestrel/dictionary/ValueProbabilitySet.h"
#include "tests/dictionary/TestValues.h"

namespace MCKestrel_800 {
namespace {

using Random = std::mt19937;

int Pick(Random& random, int below) {
  return std::uniform_int_distribution<int>(0, below - 1)(random);
}

/// The number some steps (last binary digits) away.
double Steps(double number, int steps) {
  std::int64_t bits;
  std::memcpy(&bits, &number, sizeof(bits));
  bits += steps;
  std::memcpy(&number, &bits, sizeof(bits));
  return number;
}

double AnyNumber(Random& random) {
  static const double kCentres[] = {
      1.0,    2.0,    -2.0, 0.1, 1e300, -1e-300, 3.141592653589793, Steps(1.5, 4096 - 1000),
      1024.0, 1023.5, 7.0,  8.0, 9.0,   1e15};
  static const double kSpecial[] = {0.0,
                                    -0.0,
                                    5e-324,
                                    -5e-324,
                                    NumericValue::gSysmisValue,
                                    Steps(NumericValue::gSysmisValue, -3),
                                    std::numeric_limits<double>::max(),
                                    std::numeric_limits<double>::infinity(),
                                    -std::numeric_limits<double>::infinity(),
                                    std::numeric_limits<double>::quiet_NaN()};
  if (Pick(random, 8) == 0) return kSpecial[Pick(random, 10)];
  if (Pick(random, 4) == 0) return Pick(random, 200) - 100;
  return Steps(kCentres[Pick(random, 14)], Pick(random, 1201) - 600);
}

std::string AnyText(Random& random) {
  static const char* const kTexts[] = {"", "a", "b", "abcdefgh", "abcdefghi", " a", "1", "a\t"};
  return kTexts[Pick(random, 8)] + std::string(static_cast<std::size_t>(Pick(random, 4)), ' ') +
         (Pick(random, 3) == 0 ? std::to_string(Pick(random, 50)) : "");
}

struct Mix {
  int numbers;
  int texts;
  int dates;
  int foreign;
};

std::unique_ptr<ScoreValue> AnyValue(Random& random, const Mix& mix) {
  int pick = Pick(random, mix.numbers + mix.texts + mix.dates + mix.foreign);
  if ((pick -= mix.numbers) < 0) return std::make_unique<NumericValue>(AnyNumber(random));
  if ((pick -= mix.texts) < 0) return std::make_unique<StringValue>(AnyText(random));
  if ((pick -= mix.dates) < 0) return std::make_unique<DateTimeValue>(AnyNumber(random), kDateTimeVal);
  const ScoreValue::ValueType types[] = {ScoreValue::kNumeric, ScoreValue::kString};
  return std::make_unique<WholeValue>(Pick(random, 20), types[Pick(random, 2)]);
}

const Mix kMixes[] = {{1, 0, 0, 0}, {0, 1, 0, 0}, {0, 0, 1, 0}, {4, 4, 2, 0},
                      {8, 8, 4, 1}, {0, 8, 0, 1}, {8, 0, 0, 1}};

/// The first element for which the rule holds, found by walking; -1 when there is none.
template <class Elements, class Rule>
int Walk(const Elements& elements, const Rule& rule) {
  for (std::size_t i = 0; i < elements.size(); ++i) {
    if (elements[i]->GetValue() != nullptr && rule(*elements[i]->GetValue())) return static_cast<int>(i);
  }
  return -1;
}

void ExpectLabelsAnswerAsAWalk(const ValueLabelSet& set, const ScoreValue& value) {
  const auto& labels = set.GetAllValueLabels();
  const int first = Walk(labels, [&](const ScoreValue& own) { return own == value; });
  ASSERT_EQ(set.Contains(&value), first >= 0);
  ASSERT_EQ(set.GetLabelOfValue(&value),
            first < 0 ? "" : labels[static_cast<std::size_t>(first)]->GetLabel());
  ASSERT_EQ(set.ContainsEqualTo(&value),
            Walk(labels, [&](const ScoreValue& own) { return value == own; }) >= 0);
  for (const bool exact : {false, true}) {
    const int equal = Walk(labels, [&](const ScoreValue& own) { return own.Equal(&value, exact, false); });
    ASSERT_EQ(set.ContainsEqual(&value, exact, false), equal >= 0) << value.GetString();
  }
}

/// One random change of a set of labels: mostly additions, so that the set grows past the size where an index
/// starts.
void ChangeLabels(Random& random, const Mix& mix, int serial, std::unique_ptr<ValueLabelSet>& set) {
  const std::string label = "l" + std::to_string(serial);
  const auto& labels = set->GetAllValueLabels();
  const int action = Pick(random, 20);
  if (action < 13 || labels.empty()) {
    std::unique_ptr<ScoreValue> value = AnyValue(random, mix);
    if (Pick(random, 40) == 0) value.reset();
    if (mix.foreign != 0 && Pick(random, 10) == 0) {
      set->Add(new ForeignLabel(value.release(), label));
    } else {
      set->Add(new ValueLbl(value.release(), label));
    }
    return;
  }
  ScoreValueLabel* chosen = labels[static_cast<std::size_t>(Pick(random, static_cast<int>(labels.size())))];
  if (action < 17) {
    const ValueLbl pattern(AnyValue(random, mix).release(), "pattern");
    const ScoreValueLabel* wanted = Pick(random, 2) == 0 ? chosen : &pattern;
    int first = -1;
    for (std::size_t i = 0; i < labels.size() && first < 0; ++i) {
      if (*labels[i] == *wanted) first = static_cast<int>(i);
    }
    const std::string next = first >= 0 && static_cast<std::size_t>(first) + 1 < labels.size()
                                 ? labels[static_cast<std::size_t>(first) + 1]->GetLabel()
                                 : "";
    const std::size_t size = set->Size();
    ASSERT_EQ(set->Remove(wanted), first >= 0);
    ASSERT_EQ(set->Size(), size - (first >= 0 ? 1 : 0));
    if (!next.empty()) {
      ASSERT_EQ(labels[static_cast<std::size_t>(first)]->GetLabel(), next);
    }
  } else if (action == 17) {
    chosen->SetValueLabel(AnyValue(random, mix).release(), label);
  } else if (action == 18) {
    set.reset(set->Clone());
  } else {
    ValueLabelSet other;
    other.Add(new ValueLbl(NewNumber(1), "other"));
    other = *set;
    *set = other;
  }
}

TEST(ValueIndex, LabelSetsAnswerAsAWalkWould) {
  for (std::size_t seed = 0; seed < 7 * 4; ++seed) {
    const Mix& mix = kMixes[seed % 7];
    Random random(static_cast<Random::result_type>(seed));
    auto set = std::make_unique<ValueLabelSet>();
    for (int serial = 0; serial < 400; ++serial) {
      ASSERT_NO_FATAL_FAILURE(ChangeLabels(random, mix, serial, set))
          << "seed " << seed << " step " << serial;
      for (int query = 0; query < 6; ++query) {
        const std::unique_ptr<ScoreValue> value = AnyValue(random, query < 4 ? mix : kMixes[4]);
        ASSERT_NO_FATAL_FAILURE(ExpectLabelsAnswerAsAWalk(*set, *value))
            << "seed " << seed << " step " << serial;
      }
    }
  }
}

TEST(ValueIndex, ProbabilitySetsAnswerAsAWalkWould) {
  for (std::size_t seed = 0; seed < 7; ++seed) {
    Random random(static_cast<Random::result_type>(seed));
    ValueProbabilitySet set;
    for (int serial = 0; serial < 300; ++serial) {
      set.Add(new ValueProbability(AnyValue(random, kMixes[seed]).release(), serial / 300.0));
      if (Pick(random, 5) == 0) {
        const ValueProbability pattern(AnyValue(random, kMixes[seed]).release(), 0);
        set.Remove(&pattern);
      }
      if (Pick(random, 10) == 0 && set.Size() != 0) {
        set.GetAllValueProbabilities().back()->SetValueProbability(AnyValue(random, kMixes[seed]).release(),
                                                                   1);
      }
      const auto& elements = set.GetAllValueProbabilities();
      const std::unique_ptr<ScoreValue> value = AnyValue(random, kMixes[seed]);
      const int first = Walk(elements, [&](const ScoreValue& own) { return own == *value; });
      ASSERT_EQ(set.Contains(value.get()), first >= 0) << "seed " << seed << " step " << serial;
      ASSERT_EQ(set.GetProbabilityOfValue(value.get()),
                first < 0 ? 0.0 : elements[static_cast<std::size_t>(first)]->GetProbability());
    }
  }
}

std::unique_ptr<ScoreValueRange> AnyRange(Random& random, const Mix& mix) {
  const bool low = Pick(random, 2) == 0;
  const bool high = Pick(random, 2) == 0;
  switch (Pick(random, 8)) {
    case 0: {
      const double min = AnyNumber(random);
      return std::make_unique<Range>(min, Pick(random, 2) == 0 ? Steps(min, Pick(random, 300)) : min + 1, low,
                                     high);
    }
    case 1:
      return std::make_unique<Range>(AnyValue(random, mix).release(), AnyValue(random, mix).release(), low,
                                     high);
    case 2:
      return std::make_unique<Range>(
          nullptr, Pick(random, 3) == 0 ? nullptr : AnyValue(random, mix).release(), low, high);
    case 3: {
      const double number = AnyNumber(random);
      return std::make_unique<Range>(number, number, low, high);
    }
    case 4:
      if (mix.foreign != 0) return std::make_unique<WholeRange>(Pick(random, 20));
      [[fallthrough]];
    default:
      return std::make_unique<Range>(AnyValue(random, mix).release());
  }
}

void ExpectRangesAnswerAsAWalk(const MissingValueSet& set, const ScoreValueRange& range,
                               const ScoreValue& value) {
  bool contains = false;
  bool holds = false;
  for (const ScoreValueRange* own : set.GetMissingValues()) {
    contains = contains || *own == range;
    holds = holds || own->IsInRange(&value);
  }
  ASSERT_EQ(set.Contains(&range), contains);
  ASSERT_EQ(set.HoldsValue(&value), holds) << value.GetString();
}

TEST(ValueIndex, MissingValueSetsAnswerAsAWalkWould) {
  for (std::size_t seed = 0; seed < 7 * 4; ++seed) {
    const Mix& mix = kMixes[seed % 7];
    Random random(static_cast<Random::result_type>(seed));
    auto set = std::make_unique<MissingValueSet>();
    for (int serial = 0; serial < 400; ++serial) {
      std::unique_ptr<ScoreValueRange> range = AnyRange(random, mix);
      const std::vector<const ScoreValueRange*> before = set->GetMissingValues();
      const ScoreValueRange* equal = nullptr;
      for (const ScoreValueRange* own : before) {
        if (equal == nullptr && *own == *range) equal = own;
      }
      if (Pick(random, 4) == 0) {
        ASSERT_EQ(set->Remove(range.get()), equal != nullptr) << "seed " << seed << " step " << serial;
        for (const ScoreValueRange* own : set->GetMissingValues())
          ASSERT_NE(own, equal);
      } else {
        ASSERT_EQ(set->Add(range.get()), equal == nullptr) << "seed " << seed << " step " << serial;
        if (equal == nullptr) static_cast<void>(range.release());
      }
      if (Pick(random, 30) == 0) set.reset(set->Clone());
      for (int query = 0; query < 4; ++query) {
        const auto other = AnyRange(random, mix);
        const auto value = AnyValue(random, query < 3 ? mix : kMixes[4]);
        ASSERT_NO_FATAL_FAILURE(ExpectRangesAnswerAsAWalk(*set, *other, *value))
            << "seed " << seed << " step " << serial;
      }
    }
  }
}

TEST(ValueIndex, FindsEveryNumberWithinTheTolerance) {
  // Centres on both sides of a place's edge and of a power of two.
  for (const double centre :
       {1.0, Steps(1.0, 4096), Steps(1.0, 4095), Steps(1.0, 4096 + 128), 2.0, 1e-300, -1.0}) {
    const ValueKey key = [&] {
      const NumericValue value(centre);
      return MakeValueKey(&value);
    }();
    for (int steps = -400; steps <= 400; ++steps) {
      const NumericValue other(Steps(centre, steps));
      if (!NumericValue::IsEqual(centre, other.GetDouble())) continue;
      const ValueKey otherKey = MakeValueKey(&other);
      EXPECT_TRUE(otherKey.own == key.own || otherKey.own == key.neighbour) << centre << " " << steps;
      EXPECT_TRUE(key.own == otherKey.own || key.own == otherKey.neighbour) << centre << " " << steps;
    }
  }
}

TEST(ValueIndex, AChangedLabelIsFoundAtOnceAndTheOldValueNoMore) {
  ValueLabelSet set;
  for (int i = 0; i < 100; ++i)
    set.Add(new ValueLbl(NewNumber(i), std::to_string(i)));
  ScoreValueLabel* label = set.GetAllValueLabels()[50];
  const NumericValue fifty(50);
  const NumericValue thousand(1000);
  label->SetValueLabel(NewNumber(1000), "new");
  EXPECT_FALSE(set.Contains(&fifty));
  EXPECT_EQ(set.GetLabelOfValue(&thousand), "new");
  set.Add(new ValueLbl(NewNumber(50), "again"));
  EXPECT_EQ(set.GetLabelOfValue(&fifty), "again");
  EXPECT_EQ(set.GetLabelOfValue(&thousand), "new");
  // Assignment to a label changes its value too, and a copy of a label does not speak for the set.
  auto* own = static_cast<ValueLbl*>(label);
  *own = ValueLbl(NewNumber(2000), "assigned");
  EXPECT_FALSE(set.Contains(&thousand));
  ValueLbl copy(*own);
  copy.SetValueLabel(NewNumber(3000), "copy");
  const NumericValue twoThousand(2000);
  EXPECT_EQ(set.GetLabelOfValue(&twoThousand), "assigned");
}

TEST(ValueIndex, LargeSetsAreBuiltAndReadInLinearTime) {
  // A walk per value would take some 2 * 10^10 comparisons, minutes at the least.
  constexpr int kCount = 200000;
  DictVar numbers("n", ScoreDictVar::kNUMERIC_VAR);
  DictVar texts("t", ScoreDictVar::STRING_VAR);
  auto* missing = new MissingValueSet;
  numbers.SetMissingValues(missing);
  numbers.SetMLevel(ScoreDictVar::kNominal);
  texts.SetMLevel(ScoreDictVar::kNominal);
  for (int i = 0; i < kCount; ++i) {
    ASSERT_TRUE(numbers.AddScoreValueLabel(NewNumber(i * 0.5), "x"));
    ASSERT_TRUE(texts.AddScoreValueLabel(NewText("category " + std::to_string(i)), "x"));
    ASSERT_TRUE(missing->Add(NewSingle(-1.0 - i)));
    ASSERT_TRUE(missing->Add(new Range(i, i + 1, true, false)));
  }
  EXPECT_FALSE(numbers.AddScoreValueLabel(NewNumber(1.0), "x"));
  EXPECT_FALSE(texts.AddScoreValueLabel(NewText("category 7  "), "x"));
  for (int i = 0; i < kCount; ++i) {
    const NumericValue number(i * 0.5);
    const StringValue text("category " + std::to_string(i) + " ");
    const NumericValue single(-1.0 - i);
    ASSERT_TRUE(texts.IsValidValue(&text));
    ASSERT_TRUE(numbers.GetValueLabels()->Contains(&number));
    ASSERT_TRUE(numbers.IsMissingValue(&single));
  }
}

TEST(ValueIndex, ManyEqualElementsDoNotSlowDownTheirLookUp) {
  constexpr int kCount = 200000;
  ValueProbabilitySet set;
  const NumericValue one(1);
  const NumericValue infinity(NumericValue::gInfinity);
  for (int i = 0; i < kCount; ++i) {
    set.Add(new ValueProbability(NewNumber(i % 2 == 0 ? 1 : NumericValue::gInfinity), i == 0 ? 0.5 : 0.25));
    ASSERT_EQ(set.GetProbabilityOfValue(&one), 0.5);
    ASSERT_FALSE(set.Contains(&infinity));
  }
}

}  // namespace
}  // namespace MCKestrel_800
