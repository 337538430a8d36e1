#include "kestrel/translate/DocumentReader.h"

#include <gtest/gtest.h>

#include <string>
#include <thread>
#include <vector>
#include <xercesc/dom/DOM.hpp>
#include <xercesc/framework/MemBufInputSource.hpp>
#include <xercesc/parsers/XercesDOMParser.hpp>

#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/XmlText.h"
#include "tests/support/ExpectFault.h"
#include "tests/support/HostileDocuments.h"
#include "tests/support/ReadText.h"

namespace {

using kestrel_tests::ExpectFault;
using kestrel_tests::ReadText;
using namespace MCKestrel_800;

constexpr char kInvalid[] = "Invalid XML file!!";
constexpr char kNoRoot[] = "\nInvalid XML document or no dtd file avaible in current directory";

std::string Utf16(const std::u16string& text, bool bigEndian) {
  std::string result;
  for (char16_t c : text) {
    const char high = static_cast<char>(c >> 8), low = static_cast<char>(c & 0xFF);
    result += bigEndian ? high : low;
    result += bigEndian ? low : high;
  }
  return result;
}

struct Row {
  const char* why;
  std::string text;
  int code;  // 0: the document is read
  const char* message;
};

TEST(DocumentReader, GivesTheVerdict) {
  using namespace std::string_literals;
  const Row rows[] = {
      {"the smallest document", "<a/>", 0, ""},
      {"white space around", "\n<a/>\n", 0, ""},
      {"comment and instruction after the root", "<a/><!--x--><?y z?>", 0, ""},
      {"byte order mark", "\xEF\xBB\xBF<a/>", 0, ""},
      {"UTF-16, little end first", Utf16(u"\uFEFF<a b='x'/>", false), 0, ""},
      {"UTF-16, big end first", Utf16(u"\uFEFF<a b='x'/>", true), 0, ""},
      {"UTF-16, large, in several blocks",
       Utf16(u"\uFEFF<a b='" + std::u16string(200000, u'x') + u"'/>", false), 0, ""},
      {"latin-1", "<?xml version='1.0' encoding='ISO-8859-1'?><a b='\xE9'/>", 0, ""},
      {"undeclared prefix, since name spaces are off", "<x:a/>", 0, ""},
      {"nothing", "", 4, kNoRoot},
      {"white space alone", " \n ", 4, kNoRoot},
      {"byte order mark alone", "\xEF\xBB\xBF", 4, kNoRoot},
      {"declaration alone", "<?xml version='1.0'?>", 4, kNoRoot},
      {"no XML", "{\"a\": 1}", 4, kNoRoot},
      {"NUL bytes", std::string(100, '\0'), 4, kNoRoot},
      {"duplicate attribute of the root", "<a b='1' b='2'/>", 4, kNoRoot},
      {"invalid UTF-8 in the root's attribute", "<a b='\xFF'/>", 4, kNoRoot},
      {"unknown encoding", "<?xml version='1.0' encoding='none-such'?><a/>", 4, kNoRoot},
      {"no document at all", "<?xml version='1.0' encoding='" + std::string(100000, 'x') + "'?><a/>", 4,
       "\nInput XML is not parseable into a document"},
      {"root never closed", "<a>", 6, kInvalid},
      {"cut in a child", "<a><b><c", 6, kInvalid},
      {"cut in an attribute", "<a><b c='1", 6, kInvalid},
      {"last byte missing", "<a></a", 6, kInvalid},
      {"end tags crossed", "<a><b></a></b>", 6, kInvalid},
      {"two roots", "<a/><b/>", 6, kInvalid},
      {"text after the root", "<a/>x", 6, kInvalid},
      {"control character", "<a>\x01</a>", 6, kInvalid},
      {"character reference to nothing", "<a>&#0;</a>", 6, kInvalid},
      {"two hyphens in a comment", "<a><!-- -- --></a>", 6, kInvalid},
      {"end of CDATA in text", "<a>]]></a>", 6, kInvalid},
      {"document type inside", "<a><!DOCTYPE a></a>", 6, kInvalid},
      {"undefined entity", "<a>&x;</a>", 6, kInvalid},
      {"bytes that are no UTF-8", "<a>\xFF</a>", 6, kInvalid},
      {"NUL in text", "<a>\0</a>"s, 6, kInvalid},
      {"NUL after the root", "<a/>\0"s, 6, kInvalid},
      {"NUL after the root, then anything", "<a/>\0<<<"s, 6, kInvalid},
      {"NUL after the root in UTF-16", Utf16(u"\uFEFF<a/>\0"s, false), 6, kInvalid},
      {"NUL after the root in UTF-16, big end first", Utf16(u"\uFEFF<a/>\0x"s, true), 6, kInvalid},
      {"fault after a large part", "<a>" + std::string(100000, 'x') + "<b></a>", 6, kInvalid},
  };
  for (const Row& row : rows) {
    if (row.code == 0) {
      EXPECT_NO_THROW(ReadText(row.text)->GetRoot()) << row.why;
    } else {
      ExpectFault([&row] { ReadText(row.text); }, row.code, row.message, row.why);
    }
  }
}

// The parser throws for versions of XML that there are not; its own text is shown.
TEST(DocumentReader, PassesTheTextOfATreeException) {
  try {
    ReadText("<?xml version='1.5'?><a/>");
    FAIL() << "nothing was thrown";
  } catch (const KestrelException& fault) {
    EXPECT_EQ(fault.GetErrorCode(), 6);
    EXPECT_FALSE(fault.GetErrorMessage().empty());
  }
}

TEST(DocumentReader, TellsThePlaceOfTheFirstError) {
  try {
    ReadText("<a>\n <b>\n  <c></b>\n</a>");
    FAIL() << "nothing was thrown";
  } catch (const KestrelException& fault) {
    EXPECT_EQ(fault.GetLine(), 3u);
    EXPECT_GT(fault.GetColumn(), 5u);
  }
}

struct PlaceRow {
  const char* why;
  std::string text;
  unsigned line;
  unsigned column;
};

// Documents in another encoding than they declare are the ones that users meet most.
TEST(DocumentReader, TellsWhereTheTextIsNoUtf8) {
  const std::string blanks(200000, ' ');
  const PlaceRow rows[] = {
      {"first of all", "\xFF<a/>", 1, 1},
      {"in the root", "<a>\n<b x='K\xF6ln'/></a>", 2, 8},
      {"in the root, with a declaration", "<?xml version='1.0' encoding='UTF-8'?>\n<a x='\xE4'/>", 2, 7},
      {"behind a byte order mark", "\xEF\xBB\xBF<a>\xE4</a>", 1, 4},
      {"behind good characters", "<a>\xC3\xB6\xE2\x82\xAC\xF0\x9D\x84\x9E\xE4.</a>", 1, 7},
      {"line ends of Windows", "<a>\r\n\r\n\xE4</a>", 3, 1},
      {"line ends of old", "<a>\r\r\xE4</a>", 3, 1},
      {"longer than need be", "<a>\n\xC0\xAF</a>", 2, 1},
      {"longer than need be, three bytes", "<a>\n\xE0\x9F\xBF</a>", 2, 1},
      {"half a surrogate pair", "<a>\nx\xED\xA0\x80</a>", 2, 2},
      {"past the last character", "<a>\n\xF4\x90\x80\x80</a>", 2, 1},
      {"five bytes", "<a>\n\xF8\x88\x80\x80\x80</a>", 2, 1},
      {"the end of a sequence alone", "<a>\n\x80</a>", 2, 1},
      {"a sequence that is cut", "<a>\n\xC3(</a>", 2, 1},
      {"in a large document", "<a>\n" + blanks + "\n" + blanks + "\n<b x='K\xF6ln'/></a>", 4, 8},
  };
  for (const PlaceRow& row : rows) {
    try {
      ReadText(row.text);
      ADD_FAILURE() << "nothing was thrown: " << row.why;
    } catch (const KestrelException& fault) {
      EXPECT_EQ(fault.GetLine(), row.line) << row.why;
      EXPECT_EQ(fault.GetColumn(), row.column) << row.why;
    }
  }
}

// A character may lie across the blocks that the text is kept in.
TEST(DocumentReader, FindsWhatIsNoUtf8AcrossBlocks) {
  for (size_t shift = 0; shift < 4; ++shift) {
    std::string text = "<a>" + std::string(65536 - 3 - shift, 'x') + "\xF0\x9D\x84\x9E\n\xE4</a>";
    try {
      ReadText(text);
      ADD_FAILURE() << "nothing was thrown: " << shift;
    } catch (const KestrelException& fault) {
      EXPECT_EQ(fault.GetLine(), 2u) << shift;
      EXPECT_EQ(fault.GetColumn(), 1u) << shift;
    }
  }
}

TEST(DocumentReader, RefusesMoreThanTheCap) {
  DocumentLimits limits;
  limits.maxInputBytes = 100;
  std::istringstream fits("<a>" + std::string(93, ' ') + "</a>"),
      large("<a>" + std::string(94, ' ') + "</a>");
  EXPECT_NO_THROW(ReadDocument(fits, limits));
  ExpectFault([&] { ReadDocument(large, limits); }, 6, kInvalid);
}

TEST(DocumentReader, RefusesMoreThanTheQuota) {
  DocumentLimits limits;
  limits.baseMemoryBytes = 1000;  // not even the parser fits
  limits.memoryPerInputByte = 0;
  limits.reserveBytes = 0;
  std::istringstream in("<a/>");
  ExpectFault([&] { ReadDocument(in, limits); }, 6, kInvalid);
}

// Reads a document with everything that takes memory, but for an encoding that needs a converter (whose
// making the parser does not guard; it happens before a document has used up anything), under limits that
// `tighten` sets from 0 upwards, until it is read. Returns how often it was refused before.
template <typename Tighten>
size_t CountRefusals(Tighten tighten) {
  const std::string text =
      "<?xml version='1.0' encoding='ISO-8859-1'?><!DOCTYPE a [<!ENTITY e 'text'><!ATTLIST b c CDATA 'd'>]>"
      "<a><b x='1'>&e;</b>" +
      std::string(50000, 'x') + "</a>";
  for (size_t step = 0;; ++step) {
    DocumentLimits limits;
    limits.reserveBytes = 0;
    limits.reserveAllocations = 0;
    tighten(limits, step);
    std::istringstream in(text);
    try {
      ReadDocument(in, limits);
      return step;
    } catch (const KestrelException& fault) {
      EXPECT_EQ(fault.GetErrorCode(), 6);
      EXPECT_EQ(fault.GetErrorMessage(), kInvalid);
    }
  }
}

// At whatever point of the load a quota is felt, it ends in the refusal and leaks nothing.
TEST(DocumentReader, RefusesAtAnyPoint) {
  EXPECT_GT(CountRefusals([](DocumentLimits& limits, size_t step) {
              limits.baseAllocations = step;
              limits.allocationsPerInputByte = 0;
            }),
            100u);
  EXPECT_GT(CountRefusals([](DocumentLimits& limits, size_t step) {
              limits.baseMemoryBytes = step * 32768;
              limits.memoryPerInputByte = 0;
            }),
            5u);
}

// The parser asks for memory in destructors while it reads declarations; wherever the quota ends among them,
// the load is refused and the process lives.
TEST(DocumentReader, RefusesInTheMiddleOfDeclarations) {
  const std::string text = "<!DOCTYPE a [" +
                           kestrel_tests::Repeat("<!ELEMENT a (b,(c|d)*,e?)><!ATTLIST a b CDATA 'c'>", 300) +
                           "]><a/>";
  size_t step = 0;
  for (;; step += 7) {
    DocumentLimits limits;
    limits.baseAllocations = step;
    limits.allocationsPerInputByte = 0;
    std::istringstream in(text);
    try {
      ReadDocument(in, limits);
      break;
    } catch (const KestrelException& fault) {
      EXPECT_EQ(fault.GetErrorCode(), 6);
    }
  }
  EXPECT_GT(step, 1000u);
}

struct TextRow {
  const char* why;
  const char* document;
  std::vector<std::string> children;  // of the root: "<tag>" or the text
};

std::vector<std::string> ChildrenOf(const xercesc::DOMElement* element) {
  std::vector<std::string> result;
  for (const xercesc::DOMNode* node = element->getFirstChild(); node != nullptr;
       node = node->getNextSibling()) {
    if (node->getNodeType() == xercesc::DOMNode::ELEMENT_NODE) {
      result.push_back("<" + Narrow(node->getNodeName()) + ">");
    } else {
      EXPECT_EQ(node->getNodeType(), xercesc::DOMNode::TEXT_NODE);
      result.push_back(Narrow(node->getNodeValue()));
    }
  }
  return result;
}

TEST(DocumentReader, KeepsTheTextThatCounts) {
  const TextRow rows[] = {
      {"blanks between elements", "<a> <b/>\n\t<c/> </a>", {"<b>", "<c>"}},
      {"blanks alone", "<a> \n </a>", {" \n "}},
      {"nothing", "<a></a>", {}},
      {"blanks beside text", "<a> x </a>", {" x "}},
      {"blanks beside text and elements", "<a> <b/> x <c/> </a>", {"<b>", " x ", "<c>"}},
      {"text before an element", "<a>x <b/></a>", {"x ", "<b>"}},
      {"numbers", "<a>1 2\n3</a>", {"1 2\n3"}},
      {"a comment in the text", "<a>1 <!-- x --> 2</a>", {"1  2"}},
      {"a comment between blanks", "<a> <!-- x --> <b/></a>", {"<b>"}},
      {"an instruction in the text", "<a>1<?x y?>2</a>", {"12"}},
      {"CDATA", "<a>1<![CDATA[<&]]>2</a>", {"1<&2"}},
      {"blanks as CDATA", "<a><![CDATA[ ]]><b/></a>", {" ", "<b>"}},
      {"references", "<a> &amp;&#65; </a>", {" &A "}},
      {"a blank by reference", "<a>&#32;</a>", {" "}},
      {"an entity", "<!DOCTYPE a [<!ENTITY e 'y'>]><a>x&e;z</a>", {"xyz"}},
      {"an entity of elements", "<!DOCTYPE a [<!ENTITY e '<b/><c/>'>]><a>&e;</a>", {"<b>", "<c>"}},
  };
  for (const TextRow& row : rows) {
    const auto document = ReadText(row.document);
    EXPECT_EQ(ChildrenOf(document->GetRoot()), row.children) << row.why;
  }
}

TEST(DocumentReader, KeepsAttributes) {
  const auto document = ReadText("<!DOCTYPE a [<!ATTLIST a z CDATA 'd'>]><a y='2' x='&lt;&#10;1' e=''/>");
  const xercesc::DOMElement* const root = document->GetRoot();
  EXPECT_EQ(AttributeText(root, u"x"), "<\n1");
  EXPECT_EQ(AttributeText(root, u"y"), "2");
  EXPECT_EQ(AttributeText(root, u"z"), "d");
  EXPECT_TRUE(HasAttribute(root, u"e"));
  EXPECT_FALSE(HasAttribute(root, u"f"));
  EXPECT_FALSE(root->getAttributeNode(ToXMLCh(u"z"))->getSpecified());
  EXPECT_TRUE(root->getAttributeNode(ToXMLCh(u"x"))->getSpecified());
  EXPECT_EQ(root->getAttributes()->getLength(), 4u);
}

// What a plug-in may do with a tree that the parser built in its own way works with ours.
TEST(DocumentReader, GivesATreeThatCanBeChanged) {
  const auto document = ReadText("<a x='1'><b/>text<c/></a>");
  xercesc::DOMElement* const root = document->GetRoot();
  root->setAttribute(ToXMLCh(u"x"), ToXMLCh(u"new"));
  EXPECT_EQ(AttributeText(root, u"x"), "new");
  root->getAttributeNode(ToXMLCh(u"x"))->appendChild(document->GetDocument()->createTextNode(ToXMLCh(u"er")));
  EXPECT_EQ(AttributeText(root, u"x"), "newer");
  root->removeAttribute(ToXMLCh(u"x"));
  EXPECT_FALSE(HasAttribute(root, u"x"));
  root->removeChild(root->getFirstChild())->release();
  root->appendChild(document->GetDocument()->createElement(ToXMLCh(u"d")));
  EXPECT_EQ(ChildrenOf(root), (std::vector<std::string>{"text", "<c>", "<d>"}));
  root->insertBefore(root->cloneNode(true), root->getFirstChild());
  EXPECT_EQ(root->getElementsByTagName(ToXMLCh(u"c"))->getLength(), 2u);
}

TEST(DocumentReader, LoadsOnSeveralThreads) {
  std::vector<std::thread> threads;
  for (int t = 0; t < 8; ++t) {
    threads.emplace_back([] {
      for (int i = 0; i < 100; ++i) {
        const auto document = ReadText("<?xml version='1.0' encoding='ISO-8859-2'?><a b='1'>&#65;<c/></a>");
        EXPECT_EQ(AttributeText(document->GetRoot(), u"b"), "1");
        EXPECT_THROW(ReadText("<a><b></a>"), KestrelException);
      }
    });
  }
  for (std::thread& thread : threads)
    thread.join();
}

unsigned LineOf(const xercesc::DOMNode* node) {
  try {
    FailAt(node, KestrelException::kStructure, "x");
  } catch (const KestrelException& fault) {
    return fault.GetLine();
  }
}

TEST(ReaderFault, TellsWhereTheElementStands) {
  const auto document = ReadText("<a>\n <b\n  x='1'>\n  text<c/></b>\n</a>");
  const xercesc::DOMElement* const root = document->GetRoot();
  const xercesc::DOMElement* const b = FirstChild(root);
  EXPECT_EQ(LineOf(root), 1u);
  EXPECT_EQ(LineOf(b), 3u);
  EXPECT_EQ(LineOf(b->getFirstChild()), 3u) << "a text stands in its element";
  EXPECT_EQ(LineOf(b->getAttributeNode(ToXMLCh(u"x"))), 3u) << "and so does an attribute";
  EXPECT_EQ(LineOf(b->getLastChild()), 4u);
  EXPECT_EQ(LineOf(document->GetDocument()), 0u);
  EXPECT_EQ(LineOf(nullptr), 0u);
}

TEST(ReaderFault, KnowsNoPlaceInAForeignTree) {
  xercesc::XercesDOMParser parser;
  const xercesc::MemBufInputSource source(reinterpret_cast<const XMLByte*>("<a/>"), 4, "text");
  parser.parse(source);
  EXPECT_EQ(LineOf(parser.getDocument()->getDocumentElement()), 0u);
}

TEST(ReaderFault, PutsTheFieldInFront) {
  const auto document = ReadText("<a>\n<b/></a>");
  ExpectFault([] { Fail(KestrelException::kFile, "text"); }, 2, "text");
  ExpectFault(
      [&] { FailOnField(FirstChild(document->GetRoot()), KestrelException::kUnsupported, "age", ": no"); }, 5,
      "age: no");
}

}  // namespace
