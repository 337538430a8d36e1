#include "kestrel/translate/ArrayText.h"

#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

namespace {

constexpr char16_t kQuote = u'"';
constexpr char16_t kEscape = u'\\';

}  // namespace

ArrayText::ArrayText(const xercesc::DOMElement* array) : text_(ElementText(array)) {}

bool ArrayText::Next(std::u16string& element) {
  element.clear();
  for (; at_ < text_.size(); ++at_) {
    const char16_t c = text_[at_];
    if (c == kQuote) {
      // A quote behind other characters begins the element after them.
      if (element.empty()) ReadQuoted(element);
      return true;
    }
    if (c == u' ') {
      if (!element.empty()) return true;
    } else if (c == kEscape && at_ + 1 < text_.size() && text_[at_ + 1] == kQuote) {
      ++at_;
    } else if (c != u'\n') {
      element += c;
    }
  }
  return !element.empty();
}

void ArrayText::ReadQuoted(std::u16string& element) {
  const std::size_t start = ++at_;
  while (at_ < text_.size() && (text_[at_] != kQuote || text_[at_ - 1] == kEscape))
    ++at_;
  element.assign(text_, start, at_ - start);
  if (at_ < text_.size()) ++at_;
}

}  // namespace MCKestrel_800
