// Which converter stands for a code-page number.

#ifndef KESTREL_FOUNDATION_CODEPAGES_H
#define KESTREL_FOUNDATION_CODEPAGES_H

#include <cstddef>
#include <string>

#include "kestrel/platform/Export.h"

struct UConverter;

namespace MCXML_800 {

struct CodePage {
  long number;
  const char* converter;
};

/// The code pages with a name of their own. Every other number is tried as "windows-" and as "cp" with the
/// number in at least three digits.
struct CodePageList {
  const CodePage* rows;
  size_t count;
  const CodePage* begin() const { return rows; }
  const CodePage* end() const { return rows + count; }
};
KESTREL_API CodePageList GetCodePages();

/// The name that the converter for a code page is opened by: the one of the list, or else the first of the
/// two patterns that ICU knows. Empty when there is none.
KESTREL_API std::string FindConverterName(long codePage);

/// The standard (IANA) name of the converter for a code page, or the name it is opened by when no standard
/// names it. 0, or 1 with an empty name when there is no such converter.
/// The standard name is for telling others: that of 949 is "EUC-KR", which when opened knows fewer characters
/// than the code page. To convert, open by number.
KESTREL_API int VEXAMBCodePageName(long codePage, std::string& name);

/// Opens a converter for a code page. The caller frees it with VEXAMBConverterDelete. Null when there is
/// none.
KESTREL_API UConverter* VEXAMBConverterNewForCodePage(long codePage);

}  // namespace MCXML_800

#endif  // KESTREL_FOUNDATION_CODEPAGES_H
