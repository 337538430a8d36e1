#include "kestrel/translate/MCXInputSource.h"

#include <gtest/gtest.h>

#include <istream>
#include <memory>
#include <sstream>
#include <stdexcept>
#include <streambuf>
#include <string>
#include <xercesc/parsers/XercesDOMParser.hpp>
#include <xercesc/util/BinInputStream.hpp>

#include "kestrel/translate/ParserPlatform.h"
#include "kestrel/translate/XmlText.h"

namespace {

using MCXML_800::MCXInputSource;

class MCXInputSourceTest : public testing::Test {
 protected:
  void SetUp() override { MCKestrel_800::RequireParser(); }
};

std::string ReadAll(xercesc::BinInputStream& stream, XMLSize_t step) {
  std::string result;
  std::string buffer(step, '\0');
  while (const XMLSize_t count = stream.readBytes(reinterpret_cast<XMLByte*>(&buffer[0]), step)) {
    result.append(buffer, 0, count);
  }
  return result;
}

TEST_F(MCXInputSourceTest, IsCalledIstream) {
  std::istringstream in("x");
  const MCXInputSource source(in);
  EXPECT_TRUE(MCKestrel_800::Equals(source.getSystemId(), u"istream"));
}

TEST_F(MCXInputSourceTest, ReadsWhatTheStreamGives) {
  std::istringstream in("0123456789");
  const MCXInputSource source(in);
  const std::unique_ptr<xercesc::BinInputStream> stream(source.makeStream());
  XMLByte buffer[4];
  EXPECT_EQ(stream->curPos(), 0u);
  EXPECT_EQ(stream->readBytes(buffer, 4), 4u);
  EXPECT_EQ(std::string(buffer, buffer + 4), "0123");
  EXPECT_EQ(stream->curPos(), 4u);
  EXPECT_EQ(ReadAll(*stream, 4), "456789");
  EXPECT_EQ(stream->readBytes(buffer, 4), 0u);
  EXPECT_EQ(stream->curPos(), static_cast<XMLFilePos>(-1)) << "what a stream past its end tells";
  EXPECT_EQ(stream->getContentType(), nullptr);
}

TEST_F(MCXInputSourceTest, ItsStreamsShareOneStream) {
  std::istringstream in("0123456789");
  const MCXInputSource source(in);
  const std::unique_ptr<xercesc::BinInputStream> first(source.makeStream()), second(source.makeStream());
  XMLByte buffer[4];
  first->readBytes(buffer, 4);
  EXPECT_EQ(second->curPos(), 4u);
}

// Gives its text byte by byte, then throws; cannot seek.
class ThrowingBuffer : public std::streambuf {
 public:
  explicit ThrowingBuffer(const std::string& text) : text_(text) {}

 protected:
  int_type underflow() override {
    if (position_ == text_.size()) throw std::runtime_error("the device is gone");
    setg(&text_[position_], &text_[position_], &text_[position_] + 1);
    ++position_;
    return traits_type::to_int_type(*gptr());
  }

 private:
  std::string text_;
  size_t position_ = 0;
};

TEST_F(MCXInputSourceTest, NothingFliesOutOfAStream) {
  ThrowingBuffer buffer("<a/>");
  std::istream in(&buffer);
  in.exceptions(std::ios_base::badbit | std::ios_base::failbit | std::ios_base::eofbit);
  const MCXInputSource source(in);
  const std::unique_ptr<xercesc::BinInputStream> stream(source.makeStream());
  EXPECT_EQ(stream->curPos(), static_cast<XMLFilePos>(-1));
  std::string text;
  EXPECT_NO_THROW(text = ReadAll(*stream, 1));
  EXPECT_TRUE(in.fail());
}

TEST_F(MCXInputSourceTest, FeedsAParser) {
  std::istringstream in("<a b='1'/>");
  in.exceptions(std::ios_base::failbit | std::ios_base::eofbit);
  xercesc::XercesDOMParser parser;
  parser.parse(MCXInputSource(in));
  EXPECT_EQ(parser.getErrorCount(), 0u);
  EXPECT_EQ(MCKestrel_800::AttributeText(parser.getDocument()->getDocumentElement(), u"b"), "1");
}

TEST_F(MCXInputSourceTest, FailureInTheMiddleEndsTheDocument) {
  ThrowingBuffer buffer("<a><b/>");
  std::istream in(&buffer);
  xercesc::XercesDOMParser parser;
  parser.parse(MCXInputSource(in));
  EXPECT_GT(parser.getErrorCount(), 0u);
  EXPECT_TRUE(in.bad());
}

}  // namespace
