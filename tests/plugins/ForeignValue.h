// A host's own value class: it says what type it is and is none of the library's classes.

#ifndef KESTREL_TESTS_PLUGINS_FOREIGNVALUE_H
#define KESTREL_TESTS_PLUGINS_FOREIGNVALUE_H

#include <string>

#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/ScoreValue.h"

namespace kestrel_tests {

/// Smaller than the library's classes, so that taking one for another reads beyond it.
class ForeignValue : public MCKestrel_800::ScoreValue {
 public:
  /// A text, whose characters are not its own.
  explicit ForeignValue(const char* text) : type_(kString), text_(text) {}
  /// A number, or a date/time in seconds.
  ForeignValue(ValueType type, double number) : type_(type), number_(number) {}

  void SetValue(const ScoreValue*) override {}
  ScoreValue* GetValue() const override { return Clone(); }
  ScoreValue* Clone() const override { return new ForeignValue(*this); }
  bool operator==(const ScoreValue& other) const override {
    if (other.GetType() != type_) return false;
    return type_ == kString ? other.GetString() == text_ : other.GetDouble() == number_;
  }
  bool Equal(const ScoreValue* other, bool, bool) const override {
    return other != nullptr && *this == *other;
  }
  bool operator>(const ScoreValue& other) const override { return GetDouble() > other.GetDouble(); }
  bool operator<(const ScoreValue& other) const override { return GetDouble() < other.GetDouble(); }
  bool operator<=(const ScoreValue& other) const override { return GetDouble() <= other.GetDouble(); }
  bool operator>=(const ScoreValue& other) const override { return GetDouble() >= other.GetDouble(); }
  bool IsSystemMissingValue() const override {
    return type_ != kString && MCKestrel_800::NumericValue::IsSystemMissingValue(number_);
  }
  int GetInt() const override { return static_cast<int>(GetDouble()); }
  double GetDouble() const override { return type_ == kString ? 0.0 : number_; }
  std::string GetString() const override { return type_ == kString ? text_ : std::to_string(number_); }
  ValueType GetType() const override { return type_; }

 private:
  ValueType type_;
  union {
    const char* text_;
    double number_;
  };
};

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_PLUGINS_FOREIGNVALUE_H
