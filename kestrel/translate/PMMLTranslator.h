// Turns the elements of a PMML document into the library's objects. Model plug-ins derive their translators
// from this class and call its readers, so every reader is a public operation.

#ifndef KESTREL_TRANSLATE_PMMLTRANSLATOR_H
#define KESTREL_TRANSLATE_PMMLTRANSLATOR_H

#include <xercesc/util/XercesDefs.hpp>

#include <string>
#include <vector>

#include "kestrel/foundation/DateTimeType.h"
#include "kestrel/platform/Export.h"
#include "kestrel/transform/TransformFunction.h"
#include "kestrel/translate/BaseTranslator.h"

XERCES_CPP_NAMESPACE_BEGIN
class DOMElement;
class DOMNode;
XERCES_CPP_NAMESPACE_END

namespace MCKestrel_800 {

class DiscreteSplit;
class FunctionTree;
class ResultVar;
class ScoreDictionary;
class ScoreMissingValueSet;
class ScorePredicate;
class ScoreSplitVar;
class ScoreValueRange;
class TransformVar;
class TransformationDictionary;
struct LeafNodeStats;

/// The readers of PMML elements.
///
/// Errors: every reader throws KestrelException at the first fault, with line and column where they are
/// known, and deletes what it was building. Elements belong to the caller's document and are not kept.
/// Threads: a translator keeps no state between calls of the dictionary readers; one translator serves one
/// document at a time, several translators serve several threads.
class KESTREL_API PMMLTranslator : public BaseTranslator {
 public:
  PMMLTranslator();
  ~PMMLTranslator() override;

  // A plug-in overrides the form that takes the root element; the others stay visible beside it.
  using BaseTranslator::ParseFromTree;

  /// Reads a `DataDictionary` element; null is an error (code 1). `reserved` is without meaning: pass false.
  /// Returns a new dictionary, never null or empty, that the caller deletes. Its variables keep the
  /// document's order in `GetVarNames`. Categorical variables have their encoder, with codes in the order of
  /// their valid values.
  ScoreDictionary* ParseDictionary(xercesc::DOMNode* dataDictionary, bool reserved);

  /// Reads the children of a categorical or ordinal `DataField` into its variable, which has its name, type
  /// and flags but no values yet: value labels, missing values and display format.
  static void ParseCategoricalValues(xercesc::DOMElement* field, ScoreDictVar* variable);

  /// The same for a continuous `DataField`.
  static void ParseContinuousValues(xercesc::DOMElement* field, ScoreDictVar* variable);

  /// Reads one `Interval` of a continuous field: what lies outside it is added to `set` as missing ranges.
  /// The variable may be null: an interval means the same for all. `reserved` is without meaning: pass 0.
  static void handleInterval(ScoreDictVar* var, xercesc::DOMNode* interval, ScoreMissingValueSet* set,
                             int reserved);

  /// Reads an interval element (`leftMargin`, `rightMargin`, `closure`) as one range and adds it to `target`.
  /// Without `closure` both margins stand outside; an absent or empty margin is an infinity.
  static void handleTreeInterval(xercesc::DOMElement* element, ScoreMissingValueSet* target);

  /// Adds the range of a field's "invalidRangeLower" and "invalidRangeUpper" extensions to `set`.
  /// flags  1 for each lower bound plus 10 for each upper bound that the field gives.
  /// lower, upper  the bounds; an infinity where none is given. Both belong to the range.
  /// Returns false, adding nothing, when `flags` is 0; a bound given twice is an error (code 5).
  static bool HandleVEXAMissingInterval(ScoreMissingValueSet* set, int flags, double lower, double upper);

  /// The date/time type that a `dataType` text names; `kNoDateTime` for every other text and for null.
  static DateTimeType ParseDateTimeType(const XMLCh* dataType);

  /// Turns the variable's usage type off where an `Extension` has a "UsageType" child with value "disable".
  static void ParseUsageTypeExtension(xercesc::DOMElement* extension, ScoreDictVar* variable);

  /// Gives a nominal or ordinal variable its category encoder, unless it has one, and encodes its value
  /// labels in their order. Returns false, doing nothing, for null and for a continuous variable.
  static bool SetupCatEncoder(ScoreDictVar* variable);

  // ---- Derived fields. `variable` is the derived field that is being read, with its name, type and level.
  // A field that an expression refers to, whose name the readers of expressions return, is looked up in
  // `dictionary` and then in `derived`; either may be null. (The spelling of names is part of the interface.)

  /// Reads the `DerivedField` children of a `TransformationDictionary` or `LocalTransformations` element; a
  /// null element has none. An expression may refer to data fields and to derived fields that stand before.
  /// Returns `into` with the fields added, or for null a new dictionary, which the caller deletes. References
  /// in it point at variables of `dictionary`, which must outlive it. After a fault `into` holds the fields
  /// before the one at fault.
  static TransformationDictionary* HandleTransformationDictionary(xercesc::DOMElement* element,
                                                                  const ScoreDictionary* dictionary,
                                                                  TransformationDictionary* into);

  static std::string HandleNormContinuous(xercesc::DOMElement* element, TransformVar* variable,
                                          const ScoreDictionary* dictionary, const ScoreDictionary* derived);
  static std::string HandleNormDiscrete(xercesc::DOMElement* element, TransformVar* variable,
                                        const ScoreDictionary* dictionary, const ScoreDictionary* derived);
  static std::string HandleMapValues(xercesc::DOMElement* element, TransformVar* variable,
                                     const ScoreDictionary* dictionary, const ScoreDictionary* derived);
  static std::string HandleDiscritize(xercesc::DOMElement* element, TransformVar* variable,
                                      const ScoreDictionary* dictionary, const ScoreDictionary* derived);
  static std::string HandleFieldRef(xercesc::DOMElement* element, TransformVar* variable,
                                    const ScoreDictionary* dictionary, const ScoreDictionary* derived);

  /// The range of an `Interval`, which the caller deletes. Margins are numbers; of a date/time its seconds.
  static ScoreValueRange* HandleDiscretizeBinInterVal(const xercesc::DOMElement* interval);

  /// A `Constant`: as a value of its `dataType` that the caller deletes (missing for no number), or as text.
  static ScoreValue* HandelConstant(const xercesc::DOMElement* element);
  static void HandelConstant(const xercesc::DOMElement* element, std::string& text);

  /// An `Apply` with all that is in it, as a tree that the caller deletes. Depth costs no stack.
  static FunctionTree* HandleApply(const xercesc::DOMElement* element, const TransformVar* variable,
                                   const ScoreDictionary* dictionary, const ScoreDictionary* derived);

  /// Adds the `Value` children of an element to the variable's labels and missing values.
  static void HandleValueList(const xercesc::DOMElement* parent, ScoreDictVar* variable);
  /// Adds the values and the invalid range in an element to the variable's missing values.
  static void handleDerivedVarMissingValue(const xercesc::DOMElement* parent, ScoreDictVar* variable);
  /// Reads an `Extension` that says what becomes of missing and unmatched values; others are ignored.
  static void HandleVEXAExtensions(const xercesc::DOMElement* extension, TransformVar* variable);

  /// Prepares the look-up of function names, which the first look-up does otherwise.
  static void InitFunctionMap();
  /// The code of a name, which counts exactly as it stands; kNoFunction for every other text.
  static TransformFunction GetTransFunction(const std::string& name);
  /// Whether a function counts as one of numbers (of texts) when it stands inside another.
  static bool IsNumericFunction(TransformFunction function);
  static bool IsStringFunction(TransformFunction function);
  /// Code 6 when a function does not fit into another; when a field or constant is no number (no text).
  static void VerifyParentAndChildFunction(const xercesc::DOMElement* element, TransformFunction parent,
                                           TransformFunction child);
  static void VerifyOneElem(const xercesc::DOMElement* element, const FunctionTree& argument, bool isNumeric);
  /// Code 6 when the arguments of a node do not fit its function. The node's fields have their variables.
  static void VerifyApplyFunction(const xercesc::DOMElement* element, const FunctionTree& node);

  /// Reads the `Target` children of a `Targets` element into the variables that they name: a default value,
  /// or categories with labels, prior probabilities and an encoder where there is any `TargetValue`. What a
  /// variable had before is deleted. A null element has no targets; a null dictionary is an error (code 1).
  static void HandleTargets(const xercesc::DOMElement* targets, ScoreDictionary* dictionary);

  /// Reads the `ResultField` children of an `Output` element, or null, into a new dictionary of ResultVars,
  /// in the document's order, that the caller deletes.
  static ScoreDictionary* ParseResultDictionary(const xercesc::DOMElement* output);

  /// Reads one `ResultField`, or an `OutputField`, which needs no `feature`, and adds it to the dictionary,
  /// which owns it. A name that the dictionary has already is an error (code 8).
  static ResultVar& ParseResultField(const xercesc::DOMElement* field, ScoreDictionary& into);

  // ---- Predicates. What they give back belongs to the caller; the variables of the dictionaries must
  // outlive it. A field is looked up in `dictionary` and then, unless it is null, in `derivedDictionary`.

  /// Reads a `SimplePredicate` element. With `ordinalAsScale` an ordinal number field is compared by its
  /// numbers instead of by the positions of its categories.
  static ScorePredicate* ParsePredicate(xercesc::DOMElement* element, const ScoreDictionary* dictionary,
                                        const ScoreDictionary* derivedDictionary, bool ordinalAsScale);

  /// Reads a `SimpleSetPredicate` element.
  static ScorePredicate* ParseSetPredicate(xercesc::DOMElement* element, const ScoreDictionary* dictionary,
                                           const ScoreDictionary* derivedDictionary);

  /// Reads a `CompoundPredicate` element with all that is in it. Constants that change nothing are dropped,
  /// and a single child stands for the compound. Null when nothing is left, which is no error.
  static ScorePredicate* ParseCompoundPredicate(xercesc::DOMElement* element,
                                                const ScoreDictionary* dictionary,
                                                const ScoreDictionary* derivedDictionary,
                                                bool ordinalAsScale);

  // ---- The parts of these three, for plug-ins whose elements compare fields in other forms. `element` is
  // what the attributes are read from and what faults point at; where no attribute is read it may be null. A
  // value satisfies the comparison exactly when the split sends it to a child.

  /// Builds the split of a `SimplePredicate` on numbers, or on categories, with the one child 0.
  /// Sets the texts to what the attributes say, `missing` to whether the predicate's own value is missing.
  static ScoreSplitVar* HandleNodeScaleSplit(const xercesc::DOMElement* element, const ScoreDictVar* variable,
                                             std::string& operatorText, std::string& valueText,
                                             bool& missing);
  static ScoreSplitVar* HandleNodeDiscreteSplit(const xercesc::DOMElement* element,
                                                const ScoreDictVar* variable, std::string& operatorText,
                                                std::string& valueText, bool& missing);

  /// The interval that an ordering operator, "equal" or "notEqual" makes of a number. `included` tells
  /// whether its finite ends belong to it; of "notEqual", which is all but one number, they do not.
  static void GetScaleSplitValue(const xercesc::DOMElement* element, const XMLCh* value,
                                 const XMLCh* operatorText, double& low, double& high, bool& included);

  /// Sends the one category that `value` names to a child. Null stands for an absent attribute, which is an
  /// error (code 1), as is a value that is no category.
  static void SetDiscreteSplitValue(const xercesc::DOMElement* element, const ScoreDictVar* variable,
                                    DiscreteSplit* split, const XMLCh* value, int child);

  /// Sends the categories before or behind `value` in the variable's list to a child, and notes where they
  /// begin and end; "notEqual" sends all but one. No category at all, or no operator, is an error (code 9).
  static void HandleOrdinalVariable(const xercesc::DOMElement* element, const ScoreDictVar* variable,
                                    DiscreteSplit* split, const XMLCh* value, const XMLCh* operatorText,
                                    int child);

  /// The position of a value in the variable's list of categories, or -1.
  static int GetIndexOfOrdinalValue(const xercesc::DOMElement* element, const ScoreDictVar* variable,
                                    const ScoreValue& value);

  /// Builds the split of a set ("isIn" or "isNotIn") from the `Array` in `element`, with the one child 0.
  /// Sets `values` to the array's: codes where the variable has an encoder, else numbers.
  static ScoreSplitVar* HandleArrayDiscreteSplit(const xercesc::DOMElement* element,
                                                 const ScoreDictVar* variable, const XMLCh* booleanOperator,
                                                 std::vector<double>& values);

  /// Whether a text is one of the variable's categories: as a text, without regard to trailing blanks unless
  /// the variable keeps them, or as exactly the same number. False for a text that is no number where one is
  /// needed. A variable without categories is an error (code 1).
  static bool IsValidScoreValue(const xercesc::DOMElement* element, const ScoreDictVar* variable,
                                const std::string& text);

  /// The variable's categories without those that the texts name, in their order; they stay the variable's.
  /// A text that is no category is an error (code 3).
  static std::vector<const ScoreValue*> Remove(const xercesc::DOMElement* element,
                                               const ScoreDictVar* variable,
                                               const std::vector<std::string>& toRemove);

  // ---- Arrays. Elements stand between blanks, or between double quotes when there are blanks in them.

  /// The first `Array` child; code 4 when there is none.
  static xercesc::DOMElement* GetArrayNode(const xercesc::DOMElement* parent);
  /// The elements of an array as they are written. Of the types "int" and "real" each must be a number of
  /// that kind; the attribute `n` must be their number when it is there; there must be one at least.
  static std::vector<std::string> GetArrayElements(const xercesc::DOMElement* array);

  /// The numbers of an `Array` or of a row of a basis matrix, under the same rules whatever its type says.
  static std::vector<double> VerifyDoubleArray(const xercesc::DOMElement* array);
  static std::vector<int> VerifyIntArray(const xercesc::DOMElement* array);

  /// Code 4 unless `element` has the tag.
  static void VerifyOneElem(const xercesc::DOMElement* element, const std::string& tag);

  /// Reads the `ScoreDistribution` children of a node into `stats`, in document order, replacing what it
  /// held; its memory is used again.
  static void SetLeafNodeStats(xercesc::DOMElement* node, std::vector<LeafNodeStats>& stats);
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSLATE_PMMLTRANSLATOR_H
