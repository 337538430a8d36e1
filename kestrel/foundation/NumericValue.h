// A number as a value, with the one double that stands for "missing" and the rules by which numbers compare.

#ifndef KESTREL_FOUNDATION_NUMERICVALUE_H
#define KESTREL_FOUNDATION_NUMERICVALUE_H

#include <limits>
#include <string>

#include "kestrel/foundation/ScoreValue.h"
#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// A number. Equality allows a relative difference of `fEpsilon`; ordering allows an absolute one of 1e-14.
/// The two differ on purpose: equality is for values of any size, ordering for the numbers that splits
/// compare.
class KESTREL_API NumericValue : public ScoreValue {
 public:
  /// The system-missing value: the most negative finite double.
  static constexpr double gSysmisValue = std::numeric_limits<double>::lowest();
  static constexpr double gInfinity = std::numeric_limits<double>::infinity();
  static constexpr double fEpsilon = 2.22045e-14;
  /// A value that holds the system-missing number.
  static const NumericValue SYSMIS;

  /// System-missing.
  constexpr NumericValue() noexcept = default;
  constexpr explicit NumericValue(double value) noexcept : value_(value) {}
  /// Reads the text through FromString.
  explicit NumericValue(const std::string& text);
  NumericValue(const NumericValue& other) = default;
  NumericValue& operator=(const NumericValue& other) = default;
  ~NumericValue() override;

  /// Copies the other's number; does nothing when the other is no number.
  void SetValue(const ScoreValue* other) override;
  ScoreValue* GetValue() const override;
  ScoreValue* Clone() const override;

  /// IsEqual of the two numbers; false when the other is no number.
  bool operator==(const ScoreValue& other) const override;
  /// True whatever the arguments; numbers compare by operator==.
  bool Equal(const ScoreValue* other, bool exact, bool emptyStringOK) const override;
  /// Ordering is false when either side is system-missing or the other is no number.
  bool operator>(const ScoreValue& other) const override;
  bool operator<(const ScoreValue& other) const override;
  bool operator<=(const ScoreValue& other) const override;
  bool operator>=(const ScoreValue& other) const override;

  bool IsSystemMissingValue() const override { return value_ == gSysmisValue; }
  /// The number truncated toward zero; what int cannot hold is clamped, and no number is 0.
  int GetInt() const override;
  double GetDouble() const override { return value_; }
  /// Six significant digits, whatever the locale; "Undefined" when system-missing or minus infinity.
  std::string GetString() const override;
  ValueType GetType() const override { return kNumeric; }

  void SetDoubleValue(double value) { value_ = value; }
  /// Reads a number from the start of the text as ReadDouble does. Positive infinity when it is too large or
  /// named ("inf"); system-missing when there is no number or it is too large below zero.
  void FromString(const std::string& text);

  static constexpr double GetSysmisValue() { return gSysmisValue; }
  static constexpr double GetInfinity() { return gInfinity; }
  static constexpr bool IsSystemMissingValue(double v) { return v == gSysmisValue; }
  /// Whether two numbers count as equal: |a - b| < max(|a|, |b|) * fEpsilon, or both 0, or both
  /// system-missing. An infinity equals nothing, itself included, and so do numbers below 1e-310 but 0, whose
  /// tolerance is 0.
  static bool IsEqual(double a, double b);

 private:
  double value_ = gSysmisValue;
};

/// The ordering rule of numbers for two doubles, with its absolute tolerance of 1e-14. False when either is
/// system-missing.
KESTREL_API bool NumberLess(double a, double b);
KESTREL_API bool NumberLessOrEqual(double a, double b);

}  // namespace MCKestrel_800

#endif  // KESTREL_FOUNDATION_NUMERICVALUE_H
