// Where an operation stands among a class's virtual operations: part of the interface with libraries that
// were built at another time.

#ifndef KESTREL_TESTS_SUPPORT_OPERATIONNUMBER_H
#define KESTREL_TESTS_SUPPORT_OPERATIONNUMBER_H

#include <cstddef>
#include <cstring>
#include <numeric>
#include <vector>

namespace kestrel_tests {

/// The number of a virtual operation, counted from 1 after the destructor, as the C++ ABI of g++ and clang
/// lays classes out on x86-64, on Linux and Windows alike; -1 for an operation that is not virtual. Of no use
/// elsewhere.
template <typename Operation>
long OperationNumber(Operation operation) {
  std::ptrdiff_t parts[2];
  static_assert(sizeof operation == sizeof parts, "not a member function");
  std::memcpy(parts, &operation, sizeof parts);
  // Virtual ones hold their place in the table in bytes, plus one. The destructor takes the first two places.
  if (parts[0] % 2 == 0) return -1;
  return static_cast<long>((parts[0] - 1) / static_cast<std::ptrdiff_t>(sizeof(void*))) - 1;
}

/// The numbers that so many operations have when they are listed in their order: 1, 2, 3, ...
inline std::vector<long> InOrder(std::size_t count) {
  std::vector<long> numbers(count);
  std::iota(numbers.begin(), numbers.end(), 1L);
  return numbers;
}

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_SUPPORT_OPERATIONNUMBER_H
