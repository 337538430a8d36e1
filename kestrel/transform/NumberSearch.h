// A search in ascending numbers without branches on what is compared.

#ifndef KESTREL_TRANSFORM_NUMBERSEARCH_H
#define KESTREL_TRANSFORM_NUMBERSEARCH_H

#include <cstddef>
#include <cstdint>
#include <vector>

namespace MCKestrel_800 {

/// Finds where a number stands among ascending ones. Where it lies is as good as random from case to case: a
/// branch would be guessed wrongly every other time.
///
/// The range of the numbers is cut into cells of one width. A number's cell is rounded, but never falls as
/// numbers rise; so what lies in a lower cell is lower and what lies in a higher cell is higher, and only the
/// numbers of the cell itself are left to search. Spread evenly, as ends of bins and points of curves mostly
/// are, that is one number; in the worst case all of them, by halving.
class NumberSearch {
 public:
  NumberSearch() : NumberSearch(std::vector<double>()) {}
  /// numbers  ascending, none of them NaN; fewer than 2^30.
  explicit NumberSearch(std::vector<double> numbers);

  /// The position of the first number that is not below x; their count when there is none. Of NaN, any of
  /// these.
  std::size_t FirstNotBelow(double x) const {
    const Cell& cell = cells_[CellOf(x)];
    if (width_ > 1) return FirstOfCell(cell.first, x);
    return cell.first + static_cast<std::size_t>(cell.number < x);
  }

 private:
  struct Cell {
    std::size_t first;  ///< the first number that does not lie in a lower cell
    double number;
  };

  // What is NaN, or gives NaN as infinities may where there is one cell, has some cell, too.
  std::size_t CellOf(double x) const {
    const double from_low = (x > low_ ? x : low_) - low_;
    const double cell = from_low * cells_per_unit_;
    return static_cast<std::size_t>(static_cast<std::int64_t>(cell < last_cell_ ? cell : last_cell_));
  }
  std::size_t FirstOfCell(std::size_t first, double x) const {
    for (std::size_t left = width_; left > 1;) {
      const std::size_t half = left / 2;
      first += numbers_[first + half - 1] < x ? half : 0;
      left -= half;
    }
    return first + static_cast<std::size_t>(numbers_[first] < x);
  }
  void ChooseCells(std::size_t count);

  double low_ = 0.0;
  double cells_per_unit_ = 0.0;
  double last_cell_ = 0.0;
  std::size_t width_ = 1;  ///< how many numbers are searched: those of the fullest cell
  std::vector<Cell> cells_;
  std::vector<double> numbers_;  ///< with infinities behind them, so that each cell has as many
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSFORM_NUMBERSEARCH_H
