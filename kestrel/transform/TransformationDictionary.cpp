#include "kestrel/transform/TransformationDictionary.h"

namespace MCKestrel_800 {

TransformationDictionary::TransformationDictionary() = default;
TransformationDictionary::TransformationDictionary(const TransformationDictionary& other) = default;
TransformationDictionary& TransformationDictionary::operator=(const TransformationDictionary& other) =
    default;
TransformationDictionary::~TransformationDictionary() = default;

TransformationDictionary* TransformationDictionary::Clone() const {
  return new TransformationDictionary(*this);
}

void TransformationDictionary::AddDerievedVarName(const std::string& name) {
  derived_names_.push_back(name);
}

std::vector<std::string> TransformationDictionary::GetDerivedVarNames() const {
  return derived_names_;
}

}  // namespace MCKestrel_800
