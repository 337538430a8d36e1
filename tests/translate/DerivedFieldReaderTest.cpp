// Derived fields of every kind, read and then looked at.

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/predicates/ScoreValueRange.h"
#include "kestrel/transform/FunctionTree.h"
#include "kestrel/transform/ValueMatcher.h"
#include "tests/support/DerivedText.h"

namespace {

using kestrel_test::DerivedFields;
using kestrel_test::kCategory;
using kestrel_test::kNumber;
using kestrel_test::kNumberCategory;
using kestrel_test::ReadDerivedDocument;
using kestrel_test::ReadDerivedField;
using namespace MCKestrel_800;

std::string TextOf(const ScoreValue* value) {
  return value != nullptr ? value->GetString() : "none";
}

std::string InputOf(const TransformVar::Encoding& row) {
  return TextOf(static_cast<const ValueMatcher&>(*row.matcher).GetValue());
}

constexpr char kAllKinds[] =
    "<TransformationDictionary>"
    "<Extension name='anything'/>"
    "<DerivedField name='five' displayName='Five' optype='continuous' dataType='double'>"
    "<Constant dataType='double'>5</Constant></DerivedField>"
    "<DerivedField name='same' optype='continuous' dataType='double'>"
    "<FieldRef field='x' mapMissingTo='-1'/></DerivedField>"
    "<DerivedField name='norm' optype='continuous' dataType='double'>"
    "<NormContinuous field='x' mapMissingTo='0.5' outliers='asExtremeValues'>"
    "<LinearNorm orig='0' norm='0'/><LinearNorm orig='10' norm='1'/><LinearNorm orig='10' norm='2'/>"
    "</NormContinuous></DerivedField>"
    "<DerivedField name='isred' optype='continuous' dataType='double'>"
    "<NormDiscrete field='color' method='indicator' value='red' mapMissingTo='-1'/></DerivedField>"
    "<DerivedField name='band' optype='ordinal' dataType='string'>"
    "<Discretize field='x' mapMissingTo='unknown' defaultValue='old'>"
    "<DiscretizeBin binValue='young'><Interval closure='openOpen' rightMargin='18'/></DiscretizeBin>"
    "<DiscretizeBin binValue='adult'><Interval closure='closedOpen' leftMargin='18' rightMargin='65'/>"
    "</DiscretizeBin></Discretize></DerivedField>"
    "<DerivedField name='price' optype='continuous' dataType='double'>"
    "<MapValues outputColumn='out' defaultValue='7' mapMissingTo='0'>"
    "<FieldColumnPair field='color' column='in'/><InlineTable>"
    "<row><in>red</in><out>1.5</out></row><row><out>2</out><in>green</in></row></InlineTable>"
    "</MapValues></DerivedField>"
    "<DerivedField name='total' optype='continuous' dataType='double'>"
    "<Apply function='+' mapMissingTo='-9' invalidValueTreatment='asIs'><FieldRef field='same' "
    "mapMissingTo='3'/>"
    "<Apply function='*'><Constant dataType='double'>2</Constant><FieldRef field='y'/></Apply></Apply>"
    "</DerivedField>"
    "</TransformationDictionary>";

TEST(DerivedFieldReader, ReadsEveryKindInTheDocumentsOrder) {
  const DerivedFields fields = ReadDerivedDocument(kAllKinds);
  EXPECT_EQ(fields.derived->GetDerivedVarNames(),
            (std::vector<std::string>{"five", "same", "norm", "isred", "band", "price", "total"}));
  EXPECT_EQ(fields.derived->Size(), 7u);
  struct Row {
    const char* name;
    const char* source;
    TransExpression kind;
  };
  for (const Row& row : {Row{"five", "", TransExpression::kConstant},
                         {"same", "x", TransExpression::kFieldRef},
                         {"norm", "x", TransExpression::kNormContinuous},
                         {"isred", "color", TransExpression::kNormDiscrete},
                         {"band", "x", TransExpression::kDiscretize},
                         {"price", "color", TransExpression::kMapValues},
                         {"total", "", TransExpression::kApply}}) {
    ASSERT_NE(fields.Get(row.name), nullptr) << row.name;
    EXPECT_EQ(fields.Get(row.name)->GetFieldName(), row.source) << row.name;
    EXPECT_EQ(fields.Get(row.name)->GetTransExpression(), row.kind) << row.name;
  }
  EXPECT_EQ(fields.Get("five")->GetLabel(), "Five");
}

TEST(DerivedFieldReader, TablesHoldWhatTheDocumentSays) {
  const DerivedFields fields = ReadDerivedDocument(kAllKinds);
  EXPECT_EQ(fields.Get("five")->GetConstString(), "5");
  EXPECT_EQ(TextOf(fields.Get("same")->GetRecodeMissValueRep()), "-1");

  const TransformVar& norm = *fields.Get("norm");
  EXPECT_EQ(norm.GetOrig(), (std::vector<double>{0, 10, 10}));
  EXPECT_EQ(norm.GetNorm(), (std::vector<double>{0, 1, 2}));
  EXPECT_EQ(norm.GetSlopes(), (std::vector<double>{0.1, 1}));
  EXPECT_EQ(norm.GetIntercepts(), (std::vector<double>{0, 0}));
  EXPECT_EQ(norm.GetOutlierTreatment(), ScoreDictVar::kAsExtremeValues);
  EXPECT_EQ(TextOf(norm.GetRecodeMissValueRep()), "0.5");

  const TransformVar& red = *fields.Get("isred");
  ASSERT_EQ(red.GetAllEncodedValues().size(), 1u);
  EXPECT_EQ(InputOf(red.GetAllEncodedValues()[0]), "red");
  EXPECT_EQ(TextOf(red.GetAllEncodedValues()[0].value.get()), "1");
  EXPECT_EQ(TextOf(red.GetRecodeDefaultValue()), "0");
  EXPECT_EQ(TextOf(red.GetRecodeMissValueRep()), "-1");

  const TransformVar& band = *fields.Get("band");
  ASSERT_EQ(band.GetBins().size(), 2u);
  EXPECT_EQ(TextOf(band.GetBins()[0].value.get()), "young");
  EXPECT_TRUE(band.GetBins()[0].range->IsInRange(-1e300));
  EXPECT_FALSE(band.GetBins()[0].range->IsInRange(18));
  EXPECT_TRUE(band.GetBins()[1].range->IsInRange(18));
  EXPECT_FALSE(band.GetBins()[1].range->IsInRange(65));
  EXPECT_EQ(TextOf(band.GetRecodeDefaultValue()), "old");
  EXPECT_EQ(TextOf(band.GetRecodeMissValueRep()), "unknown");

  const TransformVar& price = *fields.Get("price");
  ASSERT_EQ(price.GetAllEncodedValues().size(), 2u);
  EXPECT_EQ(InputOf(price.GetAllEncodedValues()[1]), "green");
  EXPECT_EQ(TextOf(price.GetAllEncodedValues()[1].value.get()), "2");
  EXPECT_EQ(TextOf(price.GetRecodeDefaultValue()), "7");
  EXPECT_EQ(TextOf(price.GetRecodeMissValueRep()), "0");
}

TEST(DerivedFieldReader, ApplyBecomesATree) {
  const DerivedFields fields = ReadDerivedDocument(kAllKinds);
  const FunctionTree* const root = fields.Get("total")->GetRoot();
  ASSERT_NE(root, nullptr);
  EXPECT_EQ(root->GetNodeStats().GetTransFunction(), kPlusFunction);
  EXPECT_EQ(root->GetNodeStats().GetParameterName(), "+");
  EXPECT_EQ(root->GetNodeStats().GetInvalidValueTreatment(), ApplyNodeStats::kAsIs);
  EXPECT_EQ(TextOf(root->GetNodeStats().GetRecodeMissValueTo()), "-9");
  ASSERT_EQ(root->GetChildCount(), 2);
  const ApplyNodeStats& same = root->GetChildAt(0)->GetNodeStats();
  EXPECT_EQ(same.GetParameterName(), "same");
  EXPECT_EQ(same.GetVariable(), fields.Get("same"));
  EXPECT_EQ(TextOf(same.GetFieldrefRecodeMissValueTo()), "3");
  const FunctionTree& product = *root->GetChildAt(1);
  EXPECT_EQ(product.GetNodeStats().GetInvalidValueTreatment(), ApplyNodeStats::kNotGiven);
  ASSERT_EQ(product.GetChildCount(), 2);
  EXPECT_EQ(product.GetChildAt(0)->GetNodeStats().GetParameterName(), "Constant_D_");
  EXPECT_TRUE(product.GetChildAt(0)->GetNodeStats().IsConstNode());
  EXPECT_EQ(TextOf(product.GetChildAt(0)->GetNodeStats().GetValue()), "2");
  EXPECT_EQ(product.GetChildAt(1)->GetNodeStats().GetVariable(), fields.data->GetVar("y"));
}

TEST(DerivedFieldReader, WhatWasReadComputes) {
  const DerivedFields fields = ReadDerivedDocument(kAllKinds);
  fields.derived->SetUpDerivedCaseRecord();
  CaseRecord record;
  record.Add("x", new NumericValue(5.0));
  record.Add("y", new NumericValue(4.0));
  record.Add("color", new StringValue("red"));
  ASSERT_NE(fields.derived->GetValuesForDerivedVars(&record, fields.data.get()), nullptr);
  for (const auto& [name, value] : std::vector<std::pair<std::string, std::string>>{{"five", "5"},
                                                                                    {"same", "5"},
                                                                                    {"norm", "0.5"},
                                                                                    {"isred", "1"},
                                                                                    {"band", "young"},
                                                                                    {"price", "1.5"},
                                                                                    {"total", "13"}}) {
    EXPECT_EQ(TextOf(fields.derived->GetVarValue(name)), value) << name;
  }
}

TEST(DerivedFieldReader, ReplacementsAreNumbersInTheTreeOfATextToo) {
  const char* const kReplaced[] = {
      "<Apply function='if' mapMissingTo='3'><FieldRef field='y'/><FieldRef field='x'/></Apply>",
      "<Apply function='imputeCatFieldMissingAgainstConTarget' mapMissingTo='3'><FieldRef field='code'/>"
      "<FieldRef field='x'/><Array type='real' n='1'>1</Array><Array type='real' n='1'>1</Array></Apply>",
  };
  for (const char* replaced : kReplaced) {
    const DerivedFields fields = ReadDerivedField(
        kCategory, std::string("<Apply function='substr'><FieldRef field='free'/>") + replaced + "</Apply>");
    fields.derived->SetUpDerivedCaseRecord();
    CaseRecord record;
    record.Add("free", new StringValue("abcdef"));
    ASSERT_NE(fields.derived->GetValuesForDerivedVars(&record, fields.data.get()), nullptr);
    EXPECT_EQ(TextOf(fields.derived->GetVarValue("d")), "cdef") << replaced;
  }
}

}  // namespace
