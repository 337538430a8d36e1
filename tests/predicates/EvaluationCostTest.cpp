// What every case asks of predicates must not touch the heap, the stack of a host's thread or other threads.

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <thread>
#include <vector>

#include "kestrel/predicates/CompoundPredicate.h"
#include "kestrel/predicates/ConstantPredicates.h"
#include "kestrel/predicates/SetPredicate.h"
#include "kestrel/predicates/SimplePredicate.h"
#include "tests/predicates/TestPredicates.h"
#include "tests/support/AllocationCount.h"
#include "tests/support/SmallStack.h"

namespace MCKestrel_800 {
namespace {

constexpr ScorePredicate::CompoundBoolOperator kOperators[] = {
    ScorePredicate::kOr, ScorePredicate::kAnd, ScorePredicate::kXor, ScorePredicate::kSurrogate};

/// Variables of each kind, at positions of their own.
struct Fields {
  Fields() {
    plainColor->SetName("plain");
    for (const DictVarAt& field : {DictVarAt{age.get(), 0}, {color.get(), 1}, {plainColor.get(), 2}}) {
      field.variable->SetValueIndex(field.position);
      field.variable->SetEncodedValueIndex(field.position);
    }
  }

  struct DictVarAt {
    DictVar* variable;
    int position;
  };

  std::unique_ptr<DictVar> age = MakeAge();
  std::unique_ptr<DictVar> color = MakeColor(ScoreDictVar::kNominal, true);
  std::unique_ptr<DictVar> plainColor = MakeColor(ScoreDictVar::kOrdinal, false);
};

/// A predicate of one of four kinds.
ScorePredicate* NewPredicate(const Fields& fields, int kind) {
  switch (kind % 4) {
    case 0:
      return new SimplePredicate(Below(fields.age.get(), 18 + kind).release());
    case 1:
      return new SimplePredicate(Red(fields.color.get()).release());
    case 2:
      return new SetPredicate(Red(fields.color.get()).release());
    default:
      return new SimplePredicate(Red(fields.plainColor.get()).release());
  }
}

std::unique_ptr<CompoundPredicate> NewCompound(const Fields& fields,
                                               ScorePredicate::CompoundBoolOperator boolOperator,
                                               int children) {
  auto compound = std::make_unique<CompoundPredicate>(boolOperator);
  for (int child = 0; child < children; ++child)
    compound->AddPredicate(NewPredicate(fields, child));
  return compound;
}

/// A record and the vector that stands for the same case; a negative age and an empty text are missing.
struct Case {
  Case(double age, const std::string& color) {
    const bool isMissing = color == "none";
    record.Add("age", new NumericValue(age));
    record.Add("color", new StringValue(color));
    record.Add("plain", new StringValue(color));
    const double code = isMissing ? -2 : color == "red" ? 0 : 1;
    values = {age, code, code};
  }

  CaseRecord record;
  std::vector<double> values;
};

TEST(Evaluation, AllocatesNothing) {
  const Fields fields;
  const std::vector<std::unique_ptr<Case>> cases = [] {
    std::vector<std::unique_ptr<Case>> made;
    for (const double age : {5.0, 5000.0, kSysmis}) {
      for (const char* color : {"red", "blue", "none"})
        made.push_back(std::make_unique<Case>(age, color));
    }
    return made;
  }();
  for (const int children : {1, 64, 1000}) {
    for (const auto boolOperator : kOperators) {
      const auto compound = NewCompound(fields, boolOperator, children);
      const size_t before = kestrel_tests::CountAllocations();
      int different = 0;
      for (const auto& one : cases) {
        const Result byRecord = compound->Evaluate(&one->record, nullptr);
        different += byRecord != compound->Evaluate(one->values);
        static_cast<void>(compound->EvaluateSurrogate(one->values, children / 2));
      }
      EXPECT_EQ(kestrel_tests::CountAllocations(), before)
          << children << " children, operator " << boolOperator;
      EXPECT_EQ(different, 0);
    }
  }
}

TEST(Evaluation, IsTheSameFromSeveralThreads) {
  const Fields fields;
  auto tree = NewCompound(fields, ScorePredicate::kSurrogate, 0);
  for (const auto boolOperator : kOperators)
    tree->AddPredicate(NewCompound(fields, boolOperator, 8).release());
  const auto run = [&] {
    std::vector<Result> results;
    for (int i = 0; i < 2000; ++i) {
      const char* const colors[] = {"red", "blue", "none"};
      const Case one(i % 7 == 0 ? kSysmis : i % 40, colors[i % 3]);
      results.push_back(tree->Evaluate(&one.record, nullptr));
      results.push_back(tree->Evaluate(one.values));
    }
    return results;
  };
  const std::vector<Result> alone = run();
  std::vector<std::vector<Result>> together(4);
  std::vector<std::thread> threads;
  for (std::vector<Result>& results : together)
    threads.emplace_back([&results, &run] { results = run(); });
  for (std::thread& thread : threads)
    thread.join();
  for (const std::vector<Result>& results : together)
    EXPECT_EQ(results, alone);
}

TEST(Evaluation, OfDeepNestsTakesLittleStack) {
  const Fields fields;
  const Case young(5, "red");
  // A document nests elements to 512; the second row shows a level to take less than 1 KB of a 1 MB stack.
  for (const int depth : {512, 1000}) {
    for (const auto boolOperator : kOperators) {
      kestrel_test::RunOnStack(size_t{1} << 20, [&] {
        std::unique_ptr<ScorePredicate> nest(NewPredicate(fields, 0));
        for (int level = 0; level < depth; ++level) {
          auto around = NewCompound(fields, boolOperator, 0);
          around->AddPredicate(nest.release());
          nest = std::move(around);
        }
        const std::unique_ptr<ScorePredicate> clone(nest->Clone());
        nest.reset();
        EXPECT_EQ(clone->Evaluate(young.values), ScorePredicate::PredTrue);
        EXPECT_EQ(clone->Evaluate(&young.record, nullptr), ScorePredicate::PredTrue);
        EXPECT_FALSE(clone->IsDerivedPredictor());
      });
    }
  }
}

}  // namespace
}  // namespace MCKestrel_800
