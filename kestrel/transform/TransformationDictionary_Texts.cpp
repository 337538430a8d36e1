#include "kestrel/foundation/StringValue.h"
#include "kestrel/transform/FunctionEvaluation.h"
#include "kestrel/transform/TransformationDictionary.h"

namespace MCKestrel_800 {

namespace {

std::string Apply(const StringValue& value, TransformFunction function, int& length) {
  std::string text;
  ApplyTextFunction(value, function, text, length);
  return text;
}

}  // namespace

std::string TransformationDictionary::Substring(const StringValue& value, double start, int& length) {
  std::string text;
  ApplySubstring(value, start, text, length);
  return text;
}

std::string TransformationDictionary::Concat(const std::vector<std::string>& texts,
                                             const std::vector<int>& widths, int& length) {
  std::string all;
  for (const std::string& text : texts)
    all += text;
  length = 0;
  for (const int width : widths)
    length = AddLengths(length, width);
  return all;
}

std::string TransformationDictionary::ToLowerCase(const StringValue& value, int& length) {
  return Apply(value, kLowerFunction, length);
}

std::string TransformationDictionary::ToUpperCase(const StringValue& value, int& length) {
  return Apply(value, kUppercaseFunction, length);
}

std::string TransformationDictionary::Ltrim(const StringValue& value, int& length) {
  return Apply(value, kLtrimFunction, length);
}

std::string TransformationDictionary::Rtrim(const StringValue& value, int& length) {
  return Apply(value, kRtrimFunction, length);
}

}  // namespace MCKestrel_800
