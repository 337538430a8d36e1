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
  std::vector<double> listed_seconds;  ///< where the case decides whether a date/time is looked for
  std::vector<std::string> listed_texts;
  // Of an imputation, by category; the means are `values`.
  std::vector<double> variances;
  std::vector<double> category_numbers;
  std::vector<StringValue> category_texts;
};

namespace ApplySteps {

using Step = const ApplyInstruction&;
using Next = const ApplyInstruction*;

// Arithmetic, operands to an operand; what is too large, or no number, is missing.
Next Add(Step step);
Next Subtract(Step step);
Next Multiply(Step step);
Next Divide(Step step);
Next ToOperand(Step step);
Next FromOperand(Step step);

// Numbers to a number.
Next Scalar(Step step);
Next List(Step step);
Next DateTime(Step step);  ///< x: the seconds; y: what is subtracted
Next Outlier(Step step);

// Texts to a text, into text_out.
Next ChangeText(Step step);
Next Substring(Step step);  ///< x: the start
Next Concat(Step step);

// Tests, 1 or 0. `function` tells a test from its opposite.
Next CompareNumbers(Step step);
Next CompareTexts(Step step);
Next FindNumber(Step step);
Next FindText(Step step);
Next CompareValues(Step step);  ///< numbers: kind and number of the first, then of the second
Next FindValue(Step step);      ///< numbers: kind and number
Next TestMissing(Step step);    ///< of the source
Next TestSysmis(Step step);

// Others.
Next Length(Step step);
Next ReadText(Step step);  ///< the number that a text reads as
Next ImputeNumber(Step step);
Next ImputeText(Step step);

// Replacing what is missing: x (the first text) is the value, y (the second) the replacement.
Next ReplaceSysmis(Step step);
Next ReplaceSysmisNumber(Step step);   ///< numbers: the kind; a missing date/time stays
Next ReplaceMissingNumber(Step step);  ///< of the source
Next ReplaceMissingText(Step step);

// Choosing.
Next Copy(Step step);
Next CopyText(Step step);
Next SkipUnlessOne(Step step);
Next Skip(Step step);

}  // namespace ApplySteps
}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSFORM_APPLYSTEPS_H
