// Counts how often a test program and the libraries that it loads ask the heap for memory. A program gets the
// count and the tests that it works there by COUNTS_ALLOCATIONS in its kestrel_add_test.

#ifndef KESTREL_TESTS_SUPPORT_ALLOCATIONCOUNT_H
#define KESTREL_TESTS_SUPPORT_ALLOCATIONCOUNT_H

#include <cstddef>

namespace kestrel_tests {

/// The allocations of all threads so far. To be called by one thread at a time, and only for the difference
/// of two answers: what else is in the count, and from when on, the system decides.
///
/// On Linux these are the calls of operator new in the whole process, but for types that ask for an alignment
/// of their own; the program's operators replace everybody's.
///
/// On Windows, where each library keeps to the operators that it was linked with, these are the calls of
/// malloc, calloc and realloc by the program and by each library that is not the system's: every operator new
/// ends there, and so do the compiler's own libraries, for instance for the first use of a lock. What a
/// library does is counted from the first call on after it was loaded.
///
/// So none is none on both systems, while some are more on the one than on the other.
size_t CountAllocations();

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_SUPPORT_ALLOCATIONCOUNT_H
