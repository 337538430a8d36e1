// What a derived field computes, as people write it.

#ifndef KESTREL_APPS_KESTREL_EXPRESSIONTEXT_H
#define KESTREL_APPS_KESTREL_EXPRESSIONTEXT_H

#include <cstddef>
#include <limits>
#include <string>

namespace MCKestrel_800 {
class FunctionTree;
class ScoreValue;
class ScoreValueRange;
class TransformVar;
}  // namespace MCKestrel_800

namespace kestrel_program {

/// Writes expressions on one line each:
///
///   weight / (height * height)
///   if(isMissing(age), -1, age{missing -> 40} + 1)
///   discretize(age): (-inf, 18) -> "young", [18, 65) -> "adult", else "senior", missing -> "unknown"
///   mapValues(answer): "yes" -> 1, "no" -> 0, else missing
///
/// Arithmetic and comparisons of two arguments stand between them, in no more parentheses than are needed to
/// read them back; every other function stands before its arguments. Names of fields are as they are, texts
/// in quotation marks. "{missing -> 40}" is what takes the place of a missing value of what stands before it.
class ExpressionText {
 public:
  /// Writes everything, however long.
  ExpressionText() = default;
  /// Writes so many rows of a table, values of a list and arguments of a function, counts the rest and cuts
  /// what is longer than a few lines; names and texts are fit for a terminal.
  static ExpressionText Short(std::size_t most);

  std::string Of(const MCKestrel_800::TransformVar& field) const;

 private:
  std::string WithoutLimit(const MCKestrel_800::TransformVar& field) const;
  std::string Constant(const MCKestrel_800::TransformVar& field) const;
  std::string Table(const MCKestrel_800::TransformVar& field, const char* name) const;
  std::string Rows(const MCKestrel_800::TransformVar& field) const;
  std::string Replacements(const MCKestrel_800::TransformVar& field) const;
  void AppendTree(const MCKestrel_800::FunctionTree& node, int level, std::string& out) const;
  void AppendLeaf(const MCKestrel_800::FunctionTree& node, std::string& out) const;
  void AppendCall(const MCKestrel_800::FunctionTree& node, std::string& out) const;
  std::string Value(const MCKestrel_800::ScoreValue* value) const;
  std::string Quoted(const std::string& text) const;
  std::string Name(const std::string& name) const;
  /// Appends an entry of a list with what parts it from the one before; at the limit, how many are left.
  /// Returns whether the list goes on.
  bool BeginEntry(std::size_t index, std::size_t count, const char* what, std::string& out) const;

  std::size_t most_ = std::numeric_limits<std::size_t>::max();
  bool is_short_ = false;
};

/// A single value, or an interval with brackets at the ends that belong to it: "[18, 65)", "(-inf, 18)".
std::string RangeText(const MCKestrel_800::ScoreValueRange& range);

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_EXPRESSIONTEXT_H
