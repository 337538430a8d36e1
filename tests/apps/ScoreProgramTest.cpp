// `kestrel score`, run as its users run it.

#include <gtest/gtest.h>

#include <algorithm>

#include "tests/apps/KestrelProgram.h"
#include "tests/support/FileText.h"
#include "tests/support/SystemFiles.h"

namespace kestrel_tests {
namespace {

const char kHint[] = "\n  hint: --on-error null leaves such predictions empty and goes on\n";
const char kNumber[] =
    " cannot be read; accepted is a number such as -1.5 or 2e3, with a decimal point, or an empty cell or a "
    "text of --missing for a "
    "missing "
    "value";

struct ScoreRow {
  const char* why;
  std::vector<std::string> arguments;  ///< behind "score"; the table is the standard input
  std::string table;
  int exit_code;
  std::string output;
  std::string errors;
};

void CheckRows(const std::vector<ScoreRow>& rows) {
  for (const ScoreRow& row : rows) {
    std::vector<std::string> arguments = {"score"};
    arguments.insert(arguments.end(), row.arguments.begin(), row.arguments.end());
    const ProgramOutcome outcome = RunKestrel(arguments, row.table);
    EXPECT_EQ(outcome.exit_code, row.exit_code) << row.why;
    EXPECT_EQ(outcome.output, row.output) << row.why;
    EXPECT_EQ(outcome.errors, row.errors) << row.why;
  }
}

TEST(KestrelScore, ScoresTables) {
  CheckRows({
      {"regression", {"D/line.xml"}, "x\n1\n-0.25\n", 0, "prediction\n3\n0.5\n", ""},
      {"a dash is the standard input", {"D/line.xml", "-"}, "x\n1\n", 0, "prediction\n3\n", ""},
      {"a dash is the standard output", {"D/line.xml", "-o", "-"}, "x\n1\n", 0, "prediction\n3\n", ""},
      {"classification, categories in the target's order",
       {"D/sizes.xml"},
       "x\n0.25\n1\n",
       0,
       "prediction,probability,probability_small,\"probability_large, red\"\n"
       "small,0.75,0.75,0.25\n\"large, red\",1,0,1\n",
       ""},
      {"the target does not list its categories",
       {"D/unlisted.xml"},
       "x\n0\n",
       0,
       "prediction,probability,probability_1,probability_2\n1,0.5,0.5,0.5\n",
       ""},
      {"no cases", {"D/line.xml"}, "x\n", 0, "prediction\n", ""},
      {"columns that are not read, in another order",
       {"D/line.xml"},
       "a,x,b\n?,1,\n",
       0,
       "prediction\n3\n",
       ""},
      {"tabs", {"D/line.xml"}, "a\tx\n?\t1\n", 0, "prediction\n3\n", ""},
      {"semicolons", {"D/line.xml"}, "a;x\n?;1\n", 0, "prediction\n3\n", ""},
      {"a separator that is told by name",
       {"D/line.xml", "--delimiter", "semicolon"},
       "x;a,b\n1;2\n",
       0,
       "prediction\n3\n",
       ""},
      {"and by itself", {"D/line.xml", "--delimiter", ";"}, "x;a,b,c\n1;2\n", 0, "prediction\n3\n", ""},
      {"CR LF, a UTF-8 mark, no end", {"D/line.xml"}, "\xEF\xBB\xBFx\r\n1\r\n2", 0, "prediction\n3\n5\n", ""},
      {"numbers in all their forms",
       {"D/line.xml"},
       "x\n 1 \n+1\n1.\n.5\n1e1\n1E-1\n\" 1 \"\n-0\n1e-400\n",
       0,
       "prediction\n3\n3\n3\n2\n21\n1.2\n3\n1\n1\n",
       ""},
  });
}

TEST(KestrelScore, ReadsEveryTypeOfInput) {
  const std::string header = "x,n,colour,free text,day,hour,moment,days\n";
  CheckRows({
      {"all there",
       {"D/inputs.xml"},
       header + "1,2,red,\"a, b\",1970-01-02,00:00:05,1970-01-01T00:01:00,1\n",
       0,
       "prediction\n96571\n",
       ""},
      {"blanks around dates",
       {"D/inputs.xml"},
       header + "0,0,,,\" 1970-01-02 \", 00:00:01 ,,\" 3 \"\n",
       0,
       "prediction\n86404\n",
       ""},
      {"all missing that may be, then there again",
       {"D/inputs.xml"},
       header + ",0,,,,,,\n0,0,green,\"a, b\",,,,\n,0,,,,,,\n",
       0,
       "prediction\n1000\n10200\n1000\n",
       ""},
      {"what the document calls missing",
       {"D/inputs.xml"},
       header + "-99,0,n/a,,,,,\n",
       0,
       "prediction\n1000\n",
       ""},
      {"what the user calls missing",
       {"D/inputs.xml", "--missing", "NA,?", "--missing=-1"},
       header + "NA,0,?,NA,?,NA,?,NA\n-1,0,,,,,,\n",
       0,
       "prediction\n1000\n1000\n",
       ""},
  });
}

TEST(KestrelScore, StopsAtTheFirstFault) {
  const std::string header = "x,n,colour,free text,day,hour,moment,days\n";
  const std::string here = "kestrel: standard input:2: ";
  const std::string missing = ", or an empty cell or a text of --missing for a missing value";
  CheckRows({
      {"a text where a number belongs",
       {"D/line.xml"},
       "x\n1\nabc\n2\n",
       4,
       "",
       "kestrel: standard input:3: column x: \"abc\"" + std::string(kNumber) + kHint},
      {"a number with something behind it",
       {"D/line.xml"},
       "x\n1.5kg\n",
       4,
       "",
       here + "column x: \"1.5kg\"" + kNumber + kHint},
      {"a decimal comma",
       {"D/line.xml"},
       "x;y\n1,5;2\n",
       4,
       "",
       here + "column x: \"1,5\"" + kNumber + kHint},
      {"infinity", {"D/line.xml"}, "x\ninf\n", 4, "", here + "column x: \"inf\"" + kNumber + kHint},
      {"no number", {"D/line.xml"}, "x\nNaN\n", 4, "", here + "column x: \"NaN\"" + kNumber + kHint},
      {"too large", {"D/line.xml"}, "x\n1e999\n", 4, "", here + "column x: \"1e999\"" + kNumber + kHint},
      {"blanks in quotation marks",
       {"D/line.xml"},
       "x\n\" \"\n",
       4,
       "",
       here + "column x: \" \"" + kNumber + kHint},
      {"a hexadecimal number",
       {"D/line.xml"},
       "x\n0x10\n",
       4,
       "",
       here + "column x: \"0x10\"" + kNumber + kHint},
      {"a cell with control characters",
       {"D/line.xml"},
       "x\n\"1\n2\"\n",
       4,
       "",
       here + "column x: \"1?2\"" + kNumber + kHint},
      {"a day that no month has",
       {"D/inputs.xml"},
       header + ",0,,,2023-02-29,,,\n",
       4,
       "",
       here + "column day: \"2023-02-29\" cannot be read; accepted is a date such as 2024-02-29" + missing +
           kHint},
      {"a time beyond the day",
       {"D/inputs.xml"},
       header + ",0,,,,24:00:00,,\n",
       4,
       "",
       here + "column hour: \"24:00:00\" cannot be read; accepted is a time such as 13:05:59" + missing +
           kHint},
      {"a date without time",
       {"D/inputs.xml"},
       header + ",0,,,,,2024-01-01,\n",
       4,
       "",
       here + "column moment: \"2024-01-01\" cannot be read; accepted is a date with a time such as " +
           "2024-02-29T13:05:59" + missing + kHint},
      {"a date where days belong",
       {"D/inputs.xml"},
       header + ",0,,,,,,2024-01-01\n",
       4,
       "",
       here + "column days: \"2024-01-01\" cannot be read; accepted is a number of days such as 19782" +
           missing + kHint},
      {"a category that the field does not list",
       {"D/inputs.xml"},
       header + ",0,blue,,,,,\n",
       4,
       "",
       here + "column colour: the model refuses \"blue\", accepted is one of: red, green (status 90025, " +
           "kE_INVALID_VALUE)" + kHint},
      {"a missing value that the model cannot do without",
       {"D/line.xml"},
       "x,z\n,1\n",
       4,
       "",
       here + "the case has no prediction; missing are x (status 90027, kE_MISSINGVAR)" + kHint},
      {"too few cells",
       {"D/line.xml"},
       "x,y\n1\n",
       4,
       "",
       here + "the row has 1 cell where the header has 2" + kHint},
      {"too many cells",
       {"D/line.xml"},
       "x,y\n1,2,3\n",
       4,
       "",
       here + "the row has 3 cells where the header has 2" + kHint},
  });
}

TEST(KestrelScore, GoesOnAfterFaultsWhenToldTo) {
  CheckRows({
      {"regression",
       {"D/line.xml", "--on-error", "null"},
       "x,z\n1,\na,\n,\n2\n3,\n",
       1,
       "prediction\n3\n\"\"\n\"\"\n\"\"\n7\n",
       "kestrel: standard input:3: column x: \"a\"" + std::string(kNumber) +
           "\nkestrel: standard input:4: the case has no prediction; missing are x (status 90027, "
           "kE_MISSINGVAR)"
           "\nkestrel: standard input:5: the row has 1 cell where the header has 2"
           "\nkestrel: 3 of 5 cases have no prediction\n"},
      {"classification with kept columns",
       {"D/sizes.xml", "--keep", "--on-error=null"},
       "id,x\n1,?\n2\n3,0.75\n",
       1,
       "id,x,prediction,probability,probability_small,\"probability_large, red\"\n1,?,,,,\n2,,,,,\n"
       "3,0.75,\"large, red\",0.75,0.25,0.75\n",
       "kestrel: standard input:2: column x: \"?\"" + std::string(kNumber) +
           "\nkestrel: standard input:3: the row has 1 cell where the header has 2"
           "\nkestrel: 2 of 3 cases have no prediction\n"},
      {"jsonl",
       {"D/line.xml", "--format", "jsonl", "--on-error", "null"},
       "x\na\n1\n",
       1,
       "{\"prediction\":null}\n{\"prediction\":3}\n",
       "kestrel: standard input:2: column x: \"a\"" + std::string(kNumber) +
           "\nkestrel: 1 of 2 cases have no prediction\n"},
      {"nothing to complain of", {"D/line.xml", "--on-error", "null"}, "x\n1\n", 0, "prediction\n3\n", ""},
  });
}

TEST(KestrelScore, PrintsTenFaultsAndCountsTheRest) {
  std::string table = "x\n";
  for (int i = 0; i < 25; ++i)
    table += "a\n";
  const ProgramOutcome outcome = RunKestrel({"score", "D/line.xml", "--on-error", "null"}, table);
  EXPECT_EQ(outcome.exit_code, 1);
  EXPECT_EQ(std::count(outcome.errors.begin(), outcome.errors.end(), '\n'), 11);
  EXPECT_NE(outcome.errors.find("kestrel: 25 of 25 cases have no prediction\n"), std::string::npos);
}

TEST(KestrelScore, RefusesTablesThatDoNotFitTheModel) {
  CheckRows({
      {"a column is absent",
       {"D/line.xml"},
       "a,y\n1,2\n",
       4,
       "",
       "kestrel: standard input:1: the model reads x, for which there is no column; the columns are a, y\n"},
      {"its name is written otherwise",
       {"D/line.xml"},
       "X,y\n1,2\n",
       4,
       "",
       "kestrel: standard input:1: the model reads x, for which there is no column; the columns are X, y\n"
       "  hint: upper and lower case count; the table has X where the model reads x\n"},
      {"a file that is no text",
       {"D/line.xml"},
       std::string("PK\3\4\0\0,x\n1,2\n", 14),
       4,
       "",
       "kestrel: standard input:1: this is no text table: there are zero bytes in its first line; is the "
       "file "
       "compressed, a spreadsheet, or written in UTF-16?\n"},
      {"several are, further down",
       {"D/inputs.xml"},
       "\nx,hour\n",
       4,
       "",
       "kestrel: standard input:2: the model reads n, day, moment, days, colour, free text, for which there "
       "is no "
       "column; the columns are x, hour\n"},
      {"it may be that the cells are separated by something else",
       {"D/line.xml"},
       "x:y\n1:2\n",
       4,
       "",
       "kestrel: standard input:1: the model reads x, for which there is no column; the columns are x:y\n"
       "  hint: --delimiter tells what separates the cells\n"},
      {"a name stands there twice",
       {"D/line.xml"},
       "x,a,a\n1,2,3\n",
       4,
       "",
       "kestrel: standard input:1: column a is there twice; every column needs a name of its own\n"},
      {"nothing at all",
       {"D/line.xml"},
       "",
       4,
       "",
       "kestrel: standard input: the table is empty; a line with the names of the columns is expected\n"},
      {"broken quotation marks stop it whatever it is told",
       {"D/line.xml", "--on-error", "null"},
       "x\n1\n\"2\n",
       4,
       "",
       "kestrel: standard input:3: column x: the quotation mark that opens this cell has no closing one up "
       "to the "
       "end\n"},
  });
}

TEST(KestrelScore, KeepsColumnsBesideThePredictions) {
  CheckRows({
      {"all",
       {"D/line.xml", "--keep"},
       "id,x,note\n007,1,\"a, \"\"b\"\"\"\n",
       0,
       "id,x,note,prediction\n007,1,\"a, \"\"b\"\"\",3\n",
       ""},
      {"some, in the order of asking",
       {"D/line.xml", "--keep=note,id"},
       "id,x,note\n007,1,n\n",
       0,
       "note,id,prediction\nn,007,3\n",
       ""},
      {"asked for one by one",
       {"D/line.xml", "--keep=note", "--keep=id"},
       "id,x,note\n007,1,n\n",
       0,
       "note,id,prediction\nn,007,3\n",
       ""},
      {"tabs become commas",
       {"D/line.xml", "--keep"},
       "x\ta,b\n1\t2,3\n",
       0,
       "x,\"a,b\",prediction\n1,\"2,3\",3\n",
       ""},
      {"a name that is taken",
       {"D/line.xml", "--keep"},
       "x,prediction\n1,0\n",
       0,
       "x,prediction,prediction_2\n1,0,3\n",
       "kestrel: the table has a column prediction; the model's is called prediction_2\n"},
      {"a name that is not taken, since it is not kept",
       {"D/line.xml", "--keep=x"},
       "x,prediction\n1,0\n",
       0,
       "x,prediction\n1,3\n",
       ""},
      {"jsonl: inputs that are numbers are numbers, other columns texts",
       {"D/inputs.xml", "--keep", "--format", "jsonl"},
       "id,x,n,colour,free text,day,hour,moment,days\n1,0.50,0,red,,1970-01-01,,,2\n",
       0,
       "{\"id\":\"1\",\"x\":0.5,\"n\":0,\"colour\":\"red\",\"free "
       "text\":null,\"day\":\"1970-01-01\",\"hour\":null,"
       "\"moment\":null,\"days\":2,\"prediction\":102.5}\n",
       ""},
      {"no such column",
       {"D/line.xml", "--keep=y"},
       "x\n1\n",
       2,
       "",
       "kestrel: --keep: the table has no column \"y\"; the columns are x\n"},
  });
}

TEST(KestrelScore, WritesJsonLines) {
  CheckRows({
      {"classification",
       {"D/sizes.xml", "--format", "jsonl"},
       "x\n1\n",
       0,
       "{\"prediction\":\"large, red\",\"probability\":1,\"probability_small\":0,\"probability_large, "
       "red\":1}\n",
       ""},
      {"categories that are numbers",
       {"D/unlisted.xml", "--format=jsonl"},
       "x\n0\n",
       0,
       "{\"prediction\":1,\"probability\":0.5,\"probability_1\":0.5,\"probability_2\":0.5}\n",
       ""},
  });
}

TEST(KestrelScore, TellsHowFastItWent) {
  const ProgramOutcome outcome =
      RunKestrel({"score", "D/line.xml", "--stats", "--on-error", "null"}, "x\n1\na\n2\n");
  EXPECT_EQ(outcome.exit_code, 1);
  EXPECT_NE(outcome.errors.find("kestrel: 3 cases, 1 failed, "), std::string::npos) << outcome.errors;
  EXPECT_NE(outcome.errors.find(" cases a second\n"), std::string::npos) << outcome.errors;
}

TEST(KestrelScore, CountsASingleCase) {
  EXPECT_EQ(
      RunKestrel({"score", "D/line.xml", "--stats"}, "x\n1\n").errors.find("kestrel: 1 case, 0 failed, "),
      0u);
}

TEST(KestrelScore, WritesFilesWholeOrNotAtAll) {
  const TempFolder folder;
  folder.Write("good \xC3\xA4.csv", "x\n1\n");
  folder.Write("bad.csv", "x\n1\na\n");
  folder.Write("out.csv", "old");
  ProgramOutcome outcome = RunKestrel(folder, {"score", "D/line.xml", "T/bad.csv", "-o", "T/out.csv"});
  EXPECT_EQ(outcome.exit_code, 4);
  EXPECT_EQ(outcome.errors, "kestrel: T/bad.csv:3: column x: \"a\"" + std::string(kNumber) + kHint);
  EXPECT_EQ(FileText(folder.PathOf("out.csv")), "old");
  outcome = RunKestrel(folder, {"score", "D/line.xml", "T/good \xC3\xA4.csv", "--output", "T/out.csv"});
  EXPECT_EQ(outcome.exit_code, 0) << outcome.errors;
  EXPECT_EQ(outcome.output + outcome.errors, "");
  EXPECT_EQ(FileText(folder.PathOf("out.csv")), "prediction\n3\n");
  EXPECT_EQ(std::distance(std::filesystem::directory_iterator(folder.GetPath()), {}), 3);
}

TEST(KestrelScore, DoesNotWriteOverWhatItReads) {
  const TempFolder folder;
  folder.Write("data.csv", "x\n1\n");
  folder.Write("model.xml", FileText(DataPath("line.xml")));
  std::vector<std::pair<const char*, const char*>> rows = {
      {"T/data.csv", "the table"}, {"T/./data.csv", "the table"}, {"T/model.xml", "the model"}};
  if (MakeLink(folder.GetPath() / "data.csv", folder.GetPath() / "link"))
    rows.emplace_back("T/link", "the table");
  for (const auto& [output, what] : rows) {
    const ProgramOutcome outcome = RunKestrel(folder, {"score", "T/model.xml", "T/data.csv", "-o", output});
    EXPECT_EQ(outcome.exit_code, 2);
    EXPECT_EQ(outcome.errors,
              "kestrel: -o " + std::string(output) + ": this is " + what + " itself; name another file\n");
  }
  EXPECT_EQ(FileText(folder.PathOf("data.csv")), "x\n1\n");
}

TEST(KestrelScore, TakesTheModelFromTheStandardInput) {
  const TempFolder folder;
  folder.Write("data.csv", "x\n1\n");
  RunOptions options;
  options.input = FileText(DataPath("line.xml"));
  ProgramOutcome outcome = RunKestrel(folder, {"score", "-", "T/data.csv"}, options);
  EXPECT_EQ(outcome.exit_code, 0) << outcome.errors;
  EXPECT_EQ(outcome.output, "prediction\n3\n");
  outcome = RunKestrel(folder, {"score", "-"}, options);
  EXPECT_EQ(outcome.exit_code, 2);
  EXPECT_EQ(
      outcome.errors,
      "kestrel: the model and the table cannot both come from the standard input; name a file for one\n");
}

TEST(KestrelCopyTable, WritesTheTableThatItRead) {
  const struct {
    std::vector<std::string> options;
    const char* table;
    int exit_code;
    const char* output;
    const char* errors;
  } rows[] = {
      {{}, "a;b\n1;\"x;y\"\n;\n", 0, "a,b\n1,x;y\n,\n", ""},
      {{"--delimiter", "comma"}, "a;b,c\n1,2\n", 0, "a;b,c\n1,2\n", ""},
      {{"--format", "jsonl"}, "a,,\n1,,3\n", 0, "{\"a\":\"1\",\"\":null,\"_2\":\"3\"}\n", ""},
      {{}, "a,b\n1\n", 4, "", "kestrel: standard input:2: the row has 1 cell where the header has 2\n"},
  };
  for (const auto& row : rows) {
    std::vector<std::string> arguments = {"copy-table"};
    arguments.insert(arguments.end(), row.options.begin(), row.options.end());
    const ProgramOutcome outcome = RunKestrel(arguments, row.table);
    EXPECT_EQ(outcome.exit_code, row.exit_code);
    EXPECT_EQ(outcome.output, row.output);
    EXPECT_EQ(outcome.errors, row.errors);
  }
}

}  // namespace
}  // namespace kestrel_tests
