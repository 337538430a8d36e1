// Derived fields broken in every small way: reading them gives fields that compute, or a KestrelException,
// never anything else.

#include <gtest/gtest.h>

#include <exception>
#include <map>
#include <memory>
#include <sstream>
#include <string>
#include <vector>

#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/KestrelException.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "tests/support/DerivedText.h"
#include "tests/support/RichDerived.h"
#include "tests/support/XmlMutants.h"

namespace {

using kestrel_test::DerivedFields;
using kestrel_test::kRichDerived;
using kestrel_test::Mutant;
using kestrel_test::ReadDerivedDocument;
using namespace MCKestrel_800;

/// What the fields are for a case, as text.
std::string Computed(TransformationDictionary& derived, const ScoreDictionary& data, double x,
                     const std::string& color) {
  CaseRecord record;
  record.Add("x", new NumericValue(x));
  record.Add("y", new NumericValue(3.0));
  record.Add("code", new NumericValue(2.0));
  record.Add("color", new StringValue(color));
  record.Add("free", new StringValue("a"));
  record.Add("born", new DateTimeValue("2001-01-01", kDate));
  derived.SetUpDerivedCaseRecord();
  derived.GetValuesForDerivedVars(&record, &data);
  std::string values;
  for (const std::string& name : derived.GetDerivedVarNames()) {
    const ScoreValue* const value = derived.GetVarValue(name);
    values += name + "=" + (value != nullptr ? value->GetString() : "none") + " ";
  }
  return values;
}

/// Computes the fields, and those of a copy, which must be the same.
void ExpectInOrder(const DerivedFields& fields, const std::string& why) {
  const std::unique_ptr<TransformationDictionary> copy(fields.derived->Clone());
  for (const std::string& name : fields.derived->GetDerivedVarNames()) {
    std::ostringstream shown, copy_shown;
    fields.Get(name)->Display(shown);
    copy->GetVar(name)->Display(copy_shown);
    EXPECT_EQ(shown.str(), copy_shown.str()) << why;
  }
  for (const double x : {5.0, 99.0, -1e300}) {
    for (const char* color : {"red", "", "pink"})
      EXPECT_EQ(Computed(*fields.derived, *fields.data, x, color), Computed(*copy, *fields.data, x, color))
          << why;
  }
}

/// Reads every mutant; returns how often each code came out, 0 for what was read.
std::map<int, size_t> ReadAll(const std::vector<Mutant>& mutants) {
  std::map<int, size_t> codes;
  for (const Mutant& mutant : mutants) {
    try {
      ExpectInOrder(ReadDerivedDocument(mutant.document), mutant.why);
      ++codes[0];
    } catch (const KestrelException& fault) {
      EXPECT_FALSE(fault.GetErrorMessage().empty()) << mutant.why;
      EXPECT_GT(fault.GetErrorCode(), 0) << mutant.why;
      EXPECT_NE(fault.GetLine(), 0u) << mutant.why;
      ++codes[fault.GetErrorCode()];
    } catch (const std::exception& other) {
      ADD_FAILURE() << mutant.why << ": " << other.what();
    }
  }
  return codes;
}

void ExpectCodes(const std::map<int, size_t>& codes, const std::vector<int>& expected) {
  for (const int code : expected)
    EXPECT_TRUE(codes.count(code)) << code;
}

TEST(BrokenDerivedFields, AreGoodBeforeTheyAreBroken) {
  EXPECT_EQ(ReadAll({{"whole", kRichDerived}}), (std::map<int, size_t>{{0, 1}}));
  const DerivedFields fields = ReadDerivedDocument(kRichDerived);
  EXPECT_EQ(
      Computed(*fields.derived, *fields.data, 20.0, "red"),
      "five=5 same=20 norm=2 isred=1 band=adult copied=3 price=2 due=Undefined named=a total=23 chosen=ed "
      "tamed=3 filled=red years=1.00205 ");
}

TEST(BrokenDerivedFields, CutOffAreNoDocuments) {
  for (const auto& [code, count] : ReadAll(kestrel_test::Truncated(kRichDerived, 31)))
    EXPECT_TRUE(code == 4 || code == 6) << code << " came " << count << " times";
}

TEST(BrokenDerivedFields, WithBrokenAttributesAreReadOrRefused) {
  ExpectCodes(ReadAll(kestrel_test::WithBrokenAttributes(kRichDerived, 1)), {0, 1, 3, 4, 5, 6, 8, 11});
}

TEST(BrokenDerivedFields, WithBrokenElementsAreReadOrRefused) {
  ExpectCodes(ReadAll(kestrel_test::WithBrokenElements(kRichDerived, 1)), {0, 1, 5, 6});
}

TEST(BrokenDerivedFields, WithAttributesOfOthersAreReadOrRefused) {
  const std::string text = kRichDerived;
  const kestrel_test::XmlMap map(text);
  std::vector<Mutant> mutants;
  // Every attribute with every ninth other one, beginning at another place each time.
  for (size_t i = 0; i < map.Attributes().size(); ++i) {
    for (size_t k = i % 9; k < map.Attributes().size(); k += 9) {
      const auto& attribute = map.Attributes()[i];
      const auto& other = map.Attributes()[k];
      std::string changed = text;
      changed.replace(attribute.valueStart, attribute.valueEnd - attribute.valueStart,
                      text.substr(other.valueStart, other.valueEnd - other.valueStart));
      mutants.push_back({attribute.name + " at byte " + std::to_string(attribute.start) + " as " +
                             other.name + " at byte " + std::to_string(other.start),
                         changed});
    }
  }
  ExpectCodes(ReadAll(mutants), {0, 1, 3, 5, 6, 8, 11});
}

}  // namespace
