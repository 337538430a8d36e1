#include "kestrel/translate/VEXATranslator.h"

#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "kestrel/dictionary/BaseDictionary.h"
#include "kestrel/dictionary/DictVar.h"
#include "kestrel/dictionary/MissingValueSet.h"
#include "kestrel/dictionary/ValueLabelSet.h"
#include "kestrel/dictionary/ValueLbl.h"
#include "kestrel/dictionary/VarStats.h"
#include "kestrel/predicates/Range.h"
#include "kestrel/translate/DocumentReader.h"
#include "kestrel/translate/LegacyDictionary.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/VerifiedText.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

namespace {

using xercesc::DOMElement;

/// The older format's names of elements, attributes and values. They have nothing in common with PMML's, even
/// where two are spelled alike.
struct LegacyName {
  static constexpr char16_t kRoot[] = u"vexa-ml";
  static constexpr char16_t kDictionary[] = u"dictionary";
  static constexpr char16_t kVariable[] = u"variable";
  static constexpr char16_t kName[] = u"name";
  static constexpr char16_t kStorageType[] = u"storage-type";
  static constexpr char16_t kString[] = u"STRING";
  static constexpr char16_t kLabel[] = u"label";
  static constexpr char16_t kMeasurementLevel[] = u"measurement-level";
  static constexpr char16_t kContinuous[] = u"CONTINUOUS";
  static constexpr char16_t kNominal[] = u"NOMINAL";
  static constexpr char16_t kOrdinal[] = u"ORDINAL";
  static constexpr char16_t kCategories[] = u"categories";
  static constexpr char16_t kCategory[] = u"category";
  static constexpr char16_t kValue[] = u"value";
  static constexpr char16_t kDisplayValue[] = u"display-value";
  static constexpr char16_t kMissingValues[] = u"missing-values";
  static constexpr char16_t kRange[] = u"range";
  static constexpr char16_t kVarStats[] = u"var-stats";
  static constexpr char16_t kFormatSpec[] = u"format-spec";
  static constexpr char16_t kDecimals[] = u"decimals";
  static constexpr char16_t kWidth[] = u"width";
  static constexpr char16_t kMinimum[] = u"minimum";
  static constexpr char16_t kMaximum[] = u"maximum";
  static constexpr char16_t kMean[] = u"mean";
  static constexpr char16_t kStandardDeviation[] = u"standard-deviation";
};

struct LevelRow {
  const char16_t* text;
  ScoreDictVar::MeasureLevel level;
};

constexpr LevelRow kLevels[] = {
    {LegacyName::kContinuous, ScoreDictVar::kContinuous},
    {LegacyName::kNominal, ScoreDictVar::kNominal},
    {LegacyName::kOrdinal, ScoreDictVar::kOrdinal},
};

struct StatisticRow {
  const char16_t* attribute;
  void (ScoreVarStats::*set)(double);
};

constexpr StatisticRow kStatistics[] = {
    {LegacyName::kMinimum, &ScoreVarStats::SetMin},
    {LegacyName::kMaximum, &ScoreVarStats::SetMax},
    {LegacyName::kMean, &ScoreVarStats::SetMean},
    {LegacyName::kStandardDeviation, &ScoreVarStats::SetStddev},
};

void RequireTag(const DOMElement* element, const char16_t* tag, const char* shown) {
  if (ElementIs(element, tag)) return;
  FailAt(element, KestrelException::kStructure, Narrow(element->getTagName()) + ": should be " + shown);
}

/// What the children of one variable add up to, until it is handed to the variable.
class VariableChildren {
 public:
  explicit VariableChildren(DictVar& variable) : variable_(variable) {}

  /// Reads the children of the variable's element and gives the variable what they say. Other children than
  /// those that are known are skipped.
  void Read(const DOMElement* element);

 private:
  void ReadStats(const DOMElement* element);
  void ReadMissing(const DOMElement* element);
  void ReadRange(const DOMElement* element);
  void ReadCategories(const DOMElement* element);
  void ReadCategory(const DOMElement* element);
  std::unique_ptr<ScoreValue> MakeValue(const DOMElement* element, const XMLCh* text) const;
  std::unique_ptr<ScoreValue> MakeBound(const DOMElement* element) const;
  void AddMissing(const DOMElement* element, std::unique_ptr<Range> range);
  void RefuseEmptyCategories() const;
  void RefuseIntersection() const;
  void Store();

  DictVar& variable_;
  std::unique_ptr<ValueLabelSet> labels_ = std::make_unique<ValueLabelSet>();
  std::unique_ptr<MissingValueSet> missing_ = std::make_unique<MissingValueSet>();
  // Where the ranges of missing_ stand, in its order.
  std::vector<const DOMElement*> missing_places_;
  // The first of the elements that lack a category value, and the first category that is the system-missing
  // number: kept because the faults of all children are reported before these.
  const DOMElement* without_value_ = nullptr;
  const DOMElement* system_missing_ = nullptr;
};

void VariableChildren::Read(const DOMElement* element) {
  for (const DOMElement* child : ChildElements(element)) {
    if (ElementIs(child, LegacyName::kVarStats)) {
      ReadStats(child);
    } else if (ElementIs(child, LegacyName::kMissingValues)) {
      ReadMissing(child);
    } else if (ElementIs(child, LegacyName::kCategories)) {
      ReadCategories(child);
    }
  }
  RefuseEmptyCategories();
  RefuseIntersection();
  Store();
}

void VariableChildren::ReadStats(const DOMElement* element) {
  if (const DOMElement* const format = FirstChild(element, LegacyName::kFormatSpec)) {
    const XMLCh* const decimals = Attribute(format, LegacyName::kDecimals);
    if (!IsEmpty(decimals)) variable_.SetDecimal(VerifyIntAt(format, decimals));
    const XMLCh* const width = Attribute(format, LegacyName::kWidth);
    if (!IsEmpty(width)) variable_.SetWidth(VerifyIntAt(format, width));
  }
  for (const StatisticRow& row : kStatistics) {
    const XMLCh* const text = Attribute(element, row.attribute);
    if (IsEmpty(text)) continue;
    const double number = VerifyDoubleAt(element, text);
    if (variable_.GetVarStats() == nullptr) variable_.SetVarStats(new VarStats);
    (variable_.GetVarStats()->*row.set)(number);
  }
}

void VariableChildren::ReadMissing(const DOMElement* element) {
  for (const DOMElement* child : ChildElements(element)) {
    if (ElementIs(child, LegacyName::kRange)) {
      ReadRange(child);
    } else if (ElementIs(child, LegacyName::kCategory)) {
      const XMLCh* const text = Attribute(child, LegacyName::kValue);
      if (IsEmpty(text)) FailAt(child, KestrelException::kInvalidValue, "category value is null!!");
      std::unique_ptr<ScoreValue> value = MakeValue(child, text);
      auto range = std::make_unique<Range>(value.get());
      value.release();
      AddMissing(child, std::move(range));
    }
  }
}

void VariableChildren::ReadRange(const DOMElement* element) {
  const DOMElement* const first = FirstChild(element, LegacyName::kCategory);
  const DOMElement* const second = first == nullptr ? nullptr : NextSibling(first, LegacyName::kCategory);
  if (second == nullptr) {
    FailAt(element, KestrelException::kMissingElement, "category is required in range element node!!");
  }
  std::unique_ptr<ScoreValue> low = MakeBound(first);
  std::unique_ptr<ScoreValue> high = MakeBound(second);
  auto range = std::make_unique<Range>(low.get(), high.get(), true, true);
  low.release();
  high.release();
  AddMissing(element, std::move(range));
}

std::unique_ptr<ScoreValue> VariableChildren::MakeBound(const DOMElement* element) const {
  const XMLCh* const text = Attribute(element, LegacyName::kValue);
  if (IsEmpty(text)) FailAt(element, KestrelException::kInvalidValue, "category value is required!!");
  return MakeValue(element, text);
}

/// The text as a value of the variable's type, never null.
std::unique_ptr<ScoreValue> VariableChildren::MakeValue(const DOMElement* element, const XMLCh* text) const {
  try {
    return std::unique_ptr<ScoreValue>(BaseTranslator::CarefullyMakeVarValue(&variable_, text));
  } catch (const KestrelException& fault) {
    FailAt(element, KestrelException::kConversion, fault.GetErrorMessage());
  }
}

void VariableChildren::AddMissing(const DOMElement* element, std::unique_ptr<Range> range) {
  // What is given twice is refused by the set and stays ours.
  if (!missing_->Add(range.get())) return;
  range.release();
  missing_places_.push_back(element);
}

void VariableChildren::ReadCategories(const DOMElement* element) {
  if (FirstChild(element) == nullptr && without_value_ == nullptr) without_value_ = element;
  for (const DOMElement* child : ChildElements(element)) {
    RequireTag(child, LegacyName::kCategory, "category");
    ReadCategory(child);
  }
}

void VariableChildren::ReadCategory(const DOMElement* element) {
  const XMLCh* const text = Attribute(element, LegacyName::kValue);
  if (IsEmpty(text)) {
    if (without_value_ == nullptr) without_value_ = element;
    return;
  }
  std::unique_ptr<ScoreValue> value = MakeValue(element, text);
  if (labels_->Contains(value.get())) {
    FailAt(element, KestrelException::kStructure,
           "\"" + value->GetString() + "\"" + ": Duplicated Category Value!");
  }
  // The missing values are not the variable's yet, so this asks for the system-missing number alone.
  if (system_missing_ == nullptr && variable_.IsMissingValue(value.get())) system_missing_ = element;
  auto label = std::make_unique<ValueLbl>(value.get(), AttributeText(element, LegacyName::kDisplayValue));
  value.release();
  labels_->Add(label.release());
}

void VariableChildren::RefuseEmptyCategories() const {
  if (without_value_ == nullptr) return;
  FailAt(without_value_, KestrelException::kInvalidDocument, "category values are required!!!");
}

/// A category may stand inside a missing range, where it wins. Listed as missing by itself it is a
/// contradiction.
void VariableChildren::RefuseIntersection() const {
  const DOMElement* place = system_missing_;
  const std::vector<const ScoreValueRange*> ranges = missing_->GetMissingValues();
  for (std::size_t i = 0; i < ranges.size() && place == nullptr; ++i) {
    const ScoreValue* const value = ranges[i]->GetMin();
    if (*value == *ranges[i]->GetMax() && labels_->Contains(value)) place = missing_places_[i];
  }
  if (place == nullptr) return;
  FailAt(place, KestrelException::kInvalidDocument, "Missing Value and Valid value intersect");
}

void VariableChildren::Store() {
  if (labels_->Size() == 0 && variable_.GetMLevel() != ScoreDictVar::kContinuous)
    variable_.SetEmptyCateValues(true);
  variable_.SetValueLabels(labels_.release());
  variable_.SetMissingValues(missing_.release());
}

ScoreDictVar::MeasureLevel ReadLevel(const DOMElement* element, const DictVar& variable) {
  const XMLCh* const text = Attribute(element, LegacyName::kMeasurementLevel);
  if (IsEmpty(text)) FailAt(element, KestrelException::kInvalidValue, "Measurement-level can't be null!!");
  for (const LevelRow& row : kLevels) {
    if (!Equals(text, row.text)) continue;
    if (row.level == ScoreDictVar::kContinuous && variable.IsString()) {
      FailAt(element, KestrelException::kInvalidType,
             "VEXATranslator::parseDictionary():Continuous variable should be numeric!!");
    }
    return row.level;
  }
  FailAt(element, KestrelException::kInvalidType, "Invalid measurement-level attribute!!");
}

/// Adds a variable for an element to the dictionary, which owns it from here on.
DictVar& AddVariable(const DOMElement* element, BaseDictionary& dictionary) {
  const XMLCh* const wide_name = RequiredAttribute(element, LegacyName::kName);
  const XMLCh* const storage_type = RequiredAttribute(element, LegacyName::kStorageType);
  if (IsEmpty(wide_name) || IsEmpty(storage_type)) {
    FailAt(element, KestrelException::kInvalidValue, "Varname or storage type can't be null!!");
  }
  const std::string name = Narrow(wide_name);
  const bool is_string = Equals(storage_type, LegacyName::kString);
  auto variable =
      std::make_unique<DictVar>(name, is_string ? ScoreDictVar::STRING_VAR : ScoreDictVar::kNUMERIC_VAR);
  // A dictionary that does not grow had the name already and left the variable to us.
  const std::size_t size_before = dictionary.Size();
  dictionary.AddVar(name, variable.get());
  if (dictionary.Size() == size_before) {
    FailOnField(element, KestrelException::kUnknownVariable, name, " is duplicated!!!");
  }
  return *variable.release();
}

}  // namespace

VEXATranslator::VEXATranslator() = default;
VEXATranslator::VEXATranslator(const VEXATranslator& other) = default;
VEXATranslator::~VEXATranslator() = default;

ScoreModel* VEXATranslator::ParseFromTree(DOMElement* /*root*/, const std::string& /*arg*/) {
  return nullptr;
}

ScoreDictionary* VEXATranslator::ParseDictionary(DOMElement* dictionaryElement) {
  if (dictionaryElement == nullptr) Fail(KestrelException::kStructure, "<DataDictionary is required !!");
  auto dictionary = std::make_unique<BaseDictionary>();
  for (const DOMElement* element : ChildElements(dictionaryElement)) {
    RequireTag(element, LegacyName::kVariable, "variable");
    DictVar& variable = AddVariable(element, *dictionary);
    const XMLCh* const label = Attribute(element, LegacyName::kLabel);
    if (!IsEmpty(label)) variable.SetLabel(Narrow(label));
    variable.SetMLevel(ReadLevel(element, variable));
    VariableChildren(variable).Read(element);
    SetupCatEncoder(&variable);
  }
  if (dictionary->Size() == 0) {
    FailAt(dictionaryElement, KestrelException::kInvalidDocument, "Dicitonary is empty!!");
  }
  return dictionary.release();
}

bool VEXATranslator::SetupCatEncoder(ScoreDictVar* var) {
  return PMMLTranslator::SetupCatEncoder(var);
}

std::unique_ptr<ScoreDictionary> ReadLegacyDictionary(std::istream& in) {
  const std::unique_ptr<ParsedDocument> document = ReadDocument(in);
  DOMElement* const root = document->GetRoot();
  if (!ElementIs(root, LegacyName::kRoot)) {
    FailAt(root, KestrelException::kUnsupported, "Unsupported Model found!");
  }
  DOMElement* const element = FirstChild(root, LegacyName::kDictionary);
  // Said here and not by ParseDictionary, which cannot know where the element should stand.
  if (element == nullptr) FailAt(root, KestrelException::kStructure, "<DataDictionary is required !!");
  return std::unique_ptr<ScoreDictionary>(VEXATranslator().ParseDictionary(element));
}

}  // namespace MCKestrel_800
