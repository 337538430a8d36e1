// An example's model with its data and its training program's answers, ready to be scored through the
// library.

#ifndef KESTREL_TESTS_EXAMPLES_LOADEDEXAMPLE_H
#define KESTREL_TESTS_EXAMPLES_LOADEDEXAMPLE_H

#include <gtest/gtest.h>

#include <fstream>
#include <memory>
#include <string>
#include <vector>

#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/model/ModelFactory.h"
#include "kestrel/model/ScoreModel.h"
#include "tests/examples/ExampleFolders.h"
#include "tests/support/PlainTable.h"

namespace kestrel_tests {

/// The parameter is the example's folder.
class LoadedExample : public testing::TestWithParam<std::string> {
 protected:
  /// answers  the table in the folder that holds what is to come out
  void Load(const char* answers) {
    std::ifstream document(ExamplePath(GetParam(), "model.xml"), std::ios::binary);
    ASSERT_TRUE(document.is_open());
    model_.reset(MCKestrel_800::ModelFactory::MakeModelFromXML(document, ExampleKinds(), std::string()));
    ASSERT_NE(model_, nullptr);
    data_ = ReadPlainTable(ExamplePath(GetParam(), "data.csv"));
    expected_ = ReadPlainTable(ExamplePath(GetParam(), answers));
    ASSERT_FALSE(expected_.rows.empty());
    ASSERT_EQ(data_.rows.size(), expected_.rows.size());
  }

  /// A record of a row's cells, with or without the target's; an empty cell is a missing value.
  std::unique_ptr<MCKestrel_800::CaseRecord> MakeRecord(const std::vector<std::string>& cells,
                                                        bool has_target) const {
    auto record = std::make_unique<MCKestrel_800::CaseRecord>(static_cast<int>(cells.size()));
    for (size_t i = 0; i < cells.size(); ++i) {
      const MCKestrel_800::ScoreDictVar* var = model_->GetDictionary()->GetVar(data_.header[i]);
      EXPECT_NE(var, nullptr) << data_.header[i];
      if (var == nullptr) continue;
      if (!has_target && model_->GetVarRole(var) == MCKestrel_800::ScoreModel::kTarget) continue;
      record->Add(data_.header[i], var->ToMyValue(cells[i]));
      if (cells[i].empty()) record->SetMissingValue(data_.header[i]);
    }
    return record;
  }

  std::unique_ptr<MCKestrel_800::ScoreModel> model_;
  PlainTable data_;
  PlainTable expected_;
};

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_EXAMPLES_LOADEDEXAMPLE_H
