// Lets the parser read straight from a host's stream.

#ifndef KESTREL_TRANSLATE_MCXINPUTSOURCE_H
#define KESTREL_TRANSLATE_MCXINPUTSOURCE_H

#include <iosfwd>
#include <xercesc/sax/InputSource.hpp>

#include "kestrel/platform/Export.h"

namespace MCXML_800 {

/// An input source over a stream, which is kept by reference and must outlive it and what it makes. Its
/// system identifier is "istream". The stream need not be seekable; one that fails or throws ends the
/// document there, so that whoever parses looks at the stream afterwards. Plain loads go through
/// ReadDocument, which does.
class KESTREL_API MCXInputSource : public xercesc::InputSource {
 public:
  explicit MCXInputSource(std::istream& in);
  ~MCXInputSource() override;

  /// A new stream over the same std::istream, from where that stands; the caller deletes it.
  xercesc::BinInputStream* makeStream() const override;

 private:
  std::istream& in_;
};

}  // namespace MCXML_800

#endif  // KESTREL_TRANSLATE_MCXINPUTSOURCE_H
