// Computes the derived fields of every example that has nothing else, and compares with what plain Python
// made of the same data.

#include <gtest/gtest.h>

#include <fstream>
#include <memory>
#include <string>
#include <vector>

#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/model/ModelFactory.h"
#include "kestrel/transform/TransformationDictionary.h"
#include "tests/examples/ExampleFolders.h"
#include "tests/support/PlainTable.h"

namespace kestrel_tests {
namespace {

using namespace MCKestrel_800;

class EveryDerivedExample : public testing::TestWithParam<std::string> {
 protected:
  void SetUp() override {
    std::ifstream document(ExamplePath(GetParam(), "model.xml"), std::ios::binary);
    ASSERT_TRUE(document.is_open());
    ScoreDictionary* dictionary = nullptr;
    derived_.reset(ModelFactory::GetTransformationDictionaryFromXML(document, dictionary, std::string()));
    dictionary_.reset(dictionary);
    derived_->SetUpDerivedCaseRecord();
    data_ = ReadPlainTable(ExamplePath(GetParam(), "data.csv"));
    expected_ = ReadPlainTable(ExamplePath(GetParam(), "derived.csv"));
    ASSERT_FALSE(expected_.rows.empty());
    ASSERT_EQ(data_.rows.size(), expected_.rows.size());
  }

  /// An empty cell is a missing number or date/time, and no text at all.
  static ScoreValue* MakeValue(const ScoreDictVar& variable, const std::string& cell) {
    if (variable.GetVarType() == ScoreDictVar::kDATETIME_VAR) {
      return new DateTimeValue(cell, variable.GetDateTimeType());
    }
    if (cell.empty() && variable.GetVarType() == ScoreDictVar::STRING_VAR) return nullptr;
    return variable.ToMyValue(cell);
  }

  CaseRecord MakeRecord(const std::vector<std::string>& cells) const {
    CaseRecord record(static_cast<int>(cells.size()));
    for (size_t i = 0; i < cells.size(); ++i)
      record.Add(data_.header[i], MakeValue(*dictionary_->GetVar(data_.header[i]), cells[i]));
    return record;
  }

  std::unique_ptr<ScoreDictionary> dictionary_;
  std::unique_ptr<TransformationDictionary> derived_;
  PlainTable data_;
  PlainTable expected_;
};

TEST_P(EveryDerivedExample, IsWhatPythonMakesOfTheData) {
  ASSERT_EQ(derived_->GetDerivedVarNames(), expected_.header);
  for (size_t row = 0; row < data_.rows.size(); ++row) {
    const CaseRecord record = MakeRecord(data_.rows[row]);
    const CaseRecord& values = *derived_->GetValuesForDerivedVars(&record, dictionary_.get());
    for (size_t column = 0; column < expected_.header.size(); ++column) {
      SCOPED_TRACE("case " + std::to_string(row + 1) + ", " + expected_.header[column]);
      const ScoreValue& value = *values.Get(expected_.header[column]);
      const std::string& wanted = expected_.rows[row][column];
      if (wanted.empty()) {
        EXPECT_TRUE(value.IsSystemMissingValue() || value.GetString().empty()) << value.GetString();
      } else if (value.GetType() == ScoreValue::kNumeric) {
        EXPECT_PRED2(AgreesWith, std::stod(wanted), value.GetDouble());
      } else {
        EXPECT_EQ(value.GetString(), wanted);
      }
    }
  }
}

INSTANTIATE_TEST_SUITE_P(Examples, EveryDerivedExample, testing::ValuesIn(DerivedExampleFolders()),
                         [](const auto& example) { return TestNameOf(example.param); });

}  // namespace
}  // namespace kestrel_tests
