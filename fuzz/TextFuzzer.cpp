// Bytes as text: walks and conversions of UTF-8 and of code pages agree with one another.

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <map>
#include <memory>
#include <string>
#include <vector>

#include "fuzz/Check.h"
#include "kestrel/foundation/CodePages.h"
#include "kestrel/foundation/MultibyteConversions.h"
#include "kestrel/foundation/NarrowText.h"
#include "tests/foundation/TextKinds.h"

namespace {

using namespace MCXML_800;
using kestrel_fuzz::Check;
using kestrel_tests::TextKind;

/// Walking back is done from every place, so texts are kept short.
constexpr size_t kLongestWalk = 300;

/// The start of the character that holds the byte, or the text's length.
size_t StartOf(const std::vector<size_t>& starts, size_t length, size_t index) {
  if (index >= length) return length;
  return *(std::upper_bound(starts.begin(), starts.end(), index) - 1);
}

void CheckWalkWithLength(const TextKind& kind, const std::string& text) {
  const std::vector<size_t> starts = kind.FindStarts(text.data(), text.size());
  Check(starts.empty() == text.empty(), "a text has characters unless it is empty");
  Check(text.empty() || starts.front() == 0, "the first character begins the text");
  for (size_t i = 1; i < starts.size(); ++i)
    Check(starts[i - 1] < starts[i] && starts[i] < text.size(), "starts ascend");
  for (size_t index = 0; index <= text.size(); ++index) {
    Check(kind.FindStart(text.data(), text.size(), index) == StartOf(starts, text.size(), index),
          "FindStart finds what FindStarts finds");
  }
  size_t at = text.size();
  for (size_t i = starts.size(); i > 0; --i) {
    at = kind.PreviousIndex(text.data(), at);
    Check(at == starts[i - 1], "walking backwards meets the same starts");
  }
  Check(at == 0, "walking backwards ends at the start");
}

void CheckCharacter(const TextKind& kind, const char* at, const char* end) {
  const size_t bytes = kind.Mbclen(at);
  Check(bytes > 0 && bytes <= static_cast<size_t>(end - at), "a character lies within the text");
  const int measured = kind.Mblen(at, static_cast<size_t>(end - at));
  Check(measured == -1 || measured == static_cast<int>(bytes), "mblen and mbclen agree");
  const char32_t character = kind.U32Get(at);
  Check(character != 0 && character <= 0x10FFFF, "a character has a code point");
  Check(measured == static_cast<int>(bytes) || character == 0xFFFD, "malformed bytes read as U+FFFD");
}

void CheckWalkOfTerminated(const TextKind& kind, const std::string& text) {
  const char* const begin = text.c_str();
  const char* const end = begin + text.size();
  const std::vector<size_t> starts = kind.FindStarts(begin, text.size());
  size_t count = 0;
  for (const char* at = begin; at < end; at = kind.Strinc(at)) {
    Check(count < starts.size() && at == begin + starts[count], "strinc meets the same starts");
    ++count;
    CheckCharacter(kind, at, end);
    const char32_t character = kind.U32Get(at);
    if (character == 0xFFFD) continue;
    const char* const first = kind.Strchr(begin, character);
    const char* const last = kind.Strrchr(begin, character);
    Check(first != nullptr && first <= at && last >= at, "a character that is there is found");
  }
  Check(count == starts.size(), "strinc meets every start");
  const char* at = end;
  for (size_t i = starts.size(); i > 0; --i) {
    at = kind.AnsiPrev(begin, at);
    Check(at == begin + starts[i - 1], "AnsiPrev meets the same starts");
  }
}

void CheckCopies(const TextKind& kind, const std::string& text) {
  const std::vector<size_t> starts = kind.FindStarts(text.data(), text.size());
  for (size_t size = 0; size <= text.size() + 2; ++size) {
    // No byte more than asked for, so that a write beyond is seen.
    const std::unique_ptr<char[]> copy(new char[size + 1]);
    std::memset(copy.get(), 'x', size + 1);
    kind.Strncpy(copy.get(), text.c_str(), size);
    const size_t whole = StartOf(starts, text.size(), size);
    Check(std::memcmp(copy.get(), text.data(), whole) == 0, "a copy holds the whole characters");
    Check(std::count(copy.get() + whole, copy.get() + size, '\0') == static_cast<long>(size - whole),
          "the rest of a copy is zeros");
    Check(copy[size] == 'x', "a copy stays within its size");
  }
}

void CheckComparisons(const TextKind& kind, const std::string& text) {
  const std::vector<size_t> starts = kind.FindStarts(text.data(), text.size());
  const size_t middle = starts.empty() ? 0 : starts[starts.size() / 2];
  const std::string left = text.substr(0, middle), right = text.substr(middle);
  Check(kind.Qstricmp(text.c_str(), text.c_str()) == 0, "a text equals itself");
  const int order = kind.Qstricmp(left.c_str(), right.c_str());
  const int other = kind.Qstricmp(right.c_str(), left.c_str());
  Check((order < 0) == (other > 0) && (order == 0) == (other == 0), "orders are opposite");
  Check(kind.Strnicmp(text.c_str(), left.c_str(), left.size()) == 0, "a text begins with its beginning");
  Check(kind.Strcspn(text.c_str(), text.c_str()) == 0, "the first character is in the set");
  Check(kind.Strcspn(text.c_str(), "") == text.size(), "the empty set holds none");
}

void CheckKind(const TextKind& kind, const std::string& text) {
  CheckWalkWithLength(kind, text);
  const std::string terminated = text.c_str();
  CheckWalkOfTerminated(kind, terminated);
  CheckCopies(kind, terminated);
  CheckComparisons(kind, terminated);
}

/// A buffer form at sizes around that of the whole result: cut between characters, terminated, never longer.
template <class Convert>
void CheckBuffers(const TextKind& resultKind, const std::string& whole, Convert convert) {
  const std::vector<size_t> starts = resultKind.FindStarts(whole.data(), whole.size());
  for (const size_t size :
       {size_t{1}, size_t{2}, size_t{5}, whole.size(), whole.size() + 1, whole.size() + 9}) {
    const std::unique_ptr<char[]> out(new char[size + 1]);
    std::memset(out.get(), 'x', size + 1);
    size_t length = 0;
    const int status = convert(out.get(), size, &length);
    if (size == 0) {
      Check(status == kVEXAMBBufferTooSmall && length == whole.size(), "no buffer is told the length");
      continue;
    }
    Check((status == kVEXAMBBufferTooSmall) == (size <= whole.size()), "a buffer is too small or not");
    Check(length < size && out[length] == '\0' && out[size] == 'x', "a result is terminated and fits");
    Check(std::memcmp(out.get(), whole.data(), length) == 0, "a cut result is a beginning");
    Check(length == whole.size() || std::binary_search(starts.begin(), starts.end(), length),
          "a result is cut between characters");
    Check(size <= whole.size() || length == whole.size(), "what fits is whole");
  }
}

void CheckUtf16(const std::string& text) {
  std::u16string wide;
  const int status = VEXAMBGenericToU16(text, wide);
  Check(status == kVEXAMBOk || status == kVEXAMBSubstituted, "a conversion has a status");
  std::string back;
  Check(VEXAMBU16ToGeneric(wide, back) == kVEXAMBOk, "UTF-16 of a conversion is whole");
  Check(status != kVEXAMBOk || back == text, "UTF-16 and back changes nothing");
  Check(NarrowToUtf16(text) == wide, "narrow text converts in one way");
  Check(Utf16ToNarrow(wide.data(), wide.size()) == back, "UTF-16 converts in one way");
  // Bytes as UTF-16, half pairs and all.
  std::u16string loose(text.size() / 2, u'\0');
  std::memcpy(loose.data(), text.data(), 2 * loose.size());
  std::string narrow, again;
  VEXAMBU16ToGeneric(loose, narrow);
  Check(VEXAMBGenericToU8(narrow, again) == kVEXAMBOk && again == narrow, "a conversion gives valid text");
}

void CheckCodePage(UConverter* codePage, const TextKind& pageKind, const TextKind& utf8,
                   const std::string& text) {
  std::string generic, page, second, third;
  VEXAMBCodePageToGeneric(codePage, text, generic);
  Check(VEXAMBGenericToU8(generic, second) == kVEXAMBOk && second == generic, "a conversion gives UTF-8");
  CheckBuffers(utf8, generic, [&](char* out, size_t size, size_t* length) {
    return VEXAMBCodePagetoGeneric(codePage, text.data(), text.size(), out, size, length);
  });
  const int status = VEXAMBU8ToCodePage(codePage, text, page);
  Check(VEXAMBGenericToCodePage(codePage, text, second) == status && second == page, "generic text is UTF-8");
  CheckBuffers(pageKind, page, [&](char* out, size_t size, size_t* length) {
    return VEXAMBU8ToCodePage(codePage, text.data(), text.size(), out, size, length);
  });
  if (status != kVEXAMBOk) return;
  Check(VEXAMBCodePageToGeneric(codePage, page, second) == kVEXAMBOk, "what was converted converts back");
  Check(VEXAMBGenericToCodePage(codePage, second, third) == kVEXAMBOk && third == page,
        "and there again is the same");
}

struct ConverterDeleter {
  void operator()(UConverter* converter) const { VEXAMBConverterDelete(converter); }
};
struct Page {
  std::unique_ptr<UConverter, ConverterDeleter> converter;
  std::unique_ptr<TextKind> kind;
};

/// Opened once, because that takes longer than a case.
const Page& PageOf(long number) {
  static std::map<long, Page> pages;
  Page& page = pages[number];
  if (page.kind == nullptr) {
    page.converter.reset(VEXAMBConverterNewForCodePage(number));
    Check(page.converter != nullptr, "the code page is known");
    page.kind = kestrel_tests::MakeKind(FindConverterName(number));
  }
  return page;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  const std::string text(reinterpret_cast<const char*>(data), std::min(size, kLongestWalk));
  static const std::unique_ptr<TextKind> utf8 = kestrel_tests::MakeKind("_8");
  CheckKind(*utf8, text);
  CheckUtf16(text);
  // Shift JIS, Chinese with one and with two pairs of bytes, and a page of single bytes.
  for (const long number : {932L, 936L, 54936L, 1252L}) {
    const Page& page = PageOf(number);
    CheckKind(*page.kind, text);
    CheckCodePage(page.converter.get(), *page.kind, *utf8, text);
  }
  return 0;
}
