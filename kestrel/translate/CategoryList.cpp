#include "kestrel/translate/CategoryList.h"

#include <algorithm>

#include "kestrel/dictionary/ScoreCatNumericEncoder.h"
#include "kestrel/dictionary/ScoreCatStringEncoder.h"
#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/dictionary/ScoreValueLabel.h"
#include "kestrel/dictionary/ScoreValueLabelSet.h"
#include "kestrel/predicates/DiscreteSplit.h"

namespace MCKestrel_800 {

namespace {

const ScoreValue* ValueOf(const ScoreValueLabel* label) {
  return label != nullptr ? label->GetValue() : nullptr;
}

/// Whether an encoder holds a list and nothing else, as far as that can be told at once. A list may be longer
/// than the encoder: infinities escape the reader's look for duplicates, and have one code.
bool IsMadeFrom(const ScoreEncoder& encoder, const std::vector<ScoreValueLabel*>& labels, bool inOrder) {
  if (encoder.GetEncoderType() == ScoreEncoder::kBinning) return false;
  const int count = encoder.GetNumberOfCategories();
  const std::size_t codes = static_cast<std::size_t>(count);
  if (count <= 0 || codes > labels.size()) return false;
  if (!inOrder) return true;
  if (encoder.EncodeConst(ValueOf(labels.front())) != 0) return false;
  return codes < labels.size() || encoder.EncodeConst(ValueOf(labels.back())) == count - 1;
}

/// Enters codes in ascending order, so that each goes to the end of what is there.
void PutCodes(std::vector<int>& codes, DiscreteSplit& split, int child) {
  std::sort(codes.begin(), codes.end());
  for (const int code : codes)
    split.PutCodes(code, code, child);
}

}  // namespace

CategoryList::CategoryList(const ScoreDictVar& variable, bool inOrder)
    : variable_(variable),
      labels_(variable.GetMLevel() == ScoreDictVar::kContinuous ? nullptr : variable.GetValueLabels()) {
  if (labels_ == nullptr || labels_->Size() == 0) return;
  const ScoreEncoder* const encoder = variable.GetEncoder();
  if (encoder != nullptr && IsMadeFrom(*encoder, labels_->GetAllValueLabels(), inOrder)) {
    positions_ = encoder;
    size_ = encoder->GetNumberOfCategories();
  } else {
    LookThrough();
  }
}

CategoryList::~CategoryList() = default;

/// Fills an encoder of our own as a reader would fill the variable's.
void CategoryList::LookThrough() {
  if (variable_.GetVarType() == ScoreDictVar::STRING_VAR) {
    auto encoder = std::make_unique<ScoreCatStringEncoder>();
    encoder->SetNoSpaceTrim(variable_.GetNoSpaceTrim());
    encoder->SetEmptyStringOK(variable_.GetEmptyStringOK());
    made_ = std::move(encoder);
  } else {
    made_ = std::make_unique<ScoreCatNumericEncoder>();
  }
  positions_ = made_.get();
  int place = 0;
  for (const ScoreValueLabel* label : labels_->GetAllValueLabels()) {
    if (made_->Encode(ValueOf(label)) == static_cast<int>(places_.size())) places_.push_back(place);
    ++place;
  }
  size_ = static_cast<int>(places_.size());
}

int CategoryList::Find(const ScoreValue& value) const {
  return positions_ != nullptr ? positions_->EncodeConst(&value) : -1;
}

const ScoreValue* CategoryList::ValueAt(int position) const {
  const int place = places_[static_cast<std::size_t>(position)];
  return labels_->GetAllValueLabels()[static_cast<std::size_t>(place)]->GetValue();
}

void CategoryList::Enter(const std::vector<Span>& spans, DiscreteSplit& split, int child) const {
  const ScoreEncoder* const encoder = variable_.GetEncoder();
  std::vector<int> codes;
  for (const Span& span : spans) {
    if (AreCodes()) {
      if (span.first <= span.last) split.PutCodes(span.first, span.last, child);
      continue;
    }
    for (int position = span.first; position <= span.last; ++position) {
      const ScoreValue* const value = ValueAt(position);
      if (encoder == nullptr) split.PutSplit(value->Clone(), child);
      const int code =
          encoder != nullptr ? encoder->EncodeConst(value) : places_[static_cast<std::size_t>(position)];
      // A category that the encoder does not know is one that no case can have.
      if (code >= 0) codes.push_back(code);
    }
  }
  PutCodes(codes, split, child);
}

}  // namespace MCKestrel_800
