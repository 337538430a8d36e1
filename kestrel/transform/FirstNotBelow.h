// A search in ascending numbers without branches on what is compared.

#ifndef KESTREL_TRANSFORM_FIRSTNOTBELOW_H
#define KESTREL_TRANSFORM_FIRSTNOTBELOW_H

#include <cstddef>

namespace MCKestrel_800 {

/// The position of the first number that is not below x; `count` when there is none. Where x lies among the
/// numbers of a field is as good as random from case to case: a branch would be guessed wrongly every other
/// time.
inline std::size_t FirstNotBelow(const double* numbers, std::size_t count, double x) {
  if (count == 0) return 0;
  const double* first = numbers;
  for (std::size_t left = count; left > 1;) {
    const std::size_t half = left / 2;
    const double* const upper = first + half;
    first = upper[-1] < x ? upper : first;
    left -= half;
  }
  return static_cast<std::size_t>(first - numbers) + static_cast<std::size_t>(*first < x);
}

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSFORM_FIRSTNOTBELOW_H
