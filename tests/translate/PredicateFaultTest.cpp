// Every fault that the reader of predicates reports, with its code, its whole text and its place.

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "kestrel/dictionary/BaseDictionary.h"
#include "kestrel/dictionary/DictVar.h"
#include "kestrel/foundation/KestrelException.h"
#include "kestrel/predicates/DiscreteSplit.h"
#include "tests/support/ExpectFault.h"
#include "tests/support/PredicateFields.h"
#include "tests/support/PredicateText.h"

namespace {

using kestrel_test::kPredicateFields;
using kestrel_test::ReadDictionary;
using kestrel_test::ReadPredicate;
using kestrel_test::ReadTree;
using kestrel_tests::ExpectFault;
using namespace MCKestrel_800;

struct Row {
  const char* why;
  const char* predicate;
  int code;
  const char* text;
};

constexpr char kNotListed[] = "Value list is required and split value should be in the list!";
constexpr char kEqualOfEmpty[] = "Only equal operator is allowed for null string value";

constexpr Row kRows[] = {
    // The field
    {"no field", "<SimplePredicate operator='equal' value='1'/>", 4,
     "Attribute field is missing from Node \"SimplePredicate\""},
    {"a field that is nowhere", "<SimplePredicate field='nowhere' operator='equal' value='1'/>", 8,
     "nowhere: Invalid Split Variable!"},
    {"an empty field name", "<SimplePredicate field='' operator='equal' value='1'/>", 8,
     ": Invalid Split Variable!"},
    {"names are case-sensitive", "<SimplePredicate field='Num' operator='equal' value='1'/>", 8,
     "Num: Invalid Split Variable!"},
    {"a set without field",
     "<SimpleSetPredicate booleanOperator='isIn'><Array>1</Array></SimpleSetPredicate>", 4,
     "Attribute field is missing from Node \"SimpleSetPredicate\""},
    {"a set on a field that is nowhere",
     "<SimpleSetPredicate field='nowhere' booleanOperator='isIn'><Array>1</Array></SimpleSetPredicate>", 8,
     "Variable nowhere not in the dictionary!"},
    {"the field comes before the operator", "<SimpleSetPredicate field='nowhere' booleanOperator='in'/>", 8,
     "Variable nowhere not in the dictionary!"},
    // Numbers
    {"isMissing with a value", "<SimplePredicate field='num' operator='isMissing' value='1'/>", 1,
     "No value allowed after \"isMissing\" or\"isNotMissing\""},
    {"isNotMissing with a value", "<SimplePredicate field='num' operator='isNotMissing' value='1'/>", 1,
     "No value allowed after \"isMissing\" or\"isNotMissing\""},
    {"isMissing with an empty value", "<SimplePredicate field='num' operator='isMissing' value=''/>", 1,
     "No value allowed after \"isMissing\" or\"isNotMissing\""},
    {"less than nothing", "<SimplePredicate field='num' operator='lessThan' value=''/>", 1,
     "Only \"Equal\" allowed here!!!"},
    {"not equal to an absent value", "<SimplePredicate field='num' operator='notEqual'/>", 1,
     "Only \"Equal\" allowed here!!!"},
    {"no operator and no value", "<SimplePredicate field='num'/>", 1, "Only \"Equal\" allowed here!!!"},
    {"a value that is no number", "<SimplePredicate field='num' operator='equal' value='one'/>", 3,
     "oneInvalid double string -- "},
    {"a date as text", "<SimplePredicate field='day' operator='lessThan' value='2001-02-03'/>", 3,
     "2001-02-03Invalid double string -- "},
    {"a value that is no number comes before the operator",
     "<SimplePredicate field='num' operator='is' value='one'/>", 3, "oneInvalid double string -- "},
    {"an unknown operator", "<SimplePredicate field='num' operator='is' value='1'/>", 5,
     "is: Not supported!"},
    {"operators are case-sensitive", "<SimplePredicate field='num' operator='lessthan' value='1'/>", 5,
     "lessthan: Not supported!"},
    {"no operator", "<SimplePredicate field='num' value='1'/>", 5, ": Not supported!"},
    // Categories
    {"a field without categories", "<SimplePredicate field='bare' operator='equal' value='a'/>", 4,
     "Value list is required!"},
    {"an ordinal field without categories",
     "<SimplePredicate field='bare number' operator='lessThan' value='1'/>", 4, "Value list is required!"},
    {"the list comes before the value", "<SimplePredicate field='bare' operator='isMissing' value='a'/>", 4,
     "Value list is required!"},
    {"isMissing with a value on categories",
     "<SimplePredicate field='col' operator='isMissing' value='red'/>", 1,
     "No value attribute allowed after \"isMissing\""},
    {"isNotMissing with a value on categories",
     "<SimplePredicate field='size' operator='isNotMissing' value='low'/>", 1,
     "No value attribute allowed after \"isNotMissing\""},
    {"isMissing with an empty value on categories",
     "<SimplePredicate field='col' operator='isMissing' value=''/>", 1,
     "No value attribute allowed after \"isMissing\""},
    {"not equal to the empty text", "<SimplePredicate field='col' operator='notEqual' value=''/>", 1,
     kEqualOfEmpty},
    {"not equal to an absent category", "<SimplePredicate field='nr' operator='notEqual'/>", 1,
     kEqualOfEmpty},
    {"less than the empty text", "<SimplePredicate field='size' operator='lessThan' value=''/>", 1,
     kEqualOfEmpty},
    {"an unknown operator and no value", "<SimplePredicate field='col' operator='is'/>", 1, kEqualOfEmpty},
    {"equal without a value", "<SimplePredicate field='col' operator='equal'/>", 1,
     "value attribute is required for split variable col"},
    {"equal without a value, ordinal", "<SimplePredicate field='rank' operator='equal'/>", 1,
     "value attribute is required for split variable rank"},
    {"equal to no category", "<SimplePredicate field='col' operator='equal' value='pink'/>", 1, kNotListed},
    {"case counts in categories", "<SimplePredicate field='col' operator='equal' value='Red'/>", 1,
     kNotListed},
    {"leading blanks count", "<SimplePredicate field='col' operator='equal' value=' red'/>", 1, kNotListed},
    {"trailing blanks count where they are kept",
     "<SimplePredicate field='exact' operator='equal' value='b '/>", 1, kNotListed},
    {"a missing value is no category", "<SimplePredicate field='col' operator='notEqual' value='none'/>", 1,
     kNotListed},
    {"equal to a number that is no category", "<SimplePredicate field='nr' operator='equal' value='4'/>", 1,
     kNotListed},
    {"a number next to a category",
     "<SimplePredicate field='nr' operator='equal' value='3.0000000000000004'/>", 1, kNotListed},
    {"ordered by a value that is no category",
     "<SimplePredicate field='size' operator='lessThan' value='big'/>", 1, kNotListed},
    {"a category that is no number", "<SimplePredicate field='nr' operator='equal' value='three'/>", 3,
     "threeInvalid double string -- "},
    {"an ordinal category that is no number", "<SimplePredicate field='rank' operator='lessThan' value='x'/>",
     3, "xInvalid double string -- "},
    {"a nominal field has no order", "<SimplePredicate field='col' operator='lessThan' value='green'/>", 9,
     "Invalid operator!!"},
    {"a nominal number field has none either",
     "<SimplePredicate field='nr' operator='greaterOrEqual' value='1'/>", 9, "Invalid operator!!"},
    {"an unknown operator on a nominal field", "<SimplePredicate field='col' operator='is' value='red'/>", 9,
     "Invalid operator!!"},
    {"an unknown operator on an ordinal field", "<SimplePredicate field='size' operator='is' value='low'/>",
     9, "Invalid operator!!"},
    {"nothing is less than the first category",
     "<SimplePredicate field='size' operator='lessThan' value='low'/>", 9, "Invalid operator!!"},
    {"nothing is greater than the last one",
     "<SimplePredicate field='rank' operator='greaterThan' value='20'/>", 9, "Invalid operator!!"},
    // Sets
    {"an unknown operator of a set",
     "<SimpleSetPredicate field='col' booleanOperator='in'><Array>red</Array></SimpleSetPredicate>", 9,
     "in Invalid Operator!"},
    {"no operator of a set", "<SimpleSetPredicate field='col'><Array>red</Array></SimpleSetPredicate>", 9,
     " Invalid Operator!"},
    {"a set without array", "<SimpleSetPredicate field='col' booleanOperator='isIn'/>", 4,
     "Array Node is required!!!"},
    {"the array must be a child",
     "<SimpleSetPredicate field='col' booleanOperator='isIn'><Extension><Array>red</Array></Extension>"
     "</SimpleSetPredicate>",
     4, "Array Node is required!!!"},
    {"an array of nothing",
     "<SimpleSetPredicate field='col' booleanOperator='isIn'><Array type='string'> </Array>"
     "</SimpleSetPredicate>",
     4, "No Elements found in array!"},
    {"an array of another size",
     "<SimpleSetPredicate field='col' booleanOperator='isIn'><Array n='3' type='string'>red \"green\"</Array>"
     "</SimpleSetPredicate>",
     12, "Number of Elements doesn't match with array size!"},
    {"an array whose size is no number",
     "<SimpleSetPredicate field='col' booleanOperator='isIn'><Array n='two'>red blue</Array>"
     "</SimpleSetPredicate>",
     3, "twoInvalid integer string -- "},
    {"an element that is no whole number",
     "<SimpleSetPredicate field='nr' booleanOperator='isIn'><Array type='int'>1 2.5</Array>"
     "</SimpleSetPredicate>",
     3, "2.5Invalid integer string -- "},
    {"an element that is no number",
     "<SimpleSetPredicate field='rank' booleanOperator='isIn'><Array type='real'>10 x</Array>"
     "</SimpleSetPredicate>",
     3, "xInvalid double string -- "},
    {"an element that is no category",
     "<SimpleSetPredicate field='col' booleanOperator='isIn'><Array>red pink</Array></SimpleSetPredicate>", 3,
     "In valid split value!"},
    {"the same with the other operator",
     "<SimpleSetPredicate field='nr' booleanOperator='isNotIn'><Array type='int'>4</Array>"
     "</SimpleSetPredicate>",
     3, "In valid split value!"},
    {"a text for a number field",
     "<SimpleSetPredicate field='nr' booleanOperator='isIn'><Array type='string'>one</Array>"
     "</SimpleSetPredicate>",
     3, "In valid split value!"},
    {"a number too large for its type is not cut to one that is listed",
     "<SimpleSetPredicate field='nr' booleanOperator='isIn'><Array type='int'>99999999999</Array>"
     "</SimpleSetPredicate>",
     3, "In valid split value!"},
    {"a set on a field without categories",
     "<SimpleSetPredicate field='bare' booleanOperator='isIn'><Array>a</Array></SimpleSetPredicate>", 1,
     "bare: Value list is required!!!"},
    {"a set on a continuous field",
     "<SimpleSetPredicate field='num' booleanOperator='isIn'><Array>1</Array></SimpleSetPredicate>", 1,
     "num: Value list is required!!!"},
    {"labels of a continuous field are no categories",
     "<SimpleSetPredicate field='labelled' booleanOperator='isIn'><Array>1</Array></SimpleSetPredicate>", 1,
     "labelled: Value list is required!!!"},
    // Compounds
    {"an unknown Boolean operator", "<CompoundPredicate booleanOperator='nor'/>", 11,
     "nor: Invalid Boolean Operator for the Compound Predicate"},
    {"Boolean operators are case-sensitive", "<CompoundPredicate booleanOperator='AND'/>", 11,
     "AND: Invalid Boolean Operator for the Compound Predicate"},
    {"no Boolean operator", "<CompoundPredicate/>", 11,
     ": Invalid Boolean Operator for the Compound Predicate"},
    {"a set's operator", "<CompoundPredicate booleanOperator='isIn'/>", 11,
     "isIn: Invalid Boolean Operator for the Compound Predicate"},
};

TEST(PredicateFaults, HaveTheirCodeTextAndPlace) {
  const auto dictionary = ReadDictionary(kPredicateFields);
  for (const Row& row : kRows) {
    try {
      ReadPredicate(std::string("<?xml version='1.0'?>\n\n") + row.predicate, *dictionary);
      ADD_FAILURE() << row.why << ": nothing was thrown";
    } catch (const KestrelException& fault) {
      EXPECT_EQ(fault.GetErrorCode(), row.code) << row.why;
      EXPECT_EQ(fault.GetErrorMessage(), row.text) << row.why;
      EXPECT_EQ(fault.GetLine(), 3u) << row.why;
    }
  }
}

// What comes out of a child is what its own reader throws, at its own place.
TEST(PredicateFaults, InsideACompoundAreTheChilds) {
  const auto dictionary = ReadDictionary(kPredicateFields);
  for (const Row& row : kRows) {
    const std::string document =
        "<CompoundPredicate booleanOperator='or'>\n"
        "<SimplePredicate field='num' operator='equal' value='1'/>\n"
        "<CompoundPredicate booleanOperator='and'><True/>\n" +
        std::string(row.predicate) +
        "</CompoundPredicate><SimplePredicate field='num' operator='equal' value='2'/></CompoundPredicate>";
    try {
      ReadPredicate(document, *dictionary);
      ADD_FAILURE() << row.why << ": nothing was thrown";
    } catch (const KestrelException& fault) {
      EXPECT_EQ(fault.GetErrorCode(), row.code) << row.why;
      EXPECT_EQ(fault.GetErrorMessage(), row.text) << row.why;
      EXPECT_EQ(fault.GetLine(), 4u) << row.why;
    }
  }
}

TEST(PredicateFaults, OfAnArrayAreAtTheArray) {
  const auto dictionary = ReadDictionary(kPredicateFields);
  for (const char* array :
       {"<Array n='9'>red</Array>", "<Array>pink</Array>", "<Array type='int'>x</Array>"}) {
    try {
      ReadPredicate(std::string("<SimpleSetPredicate field='col' booleanOperator='isIn'>\n\n") + array +
                        "</SimpleSetPredicate>",
                    *dictionary);
      ADD_FAILURE() << array;
    } catch (const KestrelException& fault) {
      EXPECT_EQ(fault.GetLine(), 3u) << array;
    }
  }
}

TEST(PredicateFaults, WithoutADictionaryNoFieldIsKnown) {
  const auto tree = ReadTree("<SimplePredicate field='num' operator='equal' value='1'/>");
  ExpectFault([&] { PMMLTranslator::ParsePredicate(tree->GetRoot(), nullptr, nullptr, false); }, 8,
              "num: Invalid Split Variable!");
  ExpectFault([&] { PMMLTranslator::ParsePredicate(nullptr, nullptr, nullptr, false); }, 4,
              "Attribute field is missing from Node \"\"");
}

// A dictionary that a program made may hold a variable that was never given a list.
TEST(PredicateFaults, AVariableThatNeverHadAListHasNone) {
  BaseDictionary dictionary;
  auto* variable = new DictVar("made", ScoreDictVar::STRING_VAR);
  variable->SetMLevel(ScoreDictVar::kNominal);
  dictionary.AddVar("made", variable);
  ExpectFault(
      [&] { ReadPredicate("<SimplePredicate field='made' operator='equal' value='a'/>", dictionary); }, 4,
      "Value list is required!");
  ExpectFault(
      [&] {
        ReadPredicate(
            "<SimpleSetPredicate field='made' booleanOperator='isIn'><Array>a</Array></SimpleSetPredicate>",
            dictionary);
      },
      1, "made: Value list is required!!!");
}

// The operations by themselves, as plug-ins call them, without an element to point at.
TEST(PredicateFaults, OfTheOperationsByThemselves) {
  const auto dictionary = ReadDictionary(kPredicateFields);
  const ScoreDictVar* bare = dictionary->GetVar("bare");
  const ScoreDictVar* size = dictionary->GetVar("size");
  const XMLCh* low = ToXMLCh(u"low");
  const XMLCh* lessThan = ToXMLCh(u"lessThan");
  DiscreteSplit split(size);
  double from = 0.0, to = 0.0;
  bool included = false;
  std::vector<double> values;
  using T = PMMLTranslator;
  ExpectFault([&] { T::SetDiscreteSplitValue(nullptr, size, &split, nullptr, 0); }, 1,
              "value attribute is required for split variable size");
  ExpectFault([&] { T::SetDiscreteSplitValue(nullptr, size, &split, ToXMLCh(u"tiny"), 0); }, 1, kNotListed);
  ExpectFault([&] { T::SetDiscreteSplitValue(nullptr, bare, &split, low, 0); }, 4,
              "Value list is required!!");
  ExpectFault([&] { T::HandleOrdinalVariable(nullptr, bare, &split, low, lessThan, 0); }, 4,
              "bare: Value list is required!!");
  ExpectFault([&] { T::HandleOrdinalVariable(nullptr, size, &split, low, ToXMLCh(u"isMissing"), 0); }, 9,
              "Invalid operator!!");
  ExpectFault([&] { T::HandleOrdinalVariable(nullptr, size, &split, low, nullptr, 0); }, 9,
              "Invalid operator!!");
  ExpectFault([&] { T::GetIndexOfOrdinalValue(nullptr, bare, StringValue("low")); }, 4,
              "bare: Value list is required!!");
  ExpectFault([&] { T::GetScaleSplitValue(nullptr, nullptr, lessThan, from, to, included); }, 3,
              "Invalid double string -- ");
  ExpectFault([&] { T::GetScaleSplitValue(nullptr, ToXMLCh(u"1"), nullptr, from, to, included); }, 5,
              ": Not supported!");
  ExpectFault([&] { T::HandleArrayDiscreteSplit(nullptr, size, ToXMLCh(u"in"), values); }, 11,
              "in Invalid Operator!");
  ExpectFault([&] { T::HandleArrayDiscreteSplit(nullptr, size, ToXMLCh(u"isIn"), values); }, 4,
              "Array Node is required!!!");
  ExpectFault([&] { T::IsValidScoreValue(nullptr, bare, "a"); }, 1, "bare: Value list is required!!!");
  ExpectFault([&] { T::Remove(nullptr, size, {"low", "tiny"}); }, 3, "Invalid category value: tiny");
  ExpectFault([&] { T::Remove(nullptr, bare, {"low"}); }, 3, "bare: Category value list is required!!!");
  EXPECT_TRUE(split.GetCodes().GetRuns().empty()) << "what is refused enters nothing";
}

}  // namespace
