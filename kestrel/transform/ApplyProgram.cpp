#include "kestrel/transform/ApplyProgram.h"

#include "kestrel/foundation/NumericValue.h"
#include "kestrel/transform/ApplyCompiler.h"
#include "kestrel/transform/ApplySteps.h"
#include "kestrel/transform/FunctionTree.h"

namespace MCKestrel_800 {

ApplyProgram::ApplyProgram(const FunctionTree& root, FunctionValueKind wanted, const FindSource& find,
                           std::deque<double>& numbers)
    : numbers_(numbers) {
  numbers_.push_back(NumericValue::gSysmisValue);
  texts_.emplace_front();
  text_places_.push_front(&texts_.front());
  const double* const missing = &numbers_.back();
  const ApplyText empty = &text_places_.front();
  number_ = missing;
  text_ = empty;
  ApplyCompiler compiler(*this, find);
  if (wanted == FunctionValueKind::kText) {
    text_ = compiler.Text(&root);
  } else if (wanted == FunctionValueKind::kDateTime) {
    number_ = compiler.Seconds(&root);
  } else {
    number_ = compiler.Result(root);
  }
  if (!compiler.IsTooDeep()) return;
  code_.clear();
  number_ = missing;
  text_ = empty;
}

ApplyProgram::~ApplyProgram() = default;

bool ApplyProgram::IsReference(const FunctionTree& node) {
  const ApplyNodeStats& stats = node.GetNodeStats();
  return stats.GetTransFunction() == kNoFunction && !stats.IsConstNode();
}

std::vector<const FunctionTree*> ApplyProgram::FindReferences(const FunctionTree& root) {
  std::vector<const FunctionTree*> references;
  std::vector<const FunctionTree*> waiting = {&root};
  while (!waiting.empty()) {
    const FunctionTree& node = *waiting.back();
    waiting.pop_back();
    waiting.insert(waiting.end(), node.Children().rbegin(), node.Children().rend());
    if (IsReference(node)) references.push_back(&node);
  }
  return references;
}

}  // namespace MCKestrel_800
