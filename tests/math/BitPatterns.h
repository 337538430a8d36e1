// Doubles of any bit pattern, for functions that must stand all of them.

#ifndef KESTREL_TESTS_MATH_BITPATTERNS_H
#define KESTREL_TESTS_MATH_BITPATTERNS_H

#include <cstdint>
#include <cstring>
#include <limits>
#include <random>

namespace kestrel_tests {

/// A seeded stream of doubles: any bits, numbers of ordinary size, and the edges of the format in turn.
class BitPatterns {
 public:
  explicit BitPatterns(std::uint64_t seed) : random_(seed) {}

  double Next() {
    using Limits = std::numeric_limits<double>;
    constexpr double kEdges[] = {0.0,
                                 -0.0,
                                 0.5,
                                 1.0,
                                 -1.0,
                                 2.0,
                                 Limits::min(),
                                 -Limits::min(),
                                 Limits::denorm_min(),
                                 -Limits::denorm_min(),
                                 Limits::max(),
                                 Limits::lowest(),
                                 Limits::infinity(),
                                 -Limits::infinity(),
                                 Limits::epsilon(),
                                 1.0 - Limits::epsilon() / 2.0,
                                 1e7,
                                 1e16,
                                 2147483647.0};
    const std::uint64_t bits = random_();
    switch (random_() % 8) {
      case 0:
        return kEdges[bits % (sizeof kEdges / sizeof *kEdges)];
      case 1:  // a NaN with a payload, or an infinity
        return FromBits(bits | 0x7ff0000000000000u);
      case 2:
        return static_cast<double>(bits >> 11) * 0x1p-53;
      case 3:  // -64 to 64
        return (static_cast<double>(bits >> 11) * 0x1p-53 - 0.5) * 128.0;
      case 4:
        return static_cast<double>(static_cast<int>(bits % 4001) - 2000);
      case 5:  // 1e-10 to 1e20 or so
        return FromBits((bits >> 12) | ((990 + random_() % 100) << 52));
      default:
        return FromBits(bits);
    }
  }

 private:
  static double FromBits(std::uint64_t bits) {
    double number;
    std::memcpy(&number, &bits, sizeof number);
    return number;
  }

  std::mt19937_64 random_;
};

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_MATH_BITPATTERNS_H
