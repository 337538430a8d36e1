// Scores every example with the program and compares with the answers of the program that trained the model.

#include <gtest/gtest.h>

#include <sstream>

#include "tests/apps/KestrelProgram.h"
#include "tests/examples/ExampleFolders.h"
#include "tests/support/PlainTable.h"

namespace kestrel_tests {
namespace {

class KestrelExamples : public testing::TestWithParam<std::string> {};

bool Agree(const std::string& expected, const std::string& actual) {
  char* end = nullptr;
  const double number = std::strtod(expected.c_str(), &end);
  if (expected.empty() || *end != 0) return expected == actual;
  return AgreesWith(number, std::strtod(actual.c_str(), nullptr));
}

/// Scores an example and compares with a table in its folder.
void ExpectAnswers(const std::string& example, const std::string& answers) {
  const ProgramOutcome outcome =
      RunKestrel({"score", ExamplePath(example, "model.xml"), ExamplePath(example, "data.csv")});
  ASSERT_EQ(outcome.exit_code, 0) << outcome.errors;
  std::istringstream output(outcome.output);
  const PlainTable actual = ParsePlainTable(output);
  const PlainTable expected = ReadPlainTable(ExamplePath(example, answers));
  EXPECT_EQ(actual.header, expected.header);
  ASSERT_EQ(actual.rows.size(), expected.rows.size());
  for (std::size_t row = 0; row < expected.rows.size(); ++row) {
    ASSERT_EQ(actual.rows[row].size(), expected.rows[row].size());
    for (std::size_t column = 0; column < expected.rows[row].size(); ++column)
      EXPECT_PRED2(Agree, expected.rows[row][column], actual.rows[row][column]) << "case " << row + 1;
  }
}

TEST_P(KestrelExamples, AgreeWithTheirTrainingPrograms) {
  ExpectAnswers(GetParam(), "expected.csv");
}

INSTANTIATE_TEST_SUITE_P(Examples, KestrelExamples, testing::ValuesIn(ExampleFolders()),
                         [](const auto& example) { return TestNameOf(example.param); });

class KestrelOutputExamples : public testing::TestWithParam<std::string> {};

TEST_P(KestrelOutputExamples, AgreeWithTheirTrainingPrograms) {
  ExpectAnswers(GetParam(), "outputs.csv");
}

TEST_P(KestrelOutputExamples, AreGoodAndCanBeDescribed) {
  const std::string model = ExamplePath(GetParam(), "model.xml");
  EXPECT_EQ(RunKestrel({"check", model}).exit_code, 0);
  const ProgramOutcome description = RunKestrel({"describe", model});
  EXPECT_EQ(description.exit_code, 0) << description.errors;
  for (const std::string& name : ReadPlainTable(ExamplePath(GetParam(), "outputs.csv")).header)
    EXPECT_NE(description.output.find("\n  " + name + "  "), std::string::npos) << name;
}

INSTANTIATE_TEST_SUITE_P(Examples, KestrelOutputExamples, testing::ValuesIn(FoldersWith("outputs.csv")),
                         [](const auto& example) { return TestNameOf(example.param); });

}  // namespace
}  // namespace kestrel_tests
