// Lays a function tree out as instructions.

#ifndef KESTREL_TRANSFORM_APPLYCOMPILER_H
#define KESTREL_TRANSFORM_APPLYCOMPILER_H

#include <string>
#include <vector>

#include "kestrel/transform/ApplyProgram.h"
#include "kestrel/transform/ApplySteps.h"
#include "kestrel/transform/BuiltinFunctions.h"
#include "kestrel/transform/FunctionTree.h"

namespace MCKestrel_800 {

class ScoreValue;

/// Fills one program. Each operation gives the place where a node's value will stand, as the kind that is
/// asked for; where the node is of another kind, that of a missing value.
class ApplyCompiler {
 public:
  ApplyCompiler(ApplyProgram& program, const ApplyProgram::FindSource& find)
      : program_(program), find_(find) {}

  /// The number of the whole tree, which may be missing as an operand is.
  const double* Result(const FunctionTree& root);
  /// Numbers, and the seconds of dates and times.
  const double* Number(const FunctionTree* node);
  /// The seconds of dates and times alone.
  const double* Seconds(const FunctionTree* node);
  ApplyText Text(const FunctionTree* node);
  bool IsTooDeep() const { return is_too_deep_; }

 private:
  using Kind = FunctionValueKind;
  using Node = const FunctionTree&;
  class Level;

  /// A value of a kind that the case decides.
  struct Value {
    const double* kind;    ///< a Kind as a number: of numbers, texts or dates and times
    const double* number;  ///< or the seconds; missing for a text
    ApplyText text;        ///< empty for what is none
  };

  /// The number of a node as an operand.
  const double* Operand(const FunctionTree* node);
  const double* Arithmetic(Node node);
  Kind KindOf(const FunctionTree* node) const;

  const double* NumberOfReference(Node node);
  const double* NumberOfFunction(Node node, const BuiltinFunction& function);
  const double* NumberOfSpecial(Node node, TransformFunction function);
  const double* NumberOfScalar(Node node);
  const double* NumberOfList(Node node);
  const double* NumberOfComparison(Node node);
  const double* NumberOfValueList(Node node);
  const double* NumberOfMissingTest(Node node);
  const double* NumberOfOutlier(Node node);
  // Of "if".
  template <class Take>
  void TakeBranch(Node node, const Take& take);
  const double* Choose(Node node, const double* (ApplyCompiler::*lay_out)(const FunctionTree*));
  bool IsOfOpenKind(const FunctionTree* node) const;
  Value ValueOf(const FunctionTree* node);
  Value ValueOfKind(Kind kind, const FunctionTree* node);
  void Copy(const double* from, double* to);
  void Copy(ApplyText from, const StringValue** to);
  const double* CompareValues(Node node);
  const double* FindValue(Node node, ApplyDetail& detail);

  const double* NumberOfImputation(Node node);
  const double* MethodOfOutliers(const FunctionTree* node);
  const double* Replaced(Node node, const double* result);
  const double* ReplacementOf(Node node);

  ApplyText TextOfReference(Node node);
  ApplyText TextOfFunction(Node node, const BuiltinFunction& function);
  ApplyText TextOfIf(Node node);
  ApplyText TextOfImputation(Node node);
  bool ReadImputation(Node node, ApplyDetail& detail);

  double* NewPlace();
  const StringValue** NewTextPlace();
  const double* NewConstant(double number);
  const double* MissingNumber();
  ApplyText NewConstant(const StringValue& text);
  ApplyText EmptyText();
  ApplyDetail& NewDetail();
  ApplyInstruction& Emit(ApplyInstruction::Run run, TransformFunction function = kNoFunction);
  const double* EmitNumber(ApplyInstruction::Run run, TransformFunction function, const double* x,
                           const double* y = nullptr, ApplyDetail* detail = nullptr);

  ApplyProgram& program_;
  const ApplyProgram::FindSource& find_;
  int depth_ = 0;
  bool is_too_deep_ = false;
};

/// Counts how deep the compiler is in the tree.
class ApplyCompiler::Level {
 public:
  explicit Level(ApplyCompiler& compiler) : compiler_(compiler) {
    if (++compiler_.depth_ > ApplyProgram::kMaxDepth) compiler_.is_too_deep_ = true;
  }
  ~Level() { --compiler_.depth_; }
  Level(const Level&) = delete;
  Level& operator=(const Level&) = delete;

 private:
  ApplyCompiler& compiler_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSFORM_APPLYCOMPILER_H
