// The MapValues expression: a table of values in the document.

#include <memory>
#include <string>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/transform/TransformVar.h"
#include "kestrel/transform/ValueMatcher.h"
#include "kestrel/translate/DerivedValues.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/VerifiedText.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

namespace {

using xercesc::DOMElement;
using xercesc::DOMNode;
using Tag = PMMLTagText;

/// Reads one MapValues element into its field.
class MapValuesReader {
 public:
  MapValuesReader(const DOMElement* element, TransformVar& variable, const ScoreDictionary* dictionary,
                  const ScoreDictionary* derived)
      : element_(element), variable_(variable), dictionary_(dictionary), derived_(derived) {}

  /// Returns the name of the field that the table is entered with.
  std::string Read();

 private:
  void ReadChild(const DOMElement* child);
  void ReadExtension(const DOMElement* extension);
  void ReadPair(const DOMElement* pair);
  void ReadTable(const DOMElement* table);
  void ReadRow(const DOMElement* row);
  const DOMElement* RequireCell(const DOMElement* row, const std::u16string& column) const;
  std::unique_ptr<ScoreValue> ReadCell(const DOMElement* cell, const ScoreDictVar& variable) const;
  void Add(std::unique_ptr<ScoreValue> input, std::unique_ptr<ScoreValue> output);

  const DOMElement* const element_;
  TransformVar& variable_;
  const ScoreDictionary* const dictionary_;
  const ScoreDictionary* const derived_;
  const ScoreDictVar* source_ = nullptr;
  std::u16string input_column_;
  std::u16string output_column_;
  bool has_table_ = false;
};

std::string MapValuesReader::Read() {
  output_column_ = ToUtf16(RequiredAttribute(element_, Tag::XML_ATT_MAPVALUES_OUTCOLUMN));
  ReadDefaultValue(element_, variable_);
  ReadMissingReplacement(element_, variable_);
  for (const DOMElement* child : ChildElements(element_))
    ReadChild(child);
  if (source_ == nullptr || !has_table_) {
    FailAt(element_, KestrelException::kStructure,
           "No Element Found from " + Narrow(element_->getNodeName()) + "!!!");
  }
  return source_->GetName();
}

void MapValuesReader::ReadChild(const DOMElement* child) {
  if (ElementIs(child, Tag::XML_ELE_EXTENSION)) {
    ReadExtension(child);
  } else if (ElementIs(child, Tag::XML_ELE_FIELDCOLPAIR)) {
    ReadPair(child);
  } else if (ElementIs(child, Tag::XML_ELE_INLTABLE)) {
    ReadTable(child);
  } else {
    FailAt(child, KestrelException::kStructure, "Invalid element!");
  }
}

void MapValuesReader::ReadExtension(const DOMElement* extension) {
  const XMLCh* const name = Attribute(extension, Tag::XML_ATT_EXT_NAME);
  if (!Equals(name, Tag::XML_ATT_TRAN_EXT_NAME_RECODETARGETSYSMIS)) {
    PMMLTranslator::HandleVEXAExtensions(extension, &variable_);
    return;
  }
  RequireNumericTarget(extension, variable_);
  const double input = VerifyDoubleAt(extension, RequiredAttribute(extension, Tag::XML_ATT_EXT_VALUE));
  Add(std::make_unique<NumericValue>(input), std::make_unique<NumericValue>());
}

void MapValuesReader::ReadPair(const DOMElement* pair) {
  if (source_ != nullptr) {
    FailAt(pair, KestrelException::kUnsupported, "Multi-dimensional case not supported!!");
  }
  const std::string name = Narrow(RequiredAttribute(pair, Tag::XML_ATT_FIELD));
  source_ = FindField(dictionary_, derived_, name);
  if (source_ == nullptr) FailOnField(pair, KestrelException::kUnsupported, name, ": not predefined!");
  input_column_ = ToUtf16(RequiredAttribute(pair, Tag::XML_ATT_FIELDCOLPAIR_COLUMN));
}

void MapValuesReader::ReadTable(const DOMElement* table) {
  if (source_ == nullptr) {
    FailAt(table, KestrelException::kStructure, "Element <FieldColumnPair> should defined before!");
  }
  if (has_table_) FailAt(table, KestrelException::kStructure, "Only one <InlineTable> is allowed!!");
  has_table_ = true;
  for (const DOMElement* child : ChildElements(table)) {
    if (ElementIs(child, Tag::XML_ELE_EXTENSION)) continue;
    if (!ElementIs(child, Tag::XML_ELE_ROW)) FailOnElement(child);
    ReadRow(child);
  }
}

void MapValuesReader::ReadRow(const DOMElement* row) {
  const DOMElement* const input = RequireCell(row, input_column_);
  const DOMElement* const output = RequireCell(row, output_column_);
  std::unique_ptr<ScoreValue> value = ReadCell(input, *source_);
  Add(std::move(value), ReadCell(output, variable_));
}

const DOMElement* MapValuesReader::RequireCell(const DOMElement* row, const std::u16string& column) const {
  const DOMElement* const cell = FirstChild(row, column.c_str());
  if (cell == nullptr) {
    FailAt(row, KestrelException::kStructure,
           "Child element " + Narrow(ToXMLCh(column.c_str())) + " is not found in <Row>!");
  }
  return cell;
}

std::unique_ptr<ScoreValue> MapValuesReader::ReadCell(const DOMElement* cell,
                                                      const ScoreDictVar& variable) const {
  const DOMNode* const only = cell->getFirstChild();
  // Nearly every cell is one piece of text, which is converted where it stands.
  if (only != nullptr && only->getNextSibling() == nullptr && only->getNodeType() == DOMNode::TEXT_NODE) {
    return MakeValueAt(cell, variable, only->getNodeValue());
  }
  return MakeValueAt(cell, variable, ToXMLCh(ElementText(cell).c_str()));
}

void MapValuesReader::Add(std::unique_ptr<ScoreValue> input, std::unique_ptr<ScoreValue> output) {
  auto matcher = std::make_unique<ValueMatcher>(input.release());
  variable_.AddEncodingMap(matcher.release(), output.release());
}

}  // namespace

std::string PMMLTranslator::HandleMapValues(DOMElement* element, TransformVar* variable,
                                            const ScoreDictionary* dictionary,
                                            const ScoreDictionary* derived) {
  return MapValuesReader(element, *variable, dictionary, derived).Read();
}

}  // namespace MCKestrel_800
