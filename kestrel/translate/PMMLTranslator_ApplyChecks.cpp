// What may stand inside what in an Apply expression.

#include <string>
#include <string_view>
#include <unordered_map>
#include <xercesc/dom/DOMElement.hpp>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/transform/BuiltinFunctions.h"
#include "kestrel/transform/FunctionTree.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "kestrel/translate/ReaderFault.h"

namespace MCKestrel_800 {

namespace {

using xercesc::DOMElement;
using Kind = FunctionValueKind;

[[noreturn]] void FailOnArguments(const DOMElement* element, const char* text) {
  FailAt(element, KestrelException::kInvalidDocument, text);
}

/// The rows of the built-in functions by their names.
const std::unordered_map<std::string_view, TransformFunction>& FunctionMap() {
  static const std::unordered_map<std::string_view, TransformFunction> map = [] {
    std::unordered_map<std::string_view, TransformFunction> codes;
    std::size_t count = 0;
    const BuiltinFunction* const rows = GetBuiltinFunctions(count);
    for (std::size_t i = 0; i < count; ++i)
      codes.emplace(rows[i].name, rows[i].code);
    return codes;
  }();
  return map;
}

FunctionNesting NestingOf(TransformFunction function) {
  const BuiltinFunction* const row = FindBuiltinFunction(function);
  return row != nullptr ? row->nesting : FunctionNesting::kOther;
}

bool IsFunction(const FunctionTree& node) {
  return node.GetNodeStats().GetTransFunction() != kNoFunction;
}

bool IsFieldRef(const FunctionTree& node) {
  return !IsFunction(node) && !node.GetNodeStats().IsConstNode();
}

/// Each argument of a list of numbers, or of texts, and the one of "length".
void CheckKinds(const DOMElement* element, const FunctionTree& node, const BuiltinFunction& row) {
  for (const FunctionTree* argument : node.Children()) {
    if (IsFunction(*argument)) {
      PMMLTranslator::VerifyParentAndChildFunction(element, row.code,
                                                   argument->GetNodeStats().GetTransFunction());
    } else {
      PMMLTranslator::VerifyOneElem(element, *argument, row.argument == Kind::kNumber);
    }
  }
}

void CheckField(const DOMElement* element, const FunctionTree& node, const BuiltinFunction& row) {
  const FunctionTree& argument = *node.Children().front();
  if (!IsFieldRef(argument)) {
    FailOnArguments(element, "Only <FieldRef> is allowed for function value!");
  }
  const ScoreDictVar* const variable = argument.GetNodeStats().GetVariable();
  if (row.argument == Kind::kNumberOrText && variable != nullptr &&
      variable->GetVarType() == ScoreDictVar::kDATETIME_VAR) {
    FailOnArguments(element, "Variable type doesn't match!");
  }
}

/// A categorical field with the means and variances of its categories, in their order, and a number.
void CheckImputation(const DOMElement* element, const FunctionTree& node, const BuiltinFunction& row) {
  const ScoreDictVar* const category = node.GetChildAt(0)->GetNodeStats().GetVariable();
  const ScoreDictVar* const number = node.GetChildAt(1)->GetNodeStats().GetVariable();
  const std::size_t means = node.GetNodeStats().GetArray(0).size();
  const bool is_formed = category != nullptr && category->GetMLevel() != ScoreDictVar::kContinuous &&
                         number != nullptr && number->GetMLevel() == ScoreDictVar::kContinuous &&
                         means == node.GetNodeStats().GetArray(1).size() &&
                         means <= static_cast<std::size_t>(category->GetNumberOfCats());
  if (!is_formed) FailOnArguments(element, row.arity_text);
}

}  // namespace

void PMMLTranslator::InitFunctionMap() {
  static_cast<void>(FunctionMap());
}

TransformFunction PMMLTranslator::GetTransFunction(const std::string& name) {
  const auto& map = FunctionMap();
  const auto row = map.find(name);
  return row != map.end() ? row->second : kNoFunction;
}

bool PMMLTranslator::IsNumericFunction(TransformFunction function) {
  return NestingOf(function) == FunctionNesting::kNumeric;
}

bool PMMLTranslator::IsStringFunction(TransformFunction function) {
  return NestingOf(function) == FunctionNesting::kString;
}

void PMMLTranslator::VerifyParentAndChildFunction(const DOMElement* element, TransformFunction parent,
                                                  TransformFunction child) {
  const FunctionNesting inner = NestingOf(child);
  switch (NestingOf(parent)) {
    case FunctionNesting::kNumeric:
      if (inner != FunctionNesting::kNumeric && inner != FunctionNesting::kLength) {
        FailOnArguments(element, "Numeric function is required!");
      }
      return;
    case FunctionNesting::kString:
      if (inner != FunctionNesting::kString) FailOnArguments(element, "string function is required!");
      return;
    case FunctionNesting::kLength:
      if (inner != FunctionNesting::kString) FailOnArguments(element, "apply functions don't match!");
      return;
    case FunctionNesting::kOther:
      return;
  }
}

void PMMLTranslator::VerifyOneElem(const DOMElement* element, const FunctionTree& argument, bool isNumeric) {
  if (IsFunction(argument)) return;
  const ApplyNodeStats& stats = argument.GetNodeStats();
  bool fits = true;
  if (stats.IsConstNode()) {
    const ScoreValue::ValueType type = isNumeric ? ScoreValue::kNumeric : ScoreValue::kString;
    fits = stats.GetValue() == nullptr || stats.GetValue()->GetType() == type;
  } else if (stats.GetVariable() != nullptr) {
    fits = stats.GetVariable()->GetVarType() ==
           (isNumeric ? ScoreDictVar::kNUMERIC_VAR : ScoreDictVar::STRING_VAR);
  }
  if (!fits) FailOnArguments(element, "Variable type doesn't match!");
}

void PMMLTranslator::VerifyApplyFunction(const DOMElement* element, const FunctionTree& node) {
  const BuiltinFunction* const row = FindBuiltinFunction(node.GetNodeStats().GetTransFunction());
  if (row == nullptr) return;
  if (!row->TakesCount(node.Children().size()) || node.GetNodeStats().GetNumberOfArray() != row->arrays) {
    FailOnArguments(element, row->arity_text);
  }
  switch (row->check) {
    case FunctionArgumentCheck::kNone:
      break;
    case FunctionArgumentCheck::kKind:
      CheckKinds(element, node, *row);
      break;
    case FunctionArgumentCheck::kField:
      CheckField(element, node, *row);
      break;
  }
  if (row->code == kImputeFunction) CheckImputation(element, node, *row);
}

}  // namespace MCKestrel_800
