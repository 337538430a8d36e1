#include <gtest/gtest.h>

#include <limits>
#include <memory>

#include "kestrel/dictionary/ScoreBinningEncoder.h"
#include "kestrel/dictionary/ScoreCatNumericEncoder.h"
#include "kestrel/dictionary/ScoreCatStringEncoder.h"
#include "tests/dictionary/TestValues.h"

namespace MCKestrel_800 {
namespace {

using Texts = std::vector<std::string>;
using Numbers = std::vector<double>;

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kInfinity = std::numeric_limits<double>::infinity();

TEST(ScoreCatStringEncoder, HandsOutCodesInOrderOfAppearance) {
  ScoreCatStringEncoder encoder;
  EXPECT_EQ(encoder.GetEncoderType(), 3);
  EXPECT_EQ(encoder.GetNumberOfCategories(), 0);
  EXPECT_EQ(encoder.Encode("b"), 0);
  EXPECT_EQ(encoder.Encode("a"), 1);
  EXPECT_EQ(encoder.Encode("b"), 0);
  EXPECT_EQ(encoder.Encode("B"), 2);
  EXPECT_EQ(encoder.GetNumberOfCategories(), 3);
  EXPECT_EQ(encoder.Decode(1), "a");
  EXPECT_EQ(encoder.Decode(3), "");
  EXPECT_EQ(encoder.Decode(-1), "");
  EXPECT_EQ(encoder.DecodeNum(0), NumericValue::gSysmisValue);
}

TEST(ScoreCatStringEncoder, FormsTheKeyByItsFlags) {
  struct Row {
    bool noSpaceTrim;
    bool emptyStringOK;
    const char* text;
    const char* key;
  };
  const Row rows[] = {
      {false, true, "a  ", "a"},     {false, true, "  a ", "  a"},
      {false, true, "a\t", "a\t"},   {false, true, "", ""},
      {false, true, "   ", " "},     {false, true, " ", " "},
      {false, false, "   ", ""},     {false, false, " ", ""},
      {false, false, "", ""},        {true, true, "a  ", "a  "},
      {true, true, "   ", "   "},    {true, false, "   ", "   "},
      {false, true, "a b  ", "a b"}, {false, true, "\xC3\xA4 ", "\xC3\xA4"},
  };
  for (const Row& row : rows) {
    ScoreCatStringEncoder encoder;
    EXPECT_FALSE(encoder.GetNoSpaceTrim());
    EXPECT_TRUE(encoder.GetEmptyStringOK());
    encoder.SetNoSpaceTrim(row.noSpaceTrim);
    encoder.SetEmptyStringOK(row.emptyStringOK);
    EXPECT_EQ(encoder.GetNoSpaceTrim(), row.noSpaceTrim);
    EXPECT_EQ(encoder.GetEmptyStringOK(), row.emptyStringOK);
    EXPECT_EQ(encoder.EncodeConst(row.text), -1);
    EXPECT_EQ(encoder.Encode(row.text), 0) << "'" << row.text << "'";
    EXPECT_EQ(encoder.Decode(0), row.key) << "'" << row.text << "'";
    EXPECT_EQ(encoder.Encode(row.text), 0) << "'" << row.text << "'";
    EXPECT_EQ(encoder.EncodeConst(row.text), 0) << "'" << row.text << "'";
    EXPECT_EQ(encoder.GetNumberOfCategories(), 1);
  }
}

TEST(ScoreCatStringEncoder, ATextWhoseKeyIsKnownUsesUpNoCode) {
  ScoreCatStringEncoder encoder;
  EXPECT_EQ(encoder.Encode("a"), 0);
  EXPECT_EQ(encoder.Encode("a "), 0);
  EXPECT_EQ(encoder.GetNumberOfCategories(), 1);
  EXPECT_EQ(encoder.Encode("b  "), 1);
  EXPECT_EQ(encoder.Encode("b"), 1);
  encoder.SetNoSpaceTrim(true);
  EXPECT_EQ(encoder.EncodeConst("a  "), -1);
  EXPECT_EQ(encoder.Encode("a  "), 2);
  encoder.SetNoSpaceTrim(false);
  EXPECT_EQ(encoder.EncodeConst("a  "), 2) << "the text itself comes before its trimmed form";
  EXPECT_EQ(encoder.EncodeConst("a "), 0);
  EXPECT_EQ(encoder.EncodeConst("c"), -1);
}

TEST(ScoreCatStringEncoder, EncodesValuesByTheirText) {
  ScoreCatStringEncoder encoder;
  const StringValue text("1.5 ");
  const NumericValue number(1.5);
  EXPECT_EQ(encoder.EncodeConst(&text), -1);
  EXPECT_EQ(encoder.Encode(&number), 0);
  EXPECT_EQ(encoder.Encode(&text), 0);
  EXPECT_EQ(encoder.EncodeConst(&text), 0);
  EXPECT_EQ(encoder.EncodeConst(&number), 0);
  const ScoreValue* none = nullptr;
  EXPECT_EQ(encoder.Encode(none), -1);
  EXPECT_EQ(encoder.EncodeConst(none), -1);
  EXPECT_EQ(encoder.GetNumberOfCategories(), 1);
}

TEST(ScoreCatStringEncoder, CopiesDecodeByThemselves) {
  auto encoder = std::make_unique<ScoreCatStringEncoder>(Texts{"b", "a", "b ", "c"});
  encoder->SetValueLabel(1, "A");
  encoder->SetEmptyStringOK(false);
  const ScoreCatStringEncoder copy(*encoder);
  const std::unique_ptr<ScoreEncoder> clone(encoder->Clone());
  ScoreCatStringEncoder assigned(Texts{"x"});
  assigned = *encoder;
  const ScoreCatStringEncoder& same = assigned;
  assigned = same;
  encoder.reset();
  for (const ScoreEncoder* other : std::vector<const ScoreEncoder*>{&copy, clone.get(), &assigned}) {
    EXPECT_EQ(other->GetNumberOfCategories(), 3);
    EXPECT_EQ(other->Decode(0), "b");
    EXPECT_EQ(other->Decode(1), "a");
    EXPECT_EQ(other->Decode(2), "c");
    EXPECT_EQ(other->EncodeConst("c"), 2);
    EXPECT_EQ(*other->GetValueLabels(), (Texts{"", "A"}));
  }
  EXPECT_EQ(assigned.Encode("d"), 3);
  EXPECT_EQ(copy.EncodeConst("d"), -1);
  EXPECT_FALSE(copy.GetEmptyStringOK());
}

TEST(ScoreCatStringEncoder, DisplaysItsKeysByCode) {
  ScoreCatStringEncoder encoder;
  EXPECT_EQ(DisplayOf(encoder), "\tScoreCatStringEncoder object:  Last code = -1\n");
  // More than ten: a grouping locale would show in the codes.
  std::string text = "\tScoreCatStringEncoder object:  Last code = 10\n";
  for (int code = 0; code <= 10; ++code) {
    encoder.Encode("k" + std::to_string(code));
    text += "\t\t" + std::to_string(code) + "\t\tk" + std::to_string(code) + "\n";
  }
  EXPECT_EQ(DisplayOf(encoder), text);
  EXPECT_EQ(DisplayInForeignLocale(encoder), text);
}

TEST(ScoreCatNumericEncoder, HandsOutCodesInOrderOfAppearance) {
  ScoreCatNumericEncoder encoder;
  EXPECT_EQ(encoder.GetEncoderType(), 2);
  EXPECT_EQ(encoder.Encode(3.5), 0);
  EXPECT_EQ(encoder.Encode(1.0), 1);
  EXPECT_EQ(encoder.EncodeConst(2.0), -1);
  EXPECT_EQ(encoder.EncodeConst(3.5), 0);
  EXPECT_EQ(encoder.Encode(3.5), 0);
  EXPECT_EQ(encoder.GetNumberOfCategories(), 2);
  EXPECT_EQ(encoder.DecodeNum(1), 1.0);
  EXPECT_EQ(encoder.DecodeNum(2), NumericValue::gSysmisValue);
  EXPECT_EQ(encoder.DecodeNum(-1), NumericValue::gSysmisValue);
  EXPECT_EQ(encoder.Decode(0), "");
}

TEST(ScoreCatNumericEncoder, ComparesNumbersExactly) {
  ScoreCatNumericEncoder encoder;
  EXPECT_EQ(encoder.Encode(1.0), 0);
  EXPECT_EQ(encoder.Encode(std::nextafter(1.0, 2.0)), 1);
  EXPECT_EQ(encoder.Encode(0.0), 2);
  EXPECT_EQ(encoder.Encode(-0.0), 2);
  EXPECT_EQ(encoder.Encode(kInfinity), 3);
  EXPECT_EQ(encoder.EncodeConst(kInfinity), 3);
}

TEST(ScoreCatNumericEncoder, WhatIsNoNumberIsNoCategory) {
  ScoreCatNumericEncoder encoder(Numbers{5, kNaN, 3});
  EXPECT_EQ(encoder.GetNumberOfCategories(), 2);
  EXPECT_EQ(encoder.Encode(kNaN), -1);
  EXPECT_EQ(encoder.EncodeConst(kNaN), -1);
  const NumericValue nan(kNaN);
  EXPECT_EQ(encoder.Encode(&nan), -1);
  EXPECT_EQ(encoder.EncodeConst(&nan), -1);
  const ScoreValue* none = nullptr;
  EXPECT_EQ(encoder.Encode(none), -1);
  EXPECT_EQ(encoder.EncodeConst(none), -1);
  EXPECT_EQ(encoder.GetNumberOfCategories(), 2);
  EXPECT_EQ(encoder.EncodeConst(5.0), 0);
  EXPECT_EQ(encoder.EncodeConst(3.0), 1);
}

TEST(ScoreCatNumericEncoder, EncodesTextsAndValuesByTheirNumber) {
  ScoreCatNumericEncoder encoder;
  EXPECT_EQ(encoder.Encode(std::string("2.50")), 0);
  EXPECT_EQ(encoder.EncodeConst(std::string("2.5")), 0);
  const NumericValue number(2.5);
  const StringValue text("2.5");
  EXPECT_EQ(encoder.EncodeConst(&number), 0);
  EXPECT_EQ(encoder.EncodeConst(&text), 0);
  EXPECT_EQ(encoder.EncodeConst(std::string("abc")), -1);
  EXPECT_EQ(encoder.Encode(std::string("abc")), 1);
  EXPECT_EQ(encoder.DecodeNum(1), NumericValue::gSysmisValue);
  const NumericValue missing;
  EXPECT_EQ(encoder.EncodeConst(&missing), 1);
}

TEST(ScoreCatNumericEncoder, CopiesAreDeep) {
  auto encoder = std::make_unique<ScoreCatNumericEncoder>(Numbers{3, 1, 3});
  encoder->SetValueLabels(Texts{"three", "one"});
  const std::unique_ptr<ScoreEncoder> clone(encoder->Clone());
  ScoreCatNumericEncoder assigned(5);
  assigned = *encoder;
  encoder.reset();
  assigned.Encode(7.0);
  EXPECT_EQ(assigned.GetNumberOfCategories(), 3);
  EXPECT_EQ(clone->GetNumberOfCategories(), 2);
  EXPECT_EQ(clone->DecodeNum(0), 3);
  EXPECT_EQ(*clone->GetValueLabels(), (Texts{"three", "one"}));
}

TEST(ScoreCatNumericEncoder, DisplaysSevenNumbersToALine) {
  ScoreCatNumericEncoder encoder;
  const std::string head = "\tScoreCatNumericEncoder: Last code = ";
  EXPECT_EQ(DisplayOf(encoder), head + "-1\n\t\tNumeric values of categories: \n");
  for (const double number : {1.5, 2.0, 1234567.0, 0.1, 1e-7, 100000.0})
    encoder.Encode(number);
  const std::string six = "1.5 2 1.23457e+06 0.1 1e-07 100000 ";
  EXPECT_EQ(DisplayOf(encoder), head + "5\n\t\tNumeric values of categories: " + six + "\n");
  encoder.Encode(7.0);
  EXPECT_EQ(DisplayOf(encoder), head + "6\n\t\tNumeric values of categories: " + six + "7 \n\n");
  encoder.Encode(8.0);
  EXPECT_EQ(DisplayOf(encoder), head + "7\n\t\tNumeric values of categories: " + six + "7 \n8 \n");
  EXPECT_EQ(DisplayInForeignLocale(encoder), DisplayOf(encoder));
}

TEST(ScoreBinningEncoder, PutsACutPointIntoTheBinBelow) {
  const ScoreBinningEncoder encoder(Numbers{10, 20});
  EXPECT_EQ(encoder.GetEncoderType(), 1);
  EXPECT_EQ(encoder.GetNumberOfCategories(), 3);
  struct Row {
    double number;
    double bin;
  };
  for (const Row& row : {Row{5, 0}, Row{10, 0}, Row{15, 1}, Row{20, 1}, Row{25, 2}, Row{kInfinity, 2},
                         Row{-kInfinity, 0}, Row{NumericValue::gSysmisValue, 0}, Row{kNaN, 2}}) {
    EXPECT_EQ(encoder.Encode(row.number), row.bin) << row.number;
  }
}

TEST(ScoreBinningEncoder, AgreesWithAWalkForEveryNumberOfCutPoints) {
  for (int k = 0; k <= 17; ++k) {
    Numbers cutpoints;
    for (int i = 0; i < k; ++i)
      cutpoints.push_back(2 * i);
    const ScoreBinningEncoder encoder(cutpoints);
    EXPECT_EQ(encoder.GetNumberOfCategories(), k + 1);
    for (int number = -3; number <= 2 * k + 3; ++number) {
      int bin = 0;
      while (bin < k && number > cutpoints[static_cast<std::size_t>(bin)])
        ++bin;
      EXPECT_EQ(encoder.Encode(static_cast<double>(number)), bin) << k << " cut points, " << number;
    }
  }
}

TEST(ScoreBinningEncoder, EncodesValuesAndTexts) {
  ScoreBinningEncoder encoder(Numbers{10, 20});
  const NumericValue number(15);
  const NumericValue missing;
  const NumericValue nan(kNaN);
  const ScoreValue* none = nullptr;
  const std::vector<std::pair<const ScoreValue*, int>> values = {
      {&number, 1}, {&missing, -1}, {&nan, -1}, {none, -1}};
  for (const auto& [value, bin] : values) {
    EXPECT_EQ(encoder.Encode(value), bin);
    EXPECT_EQ(encoder.EncodeConst(value), bin);
  }
  const std::vector<std::pair<std::string, int>> texts = {{"25", 2}, {"abc", -1}, {"", -1}};
  for (const auto& [text, bin] : texts) {
    EXPECT_EQ(encoder.Encode(text), bin) << text;
    EXPECT_EQ(encoder.EncodeConst(text), bin) << text;
  }
  EXPECT_EQ(encoder.Decode(0), "");
  EXPECT_EQ(encoder.DecodeNum(0), NumericValue::gSysmisValue);
}

TEST(ScoreBinningEncoder, ReplacesItsCutPointsAndCopies) {
  ScoreBinningEncoder encoder;
  EXPECT_EQ(encoder.GetNumberOfCategories(), 1);
  EXPECT_EQ(encoder.Encode(5.0), 0);
  encoder.SetBinningCutpoints(Numbers{1, 2, 3});
  EXPECT_EQ(encoder.GetBinningCutpoints(), (Numbers{1, 2, 3}));
  EXPECT_EQ(encoder.GetNumberOfCategories(), 4);
  encoder.SetValueLabel(3, "high");
  const std::unique_ptr<ScoreBinningEncoder> clone(encoder.Clone());
  encoder.SetBinningCutpoints(Numbers{});
  EXPECT_EQ(clone->Encode(2.5), 2);
  EXPECT_EQ(*clone->GetValueLabels(), (Texts{"", "", "", "high"}));
}

TEST(ScoreBinningEncoder, DisplaysItsCutPoints) {
  EXPECT_EQ(DisplayOf(ScoreBinningEncoder()), "\tScoreBinningEncoder: number of bins = 1\n\t\tCutpoints: \n");
  const ScoreBinningEncoder encoder(Numbers{10, 20.5, 1234567});
  const std::string text = "\tScoreBinningEncoder: number of bins = 4\n\t\tCutpoints: 10 20.5 1.23457e+06 \n";
  EXPECT_EQ(DisplayOf(encoder), text);
  EXPECT_EQ(DisplayInForeignLocale(encoder), text);
}

TEST(ScoreEncoder, LabelsAreOptionalAndBounded) {
  ScoreCatStringEncoder texts(Texts{"a", "b"});
  ScoreCatNumericEncoder numbers(Numbers{1, 2});
  ScoreBinningEncoder bins(Numbers{1});
  for (ScoreEncoder* encoder : std::vector<ScoreEncoder*>{&texts, &numbers, &bins}) {
    ASSERT_NE(encoder->GetValueLabels(), nullptr);
    EXPECT_TRUE(encoder->GetValueLabels()->empty());
    for (const int code : {-1, 2, std::numeric_limits<int>::max(), std::numeric_limits<int>::min()}) {
      encoder->SetValueLabel(code, "x");
    }
    EXPECT_TRUE(encoder->GetValueLabels()->empty());
    encoder->SetValueLabel(1, "B");
    EXPECT_EQ(*encoder->GetValueLabels(), (Texts{"", "B"}));
    encoder->SetValueLabels(Texts{"p", "q", "r"});
    encoder->SetValueLabel(2, "R");
    EXPECT_EQ(*encoder->GetValueLabels(), (Texts{"p", "q", "R"}));
    EXPECT_EQ(encoder->GetNumberOfCategories(), 2);
  }
}

TEST(ScoreEncoder, ReservingAWildNumberIsHarmless) {
  for (const int n : {-1, 0, 10, std::numeric_limits<int>::min(), std::numeric_limits<int>::max()}) {
    EXPECT_EQ(ScoreCatStringEncoder(n).GetNumberOfCategories(), 0);
    EXPECT_EQ(ScoreCatNumericEncoder(n).GetNumberOfCategories(), 0);
  }
}

}  // namespace
}  // namespace MCKestrel_800
