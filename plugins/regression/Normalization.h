// The names of the ways in which a RegressionModel turns the values of its equations into a prediction.

#ifndef KESTREL_PLUGINS_REGRESSION_NORMALIZATION_H
#define KESTREL_PLUGINS_REGRESSION_NORMALIZATION_H

#include <string_view>

namespace MCKestrel_800 {

/// The attribute `normalizationMethod`.
enum class Normalization { kNone, kSimplemax, kSoftmax, kLogit, kProbit, kCloglog, kExp, kLoglog, kCauchit };

/// Finds the method that `text` names, exactly as it is spelled. False, and `method` unchanged, for any other
/// text.
bool FindNormalization(std::string_view text, Normalization& method);

/// The name that documents use.
const char* NormalizationText(Normalization method);

/// Whether the method maps each equation by a function of its own (the links, "exp", and "none" as the
/// identity; see LinkFunctions.h), so that cumulative probabilities can be made of it.
bool IsCumulative(Normalization method);

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_REGRESSION_NORMALIZATION_H
