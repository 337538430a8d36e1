// Documents that are a dictionary and one predicate, to see how reading predicates grows.

#ifndef KESTREL_BENCH_SUPPORT_PREDICATEDOCUMENTS_H
#define KESTREL_BENCH_SUPPORT_PREDICATEDOCUMENTS_H

#include <vector>

#include "bench/support/Documents.h"

namespace kestrel_bench {

/// Shapes whose root holds a `DataDictionary` and then a predicate: many predicates on a field of as many
/// categories, which must not cost their product, and each kind of content that one predicate can have.
const std::vector<GrowthShape>& PredicateShapes();

}  // namespace kestrel_bench

#endif  // KESTREL_BENCH_SUPPORT_PREDICATEDOCUMENTS_H
