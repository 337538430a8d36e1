// Which ends belong to an interval, as documents say it.

#ifndef KESTREL_TRANSLATE_INTERVALCLOSURE_H
#define KESTREL_TRANSLATE_INTERVALCLOSURE_H

#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

struct IntervalClosure {
  const char16_t* text;
  bool left;   ///< the left margin belongs to the interval
  bool right;  ///< the right margin belongs to the interval
};

inline constexpr IntervalClosure kIntervalClosures[] = {
    {PMMLTagText::XML_VAL_CLOSURE_OPENOPEN, false, false},
    {PMMLTagText::XML_VAL_CLOSURE_CLOSEDCLOSED, true, true},
    {PMMLTagText::XML_VAL_CLOSURE_CLOSEDOPEN, true, false},
    {PMMLTagText::XML_VAL_CLOSURE_OPENCLOSED, false, true},
};
inline constexpr const IntervalClosure& kOpenInterval = kIntervalClosures[0];

/// The `closure` of an interval element; null for another text, and when there is none.
inline const IntervalClosure* FindClosure(const xercesc::DOMElement* interval) {
  const XMLCh* const text = Attribute(interval, PMMLTagText::XML_ATT_INTERVAL_CLOSURE);
  for (const IntervalClosure& row : kIntervalClosures) {
    if (Equals(text, row.text)) return &row;
  }
  return nullptr;
}

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSLATE_INTERVALCLOSURE_H
