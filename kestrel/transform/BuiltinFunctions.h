// The vocabulary of Apply expressions: one table of the built-in functions, which the reader, the evaluation,
// the documentation and the tests share.

#ifndef KESTREL_TRANSFORM_BUILTINFUNCTIONS_H
#define KESTREL_TRANSFORM_BUILTINFUNCTIONS_H

#include <cstddef>
#include <string_view>

#include "kestrel/platform/Export.h"
#include "kestrel/transform/TransformFunction.h"

namespace MCKestrel_800 {

/// How a function is evaluated.
enum class FunctionFamily {
  kScalar,      ///< one or two numbers to a number
  kList,        ///< any number of numbers to a number
  kText,        ///< texts to a text
  kDateTime,    ///< a date/time (and a number that is subtracted) to a number
  kComparison,  ///< two values of any kind to 1 or 0
  kValueList,   ///< a value and an array to 1 or 0
  kSpecial      ///< by itself
};

/// What a value in a tree is.
enum class FunctionValueKind {
  kNumber,
  kText,
  kDateTime,
  kNumberOrText,   ///< as an argument: both, and no date/time
  kAny,            ///< as an argument: every kind
  kFirstArgument,  ///< as a result: the kind of the first argument
  kArgument,       ///< as a result: the kind of the second argument
};

/// What a reader asks of each argument.
enum class FunctionArgumentCheck {
  kNone,   ///< nothing
  kKind,   ///< constants and fields of the argument's kind; functions that FunctionNesting lets in
  kField,  ///< a field, of the argument's kind, and nothing else
};

/// Which functions may stand inside which, where arguments are checked by `kKind`. This is not the kind of
/// the result: whatever is kOther fits nowhere, although most of it yields numbers.
enum class FunctionNesting {
  kNumeric,  ///< takes kNumeric and kLength
  kString,   ///< takes kString
  kLength,   ///< takes kString
  kOther     ///< takes everything
};

/// What becomes of a missing argument.
enum class FunctionMissingRule {
  kPropagates,  ///< the result is missing
  kSkipped,     ///< it does not count; the result is missing when all are
  kANumber,     ///< the system-missing value takes part as the number that it is
  kEmptyText,   ///< it is an empty text
  kAsMeant      ///< the function's meaning tells
};

/// One name of a function.
struct BuiltinFunction {
  const char* name;
  TransformFunction code;
  FunctionFamily family;
  FunctionValueKind argument;  ///< what its arguments are used as, but for one of another kind
  FunctionValueKind result;
  int min_arguments;       ///< expressions, without the arrays
  int max_arguments;       ///< kAnyNumber for no limit
  int arrays;              ///< how many Arrays stand beside the arguments
  const char* arity_text;  ///< what a reader says when the number of arguments or arrays is another
  FunctionArgumentCheck check;
  FunctionNesting nesting;
  FunctionMissingRule missing;
  const char* meaning;  ///< one line for the documentation; x, y, z are the arguments
  int odd_index = -1;   ///< the argument of another kind; -1 for none
  FunctionValueKind odd_argument = FunctionValueKind::kAny;  ///< its kind

  static constexpr int kAnyNumber = -1;

  /// What an argument is used as, by its position from 0.
  FunctionValueKind KindOfArgument(int index) const { return index == odd_index ? odd_argument : argument; }

  bool TakesCount(std::size_t arguments) const {
    return arguments >= static_cast<std::size_t>(min_arguments) &&
           (max_arguments == kAnyNumber || arguments <= static_cast<std::size_t>(max_arguments));
  }
};

/// All names, in the order of their codes; several names may share a code.
KESTREL_API const BuiltinFunction* GetBuiltinFunctions(std::size_t& count);

/// The row of a name, which counts exactly as it stands, or of a code (of several names the first). Null when
/// there is none.
KESTREL_API const BuiltinFunction* FindBuiltinFunction(std::string_view name);
KESTREL_API const BuiltinFunction* FindBuiltinFunction(TransformFunction code);

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSFORM_BUILTINFUNCTIONS_H
