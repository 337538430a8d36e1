#include "kestrel/transform/BinTable.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <typeinfo>

#include "kestrel/foundation/NumericValue.h"
#include "kestrel/predicates/Range.h"

namespace MCKestrel_800 {
namespace {

constexpr std::size_t kWalked = 2;
constexpr double kInfinity = std::numeric_limits<double>::infinity();

// An end of a range as a number; an absent one is an infinity. False when it is another value.
bool ReadEnd(const ScoreValue* end, double infinity, double& number) {
  number = infinity;
  if (end == nullptr) return true;
  if (typeid(*end) != typeid(NumericValue)) return false;
  number = end->GetDouble();
  if (NumericValue::IsSystemMissingValue(number)) number = infinity;
  return !std::isnan(number);
}

// Twice the tolerance of NumericValue::IsEqual: how far an end that is included may reach.
double Tolerance(double end) {
  return std::isinf(end) ? 0.0 : std::fabs(end) * 2 * NumericValue::fEpsilon;
}

}  // namespace

BinTable::BinTable(const std::vector<TransformVar::Bin>& bins) : bins_(bins) {
  ReadReaches();
  MakeCores();
}

void BinTable::ReadReaches() {
  if (bins_.size() <= kWalked) return;
  std::vector<Reach> reaches;
  reaches.reserve(bins_.size());
  for (std::size_t bin = 0; bin < bins_.size(); ++bin) {
    const ScoreValueRange* const range = bins_[bin].range.get();
    if (range == nullptr || typeid(*range) != typeid(Range)) return;
    double low, high;
    if (!ReadEnd(range->GetMin(), -kInfinity, low) || !ReadEnd(range->GetMax(), kInfinity, high)) return;
    if (low > high) return;  // its ends may be in it, and nothing between them
    reaches.push_back({low - Tolerance(low), high + Tolerance(high), static_cast<const Range*>(range), bin});
  }
  std::sort(reaches.begin(), reaches.end(),
            [](const Reach& a, const Reach& b) { return a.low != b.low ? a.low < b.low : a.high < b.high; });
  std::vector<double> highs;
  highs.reserve(reaches.size());
  for (const Reach& reach : reaches) {
    // A bin within another one: the list is no row of neighbours.
    if (!highs.empty() && reach.high < highs.back()) return;
    highs.push_back(reach.high);
  }
  reaches_ = std::move(reaches);
  highs_ = NumberSearch(std::move(highs));
}

void BinTable::MakeCores() {
  cores_.reserve(reaches_.size() + 1);
  for (std::size_t i = 0; i < reaches_.size(); ++i) {
    const Reach& reach = reaches_[i];
    double low, high;
    ReadEnd(reach.range->GetMin(), reach.low, low);
    ReadEnd(reach.range->GetMax(), reach.high, high);
    // A bin of a single value has no inside: its ends' tolerances meet.
    Core core = {low + Tolerance(low), high - Tolerance(high), reach.bin};
    // No bin holds the system-missing value, which is the lowest of the numbers.
    core.low = std::max(core.low, NumericValue::gSysmisValue);
    if (i > 0) core.low = std::max(core.low, reaches_[i - 1].high);
    if (i + 1 < reaches_.size()) core.high = std::min(core.high, reaches_[i + 1].low);
    cores_.push_back(core);
  }
  cores_.push_back({kInfinity, -kInfinity, kNone});
}

std::size_t BinTable::Walk(double number) const {
  for (std::size_t bin = 0; bin < bins_.size(); ++bin) {
    const ScoreValueRange* const range = bins_[bin].range.get();
    if (range != nullptr && range->IsInRange(number)) return bin;
  }
  return kNone;
}

std::size_t BinTable::Find(double number) const {
  if (reaches_.empty()) return Walk(number);
  std::size_t first = kNone;
  // From the first bin that may reach as far as the number.
  for (std::size_t at = highs_.FirstNotBelow(number); at < reaches_.size() && reaches_[at].low <= number;
       ++at) {
    if (reaches_[at].bin < first && reaches_[at].range->Range::IsInRange(number)) first = reaches_[at].bin;
  }
  return first;
}

}  // namespace MCKestrel_800
