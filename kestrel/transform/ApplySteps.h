// What the instructions of an Apply program do, by family.

#ifndef KESTREL_TRANSFORM_APPLYSTEPS_H
#define KESTREL_TRANSFORM_APPLYSTEPS_H

#include <cstddef>
#include <string>
#include <vector>

#include "kestrel/foundation/StringValue.h"
#include "kestrel/transform/ApplyProgram.h"

namespace MCKestrel_800 {

class SourceField;

/// What a step needs beside two numbers and a place for the result.
struct ApplyDetail {
  std::vector<const double*> numbers;
  std::vector<double> values;  ///< room for the numbers' values
  std::vector<double> scratch;
  std::vector<ApplyText> texts;
  StringValue* text_out = nullptr;
  std::string text;  ///< room for the result's text
  const StringValue** place_out = nullptr;
  const SourceField* source = nullptr;

  // Of a list of values, ascending, texts without trailing blanks.
  std::vector<double> listed_numbers;
  std::vector<std::string> listed_texts;
  // Of an imputation, by category; the means are `values`.
  std::vector<double> variances;
  std::vector<double> category_numbers;
  std::vector<StringValue> category_texts;
};

namespace ApplySteps {

using Step = const ApplyInstruction&;

// Numbers to a number.
std::size_t Add(Step step);
std::size_t Subtract(Step step);
std::size_t Multiply(Step step);
std::size_t Divide(Step step);
std::size_t Scalar(Step step);
std::size_t List(Step step);
std::size_t DateTime(Step step);  ///< x: the seconds; y: what is subtracted
std::size_t Outlier(Step step);

// Texts to a text, into text_out.
std::size_t ChangeText(Step step);
std::size_t Substring(Step step);  ///< x: the start
std::size_t Concat(Step step);

// Tests, 1 or 0. `function` tells a test from its opposite.
std::size_t CompareNumbers(Step step);
std::size_t CompareTexts(Step step);
std::size_t FindNumber(Step step);
std::size_t FindText(Step step);
std::size_t TestMissing(Step step);  ///< of the source
std::size_t TestSysmis(Step step);

// Others.
std::size_t Length(Step step);
std::size_t ReadText(Step step);  ///< the number that a text reads as
std::size_t ImputeNumber(Step step);
std::size_t ImputeText(Step step);

// Replacing what is missing: x (the first text) is the value, y (the second) the replacement.
std::size_t ReplaceSysmis(Step step);
std::size_t ReplaceMissingNumber(Step step);  ///< of the source
std::size_t ReplaceMissingText(Step step);

// Choosing.
std::size_t Copy(Step step);
std::size_t CopyText(Step step);
std::size_t SkipUnlessOne(Step step);
std::size_t Skip(Step step);

}  // namespace ApplySteps
}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSFORM_APPLYSTEPS_H
