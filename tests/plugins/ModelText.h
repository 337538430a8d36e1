// Builds regression models and case records from short texts.

#ifndef KESTREL_TESTS_PLUGINS_MODELTEXT_H
#define KESTREL_TESTS_PLUGINS_MODELTEXT_H

#include <memory>
#include <string>
#include <utility>
#include <variant>
#include <vector>

#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/model/ScoreModel.h"
#include "plugins/regression/RegressionTranslator.h"
#include "tests/support/DictionaryText.h"

namespace kestrel_tests {

/// Fields for the models of these tests: numbers x, z and n (a coded category 1, 2 or 3), the texts g
/// (categories a, b, c) and t (no list), and the targets y (number), k (categories yes, no), m (red, green,
/// blue) and o (ordinal: low, mid, high).
inline const char* TestFields() {
  return "<DataField name=\"x\" optype=\"continuous\" dataType=\"double\"/>"
         "<DataField name=\"z\" optype=\"continuous\" dataType=\"double\"/>"
         "<DataField name=\"n\" optype=\"categorical\" dataType=\"integer\"><Value value=\"1\"/><Value "
         "value=\"2\"/>"
         "<Value value=\"3\"/></DataField>"
         "<DataField name=\"g\" optype=\"categorical\" dataType=\"string\"><Value value=\"a\"/><Value "
         "value=\"b\"/>"
         "<Value value=\"c\"/></DataField>"
         "<DataField name=\"t\" optype=\"categorical\" dataType=\"string\"/>"
         "<DataField name=\"y\" optype=\"continuous\" dataType=\"double\"/>"
         "<DataField name=\"k\" optype=\"categorical\" dataType=\"string\"><Value value=\"yes\"/><Value "
         "value=\"no\"/>"
         "</DataField>"
         "<DataField name=\"m\" optype=\"categorical\" dataType=\"string\"><Value value=\"red\"/>"
         "<Value value=\"green\"/><Value value=\"blue\"/></DataField>"
         "<DataField name=\"o\" optype=\"ordinal\" dataType=\"string\"><Value value=\"low\"/><Value "
         "value=\"mid\"/>"
         "<Value value=\"high\"/></DataField>";
}

/// Active fields for all inputs of TestFields.
inline const char* TestInputs() {
  return "<MiningField name=\"x\"/><MiningField name=\"z\"/><MiningField name=\"n\"/><MiningField "
         "name=\"g\"/>"
         "<MiningField name=\"t\"/>";
}

/// A document with TestFields around a RegressionModel element.
inline std::string DocumentOf(const std::string& model) {
  return std::string("<PMML version=\"4.4\">") + kestrel_test::DictionaryOf(9, TestFields()) + model +
         "</PMML>";
}

/// A RegressionModel element that has all inputs active and one target (none when it is empty).
inline std::string ModelOf(const std::string& attributes, const std::string& target,
                           const std::string& tables) {
  const std::string target_field =
      target.empty() ? "" : "<MiningField name=\"" + target + "\" usageType=\"target\"/>";
  return "<RegressionModel " + attributes + "><MiningSchema>" + TestInputs() + target_field +
         "</MiningSchema>" + tables + "</RegressionModel>";
}

inline std::unique_ptr<MCKestrel_800::ScoreModel> BuildModel(const std::string& document) {
  const auto tree = kestrel_test::ReadTree(document);
  MCKestrel_800::RegressionTranslator translator;
  return std::unique_ptr<MCKestrel_800::ScoreModel>(translator.ParseFromTree(tree->GetRoot(), std::string()));
}

/// A cell of a case: nothing, a number or a text.
using Cell = std::variant<std::monostate, double, std::string>;

inline MCKestrel_800::ScoreValue* MakeValue(const Cell& cell) {
  if (const double* number = std::get_if<double>(&cell)) return new MCKestrel_800::NumericValue(*number);
  if (const auto* text = std::get_if<std::string>(&cell)) return new MCKestrel_800::StringValue(*text);
  return nullptr;
}

/// A record of the cells, in their order.
inline MCKestrel_800::CaseRecord RecordOf(const std::vector<std::pair<std::string, Cell>>& cells) {
  MCKestrel_800::CaseRecord record(static_cast<int>(cells.size()));
  for (const auto& [name, cell] : cells)
    record.Add(name, MakeValue(cell));
  return record;
}

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_PLUGINS_MODELTEXT_H
