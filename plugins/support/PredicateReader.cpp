#include "plugins/support/PredicateReader.h"

#include <xercesc/dom/DOMElement.hpp>

#include <memory>
#include <string>

#include "kestrel/foundation/KestrelException.h"
#include "kestrel/predicates/ConstantPredicates.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/XmlText.h"
#include "plugins/support/PredicateInputs.h"

namespace MCKestrel_800 {
namespace {

using xercesc::DOMElement;
using Tags = PMMLTagText;

using Reader = ScorePredicate* (*)(DOMElement*, const PredicateInputs&);

struct Kind {
  const char16_t* tag;
  Reader read;
};

constexpr Kind kKinds[] = {
    {Tags::XML_ELE_PREDICATE,
     [](DOMElement* element, const PredicateInputs& inputs) -> ScorePredicate* {
       return PMMLTranslator::ParsePredicate(element, inputs.GetData(), inputs.GetDerived(), false);
     }},
    {Tags::XML_ELE_SETPREDICATE,
     [](DOMElement* element, const PredicateInputs& inputs) -> ScorePredicate* {
       return PMMLTranslator::ParseSetPredicate(element, inputs.GetData(), inputs.GetDerived());
     }},
    {Tags::XML_ELE_COMPOUNDPREDICATE,
     [](DOMElement* element, const PredicateInputs& inputs) -> ScorePredicate* {
       return PMMLTranslator::ParseCompoundPredicate(element, inputs.GetData(), inputs.GetDerived(), false);
     }},
    {Tags::XML_ELE_TRUE,
     [](DOMElement*, const PredicateInputs&) -> ScorePredicate* { return new TruePredicate; }},
    {Tags::XML_ELE_FALSE,
     [](DOMElement*, const PredicateInputs&) -> ScorePredicate* { return new FalsePredicate; }},
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

DOMElement* FindPredicate(const DOMElement* element) {
  DOMElement* predicate = nullptr;
  for (DOMElement* child : ChildElements(element)) {
    if (!IsPredicate(child)) continue;
    if (predicate != nullptr) {
      FailAt(child, KestrelException::kStructure,
             "<" + Narrow(element->getTagName()) + "> has more than one predicate!");
    }
    predicate = child;
  }
  if (predicate == nullptr) {
    FailAt(element, KestrelException::kMissingElement,
           "<" + Narrow(element->getTagName()) + "> has no predicate!");
  }
  return predicate;
}

Condition ReadCondition(DOMElement* predicate, PredicateInputs& inputs, ConditionTable& conditions) {
  const std::unique_ptr<ScorePredicate> object(FindKind(predicate)->read(predicate, inputs));
  try {
    return conditions.Compile(object.get(), inputs);
  } catch (const KestrelException& fault) {
    // Compiling knows variables, not elements.
    FailAt(predicate, static_cast<KestrelException::ExceptionCode>(fault.GetErrorCode()),
           fault.GetErrorMessage());
  }
}

}  // namespace MCKestrel_800
