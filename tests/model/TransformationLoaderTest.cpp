// Loading the dictionaries of a document without a model.

#include <gtest/gtest.h>

#include <memory>
#include <sstream>
#include <string>

#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/foundation/KestrelException.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/model/ModelFactory.h"
#include "kestrel/transform/TransformationDictionary.h"
#include "tests/support/TempFolder.h"

namespace {

using namespace MCKestrel_800;

constexpr char kData[] =
    "<DataDictionary numberOfFields='1'><DataField name='x' optype='continuous' dataType='double'/>"
    "</DataDictionary>";
constexpr char kDerived[] =
    "<TransformationDictionary><DerivedField name='d' optype='continuous' dataType='double'>"
    "<Apply function='*'><FieldRef field='x'/><Constant dataType='double'>2</Constant></Apply></DerivedField>"
    "</TransformationDictionary>";

std::string Document(const std::string& content) {
  return "<PMML version='4.4'><Header/>" + content + "</PMML>";
}

struct Loaded {
  std::unique_ptr<ScoreDictionary> data;
  std::unique_ptr<TransformationDictionary> derived;
};

Loaded Load(const std::string& document) {
  std::istringstream in(document);
  ScoreDictionary* data = nullptr;
  Loaded loaded;
  loaded.derived.reset(ModelFactory::GetTransformationDictionaryFromXML(in, data, "anything"));
  loaded.data.reset(data);
  return loaded;
}

void ExpectTwice(Loaded& loaded, double x) {
  CaseRecord record;
  record.Add("x", new NumericValue(x));
  ASSERT_NE(loaded.derived->GetValuesForDerivedVars(&record, loaded.data.get()), nullptr);
  ASSERT_NE(loaded.derived->GetVarValue("d"), nullptr);
  EXPECT_EQ(loaded.derived->GetVarValue("d")->GetDouble(), 2 * x);
}

TEST(TransformationLoader, GivesFieldsThatComputeAtOnce) {
  Loaded loaded = Load(Document(std::string(kData) + kDerived));
  ASSERT_NE(loaded.data, nullptr);
  EXPECT_NE(loaded.data->GetVar("x"), nullptr);
  ExpectTwice(loaded, 4.0);
}

TEST(TransformationLoader, ReadsDocumentsOfModelsThatItDoesNotKnow) {
  Loaded loaded =
      Load(Document(kData + std::string(kDerived) + "<NoSuchModel><MiningSchema/></NoSuchModel>"));
  ExpectTwice(loaded, -3.0);
}

TEST(TransformationLoader, ReadsFiles) {
  const kestrel_tests::TempFolder folder;
  const std::string path = folder.Write("derived.xml", Document(std::string(kData) + kDerived));
  ScoreDictionary* data = nullptr;
  Loaded loaded;
  loaded.derived.reset(ModelFactory::GetTransformationDictionaryFromXML(path, data, ""));
  loaded.data.reset(data);
  ExpectTwice(loaded, 1.5);
}

TEST(TransformationLoader, GivesAnEmptyDictionaryWhereThereIsNone) {
  for (const char* derived : {"", "<TransformationDictionary/>"}) {
    const Loaded loaded = Load(Document(std::string(kData) + derived));
    ASSERT_NE(loaded.derived, nullptr);
    EXPECT_EQ(loaded.derived->Size(), 0u);
    const CaseRecord record;
    EXPECT_NE(loaded.derived->GetValuesForDerivedVars(&record, loaded.data.get()), nullptr);
  }
}

struct FaultRow {
  const char* why;
  std::string document;
  int code;
  const char* text;
};

TEST(TransformationLoader, SaysWhatIsWrong) {
  const FaultRow rows[] = {
      {"nothing", "", 4, "\nInvalid Input XML document or no dtd file avaible in current directory"},
      {"no element", "<?xml version='1.0'?>", 4,
       "\nInvalid Input XML document or no dtd file avaible in current directory"},
      {"no XML", "hello", 4, "\nInvalid Input XML document or no dtd file avaible in current directory"},
      {"cut off", "<PMML>", 6, "Invalid XML file!!"},
      {"another root", "<TransformationDictionary/>", 5, "Unsupported Model found!"},
      {"a prefix", "<p:PMML>" + std::string(kData) + "</p:PMML>", 5, "Unsupported Model found!"},
      {"no data dictionary", Document(kDerived), 1, "<DataDictionary is required !!"},
      {"an empty data dictionary", Document("<DataDictionary numberOfFields='0'/>"), 1,
       "<DataDictionary is EMPTY!!"},
      {"a field that is not there",
       Document(std::string(kData) +
                "<TransformationDictionary><DerivedField name='d' optype='continuous' dataType='double'>"
                "<FieldRef field='q'/></DerivedField></TransformationDictionary>"),
       8, "q: not predefined"},
  };
  const Loaded before = Load(Document(std::string(kData) + kDerived));
  for (const FaultRow& row : rows) {
    std::istringstream in(row.document);
    ScoreDictionary* data = before.data.get();
    try {
      delete ModelFactory::GetTransformationDictionaryFromXML(in, data, "");
      ADD_FAILURE() << row.why;
    } catch (const KestrelException& fault) {
      EXPECT_EQ(fault.GetErrorCode(), row.code) << row.why;
      EXPECT_EQ(fault.GetErrorMessage(), row.text) << row.why;
      EXPECT_EQ(data, nullptr) << row.why;
    }
  }
}

TEST(TransformationLoader, SaysThatAFileIsNotThere) {
  ScoreDictionary* data = nullptr;
  try {
    delete ModelFactory::GetTransformationDictionaryFromXML(std::string("no such folder/file.xml"), data, "");
    ADD_FAILURE() << "nothing was thrown";
  } catch (const KestrelException& fault) {
    EXPECT_EQ(fault.GetErrorCode(), KestrelException::kFile);
    EXPECT_EQ(fault.GetErrorMessage(), "Could not open model file");
  }
}

}  // namespace
