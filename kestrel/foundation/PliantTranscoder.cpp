#include "kestrel/foundation/PliantTranscoder.h"

#include <unicode/ucnv.h>
#include <unicode/utf16.h>
#include <xercesc/util/PlatformUtils.hpp>
#include <xercesc/util/TransService.hpp>
#include <xercesc/util/XMLException.hpp>
#include <xercesc/util/XMLString.hpp>

#include <algorithm>
#include <cstring>

#include "kestrel/foundation/TextConverter.h"

namespace MCXML_800 {

static_assert(sizeof(XMLCh) == sizeof(char16_t), "parser text must be UTF-16");

namespace {

// What the transcoder may be asked for at once.
constexpr XMLSize_t kBlockSize = 4096;
constexpr size_t kMaxBytesPerUnit = 8;

struct Encoding {
  size_t unitBytes = 1;
  /// Whether what a byte means depends on bytes long before it. The parser library's transcoders keep such a
  /// state from call to call and cannot be started anew.
  bool shiftStates = false;
};

Encoding Describe(const char* name) {
  Encoding encoding;
  UErrorCode status = U_ZERO_ERROR;
  UConverter* const converter = ucnv_open(name, &status);
  if (converter == nullptr) return encoding;  // the parser library may know it all the same
  const UConverterType type = ucnv_getType(converter);
  encoding.unitBytes = static_cast<size_t>(ucnv_getMinCharSize(converter));
  encoding.shiftStates = type == UCNV_EBCDIC_STATEFUL || type == UCNV_ISO_2022 || type == UCNV_HZ ||
                         type == UCNV_SCSU || type == UCNV_UTF7 || type == UCNV_BOCU1 ||
                         type == UCNV_IMAP_MAILBOX || type == UCNV_COMPOUND_TEXT;
  ucnv_close(converter);
  return encoding;
}

/// Copies the next units of the text, with U+FFFD for half surrogate pairs and never half a pair at the end:
/// transcoders disagree about such units and may keep them for the next call.
size_t TakeBlock(const XMLCh* text, size_t length, size_t& at, XMLCh* block, size_t room) {
  size_t units = 0;
  while (at < length && units + 1 < room) {
    UChar32 c;
    U16_NEXT(text, at, length, c);
    if (U_IS_SURROGATE(c)) c = 0xFFFD;
    U16_APPEND_UNSAFE(block, units, c);
  }
  return units;
}

XMLCh* NewParserText(const std::u16string& text) {
  const size_t bytes = (text.size() + 1) * sizeof(XMLCh);
  auto* const copy = static_cast<XMLCh*>(xercesc::XMLPlatformUtils::fgMemoryManager->allocate(bytes));
  std::memcpy(copy, text.c_str(), bytes);
  return copy;
}

}  // namespace

PliantTranscoder::PliantTranscoder(const char* encoding) : encoding_(encoding == nullptr ? "" : encoding) {
  xercesc::XMLTransService* const service = xercesc::XMLPlatformUtils::fgTransService;
  if (service == nullptr || encoding_.empty()) return;
  const Encoding described = Describe(encoding);
  if (described.shiftStates) return;
  unit_bytes_ = described.unitBytes;
  xercesc::XMLTransService::Codes result = xercesc::XMLTransService::Ok;
  try {
    transcoder_.reset(service->makeNewTranscoderFor(encoding, result, kBlockSize,
                                                    xercesc::XMLPlatformUtils::fgMemoryManager));
  } catch (const xercesc::XMLException&) {
    // The same as an encoding that is unknown.
  }
  if (result != xercesc::XMLTransService::Ok) transcoder_.reset();
}

PliantTranscoder::~PliantTranscoder() = default;

bool PliantTranscoder::transcodeTo(const XMLCh* text, std::string& out) const {
  return transcodeTo(text, text == nullptr ? 0 : xercesc::XMLString::stringLen(text), out);
}

bool PliantTranscoder::transcodeTo(const XMLCh* text, size_t length, std::string& out) const {
  out.clear();
  if (transcoder_ == nullptr) return false;
  if (text == nullptr) return true;
  constexpr size_t kUnits = 1024;
  XMLCh block[kUnits];
  XMLByte bytes[kUnits * kMaxBytesPerUnit];
  size_t at = 0;
  while (at < length) {
    const size_t units = TakeBlock(text, length, at, block, kUnits);
    size_t done = 0;
    while (done < units) {
      XMLSize_t eaten = 0;
      XMLSize_t written = 0;
      try {
        written = transcoder_->transcodeTo(block + done, units - done, bytes, sizeof bytes, eaten,
                                           xercesc::XMLTranscoder::UnRep_RepChar);
      } catch (const xercesc::XMLException&) {
        out.clear();
        return false;
      }
      out.append(reinterpret_cast<const char*>(bytes), written);
      if (eaten == 0) {
        out.clear();
        return false;
      }
      done += eaten;
    }
  }
  return true;
}

XMLCh* PliantTranscoder::ChangeChar2XML(const char* text) const {
  return text == nullptr ? nullptr : ChangeChar2XML(text, std::strlen(text));
}

XMLCh* PliantTranscoder::ChangeChar2XML(const char* text, size_t length) const {
  if (text == nullptr || transcoder_ == nullptr) return nullptr;
  return NewParserText(Decode(text, length));
}

/// False when the transcoder finds the text malformed and says so, as some do.
bool PliantTranscoder::DecodeWithTranscoder(const char* text, size_t length, std::u16string& out) const {
  if (length % unit_bytes_ != 0) return false;
  XMLCh block[kBlockSize];
  unsigned char sizes[kBlockSize];
  // Units never outnumber the bytes they come from, but for the few bytes that a transcoder kept from before.
  constexpr size_t kMostBytes = kBlockSize - 16;
  const auto* bytes = reinterpret_cast<const XMLByte*>(text);
  try {
    size_t at = 0;
    while (at < length) {
      XMLSize_t eaten = 0;
      const XMLSize_t units = transcoder_->transcodeFrom(bytes + at, std::min(length - at, kMostBytes), block,
                                                         kBlockSize, eaten, sizes);
      if (eaten == 0) return false;
      out.append(reinterpret_cast<const char16_t*>(block), units);
      at += eaten;
    }
    if (unit_bytes_ != 1) return true;
    // A transcoder that waits for the rest of a character gets a zero byte, gives the character up and is
    // ready for the next text.
    const XMLByte zero = 0;
    XMLSize_t eaten = 0;
    const XMLSize_t units = transcoder_->transcodeFrom(&zero, 1, block, kBlockSize, eaten, sizes);
    if (units > 1) out.append(reinterpret_cast<const char16_t*>(block), units - 1);
  } catch (const xercesc::XMLException&) {
    return false;
  }
  return true;
}

std::u16string PliantTranscoder::Decode(const char* text, size_t length) const {
  std::u16string out;
  // U+001A is what some transcoders replace a malformed byte by; rarely it is in the text.
  if (DecodeWithTranscoder(text, length, out) && out.find(u'\x1A') == std::u16string::npos) return out;
  UErrorCode status = U_ZERO_ERROR;
  UConverter* const converter = ucnv_open(encoding_.c_str(), &status);
  if (converter == nullptr) return out + u'\xFFFD';
  out.clear();
  DecodeText(converter, text, length, out);
  ucnv_close(converter);
  return out;
}

}  // namespace MCXML_800
