#include "plugins/regression/Normalization.h"

namespace MCKestrel_800 {
namespace {

struct NormalizationRow {
  const char* text;
  bool cumulative;
};

// In the order of the enumeration.
constexpr NormalizationRow kRows[] = {
    {"none", true},    {"simplemax", false}, {"softmax", false}, {"logit", true},   {"probit", true},
    {"cloglog", true}, {"exp", true},        {"loglog", true},   {"cauchit", true},
};

}  // namespace

bool FindNormalization(std::string_view text, Normalization& method) {
  int index = 0;
  for (const NormalizationRow& row : kRows) {
    if (text == row.text) {
      method = static_cast<Normalization>(index);
      return true;
    }
    ++index;
  }
  return false;
}

const char* NormalizationText(Normalization method) {
  return kRows[static_cast<int>(method)].text;
}

bool IsCumulative(Normalization method) {
  return kRows[static_cast<int>(method)].cumulative;
}

}  // namespace MCKestrel_800
