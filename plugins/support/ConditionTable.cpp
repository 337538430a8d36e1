#include "plugins/support/ConditionTable.h"

#include <algorithm>
#include <cmath>
#include <cstring>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/foundation/KestrelException.h"
#include "kestrel/predicates/CompoundPredicate.h"
#include "kestrel/predicates/DiscreteSplit.h"
#include "kestrel/predicates/ScaleSplit.h"
#include "kestrel/predicates/ScoreValueRange.h"
#include "kestrel/translate/ReaderFault.h"
#include "plugins/support/PredicateInputs.h"

namespace MCKestrel_800 {
namespace {

using Result = ScorePredicate::PredicateResult;

constexpr int kCodesInMask = 64;
/// More steps between neighbouring doubles than NumericValue::IsEqual ever calls equal: its relative
/// tolerance is a hundred times the distance of doubles just above a power of two, two hundred times that
/// below one.
constexpr std::int64_t kEqualSteps = 512;

Condition MakeCondition(Condition::Kind kind, int slot = 0) {
  Condition condition;
  condition.codes = 0;
  condition.slot = static_cast<std::uint32_t>(slot) & 0xFFFFFFu;
  condition.kind = kind;
  condition.decides = Condition::kDecidesNothing;
  condition.next = 0;
  return condition;
}

Condition MakeNumber(Condition::Kind kind, int slot, double number) {
  Condition condition = MakeCondition(kind, slot);
  condition.number = number;
  return condition;
}

/// Doubles as whole numbers that have the same order, and back.
std::int64_t OrderOf(double number) {
  std::int64_t bits;
  std::memcpy(&bits, &number, sizeof bits);
  return bits < 0 ? std::numeric_limits<std::int64_t>::min() - bits : bits;
}
double NumberAt(std::int64_t order) {
  const std::int64_t bits = order < 0 ? std::numeric_limits<std::int64_t>::min() - order : order;
  double number;
  std::memcpy(&number, &bits, sizeof number);
  return number;
}

/// The last number, from `bound` in the given direction (1 or -1), that is equal to `bound` by the tolerance.
/// Equality ends once and for all along the way, so the end is found by halving.
double LastEqual(double bound, int direction) {
  const std::int64_t start = OrderOf(bound);
  std::int64_t equal = 0;
  std::int64_t different = kEqualSteps;
  while (different - equal > 1) {
    const std::int64_t middle = (equal + different) / 2;
    if (NumericValue::IsEqual(NumberAt(start + direction * middle), bound)) {
      equal = middle;
    } else {
      different = middle;
    }
  }
  return NumberAt(start + direction * equal);
}

/// The largest number inside a range that has no lower bound.
double LargestInside(double bound, bool is_included) {
  // Infinities and numbers next to zero are not even equal to themselves.
  if (is_included && NumericValue::IsEqual(bound, bound)) return LastEqual(bound, 1);
  return std::nextafter(bound, -NumericValue::gInfinity);
}

/// The largest number below a range that has no upper bound.
double LargestBelow(double bound, bool is_included) {
  if (is_included && NumericValue::IsEqual(bound, bound)) {
    return std::nextafter(LastEqual(bound, -1), -NumericValue::gInfinity);
  }
  return bound;
}

double LowEndOf(const ScoreValueRange& range) {
  return range.GetMin()->GetDouble();
}
double HighEndOf(const ScoreValueRange& range) {
  return range.GetMax()->GetDouble();
}

[[noreturn]] void FailOnSplit() {
  Fail(KestrelException::kUnsupported, "A split of this shape: Not supported!");
}

Result ToResult(bool is_true) {
  return is_true ? ScorePredicate::PredTrue : ScorePredicate::PredFalse;
}

Result EvaluateNumber(const Condition& condition, double x) {
  if (!IsOrdinary(x)) {
    if (x == NumericValue::gSysmisValue) {
      return condition.kind == Condition::kMissing ? ScorePredicate::PredTrue : ScorePredicate::PredUnknown;
    }
    // Infinities and NaN lie in no range; the largest number is one like any other.
    if (x != std::numeric_limits<double>::max()) return ScorePredicate::PredFalse;
  }
  switch (condition.kind) {
    case Condition::kAtMost:
      return ToResult(x <= condition.number);
    case Condition::kAbove:
      return ToResult(x > condition.number);
    case Condition::kEqual:
      return ToResult(NumericValue::IsEqual(x, condition.number));
    case Condition::kNotEqual:
      return ToResult(x != condition.number);
    default:
      return ToResult(condition.kind == Condition::kPresent);
  }
}

}  // namespace

Condition ConditionTable::Compile(const ScorePredicate* predicate, PredicateInputs& inputs) {
  if (predicate == nullptr) return MakeCondition(Condition::kUndecided);
  switch (predicate->GetPredType()) {
    case ScorePredicate::kTrue:
      return MakeCondition(Condition::kAlways);
    case ScorePredicate::kFalse:
      return MakeCondition(Condition::kNever);
    case ScorePredicate::kCompound: {
      const std::size_t part = parts_.size();
      AddPart(predicate, inputs);
      Condition condition = parts_[part];
      condition.span = {static_cast<std::uint32_t>(part), 1};
      return condition;
    }
    default:
      break;
  }
  const ScoreSplitVar* split = predicate->GetSplit();
  if (split == nullptr) return MakeCondition(Condition::kUndecided);
  if (split->GetSplitVarType() == ScoreSplitVar::kScale) {
    return CompileNumber(static_cast<const ScaleSplit&>(*split), inputs);
  }
  return CompileCategory(static_cast<const DiscreteSplit&>(*split), inputs);
}

Condition ConditionTable::CompileNumber(const ScaleSplit& split, PredicateInputs& inputs) {
  // The codes of an ordinal field are in its slot, not its numbers.
  if (split.GetSplitVar()->GetMLevel() != ScoreDictVar::kContinuous) FailOnSplit();
  const int slot = inputs.SlotOf(*split.GetSplitVar());
  const std::size_t count = split.GetRangeCount();
  if (count == 0) return MakeCondition(Condition::kMissing, slot);
  if (split.GetMissvalMap() != -1) FailOnSplit();
  const ScoreValueRange& range = split.GetRange(0);
  const double low = LowEndOf(range);
  const double high = HighEndOf(range);
  const double infinity = NumericValue::gInfinity;
  if (count == 2 && low == -infinity && HighEndOf(split.GetRange(1)) == infinity) {
    return MakeNumber(Condition::kNotEqual, slot, high);
  }
  if (count != 1) FailOnSplit();
  if (*range.GetMin() == *range.GetMax() || low == high) return MakeNumber(Condition::kEqual, slot, low);
  if (low == -infinity && high == infinity) return MakeCondition(Condition::kPresent, slot);
  if (low == -infinity) {
    return MakeNumber(Condition::kAtMost, slot, LargestInside(high, range.GetHighEnd()));
  }
  if (high == infinity) return MakeNumber(Condition::kAbove, slot, LargestBelow(low, range.GetLowEnd()));
  FailOnSplit();
}

Condition ConditionTable::CompileCategory(const DiscreteSplit& split, PredicateInputs& inputs) {
  const ScoreDictVar& variable = *split.GetSplitVar();
  const int slot = inputs.SlotOf(variable);
  const std::vector<CodeMap::Run>& runs = split.GetCodes().GetRuns();
  if (split.GetMissvalMap() != -1) {
    if (!runs.empty()) FailOnSplit();
    const bool is_nominal = variable.GetMLevel() == ScoreDictVar::kNominal;
    return MakeCondition(is_nominal ? Condition::kNoCategory : Condition::kMissingCategory, slot);
  }
  Condition condition = MakeCondition(Condition::kCodes, slot);
  if (runs.empty() || runs.back().last < kCodesInMask) {
    for (const CodeMap::Run& run : runs) {
      for (int code = static_cast<int>(run.first); code <= static_cast<int>(run.last); ++code)
        condition.codes |= std::uint64_t{1} << code;
    }
    return condition;
  }
  condition.kind = Condition::kCodeRuns;
  condition.span = {static_cast<std::uint32_t>(runs_.size()), static_cast<std::uint32_t>(runs.size())};
  for (const CodeMap::Run& run : runs)
    runs_.push_back({static_cast<std::int32_t>(run.first), static_cast<std::int32_t>(run.last)});
  return condition;
}

void ConditionTable::AddPart(const ScorePredicate* predicate, PredicateInputs& inputs) {
  const std::size_t part = parts_.size();
  if (predicate == nullptr || predicate->GetPredType() != ScorePredicate::kCompound) {
    parts_.push_back(Compile(predicate, inputs));
  } else {
    const auto& compound = static_cast<const CompoundPredicate&>(*predicate);
    constexpr Condition::Kind kKinds[] = {Condition::kOr, Condition::kAnd, Condition::kXor,
                                          Condition::kSurrogate};
    parts_.push_back(MakeCondition(kKinds[compound.GetBoolOperator()]));
    for (const ScorePredicate* child : compound.GetPredicates())
      AddPart(child, inputs);
  }
  parts_[part].next = static_cast<std::int32_t>(parts_.size());
}

void ConditionTable::Seal() {
  parts_.shrink_to_fit();
  runs_.shrink_to_fit();
}

Result ConditionTable::Evaluate(const Condition& condition, const double* values) const {
  switch (condition.kind) {
    case Condition::kAlways:
      return ScorePredicate::PredTrue;
    case Condition::kNever:
      return ScorePredicate::PredFalse;
    case Condition::kUndecided:
      return ScorePredicate::PredUnknown;
    case Condition::kAtMost:
    case Condition::kAbove:
    case Condition::kEqual:
    case Condition::kNotEqual:
    case Condition::kPresent:
    case Condition::kMissing:
      return EvaluateNumber(condition, values[condition.slot]);
    case Condition::kCodes:
    case Condition::kCodeRuns:
    case Condition::kMissingCategory:
    case Condition::kNoCategory:
      return EvaluateCategory(condition, values[condition.slot]);
    default:
      return EvaluateCompound(condition.span.first, values);
  }
}

Result ConditionTable::EvaluateCategory(const Condition& condition, double code) const {
  if (code < 0) {
    const bool is_missing = code == CaseVector::kMissingCategory;
    if (condition.kind == Condition::kNoCategory) return ScorePredicate::PredTrue;
    if (condition.kind == Condition::kMissingCategory) return ToResult(is_missing);
    return is_missing ? ScorePredicate::PredUnknown : ScorePredicate::PredFalse;
  }
  // The first test keeps the conversion to a whole number defined, for NaN as well.
  if (!(code <= std::numeric_limits<std::int32_t>::max())) return ScorePredicate::PredFalse;
  const auto whole = static_cast<std::int32_t>(code);
  if (whole != code) return ScorePredicate::PredFalse;
  if (condition.kind == Condition::kCodes) {
    return ToResult(whole < kCodesInMask && (condition.codes >> whole & 1) != 0);
  }
  if (condition.kind != Condition::kCodeRuns) return ScorePredicate::PredFalse;
  const CodeRun* const first = runs_.data() + condition.span.first;
  const CodeRun* const last = first + condition.span.count;
  const CodeRun* const run = std::lower_bound(
      first, last, whole, [](const CodeRun& entry, std::int32_t wanted) { return entry.last < wanted; });
  return ToResult(run != last && run->first <= whole);
}

// The rules are those of CompoundPredicate.
Result ConditionTable::EvaluateCompound(std::size_t part, const double* values) const {
  const Condition& compound = parts_[part];
  const auto end = static_cast<std::size_t>(compound.next);
  bool met_unknown = false;
  bool is_odd = false;
  for (std::size_t i = part + 1; i < end; i = static_cast<std::size_t>(parts_[i].next)) {
    const Result result =
        parts_[i].kind >= Condition::kOr ? EvaluateCompound(i, values) : Evaluate(parts_[i], values);
    switch (compound.kind) {
      case Condition::kOr:
        if (result == ScorePredicate::PredTrue) return result;
        break;
      case Condition::kAnd:
        if (result == ScorePredicate::PredFalse) return result;
        break;
      case Condition::kXor:
        if (result == ScorePredicate::PredUnknown) return result;
        is_odd ^= result == ScorePredicate::PredTrue;
        break;
      default:
        if (result == ScorePredicate::PredUnknown) break;
        return result == ScorePredicate::PredTrue && i != part + 1 ? ScorePredicate::PredSurrogateTrue
                                                                   : result;
    }
    met_unknown |= result == ScorePredicate::PredUnknown;
  }
  if (met_unknown || compound.kind == Condition::kSurrogate) return ScorePredicate::PredUnknown;
  return ToResult(compound.kind == Condition::kAnd || is_odd);
}

std::size_t ConditionTable::GetMemorySize() const {
  return parts_.capacity() * sizeof(Condition) + runs_.capacity() * sizeof(CodeRun);
}

}  // namespace MCKestrel_800
