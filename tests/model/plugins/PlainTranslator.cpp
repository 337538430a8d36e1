// A library whose translator implements the interface itself and not the common base.

#include "kestrel/platform/Export.h"
#include "kestrel/translate/ScoreTranslator.h"
#include "tests/model/plugins/StubModel.h"

using namespace MCKestrel_800;

namespace {

class PlainTranslator : public ScoreTranslator {
 public:
  ScoreModel* ParseFromTree(xercesc::DOMElement*, xercesc::DOMElement*, const std::string&) override {
    return nullptr;
  }
  ScoreModel* ParseFromTree(xercesc::DOMElement*, ScoreDictionary*, ScoreDictionary*,
                            const std::string&) override {
    return nullptr;
  }
  ScoreModel* ParseFromTree(const std::string&, const std::string&) override { return nullptr; }
  ScoreModel* ParseFromTree(std::istream&, const std::string&) override { return nullptr; }
  ScoreModel* ParseFromTree(xercesc::DOMElement* root, const std::string& arg) override {
    return new kestrel_stub::StubModel("PlainModel", "root=" + kestrel_stub::TagOf(root) + " arg=" + arg);
  }
};

}  // namespace

extern "C" KESTREL_PLUGIN_API ScoreTranslator* GiveMyTranslator() {
  return new PlainTranslator;
}
