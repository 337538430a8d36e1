// Turns the elements of a PMML document into the library's objects. Model plug-ins derive their translators
// from this class and call its readers, so every reader is a public operation.

#ifndef KESTREL_TRANSLATE_PMMLTRANSLATOR_H
#define KESTREL_TRANSLATE_PMMLTRANSLATOR_H

#include <xercesc/util/XercesDefs.hpp>

#include <string>
#include <vector>

#include "kestrel/foundation/DateTimeType.h"
#include "kestrel/platform/Export.h"
#include "kestrel/translate/BaseTranslator.h"

XERCES_CPP_NAMESPACE_BEGIN
class DOMElement;
class DOMNode;
XERCES_CPP_NAMESPACE_END

namespace MCKestrel_800 {

class DiscreteSplit;
class ScoreDictVar;
class ScoreDictionary;
class ScoreMissingValueSet;
class ScorePredicate;
class ScoreSplitVar;
class ScoreValue;
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

  /// Reads a `DataDictionary` element.
  /// dataDictionary  the element; null is an error (code 1).
  /// reserved        without meaning; pass false.
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
  /// var       the field's variable; null is allowed, since an interval means the same for every continuous
  /// field. reserved  without meaning; pass 0.
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

  /// The date/time type that a `dataType` text names; `kNoDateTime` for every other text, the empty one and
  /// null.
  static DateTimeType ParseDateTimeType(const XMLCh* dataType);

  /// Reads an `Extension` element's "UsageType" children: the value "disable" turns the variable's usage type
  /// off.
  static void ParseUsageTypeExtension(xercesc::DOMElement* extension, ScoreDictVar* variable);

  /// Gives a nominal or ordinal variable its category encoder, unless it has one, and encodes its value
  /// labels in their order. Returns false, doing nothing, for null and for a continuous variable.
  static bool SetupCatEncoder(ScoreDictVar* variable);

  // ---- Predicates. What they give back belongs to the caller; the variables of the dictionaries must
  // outlive it. A field is looked up in `dictionary` and then, unless it is null, in `derivedDictionary`.

  /// Reads a `SimplePredicate` element.
  /// ordinalAsScale  whether an ordinal number field is compared by its numbers instead of by the positions
  /// of
  ///                 its categories.
  static ScorePredicate* ParsePredicate(xercesc::DOMElement* element, const ScoreDictionary* dictionary,
                                        const ScoreDictionary* derivedDictionary, bool ordinalAsScale);

  /// Reads a `SimpleSetPredicate` element.
  static ScorePredicate* ParseSetPredicate(xercesc::DOMElement* element, const ScoreDictionary* dictionary,
                                           const ScoreDictionary* derivedDictionary);

  /// Reads a `CompoundPredicate` element with all that is in it. Constants that change nothing are dropped,
  /// and a single child stands for the compound. Null when nothing is left: no predicate, which the caller
  /// accepts.
  static ScorePredicate* ParseCompoundPredicate(xercesc::DOMElement* element,
                                                const ScoreDictionary* dictionary,
                                                const ScoreDictionary* derivedDictionary,
                                                bool ordinalAsScale);

  /// Reads the `ScoreDistribution` children of a node into `stats`, in document order, replacing what it
  /// held.
  static void SetLeafNodeStats(xercesc::DOMElement* node, std::vector<LeafNodeStats>& stats);
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSLATE_PMMLTRANSLATOR_H
