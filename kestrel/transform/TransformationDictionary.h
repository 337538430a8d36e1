// The derived fields of one document, and their values for a case.

#ifndef KESTREL_TRANSFORM_TRANSFORMATIONDICTIONARY_H
#define KESTREL_TRANSFORM_TRANSFORMATIONDICTIONARY_H

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "kestrel/dictionary/BaseDictionary.h"
#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/foundation/DateTimeType.h"
#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

class DerivationPlan;
class ScoreValue;
class ScoreValueLabel;
class StringValue;
class TransformVar;

/// A dictionary whose variables are the derived fields (`TransformVar`). It computes them for a case into a
/// record of its own:
///
///   dictionary.SetUpDerivedCaseRecord();
///   for each case: const CaseRecord* derived = dictionary.GetValuesForDerivedVars(&record, &data);
///
/// The list of derived names says which fields are computed; filling it and adding variables are separate
/// steps of the reader. A derived field may read data fields and other derived fields, in any order. The
/// result is that of computing each dependency when it is needed, but every field is computed once a case. A
/// field that depends on itself is missing, and so is nothing else.
///
/// After the first case nothing is allocated for numbers and dates, and for texts only when one is longer
/// than all before it. The fields' definitions are not to be changed between cases.
///
/// Threads: one dictionary serves one case at a time; several threads take copies, which share nothing.
class KESTREL_API TransformationDictionary : public BaseDictionary {
 public:
  TransformationDictionary();
  /// Copies variables, names, both records and whether they are set up.
  TransformationDictionary(const TransformationDictionary& other);
  TransformationDictionary& operator=(const TransformationDictionary& other);
  ~TransformationDictionary() override;

  /// A deep copy that the caller owns.
  TransformationDictionary* Clone() const override;

  /// Appends a name to the derived names. Neither an empty nor a repeated one is refused. (So spelt, as part
  /// of the interface.)
  void AddDerievedVarName(const std::string& name);
  /// A copy of the derived names, in the order in which they were added.
  std::vector<std::string> GetDerivedVarNames() const;

  /// Makes the record of derived values, with an empty value for each derived name that is a variable: a
  /// text, a date/time or a number, by its storage type. Tells each variable its position in it. Does nothing
  /// when that was done.
  void SetUpDerivedCaseRecord();

  /// Restricts what is computed to these fields and what they depend on; the others keep their missing value.
  /// Names that are no derived field are ignored. Without this call all fields are computed.
  void SetWantedVars(const std::vector<std::string>& names);

  /// Computes the derived values of a case. Null for the case leaves them as they were. Fields are read from
  /// the case; a derived field that the case holds under its name is taken from there by those that depend on
  /// it. `dictionary` has the variables of the case's fields, whose rules say which values are missing; null
  /// is allowed.
  /// Returns the record of derived values, which stays the dictionary's and valid until the next call; null
  /// when none was set up.
  const CaseRecord* GetValuesForDerivedVars(const ScoreCaseRecord* record, const ScoreDictionary* dictionary);

  /// The value under a name in the record of derived values, or null.
  const ScoreValue* GetVarValue(const std::string& name) const;
  /// Whether a variable was computed for the case at hand: by its position in the record of derived values.
  bool IsVarValueComputed(const ScoreDictVar* var) const;

  /// Stores a value in the record of derived values and marks the variable (null is allowed) as computed.
  /// Does nothing when no record was set up, or when it refuses the value: an unknown name, another kind.
  void AddVarCaseValue(const ScoreDictVar* var, const std::string& name, const ScoreValue* value);
  void AddVarCaseValue(const ScoreDictVar* var, const std::string& name, const std::string& text);
  void AddVarCaseValue(const ScoreDictVar* var, const std::string& name, double number);
  void AddVarCaseValue(const ScoreDictVar* var, const std::string& name, double seconds,
                       DateTimeValType kind);

  // ---- Functions of lists of numbers. S is the system-missing value. Nothing else than a number or S comes
  // out: what is too large for a number is S.

  /// a - b, a * b and a / b; S unless there are two arguments, for an S, and for a division by 0.
  static double Minus(const std::vector<double>& arguments);
  static double Multiply(const std::vector<double>& arguments);
  static double Divided(const std::vector<double>& arguments);
  /// Over the arguments that are not S; S when there are none.
  static double Sum(const std::vector<double>& arguments);
  static double Mean(const std::vector<double>& arguments);
  static double Min(const std::vector<double>& arguments);
  static double Max(const std::vector<double>& arguments);
  static double ProductOperator(const std::vector<double>& arguments);
  /// The middle one, or the mean of the two in the middle.
  static double MedianOperator(const std::vector<double>& arguments);
  /// The sample's standard deviation and its square (divisor n - 1); S below two arguments that are not S.
  static double Sd(const std::vector<double>& arguments);
  static double Variance(const std::vector<double>& arguments);
  /// Distribution function, its inverse and the density of a normal distribution, of (x, mean, standard
  /// deviation); S for another count, for an S, and where the distribution is none.
  static double CdfNormal(const std::vector<double>& arguments);
  static double IdfNormal(const std::vector<double>& arguments);
  static double PdfNormal(const std::vector<double>& arguments);
  /// 1 or 0; 0 unless there are two arguments. S takes part as the number that it is.
  static double lessThan(const std::vector<double>& arguments);
  static double lessOrEqual(const std::vector<double>& arguments);
  static double greaterThan(const std::vector<double>& arguments);
  static double greaterOrEqual(const std::vector<double>& arguments);
  /// 1 or 0: all (some) of the arguments are other than 0, S included. 0 without arguments.
  static double AndOperator(const std::vector<double>& arguments);
  static double OrOperator(const std::vector<double>& arguments);
  /// 1 for a single 0, else 0.
  static double NotOperator(const std::vector<double>& arguments);

  // ---- Functions of texts. A text's length is a number beside it, such as a declared width; `length` gets
  // that of the result.

  /// From position `start`, counted from 1 and cut to a whole number, to the end. Empty unless
  /// 1 <= start < the text's size.
  static std::string Substring(const StringValue& value, double start, int& length);
  /// The texts one after the other; the length is the sum of the widths.
  static std::string Concat(const std::vector<std::string>& texts, const std::vector<int>& widths,
                            int& length);
  /// Byte by byte, ASCII letters alone, whatever the locale.
  static std::string ToLowerCase(const StringValue& value, int& length);
  static std::string ToUpperCase(const StringValue& value, int& length);
  /// Without the blanks and tabs at the start (end); the length loses as many.
  static std::string Ltrim(const StringValue& value, int& length);
  static std::string Rtrim(const StringValue& value, int& length);

  // ---- Comparisons. They delete the values, and the argument, and leave the list empty.

  /// 1 when there are two values of the same type and the first equals the second, else 0. Values of
  /// different types stay in the list.
  static double equal(std::vector<ScoreValue*>& values);
  /// What `equal` is not.
  static double notEqual(std::vector<ScoreValue*>& values);
  /// 1 when the argument equals one of the values, else 0; 0 for a null argument.
  static double isIn(std::vector<ScoreValue*>& values, ScoreValue* argument);
  static double isNotIn(std::vector<ScoreValue*>& values, ScoreValue* argument);

  // ---- Others.

  /// x between c - w and c + w, w = a * b / sqrt(n); outside the nearer bound for method 2, S for the others.
  /// S stays S.
  static double OutlierHandle(double x, int method, double c, double a, double b, double n);
  /// The value of the category whose mean is nearest to t, measured in its standard deviation: the first
  /// i with the smallest |t - means[i]| / sqrt(variances[i]). It stays the label's. Throws std::out_of_range
  /// ("invalid vector<T> subscript") when there are no means or fewer categories; so does a list of variances
  /// that is shorter than that of the means.
  static const ScoreValue* ImputeCatFieldMissingAgainstConTargetHandle(
      double t, const std::vector<ScoreValueLabel*>& categories, const std::vector<double>& means,
      const std::vector<double>& variances);

 private:
  friend class TransformVar;

  void Reset();
  void MarkComputed(const ScoreDictVar* var);
  void ChooseOutputs();
  DerivationPlan& PlanFor(const ScoreDictionary* dictionary);

  std::unique_ptr<CaseRecord> derived_record_;
  std::unique_ptr<CaseRecord> initial_record_;
  /// By position in the record. Bytes, because all are set for each case.
  std::vector<unsigned char> computed_;
  std::vector<std::string> derived_names_;
  bool is_set_up_ = false;

  std::vector<std::string> wanted_names_;
  bool has_wanted_names_ = false;
  /// How all the fields are computed with the data dictionary at hand; null until it is needed.
  std::unique_ptr<DerivationPlan> plan_;
  std::vector<unsigned char> chosen_;  ///< by position in the record: what the plan computes
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSFORM_TRANSFORMATIONDICTIONARY_H
