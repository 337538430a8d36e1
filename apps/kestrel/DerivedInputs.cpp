#include "apps/kestrel/DerivedInputs.h"

#include <unordered_set>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/transform/FunctionTree.h"
#include "kestrel/transform/TransformVar.h"
#include "kestrel/transform/TransformationDictionary.h"

namespace kestrel_program {
namespace {

using namespace MCKestrel_800;

/// The names that one field reads. Neither here nor below does depth cost stack.
void AddReads(const TransformVar& field, std::vector<std::string>& names) {
  if (!field.GetFieldName().empty()) names.push_back(field.GetFieldName());
  if (field.GetRoot() == nullptr) return;
  std::vector<const FunctionTree*> waiting = {field.GetRoot()};
  while (!waiting.empty()) {
    const FunctionTree& node = *waiting.back();
    waiting.pop_back();
    const ApplyNodeStats& stats = node.GetNodeStats();
    if (stats.GetTransFunction() == kNoFunction && !stats.IsConstNode())
      names.push_back(stats.GetParameterName());
    waiting.insert(waiting.end(), node.Children().begin(), node.Children().end());
  }
}

}  // namespace

std::vector<const ScoreDictVar*> FindDerivedInputs(const std::vector<std::string>& names,
                                                   const TransformationDictionary& derived,
                                                   const ScoreDictionary& dictionary) {
  std::unordered_set<std::string> seen;
  std::vector<std::string> waiting = names;
  while (!waiting.empty()) {
    const std::string name = waiting.back();
    waiting.pop_back();
    if (!seen.insert(name).second) continue;
    if (const auto* field = dynamic_cast<const TransformVar*>(derived.GetVar(name)))
      AddReads(*field, waiting);
  }
  std::vector<const ScoreDictVar*> inputs;
  for (const std::string& name : dictionary.GetVarNames()) {
    if (seen.count(name) == 0) continue;
    inputs.push_back(dictionary.GetVar(name));
  }
  return inputs;
}

}  // namespace kestrel_program
