// Formulas of several operations beside the same operations done one at a time, each with its own rules for
// what is missing or too large.

#include <gtest/gtest.h>

#include <cmath>
#include <iterator>
#include <limits>
#include <memory>
#include <random>

#include "kestrel/transform/FunctionEvaluation.h"
#include "tests/transform/DerivedFields.h"

namespace {

using namespace MCKestrel_800;
using namespace kestrel_test;

constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kLargest = std::numeric_limits<double>::max();

constexpr double kNumbers[] = {
    kSysmis,  kInfinity,    -kInfinity,    std::numeric_limits<double>::quiet_NaN(),
    kLargest, kLargest / 2, -kLargest / 2, 1e200,
    -1e200,   1e-200,       -1e-200,       0.0,
    -0.0,     1.0,          -1.0,          2.0,
    3.7,
};

/// Random formulas of x, y and constants, and what they come to.
class Formulas {
 public:
  explicit Formulas(unsigned seed) : random_(seed) {}

  double DrawNumber() { return kNumbers[random_() % std::size(kNumbers)]; }

  FunctionTree* Draw(int depth) {
    const unsigned kind = random_() % 10;
    if (depth == 0 || kind == 0) return DrawLeaf();
    // A function of another kind between them now and then.
    if (kind == 1) return DrawCall(kAbsFunction, 1, depth);
    constexpr TransformFunction kOperations[] = {kPlusFunction, kMinusFunction, kMultiplyFunction,
                                                 kDivideFunction};
    return DrawCall(kOperations[random_() % 4], 2, depth);
  }

  static double Compute(const FunctionTree& node, double x, double y) {
    const ApplyNodeStats& stats = node.GetNodeStats();
    const TransformFunction function = stats.GetTransFunction();
    if (function == kNoFunction) {
      if (stats.IsConstNode()) return stats.GetValue()->GetDouble();
      const double number = stats.GetParameterName() == "x" ? x : y;
      const ScoreValue* const instead = stats.GetFieldrefRecodeMissValueTo();
      return instead != nullptr && number == kSysmis ? instead->GetDouble() : number;
    }
    const double left = Compute(*node.GetChildAt(0), x, y);
    const double right = node.GetChildCount() > 1 ? Compute(*node.GetChildAt(1), x, y) : kSysmis;
    const double result = Operate(function, left, right);
    const ScoreValue* const instead = stats.GetRecodeMissValueTo();
    return instead != nullptr && result == kSysmis ? instead->GetDouble() : result;
  }

 private:
  static double Operate(TransformFunction function, double left, double right) {
    switch (function) {
      case kPlusFunction:
        return PlusNumbers(left, right);
      case kMinusFunction:
        return MinusNumbers(left, right);
      case kMultiplyFunction:
        return MultiplyNumbers(left, right);
      case kDivideFunction:
        return DivideNumbers(left, right);
      default:
        return ApplyTransFunction(left, right, function);
    }
  }

  FunctionTree* DrawLeaf() {
    if (random_() % 3 == 0) return ConstantLeaf(Number(DrawNumber()));
    ApplyNodeStats stats;
    stats.SetParameterName(random_() % 2 == 0 ? "x" : "y");
    if (random_() % 5 == 0) stats.SetFieldrefRecodeMissValueTo(Number(DrawNumber()));
    return new FunctionTreeImp(stats);
  }

  FunctionTree* DrawCall(TransformFunction function, int arguments, int depth) {
    ApplyNodeStats stats;
    stats.SetTransFunction(function);
    if (random_() % 6 == 0) stats.SetRecodeMissValueTo(Number(DrawNumber()));
    auto* node = new FunctionTreeImp(stats);
    for (int i = 0; i < arguments; ++i)
      node->Add(Draw(depth - 1));
    return node;
  }

  std::mt19937 random_;
};

TEST(Arithmetic, OfFormulasIsThatOfTheirOperations) {
  Formulas formulas(8);
  int numbers = 0, missing = 0;
  for (int round = 0; round < 400; ++round) {
    Data data;
    TransformationDictionary dictionary;
    FunctionTree* const root = formulas.Draw(1 + round % 5);
    AddDerived(dictionary, NewApply("f", root));
    dictionary.SetUpDerivedCaseRecord();
    for (int number = 0; number < 40; ++number) {
      const double x = formulas.DrawNumber(), y = formulas.DrawNumber();
      data.record.SetValue("x", x);
      data.record.SetValue("y", y);
      const double wanted = NumberOrMissing(Formulas::Compute(*root, x, y));
      const double found =
          dictionary.GetValuesForDerivedVars(&data.record, &data.dictionary)->Get(0)->GetDouble();
      ASSERT_EQ(found, wanted) << "formula " << round << " of " << x << ", " << y;
      ASSERT_EQ(std::signbit(found), std::signbit(wanted)) << "formula " << round << " of " << x << ", " << y;
      ++(wanted == kSysmis ? missing : numbers);
    }
  }
  EXPECT_GT(numbers, 2000);
  EXPECT_GT(missing, 2000);
}

}  // namespace
