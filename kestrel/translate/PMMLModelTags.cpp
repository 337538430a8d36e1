#include "kestrel/translate/PMMLModelTags.h"

namespace MCKestrel_800 {

namespace {

constexpr PMMLTagRow kTagTable[] = {
#define KESTREL_TAG(name, text) {#name, text},
#include "kestrel/translate/PMMLModelTags.inc"
#undef KESTREL_TAG
};

}  // namespace

// The class holds nothing that differs between two objects.
PMMLModelTags& PMMLModelTags::operator=(const PMMLModelTags&) {
  return *this;
}

const PMMLTagRow* GetPMMLTagTable(size_t& count) {
  count = sizeof(kTagTable) / sizeof(kTagTable[0]);
  return kTagTable;
}

}  // namespace MCKestrel_800
