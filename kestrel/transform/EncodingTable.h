// The rows of a NormDiscrete or MapValues field, laid out so that the first match is found without a walk.

#ifndef KESTREL_TRANSFORM_ENCODINGTABLE_H
#define KESTREL_TRANSFORM_ENCODINGTABLE_H

#include <cstddef>
#include <vector>

#include "kestrel/dictionary/ValueIndex.h"
#include "kestrel/transform/TransformVar.h"

namespace MCKestrel_800 {

class SourceField;

/// Answers as asking the rows' matchers in their order does. Rows that list a value are filed by it; a
/// matcher of another class is asked each time. The rows must outlive the table and not change.
class EncodingTable {
 public:
  static constexpr std::size_t kNone = ValueIndex::kNone;

  explicit EncodingTable(const std::vector<TransformVar::Encoding>& rows);

  /// The first row that matches the value at hand, which must be there; kNone when there is none.
  std::size_t Find(const SourceField& source) const;

  /// Whether the rows alone decide about texts: none asks a matcher of another class.
  bool ListsTexts() const { return lists_texts_; }
  /// The texts of the rows that list one, and the first row that matches a text; kNone when there is none.
  std::vector<const StringValue*> GetTexts() const;
  std::size_t FindText(const StringValue& text) const;

 private:
  struct Row {
    ValueKey::Kind kind;
    double number;
    const StringValue* text;
    const ScoreValueMatcher* matcher;
  };

  template <class Matches>
  std::size_t FindWith(const SourceField& source, const Matches& matches) const;

  bool lists_texts_ = true;
  std::vector<Row> rows_;
  ValueIndex index_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSFORM_ENCODINGTABLE_H
