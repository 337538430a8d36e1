// An interval of values, such as a variable's missing values or a bin.

#ifndef KESTREL_PREDICATES_RANGE_H
#define KESTREL_PREDICATES_RANGE_H

#include <iosfwd>

#include "kestrel/foundation/NumericValue.h"
#include "kestrel/platform/Export.h"
#include "kestrel/predicates/ScoreValueRange.h"

namespace MCKestrel_800 {

/// The interval between two values, or a single value:
///
///   Range(18.0, 65.0, true, false)    18 <= x < 65
///   Range(nullptr, new NumericValue(0.0), false, true)    x <= 0
///   Range(new StringValue("n/a"))    that text
///
/// An end that is included holds whatever NumericValue::IsEqual calls equal to it; the inside is strict. A
/// range whose ends are equal holds that value alone, whatever its flags, by the value's own equality; other
/// ranges hold numbers only, and never the system-missing one. Since an infinity equals nothing, a range that
/// is open to it differs from every other, its own clone included.
///
/// Threads: a finished range may be asked from several threads.
class KESTREL_API Range : public ScoreValueRange {
 public:
  /// Numbers; a system-missing minimum becomes minus infinity in the value object.
  Range(double min, double max, bool lowIncluded, bool highIncluded);
  /// Takes both values over. A null end, and a system-missing minimum (not maximum), is an infinity. The same
  /// object for both ends makes a single value.
  Range(ScoreValue* min, ScoreValue* max, bool lowIncluded, bool highIncluded);
  /// The single value, which the range takes over; null is minus infinity.
  explicit Range(ScoreValue* value);
  Range(const Range& other);
  Range& operator=(const Range& other);
  ~Range() override;

  /// Both ends and both flags are equal.
  bool operator==(const ScoreValueRange& other) const override;
  ScoreValueRange* Clone() const override;
  /// Null is ignored; a system-missing number becomes minus infinity. A value that is no number leaves the
  /// end that numbers are tested against as it was.
  void SetMin(ScoreValue* value) override;
  /// Null takes the upper end away; the end that numbers are tested against stays as it was then, and for a
  /// value that is no number. Unlike a minimum, a system-missing maximum is kept.
  void SetMax(ScoreValue* value) override;
  /// Stands here so that a compiler can put it in the place of a split's virtual call: trees ask it by the
  /// million.
  bool IsInRange(double x) const override {
    if (!single_ && min_number_ < x && x < max_number_) return !NumericValue::IsSystemMissingValue(x);
    return !(x < lowest_ || x > highest_) && IsAtEnd(x);
  }
  bool IsInRange(const ScoreValue* value) const override;
  const ScoreValue* GetMin() const override { return min_; }
  const ScoreValue* GetMax() const override { return max_; }
  bool GetHighEnd() const override { return high_included_; }
  bool GetLowEnd() const override { return low_included_; }
  void Display(std::ostream& out) const override;

 private:
  /// Whether a number that is not inside is the single value, or equal to an end that is included.
  bool IsAtEnd(double x) const;
  /// Keeps the ends as numbers, which the test of a number uses, and whether they are equal.
  void NoteMin();
  void NoteMax();
  void NoteSingle();
  /// Keeps the bounds beyond which no number is in the range: most that are tested lie well outside, and the
  /// tolerance of an end costs more than all the rest.
  void NoteReach();
  /// A date that is the one value of a new range is found by its seconds as well.
  void NoteSingleDate();
  void DeleteEnds();

  ScoreValue* min_ = nullptr;
  ScoreValue* max_ = nullptr;
  bool high_included_ = false;
  bool low_included_ = false;
  bool single_ = false;
  double min_number_;
  double max_number_;
  double lowest_;
  double highest_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PREDICATES_RANGE_H
