// Codes for the categories of a numeric variable.

#ifndef KESTREL_DICTIONARY_SCORECATNUMERICENCODER_H
#define KESTREL_DICTIONARY_SCORECATNUMERICENCODER_H

#include <map>
#include <string>
#include <vector>

#include "kestrel/dictionary/ScoreEncoder.h"

namespace MCKestrel_800 {

/// Hands out codes 0, 1, 2, ... to numbers in the order of their first appearance: `Encode` while a document
/// is read, `EncodeConst` while cases are scored.
///
/// Numbers are the same when they compare equal exactly; 0 and -0 are one. A number that is not a number
/// (NaN) is no category: it gives -1 and is not registered. A text that does not read as a number stands for
/// the system-missing value, which is encoded like any other.
class KESTREL_API ScoreCatNumericEncoder : public ScoreEncoder {
 public:
  /// Reserves room for `n` categories, within reason.
  explicit ScoreCatNumericEncoder(int n = 0);
  /// Registers the numbers in their order.
  explicit ScoreCatNumericEncoder(const std::vector<double>& numbers);
  ScoreCatNumericEncoder(const ScoreCatNumericEncoder& other);
  ScoreCatNumericEncoder& operator=(const ScoreCatNumericEncoder& other);
  ~ScoreCatNumericEncoder() override;

  EncoderType GetEncoderType() const override;
  int GetNumberOfCategories() const override;
  int Encode(const ScoreValue* value) override;
  int Encode(const std::string& text) override;
  int Encode(double number);
  int EncodeConst(const std::string& text) const override;
  int EncodeConst(const ScoreValue* value) const override;
  int EncodeConst(double number) const;
  /// Always empty.
  std::string Decode(int code) const override;
  double DecodeNum(int code) const override;
  ScoreCatNumericEncoder* Clone() const override;
  void SetValueLabels(const std::vector<std::string>& labels) override;
  void SetValueLabel(int code, const std::string& label) override;
  const std::vector<std::string>* GetValueLabels() const override;
  void Display(std::ostream& os) const override;

 private:
  std::map<double, int> codes_;
  std::vector<double> numbers_;  // by code
  std::vector<std::string> labels_;
  int lastCode_ = -1;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_SCORECATNUMERICENCODER_H
