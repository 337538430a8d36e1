#include <gtest/gtest.h>

#include <cstddef>
#include <string>

#include "kestrel/transform/BuiltinFunctions.h"
#include "tests/support/FileText.h"
#include "tests/support/RunProgram.h"

namespace MCKestrel_800 {
namespace {

TEST(FunctionDocument, IsWhatTheTablePrints) {
  const kestrel_tests::ProgramOutcome printed =
      kestrel_tests::RunProgram(kestrel_tests::BuiltProgram("tools/print_functions"), {});
  EXPECT_EQ(printed.exit_code, 0) << printed.errors;
  EXPECT_EQ(kestrel_tests::FileText(KESTREL_SOURCE_DIR "/docs/functions.md"), printed.output)
      << "write it anew: build/release/tools/print_functions > docs/functions.md";
}

TEST(FunctionDocument, HasEveryNameOnce) {
  const std::string document = kestrel_tests::FileText(KESTREL_SOURCE_DIR "/docs/functions.md");
  std::size_t count = 0;
  const BuiltinFunction* functions = GetBuiltinFunctions(count);
  for (std::size_t i = 0; i < count; ++i) {
    std::size_t rows = 0;
    const std::string name = std::string("`") + functions[i].name + "`";
    for (std::size_t at = document.find(name); at != std::string::npos; at = document.find(name, at + 1)) {
      const std::size_t start = document.rfind('\n', at) + 1;
      rows += document.compare(start, 3, "| `") == 0 ? 1 : 0;
    }
    EXPECT_EQ(rows, 1u) << name;
  }
}

}  // namespace
}  // namespace MCKestrel_800
