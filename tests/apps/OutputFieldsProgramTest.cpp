// `kestrel score` with models whose documents declare output fields, run as its users run it.

#include <gtest/gtest.h>

#include "tests/apps/KestrelProgram.h"
#include "tests/support/FileText.h"

namespace kestrel_tests {
namespace {

struct OutputRow {
  const char* why;
  std::string document;
  std::vector<std::string> arguments;  ///< behind "score MODEL"; the table is the standard input
  std::string table;
  int exit_code;
  std::string output;
  std::string errors;
};

/// A document of the test data with elements behind its mining schema.
std::string DocumentWith(const char* name, const std::string& elements) {
  return Replaced(FileText(DataPath(name)), "</MiningSchema>", "</MiningSchema>" + elements);
}

/// fields  the attributes of each
std::string Output(const std::vector<std::string>& fields) {
  std::string element = "<Output>";
  for (const std::string& field : fields)
    element += "<OutputField " + field + "/>";
  return element + "</Output>";
}

ProgramOutcome Score(const std::string& document, const std::vector<std::string>& arguments,
                     const std::string& table) {
  const TempFolder folder;
  folder.Write("m.xml", document);
  std::vector<std::string> all = {"score", "T/m.xml"};
  all.insert(all.end(), arguments.begin(), arguments.end());
  RunOptions options;
  options.input = table;
  return RunKestrel(folder, all, options);
}

void CheckRows(const std::vector<OutputRow>& rows) {
  for (const OutputRow& row : rows) {
    const ProgramOutcome outcome = Score(row.document, row.arguments, row.table);
    EXPECT_EQ(outcome.exit_code, row.exit_code) << row.why;
    EXPECT_EQ(outcome.output, row.output) << row.why;
    EXPECT_EQ(outcome.errors, row.errors) << row.why;
  }
}

const std::vector<std::string> kTreeFields = {
    "name='z' feature='predictedValue'", "name='p' feature='probability' value='large'",
    "name='node' feature='entityId'", "name='number' feature='entityId' dataType='integer'",
    "name='warning' feature='warning'"};
const char kNoPrediction[] = "the case has no prediction; missing are ";
const char kStatus[] = " (status 90027, kE_MISSINGVAR)\n";
const char kNumber[] =
    " cannot be read; accepted is a number such as -1.5 or 2e3, with a decimal point, or an empty cell or a "
    "text of --missing for a missing value\n";

TEST(KestrelOutputFields, AreTheColumnsWhereThereAreAny) {
  const std::string tree = DocumentWith("tree.xml", Output(kTreeFields));
  CheckRows({
      {"in the document's order, which is not that of their names",
       tree,
       {},
       "x,colour\n0,\n2,red\n2,gr\xC3\xBCn\n",
       0,
       "z,p,node,number,warning\n"
       "small,0,\"low, or not > 1\",,\n"
       "large,1,\"the \"\"reds\"\"\",,\n"
       "small,0,\"two\nlines\",,\n",
       ""},
      {"jsonl: numbers are numbers, texts texts, and what is missing null",
       tree,
       {"--format", "jsonl"},
       "x,colour\n2,red\n",
       0,
       "{\"z\":\"large\",\"p\":1,\"node\":\"the \\\"reds\\\"\",\"number\":null,\"warning\":null}\n",
       ""},
      {"behind the kept columns",
       tree,
       {"--keep=colour"},
       "x,colour\n2,red\n",
       0,
       "colour,z,p,node,number,warning\nred,large,1,\"the \"\"reds\"\"\",,\n",
       ""},
      {"no cases", tree, {}, "x,colour\n", 0, "z,p,node,number,warning\n", ""},
      {"rules, by number and by name",
       DocumentWith("rules.xml", Output({"name='y_hat'", "name='id' feature='ruleValue' ruleFeature='ruleId'",
                                         "name='n' feature='entityId' dataType='integer'"})),
       {"--format=jsonl"},
       "x\n20\n7\n3\n",
       0,
       "{\"y_hat\":2,\"id\":\"above 10\",\"n\":null}\n{\"y_hat\":1,\"id\":\"#2\",\"n\":2}\n"
       "{\"y_hat\":0,\"id\":null,\"n\":null}\n",
       ""},
      {"a number as a text",
       DocumentWith("line.xml", Output({"name='t' dataType='string'", "name='v'"})),
       {"--format=jsonl"},
       "x\n0.05\n",
       0,
       "{\"t\":\"1.1\",\"v\":1.1}\n",
       ""},
      {"none are declared", DocumentWith("line.xml", "<Output/>"), {}, "x\n1\n", 0, "prediction\n3\n", ""},
  });
}

TEST(KestrelOutputFields, StandBeforeThePredictionWhenAllIsWanted) {
  CheckRows({
      {"a classification",
       DocumentWith("tree.xml", Output({"name='z'"})),
       {"--all"},
       "x,colour\n2,red\n",
       0,
       "z,prediction,probability,probability_small,probability_large\nlarge,large,1,0,1\n",
       ""},
      {"a regression with kept columns and explanation",
       DocumentWith("rules.xml", Output({"name='z'"})),
       {"--all", "--explain", "--keep"},
       "id,x\na,20\n",
       0,
       "id,x,z,prediction,explanation\na,20,2,2,above 10 > #2\n",
       ""},
      {"the explanation without the prediction",
       DocumentWith("rules.xml", Output({"name='z'"})),
       {"--explain"},
       "x\n20\n",
       0,
       "z,explanation\n2,above 10 > #2\n",
       ""},
      {"without output fields it is what it is",
       FileText(DataPath("sizes.xml")),
       {"--all"},
       "x\n1\n",
       0,
       "prediction,probability,probability_small,\"probability_large, red\"\n\"large, red\",1,0,1\n",
       ""},
      {"categories that are found out by scoring leave nothing behind",
       DocumentWith("unlisted.xml", Output({"name='z'", "name='w' feature='warning'"})),
       {"--all", "--on-error=null", "--format=jsonl"},
       "x\na\n0\n",
       1,
       "{\"z\":null,\"w\":null,\"prediction\":null,\"probability\":null,\"probability_1\":null,"
       "\"probability_2\":null}\n"
       "{\"z\":1,\"w\":null,\"prediction\":1,\"probability\":0.5,\"probability_1\":0.5,\"probability_2\":0.5}"
       "\n",
       "kestrel: standard input:2: column x: \"a\"" + std::string(kNumber) +
           "kestrel: 1 of 2 cases have no prediction\n"},
  });
}

TEST(KestrelOutputFields, HaveNamesOfTheirOwn) {
  const std::string predicted = DocumentWith("line.xml", Output({"name='prediction'", "name='explanation'"}));
  CheckRows({
      {"called like the raw column, which is not there",
       predicted,
       {},
       "x\n1\n",
       0,
       "prediction,explanation\n3,3\n",
       ""},
      {"and which is there",
       predicted,
       {"--all"},
       "x\n1\n",
       0,
       "prediction,explanation,prediction_2\n3,3,3\n",
       ""},
      {"jsonl",
       predicted,
       {"--all", "--format=jsonl"},
       "x\n1\n",
       0,
       "{\"prediction\":3,\"explanation\":3,\"prediction_2\":3}\n",
       ""},
      {"called like the explanation",
       DocumentWith("rules.xml", Output({"name='explanation' feature='entityId'"})),
       {"--explain"},
       "x\n7\n",
       0,
       "explanation,explanation_2\n#2,#2\n",
       ""},
      {"called like a kept column",
       DocumentWith("line.xml", Output({"name='x'", "name='y'"})),
       {"--keep"},
       "x\n1\n",
       0,
       "x,x_2,y\n1,3,3\n",
       "kestrel: the table has a column x; the model's is called x_2\n"},
      {"called like a column that is not kept",
       DocumentWith("line.xml", Output({"name='x'"})),
       {},
       "x\n1\n",
       0,
       "x\n3\n",
       ""},
      {"names that need quotation marks",
       DocumentWith("line.xml", Output({"name='a, b'"})),
       {},
       "x\n1\n",
       0,
       "\"a, b\"\n3\n",
       ""},
  });
}

// Errors, their number and the exit code are those of the same model without output fields.
TEST(KestrelOutputFields, TellOfCasesWithoutPrediction) {
  const std::string table = "x,colour\n2,\n2,red\nabc,red\n2,red\n2,blue\n2\n2,red\n,\n";
  const std::string errors = "kestrel: standard input:2: " + std::string(kNoPrediction) + "colour" + kStatus +
                             "kestrel: standard input:4: column x: \"abc\"" + kNumber +
                             "kestrel: standard input:6: column colour: the model refuses \"blue\", accepted "
                             "is one of: red, gr\xC3\xBCn (status 90025, kE_INVALID_VALUE)\n"
                             "kestrel: standard input:7: the row has 1 cell where the header has 2\n"
                             "kestrel: standard input:9: " +
                             kNoPrediction + "x, colour" + kStatus +
                             "kestrel: 5 of 8 cases have no prediction\n";
  const std::vector<std::string> fields = {"name='z'", "name='w' feature='warning'",
                                           "name='code' feature='warning' dataType='integer'"};
  const std::string document = DocumentWith("tree.xml", Output(fields));
  CheckRows({
      {"the same model without them",
       FileText(DataPath("tree.xml")),
       {"--on-error=null"},
       table,
       1,
       "prediction,probability,probability_small,probability_large\n,,,\nlarge,1,0,1\n,,,\nlarge,1,0,1\n"
       ",,,\n,,,\nlarge,1,0,1\n,,,\n",
       errors},
      {"the case before leaves nothing behind in a row that cannot be read",
       document,
       {"--on-error=null"},
       table,
       1,
       "z,w,code\n"
       ",\"data are missing, nothing is predicted\",90027\n"
       "large,,\n"
       ",,\n"
       "large,,\n"
       ",invalid value of colour,90025\n"
       ",,\n"
       "large,,\n"
       ",\"data are missing, nothing is predicted\",90027\n",
       errors},
      {"the prediction's own cells are empty",
       document,
       {"--on-error=null", "--all", "--format=jsonl", "--keep=x"},
       "x,colour\n2,blue\n",
       1,
       "{\"x\":2,\"z\":null,\"w\":\"invalid value of colour\",\"code\":90025,\"prediction\":null,"
       "\"probability\":null,\"probability_small\":null,\"probability_large\":null}\n",
       "kestrel: standard input:2: column colour: the model refuses \"blue\", accepted is one of: red, "
       "gr\xC3\xBCn (status 90025, kE_INVALID_VALUE)\nkestrel: 1 of 1 cases have no prediction\n"},
      {"the first fault stops it like any other",
       document,
       {},
       table,
       4,
       "",
       "kestrel: standard input:2: " + std::string(kNoPrediction) + "colour" +
           " (status 90027, kE_MISSINGVAR)\n"
           "  hint: --on-error null leaves such predictions empty and goes on\n"},
  });
}

TEST(KestrelOutputFields, TellOfTheTargetsDefault) {
  const std::vector<std::string> fields = {"name='z'", "name='shown' feature='predictedDisplayValue'",
                                           "name='p' feature='probability'",
                                           "name='w' feature='warning' dataType='integer'"};
  const std::string priors =
      "<Targets><Target field='size'><TargetValue value='small' displayValue='small one' "
      "priorProbability='0.25'/><TargetValue value='large' displayValue='large one' "
      "priorProbability='0.75'/></Target></Targets>";
  const std::string no_priors =
      "<Targets><Target field='size'><TargetValue value='small'/><TargetValue value='large'/></Target>"
      "</Targets>";
  const std::string number =
      "<Targets><Target field='y'><TargetValue defaultValue='12.5'/></Target></Targets>";
  CheckRows({
      {"the most probable category",
       DocumentWith("tree.xml", Output(fields) + priors),
       {"--all"},
       "x,colour\n2,\n0,\n",
       0,
       "z,shown,p,w,prediction,probability,probability_small,probability_large\n"
       "large,large one,0.75,90027,large,0.75,0.25,0.75\nsmall,small one,1,,small,1,1,0\n",
       ""},
      {"a case that is settled without prediction counts as done",
       DocumentWith("tree.xml", Output(fields) + no_priors),
       {"--all"},
       "x,colour\n2,\n",
       0,
       "z,shown,p,w,prediction,probability,probability_small,probability_large\n,,,90027,,,,\n",
       ""},
      {"a number",
       DocumentWith("line.xml", Output({"name='z'", "name='w' feature='warning'"}) + number),
       {},
       "x,y\n,\n1,\n",
       0,
       "z,w\n12.5,\"data are missing, the target's default is predicted\"\n3,\n",
       ""},
  });
}

TEST(KestrelOutputFields, CompareWithTheTrueValue) {
  const std::string line = DocumentWith("line.xml", Output({"name='z'", "name='r' feature='residual'"}));
  const std::string tree = DocumentWith("tree.xml", Output({"name='r' feature='residual' value='large'"}));
  CheckRows({
      {"numbers, wherever their column stands", line, {}, "y,x\n3.5,1\n4,2\n", 0, "z,r\n3,0.5\n5,-1\n", ""},
      {"a true value that is not known", line, {}, "x,y\n1,\n2,6\n", 0, "z,r\n3,\n5,1\n", ""},
      {"what stands for a missing one", line, {"--missing=NA"}, "x,y\n1,NA\n", 0, "z,r\n3,\n", ""},
      {"categories",
       tree,
       {},
       "x,colour,size\n2,red,large\n2,red,small\n0,red,large\n2,red,huge\n",
       0,
       "r\n0\n-1\n1\n\"\"\n",
       ""},
      {"no column of the target", line, {}, "x\n1\n", 0, "z,r\n3,\n", ""},
      {"a cell that is no number",
       line,
       {"--on-error=null"},
       "x,y\n1,a\n2,6\n",
       1,
       "z,r\n,\n5,1\n",
       "kestrel: standard input:2: column y: \"a\"" + std::string(kNumber) +
           "kestrel: 1 of 2 cases have no prediction\n"},
      {"what is missing for a prediction is told without the target",
       line,
       {"--on-error=null"},
       "x,y\n,1\n",
       1,
       "z,r\n,\n",
       "kestrel: standard input:2: " + std::string(kNoPrediction) + "x" + kStatus +
           "kestrel: 1 of 1 cases have no prediction\n"},
      {"without a residual nobody asks for the target",
       DocumentWith("line.xml", Output({"name='z'"})),
       {},
       "x\n1\n",
       0,
       "z\n3\n",
       ""},
  });
}

}  // namespace
}  // namespace kestrel_tests
