#include "kestrel/transform/EncodingTable.h"

#include <string_view>
#include <typeinfo>

#include "kestrel/transform/SourceField.h"
#include "kestrel/transform/ValueMatcher.h"

namespace MCKestrel_800 {
namespace {

// Up to this many rows a walk costs no more than filing the value.
constexpr std::size_t kWalked = 4;

}  // namespace

EncodingTable::EncodingTable(const std::vector<TransformVar::Encoding>& rows) {
  rows_.reserve(rows.size());
  for (const TransformVar::Encoding& encoding : rows) {
    const ScoreValueMatcher* const matcher = encoding.matcher.get();
    Row row = {ValueKey::kForeign, NumericValue::gSysmisValue, nullptr, matcher};
    ValueKey key;
    if (matcher == nullptr) {
      row.kind = ValueKey::kNever;
    } else if (typeid(*matcher) == typeid(ValueMatcher)) {
      const ScoreValue* const value = static_cast<const ValueMatcher*>(matcher)->GetValue();
      key = MakeValueKey(value);
      row.kind = value == nullptr ? ValueKey::kNever : key.kind;
      if (key.kind == ValueKey::kText) row.text = static_cast<const StringValue*>(value);
      if (key.kind == ValueKey::kNumber || key.kind == ValueKey::kDateTime) row.number = value->GetDouble();
    }
    if (row.kind == ValueKey::kForeign) {
      lists_texts_ = false;
      index_.AppendForeign();
    } else if (row.kind == ValueKey::kNever) {
      index_.AppendUnfiled();
    } else {
      index_.Append(key.own);
    }
    rows_.push_back(row);
  }
}

std::vector<const StringValue*> EncodingTable::GetTexts() const {
  std::vector<const StringValue*> texts;
  for (const Row& row : rows_) {
    if (row.kind == ValueKey::kText) texts.push_back(row.text);
  }
  return texts;
}

std::size_t EncodingTable::FindText(const StringValue& text) const {
  SourceField source(nullptr);
  source.Set(&text);
  return Find(source);
}

template <class Matches>
std::size_t EncodingTable::FindWith(const SourceField& source, const Matches& matches) const {
  if (rows_.size() > kWalked) return index_.FirstOf(source.GetKey(), matches);
  for (std::size_t row = 0; row < rows_.size(); ++row) {
    if (matches(row)) return row;
  }
  return kNone;
}

std::size_t EncodingTable::Find(const SourceField& source) const {
  const ScoreValue& value = *source.GetValue();
  const auto asks = [&value](const Row& row) {
    return row.kind == ValueKey::kForeign && row.matcher->Matches(value);
  };
  const std::type_info& type = typeid(value);
  if (type == typeid(StringValue)) {
    const std::string_view text = WithoutTrailingBlanks(static_cast<const StringValue&>(value).GetText());
    return FindWith(source, [this, text, &asks](std::size_t position) {
      const Row& row = rows_[position];
      if (row.kind != ValueKey::kText) return asks(row);
      return WithoutTrailingBlanks(row.text->GetText()) == text;
    });
  }
  const ValueKey::Kind kind = source.GetKey().kind;
  if (kind == ValueKey::kNumber || kind == ValueKey::kDateTime) {
    const double number = source.GetNumber();
    return FindWith(source, [this, kind, number, &asks](std::size_t position) {
      const Row& row = rows_[position];
      if (row.kind != kind) return asks(row);
      return NumericValue::IsEqual(row.number, number);
    });
  }
  // An infinity, or a value of a host's own class: each row decides.
  for (std::size_t position = 0; position < rows_.size(); ++position) {
    const ScoreValueMatcher* const matcher = rows_[position].matcher;
    if (matcher != nullptr && matcher->Matches(value)) return position;
  }
  return kNone;
}

}  // namespace MCKestrel_800
