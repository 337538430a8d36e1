#include "apps/kestrel/ExpressionText.h"

#include <cmath>

#include "apps/kestrel/PredictionColumns.h"
#include "apps/kestrel/ShownText.h"
#include "apps/kestrel/TableWriter.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/predicates/ScoreValueRange.h"
#include "kestrel/transform/FunctionTree.h"
#include "kestrel/transform/TransformVar.h"
#include "kestrel/transform/ValueMatcher.h"

namespace kestrel_program {
namespace {

using namespace MCKestrel_800;

constexpr const char* kMissing = "missing";

/// How tightly an operator holds its arguments.
enum Level : int { kWhole = 0, kComparison = 1, kSum = 2, kProduct = 3, kPrimary = 4 };

struct Operator {
  TransformFunction code;
  const char* sign;
  Level level;
};

constexpr Operator kOperators[] = {
    {kPlusFunction, " + ", kSum},
    {kMinusFunction, " - ", kSum},
    {kMultiplyFunction, " * ", kProduct},
    {kDivideFunction, " / ", kProduct},
    {kEqualFunction, " == ", kComparison},
    {kNotEqualFunction, " != ", kComparison},
    {kLessThanFunction, " < ", kComparison},
    {kLessOrEqualFunction, " <= ", kComparison},
    {kGreaterThanFunction, " > ", kComparison},
    {kGreaterOrEqualFunction, " >= ", kComparison},
};

/// Null for what is written as a call.
const Operator* OperatorOf(const FunctionTree& node) {
  if (node.GetChildCount() != 2) return nullptr;
  for (const Operator& row : kOperators) {
    if (row.code == node.GetNodeStats().GetTransFunction()) return &row;
  }
  return nullptr;
}

/// As PMML calls them, like functions.
const char* NameOf(TransExpression kind) {
  switch (kind) {
    case TransExpression::kNormContinuous:
      return "normContinuous";
    case TransExpression::kNormDiscrete:
      return "normDiscrete";
    case TransExpression::kDiscretize:
      return "discretize";
    default:
      return "mapValues";
  }
}

bool IsUnbounded(const ScoreValue* end) {
  return end == nullptr || end->IsSystemMissingValue() || std::isinf(end->GetDouble());
}

/// Lists are put together with a comma and a blank before each part.
std::string WithoutFirstMark(const std::string& list) {
  return list.empty() ? list : list.substr(2);
}

/// As much as fits, cut where a character begins.
std::string CutTo(std::size_t size, std::string text) {
  if (text.size() <= size) return text;
  while (size > 0 && (static_cast<unsigned char>(text[size]) & 0xC0u) == 0x80u)
    --size;
  text.resize(size);
  return text + "... (see --json)";
}

}  // namespace

std::string RangeText(const ScoreValueRange& range) {
  const ScoreValue* low = range.GetMin();
  const ScoreValue* high = range.GetMax();
  if (low != nullptr && high != nullptr && *low == *high) return TextOf(*low);
  const std::string begin = IsUnbounded(low) ? "(-inf" : (range.GetLowEnd() ? "[" : "(") + TextOf(*low);
  const std::string end = IsUnbounded(high) ? "inf)" : TextOf(*high) + (range.GetHighEnd() ? "]" : ")");
  return begin + ", " + end;
}

ExpressionText ExpressionText::Short(std::size_t most) {
  ExpressionText text;
  text.most_ = most;
  text.is_short_ = true;
  return text;
}

std::string ExpressionText::Of(const TransformVar& field) const {
  constexpr std::size_t kLongest = 600;
  return is_short_ ? CutTo(kLongest, WithoutLimit(field)) : WithoutLimit(field);
}

std::string ExpressionText::WithoutLimit(const TransformVar& field) const {
  const TransExpression kind = field.GetTransExpression();
  if (kind == TransExpression::kConstant) return Constant(field);
  if (kind == TransExpression::kFieldRef) {
    const std::string replacements = WithoutFirstMark(Replacements(field));
    return Name(field.GetFieldName()) + (replacements.empty() ? "" : "{" + replacements + "}");
  }
  if (kind != TransExpression::kApply) return Table(field, NameOf(kind));
  std::string text;
  if (field.GetRoot() == nullptr) return kMissing;
  AppendTree(*field.GetRoot(), kWhole, text);
  return text;
}

std::string ExpressionText::Constant(const TransformVar& field) const {
  const std::string& text = field.GetConstString();
  if (field.GetVarType() == ScoreDictVar::STRING_VAR) return Quoted(text);
  if (field.GetVarType() == ScoreDictVar::kDATETIME_VAR) return Name(text);
  const NumericValue number(text);
  return Value(&number);
}

std::string ExpressionText::Table(const TransformVar& field, const char* name) const {
  std::string text = Rows(field);
  if (!text.empty()) text.insert(0, ", ");
  if (field.GetTransExpression() == TransExpression::kNormContinuous) {
    if (field.GetOutlierTreatment() == ScoreDictVar::kAsExtremeValues) text += ", outliers asExtremeValues";
    if (field.GetOutlierTreatment() == ScoreDictVar::kAsMissingValues) text += ", outliers asMissingValues";
  } else {
    text += ", else " +
            (field.IsRecodeElseCopy() ? Name(field.GetFieldName()) : Value(field.GetRecodeDefaultValue()));
  }
  text += Replacements(field);
  return std::string(name) + "(" + Name(field.GetFieldName()) + "): " + WithoutFirstMark(text);
}

std::string ExpressionText::Rows(const TransformVar& field) const {
  constexpr const char* kRows = "rows";
  std::string text;
  for (std::size_t i = 0; i < field.GetOrig().size(); ++i) {
    if (!BeginEntry(i, field.GetOrig().size(), kRows, text)) break;
    AppendNumber(field.GetOrig()[i], text);
    text += " -> ";
    AppendNumber(field.GetNorm()[i], text);
  }
  for (std::size_t i = 0; i < field.GetBins().size(); ++i) {
    if (!BeginEntry(i, field.GetBins().size(), kRows, text)) break;
    const TransformVar::Bin& bin = field.GetBins()[i];
    text += bin.range == nullptr ? std::string(kMissing) : RangeText(*bin.range);
    text += " -> " + (bin.value == nullptr ? Name(field.GetFieldName()) : Value(bin.value.get()));
  }
  for (std::size_t i = 0; i < field.GetAllEncodedValues().size(); ++i) {
    if (!BeginEntry(i, field.GetAllEncodedValues().size(), kRows, text)) break;
    const TransformVar::Encoding& row = field.GetAllEncodedValues()[i];
    const auto* listed = dynamic_cast<const ValueMatcher*>(row.matcher.get());
    text += (listed == nullptr ? std::string("?") : Value(listed->GetValue())) + " -> ";
    text += Value(row.value.get());
  }
  return text;
}

std::string ExpressionText::Replacements(const TransformVar& field) const {
  std::string text;
  if (field.IsRecodeMissingCopy()) {
    text += ", missing -> " + Name(field.GetFieldName());
  } else if (field.GetRecodeMissValueRep() != nullptr) {
    text += ", missing -> " + Value(field.GetRecodeMissValueRep());
  }
  if (field.GetRecodeSysmisValueRep() != nullptr)
    text += ", no value -> " + Value(field.GetRecodeSysmisValueRep());
  return text;
}

// As deep as the document's elements, whose depth the reader limits.
void ExpressionText::AppendTree(const FunctionTree& node, int level, std::string& out) const {
  const ApplyNodeStats& stats = node.GetNodeStats();
  if (stats.GetTransFunction() == kNoFunction) return AppendLeaf(node, out);
  const ScoreValue* replacement = stats.GetRecodeMissValueTo();
  const Operator* sign = OperatorOf(node);
  if (sign == nullptr) {
    AppendCall(node, out);
  } else {
    const bool is_inner = replacement != nullptr || sign->level < level;
    if (is_inner) out += '(';
    // Of operators of one kind the left one comes first; comparisons are never read that way.
    AppendTree(*node.GetChildAt(0), sign->level == kComparison ? kSum : sign->level, out);
    out += sign->sign;
    AppendTree(*node.GetChildAt(1), sign->level + 1, out);
    if (is_inner) out += ')';
  }
  if (replacement != nullptr) out += "{missing -> " + Value(replacement) + "}";
}

void ExpressionText::AppendLeaf(const FunctionTree& node, std::string& out) const {
  const ApplyNodeStats& stats = node.GetNodeStats();
  if (stats.IsConstNode()) {
    out += Value(stats.GetValue());
    return;
  }
  out += Name(stats.GetParameterName());
  const ScoreValue* replacement = stats.GetFieldrefRecodeMissValueTo();
  if (replacement != nullptr) out += "{missing -> " + Value(replacement) + "}";
}

void ExpressionText::AppendCall(const FunctionTree& node, std::string& out) const {
  const ApplyNodeStats& stats = node.GetNodeStats();
  out += Name(stats.GetParameterName()) + "(";
  const std::vector<FunctionTree*>& arguments = node.Children();
  for (std::size_t i = 0; i < arguments.size(); ++i) {
    if (!BeginEntry(i, arguments.size(), "arguments", out)) break;
    AppendTree(*arguments[i], kWhole, out);
  }
  for (int array = 0; array < stats.GetNumberOfArray(); ++array) {
    out += arguments.empty() && array == 0 ? "[" : ", [";
    const std::vector<const ScoreValue*> values = stats.GetArray(array);
    for (std::size_t i = 0; i < values.size(); ++i) {
      if (!BeginEntry(i, values.size(), "values", out)) break;
      out += Value(values[i]);
    }
    out += ']';
  }
  out += ')';
}

std::string ExpressionText::Value(const ScoreValue* value) const {
  if (value == nullptr || value->IsSystemMissingValue()) return kMissing;
  if (const auto* text = dynamic_cast<const StringValue*>(value)) return Quoted(text->GetText());
  return TextOf(*value);
}

std::string ExpressionText::Quoted(const std::string& text) const {
  std::string quoted = "\"";
  for (const char c : Name(text)) {
    if (c == '"' || c == '\\') quoted += '\\';
    quoted += c;
  }
  return quoted + "\"";
}

std::string ExpressionText::Name(const std::string& name) const {
  return is_short_ ? ShownText(name) : name;
}

bool ExpressionText::BeginEntry(std::size_t index, std::size_t count, const char* what,
                                std::string& out) const {
  if (index > 0) out += ", ";
  if (index < most_) return true;
  out += "... " + std::to_string(count - index) + " more " + what + " (see --json)";
  return false;
}

}  // namespace kestrel_program
