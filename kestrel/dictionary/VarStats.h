// The one implementation of ScoreVarStats.

#ifndef KESTREL_DICTIONARY_VARSTATS_H
#define KESTREL_DICTIONARY_VARSTATS_H

#include <memory>

#include "kestrel/dictionary/ScoreVarStats.h"

namespace MCKestrel_800 {

/// Summary statistics held as four numbers and an owned replacement value.
class KESTREL_API VarStats : public ScoreVarStats {
 public:
  /// The widest limits (the system-missing value and the largest finite number), mean 0, standard deviation
  /// 1, no replacement.
  VarStats();
  VarStats(double min, double max, double mean, double stddev);
  VarStats(const VarStats& other);
  VarStats& operator=(const VarStats& other);
  ~VarStats() override;

  VarStats* Clone() const override;
  void SetMin(double min) override;
  void SetMax(double max) override;
  void SetStddev(double stddev) override;
  void SetMean(double mean) override;
  void SetMissingReplacement(const ScoreValue* value) override;
  double GetMin() const override;
  double GetMax() const override;
  double GetStddev() const override;
  double GetMean() const override;
  const ScoreValue* GetMissingReplacement() const override;

 private:
  double min_;
  double max_;
  double mean_;
  double stddev_;
  std::unique_ptr<ScoreValue> missingReplacement_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_VARSTATS_H
