// Where a number stands among ascending ones, for numbers spread in every way.

#include "kestrel/transform/NumberSearch.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <random>
#include <vector>

namespace {

using namespace MCKestrel_800;

constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kLargest = std::numeric_limits<double>::max();
constexpr double kSmallest = std::numeric_limits<double>::denorm_min();

void Compare(std::vector<double> numbers) {
  std::sort(numbers.begin(), numbers.end());
  const NumberSearch search(numbers);
  std::vector<double> asked = {-kInfinity, -kLargest, -1.0, -0.0, 0.0, kSmallest, 1.0, kLargest, kInfinity};
  for (const double number : numbers) {
    for (const double to : {-kInfinity, number, kInfinity})
      asked.push_back(std::nextafter(number, to));
  }
  for (std::size_t i = 1; i < numbers.size(); ++i)
    asked.push_back(numbers[i - 1] / 2 + numbers[i] / 2);
  for (const double x : asked) {
    if (std::isnan(x)) continue;
    const auto wanted = std::lower_bound(numbers.begin(), numbers.end(), x) - numbers.begin();
    ASSERT_EQ(search.FirstNotBelow(x), static_cast<std::size_t>(wanted))
        << x << " in " << testing::PrintToString(numbers);
  }
  ASSERT_LE(search.FirstNotBelow(std::numeric_limits<double>::quiet_NaN()), numbers.size());
}

TEST(NumberSearch, FindsTheFirstThatIsNotBelow) {
  const struct {
    const char* why;
    std::vector<double> numbers;
  } kRows[] = {
      {"none", {}},
      {"one", {3.0}},
      {"one that is infinite", {kInfinity}},
      {"zeros of both signs", {-0.0, 0.0}},
      {"the same again and again", {2.0, 2.0, 2.0, 2.0, 2.0}},
      {"evenly spread", {0.0, 0.1, 0.2, 0.3, 0.4, 0.5, 0.6, 0.7, 0.8, 0.9, 1.0}},
      {"all but one close together", {1.0, 1.1, 1.2, 1.3, 1.4, 1.5, 1.6, 1.7, 1e9}},
      {"each ten times the one before", {1e-3, 1e-2, 1e-1, 1.0, 1e1, 1e2, 1e3, 1e4, 1e5}},
      {"open at both ends", {-kInfinity, -kInfinity, 1.0, 2.0, 4.0, kInfinity, kInfinity}},
      {"nothing but infinities", {-kInfinity, kInfinity}},
      {"a range too wide for a number", {-kLargest, -1.0, 0.0, 1.0, kLargest}},
      {"a range as wide as numbers go", {0.0, 1.0, kLargest}},
      {"the smallest numbers", {-kSmallest, 0.0, kSmallest, 2 * kSmallest, 5 * kSmallest}},
      {"neighbours", {1.0, std::nextafter(1.0, 2.0), 1.0 + 1e-15, 1.0 + 2e-15}},
  };
  for (const auto& row : kRows) {
    SCOPED_TRACE(row.why);
    Compare(row.numbers);
  }
}

TEST(NumberSearch, FindsItInRandomNumbers) {
  std::mt19937 random(5);
  const auto draw = [&random] { return static_cast<double>(random()) / 4294967296.0; };
  for (int round = 0; round < 300; ++round) {
    std::vector<double> numbers(random() % 60);
    const double power = std::pow(10.0, static_cast<double>(random() % 5));
    for (double& number : numbers)
      number = std::pow(draw(), power) * 1000.0 - static_cast<double>(random() % 2) * 500.0;
    Compare(numbers);
  }
}

}  // namespace
