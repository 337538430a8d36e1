// Bytes as the inside of a DataDictionary, or as a whole document of the older format: either a proper
// refusal, or variables whose copies and encoders agree.

#include <cstdint>
#include <memory>
#include <sstream>
#include <string>

#include "fuzz/Check.h"
#include "fuzz/CheckFault.h"
#include "kestrel/dictionary/ScoreEncoder.h"
#include "kestrel/dictionary/ScoreValueLabel.h"
#include "kestrel/dictionary/ScoreValueLabelSet.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/translate/LegacyDictionary.h"
#include "tests/support/DictionaryText.h"

namespace {

using namespace MCKestrel_800;
using kestrel_fuzz::Check;

/// The number that the dictionary has to announce, as far as plain searching finds it.
int CountFields(const std::string& text) {
  const std::string tag = "<DataField";
  int count = 0;
  for (size_t at = text.find(tag); at != std::string::npos; at = text.find(tag, at + tag.size()))
    ++count;
  return count;
}

std::unique_ptr<ScoreDictionary> Read(const std::string& text) {
  if (text.rfind("<vexa-ml", 0) != 0)
    return kestrel_test::ReadDictionary(kestrel_test::DictionaryOf(CountFields(text), text));
  std::istringstream in(text);
  return ReadLegacyDictionary(in);
}

std::string Shown(const ScoreDictionary& dictionary) {
  std::ostringstream out;
  dictionary.Display(out);
  return out.str();
}

void CheckEncoder(const ScoreDictVar& variable, const ScoreValueLabelSet& labels) {
  const ScoreEncoder* encoder = variable.GetEncoder();
  if (encoder == nullptr) return;
  for (const ScoreValueLabel* label : labels.GetAllValueLabels()) {
    const ScoreValue* value = label->GetValue();
    Check(value != nullptr, "a category has a value");
    Check(encoder->EncodeConst(value) < encoder->GetNumberOfCategories(), "codes are dense");
    Check(labels.Contains(value) || value->GetType() != ScoreValue::kString, "a set contains its texts");
  }
}

void CheckVariable(const ScoreDictVar& variable) {
  Check(!variable.GetName().empty(), "a variable has a name");
  const NumericValue missing, one(1.0);
  const StringValue empty, text("a");
  for (const ScoreValue* value :
       {static_cast<const ScoreValue*>(&missing), static_cast<const ScoreValue*>(&one),
        static_cast<const ScoreValue*>(&empty), static_cast<const ScoreValue*>(&text)}) {
    Check(!(variable.IsMissingValue(value) && variable.IsValidValue(value)), "no missing value is valid");
  }
  if (const ScoreValueLabelSet* labels = variable.GetValueLabels()) CheckEncoder(variable, *labels);
  const std::unique_ptr<ScoreDictVar> copy(variable.Clone());
  Check(*copy == variable, "a copy has the same name");
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  try {
    const auto dictionary = Read(std::string(reinterpret_cast<const char*>(data), size));
    Check(dictionary != nullptr && dictionary->Size() > 0, "a dictionary that is not refused has variables");
    const auto& variables = dictionary->GetScoreDictVars();
    Check(variables.size() == dictionary->Size(), "all variables are listed");
    for (const ScoreDictVar* variable : variables)
      CheckVariable(*variable);
    const std::unique_ptr<ScoreDictionary> copy(dictionary->Clone());
    Check(Shown(*copy) == Shown(*dictionary), "a copy displays itself like the original");
  } catch (const KestrelException& fault) {
    kestrel_fuzz::CheckFault(fault);
  }
  return 0;
}
