// The predicate elements of trees and rules: simple, set and compound ones and the constants in them.

#include <memory>
#include <string>
#include <vector>

#include "kestrel/dictionary/DictVar.h"
#include "kestrel/predicates/CompoundPredicate.h"
#include "kestrel/predicates/ConstantPredicates.h"
#include "kestrel/predicates/ScaleSplit.h"
#include "kestrel/predicates/SetPredicate.h"
#include "kestrel/predicates/SimplePredicate.h"
#include "kestrel/translate/DerivedValues.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/VerifiedText.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

namespace {

using xercesc::DOMElement;
using Tag = PMMLTagText;

/// What stays the same from a predicate to those inside it.
struct Fields {
  const ScoreDictionary* dictionary;
  const ScoreDictionary* derivedDictionary;
  bool ordinalAsScale;
};

bool IsComparedByNumber(const ScoreDictVar& variable, bool ordinalAsScale) {
  if (variable.GetMLevel() == ScoreDictVar::kContinuous) return true;
  return ordinalAsScale && variable.GetMLevel() == ScoreDictVar::kOrdinal &&
         variable.GetVarType() != ScoreDictVar::STRING_VAR;
}

/// Lends a predicate a split for a moment.
class LentSplit {
 public:
  LentSplit(SimplePredicate& predicate, const ScoreSplitVar& split)
      : predicate_(predicate), own_(predicate.GetSplit()) {
    predicate_.SetSplit(&split);
  }
  ~LentSplit() { predicate_.SetSplit(own_); }
  LentSplit(const LentSplit&) = delete;
  LentSplit& operator=(const LentSplit&) = delete;

 private:
  SimplePredicate& predicate_;
  const ScoreSplitVar* const own_;
};

/// Keeps the text that a predicate compares with. A predicate on a variable with an encoder asks that for the
/// text's code, and an encoder that does not know a text makes it a new category: a case with that value
/// would no longer be one without a category, and the encoder no longer be the list's. So the empty text,
/// which stands for no value, is not passed on, and one that is no category (a number between two of them, a
/// date's number) is kept as that of a plain number.
void KeepValue(const ScoreDictVar& variable, const std::string& text, SimplePredicate& predicate) {
  if (text.empty()) return;
  const ScoreEncoder* const encoder = variable.GetEncoder();
  if (encoder == nullptr || encoder->EncodeConst(text) >= 0) {
    predicate.SetPredicateValue(text);
    return;
  }
  static const DictVar plainNumber("number", ScoreDictVar::kNUMERIC_VAR);
  const ScaleSplit split(&plainNumber);
  const LentSplit lent(predicate, split);
  predicate.SetPredicateValue(text);
}

using Reader = ScorePredicate* (*)(DOMElement* element, const Fields& fields);

struct ReaderRow {
  const char16_t* tag;
  Reader read;
};

// Called through pointers, so that no reader's room on the stack becomes part of every level of a compound.
constexpr ReaderRow kReaders[] = {
    {Tag::XML_ELE_PREDICATE,
     [](DOMElement* element, const Fields& fields) {
       return PMMLTranslator::ParsePredicate(element, fields.dictionary, fields.derivedDictionary,
                                             fields.ordinalAsScale);
     }},
    {Tag::XML_ELE_SETPREDICATE,
     [](DOMElement* element, const Fields& fields) {
       return PMMLTranslator::ParseSetPredicate(element, fields.dictionary, fields.derivedDictionary);
     }},
    {Tag::XML_ELE_COMPOUNDPREDICATE,
     [](DOMElement* element, const Fields& fields) {
       return PMMLTranslator::ParseCompoundPredicate(element, fields.dictionary, fields.derivedDictionary,
                                                     fields.ordinalAsScale);
     }},
    {Tag::XML_ELE_TRUE, [](DOMElement*, const Fields&) -> ScorePredicate* { return new TruePredicate; }},
    {Tag::XML_ELE_FALSE, [](DOMElement*, const Fields&) -> ScorePredicate* { return new FalsePredicate; }},
};

struct BooleanOperatorRow {
  const char16_t* text;
  ScorePredicate::CompoundBoolOperator meaning;
  /// The constant that changes nothing in such a list; null when each counts.
  const char16_t* neutral;
};

constexpr BooleanOperatorRow kBooleanOperators[] = {
    {Tag::XML_VAL_OR, ScorePredicate::kOr, Tag::XML_ELE_FALSE},
    {Tag::XML_VAL_AND, ScorePredicate::kAnd, Tag::XML_ELE_TRUE},
    {Tag::XML_VAL_XOR, ScorePredicate::kXor, nullptr},
    {Tag::XML_VAL_SURROGATE, ScorePredicate::kSurrogate, nullptr},
};

const BooleanOperatorRow& ReadBooleanOperator(const DOMElement* element) {
  const XMLCh* const text = Attribute(element, Tag::XML_ATT_BOOLEANOPERATOR);
  for (const BooleanOperatorRow& row : kBooleanOperators) {
    if (Equals(text, row.text)) return row;
  }
  FailAt(element, KestrelException::kInvalidType,
         Narrow(text) + ": Invalid Boolean Operator for the Compound Predicate");
}

/// Adds what a child element reads as to a compound; nothing for an element that is no predicate, and for a
/// compound of nothing.
void AddChild(DOMElement* child, const Fields& fields, CompoundPredicate& compound) {
  for (const ReaderRow& row : kReaders) {
    if (!ElementIs(child, row.tag)) continue;
    std::unique_ptr<ScorePredicate> predicate(row.read(child, fields));
    if (predicate == nullptr) return;
    compound.AddPredicate(predicate.get());
    static_cast<void>(predicate.release());
    return;
  }
}

/// The one child of a compound, which is not needed then.
ScorePredicate* TakeOnlyChild(CompoundPredicate& compound) {
  ScorePredicate* const child = compound.GetPredicates().front();
  compound.RemovePredicate(child);
  return child;
}

}  // namespace

ScorePredicate* PMMLTranslator::ParsePredicate(DOMElement* element, const ScoreDictionary* dictionary,
                                               const ScoreDictionary* derivedDictionary,
                                               bool ordinalAsScale) {
  const std::string name = Narrow(RequiredAttribute(element, Tag::XML_ATT_FIELD));
  const ScoreDictVar* const variable = FindField(dictionary, derivedDictionary, name);
  if (variable == nullptr) {
    FailOnField(element, KestrelException::kUnknownVariable, name, ": Invalid Split Variable!");
  }
  std::string operatorText;
  std::string valueText;
  bool missing = false;
  std::unique_ptr<const ScoreSplitVar> split(
      IsComparedByNumber(*variable, ordinalAsScale)
          ? HandleNodeScaleSplit(element, variable, operatorText, valueText, missing)
          : HandleNodeDiscreteSplit(element, variable, operatorText, valueText, missing));
  auto predicate = std::make_unique<SimplePredicate>(split.get());
  static_cast<void>(split.release());
  KeepValue(*variable, valueText, *predicate);
  predicate->SetValueToMissing(missing);
  predicate->SetPredicateOperator(operatorText);
  return predicate.release();
}

ScorePredicate* PMMLTranslator::ParseSetPredicate(DOMElement* element, const ScoreDictionary* dictionary,
                                                  const ScoreDictionary* derivedDictionary) {
  const std::string name = Narrow(RequiredAttribute(element, Tag::XML_ATT_FIELD));
  const ScoreDictVar* const variable = FindField(dictionary, derivedDictionary, name);
  if (variable == nullptr) {
    FailAt(element, KestrelException::kUnknownVariable, "Variable " + name + " not in the dictionary!");
  }
  const XMLCh* const operatorText = Attribute(element, Tag::XML_ATT_BOOLEANOPERATOR);
  if (!Equals(operatorText, Tag::XML_VEXA_TRANFUNC_ISIN) &&
      !Equals(operatorText, Tag::XML_VEXA_TRANFUNC_ISNOTIN)) {
    FailAt(element, KestrelException::kInvalidOperator, Narrow(operatorText) + " Invalid Operator!");
  }
  std::vector<double> values;
  std::unique_ptr<const ScoreSplitVar> split(
      HandleArrayDiscreteSplit(element, variable, operatorText, values));
  auto predicate = std::make_unique<SetPredicate>(split.get());
  static_cast<void>(split.release());
  predicate->SetArrayData(values);
  predicate->SetPredicateOperator(Narrow(operatorText));
  return predicate.release();
}

ScorePredicate* PMMLTranslator::ParseCompoundPredicate(DOMElement* element, const ScoreDictionary* dictionary,
                                                       const ScoreDictionary* derivedDictionary,
                                                       bool ordinalAsScale) {
  const BooleanOperatorRow& row = ReadBooleanOperator(element);
  const Fields fields = {dictionary, derivedDictionary, ordinalAsScale};
  auto compound = std::make_unique<CompoundPredicate>(row.meaning);
  bool sawNeutral = false;
  for (DOMElement* child : ChildElements(element)) {
    if (row.neutral != nullptr && ElementIs(child, row.neutral)) {
      sawNeutral = true;
    } else {
      AddChild(child, fields, *compound);
    }
  }
  if (compound->GetCount() > 1) return compound.release();
  if (compound->GetCount() == 1) return TakeOnlyChild(*compound);
  if (!sawNeutral) return nullptr;
  if (row.meaning == ScorePredicate::kAnd) return new TruePredicate;
  return new FalsePredicate;
}

}  // namespace MCKestrel_800
