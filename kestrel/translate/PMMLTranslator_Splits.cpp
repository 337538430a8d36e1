// The splits behind predicates: which numbers or categories satisfy a comparison.

#include <algorithm>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/dictionary/ScoreValueLabel.h"
#include "kestrel/dictionary/ScoreValueLabelSet.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/predicates/DiscreteSplit.h"
#include "kestrel/predicates/Range.h"
#include "kestrel/predicates/ScaleSplit.h"
#include "kestrel/predicates/SimplePredicate.h"
#include "kestrel/translate/CategoryList.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/VerifiedText.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

namespace {

using xercesc::DOMElement;
using Tag = PMMLTagText;
using Span = CategoryList::Span;

/// What satisfies a comparison goes to this child, whatever does not to none.
constexpr int kSatisfied = 0;

struct OperatorRow {
  const char16_t* text;
  SimplePredicate::SimplePredOperator meaning;
};

constexpr OperatorRow kOperators[] = {
    {Tag::XML_VAL_OPERATOR_EQUAL, SimplePredicate::kEqual},
    {Tag::XML_VAL_OPERATOR_NOTEQUAL, SimplePredicate::kNotEqual},
    {Tag::XML_VAL_OPERATOR_LESSTHAN, SimplePredicate::kLessThan},
    {Tag::XML_VAL_OPERATOR_LESSOREQUAL, SimplePredicate::kLessOrEqual},
    {Tag::XML_VAL_OPERATOR_GREATERTHAN, SimplePredicate::kGreaterThan},
    {Tag::XML_VAL_OPERATOR_GREATEROREQUAL, SimplePredicate::kGreaterOrEqual},
    {Tag::XML_VAL_OPERATOR_ISMISSING, SimplePredicate::kIsMissing},
    {Tag::XML_VAL_OPERATOR_ISNOTMISSING, SimplePredicate::kIsNotMissing},
};

/// No row's meaning: of a text that is no operator.
constexpr int kNoOperator = -1;

int OperatorOf(const XMLCh* text) {
  for (const OperatorRow& row : kOperators) {
    if (Equals(text, row.text)) return row.meaning;
  }
  return kNoOperator;
}

/// What a `SimplePredicate` says beside its field.
struct Comparison {
  explicit Comparison(const DOMElement* element)
      : operatorText(Attribute(element, Tag::XML_ATT_OPERATOR)),
        value(FindAttribute(element, Tag::XML_ATT_VALUE)),
        meaning(OperatorOf(operatorText)) {}

  /// The operator takes no value.
  bool AsksWhetherMissing() const {
    return meaning == SimplePredicate::kIsMissing || meaning == SimplePredicate::kIsNotMissing;
  }
  /// What is compared with is the missing value.
  bool MeansMissing() const {
    return meaning == SimplePredicate::kIsMissing || (meaning == SimplePredicate::kEqual && IsEmpty(value));
  }

  const XMLCh* operatorText;
  const XMLCh* value;  ///< null when it is absent
  int meaning;
};

void AddRange(ScaleSplit& split, double low, double high, bool lowIncluded, bool highIncluded) {
  split.PutSplit(new Range(low, high, lowIncluded, highIncluded), kSatisfied);
}

/// The ranges of a comparison with a number.
void AddRanges(const DOMElement* element, const Comparison& comparison, ScaleSplit& split) {
  const double infinity = NumericValue::GetInfinity();
  double low = 0.0;
  double high = 0.0;
  bool included = false;
  PMMLTranslator::GetScaleSplitValue(element, comparison.value, comparison.operatorText, low, high, included);
  if (comparison.meaning == SimplePredicate::kNotEqual) {
    AddRange(split, -infinity, low, false, false);
    AddRange(split, high, infinity, false, false);
    return;
  }
  AddRange(split, low, high, included && low != -infinity, included && high != infinity);
}

/// The value of the variable that a text of the document names; null when it names none.
std::unique_ptr<ScoreValue> MakeValue(const ScoreDictVar& variable, const std::string& text) {
  try {
    return std::unique_ptr<ScoreValue>(BaseTranslator::CarefullyMakeVarValue(&variable, text));
  } catch (const KestrelException&) {
    return nullptr;
  }
}

/// The position of the category that a text names; -1 when it names none.
int FindText(const CategoryList& categories, const ScoreDictVar& variable, const std::string& text) {
  const std::unique_ptr<ScoreValue> value = MakeValue(variable, text);
  return value != nullptr ? categories.Find(*value) : -1;
}

/// The position of the category that an attribute names. Unlike the elements of an array, what is no number
/// where one is needed is reported as that.
int RequirePosition(const DOMElement* element, const ScoreDictVar& variable, const CategoryList& categories,
                    const XMLCh* text) {
  std::unique_ptr<ScoreValue> value;
  try {
    value.reset(BaseTranslator::CarefullyMakeVarValue(&variable, text));
  } catch (const KestrelException& fault) {
    FailAt(element, KestrelException::kConversion, fault.GetErrorMessage());
  }
  const int position = value != nullptr ? categories.Find(*value) : -1;
  if (position < 0) {
    FailAt(element, KestrelException::kStructure,
           "Value list is required and split value should be in the list!");
  }
  return position;
}

/// All positions but one.
std::vector<Span> AllBut(int position, int size) {
  return {{0, position - 1}, {position + 1, size - 1}};
}

/// The positions that an ordering operator, or "equal", leads to from one; empty for any other operator.
Span SpanOf(int meaning, int position, int size) {
  switch (meaning) {
    case SimplePredicate::kGreaterThan:
      return {position + 1, size - 1};
    case SimplePredicate::kGreaterOrEqual:
      return {position, size - 1};
    case SimplePredicate::kLessThan:
      return {0, position - 1};
    case SimplePredicate::kLessOrEqual:
      return {0, position};
    case SimplePredicate::kEqual:
      return {position, position};
    default:
      return {0, -1};
  }
}

[[noreturn]] void FailOnOperator(const DOMElement* element) {
  FailAt(element, KestrelException::kInvalidOperator, "Invalid operator!!");
}

void RequireOrder(const DOMElement* element, const ScoreDictVar& variable, const CategoryList& categories) {
  if (categories.IsEmpty()) {
    FailOnField(element, KestrelException::kMissingElement, variable.GetName(), ": Value list is required!!");
  }
}

void RequireCategories(const DOMElement* element, const ScoreDictVar& variable,
                       const CategoryList& categories) {
  if (categories.IsEmpty()) {
    FailOnField(element, KestrelException::kStructure, variable.GetName(), ": Value list is required!!!");
  }
}

/// Sends the categories that satisfy a comparison with a value that is there.
void EnterCategories(const DOMElement* element, const ScoreDictVar& variable, const Comparison& comparison,
                     DiscreteSplit& split) {
  if (comparison.meaning == SimplePredicate::kEqual) {
    PMMLTranslator::SetDiscreteSplitValue(element, &variable, &split, comparison.value, kSatisfied);
  } else if (variable.GetMLevel() == ScoreDictVar::kOrdinal) {
    PMMLTranslator::HandleOrdinalVariable(element, &variable, &split, comparison.value,
                                          comparison.operatorText, kSatisfied);
  } else if (comparison.meaning == SimplePredicate::kNotEqual) {
    const CategoryList categories(variable);
    const int position = RequirePosition(element, variable, categories, comparison.value);
    categories.Enter(AllBut(position, categories.Size()), split, kSatisfied);
  } else {
    FailOnOperator(element);
  }
}

[[noreturn]] void FailOnAbsentValue(const DOMElement* element, const ScoreDictVar& variable) {
  FailAt(element, KestrelException::kStructure,
         "value attribute is required for split variable " + variable.GetName());
}

/// Whether the attribute "value" fits the operator of a comparison with categories.
void CheckDiscreteValue(const DOMElement* element, const ScoreDictVar& variable,
                        const Comparison& comparison) {
  if (comparison.AsksWhetherMissing()) {
    if (comparison.value == nullptr) return;
    if (comparison.meaning == SimplePredicate::kIsMissing) {
      FailAt(element, KestrelException::kStructure, "No value attribute allowed after \"isMissing\"");
    }
    FailAt(element, KestrelException::kStructure, "No value attribute allowed after \"isNotMissing\"");
  }
  if (!IsEmpty(comparison.value)) return;
  if (comparison.meaning != SimplePredicate::kEqual) {
    FailAt(element, KestrelException::kStructure, "Only equal operator is allowed for null string value");
  }
  // An empty value means the missing one; what an absent one would mean is left to guess.
  if (comparison.value == nullptr) FailOnAbsentValue(element, variable);
}

/// Ascending runs of positions, of those given or of all the others.
std::vector<Span> RunsOf(std::vector<int> positions, bool complement, int size) {
  std::sort(positions.begin(), positions.end());
  std::vector<Span> runs;
  int next = 0;  // the first position that no run has dealt with
  for (const int position : positions) {
    if (position < next) continue;
    if (complement) {
      if (next < position) runs.push_back({next, position - 1});
    } else if (!runs.empty() && runs.back().last + 1 == position) {
      runs.back().last = position;
    } else {
      runs.push_back({position, position});
    }
    next = position + 1;
  }
  if (complement && next < size) runs.push_back({next, size - 1});
  return runs;
}

}  // namespace

ScoreSplitVar* PMMLTranslator::HandleNodeScaleSplit(const DOMElement* element, const ScoreDictVar* variable,
                                                    std::string& operatorText, std::string& valueText,
                                                    bool& missing) {
  const Comparison comparison(element);
  if (comparison.AsksWhetherMissing() && comparison.value != nullptr) {
    FailAt(element, KestrelException::kStructure, "No value allowed after \"isMissing\" or\"isNotMissing\"");
  }
  auto split = std::make_unique<ScaleSplit>(variable);
  missing = comparison.MeansMissing();
  if (missing) {
    split->SetMissvalMap(kSatisfied);
  } else if (comparison.meaning == SimplePredicate::kIsNotMissing) {
    AddRange(*split, -NumericValue::GetInfinity(), NumericValue::GetInfinity(), false, false);
  } else if (IsEmpty(comparison.value)) {
    FailAt(element, KestrelException::kStructure, "Only \"Equal\" allowed here!!!");
  } else {
    AddRanges(element, comparison, *split);
  }
  operatorText = Narrow(comparison.operatorText);
  valueText = Narrow(comparison.value);
  return split.release();
}

void PMMLTranslator::GetScaleSplitValue(const DOMElement* element, const XMLCh* value,
                                        const XMLCh* operatorText, double& low, double& high,
                                        bool& included) {
  const double number = VerifyDoubleAt(element, value);
  low = -NumericValue::GetInfinity();
  high = NumericValue::GetInfinity();
  const int meaning = OperatorOf(operatorText);
  switch (meaning) {
    case SimplePredicate::kGreaterThan:
    case SimplePredicate::kGreaterOrEqual:
      low = number;
      break;
    case SimplePredicate::kLessThan:
    case SimplePredicate::kLessOrEqual:
      high = number;
      break;
    case SimplePredicate::kEqual:
    case SimplePredicate::kNotEqual:
      low = high = number;
      break;
    default:
      FailAt(element, KestrelException::kUnsupported, Narrow(operatorText) + ": Not supported!");
  }
  included = meaning == SimplePredicate::kGreaterOrEqual || meaning == SimplePredicate::kLessOrEqual ||
             meaning == SimplePredicate::kEqual;
  // No number that a document can hold comes this far; the rule stands for operators yet to come.
  if (!(low <= high)) {
    FailAt(element, KestrelException::kUnsupported, Narrow(value) + ": Invalid split value range!!!");
  }
}

ScoreSplitVar* PMMLTranslator::HandleNodeDiscreteSplit(const DOMElement* element,
                                                       const ScoreDictVar* variable,
                                                       std::string& operatorText, std::string& valueText,
                                                       bool& missing) {
  const Comparison comparison(element);
  const CategoryList categories(*variable);
  if (categories.IsEmpty()) FailAt(element, KestrelException::kMissingElement, "Value list is required!");
  CheckDiscreteValue(element, *variable, comparison);
  auto split = std::make_unique<DiscreteSplit>(variable);
  missing = comparison.MeansMissing();
  if (missing) {
    split->SetMissvalMap(kSatisfied);
  } else if (comparison.meaning == SimplePredicate::kIsNotMissing) {
    categories.Enter({{0, categories.Size() - 1}}, *split, kSatisfied);
  } else {
    EnterCategories(element, *variable, comparison, *split);
  }
  operatorText = Narrow(comparison.operatorText);
  valueText = Narrow(comparison.value);
  return split.release();
}

void PMMLTranslator::SetDiscreteSplitValue(const DOMElement* element, const ScoreDictVar* variable,
                                           DiscreteSplit* split, const XMLCh* value, int child) {
  if (value == nullptr) FailOnAbsentValue(element, *variable);
  const CategoryList categories(*variable);
  if (categories.IsEmpty()) FailAt(element, KestrelException::kMissingElement, "Value list is required!!");
  const int position = RequirePosition(element, *variable, categories, value);
  categories.Enter({{position, position}}, *split, child);
}

void PMMLTranslator::HandleOrdinalVariable(const DOMElement* element, const ScoreDictVar* variable,
                                           DiscreteSplit* split, const XMLCh* value,
                                           const XMLCh* operatorText, int child) {
  const CategoryList categories(*variable, true);
  RequireOrder(element, *variable, categories);
  const int position = RequirePosition(element, *variable, categories, value);
  const int meaning = OperatorOf(operatorText);
  if (meaning == SimplePredicate::kNotEqual) {
    categories.Enter(AllBut(position, categories.Size()), *split, child);
    return;
  }
  const Span span = SpanOf(meaning, position, categories.Size());
  if (span.first > span.last) FailOnOperator(element);
  categories.Enter({span}, *split, child);
  split->SetStartAndEndIndex(span.first, span.last);
}

int PMMLTranslator::GetIndexOfOrdinalValue(const DOMElement* element, const ScoreDictVar* variable,
                                           const ScoreValue& value) {
  const CategoryList categories(*variable, true);
  RequireOrder(element, *variable, categories);
  return categories.Find(value);
}

ScoreSplitVar* PMMLTranslator::HandleArrayDiscreteSplit(const DOMElement* element,
                                                        const ScoreDictVar* variable,
                                                        const XMLCh* booleanOperator,
                                                        std::vector<double>& values) {
  const bool isNotIn = Equals(booleanOperator, Tag::XML_VEXA_TRANFUNC_ISNOTIN);
  if (!isNotIn && !Equals(booleanOperator, Tag::XML_VEXA_TRANFUNC_ISIN)) {
    FailAt(element, KestrelException::kInvalidType, Narrow(booleanOperator) + " Invalid Operator!");
  }
  const DOMElement* const array = GetArrayNode(element);
  const std::vector<std::string> texts = GetArrayElements(array);
  const CategoryList categories(*variable);
  RequireCategories(element, *variable, categories);
  const ScoreEncoder* const encoder = variable->GetEncoder();
  std::vector<int> positions;
  positions.reserve(texts.size());
  std::vector<double> numbers;
  numbers.reserve(texts.size());
  for (const std::string& text : texts) {
    const std::unique_ptr<ScoreValue> value = MakeValue(*variable, text);
    const int position = value != nullptr ? categories.Find(*value) : -1;
    if (position < 0) FailAt(array, KestrelException::kConversion, "In valid split value!");
    positions.push_back(position);
    numbers.push_back(categories.AreCodes() ? position
                      : encoder != nullptr  ? encoder->EncodeConst(value.get())
                                            : value->GetDouble());
  }
  auto split = std::make_unique<DiscreteSplit>(variable);
  categories.Enter(RunsOf(std::move(positions), isNotIn, categories.Size()), *split, kSatisfied);
  values = std::move(numbers);
  return split.release();
}

bool PMMLTranslator::IsValidScoreValue(const DOMElement* element, const ScoreDictVar* variable,
                                       const std::string& text) {
  const CategoryList categories(*variable);
  RequireCategories(element, *variable, categories);
  return FindText(categories, *variable, text) >= 0;
}

std::vector<const ScoreValue*> PMMLTranslator::Remove(const DOMElement* element, const ScoreDictVar* variable,
                                                      const std::vector<std::string>& toRemove) {
  const CategoryList categories(*variable);
  if (categories.IsEmpty()) {
    FailOnField(element, KestrelException::kConversion, variable->GetName(),
                ": Category value list is required!!!");
  }
  std::vector<bool> isRemoved(static_cast<std::size_t>(categories.Size()), false);
  for (const std::string& text : toRemove) {
    const int position = FindText(categories, *variable, text);
    if (position < 0) FailAt(element, KestrelException::kConversion, "Invalid category value: " + text);
    isRemoved[static_cast<std::size_t>(position)] = true;
  }
  std::vector<const ScoreValue*> kept;
  for (const ScoreValueLabel* label : variable->GetValueLabels()->GetAllValueLabels()) {
    const ScoreValue* const value = label != nullptr ? label->GetValue() : nullptr;
    const int position = value != nullptr ? categories.Find(*value) : -1;
    if (position >= 0 && !isRemoved[static_cast<std::size_t>(position)]) kept.push_back(value);
  }
  return kept;
}

}  // namespace MCKestrel_800
