#include "kestrel/translate/DOMElemUtility.h"

#include <xercesc/dom/DOMElement.hpp>
#include <xercesc/dom/DOMNodeList.hpp>

#include "kestrel/foundation/PliantTranscoder.h"
#include "kestrel/translate/BaseTranslator.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/VerifiedText.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

namespace {

const XMLCh* GetValue(const xercesc::DOMElement* element, const std::string& name, bool forced) {
  return forced ? BaseTranslator::GetAttributeForced(element, name)
                : BaseTranslator::GetAttribute(element, name);
}

[[noreturn]] void FailMissing(const xercesc::DOMElement* element, const std::string& tag) {
  FailAt(element, KestrelException::kMissingElement, "Node is missing --- " + tag + " ---");
}

}  // namespace

DOMElemUtility::DOMElemUtility(PMMLTranslator* translator, MCXML_800::PliantTranscoder* transcoder)
    : translator_(translator), transcoder_(transcoder) {}

DOMElemUtility::~DOMElemUtility() = default;

xercesc::DOMNodeList* DOMElemUtility::GetDOMNodeList(xercesc::DOMElement* element, const std::string& tag,
                                                     bool forced) {
  if (element == nullptr || tag.empty()) return nullptr;
  xercesc::DOMNodeList* const list = BaseTranslator::GetElementsByTagName(element, tag);
  // Asking for the first item ends at the first match, where the length would count them all.
  if (list != nullptr && list->item(0) != nullptr) return list;
  if (forced) FailMissing(element, tag);
  return nullptr;
}

xercesc::DOMElement* DOMElemUtility::GetElemFromNodeList(xercesc::DOMElement* element, const std::string& tag,
                                                         size_t index, bool forced) {
  if (translator_ == nullptr) return nullptr;
  xercesc::DOMNodeList* const list = GetDOMNodeList(element, tag, forced);
  if (list == nullptr) return nullptr;
  xercesc::DOMNode* const node = list->item(index);
  if (node == nullptr && forced) FailMissing(element, tag);
  return static_cast<xercesc::DOMElement*>(node);
}

size_t DOMElemUtility::GetNodeListLength(xercesc::DOMElement* element, const std::string& tag, bool forced) {
  if (translator_ == nullptr) return 0;
  const xercesc::DOMNodeList* const list = GetDOMNodeList(element, tag, forced);
  return list != nullptr ? list->getLength() : 0;
}

int DOMElemUtility::GetAttributeToInt(xercesc::DOMElement* element, const std::string& name, bool forced) {
  if (translator_ == nullptr || element == nullptr || name.empty()) return -1;
  return VerifyIntAt(element, GetValue(element, name, forced));
}

std::string DOMElemUtility::GetAttributeToString(xercesc::DOMElement* element, const std::string& name,
                                                 bool forced) {
  if (element == nullptr || name.empty()) return std::string();
  const XMLCh* const value = GetValue(element, name, forced);
  if (transcoder_ == nullptr) return Narrow(value);
  std::string text;
  if (!IsEmpty(value)) transcoder_->transcodeTo(value, text);
  return text;
}

double DOMElemUtility::GetAttributeToDouble(xercesc::DOMElement* element, const std::string& name,
                                            bool forced) {
  if (translator_ == nullptr || element == nullptr || name.empty()) return 0.0;
  return VerifyDoubleAt(element, GetValue(element, name, forced));
}

xercesc::DOMElement* DOMElemUtility::GetChildElemByName(xercesc::DOMElement* element, const std::string& tag,
                                                        bool forced) {
  if (element == nullptr || tag.empty()) return nullptr;
  return static_cast<xercesc::DOMElement*>(forced ? BaseTranslator::GetChildByTagForced(element, tag)
                                                  : BaseTranslator::GetChildByTag(element, tag));
}

}  // namespace MCKestrel_800
