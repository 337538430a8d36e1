// The order of the virtual operations that model libraries and hosts are built against.

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "kestrel/dictionary/ScoreCaseRecord.h"
#include "kestrel/dictionary/ScoreDictionary.h"
#include "tests/support/OperationNumber.h"

#if defined(__x86_64__)

namespace {

using kestrel_tests::InOrder;
using kestrel_tests::OperationNumber;
using namespace MCKestrel_800;
using std::string;

TEST(OperationOrder, OfVariables) {
  using Encoder = ScoreEncoder* (ScoreDictVar::*)();
  using ConstEncoder = const ScoreEncoder* (ScoreDictVar::*)() const;
  const std::vector<long> numbers = {
      OperationNumber(&ScoreDictVar::Clone),
      OperationNumber(&ScoreDictVar::operator==),
      OperationNumber(&ScoreDictVar::IsMissingValue),
      OperationNumber(&ScoreDictVar::IsValidValue),
      OperationNumber(&ScoreDictVar::SetName),
      OperationNumber(&ScoreDictVar::SetLabel),
      OperationNumber(&ScoreDictVar::SetVarType),
      OperationNumber(&ScoreDictVar::SetMLevel),
      OperationNumber(&ScoreDictVar::SetFormat),
      OperationNumber(&ScoreDictVar::SetDecimal),
      OperationNumber(&ScoreDictVar::SetWidth),
      OperationNumber(&ScoreDictVar::GetName),
      OperationNumber(&ScoreDictVar::GetLabel),
      OperationNumber(&ScoreDictVar::GetVarType),
      OperationNumber(&ScoreDictVar::GetMLevel),
      OperationNumber(&ScoreDictVar::GetDecimal),
      OperationNumber(&ScoreDictVar::GetWidth),
      OperationNumber(&ScoreDictVar::GetVarStats),
      OperationNumber(&ScoreDictVar::SetVarStats),
      OperationNumber(&ScoreDictVar::GetValueLabels),
      OperationNumber(&ScoreDictVar::GetLabelOfValue),
      OperationNumber(&ScoreDictVar::GetMissingValues),
      OperationNumber(&ScoreDictVar::SetMissingValues),
      OperationNumber(&ScoreDictVar::SetValueLabels),
      OperationNumber(&ScoreDictVar::ToMyValue),
      OperationNumber(&ScoreDictVar::Display),
      OperationNumber(&ScoreDictVar::GetNumberOfCats),
      OperationNumber(&ScoreDictVar::SetValueIndex),
      OperationNumber(&ScoreDictVar::SetEncodedValueIndex),
      OperationNumber(&ScoreDictVar::GetValueIndex),
      OperationNumber(&ScoreDictVar::GetEncodedValueIndex),
      OperationNumber(&ScoreDictVar::SetNoSpaceTrim),
      OperationNumber(&ScoreDictVar::GetNoSpaceTrim),
      OperationNumber(&ScoreDictVar::SetEmptyStringOK),
      OperationNumber(&ScoreDictVar::GetEmptyStringOK),
      OperationNumber(&ScoreDictVar::GetXMeasure),
      OperationNumber(&ScoreDictVar::SetXMeasure),
      OperationNumber(&ScoreDictVar::SetFlagVariable),
      OperationNumber(&ScoreDictVar::IsFlagVariable),
      OperationNumber(&ScoreDictVar::SetOutlierHandleMethod),
      OperationNumber(&ScoreDictVar::GetOutlierHandleMethod),
      OperationNumber(&ScoreDictVar::IsDerivedVariable),
      OperationNumber(&ScoreDictVar::SetDateTimeType),
      OperationNumber(&ScoreDictVar::GetDateTimeType),
      OperationNumber(&ScoreDictVar::SetDefValue),
      OperationNumber(&ScoreDictVar::GetDefValue),
      OperationNumber(&ScoreDictVar::SetValueProbabilities),
      OperationNumber(&ScoreDictVar::GetValueProbabilities),
      OperationNumber(static_cast<Encoder>(&ScoreDictVar::GetEncoder)),
      OperationNumber(static_cast<ConstEncoder>(&ScoreDictVar::GetEncoder)),
      OperationNumber(&ScoreDictVar::SetEncoder),
      OperationNumber(&ScoreDictVar::SetEmptyCateValues),
      OperationNumber(&ScoreDictVar::IsEmptyCateValues),
      OperationNumber(&ScoreDictVar::AddScoreValueLabel),
      OperationNumber(&ScoreDictVar::SetNumericDataType),
      OperationNumber(&ScoreDictVar::GetNumericDataType),
      OperationNumber(&ScoreDictVar::IsUsageTypeEnable),
      OperationNumber(&ScoreDictVar::SetUsageType),
      OperationNumber(&ScoreDictVar::SetFalgTypeTrueValue),
  };
  EXPECT_EQ(numbers, InOrder(numbers.size()));
}

TEST(OperationOrder, OfValueLabels) {
  const std::vector<long> numbers = {
      OperationNumber(&ScoreValueLabel::SetValueLabel), OperationNumber(&ScoreValueLabel::SetLabel),
      OperationNumber(&ScoreValueLabel::Clone),         OperationNumber(&ScoreValueLabel::operator==),
      OperationNumber(&ScoreValueLabel::operator>),     OperationNumber(&ScoreValueLabel::operator<),
      OperationNumber(&ScoreValueLabel::operator<=),    OperationNumber(&ScoreValueLabel::operator>=),
      OperationNumber(&ScoreValueLabel::GetLabel),      OperationNumber(&ScoreValueLabel::GetValue),
      OperationNumber(&ScoreValueLabel::Display),
  };
  EXPECT_EQ(numbers, InOrder(numbers.size()));
}

TEST(OperationOrder, OfValueLabelSets) {
  const std::vector<long> numbers = {
      OperationNumber(&ScoreValueLabelSet::Clone),
      OperationNumber(&ScoreValueLabelSet::Add),
      OperationNumber(&ScoreValueLabelSet::Remove),
      OperationNumber(&ScoreValueLabelSet::Size),
      OperationNumber(&ScoreValueLabelSet::GetAllValueLabels),
      OperationNumber(&ScoreValueLabelSet::GetLabelOfValue),
      OperationNumber(&ScoreValueLabelSet::Contains),
      OperationNumber(&ScoreValueLabelSet::Display),
  };
  EXPECT_EQ(numbers, InOrder(numbers.size()));
}

TEST(OperationOrder, OfMissingValueSets) {
  const std::vector<long> numbers = {
      OperationNumber(&ScoreMissingValueSet::Clone),
      OperationNumber(&ScoreMissingValueSet::Add),
      OperationNumber(&ScoreMissingValueSet::Remove),
      OperationNumber(&ScoreMissingValueSet::Size),
      OperationNumber(&ScoreMissingValueSet::Contains),
      OperationNumber(&ScoreMissingValueSet::GetMissingValues),
      OperationNumber(&ScoreMissingValueSet::Display),
  };
  EXPECT_EQ(numbers, InOrder(numbers.size()));
}

TEST(OperationOrder, OfStatistics) {
  const std::vector<long> numbers = {
      OperationNumber(&ScoreVarStats::Clone),
      OperationNumber(&ScoreVarStats::SetMin),
      OperationNumber(&ScoreVarStats::SetMax),
      OperationNumber(&ScoreVarStats::SetStddev),
      OperationNumber(&ScoreVarStats::SetMean),
      OperationNumber(&ScoreVarStats::SetMissingReplacement),
      OperationNumber(&ScoreVarStats::GetMin),
      OperationNumber(&ScoreVarStats::GetMax),
      OperationNumber(&ScoreVarStats::GetStddev),
      OperationNumber(&ScoreVarStats::GetMean),
      OperationNumber(&ScoreVarStats::GetMissingReplacement),
  };
  EXPECT_EQ(numbers, InOrder(numbers.size()));
}

TEST(OperationOrder, OfValueProbabilities) {
  const std::vector<long> numbers = {
      OperationNumber(&ScoreValueProbability::SetValueProbability),
      OperationNumber(&ScoreValueProbability::SetProbability),
      OperationNumber(&ScoreValueProbability::Clone),
      OperationNumber(&ScoreValueProbability::operator==),
      OperationNumber(&ScoreValueProbability::operator>),
      OperationNumber(&ScoreValueProbability::operator<),
      OperationNumber(&ScoreValueProbability::operator<=),
      OperationNumber(&ScoreValueProbability::operator>=),
      OperationNumber(&ScoreValueProbability::GetProbability),
      OperationNumber(&ScoreValueProbability::GetValue),
      OperationNumber(&ScoreValueProbability::Display),
  };
  EXPECT_EQ(numbers, InOrder(numbers.size()));
}

TEST(OperationOrder, OfValueProbabilitySets) {
  const std::vector<long> numbers = {
      OperationNumber(&ScoreValueProbabilitySet::Clone),
      OperationNumber(&ScoreValueProbabilitySet::Add),
      OperationNumber(&ScoreValueProbabilitySet::Remove),
      OperationNumber(&ScoreValueProbabilitySet::Size),
      OperationNumber(&ScoreValueProbabilitySet::GetAllValueProbabilities),
      OperationNumber(&ScoreValueProbabilitySet::GetProbabilityOfValue),
      OperationNumber(&ScoreValueProbabilitySet::Contains),
      OperationNumber(&ScoreValueProbabilitySet::Display),
  };
  EXPECT_EQ(numbers, InOrder(numbers.size()));
}

TEST(OperationOrder, OfDictionaries) {
  using Merge = bool (ScoreDictionary::*)(const ScoreDictionary*);
  using One = bool (ScoreDictionary::*)(const string&, ScoreDictVar*);
  using Get = ScoreDictVar* (ScoreDictionary::*)(const string&);
  using ConstGet = const ScoreDictVar* (ScoreDictionary::*)(const string&) const;
  const std::vector<long> numbers = {
      OperationNumber(&ScoreDictionary::Clone),
      OperationNumber(static_cast<Merge>(&ScoreDictionary::AddVar)),
      OperationNumber(static_cast<One>(&ScoreDictionary::AddVar)),
      OperationNumber(&ScoreDictionary::RemoveVar),
      OperationNumber(static_cast<Get>(&ScoreDictionary::GetVar)),
      OperationNumber(static_cast<ConstGet>(&ScoreDictionary::GetVar)),
      OperationNumber(&ScoreDictionary::Size),
      OperationNumber(&ScoreDictionary::GetScoreDictVars),
      OperationNumber(&ScoreDictionary::GetVarNames),
      OperationNumber(&ScoreDictionary::Display),
  };
  EXPECT_EQ(numbers, InOrder(numbers.size()));
}

TEST(OperationOrder, OfCaseRecords) {
  using Record = ScoreCaseRecord;
  using TextAt = bool (Record::*)(int, const string&);
  using TextUnder = bool (Record::*)(const string&, const string&);
  using DateAt = bool (Record::*)(int, double, DateTimeType);
  using DateUnder = bool (Record::*)(const string&, double, DateTimeType);
  using NumberAt = bool (Record::*)(int, double);
  using NumberUnder = bool (Record::*)(const string&, double);
  using MissingAt = bool (Record::*)(int);
  using MissingUnder = bool (Record::*)(const string&);
  using At = const ScoreValue* (Record::*)(int) const;
  using Under = const ScoreValue* (Record::*)(const string&) const;
  using Names = void (Record::*)(const std::vector<string>&);
  using Vars = void (Record::*)(const std::vector<ScoreDictVar*>&);
  const std::vector<long> numbers = {
      OperationNumber(&Record::Add),
      OperationNumber(static_cast<TextAt>(&Record::SetValue)),
      OperationNumber(static_cast<TextUnder>(&Record::SetValue)),
      OperationNumber(static_cast<DateAt>(&Record::SetValue)),
      OperationNumber(static_cast<DateUnder>(&Record::SetValue)),
      OperationNumber(static_cast<NumberAt>(&Record::SetValue)),
      OperationNumber(static_cast<NumberUnder>(&Record::SetValue)),
      OperationNumber(static_cast<MissingAt>(&Record::SetMissingValue)),
      OperationNumber(static_cast<MissingUnder>(&Record::SetMissingValue)),
      OperationNumber(&Record::Remove),
      OperationNumber(static_cast<At>(&Record::Get)),
      OperationNumber(static_cast<Under>(&Record::Get)),
      OperationNumber(static_cast<Names>(&Record::SetUpNameIndexMap)),
      OperationNumber(static_cast<Vars>(&Record::SetUpNameIndexMap)),
      OperationNumber(&Record::HasMap),
      OperationNumber(&Record::GetIndex),
      OperationNumber(&Record::Size),
      OperationNumber(&Record::GetVarNames),
      OperationNumber(&Record::GetAllValues),
      OperationNumber(&Record::Display),
      OperationNumber(&Record::GetLayoutStamp),
  };
  EXPECT_EQ(numbers, InOrder(numbers.size()));
}

TEST(OperationOrder, OfEncoders) {
  using Value = int (ScoreEncoder::*)(const ScoreValue*);
  using Text = int (ScoreEncoder::*)(const string&);
  using ConstText = int (ScoreEncoder::*)(const string&) const;
  using ConstValue = int (ScoreEncoder::*)(const ScoreValue*) const;
  const std::vector<long> numbers = {
      OperationNumber(&ScoreEncoder::GetEncoderType),
      OperationNumber(&ScoreEncoder::GetNumberOfCategories),
      OperationNumber(static_cast<Value>(&ScoreEncoder::Encode)),
      OperationNumber(static_cast<Text>(&ScoreEncoder::Encode)),
      OperationNumber(static_cast<ConstText>(&ScoreEncoder::EncodeConst)),
      OperationNumber(static_cast<ConstValue>(&ScoreEncoder::EncodeConst)),
      OperationNumber(&ScoreEncoder::Decode),
      OperationNumber(&ScoreEncoder::DecodeNum),
      OperationNumber(&ScoreEncoder::Clone),
      OperationNumber(&ScoreEncoder::SetValueLabels),
      OperationNumber(&ScoreEncoder::SetValueLabel),
      OperationNumber(&ScoreEncoder::GetValueLabels),
      OperationNumber(&ScoreEncoder::Display),
  };
  EXPECT_EQ(numbers, InOrder(numbers.size()));
}

}  // namespace

#endif
