// Predicates, variables and splits that the tests of this room share.

#ifndef KESTREL_TESTS_PREDICATES_TESTPREDICATES_H
#define KESTREL_TESTS_PREDICATES_TESTPREDICATES_H

#include <memory>
#include <ostream>
#include <sstream>
#include <string>
#include <vector>

#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/dictionary/DictVar.h"
#include "kestrel/dictionary/MissingValueSet.h"
#include "kestrel/dictionary/ScoreCatStringEncoder.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/predicates/DiscreteSplit.h"
#include "kestrel/predicates/Range.h"
#include "kestrel/predicates/ScaleSplit.h"
#include "kestrel/predicates/ScorePredicate.h"

namespace MCKestrel_800 {

constexpr double kSysmis = NumericValue::gSysmisValue;
constexpr double kInfinity = NumericValue::gInfinity;

using Result = ScorePredicate::PredicateResult;

template <class T>
std::string DisplayOf(const T& object) {
  std::ostringstream os;
  object.Display(os);
  return os.str();
}

/// A variable that is computed from others.
class DerivedVar : public DictVar {
 public:
  using DictVar::DictVar;
  DerivedVar* Clone() const override { return new DerivedVar(*this); }
  bool IsDerivedVariable() const override { return true; }
};

/// Always the same result; counts how often it is asked and how many of its kind there are.
class FixedPredicate : public ScorePredicate {
 public:
  explicit FixedPredicate(Result result, int* asked = nullptr, bool isDerived = false)
      : result_(result), asked_(asked), isDerived_(isDerived) {
    ++Alive();
  }
  FixedPredicate(const FixedPredicate& other)
      : FixedPredicate(other.result_, other.asked_, other.isDerived_) {}
  FixedPredicate& operator=(const FixedPredicate&) = delete;
  ~FixedPredicate() override { --Alive(); }

  static int& Alive() {
    static int alive = 0;
    return alive;
  }

  FixedPredicate* Clone() const override { return new FixedPredicate(*this); }
  Result Evaluate(const std::vector<double>&) const override { return Answer(); }
  Result Evaluate(const ScoreCaseRecord*, const ScoreCaseRecord*) const override { return Answer(); }
  PredicateType GetPredType() const override { return kTrue; }
  bool IsDerivedPredictor() const override {
    Answer();
    return isDerived_;
  }
  void SetSplit(const ScoreSplitVar*) override {}
  const ScoreSplitVar* GetSplit() const override { return nullptr; }
  void Display(std::ostream& os) const override { os << "fixed\n"; }

 private:
  Result Answer() const {
    if (asked_ != nullptr) ++*asked_;
    return result_;
  }

  Result result_;
  int* asked_;
  bool isDerived_;
};

/// A continuous number "age" at position 0 of vectors and records; 99 is missing.
inline std::unique_ptr<DictVar> MakeAge() {
  auto age = std::make_unique<DictVar>("age", ScoreDictVar::kNUMERIC_VAR);
  age->SetLabel("Age in years");
  auto missing = std::make_unique<MissingValueSet>();
  missing->Add(new Range(new NumericValue(99)));
  age->SetMissingValues(missing.release());
  age->SetValueIndex(0);
  age->SetEncodedValueIndex(0);
  return age;
}

/// A text "color" of three categories at position 0 of vectors and records; "none" is missing.
inline std::unique_ptr<DictVar> MakeColor(ScoreDictVar::MeasureLevel level, bool hasEncoder) {
  auto color = std::make_unique<DictVar>("color", ScoreDictVar::STRING_VAR);
  color->SetLabel("Color");
  color->SetMLevel(level);
  for (const char* name : {"red", "green", "blue"})
    color->AddScoreValueLabel(new StringValue(name), name);
  auto missing = std::make_unique<MissingValueSet>();
  missing->Add(new Range(new StringValue("none")));
  color->SetMissingValues(missing.release());
  if (hasEncoder) color->SetEncoder(new ScoreCatStringEncoder({"red", "green", "blue"}));
  color->SetValueIndex(0);
  color->SetEncodedValueIndex(0);
  return color;
}

/// Sends what lies below a number to child 0; missing values to `missvalMap`.
inline std::unique_ptr<ScaleSplit> Below(const ScoreDictVar* variable, double end, int missvalMap = -1) {
  auto split = std::make_unique<ScaleSplit>(variable);
  split->PutSplit(new Range(-kInfinity, end, false, false), 0);
  split->SetMissvalMap(missvalMap);
  return split;
}

/// Sends "red", code 0, to child 0; missing values to `missvalMap`.
inline std::unique_ptr<DiscreteSplit> Red(const ScoreDictVar* variable, int missvalMap = -1) {
  auto split = std::make_unique<DiscreteSplit>(variable);
  split->PutSplit(new StringValue("red"), 0);
  split->PutSplit(0.0, 0);
  split->SetMissvalMap(missvalMap);
  return split;
}

}  // namespace MCKestrel_800

#endif  // KESTREL_TESTS_PREDICATES_TESTPREDICATES_H
