#include "plugins/support/NumberCodes.h"

#include <algorithm>
#include <cmath>

#include "kestrel/foundation/NumericValue.h"

namespace MCKestrel_800 {
namespace {

// Every number that IsEqual accepts for x lies within this share of |x| from x.
constexpr double kReach = 2.0 * 2.22045e-14;

}  // namespace

const NumberCodes::Entry* NumberCodes::FindBuilding(double number) const {
  const double reach = std::fabs(number) * kReach;
  const auto end = building_.upper_bound(number + reach);
  const Entry* first = nullptr;
  for (auto at = building_.lower_bound(number - reach); at != end; ++at) {
    if (NumericValue::IsEqual(number, at->first) && (first == nullptr || at->second.rank < first->rank)) {
      first = &at->second;
    }
  }
  return first;
}

int NumberCodes::Add(double number, int code) {
  if (!std::isfinite(number))
    return kUnknown;  // equal to nothing, itself included, so it could never be found
  if (const Entry* entry = FindBuilding(number)) return entry->code;
  building_.emplace(number, Entry{number, static_cast<int>(building_.size()), code});
  return code;
}

void NumberCodes::Seal() {
  entries_.reserve(building_.size());
  for (const auto& [number, entry] : building_)
    entries_.push_back(entry);
  building_.clear();
}

int NumberCodes::Find(double number) const {
  if (!std::isfinite(number)) return kUnknown;
  if (!building_.empty()) {
    const Entry* entry = FindBuilding(number);
    return entry == nullptr ? kUnknown : entry->code;
  }
  const double reach = std::fabs(number) * kReach;
  auto at = std::lower_bound(entries_.begin(), entries_.end(), number - reach,
                             [](const Entry& entry, double bound) { return entry.number < bound; });
  const Entry* first = nullptr;
  for (; at != entries_.end() && at->number <= number + reach; ++at) {
    if (NumericValue::IsEqual(number, at->number) && (first == nullptr || at->rank < first->rank))
      first = &*at;
  }
  return first == nullptr ? kUnknown : first->code;
}

}  // namespace MCKestrel_800
