// A text as a value, compared without regard to trailing blanks.

#ifndef KESTREL_FOUNDATION_STRINGVALUE_H
#define KESTREL_FOUNDATION_STRINGVALUE_H

#include <cstdint>
#include <string>
#include <string_view>

#include "kestrel/foundation/ScoreValue.h"
#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// The part of a text that counts when texts are compared: all but its trailing blanks.
inline std::string_view WithoutTrailingBlanks(std::string_view text) {
  while (!text.empty() && text.back() == ' ')
    text.remove_suffix(1);
  return text;
}

/// A text. Comparison ignores trailing blanks (the space character alone) on both sides; leading blanks
/// count. Order is that of unsigned bytes.
class KESTREL_API StringValue : public ScoreValue {
 public:
  static constexpr int MAX_STRING = 255;

  StringValue();
  explicit StringValue(const std::string& text);
  /// A null pointer is the empty text.
  explicit StringValue(const char* text);
  StringValue(const StringValue& other);
  StringValue& operator=(const StringValue& other);
  StringValue(StringValue&& other) noexcept;
  StringValue& operator=(StringValue&& other) noexcept;
  ~StringValue() override;

  /// Copies the other's text; anything but a text makes this one empty. The length is not changed.
  void SetValue(const ScoreValue* other) override;
  ScoreValue* GetValue() const override;
  ScoreValue* Clone() const override;

  /// Comparison with anything but a text is false.
  bool operator==(const ScoreValue& other) const override;
  /// With `exact` only identical texts are equal, otherwise trailing blanks do not count.
  bool Equal(const ScoreValue* other, bool exact, bool emptyStringOK) const override;
  bool operator>(const ScoreValue& other) const override;
  bool operator<(const ScoreValue& other) const override;
  bool operator<=(const ScoreValue& other) const override;
  bool operator>=(const ScoreValue& other) const override;

  /// Always false: a text is never system-missing.
  bool IsSystemMissingValue() const override { return false; }
  /// The integer that the text starts with, 0 when there is none; what int cannot hold is clamped.
  int GetInt() const override;
  /// The number that the text starts with, as a stream with the classic locale leaves it: with a decimal
  /// point whatever the locale, 0.0 when there is none, the largest finite number when it is too large.
  double GetDouble() const override;
  std::string GetString() const override { return text_; }
  ValueType GetType() const override { return kString; }

  /// Replaces the text; keeps its memory and the length.
  void SetString(const std::string& text) { text_ = text; }
  /// The text without a copy, valid until it is changed.
  const std::string& GetText() const { return text_; }

  /// A length beside the text: a variable may declare a width that differs from the text held.
  void SetLength(int32_t length) { length_ = length; }
  int32_t GetLength() const { return length_; }

 private:
  std::string text_;
  int32_t length_ = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_FOUNDATION_STRINGVALUE_H
