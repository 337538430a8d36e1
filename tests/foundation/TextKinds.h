// The walking functions of each kind of text behind one interface, so that a test says its rows once.

#ifndef KESTREL_TESTS_FOUNDATION_TEXTKINDS_H
#define KESTREL_TESTS_FOUNDATION_TEXTKINDS_H

#include <cstring>
#include <memory>
#include <string>
#include <vector>

#include "kestrel/foundation/MultibyteText.h"

namespace kestrel_tests {

class TextKind {
 public:
  virtual ~TextKind() = default;
  virtual int Mblen(const char* at, size_t length) const = 0;
  virtual size_t Mbclen(const char* at) const = 0;
  virtual bool IsLeadByte(unsigned char byte) const = 0;
  virtual const char* Strinc(const char* at) const = 0;
  virtual const char* AnsiPrev(const char* start, const char* at) const = 0;
  virtual size_t PreviousIndex(const char* text, size_t index) const = 0;
  virtual size_t FindStart(const char* text, size_t length, size_t index) const = 0;
  virtual std::vector<size_t> FindStarts(const char* text, size_t length) const = 0;
  virtual char* Strncpy(char* to, const char* from, size_t size) const = 0;
  virtual const char* Strchr(const char* text, char32_t character) const = 0;
  virtual const char* Strrchr(const char* text, char32_t character) const = 0;
  virtual size_t Strcspn(const char* text, const char* set) const = 0;
  virtual int Strnicmp(const char* left, const char* right, size_t size) const = 0;
  virtual int Qstricmp(const char* left, const char* right) const = 0;
  virtual char32_t U32Get(const char* at) const = 0;
};

// One class per suffix: `BEFORE` is what stands in front of the arguments.
#define KESTREL_TEXT_KIND(S, BEFORE)                                               \
  int Mblen(const char* at, size_t length) const override {                        \
    return MCXML_800::VEXAMBmblen_##S(BEFORE at, length);                          \
  }                                                                                \
  size_t Mbclen(const char* at) const override {                                   \
    return MCXML_800::VEXAMBmbclen_##S(BEFORE at);                                 \
  }                                                                                \
  bool IsLeadByte(unsigned char byte) const override {                             \
    return MCXML_800::VEXAMBIsLeadByte_##S(BEFORE byte);                           \
  }                                                                                \
  const char* Strinc(const char* at) const override {                              \
    return MCXML_800::VEXAMBstrinc_##S(BEFORE at);                                 \
  }                                                                                \
  const char* AnsiPrev(const char* start, const char* at) const override {         \
    return MCXML_800::VEXAMBAnsiPrev_##S(BEFORE start, at);                        \
  }                                                                                \
  size_t PreviousIndex(const char* text, size_t index) const override {            \
    return MCXML_800::VEXAMBPreviousIndex_##S(BEFORE text, index);                 \
  }                                                                                \
  size_t FindStart(const char* text, size_t length, size_t index) const override { \
    return MCXML_800::VEXAMBFindStart_##S(BEFORE text, length, index);             \
  }                                                                                \
  std::vector<size_t> FindStarts(const char* text, size_t length) const override { \
    return MCXML_800::VEXAMBFindStarts_##S(BEFORE text, length);                   \
  }                                                                                \
  char* Strncpy(char* to, const char* from, size_t size) const override {          \
    return MCXML_800::VEXAMBstrncpy_##S(BEFORE to, from, size);                    \
  }                                                                                \
  const char* Strchr(const char* text, char32_t character) const override {        \
    return MCXML_800::VEXAMBstrchr_##S(BEFORE text, character);                    \
  }                                                                                \
  const char* Strrchr(const char* text, char32_t character) const override {       \
    return MCXML_800::VEXAMBstrrchr_##S(BEFORE text, character);                   \
  }                                                                                \
  size_t Strcspn(const char* text, const char* set) const override {               \
    return MCXML_800::VEXAMBstrcspn_##S(BEFORE text, set);                         \
  }                                                                                \
  int Strnicmp(const char* left, const char* right, size_t size) const override {  \
    return MCXML_800::VEXAMBstrnicmp_##S(BEFORE left, right, size);                \
  }                                                                                \
  int Qstricmp(const char* left, const char* right) const override {               \
    return MCXML_800::VEXAMBqstricmp_##S(BEFORE left, right);                      \
  }                                                                                \
  char32_t U32Get(const char* at) const override {                                 \
    return MCXML_800::VEXAMBU32Get_##S(BEFORE at);                                 \
  }

class Utf8Kind : public TextKind {
 public:
  KESTREL_TEXT_KIND(8, )
};

class LocaleKind : public TextKind {
 public:
  KESTREL_TEXT_KIND(C, )
};

class CodePageKind : public TextKind {
 public:
  /// A converter name; null walks with the default converter.
  explicit CodePageKind(const char* name)
      : converter_(name == nullptr ? nullptr : MCXML_800::VEXAMBConverterNew_C(name)) {}
  ~CodePageKind() override { MCXML_800::VEXAMBConverterDelete(converter_); }
  CodePageKind(const CodePageKind&) = delete;
  CodePageKind& operator=(const CodePageKind&) = delete;
#define KESTREL_CONVERTER_FIRST converter_,
  KESTREL_TEXT_KIND(A, KESTREL_CONVERTER_FIRST)
#undef KESTREL_CONVERTER_FIRST

 private:
  UConverter* converter_;
};

#undef KESTREL_TEXT_KIND

/// "_8", "_C" for the locale of the moment, or the name of a converter for _A.
inline std::unique_ptr<TextKind> MakeKind(const std::string& name) {
  if (name == "_8") return std::make_unique<Utf8Kind>();
  if (name == "_C") return std::make_unique<LocaleKind>();
  return std::make_unique<CodePageKind>(name == "default" ? nullptr : name.c_str());
}

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_FOUNDATION_TEXTKINDS_H
