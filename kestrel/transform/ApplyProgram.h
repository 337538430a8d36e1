// A function tree laid out as a list of instructions.

#ifndef KESTREL_TRANSFORM_APPLYPROGRAM_H
#define KESTREL_TRANSFORM_APPLYPROGRAM_H

#include <cstdint>
#include <deque>
#include <forward_list>
#include <functional>
#include <string>
#include <vector>

#include "kestrel/foundation/StringValue.h"
#include "kestrel/transform/BuiltinFunctions.h"
#include "kestrel/transform/TransformFunction.h"

namespace MCKestrel_800 {

class FunctionTree;
class SourceField;
struct ApplyDetail;

/// One step of a program. What it reads and writes are places that stay where they are from case to case:
/// views of the fields, constants, and results of steps before it.
struct ApplyInstruction {
  /// Does the step and gives the one to do next.
  using Run = const ApplyInstruction* (*)(const ApplyInstruction& step);

  Run run = nullptr;
  const double* x = nullptr;
  const double* y = nullptr;
  double* out = nullptr;
  ApplyDetail* detail = nullptr;  ///< what steps on texts, lists and fields need beside that
  TransformFunction function = kNoFunction;
  std::uint32_t skip = 0;  ///< for jumps: how many behind it are left out
};

/// A text that a step reads: a place that holds the address of the text.
using ApplyText = const StringValue* const*;

/// Computes the value of a tree for the case that its source fields hold.
///
/// Every node is, by what it is and not by the case, a number, a text or a date/time (held as the number of
/// its seconds); the imputation is what its field is, and `if` what its chosen argument is. Where another
/// kind is needed than a node is, it counts as missing, but that a date/time is a number where one is needed.
///
/// Nothing is allocated from the second case on, but for texts that are longer than all before.
class ApplyProgram {
 public:
  using FindSource = std::function<const SourceField&(const std::string& name)>;

  /// Deeper trees have no value.
  static constexpr int kMaxDepth = 512;

  /// wanted  what is needed of the tree: a number, a text or a date/time.
  /// find  gives the field of a name that the tree refers to, which must outlive the program. The tree is not
  ///       needed afterwards, but for the variables of its fields.
  /// numbers  where the program's constants and results are put, behind those of others: what is computed
  ///       together lies together. Must outlive the program.
  ApplyProgram(const FunctionTree& root, FunctionValueKind wanted, const FindSource& find,
               std::deque<double>& numbers);
  ApplyProgram(const ApplyProgram&) = delete;
  ApplyProgram& operator=(const ApplyProgram&) = delete;
  ~ApplyProgram();

  /// Whether a node is a reference to a field.
  static bool IsReference(const FunctionTree& node);
  /// All references of a tree, from left to right. Depth costs no stack.
  static std::vector<const FunctionTree*> FindReferences(const FunctionTree& root);

  void Run() {
    const ApplyInstruction* const end = code_.data() + code_.size();
    for (const ApplyInstruction* step = code_.data(); step != end;)
      step = step->run(*step);
  }
  /// Or the seconds of a date/time. The system-missing value, or what is no finite number, when the tree has
  /// none.
  double GetNumber() const { return *number_; }
  const StringValue& GetText() const { return **text_; }

 private:
  friend class ApplyCompiler;

  std::vector<ApplyInstruction> code_;
  const double* number_;
  ApplyText text_;
  // All such that addresses stay. Lists, because most programs hold little.
  std::deque<double>& numbers_;
  std::forward_list<StringValue> texts_;
  std::forward_list<const StringValue*> text_places_;
  std::forward_list<ApplyDetail> details_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSFORM_APPLYPROGRAM_H
