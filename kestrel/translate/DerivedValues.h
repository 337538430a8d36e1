// What the readers of derived fields share: finding a field, making its values, noting its categories.

#ifndef KESTREL_TRANSLATE_DERIVEDVALUES_H
#define KESTREL_TRANSLATE_DERIVEDVALUES_H

#include <xercesc/util/XercesDefs.hpp>

#include <memory>
#include <string>

#include "kestrel/foundation/ScoreValue.h"

XERCES_CPP_NAMESPACE_BEGIN
class DOMElement;
XERCES_CPP_NAMESPACE_END

namespace MCKestrel_800 {

class ScoreDictVar;
class ScoreDictionary;
class TransformVar;

/// The field of a name: a data field, else a derived one that is there already; null when there is none.
/// Either dictionary may be null.
const ScoreDictVar* FindField(const ScoreDictionary* dictionary, const ScoreDictionary* derived,
                              const std::string& name);

/// The same, refusing a name that is none (code 8).
const ScoreDictVar* RequireField(const xercesc::DOMElement* element, const ScoreDictionary* dictionary,
                                 const ScoreDictionary* derived, const std::string& name);

/// What takes the place of a missing value of a field that is referred to; null when the reference does not
/// say. Code 8, in the name of the derived field, when it is no value of the field's type.
std::unique_ptr<ScoreValue> ReadFieldReplacement(const xercesc::DOMElement* reference,
                                                 const ScoreDictVar& source, const std::string& derivedField);

/// A value of the variable's storage type. A date/time is written as a number in the field's unit or as a
/// text of its type, and held in seconds. Code 3, at the element, when the text is neither a number nor a
/// date/time where one is needed. The result is never null.
std::unique_ptr<ScoreValue> MakeValueAt(const xercesc::DOMElement* element, const ScoreDictVar& variable,
                                        const XMLCh* text);

/// Reads what takes the place of a missing input, and what an input becomes that nothing matches; absent and
/// empty attributes change nothing.
void ReadMissingReplacement(const xercesc::DOMElement* expression, TransformVar& variable);
void ReadDefaultValue(const xercesc::DOMElement* expression, TransformVar& variable);

/// Refuses to make values of a field missing that is no number (code 5).
void RequireNumericTarget(const xercesc::DOMElement* extension, const TransformVar& variable);

/// Refuses an element that has no business where it stands.
[[noreturn]] void FailOnElement(const xercesc::DOMElement* element);

/// Gives a categorical or ordinal derived field without value labels those that its expression says: the
/// values that it can have, in the order in which the document has them. None are given where an input may be
/// copied, which may be anything, and where the field's width cuts a value. Values of the field that are
/// missing are no categories.
void NoteCategories(TransformVar& variable);

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSLATE_DERIVEDVALUES_H
