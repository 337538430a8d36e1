#include "kestrel/dictionary/TextCodes.h"

#include <chrono>
#include <cstring>

namespace MCKestrel_800 {
namespace {

// Secret numbers of this process: without them, no document can be written whose categories all land in one
// place.
struct HashKey {
  std::uint64_t start;
  std::uint64_t factor;

  HashKey() {
    const auto now = static_cast<std::uint64_t>(std::chrono::steady_clock::now().time_since_epoch().count());
    const auto place = static_cast<std::uint64_t>(reinterpret_cast<std::uintptr_t>(this));
    start = Mix(now ^ Mix(place));
    factor = Mix(start + 0x9E3779B97F4A7C15u) | 1;
  }

  static std::uint64_t Mix(std::uint64_t x) {
    x = (x ^ (x >> 30)) * 0xBF58476D1CE4E5B9u;
    x = (x ^ (x >> 27)) * 0x94D049BB133111EBu;
    return x ^ (x >> 31);
  }
};

const HashKey kKey;

// Category texts are short: eight bytes a step, one multiplication each. The shift brings the high bits of
// the product, which depend on all bytes so far, back to where the table and the next step look.
std::uint64_t Hash(std::string_view text) {
  std::uint64_t hash = kKey.start + text.size();
  const char* next = text.data();
  std::size_t left = text.size();
  std::uint64_t block;
  for (; left >= sizeof block; left -= sizeof block, next += sizeof block) {
    std::memcpy(&block, next, sizeof block);
    hash = (hash ^ block) * kKey.factor;
    hash ^= hash >> 32;
  }
  block = 0;
  for (std::size_t i = 0; i < left; ++i)
    block |= std::uint64_t{static_cast<unsigned char>(next[i])} << (8 * i);
  hash = (hash ^ block) * kKey.factor;
  return hash ^ (hash >> 32);
}

}  // namespace

// Defined here too, so that hosts and plug-ins can take its address.
constexpr int TextCodes::kUnknown;

std::string_view TextCodes::KeyOf(std::string_view text) const {
  if (keep_trailing_blanks_) return text;
  while (!text.empty() && text.back() == ' ')
    text.remove_suffix(1);
  return text;
}

const TextCodes::Entry* TextCodes::FindKey(std::string_view key, std::uint64_t hash) const {
  if (table_.empty()) return nullptr;
  const std::size_t mask = table_.size() - 1;
  for (std::size_t at = hash & mask; table_[at] != 0; at = (at + 1) & mask) {
    const Entry& entry = entries_[table_[at] - 1];
    if (entry.hash == hash && entry.length == key.size() &&
        std::memcmp(texts_.data() + entry.begin, key.data(), key.size()) == 0) {
      return &entry;
    }
  }
  return nullptr;
}

int TextCodes::Find(std::string_view text) const {
  const std::string_view key = KeyOf(text);
  const Entry* entry = FindKey(key, Hash(key));
  return entry == nullptr ? kUnknown : entry->code;
}

int TextCodes::Add(std::string_view text, int code) {
  const std::string_view key = KeyOf(text);
  const std::uint64_t hash = Hash(key);
  if (const Entry* entry = FindKey(key, hash)) return entry->code;
  entries_.push_back(
      {hash, static_cast<std::uint32_t>(texts_.size()), static_cast<std::uint32_t>(key.size()), code});
  texts_.append(key.data(), key.size());
  if (table_.size() < 2 * entries_.size()) {
    Grow();
  } else {
    Insert(static_cast<std::uint32_t>(entries_.size()), hash);
  }
  return code;
}

void TextCodes::Grow() {
  std::size_t size = 8;
  while (size < 4 * entries_.size())
    size *= 2;
  table_.assign(size, 0);
  for (std::size_t i = 0; i < entries_.size(); ++i)
    Insert(static_cast<std::uint32_t>(i + 1), entries_[i].hash);
}

void TextCodes::Insert(std::uint32_t number, std::uint64_t hash) {
  const std::size_t mask = table_.size() - 1;
  std::size_t at = hash & mask;
  while (table_[at] != 0)
    at = (at + 1) & mask;
  table_[at] = number;
}

}  // namespace MCKestrel_800
