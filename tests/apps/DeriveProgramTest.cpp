// `kestrel derive`, run as its users run it.

#include <gtest/gtest.h>

#include <algorithm>

#include "tests/apps/KestrelProgram.h"
#include "tests/support/FileText.h"

namespace kestrel_tests {
namespace {

const char kHint[] = "\n  hint: --on-error null leaves such derived fields empty and goes on\n";
const char kNumber[] =
    " cannot be read; accepted is a number such as -1.5 or 2e3, with a decimal point, or an empty cell or a "
    "text of --missing for a missing value";
const char kHeader[] = "x,colour,day,hour,moment,days\n";
const char kNames[] = "twice,size,tint,the day,the hour,the moment,the days\n";

struct DeriveRow {
  const char* why;
  std::vector<std::string> arguments;  ///< behind "derive"; the table is the standard input
  std::string table;
  int exit_code;
  std::string output;
  std::string errors;
};

void CheckRows(const std::vector<DeriveRow>& rows) {
  for (const DeriveRow& row : rows) {
    std::vector<std::string> arguments = {"derive"};
    arguments.insert(arguments.end(), row.arguments.begin(), row.arguments.end());
    const ProgramOutcome outcome = RunKestrel(arguments, row.table);
    EXPECT_EQ(outcome.exit_code, row.exit_code) << row.why;
    EXPECT_EQ(outcome.output, row.output) << row.why;
    EXPECT_EQ(outcome.errors, row.errors) << row.why;
  }
}

/// derived.xml with another text in a place.
std::string Document(const std::string& from, const std::string& to) {
  const std::string text = FileText(DataPath("derived.xml"));
  EXPECT_NE(text.find(from), std::string::npos) << from;
  return Replaced(text, from, to);
}

/// derived.xml as a model with its derived fields in the given element.
std::string ModelDocument(const std::string& element) {
  const std::string model =
      "<RegressionModel functionName=\"regression\" targetFieldName=\"x\"><MiningSchema>"
      "<MiningField name=\"day\"/><MiningField name=\"x\" usageType=\"target\"/></MiningSchema>";
  const std::string rest = "<RegressionTable intercept=\"1\"/></RegressionModel>";
  std::string text = Replaced(FileText(DataPath("derived.xml")), "TransformationDictionary", element);
  if (element == "TransformationDictionary") return Replaced(text, "</PMML>", model + rest + "</PMML>");
  text = Replaced(text, "<" + element + ">", model + "<" + element + ">");
  return Replaced(text, "</" + element + ">", "</" + element + ">" + rest);
}

TEST(KestrelDerive, ComputesEveryTypeOfField) {
  CheckRows({
      {"all there",
       {"D/derived.xml"},
       kHeader + std::string("0.05,red,2024-02-29,13:05:59,2024-02-29T23:59:59,1.5\n"
                             "5,green,1969-12-31,00:00:00,0001-01-01T00:00:00,-1\n"),
       0,
       kNames + std::string("0.1,small,red,2024-02-29,13:05:59,2024-02-29T23:59:59,1.5\n"
                            "10,\"large, or more\",green,1969-12-31,00:00:00,0001-01-01T00:00:00,-1\n"),
       ""},
      {"all missing, then there again",
       {"D/derived.xml"},
       kHeader + std::string(",n/a,,,,\n1,red,2024-01-01,,,\n,,,,,\n"),
       0,
       kNames + std::string(",,grey,,,,\n2,small,red,2024-01-01,,,\n,,,,,,\n"),
       ""},
      {"numbers that are missing by the field's own word are computed with",
       {"D/derived.xml", "--fields", "twice,size"},
       "x\n-99\n",
       0,
       "twice,size\n-198,small\n",
       ""},
      {"texts that no Value element lists",
       {"D/derived.xml", "--fields=tint"},
       "colour\nblue\n",
       0,
       "tint\nblue\n",
       ""},
      {"what the user calls missing",
       {"D/derived.xml", "--fields", "twice,tint", "--missing", "NA,?"},
       "x,colour\nNA,?\n",
       0,
       "twice,tint\n,\n",
       ""},
      {"no cases", {"D/derived.xml", "--fields", "twice"}, "x\n", 0, "twice\n", ""},
      {"jsonl has numbers, texts and null",
       {"D/derived.xml", "--format", "jsonl"},
       kHeader + std::string("0.05,red,2024-02-29,,,2\n,n/a,,,,\n"),
       0,
       "{\"twice\":0.1,\"size\":\"small\",\"tint\":\"red\",\"the day\":\"2024-02-29\",\"the hour\":null,"
       "\"the moment\":null,\"the days\":2}\n"
       "{\"twice\":null,\"size\":null,\"tint\":\"grey\",\"the day\":null,\"the hour\":null,\"the "
       "moment\":null,\"the days\":null}\n",
       ""},
  });
}

TEST(KestrelDerive, ComputesTheFieldsThatAreAskedFor) {
  CheckRows({
      {"in the order of asking, with what they read alone",
       {"D/derived.xml", "--fields", "tint,size"},
       "colour,x\nred,1\n",
       0,
       "tint,size\nred,small\n",
       ""},
      {"one by one",
       {"D/derived.xml", "--fields=the days", "--fields", "twice"},
       "days;x\n3;1\n",
       0,
       "the days,twice\n3,2\n",
       ""},
      {"one that is not there",
       {"D/derived.xml", "--fields", "twice,thrice"},
       "x\n1\n",
       2,
       "",
       "kestrel: --fields: the document has no derived field \"thrice\"; the derived fields are twice, size, "
       "tint, the day, the hour, the moment, the days\n"},
      {"one that is written otherwise",
       {"D/derived.xml", "--fields", "Twice"},
       "x\n1\n",
       2,
       "",
       "kestrel: --fields: the document has no derived field \"Twice\"; the derived fields are twice, size, "
       "tint, the day, the hour, the moment, the days\n"
       "  hint: upper and lower case count; there is twice\n"},
      {"a data field",
       {"D/derived.xml", "--fields", "x"},
       "x\n1\n",
       2,
       "",
       "kestrel: --fields: the document has no derived field \"x\"; the derived fields are twice, size, "
       "tint, the day, the hour, the moment, the days\n"},
      {"one twice",
       {"D/derived.xml", "--fields", "size,twice,size"},
       "x\n1\n",
       2,
       "",
       "kestrel: --fields: the derived field \"size\" is asked for twice\n"},
  });
}

TEST(KestrelDerive, ComputesConstantsOfTablesThatItReadsNothingOf) {
  const TempFolder folder;
  folder.Write("m.xml", Document("<FieldRef field=\"day\"/>", "<Constant>2020-01-01</Constant>"));
  RunOptions options;
  options.input = "a\n?\n?\n";
  const ProgramOutcome outcome = RunKestrel(folder, {"derive", "T/m.xml", "--fields", "the day"}, options);
  EXPECT_EQ(outcome.exit_code, 0) << outcome.errors;
  EXPECT_EQ(outcome.output, "the day\n2020-01-01\n2020-01-01\n");
}

TEST(KestrelDerive, KeepsColumnsBesideTheFields) {
  CheckRows({
      {"all",
       {"D/derived.xml", "--fields", "twice", "--keep"},
       "id,x\n007,1\n",
       0,
       "id,x,twice\n007,1,2\n",
       ""},
      {"a name that is taken",
       {"D/derived.xml", "--fields", "twice", "--keep"},
       "x,twice\n1,0\n",
       0,
       "x,twice,twice_2\n1,0,2\n",
       "kestrel: the table has a column twice; the derived field is called twice_2\n"},
      {"a column that is called like a derived field is not read",
       {"D/derived.xml", "--fields", "size"},
       "x,twice\n1,100\n",
       0,
       "size\nsmall\n",
       ""},
      {"jsonl: inputs that are numbers are numbers",
       {"D/derived.xml", "--fields", "twice", "--keep=x,id", "--format", "jsonl"},
       "id,x\n7,0.50\n",
       0,
       "{\"x\":0.5,\"id\":\"7\",\"twice\":1}\n",
       ""},
      {"no such column",
       {"D/derived.xml", "--keep=z", "--fields", "twice"},
       "x\n1\n",
       2,
       "",
       "kestrel: --keep: the table has no column \"z\"; the columns are x\n"},
  });
}

TEST(KestrelDerive, StopsAtTheFirstFault) {
  const std::string here = "kestrel: standard input:";
  CheckRows({
      {"a text where a number belongs",
       {"D/derived.xml", "--fields", "size"},
       "x\n1\nabc\n2\n",
       4,
       "",
       here + "3: column x: \"abc\"" + kNumber + kHint},
      {"a day that no month has",
       {"D/derived.xml", "--fields", "the day"},
       "day\n2023-02-29\n",
       4,
       "",
       here +
           "2: column day: \"2023-02-29\" cannot be read; accepted is a date such as 2024-02-29, or an "
           "empty cell or a text of --missing for a missing value" +
           kHint},
      {"a cell that is not read may hold anything",
       {"D/derived.xml", "--fields", "size"},
       "x,day\n1,never\n",
       0,
       "size\nsmall\n",
       ""},
      {"too few cells",
       {"D/derived.xml", "--fields", "size"},
       "x,y\n1\n",
       4,
       "",
       here + "2: the row has 1 cell where the header has 2" + kHint},
      {"a column is absent",
       {"D/derived.xml", "--fields", "size,tint"},
       "id,X\n1,2\n",
       4,
       "",
       here + "1: the derived fields read x, colour, for which there is no column; the columns are id, X\n"
              "  hint: upper and lower case count; the table has X where the derived fields read x\n"},
      {"no table",
       {"D/derived.xml"},
       "",
       4,
       "",
       here.substr(0, here.size() - 1) +
           ": the table is empty; a line with the names of the columns is expected\n"},
  });
}

TEST(KestrelDerive, GoesOnAfterFaultsWhenToldTo) {
  CheckRows({
      {"csv",
       {"D/derived.xml", "--fields", "twice,size", "--keep=id", "--on-error", "null"},
       "id,x\n1,1\n2,?\n3\n4,5\n",
       1,
       "id,twice,size\n1,2,small\n2,,\n3,,\n4,10,\"large, or more\"\n",
       "kestrel: standard input:3: column x: \"?\"" + std::string(kNumber) +
           "\nkestrel: standard input:4: the row has 1 cell where the header has 2"
           "\nkestrel: 2 of 4 cases have no derived fields\n"},
      {"jsonl",
       {"D/derived.xml", "--fields", "twice", "--format", "jsonl", "--on-error", "null"},
       "x\na\n1\n",
       1,
       "{\"twice\":null}\n{\"twice\":2}\n",
       "kestrel: standard input:2: column x: \"a\"" + std::string(kNumber) +
           "\nkestrel: 1 of 2 cases have no derived fields\n"},
  });
  const ProgramOutcome outcome = RunKestrel(
      {"derive", "D/derived.xml", "--fields", "twice", "--stats", "--on-error", "null"}, "x\n1\na\n");
  EXPECT_EQ(outcome.exit_code, 1);
  EXPECT_NE(outcome.errors.find("kestrel: 2 cases, 1 failed, "), std::string::npos) << outcome.errors;
}

TEST(KestrelDerive, WritesFilesWholeOrNotAtAll) {
  const TempFolder folder;
  folder.Write("m.xml", FileText(DataPath("derived.xml")));
  folder.Write("good.csv", "x\n1\n");
  folder.Write("bad.csv", "x\n1\na\n");
  folder.Write("out.csv", "old");
  const auto derive = [&folder](const char* data, const char* out) {
    return RunKestrel(folder, {"derive", "T/m.xml", data, "--fields", "twice", "-o", out});
  };
  ProgramOutcome outcome = derive("T/bad.csv", "T/out.csv");
  EXPECT_EQ(outcome.exit_code, 4);
  EXPECT_EQ(outcome.errors, "kestrel: T/bad.csv:3: column x: \"a\"" + std::string(kNumber) + kHint);
  EXPECT_EQ(FileText(folder.PathOf("out.csv")), "old");
  outcome = derive("T/good.csv", "T/out.csv");
  EXPECT_EQ(outcome.exit_code, 0) << outcome.errors;
  EXPECT_EQ(outcome.output + outcome.errors, "");
  EXPECT_EQ(FileText(folder.PathOf("out.csv")), "twice\n2\n");
  EXPECT_EQ(std::distance(std::filesystem::directory_iterator(folder.GetPath()), {}), 4);
  for (const auto& [out, what] :
       {std::pair("T/m.xml", "the document"), std::pair("T/good.csv", "the table")}) {
    outcome = derive("T/good.csv", out);
    EXPECT_EQ(outcome.exit_code, 2);
    EXPECT_EQ(outcome.errors,
              "kestrel: -o " + std::string(out) + ": this is " + what + " itself; name another file\n");
  }
}

TEST(KestrelDerive, TakesTheDocumentFromTheStandardInput) {
  const TempFolder folder;
  folder.Write("data.csv", "x\n1\n");
  RunOptions options;
  options.input = FileText(DataPath("derived.xml"));
  ProgramOutcome outcome =
      RunKestrel(folder, {"derive", "-", "T/data.csv", "--fields", "twice", "-o", "-"}, options);
  EXPECT_EQ(outcome.exit_code, 0) << outcome.errors;
  EXPECT_EQ(outcome.output, "twice\n2\n");
  outcome = RunKestrel(folder, {"derive", "-"}, options);
  EXPECT_EQ(outcome.exit_code, 2);
  EXPECT_EQ(outcome.errors,
            "kestrel: the document and the table cannot both come from the standard input; name a file for "
            "one\n");
}

TEST(KestrelDerive, NeedsNoModelLibrary) {
  const TempFolder folder;
  for (const char* kind : {"RegressionModel", "NeuralNetwork"}) {
    folder.Write("m.xml", Replaced(ModelDocument("TransformationDictionary"), "RegressionModel", kind));
    RunOptions options;
    options.input = "x\n1\n";
    const ProgramOutcome outcome = RunKestrel(folder, {"derive", "T/m.xml", "--fields", "twice"}, options);
    EXPECT_EQ(outcome.exit_code, 0) << outcome.errors;
    EXPECT_EQ(outcome.output, "twice\n2\n") << kind;
  }
}

TEST(KestrelDerive, SaysThatThereAreNoDerivedFields) {
  const TempFolder folder;
  folder.Write("data.csv", "x\n1\n");
  const std::string accepted =
      "\n  hint: accepted are DerivedField elements in a TransformationDictionary directly below PMML\n";
  const std::string none = ": the document has no derived fields" + accepted;
  const std::string local =
      ": the derived fields are those of a model alone (LocalTransformations), which kestrel score computes "
      "for the model" +
      accepted;
  // Long enough that the element's name stands in two of the blocks that documents are read in.
  const std::string distant = ModelDocument("LocalTransformations");
  const std::string filler(65536 - distant.find("DerivedField") - 6 - std::string("<!---->").size(), ' ');
  const std::pair<std::string, std::string> rows[] = {
      {FileText(DataPath("line.xml")), none},
      {Replaced(Document("DerivedField", "Extension"), "TransformationDictionary", "Extension"), none},
      {ModelDocument("LocalTransformations"), local},
      {Replaced(distant, "<Header", "<!--" + filler + "--><Header"), local},
  };
  for (const auto& [document, want] : rows) {
    folder.Write("m.xml", document);
    RunOptions options;
    options.input = document;
    for (const char* path : {"T/m.xml", "-"}) {
      const ProgramOutcome outcome = RunKestrel(folder, {"derive", path, "T/data.csv"}, options);
      EXPECT_EQ(outcome.exit_code, 3) << want;
      EXPECT_EQ(outcome.output, "") << want;
      EXPECT_EQ(outcome.errors, std::string("kestrel: ") + (*path == '-' ? "standard input" : path) + want);
    }
  }
}

TEST(KestrelDerive, SaysWhatIsWrongWithADocumentAndWhere) {
  const struct {
    const char* from;
    const char* to;
    const char* want;
  } rows[] = {
      {"<FieldRef field=\"x\"/>", "<FieldRef field=\"z\"/>", ":22:30: z: not predefined (code 8)\n"},
      {"function=\"*\"", "function=\"times\"", ":21:31: times: not Supported function name (code 5)\n"},
      {"name=\"tint\"", "name=\"size\"", ":36:70: size: Redefinition! (code 1)\n"},
      {"</TransformationDictionary>", "", ":52:3: Invalid XML file!! (code 6)\n"},
  };
  const TempFolder folder;
  folder.Write("data.csv", "x\n1\n");
  for (const auto& row : rows) {
    folder.Write("m.xml", Document(row.from, row.to));
    const ProgramOutcome outcome = RunKestrel(folder, {"derive", "T/m.xml", "T/data.csv"});
    EXPECT_EQ(outcome.exit_code, 3) << row.want;
    EXPECT_EQ(outcome.output, "") << row.want;
    EXPECT_EQ(outcome.errors.substr(0, outcome.errors.find("  hint: ")),
              "kestrel: T/m.xml" + std::string(row.want));
    EXPECT_NE(outcome.errors.find("  hint: "), std::string::npos) << row.want;
  }
  folder.Write("m.xml", "<Table/>");
  const ProgramOutcome other = RunKestrel(folder, {"derive", "T/m.xml", "T/data.csv"});
  EXPECT_EQ(other.exit_code, 3);
  EXPECT_EQ(other.errors,
            "kestrel: T/m.xml:1:9: Unsupported Model found! (code 5)\n"
            "  hint: accepted is PMML as the root element\n");
  const ProgramOutcome outcome = RunKestrel(folder, {"derive", "T/absent.xml", "T/data.csv"});
  EXPECT_EQ(outcome.exit_code, 5);
  EXPECT_EQ(outcome.errors, "kestrel: T/absent.xml: cannot be opened: No such file or directory\n");
}

}  // namespace
}  // namespace kestrel_tests
