// The `Array` element: its elements, checked against its type and their declared number.

#include <cstddef>
#include <string>
#include <vector>

#include "kestrel/foundation/NarrowText.h"
#include "kestrel/translate/ArrayText.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/VerifiedText.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

namespace {

using xercesc::DOMElement;
using Tag = PMMLTagText;

const XMLCh* TextOf(const std::u16string& element) {
  return ToXMLCh(element.c_str());
}

/// Whether an array has so many elements as it declares, or declares nothing. Nothing is ever made from the
/// declared number.
bool HasDeclaredCount(const DOMElement* array, std::size_t count) {
  const XMLCh* const declared = FindAttribute(array, Tag::XML_ATT_ARRAY_N);
  if (declared == nullptr) return true;
  return static_cast<long long>(VerifyIntAt(array, declared)) == static_cast<long long>(count);
}

bool IsRow(const DOMElement* element) {
  return ElementIs(element, Tag::XML_ELE_ARRAY) || ElementIs(element, Tag::XML_ELE_XBASISROW) ||
         ElementIs(element, Tag::XML_ELE_UPERXBASISROW);
}

/// Refuses what is no single row of numbers.
void RequireRow(const DOMElement* element) {
  for (const DOMElement* child : ChildElements(element)) {
    if (IsRow(child)) {
      FailAt(child, KestrelException::kMissingElement, "Multi-dimensional case not supported!!");
    }
  }
  if (!IsRow(element)) {
    FailAt(element, KestrelException::kMissingElement, "Invalid character -- should be array!");
  }
}

}  // namespace

DOMElement* PMMLTranslator::GetArrayNode(const DOMElement* parent) {
  DOMElement* const array = FirstChild(parent, Tag::XML_ELE_ARRAY);
  if (array == nullptr) FailAt(parent, KestrelException::kMissingElement, "Array Node is required!!!");
  return array;
}

std::vector<std::string> PMMLTranslator::GetArrayElements(const DOMElement* array) {
  const XMLCh* const type = Attribute(array, Tag::XML_ATT_ARRAY_TYPE);
  const bool isReal = Equals(type, Tag::XML_VAL_ARRAY_TYPE_REAL);
  const bool isInt = Equals(type, Tag::XML_VAL_ARRAY_TYPE_INT);
  ArrayText text(array);
  std::u16string element;
  std::vector<std::string> elements;
  while (text.Next(element)) {
    // Checked, but kept as written: the field decides what it is compared as.
    if (isReal) VerifyDoubleAt(array, TextOf(element));
    if (isInt) VerifyIntAt(array, TextOf(element));
    elements.push_back(MCXML_800::Utf16ToNarrow(element.data(), element.size()));
  }
  if (!HasDeclaredCount(array, elements.size())) {
    FailAt(array, KestrelException::kInconsistentDictionary,
           "Number of Elements doesn't match with array size!");
  }
  if (elements.empty()) FailAt(array, KestrelException::kMissingElement, "No Elements found in array!");
  return elements;
}

std::vector<double> PMMLTranslator::VerifyDoubleArray(const DOMElement* array) {
  if (array == nullptr) Fail(KestrelException::kMissingElement, "No Array Element Node Found!!!");
  RequireRow(array);
  ArrayText text(array);
  std::u16string element;
  std::vector<double> numbers;
  while (text.Next(element))
    numbers.push_back(VerifyDoubleAt(array, TextOf(element)));
  if (numbers.empty()) {
    FailAt(array, KestrelException::kMissingElement, "No Elements found in double array!");
  }
  if (!HasDeclaredCount(array, numbers.size())) {
    FailAt(array, KestrelException::kMissingElement, "Number Does Not Match in Double array!");
  }
  return numbers;
}

std::vector<int> PMMLTranslator::VerifyIntArray(const DOMElement* array) {
  if (array == nullptr) Fail(KestrelException::kMissingElement, "No Array Element Found!!!");
  RequireRow(array);
  ArrayText text(array);
  std::u16string element;
  std::vector<int> numbers;
  while (text.Next(element))
    numbers.push_back(VerifyIntAt(array, TextOf(element)));
  if (numbers.empty()) FailAt(array, KestrelException::kMissingElement, "No Elements found in INT array!");
  if (!HasDeclaredCount(array, numbers.size())) {
    FailAt(array, KestrelException::kMissingElement, "Number Does Not Match in INT array!");
  }
  return numbers;
}

void PMMLTranslator::VerifyOneElem(const DOMElement* element, const std::string& tag) {
  if (element == nullptr || !IsEqual(element->getNodeName(), tag)) {
    FailAt(element, KestrelException::kMissingElement, "Doesn't match!");
  }
}

}  // namespace MCKestrel_800
