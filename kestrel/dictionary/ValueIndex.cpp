#include "kestrel/dictionary/ValueIndex.h"

#include <algorithm>
#include <chrono>
#include <cmath>
#include <cstring>
#include <string>
#include <string_view>
#include <typeinfo>

#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"

namespace MCKestrel_800 {

namespace {

std::uint64_t Mix(std::uint64_t x) {
  x = (x ^ (x >> 30)) * 0xBF58476D1CE4E5B9u;
  x = (x ^ (x >> 27)) * 0x94D049BB133111EBu;
  return x ^ (x >> 31);
}

/// Differs from process to process, so that the author of a document cannot choose values that share a place.
struct HashKey {
  std::uint64_t first;
  std::uint64_t second;
  HashKey() {
    const auto now =
        static_cast<std::uint64_t>(std::chrono::high_resolution_clock::now().time_since_epoch().count());
    const auto here = static_cast<std::uint64_t>(reinterpret_cast<std::uintptr_t>(this));
    const auto stack = static_cast<std::uint64_t>(reinterpret_cast<std::uintptr_t>(&now));
    first = Mix(now ^ Mix(here));
    second = Mix(first ^ Mix(stack + 0x9E3779B97F4A7C15u));
  }
};

const HashKey& TheKey() {
  static const HashKey key;
  return key;
}

std::uint64_t RotateLeft(std::uint64_t x, int bits) {
  return (x << bits) | (x >> (64 - bits));
}

/// SipHash with one round per word and three at the end: short texts take some nanoseconds, and collisions
/// cannot be prepared without the key.
class SipHash {
 public:
  explicit SipHash(const HashKey& key)
      : v0_(key.first ^ 0x736F6D6570736575u),
        v1_(key.second ^ 0x646F72616E646F6Du),
        v2_(key.first ^ 0x6C7967656E657261u),
        v3_(key.second ^ 0x7465646279746573u) {}

  void Add(std::uint64_t word) {
    v3_ ^= word;
    Round();
    v0_ ^= word;
  }
  std::uint32_t Finish() {
    v2_ ^= 0xFF;
    for (int i = 0; i < 3; ++i)
      Round();
    return static_cast<std::uint32_t>(v0_ ^ v1_ ^ v2_ ^ v3_);
  }

 private:
  void Round() {
    v0_ += v1_;
    v1_ = RotateLeft(v1_, 13) ^ v0_;
    v0_ = RotateLeft(v0_, 32);
    v2_ += v3_;
    v3_ = RotateLeft(v3_, 16) ^ v2_;
    v0_ += v3_;
    v3_ = RotateLeft(v3_, 21) ^ v0_;
    v2_ += v1_;
    v1_ = RotateLeft(v1_, 17) ^ v2_;
    v2_ = RotateLeft(v2_, 32);
  }

  std::uint64_t v0_;
  std::uint64_t v1_;
  std::uint64_t v2_;
  std::uint64_t v3_;
};

std::uint32_t PlaceOfWord(std::uint64_t word, ValueKey::Kind kind) {
  const HashKey& key = TheKey();
  return static_cast<std::uint32_t>(Mix(Mix(word ^ key.first) + key.second + kind));
}

std::uint32_t PlaceOfText(std::string_view text) {
  SipHash hash(TheKey());
  const char* at = text.data();
  std::size_t left = text.size();
  for (; left >= 8; at += 8, left -= 8) {
    std::uint64_t word;
    std::memcpy(&word, at, 8);
    hash.Add(word);
  }
  std::uint64_t last = static_cast<std::uint64_t>(text.size()) << 56;
  if (left != 0) {
    std::uint64_t rest = 0;
    std::memcpy(&rest, at, left);
    last ^= rest;
  }
  hash.Add(last);
  return hash.Finish();
}

/// Files a number by its sign and leading bits. The tolerance of NumericValue::IsEqual, 2.22045e-14 of the
/// larger number, is at most 201 steps in the last bit; a place spans 4096 steps, so an equal number lies in
/// the same place or, within 256 steps of its edge, in the next one.
ValueKey KeyOfNumber(double number, ValueKey::Kind kind) {
  constexpr int kPlaceBits = 12;
  constexpr std::uint64_t kReach = 256;
  ValueKey key;
  if (!std::isfinite(number)) {
    key.kind = ValueKey::kNever;
    return key;
  }
  key.kind = kind;
  if (number == 0.0) number = 0.0;  // -0 equals 0
  std::uint64_t bits;
  std::memcpy(&bits, &number, sizeof(bits));
  const std::uint64_t sign = bits & (std::uint64_t{1} << 63);
  const std::uint64_t steps = bits ^ sign;
  const std::uint64_t own = steps >> kPlaceBits;
  const std::uint64_t below = steps < kReach ? 0 : (steps - kReach) >> kPlaceBits;
  const std::uint64_t above = (steps + kReach) >> kPlaceBits;
  const std::uint64_t neighbour = below != own ? below : above;
  key.own = PlaceOfWord(own | sign, kind);
  key.neighbour = neighbour == own ? key.own : PlaceOfWord(neighbour | sign, kind);
  return key;
}

}  // namespace

// Defined here too, so that hosts and plug-ins can take its address.
constexpr std::size_t ValueIndex::kNone;

ValueKey MakeValueKey(const ScoreValue* value) {
  ValueKey key;
  if (value == nullptr) return key;
  const std::type_info& type = typeid(*value);
  if (type == typeid(NumericValue)) return KeyOfNumber(value->GetDouble(), ValueKey::kNumber);
  if (type == typeid(StringValue)) {
    key.kind = ValueKey::kText;
    key.own = PlaceOfText(WithoutTrailingBlanks(static_cast<const StringValue*>(value)->GetText()));
    key.neighbour = key.own;
    return key;
  }
  if (type == typeid(DateTimeValue)) return KeyOfNumber(value->GetDouble(), ValueKey::kDateTime);
  return key;
}

std::uint32_t JoinPlaces(std::uint32_t first, std::uint32_t second) {
  return PlaceOfWord((static_cast<std::uint64_t>(first) << 32) | second, ValueKey::kForeign);
}

void ErasePosition(std::vector<std::uint32_t>& positions, std::size_t position) {
  auto out = positions.begin();
  for (const std::uint32_t kept : positions) {
    if (kept != position) *out++ = kept > position ? kept - 1 : kept;
  }
  positions.erase(out, positions.end());
}

void ValueIndex::Clear() {
  places_.clear();
  next_.clear();
  tails_.clear();
  foreign_.clear();
  linked_ = 0;
}

void ValueIndex::Append(std::uint32_t place) {
  const auto position = static_cast<std::uint32_t>(places_.size());
  places_.push_back(place);
  next_.push_back(position);
  ++linked_;
  if (linked_ > tails_.size()) {
    LinkAll();
  } else {
    Link(position);
  }
}

void ValueIndex::AppendUnfiled() {
  places_.push_back(0);
  next_.push_back(kUnlinked);
}

void ValueIndex::AppendForeign() {
  foreign_.push_back(static_cast<std::uint32_t>(places_.size()));
  AppendUnfiled();
}

void ValueIndex::Erase(std::size_t position) {
  const auto at = static_cast<std::ptrdiff_t>(position);
  if (next_[position] != kUnlinked) --linked_;
  places_.erase(places_.begin() + at);
  next_.erase(next_.begin() + at);
  ErasePosition(foreign_, position);
  LinkAll();
}

void ValueIndex::Link(std::uint32_t position) {
  std::uint32_t& tail = tails_[places_[position] & (tails_.size() - 1)];
  if (tail == kUnlinked) {
    next_[position] = position;
  } else {
    next_[position] = next_[tail];
    next_[tail] = position;
  }
  tail = position;
}

void ValueIndex::LinkAll() {
  std::size_t chains = 2 * kSmall;
  while (chains < linked_)
    chains *= 2;
  tails_.assign(chains, kUnlinked);
  for (std::size_t position = 0; position < next_.size(); ++position) {
    if (next_[position] != kUnlinked) Link(static_cast<std::uint32_t>(position));
  }
}

}  // namespace MCKestrel_800
