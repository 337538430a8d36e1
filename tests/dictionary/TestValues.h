// Values and foreign implementations that the tests of this room share.

#ifndef KESTREL_TESTS_DICTIONARY_TESTVALUES_H
#define KESTREL_TESTS_DICTIONARY_TESTVALUES_H

#include <cmath>
#include <memory>
#include <ostream>
#include <sstream>
#include <string>
#include <utility>
#include <vector>

#include "kestrel/dictionary/ScoreMissingValueSet.h"
#include "kestrel/dictionary/ScoreValueLabel.h"
#include "kestrel/dictionary/ScoreValueLabelSet.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/predicates/Range.h"

namespace MCKestrel_800 {

inline NumericValue* NewNumber(double number) {
  return new NumericValue(number);
}
inline StringValue* NewText(const std::string& text) {
  return new StringValue(text);
}
inline DateTimeValue* NewDate(double seconds) {
  return new DateTimeValue(seconds, kDateTimeVal);
}
inline Range* NewSingle(double number) {
  return new Range(new NumericValue(number));
}
inline Range* NewSingle(const std::string& text) {
  return new Range(new StringValue(text));
}

template <class T>
std::string DisplayOf(const T& object) {
  std::ostringstream os;
  object.Display(os);
  return os.str();
}

/// A grouping that would show if a number were written through the stream's locale.
struct GroupingPunctuation : std::numpunct<char> {
  char do_thousands_sep() const override { return '\''; }
  char do_decimal_point() const override { return ','; }
  std::string do_grouping() const override { return "\1"; }
};

template <class T>
std::string DisplayInForeignLocale(const T& object) {
  std::ostringstream os;
  os.imbue(std::locale(std::locale::classic(), new GroupingPunctuation));
  object.Display(os);
  return os.str();
}

/// A value of a class that the library does not know, with an equality of its own: numbers are equal when
/// their whole parts are.
class WholeValue : public ScoreValue {
 public:
  explicit WholeValue(double number, ValueType type = kNumeric) : number_(number), type_(type) {}

  void SetValue(const ScoreValue* other) override { number_ = other->GetDouble(); }
  ScoreValue* GetValue() const override { return Clone(); }
  ScoreValue* Clone() const override { return new WholeValue(*this); }
  bool operator==(const ScoreValue& other) const override {
    return std::floor(number_) == std::floor(other.GetDouble());
  }
  bool Equal(const ScoreValue* other, bool, bool) const override { return *this == *other; }
  bool operator>(const ScoreValue& other) const override { return number_ > other.GetDouble(); }
  bool operator<(const ScoreValue& other) const override { return number_ < other.GetDouble(); }
  bool operator<=(const ScoreValue& other) const override { return number_ <= other.GetDouble(); }
  bool operator>=(const ScoreValue& other) const override { return number_ >= other.GetDouble(); }
  bool IsSystemMissingValue() const override { return number_ == NumericValue::gSysmisValue; }
  int GetInt() const override { return static_cast<int>(number_); }
  double GetDouble() const override { return number_; }
  std::string GetString() const override { return "whole " + std::to_string(static_cast<int>(number_)); }
  ValueType GetType() const override { return type_; }

 private:
  double number_;
  ValueType type_;
};

/// A label of a class that the library does not know.
class ForeignLabel : public ScoreValueLabel {
 public:
  ForeignLabel(ScoreValue* value, std::string label) : value_(value), label_(std::move(label)) {}

  bool SetValueLabel(ScoreValue* value, const std::string& label) override {
    value_.reset(value);
    label_ = label;
    return true;
  }
  bool SetLabel(const std::string& label) override {
    label_ = label;
    return true;
  }
  ForeignLabel* Clone() const override {
    return new ForeignLabel(value_ ? value_->Clone() : nullptr, label_);
  }
  bool operator==(const ScoreValueLabel& other) const override {
    return value_ && other.GetValue() != nullptr && *value_ == *other.GetValue();
  }
  bool operator>(const ScoreValueLabel&) const override { return false; }
  bool operator<(const ScoreValueLabel&) const override { return false; }
  bool operator<=(const ScoreValueLabel&) const override { return false; }
  bool operator>=(const ScoreValueLabel&) const override { return false; }
  std::string GetLabel() const override { return label_; }
  const ScoreValue* GetValue() const override { return value_.get(); }
  void Display(std::ostream& os) const override { os << "foreign\n"; }

 private:
  std::unique_ptr<ScoreValue> value_;
  std::string label_;
};

/// A label set of a class that the library does not know; it may be told to refuse whatever is added.
class ForeignLabelSet : public ScoreValueLabelSet {
 public:
  ForeignLabelSet() = default;
  ForeignLabelSet(const ForeignLabelSet&) = delete;
  ForeignLabelSet& operator=(const ForeignLabelSet&) = delete;
  ~ForeignLabelSet() override {
    for (ScoreValueLabel* label : labels_)
      delete label;
  }
  ForeignLabelSet* Clone() const override {
    auto copy = std::make_unique<ForeignLabelSet>();
    for (const ScoreValueLabel* label : labels_)
      copy->labels_.push_back(label == nullptr ? nullptr : label->Clone());
    return copy.release();
  }
  bool Add(ScoreValueLabel* label) override {
    if (refuses) return false;
    labels_.push_back(label);
    return true;
  }
  bool Remove(const ScoreValueLabel*) override { return false; }
  std::size_t Size() const override { return labels_.size(); }
  const std::vector<ScoreValueLabel*>& GetAllValueLabels() const override { return labels_; }
  std::string GetLabelOfValue(const ScoreValue*) const override { return "foreign"; }
  bool Contains(const ScoreValue* value) const override {
    for (const ScoreValueLabel* label : labels_) {
      if (label != nullptr && label->GetValue() != nullptr && *label->GetValue() == *value) return true;
    }
    return false;
  }
  void Display(std::ostream& os) const override { os << "foreign set\n"; }

  bool refuses = false;

 private:
  std::vector<ScoreValueLabel*> labels_;
};

/// A missing-value set of a class that the library does not know.
class ForeignMissingSet : public ScoreMissingValueSet {
 public:
  ForeignMissingSet* Clone() const override {
    auto copy = std::make_unique<ForeignMissingSet>();
    for (const auto& range : ranges_)
      copy->Add(range->Clone());
    return copy.release();
  }
  bool Add(ScoreValueRange* range) override {
    ranges_.emplace_back(range);
    return true;
  }
  bool Remove(const ScoreValueRange*) override { return false; }
  std::size_t Size() const override { return ranges_.size(); }
  bool Contains(const ScoreValueRange*) const override { return false; }
  std::vector<const ScoreValueRange*> GetMissingValues() const override {
    std::vector<const ScoreValueRange*> ranges;
    for (const auto& range : ranges_)
      ranges.push_back(range.get());
    return ranges;
  }
  void Display(std::ostream& os) const override { os << "foreign missing\n"; }

 private:
  std::vector<std::unique_ptr<ScoreValueRange>> ranges_;
};

/// A range of a class that the library does not know: the numbers whose whole part is given.
class WholeRange : public ScoreValueRange {
 public:
  explicit WholeRange(double whole) : value_(whole) {}

  bool operator==(const ScoreValueRange& other) const override {
    return other.GetMin() != nullptr && std::floor(other.GetMin()->GetDouble()) == value_.GetDouble();
  }
  WholeRange* Clone() const override { return new WholeRange(*this); }
  void SetMin(ScoreValue*) override {}
  void SetMax(ScoreValue*) override {}
  bool IsInRange(double number) const override { return std::floor(number) == value_.GetDouble(); }
  bool IsInRange(const ScoreValue* value) const override {
    return value != nullptr && IsInRange(value->GetDouble());
  }
  const ScoreValue* GetMin() const override { return &value_; }
  const ScoreValue* GetMax() const override { return &value_; }
  bool GetHighEnd() const override { return true; }
  bool GetLowEnd() const override { return true; }
  void Display(std::ostream& os) const override { os << "whole range\n"; }

 private:
  NumericValue value_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TESTS_DICTIONARY_TESTVALUES_H
