// Bytes as derived fields over fixed data fields: either a proper refusal, or fields that compute, as do
// their copies, and that leave the data fields as they were.

#include <cstdint>
#include <memory>
#include <sstream>
#include <string>

#include "fuzz/Check.h"
#include "fuzz/CheckFault.h"
#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/transform/FunctionTree.h"
#include "tests/support/DerivedText.h"

namespace {

using namespace MCKestrel_800;
using kestrel_fuzz::Check;

const ScoreDictionary& Fields() {
  static const std::unique_ptr<ScoreDictionary> fields =
      kestrel_test::ReadDictionary(kestrel_test::kDerivedSources);
  return *fields;
}

struct Case {
  double x;
  double y;
  const char* color;
  const char* born;
};

constexpr Case kCases[] = {{1.5, 2, "red", "2000-02-29"},
                           {99, -1e300, "green", "1969-12-31"},
                           {NumericValue::gSysmisValue, 0, "", ""},
                           {1e308, -0.0, "pink", "0001-01-01"}};

/// The values of all fields for a case, bit for bit.
std::string Compute(TransformationDictionary& derived, const Case& one) {
  CaseRecord record;
  record.Add("x", new NumericValue(one.x));
  record.Add("y", new NumericValue(one.y));
  record.Add("color", new StringValue(one.color));
  record.Add("size", new StringValue("mid"));
  record.Add("born", new DateTimeValue(one.born, kDate));
  derived.SetUpDerivedCaseRecord();
  Check(derived.GetValuesForDerivedVars(&record, &Fields()) != nullptr,
        "there is a record of derived values");
  std::ostringstream out;
  out << std::hexfloat;
  for (const std::string& name : derived.GetDerivedVarNames()) {
    const ScoreValue* const value = derived.GetVarValue(name);
    Check(value != nullptr, "a derived field has a value");
    out << name << '=' << value->GetDouble() << ' ' << value->GetString() << '\n';
  }
  return out.str();
}

std::string Shown(const TransformationDictionary& derived) {
  std::ostringstream out;
  for (const std::string& name : derived.GetDerivedVarNames()) {
    const auto* field = dynamic_cast<const TransformVar*>(derived.GetVar(name));
    Check(field != nullptr && field->IsDerivedVariable(), "a derived name is a derived field");
    Check(Fields().GetVar(name) == nullptr, "no derived field has a data field's name");
    field->Display(out);
    if (field->GetRoot() != nullptr) field->GetRoot()->Display(out);
  }
  return out.str();
}

void CheckEncoders(const ScoreDictionary& dictionary) {
  for (const ScoreDictVar* variable : dictionary.GetScoreDictVars()) {
    const ScoreEncoder* const encoder = variable->GetEncoder();
    Check(encoder == nullptr || encoder->GetNumberOfCategories() <= variable->GetNumberOfCats(),
          "an encoder knows the listed categories alone");
  }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  try {
    const auto tree = kestrel_test::ReadTree(std::string(reinterpret_cast<const char*>(data), size));
    try {
      const std::unique_ptr<TransformationDictionary> derived(
          PMMLTranslator::HandleTransformationDictionary(tree->GetRoot(), &Fields(), nullptr));
      const std::unique_ptr<TransformationDictionary> copy(derived->Clone());
      Check(Shown(*copy) == Shown(*derived), "a copy shows itself like the original");
      for (const Case& one : kCases)
        Check(Compute(*copy, one) == Compute(*derived, one), "a copy computes like the original");
      CheckEncoders(*derived);
      CheckEncoders(Fields());
    } catch (const KestrelException& fault) {
      kestrel_fuzz::CheckFault(fault);
      Check(fault.GetLine() != 0, "a fault of a derived field has its place");
    }
  } catch (const KestrelException& fault) {
    kestrel_fuzz::CheckFault(fault);
  }
  return 0;
}
