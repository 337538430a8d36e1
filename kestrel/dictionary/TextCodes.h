// From a category's text to its code: the look-up that every text input of every case goes through.

#ifndef KESTREL_DICTIONARY_TEXTCODES_H
#define KESTREL_DICTIONARY_TEXTCODES_H

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// A table of texts with their codes, packed into three arrays: an open-addressing table of entry numbers,
/// the entries with their hashes, and all texts in a row. Looking up allocates nothing. Built on one thread,
/// then only read.
class KESTREL_API TextCodes {
 public:
  static constexpr int kUnknown = -1;

  /// keep_trailing_blanks  false: a text and the same text followed by blanks are one key.
  explicit TextCodes(bool keep_trailing_blanks) : keep_trailing_blanks_(keep_trailing_blanks) {}

  /// Adds a text with its code, unless it is there already. Returns the code that it has afterwards.
  int Add(std::string_view text, int code);

  /// The text's code, or kUnknown.
  int Find(std::string_view text) const;

  bool IsEmpty() const { return entries_.empty(); }
  /// The number of texts.
  std::size_t GetSize() const { return entries_.size(); }

 private:
  struct Entry {
    std::uint64_t hash;
    std::uint32_t begin;
    std::uint32_t length;
    int code;
  };

  std::string_view KeyOf(std::string_view text) const;
  const Entry* FindKey(std::string_view key, std::uint64_t hash) const;
  void Grow();
  void Insert(std::uint32_t number, std::uint64_t hash);

  bool keep_trailing_blanks_;
  std::string texts_;
  std::vector<Entry> entries_;
  /// Entry numbers plus 1, 0 where free; a power of two long and never more than half full.
  std::vector<std::uint32_t> table_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_TEXTCODES_H
