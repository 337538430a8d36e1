#include "kestrel/dictionary/ScoreBinningEncoder.h"

#include <cmath>
#include <ostream>

#include "kestrel/dictionary/EncoderLabels.h"
#include "kestrel/foundation/NumberText.h"
#include "kestrel/foundation/NumericValue.h"

namespace MCKestrel_800 {

ScoreBinningEncoder::ScoreBinningEncoder(const std::vector<double>& cutpoints)
    : numberOfBins_(static_cast<int>(cutpoints.size()) + 1), cutpoints_(cutpoints) {}

ScoreBinningEncoder::ScoreBinningEncoder(const ScoreBinningEncoder& other) = default;
ScoreBinningEncoder& ScoreBinningEncoder::operator=(const ScoreBinningEncoder& other) = default;
ScoreBinningEncoder::~ScoreBinningEncoder() = default;

ScoreEncoder::EncoderType ScoreBinningEncoder::GetEncoderType() const {
  return kBinning;
}

int ScoreBinningEncoder::GetNumberOfCategories() const {
  return numberOfBins_;
}

double ScoreBinningEncoder::Encode(double number) const {
  int low = 0;
  int high = static_cast<int>(cutpoints_.size()) - 1;
  int bin = 0;
  while (low <= high) {
    const int mid = low + (high - low) / 2;
    const double cutpoint = cutpoints_[static_cast<std::size_t>(mid)];
    if (number == cutpoint) return mid;
    if (cutpoint > number) {
      high = mid - 1;
      bin = mid;
    } else {
      low = mid + 1;
      bin = mid + 1;
    }
  }
  return bin;
}

int ScoreBinningEncoder::EncodeConst(const std::string& text) const {
  const NumericValue number(text);
  return EncodeConst(&number);
}

int ScoreBinningEncoder::EncodeConst(const ScoreValue* value) const {
  if (value == nullptr) return -1;
  const double number = value->GetDouble();
  if (std::isnan(number) || NumericValue::IsSystemMissingValue(number)) return -1;
  return static_cast<int>(Encode(number));
}

int ScoreBinningEncoder::Encode(const ScoreValue* value) {
  return EncodeConst(value);
}

int ScoreBinningEncoder::Encode(const std::string& text) {
  return EncodeConst(text);
}

std::string ScoreBinningEncoder::Decode(int) const {
  return std::string();
}

double ScoreBinningEncoder::DecodeNum(int) const {
  return NumericValue::gSysmisValue;
}

ScoreBinningEncoder* ScoreBinningEncoder::Clone() const {
  return new ScoreBinningEncoder(*this);
}

void ScoreBinningEncoder::SetValueLabels(const std::vector<std::string>& labels) {
  labels_ = labels;
}

void ScoreBinningEncoder::SetValueLabel(int code, const std::string& label) {
  SetEncoderLabel(labels_, numberOfBins_, code, label);
}

const std::vector<std::string>* ScoreBinningEncoder::GetValueLabels() const {
  return &labels_;
}

void ScoreBinningEncoder::Display(std::ostream& os) const {
  os << "\tScoreBinningEncoder: number of bins = " << std::to_string(numberOfBins_) << "\n\t\tCutpoints: ";
  for (const double cutpoint : cutpoints_)
    os << FormatSixDigits(cutpoint) << " ";
  os << "\n";
}

const std::vector<double>& ScoreBinningEncoder::GetBinningCutpoints() const {
  return cutpoints_;
}

void ScoreBinningEncoder::SetBinningCutpoints(const std::vector<double>& cutpoints) {
  cutpoints_ = cutpoints;
  numberOfBins_ = static_cast<int>(cutpoints_.size()) + 1;
}

}  // namespace MCKestrel_800
