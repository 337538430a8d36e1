#include "kestrel/foundation/KestrelException.h"

namespace MCKestrel_800 {

KestrelException::KestrelException() = default;
KestrelException::KestrelException(ExceptionCode code, const std::string& message)
    : code_(code), message_(message) {}
KestrelException::KestrelException(const KestrelException& other) = default;
KestrelException& KestrelException::operator=(const KestrelException& other) = default;
KestrelException::~KestrelException() = default;

void KestrelException::SetPlace(unsigned line, unsigned column) {
  line_ = line;
  column_ = column;
}

}  // namespace MCKestrel_800
