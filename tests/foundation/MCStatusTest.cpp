#include "kestrel/foundation/MCStatus.h"

#include <gtest/gtest.h>

#include <iterator>
#include <limits>

namespace {

using MCScore::MCStatus;

TEST(MCStatus, IsOkByDefaultWithEveryFieldZero) {
  const MCStatus status;
  EXPECT_TRUE(status.IsOK());
  EXPECT_FALSE(status.IsWarning());
  EXPECT_FALSE(status.IsError());
  EXPECT_EQ(status.GetErrorCode(), 0);
  for (unsigned slot = 0; slot < 3; ++slot) {
    EXPECT_EQ(status.GetDiscreteDatum(slot), 0);
    EXPECT_EQ(status.GetScaleDatum(slot), 0.0);
  }
}

TEST(MCStatus, TellsWarningsFromErrors) {
  const MCStatus warning(5, true), error(5, false);
  EXPECT_TRUE(warning.IsWarning());
  EXPECT_FALSE(warning.IsOK());
  EXPECT_FALSE(warning.IsError());
  EXPECT_TRUE(error.IsError());
  EXPECT_FALSE(error.IsOK());
  EXPECT_FALSE(error.IsWarning());
  EXPECT_EQ(warning.GetErrorCode(), 5);
  EXPECT_EQ(error.GetErrorCode(), 5);
  EXPECT_FALSE(warning == error);
}

TEST(MCStatus, ComparesCodeSeverityAndEverySlot) {
  const MCStatus same(7, false);
  EXPECT_TRUE(same == MCStatus(7, false));
  EXPECT_FALSE(same == MCStatus(8, false));
  for (unsigned slot = 0; slot < 3; ++slot) {
    MCStatus discrete(7, false), scale(7, false);
    discrete.SetDiscreteDatum(slot, -3);
    scale.SetScaleDatum(slot, 1e-300);
    EXPECT_FALSE(same == discrete) << slot;
    EXPECT_FALSE(same == scale) << slot;
    EXPECT_EQ(discrete.GetDiscreteDatum(slot), -3);
    EXPECT_EQ(scale.GetScaleDatum(slot), 1e-300);
  }
}

TEST(MCStatus, ComparesNumbersWithoutTolerance) {
  MCStatus one(1, true), other(1, true);
  one.SetScaleDatum(2, 1.0);
  other.SetScaleDatum(2, 1.0 + std::numeric_limits<double>::epsilon());
  EXPECT_FALSE(one == other);
}

TEST(MCStatus, DiffersFromItselfWhenASlotHoldsNoNumber) {
  MCStatus status;
  status.SetScaleDatum(0, std::numeric_limits<double>::quiet_NaN());
  EXPECT_FALSE(status == status);
  EXPECT_TRUE(status.IsOK());
}

TEST(MCStatus, KeepsTheWholeRangeOf32Bits) {
  for (const long code : {-2147483647L - 1, -1L, 0L, 2147483647L}) {
    MCStatus status(code, true);
    status.SetDiscreteDatum(1, code);
    EXPECT_EQ(status.GetErrorCode(), code);
    EXPECT_EQ(status.GetDiscreteDatum(1), code);
  }
}

TEST(MCStatus, CopiesEverySlot) {
  MCStatus one(90027, false), copy;
  one.SetDiscreteDatum(0, 1);
  one.SetDiscreteDatum(2, 3);
  one.SetScaleDatum(1, 2.5);
  copy = one;
  const MCStatus second(one);
  for (const MCStatus& each : {copy, second}) {
    EXPECT_TRUE(each == one);
    EXPECT_TRUE(each.IsError());
    EXPECT_EQ(each.GetErrorCode(), 90027);
    EXPECT_EQ(each.GetDiscreteDatum(0), 1);
    EXPECT_EQ(each.GetDiscreteDatum(1), 0);
    EXPECT_EQ(each.GetDiscreteDatum(2), 3);
    EXPECT_EQ(each.GetScaleDatum(1), 2.5);
  }
}

TEST(StatusNames, StandInTheirOrder) {
  const char* const kWanted[] = {
      "kE_PARSE",         "kE_NODICTVAR",  "kE_NOCHILD",      "kE_NULLCHILD",          "kE_ANCESTORCHILD",
      "kE_ZEROCHILD",     "kE_NULLARG",    "kE_NOTCHILD",     "kE_NODENOTCHILD",       "kE_SIBLING",
      "kE_NOTSIBLING",    "kE_ANCESTOR",   "kE_IO",           "kE_CONVERTVALUE",       "kE_OUTOFDOMAIN",
      "kE_NOPARAM",       "kE_SEMANTIC",   "kE_UNKNOWNMODEL", "kE_MISSINGVAR",         "kE_SPLITVARINVALID",
      "kE_MSGFMT",        "kE_DIFFTARGET", "kE_VALUECLASH",   "kE_UNSUP_VALUE",        "kE_INVALID_VALUE",
      "kE_UNKNOWN_ERROR", "kE_MISSINGVAR", "kE_UNSUP_METHOD", "kE_NO_FIRES_NO_DEFAULT"};
  const size_t count = std::size(kWanted);
  ASSERT_EQ(MCScore::StatusNameCount(), count);
  for (size_t i = 0; i < count; ++i)
    EXPECT_STREQ(MCScore::StatusName(i), kWanted[i]) << i;
  EXPECT_STREQ(MCScore::StatusName(count), "");
  EXPECT_EQ(MCScore::StatusName(count + 1), nullptr);
}

}  // namespace
