// The interface of a split: the decision table behind a predicate.

#ifndef KESTREL_PREDICATES_SCORESPLITVAR_H
#define KESTREL_PREDICATES_SCORESPLITVAR_H

#include <iosfwd>
#include <string>

#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

class ScoreDictVar;
class ScoreValue;

/// Routes the values of one variable to child indexes; -1 stands for no child. The variable is not owned: it
/// belongs to a dictionary that must outlive the split. A split is filled on one thread; afterwards its const
/// operations allocate nothing and may be called from several threads.
class KESTREL_API ScoreSplitVar {
 public:
  enum SplitVarType : int { kScale = 0, kDiscrete = 1 };

  /// No variable yet.
  ScoreSplitVar() = default;
  explicit ScoreSplitVar(const ScoreDictVar* variable) : variable_(variable) {}
  ScoreSplitVar(const ScoreSplitVar&) = default;
  ScoreSplitVar& operator=(const ScoreSplitVar&) = default;
  virtual ~ScoreSplitVar();

  /// A new deep copy that the caller owns; it has the same variable.
  virtual ScoreSplitVar* Clone() const = 0;
  virtual void SetSplitVar(const ScoreDictVar* variable);
  /// The child that missing values go to; -1, the default, for none.
  virtual void SetMissvalMap(int child);
  virtual const ScoreDictVar* GetSplitVar() const { return variable_; }
  /// The variable's name, label, type and level; without a variable the texts are empty and the numbers -1.
  virtual std::string GetSplitName() const;
  virtual std::string GetSplitLabel() const;
  /// The variable's `VariableType`.
  virtual int GetSplitType() const;
  virtual SplitVarType GetSplitVarType() const = 0;
  /// The variable's `MeasureLevel`.
  virtual int GetSplitMLevel() const;
  virtual int GetMissvalMap() const;
  /// The child of a number or category code, or -1.
  virtual int GetSplitChildIndex(double x) const = 0;
  /// The child of a value, or -1; a null value is missing.
  virtual int GetSplitChildIndex(const ScoreValue* value) const = 0;
  virtual void Display(std::ostream& out) const = 0;

 private:
  const ScoreDictVar* variable_ = nullptr;
  int missval_map_ = -1;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PREDICATES_SCORESPLITVAR_H
