// Documents whose derived fields do not fit together, in models of every kind: the fault and where it is.

#include <gtest/gtest.h>

#include <string>

#include "tests/plugins/DerivedModelText.h"
#include "tests/support/ExpectFault.h"

namespace kestrel_tests {
namespace {

const std::string kD = Derived("d", "continuous double", FieldRef("x"));
const std::string kText = Derived("d", "categorical string", FieldRef("t"));

struct RefusedRow {
  const char* why;
  DerivedDocument document;
  int code;
  const char* message;
};

const RefusedRow kFrames[] = {
    {"a global field that reads none",
     {Derived("d", "continuous double", FieldRef("q")), ""},
     8,
     "q: not predefined"},
    {"a local field that reads none",
     {"", Derived("d", "continuous double", FieldRef("q"))},
     8,
     "q: not predefined"},
    {"a global field that reads a local one",
     {Derived("e", "continuous double", FieldRef("d")), kD},
     8,
     "d: not predefined"},
    {"the same name in both", {kD, kD}, 1, "d: Redefinition!"},
    {"a local field twice", {"", kD + kD}, 1, "d: Redefinition!"},
    {"named like a data field",
     {"", Derived("z", "continuous double", FieldRef("x"))},
     1,
     "z: Redefinition!"},
    {"a global one named like a data field",
     {Derived("z", "continuous double", FieldRef("x")), ""},
     1,
     "z: Redefinition!"},
    {"a local field as a mining field",
     {"", kD, TestInputs() + std::string("<MiningField name='d'/>")},
     8,
     "Variable d not in the dictionary!"},
    {"a derived field as a target", {kD, "", TestInputs(), "d"}, 8, "Variable d not in the dictionary!"},
    {"a text made continuous",
     {kText, "", "<MiningField name='d' optype='continuous'/>"},
     11,
     "d: string variable can't be continuous!!"},
    {"a replacement that does not fit",
     {kD, "", "<MiningField name='d' missingValueReplacement='q'/>"},
     7,
     "d: invalid missingValueReplacement -- q"},
};

TEST(DerivedRefusal, OfFramesInModelsOfEveryKind) {
  for (const RefusedRow& row : kFrames) {
    const std::string predicate = "<True/>";
    ExpectFault([&] { BuildAny(row.document.Regression("")); }, row.code, row.message, row.why);
    ExpectFault([&] { BuildAny(row.document.Tree(predicate)); }, row.code, row.message, row.why);
    ExpectFault([&] { BuildAny(row.document.Rules(predicate)); }, row.code, row.message, row.why);
  }
}

struct TermRow {
  const char* why;
  DerivedDocument document;
  std::string terms;
  int code;
  const char* message;
};

const TermRow kTerms[] = {
    {"a field that is nowhere",
     {"", kD},
     Number("e"),
     8,
     "Variable e not among the active fields of the MiningSchema!"},
    {"a derived field that is a mining field, but not active",
     {kD, "", "<MiningField name='d' usageType='supplementary'/>"},
     Number("d"),
     8,
     "Variable d not among the active fields of the MiningSchema!"},
    {"a text where a number is needed", {"", kText}, Number("d"), 11, "d: Invalid Variable Type"},
    {"a value that is none of the field's",
     {"", Derived("d", "categorical string", Bins("x", "1", "5"))},
     Category("d", "middle"),
     7,
     "d: invalid value!"},
};

TEST(DerivedRefusal, OfTerms) {
  for (const TermRow& row : kTerms)
    ExpectFault([&] { BuildAny(row.document.Regression(row.terms)); }, row.code, row.message, row.why);
}

const TermRow kPredicates[] = {
    {"a field that is nowhere", {"", kD}, Compare("e", "lessThan", "1"), 8, "e: Invalid Split Variable!"},
    {"a derived field that is a mining field, but not active",
     {kD, "", "<MiningField name='d' usageType='supplementary'/>"},
     Compare("d", "lessThan", "1"),
     8,
     "Variable d not among the active fields of the MiningSchema!"},
    {"a category that cannot be known",
     {"", kText},
     Compare("d", "equal", "Oslo"),
     4,
     "Value list is required!"},
    {"a value that is none of the field's",
     {"", Derived("d", "categorical string", Bins("x", "1", "5"))},
     Compare("d", "equal", "middle"),
     1,
     "Value list is required and split value should be in the list!"},
};

TEST(DerivedRefusal, OfPredicates) {
  for (const TermRow& row : kPredicates) {
    ExpectFault([&] { BuildAny(row.document.Tree(row.terms)); }, row.code, row.message, row.why);
    ExpectFault([&] { BuildAny(row.document.Rules(row.terms)); }, row.code, row.message, row.why);
  }
}

TEST(DerivedRefusal, SaysWhereTheFaultIs) {
  const std::string document = "<PMML version='4.4'>" + kestrel_test::DictionaryOf(9, TestFields()) +
                               "\n<RegressionModel functionName='regression'><MiningSchema><MiningField "
                               "name='x'/></MiningSchema>\n<LocalTransformations>\n" +
                               Derived("d", "continuous double", FieldRef("x")) + "\n" +
                               Derived("x", "continuous double", FieldRef("d")) +
                               "</LocalTransformations><RegressionTable/></RegressionModel></PMML>";
  try {
    BuildAny(document);
    ADD_FAILURE() << "the document was not refused";
  } catch (const MCKestrel_800::KestrelException& fault) {
    EXPECT_EQ(fault.GetErrorMessage(), "x: Redefinition!");
    EXPECT_EQ(fault.GetLine(), 5u);
  }
}

}  // namespace
}  // namespace kestrel_tests
