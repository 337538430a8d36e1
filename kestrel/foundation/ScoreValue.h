// The interface of every datum: a category, a cell of a case, a split value, a prediction.

#ifndef KESTREL_FOUNDATION_SCOREVALUE_H
#define KESTREL_FOUNDATION_SCOREVALUE_H

#include <string>

#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// A value. Missing numbers and dates are marked in-band by the system-missing number; texts are never
/// missing.
class KESTREL_API ScoreValue {
 public:
  /// What kind of value it is.
  enum ValueType : int { kNumeric = 0, kString = 1, kDateTime = 5 };

  virtual ~ScoreValue();
  /// Takes the other value over where the kinds fit; the concrete classes say what happens otherwise.
  virtual void SetValue(const ScoreValue* other) = 0;
  /// A new copy that the caller owns; the same as Clone.
  virtual ScoreValue* GetValue() const = 0;
  /// A new copy that the caller owns.
  virtual ScoreValue* Clone() const = 0;
  virtual bool operator==(const ScoreValue& other) const = 0;
  virtual bool Equal(const ScoreValue* other, bool exact, bool emptyStringOK) const = 0;
  virtual bool operator>(const ScoreValue& other) const = 0;
  virtual bool operator<(const ScoreValue& other) const = 0;
  virtual bool operator<=(const ScoreValue& other) const = 0;
  virtual bool operator>=(const ScoreValue& other) const = 0;
  virtual bool IsSystemMissingValue() const = 0;
  virtual int GetInt() const = 0;
  virtual double GetDouble() const = 0;
  virtual std::string GetString() const = 0;
  virtual ValueType GetType() const = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_FOUNDATION_SCOREVALUE_H
