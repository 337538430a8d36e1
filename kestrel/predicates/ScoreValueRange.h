// The interface of an interval of values.

#ifndef KESTREL_PREDICATES_SCOREVALUERANGE_H
#define KESTREL_PREDICATES_SCOREVALUERANGE_H

#include <iosfwd>

#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

class ScoreValue;

/// An interval of values with an inclusion flag at each end, or a single value. Owns its ends.
class KESTREL_API ScoreValueRange {
 public:
  virtual ~ScoreValueRange();
  virtual bool operator==(const ScoreValueRange& other) const = 0;
  /// A new deep copy that the caller owns.
  virtual ScoreValueRange* Clone() const = 0;
  /// Replace an end. The range takes the new value over and does not delete the one that it held: whoever
  /// replaces an end disposes of the old one.
  virtual void SetMin(ScoreValue* value) = 0;
  virtual void SetMax(ScoreValue* value) = 0;
  virtual bool IsInRange(double x) const = 0;
  virtual bool IsInRange(const ScoreValue* value) const = 0;
  /// The ends, owned by the range.
  virtual const ScoreValue* GetMin() const = 0;
  virtual const ScoreValue* GetMax() const = 0;
  /// Whether the ends belong to the range.
  virtual bool GetHighEnd() const = 0;
  virtual bool GetLowEnd() const = 0;
  virtual void Display(std::ostream& out) const = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PREDICATES_SCOREVALUERANGE_H
