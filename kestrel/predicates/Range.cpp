#include "kestrel/predicates/Range.h"

#include <algorithm>
#include <cmath>
#include <memory>
#include <ostream>

#include "kestrel/foundation/NumberText.h"
#include "kestrel/foundation/NumericValue.h"

namespace MCKestrel_800 {

namespace {

bool IsNumber(const ScoreValue* value) {
  return value != nullptr && value->GetType() == ScoreValue::kNumeric;
}

/// A minimum that is missing bounds nothing: the range reaches down to minus infinity.
void UnboundBelow(ScoreValue* min) {
  if (IsNumber(min) && min->IsSystemMissingValue()) {
    const NumericValue lowest(-NumericValue::gInfinity);
    min->SetValue(&lowest);
  }
}

ScoreValue* CloneOf(const ScoreValue* value) {
  return value == nullptr ? nullptr : value->Clone();
}

void DisplayEnd(std::ostream& out, const ScoreValue* value) {
  if (value == nullptr) {
    out << "NULL";
  } else if (value->GetType() == ScoreValue::kNumeric || value->GetType() == ScoreValue::kDateTime) {
    out << FormatSixDigits(value->GetDouble());
  } else {
    out << value->GetString();
  }
}

}  // namespace

ScoreValueRange::~ScoreValueRange() = default;

Range::Range(double min, double max, bool lowIncluded, bool highIncluded)
    : high_included_(highIncluded),
      low_included_(lowIncluded),
      single_(min == max),
      min_number_(min),
      max_number_(max) {
  auto low = std::make_unique<NumericValue>(min);
  UnboundBelow(low.get());
  max_ = new NumericValue(max);
  min_ = low.release();
  NoteReach();
}

Range::Range(ScoreValue* min, ScoreValue* max, bool lowIncluded, bool highIncluded)
    : high_included_(highIncluded),
      low_included_(lowIncluded),
      min_number_(-NumericValue::gInfinity),
      max_number_(NumericValue::gInfinity) {
  const bool same = min != nullptr && min == max;
  min_ = min != nullptr ? min : new NumericValue(-NumericValue::gInfinity);
  UnboundBelow(min_);
  NoteMin();
  if (same) {
    max_ = min_->Clone();
  } else {
    max_ = max != nullptr ? max : new NumericValue(NumericValue::gInfinity);
  }
  NoteMax();
  NoteSingle();
  NoteSingleDate();
}

Range::Range(ScoreValue* value)
    : high_included_(true),
      low_included_(true),
      min_number_(-NumericValue::gInfinity),
      max_number_(NumericValue::gInfinity) {
  min_ = value != nullptr ? value : new NumericValue(-NumericValue::gInfinity);
  UnboundBelow(min_);
  max_ = min_->Clone();
  NoteMin();
  NoteMax();
  single_ = true;
  NoteSingleDate();
}

Range::Range(const Range& other)
    : ScoreValueRange(other),
      high_included_(other.high_included_),
      low_included_(other.low_included_),
      single_(other.single_),
      min_number_(other.min_number_),
      max_number_(other.max_number_),
      lowest_(other.lowest_),
      highest_(other.highest_) {
  std::unique_ptr<ScoreValue> min(CloneOf(other.min_));
  max_ = CloneOf(other.max_);
  min_ = min.release();
}

Range& Range::operator=(const Range& other) {
  if (this == &other) return *this;
  std::unique_ptr<ScoreValue> min(CloneOf(other.min_));
  std::unique_ptr<ScoreValue> max(CloneOf(other.max_));
  DeleteEnds();
  min_ = min.release();
  max_ = max.release();
  high_included_ = other.high_included_;
  low_included_ = other.low_included_;
  single_ = other.single_;
  min_number_ = other.min_number_;
  max_number_ = other.max_number_;
  lowest_ = other.lowest_;
  highest_ = other.highest_;
  return *this;
}

Range::~Range() {
  DeleteEnds();
}

void Range::DeleteEnds() {
  // The setters may have been given one object for both ends.
  if (max_ != min_) delete max_;
  delete min_;
}

void Range::NoteMin() {
  if (IsNumber(min_)) min_number_ = min_->GetDouble();
  NoteReach();
}

void Range::NoteMax() {
  if (IsNumber(max_)) max_number_ = max_->GetDouble();
  NoteReach();
}

void Range::NoteReach() {
  // Far more than the tolerance of an end. The ends may stand the wrong way round.
  const auto slack = [](double end) { return std::fabs(end) * 1e-6; };
  const double low = std::min(min_number_, max_number_), high = std::max(min_number_, max_number_);
  lowest_ = low - slack(low);
  highest_ = high + slack(high);
}

void Range::NoteSingle() {
  single_ = min_ != nullptr && max_ != nullptr && *min_ == *max_;
}

void Range::NoteSingleDate() {
  if (!single_ || min_->GetType() != ScoreValue::kDateTime) return;
  min_number_ = max_number_ = min_->GetDouble();
  NoteReach();
}

bool Range::operator==(const ScoreValueRange& other) const {
  const auto same = [](const ScoreValue* a, const ScoreValue* b) {
    return a == nullptr || b == nullptr ? a == b : *a == *b;
  };
  return same(min_, other.GetMin()) && same(max_, other.GetMax()) && low_included_ == other.GetLowEnd() &&
         high_included_ == other.GetHighEnd();
}

ScoreValueRange* Range::Clone() const {
  return new Range(*this);
}

void Range::SetMin(ScoreValue* value) {
  if (value == nullptr) return;
  min_ = value;
  UnboundBelow(min_);
  NoteMin();
  NoteSingle();
}

void Range::SetMax(ScoreValue* value) {
  max_ = value;
  NoteMax();
  NoteSingle();
}

bool Range::IsAtEnd(double x) const {
  if (single_) return NumericValue::IsEqual(x, min_number_);
  if (NumericValue::IsSystemMissingValue(x)) return false;
  return (low_included_ && NumericValue::IsEqual(x, min_number_)) ||
         (high_included_ && NumericValue::IsEqual(x, max_number_));
}

bool Range::IsInRange(const ScoreValue* value) const {
  if (value == nullptr) return false;
  if (single_) return *value == *min_;
  if (!IsNumber(value) || value->IsSystemMissingValue()) return false;
  return IsInRange(value->GetDouble());
}

void Range::Display(std::ostream& out) const {
  out << "  Start Range Display   \nMinValue: ";
  DisplayEnd(out, min_);
  out << ";  MaxValue: ";
  DisplayEnd(out, max_);
  out << (high_included_ ? "; High End included" : "; High End not included")
      << (low_included_ ? "; lower End included" : "; lower End not included")
      << "\n End of Range Display\n\n";
}

}  // namespace MCKestrel_800
