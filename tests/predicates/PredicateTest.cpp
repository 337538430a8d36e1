// Simple, set and constant predicates.

#include <gtest/gtest.h>

#include <cmath>
#include <memory>
#include <sstream>
#include <string>
#include <vector>

#include "kestrel/dictionary/ScoreBinningEncoder.h"
#include "kestrel/dictionary/ScoreCatNumericEncoder.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/predicates/ConstantPredicates.h"
#include "kestrel/predicates/SetPredicate.h"
#include "kestrel/predicates/SimplePredicate.h"
#include "tests/predicates/TestPredicates.h"

namespace MCKestrel_800 {
namespace {

constexpr Result kTrue = ScorePredicate::PredTrue, kFalse = ScorePredicate::PredFalse,
                 kUnknown = ScorePredicate::PredUnknown;

/// A record of one value under a name; null for an empty slot.
CaseRecord RecordOf(const std::string& name, ScoreValue* value) {
  CaseRecord record;
  record.Add(name, value);
  return record;
}

TEST(Predicates, HaveTheNumbersOfTheInterface) {
  EXPECT_EQ(ScorePredicate::PredTrue, 0);
  EXPECT_EQ(ScorePredicate::PredFalse, 1);
  EXPECT_EQ(ScorePredicate::PredUnknown, 2);
  EXPECT_EQ(ScorePredicate::PredSurrogateTrue, 3);
  EXPECT_EQ(SimplePredicate().GetPredType(), 1);
  EXPECT_EQ(SetPredicate().GetPredType(), 2);
  EXPECT_EQ(TruePredicate().GetPredType(), 3);
  EXPECT_EQ(FalsePredicate().GetPredType(), 4);
}

TEST(Predicates, DisplayTheirKind) {
  EXPECT_EQ(DisplayOf(SimplePredicate()), "Simple Predicate: \n");
  EXPECT_EQ(DisplayOf(SetPredicate()), "Set Predicate: \n");
  EXPECT_EQ(DisplayOf(TruePredicate()), "Constant TRUE\n");
  EXPECT_EQ(DisplayOf(FalsePredicate()), "Constant FALSE\n");
}

TEST(ConstantPredicates, DoNotLookAtTheCase) {
  const auto age = MakeAge();
  const auto split = Below(age.get(), 18);
  TruePredicate always;
  FalsePredicate never;
  for (ScorePredicate* predicate :
       {static_cast<ScorePredicate*>(&always), static_cast<ScorePredicate*>(&never)}) {
    const Result result = predicate == &always ? kTrue : kFalse;
    predicate->SetSplit(split.get());
    EXPECT_EQ(predicate->GetSplit(), nullptr) << "it takes none";
    EXPECT_FALSE(predicate->IsDerivedPredictor());
    EXPECT_EQ(predicate->Evaluate({}), result);
    EXPECT_EQ(predicate->Evaluate(nullptr, nullptr), result);
    const std::unique_ptr<ScorePredicate> clone(predicate->Clone());
    EXPECT_EQ(clone->GetPredType(), predicate->GetPredType());
    EXPECT_EQ(clone->Evaluate({}), result);
  }
}

TEST(SimplePredicate, ReadsItsOperator) {
  struct Row {
    const char* text;
    SimplePredicate::SimplePredOperator meaning;
    int number;
    const char* why;
  };
  const Row kRows[] = {
      {"equal", SimplePredicate::kEqual, 0, "a name of PMML"},
      {"notEqual", SimplePredicate::kNotEqual, 1, "a name of PMML"},
      {"lessThan", SimplePredicate::kLessThan, 2, "a name of PMML"},
      {"lessOrEqual", SimplePredicate::kLessOrEqual, 3, "a name of PMML"},
      {"greaterThan", SimplePredicate::kGreaterThan, 4, "a name of PMML"},
      {"greaterOrEqual", SimplePredicate::kGreaterOrEqual, 5, "a name of PMML"},
      {"isMissing", SimplePredicate::kIsMissing, 6, "a name of PMML"},
      {"isNotMissing", SimplePredicate::kIsNotMissing, 7, "a name of PMML"},
      {"Equal", SimplePredicate::kIsNotMissing, 7, "an unknown text"},
      {"equal ", SimplePredicate::kIsNotMissing, 7, "an unknown text"},
      {" ", SimplePredicate::kIsNotMissing, 7, "an unknown text"},
  };
  SimplePredicate predicate;
  EXPECT_EQ(predicate.GetPredicateOperator(), SimplePredicate::kEqual);
  for (const Row& row : kRows) {
    predicate.SetPredicateOperator("lessThan");
    predicate.SetPredicateOperator(row.text);
    EXPECT_EQ(predicate.GetPredicateOperator(), row.meaning) << row.text << ": " << row.why;
    EXPECT_EQ(static_cast<int>(row.meaning), row.number) << row.text;
    predicate.SetPredicateOperator("");
    EXPECT_EQ(predicate.GetPredicateOperator(), row.meaning) << "empty leaves it as it is";
  }
}

TEST(SimplePredicate, KeepsItsValueAsTextAndNumber) {
  SimplePredicate predicate;
  EXPECT_EQ(predicate.GetPredValueByDouble(), kSysmis);
  EXPECT_EQ(predicate.GetPredValueByString(), "");
  EXPECT_FALSE(predicate.IsMissingValue());
  predicate.SetValueToMissing(true);
  EXPECT_TRUE(predicate.IsMissingValue());
  predicate.SetValueToMissing(false);
  EXPECT_FALSE(predicate.IsMissingValue());

  predicate.SetPredicateValue("5");
  EXPECT_EQ(predicate.GetPredValueByString(), "5") << "without a split the text is kept";
  EXPECT_EQ(predicate.GetPredValueByDouble(), kSysmis);
  predicate.SetSplit(new ScaleSplit);
  predicate.SetPredicateValue("6");
  EXPECT_EQ(predicate.GetPredValueByString(), "6") << "and without a variable";
  EXPECT_EQ(predicate.GetPredValueByDouble(), kSysmis);
}

TEST(SimplePredicate, ConvertsItsValueByTheVariable) {
  struct Row {
    const char* why;
    ScoreDictVar::VariableType type;
    ScoreEncoder* encoder;
    const char* text;
    double number;
  };
  const Row kRows[] = {
      {"a number", ScoreDictVar::kNUMERIC_VAR, nullptr, "2.5", 2.5},
      {"no number", ScoreDictVar::kNUMERIC_VAR, nullptr, "x", kSysmis},
      {"the number that a text starts with", ScoreDictVar::STRING_VAR, nullptr, "7 up", 7},
      {"a text without one", ScoreDictVar::STRING_VAR, nullptr, "up", 0},
      {"a date cannot be converted", ScoreDictVar::kDATETIME_VAR, nullptr, "5", 77},
      {"the code of a text", ScoreDictVar::STRING_VAR, new ScoreCatStringEncoder({"a", "b"}), "b", 1},
      {"the code of a text but for its blanks", ScoreDictVar::STRING_VAR,
       new ScoreCatStringEncoder({"a", "b"}), "b ", 1},
      {"a new text is registered", ScoreDictVar::STRING_VAR, new ScoreCatStringEncoder({"a", "b"}), "c", 2},
      {"the code of a number", ScoreDictVar::kNUMERIC_VAR, new ScoreCatNumericEncoder({5, 6}), "6", 1},
      {"a date with an encoder", ScoreDictVar::kDATETIME_VAR, new ScoreCatStringEncoder({"a"}), "a", 0},
  };
  for (const Row& row : kRows) {
    DictVar variable("v", row.type);
    variable.SetEncoder(row.encoder);
    DictVar seven("s", ScoreDictVar::kNUMERIC_VAR);
    auto* const split = new DiscreteSplit(&seven);
    SimplePredicate predicate(split);
    predicate.SetPredicateValue("77");
    split->SetSplitVar(&variable);
    predicate.SetPredicateValue(row.text);
    EXPECT_EQ(predicate.GetPredValueByDouble(), row.number) << row.why;
    EXPECT_EQ(predicate.GetPredValueByString(), row.text) << row.why;
  }
}

TEST(SetPredicate, ReadsItsOperator) {
  SetPredicate predicate;
  EXPECT_EQ(predicate.GetPredicateOperator(), SetPredicate::kIsIn);
  for (const char* text : {"isNotIn", "", "isin", "isIn "}) {
    predicate.SetPredicateOperator("isIn");
    EXPECT_EQ(predicate.GetPredicateOperator(), 0);
    predicate.SetPredicateOperator(text);
    EXPECT_EQ(predicate.GetPredicateOperator(), 1) << "'" << text << "'";
  }
}

TEST(SetPredicate, KeepsItsValuesWhenGivenNone) {
  SetPredicate predicate;
  EXPECT_TRUE(predicate.GetArrayData().empty());
  predicate.SetArrayData({1, 2});
  predicate.SetArrayData({});
  EXPECT_EQ(predicate.GetArrayData(), (std::vector<double>{1, 2}));
  predicate.SetArrayData({3});
  EXPECT_EQ(predicate.GetArrayData(), std::vector<double>{3});
}

/// The same split under a simple and under a set predicate.
struct Pair {
  explicit Pair(const ScoreSplitVar& split) : simple(split.Clone()), set(split.Clone()) {}

  SimplePredicate simple;
  SetPredicate set;
};

TEST(SimpleAndSetPredicates, WithoutASplitOrVariableAreUnknown) {
  const CaseRecord record = RecordOf("age", new NumericValue(1));
  Pair pair(*Below(nullptr, 18, 0));
  SimplePredicate simple;
  SetPredicate set;
  for (const ScorePredicate* predicate :
       std::vector<const ScorePredicate*>{&simple, &set, &pair.simple, &pair.set}) {
    EXPECT_EQ(predicate->Evaluate({1.0}), kUnknown);
    EXPECT_EQ(predicate->Evaluate({}), kUnknown);
    EXPECT_EQ(predicate->Evaluate(&record, nullptr), kUnknown);
    EXPECT_EQ(predicate->Evaluate(nullptr, nullptr), kUnknown);
    EXPECT_FALSE(predicate->IsDerivedPredictor());
  }
  EXPECT_EQ(simple.GetSplit(), nullptr);
  EXPECT_EQ(set.GetSplit(), nullptr);
}

TEST(SimpleAndSetPredicates, HoldTheirSplit) {
  const auto age = MakeAge();
  const ScoreSplitVar* const first = Below(age.get(), 18).release();
  const ScoreSplitVar* const second = Below(age.get(), 50).release();
  const ScoreSplitVar* const third = second->Clone();
  SimplePredicate simple(first);
  SetPredicate set(third);
  simple.SetSplit(second);
  EXPECT_EQ(simple.GetSplit(), second);
  EXPECT_EQ(first->GetSplitName(), "age") << "not deleted";
  EXPECT_EQ(set.GetSplit(), third);
  set.SetSplit(nullptr);
  EXPECT_EQ(set.GetSplit(), nullptr);
  EXPECT_EQ(set.Evaluate({1.0}), kUnknown);
  set.SetSplit(first);
  EXPECT_EQ(set.Evaluate({1.0}), kTrue);
  delete third;
}

TEST(SimpleAndSetPredicates, CopyDeeply) {
  const auto age = MakeAge();
  auto pair = std::make_unique<Pair>(*Below(age.get(), 18, 0));
  pair->simple.SetPredicateOperator("lessThan");
  pair->simple.SetPredicateValue("18");
  pair->simple.SetValueToMissing(true);
  pair->set.SetPredicateOperator("isNotIn");
  pair->set.SetArrayData({4, 5});
  const std::unique_ptr<SimplePredicate> simple(pair->simple.Clone());
  const std::unique_ptr<SetPredicate> set(pair->set.Clone());
  const SimplePredicate simpleCopy(*simple);
  const SetPredicate setCopy(*set);
  EXPECT_NE(simple->GetSplit(), pair->simple.GetSplit());
  EXPECT_NE(set->GetSplit(), pair->set.GetSplit());
  pair.reset();
  for (const SimplePredicate* copy : {static_cast<const SimplePredicate*>(simple.get()), &simpleCopy}) {
    EXPECT_EQ(copy->GetPredicateOperator(), SimplePredicate::kLessThan);
    EXPECT_EQ(copy->GetPredValueByString(), "18");
    EXPECT_EQ(copy->GetPredValueByDouble(), 18.0);
    EXPECT_TRUE(copy->IsMissingValue());
    EXPECT_EQ(copy->GetSplit()->GetSplitVar(), age.get());
    EXPECT_EQ(copy->Evaluate({kSysmis}), kTrue);
    EXPECT_EQ(copy->Evaluate({18.0}), kFalse);
  }
  for (const SetPredicate* copy : {static_cast<const SetPredicate*>(set.get()), &setCopy}) {
    EXPECT_EQ(copy->GetPredicateOperator(), SetPredicate::kIsNotIn);
    EXPECT_EQ(copy->GetArrayData(), (std::vector<double>{4, 5}));
    EXPECT_EQ(copy->Evaluate({17.0}), kTrue);
    EXPECT_EQ(copy->Evaluate({18.0}), kFalse);
  }
  const std::unique_ptr<SimplePredicate> bare(SimplePredicate().Clone());
  const std::unique_ptr<SetPredicate> bareSet(SetPredicate().Clone());
  EXPECT_EQ(bare->GetSplit(), nullptr);
  EXPECT_EQ(bareSet->GetSplit(), nullptr);
}

TEST(SimpleAndSetPredicates, AskAVectorBySlot) {
  struct Row {
    const char* why;
    ScoreDictVar::MeasureLevel level;
    int slot;
    std::vector<double> values;
    Result simple, routed, set;  // routed: a simple one whose split sends missing values to a child
  };
  const auto kNumber = ScoreDictVar::kContinuous;
  const auto kOrdinal = ScoreDictVar::kOrdinal;
  const auto kNominal = ScoreDictVar::kNominal;
  const Row kRows[] = {
      {"a number in a range", kNumber, 0, {17}, kTrue, kTrue, kTrue},
      {"a number in none", kNumber, 0, {18}, kFalse, kFalse, kFalse},
      {"another slot", kNumber, 1, {17, 18}, kFalse, kFalse, kFalse},
      {"a missing number", kNumber, 0, {kSysmis}, kUnknown, kTrue, kUnknown},
      {"a number beyond the vector is missing", kNumber, 1, {17}, kUnknown, kTrue, kUnknown},
      {"an empty vector", kNumber, 0, {}, kUnknown, kTrue, kUnknown},
      {"no slot", kNumber, -1, {17}, kUnknown, kTrue, kUnknown},
      {"the marker of categories is a number", kNumber, 0, {-2}, kTrue, kTrue, kTrue},
      {"NaN is in no range", kNumber, 0, {std::nan("")}, kFalse, kFalse, kFalse},
      {"a category", kNominal, 0, {0}, kTrue, kTrue, kTrue},
      {"another category", kNominal, 0, {1}, kFalse, kFalse, kFalse},
      {"a missing category", kNominal, 0, {-2}, kUnknown, kTrue, kUnknown},
      {"no category goes where the split sends missing ones", kNominal, 0, {-1}, kFalse, kTrue, kFalse},
      {"a category beyond the vector is none", kNominal, 5, {0}, kFalse, kTrue, kFalse},
      {"no slot for a category", kNominal, -1, {0}, kFalse, kTrue, kFalse},
      {"the marker of numbers is no category", kNominal, 0, {kSysmis}, kFalse, kTrue, kFalse},
      {"an ordinal category", kOrdinal, 0, {0}, kTrue, kTrue, kTrue},
      {"a missing ordinal category", kOrdinal, 0, {-2}, kUnknown, kTrue, kUnknown},
      {"no ordinal category is looked up", kOrdinal, 0, {-1}, kFalse, kFalse, kFalse},
      {"an ordinal category beyond the vector is none", kOrdinal, 5, {0}, kFalse, kFalse, kFalse},
  };
  for (const Row& row : kRows) {
    const bool isNumber = row.level == kNumber;
    const auto variable = isNumber ? MakeAge() : MakeColor(row.level, true);
    variable->SetEncodedValueIndex(row.slot);
    const auto split = [&](int missvalMap) -> std::unique_ptr<ScoreSplitVar> {
      if (isNumber) return Below(variable.get(), 18, missvalMap);
      return Red(variable.get(), missvalMap);
    };
    // A set sends nothing anywhere, routed or not; but for what is no category of a nominal field.
    const Pair plain(*split(-1)), routed(*split(3));
    EXPECT_EQ(plain.simple.Evaluate(row.values), row.simple) << row.why;
    EXPECT_EQ(routed.simple.Evaluate(row.values), row.routed) << row.why;
    EXPECT_EQ(plain.set.Evaluate(row.values), row.set) << row.why;
    EXPECT_EQ(routed.set.Evaluate(row.values), row.set == kUnknown ? kUnknown : row.routed) << row.why;
  }
}

TEST(SimpleAndSetPredicates, AskARecord) {
  struct Row {
    const char* why;
    ScoreDictVar::MeasureLevel level;
    bool hasEncoder;
    std::shared_ptr<ScoreValue> value;
    Result simple, routed, set;
  };
  const auto text = [](const char* t) { return std::make_shared<StringValue>(t); };
  const auto number = [](double x) { return std::make_shared<NumericValue>(x); };
  const auto kNumber = ScoreDictVar::kContinuous;
  const auto kOrdinal = ScoreDictVar::kOrdinal;
  const auto kNominal = ScoreDictVar::kNominal;
  const Row kRows[] = {
      {"a number in a range", kNumber, false, number(17), kTrue, kTrue, kTrue},
      {"a number in none", kNumber, false, number(18), kFalse, kFalse, kFalse},
      {"no value", kNumber, false, nullptr, kUnknown, kTrue, kUnknown},
      {"the missing number", kNumber, false, number(kSysmis), kUnknown, kTrue, kUnknown},
      {"a number that the variable calls missing", kNumber, false, number(99), kUnknown, kTrue, kUnknown},
      {"a text is in no range", kNumber, false, text("17"), kFalse, kFalse, kFalse},
      {"nominal", kNominal, true, text("red"), kTrue, kTrue, kTrue},
      {"nominal, another", kNominal, true, text("blue"), kFalse, kFalse, kFalse},
      {"nominal, no category is missing", kNominal, true, text("pink"), kUnknown, kTrue, kUnknown},
      {"nominal, missing", kNominal, true, text("none"), kUnknown, kTrue, kUnknown},
      {"nominal, no value", kNominal, true, nullptr, kUnknown, kTrue, kUnknown},
      {"nominal, trailing blanks do not count", kNominal, true, text("red  "), kTrue, kTrue, kTrue},
      {"without encoder", kNominal, false, text("red"), kTrue, kTrue, kTrue},
      {"without encoder, another", kNominal, false, text("blue"), kFalse, kFalse, kFalse},
      {"without encoder, no category is missing", kNominal, false, text("pink"), kUnknown, kTrue, kUnknown},
      {"without encoder, missing", kNominal, false, text("none"), kUnknown, kTrue, kUnknown},
      {"ordinal", kOrdinal, true, text("red"), kTrue, kTrue, kTrue},
      {"ordinal, no category is looked up", kOrdinal, true, text("pink"), kFalse, kFalse, kFalse},
      {"ordinal, missing", kOrdinal, true, text("none"), kUnknown, kTrue, kUnknown},
      {"ordinal without encoder", kOrdinal, false, text("red"), kTrue, kTrue, kTrue},
      {"ordinal without encoder, no category", kOrdinal, false, text("pink"), kFalse, kFalse, kFalse},
      {"ordinal without encoder, missing", kOrdinal, false, text("none"), kUnknown, kTrue, kUnknown},
  };
  for (const Row& row : kRows) {
    const bool isNumber = row.level == kNumber;
    const auto variable = isNumber ? MakeAge() : MakeColor(row.level, row.hasEncoder);
    const auto split = [&](int missvalMap) -> std::unique_ptr<ScoreSplitVar> {
      if (isNumber) return Below(variable.get(), 18, missvalMap);
      return Red(variable.get(), missvalMap);
    };
    const CaseRecord record = RecordOf(variable->GetName(), row.value ? row.value->Clone() : nullptr);
    const Pair plain(*split(-1)), routed(*split(3));
    EXPECT_EQ(plain.simple.Evaluate(&record, nullptr), row.simple) << row.why;
    EXPECT_EQ(routed.simple.Evaluate(&record, nullptr), row.routed) << row.why;
    EXPECT_EQ(plain.set.Evaluate(&record, nullptr), row.set) << row.why;
    EXPECT_EQ(routed.set.Evaluate(&record, nullptr), row.set) << row.why << ": a set is not routed";
  }
}

TEST(SimpleAndSetPredicates, DifferInWhatAnEncodedVariablesSplitIsAsked) {
  // The text reads as 20, its code is 1.
  DictVar variable("v", ScoreDictVar::STRING_VAR);
  variable.SetMLevel(ScoreDictVar::kOrdinal);
  variable.SetEncoder(new ScoreCatStringEncoder({"10", "20"}));
  ScaleSplit split(&variable);
  split.PutSplit(new Range(0.5, 1.5, true, true), 0);
  const Pair pair(split);
  const CaseRecord record = RecordOf("v", new StringValue("20"));
  EXPECT_EQ(pair.simple.Evaluate(&record, nullptr), kFalse) << "the value: a text is in no range";
  EXPECT_EQ(pair.set.Evaluate(&record, nullptr), kTrue) << "the code";
}

TEST(SimpleAndSetPredicates, AskBinsByTheirNumber) {
  const auto age = MakeAge();
  age->SetEncoder(new ScoreBinningEncoder({10, 20}));
  DiscreteSplit split(age.get());
  split.PutSplit(1.0, 0);
  const Pair pair(split);
  const struct {
    const char* why;
    double x;
    Result result;
  } kRows[] = {{"the second bin", 15, kTrue},
               {"the first bin", 5, kFalse},
               {"missing, though it has a bin", 99, kUnknown},
               {"the missing number", kSysmis, kUnknown}};
  for (const auto& row : kRows) {
    const CaseRecord record = RecordOf("age", new NumericValue(row.x));
    EXPECT_EQ(pair.simple.Evaluate(&record, nullptr), row.result) << row.why;
    EXPECT_EQ(pair.set.Evaluate(&record, nullptr), row.result) << row.why;
  }
}

/// A record that keeps no index.
class UnindexedRecord : public CaseRecord {
 public:
  bool HasMap() const override { return false; }
};

TEST(SimpleAndSetPredicates, FindTheValueOfTheirVariable) {
  struct Row {
    const char* why;
    int valueIndex;
    bool isDerived;
    const char* record;   // names of values below and above the limit: "age=1 x=50", or null for no record
    const char* derived;  // the same for the derived record
    Result result;
  };
  const Row kRows[] = {
      {"by position", 1, false, "x=50 age=1", nullptr, kTrue},
      {"by name, without a position", -1, false, "x=50 age=1", nullptr, kTrue},
      {"by name, where the position is another variable's", 0, false, "x=50 age=1", nullptr, kTrue},
      {"by name, beyond the record", 9, false, "x=50 age=1", nullptr, kTrue},
      {"another variable's value is never taken", 0, false, "x=1", nullptr, kUnknown},
      {"the name is not there", -1, false, "x=1", nullptr, kUnknown},
      {"no record", 0, false, nullptr, nullptr, kUnknown},
      {"an input variable is not looked for among the derived", 0, false, "x=1", "age=1", kUnknown},
      {"nor when it is in both", 0, false, "age=50", "age=1", kFalse},
      {"a derived variable is looked for there alone", 0, true, "age=50", "age=1", kTrue},
      {"and not in the record", 0, true, "age=1", "x=1", kUnknown},
      {"unless there is no derived record", 0, true, "age=1", nullptr, kTrue},
      {"a derived variable without records", 0, true, nullptr, nullptr, kUnknown},
      {"a derived variable needs no record", 0, true, nullptr, "age=1", kTrue},
  };
  const auto fill = [](CaseRecord& record, const char* text) -> const CaseRecord* {
    if (text == nullptr) return nullptr;
    std::istringstream words(text);
    for (std::string word; words >> word;) {
      const auto equals = word.find('=');
      record.Add(word.substr(0, equals), new NumericValue(std::stod(word.substr(equals + 1))));
    }
    return &record;
  };
  for (const Row& row : kRows) {
    DerivedVar derived("age", ScoreDictVar::kNUMERIC_VAR);
    DictVar input("age", ScoreDictVar::kNUMERIC_VAR);
    DictVar& variable = row.isDerived ? derived : input;
    variable.SetValueIndex(row.valueIndex);
    const Pair pair(*Below(&variable, 18));
    CaseRecord record, derivedRecord;
    UnindexedRecord unindexed;
    const CaseRecord* const first = fill(record, row.record);
    const CaseRecord* const second = fill(derivedRecord, row.derived);
    EXPECT_EQ(pair.simple.Evaluate(first, second), row.result) << row.why;
    EXPECT_EQ(pair.set.Evaluate(first, second), row.result) << row.why;
    EXPECT_EQ(pair.simple.Evaluate(fill(unindexed, row.record), second), row.result) << row.why;
    EXPECT_EQ(pair.simple.IsDerivedPredictor(), row.isDerived);
    EXPECT_EQ(pair.set.IsDerivedPredictor(), row.isDerived);
  }
}

TEST(SimpleAndSetPredicates, FollowTheirVariableAndSplitAsTheyAreBuilt) {
  // Whoever builds a predicate may finish its split and variable after it.
  const auto age = MakeAge();
  const auto other = MakeAge();
  other->SetEncodedValueIndex(1);
  auto* const split = new ScaleSplit;
  SimplePredicate predicate(split);
  const std::vector<double> values = {17, 50};
  EXPECT_EQ(predicate.Evaluate(values), kUnknown);
  split->SetSplitVar(age.get());
  EXPECT_EQ(predicate.Evaluate(values), kFalse);
  auto* const range = new Range(0.0, 18.0, true, true);
  split->PutSplit(range, 0);
  EXPECT_EQ(predicate.Evaluate(values), kTrue);
  split->SetSplitVar(other.get());
  EXPECT_EQ(predicate.Evaluate(values), kFalse);
  const std::unique_ptr<const ScoreValue> oldEnd(range->GetMax());
  range->SetMax(new NumericValue(60));
  EXPECT_EQ(predicate.Evaluate(values), kTrue);
  other->SetEncodedValueIndex(7);
  EXPECT_EQ(predicate.Evaluate(values), kUnknown);
  split->SetMissvalMap(0);
  EXPECT_EQ(predicate.Evaluate(values), kTrue);
  other->SetMLevel(ScoreDictVar::kNominal);
  split->SetMissvalMap(-1);
  EXPECT_EQ(predicate.Evaluate(values), kFalse) << "a category that is not there is none";
}

}  // namespace
}  // namespace MCKestrel_800
