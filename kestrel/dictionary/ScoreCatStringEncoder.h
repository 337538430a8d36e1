// Codes for the categories of a text variable.

#ifndef KESTREL_DICTIONARY_SCORECATSTRINGENCODER_H
#define KESTREL_DICTIONARY_SCORECATSTRINGENCODER_H

#include <functional>
#include <map>
#include <string>
#include <string_view>
#include <vector>

#include "kestrel/dictionary/ScoreEncoder.h"

namespace MCKestrel_800 {

/// Hands out codes 0, 1, 2, ... to texts in the order of their first appearance: `Encode` while a document is
/// read, `EncodeConst` while cases are scored.
///
/// Unless no-space-trim is set, the key of a text is the text without its trailing blanks; a text of nothing
/// but blanks has the key " " when empty-string-OK is set and the empty key otherwise. A text whose key is
/// registered gets that key's code. `EncodeConst` allocates nothing.
class KESTREL_API ScoreCatStringEncoder : public ScoreEncoder {
 public:
  /// Reserves room for `n` categories, within reason.
  explicit ScoreCatStringEncoder(int n = 0);
  /// Registers the texts in their order.
  explicit ScoreCatStringEncoder(const std::vector<std::string>& texts);
  ScoreCatStringEncoder(const ScoreCatStringEncoder& other);
  ScoreCatStringEncoder& operator=(const ScoreCatStringEncoder& other);
  ~ScoreCatStringEncoder() override;

  EncoderType GetEncoderType() const override;
  int GetNumberOfCategories() const override;
  int Encode(const ScoreValue* value) override;
  int Encode(const std::string& text) override;
  int EncodeConst(const std::string& text) const override;
  int EncodeConst(const ScoreValue* value) const override;
  std::string Decode(int code) const override;
  /// Always the system-missing value.
  double DecodeNum(int code) const override;
  ScoreCatStringEncoder* Clone() const override;
  void SetValueLabels(const std::vector<std::string>& labels) override;
  void SetValueLabel(int code, const std::string& label) override;
  const std::vector<std::string>* GetValueLabels() const override;
  void Display(std::ostream& os) const override;

  /// Off at first. Concerns the texts that are encoded from now on; registered keys stay as they are.
  void SetNoSpaceTrim(bool noSpaceTrim);
  bool GetNoSpaceTrim() const;
  /// On at first. Concerns the texts that are encoded from now on; registered keys stay as they are.
  void SetEmptyStringOK(bool emptyStringOK);
  bool GetEmptyStringOK() const;

 private:
  int Find(std::string_view key) const;
  std::string_view KeyOf(std::string_view text) const;

  std::map<std::string, int, std::less<>> codes_;
  std::vector<const std::string*> keys_;  // by code; they point at the keys of codes_
  std::vector<std::string> labels_;
  int lastCode_ = -1;
  bool noSpaceTrim_ = false;
  bool emptyStringOK_ = true;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_SCORECATSTRINGENCODER_H
