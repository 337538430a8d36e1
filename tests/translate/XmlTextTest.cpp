#include "kestrel/translate/XmlText.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "tests/support/ReadText.h"

namespace {

using kestrel_tests::ReadText;
using namespace MCKestrel_800;

TEST(XmlText, ComparesWithoutTranscoding) {
  EXPECT_TRUE(Equals(ToXMLCh(u"PMML"), u"PMML"));
  EXPECT_TRUE(Equals(ToXMLCh(u""), u""));
  EXPECT_TRUE(Equals(nullptr, u""));
  EXPECT_TRUE(Equals(ToXMLCh(u"\u00E4\U0001F600"), u"\u00E4\U0001F600"));
  EXPECT_FALSE(Equals(nullptr, u"x"));
  EXPECT_FALSE(Equals(ToXMLCh(u"PMML"), u"PMM"));
  EXPECT_FALSE(Equals(ToXMLCh(u"PMM"), u"PMML"));
  EXPECT_FALSE(Equals(ToXMLCh(u"pmml"), u"PMML"));
  EXPECT_TRUE(IsEmpty(nullptr));
  EXPECT_TRUE(IsEmpty(ToXMLCh(u"")));
  EXPECT_FALSE(IsEmpty(ToXMLCh(u" ")));
}

TEST(XmlText, NarrowsToUtf8) {
  EXPECT_EQ(Narrow(nullptr), "");
  EXPECT_EQ(Narrow(ToXMLCh(u"plain")), "plain");
  EXPECT_EQ(Narrow(ToXMLCh(u"\u00E4\u20AC\U0001F600")), "\xC3\xA4\xE2\x82\xAC\xF0\x9F\x98\x80");
}

TEST(XmlText, FindsAttributes) {
  const auto document = ReadText("<a x='1' y=''/>");
  const xercesc::DOMElement* const root = document->GetRoot();
  EXPECT_TRUE(Equals(Attribute(root, u"x"), u"1"));
  EXPECT_TRUE(Equals(Attribute(root, u"z"), u""));
  EXPECT_NE(Attribute(root, u"z"), nullptr);
  EXPECT_NE(Attribute(nullptr, u"z"), nullptr);
  EXPECT_NE(FindAttribute(root, u"y"), nullptr);
  EXPECT_EQ(FindAttribute(root, u"z"), nullptr);
  EXPECT_EQ(FindAttribute(nullptr, u"z"), nullptr);
  EXPECT_TRUE(HasAttribute(root, u"y"));
  EXPECT_FALSE(HasAttribute(root, u"z"));
  EXPECT_EQ(AttributeText(root, u"x"), "1");
  EXPECT_EQ(AttributeText(nullptr, u"x"), "");
}

std::string Tags(const ChildElements& children) {
  std::string result;
  for (const xercesc::DOMElement* child : children)
    result += Narrow(child->getTagName()) + " ";
  return result;
}

TEST(XmlText, WalksChildElements) {
  const auto document = ReadText("<a>x<b/>y<c><b/></c><b/><!-- z --></a>");
  const xercesc::DOMElement* const root = document->GetRoot();
  EXPECT_EQ(Tags(ChildElements(root)), "b c b ");
  EXPECT_EQ(Tags(ChildElements(root, u"b")), "b b ");
  EXPECT_EQ(Tags(ChildElements(root, u"d")), "");
  EXPECT_EQ(Tags(ChildElements(nullptr)), "");
  EXPECT_EQ(Tags(ChildElements(FirstChild(root))), "");
  EXPECT_TRUE(ElementIs(FirstChild(root), u"b"));
  EXPECT_FALSE(ElementIs(root->getFirstChild(), u"b")) << "a text";
  EXPECT_FALSE(ElementIs(nullptr, u"b"));
  EXPECT_EQ(NextSibling(nullptr), nullptr);
  EXPECT_TRUE(ElementIs(NextSibling(FirstChild(root)), u"c"));
  EXPECT_EQ(NextSibling(FirstChild(root, u"c"), u"c"), nullptr);
}

TEST(XmlText, FindsDescendantsInDocumentOrder) {
  const auto document = ReadText("<a><b><c x='1'/></b><c x='2'/><d><e/></d></a>");
  xercesc::DOMElement* const root = document->GetRoot();
  EXPECT_EQ(AttributeText(FirstDescendant(root, u"c"), u"x"), "1");
  EXPECT_NE(FirstDescendant(root, u"e"), nullptr);
  EXPECT_EQ(FirstDescendant(root, u"a"), nullptr) << "not the element itself";
  EXPECT_EQ(FirstDescendant(FirstChild(root, u"b"), u"e"), nullptr) << "not beside the element";
  EXPECT_EQ(FirstDescendant(nullptr, u"a"), nullptr);
  EXPECT_EQ(NextInTree(nullptr, nullptr), nullptr);
}

TEST(XmlText, JoinsTheTextOfAllDescendants) {
  const auto document = ReadText("<a>1 <b>2<!-- x --> <c/>3</b><![CDATA[ 4]]>\xC3\xA4<d/></a>");
  const xercesc::DOMElement* const root = document->GetRoot();
  EXPECT_EQ(ElementText(root), u"1 2 3 4\u00E4");
  EXPECT_EQ(ElementNarrowText(root), "1 2 3 4\xC3\xA4");
  EXPECT_EQ(ElementNarrowText(FirstChild(root)), "2 3") << "nothing beside the element";
  EXPECT_EQ(ElementNarrowText(FirstChild(root, u"d")), "");
  EXPECT_EQ(ElementNarrowText(nullptr), "");
}

}  // namespace
