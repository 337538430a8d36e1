// Polynomials with coefficients in tables.

#ifndef KESTREL_MATH_POLYNOMIAL_H
#define KESTREL_MATH_POLYNOMIAL_H

#include <cstddef>

namespace MCMath_800 {

/// The polynomial at x, lowest power first. Its even and odd halves are summed side by side, since one chain
/// of multiplications and additions would wait for itself.
template <std::size_t N>
double Polynomial(const double (&coefficients)[N], double x) {
  const double square = x * x;
  double even = coefficients[(N - 1) / 2 * 2];
  double odd = 0.0;
  for (std::size_t i = (N - 1) / 2 * 2; i >= 2; i -= 2)
    even = even * square + coefficients[i - 2];
  if constexpr (N > 1) {
    constexpr std::size_t kLastOdd = N / 2 * 2 - 1;
    odd = coefficients[kLastOdd];
    for (std::size_t i = kLastOdd; i >= 3; i -= 2)
      odd = odd * square + coefficients[i - 2];
  }
  return even + x * odd;
}

}  // namespace MCMath_800

#endif  // KESTREL_MATH_POLYNOMIAL_H
