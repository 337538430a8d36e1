// The codes of the built-in functions.

#ifndef KESTREL_TRANSFORM_TRANSFORMFUNCTION_H
#define KESTREL_TRANSFORM_TRANSFORMFUNCTION_H

namespace MCKestrel_800 {

/// What a node of a function tree computes. The numbers are part of the interface: hosts store them. Names,
/// families and arguments stand in BuiltinFunctions.h.
enum TransformFunction : int {
  kPlusFunction = 0,
  kMinusFunction = 1,
  kMultiplyFunction = 2,
  kDivideFunction = 3,
  kPowFunction = 4,
  kAbsFunction = 5,
  kExpFunction = 6,
  kLog10Function = 7,
  kLnFunction = 8,
  kModFunction = 9,
  kRoundFunction = 10,
  kSqrtFunction = 11,
  kTruncFunction = 12,
  kCdfNormalFunction = 13,
  kCdfNormFunction = 14,
  kIdfNormalFunction = 15,
  kPdfNormalFunction = 16,
  kMaxFunction = 17,
  kMeanFunction = 18,
  kMinFunction = 19,
  kSdFunction = 20,
  kSumFunction = 21,
  kVarianceFunction = 22,
  kConcatFunction = 23,
  kLengthFunction = 24,
  kLowerFunction = 25,
  kLtrimFunction = 26,
  kRtrimFunction = 27,
  kSubstrFunction = 28,
  kUppercaseFunction = 29,
  kSysmisFunction = 30,
  kValueFunction = 31,
  kDateYearsDifferenceFunction = 32,
  kDateMonthsDifferenceFunction = 33,
  kDateDaysDifferenceFunction = 34,
  kYearFromDateFunction = 35,
  kMonthFromDateFunction = 36,
  kDayFromDateFunction = 37,
  kTimeHoursDifferenceFunction = 38,
  kTimeMinutesDifferenceFunction = 39,
  kTimeSecondsDifferenceFunction = 40,
  kHourFromTimeFunction = 41,
  kMinuteFromTimeFunction = 42,
  kSecondFromTimeFunction = 43,
  kRecastToOrdinalFunction = 44,
  kRecastToScaleFunction = 45,
  kOutlierHandleFunction = 46,
  kIsMissingFunction = 47,
  kIsNotMissingFunction = 48,
  kEqualFunction = 49,
  kNotEqualFunction = 50,
  kLessThanFunction = 51,
  kLessOrEqualFunction = 52,
  kGreaterThanFunction = 53,
  kGreaterOrEqualFunction = 54,
  kIsInFunction = 55,
  kIsNotInFunction = 56,
  kAndFunction = 57,
  kOrFunction = 58,
  kNotFunction = 59,
  kIfFunction = 60,
  kThresholdFunction = 61,
  kFloorFunction = 62,
  kCeilFunction = 63,
  kImputeFunction = 64,  ///< imputeCatFieldMissingAgainstConTarget
  kNoFunction = 65,      ///< a leaf
  kMedianFunction = 66,
  kProductFunction = 67,
  kLowercaseFunction = 68
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSFORM_TRANSFORMFUNCTION_H
