// Output fields as documents declare them: their variables, and every fault with its code, text and place.

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "kestrel/dictionary/BaseDictionary.h"
#include "kestrel/foundation/KestrelException.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "kestrel/translate/ResultVar.h"
#include "kestrel/translate/XmlText.h"
#include "tests/support/ReadText.h"

namespace {

using kestrel_tests::ReadText;
using namespace MCKestrel_800;
using Feature = ScoreResultField::ResultFeature;

/// The dictionary of an Output element with these children.
std::unique_ptr<ScoreDictionary> ReadOutput(const std::string& fields) {
  const auto document = ReadText("<Output>\n" + fields + "</Output>");
  return std::unique_ptr<ScoreDictionary>(PMMLTranslator::ParseResultDictionary(document->GetRoot()));
}

const ResultVar* FieldOf(const ScoreDictionary& dictionary, const std::string& name) {
  return dynamic_cast<const ResultVar*>(dictionary.GetVar(name));
}

/// A copy of the variable of one element, read by itself into a dictionary that has "taken" already.
std::unique_ptr<ResultVar> ReadOne(const std::string& element) {
  BaseDictionary dictionary;
  dictionary.AddVar("taken", new ResultVar("taken", ScoreDictVar::kNUMERIC_VAR));
  const auto document = ReadText("<?xml version='1.0'?>\n\n" + element);
  const ResultVar& made = PMMLTranslator::ParseResultField(document->GetRoot(), dictionary);
  EXPECT_EQ(dictionary.GetVar(made.GetName()), &made);
  EXPECT_EQ(dictionary.GetVarNames(), (std::vector<std::string>{"taken", made.GetName()}));
  return std::unique_ptr<ResultVar>(made.Clone());
}

TEST(Output, HasAVariableOfEachResultField) {
  const auto dictionary = ReadOutput(
      "<ResultField name='z' displayName='The class' optype='categorical' dataType='string' "
      "feature='predictedValue'/>"
      "<Extension/>"
      "<OutputField name='skipped' feature='nonsense'/>"
      "<ResultField name='a' optype='continuous' dataType='double' feature='probability' value='yes'/>");
  EXPECT_EQ(dictionary->GetVarNames(), (std::vector<std::string>{"z", "a"}));

  const ResultVar* const first = FieldOf(*dictionary, "z");
  ASSERT_NE(first, nullptr);
  EXPECT_EQ(first->GetName(), "z");
  EXPECT_EQ(first->GetLabel(), "The class");
  EXPECT_EQ(first->GetMLevel(), ScoreDictVar::kNominal);
  EXPECT_EQ(first->GetVarType(), ScoreDictVar::STRING_VAR);
  EXPECT_EQ(first->GetFeature(), Feature::kPredictedValue);
  EXPECT_EQ(first->GetDefValue(), nullptr);

  const ResultVar* const second = FieldOf(*dictionary, "a");
  ASSERT_NE(second, nullptr);
  EXPECT_EQ(second->GetLabel(), "");
  EXPECT_EQ(second->GetMLevel(), ScoreDictVar::kContinuous);
  EXPECT_EQ(second->GetVarType(), ScoreDictVar::kNUMERIC_VAR);
  EXPECT_EQ(second->GetFeature(), 3);
  ASSERT_NE(second->GetDefValue(), nullptr);
  EXPECT_EQ(*second->GetDefValue(), StringValue("yes"));
}

TEST(Output, MayBeEmptyOrAbsent) {
  EXPECT_EQ(ReadOutput("")->Size(), 0u);
  EXPECT_EQ(ReadOutput("<Extension/>")->Size(), 0u);
  const std::unique_ptr<ScoreDictionary> none(PMMLTranslator::ParseResultDictionary(nullptr));
  ASSERT_NE(none, nullptr);
  EXPECT_EQ(none->Size(), 0u);
}

struct FeatureRow {
  const char* text;
  int code;
};

constexpr FeatureRow kFeatures[] = {
    {"", 0},
    {"predictedValue", 1},
    {"predictedDisplayValue", 2},
    {"probability", 3},
    {"residual", 4},
    {"standardError", 5},
    {"clusterId", 6},
    {"clusterAffinity", 7},
    {"categorical", 2},
    {"entityId", 8},
    {"entityAffinity", 9},
    {"warning", 10},
    {"ruleValue", 11},
    {"standardDeviation", 12},
};

TEST(Output, KnowsEveryFeature) {
  for (const FeatureRow& row : kFeatures) {
    for (const char* tag : {"ResultField", "OutputField"}) {
      const auto field = ReadOne("<" + std::string(tag) + " name='f' feature='" + row.text + "'/>");
      EXPECT_EQ(field->GetFeature(), row.code) << tag << " " << row.text;
    }
  }
}

TEST(Output, KnowsTheLaterNamesInAnOutputField) {
  EXPECT_EQ(ReadOne("<OutputField name='f' feature='affinity'/>")->GetFeature(), Feature::kEntityAffinity);
  EXPECT_EQ(ReadOne("<OutputField name='f'/>")->GetFeature(), Feature::kPredictedValue);
}

struct TypeRow {
  const char* attributes;
  ScoreDictVar::MeasureLevel level;
  ScoreDictVar::VariableType type;
};

constexpr TypeRow kTypes[] = {
    {"", ScoreDictVar::kContinuous, ScoreDictVar::kNUMERIC_VAR},
    {"optype='continuous'", ScoreDictVar::kContinuous, ScoreDictVar::kNUMERIC_VAR},
    {"optype='ordinal'", ScoreDictVar::kOrdinal, ScoreDictVar::kNUMERIC_VAR},
    {"optype='categorical'", ScoreDictVar::kNominal, ScoreDictVar::kNUMERIC_VAR},
    {"dataType='string'", ScoreDictVar::kContinuous, ScoreDictVar::STRING_VAR},
    {"optype='continuous' dataType='string'", ScoreDictVar::kContinuous, ScoreDictVar::STRING_VAR},
    {"optype='ordinal' dataType='string'", ScoreDictVar::kOrdinal, ScoreDictVar::STRING_VAR},
    {"dataType=''", ScoreDictVar::kContinuous, ScoreDictVar::kNUMERIC_VAR},
    {"dataType='String'", ScoreDictVar::kContinuous, ScoreDictVar::kNUMERIC_VAR},
    {"dataType='double'", ScoreDictVar::kContinuous, ScoreDictVar::kNUMERIC_VAR},
    {"dataType='date'", ScoreDictVar::kContinuous, ScoreDictVar::kNUMERIC_VAR},
    {"dataType='dateTime' optype='ordinal'", ScoreDictVar::kOrdinal, ScoreDictVar::kNUMERIC_VAR},
};

TEST(Output, ReadsLevelAndType) {
  for (const TypeRow& row : kTypes) {
    const auto field =
        ReadOne("<ResultField name='f' feature='residual' " + std::string(row.attributes) + "/>");
    EXPECT_EQ(field->GetMLevel(), row.level) << row.attributes;
    EXPECT_EQ(field->GetVarType(), row.type) << row.attributes;
  }
}

struct ValueRow {
  const char* attributes;
  bool is_number;
  const char* text;
  double number;
};

constexpr ValueRow kValues[] = {
    {"value='yes'", false, "yes", 0.0},
    {"value='2.5'", true, "2.5", 2.5},
    {"value=' -1e2'", true, "-100", -100.0},
    {"value='1 or 2'", false, "1 or 2", 1.0},
    {"value=''", false, "", 0.0},
    {"value='yes' dataType='string'", false, "yes", 0.0},
    {"value='2.50' dataType='string'", false, "2.50", 2.5},
    {"value='' dataType='string'", false, "", 0.0},
};

TEST(Output, KeepsTheValueAsOneOfItsTypeOrAsItStands) {
  for (const ValueRow& row : kValues) {
    const auto field =
        ReadOne("<ResultField name='f' feature='probability' " + std::string(row.attributes) + "/>");
    const ScoreValue* const value = field->GetDefValue();
    ASSERT_NE(value, nullptr) << row.attributes;
    EXPECT_EQ(value->GetType(), row.is_number ? ScoreValue::kNumeric : ScoreValue::kString) << row.attributes;
    EXPECT_EQ(value->GetString(), row.text) << row.attributes;
    EXPECT_EQ(value->GetDouble(), row.number) << row.attributes;
  }
  EXPECT_EQ(ReadOne("<ResultField name='f' feature='probability'/>")->GetDefValue(), nullptr);
}

struct FaultRow {
  const char* element;
  int code;
  const char* text;
};

constexpr FaultRow kFaults[] = {
    {"<ResultField/>", 4, "Attribute name is missing from Node \"ResultField\""},
    {"<OutputField/>", 4, "Attribute name is missing from Node \"OutputField\""},
    {"<ResultField name=''/>", 1, "<ResultField>'s name can't be null string !!"},
    {"<OutputField name=''/>", 1, "<OutputField>'s name can't be null string !!"},
    {"<ResultField name='taken' optype='x'/>", 8, "taken: Invalid Variable Name -- alreay in the dictionary"},
    {"<OutputField name='taken'/>", 8, "taken: Invalid Variable Name -- alreay in the dictionary"},
    {"<ResultField name='f' optype='nominal'/>", 11, "f: Invalid Variable Type"},
    {"<ResultField name='f' optype='' feature='residual'/>", 11, "f: Invalid Variable Type"},
    {"<OutputField name='f' optype='Continuous'/>", 11, "f: Invalid Variable Type"},
    {"<ResultField name='f'/>", 4, "Attribute feature is missing from Node \"ResultField\""},
    {"<ResultField name='f' feature='nonsense'/>", 11, "f: Invalid feature Type"},
    {"<ResultField name='f' feature='PredictedValue'/>", 11, "f: Invalid feature Type"},
    {"<ResultField name='f' feature='probability '/>", 11, "f: Invalid feature Type"},
    {"<ResultField name='f' feature='affinity'/>", 11, "f: Invalid feature Type"},
    {"<ResultField name='f' feature='decision'/>", 11, "f: Invalid feature Type"},
    {"<OutputField name='f' feature='nonsense'/>", 11, "f: Invalid feature Type"},
};

/// Reads one element, which stands in line 3, and expects a fault there that leaves the dictionary as it was.
void ExpectFaultOf(const std::string& element, int code, const std::string& text) {
  BaseDictionary dictionary;
  dictionary.AddVar("taken", new ResultVar("taken", ScoreDictVar::kNUMERIC_VAR));
  const auto document = ReadText("<?xml version='1.0'?>\n<Output>\n" + element + "</Output>");
  const auto* const field = FirstChild(document->GetRoot());
  try {
    PMMLTranslator::ParseResultField(field, dictionary);
    ADD_FAILURE() << element << ": nothing was thrown";
  } catch (const KestrelException& fault) {
    EXPECT_EQ(fault.GetErrorCode(), code) << element;
    EXPECT_EQ(fault.GetErrorMessage(), text) << element;
    EXPECT_EQ(fault.GetLine(), 3u) << element;
  }
  EXPECT_EQ(dictionary.GetVarNames(), std::vector<std::string>{"taken"}) << element;
}

TEST(Output, RefusesWithCodeTextAndPlace) {
  for (const FaultRow& row : kFaults)
    ExpectFaultOf(row.element, row.code, row.text);
}

TEST(Output, SaysWhichFeaturesAreNotSupported) {
  for (const char* feature :
       {"transformedValue", "decision", "reasonCode", "confidenceIntervalLower", "confidenceIntervalUpper"}) {
    ExpectFaultOf("<OutputField name='f' feature='" + std::string(feature) + "'/>", 5,
                  "f: feature -- " + std::string(feature) + ": Not supported!");
    ExpectFaultOf("<ResultField name='f' feature='" + std::string(feature) + "'/>", 11,
                  "f: Invalid feature Type");
  }
}

TEST(Output, KnowsTheLaterNamesOfWhatIsToldOfARule) {
  for (const char* feature :
       {"antecedent", "consequent", "rule", "ruleId", "confidence", "support", "lift", "leverage"}) {
    BaseDictionary dictionary;
    const auto document = ReadText("<OutputField name='f' feature='" + std::string(feature) + "'/>");
    EXPECT_EQ(PMMLTranslator::ParseResultField(document->GetRoot(), dictionary).GetFeature(),
              ScoreResultField::kRuleValue);
    ExpectFaultOf("<ResultField name='f' feature='" + std::string(feature) + "'/>", 11,
                  "f: Invalid feature Type");
  }
}

TEST(Output, RefusesTwoFieldsOfOneName) {
  try {
    ReadOutput(
        "<ResultField name='f' feature='residual'/>\n<ResultField name='g' feature='residual'/>\n"
        "<ResultField name='f' feature='warning'/>");
    FAIL() << "nothing was thrown";
  } catch (const KestrelException& fault) {
    EXPECT_EQ(fault.GetErrorCode(), 8);
    EXPECT_EQ(fault.GetErrorMessage(), "f: Invalid Variable Name -- alreay in the dictionary");
    EXPECT_EQ(fault.GetLine(), 4u);
  }
}

TEST(Output, MayHaveVeryManyFields) {
  std::string fields;
  constexpr int kCount = 20000;
  for (int i = 0; i < kCount; ++i)
    fields += "<ResultField name='p_" + std::to_string(i) + "' feature='probability' value='c'/>";
  const auto dictionary = ReadOutput(fields);
  EXPECT_EQ(dictionary->Size(), static_cast<size_t>(kCount));
  ASSERT_NE(FieldOf(*dictionary, "p_19999"), nullptr);
  EXPECT_EQ(dictionary->GetVarNames().back(), "p_19999");
}

}  // namespace
