// Counts how often the test program and the libraries it loads ask the heap for an object.

#ifndef KESTREL_TESTS_DICTIONARY_ALLOCATIONCOUNTER_H
#define KESTREL_TESTS_DICTIONARY_ALLOCATIONCOUNTER_H

namespace kestrel_test {

/// Calls of operator new since the program started.
long AllocationsSoFar();

}  // namespace kestrel_test

#endif  // KESTREL_TESTS_DICTIONARY_ALLOCATIONCOUNTER_H
