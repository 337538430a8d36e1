#include "kestrel/foundation/TextConverter.h"

#include <unicode/ucnv.h>
#include <unicode/ucnv_cb.h>

#include <atomic>
#include <memory>

#include "kestrel/foundation/CodePages.h"
#include "kestrel/foundation/Locale.h"
#include "kestrel/foundation/MultibyteConversions.h"
#include "kestrel/foundation/Utf8Text.h"
#include "kestrel/platform/Environment.h"
#include "kestrel/platform/ThreadObject.h"

namespace MCXML_800 {

namespace {

struct CloseConverter {
  void operator()(UConverter* converter) const { ucnv_close(converter); }
};
using ConverterHolder = std::unique_ptr<UConverter, CloseConverter>;

ConverterHolder Open(const std::string& name) {
  UErrorCode status = U_ZERO_ERROR;
  ConverterHolder converter(ucnv_open(name.c_str(), &status));
  if (U_FAILURE(status)) {
    status = U_ZERO_ERROR;
    converter.reset(ucnv_open("UTF-8", &status));
  }
  return converter;
}

/// The name to open the process's code page by. The table's own name is taken, not the standard one that goes
/// with it, because the standard name of 949 stands for fewer characters.
std::string ProcessCodePageName() {
  const long number = MCKestrel_800::CodePageNumber();
  return number != 0 ? FindConverterName(number) : MCKestrel_800::CodePageName();
}

/// Never changed once others see it, and never destroyed: a thread may clone it at any time. The ones before
/// stay reachable; there are as many as the host has switched the mode.
struct SharedConverter {
  ConverterHolder converter;
  std::string name;
  int id;
  const SharedConverter* previous;
};

std::atomic<const SharedConverter*> current{nullptr};

const SharedConverter* Current() {
  const SharedConverter* shared = current.load(std::memory_order_acquire);
  if (shared != nullptr) return shared;
  // Only for a call that comes before the library's own start, from the start of another part of it.
  RenewDefaultConverter(qUTF8mode() != 0);
  return current.load(std::memory_order_acquire);
}

}  // namespace

void RenewDefaultConverter(bool utf8) {
  const std::string name = utf8 ? "UTF-8" : ProcessCodePageName();
  const SharedConverter* last = current.load(std::memory_order_acquire);
  if (last != nullptr && last->name == name) return;
  auto made = std::make_unique<SharedConverter>(SharedConverter{Open(name), name, 0, nullptr});
  do {
    made->previous = last;
    made->id = last == nullptr ? 1 : last->id + 1;
  } while (!current.compare_exchange_weak(last, made.get(), std::memory_order_acq_rel));
  static_cast<void>(made.release());  // the list keeps it
}

int DefaultConverterCount() {
  return Current()->id;
}

UConverter* DefaultConverter() {
  struct Own {
    ConverterHolder converter;
    int id = 0;
  };
  Own& own = MCKestrel_800::ThreadObject<Own>();
  const SharedConverter* const shared = Current();
  if (own.id != shared->id) {
    own.converter.reset(CloneConverter(shared->converter.get()));
    own.id = shared->id;
  }
  return own.converter.get();
}

UConverter* ProcessCodePageConverter() {
  struct Own {
    ConverterHolder converter;
    std::string name;
  };
  Own& own = MCKestrel_800::ThreadObject<Own>();
  std::string name = ProcessCodePageName();
  if (own.converter == nullptr || own.name != name) {
    own.converter = Open(name);
    own.name = std::move(name);
  }
  return own.converter.get();
}

UConverter* CloneConverter(const UConverter* converter) {
  if (converter == nullptr) return nullptr;
  UErrorCode status = U_ZERO_ERROR;
#if U_ICU_VERSION_MAJOR_NUM >= 71
  return ucnv_clone(converter, &status);
#else
  return ucnv_safeClone(converter, nullptr, nullptr, &status);
#endif
}

bool IsUtf8(const UConverter* converter) {
  return converter == nullptr || ucnv_getType(converter) == UCNV_UTF8;
}

namespace {

constexpr size_t kBlock = 1024;

// Substitution is the library's way; what these add is that it does not go unnoticed.

void U_CALLCONV NoteAndDecode(const void* context, UConverterToUnicodeArgs* args, const char*, int32_t,
                              UConverterCallbackReason reason, UErrorCode* status) {
  if (reason > UCNV_IRREGULAR) return;
  *static_cast<bool*>(const_cast<void*>(context)) = true;
  *status = U_ZERO_ERROR;
  // ICU's own way writes U+001A for some single bytes, which XML does not even allow.
  ucnv_cbToUWriteUChars(args, u"\xFFFD", 1, 0, status);
}

void U_CALLCONV NoteAndEncode(const void* context, UConverterFromUnicodeArgs* args, const char16_t* units,
                              int32_t length, UChar32 codePoint, UConverterCallbackReason reason,
                              UErrorCode* status) {
  if (reason <= UCNV_IRREGULAR) *static_cast<bool*>(const_cast<void*>(context)) = true;
  UCNV_FROM_U_CALLBACK_SUBSTITUTE(nullptr, args, units, length, codePoint, reason, status);
}

/// Starts the converter anew with our callback, and gives it back its own when done.
class DecodeScope {
 public:
  DecodeScope(UConverter* converter, bool* noted) : converter_(converter) {
    ucnv_resetToUnicode(converter);
    UErrorCode status = U_ZERO_ERROR;
    ucnv_setToUCallBack(converter, NoteAndDecode, noted, &action_, &context_, &status);
  }
  ~DecodeScope() {
    UErrorCode status = U_ZERO_ERROR;
    ucnv_setToUCallBack(converter_, action_, context_, nullptr, nullptr, &status);
    ucnv_resetToUnicode(converter_);
  }
  DecodeScope(const DecodeScope&) = delete;
  DecodeScope& operator=(const DecodeScope&) = delete;

 private:
  UConverter* converter_;
  UConverterToUCallback action_ = nullptr;
  const void* context_ = nullptr;
};

class EncodeScope {
 public:
  EncodeScope(UConverter* converter, bool* noted) : converter_(converter) {
    ucnv_resetFromUnicode(converter);
    UErrorCode status = U_ZERO_ERROR;
    ucnv_setFromUCallBack(converter, NoteAndEncode, noted, &action_, &context_, &status);
  }
  ~EncodeScope() {
    UErrorCode status = U_ZERO_ERROR;
    ucnv_setFromUCallBack(converter_, action_, context_, nullptr, nullptr, &status);
    ucnv_resetFromUnicode(converter_);
  }
  EncodeScope(const EncodeScope&) = delete;
  EncodeScope& operator=(const EncodeScope&) = delete;

 private:
  UConverter* converter_;
  UConverterFromUCallback action_ = nullptr;
  const void* context_ = nullptr;
};

}  // namespace

int DecodeText(UConverter* converter, const char* text, size_t length, std::u16string& out) {
  converter = OrDefault(converter);
  if (IsUtf8(converter)) return AppendUtf8AsUtf16(text, length, out) ? kVEXAMBOk : kVEXAMBSubstituted;
  bool noted = false;
  const DecodeScope scope(converter, &noted);
  char16_t block[kBlock];
  const char* const end = text + length;
  UErrorCode status = U_ZERO_ERROR;
  do {
    char16_t* to = block;
    status = U_ZERO_ERROR;
    ucnv_toUnicode(converter, &to, block + kBlock, &text, end, nullptr, true, &status);
    out.append(block, to);
  } while (status == U_BUFFER_OVERFLOW_ERROR);
  return noted || U_FAILURE(status) ? kVEXAMBSubstituted : kVEXAMBOk;
}

int EncodeText(UConverter* converter, const char16_t* text, size_t length, std::string& out) {
  converter = OrDefault(converter);
  if (IsUtf8(converter)) return AppendUtf16AsUtf8(text, length, out) ? kVEXAMBOk : kVEXAMBSubstituted;
  bool noted = false;
  const EncodeScope scope(converter, &noted);
  char block[kBlock];
  const char16_t* const end = text + length;
  UErrorCode status = U_ZERO_ERROR;
  do {
    char* to = block;
    status = U_ZERO_ERROR;
    ucnv_fromUnicode(converter, &to, block + kBlock, &text, end, nullptr, true, &status);
    out.append(block, to);
  } while (status == U_BUFFER_OVERFLOW_ERROR);
  return noted || U_FAILURE(status) ? kVEXAMBSubstituted : kVEXAMBOk;
}

}  // namespace MCXML_800
