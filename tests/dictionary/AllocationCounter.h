// Counts how often the test program and the libraries it loads ask the heap for an object.

#ifndef KESTREL_TESTS_DICTIONARY_ALLOCATIONCOUNTER_H
#define KESTREL_TESTS_DICTIONARY_ALLOCATIONCOUNTER_H

namespace MCKestrel_800 {

/// Calls of operator new since the program started.
long AllocationsSoFar();

}  // namespace MCKestrel_800

#endif  // KESTREL_TESTS_DICTIONARY_ALLOCATIONCOUNTER_H
