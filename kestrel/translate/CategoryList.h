// The categories of a variable by their positions, and how they are entered into a split.

#ifndef KESTREL_TRANSLATE_CATEGORYLIST_H
#define KESTREL_TRANSLATE_CATEGORYLIST_H

#include <memory>
#include <vector>

#include "kestrel/foundation/ScoreValue.h"

namespace MCKestrel_800 {

class DiscreteSplit;
class ScoreDictVar;
class ScoreEncoder;
class ScoreValueLabelSet;

/// The different categories of a variable in the order in which it lists them. Texts are the same as the
/// variable's flags say, numbers when they are exactly equal: a category and a case's value meet as codes,
/// and encoders know no tolerance.
///
/// Of a variable whose encoder was made from its list, the positions are the codes, and nothing here takes
/// time that grows with the list: a document may refer to a long list as often as it likes. Other variables,
/// which come from programs and not from documents, have their list looked through once for each object of
/// this class. The variable must not change meanwhile.
class CategoryList {
 public:
  /// Neighbouring positions.
  struct Span {
    int first;
    int last;
  };

  /// inOrder  whether more is asked of the positions than to be different: then they are the list's order
  ///          also where an encoder was filled in another one.
  explicit CategoryList(const ScoreDictVar& variable, bool inOrder = false);
  ~CategoryList();
  CategoryList(const CategoryList&) = delete;
  CategoryList& operator=(const CategoryList&) = delete;

  /// Whether there are no categories, which is so of every continuous variable.
  bool IsEmpty() const { return Size() == 0; }
  int Size() const { return size_; }
  /// Whether the positions are the codes of the variable's own encoder.
  bool AreCodes() const { return positions_ != nullptr && made_ == nullptr; }
  /// The value's position, or -1.
  int Find(const ScoreValue& value) const;

  /// Sends categories to a child of the split: as codes where the variable has an encoder, else as values
  /// and, for flat vectors, as their positions in the list. The spans ascend; one may be empty, with its
  /// last before its first.
  void Enter(const std::vector<Span>& spans, DiscreteSplit& split, int child) const;

 private:
  void LookThrough();
  const ScoreValue* ValueAt(int position) const;

  const ScoreDictVar& variable_;
  const ScoreValueLabelSet* const labels_;
  /// Gives positions as codes: the variable's own encoder, or one that was made here.
  const ScoreEncoder* positions_ = nullptr;
  std::unique_ptr<ScoreEncoder> made_;
  /// Of a list that was looked through: where in it the categories stand.
  std::vector<int> places_;
  int size_ = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSLATE_CATEGORYLIST_H
