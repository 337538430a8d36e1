// The Apply expression: a tree of functions, fields and constants.

#include <memory>
#include <string>
#include <vector>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/foundation/NarrowText.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/transform/BuiltinFunctions.h"
#include "kestrel/transform/FunctionTreeImp.h"
#include "kestrel/transform/TransformVar.h"
#include "kestrel/translate/DerivedValues.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/VerifiedText.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

namespace {

using xercesc::DOMElement;
using Kind = FunctionValueKind;
using Tag = PMMLTagText;

// The names of constants, by what they hold. No reader of trees relies on more than the letter.
constexpr char kNumberName[] = "Constant_D_";
constexpr char kDateTimeName[] = "Constant_T_";
constexpr char kOtherName[] = "Constant_S_";

/// Which argument of "outlierHandle" names the method.
constexpr int kOutlierMethod = 1;

struct TreatmentRow {
  const char16_t* text;
  ApplyNodeStats::InvalidValueTreatment treatment;
};

constexpr TreatmentRow kTreatments[] = {
    {Tag::XML_ATT_RETURNINVALID, ApplyNodeStats::kReturnInvalid},
    {Tag::XML_ATT_ASIS, ApplyNodeStats::kAsIs},
    {Tag::XML_ATT_ASMISSING, ApplyNodeStats::kAsMissing},
};

ApplyNodeStats::InvalidValueTreatment ReadTreatment(const DOMElement* apply) {
  const XMLCh* const text = Attribute(apply, Tag::XML_ATT_INVALIDVALUETREATMENT);
  for (const TreatmentRow& row : kTreatments) {
    if (Equals(text, row.text)) return row.treatment;
  }
  return ApplyNodeStats::kNotGiven;
}

/// The number that a text is; null when it is none.
std::unique_ptr<ScoreValue> NumberOf(const std::string& text) {
  try {
    return std::make_unique<NumericValue>(BaseTranslator::VerifyDouble(text));
  } catch (const KestrelException&) {
    return nullptr;
  }
}

Kind KindOfType(ScoreDictVar::VariableType type) {
  if (type == ScoreDictVar::kNUMERIC_VAR) return Kind::kNumber;
  return type == ScoreDictVar::kDATETIME_VAR ? Kind::kDateTime : Kind::kText;
}

/// What a node yields, as far as that is known; else kAny.
Kind KindOf(const FunctionTree* node) {
  while (node != nullptr && node->GetNodeStats().GetTransFunction() != kNoFunction) {
    const BuiltinFunction* const row = FindBuiltinFunction(node->GetNodeStats().GetTransFunction());
    if (row == nullptr) return Kind::kAny;
    if (row->result != Kind::kFirstArgument && row->result != Kind::kArgument) return row->result;
    node = node->GetChildAt(row->result == Kind::kArgument ? 1 : 0);
  }
  if (node == nullptr) return Kind::kAny;
  const ApplyNodeStats& stats = node->GetNodeStats();
  if (const ScoreValue* const value = stats.GetValue(); value != nullptr) {
    if (value->GetType() == ScoreValue::kString) return Kind::kText;
    return value->GetType() == ScoreValue::kDateTime ? Kind::kDateTime : Kind::kNumber;
  }
  return stats.GetVariable() != nullptr ? KindOfType(stats.GetVariable()->GetVarType()) : Kind::kAny;
}

/// The type of the values among which one is looked for: that of the argument.
class ElementType {
 public:
  explicit ElementType(const FunctionTree* argument)
      : variable_(argument != nullptr ? argument->GetNodeStats().GetVariable() : nullptr),
        is_text_(KindOf(argument) == Kind::kText) {}

  std::unique_ptr<ScoreValue> Make(const DOMElement* where, const std::string& text) const {
    if (variable_ != nullptr) {
      return MakeValueAt(where, *variable_, ToXMLCh(MCXML_800::NarrowToUtf16(text).c_str()));
    }
    if (!is_text_) {
      if (auto number = NumberOf(text); number != nullptr) return number;
    }
    return std::make_unique<StringValue>(text);
  }

 private:
  const ScoreDictVar* const variable_;
  const bool is_text_;
};

/// Builds the tree of one Apply element. It goes down and up the document's tree and its own side by side, so
/// that depth costs no stack.
class ApplyReader {
 public:
  ApplyReader(const TransformVar& variable, const ScoreDictionary* dictionary, const ScoreDictionary* derived)
      : variable_(variable), dictionary_(dictionary), derived_(derived) {}

  std::unique_ptr<FunctionTree> Read(const DOMElement* top);

 private:
  std::unique_ptr<FunctionTree> Open(const DOMElement* apply);
  void AddLeaf(const DOMElement* child, const DOMElement* apply, FunctionTree& node);
  std::unique_ptr<FunctionTree> MakeFieldRef(const DOMElement* element);
  std::unique_ptr<FunctionTree> MakeConstant(const DOMElement* element, const DOMElement* apply,
                                             const FunctionTree& node);
  std::unique_ptr<ScoreValue> ReadUntyped(const DOMElement* constant, const DOMElement* apply,
                                          const FunctionTree& node) const;
  bool IsComparedWithText(const DOMElement* apply) const;
  std::unique_ptr<ScoreValue> ReadReplacement(const DOMElement* apply, const BuiltinFunction& function) const;

  void Close(const DOMElement* apply, FunctionTree& node) const;
  void ReadArrays(const DOMElement* apply, FunctionTree& node) const;
  void TakeListedConstants(const DOMElement* apply, FunctionTree& node) const;
  void CheckOutlierMethod(const DOMElement* apply, const FunctionTree& node) const;

  const TransformVar& variable_;
  const ScoreDictionary* const dictionary_;
  const ScoreDictionary* const derived_;
  int count_ = 0;
};

/// Values of an array on their way into a node.
class ValueList {
 public:
  void Add(std::unique_ptr<ScoreValue> value) { values_.push_back(std::move(value)); }
  void GiveTo(FunctionTree& node) {
    std::vector<ScoreValue*> given;
    given.reserve(values_.size());
    for (std::unique_ptr<ScoreValue>& value : values_)
      given.push_back(value.release());
    ApplyNodeStats stats(node.GetNodeStats());
    stats.AddArray(given);
    node.SetNodeStats(stats);
  }

 private:
  std::vector<std::unique_ptr<ScoreValue>> values_;
};

/// The parent of an element below the one at the top.
const DOMElement* ParentOf(const DOMElement* element) {
  return static_cast<const DOMElement*>(element->getParentNode());
}

std::unique_ptr<FunctionTree> ApplyReader::Read(const DOMElement* top) {
  std::unique_ptr<FunctionTree> root = Open(top);
  FunctionTree* node = root.get();
  const DOMElement* apply = top;
  const DOMElement* child = FirstChild(top);
  for (;;) {
    if (child == nullptr) {
      Close(apply, *node);
      if (apply == top) return root;
      child = NextSibling(apply);
      apply = ParentOf(apply);
      node = node->GetParent();
    } else if (ElementIs(child, Tag::XML_ELE_APPLY)) {
      std::unique_ptr<FunctionTree> inner = Open(child);
      node->Add(inner.get());
      node = inner.release();
      apply = child;
      child = FirstChild(apply);
    } else {
      AddLeaf(child, apply, *node);
      child = NextSibling(child);
    }
  }
}

std::unique_ptr<FunctionTree> ApplyReader::Open(const DOMElement* apply) {
  const std::string name = Narrow(RequiredAttribute(apply, Tag::XML_ATT_APPLY_FUNCTION));
  const TransformFunction code = PMMLTranslator::GetTransFunction(name);
  if (code == kNoFunction) {
    FailAt(apply, KestrelException::kUnsupported, name + ": not Supported function name");
  }
  ApplyNodeStats stats;
  stats.SetNodeID(std::to_string(++count_));
  stats.SetParameterName(name);
  stats.SetTransFunction(code);
  stats.SetInvalidValueTreatment(ReadTreatment(apply));
  stats.SetRecodeMissValueTo(ReadReplacement(apply, *FindBuiltinFunction(code)).release());
  return std::make_unique<FunctionTreeImp>(stats);
}

/// Null when the attribute is absent. What a function of any kind is replaced by is a number when it reads as
/// one.
std::unique_ptr<ScoreValue> ApplyReader::ReadReplacement(const DOMElement* apply,
                                                         const BuiltinFunction& function) const {
  const XMLCh* const text = Attribute(apply, Tag::XML_ATT_MISSREPVALUE);
  if (IsEmpty(text)) return nullptr;
  if (function.result == Kind::kNumber) return std::make_unique<NumericValue>(VerifyDoubleAt(apply, text));
  const std::string narrow = Narrow(text);
  if (function.result != Kind::kText) {
    if (auto number = NumberOf(narrow); number != nullptr) return number;
  }
  return std::make_unique<StringValue>(narrow);
}

void ApplyReader::AddLeaf(const DOMElement* child, const DOMElement* apply, FunctionTree& node) {
  std::unique_ptr<FunctionTree> leaf;
  if (ElementIs(child, Tag::XML_ELE_FIELDREF)) {
    leaf = MakeFieldRef(child);
  } else if (ElementIs(child, Tag::XML_ELE_CONSTANT)) {
    leaf = MakeConstant(child, apply, node);
  } else if (ElementIs(child, Tag::XML_ELE_EXTENSION) || ElementIs(child, Tag::XML_ELE_ARRAY)) {
    return;  // arrays are read when the arguments are known
  } else {
    FailOnElement(child);
  }
  node.Add(leaf.get());
  static_cast<void>(leaf.release());
}

std::unique_ptr<FunctionTree> ApplyReader::MakeFieldRef(const DOMElement* element) {
  const std::string name = Narrow(RequiredAttribute(element, Tag::XML_ATT_FIELD));
  const ScoreDictVar* const source = RequireField(element, dictionary_, derived_, name);
  ApplyNodeStats stats;
  stats.SetNodeID(std::to_string(++count_));
  stats.SetParameterName(name);
  stats.SetVariable(source);
  stats.SetFieldrefRecodeMissValueTo(ReadFieldReplacement(element, *source, variable_.GetName()).release());
  return std::make_unique<FunctionTreeImp>(stats);
}

std::unique_ptr<FunctionTree> ApplyReader::MakeConstant(const DOMElement* element, const DOMElement* apply,
                                                        const FunctionTree& node) {
  std::unique_ptr<ScoreValue> value =
      IsEmpty(Attribute(element, Tag::XML_ATT_DATATYPE))
          ? ReadUntyped(element, apply, node)
          : std::unique_ptr<ScoreValue>(PMMLTranslator::HandelConstant(element));
  const ScoreValue::ValueType type = value->GetType();
  ApplyNodeStats stats;
  stats.SetNodeID(std::to_string(++count_));
  stats.SetParameterName(type == ScoreValue::kNumeric    ? kNumberName
                         : type == ScoreValue::kDateTime ? kDateTimeName
                                                         : kOtherName);
  stats.SetConstNode(true);
  stats.SetValue(value.release());
  return std::make_unique<FunctionTreeImp>(stats);
}

/// A constant without a type is a text where only a text makes sense, and a number everywhere else, which is
/// the missing one when it does not read as a number.
std::unique_ptr<ScoreValue> ApplyReader::ReadUntyped(const DOMElement* constant, const DOMElement* apply,
                                                     const FunctionTree& node) const {
  std::string text;
  PMMLTranslator::HandelConstant(constant, text);
  const BuiltinFunction& function = *FindBuiltinFunction(node.GetNodeStats().GetTransFunction());
  const Kind wanted = function.KindOfArgument(node.GetChildCount());
  bool is_text = wanted == Kind::kText;
  if (wanted == Kind::kAny) {
    // What is compared stands first or second; whatever follows is one argument too many.
    is_text = (node.GetChildCount() < 2 && IsComparedWithText(apply)) || NumberOf(text) == nullptr;
  }
  if (is_text) return std::make_unique<StringValue>(text);
  return std::make_unique<NumericValue>(text);
}

bool ApplyReader::IsComparedWithText(const DOMElement* apply) const {
  const DOMElement* const reference = FirstChild(apply, Tag::XML_ELE_FIELDREF);
  const XMLCh* const function = Attribute(apply, Tag::XML_ATT_APPLY_FUNCTION);
  const bool compares =
      Equals(function, Tag::XML_VEXA_TRANFUNC_EQUAL) || Equals(function, Tag::XML_VEXA_TRANFUNC_NOTEQUAL);
  if (reference == nullptr || !compares) return false;
  const ScoreDictVar* const field =
      FindField(dictionary_, derived_, AttributeText(reference, Tag::XML_ATT_FIELD));
  return field != nullptr && field->GetVarType() == ScoreDictVar::STRING_VAR;
}

void ApplyReader::Close(const DOMElement* apply, FunctionTree& node) const {
  ReadArrays(apply, node);
  const TransformFunction code = node.GetNodeStats().GetTransFunction();
  if (code == kIsInFunction || code == kIsNotInFunction) TakeListedConstants(apply, node);
  if (code == kOutlierHandleFunction) CheckOutlierMethod(apply, node);
  PMMLTranslator::VerifyApplyFunction(apply, node);
}

void ApplyReader::ReadArrays(const DOMElement* apply, FunctionTree& node) const {
  const BuiltinFunction& function = *FindBuiltinFunction(node.GetNodeStats().GetTransFunction());
  const bool numbers = function.code == kImputeFunction;
  const ElementType type(node.GetChildAt(0));
  for (const DOMElement* array : ChildElements(apply, Tag::XML_ELE_ARRAY)) {
    if (function.arrays == 0) FailOnElement(array);
    // Not left to the check of the whole node: adding an array copies those before it.
    if (node.GetNodeStats().GetNumberOfArray() == function.arrays) {
      FailAt(apply, KestrelException::kInvalidDocument, function.arity_text);
    }
    ValueList values;
    if (numbers) {
      for (const double number : PMMLTranslator::VerifyDoubleArray(array))
        values.Add(std::make_unique<NumericValue>(number));
    } else {
      for (const std::string& text : PMMLTranslator::GetArrayElements(array))
        values.Add(type.Make(array, text));
    }
    values.GiveTo(node);
  }
}

/// Documents write the list of "isIn" as an Array or as constants behind the value.
void ApplyReader::TakeListedConstants(const DOMElement* apply, FunctionTree& node) const {
  if (node.GetNodeStats().GetNumberOfArray() != 0 || node.GetChildCount() < 2) return;
  const ElementType type(node.GetChildAt(0));
  ValueList values;
  int index = 0;
  for (const DOMElement* child : ChildElements(apply)) {
    if (ElementIs(child, Tag::XML_ELE_EXTENSION)) continue;
    if (index++ == 0) continue;
    if (!ElementIs(child, Tag::XML_ELE_CONSTANT)) return;
    values.Add(type.Make(child, ElementNarrowText(child)));
  }
  values.GiveTo(node);
  const std::vector<FunctionTree*> children = node.Children();
  for (size_t i = children.size(); i-- > 1;) {
    node.Remove(static_cast<int>(i));
    delete children[i];
  }
}

void ApplyReader::CheckOutlierMethod(const DOMElement* apply, const FunctionTree& node) const {
  const FunctionTree* const method = node.GetChildAt(kOutlierMethod);
  if (method == nullptr) return;  // the number of arguments is reported
  const ScoreValue* const value = method->GetNodeStats().GetValue();
  const std::string text = value != nullptr ? value->GetString() : std::string();
  for (const char16_t* known :
       {Tag::XML_VAL_MININGFIELD_OUTLIERS_ASMISS, Tag::XML_VAL_MININGFIELD_OUTLIERS_ASEXTREME,
        Tag::XML_VAL_MININGFIELD_OUTLIERS_ASIS}) {
    if (text == Narrow(ToXMLCh(known))) return;
  }
  FailOnField(apply, KestrelException::kUnsupported, variable_.GetName(),
              ": not Supported outlier handle method");
}

}  // namespace

FunctionTree* PMMLTranslator::HandleApply(const DOMElement* element, const TransformVar* variable,
                                          const ScoreDictionary* dictionary, const ScoreDictionary* derived) {
  return ApplyReader(*variable, dictionary, derived).Read(element).release();
}

}  // namespace MCKestrel_800
