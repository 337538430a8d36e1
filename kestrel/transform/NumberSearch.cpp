#include "kestrel/transform/NumberSearch.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <utility>

namespace MCKestrel_800 {
namespace {

// Numbers that are spread evenly lie this many cells apart: with one, rounding would put two in a cell.
constexpr std::size_t kCellsPerNumber = 2;

}  // namespace

NumberSearch::NumberSearch(std::vector<double> numbers) : numbers_(std::move(numbers)) {
  const std::size_t count = numbers_.size();
  ChooseCells(count);
  constexpr double kBehindAll = std::numeric_limits<double>::infinity();
  cells_.reserve(static_cast<std::size_t>(last_cell_) + 1);
  std::size_t next = 0;
  while (cells_.size() <= static_cast<std::size_t>(last_cell_)) {
    const std::size_t first = next;
    while (next < count && CellOf(numbers_[next]) == cells_.size())
      ++next;
    width_ = std::max(width_, next - first);
    cells_.push_back({first, first < count ? numbers_[first] : kBehindAll});
  }
  numbers_.resize(std::max(count, cells_.back().first + width_), kBehindAll);
}

// A range that is no number, as ends may be infinite, leaves one cell.
void NumberSearch::ChooseCells(std::size_t count) {
  const auto is_finite = [](double number) { return std::isfinite(number); };
  const auto first = std::find_if(numbers_.begin(), numbers_.end(), is_finite);
  const auto last = std::find_if(numbers_.rbegin(), numbers_.rend(), is_finite);
  if (first == numbers_.end()) return;
  const double cells_per_unit = static_cast<double>(kCellsPerNumber * count - 1) / (*last - *first);
  if (!std::isnormal(cells_per_unit)) return;
  low_ = *first;
  cells_per_unit_ = cells_per_unit;
  last_cell_ = static_cast<double>(kCellsPerNumber * count - 1);
}

}  // namespace MCKestrel_800
