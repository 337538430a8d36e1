// The walks that the _C, _A and _8 functions have in common. A scheme knows one kind of text:
//   Step Next(const char* at, const char* end)    the character at `at`, which is before `end`
//   bool IsLead(unsigned char)                    whether several bytes can begin with it
//   size_t SafePoint(text, length, index)         a place where a character surely begins, not after `index`,
//                                                 which is less than `length`

#ifndef KESTREL_FOUNDATION_MULTIBYTEWALK_H
#define KESTREL_FOUNDATION_MULTIBYTEWALK_H

#include <unicode/uchar.h>

#include <algorithm>
#include <bitset>
#include <cstring>
#include <vector>

namespace MCXML_800 {

/// One character. What has no code point gets a number beyond them that its bytes alone have, so that texts
/// can be compared and searched all the same.
struct Step {
  size_t bytes;
  char32_t key;
  bool malformed;

  bool HasCodePoint() const { return key <= 0x10FFFF; }

  static Step Of(size_t bytes, char32_t codePoint) { return {bytes, codePoint, false}; }
  static Step Without(const char* at, size_t bytes, bool malformed) {
    char32_t key = 0;
    for (size_t i = 0; i < bytes; ++i)
      key = (key << 8) | static_cast<unsigned char>(at[i]);
    // Four bytes always begin with one from 0x80 on and fill the number; fewer carry their count.
    if (bytes < 4) key |= 0x40000000u | static_cast<char32_t>(bytes << 24);
    return {bytes, key, malformed};
  }
};

/// No character of a stateless code page has more bytes.
constexpr size_t kLongestCharacter = 16;

inline size_t BoundedLength(const char* text, size_t limit) {
  const void* const zero = std::memchr(text, 0, limit);
  return zero == nullptr ? limit : static_cast<size_t>(static_cast<const char*>(zero) - text);
}

inline char32_t Fold(char32_t key) {
  if (key < 0x80) return key >= 'A' && key <= 'Z' ? key + ('a' - 'A') : key;
  if (key > 0x10FFFF) return key;
  return static_cast<char32_t>(u_foldCase(static_cast<UChar32>(key), U_FOLD_CASE_DEFAULT));
}

/// Characters to look for.
class KeySet {
 public:
  void Add(char32_t key) {
    if (key < ascii_.size()) {
      ascii_.set(key);
    } else {
      others_.push_back(key);
    }
  }
  void Finish() { std::sort(others_.begin(), others_.end()); }
  bool Has(char32_t key) const {
    return key < ascii_.size() ? ascii_.test(key) : std::binary_search(others_.begin(), others_.end(), key);
  }

 private:
  std::bitset<128> ascii_;
  std::vector<char32_t> others_;
};

template <class Scheme>
class Walk {
 public:
  explicit Walk(Scheme& scheme) : scheme_(scheme) {}

  int Mblen(const char* at, size_t length) {
    if (at == nullptr || length == 0 || *at == 0) return 0;
    const Step step = scheme_.Next(at, at + std::min(length, kLongestCharacter));
    return step.malformed ? -1 : static_cast<int>(step.bytes);
  }

  size_t Mbclen(const char* at) { return IsEnd(at) ? 0 : NextOfTerminated(at).bytes; }

  const char* Strinc(const char* at) { return IsEnd(at) ? at : at + NextOfTerminated(at).bytes; }

  char32_t U32Get(const char* at) {
    if (IsEnd(at)) return 0;
    const Step step = NextOfTerminated(at);
    return step.HasCodePoint() ? step.key : 0xFFFD;
  }

  size_t FindStart(const char* text, size_t length, size_t index) {
    if (text == nullptr || index >= length) return length;
    size_t start = scheme_.SafePoint(text, length, index);
    for (;;) {
      const size_t next = start + scheme_.Next(text + start, text + length).bytes;
      if (next > index) return start;
      start = next;
    }
  }

  size_t PreviousIndex(const char* text, size_t index) {
    return index == 0 ? 0 : FindStart(text, index, index - 1);
  }

  const char* AnsiPrev(const char* start, const char* at) {
    if (start == nullptr || at <= start) return start;
    return start + PreviousIndex(start, static_cast<size_t>(at - start));
  }

  std::vector<size_t> FindStarts(const char* text, size_t length) {
    std::vector<size_t> starts;
    if (text == nullptr) return starts;
    for (size_t at = 0; at < length; at += scheme_.Next(text + at, text + length).bytes)
      starts.push_back(at);
    return starts;
  }

  char* Strncpy(char* to, const char* from, size_t size) {
    if (to == nullptr || size == 0) return to;
    size_t bytes = 0;
    if (from != nullptr) bytes = FindStart(from, LengthAround(from, size), size);
    std::memcpy(to, from == nullptr ? "" : from, bytes);
    std::memset(to + bytes, 0, size - bytes);
    return to;
  }

  const char* Strchr(const char* text, char32_t character, bool last) {
    if (text == nullptr) return nullptr;
    const char* const end = text + std::strlen(text);
    if (character == 0) return end;
    const char* found = nullptr;
    while (text < end) {
      const Step step = scheme_.Next(text, end);
      if (step.key == character && step.HasCodePoint()) {
        found = text;
        if (!last) break;
      }
      text += step.bytes;
    }
    return found;
  }

  size_t Strcspn(const char* text, const char* set) {
    if (text == nullptr) return 0;
    KeySet keys;
    if (set != nullptr) {
      const char* const setEnd = set + std::strlen(set);
      while (set < setEnd) {
        const Step step = scheme_.Next(set, setEnd);
        keys.Add(step.key);
        set += step.bytes;
      }
    }
    keys.Finish();
    const char* const end = text + std::strlen(text);
    const char* at = text;
    while (at < end) {
      const Step step = scheme_.Next(at, end);
      if (keys.Has(step.key)) break;
      at += step.bytes;
    }
    return static_cast<size_t>(at - text);
  }

  int Stricmp(const char* left, const char* right) {
    return Compare(left, left == nullptr ? 0 : std::strlen(left), right,
                   right == nullptr ? 0 : std::strlen(right));
  }

  int Strnicmp(const char* left, const char* right, size_t size) {
    return Compare(left, WholeCharacters(left, size), right, WholeCharacters(right, size));
  }

 private:
  static bool IsEnd(const char* at) { return at == nullptr || *at == 0; }

  Step NextOfTerminated(const char* at) {
    return scheme_.Next(at, at + BoundedLength(at, kLongestCharacter));
  }

  /// The length of a terminated text as far as it matters for a boundary at `size`.
  static size_t LengthAround(const char* text, size_t size) {
    const size_t most = static_cast<size_t>(-1) / 2;
    return BoundedLength(text, size > most ? most : size + kLongestCharacter);
  }

  size_t WholeCharacters(const char* text, size_t size) {
    return text == nullptr ? 0 : FindStart(text, LengthAround(text, size), size);
  }

  int Compare(const char* left, size_t leftLength, const char* right, size_t rightLength) {
    const char* const leftEnd = left + leftLength;
    const char* const rightEnd = right + rightLength;
    while (left < leftEnd && right < rightEnd) {
      const Step one = scheme_.Next(left, leftEnd);
      const Step two = scheme_.Next(right, rightEnd);
      const char32_t a = Fold(one.key), b = Fold(two.key);
      if (a != b) return a < b ? -1 : 1;
      left += one.bytes;
      right += two.bytes;
    }
    return static_cast<int>(left < leftEnd) - static_cast<int>(right < rightEnd);
  }

  Scheme& scheme_;
};

}  // namespace MCXML_800

#endif  // KESTREL_FOUNDATION_MULTIBYTEWALK_H
