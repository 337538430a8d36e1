#include "kestrel/translate/ResultVar.h"

namespace MCKestrel_800 {

ResultVar::ResultVar(const std::string& name, VariableType type) : DictVar(name, type) {}
ResultVar::ResultVar(const ResultVar& other) = default;
ResultVar& ResultVar::operator=(const ResultVar& other) = default;
ResultVar::~ResultVar() = default;

ResultVar* ResultVar::Clone() const {
  return new ResultVar(*this);
}

}  // namespace MCKestrel_800
