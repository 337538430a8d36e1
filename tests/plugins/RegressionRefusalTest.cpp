#include <gtest/gtest.h>

#include <string>

#include "tests/plugins/ModelText.h"
#include "tests/support/ExpectFault.h"

namespace {

using namespace MCKestrel_800;
using kestrel_tests::BuildModel;
using kestrel_tests::DocumentOf;
using kestrel_tests::ExpectFault;
using kestrel_tests::ModelOf;

const char kRegression[] = "functionName='regression'";

std::string Classification(const std::string& method) {
  return "functionName='classification' normalizationMethod='" + method + "'";
}

std::string Tables(const std::string& categories) {
  std::string tables;
  for (size_t start = 0; start < categories.size();) {
    size_t end = categories.find(' ', start);
    if (end == std::string::npos) end = categories.size();
    tables += "<RegressionTable targetCategory='" + categories.substr(start, end - start) +
              "' intercept='1'><NumericPredictor name='x' coefficient='1'/></RegressionTable>";
    start = end + 1;
  }
  return tables;
}

struct TermRow {
  const char* why;
  const char* terms;
  int code;
  const char* message;
};

const TermRow kTermRows[] = {
    {"unknown predictor", "<NumericPredictor name='w' coefficient='1'/>", 8,
     "Variable w not among the active fields of the MiningSchema!"},
    {"a target is no predictor", "<NumericPredictor name='y' coefficient='1'/>", 8,
     "Variable y not among the active fields of the MiningSchema!"},
    {"unknown category field", "<CategoricalPredictor name='k' value='yes' coefficient='1'/>", 8,
     "Variable k not among the active fields of the MiningSchema!"},
    {"unknown factor", "<PredictorTerm coefficient='1'><FieldRef field='derived'/></PredictorTerm>", 8,
     "Variable derived not among the active fields of the MiningSchema!"},
    {"no name", "<NumericPredictor coefficient='1'/>", 4,
     "Attribute name is missing from Node \"NumericPredictor\""},
    {"empty name", "<NumericPredictor name='' coefficient='1'/>", 1,
     "<NumericPredictor>'s name can't be null string !!"},
    {"empty field", "<PredictorTerm coefficient='1'><FieldRef field=''/></PredictorTerm>", 1,
     "<FieldRef>'s field can't be null string !!"},
    {"no field", "<PredictorTerm coefficient='1'><FieldRef/></PredictorTerm>", 4,
     "Attribute field is missing from Node \"FieldRef\""},
    {"no coefficient", "<NumericPredictor name='x'/>", 4,
     "Attribute coefficient is missing from Node \"NumericPredictor\""},
    {"no coefficient of a category", "<CategoricalPredictor name='g' value='a'/>", 4,
     "Attribute coefficient is missing from Node \"CategoricalPredictor\""},
    {"no coefficient of a product", "<PredictorTerm><FieldRef field='x'/></PredictorTerm>", 4,
     "Attribute coefficient is missing from Node \"PredictorTerm\""},
    {"coefficient that is no number", "<NumericPredictor name='x' coefficient='1,5'/>", 3,
     "1,5Invalid double string -- "},
    {"empty coefficient", "<NumericPredictor name='x' coefficient=''/>", 3, "Invalid double string -- "},
    {"exponent that is no number", "<NumericPredictor name='x' exponent='two' coefficient='1'/>", 3,
     "twoInvalid double string -- "},
    {"mapMissingTo that is no number",
     "<PredictorTerm coefficient='1'><FieldRef field='x' mapMissingTo='q'/>"
     "</PredictorTerm>",
     3, "qInvalid double string -- "},
    {"no value", "<CategoricalPredictor name='g' coefficient='1'/>", 4,
     "Attribute value is missing from Node \"CategoricalPredictor\""},
    {"a value that the field does not list", "<CategoricalPredictor name='g' value='z' coefficient='1'/>", 7,
     "g: invalid value!"},
    {"a value of a coded field that is no number",
     "<CategoricalPredictor name='n' value='one' coefficient='1'/>", 7, "n: invalid value!"},
    {"a text as number", "<NumericPredictor name='g' coefficient='1'/>", 11, "g: Invalid Variable Type"},
    {"a text as factor", "<PredictorTerm coefficient='1'><FieldRef field='t'/></PredictorTerm>", 11,
     "t: Invalid Variable Type"},
    {"a product of nothing", "<PredictorTerm coefficient='1'/>", 1,
     "<FieldRef> is required in <PredictorTerm>!!"},
    {"another element in a product", "<PredictorTerm coefficient='1'><Constant/></PredictorTerm>", 1,
     "Constant: Invalid element!"},
    {"another element in a table", "<Predictor name='x'/>", 1, "Predictor: Invalid element!"},
};

TEST(RegressionRefusals, PredictorsAndTables) {
  for (const auto& row : kTermRows) {
    const std::string table = std::string("<RegressionTable>") + row.terms + "</RegressionTable>";
    ExpectFault([&] { BuildModel(DocumentOf(ModelOf(kRegression, "y", table))); }, row.code, row.message,
                row.why);
  }
}

const std::string kTable = "<RegressionTable intercept='1'/>";

struct ModelRow {
  const char* why;
  std::string model;
  int code;
  const char* message;
};

const ModelRow kModelRows[] = {
    {"no function", ModelOf("", "y", kTable), 4,
     "Attribute functionName is missing from Node \"RegressionModel\""},
    {"another function", ModelOf("functionName='clustering'", "y", kTable), 5,
     "functionName -- clustering: Not supported!"},
    {"unknown normalisation", ModelOf("functionName='regression' normalizationMethod='log'", "y", kTable), 6,
     "invalid normalizationMethod -- log"},
    {"not scorable", ModelOf("functionName='regression' isScorable='false'", "y", kTable), 5,
     "RegressionModel is marked as not scorable!"},
    {"no schema", "<RegressionModel functionName='regression'>" + kTable + "</RegressionModel>", 4,
     "Node is missing --- MiningSchema ---"},
    {"no table", ModelOf(kRegression, "y", ""), 4, "Node is missing --- RegressionTable ---"},
    {"two tables", ModelOf(kRegression, "y", kTable + kTable), 1,
     "Only one RegressionTable is allowed for regression!"},
    {"intercept that is no number", ModelOf(kRegression, "y", "<RegressionTable intercept='-'/>"), 3,
     "-Invalid double string -- "},
    {"a regression of a text", ModelOf(kRegression, "k", kTable), 11, "k: Invalid Variable Type"},
    {"simplemax of one equation",
     ModelOf("functionName='regression' normalizationMethod='simplemax'", "y", kTable), 5,
     "simplemax normalization: Not supported for regression!"},
    {"unknown target", ModelOf("functionName='regression' targetFieldName='Y'", "", kTable), 8,
     "Variable Y not in the dictionary!"},
    {"two targets",
     "<RegressionModel functionName='regression'><MiningSchema><MiningField name='x' "
     "usageType='target'/><MiningField name='y' usageType='predicted'/></MiningSchema>" +
         kTable + "</RegressionModel>",
     1, "RegressionModel has more than one target!"},
    {"no category", ModelOf(Classification("softmax"), "k", kTable), 4,
     "Attribute targetCategory is missing from Node \"RegressionTable\""},
    {"unknown category", ModelOf(Classification("softmax"), "k", Tables("yes maybe")), 7,
     "k: invalid value!"},
    {"a category that is no number", ModelOf(Classification("softmax"), "y", Tables("1 two")), 7,
     "y: invalid value!"},
    {"a category twice", ModelOf(Classification("softmax"), "k", Tables("yes yes")), 1,
     "\"yes\": Duplicated Category Value!"},
    {"a category twice without target", ModelOf(Classification("softmax"), "", Tables("p q p")), 1,
     "\"p\": Duplicated Category Value!"},
    {"one category", ModelOf(Classification("softmax"), "", Tables("p")), 1,
     "Classification needs at least two categories!"},
    {"softmax without a category's table", ModelOf(Classification("softmax"), "m", Tables("red green")), 1,
     "\"blue\": RegressionTable is required for each category!"},
    {"simplemax without a category's table", ModelOf(Classification("simplemax"), "k", Tables("no")), 1,
     "\"yes\": RegressionTable is required for each category!"},
    {"none without two tables", ModelOf(Classification("none"), "m", Tables("blue")), 1,
     "\"red\": RegressionTable is required for each category!"},
    {"ordinal without an inner table", ModelOf(Classification("logit"), "o", Tables("low high")), 1,
     "\"mid\": RegressionTable is required for each category!"},
    {"one against the rest without two tables", ModelOf(Classification("logit"), "m", Tables("red")), 1,
     "\"green\": RegressionTable is required for each category!"},
    {"exp without two tables", ModelOf(Classification("exp"), "m", Tables("blue")), 1,
     "\"red\": RegressionTable is required for each category!"},
    {"ordinal exp without an inner table", ModelOf(Classification("exp"), "o", Tables("low high")), 1,
     "\"mid\": RegressionTable is required for each category!"},
    {"exp of one category", ModelOf(Classification("exp"), "", Tables("p")), 1,
     "Classification needs at least two categories!"},
    {"a fault of the schema",
     "<RegressionModel functionName='regression'><MiningSchema/>" + kTable + "</RegressionModel>", 1,
     "<MiningSchema> is EMPTY!!"},
};

TEST(RegressionRefusals, Models) {
  for (const auto& row : kModelRows) {
    ExpectFault([&] { BuildModel(DocumentOf(row.model)); }, row.code, row.message, row.why);
  }
}

TEST(RegressionRefusals, Documents) {
  const std::string model = ModelOf(kRegression, "y", "<RegressionTable/>");
  const std::string dictionary = kestrel_test::DictionaryOf(9, kestrel_tests::TestFields());
  ExpectFault([&] { BuildModel("<PMML>" + model + "</PMML>"); }, 1, "<DataDictionary is required !!");
  ExpectFault([&] { BuildModel("<PMML>" + dictionary + "</PMML>"); }, 4,
              "Node is missing --- RegressionModel ---");
  ExpectFault([&] { BuildModel("<PMML>" + dictionary + "<MiningModel>" + model + "</MiningModel></PMML>"); },
              4, "Node is missing --- RegressionModel ---", "a part of another model is no model");
  RegressionTranslator translator;
  const auto tree = kestrel_test::ReadTree(model);
  ExpectFault([&] { translator.ParseFromTree(tree->GetRoot(), nullptr, nullptr, std::string()); }, 1,
              "<DataDictionary is required !!");
}

TEST(RegressionRefusals, HaveAPlace) {
  try {
    BuildModel("<PMML>\n" + kestrel_test::DictionaryOf(9, kestrel_tests::TestFields()) + "\n" +
               ModelOf(kRegression, "y",
                       "\n<RegressionTable>\n<NumericPredictor name='x' coefficient='?'/>"
                       "</RegressionTable>") +
               "</PMML>");
    ADD_FAILURE();
  } catch (const KestrelException& fault) {
    EXPECT_EQ(fault.GetLine(), 5u);
    EXPECT_EQ(fault.GetErrorMessage(), "?Invalid double string -- ");
  }
  try {
    BuildModel(DocumentOf("\n" + ModelOf(Classification("exp"), "m", Tables("red"))));
    ADD_FAILURE();
  } catch (const KestrelException& fault) {
    EXPECT_EQ(fault.GetLine(), 2u);
  }
}

}  // namespace
