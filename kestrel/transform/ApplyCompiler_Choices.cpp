// "if", and the tests of values whose kind it decides.

#include <vector>

#include "kestrel/transform/ApplyCompiler.h"

namespace MCKestrel_800 {
namespace {

bool IsIf(const FunctionTree& node) {
  return node.GetNodeStats().GetTransFunction() == kIfFunction;
}

}  // namespace

// take  lays an argument out, null for an absent one, and copies it to where the choice stands.
template <class Take>
void ApplyCompiler::TakeBranch(Node node, const Take& take) {
  const double* const condition = Number(node.GetChildAt(0));
  const std::size_t test = program_.code_.size();
  Emit(ApplySteps::SkipUnlessOne).x = condition;
  take(node.GetChildAt(1));
  const std::size_t jump = program_.code_.size();
  Emit(ApplySteps::Skip);
  program_.code_[test].skip = static_cast<std::uint32_t>(jump - test);
  take(node.GetChildAt(2));
  program_.code_[jump].skip = static_cast<std::uint32_t>(program_.code_.size() - jump - 1);
}

void ApplyCompiler::Copy(const double* from, double* to) {
  ApplyInstruction& step = Emit(ApplySteps::Copy);
  step.x = from;
  step.out = to;
}

void ApplyCompiler::Copy(ApplyText from, const StringValue** to) {
  ApplyDetail& detail = NewDetail();
  detail.texts = {from};
  detail.place_out = to;
  Emit(ApplySteps::CopyText).detail = &detail;
}

const StringValue** ApplyCompiler::NewTextPlace() {
  program_.text_places_.push_front(*EmptyText());
  return &program_.text_places_.front();
}

// Both arguments are laid out as the kind that is needed, whatever the other one is.
const double* ApplyCompiler::Choose(Node node, const double* (ApplyCompiler::*lay_out)(const FunctionTree*)) {
  double* const out = NewPlace();
  TakeBranch(node,
             [this, out, lay_out](const FunctionTree* argument) { Copy((this->*lay_out)(argument), out); });
  return out;
}

ApplyText ApplyCompiler::TextOfIf(Node node) {
  const StringValue** const out = NewTextPlace();
  TakeBranch(node, [this, out](const FunctionTree* argument) { Copy(Text(argument), out); });
  return out;
}

// Whether the case decides what kind a node is of. Dates and times that are chosen count, too: a missing one
// is not replaced, which the number of its seconds would be.
bool ApplyCompiler::IsOfOpenKind(const FunctionTree* node) const {
  if (node == nullptr || node->GetNodeStats().GetTransFunction() == kNoFunction) return false;
  const Kind kind = KindOf(node);
  if (kind == Kind::kDateTime && (IsIf(*node) || node->GetNodeStats().GetRecodeMissValueTo() != nullptr)) {
    return true;
  }
  // In a loop, since trees may be deep.
  std::vector<const FunctionTree*> waiting = {node};
  while (!waiting.empty()) {
    const FunctionTree& next = *waiting.back();
    waiting.pop_back();
    if (!IsIf(next)) {
      if (KindOf(&next) != kind) return true;
      continue;
    }
    for (const int index : {1, 2}) {
      if (const FunctionTree* const argument = next.GetChildAt(index)) waiting.push_back(argument);
    }
  }
  return false;
}

ApplyCompiler::Value ApplyCompiler::ValueOfKind(Kind kind, const FunctionTree* node) {
  const double* const number = kind == Kind::kText       ? MissingNumber()
                               : kind == Kind::kDateTime ? Seconds(node)
                                                         : Number(node);
  return {NewConstant(static_cast<double>(kind)), number, kind == Kind::kText ? Text(node) : EmptyText()};
}

// An absent argument of an "if" is the missing value of the kind that the second one has.
ApplyCompiler::Value ApplyCompiler::ValueOf(const FunctionTree* node) {
  const Level level(*this);
  if (node == nullptr || is_too_deep_) return ValueOfKind(Kind::kNumber, nullptr);
  if (!IsIf(*node)) return ValueOfKind(KindOf(node), node);
  double* const kind = NewPlace();
  double* const number = NewPlace();
  const StringValue** const text = NewTextPlace();
  TakeBranch(*node, [this, node, kind, number, text](const FunctionTree* argument) {
    const Value value = argument == nullptr ? ValueOfKind(KindOf(node), nullptr) : ValueOf(argument);
    Copy(value.kind, kind);
    Copy(value.number, number);
    Copy(value.text, text);
  });
  const double* const replacement = ReplacementOf(*node);
  if (replacement == nullptr) return {kind, number, text};
  ApplyDetail& detail = NewDetail();
  detail.numbers = {kind};
  const double* const replaced =
      EmitNumber(ApplySteps::ReplaceSysmisNumber, kNoFunction, number, replacement, &detail);
  return {kind, replaced, text};
}

const double* ApplyCompiler::CompareValues(Node node) {
  const Value left = ValueOf(node.GetChildAt(0));
  const Value right = ValueOf(node.GetChildAt(1));
  ApplyDetail& detail = NewDetail();
  detail.numbers = {left.kind, left.number, right.kind, right.number};
  detail.texts = {left.text, right.text};
  return EmitNumber(ApplySteps::CompareValues, node.GetNodeStats().GetTransFunction(), nullptr, nullptr,
                    &detail);
}

// detail  holds the list.
const double* ApplyCompiler::FindValue(Node node, ApplyDetail& detail) {
  const Value value = ValueOf(node.GetChildAt(0));
  detail.numbers = {value.kind, value.number};
  detail.texts = {value.text};
  return EmitNumber(ApplySteps::FindValue, node.GetNodeStats().GetTransFunction(), nullptr, nullptr, &detail);
}

}  // namespace MCKestrel_800
