#include "kestrel/translate/DOMElemUtility.h"

#include <gtest/gtest.h>

#include <functional>
#include <iterator>
#include <memory>
#include <string>
#include <xercesc/dom/DOM.hpp>

#include "kestrel/foundation/PliantTranscoder.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "kestrel/translate/XmlText.h"
#include "tests/support/ExpectFault.h"
#include "tests/support/ReadText.h"

namespace {

using kestrel_tests::ExpectFault;
using kestrel_tests::ReadText;
using namespace MCKestrel_800;

class PlainTranslator : public PMMLTranslator {
 public:
  using PMMLTranslator::ParseFromTree;
  ScoreModel* ParseFromTree(xercesc::DOMElement*, const std::string&) override { return nullptr; }
};

class DOMElemUtilityTest : public testing::Test {
 protected:
  DOMElemUtilityTest()
      : document_(ReadText(
            "<a int='12' real='1.5' text='\xC3\xA4' bad='x'><b n='0'/>\n<c bad='x'><b n='1'/></c></a>")),
        root_(document_->GetRoot()),
        utility_(&translator_, nullptr),
        unbound_(nullptr, nullptr) {}
  PlainTranslator translator_;
  std::unique_ptr<ParsedDocument> document_;
  xercesc::DOMElement* root_;
  DOMElemUtility utility_;
  DOMElemUtility unbound_;
};

TEST_F(DOMElemUtilityTest, ListsDescendants) {
  ASSERT_NE(utility_.GetDOMNodeList(root_, "b", false), nullptr);
  EXPECT_EQ(utility_.GetDOMNodeList(root_, "b", true)->getLength(), 2u);
  for (bool forced : {false, true}) {
    EXPECT_EQ(utility_.GetDOMNodeList(nullptr, "b", forced), nullptr);
    EXPECT_EQ(utility_.GetDOMNodeList(root_, "", forced), nullptr);
  }
  EXPECT_EQ(utility_.GetDOMNodeList(root_, "z", false), nullptr);
  ExpectFault([&] { utility_.GetDOMNodeList(root_, "z", true); }, 4, "Node is missing --- z ---");
}

TEST_F(DOMElemUtilityTest, PicksAndCountsDescendants) {
  EXPECT_EQ(AttributeText(utility_.GetElemFromNodeList(root_, "b", 1, true), u"n"), "1");
  EXPECT_EQ(utility_.GetElemFromNodeList(root_, "b", 2, false), nullptr);
  ExpectFault([&] { utility_.GetElemFromNodeList(root_, "b", 2, true); }, 4, "Node is missing --- b ---");
  EXPECT_EQ(utility_.GetNodeListLength(root_, "b", false), 2u);
  EXPECT_EQ(utility_.GetNodeListLength(root_, "z", false), 0u);
  ExpectFault([&] { utility_.GetNodeListLength(root_, "z", true); }, 4, "Node is missing --- z ---");
  for (bool forced : {false, true}) {
    EXPECT_EQ(unbound_.GetElemFromNodeList(root_, "b", 0, forced), nullptr);
    EXPECT_EQ(utility_.GetElemFromNodeList(nullptr, "b", 0, forced), nullptr);
    EXPECT_EQ(utility_.GetElemFromNodeList(root_, "", 0, forced), nullptr);
    EXPECT_EQ(unbound_.GetNodeListLength(root_, "b", forced), 0u);
    EXPECT_EQ(utility_.GetNodeListLength(nullptr, "b", forced), 0u);
    EXPECT_EQ(utility_.GetNodeListLength(root_, "", forced), 0u);
  }
}

TEST_F(DOMElemUtilityTest, ReadsNumbers) {
  for (bool forced : {false, true}) {
    EXPECT_EQ(utility_.GetAttributeToInt(root_, "int", forced), 12);
    EXPECT_EQ(utility_.GetAttributeToDouble(root_, "real", forced), 1.5);
    EXPECT_EQ(utility_.GetAttributeToInt(nullptr, "int", forced), -1);
    EXPECT_EQ(utility_.GetAttributeToInt(root_, "", forced), -1);
    EXPECT_EQ(unbound_.GetAttributeToInt(root_, "int", forced), -1);
    EXPECT_EQ(utility_.GetAttributeToDouble(nullptr, "real", forced), 0.0);
    EXPECT_EQ(utility_.GetAttributeToDouble(root_, "", forced), 0.0);
    EXPECT_EQ(unbound_.GetAttributeToDouble(root_, "real", forced), 0.0);
    ExpectFault([&] { utility_.GetAttributeToInt(root_, "bad", forced); }, 3, "xInvalid integer string -- ");
    ExpectFault([&] { utility_.GetAttributeToDouble(root_, "bad", forced); }, 3,
                "xInvalid double string -- ");
  }
  ExpectFault([&] { utility_.GetAttributeToInt(root_, "z", false); }, 3, "Invalid integer string -- ");
  ExpectFault([&] { utility_.GetAttributeToDouble(root_, "z", false); }, 3, "Invalid double string -- ");
  ExpectFault([&] { utility_.GetAttributeToInt(root_, "z", true); }, 4,
              "Attribute z is missing from Node \"a\"");
  ExpectFault([&] { utility_.GetAttributeToDouble(root_, "z", true); }, 4,
              "Attribute z is missing from Node \"a\"");
}

TEST_F(DOMElemUtilityTest, ReadsTexts) {
  EXPECT_EQ(utility_.GetAttributeToString(root_, "text", false), "\xC3\xA4");
  MCXML_800::PliantTranscoder latin("ISO-8859-1");
  EXPECT_EQ(DOMElemUtility(&translator_, &latin).GetAttributeToString(root_, "text", true), "\xE4");
  EXPECT_EQ(DOMElemUtility(&translator_, &latin).GetAttributeToString(root_, "z", false), "");
  EXPECT_EQ(utility_.GetAttributeToString(root_, "z", false), "");
  EXPECT_EQ(utility_.GetAttributeToString(nullptr, "text", true), "");
  EXPECT_EQ(utility_.GetAttributeToString(root_, "", true), "");
  ExpectFault([&] { utility_.GetAttributeToString(root_, "z", true); }, 4,
              "Attribute z is missing from Node \"a\"");
}

TEST_F(DOMElemUtilityTest, FindsAChild) {
  for (bool forced : {false, true}) {
    EXPECT_EQ(AttributeText(utility_.GetChildElemByName(root_, "b", forced), u"n"), "0");
    EXPECT_EQ(utility_.GetChildElemByName(nullptr, "b", forced), nullptr);
    EXPECT_EQ(utility_.GetChildElemByName(root_, "", forced), nullptr);
  }
  EXPECT_EQ(utility_.GetChildElemByName(root_, "z", false), nullptr);
  ExpectFault([&] { utility_.GetChildElemByName(root_, "z", true); }, 4, "Node is missing --- z ---");
}

TEST_F(DOMElemUtilityTest, FaultsHaveTheElementsPlace) {
  xercesc::DOMElement* const c = FirstChild(root_, u"c");
  const std::function<void()> actions[] = {
      [&] { utility_.GetChildElemByName(c, "z", true); },
      [&] { utility_.GetDOMNodeList(c, "z", true); },
      [&] { utility_.GetElemFromNodeList(c, "b", 7, true); },
      [&] { utility_.GetNodeListLength(c, "z", true); },
      [&] { utility_.GetAttributeToString(c, "z", true); },
      [&] { utility_.GetAttributeToInt(c, "z", true); },
      [&] { utility_.GetAttributeToInt(c, "z", false); },
      [&] { utility_.GetAttributeToInt(c, "bad", false); },
      [&] { utility_.GetAttributeToDouble(c, "bad", false); },
  };
  for (size_t i = 0; i < std::size(actions); ++i) {
    try {
      actions[i]();
      ADD_FAILURE() << "nothing was thrown by " << i;
    } catch (const KestrelException& fault) {
      EXPECT_EQ(fault.GetLine(), 2u) << i;
      EXPECT_GT(fault.GetColumn(), 0u) << i;
    }
  }
}

}  // namespace
