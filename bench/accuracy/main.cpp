// How right and how fast the distribution functions are: prints docs/accuracy.md.
//
// Judged by the reference tables of tests/data/math/, with Boost.Math on the same points beside. `--smoke`
// takes every hundredth point and one round, to see that it runs.

#include <algorithm>
#include <chrono>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <sstream>
#include <string>
#include <vector>

#include "bench/accuracy/BoostFunctions.h"
#include "bench/support/Interleaved.h"
#include "tests/math/ReferenceFunctions.h"

namespace kestrel_bench {
namespace {

using kestrel_tests::ReferenceFunction;
using kestrel_tests::ReferencePoint;

using Function = double (*)(const double* arguments);
using Points = std::vector<ReferencePoint>;

struct Effort {
  size_t step;
  int rounds;
  /// What one turn of the slowest contestant may take, in seconds.
  double turn;
};
constexpr Effort kFull = {1, 5, 0.1};
constexpr Effort kSmoke = {100, 1, 0.001};

/// Rounding a number once takes this much of it.
constexpr double kRounding = 0x1p-53;

/// An error so many times as large as the other contestant's is worse than it.
constexpr double kTimes = 10.0;

/// The shortest decimal that is this double; whole numbers without an exponent.
std::string Shortest(double number) {
  char text[40];
  std::snprintf(text, sizeof text, "%.0f", number);
  if (std::fabs(number) < 1e9 && std::strtod(text, nullptr) == number) return text;
  for (int digits = 1; digits <= 17; ++digits) {
    std::snprintf(text, sizeof text, "%.*g", digits, number);
    if (std::strtod(text, nullptr) == number) break;
  }
  return text;
}

std::string Arguments(const ReferenceFunction& function, const ReferencePoint& point) {
  std::istringstream columns(function.arguments);
  std::string text, column;
  for (size_t i = 0; columns >> column; ++i)
    text += (i == 0 ? "" : ", ") + Shortest(point.arguments[i]);
  return text;
}

std::string Marked(double figure, bool missed) {
  char text[40];
  std::snprintf(text, sizeof text, missed ? "**%.1e**" : "%.1e", figure);
  return figure > 0.0 ? text : "-";
}

/// The errors of one contestant at every point.
class Errors {
 public:
  Errors(Function function, const Points& points) {
    for (const ReferencePoint& point : points)
      errors_.push_back(RelativeError(function(point.arguments), point));
  }

  double operator[](size_t i) const { return errors_[i]; }

  size_t Worst() const {
    return static_cast<size_t>(std::max_element(errors_.begin(), errors_.end()) - errors_.begin());
  }

  double NinetyNinePointNine() const {
    std::vector<double> sorted = errors_;
    std::sort(sorted.begin(), sorted.end());
    return sorted[(sorted.size() - 1) * 999 / 1000];
  }

  /// The largest error where `select` holds; 0 when there is no such point.
  template <class Select>
  double Largest(Select select) const {
    double largest = 0.0;
    for (size_t i = 0; i < errors_.size(); ++i) {
      if (select(i)) largest = std::max(largest, errors_[i]);
    }
    return largest;
  }

  /// How much worse than another contestant at every point, an error below the noise there being as good as
  /// none.
  std::vector<double> RatiosTo(const Errors& other, const std::vector<double>& noise) const {
    std::vector<double> ratios;
    for (size_t i = 0; i < errors_.size(); ++i)
      ratios.push_back(errors_[i] / std::max(other[i], noise[i]));
    return ratios;
  }

  /// "1.2e-15", with the number of points that have no number or nothing like the right one.
  std::string Summary() const {
    const auto lost = [this](size_t i) { return errors_[i] > 0.01; };
    std::string text = Marked(Largest([&](size_t i) { return !lost(i); }), false);
    size_t count = 0;
    for (size_t i = 0; i < errors_.size(); ++i)
      count += lost(i);
    if (count > 0) text += ", " + std::to_string(count) + " lost";
    return text;
  }

 private:
  std::vector<double> errors_;
};

/// What rounding alone does to a result, relative to it: its own, or that of the probability that an inverse
/// is given, which moves its result by so much.
std::vector<double> NoiseAt(const ReferenceFunction& function, const Points& points) {
  std::vector<double> noise;
  for (const ReferencePoint& point : points)
    noise.push_back(kRounding * std::max(1.0, Condition(function, point)));
  return noise;
}

void PrintRatios(const std::vector<double>& ratios, const ReferenceFunction& function, const Points& points) {
  const auto worst = std::max_element(ratios.begin(), ratios.end());
  const auto above = std::count_if(ratios.begin(), ratios.end(), [](double ratio) { return ratio > kTimes; });
  const ReferencePoint& point = points[static_cast<size_t>(worst - ratios.begin())];
  std::printf(above > 0 ? " **%.3g** | **%ld** | %s |" : " %.3g | %ld | %s |", *worst,
              static_cast<long>(above), Arguments(function, point).c_str());
}

/// Prints one row and returns whether the function is right at all.
bool PrintErrors(const ReferenceFunction& function, const Points& points) {
  const Errors ours(function.call, points);
  const auto in_body = [&](size_t i) { return std::fabs(points[i].value) >= kestrel_tests::kBodyFrom; };
  const double body = ours.Largest(in_body);
  const double tail = ours.Largest([&](size_t i) { return !in_body(i); });
  const size_t worst = ours.Worst();
  std::printf("| `%s` | %zu | %s | %s | %.1e | %s |", function.name, points.size(),
              Marked(body, body > function.goal.body).c_str(),
              Marked(tail, tail > function.goal.tail).c_str(), ours.NinetyNinePointNine(),
              Arguments(function, points[worst]).c_str());
  if (const BoostFunction* const boost = FindBoostFunction(function.name)) {
    const std::vector<double> noise = NoiseAt(function, points);
    for (const Function contestant : {boost->standard, boost->plain}) {
      const Errors theirs(contestant, points);
      std::printf(" %s | %.1e |", theirs.Summary().c_str(), theirs.NinetyNinePointNine());
      PrintRatios(ours.RatiosTo(theirs, noise), function, points);
    }
    std::printf("\n");
  } else {
    std::printf(" - | - | - | - | - | - | - | - | - | - |\n");
  }
  std::fflush(stdout);
  return ours[worst] < 1e-3;
}

bool HasWayBack(const ReferenceFunction& function) {
  return function.back.call != nullptr;
}

void PrintRoundTrip(const ReferenceFunction& function, const Points& points) {
  double largest = 0.0, rounding = 0.0, beyond = 0.0;
  const ReferencePoint* worst = nullptr;
  for (const ReferencePoint& point : points) {
    const kestrel_tests::RoundTrip trip = TurnBack(function, point.arguments);
    largest = std::max(largest, trip.difference);
    rounding = std::max(rounding, trip.rounding);
    if (worst == nullptr || trip.difference - trip.rounding > beyond) {
      beyond = std::max(0.0, trip.difference - trip.rounding);
      worst = &point;
    }
  }
  std::printf("| `%s` | %zu | %s | %s | %s | %s |\n", function.name, points.size(),
              Marked(largest, false).c_str(), Marked(rounding, false).c_str(),
              Marked(beyond, beyond > kestrel_tests::kTurnedBack).c_str(),
              Arguments(function, *worst).c_str());
  std::fflush(stdout);
}

double SecondsSince(std::chrono::steady_clock::time_point start) {
  return std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
}

volatile double sink;

double SecondsOfOneCall(Function function, const ReferencePoint& point) {
  const auto start = std::chrono::steady_clock::now();
  sink = function(point.arguments);
  return SecondsSince(start);
}

/// The slowest point: the least of five calls there, so that an interruption does not count.
struct Longest {
  double seconds = 0.0;
  const ReferencePoint* point = nullptr;

  Longest(Function function, const Points& points) {
    for (const ReferencePoint& candidate : points) {
      double least = SecondsOfOneCall(function, candidate);
      for (int i = 0; i < 4 && least > seconds; ++i)
        least = std::min(least, SecondsOfOneCall(function, candidate));
      if (least > seconds || point == nullptr) {
        seconds = least;
        point = &candidate;
      }
    }
  }
};

void CallAll(Function function, const Points& points, size_t count, int times) {
  double sum = 0.0;
  for (int turn = 0; turn < times; ++turn) {
    for (size_t i = 0; i < count; ++i)
      sum += function(points[i].arguments);
  }
  sink = sum;
}

/// Mean seconds of one call of each contestant, over as many points as the slowest gets through in a turn.
std::vector<double> MeanSeconds(const std::vector<Function>& functions, const Points& points,
                                const Effort& effort) {
  size_t count = points.size();
  double slowest = 1e-9, fastest = 1.0;
  for (const Function function : functions) {
    const auto start = std::chrono::steady_clock::now();
    size_t done = 0;
    while (done < count && SecondsSince(start) < effort.turn)
      sink = function(points[done++].arguments);
    count = done;
    const double mean = SecondsSince(start) / static_cast<double>(done);
    slowest = std::max(slowest, mean);
    fastest = std::min(fastest, mean);
  }
  // The clock has to see something of the fastest, too.
  const double calls = std::max(effort.turn / slowest, effort.turn / 10.0 / fastest);
  const int times = std::max(1, static_cast<int>(calls / static_cast<double>(count)));
  std::vector<Contestant> contestants;
  for (const Function function : functions)
    contestants.push_back(
        {"", [function, &points, count, times] { CallAll(function, points, count, times); }});
  std::vector<double> seconds = Compare(contestants, effort.rounds, Least);
  for (double& one : seconds)
    one /= static_cast<double>(count) * times;
  return seconds;
}

void PrintTimes(const ReferenceFunction& function, const Points& points, const Effort& effort) {
  const BoostFunction* const boost = FindBoostFunction(function.name);
  std::vector<Function> functions = {function.call};
  if (boost != nullptr) functions.insert(functions.end(), {boost->standard, boost->plain});
  const std::vector<double> seconds = MeanSeconds(functions, points, effort);
  const Longest longest(function.call, points);
  std::printf("| `%s` | %.0f |", function.name, 1e9 * seconds[0]);
  // The normal functions are to be as fast as Boost.Math's, the others within 1.5 times.
  const double allowed = std::strcmp(function.table, "normal") == 0 ? 1.0 : 1.5;
  for (size_t i = 1; i <= 2; ++i) {
    if (boost == nullptr) {
      std::printf(" - | - |");
      continue;
    }
    const double ratio = seconds[0] / seconds[i];
    std::printf(ratio > allowed ? " %.0f | **%.2f** |" : " %.0f | %.2f |", 1e9 * seconds[i], ratio);
  }
  std::printf(longest.seconds > 20e-6 ? " **%.1f** | %s |\n" : " %.1f | %s |\n", 1e6 * longest.seconds,
              Arguments(function, *longest.point).c_str());
  std::fflush(stdout);
}

constexpr char kIntroduction[] =
    R"(# Distribution functions: accuracy and time, measured

Printed by `bench/run build/release accuracy`, which judges the functions of `MCDistFun` by the tables in
`tests/data/math/`. Their values were computed with 60 digits and more (`make_reference.py` there makes them,
`check_reference.py` holds them against other methods) and have 25; those of samples are exact fractions
(`make_samples.py`). Points cover both tails down to 1e-300, the neighbourhood of the mean, x near 0 and 1, and
parameters from 0.1 to 1e7. `**Bold**` is what misses its goal.

"Boost" is Boost.Math as it comes, which computes in long double here and rounds the result; "Boost, double" is
held to double, as Kestrel always is, and as Boost.Math itself is where long double is double.
)";

constexpr char kErrorHeading[] = R"(
## Relative errors

Columns with a contestant's name have the largest error; body: results from 1e-5 up, tail: below. Goals: 2e-15;
inverses 1e-14, non-central functions 1e-10. "99.9 %" is what all but a thousandth of the points keep. "Lost": an error
above 1 %, or no number at all.

Ratio: the error over Boost's at the point where that is worst, and above 10 the number of points where it is more than
that; goal: none. An error of Boost's below 2^-53, which rounding the result alone may cause, is taken as 2^-53. An
inverse is judged by its condition as well: by how much its result moves when the p that it is given is rounded, by
2^-53 of it. Where that is more than the result's own rounding (small shapes have quantiles like p^(1 / shape)) it takes
its place; the condition is measured by the distribution function on both sides of the result.

| function | points | body | tail | 99.9 % | largest at | Boost | 99.9 % | ratio | above 10 | at | Boost, double | 99.9 % | ratio | above 10 | at |
|---|---|---|---|---|---|---|---|---|---|---|---|---|---|---|---|
)";

constexpr char kRoundTripHeading[] = R"(
## Inverses turned back

How far the distribution function at an inverse's result is from the p that was asked for, relative to p. An inverse can
give no better than the double closest to the quantile, and half a unit in that double's last place is much where the
distribution is narrow for its place: a chi-square of 1e7 degrees of freedom has a deviation of 4500. "Rounding" is the
largest that this alone explains, "beyond" the largest rest above what it explains at that point. Goal for the rest:
1e-12.

| function | points | largest | rounding | beyond | at |
|---|---|---|---|---|---|
)";

constexpr char kTimeHeading[] = R"(
## Time of a call

Mean over the same points, in nanoseconds, user and system time, best of five interleaved rounds. Goals: the normal
functions at least as fast as Boost's, the others within 1.5 times; no call above 20 microseconds. Longest: the slowest
point's best of five calls. Samples have up to 200 values, or 300 for the median's interval, and their time has that of
making and sorting them.

| function | Kestrel, ns | Boost, ns | ratio | Boost, double, ns | ratio | longest call, us | at |
|---|---|---|---|---|---|---|---|
)";

/// The judged functions whose names begin with one of those wanted; all when none is.
std::vector<ReferenceFunction> Select(const std::vector<std::string>& wanted) {
  std::vector<ReferenceFunction> selected;
  for (const ReferenceFunction& function : kestrel_tests::ReferenceFunctions()) {
    const std::string name = function.name;
    if (wanted.empty() || std::any_of(wanted.begin(), wanted.end(), [&](const std::string& beginning) {
          return name.compare(0, beginning.size(), beginning) == 0;
        }))
      selected.push_back(function);
  }
  return selected;
}

/// Returns the number of functions that are wrong.
int Print(const std::vector<ReferenceFunction>& functions, const Effort& effort) {
  std::fputs(kIntroduction, stdout);
  std::fputs(kErrorHeading, stdout);
  int wrong = 0;
  for (const ReferenceFunction& function : functions) {
    if (!PrintErrors(function, ReadReferencePoints(function, effort.step))) {
      std::fprintf(stderr, "bench_accuracy: %s gives a wrong answer\n", function.name);
      ++wrong;
    }
  }
  if (std::any_of(functions.begin(), functions.end(), HasWayBack)) std::fputs(kRoundTripHeading, stdout);
  for (const ReferenceFunction& function : functions) {
    if (HasWayBack(function)) PrintRoundTrip(function, ReadReferencePoints(function, effort.step));
  }
  std::fputs(kTimeHeading, stdout);
  for (const ReferenceFunction& function : functions)
    PrintTimes(function, ReadReferencePoints(function, effort.step), effort);
  return wrong;
}

}  // namespace
}  // namespace kestrel_bench

int main(int argc, char** argv) {
  std::vector<std::string> wanted(argv + 1, argv + argc);
  const bool smoke = !wanted.empty() && wanted[0] == "--smoke";
  if (smoke) wanted.erase(wanted.begin());
  const std::vector<kestrel_tests::ReferenceFunction> functions = kestrel_bench::Select(wanted);
  if (functions.empty()) {
    std::fprintf(stderr, "usage: bench_accuracy [--smoke] [BEGINNING-OF-A-NAME...]\n");
    return 2;
  }
  return kestrel_bench::Print(functions, smoke ? kestrel_bench::kSmoke : kestrel_bench::kFull) == 0 ? 0 : 1;
}
