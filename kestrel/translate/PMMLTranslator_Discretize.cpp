// The Discretize expression: intervals and what becomes of the values in them.

#include <iterator>
#include <memory>
#include <set>
#include <string>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/predicates/Range.h"
#include "kestrel/transform/TransformVar.h"
#include "kestrel/translate/DerivedValues.h"
#include "kestrel/translate/IntervalClosure.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/VerifiedText.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

namespace {

using xercesc::DOMElement;
using Tag = PMMLTagText;

const IntervalClosure& ReadClosure(const DOMElement* interval) {
  const IntervalClosure* const closure = FindClosure(interval);
  if (closure != nullptr) return *closure;
  FailAt(interval, KestrelException::kStructure, "In valid closure value in <InterVal>.");
}

/// Null when the margin is absent or empty.
std::unique_ptr<ScoreValue> ReadMargin(const DOMElement* interval, const char16_t* name) {
  const XMLCh* const text = Attribute(interval, name);
  if (IsEmpty(text)) return nullptr;
  return std::make_unique<NumericValue>(VerifyDoubleAt(interval, text));
}

/// Ranges of numbers of which no two have a number in common, kept in order, so that a new one has two
/// neighbours to be compared with however many there are.
class DisjointRanges {
 public:
  /// False, leaving it out, when the range has a number in common with one before.
  bool Add(const ScoreValueRange& range);

 private:
  struct Span {
    double low;
    double high;
    bool low_included;
    bool high_included;

    /// Where two begin at the same number, the one that holds it comes first.
    bool operator<(const Span& other) const {
      if (low != other.low) return low < other.low;
      if (low_included != other.low_included) return low_included;
      return high < other.high;
    }
    /// Of a span that comes before the other. Margins are the same by the rule by which ranges compare them.
    bool ReachesInto(const Span& other) const {
      if (NumericValue::IsEqual(high, other.low)) return high_included && other.low_included;
      return high > other.low;
    }
  };

  std::set<Span> spans_;
};

bool DisjointRanges::Add(const ScoreValueRange& range) {
  const double infinity = NumericValue::GetInfinity();
  const ScoreValue* const min = range.GetMin();
  const ScoreValue* const max = range.GetMax();
  Span span = {min != nullptr ? min->GetDouble() : -infinity, max != nullptr ? max->GetDouble() : infinity,
               range.GetLowEnd(), range.GetHighEnd()};
  if (NumericValue::IsEqual(span.low, span.high)) {
    // A range whose ends are equal holds that number whatever it says of its ends.
    span.low_included = span.high_included = true;
  } else if (span.low > span.high) {
    return true;  // it holds nothing
  }
  const auto next = spans_.lower_bound(span);
  if (next != spans_.end() && span.ReachesInto(*next)) return false;
  if (next != spans_.begin() && std::prev(next)->ReachesInto(span)) return false;
  spans_.insert(next, span);
  return true;
}

/// Reads one Discretize element into its field.
class DiscretizeReader {
 public:
  DiscretizeReader(const DOMElement* element, TransformVar& variable)
      : element_(element), variable_(variable) {}

  void Read();

 private:
  void ReadExtension(const DOMElement* extension);
  void ReadBin(const DOMElement* bin);
  void AddBin(const DOMElement* interval, std::unique_ptr<ScoreValueRange> range,
              std::unique_ptr<ScoreValue> value);

  const DOMElement* const element_;
  TransformVar& variable_;
  DisjointRanges ranges_;
};

/// The one interval in an element.
const DOMElement* RequireInterval(const DOMElement* parent) {
  const DOMElement* interval = nullptr;
  for (const DOMElement* child : ChildElements(parent)) {
    if (ElementIs(child, Tag::XML_ELE_EXTENSION)) continue;
    if (!ElementIs(child, Tag::XML_ELE_INTERVAL)) {
      FailAt(child, KestrelException::kStructure, "Only <Extension> and <Interval> are allowed!");
    }
    if (interval != nullptr) {
      FailAt(child, KestrelException::kStructure, "ONLY one <Interval> is allowed.");
    }
    interval = child;
  }
  if (interval == nullptr) FailAt(parent, KestrelException::kStructure, "Element Interval is required");
  return interval;
}

std::unique_ptr<ScoreValueRange> ReadRange(const DOMElement* interval) {
  return std::unique_ptr<ScoreValueRange>(PMMLTranslator::HandleDiscretizeBinInterVal(interval));
}

void DiscretizeReader::Read() {
  ReadDefaultValue(element_, variable_);
  ReadMissingReplacement(element_, variable_);
  bool has_bin = false;
  for (const DOMElement* child : ChildElements(element_)) {
    if (ElementIs(child, Tag::XML_ELE_EXTENSION)) {
      ReadExtension(child);
    } else if (ElementIs(child, Tag::XML_ELE_DISCRETIZEBIN)) {
      has_bin = true;
      ReadBin(child);
    } else {
      FailAt(child, KestrelException::kStructure, "Only <Extension> and <DisCretizeBin> are allowed!");
    }
  }
  if (!has_bin) FailAt(element_, KestrelException::kStructure, "<DiscretizeBin> is required");
}

void DiscretizeReader::ReadExtension(const DOMElement* extension) {
  const XMLCh* const name = Attribute(extension, Tag::XML_ATT_EXT_NAME);
  if (Equals(name, Tag::XML_ATT_TRAN_EXT_NAME_RECODETARGETSYSMIS)) {
    RequireNumericTarget(extension, variable_);
    const DOMElement* const interval = RequireInterval(extension);
    AddBin(interval, ReadRange(interval), std::make_unique<NumericValue>());
  } else if (Equals(name, Tag::XML_ATT_TRAN_EXT_NAME_INTERVALCOPY)) {
    const DOMElement* const interval = RequireInterval(extension);
    AddBin(interval, ReadRange(interval), nullptr);
    variable_.SetRecodeIntervalCopy(ReadRange(interval).release());
  } else {
    PMMLTranslator::HandleVEXAExtensions(extension, &variable_);
  }
}

void DiscretizeReader::ReadBin(const DOMElement* bin) {
  const XMLCh* const text = FindAttribute(bin, Tag::XML_ATT_BINVALUE);
  std::unique_ptr<ScoreValue> value;
  if (text != nullptr) value = MakeValueAt(bin, variable_, text);
  const DOMElement* const interval = RequireInterval(bin);
  AddBin(interval, ReadRange(interval), std::move(value));
}

void DiscretizeReader::AddBin(const DOMElement* interval, std::unique_ptr<ScoreValueRange> range,
                              std::unique_ptr<ScoreValue> value) {
  if (!ranges_.Add(*range)) {
    FailAt(interval, KestrelException::kStructure, "Only disjoint value range is allowed");
  }
  variable_.AddBinningValue(range.release(), value.release());
}

}  // namespace

std::string PMMLTranslator::HandleDiscritize(DOMElement* element, TransformVar* variable,
                                             const ScoreDictionary* dictionary,
                                             const ScoreDictionary* derived) {
  std::string name = Narrow(RequiredAttribute(element, Tag::XML_ATT_FIELD));
  if (FindField(dictionary, derived, name) == nullptr) {
    FailOnField(element, KestrelException::kStructure, name, ": not predefined!");
  }
  DiscretizeReader(element, *variable).Read();
  return name;
}

ScoreValueRange* PMMLTranslator::HandleDiscretizeBinInterVal(const DOMElement* interval) {
  const IntervalClosure& closure = ReadClosure(interval);
  std::unique_ptr<ScoreValue> left = ReadMargin(interval, Tag::XML_ATT_INTERVAL_LEFTMARGIN);
  std::unique_ptr<ScoreValue> right = ReadMargin(interval, Tag::XML_ATT_INTERVAL_RIGHTMARGIN);
  if (left == nullptr && right == nullptr) {
    FailAt(interval, KestrelException::kStructure, "At least one margin must be defined.");
  }
  return new Range(left.release(), right.release(), closure.left, closure.right);
}

}  // namespace MCKestrel_800
