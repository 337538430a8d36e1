// Which parts of the model led to each answer, as a column of the output.

#ifndef KESTREL_APPS_KESTREL_EXPLANATIONCOLUMN_H
#define KESTREL_APPS_KESTREL_EXPLANATIONCOLUMN_H

#include <string_view>
#include <vector>

namespace MCKestrel_800 {
class ResultEntities;
class ScoreResult;
}  // namespace MCKestrel_800

namespace kestrel_program {

class TableWriter;

/// "explanation": the identifiers of the nodes that the case passed in a tree, or of the rules that fired, as
/// a list. Missing for a case that none led to, and for every case of a model that has no such parts.
class ExplanationColumn {
 public:
  static constexpr const char* kName = "explanation";

  /// Has the path recorded in the result, which must outlive this object.
  explicit ExplanationColumn(MCKestrel_800::ScoreResult* result);

  /// Forgets the case before: a model may give a case up before it empties the result, and a row that cannot
  /// be read does not reach the model at all.
  void BeginCase();
  /// Whether the model told anything since BeginCase.
  bool HasPath() const;
  void Write(TableWriter& writer);

 private:
  MCKestrel_800::ResultEntities* entities_;  ///< null when the model's results have none
  std::vector<std::string_view> path_;       ///< of the case being written
};

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_EXPLANATIONCOLUMN_H
