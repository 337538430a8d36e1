#include "kestrel/transform/ApplyCompiler.h"

#include <algorithm>
#include <cmath>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/dictionary/ScoreValueLabelSet.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/transform/SourceField.h"

namespace MCKestrel_800 {
namespace {

FunctionValueKind KindOfValue(const ScoreValue* value) {
  if (value == nullptr) return FunctionValueKind::kNumber;
  switch (value->GetType()) {
    case ScoreValue::kString:
      return FunctionValueKind::kText;
    case ScoreValue::kDateTime:
      return FunctionValueKind::kDateTime;
    default:
      return FunctionValueKind::kNumber;
  }
}

// A field that nobody knows is whatever is needed: kAny.
FunctionValueKind KindOfVariable(const ScoreDictVar* variable) {
  if (variable == nullptr) return FunctionValueKind::kAny;
  switch (variable->GetVarType()) {
    case ScoreDictVar::kNUMERIC_VAR:
      return FunctionValueKind::kNumber;
    case ScoreDictVar::kDATETIME_VAR:
      return FunctionValueKind::kDateTime;
    default:
      return FunctionValueKind::kText;
  }
}

const FunctionTree* ChildOf(const FunctionTree& node, int index) {
  return node.GetChildAt(index);
}

TransformFunction FunctionOf(const FunctionTree& node) {
  return node.GetNodeStats().GetTransFunction();
}

bool IsConstant(const FunctionTree& node) {
  return FunctionOf(node) == kNoFunction && !ApplyProgram::IsReference(node);
}

// Whether a node is a sum, difference, product or quotient of two.
bool IsArithmetic(const FunctionTree& node) {
  const TransformFunction function = FunctionOf(node);
  if (function == kPlusFunction) return true;
  return (function == kMinusFunction || function == kMultiplyFunction || function == kDivideFunction) &&
         node.GetChildCount() == 2;
}

// Whether that is all there is to a node.
bool GivesOperand(const FunctionTree& node) {
  return IsArithmetic(node) && node.GetNodeStats().GetRecodeMissValueTo() == nullptr;
}

double NumberOrMissing(const ScoreValue* value) {
  if (value == nullptr || value->GetType() == ScoreValue::kString) return NumericValue::gSysmisValue;
  return value->GetDouble();
}

// With the length that the value has, where it is a text of the library's own.
StringValue TextOrEmpty(const ScoreValue* value) {
  if (value == nullptr || value->GetType() != ScoreValue::kString) return StringValue();
  const auto* text = dynamic_cast<const StringValue*>(value);
  return text != nullptr ? *text : StringValue(value->GetString());
}

}  // namespace

FunctionValueKind ApplyCompiler::KindOf(const FunctionTree* node) const {
  // Down the arguments that decide: in a loop, since trees may be deep.
  for (int depth = 0; node != nullptr && depth < ApplyProgram::kMaxDepth; ++depth) {
    const ApplyNodeStats& stats = node->GetNodeStats();
    if (ApplyProgram::IsReference(*node)) {
      const Kind kind = KindOfVariable(find_(stats.GetParameterName()).GetVariable());
      return kind == Kind::kAny ? Kind::kNumber : kind;
    }
    if (stats.GetTransFunction() == kNoFunction) return KindOfValue(stats.GetValue());
    const BuiltinFunction* const function = FindBuiltinFunction(stats.GetTransFunction());
    if (function == nullptr) return Kind::kNumber;
    if (function->result == Kind::kArgument) {
      node = ChildOf(*node, 1);
    } else if (function->result == Kind::kFirstArgument) {
      node = ChildOf(*node, 0);
    } else {
      return function->result;
    }
  }
  return Kind::kNumber;
}

const double* ApplyCompiler::Result(Node root) {
  return GivesOperand(root) ? Operand(&root) : Number(&root);
}

const double* ApplyCompiler::Number(const FunctionTree* node) {
  const Level level(*this);
  if (node == nullptr || is_too_deep_) return MissingNumber();
  if (ApplyProgram::IsReference(*node)) return NumberOfReference(*node);
  const TransformFunction code = FunctionOf(*node);
  if (code == kNoFunction) return NewConstant(NumberOrMissing(node->GetNodeStats().GetValue()));
  const BuiltinFunction* const function = FindBuiltinFunction(code);
  // A function that does not exist.
  if (function == nullptr) return NewConstant(0.0);
  if (function->result == Kind::kText) return MissingNumber();
  return Replaced(*node, NumberOfFunction(*node, *function));
}

// Arithmetic within arithmetic, which most formulas are, hands its result on as it is.
const double* ApplyCompiler::Operand(const FunctionTree* node) {
  if (node == nullptr || IsConstant(*node)) return NewConstant(AsOperand(*Number(node)));
  const ApplyNodeStats& stats = node->GetNodeStats();
  const bool is_field = ApplyProgram::IsReference(*node) && stats.GetFieldrefRecodeMissValueTo() == nullptr;
  if (!is_field && !GivesOperand(*node)) return EmitNumber(ApplySteps::ToOperand, kNoFunction, Number(node));
  const Level level(*this);
  if (is_too_deep_) return MissingNumber();
  return is_field ? &find_(stats.GetParameterName()).GetOperand() : Arithmetic(*node);
}

const double* ApplyCompiler::Arithmetic(Node node) {
  const TransformFunction function = FunctionOf(node);
  const double* const x = Operand(ChildOf(node, 0));
  const double* const y = Operand(node.GetChildCount() > 1 ? ChildOf(node, 1) : nullptr);
  const ApplyInstruction::Run run = function == kPlusFunction       ? ApplySteps::Add
                                    : function == kMinusFunction    ? ApplySteps::Subtract
                                    : function == kMultiplyFunction ? ApplySteps::Multiply
                                                                    : ApplySteps::Divide;
  return EmitNumber(run, function, x, y);
}

const double* ApplyCompiler::Seconds(const FunctionTree* node) {
  if (node == nullptr) return MissingNumber();
  // Here the case decides, too: a date/time field may hold something else.
  if (ApplyProgram::IsReference(*node) && node->GetNodeStats().GetFieldrefRecodeMissValueTo() == nullptr) {
    return &find_(node->GetNodeStats().GetParameterName()).GetSeconds();
  }
  if (FunctionOf(*node) == kIfFunction) {
    const Level level(*this);
    return is_too_deep_ ? MissingNumber() : Choose(*node, &ApplyCompiler::Seconds);
  }
  if (KindOf(node) != Kind::kDateTime) return MissingNumber();
  // What replaces a missing result is a number, and no date/time.
  return FunctionOf(*node) == kImputeFunction ? NumberOfImputation(*node) : Number(node);
}

const double* ApplyCompiler::NumberOfReference(Node node) {
  const ApplyNodeStats& stats = node.GetNodeStats();
  const SourceField& source = find_(stats.GetParameterName());
  const ScoreValue* const replacement = stats.GetFieldrefRecodeMissValueTo();
  if (replacement == nullptr) return &source.GetNumber();
  ApplyDetail& detail = NewDetail();
  detail.source = &source;
  return EmitNumber(ApplySteps::ReplaceMissingNumber, kNoFunction, &source.GetNumber(),
                    NewConstant(NumberOrMissing(replacement)), &detail);
}

const double* ApplyCompiler::NumberOfFunction(Node node, const BuiltinFunction& function) {
  switch (function.family) {
    case FunctionFamily::kScalar:
      return NumberOfScalar(node);
    case FunctionFamily::kList:
      return NumberOfList(node);
    case FunctionFamily::kDateTime:
      // A function of one argument subtracts nothing.
      return EmitNumber(ApplySteps::DateTime, function.code, Seconds(ChildOf(node, 0)),
                        function.max_arguments == 1 ? NewConstant(0.0) : Number(ChildOf(node, 1)));
    case FunctionFamily::kComparison:
      return NumberOfComparison(node);
    case FunctionFamily::kValueList:
      return NumberOfValueList(node);
    default:
      return NumberOfSpecial(node, function.code);
  }
}

const double* ApplyCompiler::NumberOfSpecial(Node node, TransformFunction function) {
  const FunctionTree* const argument = ChildOf(node, 0);
  switch (function) {
    case kIsMissingFunction:
    case kIsNotMissingFunction:
      return NumberOfMissingTest(node);
    case kSysmisFunction:
      if (KindOf(argument) == Kind::kText) return NewConstant(0.0);
      return EmitNumber(ApplySteps::TestSysmis, function, Number(argument));
    case kLengthFunction: {
      ApplyDetail& detail = NewDetail();
      detail.texts = {Text(argument)};
      return EmitNumber(ApplySteps::Length, function, nullptr, nullptr, &detail);
    }
    case kOutlierHandleFunction:
      return NumberOfOutlier(node);
    case kIfFunction:
      return Choose(node, &ApplyCompiler::Number);
    case kImputeFunction:
      return NumberOfImputation(node);
    default: {  // the number of a value, unchanged
      if (KindOf(argument) != Kind::kText) return EmitNumber(ApplySteps::Copy, function, Number(argument));
      ApplyDetail& detail = NewDetail();
      detail.texts = {Text(argument)};
      return EmitNumber(ApplySteps::ReadText, function, nullptr, nullptr, &detail);
    }
  }
}

const double* ApplyCompiler::NumberOfScalar(Node node) {
  if (IsArithmetic(node)) return EmitNumber(ApplySteps::FromOperand, kNoFunction, Arithmetic(node));
  const double* const x = Number(ChildOf(node, 0));
  const double* const y = node.GetChildCount() > 1 ? Number(ChildOf(node, 1)) : MissingNumber();
  return EmitNumber(ApplySteps::Scalar, FunctionOf(node), x, y);
}

const double* ApplyCompiler::NumberOfList(Node node) {
  if (IsArithmetic(node)) return EmitNumber(ApplySteps::FromOperand, kNoFunction, Arithmetic(node));
  ApplyDetail& detail = NewDetail();
  for (const FunctionTree* child : node.Children())
    detail.numbers.push_back(Number(child));
  detail.values.resize(detail.numbers.size());
  detail.scratch.reserve(detail.numbers.size());
  return EmitNumber(ApplySteps::List, FunctionOf(node), nullptr, nullptr, &detail);
}

const double* ApplyCompiler::NumberOfComparison(Node node) {
  const TransformFunction function = FunctionOf(node);
  const FunctionTree* const left = ChildOf(node, 0);
  const FunctionTree* const right = ChildOf(node, 1);
  if (node.GetChildCount() == 2 && (IsOfOpenKind(left) || IsOfOpenKind(right))) return CompareValues(node);
  const Kind kind = KindOf(left);
  if (node.GetChildCount() != 2 || kind != KindOf(right)) {
    return NewConstant(function == kNotEqualFunction ? 1.0 : 0.0);
  }
  if (kind != Kind::kText) {
    const double* const x = Number(left);
    return EmitNumber(ApplySteps::CompareNumbers, function, x, Number(right));
  }
  ApplyDetail& detail = NewDetail();
  detail.texts = {Text(left), Text(right)};
  return EmitNumber(ApplySteps::CompareTexts, function, nullptr, nullptr, &detail);
}

const double* ApplyCompiler::NumberOfValueList(Node node) {
  const TransformFunction function = FunctionOf(node);
  const FunctionTree* const argument = ChildOf(node, 0);
  if (argument == nullptr) return NewConstant(function == kIsNotInFunction ? 1.0 : 0.0);
  const bool is_open = IsOfOpenKind(argument);
  const Kind kind = KindOf(argument);
  ApplyDetail& detail = NewDetail();
  for (const ScoreValue* value : node.GetNodeStats().GetArray(0)) {
    const Kind listed = KindOfValue(value);
    if (value == nullptr || (listed != kind && !is_open)) continue;
    if (listed == Kind::kText) {
      detail.listed_texts.emplace_back(WithoutTrailingBlanks(value->GetString()));
    } else if (std::isfinite(value->GetDouble())) {  // anything else equals nothing
      (is_open && listed == Kind::kDateTime ? detail.listed_seconds : detail.listed_numbers)
          .push_back(value->GetDouble());
    }
  }
  std::sort(detail.listed_texts.begin(), detail.listed_texts.end());
  std::sort(detail.listed_numbers.begin(), detail.listed_numbers.end());
  std::sort(detail.listed_seconds.begin(), detail.listed_seconds.end());
  if (is_open) return FindValue(node, detail);
  if (kind != Kind::kText) {
    return EmitNumber(ApplySteps::FindNumber, function, Number(argument), nullptr, &detail);
  }
  detail.texts = {Text(argument)};
  return EmitNumber(ApplySteps::FindText, function, nullptr, nullptr, &detail);
}

const double* ApplyCompiler::NumberOfMissingTest(Node node) {
  const TransformFunction function = FunctionOf(node);
  const FunctionTree* const argument = ChildOf(node, 0);
  const bool is_negated = function == kIsNotMissingFunction;
  // An absent argument is missing, the text of a function never is.
  if (argument == nullptr) return NewConstant(is_negated ? 0.0 : 1.0);
  if (ApplyProgram::IsReference(*argument)) {
    ApplyDetail& detail = NewDetail();
    detail.source = &find_(argument->GetNodeStats().GetParameterName());
    return EmitNumber(ApplySteps::TestMissing, function, nullptr, nullptr, &detail);
  }
  if (KindOf(argument) == Kind::kText) return NewConstant(is_negated ? 1.0 : 0.0);
  return EmitNumber(ApplySteps::TestSysmis, function, Number(argument));
}

const double* ApplyCompiler::NumberOfOutlier(Node node) {
  ApplyDetail& detail = NewDetail();
  for (int i = 0; i < 6; ++i) {
    const FunctionTree* const argument = ChildOf(node, i);
    detail.numbers.push_back(i == 1 ? MethodOfOutliers(argument) : Number(argument));
  }
  return EmitNumber(ApplySteps::Outlier, FunctionOf(node), nullptr, nullptr, &detail);
}

// The method as its number: documents write its name.
const double* ApplyCompiler::MethodOfOutliers(const FunctionTree* node) {
  if (KindOf(node) != Kind::kText) return Number(node);
  const std::string name = TextOrEmpty(node == nullptr ? nullptr : node->GetNodeStats().GetValue()).GetText();
  if (name == "asExtremeValues") return NewConstant(ScoreDictVar::kAsExtremeValues);
  return NewConstant(name == "asMissingValues" ? ScoreDictVar::kAsMissingValues : ScoreDictVar::kAsIs);
}

const double* ApplyCompiler::NumberOfImputation(Node node) {
  ApplyDetail& detail = NewDetail();
  if (!ReadImputation(node, detail) || KindOf(ChildOf(node, 0)) == Kind::kText) return MissingNumber();
  const double* const category = Number(ChildOf(node, 0));
  return EmitNumber(ApplySteps::ImputeNumber, kImputeFunction, category, Number(ChildOf(node, 1)), &detail);
}

// The categories with the mean and the variance of each; false when the tree has no such thing.
bool ApplyCompiler::ReadImputation(Node node, ApplyDetail& detail) {
  const FunctionTree* const category = ChildOf(node, 0);
  if (category == nullptr || !ApplyProgram::IsReference(*category)) return false;
  detail.source = &find_(category->GetNodeStats().GetParameterName());
  const ScoreDictVar* const variable = detail.source->GetVariable();
  const ScoreValueLabelSet* const labels = variable == nullptr ? nullptr : variable->GetValueLabels();
  if (labels == nullptr) return false;
  for (const ScoreValue* value : node.GetNodeStats().GetArray(0))
    detail.values.push_back(NumberOrMissing(value));
  for (const ScoreValue* value : node.GetNodeStats().GetArray(1))
    detail.variances.push_back(NumberOrMissing(value));
  const std::vector<ScoreValueLabel*>& categories = labels->GetAllValueLabels();
  const std::size_t count = detail.values.size();
  if (count == 0 || count != detail.variances.size() || count > categories.size()) return false;
  for (const ScoreValueLabel* label : categories) {
    detail.category_numbers.push_back(NumberOrMissing(label->GetValue()));
    detail.category_texts.push_back(TextOrEmpty(label->GetValue()));
  }
  return true;
}

const double* ApplyCompiler::Replaced(Node node, const double* result) {
  const double* const replacement = ReplacementOf(node);
  return replacement == nullptr ? result
                                : EmitNumber(ApplySteps::ReplaceSysmis, kNoFunction, result, replacement);
}

// Null when there is none.
const double* ApplyCompiler::ReplacementOf(Node node) {
  const ScoreValue* const replacement = node.GetNodeStats().GetRecodeMissValueTo();
  return replacement == nullptr ? nullptr : NewConstant(NumberOrMissing(replacement));
}

ApplyText ApplyCompiler::Text(const FunctionTree* node) {
  const Level level(*this);
  if (node == nullptr || is_too_deep_) return EmptyText();
  if (ApplyProgram::IsReference(*node)) return TextOfReference(*node);
  const TransformFunction code = FunctionOf(*node);
  if (code == kNoFunction) return NewConstant(TextOrEmpty(node->GetNodeStats().GetValue()));
  const BuiltinFunction* const function = FindBuiltinFunction(code);
  return function == nullptr ? EmptyText() : TextOfFunction(*node, *function);
}

ApplyText ApplyCompiler::TextOfReference(Node node) {
  const ApplyNodeStats& stats = node.GetNodeStats();
  const SourceField& source = find_(stats.GetParameterName());
  const ScoreValue* const replacement = stats.GetFieldrefRecodeMissValueTo();
  if (replacement == nullptr) return &source.GetText();
  ApplyDetail& detail = NewDetail();
  detail.source = &source;
  detail.texts = {&source.GetText(), NewConstant(TextOrEmpty(replacement))};
  program_.text_places_.push_front(*detail.texts[1]);
  detail.place_out = &program_.text_places_.front();
  Emit(ApplySteps::ReplaceMissingText).detail = &detail;
  return detail.place_out;
}

ApplyText ApplyCompiler::TextOfFunction(Node node, const BuiltinFunction& function) {
  if (function.code == kIfFunction) return TextOfIf(node);
  if (function.code == kImputeFunction) return TextOfImputation(node);
  if (function.family != FunctionFamily::kText) return EmptyText();
  ApplyDetail& detail = NewDetail();
  const double* start = nullptr;
  ApplyInstruction::Run run = ApplySteps::ChangeText;
  if (function.code == kConcatFunction) {
    run = ApplySteps::Concat;
    for (const FunctionTree* child : node.Children())
      detail.texts.push_back(Text(child));
  } else {
    detail.texts = {Text(ChildOf(node, 0))};
    if (function.code == kSubstrFunction) {
      run = ApplySteps::Substring;
      start = Number(ChildOf(node, 1));
    }
  }
  program_.texts_.emplace_front();
  detail.text_out = &program_.texts_.front();
  program_.text_places_.push_front(detail.text_out);
  ApplyInstruction& step = Emit(run, function.code);
  step.x = start;
  step.detail = &detail;
  return &program_.text_places_.front();
}

ApplyText ApplyCompiler::TextOfImputation(Node node) {
  ApplyDetail& detail = NewDetail();
  if (!ReadImputation(node, detail) || KindOf(ChildOf(node, 0)) != Kind::kText) return EmptyText();
  detail.texts = {Text(ChildOf(node, 0))};
  const double* const number = Number(ChildOf(node, 1));
  detail.place_out = NewTextPlace();
  ApplyInstruction& step = Emit(ApplySteps::ImputeText, kImputeFunction);
  step.y = number;
  step.detail = &detail;
  return detail.place_out;
}

double* ApplyCompiler::NewPlace() {
  program_.numbers_.push_back(NumericValue::gSysmisValue);
  return &program_.numbers_.back();
}

const double* ApplyCompiler::NewConstant(double number) {
  program_.numbers_.push_back(number);
  return &program_.numbers_.back();
}

const double* ApplyCompiler::MissingNumber() {
  return NewConstant(NumericValue::gSysmisValue);
}

ApplyText ApplyCompiler::NewConstant(const StringValue& text) {
  program_.texts_.push_front(text);
  program_.text_places_.push_front(&program_.texts_.front());
  return &program_.text_places_.front();
}

ApplyText ApplyCompiler::EmptyText() {
  return NewConstant(StringValue());
}

ApplyDetail& ApplyCompiler::NewDetail() {
  program_.details_.emplace_front();
  return program_.details_.front();
}

ApplyInstruction& ApplyCompiler::Emit(ApplyInstruction::Run run, TransformFunction function) {
  program_.code_.emplace_back();
  program_.code_.back().run = run;
  program_.code_.back().function = function;
  return program_.code_.back();
}

const double* ApplyCompiler::EmitNumber(ApplyInstruction::Run run, TransformFunction function,
                                        const double* x, const double* y, ApplyDetail* detail) {
  program_.numbers_.push_back(NumericValue::gSysmisValue);
  ApplyInstruction& step = Emit(run, function);
  step.x = x;
  step.y = y;
  step.out = &program_.numbers_.back();
  step.detail = detail;
  return step.out;
}

}  // namespace MCKestrel_800
