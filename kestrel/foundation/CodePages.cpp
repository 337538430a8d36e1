#include "kestrel/foundation/CodePages.h"

#include <unicode/ucnv.h>

#include <cstdio>

namespace MCXML_800 {

namespace {

constexpr CodePage kCodePages[] = {
    {932, "windows-31j"}, {936, "GBK"},     {949, "KS_C_5601-1987"}, {950, "Big5"},         {1250, "cp1250"},
    {1251, "cp1251"},     {1252, "cp1252"}, {1253, "cp1253"},        {1254, "cp1254"},      {1255, "cp1255"},
    {1256, "cp1256"},     {1257, "cp1257"}, {1258, "cp1258"},        {28591, "ISO-8859-1"}, {65001, "UTF-8"},
};

constexpr const char* kPatterns[] = {"windows-%03ld", "cp%03ld"};

bool IsKnown(const char* name) {
  UErrorCode status = U_ZERO_ERROR;
  return ucnv_countAliases(name, &status) > 0 && U_SUCCESS(status);
}

}  // namespace

CodePageList GetCodePages() {
  return {kCodePages, sizeof kCodePages / sizeof kCodePages[0]};
}

std::string FindConverterName(long codePage) {
  // ICU takes no notice of hyphens in names: "cp-37" would find code page 37.
  if (codePage < 0) return {};
  for (const CodePage& row : GetCodePages())
    if (row.number == codePage && IsKnown(row.converter)) return row.converter;
  for (const char* pattern : kPatterns) {
    char name[40];
    std::snprintf(name, sizeof name, pattern, codePage);
    if (IsKnown(name)) return name;
  }
  return {};
}

int VEXAMBCodePageName(long codePage, std::string& name) {
  name = FindConverterName(codePage);
  if (name.empty()) return 1;
  UErrorCode status = U_ZERO_ERROR;
  const char* const standard = ucnv_getStandardName(name.c_str(), "IANA", &status);
  if (U_SUCCESS(status) && standard != nullptr) name = standard;
  return 0;
}

UConverter* VEXAMBConverterNewForCodePage(long codePage) {
  const std::string name = FindConverterName(codePage);
  if (name.empty()) return nullptr;
  UErrorCode status = U_ZERO_ERROR;
  return ucnv_open(name.c_str(), &status);
}

}  // namespace MCXML_800
