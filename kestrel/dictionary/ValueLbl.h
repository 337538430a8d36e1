// The one implementation of ScoreValueLabel.

#ifndef KESTREL_DICTIONARY_VALUELBL_H
#define KESTREL_DICTIONARY_VALUELBL_H

#include <string>

#include "kestrel/dictionary/FiledValue.h"
#include "kestrel/dictionary/ScoreValueLabel.h"

namespace MCKestrel_800 {

/// A value label that owns its value. Not safe for a reader while another thread calls a setter.
class KESTREL_API ValueLbl : public ScoreValueLabel {
 public:
  /// Takes ownership of `value` (may be null). The label may be empty here: a category need not have a text.
  ValueLbl(ScoreValue* value, const std::string& label);
  ValueLbl(const ValueLbl& other);
  ValueLbl& operator=(const ValueLbl& other);
  ~ValueLbl() override;

  bool SetValueLabel(ScoreValue* value, const std::string& label) override;
  bool SetLabel(const std::string& label) override;
  ValueLbl* Clone() const override;
  bool operator==(const ScoreValueLabel& other) const override;
  bool operator>(const ScoreValueLabel& other) const override;
  bool operator<(const ScoreValueLabel& other) const override;
  bool operator<=(const ScoreValueLabel& other) const override;
  bool operator>=(const ScoreValueLabel& other) const override;
  std::string GetLabel() const override;
  const ScoreValue* GetValue() const override;
  void Display(std::ostream& os) const override;

 private:
  template <class Interface, class Element>
  friend class IndexedElements;

  FiledValue value_;
  std::string label_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_VALUELBL_H
