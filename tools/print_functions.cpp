// Prints docs/functions.md from the table of the built-in functions.

#include <cstddef>
#include <iostream>
#include <string>

#include "kestrel/platform/Terminal.h"
#include "kestrel/transform/BuiltinFunctions.h"

namespace {

using MCKestrel_800::BuiltinFunction;
using MCKestrel_800::FunctionArgumentCheck;
using MCKestrel_800::FunctionFamily;
using MCKestrel_800::FunctionMissingRule;
using MCKestrel_800::FunctionValueKind;

constexpr char kHead[] = R"(# Built-in functions

Printed by `build/release/tools/print_functions` from the table in `kestrel/transform/BuiltinFunctions.cpp`; a test holds
the two together.

What an `Apply` of a derived field may name. Names count exactly as they stand; several names in a row are the same
function. In the meanings x, y and z are the arguments in their order. A "field" is a `FieldRef` and nothing else, an
"array" an `Array` beside the arguments. A missing number is the system-missing value, a missing text the empty one; what
is too large for a number is missing, and no infinity comes out of any function. An `Apply` with `mapMissingTo` gives
that in place of a missing number.

The length of a text is a number beside it: the width of its field where one is declared, else its size in bytes. Texts
keep it, trimmed ones lose as much as the text, `concat` adds the lengths up, and what `substr` returns has its start as
the length.
)";

/// How numbers are handed over is no matter of documents: both families stand together, and so do the tests
/// of values.
struct Section {
  const char* title;
  FunctionFamily family;
  FunctionFamily other_family;
};
constexpr Section kSections[] = {
    {"Numbers", FunctionFamily::kScalar, FunctionFamily::kList},
    {"Texts", FunctionFamily::kText, FunctionFamily::kText},
    {"Dates and times", FunctionFamily::kDateTime, FunctionFamily::kDateTime},
    {"Values of any kind", FunctionFamily::kComparison, FunctionFamily::kValueList},
    {"Others", FunctionFamily::kSpecial, FunctionFamily::kSpecial},
};

std::string KindName(FunctionValueKind kind) {
  switch (kind) {
    case FunctionValueKind::kNumber:
      return "number";
    case FunctionValueKind::kText:
      return "text";
    case FunctionValueKind::kDateTime:
      return "date or time";
    case FunctionValueKind::kNumberOrText:
      return "number or text";
    case FunctionValueKind::kAny:
      return "value";
    case FunctionValueKind::kFirstArgument:
      return "what x is";
    case FunctionValueKind::kArgument:
      return "what y is";
  }
  return "";
}

std::string ArgumentName(const BuiltinFunction& function, int index) {
  const FunctionValueKind kind = function.KindOfArgument(index);
  if (function.check != FunctionArgumentCheck::kField) return KindName(kind);
  return kind == FunctionValueKind::kAny ? "field" : KindName(kind) + " field";
}

/// Each argument by its kind, those that may be left out in brackets.
std::string Arguments(const BuiltinFunction& function) {
  if (function.max_arguments == BuiltinFunction::kAnyNumber) {
    return "any number of " + KindName(function.argument) + "s";
  }
  std::string text;
  for (int i = 0; i < function.max_arguments; ++i) {
    const std::string next = (i == 0 ? "" : ", ") + ArgumentName(function, i);
    text += i < function.min_arguments ? next : "[" + next + "]";
  }
  for (int i = 0; i < function.arrays; ++i)
    text += ", array";
  return text;
}

const char* MissingText(FunctionMissingRule rule) {
  switch (rule) {
    case FunctionMissingRule::kPropagates:
      return "makes the result missing";
    case FunctionMissingRule::kSkipped:
      return "does not count; missing when none is left";
    case FunctionMissingRule::kANumber:
      return "is the smallest number";
    case FunctionMissingRule::kEmptyText:
      return "is an empty text";
    case FunctionMissingRule::kAsMeant:
      return "as the meaning says";
  }
  return "";
}

/// All names of the function at `first`; moves on to the row behind them.
std::string Names(const BuiltinFunction*& row, const BuiltinFunction* end) {
  const BuiltinFunction* const first = row;
  std::string names;
  for (; row != end && row->code == first->code; ++row)
    names += std::string(row == first ? "`" : ", `") + row->name + "`";
  return names;
}

void PrintSection(const Section& section) {
  std::cout << "\n## " << section.title
            << "\n\n| name | arguments | gives | a missing argument | meaning |\n|---|---|---|---|---|\n";
  std::size_t count = 0;
  const BuiltinFunction* row = MCKestrel_800::GetBuiltinFunctions(count);
  const BuiltinFunction* const end = row + count;
  while (row != end) {
    const BuiltinFunction& function = *row;
    const std::string names = Names(row, end);
    if (function.family != section.family && function.family != section.other_family) continue;
    std::cout << "| " << names << " | " << Arguments(function) << " | " << KindName(function.result) << " | "
              << MissingText(function.missing) << " | " << function.meaning << " |\n";
  }
}

}  // namespace

int main() {
  MCKestrel_800::PrepareStandardStreams();
  std::cout << kHead;
  for (const Section& section : kSections)
    PrintSection(section);
  return std::cout.flush() ? 0 : 1;
}
