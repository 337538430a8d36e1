// Small dictionaries of derived fields, and the values of a case.

#ifndef KESTREL_TESTS_TRANSFORM_DERIVEDFIELDS_H
#define KESTREL_TESTS_TRANSFORM_DERIVEDFIELDS_H

#include <memory>
#include <string>
#include <vector>

#include "kestrel/dictionary/BaseDictionary.h"
#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/dictionary/DictVar.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/transform/FunctionTreeImp.h"
#include "kestrel/transform/TransformVar.h"
#include "kestrel/transform/TransformationDictionary.h"
#include "kestrel/transform/ValueMatcher.h"

namespace kestrel_test {

constexpr double kSysmis = MCKestrel_800::NumericValue::gSysmisValue;

inline MCKestrel_800::NumericValue* Number(double number) {
  return new MCKestrel_800::NumericValue(number);
}
inline MCKestrel_800::StringValue* Text(const std::string& text) {
  return new MCKestrel_800::StringValue(text);
}
inline MCKestrel_800::ValueMatcher* Is(MCKestrel_800::ScoreValue* value) {
  return new MCKestrel_800::ValueMatcher(value);
}

inline MCKestrel_800::FunctionTree* FieldLeaf(const std::string& name) {
  MCKestrel_800::ApplyNodeStats stats;
  stats.SetParameterName(name);
  return new MCKestrel_800::FunctionTreeImp(stats);
}
inline MCKestrel_800::FunctionTree* ConstantLeaf(MCKestrel_800::ScoreValue* value) {
  MCKestrel_800::ApplyNodeStats stats;
  stats.SetConstNode(true);
  stats.SetValue(value);
  return new MCKestrel_800::FunctionTreeImp(stats);
}
inline MCKestrel_800::FunctionTree* Call(MCKestrel_800::TransformFunction function,
                                         const std::vector<MCKestrel_800::FunctionTree*>& arguments) {
  MCKestrel_800::ApplyNodeStats stats;
  stats.SetTransFunction(function);
  auto* node = new MCKestrel_800::FunctionTreeImp(stats);
  for (MCKestrel_800::FunctionTree* argument : arguments)
    node->Add(argument);
  return node;
}
/// The same tree with a number in place of a missing result.
inline MCKestrel_800::FunctionTree* WithReplacement(MCKestrel_800::FunctionTree* tree, double number) {
  MCKestrel_800::ApplyNodeStats stats(tree->GetNodeStats());
  stats.SetRecodeMissValueTo(Number(number));
  tree->SetNodeStats(stats);
  return tree;
}

/// A field of each kind as tests want it; the dictionary that it is added to owns it.
inline MCKestrel_800::TransformVar* NewField(
    const std::string& name, const std::string& source, MCKestrel_800::TransExpression kind,
    MCKestrel_800::ScoreDictVar::VariableType type = MCKestrel_800::ScoreDictVar::kNUMERIC_VAR) {
  auto* field = new MCKestrel_800::TransformVar(name, type);
  field->AddFieldNameAndTransExpression(source, kind);
  return field;
}
inline MCKestrel_800::TransformVar* NewApply(
    const std::string& name, MCKestrel_800::FunctionTree* root,
    MCKestrel_800::ScoreDictVar::VariableType type = MCKestrel_800::ScoreDictVar::kNUMERIC_VAR) {
  auto* field = NewField(name, "", MCKestrel_800::TransExpression::kApply, type);
  field->SetRoot(root);
  return field;
}
inline MCKestrel_800::TransformVar* NewReference(const std::string& name, const std::string& source) {
  return NewField(name, source, MCKestrel_800::TransExpression::kFieldRef);
}

inline void AddDerived(MCKestrel_800::TransformationDictionary& dictionary,
                       MCKestrel_800::TransformVar* field) {
  dictionary.AddVar(field->GetName(), field);
  dictionary.AddDerievedVarName(field->GetName());
}

/// A data dictionary with the numeric fields x and y, the text t and the date d, and a record of them.
struct Data {
  MCKestrel_800::BaseDictionary dictionary;
  MCKestrel_800::CaseRecord record;

  Data() {
    using MCKestrel_800::DictVar;
    using MCKestrel_800::ScoreDictVar;
    for (const char* name : {"x", "y"}) {
      dictionary.AddVar(name, new DictVar(name, ScoreDictVar::kNUMERIC_VAR));
      record.Add(name, Number(kSysmis));
    }
    dictionary.AddVar("t", new DictVar("t", ScoreDictVar::STRING_VAR));
    record.Add("t", Text(""));
    auto* date = new DictVar("d", ScoreDictVar::kDATETIME_VAR);
    date->SetDateTimeType(MCKestrel_800::kDate);
    dictionary.AddVar("d", date);
    record.Add("d", new MCKestrel_800::DateTimeValue);
  }
};

}  // namespace kestrel_test

#endif  // KESTREL_TESTS_TRANSFORM_DERIVEDFIELDS_H
