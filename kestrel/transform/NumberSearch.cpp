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
  starts_.assign(static_cast<std::size_t>(last_cell_) + 1, 0);
  std::uint32_t below = 0;
  for (std::size_t cell = 0; cell < starts_.size(); ++cell) {
    starts_[cell] = below;
    while (below < count && CellOf(numbers_[below]) == cell)
      ++below;
    width_ = std::max<std::size_t>(width_, below - starts_[cell]);
  }
  numbers_.resize(std::max(count, starts_.back() + width_), std::numeric_limits<double>::infinity());
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
