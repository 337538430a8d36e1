// Scores every example with the program, as a person would, and compares with the training program's answers;
// computes the derived fields of those that have no model, and compares with Python's.

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdlib>
#include <sstream>

#include "tests/examples/ExampleFolders.h"
#include "tests/support/PlainTable.h"
#include "tests/support/RunProgram.h"

namespace kestrel_tests {
namespace {

std::string Program() {
  return BuiltProgram("bin/kestrel");
}

class EveryExampleByProgram : public testing::TestWithParam<std::string> {};

TEST_P(EveryExampleByProgram, AgreesWithItsTrainingProgram) {
  const ProgramOutcome outcome = RunProgram(
      Program(), {"score", ExamplePath(GetParam(), "model.xml"), ExamplePath(GetParam(), "data.csv")});
  ASSERT_EQ(outcome.exit_code, 0) << outcome.errors;
  std::istringstream in(outcome.output);
  const PlainTable scored = ParsePlainTable(in),
                   expected = ReadPlainTable(ExamplePath(GetParam(), "expected.csv"));
  ASSERT_EQ(scored.header, expected.header);
  ASSERT_EQ(scored.rows.size(), expected.rows.size());
  const bool regression = expected.header.size() == 1;
  for (size_t row = 0; row < scored.rows.size(); ++row) {
    SCOPED_TRACE("case " + std::to_string(row + 1));
    for (size_t column = 0; column < expected.header.size(); ++column) {
      const std::string& wanted = expected.rows[row][column];
      const std::string& answer = scored.rows[row][column];
      if (column == 0 && !regression) {
        EXPECT_EQ(answer, wanted);
      } else {
        EXPECT_PRED2(AgreesWith, std::stod(wanted), std::stod(answer)) << expected.header[column];
      }
    }
  }
}

TEST_P(EveryExampleByProgram, IsGoodAndCanBeDescribed) {
  const std::string model = ExamplePath(GetParam(), "model.xml");
  EXPECT_EQ(RunProgram(Program(), {"check", model}).exit_code, 0);
  const ProgramOutcome description = RunProgram(Program(), {"describe", model});
  EXPECT_EQ(description.exit_code, 0);
  const auto& kinds = ExampleKinds();
  EXPECT_EQ(std::count_if(kinds.begin(), kinds.end(),
                          [&description](const std::string& kind) {
                            return description.output.find(kind) != std::string::npos;
                          }),
            1)
      << description.output;
}

INSTANTIATE_TEST_SUITE_P(Examples, EveryExampleByProgram, testing::ValuesIn(ExampleFolders()),
                         [](const auto& example) { return TestNameOf(example.param); });

class EveryDerivedExampleByProgram : public testing::TestWithParam<std::string> {};

/// A cell that reads as a number agrees with any way to write it.
bool CellsAgree(const std::string& wanted, const std::string& answer) {
  char* end = nullptr;
  const double number = std::strtod(wanted.c_str(), &end);
  if (wanted.empty() || *end != 0) return wanted == answer;
  return AgreesWith(number, std::strtod(answer.c_str(), &end)) && *end == 0;
}

TEST_P(EveryDerivedExampleByProgram, IsWhatPythonMakesOfTheData) {
  const ProgramOutcome outcome = RunProgram(
      Program(), {"derive", ExamplePath(GetParam(), "model.xml"), ExamplePath(GetParam(), "data.csv")});
  ASSERT_EQ(outcome.exit_code, 0) << outcome.errors;
  std::istringstream in(outcome.output);
  const PlainTable derived = ParsePlainTable(in),
                   expected = ReadPlainTable(ExamplePath(GetParam(), "derived.csv"));
  ASSERT_EQ(derived.header, expected.header);
  ASSERT_EQ(derived.rows.size(), expected.rows.size());
  for (size_t row = 0; row < derived.rows.size(); ++row) {
    ASSERT_EQ(derived.rows[row].size(), expected.rows[row].size());
    for (size_t column = 0; column < expected.header.size(); ++column) {
      EXPECT_PRED2(CellsAgree, expected.rows[row][column], derived.rows[row][column])
          << "case " << row + 1 << ", " << expected.header[column];
    }
  }
}

TEST_P(EveryDerivedExampleByProgram, IsGoodAndCanBeDescribed) {
  const std::string document = ExamplePath(GetParam(), "model.xml");
  EXPECT_EQ(RunProgram(Program(), {"check", document}).exit_code, 0);
  const ProgramOutcome description = RunProgram(Program(), {"describe", document});
  EXPECT_EQ(description.exit_code, 0) << description.errors;
  for (const std::string& name : ReadPlainTable(ExamplePath(GetParam(), "derived.csv")).header)
    EXPECT_NE(description.output.find("\n  " + name + "  "), std::string::npos) << name;
}

INSTANTIATE_TEST_SUITE_P(Examples, EveryDerivedExampleByProgram, testing::ValuesIn(DerivedExampleFolders()),
                         [](const auto& example) { return TestNameOf(example.param); });

}  // namespace
}  // namespace kestrel_tests
