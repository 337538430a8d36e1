#include "kestrel/dictionary/ScoreCatStringEncoder.h"

#include <ostream>
#include <typeinfo>

#include "kestrel/dictionary/EncoderLabels.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"

namespace MCKestrel_800 {

ScoreEncoder::~ScoreEncoder() = default;

ScoreCatStringEncoder::ScoreCatStringEncoder(int n) {
  keys_.reserve(EncoderRoom(n));
}

ScoreCatStringEncoder::ScoreCatStringEncoder(const std::vector<std::string>& texts) {
  for (const std::string& text : texts)
    ScoreCatStringEncoder::Encode(text);
}

ScoreCatStringEncoder::ScoreCatStringEncoder(const ScoreCatStringEncoder& other)
    : ScoreEncoder(other),
      codes_(other.codes_),
      keys_(other.keys_.size()),
      labels_(other.labels_),
      lastCode_(other.lastCode_),
      noSpaceTrim_(other.noSpaceTrim_),
      emptyStringOK_(other.emptyStringOK_) {
  // The other encoder's list points into the other encoder's map.
  for (const auto& [key, code] : codes_)
    keys_[static_cast<std::size_t>(code)] = &key;
}

ScoreCatStringEncoder& ScoreCatStringEncoder::operator=(const ScoreCatStringEncoder& other) {
  if (this == &other) return *this;
  ScoreCatStringEncoder copy(other);
  // Swapping moves the map's nodes as they are, so the list still points at them.
  codes_.swap(copy.codes_);
  keys_.swap(copy.keys_);
  labels_.swap(copy.labels_);
  lastCode_ = copy.lastCode_;
  noSpaceTrim_ = copy.noSpaceTrim_;
  emptyStringOK_ = copy.emptyStringOK_;
  return *this;
}

ScoreCatStringEncoder::~ScoreCatStringEncoder() = default;

ScoreEncoder::EncoderType ScoreCatStringEncoder::GetEncoderType() const {
  return kCatString;
}

int ScoreCatStringEncoder::GetNumberOfCategories() const {
  return static_cast<int>(keys_.size());
}

int ScoreCatStringEncoder::Find(std::string_view key) const {
  const auto it = codes_.find(key);
  return it == codes_.end() ? -1 : it->second;
}

std::string_view ScoreCatStringEncoder::KeyOf(std::string_view text) const {
  if (noSpaceTrim_ || text.empty()) return text;
  const std::string_view key = WithoutTrailingBlanks(text);
  return key.empty() && emptyStringOK_ ? text.substr(0, 1) : key;
}

int ScoreCatStringEncoder::Encode(const std::string& text) {
  // The text itself comes first: it may have been registered untrimmed.
  const int known = ScoreCatStringEncoder::EncodeConst(text);
  if (known >= 0) return known;
  const auto it = codes_.emplace(KeyOf(text), ++lastCode_).first;
  keys_.push_back(&it->first);
  return lastCode_;
}

int ScoreCatStringEncoder::Encode(const ScoreValue* value) {
  return value == nullptr ? -1 : Encode(value->GetString());
}

int ScoreCatStringEncoder::EncodeConst(const std::string& text) const {
  const int known = Find(text);
  if (known >= 0) return known;
  const std::string_view key = KeyOf(text);
  return key.size() == text.size() ? -1 : Find(key);
}

int ScoreCatStringEncoder::EncodeConst(const ScoreValue* value) const {
  if (value == nullptr) return -1;
  if (typeid(*value) == typeid(StringValue))
    return EncodeConst(static_cast<const StringValue*>(value)->GetText());
  return EncodeConst(value->GetString());
}

std::string ScoreCatStringEncoder::Decode(int code) const {
  return code < 0 || code > lastCode_ ? std::string() : *keys_[static_cast<std::size_t>(code)];
}

double ScoreCatStringEncoder::DecodeNum(int) const {
  return NumericValue::gSysmisValue;
}

ScoreCatStringEncoder* ScoreCatStringEncoder::Clone() const {
  return new ScoreCatStringEncoder(*this);
}

void ScoreCatStringEncoder::SetValueLabels(const std::vector<std::string>& labels) {
  labels_ = labels;
}

void ScoreCatStringEncoder::SetValueLabel(int code, const std::string& label) {
  SetEncoderLabel(labels_, GetNumberOfCategories(), code, label);
}

const std::vector<std::string>* ScoreCatStringEncoder::GetValueLabels() const {
  return &labels_;
}

void ScoreCatStringEncoder::Display(std::ostream& os) const {
  // Numbers go through to_string: a stream may carry a locale that groups digits.
  os << "\tScoreCatStringEncoder object:  Last code = " << std::to_string(lastCode_) << "\n";
  for (std::size_t code = 0; code < keys_.size(); ++code) {
    os << "\t\t" << std::to_string(code) << "\t\t";
    if (keys_[code] == nullptr) {
      os << "ERROR\n";
    } else {
      os << *keys_[code] << "\n";
    }
  }
}

void ScoreCatStringEncoder::SetNoSpaceTrim(bool noSpaceTrim) {
  noSpaceTrim_ = noSpaceTrim;
}

bool ScoreCatStringEncoder::GetNoSpaceTrim() const {
  return noSpaceTrim_;
}

void ScoreCatStringEncoder::SetEmptyStringOK(bool emptyStringOK) {
  emptyStringOK_ = emptyStringOK;
}

bool ScoreCatStringEncoder::GetEmptyStringOK() const {
  return emptyStringOK_;
}

}  // namespace MCKestrel_800
