// The order of the virtual operations that model libraries and hosts are built against.

#include <gtest/gtest.h>

#include <string>
#include <xercesc/dom/DOMElement.hpp>

#include "kestrel/model/BaseModel.h"
#include "kestrel/model/ScoreClsResult.h"
#include "kestrel/model/ScoreRegResult.h"
#include "kestrel/model/ScoreVersionInfo.h"
#include "kestrel/translate/BaseTranslator.h"
#include "tests/support/OperationNumber.h"

#if defined(__x86_64__)

namespace {

using kestrel_tests::OperationNumber;
using namespace MCKestrel_800;
using std::string;

TEST(OperationOrder, OfTranslators) {
  using xercesc::DOMElement;
  using Elements = ScoreModel* (ScoreTranslator::*)(DOMElement*, DOMElement*, const string&);
  using Dictionaries =
      ScoreModel* (ScoreTranslator::*)(DOMElement*, ScoreDictionary*, ScoreDictionary*, const string&);
  using File = ScoreModel* (ScoreTranslator::*)(const string&, const string&);
  using Stream = ScoreModel* (ScoreTranslator::*)(std::istream&, const string&);
  using Root = ScoreModel* (ScoreTranslator::*)(DOMElement*, const string&);
  using Two = ScoreModel* (BaseTranslator::*)(std::istream&, const string&, const string&);
  EXPECT_EQ(OperationNumber(static_cast<Elements>(&ScoreTranslator::ParseFromTree)), 1);
  EXPECT_EQ(OperationNumber(static_cast<Dictionaries>(&ScoreTranslator::ParseFromTree)), 2);
  EXPECT_EQ(OperationNumber(static_cast<File>(&ScoreTranslator::ParseFromTree)), 3);
  EXPECT_EQ(OperationNumber(static_cast<Stream>(&ScoreTranslator::ParseFromTree)), 4);
  EXPECT_EQ(OperationNumber(static_cast<Root>(&ScoreTranslator::ParseFromTree)), 5);
  EXPECT_EQ(OperationNumber(static_cast<Two>(&BaseTranslator::ParseFromTree)), 6);
}

template <typename Model>
void ExpectTheOrderOfModels() {
  using SetByName = bool (Model::*)(const string&, ScoreModel::VarRole);
  using SetByVariable = bool (Model::*)(const ScoreDictVar*, ScoreModel::VarRole);
  using GetByName = int (Model::*)(const string&) const;
  using GetByVariable = int (Model::*)(const ScoreDictVar*) const;
  EXPECT_EQ(OperationNumber(&Model::SetScoreDictionary), 1);
  EXPECT_EQ(OperationNumber(&Model::SetTransformationScoreDictionary), 2);
  EXPECT_EQ(OperationNumber(&Model::SetResultScoreDictionary), 3);
  EXPECT_EQ(OperationNumber(static_cast<SetByName>(&Model::SetVarRole)), 4);
  EXPECT_EQ(OperationNumber(static_cast<SetByVariable>(&Model::SetVarRole)), 5);
  EXPECT_EQ(OperationNumber(&Model::SetMissingValuePolicy), 6);
  EXPECT_EQ(OperationNumber(&Model::SetVersionInfo), 7);
  EXPECT_EQ(OperationNumber(&Model::Score), 8);
  EXPECT_EQ(OperationNumber(static_cast<GetByName>(&Model::GetVarRole)), 9);
  EXPECT_EQ(OperationNumber(static_cast<GetByVariable>(&Model::GetVarRole)), 10);
  EXPECT_EQ(OperationNumber(&Model::GetVersionInfo), 11);
  EXPECT_EQ(OperationNumber(&Model::GetPredictors), 12);
  EXPECT_EQ(OperationNumber(&Model::GetTargetVar), 13);
  EXPECT_EQ(OperationNumber(&Model::GetDictionary), 14);
  EXPECT_EQ(OperationNumber(&Model::GetTransformationDictionary), 15);
  EXPECT_EQ(OperationNumber(&Model::GetResultDictionary), 16);
  EXPECT_EQ(OperationNumber(&Model::MakeResult), 17);
  EXPECT_EQ(OperationNumber(&Model::GetMissingValuePolicy), 18);
  EXPECT_EQ(OperationNumber(&Model::GetModelKind), 19);
  EXPECT_EQ(OperationNumber(&Model::SuppressCategoryProbabilities), 20);
  EXPECT_EQ(OperationNumber(&Model::Display), 21);
}

TEST(OperationOrder, OfModels) {
  ExpectTheOrderOfModels<ScoreModel>();
  ExpectTheOrderOfModels<BaseModel>();
}

TEST(OperationOrder, OfResults) {
  EXPECT_EQ(OperationNumber(&ScoreResult::SetPrediction), 1);
  EXPECT_EQ(OperationNumber(&ScoreResult::GetPrediction), 2);
  EXPECT_EQ(OperationNumber(&ScoreResult::Reset), 3);
  EXPECT_EQ(OperationNumber(&ScoreResult::SetProbability), 4);
  EXPECT_EQ(OperationNumber(&ScoreResult::GetProbability), 5);
  EXPECT_EQ(OperationNumber(&ScoreResult::GetResultKind), 6);
  EXPECT_EQ(OperationNumber(&ScoreClsResult::AddCategoryProbability), 7);
  EXPECT_EQ(OperationNumber(&ScoreClsResult::GetCategoryProbability), 8);
  EXPECT_EQ(OperationNumber(&ScoreClsResult::GetCategoryCount), 9);
  EXPECT_EQ(OperationNumber(&ScoreRegResult::SetStandardError), 7);
  EXPECT_EQ(OperationNumber(&ScoreRegResult::GetStandardError), 8);
}

TEST(OperationOrder, OfVersions) {
  EXPECT_EQ(OperationNumber(&ScoreVersionInfo::SetVersionInfo), 1);
  EXPECT_EQ(OperationNumber(&ScoreVersionInfo::Clone), 2);
  EXPECT_EQ(OperationNumber(&ScoreVersionInfo::operator==), 3);
  EXPECT_EQ(OperationNumber(&ScoreVersionInfo::GetVersionInfo), 4);
}

}  // namespace

#endif
