#include "kestrel/foundation/KestrelException.h"

#include <gtest/gtest.h>

#include <exception>
#include <string>
#include <type_traits>

namespace MCKestrel_800 {
namespace {

TEST(KestrelException, IsEmptyByDefault) {
  const KestrelException fault;
  EXPECT_EQ(fault.GetErrorCode(), 0);
  EXPECT_EQ(fault.GetErrorMessage(), "");
  EXPECT_EQ(fault.GetLine(), 0u);
  EXPECT_EQ(fault.GetColumn(), 0u);
}

TEST(KestrelException, CarriesCodeTextAndPlaceThroughThrowAndCopy) {
  try {
    KestrelException fault(KestrelException::kUnknownVariable, "x: Invalid Split Variable!");
    fault.SetPlace(12, 7);
    throw fault;
  } catch (const KestrelException& caught) {
    KestrelException copy;
    copy = caught;
    EXPECT_EQ(copy.GetErrorCode(), 8);
    EXPECT_EQ(copy.GetErrorMessage(), "x: Invalid Split Variable!");
    EXPECT_EQ(copy.GetLine(), 12u);
    EXPECT_EQ(copy.GetColumn(), 7u);
  }
}

TEST(KestrelException, KeepsItsOwnCopyOfTheText) {
  std::string text = "Value list is required!";
  const KestrelException fault(KestrelException::kMissingElement, text);
  const KestrelException copy(fault);
  text.assign("something else");
  EXPECT_EQ(fault.GetErrorMessage(), "Value list is required!");
  EXPECT_EQ(copy.GetErrorMessage(), "Value list is required!");
  EXPECT_EQ(copy.GetErrorCode(), 4);
  EXPECT_NE(&copy.GetErrorMessage(), &fault.GetErrorMessage());
}

TEST(KestrelException, IsNoStandardException) {
  EXPECT_FALSE((std::is_base_of_v<std::exception, KestrelException>));
  EXPECT_TRUE(std::has_virtual_destructor_v<KestrelException>);
}

TEST(KestrelException, CodesKeepTheirNumbers) {
  struct Row {
    KestrelException::ExceptionCode code;
    int number;
  };
  constexpr Row kRows[] = {{KestrelException::kNone, 0},
                           {KestrelException::kStructure, 1},
                           {KestrelException::kFile, 2},
                           {KestrelException::kConversion, 3},
                           {KestrelException::kMissingElement, 4},
                           {KestrelException::kUnsupported, 5},
                           {KestrelException::kInvalidDocument, 6},
                           {KestrelException::kInvalidValue, 7},
                           {KestrelException::kUnknownVariable, 8},
                           {KestrelException::kInvalidOperator, 9},
                           {KestrelException::kReserved, 10},
                           {KestrelException::kInvalidType, 11},
                           {KestrelException::kInconsistentDictionary, 12}};
  for (const Row& row : kRows)
    EXPECT_EQ(static_cast<int>(row.code), row.number);
}

}  // namespace
}  // namespace MCKestrel_800
