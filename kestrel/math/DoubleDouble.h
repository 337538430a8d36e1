// Numbers of two doubles, some 30 digits: for the exponents and arguments whose last digit would show in the
// result. Error-free sums and products after T. J. Dekker, "A floating-point technique for extending the
// available precision", Numer. Math. 18 (1971) 224-242, and D. E. Knuth's TwoSum. Not `long double`, which is
// another format on every system, and not std::fma, which is a slow call where the processor need not have
// it.

#ifndef KESTREL_MATH_DOUBLEDOUBLE_H
#define KESTREL_MATH_DOUBLEDOUBLE_H

#include <cstdint>
#include <cstring>

namespace MCMath_800 {

/// high + low, where low is no more than three halves of a unit in the last place of high. Operations err by
/// a few 2^-104 of their largest operand while everything, the low part as well, is in the range of normal
/// numbers. When high is infinite, or no number, low means nothing.
struct DoubleDouble {
  double high = 0.0;
  double low = 0.0;

  constexpr DoubleDouble() = default;
  /// The double itself: it is one of these numbers.
  constexpr DoubleDouble(double number) : high(number) {}
  constexpr DoubleDouble(double high_part, double low_part) : high(high_part), low(low_part) {}
};

/// The number without its last 27 bits: its product with another such head is exact.
inline double HeadOf(double number) {
  std::uint64_t bits;
  std::memcpy(&bits, &number, sizeof bits);
  bits &= ~std::uint64_t{0x7FFFFFF};
  std::memcpy(&number, &bits, sizeof bits);
  return number;
}

/// A sum whose first part is a head, the second up to 2^-25 of it: 79 bits, in the form that products want.
struct HeadAndTail {
  double head;
  double tail;
};
/// a.low may be as large as half a.high.
inline HeadAndTail Split(DoubleDouble a) {
  const double head = HeadOf(a.high + a.low);
  return {head, (a.high - head) + a.low};
}

/// a + b without rounding.
inline DoubleDouble AddExactly(double a, double b) {
  const double high = a + b;
  const double part = high - a;
  return {high, (a - (high - part)) + (b - part)};
}

/// The same for |a| >= |b| or a = 0.
inline DoubleDouble AddOrdered(double a, double b) {
  const double high = a + b;
  return {high, b - (high - a)};
}

/// a * b, to 2^-105.
inline DoubleDouble MultiplyExactly(double a, double b) {
  const double high = a * b;
  const double a_head = HeadOf(a), a_tail = a - a_head;
  const double b_head = HeadOf(b), b_tail = b - b_head;
  return {high, ((a_head * b_head - high) + a_head * b_tail + a_tail * b_head) + a_tail * b_tail};
}

inline DoubleDouble operator-(DoubleDouble a) {
  return {-a.high, -a.low};
}
inline DoubleDouble operator+(DoubleDouble a, DoubleDouble b) {
  const DoubleDouble sum = AddExactly(a.high, b.high);
  return AddOrdered(sum.high, sum.low + (a.low + b.low));
}
inline DoubleDouble operator-(DoubleDouble a, DoubleDouble b) {
  return a + -b;
}
inline DoubleDouble operator*(DoubleDouble a, double b) {
  const DoubleDouble product = MultiplyExactly(a.high, b);
  return {product.high, product.low + a.low * b};
}
inline DoubleDouble operator*(DoubleDouble a, DoubleDouble b) {
  const DoubleDouble product = MultiplyExactly(a.high, b.high);
  return {product.high, product.low + (a.low * b.high + a.high * b.low)};
}
inline DoubleDouble operator/(DoubleDouble a, double b) {
  const double quotient = a.high / b;
  const DoubleDouble back = MultiplyExactly(quotient, b);
  return {quotient, ((a.high - back.high) - back.low + a.low) / b};
}
inline DoubleDouble operator/(DoubleDouble a, DoubleDouble b) {
  const double quotient = a.high / b.high;
  const DoubleDouble back = MultiplyExactly(quotient, b.high);
  return {quotient, ((a.high - back.high) - back.low + a.low - quotient * b.low) / b.high};
}

}  // namespace MCMath_800

#endif  // KESTREL_MATH_DOUBLEDOUBLE_H
