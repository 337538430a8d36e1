#include "kestrel/dictionary/ScoreCatNumericEncoder.h"

#include <cmath>
#include <ostream>

#include "kestrel/dictionary/EncoderLabels.h"
#include "kestrel/foundation/NumberText.h"
#include "kestrel/foundation/NumericValue.h"

namespace MCKestrel_800 {

ScoreCatNumericEncoder::ScoreCatNumericEncoder(int n) {
  numbers_.reserve(EncoderRoom(n));
}

ScoreCatNumericEncoder::ScoreCatNumericEncoder(const std::vector<double>& numbers) {
  for (const double number : numbers)
    Encode(number);
}

ScoreCatNumericEncoder::ScoreCatNumericEncoder(const ScoreCatNumericEncoder& other) = default;
ScoreCatNumericEncoder& ScoreCatNumericEncoder::operator=(const ScoreCatNumericEncoder& other) = default;
ScoreCatNumericEncoder::~ScoreCatNumericEncoder() = default;

ScoreEncoder::EncoderType ScoreCatNumericEncoder::GetEncoderType() const {
  return kCatNumeric;
}

int ScoreCatNumericEncoder::GetNumberOfCategories() const {
  return static_cast<int>(numbers_.size());
}

int ScoreCatNumericEncoder::Encode(double number) {
  // NaN has no place in the order of the map: looking for it would find any key.
  if (std::isnan(number)) return -1;
  const auto [it, isNew] = codes_.emplace(number, lastCode_ + 1);
  if (isNew) {
    ++lastCode_;
    numbers_.push_back(number);
  }
  return it->second;
}

int ScoreCatNumericEncoder::Encode(const std::string& text) {
  return Encode(NumericValue(text).GetDouble());
}

int ScoreCatNumericEncoder::Encode(const ScoreValue* value) {
  return value == nullptr ? -1 : Encode(value->GetDouble());
}

int ScoreCatNumericEncoder::EncodeConst(double number) const {
  if (std::isnan(number)) return -1;
  const auto it = codes_.find(number);
  return it == codes_.end() ? -1 : it->second;
}

int ScoreCatNumericEncoder::EncodeConst(const std::string& text) const {
  return EncodeConst(NumericValue(text).GetDouble());
}

int ScoreCatNumericEncoder::EncodeConst(const ScoreValue* value) const {
  return value == nullptr ? -1 : EncodeConst(value->GetDouble());
}

std::string ScoreCatNumericEncoder::Decode(int) const {
  return std::string();
}

double ScoreCatNumericEncoder::DecodeNum(int code) const {
  return code < 0 || code > lastCode_ ? NumericValue::gSysmisValue : numbers_[static_cast<std::size_t>(code)];
}

ScoreCatNumericEncoder* ScoreCatNumericEncoder::Clone() const {
  return new ScoreCatNumericEncoder(*this);
}

void ScoreCatNumericEncoder::SetValueLabels(const std::vector<std::string>& labels) {
  labels_ = labels;
}

void ScoreCatNumericEncoder::SetValueLabel(int code, const std::string& label) {
  SetEncoderLabel(labels_, GetNumberOfCategories(), code, label);
}

const std::vector<std::string>* ScoreCatNumericEncoder::GetValueLabels() const {
  return &labels_;
}

void ScoreCatNumericEncoder::Display(std::ostream& os) const {
  constexpr std::size_t kPerLine = 7;
  os << "\tScoreCatNumericEncoder: Last code = " << std::to_string(lastCode_) << "\n";
  os << "\t\tNumeric values of categories: ";
  for (std::size_t code = 0; code < numbers_.size(); ++code) {
    os << FormatSixDigits(numbers_[code]) << " ";
    if ((code + 1) % kPerLine == 0) os << "\n";
  }
  os << "\n";
}

}  // namespace MCKestrel_800
