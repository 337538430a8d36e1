// The interface of a case's output fields: the values that a document asks for by name.

#ifndef KESTREL_TRANSLATE_SCORERESULTFIELD_H
#define KESTREL_TRANSLATE_SCORERESULTFIELD_H

#include <cstddef>
#include <map>
#include <string>
#include <vector>

#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

class ScoreValue;

/// Values by the names of output fields, one case at a time. A name may have no value (null).
class KESTREL_API ScoreResultField {
 public:
  /// What an output field tells of a result. ResultVar says which one a variable is.
  enum ResultFeature : int {
    kNoFeature = 0,
    kPredictedValue = 1,
    kPredictedDisplayValue = 2,
    kProbability = 3,
    kResidual = 4,
    kStandardError = 5,
    kClusterId = 6,
    kClusterAffinity = 7,
    kEntityId = 8,
    kEntityAffinity = 9,
    kWarning = 10,
    kRuleValue = 11,
    kStandardDeviation = 12
  };
  using ValueMap = std::map<std::string, ScoreValue*>;

  virtual ~ScoreResultField();

  /// Replaces all fields. The object owns the map's values from then on and deletes those that it held, but
  /// for those that are in the new map as well.
  virtual void SetMapResultValue(const ValueMap& values) = 0;
  /// All fields; the values stay the object's.
  virtual const ValueMap& GetMapResultValue() const = 0;
  /// The value of a field, which stays the object's; null when there is no such field or it has no value.
  virtual const ScoreValue* GetResultValue(const std::string& name) const = 0;

  /// Store a copy of a value, a text or a number under a name, which is added when it is not there. A value
  /// of the same kind is written over, so that a case after the first one allocates nothing. A null value
  /// leaves the field without one.
  virtual void SetResultValue(const std::string& name, const ScoreValue* value) = 0;
  virtual void SetResultValue(const std::string& name, const std::string& text) = 0;
  virtual void SetResultValue(const std::string& name, double number) = 0;

  /// Always 0.
  virtual int GetResultType(const std::string& name) const = 0;
  /// Adds a field with a value, or null for none, and takes ownership of it. The value that a field of that
  /// name had is deleted.
  virtual void AddResultField(const std::string& name, ScoreValue* value) = 0;
  /// The names in ascending (byte-wise) order.
  virtual std::vector<std::string> GetResultFields() const = 0;
  virtual std::size_t GetResultSize() const = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSLATE_SCORERESULTFIELD_H
