// Documents from streams of every temper.

#include <gtest/gtest.h>

#include <fstream>
#include <istream>
#include <sstream>
#include <stdexcept>
#include <streambuf>
#include <string>

#include "kestrel/translate/DocumentReader.h"
#include "kestrel/translate/XmlText.h"
#include "tests/support/ExpectFault.h"
#include "tests/support/SystemFiles.h"

namespace {

using kestrel_tests::ExpectFault;
using MCKestrel_800::ReadDocument;

constexpr char kUnreadable[] = "Could not read model file";
constexpr char kInvalid[] = "Invalid XML file!!";
constexpr char kNoRoot[] = "\nInvalid XML document or no dtd file avaible in current directory";

std::string LargeDocument() {
  std::string text = "<a>";
  for (int i = 0; i < 20000; ++i)
    text += "<b c='" + std::to_string(i) + "'/>\n";
  return text + "</a>";
}

size_t CountElements(std::istream& in) {
  const auto document = ReadDocument(in);
  size_t count = 0;
  for (xercesc::DOMElement* child : MCKestrel_800::ChildElements(document->GetRoot())) {
    EXPECT_EQ(MCKestrel_800::AttributeText(child, u"c"), std::to_string(count));
    ++count;
  }
  return count;
}

// Gives `step` bytes at a time, cannot seek, and does something at byte `limit`.
class TrickleBuffer : public std::streambuf {
 public:
  enum class AtLimit { kEnd, kThrow };
  TrickleBuffer(const std::string& text, size_t step, size_t limit = std::string::npos,
                AtLimit atLimit = AtLimit::kEnd)
      : text_(text), step_(step), limit_(std::min(limit, text.size())), throws_(atLimit == AtLimit::kThrow) {}

 protected:
  int_type underflow() override {
    if (position_ >= limit_) {
      if (throws_) throw std::runtime_error("the device is gone");
      return traits_type::eof();
    }
    const size_t count = std::min(step_, limit_ - position_);
    setg(&text_[position_], &text_[position_], &text_[position_] + count);
    position_ += count;
    return traits_type::to_int_type(*gptr());
  }

 private:
  std::string text_;
  size_t step_;
  size_t limit_;
  bool throws_;
  size_t position_ = 0;
};

TEST(DocumentStreams, BytesMayComeInAnyPortion) {
  const std::string text = LargeDocument();
  for (size_t step : {1u, 3u, 7u, 4096u, 100000u}) {
    TrickleBuffer buffer(text, step);
    std::istream in(&buffer);
    EXPECT_EQ(in.tellg(), std::istream::pos_type(-1));
    EXPECT_EQ(CountElements(in), 20000u) << step;
  }
}

TEST(DocumentStreams, SilentEndInTheMiddleIsMalformed) {
  TrickleBuffer buffer(LargeDocument(), 1000, 150000);
  std::istream in(&buffer);
  ExpectFault([&] { ReadDocument(in); }, 6, kInvalid);
}

TEST(DocumentStreams, ThrowingBufferIsUnreadable) {
  const std::string text = LargeDocument();
  for (size_t limit : {size_t{0}, size_t{10}, size_t{150000}, text.size()}) {
    TrickleBuffer buffer(text, 1000, limit, TrickleBuffer::AtLimit::kThrow);
    std::istream in(&buffer);
    ExpectFault([&] { ReadDocument(in); }, 2, kUnreadable, "at byte " + std::to_string(limit));
    EXPECT_TRUE(in.bad());
  }
}

TEST(DocumentStreams, ThrowingBufferAndMaskIsUnreadable) {
  TrickleBuffer buffer(LargeDocument(), 1000, 150000, TrickleBuffer::AtLimit::kThrow);
  std::istream in(&buffer);
  in.exceptions(std::ios_base::badbit);
  ExpectFault([&] { ReadDocument(in); }, 2, kUnreadable);
  EXPECT_EQ(in.exceptions(), std::ios_base::badbit);
}

TEST(DocumentStreams, ExceptionMaskDoesNotCountAndComesBack) {
  const std::ios_base::iostate masks[] = {
      std::ios_base::eofbit, std::ios_base::failbit, std::ios_base::badbit,
      std::ios_base::eofbit | std::ios_base::failbit | std::ios_base::badbit};
  for (const std::ios_base::iostate mask : masks) {
    std::istringstream in("<a/>");
    in.exceptions(mask);
    EXPECT_NO_THROW(ReadDocument(in)) << mask;
    EXPECT_EQ(in.exceptions(), mask);
    std::istringstream broken("<a>");
    broken.exceptions(mask);
    ExpectFault([&] { ReadDocument(broken); }, 6, kInvalid);
    EXPECT_EQ(broken.exceptions(), mask);
  }
}

TEST(DocumentStreams, StreamIsLeftAtItsEnd) {
  std::istringstream in("<a/>\n\n");
  ReadDocument(in);
  EXPECT_TRUE(in.eof());
  EXPECT_FALSE(in.bad());
}

TEST(DocumentStreams, ReadingStartsWhereTheStreamStands) {
  std::istringstream in("skipped<a/>");
  in.ignore(7);
  EXPECT_NO_THROW(ReadDocument(in));
}

TEST(DocumentStreams, StreamsThatGiveNothing) {
  std::ifstream missing("/nonexistent/model.xml");
  ExpectFault([&] { ReadDocument(missing); }, 2, kUnreadable, "a file that is not there");
  std::ifstream directory("/tmp");
  ExpectFault([&] { ReadDocument(directory); }, 2, kUnreadable, "a directory");
  std::istream none(nullptr);
  ExpectFault([&] { ReadDocument(none); }, 2, kUnreadable, "no buffer");
  std::ifstream unopened;
  ExpectFault([&] { ReadDocument(unopened); }, 4, kNoRoot, "never opened");
  std::istringstream atEnd("<a/>");
  atEnd.ignore(100);
  ExpectFault([&] { ReadDocument(atEnd); }, 4, kNoRoot, "read before");
  std::ifstream device(kestrel_tests::NullDevice());
  ExpectFault([&] { ReadDocument(device); }, 4, kNoRoot, "an empty device");
}

TEST(DocumentStreams, EndlessStreamMeetsTheCap) {
  struct Endless : std::streambuf {
    int_type underflow() override {
      setg(zeros, zeros, zeros + sizeof zeros);
      return 0;
    }
    char zeros[4096] = {};
  };
  Endless zeros;
  std::istream zero(&zeros);
  MCKestrel_800::DocumentLimits limits;
  limits.maxInputBytes = size_t{10} << 20;
  ExpectFault([&] { ReadDocument(zero, limits); }, 6, kInvalid);
}

}  // namespace
