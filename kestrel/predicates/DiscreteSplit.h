// A split that maps single values and category codes.

#ifndef KESTREL_PREDICATES_DISCRETESPLIT_H
#define KESTREL_PREDICATES_DISCRETESPLIT_H

#include <iosfwd>
#include <memory>
#include <utility>
#include <vector>

#include "kestrel/platform/Export.h"
#include "kestrel/predicates/CodeMap.h"
#include "kestrel/predicates/ScoreSplitVar.h"

namespace MCKestrel_800 {

/// Two tables side by side: values, for variables without an encoder, and codes, for those with one and for
/// flat vectors. Copies are deep.
class KESTREL_API DiscreteSplit : public ScoreSplitVar {
 public:
  DiscreteSplit();
  explicit DiscreteSplit(const ScoreDictVar* variable);
  DiscreteSplit(const DiscreteSplit& other);
  DiscreteSplit& operator=(const DiscreteSplit& other);
  ~DiscreteSplit() override;

  DiscreteSplit* Clone() const override;
  SplitVarType GetSplitVarType() const override;
  /// A negative number of a nominal variable goes where missing values go; any other is looked up among the
  /// codes.
  int GetSplitChildIndex(double x) const override;
  /// Null goes where missing values go; any other value to the first equal one of the list: texts by `Equal`
  /// with the variable's flags, other values by `operator==`. A missing value that is not null is compared
  /// like any other.
  int GetSplitChildIndex(const ScoreValue* value) const override;
  /// Shows the values; the codes are not shown.
  void Display(std::ostream& out) const override;

  /// Appends a value, which the split owns from then on. Null is refused: nothing happens.
  void PutSplit(ScoreValue* value, int child);
  /// Adds a code; one that is there already keeps its child.
  void PutSplit(double code, int child);
  /// Adds the codes from `first` to `last`; those that are there already keep their child.
  void PutCodes(int first, int last, int child);

  /// The values in the order in which they were put, those of one child, and the first alone. They belong to
  /// the split.
  std::vector<ScoreValue*> GetSplitValues() const;
  std::vector<ScoreValue*> GetSplitValuesForIndex(int child) const;
  std::vector<ScoreValue*> GetSplitValuesFirst() const;

  /// The positions of this split's first and last value in the variable's category list, for display and for
  /// model plug-ins; -1 when there is no such interval.
  void GetStartAndEndIndex(int& start, int& end) const;
  void SetStartAndEndIndex(int start, int end);

  const CodeMap& GetCodes() const { return codes_; }

 private:
  std::vector<std::pair<std::unique_ptr<ScoreValue>, int>> values_;
  int start_index_ = -1;
  int end_index_ = -1;
  CodeMap codes_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PREDICATES_DISCRETESPLIT_H
