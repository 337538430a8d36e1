#include "plugins/support/PredicateReader.h"

#include <xercesc/dom/DOMElement.hpp>

#include "kestrel/predicates/ConstantPredicates.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {
namespace {

using xercesc::DOMElement;
using Tags = PMMLTagText;

using Reader = ScorePredicate* (*)(DOMElement*, const ScoreDictionary*);

struct Kind {
  const char16_t* tag;
  Reader read;
};

constexpr Kind kKinds[] = {
    {Tags::XML_ELE_PREDICATE,
     [](DOMElement* element, const ScoreDictionary* dictionary) -> ScorePredicate* {
       return PMMLTranslator::ParsePredicate(element, dictionary, nullptr, false);
     }},
    {Tags::XML_ELE_SETPREDICATE,
     [](DOMElement* element, const ScoreDictionary* dictionary) -> ScorePredicate* {
       return PMMLTranslator::ParseSetPredicate(element, dictionary, nullptr);
     }},
    {Tags::XML_ELE_COMPOUNDPREDICATE,
     [](DOMElement* element, const ScoreDictionary* dictionary) -> ScorePredicate* {
       return PMMLTranslator::ParseCompoundPredicate(element, dictionary, nullptr, false);
     }},
    {Tags::XML_ELE_TRUE,
     [](DOMElement*, const ScoreDictionary*) -> ScorePredicate* { return new TruePredicate; }},
    {Tags::XML_ELE_FALSE,
     [](DOMElement*, const ScoreDictionary*) -> ScorePredicate* { return new FalsePredicate; }},
};

const Kind* FindKind(const DOMElement* element) {
  for (const Kind& kind : kKinds) {
    if (ElementIs(element, kind.tag)) return &kind;
  }
  return nullptr;
}

}  // namespace

bool IsPredicate(const DOMElement* element) {
  return FindKind(element) != nullptr;
}

std::unique_ptr<ScorePredicate> ReadPredicate(DOMElement* element, const ScoreDictionary& dictionary) {
  return std::unique_ptr<ScorePredicate>(FindKind(element)->read(element, &dictionary));
}

}  // namespace MCKestrel_800
