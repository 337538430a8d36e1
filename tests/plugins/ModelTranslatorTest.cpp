// The frame of every model element, read by a translator that builds no model of its own kind.

#include "plugins/support/ModelTranslator.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <utility>

#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/model/BaseModel.h"
#include "kestrel/model/Results.h"
#include "kestrel/model/ScoreVersionInfo.h"
#include "tests/plugins/ModelText.h"
#include "tests/support/ExpectFault.h"

namespace kestrel_tests {
namespace {

using namespace MCKestrel_800;

/// Keeps what its translator was told.
class FrameModel : public BaseModel {
 public:
  FrameModel(ModelFrame frame, ModelDictionaries dictionaries) : frame_(std::move(frame)) {
    dictionaries.GiveTo(*this);
  }

  MCScore::MCStatus Score(const ScoreCaseRecord*, ScoreResult*) override { return MCScore::MCStatus(); }
  std::vector<const ScoreDictVar*> GetPredictors() const override { return {}; }
  ScoreResult* MakeResult() const override { return new RegResult; }
  std::string GetModelKind() const override { return "FrameModel"; }
  bool SuppressCategoryProbabilities() const override { return false; }
  void Display(std::ostream&) const override {}

  const ModelFrame& GetFrame() const { return frame_; }

 private:
  ModelFrame frame_;
};

class FrameTranslator : public ModelTranslator {
 public:
  FrameTranslator() : ModelTranslator("FrameModel") {}

 protected:
  std::unique_ptr<ScoreModel> BuildModel(xercesc::DOMElement* element,
                                         ModelDictionaries dictionaries) override {
    ModelFrame frame = ReadFrame(element, dictionaries);
    return std::make_unique<FrameModel>(std::move(frame), std::move(dictionaries));
  }
};

std::string FrameOf(const std::string& attributes, const std::string& fields) {
  return "<FrameModel " + attributes + "><MiningSchema>" + fields + "</MiningSchema></FrameModel>";
}

std::unique_ptr<FrameModel> ReadRoot(const std::string& document) {
  const auto parsed = kestrel_test::ReadTree(document);
  FrameTranslator translator;
  return std::unique_ptr<FrameModel>(
      static_cast<FrameModel*>(translator.ParseFromTree(parsed->GetRoot(), std::string())));
}

const std::string kX = "<MiningField name='x'/>";
const std::string kTargetY = "<MiningField name='y' usageType='target'/>";
const std::string kTargetM = "<MiningField name='m' usageType='predicted'/>";

struct TargetRow {
  const char* why;
  const char* attributes;
  std::string fields;
  const char* target;
};

const TargetRow kTargets[] = {
    {"none", "functionName='regression'", kX, ""},
    {"of the schema", "functionName='regression'", kX + kTargetY, "y"},
    {"of the attribute", "functionName='classification' targetFieldName='m'", kX, "m"},
    {"chosen among several", "functionName='classification' targetFieldName='m'", kTargetY + kTargetM, "m"},
    {"the schema's wins when the attribute names no target", "functionName='regression' targetFieldName='x'",
     kX + kTargetY, "y"},
    {"an empty attribute", "functionName='regression' targetFieldName=''", kX + kTargetY, "y"},
    {"an attribute that is not needed may name anything", "functionName='regression' targetFieldName='none'",
     kX + kTargetY, "y"},
};

TEST(ModelTranslator, FindsTheTarget) {
  for (const TargetRow& row : kTargets) {
    const auto model = ReadRoot(DocumentOf(FrameOf(row.attributes, row.fields)));
    const ModelFrame& frame = model->GetFrame();
    EXPECT_EQ(frame.target, row.target) << row.why;
    EXPECT_EQ(frame.target_variable,
              row.target == std::string() ? nullptr : model->GetDictionary()->GetVar(row.target))
        << row.why;
  }
}

TEST(ModelTranslator, TellsTheFunction) {
  EXPECT_FALSE(ReadRoot(DocumentOf(FrameOf("functionName='regression'", kX)))->GetFrame().is_classification);
  EXPECT_TRUE(
      ReadRoot(DocumentOf(FrameOf("functionName='classification'", kX)))->GetFrame().is_classification);
}

TEST(ModelTranslator, KeepsTheDocumentsVersion) {
  const std::string model = FrameOf("functionName='regression' isScorable='true'", kX);
  EXPECT_EQ(ReadRoot(DocumentOf(model))->GetVersionInfo()->GetVersionInfo(), "4.4");
  const std::string document = "<PMML>" + kestrel_test::DictionaryOf(9, TestFields()) + model + "</PMML>";
  EXPECT_NE(ReadRoot(document)->GetVersionInfo(), nullptr);
}

struct RefusedRow {
  const char* why;
  std::string document;
  int code;
  const char* message;
};

std::vector<RefusedRow> RefusedRows() {
  const std::string regression = "functionName='regression'";
  return {
      {"no dictionary", "<PMML>" + FrameOf(regression, kX) + "</PMML>", 1, "<DataDictionary is required !!"},
      {"no model", DocumentOf("<OtherModel/>"), 4, "Node is missing --- FrameModel ---"},
      {"a model further down", DocumentOf("<Box>" + FrameOf(regression, kX) + "</Box>"), 4,
       "Node is missing --- FrameModel ---"},
      {"no mining schema", DocumentOf("<FrameModel " + regression + "/>"), 4,
       "Node is missing --- MiningSchema ---"},
      {"no function", DocumentOf(FrameOf("", kX)), 4,
       "Attribute functionName is missing from Node \"FrameModel\""},
      {"another function", DocumentOf(FrameOf("functionName='timeSeries'", kX)), 5,
       "functionName -- timeSeries: Not supported!"},
      {"an empty function", DocumentOf(FrameOf("functionName=''", kX)), 5,
       "functionName -- : Not supported!"},
      {"not scorable", DocumentOf(FrameOf(regression + " isScorable='false'", kX)), 5,
       "FrameModel is marked as not scorable!"},
      {"several targets", DocumentOf(FrameOf("functionName='classification'", kTargetY + kTargetM)), 1,
       "FrameModel has more than one target!"},
      {"several targets, and none of them chosen",
       DocumentOf(FrameOf("functionName='classification' targetFieldName='x'", kX + kTargetY + kTargetM)), 1,
       "FrameModel has more than one target!"},
      {"a target that is no field", DocumentOf(FrameOf(regression + " targetFieldName='none'", kX)), 8,
       "Variable none not in the dictionary!"},
      {"a text as the target of a regression", DocumentOf(FrameOf(regression, kX + kTargetM)), 11,
       "m: Invalid Variable Type"},
  };
}

TEST(ModelTranslator, RefusesWhatIsNoFrame) {
  for (const RefusedRow& row : RefusedRows())
    ExpectFault([&] { ReadRoot(row.document); }, row.code, row.message, row.why);
}

TEST(ModelTranslator, CopiesTheDictionariesOfAHost) {
  const auto parsed = kestrel_test::ReadTree(FrameOf("functionName='regression'", kX + kTargetY));
  const auto dictionary = kestrel_test::ReadDictionary(kestrel_test::DictionaryOf(9, TestFields()));
  FrameTranslator translator;
  const std::unique_ptr<ScoreModel> model(
      translator.ParseFromTree(parsed->GetRoot(), dictionary.get(), dictionary.get(), std::string()));
  EXPECT_NE(model->GetDictionary(), dictionary.get());
  EXPECT_NE(model->GetDictionary()->GetVar("x"), nullptr);
  EXPECT_NE(model->GetResultDictionary(), nullptr);
  EXPECT_NE(model->GetResultDictionary(), dictionary.get());
  const std::unique_ptr<ScoreModel> without(
      translator.ParseFromTree(parsed->GetRoot(), dictionary.get(), nullptr, std::string()));
  EXPECT_EQ(without->GetResultDictionary(), nullptr);
  ExpectFault([&] { translator.ParseFromTree(parsed->GetRoot(), nullptr, nullptr, std::string()); }, 1,
              "<DataDictionary is required !!");
}

}  // namespace
}  // namespace kestrel_tests
