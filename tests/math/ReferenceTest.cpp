#include <gtest/gtest.h>

#include <cmath>
#include <ostream>
#include <sstream>
#include <string>
#include <vector>

#include "tests/math/ReferenceFunctions.h"

namespace kestrel_tests {

void PrintTo(const ReferenceFunction& function, std::ostream* out) {
  *out << function.name;
}

}  // namespace kestrel_tests

namespace {

using namespace kestrel_tests;

/// One function and how its error looks over a part of its table.
class ReferenceTest : public testing::TestWithParam<ReferenceFunction> {};

std::string ArgumentsOf(const ReferencePoint& point) {
  std::ostringstream text;
  text.precision(17);
  for (const double argument : point.arguments)
    text << ' ' << argument;
  return text.str();
}

// The whole tables, with Boost.Math beside, are what `./dev bench accuracy` judges.
TEST_P(ReferenceTest, KeepsItsGoalAtEveryTwentiethPoint) {
  const ReferenceFunction& function = GetParam();
  const std::vector<ReferencePoint> points = ReadReferencePoints(function, 20);
  ASSERT_GE(points.size(), 50u);
  int failures = 0;
  for (const ReferencePoint& point : points) {
    const double value = function.call(point.arguments);
    const double error = RelativeError(value, point);
    const double allowed = std::fabs(point.value) >= kBodyFrom ? function.goal.body : function.goal.tail;
    if (error <= allowed) continue;
    // A fault of a whole region would print hundreds of lines.
    if (++failures <= 5) {
      ADD_FAILURE() << function.name << " at" << ArgumentsOf(point) << ": " << value << ", relative error "
                    << error << ", allowed " << allowed;
    }
  }
  EXPECT_EQ(failures, 0) << "of " << points.size() << " points";
}

TEST_P(ReferenceTest, TurnsBackAsFarAsItsResultIsADouble) {
  const ReferenceFunction& function = GetParam();
  if (function.back.call == nullptr) return;
  for (const ReferencePoint& point : ReadReferencePoints(function, 20)) {
    const RoundTrip trip = TurnBack(function, point.arguments);
    EXPECT_LE(trip.difference, trip.rounding + kTurnedBack) << function.name << " at" << ArgumentsOf(point);
  }
}

std::string NameOf(const testing::TestParamInfo<ReferenceFunction>& info) {
  const std::string name = info.param.name;
  const size_t end = name.find(')');
  const std::string part = name.size() > end + 2 ? "_" + name.substr(end + 2) : "";
  return name.substr(0, name.find('(')) + part;
}

INSTANTIATE_TEST_SUITE_P(DistFun, ReferenceTest, testing::ValuesIn(ReferenceFunctions()), NameOf);

}  // namespace
