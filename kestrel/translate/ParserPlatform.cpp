#include "kestrel/translate/ParserPlatform.h"

#include <exception>
#include <string>
#include <xercesc/util/OutOfMemoryException.hpp>
#include <xercesc/util/PanicHandler.hpp>
#include <xercesc/util/PlatformUtils.hpp>

#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

namespace {

struct ParserPanic {
  std::string reason;
};

// Without it the parser library ends the host's process.
class ThrowingPanicHandler final : public xercesc::PanicHandler {
 public:
  void panic(const PanicReasons reason) override { throw ParserPanic{getPanicReasonString(reason)}; }
};

// Returns the reason of the failure; empty when all is well.
std::string Initialise(xercesc::MemoryManager* memory) {
  std::string reason;
  try {
    // Kept for good: the parser library holds on to it.
    static ThrowingPanicHandler* const handler = new ThrowingPanicHandler;
    xercesc::XMLPlatformUtils::Initialize(xercesc::XMLUni::fgXercescDefaultLocale, nullptr, handler, memory);
    return std::string();
  } catch (const ParserPanic& panic) {
    reason = panic.reason;
  } catch (const xercesc::OutOfMemoryException&) {
    reason = "Out Of Memory";
  } catch (const xercesc::XMLException& e) {
    reason = Narrow(e.getMessage());
  } catch (const std::exception& e) {
    reason = e.what();
  } catch (...) {
  }
  return reason.empty() ? "The XML parser could not be initialised" : reason;
}

}  // namespace

void RequireParser(xercesc::MemoryManager* memory) {
  // The language makes threads that come here at the same time wait for the first.
  static const std::string* const failure = new std::string(Initialise(memory));
  if (!failure->empty()) Fail(KestrelException::kUnsupported, *failure);
}

}  // namespace MCKestrel_800
