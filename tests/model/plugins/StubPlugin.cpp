// A library that works as it should. Built once for each tag that the tests need, with STUB_TAG naming the
// tag; STUB_TAKES_NAMES gives it the second entry point, STUB_OFFERS_ALL every operation of a translator.

#include <atomic>
#include <istream>
#include <iterator>

#include "kestrel/platform/Export.h"
#include "kestrel/translate/BaseTranslator.h"
#include "tests/model/plugins/StubModel.h"

namespace kestrel_stub {
namespace {

std::atomic<int> live_translators{0};

class StubTranslator : public BaseTranslator {
 public:
  StubTranslator() { ++live_translators; }
  ~StubTranslator() override { --live_translators; }
  StubTranslator(const StubTranslator&) = delete;
  StubTranslator& operator=(const StubTranslator&) = delete;

  using BaseTranslator::ParseFromTree;

  ScoreModel* ParseFromTree(xercesc::DOMElement* root, const std::string& arg) override {
    return Make("root=" + TagOf(root) + " arg=" + arg);
  }

#ifdef STUB_OFFERS_ALL
  ScoreModel* ParseFromTree(xercesc::DOMElement* model, xercesc::DOMElement* other,
                            const std::string& arg) override {
    return Make("model=" + TagOf(model) + " other=" + TagOf(other) + " arg=" + arg);
  }
  ScoreModel* ParseFromTree(xercesc::DOMElement* model, ScoreDictionary* dictionary, ScoreDictionary* results,
                            const std::string& arg) override {
    return Make("model=" + TagOf(model) + " dictionary=" + (dictionary != nullptr ? "given" : "none") +
                " results=" + (results != nullptr ? "given" : "none") + " arg=" + arg);
  }
  ScoreModel* ParseFromTree(std::istream& in, const std::string& arg, const std::string& second) override {
    const std::string text{std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>()};
    return Make("text=" + text + " arg=" + arg + " second=" + second);
  }
#endif

  const std::vector<std::string>* names = nullptr;

 private:
  ScoreModel* Make(std::string story) const {
    if (names != nullptr) {
      story += " names=";
      for (const std::string& name : *names)
        story += name + ";";
    }
    return new StubModel(STUB_TAG, story);
  }
};

}  // namespace
}  // namespace kestrel_stub

extern "C" KESTREL_PLUGIN_API MCKestrel_800::ScoreTranslator* GiveMyTranslator() {
  return new kestrel_stub::StubTranslator;
}

#ifdef STUB_TAKES_NAMES
extern "C" KESTREL_PLUGIN_API void PassModelNames(MCKestrel_800::ScoreTranslator* translator,
                                                  std::vector<std::string>* names) {
  static_cast<kestrel_stub::StubTranslator*>(translator)->names = names;
  names->push_back("mark of the plug-in");
}
#endif

extern "C" KESTREL_PLUGIN_API int CountLiveTranslators() {
  return kestrel_stub::live_translators;
}
