#include "bench/support/Documents.h"

namespace kestrel_bench {

namespace {

std::string Begin(size_t fields) {
  return "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<PMML xmlns=\"http://www.dmg.org/PMML-4_4\" "
         "version=\"4.4\">\n"
         "  <Header description=\"benchmark\"/>\n  <DataDictionary numberOfFields=\"" +
         std::to_string(fields) + "\">\n";
}

std::string Field(const std::string& name, const char* optype, const char* type, const std::string& content) {
  std::string field =
      "    <DataField name=\"" + name + "\" optype=\"" + optype + "\" dataType=\"" + type + "\"";
  return field + (content.empty() ? "/>\n" : ">\n" + content + "    </DataField>\n");
}

std::string Value(const std::string& text, const char* property) {
  return "      <Value value=\"" + text + "\"" +
         (property[0] == '\0' ? "" : " property=\"" + std::string(property) + "\"") + "/>\n";
}

std::string Coefficient(size_t i) {
  return std::to_string(0.5 + static_cast<double>(i) / 8);
}

std::string NumericInputs(size_t inputs) {
  std::string text;
  for (size_t i = 0; i < inputs; ++i)
    text += Field("x" + std::to_string(i), "continuous", "double", "");
  return text;
}

std::string Schema(const std::string& inputs) {
  return "    <MiningSchema>\n" + inputs +
         "      <MiningField name=\"y\" usageType=\"target\"/>\n    </MiningSchema>\n";
}

std::string InputFields(size_t inputs, bool replace) {
  std::string text;
  for (size_t i = 0; i < inputs; ++i) {
    text += "      <MiningField name=\"x" + std::to_string(i) + "\"" +
            (replace ? " missingValueReplacement=\"1\" missingValueTreatment=\"asMean\"" : "") + "/>\n";
  }
  return text;
}

std::string Predictors(size_t inputs, size_t offset) {
  std::string text;
  for (size_t i = 0; i < inputs; ++i) {
    text += "      <NumericPredictor name=\"x" + std::to_string(i) + "\" exponent=\"1\" coefficient=\"" +
            Coefficient(i + offset) + "\"/>\n";
  }
  return text;
}

std::string RegressionModel(const std::string& schema, const std::string& tables) {
  return "  </DataDictionary>\n  <RegressionModel functionName=\"regression\">\n" + Schema(schema) + tables +
         "  </RegressionModel>\n</PMML>\n";
}

std::string Table(const std::string& predictors) {
  return "    <RegressionTable intercept=\"0.25\">\n" + predictors + "    </RegressionTable>\n";
}

}  // namespace

std::string LinearModel(size_t inputs, bool replace) {
  return Begin(inputs + 1) + NumericInputs(inputs) + Field("y", "continuous", "double", "") +
         RegressionModel(InputFields(inputs, replace), Table(Predictors(inputs, 0)));
}

std::string ClassificationModel(size_t inputs, size_t categories) {
  std::string labels, tables;
  for (size_t k = 0; k < categories; ++k) {
    const std::string label = "class" + std::to_string(k);
    labels += Value(label, "");
    tables += "    <RegressionTable intercept=\"0.25\" targetCategory=\"" + label + "\">\n" +
              Predictors(inputs, k) + "    </RegressionTable>\n";
  }
  return Begin(inputs + 1) + NumericInputs(inputs) + Field("y", "categorical", "string", labels) +
         "  </DataDictionary>\n  <RegressionModel functionName=\"classification\" "
         "normalizationMethod=\"softmax\">\n" +
         Schema(InputFields(inputs, false)) + tables + "  </RegressionModel>\n</PMML>\n";
}

std::string DictionaryModel(size_t fields) {
  std::string text = Begin(fields + 1);
  for (size_t i = 0; i < fields; ++i) {
    const std::string name = "x" + std::to_string(i);
    switch (i % 3) {
      case 0:
        text += Field(
            name, "continuous", "double",
            "      <Interval closure=\"closedClosed\" leftMargin=\"-100.5\" rightMargin=\"1000.25\"/>\n");
        break;
      case 1:
        text +=
            Field(name, "categorical", "string", Value("low", "") + Value("medium", "") + Value("high", ""));
        break;
      default:
        text += Field(name, "ordinal", "integer",
                      Value("1", "") + Value("2", "") + Value("3", "") + Value("98", "missing") +
                          Value("99", "invalid"));
    }
  }
  return text + Field("y", "continuous", "double", "") +
         RegressionModel(InputFields(1, false), Table(Predictors(1, 0)));
}

namespace {

/// 0, 1, ... n - 1 out of order.
std::string Shuffled(size_t i, size_t n) {
  return std::to_string(i * 7919 % n);
}

/// A small model on one input with that content.
std::string OneInputModel(const char* optype, const char* type, const std::string& content) {
  return Begin(3) + Field("f", optype, type, content) + NumericInputs(1) +
         Field("y", "continuous", "double", "") +
         RegressionModel(InputFields(1, false), Table(Predictors(1, 0)));
}

std::string TextCategories(size_t n) {
  std::string values;
  for (size_t i = 0; i < n; ++i)
    values += Value("category number " + Shuffled(i, n), "");
  return OneInputModel("categorical", "string", values);
}

std::string NumberCategories(size_t n) {
  std::string values;
  for (size_t i = 0; i < n; ++i)
    values += Value(Shuffled(i, n) + ".5", "");
  return OneInputModel("ordinal", "double", values);
}

std::string ValidAndMissing(size_t n, const char* optype) {
  std::string values;
  for (size_t i = 0; i < n; ++i)
    values += Value(Shuffled(i, n), i % 2 == 0 ? "valid" : "missing");
  return OneInputModel(optype, "double", values);
}

std::string Extensions(size_t n) {
  std::string content;
  for (size_t i = 0; i < n; ++i)
    content += "      <Extension name=\"width\" value=\"8\"/>\n";
  return OneInputModel("continuous", "double", content);
}

std::string Intervals(size_t n) {
  std::string content;
  for (size_t i = 0; i < n; ++i) {
    const std::string left = Shuffled(i, n);
    content += "      <X-DataField><Interval leftMargin=\"" + left + "\" rightMargin=\"" + left +
               ".5\"/></X-DataField>\n";
  }
  return OneInputModel("continuous", "double", content);
}

}  // namespace

const std::vector<GrowthShape>& GrowthShapes() {
  static const std::vector<GrowthShape> shapes = {
      {"fields", DictionaryModel},
      {"inputs of the model", [](size_t n) { return LinearModel(n, true); }},
      {"categories of one text field", TextCategories},
      {"categories of one numeric field", NumberCategories},
      {"valid and missing categories", [](size_t n) { return ValidAndMissing(n, "ordinal"); }},
      {"valid and missing numbers", [](size_t n) { return ValidAndMissing(n, "continuous"); }},
      {"intervals of one field", Intervals},
      {"extensions of one field", Extensions},
  };
  return shapes;
}

}  // namespace kestrel_bench
