// The categories of derived fields, and predicates on them.

#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "tests/support/DerivedText.h"
#include "tests/support/ExpectFault.h"
#include "tests/support/PredicateText.h"

namespace {

using kestrel_test::DerivedFields;
using kestrel_test::ReadDerivedField;
using namespace MCKestrel_800;

struct CategoryRow {
  const char* why;
  const char* type;
  const char* content;
  const char* categories;  ///< in their order; empty for none
};

#define TEXT "optype='categorical' dataType='string'"
#define NUMBER "optype='ordinal' dataType='double'"
#define BINS                                                                                    \
  "<DiscretizeBin binValue='b'><Interval closure='openOpen' rightMargin='0'/></DiscretizeBin>"  \
  "<DiscretizeBin binValue='a'><Interval closure='closedOpen' leftMargin='0' rightMargin='1'/>" \
  "</DiscretizeBin><DiscretizeBin binValue='b'><Interval closure='closedOpen' "                 \
  "leftMargin='1'/></DiscretizeBin>"
#define MAP_END                                                                           \
  "<FieldColumnPair field='color' column='i'/><InlineTable><row><i>red</i><o>2</o></row>" \
  "<row><i>green</i><o>1</o></row><row><i>blue</i><o>2</o></row></InlineTable></MapValues>"

std::string CategoriesOf(const ScoreDictVar& variable) {
  std::string text;
  if (variable.GetValueLabels() == nullptr) return text;
  for (const ScoreValueLabel* label : variable.GetValueLabels()->GetAllValueLabels())
    text += (text.empty() ? "" : " ") + label->GetValue()->GetString();
  return text;
}

constexpr CategoryRow kRows[] = {
    {"bins in their order", TEXT, "<Discretize field='x'>" BINS "</Discretize>", "b a"},
    {"the default and the replacement last", TEXT,
     "<Discretize field='x' mapMissingTo='m' defaultValue='e'>" BINS "</Discretize>", "b a e m"},
    {"a bin that copies", TEXT,
     "<Discretize field='x'><DiscretizeBin><Interval closure='openOpen' leftMargin='5' rightMargin='6'/>"
     "</DiscretizeBin></Discretize>",
     ""},
    {"copies of what no bin holds", TEXT,
     "<Discretize field='x'>" BINS "<Extension name='recodeElseCopy'/></Discretize>", ""},
    {"copies of what is missing", TEXT,
     "<Discretize field='x'>" BINS "</Discretize><Extension name='recodeMissingCopy'/>", ""},
    {"the document's list wins", TEXT, "<Discretize field='x'>" BINS "</Discretize><Value value='z'/>", "z"},
    {"missing values are none", TEXT,
     "<Discretize field='x'>" BINS "</Discretize><Value value='b' property='missing'/>", "a"},
    {"texts that are cut", TEXT " width='1'",
     "<Discretize field='x' defaultValue='long'>" BINS "</Discretize>", ""},
    {"texts that just fit", TEXT " width='1'", "<Discretize field='x'>" BINS "</Discretize>", "b a"},
    {"outputs of a table", NUMBER, "<MapValues outputColumn='o' defaultValue='9'>" MAP_END, "2 1 9"},
    {"the number for the missing one", NUMBER,
     "<MapValues outputColumn='o'><Extension name='mapSysmisTo' value='5'/>" MAP_END, "2 1 5"},
    {"a value made missing", NUMBER,
     "<MapValues outputColumn='o'><Extension name='recodeTargetSysmis' value='5'/>" MAP_END, "2 1"},
    {"outputs as texts", TEXT, "<MapValues outputColumn='o'>" MAP_END, "2 1"},
    {"no and yes", NUMBER, "<NormDiscrete field='color' value='red'/>", "0 1"},
    {"no, yes and unknown", NUMBER, "<NormDiscrete field='color' value='red' mapMissingTo='-1'/>", "0 1 -1"},
    {"an indicator that is no number", TEXT, "<NormDiscrete field='color' value='red'/>", ""},
    {"a constant", TEXT, "<Constant>w</Constant>", "w"},
    {"a constant number", NUMBER, "<Constant>4</Constant>", "4"},
    {"a constant that is none", NUMBER, "<Constant>w</Constant>", ""},
    {"a reference", TEXT, "<FieldRef field='color'/>", ""},
    {"a function", NUMBER, "<Apply function='sqrt'><FieldRef field='x'/></Apply>", ""},
    {"a continuous field", "optype='continuous' dataType='double'", "<Constant>4</Constant>", ""},
};

TEST(DerivedCategories, AreWhatTheExpressionSays) {
  for (const CategoryRow& row : kRows) {
    const DerivedFields fields = ReadDerivedField(row.type, row.content);
    const TransformVar& d = *fields.Get("d");
    EXPECT_EQ(CategoriesOf(d), row.categories) << row.why;
    if (d.GetMLevel() == ScoreDictVar::kContinuous) {
      EXPECT_EQ(d.GetEncoder(), nullptr) << row.why;
    } else {
      ASSERT_NE(d.GetEncoder(), nullptr) << row.why;
      EXPECT_EQ(d.GetEncoder()->GetNumberOfCategories(), d.GetNumberOfCats()) << row.why;
    }
  }
}

char AskAbout(const DerivedFields& fields, const ScorePredicate& predicate, double x) {
  fields.derived->SetUpDerivedCaseRecord();
  CaseRecord record;
  record.Add("x", new NumericValue(x));
  fields.derived->GetValuesForDerivedVars(&record, fields.data.get());
  CaseRecord seen;
  seen.Add("d", fields.derived->GetVarValue("d")->Clone());
  return kestrel_test::ResultLetter(predicate.Evaluate(&seen, nullptr));
}

struct PredicateRow {
  const char* predicate;
  const char* answers;  ///< for x = -1, 0.5, 2 and missing
};

TEST(DerivedCategories, SatisfyPredicatesAsThoseOfDataFieldsDo) {
  const DerivedFields fields =
      ReadDerivedField("optype='ordinal' dataType='string'",
                       "<Discretize field='x'><DiscretizeBin binValue='young'><Interval closure='openOpen' "
                       "rightMargin='0'/></DiscretizeBin><DiscretizeBin binValue='adult'><Interval "
                       "closure='closedOpen' leftMargin='0' rightMargin='1'/></DiscretizeBin><DiscretizeBin "
                       "binValue='old'><Interval closure='closedOpen' leftMargin='1'/></DiscretizeBin>"
                       "</Discretize>");
  for (const PredicateRow& row : {PredicateRow{"operator='equal' value='young'", "TFF"},
                                  {"operator='notEqual' value='adult'", "TFT"},
                                  {"operator='greaterOrEqual' value='adult'", "FTT"},
                                  {"operator='lessThan' value='adult'", "TFF"}}) {
    const auto predicate =
        kestrel_test::ReadPredicate("<SimplePredicate field='d' " + std::string(row.predicate) + "/>",
                                    *fields.data, false, fields.derived.get());
    std::string answers;
    for (const double x : {-1.0, 0.5, 2.0})
      answers += AskAbout(fields, *predicate, x);
    EXPECT_EQ(answers, row.answers) << row.predicate;
    EXPECT_NE(AskAbout(fields, *predicate, NumericValue::gSysmisValue), 'T') << row.predicate;
  }
  kestrel_tests::ExpectFault(
      [&] {
        kestrel_test::ReadPredicate("<SimplePredicate field='d' operator='equal' value='ancient'/>",
                                    *fields.data, false, fields.derived.get());
      },
      1, "Value list is required and split value should be in the list!");
}

TEST(DerivedCategories, ThatAreNotKnownAreNoCategories) {
  const DerivedFields fields = ReadDerivedField(TEXT, "<FieldRef field='color'/>");
  EXPECT_TRUE(fields.Get("d")->IsEmptyCateValues());
  const StringValue any("any");
  EXPECT_TRUE(fields.Get("d")->IsValidValue(&any));
}

}  // namespace
