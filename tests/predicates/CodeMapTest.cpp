#include "kestrel/predicates/CodeMap.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <map>
#include <random>
#include <string>
#include <vector>

namespace MCKestrel_800 {
namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr int kLowest = std::numeric_limits<int>::min(), kHighest = std::numeric_limits<int>::max();

/// The runs as "1-4:0 7:1".
std::string RunsOf(const CodeMap& map) {
  std::string text;
  const auto number = [](double x) {
    std::string digits = std::to_string(x);
    digits.erase(digits.find_last_not_of('0') + 1);
    if (digits.back() == '.') digits.pop_back();
    return digits;
  };
  for (const CodeMap::Run& run : map.GetRuns()) {
    if (!text.empty()) text += ' ';
    text += number(run.first);
    if (run.last != run.first) text += ".." + number(run.last);
    text += ":" + std::to_string(run.child);
  }
  return text;
}

struct Put {
  double first;
  double last;  // the same as first: a single number
  int child;
};

CodeMap MapOf(const std::vector<Put>& puts) {
  CodeMap map;
  for (const Put& put : puts) {
    if (put.first == put.last || std::isnan(put.first)) {
      map.Insert(put.first, put.child);
    } else {
      map.InsertRun(static_cast<int>(put.first), static_cast<int>(put.last), put.child);
    }
  }
  return map;
}

TEST(CodeMap, KeepsRuns) {
  struct Row {
    const char* why;
    std::vector<Put> puts;
    const char* runs;
  };
  const Row kRows[] = {
      {"nothing", {}, ""},
      {"a code", {{3, 3, 0}}, "3:0"},
      {"ascending neighbours join", {{1, 1, 0}, {2, 2, 0}, {3, 3, 0}}, "1..3:0"},
      {"descending neighbours join", {{3, 3, 0}, {2, 2, 0}, {1, 1, 0}}, "1..3:0"},
      {"a gap that is filled joins both sides", {{1, 1, 0}, {3, 3, 0}, {2, 2, 0}}, "1..3:0"},
      {"neighbours of another child stay apart", {{1, 1, 0}, {2, 2, 1}, {3, 3, 0}}, "1:0 2:1 3:0"},
      {"a gap joins the side of its child alone", {{1, 1, 0}, {3, 3, 1}, {2, 2, 1}}, "1:0 2..3:1"},
      {"no neighbours", {{1, 1, 0}, {3, 3, 0}}, "1:0 3:0"},
      {"the first child stays", {{1, 1, 0}, {1, 1, 1}}, "1:0"},
      {"and inside a run", {{1, 5, 0}, {3, 3, 1}}, "1..5:0"},
      {"a run fills the gaps alone", {{2, 2, 0}, {4, 4, 0}, {1, 5, 1}}, "1:1 2:0 3:1 4:0 5:1"},
      {"a run of the same child swallows", {{2, 2, 0}, {4, 4, 0}, {1, 5, 0}}, "1..5:0"},
      {"a run starts inside another", {{1, 3, 0}, {2, 6, 1}}, "1..3:0 4..6:1"},
      {"a run ends inside another", {{4, 6, 0}, {1, 5, 1}}, "1..3:1 4..6:0"},
      {"a run inside another", {{1, 6, 0}, {2, 3, 1}}, "1..6:0"},
      {"a run that touches another", {{1, 3, 0}, {4, 6, 0}}, "1..6:0"},
      {"a run between two others", {{1, 2, 0}, {6, 7, 0}, {3, 5, 0}}, "1..7:0"},
      {"an empty run", {{5, 4, 0}}, ""},
      {"negative codes", {{-2, -2, 0}, {-1, 1, 0}}, "-2..1:0"},
      {"a fraction", {{2.5, 2.5, 0}}, "2.5:0"},
      {"fractions do not join", {{1.5, 1.5, 0}, {2.5, 2.5, 0}, {3, 3, 0}}, "1.5:0 2.5:0 3:0"},
      {"a fraction inside a run", {{1, 4, 0}, {2.5, 2.5, 1}}, "1..2:0 2.5:1 3..4:0"},
      {"a fraction in the first gap of a run", {{1, 4, 0}, {1.5, 1.5, 0}}, "1:0 1.5:0 2..4:0"},
      {"a run around a fraction", {{2.5, 2.5, 1}, {1, 4, 0}}, "1..2:0 2.5:1 3..4:0"},
      {"a fraction twice", {{2.5, 2.5, 1}, {2.5, 2.5, 0}}, "2.5:1"},
      {"a run between fractions", {{0.5, 0.5, 0}, {1.5, 1.5, 0}, {1, 1, 0}}, "0.5:0 1:0 1.5:0"},
      {"minus zero is zero", {{-0.0, -0.0, 0}, {0, 0, 1}, {1, 1, 0}}, "0..1:0"},
      {"NaN is ignored", {{NAN, NAN, 0}}, ""},
      {"infinities are numbers like others",
       {{kInfinity, kInfinity, 0}, {-kInfinity, -kInfinity, 1}},
       "-inf:1 inf:0"},
      {"a run between infinities",
       {{kInfinity, kInfinity, 0}, {-kInfinity, -kInfinity, 0}, {1, 2, 0}},
       "-inf:0 1..2:0 inf:0"},
      {"all codes", {{kLowest, kHighest, 0}}, "-2147483648..2147483647:0"},
      {"beyond the codes nothing joins",
       {{kHighest, kHighest, 0}, {2147483648.0, 2147483648.0, 0}},
       "2147483647:0 2147483648:0"},
      {"nor below them",
       {{-2147483649.0, -2147483649.0, 0}, {kLowest, kLowest, 0}},
       "-2147483649:0 -2147483648:0"},
      {"nor when the run comes last",
       {{2147483648.0, 2147483648.0, 0}, {1, kHighest, 0}},
       "1..2147483647:0 2147483648:0"},
  };
  for (const Row& row : kRows)
    EXPECT_EQ(RunsOf(MapOf(row.puts)), row.runs) << row.why;
}

TEST(CodeMap, FindsNumbersThatAreEqualToAKey) {
  struct Row {
    const char* why;
    std::vector<Put> puts;
    double x;
    int child;
  };
  const std::vector<Put> oneRun = {{1, 4, 7}};
  const std::vector<Put> many = {{1, 4, 7}, {10, 10, 8}, {20.5, 20.5, 9}, {30, 40, 6}, {41, 41, 5}};
  const Row kRows[] = {
      {"an empty map", {}, 0, -1},
      {"the first of a run", oneRun, 1, 7},
      {"inside a run", oneRun, 2, 7},
      {"the last of a run", oneRun, 4, 7},
      {"below", oneRun, 0, -1},
      {"above", oneRun, 5, -1},
      {"a fraction inside a run", oneRun, 2.5, -1},
      {"just above the last", oneRun, std::nextafter(4, 5), -1},
      {"just below the first", oneRun, std::nextafter(1, 0), -1},
      {"NaN", oneRun, NAN, -1},
      {"infinity", oneRun, kInfinity, -1},
      {"minus infinity", oneRun, -kInfinity, -1},
      {"the missing number", oneRun, std::numeric_limits<double>::lowest(), -1},
      {"an infinity that was put", {{kInfinity, kInfinity, 1}, {-kInfinity, -kInfinity, 2}}, kInfinity, 1},
      {"and the other", {{kInfinity, kInfinity, 1}, {-kInfinity, -kInfinity, 2}}, -kInfinity, 2},
      {"NaN among infinities", {{kInfinity, kInfinity, 1}, {-kInfinity, -kInfinity, 2}}, NAN, -1},
      {"NaN that was put", {{NAN, NAN, 1}}, NAN, -1},
      {"minus zero finds zero", {{0, 0, 1}}, -0.0, 1},
      {"zero finds minus zero", {{-0.0, -0.0, 1}}, 0.0, 1},
      {"minus zero in a run", {{-2, 2, 1}}, -0.0, 1},
      {"many: the first", many, 1, 7},
      {"many: between", many, 7, -1},
      {"many: single", many, 10, 8},
      {"many: fraction", many, 20.5, 9},
      {"many: near the fraction", many, 20, -1},
      {"many: next of another child", many, 41, 5},
      {"many: the last of a run", many, 40, 6},
      {"many: above all", many, 42, -1},
      {"a number beyond the codes", {{1e300, 1e300, 3}}, 1e300, 3},
  };
  for (const Row& row : kRows)
    EXPECT_EQ(MapOf(row.puts).Find(row.x), row.child) << row.why;
}

TEST(CodeMap, AgreesWithAMapOfSingleCodes) {
  std::mt19937 random(1);
  const auto pick = [&random](int count) {
    return static_cast<int>(random() % static_cast<unsigned>(count));
  };
  for (int round = 0; round < 2000; ++round) {
    CodeMap map;
    std::map<double, int> plain;
    for (int put = 0; put < 12; ++put) {
      const int child = pick(2), first = pick(20) - 5;
      if (pick(2) == 0) {
        const double code = first + 0.5 * pick(2);
        map.Insert(code, child);
        plain.emplace(code, child);
      } else {
        const int last = first + pick(8) - 1;
        map.InsertRun(first, last, child);
        for (int code = first; code <= last; ++code)
          plain.emplace(code, child);
      }
    }
    for (double x = -7; x < 25; x += 0.25) {
      const auto it = plain.find(x);
      ASSERT_EQ(map.Find(x), it == plain.end() ? -1 : it->second) << "round " << round << ", " << x;
    }
    const std::vector<CodeMap::Run> runs = map.GetRuns();
    for (std::size_t i = 1; i < runs.size(); ++i)
      ASSERT_LT(runs[i - 1].last, runs[i].first) << "round " << round;
  }
}

TEST(CodeMap, StaysAsSmallAsWhatWasPut) {
  constexpr int kCategories = 100000;
  CodeMap complement;
  complement.InsertRun(0, 49999, 0);
  complement.InsertRun(50001, kCategories - 1, 0);
  EXPECT_EQ(RunsOf(complement), "0..49999:0 50001..99999:0");

  CodeMap ascending, descending, joined;
  for (int code = 0; code < kCategories; ++code) {
    ascending.Insert(code, 0);
    descending.Insert(kCategories - 1 - code, 0);
  }
  EXPECT_EQ(RunsOf(ascending), "0..99999:0");
  EXPECT_EQ(RunsOf(descending), "0..99999:0");

  // First every other code, from above; then the rest closes all gaps.
  for (int code = kCategories - 1; code > 0; code -= 2)
    joined.Insert(code, 0);
  EXPECT_EQ(joined.GetRuns().size(), 50000u);
  joined.InsertRun(0, kCategories - 1, 0);
  EXPECT_EQ(RunsOf(joined), "0..99999:0");
}

TEST(CodeMap, CopiesAreIndependent) {
  CodeMap map = MapOf({{1, 4, 0}});
  const CodeMap copy(map);
  map.Insert(9, 0);
  EXPECT_EQ(RunsOf(copy), "1..4:0");
  EXPECT_EQ(RunsOf(map), "1..4:0 9:0");
}

}  // namespace
}  // namespace MCKestrel_800
