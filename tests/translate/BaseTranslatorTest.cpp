#include "kestrel/translate/BaseTranslator.h"

#include <gtest/gtest.h>

#include <clocale>
#include <limits>
#include <locale>
#include <memory>
#include <sstream>
#include <string>
#include <xercesc/dom/DOM.hpp>
#include <xercesc/util/XMLString.hpp>

#include "kestrel/dictionary/DictVar.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/PliantTranscoder.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/translate/ParserPlatform.h"
#include "kestrel/translate/XmlText.h"
#include "tests/support/ExpectFault.h"
#include "tests/support/ReadText.h"

namespace {

using kestrel_tests::ExpectFault;
using kestrel_tests::ReadText;
using namespace MCKestrel_800;

class PlainTranslator : public BaseTranslator {
 public:
  using BaseTranslator::ParseFromTree;
  ScoreModel* ParseFromTree(xercesc::DOMElement*, const std::string&) override { return nullptr; }
};

// A copy that XMLString::release takes.
XMLCh* Copied(const char16_t* text) {
  return xercesc::XMLString::replicate(ToXMLCh(text));
}

std::u16string Wide(const std::string& text) {
  return std::u16string(text.begin(), text.end());
}

TEST(BaseTranslator, TrimsBlanksInItsOwnWay) {
  const struct {
    const char* text;
    const char* trimmed;
    const char* why;
  } rows[] = {
      {"", "", "empty"},
      {"   ", "   ", "blanks alone stay"},
      {"ab", "ab", "nothing to trim"},
      {"ab  ", "ab", "trailing blanks go when none lead"},
      {"  ab", "ab", "leading blanks go"},
      {"  ab  ", "ab  ", "as many trailing blanks stay as led"},
      {" ab   ", "ab ", "but no more"},
      {"   ab ", "ab ", "nor more than there are"},
      {"a b", "a b", "inner blanks stay"},
      {"\tab\n", "\tab\n", "tabs and line ends are no blanks"},
  };
  for (const auto& row : rows)
    EXPECT_EQ(BaseTranslator::TrimBlanks(row.text), row.trimmed) << row.why;
}

TEST(BaseTranslator, VerifiesIntegers) {
  const struct {
    const char* text;
    int value;
  } rows[] = {{"0", 0},
              {"12", 12},
              {"-12", -12},
              {"+12", 12},
              {"007", 7},
              {"-0", 0},
              {"2147483647", 2147483647},
              {"2147483648", std::numeric_limits<int>::max()},
              {"-2147483648", std::numeric_limits<int>::min()},
              {"-2147483649", std::numeric_limits<int>::min()},
              {"99999999999999999999999999", std::numeric_limits<int>::max()},
              {"-99999999999999999999999999", std::numeric_limits<int>::min()}};
  for (const auto& row : rows) {
    EXPECT_EQ(BaseTranslator::VerifyInt(std::string(row.text)), row.value) << row.text;
    EXPECT_EQ(BaseTranslator::VerifyInt(ToXMLCh(Wide(row.text).c_str())), row.value) << row.text;
  }
}

TEST(BaseTranslator, RefusesWhatIsNoInteger) {
  for (const std::string text : {"", "-", "+", "1-", "+-1", "-+1", "1+2", "--1", "++1", " 12", "12 ", "1.0",
                                 "1e2", "x", "0x10", "1,000"}) {
    const std::string message = text + "Invalid integer string -- ";
    ExpectFault([&] { BaseTranslator::VerifyInt(text); }, 3, message, text);
    ExpectFault([&] { BaseTranslator::VerifyInt(ToXMLCh(Wide(text).c_str())); }, 3, message, text);
  }
  ExpectFault([] { BaseTranslator::VerifyInt(static_cast<const XMLCh*>(nullptr)); }, 3,
              "Invalid integer string -- ");
  ExpectFault([] { BaseTranslator::VerifyInt(ToXMLCh(u"\u0661")); }, 3, "\xD9\xA1Invalid integer string -- ",
              "digits of other scripts");
  ExpectFault([] { BaseTranslator::VerifyInt(std::string("1\0", 2)); }, 3,
              std::string("1\0", 2) + "Invalid integer string -- ", "a zero byte inside");
}

TEST(BaseTranslator, VerifiesNumbers) {
  const double infinity = std::numeric_limits<double>::infinity();
  const struct {
    const char* text;
    double value;
  } rows[] = {{"0", 0.0},
              {"12", 12.0},
              {"-1.5", -1.5},
              {"+1.5", 1.5},
              {".5", 0.5},
              {"-.5", -0.5},
              {" 1.5e-3", 0.0015},
              {"   1.5", 1.5},
              {"1.5   ", 1.5},
              {"1E5", 1e5},
              {"1e+5", 1e5},
              {"-1.25E-2", -0.0125},
              {"0.1", 0.1},
              {"123456789.123456789", 123456789.123456789},
              {"1e999", infinity},
              {"-1e999", -infinity},
              {"1e-999", 0.0},
              {"4.9406564584124654e-324", 4.9406564584124654e-324},
              {"1.7976931348623157e308", 1.7976931348623157e308},
              // A sign and an exponent with nothing between keep every rule, and read as nothing.
              {"-e5", 0.0}};
  for (const auto& row : rows) {
    EXPECT_EQ(BaseTranslator::VerifyDouble(std::string(row.text)), row.value) << row.text;
    EXPECT_EQ(BaseTranslator::VerifyDouble(ToXMLCh(Wide(row.text).c_str())), row.value) << row.text;
  }
  const std::string longText = "0." + std::string(500, '0') + "1e501";
  EXPECT_EQ(BaseTranslator::VerifyDouble(longText), 1.0);
  EXPECT_EQ(BaseTranslator::VerifyDouble(ToXMLCh(Wide(longText).c_str())), 1.0);
}

// " 1.5 " is among them: with a blank in front the one behind is not trimmed, and it is no digit.
TEST(BaseTranslator, RefusesWhatIsNoNumber) {
  for (const std::string text :
       {"",      " ",    "   ",  "1.e5", "e5",  "1e",    "1,5",   "1e5e5", "1e5E5", "1E5e5",
        "E5",    "1E",   "-",    "+",    "1-",  "1+",    "--1",   "+-1",   "-+1",   "1e--5",
        "1e+-5", "1e5-", "1-e5", "1.",   ".",   "-.",    "1.2.3", "1e1.5", "1e.5",  " 1.5 ",
        "\t1",   "1\n",  "inf",  "nan",  "NaN", "0x1p3", "1d5",   "1 2",   "1.5f"}) {
    const std::string message = text + "Invalid double string -- ";
    ExpectFault([&] { BaseTranslator::VerifyDouble(text); }, 3, message, text);
    ExpectFault([&] { BaseTranslator::VerifyDouble(ToXMLCh(Wide(text).c_str())); }, 3, message, text);
  }
  ExpectFault([] { BaseTranslator::VerifyDouble(static_cast<const XMLCh*>(nullptr)); }, 3,
              "Invalid double string -- ");
  ExpectFault([] { BaseTranslator::VerifyDouble(ToXMLCh(u"\u00BD")); }, 3,
              "\xC2\xBDInvalid double string -- ");
}

class CommaPoint : public std::numpunct<char> {
 protected:
  char do_decimal_point() const override { return ','; }
};

TEST(BaseTranslator, NumbersDoNotDependOnTheLocale) {
  const std::string before = std::setlocale(LC_ALL, nullptr);
  const std::locale previous = std::locale::global(std::locale(std::locale::classic(), new CommaPoint));
  std::setlocale(LC_ALL, "de_DE.UTF-8");  // where there is one
  EXPECT_EQ(BaseTranslator::VerifyDouble(std::string("1.5")), 1.5);
  EXPECT_EQ(BaseTranslator::VerifyDouble(ToXMLCh(u"1.5")), 1.5);
  EXPECT_THROW(BaseTranslator::VerifyDouble(std::string("1,5")), KestrelException);
  std::locale::global(previous);
  std::setlocale(LC_ALL, before.c_str());
}

TEST(BaseTranslator, VerifiesDateTimes) {
  EXPECT_EQ(BaseTranslator::VerifyDateTime(std::string("1970-01-02"), DateTimeType::kDate), 86400.0);
  EXPECT_EQ(BaseTranslator::VerifyDateTime(ToXMLCh(u"1970-01-02"), DateTimeType::kDate), 86400.0);
  ExpectFault([] { BaseTranslator::VerifyDateTime(std::string("1970-13-01"), DateTimeType::kDate); }, 3,
              "1970-13-01 Invalid date time string -- ");
  ExpectFault([] { BaseTranslator::VerifyDateTime(ToXMLCh(u"x"), DateTimeType::kDate); }, 3,
              "x Invalid date time string -- ");
}

TEST(BaseTranslator, MakesValuesOfAVariablesType) {
  DictVar number("n", ScoreDictVar::kNUMERIC_VAR), text("t", ScoreDictVar::STRING_VAR),
      date("d", ScoreDictVar::kDATETIME_VAR), other("o", static_cast<ScoreDictVar::VariableType>(2));
  date.SetDateTimeType(DateTimeType::kDateDaysSince1970);
  std::unique_ptr<ScoreValue> value(BaseTranslator::CarefullyMakeVarValue(&number, std::string("1.5")));
  ASSERT_NE(dynamic_cast<NumericValue*>(value.get()), nullptr);
  EXPECT_EQ(value->GetDouble(), 1.5);
  value.reset(BaseTranslator::CarefullyMakeVarValue(&number, ToXMLCh(u"2.5")));
  EXPECT_EQ(value->GetDouble(), 2.5);
  value.reset(BaseTranslator::CarefullyMakeVarValue(&text, ToXMLCh(u"1.5\u00E4")));
  ASSERT_NE(dynamic_cast<StringValue*>(value.get()), nullptr);
  EXPECT_EQ(value->GetString(), "1.5\xC3\xA4");
  value.reset(BaseTranslator::CarefullyMakeVarValue(&date, std::string("2")));
  ASSERT_NE(dynamic_cast<DateTimeValue*>(value.get()), nullptr);
  EXPECT_EQ(value->GetDouble(), 2 * 86400.0);
  EXPECT_EQ(BaseTranslator::CarefullyMakeVarValue(&other, std::string("1")), nullptr);
  EXPECT_EQ(BaseTranslator::CarefullyMakeVarValue(nullptr, std::string("1")), nullptr);
  EXPECT_EQ(BaseTranslator::CarefullyMakeVarValue(nullptr, ToXMLCh(u"1")), nullptr);
  ExpectFault([&] { BaseTranslator::CarefullyMakeVarValue(&number, std::string("x")); }, 3,
              "xInvalid double string -- ");
  ExpectFault([&] { BaseTranslator::CarefullyMakeVarValue(&date, ToXMLCh(u"1970-01-01")); }, 3,
              "1970-01-01Invalid double string -- ");
}

class BaseTranslatorTreeTest : public testing::Test {
 protected:
  BaseTranslatorTreeTest()
      : document_(ReadText("<a x='1' y=''>text<!-- c --><b n='1'/>text<c><b n='2'/></c><b n='3'/></a>")),
        root_(document_->GetRoot()) {}
  static std::string NumberOf(const xercesc::DOMNode* node) {
    return node == nullptr ? "null" : AttributeText(static_cast<const xercesc::DOMElement*>(node), u"n");
  }
  std::unique_ptr<ParsedDocument> document_;
  xercesc::DOMElement* root_;
};

TEST_F(BaseTranslatorTreeTest, WalksElements) {
  xercesc::DOMNode* const first = BaseTranslator::GetFirstChildElt(root_);
  EXPECT_EQ(NumberOf(first), "1");
  EXPECT_TRUE(ElementIs(BaseTranslator::GetNextSiblingElt(first), u"c"));
  EXPECT_EQ(BaseTranslator::GetFirstChildElt(first), nullptr);
  EXPECT_EQ(BaseTranslator::GetFirstChildElt(nullptr), nullptr);
  EXPECT_EQ(BaseTranslator::GetNextSiblingElt(nullptr), nullptr);
  EXPECT_EQ(BaseTranslator::GetNextSiblingElt(root_), nullptr);
}

TEST_F(BaseTranslatorTreeTest, FindsChildrenByTag) {
  EXPECT_EQ(NumberOf(BaseTranslator::GetChildByTag(root_, "b")), "1");
  EXPECT_TRUE(ElementIs(BaseTranslator::GetChildByTag(root_, "c"), u"c"));
  EXPECT_EQ(BaseTranslator::GetChildByTag(root_, "B"), nullptr);
  EXPECT_EQ(BaseTranslator::GetChildByTag(nullptr, "b"), nullptr);
  EXPECT_EQ(NumberOf(BaseTranslator::GetChildTag(root_, Copied(u"b"))), "1");
  EXPECT_EQ(BaseTranslator::GetChildTag(root_, Copied(u"z")), nullptr);
  EXPECT_EQ(BaseTranslator::GetChildTag(nullptr, Copied(u"b")), nullptr);
  EXPECT_EQ(NumberOf(BaseTranslator::GetChildByTagForced(root_, "b")), "1");
  EXPECT_EQ(NumberOf(BaseTranslator::GetChildTagForced(root_, Copied(u"b"))), "1");
  ExpectFault([&] { BaseTranslator::GetChildByTagForced(root_, "z"); }, 4, "Node is missing --- z ---");
  ExpectFault([&] { BaseTranslator::GetChildByTagForced(nullptr, "z"); }, 4, "Node is missing --- z ---");
  ExpectFault([&] { BaseTranslator::GetChildTagForced(root_, Copied(u"z")); }, 4, "zNode is missing --- ");
}

TEST_F(BaseTranslatorTreeTest, ListsDescendants) {
  EXPECT_EQ(BaseTranslator::GetElementsByTagName(document_->GetDocument(), "b")->getLength(), 3u);
  EXPECT_EQ(BaseTranslator::GetElementsByTagName(root_, "b")->getLength(), 3u);
  EXPECT_EQ(BaseTranslator::GetElementsByTagName(root_, "z")->getLength(), 0u);
  ExpectFault([] { BaseTranslator::GetElementsByTagName(static_cast<xercesc::DOMDocument*>(nullptr), "b"); },
              4, "Node is missing --- b ---");
  ExpectFault([] { BaseTranslator::GetElementsByTagName(static_cast<xercesc::DOMElement*>(nullptr), "b"); },
              4, "Node is missing --- b ---");
}

TEST_F(BaseTranslatorTreeTest, GetsAttributes) {
  EXPECT_TRUE(Equals(BaseTranslator::GetAttribute(root_, "x"), u"1"));
  EXPECT_TRUE(IsEmpty(BaseTranslator::GetAttribute(root_, "z")));
  EXPECT_NE(BaseTranslator::GetAttribute(root_, "z"), nullptr);
  EXPECT_TRUE(Equals(BaseTranslator::GetAttributeForced(root_, "y"), u""));
  ExpectFault([&] { BaseTranslator::GetAttributeForced(root_, "z"); }, 4,
              "Attribute z is missing from Node \"a\"");
}

TEST(BaseTranslator, ComparesTexts) {
  EXPECT_TRUE(BaseTranslator::IsEqual(ToXMLCh(u"a\u00E4"), "a\xC3\xA4"));
  EXPECT_FALSE(BaseTranslator::IsEqual(ToXMLCh(u"a"), "b"));
  EXPECT_TRUE(BaseTranslator::IsEqual(nullptr, ToXMLCh(u"a"), "a"));
  EXPECT_TRUE(BaseTranslator::IsEqual(nullptr, ToXMLCh(u"\u00E4"), "\xC3\xA4"));
  PlainTranslator translator;
  translator.CreateTranscoder("");
  EXPECT_TRUE(BaseTranslator::IsEqual(translator.GetTranscoder(), ToXMLCh(u"\u00E4\u20AC"), "\xE4\x80"));
  EXPECT_FALSE(BaseTranslator::IsEqual(translator.GetTranscoder(), ToXMLCh(u"\u00E4"), "\xC3\xA4"));
  EXPECT_TRUE(BaseTranslator::IsEqual(translator.GetTranscoder(), nullptr, ""));
  translator.CreateTranscoder("UTF-8");
  EXPECT_TRUE(BaseTranslator::IsEqual(translator.GetTranscoder(), ToXMLCh(u"\u00E4"), "\xC3\xA4"));
}

TEST(BaseTranslator, SharesItsTranscoder) {
  PlainTranslator first;
  EXPECT_EQ(first.GetTranscoder(), nullptr);
  first.CreateTranscoder("ISO-8859-1");
  MCXML_800::PliantTranscoder* const transcoder = first.GetTranscoder();
  ASSERT_NE(transcoder, nullptr);
  PlainTranslator second;
  second.CreateTranscoder("");
  second = first;
  EXPECT_EQ(second.GetTranscoder(), transcoder);
  {
    PlainTranslator third(second);
    EXPECT_EQ(third.GetTranscoder(), transcoder);
  }
  PlainTranslator& alias = second;
  second = alias;
  first.CreateTranscoder("");
  EXPECT_TRUE(BaseTranslator::IsEqual(second.GetTranscoder(), ToXMLCh(u"\u00E4"), "\xE4"));
}

TEST(BaseTranslator, RefusesEncodingsThatItCannotConvert) {
  PlainTranslator translator;
  for (const std::string encoding : {"none-such", " ", "ISO-2022-JP", "UTF-8;x"}) {
    ExpectFault([&] { translator.CreateTranscoder(encoding); }, 5, encoding + ": Not supported!");
    EXPECT_EQ(translator.GetTranscoder(), nullptr) << encoding;
  }
  translator.CreateTranscoder("ISO-8859-1");
  MCXML_800::PliantTranscoder* const transcoder = translator.GetTranscoder();
  EXPECT_THROW(translator.CreateTranscoder("none-such"), KestrelException);
  EXPECT_EQ(translator.GetTranscoder(), transcoder) << "the one before stays";
}

TEST(BaseTranslator, OffersNoFormByItself) {
  PlainTranslator translator;
  std::istringstream in("<a/>");
  EXPECT_EQ(translator.ParseFromTree(nullptr, static_cast<xercesc::DOMElement*>(nullptr), ""), nullptr);
  EXPECT_EQ(translator.ParseFromTree(nullptr, static_cast<ScoreDictionary*>(nullptr), nullptr, ""), nullptr);
  EXPECT_EQ(translator.ParseFromTree(std::string("model.xml"), std::string()), nullptr);
  EXPECT_EQ(translator.ParseFromTree(in, std::string()), nullptr);
  EXPECT_EQ(translator.ParseFromTree(in, std::string(), std::string()), nullptr);
}

}  // namespace
