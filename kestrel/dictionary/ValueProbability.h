// The one implementation of ScoreValueProbability.

#ifndef KESTREL_DICTIONARY_VALUEPROBABILITY_H
#define KESTREL_DICTIONARY_VALUEPROBABILITY_H

#include "kestrel/dictionary/FiledValue.h"
#include "kestrel/dictionary/ScoreValueProbability.h"

namespace MCKestrel_800 {

/// A value probability that owns its value. Not safe for a reader while another thread calls a setter.
class KESTREL_API ValueProbability : public ScoreValueProbability {
 public:
  /// Takes ownership of `value` (may be null). A probability that is not a number from 0 to 1 becomes 0.
  ValueProbability(ScoreValue* value, double probability);
  ValueProbability(const ValueProbability& other);
  ValueProbability& operator=(const ValueProbability& other);
  ~ValueProbability() override;

  bool SetValueProbability(ScoreValue* value, double probability) override;
  bool SetProbability(double probability) override;
  ValueProbability* Clone() const override;
  bool operator==(const ScoreValueProbability& other) const override;
  bool operator>(const ScoreValueProbability& other) const override;
  bool operator<(const ScoreValueProbability& other) const override;
  bool operator<=(const ScoreValueProbability& other) const override;
  bool operator>=(const ScoreValueProbability& other) const override;
  double GetProbability() const override;
  const ScoreValue* GetValue() const override;
  void Display(std::ostream& os) const override;

 private:
  template <class Interface, class Element>
  friend class IndexedElements;

  FiledValue value_;
  double probability_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_VALUEPROBABILITY_H
