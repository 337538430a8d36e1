// What decides whether a row of an encoding applies to a value.

#ifndef KESTREL_TRANSFORM_VALUEMATCHER_H
#define KESTREL_TRANSFORM_VALUEMATCHER_H

#include <memory>

#include "kestrel/foundation/ScoreValue.h"
#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// A test of a value. A host may derive its own; rows with such a test are asked one by one.
class KESTREL_API ScoreValueMatcher {
 public:
  virtual ~ScoreValueMatcher();
  virtual bool Matches(const ScoreValue& value) const = 0;
  /// A deep copy that the caller owns.
  virtual ScoreValueMatcher* Clone() const = 0;
};

/// Matches what the listed value equals by its own `operator==`: numbers within their tolerance, texts but
/// for trailing blanks. Rows of listed values are found without a walk.
class KESTREL_API ValueMatcher : public ScoreValueMatcher {
 public:
  /// Takes the value over. Null matches nothing.
  explicit ValueMatcher(ScoreValue* value);
  ValueMatcher(const ValueMatcher& other);
  ValueMatcher& operator=(const ValueMatcher& other);
  ~ValueMatcher() override;

  bool Matches(const ScoreValue& value) const override;
  ValueMatcher* Clone() const override;
  const ScoreValue* GetValue() const { return value_.get(); }

 private:
  std::unique_ptr<ScoreValue> value_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSFORM_VALUEMATCHER_H
