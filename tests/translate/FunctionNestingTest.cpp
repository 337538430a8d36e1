// Names of functions, and which functions may stand inside which.

#include <gtest/gtest.h>

#include <set>
#include <string>

#include "kestrel/foundation/KestrelException.h"
#include "kestrel/translate/PMMLTranslator.h"

namespace {

using namespace MCKestrel_800;

constexpr int kLastCode = 68;

TEST(FunctionNesting, NamesCountExactly) {
  PMMLTranslator::InitFunctionMap();
  EXPECT_EQ(PMMLTranslator::GetTransFunction("avg"), kMeanFunction);
  EXPECT_EQ(PMMLTranslator::GetTransFunction("mean"), kMeanFunction);
  EXPECT_EQ(PMMLTranslator::GetTransFunction("+"), kPlusFunction);
  EXPECT_EQ(PMMLTranslator::GetTransFunction("imputeCatFieldMissingAgainstConTarget"), kImputeFunction);
  for (const char* name : {"", "Mean", " mean", "mean ", "none"})
    EXPECT_EQ(PMMLTranslator::GetTransFunction(name), kNoFunction) << name;
}

TEST(FunctionNesting, FunctionsAreOfNumbersOrOfTexts) {
  std::set<int> numeric = {30, 60, 64, 66, 67};
  for (int code = 0; code <= 22; ++code)
    numeric.insert(code);
  const std::set<int> string = {23, 25, 26, 27, 29, 68};
  for (int code = 0; code <= kLastCode; ++code) {
    const auto function = static_cast<TransformFunction>(code);
    EXPECT_EQ(PMMLTranslator::IsNumericFunction(function), numeric.count(code) == 1) << code;
    EXPECT_EQ(PMMLTranslator::IsStringFunction(function), string.count(code) == 1) << code;
  }
}

/// What is said of a function in another; empty when it fits.
std::string FaultOf(TransformFunction parent, TransformFunction child) {
  try {
    PMMLTranslator::VerifyParentAndChildFunction(nullptr, parent, child);
    return std::string();
  } catch (const KestrelException& fault) {
    EXPECT_EQ(fault.GetErrorCode(), KestrelException::kInvalidDocument);
    return fault.GetErrorMessage();
  }
}

TEST(FunctionNesting, ParentsTakeTheirKind) {
  for (int code = 0; code <= kLastCode; ++code) {
    const auto child = static_cast<TransformFunction>(code);
    const bool is_numeric = PMMLTranslator::IsNumericFunction(child);
    const bool is_string = PMMLTranslator::IsStringFunction(child);
    EXPECT_EQ(FaultOf(kMeanFunction, child),
              is_numeric || child == kLengthFunction ? "" : "Numeric function is required!")
        << code;
    EXPECT_EQ(FaultOf(kConcatFunction, child), is_string ? "" : "string function is required!") << code;
    EXPECT_EQ(FaultOf(kLengthFunction, child), is_string ? "" : "apply functions don't match!") << code;
    EXPECT_EQ(FaultOf(kEqualFunction, child), "") << code;
  }
}

}  // namespace
