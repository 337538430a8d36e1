// Counts the allocations of the process. A program that links AllocationCount.cpp gets the counting
// operators.

#ifndef KESTREL_TESTS_MODEL_ALLOCATIONCOUNT_H
#define KESTREL_TESTS_MODEL_ALLOCATIONCOUNT_H

#include <cstddef>

namespace kestrel_tests {

/// The calls of operator new so far, on all threads.
size_t CountAllocations();

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_MODEL_ALLOCATIONCOUNT_H
