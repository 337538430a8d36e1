#include "kestrel/foundation/MultibyteConversions.h"

#include <algorithm>
#include <cstring>
#include <memory>

#include "kestrel/foundation/MultibyteText.h"
#include "kestrel/foundation/TextConverter.h"
#include "kestrel/foundation/Utf8Text.h"

namespace MCXML_800 {

namespace {

/// One side of a conversion: UTF-8, or what a converter stands for (null: the default).
struct Side {
  bool utf8;
  UConverter* converter;
};
constexpr Side kUtf8{true, nullptr};
Side Generic() {
  return {false, nullptr};
}
Side Of(UConverter* converter) {
  return {false, converter};
}

int Decode(Side from, const char* text, size_t length, std::u16string& out) {
  if (!from.utf8) return DecodeText(from.converter, text, length, out);
  return AppendUtf8AsUtf16(text, length, out) ? kVEXAMBOk : kVEXAMBSubstituted;
}

int Encode(Side to, const char16_t* text, size_t length, std::string& out) {
  if (!to.utf8) return EncodeText(to.converter, text, length, out);
  return AppendUtf16AsUtf8(text, length, out) ? kVEXAMBOk : kVEXAMBSubstituted;
}

int Convert(Side from, Side to, const char* text, size_t length, std::string& out) {
  std::u16string wide;
  const int decoded = Decode(from, text, length, wide);
  std::string narrow;
  const int encoded = Encode(to, wide.data(), wide.size(), narrow);
  out = std::move(narrow);
  return std::max(decoded, encoded);
}

int Convert(Side from, Side to, const std::string& text, std::string& out) {
  return Convert(from, to, text.data(), text.size(), out);
}

/// unsigned short and char16_t have the same values but are not the same type, and may not be read as each
/// other.
std::u16string ToChar16(const unsigned short* text, size_t length) {
  return std::u16string(text, text + length);
}

int FromU16(Side to, const std::u16string& text, std::string& out) {
  std::string narrow;
  const int status = Encode(to, text.data(), text.size(), narrow);
  out = std::move(narrow);
  return status;
}

int ToU16(Side from, const std::string& text, std::u16string& out) {
  std::u16string wide;
  const int status = Decode(from, text.data(), text.size(), wide);
  out = std::move(wide);
  return status;
}

template <class Unit>
bool FindLength(const Unit* text, size_t& length) {
  if (text == nullptr) {
    if (length == kVEXAMBTerminated) length = 0;
    return length == 0;
  }
  if (length == kVEXAMBTerminated) length = std::char_traits<Unit>::length(text);
  return true;
}

/// Hands a whole result to a buffer. `cut` is the number of units, before `size`, that make whole characters.
template <class Unit, class Text, class Cut>
int Deliver(int status, const Text& result, Unit* out, size_t size, size_t* outLength, Cut cut) {
  if (out == nullptr || size == 0) {
    if (outLength != nullptr) *outLength = result.size();
    return kVEXAMBBufferTooSmall;
  }
  const bool fits = result.size() < size;
  const size_t length = fits ? result.size() : cut(result, size - 1);
  std::copy_n(result.data(), length, out);
  out[length] = 0;
  if (outLength != nullptr) *outLength = length;
  return fits ? status : kVEXAMBBufferTooSmall;
}

int Refuse(size_t* outLength) {
  if (outLength != nullptr) *outLength = 0;
  return kVEXAMBBadArgument;
}

int DeliverNarrow(int status, Side to, const std::string& result, char* out, size_t size, size_t* outLength) {
  return Deliver(status, result, out, size, outLength, [to](const std::string& text, size_t most) {
    return to.utf8 ? VEXAMBFindStart_8(text.data(), text.size(), most)
                   : VEXAMBFindStart_A(to.converter, text.data(), text.size(), most);
  });
}

int ConvertBuffer(Side from, Side to, const char* text, size_t length, char* out, size_t size,
                  size_t* outLength) {
  if (out != nullptr && size > 0) *out = 0;
  if (!FindLength(text, length)) return Refuse(outLength);
  std::string result;
  const int status = Convert(from, to, text, length, result);
  return DeliverNarrow(status, to, result, out, size, outLength);
}

}  // namespace

int VEXAMBCodePageToGeneric(UConverter* codePage, const std::string& text, std::string& out) {
  return Convert(Of(codePage), Generic(), text, out);
}
int VEXAMBGenericToCodePage(UConverter* codePage, const std::string& text, std::string& out) {
  return Convert(Generic(), Of(codePage), text, out);
}

int VEXAMBU8ToGeneric(UConverter* generic, const std::string& text, std::string& out) {
  return Convert(kUtf8, Of(generic), text, out);
}
int VEXAMBU8ToGeneric(const std::string& text, std::string& out) {
  return VEXAMBU8ToGeneric(nullptr, text, out);
}
int VEXAMBGenericToU8(UConverter* generic, const std::string& text, std::string& out) {
  return Convert(Of(generic), kUtf8, text, out);
}
int VEXAMBGenericToU8(const std::string& text, std::string& out) {
  return VEXAMBGenericToU8(nullptr, text, out);
}

int VEXAMBU16ToGeneric(UConverter* generic, const VEXAMBU16String& text, std::string& out) {
  return FromU16(Of(generic), ToChar16(text.data(), text.size()), out);
}
int VEXAMBU16ToGeneric(UConverter* generic, const std::u16string& text, std::string& out) {
  return FromU16(Of(generic), text, out);
}
int VEXAMBU16ToGeneric(const VEXAMBU16String& text, std::string& out) {
  return VEXAMBU16ToGeneric(nullptr, text, out);
}
int VEXAMBU16ToGeneric(const std::u16string& text, std::string& out) {
  return VEXAMBU16ToGeneric(nullptr, text, out);
}
int VEXAMBGenericToU16(UConverter* generic, const std::string& text, VEXAMBU16String& out) {
  std::u16string wide;
  const int status = ToU16(Of(generic), text, wide);
  out.assign(wide.begin(), wide.end());
  return status;
}
int VEXAMBGenericToU16(UConverter* generic, const std::string& text, std::u16string& out) {
  return ToU16(Of(generic), text, out);
}
int VEXAMBGenericToU16(const std::string& text, VEXAMBU16String& out) {
  return VEXAMBGenericToU16(nullptr, text, out);
}
int VEXAMBGenericToU16(const std::string& text, std::u16string& out) {
  return VEXAMBGenericToU16(nullptr, text, out);
}

int VEXAMBU8ToCodePage(UConverter* codePage, const std::string& text, std::string& out) {
  return Convert(kUtf8, Of(codePage), text, out);
}

int VEXAMBCodePagetoGeneric(UConverter* codePage, const char* text, size_t length, char* out, size_t size,
                            size_t* outLength) {
  return ConvertBuffer(Of(codePage), Generic(), text, length, out, size, outLength);
}
int VEXAMBGenerictoCodePage(UConverter* codePage, const char* text, size_t length, char* out, size_t size,
                            size_t* outLength) {
  return ConvertBuffer(Generic(), Of(codePage), text, length, out, size, outLength);
}
int VEXAMBGenericto8(UConverter* generic, const char* text, size_t length, char* out, size_t size,
                     size_t* outLength) {
  return ConvertBuffer(Of(generic), kUtf8, text, length, out, size, outLength);
}
int VEXAMB8toGeneric(UConverter* generic, const char* text, size_t length, char* out, size_t size,
                     size_t* outLength) {
  return ConvertBuffer(kUtf8, Of(generic), text, length, out, size, outLength);
}
int VEXAMBU8ToCodePage(UConverter* codePage, const char* text, size_t length, char* out, size_t size,
                       size_t* outLength) {
  return ConvertBuffer(kUtf8, Of(codePage), text, length, out, size, outLength);
}

int VEXAMBGenericto16(UConverter* generic, const char* text, size_t length, unsigned short* out, size_t size,
                      size_t* outLength) {
  if (out != nullptr && size > 0) *out = 0;
  if (!FindLength(text, length)) return Refuse(outLength);
  std::u16string result;
  const int status = Decode(Of(generic), text, length, result);
  return Deliver(status, result, out, size, outLength, [](const std::u16string& whole, size_t most) {
    // All pairs in the result are whole, so a second unit behind the cut has its first before it.
    const bool splits = most > 0 && whole[most] >= 0xDC00 && whole[most] <= 0xDFFF;
    return splits ? most - 1 : most;
  });
}

int VEXAMB16toGeneric(UConverter* generic, const unsigned short* text, size_t length, char* out, size_t size,
                      size_t* outLength) {
  if (out != nullptr && size > 0) *out = 0;
  if (!FindLength(text, length)) return Refuse(outLength);
  std::string result;
  const int status = FromU16(Of(generic), ToChar16(text, length), result);
  return DeliverNarrow(status, Of(generic), result, out, size, outLength);
}

int VEXAMBTranscodeGeneric(UConverter* generic, const char* text, unsigned short** out) {
  if (out == nullptr) return kVEXAMBBadArgument;
  *out = nullptr;
  if (text == nullptr) return kVEXAMBOk;
  std::u16string wide;
  const int status = Decode(Of(generic), text, std::strlen(text), wide);
  *out = new unsigned short[wide.size() + 1];
  std::copy_n(wide.c_str(), wide.size() + 1, *out);
  return status;
}

int VEXAMBTranscodeGeneric(UConverter* generic, const unsigned short* text, char** out) {
  if (out == nullptr) return kVEXAMBBadArgument;
  *out = nullptr;
  if (text == nullptr) return kVEXAMBOk;
  std::string narrow;
  const int status =
      FromU16(Of(generic), ToChar16(text, std::char_traits<unsigned short>::length(text)), narrow);
  *out = new char[narrow.size() + 1];
  std::copy_n(narrow.c_str(), narrow.size() + 1, *out);
  return status;
}

}  // namespace MCXML_800
