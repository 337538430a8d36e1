#include "apps/kestrel/TableWriter.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

namespace kestrel_tests {
namespace {

using kestrel_program::AppendNumber;
using kestrel_program::TableWriter;

struct TextRow {
  const char* why;
  std::string text;
  const char* csv;
  const char* json;
};

const TextRow kTexts[] = {
    {"plain", "setosa", "setosa", "\"setosa\""},
    {"blank inside", "a b", "a b", "\"a b\""},
    {"blank in front", " a", "\" a\"", "\" a\""},
    {"blank behind", "a ", "\"a \"", "\"a \""},
    {"tab in front", "\ta", "\"\ta\"", "\"\\ta\""},
    {"comma", "a,b", "\"a,b\"", "\"a,b\""},
    {"semicolon", "a;b", "a;b", "\"a;b\""},
    {"quotation mark", "5\" pipe", "\"5\"\" pipe\"", "\"5\\\" pipe\""},
    {"line feed", "a\nb", "\"a\nb\"", "\"a\\nb\""},
    {"carriage return", "a\rb", "\"a\rb\"", "\"a\\rb\""},
    {"backslash", "a\\b", "a\\b", "\"a\\\\b\""},
    {"control character", "a\x01", "a\x01", "\"a\\u0001\""},
    {"beyond ASCII", "\xC3\xA4", "\xC3\xA4", "\"\xC3\xA4\""},
    {"not UTF-8", "a\xFF", "a\xFF", "\"a\xEF\xBF\xBD\""},
};

TEST(TableWriter, WritesTexts) {
  for (const TextRow& row : kTexts) {
    std::string csv, json;
    const auto csv_writer = TableWriter::Make(TableWriter::Format::kCsv, {"t", "u"}, csv);
    csv_writer->AddText(row.text);
    EXPECT_EQ(csv, row.csv) << row.why;
    const auto json_writer = TableWriter::Make(TableWriter::Format::kJsonLines, {"t"}, json);
    json_writer->AddText(row.text);
    json_writer->EndRow();
    EXPECT_EQ(json, "{\"t\":" + std::string(row.json) + "}\n") << row.why;
  }
}

struct NumberRow {
  double number;
  const char* csv;
  const char* json;
};

const NumberRow kNumbers[] = {
    {0.0, "0", "0"},
    {-0.0, "-0", "-0"},
    {1.0, "1", "1"},
    {0.1, "0.1", "0.1"},
    {1.0 / 3.0, "0.3333333333333333", "0.3333333333333333"},
    {-1.5e300, "-1.5e+300", "-1.5e+300"},
    {5e-324, "5e-324", "5e-324"},
    {-1.2345678901234567e-308, "-1.2345678901234567e-308", "-1.2345678901234567e-308"},
    {1e21, "1e+21", "1e+21"},
    {std::numeric_limits<double>::infinity(), "inf", "null"},
    {-std::numeric_limits<double>::infinity(), "-inf", "null"},
    {std::nan(""), "nan", "null"},
};

TEST(TableWriter, WritesNumbersInTheirShortestForm) {
  for (const NumberRow& row : kNumbers) {
    std::string csv, json;
    TableWriter::Make(TableWriter::Format::kCsv, {"t"}, csv)->AddNumber(row.number);
    EXPECT_EQ(csv, row.csv);
    const auto writer = TableWriter::Make(TableWriter::Format::kJsonLines, {"t"}, json);
    writer->AddNumber(row.number);
    EXPECT_EQ(json, "{\"t\":" + std::string(row.json));
  }
}

void WriteTwoRows(TableWriter& writer) {
  writer.BeginTable();
  writer.AddText("x");
  writer.AddNumber(1.5);
  writer.AddMissing();
  writer.EndRow();
  writer.AddMissing();
  writer.AddMissing();
  writer.AddText("y");
  writer.EndRow();
}

TEST(TableWriter, WritesRowsAsCsv) {
  std::string out;
  WriteTwoRows(*TableWriter::Make(TableWriter::Format::kCsv, {"a", "b,c", "d"}, out));
  EXPECT_EQ(out, "a,\"b,c\",d\nx,1.5,\n,,y\n");
}

TEST(TableWriter, WritesRowsAsJsonLines) {
  std::string out;
  WriteTwoRows(*TableWriter::Make(TableWriter::Format::kJsonLines, {"a", "b\"c", "d"}, out));
  EXPECT_EQ(out,
            "{\"a\":\"x\",\"b\\\"c\":1.5,\"d\":null}\n"
            "{\"a\":null,\"b\\\"c\":null,\"d\":\"y\"}\n");
}

struct ListRow {
  const char* why;
  std::vector<std::string_view> texts;
  const char* csv;
  const char* json;
};

const ListRow kLists[] = {
    {"none", {}, "", "[]"},
    {"one", {"n1"}, "n1", "[\"n1\"]"},
    {"several", {"n1", "n2", "n3"}, "n1 > n2 > n3", "[\"n1\",\"n2\",\"n3\"]"},
    {"one empty", {""}, "", "[\"\"]"},
    {"empty between", {"a", "", "b"}, "a >  > b", "[\"a\",\"\",\"b\"]"},
    {"empty at the ends need quotation marks", {"", ""}, "\" > \"", "[\"\",\"\"]"},
    {"one has a comma", {"a", "b,c"}, "\"a > b,c\"", "[\"a\",\"b,c\"]"},
    {"quotation mark", {"5\" pipe", "b"}, "\"5\"\" pipe > b\"", "[\"5\\\" pipe\",\"b\"]"},
    {"line end", {"a\nb", "c"}, "\"a\nb > c\"", "[\"a\\nb\",\"c\"]"},
    {"what stands between texts in one", {"a > b", "c"}, "a > b > c", "[\"a > b\",\"c\"]"},
    {"not UTF-8", {"a\xFF"}, "a\xFF", "[\"a\xEF\xBF\xBD\"]"},
};

TEST(TableWriter, WritesLists) {
  for (const ListRow& row : kLists) {
    std::string csv, json;
    const auto csv_writer = TableWriter::Make(TableWriter::Format::kCsv, {"t", "u"}, csv);
    csv_writer->AddList(row.texts);
    csv_writer->AddList(row.texts);
    csv_writer->EndRow();
    EXPECT_EQ(csv, std::string(row.csv) + "," + row.csv + "\n") << row.why;
    const auto json_writer = TableWriter::Make(TableWriter::Format::kJsonLines, {"t", "u"}, json);
    json_writer->AddList(row.texts);
    json_writer->AddList(row.texts);
    json_writer->EndRow();
    EXPECT_EQ(json, "{\"t\":" + std::string(row.json) + ",\"u\":" + row.json + "}\n") << row.why;
  }
}

TEST(TableWriter, KeepsAMissingCellOfOneColumnFromBeingABlankLine) {
  std::string out;
  const auto writer = TableWriter::Make(TableWriter::Format::kCsv, {"a"}, out);
  writer->BeginTable();
  writer->AddMissing();
  writer->EndRow();
  writer->AddText("");
  writer->EndRow();
  EXPECT_EQ(out, "a\n\"\"\n\"\"\n");
}

TEST(NumberTexts, AreThoseOfAppendNumberHoweverOftenAsked) {
  kestrel_program::NumberTexts texts;
  for (int round = 0; round < 2; ++round) {
    for (int i = 0; i < 5000; ++i) {
      const double number = i == 0 ? -0.0 : (i - 1) / 7.0;
      std::string want;
      AppendNumber(number, want);
      EXPECT_EQ(texts.Get(number), want);
      EXPECT_EQ(texts.Get(number), want);
    }
  }
}

TEST(AppendNumber, AppendsBehindWhatIsThere) {
  std::string text = "x=";
  AppendNumber(2.5, text);
  EXPECT_EQ(text, "x=2.5");
}

}  // namespace
}  // namespace kestrel_tests
