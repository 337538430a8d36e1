#include "kestrel/translate/MCXInputSource.h"

#include <istream>
#include <xercesc/util/BinInputStream.hpp>

#include "kestrel/translate/XmlText.h"

namespace MCXML_800 {

namespace {

class HostStream final : public xercesc::BinInputStream {
 public:
  explicit HostStream(std::istream& in) : in_(in) {}

  XMLFilePos curPos() const override {
    try {
      return static_cast<XMLFilePos>(static_cast<std::streamoff>(in_.tellg()));
    } catch (...) {
      return static_cast<XMLFilePos>(-1);
    }
  }

  XMLSize_t readBytes(XMLByte* const buffer, const XMLSize_t max) override {
    try {
      in_.read(reinterpret_cast<char*>(buffer), static_cast<std::streamsize>(max));
    } catch (...) {
      // A stream may be set to throw at its own end, and the parser leaks when something foreign flies
      // through it. What was read counts.
    }
    return static_cast<XMLSize_t>(in_.gcount());
  }

  const XMLCh* getContentType() const override { return nullptr; }

 private:
  std::istream& in_;
};

}  // namespace

MCXInputSource::MCXInputSource(std::istream& in) : InputSource(MCKestrel_800::ToXMLCh(u"istream")), in_(in) {}

MCXInputSource::~MCXInputSource() = default;

xercesc::BinInputStream* MCXInputSource::makeStream() const {
  return new (getMemoryManager()) HostStream(in_);
}

}  // namespace MCXML_800
