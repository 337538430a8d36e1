#include "apps/kestrel/DocumentHints.h"

#include "kestrel/foundation/KestrelException.h"

namespace kestrel_program {
namespace {

using MCKestrel_800::KestrelException;

struct Hint {
  int code;
  const char* part;  ///< of the message; the empty one is in every message
  const char* text;
};

/// The first row that fits counts, so a code's general row is its last.
constexpr Hint kHints[] = {
    {KestrelException::kStructure, "Duplicated", "each of them may be there once; remove or rename one"},
    {KestrelException::kStructure, "defined as both", "a value may be on one of the two lists only"},
    {KestrelException::kStructure, "more than one target",
     "targetFieldName=\"...\" in the model chooses one"},
    {KestrelException::kStructure, "allowed for regression",
     "several tables belong to functionName=\"classification\""},
    {KestrelException::kStructure, "required for each category",
     "add a RegressionTable with this targetCategory, or remove the category from the target"},
    {KestrelException::kStructure, "more than one predicate", "join the predicates in one CompoundPredicate"},
    {KestrelException::kStructure, "Missing\"", "isMissing and isNotMissing take no value; remove it"},
    {KestrelException::kStructure, "Only \"Equal\" allowed",
     "accepted is a number as value; isMissing and isNotMissing need none"},
    {KestrelException::kStructure, "null string value",
     "accepted is one of the field's Value elements as value; isMissing and isNotMissing need none"},
    {KestrelException::kStructure, "value attribute is required",
     "accepted is one of the field's Value elements as value; an empty one means missing"},
    {KestrelException::kStructure, "should be in the list",
     "accepted is a valid Value element of the field, spelled as it is there"},
    {KestrelException::kStructure, "Value list is required",
     "a set needs a categorical or ordinal field that lists its Value elements"},
    {KestrelException::kStructure, "EXPRESSION",
     "a DerivedField has one expression: Constant, FieldRef, NormContinuous, NormDiscrete, Discretize, "
     "MapValues "
     "or Apply"},
    {KestrelException::kStructure, "Redefinition", "every field needs a name of its own, derived ones too"},
    {KestrelException::kStructure, "predefined",
     "accepted is a data field, or a derived field that stands before, of the optype that the expression "
     "takes"},
    {KestrelException::kStructure, "LinearNorm", "add LinearNorm elements; a line needs two points"},
    {KestrelException::kStructure, "<FieldColumnPair> should",
     "put the FieldColumnPair before the InlineTable"},
    {KestrelException::kStructure, "No Element Found from",
     "accepted is a FieldColumnPair and then an InlineTable"},
    {KestrelException::kStructure, "in <Row>",
     "each row needs the two columns that the FieldColumnPair and outputColumn name"},
    {KestrelException::kStructure, "closure", "accepted is openOpen, openClosed, closedOpen or closedClosed"},
    {KestrelException::kStructure, "margin", "accepted is leftMargin, rightMargin or both"},
    {KestrelException::kStructure, "disjoint",
     "intervals may meet, when one of the two leaves the margin out, and not overlap"},
    {KestrelException::kStructure, "Interval", "accepted is one Interval in each DiscretizeBin"},
    {KestrelException::kStructure, "",
     "an element or attribute stands where it may not, or a required one is absent; docs/documents.md lists "
     "them"},
    {KestrelException::kFile, "", "check the path, and that the file can be read"},
    {KestrelException::kConversion, "In valid split value",
     "each element must be a valid Value element of the field; one with blanks stands in double quotes"},
    {KestrelException::kConversion, "integer",
     "accepted is a whole number such as 12, without blanks and decimals"},
    {KestrelException::kConversion, "", "accepted is a number such as -1.5 or 2e3, with a decimal point"},
    {KestrelException::kMissingElement, "no dtd file",
     "this is no XML, or its bytes are not in the encoding that it declares (UTF-8 when it declares none)"},
    {KestrelException::kMissingElement, "not parseable",
     "there is nothing in it; is the file the right one?"},
    {KestrelException::kMissingElement, "Value list is required",
     "a comparison on a categorical or ordinal field needs that field's Value elements in the "
     "DataDictionary"},
    {KestrelException::kMissingElement, "has no predicate",
     "accepted is a predicate such as True, which always applies"},
    {KestrelException::kMissingElement, "has no score",
     "a leaf needs score=\"...\" or, in a classification, ScoreDistribution elements"},
    {KestrelException::kMissingElement, "required for missingValueStrategy",
     "add it to this Node, or choose another strategy; docs/documents.md says what each one needs"},
    {KestrelException::kMissingElement, "Array Node", "accepted is an Array element in the set"},
    {KestrelException::kMissingElement, "No Elements found",
     "accepted is one element or more, parted by blanks"},
    {KestrelException::kMissingElement, "Constant value", "write the value between the tags"},
    {KestrelException::kMissingElement, "", "add what is missing, or check that the file is the right one"},
    {KestrelException::kUnsupported, "Unsupported Model found",
     "accepted is a PMML element with a model such as RegressionModel directly in it; with --models, one "
     "that "
     "the list names"},
    {KestrelException::kUnsupported, "Invalid split value range",
     "accepted is a value that leaves some numbers"},
    {KestrelException::kUnsupported, "functionName", "accepted is regression or classification"},
    {KestrelException::kUnsupported, "not Supported function name",
     "accepted are the functions in docs/functions.md; upper and lower case count"},
    {KestrelException::kUnsupported, "outlier handle method",
     "accepted as second argument is asIs, asMissingValues or asExtremeValues"},
    {KestrelException::kUnsupported, "not predefined",
     "accepted is a data field, or a derived field that stands before"},
    {KestrelException::kUnsupported, "defined already", "two settings contradict each other; remove one"},
    {KestrelException::kUnsupported, "", "export the model in a form without this construct"},
    {KestrelException::kInvalidDocument, "Invalid XML file",
     "up to here it is well-formed XML; what follows is not, needs something outside of the document, or is "
     "beyond the limits in docs/documents.md"},
    {KestrelException::kInvalidDocument, "invalid normalizationMethod",
     "accepted is none, softmax, simplemax, logit, probit, cloglog, loglog, cauchit or exp"},
    {KestrelException::kInvalidDocument, "invalid usageType",
     "accepted is active, target, predicted, supplementary, order, group, frequencyWeight or analysisWeight"},
    {KestrelException::kInvalidDocument, "invalid optype", "accepted is continuous, categorical or ordinal"},
    {KestrelException::kInvalidDocument, "invalid outliers",
     "accepted is asIs, asMissingValues or asExtremeValues"},
    {KestrelException::kInvalidDocument, "invalid missingValueTreatment",
     "accepted is asIs, asMean, asMode, asMedian, asValue or returnInvalid"},
    {KestrelException::kInvalidDocument, "invalid invalidValueTreatment",
     "accepted is returnInvalid, asIs, asMissing or asValue"},
    {KestrelException::kInvalidDocument, "invalid missingValueStrategy",
     "accepted is none, lastPrediction, nullPrediction, defaultChild, weightedConfidence or aggregateNodes"},
    {KestrelException::kInvalidDocument, "invalid missingValuePenalty", "accepted is a number from 0 to 1"},
    {KestrelException::kInvalidDocument, "invalid noTrueChildStrategy",
     "accepted is returnNullPrediction or returnLastPrediction"},
    {KestrelException::kInvalidDocument, "invalid splitCharacteristic",
     "accepted is binarySplit or multiSplit"},
    {KestrelException::kInvalidDocument, "invalid defaultChild",
     "accepted is the id of a Node directly in this one"},
    {KestrelException::kInvalidDocument, "invalid criterion",
     "accepted is firstHit, weightedMax or weightedSum"},
    {KestrelException::kInvalidDocument, "invalid recordCount", "accepted is a number that is not negative"},
    {KestrelException::kInvalidDocument, "property value", "accepted is valid, invalid or missing"},
    {KestrelException::kInvalidDocument, "invalidValueReplacement is required",
     "invalidValueTreatment=\"asValue\" needs invalidValueReplacement=\"...\" beside it"},
    {KestrelException::kInvalidDocument, "ScoreDistribution: invalid recordCount",
     "accepted is a number that is not negative"},
    {KestrelException::kInvalidDocument, "ScoreDistribution", "accepted is a number from 0 to 1"},
    {KestrelException::kInvalidDocument, "lowValue is above", "exchange the two"},
    {KestrelException::kInvalidDocument, "parameter",
     "docs/functions.md lists how many arguments each function takes"},
    {KestrelException::kInvalidDocument, "PMML error for",
     "accepted are a categorical field that lists its values, a continuous field, the means and the "
     "variances"},
    {KestrelException::kInvalidDocument, "<FieldRef> is allowed",
     "accepted is a FieldRef as the one argument"},
    {KestrelException::kInvalidDocument, "function is required",
     "the functions inside it must yield what the outer one takes"},
    {KestrelException::kInvalidDocument, "apply functions",
     "the functions inside it must yield what the outer one takes"},
    {KestrelException::kInvalidDocument, "type doesn't match",
     "docs/functions.md lists which functions take numbers and which texts"},
    {KestrelException::kInvalidDocument, "", "attributes with a list of values must have one of them"},
    {KestrelException::kInvalidValue, "",
     "a field that lists its categories takes these alone, and one that is not dataType=\"string\" numbers "
     "alone"},
    {KestrelException::kUnknownVariable, "active fields",
     "accepted is the name of a MiningField of this model with usageType=\"active\" or none"},
    {KestrelException::kUnknownVariable, "in the dictionary!",
     "accepted is the name of a DataField; upper and lower case count"},
    {KestrelException::kUnknownVariable, "Invalid Split Variable",
     "accepted is the name of a DataField; upper and lower case count"},
    {KestrelException::kUnknownVariable, "not predefined",
     "accepted is a data field, or a derived field that stands before"},
    {KestrelException::kUnknownVariable, "same type",
     "accepted as mapMissingTo is a value of the field's type"},
    {KestrelException::kUnknownVariable, "", "every DataField needs a name of its own"},
    {KestrelException::kInvalidOperator, " Invalid Operator!", "accepted is isIn or isNotIn"},
    {KestrelException::kInvalidOperator, "Invalid operator!!",
     "accepted on a categorical field is equal, notEqual, isMissing or isNotMissing; on an ordinal one also "
     "lessThan, "
     "lessOrEqual, greaterThan and greaterOrEqual, if they leave a category"},
    {KestrelException::kInvalidOperator, "", "the operator must fit the field"},
    {KestrelException::kInvalidType, "Invalid Boolean Operator", "accepted is or, and, xor or surrogate"},
    {KestrelException::kInvalidType, "string variable",
     "dataType=\"string\" goes with optype categorical or ordinal"},
    {KestrelException::kInvalidType, "flag", "a flag is a field with optype=\"categorical\""},
    {KestrelException::kInvalidType, "",
     "accepted as optype is continuous, categorical or ordinal; where a number is needed, no text field"},
    {KestrelException::kInconsistentDictionary, "numberOfFields",
     "accepted is the number of DataField elements"},
    {KestrelException::kInconsistentDictionary, "array size",
     "n must be the number of elements; blanks part them, and one with blanks stands in double quotes"},
    {KestrelException::kInconsistentDictionary, "two categories", "a flag lists two categories"},
    {KestrelException::kInconsistentDictionary, "",
     "correct the DataDictionary so that it does not contradict itself"},
};

}  // namespace

const char* HintForFault(int code, const std::string& message) {
  for (const Hint& hint : kHints) {
    if (hint.code == code && message.find(hint.part) != std::string::npos) return hint.text;
  }
  return nullptr;
}

}  // namespace kestrel_program
