// The names that model documents are written with. Readers take every tag, attribute and value name from
// here.

#ifndef KESTREL_TRANSLATE_PMMLMODELTAGS_H
#define KESTREL_TRANSLATE_PMMLMODELTAGS_H

#include <cstddef>

#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// The element, attribute and value names as narrow text. The prefix tells the kind: XML_ELE_ and XML_ELM_ an
/// element's tag, XML_ATT_ an attribute's name, XML_VAL_ a fixed value, XML_EXT_ a name inside `Extension`
/// elements, XML_MSTAT_ a statistics element's tag, XML_VEXA_TRANFUNC_ a function that `Apply` may call. The
/// constants are not exported: each module that uses one has its own copy, so compare texts, never addresses.
class PMMLModelTags {
 public:
  KESTREL_API PMMLModelTags& operator=(const PMMLModelTags& other);

#define KESTREL_TAG(name, text) static constexpr char name[] = text;
#include "kestrel/translate/PMMLModelTags.inc"
#undef KESTREL_TAG
};

/// The same names as UTF-16, so that readers compare parser text without transcoding either side.
struct PMMLTagText {
#define KESTREL_TAG(name, text) static constexpr char16_t name[] = u"" text;
#include "kestrel/translate/PMMLModelTags.inc"
#undef KESTREL_TAG
};

/// One row of the table of names, for tools and tests.
struct PMMLTagRow {
  const char* constant;  ///< the constant's name in PMMLModelTags
  const char* text;      ///< its text
};

/// Returns the table's first row and sets `count` to the number of rows. The table lives as long as the
/// library.
KESTREL_API const PMMLTagRow* GetPMMLTagTable(size_t& count);

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSLATE_PMMLMODELTAGS_H
