#include "kestrel/transform/FunctionEvaluation.h"
#include "kestrel/transform/TransformationDictionary.h"

namespace MCKestrel_800 {

namespace {

double Apply(const std::vector<double>& arguments, TransformFunction function) {
  return ApplyAccumulateFunction(arguments.data(), arguments.size(), function);
}

}  // namespace

double TransformationDictionary::Minus(const std::vector<double>& arguments) {
  return Apply(arguments, kMinusFunction);
}

double TransformationDictionary::Multiply(const std::vector<double>& arguments) {
  return Apply(arguments, kMultiplyFunction);
}

double TransformationDictionary::Divided(const std::vector<double>& arguments) {
  return Apply(arguments, kDivideFunction);
}

double TransformationDictionary::Sum(const std::vector<double>& arguments) {
  return Apply(arguments, kSumFunction);
}

double TransformationDictionary::Mean(const std::vector<double>& arguments) {
  return Apply(arguments, kMeanFunction);
}

double TransformationDictionary::Min(const std::vector<double>& arguments) {
  return Apply(arguments, kMinFunction);
}

double TransformationDictionary::Max(const std::vector<double>& arguments) {
  return Apply(arguments, kMaxFunction);
}

double TransformationDictionary::ProductOperator(const std::vector<double>& arguments) {
  return Apply(arguments, kProductFunction);
}

double TransformationDictionary::MedianOperator(const std::vector<double>& arguments) {
  return Apply(arguments, kMedianFunction);
}

double TransformationDictionary::Sd(const std::vector<double>& arguments) {
  return Apply(arguments, kSdFunction);
}

double TransformationDictionary::Variance(const std::vector<double>& arguments) {
  return Apply(arguments, kVarianceFunction);
}

double TransformationDictionary::CdfNormal(const std::vector<double>& arguments) {
  return Apply(arguments, kCdfNormalFunction);
}

double TransformationDictionary::IdfNormal(const std::vector<double>& arguments) {
  return Apply(arguments, kIdfNormalFunction);
}

double TransformationDictionary::PdfNormal(const std::vector<double>& arguments) {
  return Apply(arguments, kPdfNormalFunction);
}

double TransformationDictionary::lessThan(const std::vector<double>& arguments) {
  return Apply(arguments, kLessThanFunction);
}

double TransformationDictionary::lessOrEqual(const std::vector<double>& arguments) {
  return Apply(arguments, kLessOrEqualFunction);
}

double TransformationDictionary::greaterThan(const std::vector<double>& arguments) {
  return Apply(arguments, kGreaterThanFunction);
}

double TransformationDictionary::greaterOrEqual(const std::vector<double>& arguments) {
  return Apply(arguments, kGreaterOrEqualFunction);
}

double TransformationDictionary::AndOperator(const std::vector<double>& arguments) {
  return Apply(arguments, kAndFunction);
}

double TransformationDictionary::OrOperator(const std::vector<double>& arguments) {
  return Apply(arguments, kOrFunction);
}

double TransformationDictionary::NotOperator(const std::vector<double>& arguments) {
  return Apply(arguments, kNotFunction);
}

double TransformationDictionary::OutlierHandle(double x, int method, double c, double a, double b, double n) {
  return HandleOutlier(x, method, c, a, b, n);
}

}  // namespace MCKestrel_800
