// The deepest expression that a document may hold is read, computed, copied and deleted on the stacks that
// hosts have.

#include <gtest/gtest.h>

#include <cstddef>
#include <memory>
#include <sstream>
#include <string>

#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/foundation/KestrelException.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/transform/FunctionTree.h"
#include "kestrel/translate/DocumentReader.h"
#include "tests/support/DerivedText.h"
#include "tests/support/HostileDocuments.h"
#include "tests/support/SmallStack.h"

namespace {

using kestrel_test::DerivedFields;
using kestrel_test::ReadDerivedDocument;
using kestrel_test::RunOnStack;
using kestrel_tests::Repeat;
using namespace MCKestrel_800;

// The first leaves each level one kilobyte, beside what lies below the expression.
constexpr std::size_t kStacks[] = {std::size_t{640} << 10, std::size_t{1} << 20, std::size_t{8} << 20};

/// x + 1 + 1 ..., as deep as a document may be: the root, the field and the innermost reference are elements
/// too.
std::size_t Additions() {
  return DocumentLimits().maxDepth - 3;
}

std::string Nested() {
  return kestrel_test::DerivedDocument(kestrel_test::DerivedField(
      kestrel_test::kNumber,
      Repeat("<Apply function='+'><Constant dataType='double'>1</Constant>", Additions()) +
          "<FieldRef field='x'/>" + Repeat("</Apply>", Additions())));
}

TEST(DeepDerivedFields, AreReadComputedCopiedAndDeleted) {
  const std::string document = Nested();
  for (const std::size_t stack : kStacks) {
    RunOnStack(stack, [&] {
      const DerivedFields fields = ReadDerivedDocument(document);
      const std::unique_ptr<TransformationDictionary> copy(fields.derived->Clone());
      std::ostringstream shown;
      fields.Get("d")->Display(shown);
      fields.Get("d")->GetRoot()->Display(shown);
      EXPECT_FALSE(shown.str().empty());
      copy->SetUpDerivedCaseRecord();
      CaseRecord record;
      record.Add("x", new NumericValue(5.0));
      copy->GetValuesForDerivedVars(&record, fields.data.get());
      EXPECT_EQ(copy->GetVarValue("d")->GetDouble(), 5.0 + static_cast<double>(Additions()));
    });
  }
}

// The exception leaves half a tree behind, which is deleted.
TEST(DeepDerivedFields, WithAFaultInTheInnermostAreRefused) {
  std::string document = Nested();
  document.replace(document.rfind("'x'"), 3, "'q'");
  for (const std::size_t stack : kStacks) {
    RunOnStack(stack, [&] {
      try {
        ReadDerivedDocument(document);
        ADD_FAILURE() << "nothing was thrown";
      } catch (const KestrelException& fault) {
        EXPECT_EQ(fault.GetErrorMessage(), "q: not predefined");
      }
    });
  }
}

TEST(DeepDerivedFields, OfOneMoreLevelAreNoDocuments) {
  std::string document = Nested();
  document.insert(document.find("<Apply"), "<Apply function='sqrt'>");
  document.insert(document.rfind("</DerivedField>"), "</Apply>");
  try {
    ReadDerivedDocument(document);
    ADD_FAILURE() << "nothing was thrown";
  } catch (const KestrelException& fault) {
    EXPECT_EQ(fault.GetErrorMessage(), "Invalid XML file!!");
  }
}

}  // namespace
