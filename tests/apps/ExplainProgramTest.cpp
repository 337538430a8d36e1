// `kestrel score --explain`, run as its users run it.

#include <gtest/gtest.h>

#include <algorithm>

#include "tests/apps/KestrelProgram.h"
#include "tests/support/FileText.h"

namespace kestrel_tests {
namespace {

const char kHasNone[] =
    "kestrel: the first scored case has no explanation: no node of a tree and no rule led to it (the model "
    "is a ";

struct ExplainRow {
  const char* why;
  std::vector<std::string> arguments;  ///< behind "score --explain"; the table is the standard input
  std::string table;
  int exit_code;
  std::string output;
  std::string errors;
};

void CheckRows(const std::vector<ExplainRow>& rows) {
  for (const ExplainRow& row : rows) {
    std::vector<std::string> arguments = {"score", "--explain"};
    arguments.insert(arguments.end(), row.arguments.begin(), row.arguments.end());
    const ProgramOutcome outcome = RunKestrel(arguments, row.table);
    EXPECT_EQ(outcome.exit_code, row.exit_code) << row.why;
    EXPECT_EQ(outcome.output, row.output) << row.why;
    EXPECT_EQ(outcome.errors, row.errors) << row.why;
  }
}

TEST(KestrelExplain, TellsTheNodesThatACasePassed) {
  CheckRows({
      {"identifiers with commas, quotation marks and line ends; a node without one has its number",
       {"D/tree.xml"},
       "x,colour\n0,\n2,red\n2,gr\xC3\xBCn\n",
       0,
       "prediction,probability,probability_small,probability_large,explanation\n"
       "small,1,1,0,\"all > low, or not > 1\"\n"
       "large,1,0,1,\"all > #3 > the \"\"reds\"\"\"\n"
       "small,1,1,0,\"all > #3 > two\nlines\"\n",
       ""},
      {"jsonl has them one by one",
       {"D/tree.xml", "--format", "jsonl"},
       "x,colour\n0,\n2,red\n2,gr\xC3\xBCn\n",
       0,
       "{\"prediction\":\"small\",\"probability\":1,\"probability_small\":1,\"probability_large\":0,"
       "\"explanation\":[\"all\",\"low, or not > 1\"]}\n"
       "{\"prediction\":\"large\",\"probability\":1,\"probability_small\":0,\"probability_large\":1,"
       "\"explanation\":[\"all\",\"#3\",\"the \\\"reds\\\"\"]}\n"
       "{\"prediction\":\"small\",\"probability\":1,\"probability_small\":1,\"probability_large\":0,"
       "\"explanation\":[\"all\",\"#3\",\"two\\nlines\"]}\n",
       ""},
      {"no cases",
       {"D/tree.xml"},
       "x,colour\n",
       0,
       "prediction,probability,probability_small,probability_large,explanation\n",
       ""},
  });
}

TEST(KestrelExplain, TellsTheRulesThatFired) {
  CheckRows({
      {"all of them, in the document's order",
       {"D/rules.xml"},
       "x\n20\n7\n-1\n",
       0,
       "prediction,explanation\n2,above 10 > #2\n1,#2\n-1,negative\n",
       ""},
      {"a case of which none fired",
       {"D/rules.xml", "--format=jsonl"},
       "x\n20\n3\n",
       0,
       "{\"prediction\":2,\"explanation\":[\"above 10\",\"#2\"]}\n{\"prediction\":0,\"explanation\":null}\n",
       ""},
      {"it is the first",
       {"D/rules.xml"},
       "x\n3\n20\n",
       0,
       "prediction,explanation\n0,\n2,above 10 > #2\n",
       std::string(kHasNone) + "RuleSetModel)\n"},
  });
}

TEST(KestrelExplain, SaysOnceThatThereIsNothingToTell) {
  CheckRows({
      {"csv",
       {"D/line.xml"},
       "x\n1\n2\n",
       0,
       "prediction,explanation\n3,\n5,\n",
       std::string(kHasNone) + "RegressionModel)\n"},
      {"jsonl",
       {"D/line.xml", "--format", "jsonl"},
       "x\n1\n",
       0,
       "{\"prediction\":3,\"explanation\":null}\n",
       std::string(kHasNone) + "RegressionModel)\n"},
      {"not before a case is scored",
       {"D/line.xml", "--on-error", "null", "--keep"},
       "x\n\n1,\n1\n2\n",
       1,
       "x,prediction,explanation\n1,,\n1,3,\n2,5,\n",
       "kestrel: standard input:3: the row has 2 cells where the header has 1\n" + std::string(kHasNone) +
           "RegressionModel)\nkestrel: 1 of 3 cases have no prediction\n"},
      {"not when none is", {"D/line.xml"}, "x\n", 0, "prediction,explanation\n", ""},
  });
}

TEST(KestrelExplain, TellsHowFarACaseWithoutPredictionCame) {
  const std::string missing = "the case has no prediction; missing are ";
  const std::string status = " (status 90027, kE_MISSINGVAR)\n";
  CheckRows({
      {"the case before leaves nothing behind",
       {"D/tree.xml", "--on-error", "null", "--format", "jsonl", "--keep=x"},
       "x,colour\n2,\n2,red\nabc,red\n2,red\n2,blue\n,\n",
       1,
       "{\"x\":2,\"prediction\":null,\"probability\":null,\"probability_small\":null,"
       "\"probability_large\":null,\"explanation\":[\"all\",\"#3\"]}\n"
       "{\"x\":2,\"prediction\":\"large\",\"probability\":1,\"probability_small\":0,\"probability_large\":1,"
       "\"explanation\":[\"all\",\"#3\",\"the \\\"reds\\\"\"]}\n"
       "{\"x\":\"abc\",\"prediction\":null,\"probability\":null,\"probability_small\":null,"
       "\"probability_large\":null,\"explanation\":null}\n"
       "{\"x\":2,\"prediction\":\"large\",\"probability\":1,\"probability_small\":0,\"probability_large\":1,"
       "\"explanation\":[\"all\",\"#3\",\"the \\\"reds\\\"\"]}\n"
       "{\"x\":2,\"prediction\":null,\"probability\":null,\"probability_small\":null,"
       "\"probability_large\":null,\"explanation\":null}\n"
       "{\"x\":null,\"prediction\":null,\"probability\":null,\"probability_small\":null,"
       "\"probability_large\":null,\"explanation\":[\"all\"]}\n",
       "kestrel: standard input:2: " + missing + "colour" + status +
           "kestrel: standard input:4: column x: \"abc\" cannot be read; accepted is a number such as -1.5 "
           "or 2e3, with a decimal point, or an empty cell or a text of --missing for a missing value\n"
           "kestrel: standard input:6: column colour: the model refuses \"blue\", accepted is one of: red, "
           "gr\xC3\xBCn (status 90025, kE_INVALID_VALUE)\n"
           "kestrel: standard input:7: " +
           missing + "x, colour" + status + "kestrel: 4 of 6 cases have no prediction\n"},
      {"csv",
       {"D/tree.xml", "--on-error", "null"},
       "x,colour\n2,\n",
       1,
       "prediction,probability,probability_small,probability_large,explanation\n,,,,all > #3\n",
       "kestrel: standard input:2: " + missing + "colour" + status +
           "kestrel: 1 of 1 cases have no prediction\n"},
      {"the first fault stops it like any other",
       {"D/tree.xml"},
       "x,colour\n2,\n",
       4,
       "",
       "kestrel: standard input:2: the case has no prediction; missing are colour (status 90027, "
       "kE_MISSINGVAR)\n"
       "  hint: --on-error null leaves such predictions empty and goes on\n"},
  });
}

TEST(KestrelExplain, StandsBehindAllOtherColumns) {
  CheckRows({
      {"kept columns",
       {"D/rules.xml", "--keep"},
       "id,x\n007,7\n",
       0,
       "id,x,prediction,explanation\n007,7,1,#2\n",
       ""},
      {"names that are taken",
       {"D/rules.xml", "--keep"},
       "explanation,x,explanation_2\nthe user's,7,too\n",
       0,
       "explanation,x,explanation_2,prediction,explanation_3\nthe user's,7,too,1,#2\n",
       "kestrel: the table has a column explanation; the model's is called explanation_3\n"},
      {"a name that is not taken, since it is not kept",
       {"D/rules.xml"},
       "explanation,x\nthe user's,7\n",
       0,
       "prediction,explanation\n1,#2\n",
       ""},
  });
}

TEST(KestrelExplain, WritesFilesAndTakesTheModelFromTheStandardInput) {
  const TempFolder folder;
  folder.Write("data.csv", "x\n7\n");
  RunOptions options;
  options.input = FileText(DataPath("rules.xml"));
  const ProgramOutcome outcome =
      RunKestrel(folder, {"score", "-", "T/data.csv", "-o", "T/out.csv", "--explain"}, options);
  EXPECT_EQ(outcome.exit_code, 0) << outcome.errors;
  EXPECT_EQ(outcome.output + outcome.errors, "");
  EXPECT_EQ(FileText(folder.PathOf("out.csv")), "prediction,explanation\n1,#2\n");
}

// A long chain of nodes in a long table: what a case tells must not pile up over the cases.
TEST(KestrelExplain, TellsAsManyNodesAsThereAre) {
  constexpr int kDepth = 100;
  std::string nodes = "<Node id=\"n0\" score=\"1\"><True/>";
  std::string path = "n0";
  for (int i = 1; i <= kDepth; ++i) {
    nodes += "<Node id=\"n" + std::to_string(i) + "\" score=\"1\"><True/>";
    path += " > n" + std::to_string(i);
  }
  for (int i = 0; i <= kDepth; ++i)
    nodes += "</Node>";
  std::string document = FileText(DataPath("line.xml"));
  document = Replaced(document, "RegressionModel", "TreeModel");
  const std::size_t begin = document.find("<RegressionTable");
  const std::size_t end = document.find("</TreeModel>");
  ASSERT_LT(begin, end);
  document.replace(begin, end - begin, nodes);
  const TempFolder folder;
  folder.Write("chain.xml", document);
  std::string table = "x\n";
  std::string want = "prediction,explanation\n";
  for (int i = 0; i < 500; ++i) {
    table += "1\n";
    want += "1," + path + "\n";
  }
  RunOptions options;
  options.input = table;
  const ProgramOutcome outcome = RunKestrel(folder, {"score", "T/chain.xml", "--explain"}, options);
  EXPECT_EQ(outcome.exit_code, 0) << outcome.errors;
  EXPECT_EQ(outcome.output, want);
  EXPECT_EQ(outcome.errors, "");
}

}  // namespace
}  // namespace kestrel_tests
