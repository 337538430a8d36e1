// Scores every example with the program, as a person would, and compares with the training program's answers.

#include <gtest/gtest.h>

#include <algorithm>
#include <sstream>

#include "tests/examples/ExampleFolders.h"
#include "tests/support/PlainTable.h"
#include "tests/support/RunProgram.h"

namespace kestrel_tests {
namespace {

std::string Program() {
  return std::string(KESTREL_BINARY_DIR) + "/bin/kestrel";
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

}  // namespace
}  // namespace kestrel_tests
