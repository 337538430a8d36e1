// Documents of a wanted size, in the shapes that real ones have.

#ifndef KESTREL_BENCH_SUPPORT_DOCUMENTS_H
#define KESTREL_BENCH_SUPPORT_DOCUMENTS_H

#include <cstddef>
#include <string>
#include <vector>

namespace kestrel_bench {

/// A linear regression on `inputs` numeric fields named x0, x1, ..., with the coefficient 0.5 + i / 8 for
/// input i. With `replace` every input has a replacement (1.0) for missing values.
std::string LinearModel(size_t inputs, bool replace);

/// A classification with `categories` tables on `inputs` numeric fields.
std::string ClassificationModel(size_t inputs, size_t categories);

/// A dictionary of `fields` fields by turns continuous with an interval, categorical with three values and
/// numeric ordinal with missing values, and a small model on the first.
std::string DictionaryModel(size_t fields);

/// A way to make a document of n equal pieces, to see how the load grows with n.
struct GrowthShape {
  const char* name;
  std::string (*make)(size_t n);
};

/// Fields, inputs of the model, and each kind of content that one field can have, always in shuffled order.
const std::vector<GrowthShape>& GrowthShapes();

}  // namespace kestrel_bench

#endif  // KESTREL_BENCH_SUPPORT_DOCUMENTS_H
