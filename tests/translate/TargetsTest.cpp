// What a document's targets add to their variables, and every fault with its code, text and place.

#include <gtest/gtest.h>

#include <memory>
#include <sstream>
#include <string>
#include <vector>

#include "kestrel/dictionary/BaseDictionary.h"
#include "kestrel/dictionary/DictVar.h"
#include "kestrel/dictionary/ValueProbability.h"
#include "kestrel/dictionary/ValueProbabilitySet.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/KestrelException.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "kestrel/translate/XmlText.h"
#include "tests/support/DictionaryText.h"
#include "tests/support/ExpectFault.h"

namespace {

using kestrel_test::ReadDictionary;
using kestrel_test::ReadTree;
using kestrel_tests::ExpectFault;
using namespace MCKestrel_800;
using Texts = std::vector<std::string>;

constexpr char kFields[] =
    "<DataDictionary numberOfFields='10'>"
    "<DataField name='x' optype='continuous' dataType='double'/>"
    "<DataField name='day' optype='continuous' dataType='dateDaysSince[1970]'/>"
    "<DataField name='class' optype='categorical' dataType='string'>"
    "<Value value='old' displayValue='Old'/><Value value='?' property='missing'/></DataField>"
    "<DataField name='free' optype='categorical' dataType='string'/>"
    "<DataField name='exact' optype='categorical' dataType='string'>"
    "<Extension name='noSpaceTrim' value='true'/></DataField>"
    "<DataField name='code' optype='categorical' dataType='integer'>"
    "<Extension name='invalidRangeLower' value='100'/><Extension name='invalidRangeUpper' value='200'/>"
    "<Value value='1'/><Value value='150'/><Value value='9' property='invalid'/></DataField>"
    "<DataField name='size' optype='ordinal' dataType='string'>"
    "<Value value='low'/><Value value='high'/></DataField>"
    "<DataField name='epoch' optype='ordinal' dataType='dateDaysSince[1970]'><Value value='1'/></DataField>"
    "<DataField name='flag' optype='categorical' dataType='string'>"
    "<Extension name='measure' value='flag'/><Value value='t'/><Value value='f'/></DataField>"
    "<DataField name='plain' optype='categorical' dataType='string'><Value value='v'/></DataField>"
    "</DataDictionary>";

void Read(const std::string& targets, ScoreDictionary* dictionary) {
  const auto document = ReadTree("<Targets>\n" + targets + "</Targets>");
  PMMLTranslator::HandleTargets(document->GetRoot(), dictionary);
}

std::unique_ptr<ScoreDictionary> FieldsWith(const std::string& targets) {
  auto dictionary = ReadDictionary(kFields);
  Read(targets, dictionary.get());
  return dictionary;
}

std::string Categories(const std::string& field, const Texts& values) {
  std::string target = "<Target field='" + field + "'>";
  for (const std::string& value : values)
    target += "<TargetValue value='" + value + "'/>";
  return target + "</Target>";
}

Texts LabelledValues(const ScoreDictVar& variable) {
  Texts values;
  for (const ScoreValueLabel* label : variable.GetValueLabels()->GetAllValueLabels())
    values.push_back(label->GetValue()->GetString());
  return values;
}

TEST(Targets, GiveACategoricalVariableItsCategories) {
  const auto dictionary = FieldsWith(
      "<Target field='class' optype='categorical'><Extension/>"
      "<TargetValue value='yes' displayValue='Yes, please' priorProbability='0.25'/>"
      "<TargetValue value='no'/>"
      "<TargetValue value='maybe' displayValue='' priorProbability=' 0.75'/></Target>");
  const ScoreDictVar& variable = *dictionary->GetVar("class");
  EXPECT_EQ(LabelledValues(variable), (Texts{"yes", "no", "maybe"}));
  const StringValue yes("yes");
  const StringValue no("no");
  const StringValue maybe("maybe");
  const StringValue old("old");
  EXPECT_EQ(variable.GetLabelOfValue(&yes), "Yes, please");
  EXPECT_EQ(variable.GetLabelOfValue(&no), "");
  EXPECT_EQ(variable.GetLabelOfValue(&maybe), "");
  EXPECT_TRUE(variable.IsValidValue(&no));
  EXPECT_FALSE(variable.IsValidValue(&old));

  const ScoreValueProbabilitySet* const priors = variable.GetValueProbabilities();
  ASSERT_NE(priors, nullptr);
  EXPECT_EQ(priors->Size(), 2u);
  EXPECT_EQ(priors->GetProbabilityOfValue(&yes), 0.25);
  EXPECT_EQ(priors->GetProbabilityOfValue(&maybe), 0.75);
  EXPECT_FALSE(priors->Contains(&no));

  // The new categories have the codes now.
  ASSERT_NE(variable.GetEncoder(), nullptr);
  EXPECT_EQ(variable.GetEncoder()->GetNumberOfCategories(), 3);
  EXPECT_EQ(variable.GetEncoder()->EncodeConst(&yes), 0);
  EXPECT_EQ(variable.GetEncoder()->EncodeConst(&maybe), 2);
  EXPECT_EQ(variable.GetEncoder()->EncodeConst(&old), -1);

  // What the data field says otherwise stays.
  const StringValue missing("?");
  EXPECT_TRUE(variable.IsMissingValue(&missing));
  EXPECT_EQ(variable.GetDefValue(), nullptr);
}

TEST(Targets, GiveAnOrdinalVariableItsOrder) {
  const auto dictionary = FieldsWith(Categories("size", {"high", "mid", "low"}));
  const ScoreDictVar& variable = *dictionary->GetVar("size");
  EXPECT_EQ(LabelledValues(variable), (Texts{"high", "mid", "low"}));
  EXPECT_EQ(variable.GetEncoder()->EncodeConst(std::string("mid")), 1);
  ASSERT_NE(variable.GetValueProbabilities(), nullptr);
  EXPECT_EQ(variable.GetValueProbabilities()->Size(), 0u);
}

TEST(Targets, ConvertCategoriesToTheVariablesType) {
  const auto dictionary = FieldsWith(Categories("code", {"1.50", " -2"}) + Categories("epoch", {"2", "1"}));
  const ScoreDictVar& code = *dictionary->GetVar("code");
  const NumericValue number(1.5);
  EXPECT_TRUE(code.GetValueLabels()->Contains(&number));
  EXPECT_EQ(code.GetEncoder()->EncodeConst(&number), 0);
  const NumericValue second(-2.0);
  EXPECT_EQ(code.GetEncoder()->EncodeConst(&second), 1);
  const ScoreDictVar& epoch = *dictionary->GetVar("epoch");
  const DateTimeValue second_day(86400.0, kDateVal);
  EXPECT_TRUE(epoch.GetValueLabels()->Contains(&second_day));
}

TEST(Targets, TellTrailingBlanksApartWhereTheVariableDoes) {
  const auto dictionary = FieldsWith(Categories("exact", {"a", "a "}));
  EXPECT_EQ(dictionary->GetVar("exact")->GetEncoder()->GetNumberOfCategories(), 2);
  ExpectFault([] { FieldsWith(Categories("free", {"a", "a "})); }, 1, "free: Duplicated Category Value!");
}

TEST(Targets, LeaveNoVariableWithoutCategoriesThatHasSome) {
  EXPECT_TRUE(FieldsWith("")->GetVar("free")->IsEmptyCateValues());
  EXPECT_FALSE(FieldsWith(Categories("free", {"a"}))->GetVar("free")->IsEmptyCateValues());
}

TEST(Targets, WithoutValuesLeaveTheVariable) {
  for (const char* target :
       {"<Target field='class'/>", "<Target field='flag' optype='categorical'><Extension/></Target>",
        "<Target field='size' optype='ordinal' castInteger='round' rescaleFactor='3' min='0' max='1'/>",
        "<Target field='code'/>", "<Other field='nowhere'/>"}) {
    const auto dictionary = ReadDictionary(kFields);
    std::vector<const void*> before;
    std::vector<const void*> after;
    const auto note = [&](std::vector<const void*>& parts) {
      for (const ScoreDictVar* variable : dictionary->GetScoreDictVars()) {
        parts.push_back(variable->GetValueLabels());
        parts.push_back(variable->GetValueProbabilities());
        parts.push_back(variable->GetEncoder());
        parts.push_back(variable->GetDefValue());
      }
    };
    note(before);
    Read(target, dictionary.get());
    note(after);
    EXPECT_EQ(before, after) << target;
  }
}

TEST(Targets, KeepANumberThatTheDataFieldListsInsideAMissingInterval) {
  const auto dictionary = FieldsWith(Categories("code", {"150"}));
  const NumericValue inside(150.0);
  EXPECT_TRUE(dictionary->GetVar("code")->IsValidValue(&inside));
}

TEST(Targets, GiveAContinuousVariableItsDefault) {
  const auto dictionary = FieldsWith(
      "<Target field='x' optype='continuous' rescaleConstant='10'><Extension/>"
      "<TargetValue defaultValue=' 2.5'/><TargetValue defaultValue='7'/></Target>"
      "<Target field='day'><TargetValue defaultValue='2'/></Target>");
  const ScoreDictVar& number = *dictionary->GetVar("x");
  ASSERT_NE(number.GetDefValue(), nullptr);
  EXPECT_EQ(*number.GetDefValue(), NumericValue(2.5));
  EXPECT_EQ(number.GetValueProbabilities(), nullptr);
  const ScoreDictVar& day = *dictionary->GetVar("day");
  ASSERT_NE(day.GetDefValue(), nullptr);
  EXPECT_EQ(day.GetDefValue()->GetType(), ScoreValue::kDateTime);
  EXPECT_EQ(day.GetDefValue()->GetDouble(), 172800.0);
}

TEST(Targets, LeaveAContinuousVariableWithoutADefault) {
  for (const char* target :
       {"<Target field='x'/>", "<Target field='x'><TargetValue/></Target>",
        "<Target field='x'><TargetValue defaultValue=''/></Target>",
        "<Target field='x'><TargetValue value='1' priorProbability='7' displayValue='one'/></Target>",
        "<Target field='x'><TargetValue/><TargetValue defaultValue='7'/></Target>"}) {
    const auto dictionary = FieldsWith(target);
    EXPECT_EQ(dictionary->GetVar("x")->GetDefValue(), nullptr) << target;
    EXPECT_EQ(dictionary->GetVar("x")->GetValueLabels()->Size(), 0u) << target;
  }
}

/// The address checks find what is not deleted, or deleted twice.
TEST(Targets, ReplaceWhatTheVariableHad) {
  const auto dictionary = FieldsWith(
      "<Target field='x'><TargetValue defaultValue='1'/></Target>"
      "<Target field='x'><TargetValue defaultValue='2'/></Target>"
      "<Target field='class'><TargetValue value='a' priorProbability='1'/></Target>"
      "<Target field='class'><TargetValue value='b' priorProbability='0.5'/></Target>");
  EXPECT_EQ(dictionary->GetVar("x")->GetDefValue()->GetDouble(), 2.0);
  const ScoreDictVar& variable = *dictionary->GetVar("class");
  EXPECT_EQ(LabelledValues(variable), Texts{"b"});
  EXPECT_EQ(variable.GetEncoder()->GetNumberOfCategories(), 1);
  const StringValue a("a");
  const StringValue b("b");
  EXPECT_FALSE(variable.GetValueProbabilities()->Contains(&a));
  EXPECT_EQ(variable.GetValueProbabilities()->GetProbabilityOfValue(&b), 0.5);
}

TEST(Targets, MakeCategoriesOfAVariableThatAProgramMade) {
  BaseDictionary dictionary;
  auto made = std::make_unique<DictVar>("y", ScoreDictVar::kNUMERIC_VAR);
  made->SetMLevel(ScoreDictVar::kOrdinal);
  dictionary.AddVar("y", made.release());
  Read(Categories("y", {"2", "1"}), &dictionary);
  EXPECT_EQ(LabelledValues(*dictionary.GetVar("y")), (Texts{"2", "1"}));
  const NumericValue last(1.0);
  EXPECT_EQ(dictionary.GetVar("y")->GetEncoder()->EncodeConst(&last), 1);
}

TEST(Targets, TakeTheBoundsOfProbabilities) {
  const auto dictionary = FieldsWith(
      "<Target field='plain'><TargetValue value='a' priorProbability='0'/>"
      "<TargetValue value='b' priorProbability='1.0'/></Target>");
  const auto& priors = dictionary->GetVar("plain")->GetValueProbabilities()->GetAllValueProbabilities();
  ASSERT_EQ(priors.size(), 2u);
  EXPECT_EQ(priors[0]->GetProbability(), 0.0);
  EXPECT_EQ(priors[1]->GetProbability(), 1.0);
}

// ---- Faults

struct FaultRow {
  const char* why;
  const char* target;
  int code;
  const char* text;
};

const FaultRow kFaults[] = {
    {"no field", "<Target optype='x'/>", 4, "Attribute field is missing from Node \"Target\""},
    {"an empty field", "<Target field='' optype='x'/>", 1, "<Target>'s name can't be null string !!"},
    {"an unknown field", "<Target field='nowhere' optype='x'/>", 8,
     "nowhere: Invalid Field Name -- does not  in the dictionary"},
    {"names are case-sensitive", "<Target field='X'/>", 8,
     "X: Invalid Field Name -- does not  in the dictionary"},
    {"an unknown level", "<Target field='x' optype='nominal'/>", 11, "x: Invalid Variable Type"},
    {"an empty level", "<Target field='x' optype=''/>", 11, "x: Invalid Variable Type"},
    {"another level", "<Target field='x' optype='categorical'/>", 11,
     "x: Invalid Variable Type, does not match the variable type in data dictionary"},
    {"ordinal is not categorical", "<Target field='size' optype='categorical'/>", 11,
     "size: Invalid Variable Type, does not match the variable type in data dictionary"},
    {"categorical is not continuous", "<Target field='class' optype='continuous'/>", 11,
     "class: Invalid Variable Type, does not match the variable type in data dictionary"},
    {"a default that is no number", "<Target field='x'><TargetValue defaultValue='2,5'/></Target>", 3,
     "2,5Invalid double string -- "},
    {"a value without value", "<Target field='class'><TargetValue displayValue='Yes'/></Target>", 4,
     "Attribute value is missing from Node \"TargetValue\""},
    {"no number", "<Target field='code'><TargetValue value='one'/></Target>", 7, "code: invalid value!"},
    {"an empty number", "<Target field='code'><TargetValue value=''/></Target>", 7, "code: invalid value!"},
    {"no date", "<Target field='epoch'><TargetValue value='today'/></Target>", 7, "epoch: invalid value!"},
    {"a value twice", "<Target field='class'><TargetValue value='a'/><TargetValue value='a'/></Target>", 1,
     "class: Duplicated Category Value!"},
    {"a number twice", "<Target field='code'><TargetValue value='1'/><TargetValue value='1.0'/></Target>", 1,
     "code: Duplicated Category Value!"},
    {"a missing text", "<Target field='class'><TargetValue value='?'/></Target>", 12,
     "class: category value is defined as both valid and invalid/missing"},
    {"a missing number", "<Target field='code'><TargetValue value='9'/></Target>", 12,
     "code: category value is defined as both valid and invalid/missing"},
    {"a number in a missing interval", "<Target field='code'><TargetValue value='120'/></Target>", 12,
     "code: category value is defined as both valid and invalid/missing"},
    {"the missing number itself",
     "<Target field='code'><TargetValue value='-1.7976931348623157e308'/></Target>", 12,
     "code: category value is defined as both valid and invalid/missing"},
    {"a prior that is no number",
     "<Target field='class'><TargetValue value='a' priorProbability='half'/></Target>", 3,
     "class: invalid prior probability!"},
    {"an empty prior", "<Target field='class'><TargetValue value='a' priorProbability=''/></Target>", 3,
     "class: invalid prior probability!"},
    {"a prior above 1", "<Target field='class'><TargetValue value='a' priorProbability='1.01'/></Target>", 3,
     "class: invalid prior probability!"},
    {"a prior below 0", "<Target field='class'><TargetValue value='a' priorProbability='-0.5'/></Target>", 3,
     "class: invalid prior probability!"},
    {"an infinite prior", "<Target field='class'><TargetValue value='a' priorProbability='1e999'/></Target>",
     3, "class: invalid prior probability!"},
    {"a flag of one", "<Target field='flag'><TargetValue value='t'/></Target>", 12,
     "Flag variable has to have two categories!"},
    {"a flag of three",
     "<Target field='flag'><TargetValue value='t'/><TargetValue value='f'/><TargetValue value='u'/></Target>",
     12, "Flag variable has to have two categories!"},
};

TEST(Targets, RefuseWithCodeTextAndPlaceAndChangeNothing) {
  for (const FaultRow& row : kFaults) {
    const auto dictionary = ReadDictionary(kFields);
    std::ostringstream before;
    dictionary->Display(before);
    try {
      Read(std::string("\n") + row.target, dictionary.get());
      ADD_FAILURE() << row.why << ": nothing was thrown";
    } catch (const KestrelException& fault) {
      EXPECT_EQ(fault.GetErrorCode(), row.code) << row.why;
      EXPECT_EQ(fault.GetErrorMessage(), row.text) << row.why;
      EXPECT_EQ(fault.GetLine(), 3u) << row.why;
    }
    std::ostringstream after;
    dictionary->Display(after);
    EXPECT_EQ(before.str(), after.str()) << row.why;
    for (const ScoreDictVar* variable : dictionary->GetScoreDictVars()) {
      EXPECT_EQ(variable->GetValueProbabilities(), nullptr) << row.why;
      EXPECT_EQ(variable->GetDefValue(), nullptr) << row.why;
    }
    EXPECT_EQ(dictionary->GetVar("class")->GetEncoder()->EncodeConst(std::string("old")), 0) << row.why;
  }
}

/// A fault of a value is where the value is.
TEST(Targets, PointAtTheValueAtFault) {
  try {
    FieldsWith("<Target field='class'><TargetValue value='a'/>\n\n<TargetValue value='a'/></Target>");
    FAIL() << "nothing was thrown";
  } catch (const KestrelException& fault) {
    EXPECT_EQ(fault.GetLine(), 4u);
  }
}

TEST(Targets, AreReadInTheirOrderUpToTheFirstFault) {
  const auto dictionary = ReadDictionary(kFields);
  ExpectFault(
      [&] {
        Read(
            "<Target field='x'><TargetValue defaultValue='1'/></Target><Target field='nowhere'/>"
            "<Target field='day'><TargetValue defaultValue='1'/></Target>",
            dictionary.get());
      },
      8, "nowhere: Invalid Field Name -- does not  in the dictionary");
  EXPECT_NE(dictionary->GetVar("x")->GetDefValue(), nullptr);
  EXPECT_EQ(dictionary->GetVar("day")->GetDefValue(), nullptr);
}

TEST(Targets, TakeTwoCategoriesOfAFlag) {
  const auto dictionary = FieldsWith(Categories("flag", {"yes", "no"}));
  EXPECT_EQ(LabelledValues(*dictionary->GetVar("flag")), (Texts{"yes", "no"}));
}

TEST(Targets, NeedALevel) {
  BaseDictionary dictionary;
  auto made = std::make_unique<DictVar>("y", ScoreDictVar::kNUMERIC_VAR);
  made->SetMLevel(static_cast<ScoreDictVar::MeasureLevel>(3));
  dictionary.AddVar("y", made.release());
  ExpectFault([&] { Read("<Target field='y'/>", &dictionary); }, 1, "Invalid Variable Type!");
}

TEST(Targets, RefuseAValueOfATypeThatThereIsNot) {
  BaseDictionary dictionary;
  auto made = std::make_unique<DictVar>("y", static_cast<ScoreDictVar::VariableType>(2));
  made->SetMLevel(ScoreDictVar::kNominal);
  dictionary.AddVar("y", made.release());
  ExpectFault([&] { Read(Categories("y", {"1"}), &dictionary); }, 7, "y: invalid value!");
}

TEST(Targets, NeedADictionary) {
  PMMLTranslator::HandleTargets(nullptr, nullptr);
  const auto dictionary = ReadDictionary(kFields);
  PMMLTranslator::HandleTargets(nullptr, dictionary.get());
  ExpectFault([] { Read("", nullptr); }, 1, "<DataDictionary is required !!");
}

/// A reader whose time grew with the square would not end in reasonable time.
TEST(Targets, MayHaveAHundredThousandValues) {
  constexpr int kCount = 100000;
  for (const char* field : {"class", "exact", "code"}) {
    std::string target = "<Target field='" + std::string(field) + "'>";
    // Below the range that counts as missing.
    for (int i = 0; i < kCount; ++i) {
      target += "<TargetValue value='-" + std::to_string(i * 7919LL % kCount + 1) +
                "' priorProbability='0.00001'/>";
    }
    const auto dictionary = FieldsWith(target + "</Target>");
    const ScoreDictVar& variable = *dictionary->GetVar(field);
    EXPECT_EQ(variable.GetNumberOfCats(), kCount) << field;
    EXPECT_EQ(variable.GetEncoder()->GetNumberOfCategories(), kCount) << field;
    EXPECT_EQ(variable.GetValueProbabilities()->Size(), static_cast<size_t>(kCount)) << field;
  }
}

}  // namespace
