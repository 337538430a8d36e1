#include "apps/kestrel/TableReader.h"

#include <gtest/gtest.h>

#include <numeric>

#include "apps/kestrel/InputFile.h"
#include "apps/kestrel/ProgramError.h"
#include "tests/support/TempFolder.h"

namespace kestrel_tests {
namespace {

using namespace kestrel_program;
using namespace std::string_literals;

/// A table as one text: cells in brackets, "@" and the line in front of each row but the header, rows
/// separated by blanks. A fault is its text, without the folder.
std::string Read(const std::string& content, char delimiter = 0) {
  const TempFolder folder;
  const std::string path = folder.Write("t.csv", content);
  std::string shown;
  try {
    InputFile input(path);
    TableReader reader(input, delimiter);
    for (const std::string& name : reader.GetHeader())
      shown += "[" + name + "]";
    std::vector<std::size_t> columns(reader.GetHeader().size());
    std::iota(columns.begin(), columns.end(), std::size_t{0});
    reader.ReadRows(columns, [&](const TableRow& row) {
      shown += " @" + std::to_string(row.GetLine());
      for (const std::size_t column : columns)
        shown += "[" + std::string(row.GetCell(column)) + "]";
      if (row.GetCellCount() != columns.size()) shown += "#" + std::to_string(row.GetCellCount());
      return true;
    });
  } catch (const ProgramError& fault) {
    EXPECT_EQ(fault.GetCode(), kData);
    return fault.GetText().substr(folder.GetPath().u8string().size() + 1);
  }
  return shown;
}

struct Row {
  const char* why;
  std::string content;
  std::string want;
};

const Row kTables[] = {
    {"commas", "a,b\n1,2\n3,4\n", "[a][b] @2[1][2] @3[3][4]"},
    {"tabs", "a\tb\n1\t2\n", "[a][b] @2[1][2]"},
    {"semicolons, commas in the cells", "a;b\n1,5;2\n", "[a][b] @2[1,5][2]"},
    {"vertical bars", "a|b\n1|2\n", "[a][b] @2[1][2]"},
    {"the most frequent separator of the header counts", "a;b,c;d\n1;2;3\n", "[a][b,c][d] @2[1][2][3]"},
    {"of equally frequent ones the tab counts", "a,b\tc\n1\t2\n", "[a,b][c] @2[1][2]"},
    {"then the comma", "a;b,c\n1,2\n", "[a;b][c] @2[1][2]"},
    {"separators in quotation marks do not", "\"a;b;c\",d\n1,2\n", "[a;b;c][d] @2[1][2]"},
    {"one column", "a\n1\n2\n", "[a] @2[1] @3[2]"},
    {"CR LF", "a,b\r\n1,2\r\n3,4\r\n", "[a][b] @2[1][2] @3[3][4]"},
    {"CR alone", "a,b\r1,2\r3,4\r", "[a][b] @2[1][2] @3[3][4]"},
    {"no line end at the end", "a,b\n1,2", "[a][b] @2[1][2]"},
    {"no line end, last cell empty", "a,b\n1,", "[a][b] @2[1][]"},
    {"a header alone", "a,b\n", "[a][b]"},
    {"a header alone without line end", "a,b", "[a][b]"},
    {"a UTF-8 mark",
     "\xEF\xBB\xBF"
     "a,b\n1,2\n",
     "[a][b] @2[1][2]"},
    {"a UTF-8 mark before quotation marks", "\xEF\xBB\xBF\"a\",b\n1,2\n", "[a][b] @2[1][2]"},
    {"empty cells", "a,b,c\n,,\n1,,3\n", "[a][b][c] @2[][][] @3[1][][3]"},
    {"empty lines are skipped and counted", "\n\na,b\n\n1,2\n\n\n3,4\n\n", "[a][b] @5[1][2] @8[3][4]"},
    {"empty lines with CR LF", "a,b\r\n\r\n1,2\r\n", "[a][b] @3[1][2]"},
    {"lines of blanks are skipped", "a,b\n   \n1,2\n", "[a][b] @3[1][2]"},
    {"blanks around cells do not count", " a , b\n 1 2 ,\t3\t\n", "[a][b] @2[1 2][3]"},
    {"blanks in quotation marks do", "a,b\n\" 1 \" , \" \"\n", "[a][b] @2[ 1 ][ ]"},
    {"separators in quotation marks", "a,b\n\"1,2\",3\n", "[a][b] @2[1,2][3]"},
    {"quotation marks written twice", "a,b\n\"say \"\"hi\"\"\",\"\"\"\"\n", "[a][b] @2[say \"hi\"][\"]"},
    {"line ends in quotation marks are counted", "a,b\n\"1\n2\n\",3\n4,5\n", "[a][b] @2[1\n2\n][3] @5[4][5]"},
    {"CR LF in quotation marks", "a\n\"1\r\n2\"\n3\n", "[a] @2[1\r\n2] @4[3]"},
    {"line ends in the header", "\"a\nb\",c\n1,2\n", "[a\nb][c] @3[1][2]"},
    {"an empty cell in quotation marks makes a row", "a\n\"\"\n1\n", "[a] @2[] @3[1]"},
    {"too few cells", "a,b,c\n1\n1,2,3\n", "[a][b][c] @2[1][][]#1 @3[1][2][3]"},
    {"too many cells", "a,b\n1,2,3,4\n", "[a][b] @2[1][2]#4"},
    {"bytes of zero",
     "a,b\n1\0"
     "2,\0\n"s,
     "[a][b] @2[1\0"
     "2][\0]"s},
    {"other bytes pass unchanged", "\xC3\xA4,b\n\xFF\xFE,\x01\n", "[\xC3\xA4][b] @2[\xFF\xFE][\x01]"},
    {"columns without name, more than one", ",a,\n1,2,3\n", "[][a][] @2[1][2][3]"},
    {"a line of tabs is a header when tabs separate", "\t\na\tb\n", "[][] @2[a][b]"},
    {"and blank when they do not", "\t\na,b,c\n1,2,3\n", "[a][b][c] @3[1][2][3]"},
    {"a header in quotation marks", "\"a,1\",\"b\"\n1,2\n", "[a,1][b] @2[1][2]"},
};

TEST(TableReader, ReadsTables) {
  for (const Row& row : kTables)
    EXPECT_EQ(Read(row.content), row.want) << row.why;
}

TEST(TableReader, TakesTheSeparatorThatItIsTold) {
  EXPECT_EQ(Read("a,b;c\n1,2;3\n", ';'), "[a,b][c] @2[1,2][3]");
  EXPECT_EQ(Read("a,b;c\n1,2;3\n", ','), "[a][b;c] @2[1][2;3]");
  EXPECT_EQ(Read("a\tb\n\t2\n", '\t'), "[a][b] @2[][2]");
}

const char kNoEnd[] = "the quotation mark that opens this cell has no closing one up to the end";
const char kInside[] =
    "a quotation mark stands inside this cell; the cell must be enclosed in quotation marks, and those "
    "inside it "
    "written twice";

const Row kFaults[] = {
    {"nothing at all", "", "t.csv: the table is empty; a line with the names of the columns is expected"},
    {"empty lines alone", "\n\r\n \n",
     "t.csv: the table is empty; a line with the names of the columns is expected"},
    {"a UTF-8 mark alone", "\xEF\xBB\xBF",
     "t.csv: the table is empty; a line with the names of the columns is expected"},
    {"UTF-16, low byte first",
     "\xFF\xFE"
     "a\0"s,
     "t.csv: the table is written in UTF-16; UTF-8 is expected"},
    {"UTF-16, high byte first", "\xFE\xFF\0a"s, "t.csv: the table is written in UTF-16; UTF-8 is expected"},
    {"the same name twice", "a,b,a\n1,2,3\n",
     "t.csv:1: column a is there twice; every column needs a name of its own"},
    {"the same name twice, further down", "\n\na,a\n",
     "t.csv:3: column a is there twice; every column needs a name of its own"},
    {"no closing mark", "a,b\n1,2\n3,\"4\n5,6\n", "t.csv:3: column b: "s + kNoEnd},
    {"no closing mark behind a cell of two lines", "a,b\n\"1\n2\",\"x\n", "t.csv:3: column b: "s + kNoEnd},
    {"no closing mark in the header", "a,\"b\n1,2\n", "t.csv:1: "s + kNoEnd},
    {"a mark inside", "a,b\n1,2\n3\" pipe,4\n", "t.csv:3: column a: "s + kInside},
    {"text behind the closing mark", "a,b\n1,\"2\"x\n", "t.csv:2: column b: "s + kInside},
    {"the column has no name", ",b\n\"1\"x,2\n", "t.csv:2: column 1: "s + kInside},
    {"beyond the header", "a\n1,x\"y\n", "t.csv:2: "s + kInside},
};

TEST(TableReader, RefusesWhatIsNoTable) {
  for (const Row& row : kFaults)
    EXPECT_EQ(Read(row.content), row.want) << row.why;
}

TEST(TableReader, ReadsCellsLongerThanItsBlocks) {
  const std::string longest(1'000'000, 'x');
  EXPECT_EQ(Read("a,b\n" + longest + ",1\n\"" + longest + "\",2\n"),
            "[a][b] @2[" + longest + "][1] @3[" + longest + "][2]");
  EXPECT_EQ(Read(longest + ",b\n1,2\n"), "[" + longest + "][b] @2[1][2]");
}

TEST(TableReader, RefusesCellsAndHeadersWithoutEnd) {
  const std::string endless(18'000'000, 'x');
  EXPECT_EQ(Read("a,b\n1,\"" + endless),
            "t.csv:2: column b: this cell has more than 16 MB; is its closing quotation mark missing?");
  EXPECT_EQ(
      Read("\"" + endless),
      "t.csv:1: the header line has no end within 16 MB; is this a text table, and does every quotation mark "
      "have its closing one?");
}

TEST(TableReader, CutsBlocksAnywhere) {
  // Rows of 9 to 15 bytes, with quotation marks, line ends in them and CR LF, so that all of it meets the
  // ends of blocks.
  std::string content = "a,b\r\n";
  std::uint64_t rows = 0;
  while (content.size() < 2'000'000)
    content += "\"" + std::to_string(rows++) + "\",\"\"\"\n\"\r\n";
  const TempFolder folder;
  InputFile input(folder.Write("t.csv", content));
  TableReader reader(input, 0);
  ASSERT_EQ(reader.GetHeader().size(), 2u);
  std::uint64_t seen = 0;
  reader.ReadRows({0, 1}, [&](const TableRow& row) {
    EXPECT_EQ(row.GetCell(0), std::to_string(seen));
    EXPECT_EQ(row.GetCell(1), "\"\n");
    EXPECT_EQ(row.GetLine(), 2 * seen + 2);
    ++seen;
    return !testing::Test::HasFailure();
  });
  EXPECT_EQ(seen, rows);
}

TEST(TableReader, LeavesOutColumnsThatNobodyAskedFor) {
  const TempFolder folder;
  InputFile input(folder.Write("t.csv", "a,b,c\n1,2,3\n"));
  TableReader reader(input, 0);
  reader.GetHeader();
  reader.ReadRows({2}, [](const TableRow& row) {
    EXPECT_EQ(row.GetCell(0), "");
    EXPECT_EQ(row.GetCell(2), "3");
    EXPECT_EQ(row.GetCellCount(), 3u);
    return true;
  });
}

TEST(TableReader, StopsWhenToldAndPassesWhatIsThrown) {
  const TempFolder folder;
  const std::string path = folder.Write("t.csv", "a\n1\n2\n3\n");
  int seen = 0;
  InputFile input(path);
  TableReader reader(input, 0);
  reader.GetHeader();
  reader.ReadRows({0}, [&](const TableRow&) { return ++seen < 2; });
  EXPECT_EQ(seen, 2);

  InputFile again(path);
  TableReader thrower(again, 0);
  thrower.GetHeader();
  EXPECT_THROW(thrower.ReadRows({0}, [](const TableRow&) -> bool { throw 17; }), int);
}

TEST(InputFile, SaysWhatCannotBeOpened) {
  const TempFolder folder;
  const auto fault_of = [](const std::string& path) {
    try {
      InputFile input(path);
    } catch (const ProgramError& fault) {
      EXPECT_EQ(fault.GetCode(), kInputOutput);
      return fault.GetText();
    }
    return "none"s;
  };
  const std::string absent = folder.PathOf("absent");
  EXPECT_EQ(fault_of(absent), absent + ": cannot be opened: No such file or directory");
  const std::string itself = folder.GetPath().u8string();
  EXPECT_EQ(fault_of(itself), itself + ": this is a folder; a file is expected");
}

}  // namespace
}  // namespace kestrel_tests
