// Codes for the bins of a continuous variable.

#ifndef KESTREL_DICTIONARY_SCOREBINNINGENCODER_H
#define KESTREL_DICTIONARY_SCOREBINNINGENCODER_H

#include <string>
#include <vector>

#include "kestrel/dictionary/ScoreEncoder.h"

namespace MCKestrel_800 {

/// Maps a number to the index of its bin. With the ascending cut points c[0..k-1] the bins are (-inf, c[0]],
/// (c[0], c[1]], ..., (c[k-1], +inf), numbered 0 to k. It registers nothing: `Encode` and `EncodeConst`
/// agree.
///
/// In the forms that take a value or a text, what is no number, NaN and the system-missing value give -1.
class KESTREL_API ScoreBinningEncoder : public ScoreEncoder {
 public:
  /// The cut points ascend; without any there is one bin.
  explicit ScoreBinningEncoder(const std::vector<double>& cutpoints = {});
  ScoreBinningEncoder(const ScoreBinningEncoder& other);
  ScoreBinningEncoder& operator=(const ScoreBinningEncoder& other);
  ~ScoreBinningEncoder() override;

  EncoderType GetEncoderType() const override;
  /// The number of bins.
  int GetNumberOfCategories() const override;
  int Encode(const ScoreValue* value) override;
  int Encode(const std::string& text) override;
  /// The index of the number's bin. Every number has one: the system-missing value lies below all cut points,
  /// and NaN, which is below nothing, goes to the last bin.
  double Encode(double number) const;
  int EncodeConst(const std::string& text) const override;
  int EncodeConst(const ScoreValue* value) const override;
  /// Always empty.
  std::string Decode(int code) const override;
  /// Always the system-missing value.
  double DecodeNum(int code) const override;
  ScoreBinningEncoder* Clone() const override;
  void SetValueLabels(const std::vector<std::string>& labels) override;
  void SetValueLabel(int code, const std::string& label) override;
  const std::vector<std::string>* GetValueLabels() const override;
  void Display(std::ostream& os) const override;

  const std::vector<double>& GetBinningCutpoints() const;
  /// Replaces the cut points, which ascend, and with them the number of bins.
  void SetBinningCutpoints(const std::vector<double>& cutpoints);

 private:
  int numberOfBins_;
  std::vector<double> cutpoints_;
  std::vector<std::string> labels_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_SCOREBINNINGENCODER_H
