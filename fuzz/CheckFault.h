// What every refusal of a document must look like.

#ifndef KESTREL_FUZZ_CHECKFAULT_H
#define KESTREL_FUZZ_CHECKFAULT_H

#include "fuzz/Check.h"
#include "kestrel/foundation/KestrelException.h"

namespace kestrel_fuzz {

inline void CheckFault(const MCKestrel_800::KestrelException& fault) {
  using MCKestrel_800::KestrelException;
  const int code = fault.GetErrorCode();
  Check(code >= KestrelException::kStructure && code <= KestrelException::kInconsistentDictionary,
        "a fault has a code of 1 to 12");
  Check(code != KestrelException::kReserved, "no fault has the reserved code");
  Check(!fault.GetErrorMessage().empty(), "a fault has a text");
  Check(fault.GetColumn() == 0 || fault.GetLine() != 0, "a column has a line");
}

}  // namespace kestrel_fuzz

#endif  // KESTREL_FUZZ_CHECKFAULT_H
