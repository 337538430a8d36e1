// The text of an `Array`, element by element, and the arrays of numbers.

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "kestrel/foundation/KestrelException.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "tests/support/DictionaryText.h"
#include "tests/support/ExpectFault.h"

namespace {

using kestrel_test::ReadTree;
using kestrel_tests::ExpectFault;
using namespace MCKestrel_800;
using Texts = std::vector<std::string>;

struct TextRow {
  const char* why;
  const char* array;
  Texts elements;
};

const TextRow kTexts[] = {
    {"one element", "<Array>a</Array>", {"a"}},
    {"blanks part elements", "<Array>a b c</Array>", {"a", "b", "c"}},
    {"any number of blanks", "<Array>  a   b  </Array>", {"a", "b"}},
    {"the end ends the last element", "<Array>ab cd</Array>", {"ab", "cd"}},
    {"a line feed parts nothing", "<Array>ab\ncd ef</Array>", {"abcd", "ef"}},
    {"a line feed beside a blank", "<Array>ab \ncd\n ef\n</Array>", {"ab", "cd", "ef"}},
    {"line ends of other systems", "<Array>ab\r\ncd \r\nef</Array>", {"abcd", "ef"}},
    {"other white space is part of an element", "<Array>a\tb</Array>", {"a\tb"}},
    {"quotes hold blanks", "<Array type='string'>\"a b\" x</Array>", {"a b", "x"}},
    {"quotes hold nothing", "<Array>\"\" x \"\"</Array>", {"", "x", ""}},
    {"blanks alone", "<Array>\"  \"</Array>", {"  "}},
    {"quotes hold line feeds", "<Array>\"a\nb\"</Array>", {"a\nb"}},
    {"quotes part elements", "<Array>a\"b\"c\"d e\"</Array>", {"a", "b", "c", "d e"}},
    {"quotes next to each other", "<Array>\"a\"\"b\"</Array>", {"a", "b"}},
    {"a quote inside quotes", "<Array>\"a \\\" b\" c</Array>", {"a \\\" b", "c"}},
    {"a backslash inside quotes", "<Array>\"a\\b\" c</Array>", {"a\\b", "c"}},
    {"a backslash is escaped by nothing", "<Array>\"a\\\\\" b\"</Array>", {"a\\\\\" b"}},
    {"quotes that end with the text", "<Array>a \"b c</Array>", {"a", "b c"}},
    {"one quote at the end", "<Array>a \"</Array>", {"a", ""}},
    {"an escaped quote outside of quotes", "<Array>a\\\"b c</Array>", {"ab", "c"}},
    {"a backslash outside of quotes", "<Array>a\\b \\</Array>", {"a\\b", "\\"}},
    {"entities and character references",
     "<Array>a&amp;b &#65;&#32;c &quot;d e&quot;</Array>",
     {"a&b", "A", "c", "d e"}},
    {"comments and CDATA sections cut nothing",
     "<Array>a<!-- b -->c <![CDATA[d<e]]>f</Array>",
     {"ac", "d<ef"}},
    {"characters of all planes",
     "<Array>\xC3\xA4 \xF0\x9F\xA6\x85 \"\xE2\x82\xAC 5\"</Array>",
     {"\xC3\xA4", "\xF0\x9F\xA6\x85", "\xE2\x82\xAC 5"}},
    {"the declared number", "<Array n='2'>a b</Array>", {"a", "b"}},
    {"an element of nothing counts", "<Array n='1'>\"\"</Array>", {""}},
    {"whole numbers as written", "<Array type='int'>1 -2 +3 007</Array>", {"1", "-2", "+3", "007"}},
    {"numbers as written", "<Array type='real'>1 -2.5e3 .5</Array>", {"1", "-2.5e3", ".5"}},
    {"quoted numbers", "<Array type='real'>\"1\" \"2\"</Array>", {"1", "2"}},
    {"any other type is text", "<Array type='Int'>1 x</Array>", {"1", "x"}},
};

TEST(ArrayReader, SplitsTheText) {
  for (const TextRow& row : kTexts) {
    const auto tree = ReadTree(row.array);
    EXPECT_EQ(PMMLTranslator::GetArrayElements(tree->GetRoot()), row.elements) << row.why;
  }
}

struct FaultRow {
  const char* why;
  const char* array;
  int code;
  const char* text;
};

constexpr FaultRow kTextFaults[] = {
    {"nothing", "<Array/>", 4, "No Elements found in array!"},
    {"blanks and line feeds", "<Array type='string'> \n </Array>", 4, "No Elements found in array!"},
    {"escaped quotes alone", "<Array>\\\"\\\"</Array>", 4, "No Elements found in array!"},
    {"nothing declared and nothing there", "<Array n='0'/>", 4, "No Elements found in array!"},
    {"something declared and nothing there", "<Array n='3'/>", 12,
     "Number of Elements doesn't match with array size!"},
    {"fewer than declared", "<Array n='3' type='string'>\"a b\" x</Array>", 12,
     "Number of Elements doesn't match with array size!"},
    {"more than declared", "<Array n='1'>a b</Array>", 12,
     "Number of Elements doesn't match with array size!"},
    {"a negative number declared", "<Array n='-1'>a</Array>", 12,
     "Number of Elements doesn't match with array size!"},
    {"far more declared than there can be", "<Array n='99999999999999999999'>a</Array>", 12,
     "Number of Elements doesn't match with array size!"},
    {"no number declared", "<Array n=''>a</Array>", 3, "Invalid integer string -- "},
    {"a fraction declared", "<Array n='1.0'>a</Array>", 3, "1.0Invalid integer string -- "},
    {"no whole number", "<Array type='int'>1 2.0</Array>", 3, "2.0Invalid integer string -- "},
    {"an empty whole number", "<Array type='int'>\"\"</Array>", 3, "Invalid integer string -- "},
    {"no number", "<Array type='real'>1 2,5</Array>", 3, "2,5Invalid double string -- "},
    {"not a number", "<Array type='real'>NaN</Array>", 3, "NaNInvalid double string -- "},
    {"a tab is part of a number", "<Array type='real'>1\t2</Array>", 3, "1\t2Invalid double string -- "},
};

TEST(ArrayReader, RefusesWhatIsNoArray) {
  for (const FaultRow& row : kTextFaults) {
    const auto tree = ReadTree(std::string("<?xml version='1.0'?>\n") + row.array);
    ExpectFault([&] { PMMLTranslator::GetArrayElements(tree->GetRoot()); }, row.code, row.text, row.why);
    try {
      PMMLTranslator::GetArrayElements(tree->GetRoot());
    } catch (const KestrelException& fault) {
      EXPECT_GE(fault.GetLine(), 2u) << row.why;
    }
  }
}

TEST(ArrayReader, FindsTheFirstArrayOfAnElement) {
  const auto tree = ReadTree("<a><b><Array>0</Array></b><Array>1</Array><Array>2</Array></a>");
  EXPECT_EQ(PMMLTranslator::GetArrayElements(PMMLTranslator::GetArrayNode(tree->GetRoot())), Texts{"1"});
  const auto other = ReadTree("<a><b><Array>0</Array></b><array>1</array></a>");
  ExpectFault([&] { PMMLTranslator::GetArrayNode(other->GetRoot()); }, 4, "Array Node is required!!!");
  ExpectFault([&] { PMMLTranslator::GetArrayNode(nullptr); }, 4, "Array Node is required!!!");
}

TEST(ArrayReader, ReadsNumbers) {
  const struct {
    const char* array;
    std::vector<double> numbers;
  } rows[] = {
      {"<Array n='3' type='real'>1 -2.5e1\n .5</Array>", {1, -25, 0.5}},
      {"<Array type='int'>1 2</Array>", {1, 2}},
      {"<Array type='string'>1 \"2.5\"</Array>", {1, 2.5}},
      {"<x-BasisRow>1 2</x-BasisRow>", {1, 2}},
      {"<X-BasisRow n='1'>7</X-BasisRow>", {7}},
      {"<Array><Extension/>1</Array>", {1}},
  };
  for (const auto& row : rows) {
    EXPECT_EQ(PMMLTranslator::VerifyDoubleArray(ReadTree(row.array)->GetRoot()), row.numbers) << row.array;
  }
  EXPECT_EQ(PMMLTranslator::VerifyIntArray(ReadTree("<Array n='3'>1 -2 +3</Array>")->GetRoot()),
            (std::vector<int>{1, -2, 3}));
  EXPECT_EQ(PMMLTranslator::VerifyIntArray(ReadTree("<X-BasisRow>4 5</X-BasisRow>")->GetRoot()),
            (std::vector<int>{4, 5}));
}

struct NumberFaultRow {
  const char* why;
  const char* array;
  int code;
  const char* ofDouble;
  const char* ofInt;
};

constexpr NumberFaultRow kNumberFaults[] = {
    {"another element", "<Vector>1</Vector>", 4, "Invalid character -- should be array!",
     "Invalid character -- should be array!"},
    {"nothing", "<Array> </Array>", 4, "No Elements found in double array!",
     "No Elements found in INT array!"},
    {"another number of them", "<Array n='3'>1 2</Array>", 4, "Number Does Not Match in Double array!",
     "Number Does Not Match in INT array!"},
    {"a text", "<Array>1 x</Array>", 3, "xInvalid double string -- ", "xInvalid integer string -- "},
    {"rows in an array", "<Array><Array>1</Array><Array>2</Array></Array>", 4,
     "Multi-dimensional case not supported!!", "Multi-dimensional case not supported!!"},
    {"rows of a basis", "<X-Basis><X-BasisRow>1</X-BasisRow></X-Basis>", 4,
     "Multi-dimensional case not supported!!", "Multi-dimensional case not supported!!"},
    {"rows of a basis, the other spelling", "<x-Basis><x-BasisRow>1</x-BasisRow></x-Basis>", 4,
     "Multi-dimensional case not supported!!", "Multi-dimensional case not supported!!"},
};

TEST(ArrayReader, RefusesWhatAreNoNumbers) {
  for (const NumberFaultRow& row : kNumberFaults) {
    const auto tree = ReadTree(row.array);
    ExpectFault([&] { PMMLTranslator::VerifyDoubleArray(tree->GetRoot()); }, row.code, row.ofDouble, row.why);
    ExpectFault([&] { PMMLTranslator::VerifyIntArray(tree->GetRoot()); }, row.code, row.ofInt, row.why);
  }
  ExpectFault([] { PMMLTranslator::VerifyDoubleArray(nullptr); }, 4, "No Array Element Node Found!!!");
  ExpectFault([] { PMMLTranslator::VerifyIntArray(nullptr); }, 4, "No Array Element Found!!!");
  const auto fraction = ReadTree("<Array>1.5</Array>");
  ExpectFault([&] { PMMLTranslator::VerifyIntArray(fraction->GetRoot()); }, 3,
              "1.5Invalid integer string -- ");
}

TEST(ArrayReader, ComparesOneElement) {
  const auto tree = ReadTree("<Array>1</Array>");
  EXPECT_NO_THROW(PMMLTranslator::VerifyOneElem(tree->GetRoot(), "Array"));
  ExpectFault([&] { PMMLTranslator::VerifyOneElem(tree->GetRoot(), "Matrix"); }, 4, "Doesn't match!");
  ExpectFault([] { PMMLTranslator::VerifyOneElem(nullptr, "Array"); }, 4, "Doesn't match!");
}

}  // namespace
