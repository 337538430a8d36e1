// Libraries that do something wrong, one for each FAULT_... that this file is built with.

#include <stdexcept>

#include "kestrel/foundation/KestrelException.h"
#include "kestrel/platform/Export.h"
#include "kestrel/translate/BaseTranslator.h"
#include "tests/model/plugins/StubModel.h"

using namespace MCKestrel_800;

#ifdef FAULT_NEEDS_ABSENT
extern "C" int GiveNumberOfAbsent();
#endif

namespace {

class FaultyTranslator : public BaseTranslator {
 public:
  using BaseTranslator::ParseFromTree;
  ScoreModel* ParseFromTree(xercesc::DOMElement*, const std::string&) override {
    // A half-built model, as a translator that gives up has one.
    auto model = std::make_unique<kestrel_stub::StubModel>("Faulty", "");
#if defined(FAULT_THROWS_KESTREL)
    throw KestrelException(KestrelException::kUnknownVariable, "Variable x not in the dictionary!");
#elif defined(FAULT_THROWS_STANDARD)
    throw std::out_of_range("from the plug-in");
#elif defined(FAULT_THROWS_INT)
    throw 17;
#elif defined(FAULT_NEEDS_ABSENT)
    if (GiveNumberOfAbsent() == 0) return model.release();
#endif
    return nullptr;
  }
};

}  // namespace

#ifndef FAULT_NO_ENTRY
extern "C" KESTREL_PLUGIN_API ScoreTranslator* GiveMyTranslator() {
#if defined(FAULT_NULL_TRANSLATOR)
  return nullptr;
#elif defined(FAULT_ENTRY_THROWS)
  throw 18;
#else
  return new FaultyTranslator;
#endif
}
#else
extern "C" KESTREL_PLUGIN_API int SomethingElse() {
  return sizeof(FaultyTranslator) != 0;
}
#endif

#ifdef FAULT_NAMES_THROW
extern "C" KESTREL_PLUGIN_API void PassModelNames(ScoreTranslator*, std::vector<std::string>*) {
  throw KestrelException(KestrelException::kInvalidDocument, "no such names");
}
#endif

#if defined(FAULT_OTHER_VERSION) || defined(FAULT_NULL_VERSION)
extern "C" KESTREL_PLUGIN_API const char* GiveMyVersion() {
#ifdef FAULT_OTHER_VERSION
  return "7.2";
#else
  return nullptr;
#endif
}
#endif
