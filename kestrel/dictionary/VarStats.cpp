#include "kestrel/dictionary/VarStats.h"

#include <limits>

#include "kestrel/foundation/NumericValue.h"

namespace MCKestrel_800 {

ScoreVarStats::~ScoreVarStats() = default;

VarStats::VarStats()
    : VarStats(NumericValue::GetSysmisValue(), std::numeric_limits<double>::max(), 0.0, 1.0) {}

VarStats::VarStats(double min, double max, double mean, double stddev)
    : min_(min), max_(max), mean_(mean), stddev_(stddev) {}

VarStats::VarStats(const VarStats& other)
    : ScoreVarStats(other),
      min_(other.min_),
      max_(other.max_),
      mean_(other.mean_),
      stddev_(other.stddev_),
      missingReplacement_(other.missingReplacement_ ? other.missingReplacement_->Clone() : nullptr) {}

VarStats& VarStats::operator=(const VarStats& other) {
  if (this == &other) return *this;
  SetMissingReplacement(other.missingReplacement_.get());
  min_ = other.min_;
  max_ = other.max_;
  mean_ = other.mean_;
  stddev_ = other.stddev_;
  return *this;
}

VarStats::~VarStats() = default;

VarStats* VarStats::Clone() const {
  return new VarStats(*this);
}

void VarStats::SetMin(double min) {
  min_ = min;
}

void VarStats::SetMax(double max) {
  max_ = max;
}

void VarStats::SetStddev(double stddev) {
  stddev_ = stddev;
}

void VarStats::SetMean(double mean) {
  mean_ = mean;
}

void VarStats::SetMissingReplacement(const ScoreValue* value) {
  // The clone is made before the old value goes: the argument may be that value.
  missingReplacement_.reset(value == nullptr ? nullptr : value->Clone());
}

double VarStats::GetMin() const {
  return min_;
}

double VarStats::GetMax() const {
  return max_;
}

double VarStats::GetStddev() const {
  return stddev_;
}

double VarStats::GetMean() const {
  return mean_;
}

const ScoreValue* VarStats::GetMissingReplacement() const {
  return missingReplacement_.get();
}

}  // namespace MCKestrel_800
