// Constants of the library's classes have one address, which programs and plug-ins can take, on every system.

#include <gtest/gtest.h>

#include <cstdint>
#include <limits>

#include "kestrel/dictionary/TextCodes.h"
#include "kestrel/dictionary/ValueIndex.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/MCMV.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/PliantString.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/math/MCPower.h"
#include "kestrel/model/BaseModel.h"

namespace {

/// Models of plug-ins see what is protected.
struct PluginModel : MCKestrel_800::BaseModel {
  using BaseModel::kNoPrediction;
};

template <typename Number>
struct Constant {
  const char* name;
  const volatile Number* address;
  Number want;
};

template <typename Number, size_t count>
void ExpectValues(const Constant<Number> (&constants)[count]) {
  for (const Constant<Number>& constant : constants)
    EXPECT_EQ(*constant.address, constant.want) << constant.name;
}

TEST(ExportedConstants, CanBeBoundTo) {
  using namespace MCKestrel_800;
  using MCMath_800::MCPower;
  ExpectValues<double>({
      {"gMissingValue", &MCCommon_800::MCMV::gMissingValue, -1.7976931348623157e308},
      {"gSysmisValue", &NumericValue::gSysmisValue, -1.7976931348623157e308},
      {"gInfinity", &NumericValue::gInfinity, std::numeric_limits<double>::infinity()},
      {"fEpsilon", &NumericValue::fEpsilon, 2.22045e-14},
      {"gMachineEpsilon", &MCPower::gMachineEpsilon, 2.220446049250313e-16},
      {"gMachineMaxExp", &MCPower::gMachineMaxExp, 709.0},
      {"gMachineMinExp", &MCPower::gMachineMinExp, -708.39},
  });
  ExpectValues<int>({
      {"kUnknown", &TextCodes::kUnknown, -1},
      {"MAX_STRING", &StringValue::MAX_STRING, 255},
      {"gMachineMaxInt", &MCPower::gMachineMaxInt, 2147483647},
  });
  ExpectValues<int64_t>({
      {"fJan_1_1970_JulianDay", &DateTimeValue::fJan_1_1970_JulianDay, 2440588},
      {"fSeconds_Per_Day", &DateTimeValue::fSeconds_Per_Day, 86400},
      {"fDaysInMonth", &DateTimeValue::fDaysInMonth[2], 28},
      {"fDaysBeforeMonth", &DateTimeValue::fDaysBeforeMonth[2], 31},
  });
  ExpectValues<size_t>({
      {"ValueIndex::kNone", &ValueIndex::kNone, static_cast<size_t>(-1)},
      {"npos", &MCXML_800::PliantString::npos, static_cast<size_t>(-1)},
  });
  ExpectValues<long>({{"kNoPrediction", &PluginModel::kNoPrediction, 90027}});
}

}  // namespace
