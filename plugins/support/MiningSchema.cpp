#include "plugins/support/MiningSchema.h"

#include <xercesc/dom/DOMElement.hpp>

#include <utility>

#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/foundation/KestrelException.h"
#include "kestrel/transform/TransformationDictionary.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/XmlText.h"
#include "plugins/support/Attributes.h"

namespace MCKestrel_800 {
namespace {

using xercesc::DOMElement;
using Tags = PMMLTagText;

// The attributes that the table of names does not list.
constexpr char16_t kInvalidValueReplacement[] = u"invalidValueReplacement";

constexpr Word<ScoreModel::VarRole> kUsageTypes[] = {
    {"active", ScoreModel::kPredictor},
    {"predicted", ScoreModel::kTarget},
    {"target", ScoreModel::kTarget},
    {"supplementary", ScoreModel::kSupplementary},
    {"order", ScoreModel::kOrder},
    {"group", ScoreModel::kGroup},
    {"frequencyWeight", ScoreModel::kFrequencyWeight},
    {"analysisWeight", ScoreModel::kAnalysisWeight},
};

constexpr Word<ScoreDictVar::MeasureLevel> kOptypes[] = {
    {"continuous", ScoreDictVar::kContinuous},
    {"ordinal", ScoreDictVar::kOrdinal},
    {"categorical", ScoreDictVar::kNominal},
};

constexpr Word<ScoreDictVar::OutlierHandleMethod> kOutliers[] = {
    {"asIs", ScoreDictVar::kAsIs},
    {"asMissingValues", ScoreDictVar::kAsMissingValues},
    {"asExtremeValues", ScoreDictVar::kAsExtremeValues},
};

// The meaning: whether a missing value makes the case invalid. The others only tell how the replacement was
// found.
constexpr Word<bool> kMissingTreatments[] = {
    {"asIs", false},     {"asMean", false},  {"asMode", false},
    {"asMedian", false}, {"asValue", false}, {"returnInvalid", true},
};

constexpr Word<MiningField::InvalidTreatment> kInvalidTreatments[] = {
    {"returnInvalid", MiningField::InvalidTreatment::kReturnInvalid},
    {"asIs", MiningField::InvalidTreatment::kAsIs},
    {"asMissing", MiningField::InvalidTreatment::kAsMissing},
    {"asValue", MiningField::InvalidTreatment::kAsValue},
};

/// Reads one `MiningField`.
class FieldReader {
 public:
  FieldReader(const DOMElement* element, ScoreDictionary* dictionary, TransformationDictionary* derived)
      : element_(element) {
    field_.name =
        Narrow(BaseTranslator::GetAttributeForced(element, PMMLModelTags::XML_ATT_MININGFIELD_NAME));
    if (field_.name.empty()) {
      FailAt(element, KestrelException::kStructure, "<MiningField>'s name can't be null string !!");
    }
    variable_ = dictionary->GetVar(field_.name);
    is_derived_ = variable_ == nullptr;
    if (is_derived_ && derived != nullptr) variable_ = derived->GetVar(field_.name);
    if (variable_ == nullptr) FailOnUnknownField();
    field_.variable = variable_;
  }

  MiningField Read() {
    ReadWord(Tags::XML_ATT_MININGFIELD_USAGETYPE, kUsageTypes, field_.role);
    // What is predicted is a field of the data.
    if (field_.role == ScoreModel::kTarget && is_derived_) FailOnUnknownField();
    ReadOptype();
    ReadOutliers();
    ReadWord(Tags::XML_ATT_MININGFIELD_MISSTREATMENT, kMissingTreatments, field_.missing_is_invalid);
    field_.missing_replacement = ReadReplacement(Tags::XML_ATT_MININGFIELD_MISSREPLACE);
    ReadInvalidTreatment();
    return std::move(field_);
  }

 private:
  /// Leaves `meaning` as it is when the attribute is absent.
  template <typename T, std::size_t N>
  void ReadWord(const char16_t* attribute, const Word<T> (&vocabulary)[N], T& meaning) const {
    const XMLCh* found = FindAttribute(element_, attribute);
    if (found == nullptr) return;
    const std::string text = Narrow(found);
    const Word<T>* const word = FindWord(vocabulary, text);
    if (word == nullptr) Refuse(KestrelException::kInvalidDocument, attribute, text);
    meaning = word->meaning;
  }

  [[noreturn]] void FailOnUnknownField() const {
    FailAt(element_, KestrelException::kUnknownVariable,
           "Variable " + field_.name + " not in the dictionary!");
  }

  [[noreturn]] void Refuse(KestrelException::ExceptionCode code, const char16_t* attribute,
                           const std::string& text) const {
    FailOnField(element_, code, field_.name, ": invalid " + Narrow(ToXMLCh(attribute)) + " -- " + text);
  }

  void ReadOptype() {
    ScoreDictVar::MeasureLevel level = variable_->GetMLevel();
    ReadWord(Tags::XML_ATT_VAL_MINING_OPTYPE, kOptypes, level);
    if (level == variable_->GetMLevel()) return;
    if (level == ScoreDictVar::kContinuous && variable_->GetVarType() == ScoreDictVar::STRING_VAR) {
      FailOnField(element_, KestrelException::kInvalidType, field_.name,
                  ": string variable can't be continuous!!");
    }
    variable_->SetMLevel(level);
    PMMLTranslator::SetupCatEncoder(variable_);
  }

  void ReadOutliers() {
    ReadWord(Tags::XML_ATT_MININGFIELD_OUTLIERS, kOutliers, field_.outliers);
    ReadMargin(Tags::XML_ATT_MININGFIELD_LOWVALUE, field_.low_value);
    ReadMargin(Tags::XML_ATT_MININGFIELD_HIGHVALUE, field_.high_value);
    if (field_.low_value > field_.high_value) {
      FailOnField(element_, KestrelException::kInvalidDocument, field_.name, ": lowValue is above highValue");
    }
  }

  void ReadMargin(const char16_t* attribute, double& margin) const {
    const XMLCh* text = FindAttribute(element_, attribute);
    if (IsEmpty(text)) return;
    try {
      margin = BaseTranslator::VerifyDouble(text);
    } catch (const KestrelException&) {
      Refuse(KestrelException::kConversion, attribute, Narrow(text));
    }
  }

  void ReadInvalidTreatment() {
    ReadWord(Tags::XML_ATT_INVALIDVALUETREATMENT, kInvalidTreatments, field_.invalid);
    std::unique_ptr<ScoreValue> replacement = ReadReplacement(kInvalidValueReplacement);
    if (field_.invalid != MiningField::InvalidTreatment::kAsValue) return;
    if (replacement == nullptr) {
      FailOnField(element_, KestrelException::kInvalidDocument, field_.name,
                  ": invalidValueReplacement is required");
    }
    field_.invalid_replacement = std::move(replacement);
  }

  /// A value of the field's type, or null when the attribute is absent. An empty attribute is a text, but no
  /// number.
  std::unique_ptr<ScoreValue> ReadReplacement(const char16_t* attribute) const {
    const XMLCh* text = FindAttribute(element_, attribute);
    if (text == nullptr) return nullptr;
    try {
      std::unique_ptr<ScoreValue> value(BaseTranslator::CarefullyMakeVarValue(variable_, text));
      if (value != nullptr) return value;
    } catch (const KestrelException&) {
      // Reported below, with the field's name.
    }
    Refuse(KestrelException::kInvalidValue, attribute, Narrow(text));
  }

  const DOMElement* element_;
  ScoreDictVar* variable_ = nullptr;
  bool is_derived_ = false;
  MiningField field_;
};

}  // namespace

MiningSchema MiningSchema::Read(const DOMElement* element, ScoreDictionary* dictionary,
                                TransformationDictionary* derived) {
  MiningSchema schema;
  for (DOMElement* child : ChildElements(element)) {
    if (ElementIs(child, Tags::XML_ELE_EXTENSION)) continue;
    if (!ElementIs(child, Tags::XML_ELE_MININGFIELD)) {
      FailAt(child, KestrelException::kStructure, "<MiningField> or <Extension> is required here!!");
    }
    FieldReader reader(child, dictionary, derived);
    MiningField field = reader.Read();
    if (!schema.positions_.emplace(field.name, schema.fields_.size()).second) {
      FailOnField(child, KestrelException::kStructure, field.name, ": Duplicated MiningField!");
    }
    schema.fields_.push_back(std::move(field));
  }
  if (schema.fields_.empty()) FailAt(element, KestrelException::kStructure, "<MiningSchema> is EMPTY!!");
  return schema;
}

const MiningField* MiningSchema::Find(const std::string& name) const {
  const auto found = positions_.find(name);
  return found == positions_.end() ? nullptr : &fields_[found->second];
}

void MiningSchema::AddDerivedFields(const TransformationDictionary& derived) {
  for (const std::string& name : derived.GetDerivedVarNames()) {
    if (Find(name) != nullptr || !derived_positions_.emplace(name, derived_fields_.size()).second) continue;
    MiningField field;
    field.name = name;
    field.variable = derived.GetVar(name);
    field.invalid = MiningField::InvalidTreatment::kAsIs;
    derived_fields_.push_back(std::move(field));
  }
}

const MiningField* MiningSchema::FindInput(const std::string& name) const {
  if (const MiningField* const field = Find(name)) {
    return field->role == ScoreModel::kPredictor ? field : nullptr;
  }
  const auto found = derived_positions_.find(name);
  return found == derived_positions_.end() ? nullptr : &derived_fields_[found->second];
}

void MiningSchema::SetRoles(ScoreModel& model) const {
  for (const MiningField& field : fields_)
    model.SetVarRole(field.name, field.role);
}

}  // namespace MCKestrel_800
