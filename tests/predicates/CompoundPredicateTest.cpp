#include "kestrel/predicates/CompoundPredicate.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "kestrel/predicates/ConstantPredicates.h"
#include "kestrel/predicates/SimplePredicate.h"
#include "tests/predicates/CompoundRules.h"
#include "tests/predicates/TestPredicates.h"

namespace MCKestrel_800 {
namespace {

constexpr ScorePredicate::CompoundBoolOperator kOperators[] = {
    ScorePredicate::kOr, ScorePredicate::kAnd, ScorePredicate::kXor, ScorePredicate::kSurrogate};

/// A compound of fixed results, such as "TFU".
struct Fixed {
  Fixed(ScorePredicate::CompoundBoolOperator boolOperator, const std::string& children)
      : predicate(boolOperator) {
    for (const char letter : children)
      predicate.AddPredicate(
          new FixedPredicate(static_cast<Result>(std::string(kLetters).find(letter)), &asked));
  }

  CompoundPredicate predicate;
  int asked = 0;
};

/// All texts of up to four letters.
std::vector<std::string> AllChildren() {
  std::vector<std::string> all = {""};
  for (std::size_t i = 0; i < all.size() && all[i].size() < 4; ++i) {
    for (const char* letter = kLetters; *letter != '\0'; ++letter)
      all.push_back(all[i] + *letter);
  }
  return all;
}

TEST(CompoundPredicate, FollowsItsRulesForEveryListOfResults) {
  const std::vector<std::string> all = AllChildren();
  ASSERT_EQ(all.size(), 1u + 4 + 16 + 64 + 256);
  for (const auto boolOperator : kOperators) {
    for (const std::string& children : all) {
      const Verdict verdict = VerdictOf(boolOperator, children);
      Fixed byVector(boolOperator, children), byRecord(boolOperator, children);
      EXPECT_EQ(LetterOf(byVector.predicate.Evaluate({})), verdict.letter) << boolOperator << " " << children;
      EXPECT_EQ(LetterOf(byRecord.predicate.Evaluate(nullptr, nullptr)), verdict.letter)
          << boolOperator << " " << children;
      EXPECT_EQ(byVector.asked, static_cast<int>(verdict.asked)) << boolOperator << " " << children;
      EXPECT_EQ(byRecord.asked, static_cast<int>(verdict.asked)) << boolOperator << " " << children;
    }
  }
}

TEST(CompoundPredicate, DecidesTheCasesThatAreEasilyMistaken) {
  struct Row {
    const char* why;
    ScorePredicate::CompoundBoolOperator boolOperator;
    const char* children;
    char letter;
  };
  const Row kRows[] = {
      {"an empty or", ScorePredicate::kOr, "", 'F'},
      {"an empty and", ScorePredicate::kAnd, "", 'T'},
      {"an empty xor", ScorePredicate::kXor, "", 'F'},
      {"an empty list of surrogates", ScorePredicate::kSurrogate, "", 'U'},
      {"three true children of xor", ScorePredicate::kXor, "TTT", 'T'},
      {"xor with an unknown child at the end", ScorePredicate::kXor, "TFU", 'U'},
      {"a true surrogate", ScorePredicate::kSurrogate, "UT", 'S'},
      {"a false surrogate", ScorePredicate::kSurrogate, "UF", 'F'},
      {"the first is true", ScorePredicate::kSurrogate, "TU", 'T'},
      {"a single unknown one", ScorePredicate::kSurrogate, "U", 'U'},
      {"a list within a list", ScorePredicate::kSurrogate, "S", 'S'},
      {"a surrogate's surrogate", ScorePredicate::kSurrogate, "US", 'S'},
      {"true by a surrogate is not true to or", ScorePredicate::kOr, "S", 'F'},
      {"nor to xor", ScorePredicate::kXor, "S", 'F'},
      {"nor false to and", ScorePredicate::kAnd, "S", 'T'},
  };
  for (const Row& row : kRows) {
    const Fixed fixed(row.boolOperator, row.children);
    EXPECT_EQ(LetterOf(fixed.predicate.Evaluate({})), row.letter) << row.why;
    EXPECT_EQ(LetterOf(fixed.predicate.Evaluate(nullptr, nullptr)), row.letter) << row.why;
  }
}

TEST(CompoundPredicate, StartsAListOfSurrogatesAnywhere) {
  for (const auto boolOperator : kOperators) {
    for (const std::string& children : AllChildren()) {
      const Fixed fixed(boolOperator, children);
      for (int start = -2; start <= 5; ++start) {
        const bool isInList = start >= 0 && start < static_cast<int>(children.size());
        const char want =
            boolOperator == ScorePredicate::kSurrogate && isInList
                ? VerdictOf(boolOperator, children.substr(static_cast<std::size_t>(start))).letter
                : 'F';
        EXPECT_EQ(LetterOf(fixed.predicate.EvaluateSurrogate({}, start)), want)
            << boolOperator << " " << children << " from " << start;
      }
    }
  }
}

TEST(CompoundPredicate, IsUnknownWithAnyOtherOperator) {
  for (const int number : {-1, 4, 1000}) {
    const auto boolOperator = static_cast<ScorePredicate::CompoundBoolOperator>(number);
    const Fixed fixed(boolOperator, "T");
    EXPECT_EQ(LetterOf(fixed.predicate.Evaluate({})), 'U') << number;
    EXPECT_EQ(LetterOf(fixed.predicate.Evaluate(nullptr, nullptr)), 'U') << number;
    EXPECT_EQ(LetterOf(fixed.predicate.EvaluateSurrogate({}, 0)), 'F') << number;
    EXPECT_EQ(fixed.asked, 0);
  }
}

TEST(CompoundPredicate, IsAListOfSurrogatesUnlessTold) {
  CompoundPredicate predicate;
  EXPECT_EQ(predicate.GetBoolOperator(), 3);
  predicate.AddPredicate(new FixedPredicate(ScorePredicate::PredUnknown));
  predicate.AddPredicate(new FixedPredicate(ScorePredicate::PredTrue));
  EXPECT_EQ(predicate.Evaluate({}), ScorePredicate::PredSurrogateTrue);
  predicate.SetBoolOperator(ScorePredicate::kOr);
  EXPECT_EQ(predicate.GetBoolOperator(), 0);
  EXPECT_EQ(predicate.Evaluate({}), ScorePredicate::PredTrue);
  EXPECT_EQ(CompoundPredicate(ScorePredicate::kAnd).GetBoolOperator(), 1);
  EXPECT_EQ(CompoundPredicate(ScorePredicate::kXor).GetBoolOperator(), 2);
}

TEST(CompoundPredicate, OwnsItsChildrenUntilTheyAreRemoved) {
  ASSERT_EQ(FixedPredicate::Alive(), 0);
  {
    CompoundPredicate predicate(ScorePredicate::kOr);
    auto *const a = new TruePredicate, *const b = new TruePredicate;
    auto* const c = new FixedPredicate(ScorePredicate::PredFalse);
    predicate.AddPredicate(a);
    predicate.AddPredicate(nullptr);
    predicate.AddPredicate(b);
    predicate.AddPredicate(c);
    EXPECT_EQ(predicate.GetCount(), 3) << "null is refused";
    EXPECT_EQ(predicate.GetPredicates(), (std::vector<ScorePredicate*>{a, b, c}));
    EXPECT_EQ(static_cast<const CompoundPredicate&>(predicate).GetPredicates().size(), 3u);

    EXPECT_TRUE(predicate.RemovePredicate(b)) << "found by its address";
    EXPECT_EQ(predicate.GetPredicates(), (std::vector<ScorePredicate*>{a, c}));
    EXPECT_FALSE(predicate.RemovePredicate(b)) << "it is not there any more";
    EXPECT_FALSE(predicate.RemovePredicate(nullptr));
    EXPECT_EQ(predicate.GetCount(), 2);
    delete b;
    EXPECT_EQ(FixedPredicate::Alive(), 1);
  }
  EXPECT_EQ(FixedPredicate::Alive(), 0);
}

TEST(CompoundPredicate, CopiesDeeply) {
  {
    auto predicate = std::make_unique<CompoundPredicate>(ScorePredicate::kAnd);
    auto inner = std::make_unique<CompoundPredicate>();
    inner->AddPredicate(new FixedPredicate(ScorePredicate::PredUnknown));
    inner->AddPredicate(new FixedPredicate(ScorePredicate::PredTrue));
    predicate->AddPredicate(inner.release());
    predicate->AddPredicate(new FixedPredicate(ScorePredicate::PredTrue));
    const std::unique_ptr<CompoundPredicate> clone(predicate->Clone());
    const CompoundPredicate copy(*predicate);
    EXPECT_EQ(FixedPredicate::Alive(), 9);
    predicate.reset();
    EXPECT_EQ(FixedPredicate::Alive(), 6);
    for (const CompoundPredicate* other : {const_cast<const CompoundPredicate*>(clone.get()), &copy}) {
      EXPECT_EQ(other->GetBoolOperator(), ScorePredicate::kAnd);
      EXPECT_EQ(other->GetCount(), 2);
      EXPECT_EQ(other->Evaluate({}), ScorePredicate::PredTrue);
    }
  }
  EXPECT_EQ(FixedPredicate::Alive(), 0);
}

TEST(CompoundPredicate, HasNoSplit) {
  const auto age = MakeAge();
  const auto split = Below(age.get(), 18);
  CompoundPredicate predicate;
  predicate.SetSplit(split.get());
  EXPECT_EQ(predicate.GetSplit(), nullptr);
  EXPECT_EQ(predicate.GetPredType(), 0);
  EXPECT_EQ(DisplayOf(predicate), "Compound Predicate: \n");
}

TEST(CompoundPredicate, IsDerivedWhenAChildIs) {
  CompoundPredicate predicate;
  EXPECT_FALSE(predicate.IsDerivedPredictor());
  int asked = 0;
  for (const bool isDerived : {false, true, false})
    predicate.AddPredicate(new FixedPredicate(ScorePredicate::PredTrue, &asked, isDerived));
  EXPECT_TRUE(predicate.IsDerivedPredictor());
  EXPECT_EQ(asked, 2) << "in their order, up to the first";
  const std::unique_ptr<ScorePredicate> second(predicate.GetPredicates()[1]);
  predicate.RemovePredicate(second.get());
  EXPECT_FALSE(predicate.IsDerivedPredictor());

  const DerivedVar derived("d", ScoreDictVar::kNUMERIC_VAR);
  auto inner = std::make_unique<CompoundPredicate>();
  inner->AddPredicate(new SimplePredicate(Below(&derived, 0).release()));
  predicate.AddPredicate(inner.release());
  EXPECT_TRUE(predicate.IsDerivedPredictor()) << "a child's child";
}

}  // namespace
}  // namespace MCKestrel_800
