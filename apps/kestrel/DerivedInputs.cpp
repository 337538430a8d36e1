#include "apps/kestrel/DerivedInputs.h"

#include <unordered_set>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/transform/TransformVar.h"
#include "kestrel/transform/TransformationDictionary.h"

namespace kestrel_program {

using namespace MCKestrel_800;

std::vector<const ScoreDictVar*> FindDerivedInputs(const std::vector<std::string>& names,
                                                   const TransformationDictionary& derived,
                                                   const ScoreDictionary& dictionary) {
  std::unordered_set<std::string> seen;
  std::vector<std::string> waiting = names;
  while (!waiting.empty()) {
    const std::string name = waiting.back();
    waiting.pop_back();
    if (!seen.insert(name).second) continue;
    const auto* const field = dynamic_cast<const TransformVar*>(derived.GetVar(name));
    if (field == nullptr) continue;
    for (const std::string& read : field->GetSourceNames())
      waiting.push_back(read);
  }
  std::vector<const ScoreDictVar*> inputs;
  for (const std::string& name : dictionary.GetVarNames()) {
    if (seen.count(name) == 0) continue;
    inputs.push_back(dictionary.GetVar(name));
  }
  return inputs;
}

}  // namespace kestrel_program
