// The derived fields of one document.

#ifndef KESTREL_TRANSFORM_TRANSFORMATIONDICTIONARY_H
#define KESTREL_TRANSFORM_TRANSFORMATIONDICTIONARY_H

#include <string>
#include <vector>

#include "kestrel/dictionary/BaseDictionary.h"
#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// A dictionary whose variables are the derived fields, with their names in the order of the document beside
/// it. The list of derived names is a list of its own: filling it and adding variables are separate steps of
/// the reader.
///
/// Threads: as for any dictionary, filled on one thread.
class KESTREL_API TransformationDictionary : public BaseDictionary {
 public:
  TransformationDictionary();
  /// Copies the variables and the derived names deeply.
  TransformationDictionary(const TransformationDictionary& other);
  TransformationDictionary& operator=(const TransformationDictionary& other);
  ~TransformationDictionary() override;

  /// A deep copy that the caller owns.
  TransformationDictionary* Clone() const override;

  /// Appends a name to the derived names. Neither an empty nor a repeated one is refused.
  void AddDerievedVarName(const std::string& name);

  /// A copy of the derived names, in the order in which they were added.
  std::vector<std::string> GetDerivedVarNames() const;

 private:
  std::vector<std::string> derived_names_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSFORM_TRANSFORMATIONDICTIONARY_H
