// Random predicates on random cases: as records, as flat vectors, and as plain rules that know neither.

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <map>
#include <memory>
#include <numeric>
#include <random>
#include <string>
#include <utility>
#include <vector>

#include "kestrel/dictionary/ScoreBinningEncoder.h"
#include "kestrel/dictionary/ScoreCatNumericEncoder.h"
#include "kestrel/predicates/CompoundPredicate.h"
#include "kestrel/predicates/ConstantPredicates.h"
#include "kestrel/predicates/SetPredicate.h"
#include "kestrel/predicates/SimplePredicate.h"
#include "tests/predicates/CompoundRules.h"
#include "tests/predicates/TestPredicates.h"

namespace MCKestrel_800 {
namespace {

/// The same numbers wherever the test runs: the standard's distributions differ between libraries.
class Chance {
 public:
  explicit Chance(unsigned seed) : random_(seed) {}
  int Below(int count) { return static_cast<int>(random_() % static_cast<unsigned>(count)); }
  bool Is(int percent) { return Below(100) < percent; }
  template <class T>
  const T& Of(const std::vector<T>& all) {
    return all[static_cast<std::size_t>(Below(static_cast<int>(all.size())))];
  }
  std::vector<int> Shuffled(int count) {
    std::vector<int> all(static_cast<std::size_t>(count));
    std::iota(all.begin(), all.end(), 0);
    for (std::size_t i = all.size(); i > 1; --i)
      std::swap(all[i - 1], all[static_cast<std::size_t>(Below(static_cast<int>(i)))]);
    return all;
  }

 private:
  std::mt19937 random_;
};

/// A datum of a case: absent, a number or a text.
struct Datum {
  enum Kind { kAbsent, kNumber, kText } kind = kAbsent;
  double number = 0;
  std::string text;

  static Datum Of(double number) { return {kNumber, number, ""}; }
  static Datum Of(const std::string& text) { return {kText, 0, text}; }
  ScoreValue* NewValue() const {
    if (kind == kNumber) return new NumericValue(number);
    if (kind == kText) return new StringValue(text);
    return nullptr;
  }
};

/// A field as the test knows it. Category numbers and texts stand in the order of their codes.
struct Field {
  enum Kind { kNumber, kBins, kNumbers, kTexts } kind;
  std::string name;
  ScoreDictVar::MeasureLevel level;
  bool hasEncoder;
  bool isDerived;
  bool noSpaceTrim;
  std::unique_ptr<DictVar> variable;

  bool IsCategorical() const { return level != ScoreDictVar::kContinuous; }
};

const std::vector<double> kCuts = {10, 20, 30};
const std::vector<double> kNumbers = {3, -1, 2.5, 0, 1e6};
const std::vector<std::string> kTexts = {"red", "green", " blue", "x-large", "Red"};
constexpr double kMissingNumber = 99;
const std::string kMissingText = "none";
constexpr double kInfinite = NumericValue::gInfinity;

/// Whether two numbers are the same within the tolerance of values.
bool IsClose(double a, double b) {
  if (std::isinf(a) || std::isinf(b)) return false;
  return a == b || std::fabs(a - b) < 2.22045e-14 * std::max(std::fabs(a), std::fabs(b));
}

std::string WithoutBlanks(std::string text) {
  text.erase(text.find_last_not_of(' ') + 1);
  return text;
}

std::unique_ptr<DictVar> MakeVariable(const Field& field) {
  const auto type = field.kind == Field::kTexts ? ScoreDictVar::STRING_VAR : ScoreDictVar::kNUMERIC_VAR;
  std::unique_ptr<DictVar> variable = field.isDerived ? std::make_unique<DerivedVar>(field.name, type)
                                                      : std::make_unique<DictVar>(field.name, type);
  variable->SetMLevel(field.level);
  variable->SetNoSpaceTrim(field.noSpaceTrim);
  auto missing = std::make_unique<MissingValueSet>();
  if (field.kind == Field::kTexts) {
    missing->Add(new Range(new StringValue(kMissingText)));
    for (const std::string& text : kTexts)
      variable->AddScoreValueLabel(new StringValue(text), text);
    auto encoder = std::make_unique<ScoreCatStringEncoder>(kTexts);
    encoder->SetNoSpaceTrim(field.noSpaceTrim);
    if (field.hasEncoder) variable->SetEncoder(encoder.release());
  } else {
    missing->Add(new Range(new NumericValue(kMissingNumber)));
    if (field.kind == Field::kNumbers) {
      for (const double number : kNumbers)
        variable->AddScoreValueLabel(new NumericValue(number), "label");
      if (field.hasEncoder) variable->SetEncoder(new ScoreCatNumericEncoder(kNumbers));
    }
    if (field.kind == Field::kBins) variable->SetEncoder(new ScoreBinningEncoder(kCuts));
  }
  variable->SetMissingValues(missing.release());
  return variable;
}

Field MakeField(Chance& chance, int number) {
  Field field{};
  field.kind = static_cast<Field::Kind>(chance.Below(4));
  field.name = "field" + std::to_string(number);
  field.level = ScoreDictVar::kContinuous;
  if (field.kind == Field::kNumbers || field.kind == Field::kTexts)
    field.level = chance.Is(50) ? ScoreDictVar::kOrdinal : ScoreDictVar::kNominal;
  field.hasEncoder = field.kind == Field::kBins || (field.IsCategorical() && chance.Is(50));
  field.isDerived = chance.Is(30);
  field.noSpaceTrim = field.kind == Field::kTexts && chance.Is(30);
  field.variable = MakeVariable(field);
  return field;
}

Datum MakeDatum(Chance& chance, const Field& field) {
  if (chance.Is(15)) return {};
  if (field.kind == Field::kTexts) {
    if (chance.Is(15)) return Datum::Of(chance.Is(50) ? kMissingText : kMissingText + "  ");
    if (chance.Is(10)) return Datum::Of(chance.Of<std::string>({"", " ", "pink", "RED", "blue"}));
    return Datum::Of(chance.Of(kTexts) + (chance.Is(30) ? "  " : ""));
  }
  if (chance.Is(15)) return Datum::Of(chance.Is(50) ? kSysmis : kMissingNumber);
  if (chance.Is(10))
    return Datum::Of(chance.Of<double>({kInfinite, -kInfinite, std::nan(""), -2, -1, 1e300, 0.0}));
  const double number = chance.Of(field.kind == Field::kNumbers ? kNumbers : kCuts);
  // On a boundary, within the tolerance of it, and just beyond.
  return Datum::Of(number *
                   chance.Of<double>({1, 1, 1, 1 + 1e-15, 1 - 1e-15, 1 + 1e-13, 1 - 1e-13, 1.3, 0.6}));
}

/// What a datum is to a field.
struct State {
  enum Kind { kMissing, kNoCategory, kCategory, kNumber } kind;
  int category = -1;
  double number = 0;
};

State StateOf(const Field& field, const Datum& datum) {
  if (datum.kind == Datum::kAbsent) return {State::kMissing};
  const double x = datum.number;
  if (field.kind == Field::kTexts) {
    const std::string text = WithoutBlanks(datum.text);
    if (text == kMissingText) return {State::kMissing};
    for (std::size_t i = 0; i < kTexts.size(); ++i) {
      if (kTexts[i] == (field.noSpaceTrim ? datum.text : text))
        return {State::kCategory, static_cast<int>(i)};
    }
  } else {
    if (x == kSysmis || IsClose(x, kMissingNumber)) return {State::kMissing};
    if (field.kind == Field::kNumber) return {State::kNumber, -1, x};
    if (field.kind == Field::kBins && std::isnan(x)) return {State::kNoCategory};
    if (field.kind == Field::kBins)
      return {State::kCategory, static_cast<int>(std::count_if(kCuts.begin(), kCuts.end(),
                                                               [x](double cut) { return x > cut; }))};
    for (std::size_t i = 0; i < kNumbers.size(); ++i) {
      // An encoder knows exact numbers, a list of values has a tolerance.
      if (field.hasEncoder ? x == kNumbers[i] : IsClose(x, kNumbers[i]))
        return {State::kCategory, static_cast<int>(i)};
    }
  }
  return {field.level == ScoreDictVar::kNominal ? State::kMissing : State::kNoCategory};
}

double VectorValueOf(const Field& field, const State& state) {
  if (state.kind == State::kMissing) return field.IsCategorical() ? -2.0 : kSysmis;
  if (state.kind == State::kNumber) return state.number;
  return state.kind == State::kCategory ? state.category : -1.0;
}

/// A predicate as the test knows it.
struct Rule {
  enum Kind { kSimple, kSet, kCompound, kTrue, kFalse, kNoSplit } kind = kTrue;
  const Field* field = nullptr;
  std::size_t fieldNumber = 0;
  bool takesMissing = false;
  std::vector<int> categories;
  double low = 0, high = 0;
  bool lowIncluded = false, highIncluded = false;
  ScorePredicate::CompoundBoolOperator boolOperator = ScorePredicate::kOr;
  std::vector<Rule> children;
};

Rule MakeRule(Chance& chance, const std::vector<Field>& fields, int depth) {
  Rule rule;
  if (depth > 0 && chance.Is(60)) {
    rule.kind = Rule::kCompound;
    // Surrogates more often: it takes an unknown child for them to matter.
    rule.boolOperator = static_cast<ScorePredicate::CompoundBoolOperator>(
        std::min(chance.Below(6), int{ScorePredicate::kSurrogate}));
    for (int child = chance.Below(5); child > 0; --child)
      rule.children.push_back(MakeRule(chance, fields, depth - 1));
    return rule;
  }
  rule.kind =
      chance.Is(90) ? static_cast<Rule::Kind>(chance.Below(2)) : static_cast<Rule::Kind>(3 + chance.Below(3));
  if (rule.kind > Rule::kSet) return rule;
  rule.fieldNumber = static_cast<std::size_t>(chance.Below(static_cast<int>(fields.size())));
  rule.field = &fields[rule.fieldNumber];
  rule.takesMissing = chance.Is(25);
  const int count = static_cast<int>(rule.field->kind == Field::kBins ? kCuts.size() + 1 : kNumbers.size());
  for (const int category : chance.Shuffled(count)) {
    if (chance.Is(50)) rule.categories.push_back(category);
  }
  rule.low = chance.Of<double>({-kInfinite, 10, 20});
  rule.high = chance.Of<double>({20, 30, kInfinite});
  rule.lowIncluded = chance.Is(50);
  rule.highIncluded = chance.Is(50);
  return rule;
}

std::unique_ptr<ScoreSplitVar> MakeSplit(Chance& chance, const Rule& rule) {
  const Field& field = *rule.field;
  std::unique_ptr<ScoreSplitVar> made;
  const int child = chance.Below(4);
  if (field.kind == Field::kNumber) {
    auto split = std::make_unique<ScaleSplit>(field.variable.get());
    split->PutSplit(new Range(rule.low, rule.high, rule.lowIncluded, rule.highIncluded), child);
    made = std::move(split);
  } else {
    auto split = std::make_unique<DiscreteSplit>(field.variable.get());
    for (const int category : rule.categories) {
      const auto i = static_cast<std::size_t>(category);
      split->PutSplit(static_cast<double>(category), child);
      if (field.hasEncoder) continue;
      if (field.kind == Field::kTexts) split->PutSplit(new StringValue(kTexts[i]), child);
      if (field.kind == Field::kNumbers) split->PutSplit(new NumericValue(kNumbers[i]), child);
    }
    made = std::move(split);
  }
  if (rule.takesMissing) made->SetMissvalMap(chance.Below(4));
  return made;
}

std::unique_ptr<ScorePredicate> MakePredicate(Chance& chance, const Rule& rule) {
  switch (rule.kind) {
    case Rule::kSimple:
      return std::make_unique<SimplePredicate>(MakeSplit(chance, rule).release());
    case Rule::kSet:
      return std::make_unique<SetPredicate>(MakeSplit(chance, rule).release());
    case Rule::kTrue:
      return std::make_unique<TruePredicate>();
    case Rule::kFalse:
      return std::make_unique<FalsePredicate>();
    case Rule::kNoSplit:
      return std::make_unique<SimplePredicate>();
    default:
      break;
  }
  auto compound = std::make_unique<CompoundPredicate>(rule.boolOperator);
  for (const Rule& child : rule.children)
    compound->AddPredicate(MakePredicate(chance, child).release());
  return compound;
}

bool Holds(const Rule& rule, const State& state) {
  if (state.kind == State::kCategory)
    return std::count(rule.categories.begin(), rule.categories.end(), state.category) > 0;
  if (state.kind != State::kNumber) return false;
  const double x = state.number;
  if (rule.low == rule.high) return IsClose(x, rule.low);
  return (rule.lowIncluded && IsClose(x, rule.low)) || (rule.highIncluded && IsClose(x, rule.high)) ||
         (rule.low < x && x < rule.high);
}

char LetterOf(const Rule& rule, const std::vector<State>& states) {
  if (rule.kind == Rule::kTrue) return 'T';
  if (rule.kind == Rule::kFalse) return 'F';
  if (rule.kind == Rule::kNoSplit) return 'U';
  if (rule.kind == Rule::kCompound) {
    std::string children;
    for (const Rule& child : rule.children)
      children += LetterOf(child, states);
    return VerdictOf(rule.boolOperator, children).letter;
  }
  const State& state = states[rule.fieldNumber];
  if (state.kind == State::kMissing) return rule.kind == Rule::kSimple && rule.takesMissing ? 'T' : 'U';
  return Holds(rule, state) ? 'T' : 'F';
}

/// Fields with what they may be put into: records of this or another layout, and a vector.
struct World {
  World(Chance& chance, int count) {
    for (int i = 0; i < count; ++i)
      fields.push_back(MakeField(chance, i));
    slots = chance.Shuffled(count);
    const std::vector<int> positions = chance.Shuffled(count);
    for (std::size_t i = 0; i < fields.size(); ++i) {
      fields[i].variable->SetEncodedValueIndex(slots[i]);
      // Some positions are not known, and those that are fit some of the records.
      fields[i].variable->SetValueIndex(chance.Is(20) ? -1 : positions[i]);
    }
    layout.resize(fields.size());
    for (std::size_t i = 0; i < fields.size(); ++i)
      layout[static_cast<std::size_t>(positions[i])] = static_cast<int>(i);
  }

  std::vector<Field> fields;
  std::vector<int> slots;
  std::vector<int> layout;  // by position: the number of the field
};

struct Case {
  Case(Chance& chance, const World& world) {
    hasDerived = chance.Is(60);
    const int count = static_cast<int>(world.fields.size());
    values.resize(world.fields.size());
    states.resize(world.fields.size());
    for (const int number : chance.Is(60) ? world.layout : chance.Shuffled(count)) {
      const auto i = static_cast<std::size_t>(number);
      const Field& field = world.fields[i];
      const Datum datum = MakeDatum(chance, field);
      const bool isElsewhere = field.isDerived && hasDerived;
      CaseRecord& holder = isElsewhere ? derived : record;
      if (datum.kind != Datum::kAbsent || chance.Is(50)) holder.Add(field.name, datum.NewValue());
      // What must not be found: the other record's value of that name.
      if ((isElsewhere || hasDerived) && chance.Is(50))
        (isElsewhere ? record : derived).Add(field.name, MakeDatum(chance, field).NewValue());
      states[i] = StateOf(field, datum);
      values[static_cast<std::size_t>(world.slots[i])] = VectorValueOf(field, states[i]);
    }
  }

  CaseRecord record, derived;
  bool hasDerived;
  std::vector<State> states;
  std::vector<double> values;
};

TEST(Predicates, AnswerAlikeOnRecordsAndVectorsAndByTheRules) {
  constexpr int kWorlds = 250, kRules = 8, kCases = 5;
  std::map<char, int> answers;
  for (int number = 0; number < kWorlds; ++number) {
    Chance chance(static_cast<unsigned>(number));
    const World world(chance, 6);
    for (int i = 0; i < kRules; ++i) {
      const Rule rule = MakeRule(chance, world.fields, i % 6);
      const std::unique_ptr<ScorePredicate> predicate = MakePredicate(chance, rule);
      for (int j = 0; j < kCases; ++j) {
        const Case one(chance, world);
        const char want = LetterOf(rule, one.states);
        const CaseRecord* const derived = one.hasDerived ? &one.derived : nullptr;
        EXPECT_EQ(LetterOf(predicate->Evaluate(&one.record, derived)), want)
            << "record: world " << number << ", rule " << i << ", case " << j;
        EXPECT_EQ(LetterOf(predicate->Evaluate(one.values)), want)
            << "vector: world " << number << ", rule " << i << ", case " << j;
        ++answers[want];
      }
    }
  }
  for (const char letter : {'T', 'F', 'U', 'S'})
    EXPECT_GT(answers[letter], 100) << letter << ": the cases tell little";
}

}  // namespace
}  // namespace MCKestrel_800
