// The outcome of scoring one case, returned by value.

#ifndef KESTREL_FOUNDATION_MCSTATUS_H
#define KESTREL_FOUNDATION_MCSTATUS_H

#include <cstddef>
#include <cstdint>

#include "kestrel/platform/Export.h"

namespace MCScore {

/// A code, whether it is a warning or an error, and up to three integers and three numbers that say more.
/// Only the severity decides between OK, warning and error.
class KESTREL_API MCStatus {
 public:
  /// OK: every field is zero.
  MCStatus() = default;
  /// A warning or an error with that code.
  MCStatus(long code, bool isWarning);
  MCStatus(const MCStatus& other) = default;
  MCStatus& operator=(const MCStatus& other) = default;

  /// Code, severity and all data are equal; numbers compare without tolerance.
  bool operator==(const MCStatus& other) const;

  bool IsError() const { return severity_ < 0; }
  bool IsOK() const { return severity_ == 0; }
  bool IsWarning() const { return severity_ > 0; }
  long GetErrorCode() const { return code_; }

  /// The detail slots; `index` is 0, 1 or 2 and is not checked.
  void SetDiscreteDatum(unsigned int index, long value) { discrete_[index] = static_cast<int32_t>(value); }
  long GetDiscreteDatum(unsigned int index) const { return discrete_[index]; }
  void SetScaleDatum(unsigned int index, double value) { scale_[index] = value; }
  double GetScaleDatum(unsigned int index) const { return scale_[index]; }

 private:
  int32_t code_ = 0;
  int16_t severity_ = 0;
  int32_t discrete_[3] = {0, 0, 0};
  double scale_[3] = {0.0, 0.0, 0.0};
};

/// The names of the conditions that models report, in the order of their table. One name stands in it twice.
/// Null past the end; the last entry is the empty string.
KESTREL_API const char* StatusName(size_t index);
/// The number of names, the empty one at the end not counted.
KESTREL_API size_t StatusNameCount();

}  // namespace MCScore

#endif  // KESTREL_FOUNDATION_MCSTATUS_H
